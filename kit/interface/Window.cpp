#include <Window.h>

#include <AppDefs.h>
#include <Bitmap.h>
#include <Message.h>
#include <View.h>

#include "Display.h"
#include "ViewData.h"
#include "WindowData.h"

using BPrivate::Display;
using BPrivate::DisplayWindow;
using BPrivate::ViewAccess;
using BPrivate::WindowAccess;
using BPrivate::WindowData;

namespace {

struct LookAndFeel {
	window_look look;
	window_feel feel;
};

LookAndFeel LookAndFeelFor(window_type type)
{
	switch (type) {
		case B_DOCUMENT_WINDOW:
			return {B_DOCUMENT_WINDOW_LOOK, B_NORMAL_WINDOW_FEEL};
		case B_MODAL_WINDOW:
			return {B_MODAL_WINDOW_LOOK, B_MODAL_APP_WINDOW_FEEL};
		case B_FLOATING_WINDOW:
			return {B_FLOATING_WINDOW_LOOK, B_FLOATING_APP_WINDOW_FEEL};
		case B_BORDERED_WINDOW:
			return {B_BORDERED_WINDOW_LOOK, B_NORMAL_WINDOW_FEEL};
		default:
			return {B_TITLED_WINDOW_LOOK, B_NORMAL_WINDOW_FEEL};
	}
}

int32 PixelSize(float extent)
{
	return max_c(int32(1), BPrivate::PixelCoordinate(extent) + 1);
}

// Gives the framebuffer the window's size; the views then redraw it all.
void SizeFramebuffer(BWindow* window)
{
	WindowData& data = WindowAccess::Data(window);
	BPrivate::Surface& surface = data.surface;
	surface.width = PixelSize(data.frame.Width());
	surface.height = PixelSize(data.frame.Height());
	surface.bytesPerRow = surface.width * 4;
	surface.space = B_RGB32;
	data.framebuffer.assign(size_t(surface.width) * surface.height, 0xffffffff);
	surface.bits = reinterpret_cast<uint8*>(data.framebuffer.data());
	WindowAccess::LayoutChanged(window);
	WindowAccess::Invalidate(window, surface.Bounds());
}

}

namespace BPrivate {

void WindowAccess::Publish(BWindow* window)
{
	const WindowData& data = Data(window);
	if (data.display == nullptr)
		return;
	{
		std::lock_guard<std::mutex> guard(data.display->lock);
		data.display->frame = data.frame;
		data.display->title = data.title;
		data.display->look = data.look;
		data.display->feel = data.feel;
		data.display->flags = data.flags;
		data.display->visible = data.hideLevel <= 0;
	}
	Display::Default().Driver().UpdateWindow(data.display);
}

void WindowAccess::Resize(BWindow* window, float width, float height)
{
	WindowData& data = Data(window);
	if (width == data.frame.Width() && height == data.frame.Height())
		return;
	data.frame.right = data.frame.left + width;
	data.frame.bottom = data.frame.top + height;
	SizeFramebuffer(window);
	data.topView->ResizeTo(width, height);
}

}

BWindow::BWindow(BRect frame, const char* title, window_type type, uint32 flags,
	uint32 workspace)
	:
	BLooper(title, B_DISPLAY_PRIORITY),
	fWindowData(std::make_unique<WindowData>())
{
	LookAndFeel lookAndFeel = LookAndFeelFor(type);
	_Init(frame, title, lookAndFeel.look, lookAndFeel.feel, flags, workspace);
}

BWindow::BWindow(BRect frame, const char* title, window_look look, window_feel feel,
	uint32 flags, uint32 workspace)
	:
	BLooper(title, B_DISPLAY_PRIORITY),
	fWindowData(std::make_unique<WindowData>())
{
	_Init(frame, title, look, feel, flags, workspace);
}

