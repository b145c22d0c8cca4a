#ifndef _MENU_BAR_H
#define _MENU_BAR_H

#include <memory>

#include <Menu.h>

namespace BPrivate {
struct MenuBarData;
}

// The row of menu titles along the top of a window. Pressing a title opens
// its menu: releasing over an item invokes it, releasing over the bar keeps
// the menu open for clicks and the keyboard, and moving to another title
// opens that one's menu instead. The window's MenusBeginning runs before the
// menus open, MenusEnded after they close. While attached, the bar answers
// the shortcuts of all its items, between the same two hooks, so that the
// window can enable and disable the item first.
class BMenuBar : public BMenu {
public:
	// With resizeToFit, a bar in a row takes the height its font needs.
	BMenuBar(BRect frame, const char* name,
		uint32 resizingMode = B_FOLLOW_LEFT_RIGHT | B_FOLLOW_TOP,
		menu_layout layout = B_ITEMS_IN_ROW, bool resizeToFit = true);
	virtual ~BMenuBar();

	virtual void AttachedToWindow();
	virtual void DetachedFromWindow();
	virtual void Draw(BRect updateRect);
	virtual void MouseDown(BPoint where);
	virtual void MouseMoved(BPoint where, uint32 transit, const BMessage* dragMessage);
	virtual void MouseUp(BPoint where);
	virtual void MessageReceived(BMessage* message);

private:
	std::unique_ptr<BPrivate::MenuBarData> fMenuBarData;
};

#endif
