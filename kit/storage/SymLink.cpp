#include <SymLink.h>

#include <climits>
#include <cstring>
#include <fcntl.h>
#include <unistd.h>

#include <Directory.h>
#include <Path.h>

#include "EntryPath.h"
#include "ErrnoStatus.h"

namespace {

// Links are opened as themselves, without data access.
constexpr int kLinkOpenFlags = O_PATH | O_NOFOLLOW;

}

BSymLink::BSymLink()
{
}

BSymLink::BSymLink(const BSymLink& link)
	:
	BNode(link)
{
}

BSymLink::BSymLink(const entry_ref* ref)
{
	SetTo(ref);
}

BSymLink::BSymLink(const BEntry* entry)
{
	SetTo(entry);
}

BSymLink::BSymLink(const char* path)
{
	SetTo(path);
}

BSymLink::BSymLink(const BDirectory* dir, const char* path)
{
	SetTo(dir, path);
}

BSymLink::~BSymLink() = default;

status_t BSymLink::SetTo(const entry_ref* ref)
{
	return _SetToRef(ref, kLinkOpenFlags);
}

status_t BSymLink::SetTo(const BEntry* entry)
{
	return _SetToEntry(entry, kLinkOpenFlags);
}

status_t BSymLink::SetTo(const char* path)
{
	return _SetToPath(path, kLinkOpenFlags);
}

status_t BSymLink::SetTo(const BDirectory* dir, const char* path)
{
	return _SetToAt(dir, path, kLinkOpenFlags);
}

ssize_t BSymLink::ReadLink(char* buffer, size_t size)
{
	if (InitCheck() != B_OK)
		return InitCheck();
	if (buffer == nullptr || size == 0)
		return B_BAD_VALUE;
	if (!IsSymLink())
		return B_BAD_VALUE;
	char target[PATH_MAX];
	ssize_t length = readlinkat(_FileDescriptor(), "", target, sizeof(target));
	if (length < 0)
		return BPrivate::StatusFromErrno();
	size_t copied = std::min(static_cast<size_t>(length), size - 1);
	std::memcpy(buffer, target, copied);
	buffer[copied] = '\0';
	return copied;
}

ssize_t BSymLink::MakeLinkedPath(const char* dirPath, BPath* path)
{
	if (dirPath == nullptr || path == nullptr)
		return B_BAD_VALUE;
	char target[PATH_MAX];
	ssize_t length = ReadLink(target, sizeof(target));
	if (length < 0)
		return length;
	status_t status = target[0] == '/' ? path->SetTo(target)
		: path->SetTo(dirPath, target);
	return status == B_OK ? static_cast<ssize_t>(std::strlen(path->Path()))
		: status;
}

ssize_t BSymLink::MakeLinkedPath(const BDirectory* dir, BPath* path)
{
	if (dir == nullptr || path == nullptr)
		return B_BAD_VALUE;
	std::string folder;
	status_t status = BPrivate::PathOfDirectory(dir, &folder);
	if (status != B_OK)
		return status;
	return MakeLinkedPath(folder.c_str(), path);
}

bool BSymLink::IsAbsolute()
{
	char target[PATH_MAX];
	return ReadLink(target, sizeof(target)) > 0 && target[0] == '/';
}

BSymLink& BSymLink::operator=(const BSymLink& link)
{
	BNode::operator=(link);
	return *this;
}
