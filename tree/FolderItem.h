#ifndef FOLDER_ITEM_H
#define FOLDER_ITEM_H

#include <Entry.h>
#include <Point.h>

class GvTreeView;

// What kind of folder a row is; the values double as the tree's status for
// the window's menus.
enum {
	GV_FOLDER_ORDINARY = 0,
	GV_FOLDER_READ_ONLY = 1,
	GV_FOLDER_DESKTOP = 2,
	GV_FOLDER_TRASH = 3
};

// One row of the folder tree. Every row ever read sits in one flat list in
// depth-first order (prev, next); nextVisible threads the rows shown. The
// list owns the rows: deleting a row deletes its subtree with it.
class FolderItem {
public:
	// Opens the folder once to learn whether it is a volume's root, its
	// device and how many subfolders it has (nothing is counted in the trash).
	FolderItem(const entry_ref* folderRef, int32 folderLevel, int folderStatus);
	~FolderItem();

	FolderItem(const FolderItem&) = delete;
	FolderItem& operator=(const FolderItem&) = delete;

	// The row's label in a buffer of B_FILE_NAME_LENGTH bytes: the volume's
	// name for a volume's root, else the folder's name.
	void GetName(char* buffer) const;
	void AddSubdir();
	void RemoveSubdir();
	// mode 0 draws on an erased background, 1 erases the band and draws the
	// row selected, 2 erases it and draws the row unselected.
	void DrawItem(GvTreeView* view, BPoint where, int mode);

	int32 status;
	int32 subdirCount;
	bool isVolume;
	entry_ref ref;
	int32 level;
	dev_t device;
	bool expanded;
	bool subdirsRead;
	// The width of the label as last drawn, plus 2; 0 until drawn.
	float textWidth;
	FolderItem* prev;
	FolderItem* next;
	FolderItem* nextVisible;
};

#endif
