#include <FindDirectory.h>

#include <cstdlib>
#include <cstring>

#include <Directory.h>
#include <Path.h>

#include "EntryPath.h"
#include "TrashRecords.h"
#include "UserFolders.h"

namespace {

status_t FolderFor(directory_which which, std::string* folder)
{
	using namespace BPrivate;
	switch (which) {
		case B_DESKTOP_DIRECTORY:
			*folder = DesktopFolder();
			return B_OK;
		case B_TRASH_DIRECTORY:
			return MakeHomeTrash(folder);
		case B_BEOS_APPS_DIRECTORY:
			*folder = "/usr/bin";
			return B_OK;
		case B_COMMON_TEMP_DIRECTORY: {
			const char* temp = std::getenv("TMPDIR");
			*folder = temp != nullptr && temp[0] == '/' ? temp : "/tmp";
			return B_OK;
		}
		case B_USER_DIRECTORY:
			*folder = HomeFolder();
			return B_OK;
		case B_USER_CONFIG_DIRECTORY:
		case B_USER_SETTINGS_DIRECTORY:
			*folder = ConfigHome();
			return B_OK;
		case B_USER_FONTS_DIRECTORY:
			*folder = JoinPath(DataHome(), "fonts");
			return B_OK;
	}
	return B_BAD_VALUE;
}

}

status_t find_directory(directory_which which, dev_t, bool createIt,
	char* returnedPath, int32 pathLength)
{
	if (returnedPath == nullptr || pathLength <= 0)
		return B_BAD_VALUE;
	std::string folder;
	status_t status = FolderFor(which, &folder);
	if (status == B_OK && createIt)
		status = create_directory(folder.c_str(), 0700);
	if (status != B_OK)
		return status;
	if (folder.size() >= static_cast<size_t>(pathLength))
		return B_NAME_TOO_LONG;
	std::memcpy(returnedPath, folder.c_str(), folder.size() + 1);
	return B_OK;
}

status_t find_directory(directory_which which, BPath* path, bool createIt,
	BVolume*)
{
	if (path == nullptr)
		return B_BAD_VALUE;
	char folder[B_PATH_NAME_LENGTH];
	status_t status = find_directory(which, 0, createIt, folder,
		sizeof(folder));
	return status == B_OK ? path->SetTo(folder) : status;
}