BWindow::BWindow(BBitmap* bitmap)
	:
	BLooper("offscreen"),
	fWindowData(std::make_unique<WindowData>())
{
	WindowData& data = *fWindowData;
	BRect bounds = bitmap->Bounds().OffsetToCopy(0, 0);
	data.frame = bounds;
	data.bitmap = bitmap;
	data.surface.bits = static_cast<uint8*>(bitmap->Bits());
	data.surface.bytesPerRow = bitmap->BytesPerRow();
	data.surface.space = bitmap->ColorSpace();
	data.surface.width = bounds.IntegerWidth() + 1;
	data.surface.height = bounds.IntegerHeight() + 1;
	data.hideLevel = 0;
	data.topView = new BView(bounds, "top view", B_FOLLOW_ALL, 0);
	data.topView->SetViewColor(B_TRANSPARENT_COLOR);
	ViewAccess::Attach(data.topView, this);
	// Never runs: drop the lock a looper is constructed with, so that any
	// thread can lock the bitmap.
	Unlock();
}

void BWindow::_Init(BRect frame, const char* title, window_look look, window_feel feel,
	uint32 flags, uint32 workspace)
{
	WindowData& data = *fWindowData;
	data.title = title != nullptr ? title : "";
	data.look = look;
	data.feel = feel;
	data.flags = flags;
	data.workspaces = workspace;
	data.frame = frame;
	data.topView = new BView(Bounds(), "top view", B_FOLLOW_ALL, 0);
	ViewAccess::Attach(data.topView, this);
	SizeFramebuffer(this);
	BPrivate::RegisterWindow(this);
}

BWindow::~BWindow()
{
	WindowData& data = *fWindowData;
	if (data.bitmap == nullptr)
		BPrivate::UnregisterWindow(this);
	if (data.display != nullptr) {
		Display::Default().Driver().DestroyWindow(data.display);
		Display::Default().RemoveWindow(data.display);
	}
	BView* top = data.topView;
	ViewAccess::Detach(top);
	data.topView = nullptr;
	delete top;
}

void BWindow::AddChild(BView* child, BView* before)
{
	fWindowData->topView->AddChild(child, before);
}

bool BWindow::RemoveChild(BView* child)
{
	return fWindowData->topView->RemoveChild(child);
}

int32 BWindow::CountChildren() const
{
	return fWindowData->topView->CountChildren();
}

BView* BWindow::ChildAt(int32 index) const
{
	return fWindowData->topView->ChildAt(index);
}

BView* BWindow::FindView(const char* name) const
{
	BView* top = fWindowData->topView;
	for (int32 i = 0; i < top->CountChildren(); i++) {
		if (BView* found = top->ChildAt(i)->FindView(name))
			return found;
	}
	return nullptr;
}

BView* BWindow::FindView(BPoint point) const
{
	BView* found = ViewAccess::ViewAt(fWindowData->topView, point);
	return found != fWindowData->topView ? found : nullptr;
}

BView* BWindow::CurrentFocus() const
{
	return fWindowData->focus;
}

void BWindow::FrameMoved(BPoint) {}
void BWindow::FrameResized(float, float) {}
void BWindow::WindowActivated(bool) {}
void BWindow::MenusBeginning() {}
void BWindow::MenusEnded() {}

void BWindow::Show()
{
	WindowData& data = *fWindowData;
	if (data.bitmap != nullptr || data.hideLevel <= 0 || --data.hideLevel > 0)
		return;
	Display& display = Display::Default();
	bool created = data.display == nullptr;
	if (created) {
		data.display = std::make_shared<DisplayWindow>(this, BMessenger(this));
		display.AddWindow(data.display);
	}
	WindowAccess::LayoutChanged(this);
	WindowAccess::Invalidate(this, data.surface.Bounds());
	WindowAccess::Publish(this);
	if (created)
		display.Driver().CreateWindow(data.display);
	if (Thread() < 0)
		Run();
	if ((data.flags & B_AVOID_FOCUS) == 0)
		display.Driver().ActivateWindow(data.display);
}

void BWindow::Hide()
{
	WindowData& data = *fWindowData;
	if (++data.hideLevel != 1)
		return;
	WindowAccess::LayoutChanged(this);
	WindowAccess::Publish(this);
}

