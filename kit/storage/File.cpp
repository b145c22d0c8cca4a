#include <File.h>

#include <cerrno>
#include <fcntl.h>
#include <unistd.h>

#include "ErrnoStatus.h"

using BPrivate::StatusFromErrno;

namespace {

// Runs a read or write call again when a signal interrupts it.
template<typename Call>
ssize_t Retry(Call call)
{
	ssize_t result;
	do
		result = call();
	while (result < 0 && errno == EINTR);
	return result;
}

// Writes all of buffer, giving the count done when the disk fails part-way
// and the error only when nothing was written.
template<typename WriteSome>
ssize_t WriteAll(const void* buffer, size_t size, WriteSome writeSome)
{
	const char* data = static_cast<const char*>(buffer);
	size_t done = 0;
	while (done < size) {
		ssize_t length = Retry([&] { return writeSome(data + done,
			size - done, done); });
		if (length <= 0) {
			if (done > 0)
				break;
			return length < 0 ? StatusFromErrno() : B_IO_ERROR;
		}
		done += length;
	}
	return done;
}

}

BFile::BFile()
	:
	fMode(0)
{
}

BFile::BFile(const BFile& file)
	:
	BNode(file),
	fMode(file.fMode)
{
}

BFile::BFile(const entry_ref* ref, uint32 openMode)
	:
	fMode(0)
{
	SetTo(ref, openMode);
}

BFile::BFile(const BEntry* entry, uint32 openMode)
	:
	fMode(0)
{
	SetTo(entry, openMode);
}

BFile::BFile(const char* path, uint32 openMode)
	:
	fMode(0)
{
	SetTo(path, openMode);
}

BFile::BFile(const BDirectory* dir, const char* path, uint32 openMode)
	:
	fMode(0)
{
	SetTo(dir, path, openMode);
}

BFile::~BFile() = default;

status_t BFile::SetTo(const entry_ref* ref, uint32 openMode)
{
	fMode = openMode;
	return _CheckRegular(_SetToRef(ref, openMode));
}

status_t BFile::SetTo(const BEntry* entry, uint32 openMode)
{
	fMode = openMode;
	return _CheckRegular(_SetToEntry(entry, openMode));
}

status_t BFile::SetTo(const char* path, uint32 openMode)
{
	fMode = openMode;
	return _CheckRegular(_SetToPath(path, openMode));
}

status_t BFile::SetTo(const BDirectory* dir, const char* path,
	uint32 openMode)
{
	fMode = openMode;
	return _CheckRegular(_SetToAt(dir, path, openMode));
}

// Only regular files carry data here: a folder is refused as the platform
// does, and a pipe, socket or device would block or misbehave in a copy.
// The node was opened non-blocking so that a pipe could not hang its open.
status_t BFile::_CheckRegular(status_t status)
{
	if (status != B_OK)
		return status;
	struct stat st;
	if (fstat(_FileDescriptor(), &st) != 0)
		status = StatusFromErrno();
	else if (S_ISDIR(st.st_mode))
		status = B_IS_A_DIRECTORY;
	else if (!S_ISREG(st.st_mode))
		status = B_NOT_ALLOWED;
	else if (fcntl(_FileDescriptor(), F_SETFL,
			fcntl(_FileDescriptor(), F_GETFL) & ~O_NONBLOCK) != 0) {
		status = StatusFromErrno();
	}
	return status != B_OK ? _Fail(status) : B_OK;
}

bool BFile::IsReadable() const
{
	return InitCheck() == B_OK && (fMode & O_ACCMODE) != O_WRONLY;
}

bool BFile::IsWritable() const
{
	return InitCheck() == B_OK && (fMode & O_ACCMODE) != O_RDONLY;
}

ssize_t BFile::Read(void* buffer, size_t size)
{
	if (InitCheck() != B_OK)
		return InitCheck();
	ssize_t length = Retry([&] {
		return read(_FileDescriptor(), buffer, size); });
	return length >= 0 ? length : StatusFromErrno();
}

ssize_t BFile::ReadAt(off_t location, void* buffer, size_t size)
{
	if (InitCheck() != B_OK)
		return InitCheck();
	if (location < 0)
		return B_BAD_VALUE;
	ssize_t length = Retry([&] {
		return pread(_FileDescriptor(), buffer, size, location); });
	return length >= 0 ? length : StatusFromErrno();
}

ssize_t BFile::Write(const void* buffer, size_t size)
{
	if (InitCheck() != B_OK)
		return InitCheck();
	return WriteAll(buffer, size, [&](const char* data, size_t count, size_t) {
		return write(_FileDescriptor(), data, count);
	});
}

ssize_t BFile::WriteAt(off_t location, const void* buffer, size_t size)
{
	if (InitCheck() != B_OK)
		return InitCheck();
	if (location < 0)
		return B_BAD_VALUE;
	return WriteAll(buffer, size,
		[&](const char* data, size_t count, size_t done) {
			return pwrite(_FileDescriptor(), data, count, location + done);
		});
}

off_t BFile::Seek(off_t position, uint32 seekMode)
{
	if (InitCheck() != B_OK)
		return InitCheck();
	off_t result = lseek(_FileDescriptor(), position, seekMode);
	return result >= 0 ? result : StatusFromErrno();
}

off_t BFile::Position() const
{
	if (InitCheck() != B_OK)
		return InitCheck();
	off_t result = lseek(_FileDescriptor(), 0, SEEK_CUR);
	return result >= 0 ? result : StatusFromErrno();
}

status_t BFile::GetSize(off_t* size) const
{
	return BNode::GetSize(size);
}

status_t BFile::SetSize(off_t size)
{
	if (InitCheck() != B_OK)
		return InitCheck();
	if (size < 0)
		return B_BAD_VALUE;
	return ftruncate(_FileDescriptor(), size) == 0 ? B_OK : StatusFromErrno();
}

BFile& BFile::operator=(const BFile& file)
{
	if (this != &file) {
		BNode::operator=(file);
		fMode = file.fMode;
	}
	return *this;
}
