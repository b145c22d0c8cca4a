#include <Entry.h>

#include <cerrno>
#include <cstdio>
#include <fcntl.h>
#include <unistd.h>

#include <Directory.h>
#include <Path.h>

#include "DirectoryRegistry.h"
#include "EntryPath.h"
#include "ErrnoStatus.h"
#include "TrashRecords.h"
#include "VolumeTable.h"

using BPrivate::EntryPath;
using BPrivate::StatusFromErrno;

namespace {

bool SameNode(const std::string& a, const std::string& b)
{
	struct stat first;
	struct stat second;
	return lstat(a.c_str(), &first) == 0 && lstat(b.c_str(), &second) == 0
		&& first.st_dev == second.st_dev && first.st_ino == second.st_ino;
}

// Renames without replacing anything, for file systems without
// RENAME_NOREPLACE: a hard link fails on an existing name by itself; where
// there are no hard links, only a look just before the rename is left.
status_t RenameWithoutReplaceFallback(const std::string& from,
	const std::string& to, bool isFolder)
{
	if (!isFolder) {
		if (link(from.c_str(), to.c_str()) == 0) {
			if (unlink(from.c_str()) == 0)
				return B_OK;
			status_t status = StatusFromErrno();
			unlink(to.c_str());
			return status;
		}
		if (errno == EEXIST)
			return B_FILE_EXISTS;
	}
	struct stat st;
	if (lstat(to.c_str(), &st) == 0)
		return B_FILE_EXISTS;
	return rename(from.c_str(), to.c_str()) == 0 ? B_OK : StatusFromErrno();
}

status_t RenamePath(const std::string& from, const std::string& to,
	bool isFolder, bool clobber)
{
	if (clobber)
		return rename(from.c_str(), to.c_str()) == 0 ? B_OK : StatusFromErrno();
	if (renameat2(AT_FDCWD, from.c_str(), AT_FDCWD, to.c_str(),
			RENAME_NOREPLACE) == 0) {
		return B_OK;
	}
	switch (errno) {
		case EEXIST:
			// The same node under another case on a file system that
			// ignores case: only its spelling changes.
			if (SameNode(from, to))
				return rename(from.c_str(), to.c_str()) == 0
					? B_OK : StatusFromErrno();
			return B_FILE_EXISTS;
		case EINVAL:
			// Also the answer to moving a folder into itself.
			if (isFolder && to.compare(0, from.size() + 1, from + "/") == 0)
				return B_BAD_VALUE;
			return RenameWithoutReplaceFallback(from, to, isFolder);
		case ENOSYS:
		case ENOTSUP:
			return RenameWithoutReplaceFallback(from, to, isFolder);
		default:
			return StatusFromErrno();
	}
}

// The folder a BDirectory is open on.
status_t FolderOf(const BDirectory* dir, std::string* path, dev_t* device,
	ino_t* node)
{
	if (dir == nullptr)
		return B_BAD_VALUE;
	struct stat st;
	status_t status = dir->GetStat(&st);
	if (status == B_OK)
		status = BPrivate::PathOfDirectory(dir, path);
	if (status != B_OK)
		return status;
	*device = st.st_dev;
	*node = st.st_ino;
	return B_OK;
}

}

status_t BEntry::Rename(const char* path, bool clobber)
{
	EntryPath entry;
	status_t status = _Resolve(&entry);
	if (status != B_OK)
		return status;
	return _MoveTo(entry.folder.c_str(), fRef.device, fRef.directory, path,
		clobber);
}

status_t BEntry::MoveTo(BDirectory* dir, const char* path, bool clobber)
{
	if (fCStatus != B_OK)
		return fCStatus;
	std::string folder;
	dev_t device;
	ino_t node;
	status_t status = FolderOf(dir, &folder, &device, &node);
	if (status != B_OK)
		return status;
	return _MoveTo(folder.c_str(), device, node,
		path != nullptr ? path : fRef.name, clobber);
}

status_t BEntry::_MoveTo(const char* dirPath, dev_t dirDevice, ino_t dirNode,
	const char* name, bool clobber)
{
	status_t status = BPrivate::CheckName(name);
	if (status != B_OK)
		return status;
	EntryPath source;
	status = _Resolve(&source);
	if (status != B_OK)
		return status;
	struct stat st;
	if (source.leaf == "." || lstat(source.Path().c_str(), &st) != 0)
		return source.leaf == "." ? B_NOT_ALLOWED : StatusFromErrno();
	if (dirDevice != fRef.device)
		return B_CROSS_DEVICE_LINK;
	bool isFolder = S_ISDIR(st.st_mode);
	std::string from = source.Path();
	std::string to = BPrivate::JoinPath(dirPath, name);
	if (from == to)
		return B_OK;
	if (isFolder && BPrivate::VolumeTable::Default().IsRoot(from))
		return B_BUSY;

	BPrivate::TrashMove trash;
	status = trash.Prepare(source, dirPath, name, clobber);
	if (status != B_OK)
		return status;
	{
		BPrivate::DirectoryRegistry& registry
			= BPrivate::DirectoryRegistry::Default();
		std::unique_lock<std::shared_mutex> moving(registry.MoveLock());
		status = RenamePath(from, to, isFolder, clobber);
		if (status == B_OK && isFolder)
			registry.Moved(from, to);
	}
	trash.Finish(status == B_OK);
	if (status != B_OK)
		return status;

	fRef.device = dirDevice;
	fRef.directory = dirNode;
	return fRef.set_name(name);
}

status_t BEntry::Remove()
{
	EntryPath entry;
	status_t status = _Resolve(&entry);
	if (status != B_OK)
		return status;
	if (entry.leaf == ".")
		return B_NOT_ALLOWED;
	std::string path = entry.Path();
	struct stat st;
	if (lstat(path.c_str(), &st) != 0)
		return StatusFromErrno();
	if ((S_ISDIR(st.st_mode) ? rmdir(path.c_str()) : unlink(path.c_str())) != 0)
		return StatusFromErrno();
	if (S_ISDIR(st.st_mode))
		BPrivate::DirectoryRegistry::Default().Removed(path);
	BPrivate::TrashMove::Removed(entry.folder, entry.leaf);
	return B_OK;
}
