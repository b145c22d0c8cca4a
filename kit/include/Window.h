#ifndef _WINDOW_H
#define _WINDOW_H

#include <memory>

#include <InterfaceDefs.h>
#include <Looper.h>
#include <Rect.h>

class BBitmap;
class BView;

namespace BPrivate {
struct WindowData;
class WindowAccess;
}

enum window_type {
	B_UNTYPED_WINDOW = 0,
	B_TITLED_WINDOW = 1,
	B_MODAL_WINDOW = 3,
	B_DOCUMENT_WINDOW = 11,
	B_BORDERED_WINDOW = 20,
	B_FLOATING_WINDOW = 21
};

enum window_look {
	B_BORDERED_WINDOW_LOOK = 20,
	B_NO_BORDER_WINDOW_LOOK = 19,
	B_TITLED_WINDOW_LOOK = 1,
	B_DOCUMENT_WINDOW_LOOK = 11,
	B_MODAL_WINDOW_LOOK = 3,
	B_FLOATING_WINDOW_LOOK = 7
};

enum window_feel {
	B_NORMAL_WINDOW_FEEL = 0,
	B_MODAL_SUBSET_WINDOW_FEEL = 2,
	B_MODAL_APP_WINDOW_FEEL = 1,
	B_MODAL_ALL_WINDOW_FEEL = 3,
	B_FLOATING_SUBSET_WINDOW_FEEL = 5,
	B_FLOATING_APP_WINDOW_FEEL = 4,
	B_FLOATING_ALL_WINDOW_FEEL = 6
};

enum {
	B_NOT_MOVABLE = 0x00000001,
	B_NOT_CLOSABLE = 0x00000020,
	B_NOT_ZOOMABLE = 0x00000040,
	B_NOT_MINIMIZABLE = 0x00004000,
	B_NOT_RESIZABLE = 0x00000002,
	B_NOT_H_RESIZABLE = 0x00000004,
	B_NOT_V_RESIZABLE = 0x00000008,
	B_AVOID_FRONT = 0x00000080,
	B_AVOID_FOCUS = 0x00002000,
	B_WILL_ACCEPT_FIRST_CLICK = 0x00000010,
	B_OUTLINE_RESIZE = 0x00001000,
	B_NO_WORKSPACE_ACTIVATION = 0x00000100,
	B_NOT_ANCHORED_ON_ACTIVATE = 0x00020000,
	B_ASYNCHRONOUS_CONTROLS = 0x00080000,
	B_QUIT_ON_WINDOW_CLOSE = 0x00100000
};

#define B_CURRENT_WORKSPACE 0
#define B_ALL_WORKSPACES 0xffffffff

// A window on the screen: a looper whose thread starts with the first Show()
// and dispatches the window's input and updates. frame is in screen
// coordinates and covers the window's content, borders not included. Quit()
// (from BLooper) closes and deletes it; QuitRequested answers true.
class BWindow : public BLooper {
public:
	BWindow(BRect frame, const char* title, window_type type, uint32 flags,
		uint32 workspace = B_CURRENT_WORKSPACE);
	BWindow(BRect frame, const char* title, window_look look, window_feel feel,
		uint32 flags, uint32 workspace = B_CURRENT_WORKSPACE);
	// Deletes the window's views.
	virtual ~BWindow();

	// Views; AddChild passes ownership of child to the window.
	void AddChild(BView* child, BView* before = NULL);
	bool RemoveChild(BView* child);
	int32 CountChildren() const;
	BView* ChildAt(int32 index) const;
	BView* FindView(const char* name) const;
	BView* FindView(BPoint point) const;
	BView* CurrentFocus() const;

	// Routes input to the view under the pointer (mouse messages) or to the
	// focus view (keys), and updates to the views' Draw.
	virtual void DispatchMessage(BMessage* message, BHandler* handler);

	// Hooks.
	virtual void FrameMoved(BPoint newPosition);
	virtual void FrameResized(float newWidth, float newHeight);
	virtual void WindowActivated(bool active);
	virtual void MenusBeginning();
	virtual void MenusEnded();

	virtual void Show();
	virtual void Hide();
	bool IsHidden() const;
	void Activate(bool active = true);
	bool IsActive() const;

	void SetTitle(const char* title);
	const char* Title() const;
	window_look Look() const;
	window_feel Feel() const;
	uint32 Flags() const;
	uint32 Workspaces() const;

	BRect Frame() const;
	BRect Bounds() const;
	void MoveTo(BPoint where);
	void MoveTo(float x, float y);
	void MoveBy(float dx, float dy);
	void ResizeTo(float width, float height);
	void ResizeBy(float dx, float dy);

	BPoint ConvertToScreen(BPoint point) const;
	void ConvertToScreen(BPoint* point) const;
	BRect ConvertToScreen(BRect rect) const;
	void ConvertToScreen(BRect* rect) const;
	BPoint ConvertFromScreen(BPoint point) const;
	void ConvertFromScreen(BPoint* point) const;
	BRect ConvertFromScreen(BRect rect) const;
	void ConvertFromScreen(BRect* rect) const;

	// Draws what is invalid now, in the calling thread, which must be the
	// window's own thread (elsewhere it does nothing).
	void UpdateIfNeeded();
	bool NeedsUpdate() const;
	void Flush() const;
	void Sync() const;

private:
	friend class BBitmap;
	friend class BPrivate::WindowAccess;

	// The hidden window behind a bitmap that accepts views.
	explicit BWindow(BBitmap* bitmap);

	void _Init(BRect frame, const char* title, window_look look, window_feel feel,
		uint32 flags, uint32 workspace);

	std::unique_ptr<BPrivate::WindowData> fWindowData;
};

#endif
