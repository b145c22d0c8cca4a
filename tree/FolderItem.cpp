#include "FolderItem.h"

#include <Directory.h>
#include <Volume.h>

#include <cstdio>

namespace {

// Copies text into a label buffer, cut at a character boundary when it is too
// long, so that a cut never leaves half a UTF-8 sequence.
void CopyLabel(char* buffer, const char* format, const char* text)
{
	int length = std::snprintf(buffer, B_FILE_NAME_LENGTH, format, text);
	if (length < B_FILE_NAME_LENGTH)
		return;
	int end = B_FILE_NAME_LENGTH - 1;
	while (end > 0 && (buffer[end] & 0xc0) == 0x80)
		end--;
	buffer[end] = '\0';
}

}

FolderItem::FolderItem(const entry_ref* folderRef, int32 folderLevel, int folderStatus)
	: status(folderStatus),
	  subdirCount(0),
	  isVolume(false),
	  ref(*folderRef),
	  level(folderLevel),
	  device(folderRef->device),
	  expanded(false),
	  subdirsRead(folderStatus == GV_FOLDER_TRASH),
	  textWidth(0),
	  prev(NULL),
	  next(NULL),
	  nextVisible(NULL)
{
	BDirectory folder(&ref);
	if (folder.InitCheck() != B_OK)
		return;
	// Below its volume's root a folder is on the volume of its own ref.
	isVolume = folder.IsRootDirectory();
	struct stat st;
	if (isVolume && folder.GetStat(&st) == B_OK)
		device = st.st_dev;
	if (status == GV_FOLDER_TRASH)
		return;

	entry_ref child;
	while (folder.GetNextRef(&child) == B_OK) {
		if (folder.GetStatFor(child.name, &st) == B_OK && S_ISDIR(st.st_mode))
			subdirCount++;
	}
}

FolderItem::~FolderItem()
{
	while (next != NULL && next->level > level)
		delete next;

	if (prev != NULL) {
		if (prev->nextVisible == this)
			prev->nextVisible = next;
		prev->next = next;
	}
	if (next != NULL)
		next->prev = prev;
}

void FolderItem::GetName(char* buffer) const
{
	if (isVolume) {
		BVolume volume(device);
		char volumeName[B_FILE_NAME_LENGTH];
		if (volume.InitCheck() == B_OK && volume.GetName(volumeName) == B_OK) {
			CopyLabel(buffer, status == GV_FOLDER_READ_ONLY ? "%s  (read-only)" : "%s",
				volumeName);
			return;
		}
	}
	CopyLabel(buffer, "%s", ref.name != NULL ? ref.name : "");
}

void FolderItem::AddSubdir()
{
	subdirCount++;
}

void FolderItem::RemoveSubdir()
{
	if (subdirCount > 0)
		subdirCount--;
}
