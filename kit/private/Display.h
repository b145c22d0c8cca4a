#ifndef KIT_PRIVATE_DISPLAY_H
#define KIT_PRIVATE_DISPLAY_H

#include <memory>
#include <mutex>
#include <string>
#include <vector>

#include <Messenger.h>
#include <Rect.h>
#include <Window.h>

namespace BPrivate {

// What the display knows of a window. The window's thread presents frames
// into it; the driver shows them, possibly from another thread.
struct DisplayWindow {
	DisplayWindow(const BWindow* owner, BMessenger target)
		: owner(owner), target(target) {}

	// Identity only: the window may be gone, never dereference it.
	const BWindow* const owner;
	// Where input for the window goes.
	const BMessenger target;

	mutable std::mutex lock;
	// Guarded by lock. The last presented frame, rows of B_RGB32 pixels.
	std::vector<uint32> pixels;
	int32 width = 0;
	int32 height = 0;
	BRect frame;
	std::string title;
	window_look look = B_TITLED_WINDOW_LOOK;
	window_feel feel = B_NORMAL_WINDOW_FEEL;
	uint32 flags = 0;
	bool visible = false;
};

// The driver table of a display backend. Every entry may be called from any
// thread; a driver that must work in one thread forwards the call there.
class DisplayDriver {
public:
	virtual ~DisplayDriver() = default;

	virtual void CreateWindow(const std::shared_ptr<DisplayWindow>& window) = 0;
	virtual void DestroyWindow(const std::shared_ptr<DisplayWindow>& window) = 0;
	// Title, frame or visibility changed.
	virtual void UpdateWindow(const std::shared_ptr<DisplayWindow>& window) = 0;
	// Raises the window and gives it the keyboard.
	virtual void ActivateWindow(const std::shared_ptr<DisplayWindow>& window) = 0;
	// pixels holds a new frame.
	virtual void Present(const std::shared_ptr<DisplayWindow>& window) = 0;
	virtual BRect ScreenFrame() = 0;
};

// NULL when there is no display to open.
std::unique_ptr<DisplayDriver> CreateSdlDriver();
std::unique_ptr<DisplayDriver> CreateHeadlessDriver();

// The kit's side of the display: the driver chosen for this process (SDL
// when a display is present, else headless; VARNEL_BACKEND=sdl or headless
// forces one), the windows in stacking order and the state of the pointer
// and the keyboard. Drivers turn their events into the platform's messages
// through the Post functions.
class Display {
public:
	static Display& Default();

	DisplayDriver& Driver() { return *fDriver; }

	void AddWindow(const std::shared_ptr<DisplayWindow>& window);
	void RemoveWindow(const std::shared_ptr<DisplayWindow>& window);
	// Front to back.
	std::vector<std::shared_ptr<DisplayWindow>> Windows() const;
	std::shared_ptr<DisplayWindow> Find(const BWindow* owner) const;
	// Records that window became the active one: front of the list, and
	// B_WINDOW_ACTIVATED to it and to the one that was active before.
	void SetActiveWindow(const std::shared_ptr<DisplayWindow>& window);

	uint32 Modifiers() const;
	void SetModifiers(uint32 modifiers);
	void GetPointer(BPoint* screenWhere, uint32* buttons) const;

	// where is in the window's coordinates. Input that a modal window
	// blocks is dropped. While a menu window is shown, it takes the input of
	// every window, as a pointer and keyboard grab would.
	void PostMouse(const DisplayWindow& window, uint32 what, BPoint where,
		uint32 buttons, int32 clicks);
	void PostWheel(const DisplayWindow& window, float dx, float dy);
	// bytes is UTF-8; key the raw key code; rawChar the unmodified character.
	void PostKey(const DisplayWindow& window, uint32 what, const char* bytes,
		int32 key, int32 rawChar);

private:
	Display();
	bool _Blocked(const DisplayWindow& window) const;
	std::shared_ptr<DisplayWindow> _OpenMenu() const;

	std::unique_ptr<DisplayDriver> fDriver;

	mutable std::mutex fLock;
	std::vector<std::shared_ptr<DisplayWindow>> fWindows;
	const DisplayWindow* fActive = nullptr;
	uint32 fModifiers = 0;
	BPoint fPointer;
	uint32 fButtons = 0;
};

}

#endif
