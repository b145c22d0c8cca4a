#include "UserFolders.h"

#include <cstdlib>
#include <fstream>
#include <pwd.h>
#include <unistd.h>
#include <vector>

#include "EntryPath.h"

namespace BPrivate {

namespace {

// An XDG variable counts only when it holds an absolute path.
const char* AbsoluteVariable(const char* name)
{
	const char* value = std::getenv(name);
	return value != nullptr && value[0] == '/' ? value : nullptr;
}

// XDG_DESKTOP_DIR of user-dirs.dirs: "$HOME/Name" or "/path", in quotes,
// with backslash escapes.
std::string DesktopFromUserDirs()
{
	std::ifstream file(JoinPath(ConfigHome(), "user-dirs.dirs"));
	const std::string key = "XDG_DESKTOP_DIR=\"";
	std::string line;
	while (std::getline(file, line)) {
		if (line.compare(0, key.size(), key) != 0)
			continue;
		std::string value;
		for (size_t i = key.size(); i < line.size() && line[i] != '"'; i++) {
			if (line[i] == '\\' && i + 1 < line.size())
				i++;
			value += line[i];
		}
		if (value.compare(0, 5, "$HOME") == 0
			&& (value.size() == 5 || value[5] == '/'))
			value = HomeFolder() + value.substr(5);
		if (!value.empty() && value[0] == '/')
			return value;
	}
	return "";
}

}

std::string HomeFolder()
{
	const char* home = AbsoluteVariable("HOME");
	if (home != nullptr)
		return home;
	long size = sysconf(_SC_GETPW_R_SIZE_MAX);
	std::vector<char> buffer(size > 0 ? size : 16384);
	passwd entry;
	passwd* result = nullptr;
	if (getpwuid_r(getuid(), &entry, buffer.data(), buffer.size(), &result)
			== 0 && result != nullptr && result->pw_dir[0] == '/') {
		return result->pw_dir;
	}
	return "/";
}

std::string DataHome()
{
	const char* dataHome = AbsoluteVariable("XDG_DATA_HOME");
	return dataHome != nullptr ? dataHome
		: JoinPath(HomeFolder(), ".local/share");
}

std::string ConfigHome()
{
	const char* configHome = AbsoluteVariable("XDG_CONFIG_HOME");
	return configHome != nullptr ? configHome
		: JoinPath(HomeFolder(), ".config");
}

std::string DesktopFolder()
{
	std::string desktop = DesktopFromUserDirs();
	return desktop.empty() ? JoinPath(HomeFolder(), "Desktop") : desktop;
}

}
