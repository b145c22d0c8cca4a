// The selected row, the keys and clicks the tree answers, its status for
// the window's menus and the start of a rename.

#include "GvTreeView.h"

#include <Message.h>
#include <Messenger.h>
#include <Window.h>

#include "Commands.h"
#include "FolderItem.h"
#include "GvRenView.h"
#include "GvScrollView.h"

void GvTreeView::_DescribeFolder(BMessage* message, const FolderItem* item)
{
	message->RemoveName(GV_PARENT_REF);
	message->RemoveName(GV_READ_ONLY);
	message->RemoveName(GV_VOLUME);
	message->RemoveName(GV_DEVICE);
	message->AddRef(GV_PARENT_REF, &item->ref);
	message->AddBool(GV_READ_ONLY, item->status == GV_FOLDER_READ_ONLY);
	message->AddBool(GV_VOLUME, item->isVolume);
	message->AddInt32(GV_DEVICE, item->device);
}

void GvTreeView::_SendToFiles(BMessage* message)
{
	if (filesMessenger != NULL)
		filesMessenger->SendMessage(message, (BHandler*)NULL, B_INFINITE_TIMEOUT);
}

int32 GvTreeView::Select(int32 index)
{
	if (selected != NULL)
		UnSelect();
	if (first == NULL)
		return 1;

	FolderItem* item = ItemAt(index);
	if (item == NULL) {
		item = first;
		index = 0;
	}
	item->DrawItem(this, _RowOrigin(item, index), 1);
	selected = item;

	float top = _RowTop(index);
	if (top < Bounds().top)
		ScrollTo(0, index == 0 ? 0 : top);
	if (top + 20 > Bounds().bottom) {
		if (top > Bounds().bottom)
			ScrollTo(0, top);
		else
			ScrollBy(0, 20);
	}

	BMessage message(GV_REFRESH);
	_DescribeFolder(&message, item);
	_SendToFiles(&message);
	if (Window() != NULL)
		Window()->PostMessage(&message, Window());
	return 1;
}

void GvTreeView::UnSelect()
{
	int32 index = IndexOf(selected);
	if (index < 0)
		return;
	selected->DrawItem(this, _RowOrigin(selected, index), 2);
	selected = NULL;
}

void GvTreeView::KeyDown(const char* bytes, int32 numBytes)
{
	switch (bytes[0]) {
		case B_PAGE_UP:
			ScrollBy(0, -Bounds().Height());
			break;
		case B_PAGE_DOWN:
			ScrollBy(0, Bounds().Height());
			break;
		case B_FUNCTION_KEY:
		{
			BMessage* event = Window()->CurrentMessage();
			if (event == NULL || event->GetInt32(GV_KEY, 0) != B_F5_KEY)
				break;
			Window()->PostMessage(GV_REFRESH, this);
			BMessage refresh(GV_REFRESH);
			_SendToFiles(&refresh);
			break;
		}
		case B_LEFT_ARROW:
			if (selected != NULL && selected->expanded)
				Expand_Collapse(selected);
			break;
		case B_RIGHT_ARROW:
			if (selected != NULL && !selected->expanded)
				Expand_Collapse(selected);
			break;
		case B_UP_ARROW:
		case B_DOWN_ARROW:
		{
			int32 index = IndexOf(selected) + (bytes[0] == B_UP_ARROW ? -1 : 1);
			UnSelect();
			Select(index);
			break;
		}
		default:
			BView::KeyDown(bytes, numBytes);
	}
}

void GvTreeView::MouseDown(BPoint where)
{
	BMessage* event = Window()->CurrentMessage();
	int32 buttons = event != NULL ? event->GetInt32(GV_BUTTONS, 0) : 0;
	int32 clicks = event != NULL ? event->GetInt32(GV_CLICKS, 1) : 1;

	MakeFocus(true);
	RemoveChild(renameView);

	int32 row = _RowAt(where.y);
	FolderItem* item = ItemAt(row);
	if (item == NULL)
		return;

	BPoint origin = _RowOrigin(item, row);
	BRect box(origin.x + GV_TREE_BOX_MIN, origin.y + GV_TREE_BOX_MIN,
		origin.x + GV_TREE_BOX_MAX, origin.y + GV_TREE_BOX_MAX);
	if (box.Contains(where)) {
		if (item->subdirCount > 0)
			Expand_Collapse(item);
		return;
	}
	BRect label(origin.x + GV_TREE_BOX, origin.y,
		origin.x + GV_TREE_BOX + GV_TREE_ICON + item->textWidth, origin.y + GV_TREE_V_INT);
	if (!label.Contains(where))
		return;

	if (buttons == B_SECONDARY_MOUSE_BUTTON)
		PopMenu(item, ConvertToScreen(where));
	else if (item != selected)
		Select(row);
	else {
		if (clicks == 2)
			Expand_Collapse(item);
		InitiateDrag(item);
	}
}

void GvTreeView::MakeFocus(bool focused)
{
	if (scrollFrame != NULL)
		scrollFrame->SetBorder(focused);
	BView::MakeFocus(true);
}

int32 GvTreeView::GetStatus()
{
	if (selected == NULL)
		return GV_STATUS_PROTECTED;
	if (selected->status == GV_FOLDER_READ_ONLY)
		return GV_STATUS_READ_ONLY;
	if (selected->isVolume)
		return GV_STATUS_VOLUME;
	return selected->status;
}

FolderItem* GvTreeView::_CommandRow(BMessage* message)
{
	int32 index;
	if (message->FindInt32(GV_TREE_INDEX, &index) == B_OK)
		return ItemAt(index);
	return selected;
}

void GvTreeView::Open(BMessage* message)
{
	Expand_Collapse(_CommandRow(message));
}

void GvTreeView::Rename(int32 index)
{
	FolderItem* item = ItemAt(index);
	if (item == NULL)
		return;
	char label[B_FILE_NAME_LENGTH];
	item->GetName(label);

	// A second request starts over on the new row.
	RemoveChild(renameView);
	renameView->ResizeTo(item->textWidth + 20, GV_TREE_V_INT);
	BPoint origin = _RowOrigin(item, index);
	renameView->MoveTo(origin.x + GV_TREE_BOX + GV_TREE_ICON, origin.y);
	renameView->Insert(label);
	AddChild(renameView);
	renameView->MakeFocus(true);
	renameView->SelectAll();
}
