// The refresh hub: every change the program makes to the file system comes
// back to the tree as an 'rfsh' notification, applied here to the rows
// before the file list is told to re-read or to switch folders.

#include "GvTreeView.h"

#include <Message.h>
#include <Window.h>

#include "Commands.h"
#include "FolderItem.h"

void GvTreeView::Refresh(BMessage* message)
{
	BRect region = Bounds();
	// One message to the file list, whose fields carry from event to event.
	BMessage outgoing(GV_REFRESH);
	int32 event;
	for (int32 i = 0; message->FindInt32(GV_EVENT, i, &event) == B_OK; i++) {
		switch (event) {
			case GV_DELETE:
				_FolderLeft(message, &outgoing);
				break;
			case GV_NEW_FOLDER:
				_FolderCreated(message, &region);
				break;
			case GV_RENAMED:
				_FolderRenamed(message, &outgoing, &region);
				break;
		}
	}
	Invalidate(region);
	if (Window() != NULL)
		Window()->UpdateIfNeeded();
}

// The row is looked up under the folder the file list names, which reads
// that folder if need be; nothing inside the trash has a row to remove.
void GvTreeView::_FolderLeft(BMessage* message, BMessage* outgoing)
{
	FolderItem* row = NULL;
	entry_ref deletedRef;
	entry_ref parentRef;
	if (message->FindRef(GV_DELETED_REF, &deletedRef) == B_OK) {
		if (message->FindRef(GV_DELETED_PARENT_REF, &parentRef) == B_OK) {
			FolderItem* parent = FindItem(&parentRef);
			row = FindItemUnder(parent, &deletedRef);
			if (row == parent)
				row = NULL;
		} else
			row = FindItem(&deletedRef);
	}

	if (row == selected && first != NULL) {
		selected = first;
		_DescribeFolder(outgoing, first);
	}
	_SendToFiles(outgoing);
	RemoveItem(row);
}

// A parent whose subfolders were read is opened before the row goes under
// it, so the new row is one of the shown rows; one whose subfolders were
// never read gets it with the others when it is first opened.
void GvTreeView::_FolderCreated(BMessage* message, BRect* region)
{
	entry_ref parentRef;
	FolderItem* parent = message->FindRef(GV_PARENT_REF, &parentRef) == B_OK
		? FindItem(&parentRef) : NULL;
	if (parent == NULL)
		return;

	entry_ref newRef;
	if (parent->status != GV_FOLDER_TRASH
		&& message->FindRef(GV_NEW_REF, &newRef) == B_OK) {
		if (parent->subdirsRead || parent->subdirCount <= 0) {
			_Open(parent);
			if (_FindChild(parent, &newRef) == NULL) {
				_Link(_LastOf(parent),
					new FolderItem(&newRef, parent->level + 1, _StatusFor(&newRef, parent)));
				parent->AddSubdir();
			}
			parent->subdirsRead = true;
			_CountRows();
		}
		region->top = _RowTop(IndexOf(parent));

		if (message->HasBool(GV_NEW)) {
			BMessage rename(GV_ASK_RENAME);
			rename.AddInt32(GV_TREE_INDEX, IndexOf(FindItemUnder(parent, &newRef)));
			Window()->PostMessage(&rename, this);
		}
	}

	if (parent == selected) {
		BMessage refresh(GV_REFRESH);
		_SendToFiles(&refresh);
	}
}

void GvTreeView::_FolderRenamed(BMessage* message, BMessage* outgoing, BRect* region)
{
	entry_ref oldRef;
	entry_ref renamedRef;
	if (message->FindRef(GV_OLD_REF, &oldRef) != B_OK
		|| message->FindRef(GV_RENAMED_REF, &renamedRef) != B_OK)
		return;
	FolderItem* row = FindItem(&oldRef);
	if (row == NULL)
		return;

	row->ref = renamedRef;
	region->top = _RowTop(IndexOf(row));
	region->bottom = region->top + 20;
	if (row == selected)
		_DescribeFolder(outgoing, row);
	_SendToFiles(outgoing);
}
