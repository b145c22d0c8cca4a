#ifndef _POP_UP_MENU_H
#define _POP_UP_MENU_H

#include <memory>

#include <Menu.h>

namespace BPrivate {
struct PopUpMenuData;
}

// A menu shown on its own, usually under the pointer in answer to a click.
class BPopUpMenu : public BMenu {
public:
	BPopUpMenu(const char* name, bool radioMode = true, bool labelFromMarked = true,
		menu_layout layout = B_ITEMS_IN_COLUMN);
	// Closes the menu first if it is open.
	virtual ~BPopUpMenu();

	// Opens the menu with its top left corner at screenPoint, moved as
	// needed to lie on the screen, and tracks the user's choice:
	// - releasing the button over an enabled item chooses it;
	// - a release inside clickToOpen (screen coordinates) keeps the menu
	//   open, so that a click opens it for a second click; so does a release
	//   over the menu, or anywhere when openAnyway is true; any other release
	//   closes it;
	// - a click outside the menu or Escape closes it.
	// Synchronously (the default) it returns once the menu is closed, with
	// the item chosen or NULL; the calling window keeps showing what it
	// showed meanwhile. With deliversMessage, the item's message also goes
	// to its target. Asynchronously it returns NULL at once and the message
	// is delivered; the menu then deletes itself when it closes if
	// SetAsyncAutoDestruct(true) was called.
	BMenuItem* Go(BPoint screenPoint, bool deliversMessage = false, bool openAnyway = false,
		bool asynchronous = false);
	BMenuItem* Go(BPoint screenPoint, bool deliversMessage, bool openAnyway,
		BRect clickToOpen, bool asynchronous = false);

	void SetAsyncAutoDestruct(bool state);
	bool AsyncAutoDestruct() const;

private:
	BMenuItem* _Go(BPoint screenPoint, bool deliversMessage, bool openAnyway,
		const BRect* clickToOpen, bool asynchronous);

	std::unique_ptr<BPrivate::PopUpMenuData> fPopUpMenuData;
};

#endif
