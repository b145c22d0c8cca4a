#include <SDL.h>

#include <cctype>
#include <cstdio>
#include <deque>
#include <map>
#include <mutex>

#include <AppDefs.h>
#include <Application.h>
#include <InterfaceDefs.h>
#include <Message.h>

#include "Display.h"
#include "MainLoop.h"
#include "SdlKeys.h"
#include "WindowHooks.h"

namespace BPrivate {

namespace {

constexpr Uint16 kShortcutMods = KMOD_CTRL | KMOD_ALT | KMOD_GUI;

enum class Command {
	kCreate,
	kDestroy,
	kUpdate,
	kActivate,
	kPresent
};

struct Request {
	Command command;
	std::shared_ptr<DisplayWindow> window;
};

struct NativeWindow {
	std::shared_ptr<DisplayWindow> window;
	SDL_Window* sdl = nullptr;
};

// SDL wants its video calls in one thread, the main one: window threads
// queue requests, and a registered user event wakes the main loop to run them.
class SdlDriver : public DisplayDriver {
public:
	bool Init();

	void CreateWindow(const std::shared_ptr<DisplayWindow>& window) override
	{
		_Request(Command::kCreate, window);
	}
	void DestroyWindow(const std::shared_ptr<DisplayWindow>& window) override
	{
		_Request(Command::kDestroy, window);
	}
	void UpdateWindow(const std::shared_ptr<DisplayWindow>& window) override
	{
		_Request(Command::kUpdate, window);
	}
	void ActivateWindow(const std::shared_ptr<DisplayWindow>& window) override
	{
		_Request(Command::kActivate, window);
	}
	void Present(const std::shared_ptr<DisplayWindow>& window) override
	{
		_Request(Command::kPresent, window);
	}
	BRect ScreenFrame() override { return fScreen; }

	void Run(BApplication* application);
	void Wake();

private:
	void _Request(Command command, const std::shared_ptr<DisplayWindow>& window);
	void _RunRequests();
	void _Create(const std::shared_ptr<DisplayWindow>& window);
	void _Update(const NativeWindow& native);
	void _Present(const NativeWindow& native);
	NativeWindow* _Native(const DisplayWindow* window);
	NativeWindow* _NativeFor(Uint32 windowID);
	void _Handle(const SDL_Event& event);
	void _HandleWindowEvent(NativeWindow& native, const SDL_WindowEvent& event);
	void _HandleKey(const SDL_KeyboardEvent& event);
	const DisplayWindow* _KeyTarget(Uint32 windowID);

	BRect fScreen;
	Uint32 fEventType = 0;

	std::mutex fLock;
	std::deque<Request> fRequests;
	bool fWakePending = false;

