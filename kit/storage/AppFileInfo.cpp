#include <AppFileInfo.h>

#include <cstring>
#include <string>

#include <sys/stat.h>
#include <unistd.h>

#include <File.h>

#include "AppResources.h"
#include "MimeDatabase.h"
#include "TypeIcons.h"

using namespace BPrivate;

namespace {

// The node's own descriptor, not its stat: BNode reports the kit's volume
// ids, /proc/self/exe the system's.
bool IsRunningProgram(BFile* file)
{
	int fd = file->Dup();
	if (fd < 0)
		return false;
	struct stat fileStat;
	struct stat programStat;
	bool same = fstat(fd, &fileStat) == 0
		&& stat("/proc/self/exe", &programStat) == 0
		&& fileStat.st_dev == programStat.st_dev
		&& fileStat.st_ino == programStat.st_ino;
	close(fd);
	return same;
}

// A text resource without its closing line break, cut to fit.
void CopyTextResource(const char* name, char* buffer, size_t capacity)
{
	const void* data;
	size_t size;
	std::string text;
	if (FindAppResource(name, &data, &size))
		text.assign(static_cast<const char*>(data), strnlen(
			static_cast<const char*>(data), size));
	while (!text.empty() && (text.back() == '\n' || text.back() == '\r'))
		text.pop_back();
	CopyString(text, buffer, capacity);
}

}

BAppFileInfo::BAppFileInfo()
	: fIsRunningProgram(false)
{
}

BAppFileInfo::BAppFileInfo(BFile* file)
	: BAppFileInfo()
{
	SetTo(file);
}

BAppFileInfo::~BAppFileInfo()
{
}

status_t BAppFileInfo::SetTo(BFile* file)
{
	status_t status = BNodeInfo::SetTo(file);
	fIsRunningProgram = status == B_OK && IsRunningProgram(file);
	return status;
}

status_t BAppFileInfo::GetIcon(BBitmap* icon, icon_size which) const
{
	if (InitCheck() != B_OK)
		return B_NO_INIT;
	if (!fIsRunningProgram)
		return BNodeInfo::GetIcon(icon, which);
	status_t status = CheckIconBitmap(icon, which);
	if (status != B_OK)
		return status;

	const void* data;
	size_t size;
	if (!FindAppResource(StandardIconName(which), &data, &size))
		return B_ENTRY_NOT_FOUND;
	IconRef pixels = DecodePngIcon(data, size, which);
	if (pixels == nullptr)
		return B_BAD_DATA;
	CopyIconToBitmap(*pixels, icon);
	return B_OK;
}

status_t BAppFileInfo::GetVersionInfo(version_info* info,
	version_kind kind) const
{
	if (InitCheck() != B_OK)
		return B_NO_INIT;
	if (info == NULL)
		return B_BAD_VALUE;
	if (!fIsRunningProgram || kind != B_APP_VERSION_KIND)
		return B_ENTRY_NOT_FOUND;

	memset(info, 0, sizeof(*info));
	info->major = VARNEL_VERSION_MAJOR;
	info->middle = VARNEL_VERSION_MIDDLE;
	info->minor = VARNEL_VERSION_MINOR;
	// The build knows no pre-release stages.
	info->variety = B_FINAL_VERSION;
	CopyTextResource(kShortInfoResource, info->short_info,
		sizeof(info->short_info));
	CopyTextResource(kLongInfoResource, info->long_info,
		sizeof(info->long_info));
	return B_OK;
}
