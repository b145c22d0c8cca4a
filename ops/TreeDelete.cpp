// Moving a folder of the tree to the trash.

#include "GvTreeView.h"

#include <Directory.h>
#include <FindDirectory.h>
#include <Message.h>
#include <Path.h>
#include <Window.h>

#include <cstdio>

#include "Commands.h"
#include "FolderItem.h"

// A name taken in the trash is tried again as "NAME copy 1", "NAME copy 2"...
// The folder goes straight to its trash name, so it is never renamed where
// it stands; when the next name would not fit in a file name the attempt
// stops and the folder stays. The tree hears only of a folder that left.
void GvTreeView::Delete(BMessage* message)
{
	FolderItem* item = _CommandRow(message);
	if (item == NULL || _IsProtected(item))
		return;

	BEntry entry(&item->ref, false);
	BPath trashPath;
	BDirectory trash;
	if (entry.InitCheck() != B_OK
		|| find_directory(B_TRASH_DIRECTORY, &trashPath, false) != B_OK
		|| trash.SetTo(trashPath.Path()) != B_OK)
		return;

	const char* name = item->ref.name;
	status_t result = entry.MoveTo(&trash, name, false);
	char trashName[B_FILE_NAME_LENGTH];
	for (int copy = 1; result == B_FILE_EXISTS; copy++) {
		int length = std::snprintf(trashName, sizeof(trashName), "%s copy %d", name, copy);
		if (length >= int(sizeof(trashName)))
			return;
		result = entry.MoveTo(&trash, trashName, false);
	}
	if (result != B_OK)
		return;

	BMessage notification(GV_REFRESH);
	notification.AddInt32(GV_EVENT, GV_DELETE);
	notification.AddRef(GV_DELETED_REF, &item->ref);
	Window()->PostMessage(&notification, this);
}
