#ifndef GV_WINDOW_H
#define GV_WINDOW_H

#include <Window.h>

class BMenu;
class BMenuBar;
class GvFilesView;
class GvTreeView;

// The main window: the menu bar, the folder tree on the left and the file
// list on the right, each in its frame. It routes the menu commands to the
// pane that has the focus and handles Empty Trash, Help and its title itself.
class GvWindow : public BWindow {
public:
	GvWindow(BRect frame, const char* title);

	virtual void MessageReceived(BMessage* message);
	virtual bool QuitRequested();
	virtual void MenusBeginning();

	// The two layouts: screens up to 640 pixels wide get the small one.
	static bool IsSmallScreen();
	static BRect FrameForScreen();

	BMenuBar* menuBar;
	BMenu* filesMenu;
	GvTreeView* tree;
	GvFilesView* fileList;

private:
	void BuildMenus();
	void BuildPanes();
	void RouteToFocusedPane(BMessage* message);
	void EmptyTrash();
	void ShowHelp();
	void ShowFolderInTitle(BMessage* message);
};

// Files menu items, by index.
enum {
	GV_FILES_ITEM_OPEN = 0,
	GV_FILES_ITEM_RENAME = 1,
	GV_FILES_ITEM_DELETE = 2,
	GV_FILES_ITEM_NEW_FOLDER = 4,
	GV_FILES_ITEM_EMPTY_TRASH = 6
};

#endif