bool BWindow::IsHidden() const
{
	return fWindowData->hideLevel > 0;
}

void BWindow::Activate(bool active)
{
	if (active && fWindowData->display != nullptr && !IsHidden())
		Display::Default().Driver().ActivateWindow(fWindowData->display);
}

bool BWindow::IsActive() const
{
	return fWindowData->active;
}

void BWindow::SetTitle(const char* title)
{
	fWindowData->title = title != nullptr ? title : "";
	WindowAccess::Publish(this);
}

const char* BWindow::Title() const
{
	return fWindowData->title.c_str();
}

window_look BWindow::Look() const
{
	return fWindowData->look;
}

window_feel BWindow::Feel() const
{
	return fWindowData->feel;
}

uint32 BWindow::Flags() const
{
	return fWindowData->flags;
}

uint32 BWindow::Workspaces() const
{
	return fWindowData->workspaces;
}

BRect BWindow::Frame() const
{
	return fWindowData->frame;
}

BRect BWindow::Bounds() const
{
	return fWindowData->frame.OffsetToCopy(0, 0);
}

void BWindow::MoveTo(BPoint where)
{
	WindowData& data = *fWindowData;
	if (where == data.frame.LeftTop())
		return;
	data.frame.OffsetTo(where);
	WindowAccess::Publish(this);
	BMessage moved(B_WINDOW_MOVED);
	moved.AddPoint("where", where);
	PostMessage(&moved);
}

void BWindow::MoveTo(float x, float y)
{
	MoveTo(BPoint(x, y));
}

void BWindow::MoveBy(float dx, float dy)
{
	MoveTo(fWindowData->frame.LeftTop() + BPoint(dx, dy));
}

void BWindow::ResizeTo(float width, float height)
{
	WindowData& data = *fWindowData;
	width = max_c(width, 0.0f);
	height = max_c(height, 0.0f);
	if (data.bitmap != nullptr
		|| (width == data.frame.Width() && height == data.frame.Height()))
		return;
	WindowAccess::Resize(this, width, height);
	WindowAccess::Publish(this);
	BMessage resized(B_WINDOW_RESIZED);
	resized.AddFloat("width", width);
	resized.AddFloat("height", height);
	PostMessage(&resized);
}

void BWindow::ResizeBy(float dx, float dy)
{
	ResizeTo(fWindowData->frame.Width() + dx, fWindowData->frame.Height() + dy);
}

BPoint BWindow::ConvertToScreen(BPoint point) const
{
	return point + fWindowData->frame.LeftTop();
}

void BWindow::ConvertToScreen(BPoint* point) const
{
	*point = ConvertToScreen(*point);
}

BRect BWindow::ConvertToScreen(BRect rect) const
{
	return rect.OffsetByCopy(fWindowData->frame.left, fWindowData->frame.top);
}

void BWindow::ConvertToScreen(BRect* rect) const
{
	*rect = ConvertToScreen(*rect);
}

BPoint BWindow::ConvertFromScreen(BPoint point) const
{
	return point - fWindowData->frame.LeftTop();
}

void BWindow::ConvertFromScreen(BPoint* point) const
{
	*point = ConvertFromScreen(*point);
}

BRect BWindow::ConvertFromScreen(BRect rect) const
{
	return rect.OffsetByCopy(-fWindowData->frame.left, -fWindowData->frame.top);
}

void BWindow::ConvertFromScreen(BRect* rect) const
{
	*rect = ConvertFromScreen(*rect);
}

void BWindow::UpdateIfNeeded()
{
	if (find_thread(NULL) == Thread())
		WindowAccess::Update(this);
}

bool BWindow::NeedsUpdate() const
{
	return !fWindowData->invalid.IsEmpty();
}

void BWindow::Flush() const
{
	WindowAccess::Present(const_cast<BWindow*>(this));
}

void BWindow::Sync() const
{
	Flush();
}
