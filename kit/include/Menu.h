#ifndef _MENU_H
#define _MENU_H

#include <memory>

#include <Messenger.h>
#include <View.h>

class BMenuItem;

namespace BPrivate {
struct MenuData;
class MenuAccess;
}

enum menu_layout {
	B_ITEMS_IN_ROW = 0,
	B_ITEMS_IN_COLUMN,
	B_ITEMS_IN_MATRIX
};

// A list of items, shown in a window of its own while open: opened from a
// menu bar, from the item of another menu or by BPopUpMenu::Go. While open,
// a menu takes the pointer and the keyboard: the arrows move through the
// items, Enter invokes the selected one and Escape closes the menu. The menu
// owns its items. Changing a menu while it is open is for its own window's
// thread only.
class BMenu : public BView {
public:
	BMenu(const char* name, menu_layout layout = B_ITEMS_IN_COLUMN);
	virtual ~BMenu();

	virtual void Draw(BRect updateRect);
	virtual void MessageReceived(BMessage* message);

	bool AddItem(BMenuItem* item);
	bool AddItem(BMenuItem* item, int32 index);
	// Adds an item that opens menu.
	bool AddItem(BMenu* menu);
	bool AddItem(BMenu* menu, int32 index);
	bool AddSeparatorItem();
	// The removed items are the caller's.
	BMenuItem* RemoveItem(int32 index);
	bool RemoveItem(BMenuItem* item);
	bool RemoveItems(int32 index, int32 count, bool deleteItems = false);

	BMenuItem* ItemAt(int32 index) const;
	BMenu* SubmenuAt(int32 index) const;
	int32 CountItems() const;
	int32 IndexOf(BMenuItem* item) const;
	int32 IndexOf(BMenu* menu) const;
	BMenuItem* FindItem(uint32 command) const;
	BMenuItem* FindItem(const char* label) const;
	BMenuItem* FindMarked();

	// Aims every item at target (not those of submenus).
	virtual status_t SetTargetForItems(BHandler* target);
	virtual status_t SetTargetForItems(BMessenger messenger);

	virtual void SetEnabled(bool enabled);
	bool IsEnabled() const;
	// In radio mode, invoking an item marks it and unmarks the others.
	virtual void SetRadioMode(bool flag);
	bool IsRadioMode() const;
	// The superitem shows the label of the marked item.
	virtual void SetLabelFromMarked(bool flag);
	bool IsLabelFromMarked();

	BMenu* Supermenu() const;
	BMenuItem* Superitem() const;
	menu_layout Layout() const;

	virtual void GetPreferredSize(float* width, float* height);

protected:
	BMenu(BRect frame, const char* name, uint32 resizingMode, uint32 flags,
		menu_layout layout, bool resizeToFit);

private:
	friend class BPrivate::MenuAccess;

	void _Init(menu_layout layout, bool resizeToFit);

	std::unique_ptr<BPrivate::MenuData> fMenuData;
};

#endif
