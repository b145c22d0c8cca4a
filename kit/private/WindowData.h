#ifndef KIT_PRIVATE_WINDOW_DATA_H
#define KIT_PRIVATE_WINDOW_DATA_H

#include <atomic>
#include <memory>
#include <string>
#include <vector>

#include <Window.h>

#include "Display.h"
#include "Painter.h"
#include "Region.h"

namespace BPrivate {

class ShortcutHandler;

// Messages a window sends itself.
enum {
	kUpdateMessage = '_UPD',
	kFlushMessage = '_FLS'
};

struct WindowData {
	std::string title;
	window_look look = B_TITLED_WINDOW_LOOK;
	window_feel feel = B_NORMAL_WINDOW_FEEL;
	uint32 flags = 0;
	uint32 workspaces = B_CURRENT_WORKSPACE;
	// The content area in screen coordinates.
	BRect frame;

	// Owned; covers the whole window and holds the views added to it.
	BView* topView = nullptr;
	BView* focus = nullptr;
	// The view that got the press, which receives the pointer until release.
	BView* mouseView = nullptr;
	// The view the pointer was last over.
	BView* lastMouseView = nullptr;
	ShortcutHandler* shortcuts = nullptr;
	BView* defaultButton = nullptr;

	// What the views draw on: the window's framebuffer, or for the window
	// behind a bitmap, the bitmap's bits.
	std::vector<uint32> framebuffer;
	Surface surface;
	BBitmap* bitmap = nullptr;

	// Bumped by every change of geometry or of the view hierarchy.
	uint32 layoutStamp = 1;
	Region invalid;
	bool updatePending = false;
	// The area being redrawn while the views' Draw hooks run.
	Region updating;
	bool inUpdate = false;
	uint32 updateStamp = 0;
	// Drawn since the last present.
	IntRect dirty;
	std::atomic<bool> flushPosted{false};

	std::shared_ptr<DisplayWindow> display;
	// Show() and Hide() count: hidden while positive.
	int32 hideLevel = 1;
	bool active = false;
};

// The windows of the program in creation order (BApplication::WindowAt).
void RegisterWindow(BWindow* window);
void UnregisterWindow(BWindow* window);

class WindowAccess {
public:
	static WindowData& Data(const BWindow* window) { return *window->fWindowData; }
	static bool IsOffscreen(const BWindow* window) { return Data(window).bitmap != nullptr; }
	// Adds rect (window coordinates) to what the next update redraws.
	static void Invalidate(BWindow* window, const IntRect& rect);
	// Records pixels drawn outside of the window's own dispatching, so that
	// they reach the screen.
	static void Drawn(BWindow* window, const IntRect& touched);
	static void LayoutChanged(BWindow* window) { Data(window).layoutStamp++; }
	// Tells the display the window's title, frame, look and visibility.
	static void Publish(BWindow* window);
	// Gives the window a new size (the views follow) without telling the
	// display.
	static void Resize(BWindow* window, float width, float height);
	// Redraws what is invalid, in the window's thread.
	static void Update(BWindow* window);
	// Hands what was drawn to the display.
	static void Present(BWindow* window);
	// Pointer and focus bookkeeping when views leave the window.
	static void ViewRemoved(BWindow* window, BView* view);
	static void SetFocus(BWindow* window, BView* view);
};

}

#endif
