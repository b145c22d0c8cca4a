#ifndef KIT_PRIVATE_WINDOW_HOOKS_H
#define KIT_PRIVATE_WINDOW_HOOKS_H

#include <memory>

#include <Window.h>

class BMessage;
class BView;

namespace BPrivate {

// The feel of menu windows (pop-up menus and the menus of a menu bar): in
// front of every other window, without decorations, given the keyboard while
// shown. The SDL backend makes them pop-up menu windows.
constexpr window_feel kMenuWindowFeel = window_feel(1025);

// How menus answer their shortcuts. The window asks its handler first for
// every B_KEY_DOWN with B_CONTROL_KEY or B_COMMAND_KEY held, in the window's
// thread with the window locked; true means the key was used.
class ShortcutHandler {
public:
	virtual ~ShortcutHandler() = default;
	virtual bool HandleShortcut(BWindow* window, BMessage* keyDown) = 0;
};

// NULL removes it. Call with the window locked.
void SetShortcutHandler(BWindow* window, ShortcutHandler* handler);

// The button that Enter presses wherever the focus is (BButton::MakeDefault):
// the window gives it every B_KEY_DOWN of B_ENTER. NULL for none. Call with
// the window locked.
void SetDefaultButton(BWindow* window, BView* button);
BView* DefaultButton(const BWindow* window);

// A drag in progress, started by BView::DragMessage. While one is set,
// MouseMoved hooks receive its message, and the window that receives the
// release of the buttons hands the release over (in that window's thread,
// with it locked). A dropped message posted to a window goes to the view
// under its drop point (BMessage::DropPoint, in screen coordinates).
class DragSession {
public:
	virtual ~DragSession() = default;
	virtual const BMessage* Message() const = 0;
	// Every B_MOUSE_MOVED a window receives while the drag lasts.
	virtual void Moved(BPoint screenWhere) = 0;
	virtual void Released(BPoint screenWhere) = 0;
};

// NULL ends the drag.
void SetDragSession(std::shared_ptr<DragSession> session);
std::shared_ptr<DragSession> CurrentDragSession();

}

#endif
