// The two chains of rows: the full depth-first list and the chain of shown
// rows threaded through it. A collapsed folder's nextVisible skips its
// subtree, whose own links stay as they were, so opening it again brings the
// rows back as they were shown.

#include "GvTreeView.h"

#include <Directory.h>
#include <Window.h>

#include "FolderItem.h"
#include "GvRenView.h"

FolderItem* GvTreeView::_LastOf(FolderItem* item)
{
	FolderItem* last = item;
	while (last->next != NULL && last->next->level > item->level)
		last = last->next;
	return last;
}

FolderItem* GvTreeView::_After(FolderItem* item)
{
	return _LastOf(item)->next;
}

FolderItem* GvTreeView::_FindChild(FolderItem* parent, const entry_ref* ref)
{
	for (FolderItem* item = parent->next; item != NULL && item->level > parent->level;
			item = item->next) {
		if (item->level == parent->level + 1 && item->ref == *ref)
			return item;
	}
	return NULL;
}

// Every row whose chain goes from the point after last to from goes to to
// instead: last itself, and those of its ancestors at least as deep as level,
// which reach that point only when they are collapsed.
void GvTreeView::_Relink(FolderItem* last, int32 level, FolderItem* from, FolderItem* to)
{
	if (last->nextVisible == from)
		last->nextVisible = to;
	int32 depth = last->level;
	for (FolderItem* ancestor = last->prev; ancestor != NULL && depth > level;
			ancestor = ancestor->prev) {
		if (ancestor->level >= depth)
			continue;
		depth = ancestor->level;
		if (depth >= level && ancestor->nextVisible == from)
			ancestor->nextVisible = to;
	}
}

// Inserts item into the full list right after after, which ends a subtree
// (it has no children of its own).
void GvTreeView::_Link(FolderItem* after, FolderItem* item)
{
	FolderItem* following = after->next;
	item->prev = after;
	item->next = following;
	item->nextVisible = following;
	_Relink(after, item->level, following, item);
	after->next = item;
	if (following != NULL)
		following->prev = item;
}

// Counted from the chain itself, so that the count stays exact whatever
// part of the list a change touched, hidden rows included.
void GvTreeView::_CountRows()
{
	int32 count = 0;
	for (FolderItem* item = first; item != NULL; item = item->nextVisible)
		count++;
	lastVisible = count - 1;
}

void GvTreeView::_Open(FolderItem* item)
{
	item->expanded = true;
	item->nextVisible = item->next;
	_CountRows();
}

int32 GvTreeView::AddItem(FolderItem* after, FolderItem* item)
{
	if (item == NULL)
		return 0;
	if (after == NULL) {
		if (first != NULL)
			return 2;
		first = item;
	} else
		_Link(after, item);
	_CountRows();
	return 1;
}

int32 GvTreeView::AddUnder(FolderItem* parent, FolderItem* item)
{
	if (parent == NULL)
		return 2;
	if (item == NULL)
		return 0;
	_Link(_LastOf(parent), item);
	_CountRows();
	return 1;
}

int32 GvTreeView::RemoveItem(FolderItem* item)
{
	if (item == NULL)
		return 2;

	// Row indices are about to move under an editor still open.
	RemoveChild(renameView);

	bool selectionGoes = false;
	FolderItem* following = item;
	do {
		selectionGoes = selectionGoes || following == selected;
		following = following->next;
	} while (following != NULL && following->level > item->level);

	for (FolderItem* parent = item->prev; parent != NULL; parent = parent->prev) {
		if (parent->level < item->level) {
			parent->RemoveSubdir();
			break;
		}
	}

	if (item->prev != NULL)
		_Relink(item->prev, item->level, item, following);
	if (item == first)
		first = following;
	delete item;
	_CountRows();

	if (first == NULL)
		selected = NULL;
	else if (selectionGoes) {
		selected = NULL;
		Select(0);
	}
	AdjustScrollBars(Bounds().Width(), Bounds().Height());
	return 1;
}

void GvTreeView::RemoveAll()
{
	RemoveChild(renameView);
	while (first != NULL) {
		FolderItem* old = first;
		first = _After(old);
		delete old;
	}
	lastVisible = -1;
	selected = NULL;
	widestRow = 0;
}

