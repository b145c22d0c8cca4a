#include "TrashRecords.h"

#include <atomic>
#include <cerrno>
#include <cstdlib>
#include <ctime>
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <Directory.h>

#include "EntryPath.h"
#include "ErrnoStatus.h"
#include "UserFolders.h"

namespace BPrivate {

namespace {

const char* kRecordSuffix = ".trashinfo";

// The URI path escaping `gio trash` uses: all but unreserved characters
// and "/" as %XX.
std::string EscapePath(const std::string& path)
{
	static const char kHex[] = "0123456789ABCDEF";
	std::string escaped;
	for (unsigned char c : path) {
		if ((c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z')
			|| (c >= '0' && c <= '9') || c == '-' || c == '.' || c == '_'
			|| c == '~' || c == '/') {
			escaped += static_cast<char>(c);
		} else {
			escaped += '%';
			escaped += kHex[c >> 4];
			escaped += kHex[c & 0xf];
		}
	}
	return escaped;
}

std::string RecordFor(const std::string& originalPath)
{
	time_t now = time(nullptr);
	struct tm local;
	localtime_r(&now, &local);
	char date[32];
	strftime(date, sizeof(date), "%Y-%m-%dT%H:%M:%S", &local);
	return "[Trash Info]\nPath=" + EscapePath(originalPath)
		+ "\nDeletionDate=" + date + "\n";
}

// The trash's files and info folders, when the trash exists.
bool TrashFolders(std::string* files, std::string* info)
{
	std::string trash;
	if (CanonicalPath(HomeTrashFolder().c_str(), &trash) != B_OK)
		return false;
	*files = JoinPath(trash, "files");
	*info = JoinPath(trash, "info");
	return true;
}

std::string ReadRecord(const std::string& path)
{
	std::string contents;
	int fd = open(path.c_str(), O_RDONLY | O_CLOEXEC);
	if (fd < 0)
		return contents;
	char buffer[4096];
	ssize_t length;
	while ((length = read(fd, buffer, sizeof(buffer))) > 0)
		contents.append(buffer, length);
	close(fd);
	return contents;
}

status_t WriteAll(int fd, const std::string& contents)
{
	size_t done = 0;
	while (done < contents.size()) {
		ssize_t length = write(fd, contents.data() + done,
			contents.size() - done);
		if (length < 0 && errno != EINTR)
			return StatusFromErrno();
		if (length > 0)
			done += length;
	}
	return fsync(fd) == 0 ? B_OK : StatusFromErrno();
}

// Creates path with O_EXCL holding contents; nothing is left behind when
// that fails part-way.
status_t CreateRecord(const std::string& path, const std::string& contents)
{
	int fd = open(path.c_str(), O_WRONLY | O_CREAT | O_EXCL | O_CLOEXEC, 0600);
	if (fd < 0)
		return StatusFromErrno();
	status_t status = WriteAll(fd, contents);
	if (close(fd) != 0 && status == B_OK)
		status = StatusFromErrno();
	if (status != B_OK)
		unlink(path.c_str());
	return status;
}

}

std::string HomeTrashFolder()
{
	return JoinPath(DataHome(), "Trash");
}

status_t MakeHomeTrash(std::string* filesFolder)
{
	std::string trash = HomeTrashFolder();
	for (const char* folder : { "files", "info" }) {
		status_t status = create_directory(JoinPath(trash, folder).c_str(),
			0700);
		if (status != B_OK)
			return status;
	}
	*filesFolder = JoinPath(trash, "files");
	return B_OK;
}

status_t TrashMove::Prepare(const EntryPath& source,
	const std::string& targetFolder, const std::string& targetName,
	bool clobber)
{
	std::string files;
	std::string info;
	if (!TrashFolders(&files, &info))
		return B_OK;
	bool leaving = source.folder == files;
	if (leaving)
		fOldRecord = JoinPath(info, source.leaf + kRecordSuffix);
	if (targetFolder != files)
		return B_OK;

	// Renamed inside the trash, an entry keeps where it came from.
	std::string contents = leaving ? ReadRecord(fOldRecord) : "";
	if (contents.empty())
		contents = RecordFor(source.Path());
	fRecord = JoinPath(info, targetName + kRecordSuffix);
	if (clobber) {
		// The record of what the move replaces stays until the move is done.
		static std::atomic<int32> sCounter = 0;
		fWritten = JoinPath(info, ".varnel-" + std::to_string(getpid()) + "-"
			+ std::to_string(sCounter++) + kRecordSuffix);
		unlink(fWritten.c_str());
		status_t status = CreateRecord(fWritten, contents);
		if (status != B_OK)
			fWritten.clear();
		return status;
	}

	status_t status = CreateRecord(fRecord, contents);
	struct stat st;
	if (status == B_FILE_EXISTS
		&& lstat(JoinPath(files, targetName).c_str(), &st) != 0
		&& errno == ENOENT) {
		// A record left over from an item no longer in the trash.
		unlink(fRecord.c_str());
		status = CreateRecord(fRecord, contents);
	}
	if (status == B_OK)
		fWritten = fRecord;
	return status;
}

void TrashMove::Finish(bool moved)
{
	if (!moved) {
		if (!fWritten.empty())
			unlink(fWritten.c_str());
		return;
	}
	if (!fWritten.empty() && fWritten != fRecord)
		rename(fWritten.c_str(), fRecord.c_str());
	if (!fOldRecord.empty() && fOldRecord != fRecord)
		unlink(fOldRecord.c_str());
}

void TrashMove::Removed(const std::string& folder, const std::string& name)
{
	std::string files;
	std::string info;
	if (TrashFolders(&files, &info) && folder == files)
		unlink(JoinPath(info, name + kRecordSuffix).c_str());
}

}
