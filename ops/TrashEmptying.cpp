#include "CopyWindow.h"

#include <Directory.h>
#include <Entry.h>
#include <FindDirectory.h>
#include <Message.h>
#include <Path.h>
#include <StatusBar.h>

namespace {
const rgb_color kDeletingRed = { 200, 0, 0, 255 };

bool IsFolder(BDirectory* parent, const entry_ref& ref)
{
	struct stat st;
	return parent->GetStatFor(ref.name, &st) == B_OK && S_ISDIR(st.st_mode);
}

// Removed through the kit, which also drops the trash record of a top-level
// item; a folder goes only when it is empty, as with rmdir.
void Remove(const entry_ref& ref)
{
	BEntry entry(&ref, false);
	if (entry.InitCheck() == B_OK)
		entry.Remove();
}
}

int32 CopyWindow::EmptyTrash()
{
	BPath trashPath;
	if (find_directory(B_TRASH_DIRECTORY, &trashPath, false) != B_OK)
		return 1;
	BDirectory trash(trashPath.Path());
	entry_ref trashRef;
	if (trash.InitCheck() != B_OK || get_ref_for_path(trashPath.Path(), &trashRef) != B_OK)
		return 1;

	// Reset, maximum and colour in this order, each applied before the next.
	int64 count = CountEntries(&trashRef);
	if (Lock()) {
		bar->Reset("Deleting ", " items remaining");
		itemsRemaining = uint32(count);
		bar->SetMaxValue(float(itemsRemaining));
		bar->SetBarColor(kDeletingRed);
		Unlock();
	}
	return DeleteDirectory(&trashRef);
}

int32 CopyWindow::DeleteDirectory(const entry_ref* folder)
{
	BDirectory directory(folder);
	if (directory.InitCheck() != B_OK)
		return 1;
	if (cancel)
		return 3;
	DeleteSubdirs(&directory);
	if (cancel)
		return 3;
	directory.Rewind();
	DeleteFiles(&directory);
	return 1;
}

void CopyWindow::DeleteSubdirs(BDirectory* folder)
{
	entry_ref ref;
	while (folder->GetNextRef(&ref) == B_OK) {
		if (!IsFolder(folder, ref))
			continue;
		BDirectory subfolder(&ref);
		if (subfolder.InitCheck() == B_OK) {
			if (cancel)
				return;
			DeleteSubdirs(&subfolder);
			if (cancel)
				return;
			subfolder.Rewind();
			DeleteFiles(&subfolder);
		}
		if (cancel)
			return;
		ShowItem(ref.name);
		Remove(ref);
		Advance(1.0f);
	}
}

void CopyWindow::DeleteFiles(BDirectory* folder)
{
	entry_ref ref;
	while (folder->GetNextRef(&ref) == B_OK) {
		if (cancel)
			return;
		if (IsFolder(folder, ref))
			continue;
		ShowItem(ref.name);
		Remove(ref);
		Advance(1.0f);
	}
}