	// Main thread only.
	std::map<Uint32, NativeWindow> fWindows;
	uint32 fButtons = 0;
	int32 fPendingKey = 0;
};

bool SdlDriver::Init()
{
	SDL_SetHint(SDL_HINT_QUIT_ON_LAST_WINDOW_CLOSE, "0");
	// Frames are drawn by the kit and only copied to the screen: the plain
	// X11 framebuffer does that without OpenGL, which may be missing or slow.
	SDL_SetHint(SDL_HINT_FRAMEBUFFER_ACCELERATION, "0");
	SDL_SetHint(SDL_HINT_MOUSE_FOCUS_CLICKTHROUGH, "1");
	SDL_SetHint(SDL_HINT_VIDEO_X11_NET_WM_BYPASS_COMPOSITOR, "0");
	if (SDL_Init(SDL_INIT_VIDEO) != 0)
		return false;
	SDL_Rect bounds;
	fEventType = SDL_RegisterEvents(1);
	if (fEventType == Uint32(-1) || SDL_GetDisplayBounds(0, &bounds) != 0) {
		SDL_Quit();
		return false;
	}
	fScreen = BRect(bounds.x, bounds.y, bounds.x + bounds.w - 1, bounds.y + bounds.h - 1);
	SDL_StartTextInput();
	return true;
}

void SdlDriver::_Request(Command command, const std::shared_ptr<DisplayWindow>& window)
{
	std::lock_guard<std::mutex> guard(fLock);
	if (command == Command::kPresent) {
		for (const Request& request : fRequests) {
			if (request.command == Command::kPresent && request.window == window)
				return;
		}
	}
	fRequests.push_back({command, window});
	if (!fWakePending) {
		fWakePending = true;
		SDL_Event event = {};
		event.type = fEventType;
		SDL_PushEvent(&event);
	}
}

void SdlDriver::Wake()
{
	SDL_Event event = {};
	event.type = fEventType;
	SDL_PushEvent(&event);
}

void SdlDriver::_RunRequests()
{
	std::deque<Request> requests;
	{
		std::lock_guard<std::mutex> guard(fLock);
		requests.swap(fRequests);
		fWakePending = false;
	}
	for (const Request& request : requests) {
		if (request.command == Command::kCreate) {
			_Create(request.window);
			continue;
		}
		NativeWindow* native = _Native(request.window.get());
		if (native == nullptr)
			continue;
		switch (request.command) {
			case Command::kDestroy:
				SDL_DestroyWindow(native->sdl);
				fWindows.erase(SDL_GetWindowID(native->sdl));
				break;
			case Command::kUpdate:
				_Update(*native);
				break;
			case Command::kActivate:
				SDL_RaiseWindow(native->sdl);
				break;
			case Command::kPresent:
				_Present(*native);
				break;
			case Command::kCreate:
				break;
		}
	}
}

void SdlDriver::_Create(const std::shared_ptr<DisplayWindow>& window)
{
	Uint32 flags = SDL_WINDOW_HIDDEN;
	BRect frame;
	std::string title;
	{
		std::lock_guard<std::mutex> guard(window->lock);
		frame = window->frame;
		title = window->title;
		if (window->feel == kMenuWindowFeel)
			flags |= SDL_WINDOW_POPUP_MENU | SDL_WINDOW_BORDERLESS;
		else if (window->look == B_NO_BORDER_WINDOW_LOOK
			|| window->look == B_BORDERED_WINDOW_LOOK)
			flags |= SDL_WINDOW_BORDERLESS;
		if ((window->flags & B_NOT_RESIZABLE) == 0
			&& (window->look == B_DOCUMENT_WINDOW_LOOK || window->look == B_TITLED_WINDOW_LOOK))
			flags |= SDL_WINDOW_RESIZABLE;
	}
	SDL_Window* sdl = SDL_CreateWindow(title.c_str(), int(frame.left), int(frame.top),
		frame.IntegerWidth() + 1, frame.IntegerHeight() + 1, flags);
	if (sdl == nullptr) {
		fprintf(stderr, "Cannot open the window \"%s\": %s\n", title.c_str(), SDL_GetError());
		return;
	}
	NativeWindow& native = fWindows[SDL_GetWindowID(sdl)];
	native.window = window;
	native.sdl = sdl;
	_Update(native);
}

void SdlDriver::_Update(const NativeWindow& native)
{
	const DisplayWindow& window = *native.window;
	std::unique_lock<std::mutex> guard(window.lock);
	BRect frame = window.frame;
	std::string title = window.title;
	bool visible = window.visible;
	guard.unlock();

	SDL_SetWindowTitle(native.sdl, title.c_str());
	int x, y, width, height;
	SDL_GetWindowPosition(native.sdl, &x, &y);
	SDL_GetWindowSize(native.sdl, &width, &height);
	if (x != int(frame.left) || y != int(frame.top))
		SDL_SetWindowPosition(native.sdl, int(frame.left), int(frame.top));
	if (width != frame.IntegerWidth() + 1 || height != frame.IntegerHeight() + 1)
		SDL_SetWindowSize(native.sdl, frame.IntegerWidth() + 1, frame.IntegerHeight() + 1);
	bool shown = (SDL_GetWindowFlags(native.sdl) & SDL_WINDOW_SHOWN) != 0;
	if (visible && !shown) {
		SDL_ShowWindow(native.sdl);
		_Present(native);
	} else if (!visible && shown)
		SDL_HideWindow(native.sdl);
}

void SdlDriver::_Present(const NativeWindow& native)
{
	SDL_Surface* surface = SDL_GetWindowSurface(native.sdl);
	if (surface == nullptr)
		return;
	const DisplayWindow& window = *native.window;
	{
		std::lock_guard<std::mutex> guard(window.lock);
		int width = min_c(surface->w, int(window.width));
		int height = min_c(surface->h, int(window.height));
		if (width <= 0 || height <= 0)
			return;
		SDL_ConvertPixels(width, height, SDL_PIXELFORMAT_ARGB8888, window.pixels.data(),
			window.width * 4, surface->format->format, surface->pixels, surface->pitch);
	}
	SDL_UpdateWindowSurface(native.sdl);
}

NativeWindow* SdlDriver::_Native(const DisplayWindow* window)
{
	for (auto& entry : fWindows) {
		if (entry.second.window.get() == window)
			return &entry.second;
	}
	return nullptr;
}

NativeWindow* SdlDriver::_NativeFor(Uint32 windowID)
{
	auto found = fWindows.find(windowID);
	return found != fWindows.end() ? &found->second : nullptr;
}

void SdlDriver::Run(BApplication* application)
{
	while (DispatchApplicationMessages(application, 0)) {
		SDL_Event event;
		if (SDL_WaitEvent(&event) == 0)
			continue;
		_Handle(event);
		while (SDL_PollEvent(&event))
			_Handle(event);
	}
	_RunRequests();
}

void SdlDriver::_Handle(const SDL_Event& event)
{
	if (event.type == fEventType) {
		_RunRequests();
		return;
	}
	switch (event.type) {
		case SDL_QUIT:
			if (be_app != nullptr)
				be_app->PostMessage(B_QUIT_REQUESTED);
			break;
		case SDL_WINDOWEVENT:
			if (NativeWindow* native = _NativeFor(event.window.windowID))
				_HandleWindowEvent(*native, event.window);
			break;
		case SDL_MOUSEMOTION:
		case SDL_MOUSEBUTTONDOWN:
		case SDL_MOUSEBUTTONUP:
		{
			bool motion = event.type == SDL_MOUSEMOTION;
			NativeWindow* native = _NativeFor(motion ? event.motion.windowID
				: event.button.windowID);
			if (native == nullptr)
				break;
			Display::Default().SetModifiers(ModifiersFor(SDL_GetModState()));
			if (motion) {
				Display::Default().PostMouse(*native->window, B_MOUSE_MOVED,
					BPoint(event.motion.x, event.motion.y), fButtons, 0);
				break;
			}
			static const uint32 kButtons[] = {0, B_PRIMARY_MOUSE_BUTTON,
				B_TERTIARY_MOUSE_BUTTON, B_SECONDARY_MOUSE_BUTTON};
			uint32 button = event.button.button < 4 ? kButtons[event.button.button] : 0;
			bool down = event.type == SDL_MOUSEBUTTONDOWN;
			fButtons = down ? fButtons | button : fButtons & ~button;
			Display::Default().PostMouse(*native->window, down ? B_MOUSE_DOWN : B_MOUSE_UP,
				BPoint(event.button.x, event.button.y), fButtons, event.button.clicks);
			break;
		}
		case SDL_MOUSEWHEEL:
			if (NativeWindow* native = _NativeFor(event.wheel.windowID)) {
				// The platform counts downwards turns as positive.
				Display::Default().PostWheel(*native->window, event.wheel.x, -event.wheel.y);
			}
			break;
		case SDL_KEYDOWN:
		case SDL_KEYUP:
			_HandleKey(event.key);
			break;
		case SDL_TEXTINPUT:
		{
			// Ctrl, Alt or the logo key made the key a shortcut, sent already.
			const DisplayWindow* target = _KeyTarget(event.text.windowID);
			if (target == nullptr || (SDL_GetModState() & kShortcutMods) != 0)
				break;
			uint8 first = uint8(event.text.text[0]);
			Display::Default().PostKey(*target, B_KEY_DOWN, event.text.text, fPendingKey,
				first < 0x80 ? tolower(first) : first);
			break;
		}
	}
}

void SdlDriver::_HandleWindowEvent(NativeWindow& native, const SDL_WindowEvent& event)
{
	DisplayWindow& window = *native.window;
	switch (event.event) {
		case SDL_WINDOWEVENT_EXPOSED:
			_Present(native);
			break;
		case SDL_WINDOWEVENT_SIZE_CHANGED:
		{
			BRect frame;
			{
				std::lock_guard<std::mutex> guard(window.lock);
				frame = window.frame;
			}
			if (event.data1 != frame.IntegerWidth() + 1
				|| event.data2 != frame.IntegerHeight() + 1) {
				BMessage resized(B_WINDOW_RESIZED);
				resized.AddFloat("width", event.data1 - 1);
				resized.AddFloat("height", event.data2 - 1);
				window.target.SendMessage(&resized);
			}
			_Present(native);
			break;
		}
		case SDL_WINDOWEVENT_MOVED:
		{
			BMessage moved(B_WINDOW_MOVED);
			moved.AddPoint("where", BPoint(event.data1, event.data2));
			window.target.SendMessage(&moved);
			break;
		}
		case SDL_WINDOWEVENT_CLOSE:
			window.target.SendMessage(B_QUIT_REQUESTED);
			break;
		case SDL_WINDOWEVENT_FOCUS_GAINED:
			Display::Default().SetActiveWindow(native.window);
			break;
	}
}

const DisplayWindow* SdlDriver::_KeyTarget(Uint32 windowID)
{
	NativeWindow* native = _NativeFor(windowID);
	return native != nullptr ? native->window.get() : nullptr;
}

void SdlDriver::_HandleKey(const SDL_KeyboardEvent& event)
{
	Display::Default().SetModifiers(ModifiersFor(event.keysym.mod));
	const DisplayWindow* target = _KeyTarget(event.windowID);
	int32 rawKey = RawKeyFor(event.keysym.scancode);
	if (target == nullptr)
		return;
	uint32 what = event.type == SDL_KEYDOWN ? B_KEY_DOWN : B_KEY_UP;
	SDL_Keycode key = event.keysym.sym;
	char bytes[2] = {SpecialKeyByte(key), '\0'};
	if (bytes[0] == 0) {
		// A character: without Ctrl, Alt or the logo key its text follows as
		// SDL_TEXTINPUT, which carries what the keyboard layout made of it.
		if (what == B_KEY_DOWN)
			fPendingKey = rawKey;
		bool shortcut = (event.keysym.mod & kShortcutMods) != 0;
		if ((what == B_KEY_DOWN && !shortcut) || key <= 0 || key >= 0x80)
			return;
		bytes[0] = char(key);
	}
	Display::Default().PostKey(*target, what, bytes, rawKey,
		bytes[0] == B_FUNCTION_KEY ? B_FUNCTION_KEY : tolower(uint8(bytes[0])));
}

class SdlMainLoop : public MainLoop {
public:
	explicit SdlMainLoop(SdlDriver* driver) : fDriver(driver) {}
	void Run(BApplication* application) override { fDriver->Run(application); }
	void Wake() override { fDriver->Wake(); }

private:
	SdlDriver* fDriver;
};

}

std::unique_ptr<DisplayDriver> CreateSdlDriver()
{
	auto driver = std::make_unique<SdlDriver>();
	if (!driver->Init())
		return nullptr;
	SetMainLoop(new SdlMainLoop(driver.get()));
	return driver;
}

}
