#include <Node.h>

#include <cerrno>
#include <climits>
#include <cstring>
#include <fcntl.h>
#include <sys/file.h>
#include <sys/stat.h>
#include <unistd.h>

#include <Directory.h>
#include <Entry.h>

#include "Attributes.h"
#include "DirectoryRegistry.h"
#include "EntryPath.h"
#include "ErrnoStatus.h"
#include "NodeData.h"
#include "VolumeTable.h"

namespace BPrivate {

NodeData::~NodeData()
{
	if (fd >= 0)
		close(fd);
}

status_t PathOfDescriptor(int fd, std::string* path, struct stat* st)
{
	std::string link = "/proc/self/fd/" + std::to_string(fd);
	char buffer[PATH_MAX];
	ssize_t length = readlink(link.c_str(), buffer, sizeof(buffer));
	if (length < 0)
		return StatusFromErrno();
	if (length == sizeof(buffer))
		return B_NAME_TOO_LONG;
	path->assign(buffer, length);
	// A removed node reads as "PATH (deleted)"; it has no links left.
	struct stat own;
	if (st == nullptr)
		st = &own;
	if (path->empty() || (*path)[0] != '/' || fstat(fd, st) != 0
		|| st->st_nlink == 0) {
		return B_ENTRY_NOT_FOUND;
	}
	return B_OK;
}

}

using BPrivate::NodeData;

BNode::BNode()
	:
	fCStatus(B_NO_INIT)
{
}

BNode::BNode(const entry_ref* ref)
	:
	fCStatus(B_NO_INIT)
{
	SetTo(ref);
}

BNode::BNode(const BEntry* entry)
	:
	fCStatus(B_NO_INIT)
{
	SetTo(entry);
}

BNode::BNode(const char* path)
	:
	fCStatus(B_NO_INIT)
{
	SetTo(path);
}

BNode::BNode(const BDirectory* dir, const char* path)
	:
	fCStatus(B_NO_INIT)
{
	SetTo(dir, path);
}

BNode::BNode(const BNode& node)
	:
	BStatable(),
	fCStatus(B_NO_INIT)
{
	*this = node;
}

BNode::~BNode()
{
	Unset();
}

status_t BNode::InitCheck() const
{
	return fCStatus;
}

status_t BNode::GetStat(struct stat* st) const
{
	if (fCStatus != B_OK)
		return fCStatus;
	if (st == nullptr)
		return B_BAD_VALUE;
	if (fstat(fData->fd, st) != 0)
		return BPrivate::StatusFromErrno();
	st->st_dev = fData->device;
	return B_OK;
}

status_t BNode::SetTo(const entry_ref* ref)
{
	return _SetToRef(ref, O_RDONLY);
}

status_t BNode::SetTo(const BEntry* entry)
{
	return _SetToEntry(entry, O_RDONLY);
}

status_t BNode::SetTo(const char* path)
{
	return _SetToPath(path, O_RDONLY);
}

status_t BNode::SetTo(const BDirectory* dir, const char* path)
{
	return _SetToAt(dir, path, O_RDONLY);
}

void BNode::Unset()
{
	if (fData != nullptr && fData->locked)
		Unlock();
	fData.reset();
	fCStatus = B_NO_INIT;
}

status_t BNode::_SetToRef(const entry_ref* ref, int openFlags)
{
	Unset();
	if (ref == nullptr)
		return fCStatus = B_BAD_VALUE;
	status_t status = BPrivate::CheckRefName(*ref);
	if (status != B_OK)
		return fCStatus = status;
	// A folder open right now reaches its entries wherever it lies.
	std::shared_ptr<NodeData> folder = BPrivate::DirectoryRegistry::Default()
		.OpenFolder(ref->device, ref->directory);
	if (folder != nullptr) {
		return _Adopt(openat(folder->fd, ref->name,
			openFlags | O_CLOEXEC | O_NOCTTY | O_NONBLOCK, 0666), openFlags);
	}
	BPrivate::EntryPath entry;
	status = BPrivate::EntryForRef(*ref, &entry);
	if (status != B_OK)
		return fCStatus = status;
	return _SetToPath(entry.Path().c_str(), openFlags);
}

status_t BNode::_SetToEntry(const BEntry* entry, int openFlags)
{
	Unset();
	entry_ref ref;
	if (entry == nullptr)
		return fCStatus = B_BAD_VALUE;
	status_t status = entry->GetRef(&ref);
	if (status != B_OK)
		return fCStatus = status;
	return _SetToRef(&ref, openFlags);
}

status_t BNode::_SetToPath(const char* path, int openFlags)
{
	Unset();
	if (path == nullptr || path[0] == '\0')
		return fCStatus = B_BAD_VALUE;
	return _Adopt(open(path, openFlags | O_CLOEXEC | O_NOCTTY | O_NONBLOCK,
		0666), openFlags);
}

status_t BNode::_SetToAt(const BDirectory* dir, const char* path,
	int openFlags)
{
	if (dir == nullptr || path == nullptr || path[0] == '\0')
		return _Fail(B_BAD_VALUE);
	const BNode* folder = dir;
	if (path[0] != '/' && folder->InitCheck() != B_OK)
		return _Fail(folder->InitCheck());
	// Opened before this node lets go of its own, which may be dir.
	int dirFd = path[0] == '/' ? AT_FDCWD : folder->_FileDescriptor();
	int fd = openat(dirFd, path, openFlags | O_CLOEXEC | O_NOCTTY | O_NONBLOCK,
		0666);
	if (fd < 0)
		return _Fail(BPrivate::StatusFromErrno());
	Unset();
	return _Adopt(fd, openFlags);
}