FolderItem* GvTreeView::ItemAt(int32 index)
{
	if (index < 0 || index > lastVisible)
		return NULL;
	FolderItem* item = first;
	for (int32 i = 0; i < index && item != NULL; i++)
		item = item->nextVisible;
	return item;
}

int32 GvTreeView::IndexOf(FolderItem* item)
{
	if (item == NULL)
		return -1;
	int32 index = 0;
	for (FolderItem* row = first; row != NULL; row = row->nextVisible, index++) {
		if (row == item)
			return index;
	}
	return -1;
}

FolderItem* GvTreeView::FindItem(const entry_ref* ref)
{
	if (ref == NULL)
		return NULL;
	for (FolderItem* item = first; item != NULL; item = item->next) {
		if (item->ref == *ref)
			return item;
	}
	return NULL;
}

FolderItem* GvTreeView::FindLast()
{
	FolderItem* last = first;
	while (last != NULL && last->next != NULL)
		last = last->next;
	return last;
}

int32 GvTreeView::Expand(FolderItem* item)
{
	if (item == NULL)
		return 2;
	int32 result = AddSubdirs(item);
	if (result == 1)
		_Open(item);
	return result;
}

int32 GvTreeView::Collapse(FolderItem* item)
{
	if (item == NULL)
		return 2;
	if (item->expanded) {
		FolderItem* after = item->nextVisible;
		while (after != NULL && after->level > item->level)
			after = after->nextVisible;
		item->nextVisible = after;
		item->expanded = false;
		_CountRows();
	}
	return 1;
}

// The child is looked for in the whole list, not only among the rows shown,
// so that a folder whose reading failed once never gets a row twice; the
// parent ends up open in every case.
FolderItem* GvTreeView::FindItemUnder(FolderItem* parent, const entry_ref* ref)
{
	if (parent == NULL || ref == NULL)
		return NULL;
	if (parent->status == GV_FOLDER_TRASH)
		return parent;

	AddSubdirs(parent);
	FolderItem* child = _FindChild(parent, ref);
	if (child == NULL) {
		if (parent->subdirCount <= 0)
			parent->AddSubdir();
		child = new FolderItem(ref, parent->level + 1, _StatusFor(ref, parent));
		_Link(_LastOf(parent), child);
	}
	_Open(parent);
	return child;
}

FolderItem* GvTreeView::ExpandParentItem(FolderItem* root, BEntry* entry)
{
	entry_ref ref;
	if (root == NULL || entry == NULL || entry->GetRef(&ref) != B_OK)
		return NULL;
	BDirectory folder(entry);
	if (folder.IsRootDirectory()) {
		// The climb stops at the root of the entry's own volume, which must
		// be the volume of root.
		struct stat st;
		return folder.GetStat(&st) == B_OK && st.st_dev == root->device ? root : NULL;
	}

	BEntry parentEntry;
	if (entry->GetParent(&parentEntry) != B_OK)
		return NULL;
	*entry = parentEntry;
	FolderItem* parent = ExpandParentItem(root, entry);
	if (parent == NULL)
		return NULL;
	return FindItemUnder(parent, &ref);
}

void GvTreeView::FindAndOpen(const entry_ref* ref, int32 device)
{
	if (ref == NULL)
		return;
	// A folder that has gone gets no row.
	BDirectory folder(ref);
	if (folder.InitCheck() != B_OK)
		return;
	BEntry entry(ref);

	FolderItem* item = first;
	while (item != NULL && (item->level != 0 || item->device != dev_t(device)))
		item = item->nextVisible;
	if (item != NULL && AddSubdirs(item) == 1)
		_Open(item);
	if (item != NULL && !folder.IsRootDirectory()) {
		BEntry parentEntry;
		item = entry.GetParent(&parentEntry) == B_OK
			? ExpandParentItem(item, &parentEntry) : NULL;
		item = FindItemUnder(item, ref);
	}
	if (item == NULL)
		return;

	int32 index = IndexOf(item);
	Invalidate();
	if (Window() != NULL)
		Window()->UpdateIfNeeded();
	AdjustScrollBars(Bounds().Width(), Bounds().Height());

	BPoint origin = _RowOrigin(item, index);
	BRect frame = Frame();
	if (origin.x + GV_TREE_BOX + GV_TREE_ICON + item->textWidth > frame.right)
		ScrollTo(origin.x, 0);
	if (origin.y + 20 > frame.bottom)
		ScrollTo(0, origin.y);
	Select(index);
}
