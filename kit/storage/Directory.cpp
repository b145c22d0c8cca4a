#include <Directory.h>

#include <cerrno>
#include <cstring>
#include <dirent.h>
#include <fcntl.h>
#include <unistd.h>

#include <Entry.h>
#include <File.h>
#include <Path.h>
#include <SymLink.h>

#include "DirectoryRegistry.h"
#include "EntryPath.h"
#include "ErrnoStatus.h"
#include "NodeData.h"
#include "VolumeTable.h"

using BPrivate::StatusFromErrno;

namespace BPrivate {

// A walk through a folder's entries: reads the folder's descriptor itself,
// which nothing else reads or seeks, so a walk costs no descriptor of its own.
struct DirectoryIterator {
	DirectoryIterator(int fd, bool ownsDescriptor)
		: fd(fd), ownsDescriptor(ownsDescriptor),
		  buffer(std::make_unique<char[]>(kBufferSize)) {}
	DirectoryIterator(const DirectoryIterator&) = delete;
	DirectoryIterator& operator=(const DirectoryIterator&) = delete;
	~DirectoryIterator()
	{
		if (ownsDescriptor)
			close(fd);
	}

	// The next entry but "." and "..", or NULL at the end (errno 0) or on
	// an error (errno set).
	const char* Next()
	{
		while (true) {
			if (offset >= filled) {
				ssize_t length = getdents64(fd, buffer.get(), kBufferSize);
				if (length <= 0) {
					if (length == 0)
						errno = 0;
					return nullptr;
				}
				filled = length;
				offset = 0;
			}
			auto* entry = reinterpret_cast<dirent64*>(buffer.get() + offset);
			offset += entry->d_reclen;
			if (std::strcmp(entry->d_name, ".") != 0
				&& std::strcmp(entry->d_name, "..") != 0)
				return entry->d_name;
		}
	}

	status_t Rewind()
	{
		if (lseek(fd, 0, SEEK_SET) < 0)
			return StatusFromErrno();
		offset = filled = 0;
		return B_OK;
	}

	static constexpr size_t kBufferSize = 32768;
	int fd;
	bool ownsDescriptor;
	std::unique_ptr<char[]> buffer;
	size_t offset = 0;
	size_t filled = 0;
	ino_t node = 0;
};

}

using BPrivate::DirectoryIterator;

namespace {

// A new walk of the folder open as fd, on a descriptor of its own.
std::unique_ptr<DirectoryIterator> OpenIterator(int fd)
{
	int own = openat(fd, ".", O_RDONLY | O_DIRECTORY | O_CLOEXEC);
	if (own < 0)
		return nullptr;
	return std::make_unique<DirectoryIterator>(own, true);
}

status_t CheckChildPath(const BDirectory& dir, const char* path)
{
	if (dir.InitCheck() != B_OK)
		return dir.InitCheck();
	return path == nullptr || path[0] == '\0' ? B_BAD_VALUE : B_OK;
}

int32 FlavorOf(mode_t mode)
{
	if (S_ISDIR(mode))
		return B_DIRECTORY_NODE;
	if (S_ISLNK(mode))
		return B_SYMLINK_NODE;
	return B_FILE_NODE;
}

}

BDirectory::BDirectory()
{
}

BDirectory::BDirectory(const BDirectory& dir)
	:
	BNode()
{
	*this = dir;
}

BDirectory::BDirectory(const entry_ref* ref)
{
	SetTo(ref);
}

BDirectory::BDirectory(const node_ref* nref)
{
	SetTo(nref);
}

BDirectory::BDirectory(const BEntry* entry)
{
	SetTo(entry);
}

BDirectory::BDirectory(const char* path)
{
	SetTo(path);
}

BDirectory::BDirectory(const BDirectory* dir, const char* path)
{
	SetTo(dir, path);
}

BDirectory::~BDirectory() = default;

status_t BDirectory::SetTo(const entry_ref* ref)
{
	fIterator.reset();
	return _Open(_SetToRef(ref, O_RDONLY | O_DIRECTORY));
}

status_t BDirectory::SetTo(const node_ref* nref)
{
	Unset();
	if (nref == nullptr)
		return B_BAD_VALUE;
	std::string path;
	status_t status = BPrivate::DirectoryRegistry::Default().Resolve(
		nref->device, nref->node, &path);
	if (status != B_OK)
		return status;
	return SetTo(path.c_str());
}

status_t BDirectory::SetTo(const BEntry* entry)
{
	fIterator.reset();
	return _Open(_SetToEntry(entry, O_RDONLY | O_DIRECTORY));
}

