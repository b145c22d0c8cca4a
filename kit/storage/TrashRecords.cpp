#include "TrashRecords.h"

#include <algorithm>
#include <atomic>
#include <cerrno>
#include <ctime>
#include <sys/stat.h>
#include <unistd.h>

#include <Directory.h>
#include <StorageDefs.h>
#include <File.h>

#include "EntryPath.h"
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
	BFile file(path.c_str(), B_READ_ONLY);
	off_t size;
	// A record is a few lines; anything else is not one.
	if (file.GetSize(&size) != B_OK || size > 65536)
		return "";
	std::string contents(size, '\0');
	ssize_t length = file.Read(contents.data(), size);
	contents.resize(std::max<ssize_t>(length, 0));
	return contents;
}

// Creates path with O_EXCL holding contents; nothing is left behind when
// that fails part-way.
status_t CreateRecord(const std::string& path, const std::string& contents)
{
	BFile file(path.c_str(), B_WRITE_ONLY | B_CREATE_FILE | B_FAIL_IF_EXISTS);
	status_t status = file.InitCheck();
	if (status != B_OK)
		return status;
	// As private as the records gio writes.
	status = file.SetPermissions(0600);
	if (status == B_OK) {
		ssize_t written = file.Write(contents.data(), contents.size());
		if (written < 0)
			status = written;
		else if (static_cast<size_t>(written) < contents.size())
			status = B_DEVICE_FULL;
		else
			status = file.Sync();
	}
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

	std::string recordName = targetName + kRecordSuffix;
	if (recordName.size() >= B_FILE_NAME_LENGTH)
		return B_NAME_TOO_LONG;
	// Renamed inside the trash, an entry keeps where it came from, or
	// stays without a record if it had none.
	std::string contents = leaving ? ReadRecord(fOldRecord)
		: RecordFor(source.Path());
	if (contents.empty())
		return B_OK;
	fRecord = JoinPath(info, recordName);
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
