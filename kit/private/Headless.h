#ifndef KIT_PRIVATE_HEADLESS_H
#define KIT_PRIVATE_HEADLESS_H

#include <string>
#include <vector>

#include <InterfaceDefs.h>
#include <OS.h>
#include <Window.h>

// Test support for the display-less backend: input as the display would
// deliver it, and what the windows show. Windows are named by pointer, which
// is only compared, so a window that has gone is reported as such.
namespace BPrivate::Headless {

// Whether the kit runs without a display; the rest works only then.
bool IsActive();
// The main screen's size; 1024 x 768 until set.
void SetScreenSize(int32 width, int32 height);

struct WindowInfo {
	const BWindow* window;
	std::string title;
	BRect frame;
	bool visible;
	window_feel feel;
};

// The shown windows, front to back.
std::vector<WindowInfo> ListWindows();

// where is in the window's coordinates; buttons are those held after the
// event. Fails with B_BAD_VALUE for a window that is not on the display.
status_t PostMouse(const BWindow* window, uint32 what, BPoint where,
	uint32 buttons = B_PRIMARY_MOUSE_BUTTON, int32 clicks = 1);
status_t PostWheel(const BWindow* window, float dx, float dy);
// A B_KEY_DOWN of bytes (UTF-8) with the raw key code key.
status_t PostKey(const BWindow* window, const char* bytes, int32 key = 0);
// The modifier keys held from now on.
void SetModifiers(uint32 modifiers);

// Waits until every looper is idle; false on timeout.
bool WaitForIdle(bigtime_t timeout = 10000000);

// The window's last presented frame, rows of B_RGB32 pixels.
status_t ReadPixels(const BWindow* window, std::vector<uint32>* pixels,
	int32* width, int32* height);
// One pixel of it; alpha 0 outside the frame or for an unknown window.
rgb_color PixelAt(const BWindow* window, int32 x, int32 y);
status_t SaveScreenshot(const BWindow* window, const char* path);

}

#endif