status_t BDirectory::SetTo(const char* path)
{
	fIterator.reset();
	return _Open(_SetToPath(path, O_RDONLY | O_DIRECTORY));
}

status_t BDirectory::SetTo(const BDirectory* dir, const char* path)
{
	fIterator.reset();
	return _Open(_SetToAt(dir, path, O_RDONLY | O_DIRECTORY));
}

void BDirectory::Unset()
{
	fIterator.reset();
	BNode::Unset();
}

// Starts the walk of the folder just opened (when status says it was) and
// registers the folder, so that the refs of its entries resolve.
status_t BDirectory::_Open(status_t status)
{
	if (status != B_OK)
		return status;
	const BPrivate::NodeData& data = *_Data();
	if (!data.opened)
		return _Fail(B_ENTRY_NOT_FOUND);

	BPrivate::DirectoryRegistry& registry
		= BPrivate::DirectoryRegistry::Default();
	std::shared_lock<std::shared_mutex> noMoves(registry.MoveLock());
	// A move by the kit since the path was read may have changed it.
	std::string movedTo;
	const std::string* path = &data.openedPath;
	if (registry.Moves() != data.movesBeforeLocating) {
		status = _GetPath(&movedTo);
		if (status != B_OK)
			return _Fail(status);
		path = &movedTo;
	}
	registry.Register(_Device(), data.openedStat.st_ino,
		data.openedStat.st_dev, *path, _Data());
	fIterator = std::make_unique<DirectoryIterator>(data.fd, false);
	fIterator->node = data.openedStat.st_ino;
	return B_OK;
}

// The absolute form of a path given relative to this folder.
status_t BDirectory::_Absolute(const char* path, std::string* absolute) const
{
	if (InitCheck() != B_OK)
		return InitCheck();
	if (path == nullptr || path[0] == '\0')
		return B_BAD_VALUE;
	if (path[0] == '/') {
		*absolute = path;
		return B_OK;
	}
	std::string folder;
	status_t status = _GetPath(&folder);
	if (status == B_OK)
		*absolute = BPrivate::JoinPath(folder, path);
	return status;
}

status_t BDirectory::GetEntry(BEntry* entry) const
{
	if (entry == nullptr)
		return B_BAD_VALUE;
	std::string path;
	status_t status = _GetPath(&path);
	if (status != B_OK) {
		entry->Unset();
		return status;
	}
	return entry->SetTo(path.c_str());
}

// Told at the opening: the folder open here stays what it was even when
// another volume is mounted over its path later.
bool BDirectory::IsRootDirectory() const
{
	return InitCheck() == B_OK && _Data()->isRoot;
}

status_t BDirectory::FindEntry(const char* path, BEntry* entry,
	bool traverse) const
{
	if (entry == nullptr)
		return B_BAD_VALUE;
	std::string absolute;
	status_t status = _Absolute(path, &absolute);
	if (status == B_OK)
		status = entry->SetTo(absolute.c_str(), traverse);
	if (status == B_OK && !entry->Exists())
		status = B_ENTRY_NOT_FOUND;
	if (status != B_OK)
		entry->Unset();
	return status;
}

bool BDirectory::Contains(const char* path, int32 nodeFlags) const
{
	std::string absolute;
	struct stat st;
	return _Absolute(path, &absolute) == B_OK
		&& lstat(absolute.c_str(), &st) == 0
		&& (FlavorOf(st.st_mode) & nodeFlags) != 0;
}

bool BDirectory::Contains(const BEntry* entry, int32 nodeFlags) const
{
	BPath path;
	std::string folder;
	struct stat st;
	if (entry == nullptr || entry->GetPath(&path) != B_OK
		|| _GetPath(&folder) != B_OK || entry->GetStat(&st) != B_OK) {
		return false;
	}
	std::string inside = BPrivate::JoinPath(folder, "");
	return std::strncmp(path.Path(), inside.c_str(), inside.size()) == 0
		&& (FlavorOf(st.st_mode) & nodeFlags) != 0;
}

