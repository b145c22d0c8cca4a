#include "Display.h"

#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <cstring>

#include <AppDefs.h>
#include <Message.h>
#include <OS.h>

#include "WindowHooks.h"

namespace BPrivate {

namespace {

bool Floats(window_feel feel)
{
	return feel == B_FLOATING_APP_WINDOW_FEEL || feel == B_FLOATING_ALL_WINDOW_FEEL
		|| feel == B_MODAL_APP_WINDOW_FEEL || feel == B_MODAL_ALL_WINDOW_FEEL
		|| feel == kMenuWindowFeel;
}

bool IsModal(window_feel feel)
{
	return feel == B_MODAL_APP_WINDOW_FEEL || feel == B_MODAL_ALL_WINDOW_FEEL;
}

void PostActivation(const DisplayWindow& window, bool active)
{
	BMessage message(B_WINDOW_ACTIVATED);
	message.AddInt64("when", system_time());
	message.AddBool("active", active);
	window.target.SendMessage(&message);
}

}

Display& Display::Default()
{
	// Never destroyed: window threads may still report to it at exit.
	static Display* display = new Display;
	return *display;
}

Display::Display()
{
	const char* forced = getenv("VARNEL_BACKEND");
	bool wantsSdl = forced != nullptr ? strcmp(forced, "sdl") == 0
		: getenv("DISPLAY") != nullptr || getenv("WAYLAND_DISPLAY") != nullptr;
	if (wantsSdl)
		fDriver = CreateSdlDriver();
	if (fDriver == nullptr) {
		if (wantsSdl)
			fprintf(stderr, "No display could be opened: running without one.\n");
		fDriver = CreateHeadlessDriver();
	}
}

void Display::AddWindow(const std::shared_ptr<DisplayWindow>& window)
{
	std::lock_guard<std::mutex> guard(fLock);
	fWindows.insert(fWindows.begin(), window);
}

void Display::RemoveWindow(const std::shared_ptr<DisplayWindow>& window)
{
	std::lock_guard<std::mutex> guard(fLock);
	std::erase(fWindows, window);
	if (fActive == window.get())
		fActive = nullptr;
}

std::vector<std::shared_ptr<DisplayWindow>> Display::Windows() const
{
	std::lock_guard<std::mutex> guard(fLock);
	return fWindows;
}

std::shared_ptr<DisplayWindow> Display::Find(const BWindow* owner) const
{
	std::lock_guard<std::mutex> guard(fLock);
	for (const auto& window : fWindows) {
		if (window->owner == owner)
			return window;
	}
	return nullptr;
}

void Display::SetActiveWindow(const std::shared_ptr<DisplayWindow>& window)
{
	const DisplayWindow* previous;
	{
		std::lock_guard<std::mutex> guard(fLock);
		previous = fActive;
		if (previous == window.get())
			return;
		fActive = window.get();
		auto found = std::find(fWindows.begin(), fWindows.end(), window);
		if (found != fWindows.end())
			std::rotate(fWindows.begin(), found, found + 1);
		// Posting under the lock keeps previous alive meanwhile.
		if (previous != nullptr)
			PostActivation(*previous, false);
	}
	PostActivation(*window, true);
}

uint32 Display::Modifiers() const
{
	std::lock_guard<std::mutex> guard(fLock);
	return fModifiers;
}

void Display::SetModifiers(uint32 modifiers)
{
	std::lock_guard<std::mutex> guard(fLock);
	fModifiers = modifiers;
}

void Display::GetPointer(BPoint* screenWhere, uint32* buttons) const
{
	std::lock_guard<std::mutex> guard(fLock);
	*screenWhere = fPointer;
	*buttons = fButtons;
}

bool Display::_Blocked(const DisplayWindow& window) const
{
	window_feel feel;
	{
		std::lock_guard<std::mutex> guard(window.lock);
		feel = window.feel;
	}
	if (Floats(feel))
		return false;
	for (const auto& other : fWindows) {
		std::lock_guard<std::mutex> guard(other->lock);
		if (other.get() != &window && other->visible && IsModal(other->feel))
			return true;
	}
	return false;
}

// The frontmost shown menu window; the caller holds fLock.
std::shared_ptr<DisplayWindow> Display::_OpenMenu() const
{
	for (const auto& window : fWindows) {
		std::lock_guard<std::mutex> guard(window->lock);
		if (window->visible && window->feel == kMenuWindowFeel)
			return window;
	}
	return nullptr;
}

void Display::PostMouse(const DisplayWindow& origin, uint32 what, BPoint where,
	uint32 buttons, int32 clicks)
{
	BPoint screen;
	{
		std::lock_guard<std::mutex> guard(origin.lock);
		screen = where + origin.frame.LeftTop();
	}
	uint32 modifiers;
	std::shared_ptr<DisplayWindow> menu;
	{
		std::lock_guard<std::mutex> guard(fLock);
		fPointer = screen;
		fButtons = buttons;
		modifiers = fModifiers;
		menu = _OpenMenu();
		if (what == B_MOUSE_DOWN && menu == nullptr && _Blocked(origin))
			return;
	}
	const DisplayWindow& window = menu != nullptr ? *menu : origin;
	if (menu != nullptr) {
		std::lock_guard<std::mutex> guard(menu->lock);
		where = screen - menu->frame.LeftTop();
	}
	BMessage message(what);
	message.AddInt64("when", system_time());
	message.AddPoint("where", where);
	message.AddPoint("screen_where", screen);
	message.AddInt32("buttons", int32(buttons));
	message.AddInt32("modifiers", int32(modifiers));
	if (what == B_MOUSE_DOWN)
		message.AddInt32("clicks", clicks);
	window.target.SendMessage(&message);
}

void Display::PostWheel(const DisplayWindow& window, float dx, float dy)
{
	{
		std::lock_guard<std::mutex> guard(fLock);
		if (_OpenMenu() != nullptr || _Blocked(window))
			return;
	}
	BMessage message(B_MOUSE_WHEEL_CHANGED);
	message.AddInt64("when", system_time());
	message.AddFloat("be:wheel_delta_x", dx);
	message.AddFloat("be:wheel_delta_y", dy);
	window.target.SendMessage(&message);
}

void Display::PostKey(const DisplayWindow& origin, uint32 what, const char* bytes,
	int32 key, int32 rawChar)
{
	uint32 modifiers;
	std::shared_ptr<DisplayWindow> menu;
	{
		std::lock_guard<std::mutex> guard(fLock);
		menu = _OpenMenu();
		if (menu == nullptr && _Blocked(origin))
			return;
		modifiers = fModifiers;
	}
	const DisplayWindow& window = menu != nullptr ? *menu : origin;
	BMessage message(what);
	message.AddInt64("when", system_time());
	message.AddInt32("modifiers", int32(modifiers));
	message.AddInt32("key", key);
	message.AddInt32("raw_char", rawChar);
	message.AddInt8("byte", int8(bytes[0]));
	message.AddString("bytes", bytes);
	window.target.SendMessage(&message);
}

}
