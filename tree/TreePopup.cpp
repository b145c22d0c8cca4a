// The context menu of a row.

#include "GvTreeView.h"

#include <MenuItem.h>
#include <Message.h>
#include <PopUpMenu.h>

#include "Commands.h"
#include "FolderItem.h"

namespace {

BMenuItem* CommandItem(const char* label, uint32 command, int32 index, bool enabled)
{
	BMessage* message = new BMessage(command);
	message->AddInt32(GV_TREE_INDEX, index);
	BMenuItem* item = new BMenuItem(label, message);
	item->SetEnabled(enabled);
	return item;
}

}

void GvTreeView::PopMenu(FolderItem* item, BPoint where)
{
	if (item == NULL || item->status == GV_FOLDER_TRASH)
		return;

	int32 index = IndexOf(item);
	char label[B_FILE_NAME_LENGTH];
	item->GetName(label);
	bool writable = item->status != GV_FOLDER_READ_ONLY;
	bool changeable = writable && !_IsProtected(item);

	BPopUpMenu* menu = new BPopUpMenu("popup");
	menu->AddItem(CommandItem(label, GV_OPEN, index, true));
	menu->AddSeparatorItem();
	menu->AddItem(CommandItem("Rename", GV_ASK_RENAME, index, changeable));
	menu->AddItem(CommandItem("Move to trash", GV_DELETE, index, changeable));
	menu->AddSeparatorItem();
	menu->AddItem(CommandItem("Create a new folder", GV_NEW_FOLDER, index, writable));
	menu->SetTargetForItems(this);

	BRect clickArea(where - BPoint(5, 5), where + BPoint(5, 5));
	menu->Go(where, true, true, clickArea, false);
	delete menu;
}
