// Icon lookup in freedesktop.org icon themes: index.theme lists a theme's
// icon folders and their sizes; only PNGs of the exact size are used.

#include <algorithm>
#include <cstdlib>
#include <cstring>

#include <glib.h>
#include <sys/stat.h>
#include <unistd.h>

#include "GioLock.h"
#include "TypeIcons.h"

namespace BPrivate {

namespace {

const char* const kDefaultTheme = "Adwaita";
const char* const kFallbackTheme = "hicolor";

struct KeyFileFree {
	void operator()(GKeyFile* file) const { g_key_file_free(file); }
};
typedef std::unique_ptr<GKeyFile, KeyFileFree> KeyFile;

struct StringListFree {
	void operator()(gchar** list) const { g_strfreev(list); }
};
typedef std::unique_ptr<gchar*, StringListFree> StringList;

std::string Environment(const char* name, const std::string& fallback)
{
	const char* value = getenv(name);
	return value != nullptr && value[0] != '\0' ? value : fallback;
}

std::vector<std::string> BaseFolders()
{
	std::vector<std::string> folders;
	std::string home = Environment("HOME", "");
	if (!home.empty())
		folders.push_back(home + "/.icons");
	std::string dataHome = Environment("XDG_DATA_HOME",
		home.empty() ? "" : home + "/.local/share");
	if (!dataHome.empty())
		folders.push_back(dataHome + "/icons");

	std::string dataDirs = Environment("XDG_DATA_DIRS",
		"/usr/local/share:/usr/share");
	size_t start = 0;
	while (start <= dataDirs.size()) {
		size_t end = std::min(dataDirs.find(':', start), dataDirs.size());
		if (end > start)
			folders.push_back(dataDirs.substr(start, end - start) + "/icons");
		start = end + 1;
	}
	return folders;
}

// A theme's index comes from the first base folder that has one.
KeyFile LoadIndex(const std::vector<std::string>& baseFolders,
	const std::string& theme)
{
	for (const std::string& folder : baseFolders) {
		KeyFile index(g_key_file_new());
		g_key_file_set_list_separator(index.get(), ',');
		std::string path = folder + "/" + theme + "/index.theme";
		if (g_key_file_load_from_file(index.get(), path.c_str(),
				G_KEY_FILE_NONE, nullptr))
			return index;
	}
	return nullptr;
}

bool IsFolder(const std::string& path)
{
	struct stat st;
	return stat(path.c_str(), &st) == 0 && S_ISDIR(st.st_mode);
}

}

IconTheme::IconTheme()
	: fBaseFolders(BaseFolders())
{
	std::lock_guard<std::mutex> lock(GioLock());
	// Depth first along Inherits, each theme once; hicolor always comes last.
	std::vector<std::string> pending{kDefaultTheme, kFallbackTheme};
	while (!pending.empty()) {
		std::string name = pending.front();
		pending.erase(pending.begin());
		bool seen = std::any_of(fThemes.begin(), fThemes.end(),
			[&](const Theme& theme) { return theme.name == name; });
		if (seen || (name == kFallbackTheme && !pending.empty()))
			continue;
		KeyFile index = LoadIndex(fBaseFolders, name);
		if (index == nullptr)
			continue;

		Theme theme{name, {}};
		StringList folders(g_key_file_get_string_list(index.get(),
			"Icon Theme", "Directories", nullptr, nullptr));
		for (gchar** folder = folders.get(); folder && *folder; folder++) {
			// Missing keys read as 0; Scale defaults to 1.
			int32 size = g_key_file_get_integer(index.get(), *folder, "Size",
				nullptr);
			int32 scale = g_key_file_get_integer(index.get(), *folder, "Scale",
				nullptr);
			gchar* type = g_key_file_get_string(index.get(), *folder, "Type",
				nullptr);
			bool scalable = type != nullptr && strcmp(type, "Scalable") == 0;
			g_free(type);
			if (scale <= 1 && !scalable)
				theme.folders.emplace_back(*folder, size);
		}
		fThemes.push_back(std::move(theme));

		StringList parents(g_key_file_get_string_list(index.get(),
			"Icon Theme", "Inherits", nullptr, nullptr));
		std::vector<std::string> inherited;
		for (gchar** parent = parents.get(); parent && *parent; parent++)
			inherited.push_back(*parent);
		pending.insert(pending.begin(), inherited.begin(), inherited.end());
	}
}

IconTheme::~IconTheme() = default;

IconRef IconTheme::Find(const std::vector<std::string>& names, int32 size,
	const std::function<IconRef(const std::string& path)>& load)
{
	for (const std::vector<std::string>& folders : _FoldersFor(size)) {
		for (const std::string& name : names) {
			if (name.empty() || name.find('/') != std::string::npos)
				continue;
			for (const std::string& folder : folders) {
				std::string path = folder + "/" + name + ".png";
				if (access(path.c_str(), R_OK) != 0)
					continue;
				if (IconRef icon = load(path))
					return icon;
			}
		}
	}
	return nullptr;
}

const IconTheme::FoldersPerTheme& IconTheme::_FoldersFor(int32 size)
{
	auto known = fFolders.find(size);
	if (known != fFolders.end())
		return known->second;

	FoldersPerTheme perTheme;
	for (const Theme& theme : fThemes) {
		std::vector<std::string> existing;
		for (const auto& [folder, folderSize] : theme.folders) {
			if (folderSize != size)
				continue;
			for (const std::string& base : fBaseFolders) {
				std::string path = base + "/" + theme.name + "/" + folder;
				if (IsFolder(path))
					existing.push_back(path);
			}
		}
		perTheme.push_back(std::move(existing));
	}
	return fFolders.emplace(size, std::move(perTheme)).first->second;
}

}
