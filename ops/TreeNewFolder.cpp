// Creating a folder in a row of the tree.

#include "GvTreeView.h"

#include <Directory.h>
#include <Message.h>
#include <Window.h>

#include <cstdio>

#include "Commands.h"
#include "FolderItem.h"

namespace {
const char* const kNewFolderName = "New Folder";
}

// The folder is "New Folder", else the first free "New Folder N" from 2 on.
// The row comes with the notification, which also opens the rename editor.
void GvTreeView::NewFolder(BMessage* message)
{
	FolderItem* item = _CommandRow(message);
	if (item == NULL)
		return;
	BDirectory folder(&item->ref);
	if (folder.InitCheck() != B_OK)
		return;

	char name[B_FILE_NAME_LENGTH];
	std::snprintf(name, sizeof(name), "%s", kNewFolderName);
	status_t result = folder.CreateDirectory(name, NULL);
	for (int number = 2; result == B_FILE_EXISTS; number++) {
		std::snprintf(name, sizeof(name), "%s %d", kNewFolderName, number);
		result = folder.CreateDirectory(name, NULL);
	}
	entry_ref newRef;
	BEntry created(&folder, name);
	if (result != B_OK || created.GetRef(&newRef) != B_OK)
		return;

	BMessage notification(GV_REFRESH);
	notification.AddInt32(GV_EVENT, GV_NEW_FOLDER);
	notification.AddRef(GV_PARENT_REF, &item->ref);
	notification.AddRef(GV_NEW_REF, &newRef);
	notification.AddBool(GV_NEW, true);
	Window()->PostMessage(&notification, this);
}
