#ifndef _FILE_H
#define _FILE_H

#include <Node.h>

// A regular file opened for data access. The open mode is a combination of
// B_READ_ONLY, B_WRITE_ONLY or B_READ_WRITE with B_CREATE_FILE,
// B_FAIL_IF_EXISTS, B_ERASE_FILE and B_OPEN_AT_END; new files get mode 0666
// less the umask. A folder is refused with B_IS_A_DIRECTORY.
//
// Write returns the number of bytes written; when the disk fills or fails
// part-way, that number is short of the request (or the error code when
// nothing could be written), so a caller never takes a partial write for a
// complete one.
class BFile : public BNode {
public:
	BFile();
	BFile(const BFile& file);
	BFile(const entry_ref* ref, uint32 openMode);
	BFile(const BEntry* entry, uint32 openMode);
	BFile(const char* path, uint32 openMode);
	BFile(const BDirectory* dir, const char* path, uint32 openMode);
	virtual ~BFile();

	status_t SetTo(const entry_ref* ref, uint32 openMode);
	status_t SetTo(const BEntry* entry, uint32 openMode);
	status_t SetTo(const char* path, uint32 openMode);
	status_t SetTo(const BDirectory* dir, const char* path, uint32 openMode);

	bool IsReadable() const;
	bool IsWritable() const;

	ssize_t Read(void* buffer, size_t size);
	ssize_t ReadAt(off_t location, void* buffer, size_t size);
	ssize_t Write(const void* buffer, size_t size);
	ssize_t WriteAt(off_t location, const void* buffer, size_t size);

	// seekMode is SEEK_SET, SEEK_CUR or SEEK_END; returns the new position.
	off_t Seek(off_t position, uint32 seekMode);
	off_t Position() const;

	status_t GetSize(off_t* size) const;
	status_t SetSize(off_t size);

	BFile& operator=(const BFile& file);

private:
	status_t _CheckRegular(status_t status);

	uint32 fMode;
};

#endif
