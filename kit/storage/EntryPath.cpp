#include "EntryPath.h"

#include <climits>
#include <cstdlib>
#include <cstring>
#include <memory>
#include <fcntl.h>
#include <unistd.h>

#include <Directory.h>
#include <Entry.h>
#include <NodeMonitor.h>

#include "DirectoryRegistry.h"
#include "ErrnoStatus.h"
#include "VolumeTable.h"

namespace BPrivate {

namespace {

void SplitPath(const std::string& path, EntryPath* entry)
{
	if (path == "/") {
		entry->folder = "/";
		entry->leaf = ".";
		return;
	}
	size_t slash = path.rfind('/');
	entry->folder = slash == 0 ? "/" : path.substr(0, slash);
	entry->leaf = path.substr(slash + 1);
}

status_t AbsolutePath(const char* path, std::string* absolute)
{
	if (path == nullptr || path[0] == '\0')
		return B_BAD_VALUE;
	if (path[0] == '/') {
		*absolute = path;
		return B_OK;
	}
	std::unique_ptr<char, decltype(&std::free)> cwd(getcwd(nullptr, 0),
		&std::free);
	if (cwd == nullptr)
		return StatusFromErrno();
	*absolute = JoinPath(cwd.get(), path);
	return B_OK;
}

}

std::string EntryPath::Path() const
{
	return leaf == "." ? folder : JoinPath(folder, leaf);
}

status_t PathOfDirectory(const BDirectory* dir, std::string* path)
{
	if (dir == nullptr)
		return B_BAD_VALUE;
	BEntry folder;
	entry_ref ref;
	EntryPath entry;
	status_t status = dir->GetEntry(&folder);
	if (status == B_OK)
		status = folder.GetRef(&ref);
	if (status == B_OK)
		status = EntryForRef(ref, &entry);
	if (status == B_OK)
		*path = entry.Path();
	return status;
}

std::string JoinPath(const std::string& folder, const std::string& leaf)
{
	if (!folder.empty() && folder.back() == '/')
		return folder + leaf;
	return folder + "/" + leaf;
}

status_t CheckName(const char* name)
{
	if (name == nullptr || name[0] == '\0' || std::strchr(name, '/') != nullptr
		|| std::strcmp(name, ".") == 0 || std::strcmp(name, "..") == 0) {
		return B_BAD_VALUE;
	}
	if (std::strlen(name) >= B_FILE_NAME_LENGTH)
		return B_NAME_TOO_LONG;
	return B_OK;
}

status_t CanonicalPath(const char* path, std::string* canonical)
{
	if (path == nullptr || path[0] == '\0')
		return B_BAD_VALUE;
	std::unique_ptr<char, decltype(&std::free)> resolved(
		realpath(path, nullptr), &std::free);
	if (resolved == nullptr)
		return StatusFromErrno();
	*canonical = resolved.get();
	return B_OK;
}

status_t CanonicalEntry(const char* path, bool traverse, EntryPath* entry)
{
	std::string absolute;
	status_t status = AbsolutePath(path, &absolute);
	if (status != B_OK)
		return status;

	std::string trimmed = absolute;
	while (trimmed.size() > 1 && trimmed.back() == '/')
		trimmed.pop_back();
	SplitPath(trimmed, entry);
	// A trailing "/" asks for a folder, and "." and ".." name one.
	if (trimmed != absolute || entry->leaf == "." || entry->leaf == "..") {
		std::string canonical;
		status = CanonicalPath(absolute.c_str(), &canonical);
		if (status != B_OK)
			return status;
		SplitPath(canonical, entry);
		return B_OK;
	}

	status = CanonicalPath(entry->folder.c_str(), &entry->folder);
	if (status != B_OK)
		return status;
	if (entry->leaf.size() >= B_FILE_NAME_LENGTH)
		return B_NAME_TOO_LONG;

	struct stat st;
	if (traverse && lstat(entry->Path().c_str(), &st) == 0
		&& S_ISLNK(st.st_mode)) {
		std::string target;
		status = CanonicalPath(entry->Path().c_str(), &target);
		if (status != B_OK)
			return status;
		SplitPath(target, entry);
	}
	return B_OK;
}

status_t RefForPath(const char* path, bool traverse, entry_ref* ref)
{
	DirectoryRegistry& registry = DirectoryRegistry::Default();
	std::shared_lock<std::shared_mutex> noMoves(registry.MoveLock());
	EntryPath entry;
	status_t status = CanonicalEntry(path, traverse, &entry);
	if (status != B_OK)
		return status;
	struct stat st;
	if (lstat(entry.folder.c_str(), &st) != 0)
		return StatusFromErrno();
	if (!S_ISDIR(st.st_mode))
		return B_NOT_A_DIRECTORY;
	dev_t device = VolumeTable::Default().DeviceFor(entry.folder);
	registry.Register(device, st.st_ino, st.st_dev, entry.folder);
	ref->device = device;
	ref->directory = st.st_ino;
	return ref->set_name(entry.leaf.c_str());
}

status_t CheckRefName(const entry_ref& ref)
{
	if (ref.name == nullptr)
		return B_BAD_VALUE;
	return std::strcmp(ref.name, ".") == 0 ? B_OK : CheckName(ref.name);
}

status_t EntryForRef(const entry_ref& ref, EntryPath* entry)
{
	status_t status = CheckRefName(ref);
	if (status != B_OK)
		return status;
	status = DirectoryRegistry::Default().Resolve(ref.device,
		ref.directory, &entry->folder);
	if (status != B_OK)
		return status;
	entry->leaf = ref.name;
	return B_OK;
}

status_t ApplyStat(int fd, const char* path, const struct stat& st,
	uint32 what)
{
	int at = path != nullptr ? AT_FDCWD : fd;
	int noFollow = path != nullptr ? AT_SYMLINK_NOFOLLOW : 0;
	if ((what & B_STAT_MODE) != 0) {
		mode_t mode = st.st_mode & 07777;
		if ((path != nullptr ? fchmodat(at, path, mode, noFollow) : fchmod(fd, mode))
				!= 0) {
			return StatusFromErrno();
		}
	}
	if ((what & (B_STAT_UID | B_STAT_GID)) != 0
		&& fchownat(at, path != nullptr ? path : "",
			(what & B_STAT_UID) != 0 ? st.st_uid : static_cast<uid_t>(-1),
			(what & B_STAT_GID) != 0 ? st.st_gid : static_cast<gid_t>(-1),
			path != nullptr ? AT_SYMLINK_NOFOLLOW : AT_EMPTY_PATH) != 0) {
		return StatusFromErrno();
	}
	if ((what & (B_STAT_MODIFICATION_TIME | B_STAT_ACCESS_TIME)) != 0) {
		timespec times[2] = { { 0, UTIME_OMIT }, { 0, UTIME_OMIT } };
		if ((what & B_STAT_ACCESS_TIME) != 0)
			times[0] = st.st_atim;
		if ((what & B_STAT_MODIFICATION_TIME) != 0)
			times[1] = st.st_mtim;
		if ((path != nullptr ? utimensat(at, path, times, noFollow)
				: futimens(fd, times)) != 0)
			return StatusFromErrno();
	}
	return B_OK;
}

dev_t DeviceOfNode(const std::string& path, const struct stat& st,
	dev_t folderDevice)
{
	dev_t device;
	if (S_ISDIR(st.st_mode) && VolumeTable::Default().IsRoot(path, &device))
		return device;
	return folderDevice;
}

}
