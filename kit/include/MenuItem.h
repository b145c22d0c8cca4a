#ifndef _MENU_ITEM_H
#define _MENU_ITEM_H

#include <memory>

#include <Invoker.h>
#include <Rect.h>

class BMenu;

namespace BPrivate {
struct MenuItemData;
class MenuAccess;
}

// One entry of a menu: a label, a model message and a keyboard shortcut, or
// a submenu. Shortcuts are letters typed with the menu key, Ctrl on a PC
// keyboard (B_COMMAND_KEY in modifiers stands for it; B_SHIFT_KEY and
// B_OPTION_KEY may be added), and show as "Ctrl+O" at the right of the item.
// An item that has no target when it is invoked goes to the window of the
// menu bar it belongs to, or of the thread that opened its pop-up menu.
class BMenuItem : public BInvoker {
public:
	BMenuItem(const char* label, BMessage* message, char shortcut = 0,
		uint32 modifiers = 0);
	// An item that opens menu, which it owns, labelled with menu's name.
	BMenuItem(BMenu* menu, BMessage* message = NULL);
	virtual ~BMenuItem();

	virtual void SetLabel(const char* name);
	const char* Label() const;
	// A disabled item is drawn grey and can be invoked neither by the mouse
	// nor by its shortcut. An item of a disabled menu is disabled too.
	virtual void SetEnabled(bool enabled);
	bool IsEnabled() const;
	virtual void SetMarked(bool marked);
	bool IsMarked() const;
	virtual void SetShortcut(char shortcut, uint32 modifiers);
	char Shortcut(uint32* modifiers = NULL) const;

	BMenu* Submenu() const;
	BMenu* Menu() const;
	// In the coordinates of its menu.
	BRect Frame() const;
	bool IsSelected() const;

	// Adds "when" (int64), "source" (the item, a pointer) and "index" (its
	// place in its menu, int32) to the copy it sends.
	virtual status_t Invoke(BMessage* message = NULL);

protected:
	// The size of what the item shows, margins excluded.
	virtual void GetContentSize(float* width, float* height);
	// Draws the item in its menu, with the menu's drawing state.
	virtual void Draw();
	virtual void DrawContent();
	// Where DrawContent starts: the left end of the label's baseline.
	BPoint ContentLocation() const;

private:
	friend class BPrivate::MenuAccess;

	std::unique_ptr<BPrivate::MenuItemData> fMenuItemData;
};

// A line between groups of items; never enabled.
class BSeparatorItem : public BMenuItem {
public:
	BSeparatorItem();
	virtual ~BSeparatorItem();

	virtual void SetEnabled(bool enabled);

protected:
	virtual void GetContentSize(float* width, float* height);
	virtual void Draw();
};

#endif
