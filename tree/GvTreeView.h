#ifndef GV_TREE_VIEW_H
#define GV_TREE_VIEW_H

#include <memory>

#include <Entry.h>

#include "GvTargetView.h"

class BBitmap;
class BMessenger;
class BScrollBar;
class BVolumeRoster;
class FolderItem;
class GvRenView;

// The layout of a row, relative to its origin.
const float GV_TREE_BOX = 14;
const float GV_TREE_BOX_MIN = 3;
const float GV_TREE_BOX_MAX = 11;
const float GV_TREE_V_INT = 16;
const float GV_TREE_ICON = 20;
const float GV_TREE_V_TEXT_START = 11;

// The left pane: every mounted persistent volume and the folders opened
// below it. Folders are read the first time they are opened; afterwards the
// tree learns of changes only through the 'rfsh' notifications its refresh
// hub applies, and through mount and unmount events.
class GvTreeView : public GvTargetView {
public:
	GvTreeView(BRect frame, const char* name);
	virtual ~GvTreeView();

	virtual void MessageReceived(BMessage* message);
	virtual void AttachedToWindow();
	virtual void Draw(BRect update);
	virtual void MouseDown(BPoint where);
	virtual void KeyDown(const char* bytes, int32 numBytes);
	virtual void FrameResized(float width, float height);
	virtual void MakeFocus(bool focused = true);

	// The rows. Results: 1 done, 0 nothing done, 2 invalid argument.
	int32 AddItem(FolderItem* after, FolderItem* item);
	int32 AddUnder(FolderItem* parent, FolderItem* item);
	int32 RemoveItem(FolderItem* item);
	void RemoveAll();
	FolderItem* ItemAt(int32 index);
	int32 IndexOf(FolderItem* item);
	FolderItem* FindItem(const entry_ref* ref);
	FolderItem* FindLast();
	int32 Expand(FolderItem* item);
	int32 Collapse(FolderItem* item);
	// The child of parent that has ref, created when it is not there.
	FolderItem* FindItemUnder(FolderItem* parent, const entry_ref* ref);
	// The row of entry's folder below the volume row root, every folder on
	// the way read and expanded; entry is moved up to the volume's root.
	FolderItem* ExpandParentItem(FolderItem* root, BEntry* entry);
	// Shows, scrolls to and selects the folder ref of volume device.
	void FindAndOpen(const entry_ref* ref, int32 device);

	// Volumes and reading.
	int32 InitTree();
	void AddVolume(int32 device);
	void RemoveVolume(int32 device);
	void Monitor(BMessage* message);
	int32 AddSubdirs(FolderItem* item);
	int32 Expand_Collapse(FolderItem* item);

	// Drawing.
	void DrawIcon(bool volume);
	void AdjustScrollBars(float width, float height);
	void AdjustScrollBar(BScrollBar* bar, float total, float visible, float range);
	void Disable(BRect area);
	void Enable(BRect area);

	// Selection and commands.
	int32 Select(int32 index);
	void UnSelect();
	int32 GetStatus();
	void Open(BMessage* message);
	void Rename(int32 index);
	void PopMenu(FolderItem* item, BPoint where);
	void InitiateDrag(FolderItem* item);

	// File operations, each given the command or notification received.
	void Copy(BMessage* message);
	void Move(BMessage* message);
	void LinkTo(BMessage* message);
	void Delete(BMessage* message);
	void NewFolder(BMessage* message);
	void Refresh(BMessage* message);

	entry_ref desktopRef;
	entry_ref trashRef;
	// Owned; a child of the tree only while a rename is in progress.
	GvRenView* renameView;
	std::unique_ptr<BVolumeRoster> volumeRoster;
	std::unique_ptr<BBitmap> folderIcon;
	std::unique_ptr<BBitmap> volumeIcon;
	BScrollBar* verticalBar;
	BScrollBar* horizontalBar;
	// False while the pane is greyed out during a folder read.
	bool enabled;
	// The right end of the widest label drawn so far.
	float widestRow;
	// The index of the last shown row (shown rows minus one); -1 when empty.
	int32 lastVisible;
	FolderItem* first;
	FolderItem* selected;
	// The file list; set by the window once both panes exist, deleted here.
	BMessenger* filesMessenger;

private:
	static float _RowTop(int32 index);
	static BPoint _RowOrigin(const FolderItem* item, int32 index);
	// The row under y, -1 above the first one.
	static int32 _RowAt(float y);
	// Sets the fields of a folder-shown 'rfsh' to item's folder.
	static void _DescribeFolder(BMessage* message, const FolderItem* item);

	// List helpers: the last item of item's subtree, the item after it, and
	// the child of parent with ref wherever it is in the list.
	static FolderItem* _LastOf(FolderItem* item);
	static FolderItem* _After(FolderItem* item);
	static FolderItem* _FindChild(FolderItem* parent, const entry_ref* ref);
	void _Relink(FolderItem* last, int32 level, FolderItem* from, FolderItem* to);
	void _Link(FolderItem* after, FolderItem* item);
	void _Open(FolderItem* item);
	void _CountRows();
	int _StatusFor(const entry_ref* ref, const FolderItem* parent) const;
	bool _IsProtected(const FolderItem* item) const;

	// The row a command names with "tree index", else the selected one.
	FolderItem* _CommandRow(BMessage* message);
	void _Renamed(BMessage* message);
	void _SendToFiles(BMessage* message);

	// The events of a change notification.
	void _FolderLeft(BMessage* message, BMessage* outgoing);
	void _FolderCreated(BMessage* message, BRect* region);
	void _FolderRenamed(BMessage* message, BMessage* outgoing, BRect* region);
};

#endif
