#ifndef KIT_INTERFACE_MENU_PRIVATE_H
#define KIT_INTERFACE_MENU_PRIVATE_H

#include <condition_variable>
#include <memory>
#include <mutex>
#include <string>
#include <vector>

#include <Menu.h>
#include <MenuItem.h>
#include <Messenger.h>
#include <Window.h>

#include "ModalHandoff.h"

class BMenuBar;

namespace BPrivate {

// The layout of items: room at the left of a column item for the check
// mark, at its right, between its label and its shortcut, for the arrow of
// a submenu; and on both sides of a label in a row.
constexpr float kItemLeftMargin = 18;
constexpr float kItemRightMargin = 10;
constexpr float kShortcutGap = 20;
constexpr float kSubmenuRoom = 12;
constexpr float kRowMargin = 8;

// Messages between the menus, their windows and their session.
enum {
	// To a menu view: "index" (int32) is the item to show selected, -1 none.
	kMenuSelect = '_MSL',
	// To a menu window: let the menu go and close; "marked" (pointer), when
	// present, is the item to mark first.
	kMenuClose = '_MCL',
	// To a menu bar: its menus have closed.
	kMenusEnded = '_MND'
};

struct MenuItemData {
	std::string label;
	char shortcut = 0;
	uint32 modifiers = 0;
	bool enabled = true;
	bool marked = false;
	BMenu* submenu = nullptr;
	BMenu* menu = nullptr;
	BRect frame;
};

struct MenuData {
	std::vector<BMenuItem*> items;
	menu_layout layout = B_ITEMS_IN_COLUMN;
	bool resizeToFit = true;
	bool enabled = true;
	bool radioMode = false;
	bool labelFromMarked = false;
	BMenuItem* superitem = nullptr;
	// The item drawn selected.
	int32 selected = -1;
};

class MenuAccess {
public:
	static MenuData& Data(const BMenu* menu) { return *menu->fMenuData; }
	static MenuItemData& Data(const BMenuItem* item) { return *item->fMenuItemData; }
	// Measures the items, gives them their frames and returns the size the
	// menu needs (a width and a height, as BRect::Width and Height count).
	static BPoint Layout(BMenu* menu);
	static void DrawItem(BMenuItem* item) { item->Draw(); }
	// The item under point (menu coordinates) that can be selected, or -1.
	static int32 SelectableAt(const BMenu* menu, BPoint point);
	static bool IsSelectable(const BMenuItem* item);
	// The next selectable item after index in direction (1 or -1),
	// wrapping around; -1 when there is none.
	static int32 NextSelectable(const BMenu* menu, int32 index, int32 direction);
	// The item whose shortcut the key makes with the modifier keys held, in
	// menu or its submenus.
	static BMenuItem* FindShortcut(const BMenu* menu, char key, uint32 modifiers);
	// Aims the items without a target, submenus included, at looper.
	static void Install(BMenu* menu, BLooper* looper);
	// "Ctrl+O" and the like; empty without a shortcut.
	static std::string ShortcutLabel(const BMenuItem* item);
};

// One round of menu tracking, from the opening of a menu until it closes:
// a pop-up menu, or the menus of a bar. Input reaches it from whichever
// window receives it, the menu windows above all (they take all input while
// shown), in that window's thread; each menu and the bar change only in
// their own window's thread, told by message.
class MenuSession : public std::enable_shared_from_this<MenuSession> {
public:
	struct Options {
		bool deliversMessage = true;
		bool openAnyway = false;
		bool hasClickRect = false;
		BRect clickRect;
		// Someone waits for the end (a synchronous BPopUpMenu::Go).
		bool waited = false;
		// The menu deletes itself when it closes.
		bool autoDelete = false;
	};

	static std::shared_ptr<MenuSession> StartPopUp(BMenu* menu, BPoint where,
		const Options& options);
	// Opens the menu of the bar's item index. From the keyboard, its first
	// item is selected and the menu stays open without a button held.
	static std::shared_ptr<MenuSession> StartBar(BMenuBar* bar, int32 index, bool byKeyboard);

	void MouseEvent(uint32 what, BPoint screenWhere, uint32 buttons);
	void KeyEvent(const char* bytes);
	// Closes everything without a choice.
	void Cancel();
	// From a menu window: it let its menu go.
	void Released(BMenu* menu);
	// Waits until the session has ended and every menu was let go, and
	// returns the chosen item. Blocking a looper's thread, it counts as idle.
	BMenuItem* Wait();
	// Cancels the session and waits until every menu was let go; a menu
	// that would delete itself when it closes no longer does.
	void Close();
	bool IsOpen() const;

private:
	struct Level {
		BMenu* menu;
		// On the screen.
		BRect frame;
		// The menu view, or the bar, whose selection follows.
		BMessenger view;
		// The menu's own window; none for the bar.
		BMessenger window;
		int32 selected;
		bool isBar;
	};
	enum class Placement {
		kAtPoint,
		kBelow,
		kBeside
	};
	struct Hit {
		int32 level = -1;
		int32 index = -1;
	};

	explicit MenuSession(const Options& options);

	struct Opening {
		BMenu* menu = nullptr;
		BRect anchor;
		Placement placement = Placement::kAtPoint;
		bool selectFirst = false;
		// fChanges when it was asked for.
		uint32 changes = 0;
	};

	// The methods below run with fLock held.
	Hit _HitTest(BPoint screenWhere) const;
	void _Hover(const Hit& hit);
	void _Select(int32 level, int32 index);
	void _CloseFrom(int32 level);
	void _Open(const Opening& opening);
	void _OpenSubmenu(int32 level, bool selectFirst);
	void _SwitchBar(int32 direction);
	void _Choose(BMenuItem* item);
	void _End(BMenuItem* chosen);
	bool _IsFinished() const { return fDone && fAttached.empty(); }

	mutable std::mutex fLock;
	std::condition_variable fChanged;
	Options fOptions;
	std::vector<Level> fLevels;
	// Menus in windows that have not let them go yet.
	std::vector<BMenu*> fAttached;
	// A menu to open once its previous window lets it go.
	Opening fPending;
	BMenu* fRoot = nullptr;
	bool fSticky = false;
	// Counts the changes of levels and selections.
	uint32 fChanges = 0;
	bool fDone = false;
	BMenuItem* fChosen = nullptr;
	ModalHandoff fHandoff;
};

// The menu's looper thread gave up a press it was tracking to a menu: the
// menu consumed the release of the button.
void ForgetPress(BWindow* window);

}

#endif
