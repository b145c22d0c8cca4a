// Dragging a row: the drop mode from the modifier keys, and its image.

#include "GvTreeView.h"

#include <Bitmap.h>
#include <Message.h>
#include <Path.h>
#include <Window.h>

#include "Commands.h"
#include "FolderItem.h"
#include "GvDragView.h"

void GvTreeView::InitiateDrag(FolderItem* item)
{
	if (first == NULL || item == NULL)
		return;

	BMessage* event = Window()->CurrentMessage();
	int32 modifiers = event != NULL ? event->GetInt32(GV_MODIFIERS, 0) : 0;
	uint32 code = GV_MOVE;
	if ((modifiers & B_CONTROL_KEY) != 0)
		code = (modifiers & B_SHIFT_KEY) != 0 ? GV_LINK : GV_COPY;
	// A volume can only be linked to; nothing is moved off a read-only one.
	if (item->isVolume)
		code = GV_LINK;
	else if (code == GV_MOVE && item->status == GV_FOLDER_READ_ONLY)
		code = GV_COPY;

	BMessage message(code);
	message.AddRef(GV_SOURCE_REF, &item->ref);
	if (code != GV_MOVE) {
		BEntry entry(&item->ref);
		BPath path;
		entry.GetPath(&path);
		message.AddFlat(GV_SOURCE_PATH, &path);
	}
	message.AddBool(GV_FOLDER, true);

	char label[B_FILE_NAME_LENGTH];
	item->GetName(label);
	BBitmap* icon = new BBitmap(item->isVolume ? volumeIcon.get() : folderIcon.get());
	BRect frame(0, 0, GV_TREE_ICON + item->textWidth, 19);
	BBitmap* image = new BBitmap(frame, B_CMAP8, true);
	image->Lock();
	image->AddChild(new GvDragView(frame, icon, label, code));
	image->Unlock();
	DragMessage(&message, image, BPoint(-18, -10));
}