status_t BDirectory::GetStatFor(const char* path, struct stat* st) const
{
	if (InitCheck() != B_OK)
		return InitCheck();
	if (path == nullptr || path[0] == '\0' || st == nullptr)
		return B_BAD_VALUE;
	if (fstatat(_FileDescriptor(), path, st, AT_SYMLINK_NOFOLLOW) != 0)
		return StatusFromErrno();
	// Only a folder can be the root of another volume, and only a folder
	// named as the root of one.
	bool name = BPrivate::CheckName(path) == B_OK;
	if (name && (!S_ISDIR(st->st_mode)
			|| !BPrivate::VolumeTable::Default().MayBeRootNamed(path))) {
		st->st_dev = _Device();
		return B_OK;
	}
	std::string absolute;
	status_t status = _Absolute(path, &absolute);
	if (status != B_OK)
		return status;
	if (name) {
		st->st_dev = BPrivate::DeviceOfNode(absolute, *st, _Device());
		return B_OK;
	}
	BPrivate::EntryPath entry;
	status = BPrivate::CanonicalEntry(absolute.c_str(), false, &entry);
	if (status != B_OK)
		return status;
	st->st_dev = BPrivate::DeviceOfNode(entry.Path(), *st,
		BPrivate::VolumeTable::Default().DeviceFor(entry.folder));
	return B_OK;
}

status_t BDirectory::GetNextEntry(BEntry* entry, bool traverse)
{
	if (entry == nullptr)
		return B_BAD_VALUE;
	entry_ref ref;
	status_t status = GetNextRef(&ref);
	if (status == B_OK)
		status = entry->SetTo(&ref, traverse);
	if (status != B_OK)
		entry->Unset();
	return status;
}

status_t BDirectory::GetNextRef(entry_ref* ref)
{
	if (InitCheck() != B_OK)
		return InitCheck();
	if (ref == nullptr)
		return B_BAD_VALUE;
	const char* name = fIterator->Next();
	if (name == nullptr)
		return errno != 0 ? StatusFromErrno() : B_ENTRY_NOT_FOUND;
	ref->device = _Device();
	ref->directory = fIterator->node;
	return ref->set_name(name);
}

status_t BDirectory::Rewind()
{
	if (InitCheck() != B_OK)
		return InitCheck();
	return fIterator->Rewind();
}

int32 BDirectory::CountEntries() const
{
	if (InitCheck() != B_OK)
		return InitCheck();
	std::unique_ptr<DirectoryIterator> walk = OpenIterator(_FileDescriptor());
	if (walk == nullptr)
		return StatusFromErrno();
	int32 count = 0;
	while (walk->Next() != nullptr)
		count++;
	return count;
}

status_t BDirectory::CreateDirectory(const char* path, BDirectory* dir)
{
	status_t status = CheckChildPath(*this, path);
	if (status != B_OK)
		return status;
	if (mkdirat(_FileDescriptor(), path, 0777) != 0)
		return StatusFromErrno();
	return dir != nullptr ? dir->SetTo(this, path) : B_OK;
}

status_t BDirectory::CreateFile(const char* path, BFile* file,
	bool failIfExists)
{
	status_t status = CheckChildPath(*this, path);
	if (status != B_OK)
		return status;
	uint32 mode = B_READ_WRITE | B_CREATE_FILE
		| (failIfExists ? B_FAIL_IF_EXISTS : B_ERASE_FILE);
	BFile created;
	return (file != nullptr ? file : &created)->SetTo(this, path, mode);
}

status_t BDirectory::CreateSymLink(const char* path, const char* linkToPath,
	BSymLink* link)
{
	status_t status = CheckChildPath(*this, path);
	if (status != B_OK)
		return status;
	if (linkToPath == nullptr || linkToPath[0] == '\0')
		return B_BAD_VALUE;
	if (symlinkat(linkToPath, _FileDescriptor(), path) != 0)
		return StatusFromErrno();
	return link != nullptr ? link->SetTo(this, path) : B_OK;
}

BDirectory& BDirectory::operator=(const BDirectory& dir)
{
	if (this != &dir) {
		fIterator.reset();
		BNode::operator=(dir);
		if (InitCheck() == B_OK)
			_Open(B_OK);
	}
	return *this;
}

status_t create_directory(const char* path, mode_t mode)
{
	if (path == nullptr || path[0] == '\0')
		return B_BAD_VALUE;
	std::string partial;
	std::string whole = path;
	size_t start = 0;
	while (start <= whole.size()) {
		size_t slash = whole.find('/', start);
		if (slash == std::string::npos)
			slash = whole.size();
		partial = whole.substr(0, slash);
		start = slash + 1;
		if (partial.empty() || partial.back() == '/')
			continue;
		if (mkdir(partial.c_str(), mode) != 0 && errno != EEXIST)
			return StatusFromErrno();
	}
	struct stat st;
	if (stat(path, &st) != 0)
		return StatusFromErrno();
	if (!S_ISDIR(st.st_mode))
		return B_NOT_A_DIRECTORY;
	return B_OK;
}