// Takes fd, just opened with openFlags (or the open's failure), as this
// node.
status_t BNode::_Adopt(int fd, int openFlags)
{
	if (fd < 0)
		return fCStatus = BPrivate::StatusFromErrno();
	// Not made with make_shared: the registry's weak pointers would keep the
	// whole node's memory.
	std::shared_ptr<NodeData> data(new NodeData);
	data->fd = fd;
	data->pathOnly = (openFlags & O_PATH) != 0;
	data->movesBeforeLocating = BPrivate::DirectoryRegistry::Default().Moves();
	// A node removed right after its opening has no volume to tell.
	data->opened = BPrivate::PathOfDescriptor(fd, &data->openedPath,
		&data->openedStat) == B_OK;
	if (data->opened) {
		data->device = BPrivate::VolumeTable::Default().DeviceFor(
			data->openedPath, &data->isRoot);
	}
	fData = std::move(data);
	return fCStatus = B_OK;
}

status_t BNode::_Fail(status_t status)
{
	Unset();
	return fCStatus = status;
}

int BNode::_FileDescriptor() const
{
	return fData != nullptr ? fData->fd : -1;
}

dev_t BNode::_Device() const
{
	return fData != nullptr ? fData->device : 0;
}

status_t BNode::_GetPath(std::string* path) const
{
	if (fCStatus != B_OK)
		return fCStatus;
	return BPrivate::PathOfDescriptor(fData->fd, path);
}

status_t BNode::_SetStat(const struct stat& st, uint32 what)
{
	if (fCStatus != B_OK)
		return fCStatus;
	return BPrivate::ApplyStat(fData->fd, nullptr, st, what);
}

status_t BNode::Lock()
{
	if (fCStatus != B_OK)
		return fCStatus;
	if (fData->locked)
		return B_BUSY;
	if (flock(fData->fd, LOCK_EX | LOCK_NB) != 0)
		return errno == EWOULDBLOCK ? B_BUSY : BPrivate::StatusFromErrno();
	fData->locked = true;
	return B_OK;
}

status_t BNode::Unlock()
{
	if (fCStatus != B_OK)
		return fCStatus;
	if (!fData->locked)
		return B_BAD_VALUE;
	if (flock(fData->fd, LOCK_UN) != 0)
		return BPrivate::StatusFromErrno();
	fData->locked = false;
	return B_OK;
}

status_t BNode::Sync()
{
	if (fCStatus != B_OK)
		return fCStatus;
	return fsync(fData->fd) == 0 ? B_OK : BPrivate::StatusFromErrno();
}

ssize_t BNode::WriteAttr(const char* name, type_code type, off_t offset,
	const void* buffer, size_t length)
{
	if (fCStatus != B_OK)
		return fCStatus;
	return BPrivate::Attributes(fData->fd, fData->pathOnly).Write(name, type,
		offset, buffer, length);
}

ssize_t BNode::ReadAttr(const char* name, type_code, off_t offset,
	void* buffer, size_t length) const
{
	if (fCStatus != B_OK)
		return fCStatus;
	return BPrivate::Attributes(fData->fd, fData->pathOnly).Read(name, offset,
		buffer, length);
}

status_t BNode::RemoveAttr(const char* name)
{
	if (fCStatus != B_OK)
		return fCStatus;
	return BPrivate::Attributes(fData->fd, fData->pathOnly).Remove(name);
}

status_t BNode::GetAttrInfo(const char* name, attr_info* info) const
{
	if (fCStatus != B_OK)
		return fCStatus;
	return BPrivate::Attributes(fData->fd, fData->pathOnly).Stat(name, info);
}

status_t BNode::GetNextAttrName(char* buffer)
{
	if (fCStatus != B_OK)
		return fCStatus;
	if (buffer == nullptr)
		return B_BAD_VALUE;
	if (!fData->attributesListed) {
		status_t status = BPrivate::Attributes(fData->fd, fData->pathOnly)
			.Names(&fData->attributeNames);
		if (status != B_OK)
			return status;
		fData->attributesListed = true;
		fData->nextAttribute = 0;
	}
	if (fData->nextAttribute >= fData->attributeNames.size())
		return B_ENTRY_NOT_FOUND;
	const std::string& name = fData->attributeNames[fData->nextAttribute++];
	std::memcpy(buffer, name.c_str(), name.size() + 1);
	return B_OK;
}

status_t BNode::RewindAttrs()
{
	if (fCStatus != B_OK)
		return fCStatus;
	fData->attributesListed = false;
	fData->attributeNames.clear();
	return B_OK;
}

// A copy is a node of its own, with its own lock and position: the node is
// opened again through the descriptor's /proc link, which reaches it
// wherever it is now.
BNode& BNode::operator=(const BNode& node)
{
	if (this == &node)
		return *this;
	Unset();
	if (node.fCStatus != B_OK)
		return *this;
	int fd = node.fData->fd;
	int flags = fcntl(fd, F_GETFL)
		& (O_ACCMODE | O_APPEND | O_NONBLOCK | O_PATH);
	std::string link = "/proc/self/fd/" + std::to_string(fd);
	_Adopt(open(link.c_str(), flags | O_CLOEXEC | O_NOCTTY), flags);
	return *this;
}

bool BNode::operator==(const BNode& node) const
{
	if (fCStatus != B_OK || node.fCStatus != B_OK)
		return fCStatus != B_OK && node.fCStatus != B_OK;
	node_ref mine;
	node_ref theirs;
	return GetNodeRef(&mine) == B_OK && node.GetNodeRef(&theirs) == B_OK
		&& mine == theirs;
}

bool BNode::operator!=(const BNode& node) const
{
	return !(*this == node);
}

int BNode::Dup()
{
	if (fCStatus != B_OK)
		return -1;
	return fcntl(fData->fd, F_DUPFD_CLOEXEC, 0);
}
