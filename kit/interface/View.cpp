#include <View.h>

#include <algorithm>
#include <cstring>

#include <AppDefs.h>
#include <Message.h>
#include <OS.h>
#include <Window.h>

#include "Display.h"
#include "ViewData.h"
#include "WindowData.h"

using BPrivate::PixelRect;
using BPrivate::ViewAccess;
using BPrivate::ViewData;
using BPrivate::WindowAccess;

namespace {

// How far an edge moves when the parent grows by delta, by its rule.
float EdgeShift(uint32 rule, float delta)
{
	switch (rule) {
		case _VIEW_RIGHT_:
		case _VIEW_BOTTOM_:
			return delta;
		case _VIEW_CENTER_:
			return delta / 2;
		default:
			return 0;
	}
}

void AttachTree(BView* view, BWindow* window)
{
	ViewData& data = ViewAccess::Data(view);
	data.window = window;
	data.visibleStamp = 0;
	data.drawClipStamp = 0;
	window->AddHandler(view);
	if (data.parent != nullptr)
		view->SetNextHandler(data.parent);
	for (BView* child : data.children)
		AttachTree(child, window);
}

// Hooks see the children the view had before its own hook ran; a child its
// hook adds is attached by AddChild itself.
void CallAttached(BView* view)
{
	std::vector<BView*> children = ViewAccess::Data(view).children;
	view->AttachedToWindow();
	for (BView* child : children) {
		if (child->Parent() == view)
			CallAttached(child);
	}
}

void CallAllAttached(BView* view)
{
	std::vector<BView*> children = ViewAccess::Data(view).children;
	for (BView* child : children) {
		if (child->Parent() == view)
			CallAllAttached(child);
	}
	view->AllAttached();
}

void CallDetached(BView* view)
{
	view->DetachedFromWindow();
	std::vector<BView*> children = ViewAccess::Data(view).children;
	for (BView* child : children)
		CallDetached(child);
}

void CallAllDetached(BView* view)
{
	std::vector<BView*> children = ViewAccess::Data(view).children;
	for (BView* child : children)
		CallAllDetached(child);
	view->AllDetached();
}

void DetachTree(BView* view, BWindow* window)
{
	ViewData& data = ViewAccess::Data(view);
	for (BView* child : data.children)
		DetachTree(child, window);
	window->RemoveHandler(view);
	data.window = nullptr;
}

// Tells the window that the area of view (in its parent) needs drawing.
void InvalidateFrame(const BView* view)
{
	const ViewData& data = ViewAccess::Data(view);
	if (data.window == nullptr)
		return;
	BRect frame = data.parent != nullptr
		? ViewAccess::ConvertToWindow(data.parent, data.frame) : data.frame;
	WindowAccess::Invalidate(data.window, PixelRect(frame));
}

int32 IndexInParent(const BView* view)
{
	const std::vector<BView*>& siblings = ViewAccess::Data(view->Parent()).children;
	return int32(std::find(siblings.begin(), siblings.end(), view) - siblings.begin());
}

void PostFrameEvent(BView* view, uint32 what, BPoint value)
{
	const ViewData& data = ViewAccess::Data(view);
	if ((data.flags & B_FRAME_EVENTS) == 0 || data.window == nullptr
		|| WindowAccess::IsOffscreen(data.window))
		return;
	BMessage message(what);
	message.AddInt64("when", system_time());
	if (what == B_VIEW_RESIZED) {
		message.AddFloat("width", value.x);
		message.AddFloat("height", value.y);
	} else
		message.AddPoint("where", value);
	data.window->PostMessage(&message, view);
}

}

namespace BPrivate {

BPoint ViewAccess::WindowOrigin(const BView* view)
{
	BPoint origin;
	for (const BView* v = view; v != nullptr; v = Data(v).parent)
		origin += Data(v).frame.LeftTop() - Data(v).origin;
	return origin;
}

BRect ViewAccess::ConvertToWindow(const BView* view, BRect rect)
{
	BPoint origin = WindowOrigin(view);
	return rect.OffsetByCopy(origin.x, origin.y);
}

const Region& ViewAccess::Visible(const BView* view)
{
	ViewData& data = Data(view);
	const WindowData& window = WindowAccess::Data(data.window);
	if (data.visibleStamp == window.layoutStamp)
		return data.visible;

	data.visible.MakeEmpty();
	data.visibleStamp = window.layoutStamp;
	if (view->IsHidden())
		return data.visible;
	IntRect area = PixelRect(ConvertToWindow(view, view->Bounds()));
	for (const BView* v = data.parent; v != nullptr; v = Data(v).parent)
		area = area & PixelRect(ConvertToWindow(v, v->Bounds()));
	data.visible.Include(area);
	if ((data.flags & B_DRAW_ON_CHILDREN) == 0) {
		for (const BView* child : data.children) {
			if (!Data(child).hidden)
				data.visible.Exclude(PixelRect(ConvertToWindow(view, Data(child).frame)));
		}
	}
	// Siblings added later lie on top, at every level up.
	for (const BView* v = view; Data(v).parent != nullptr; v = Data(v).parent) {
		const BView* parent = Data(v).parent;
		const std::vector<BView*>& siblings = Data(parent).children;
		auto above = std::find(siblings.begin(), siblings.end(), v);
		for (++above; above != siblings.end(); ++above) {
			if (!Data(*above).hidden) {
				data.visible.Exclude(
					PixelRect(ConvertToWindow(parent, Data(*above).frame)));
			}
		}
	}
	return data.visible;
}

const Region& ViewAccess::DrawClip(const BView* view)
{
	ViewData& data = Data(view);
	const WindowData& window = WindowAccess::Data(data.window);
	const Region& visible = Visible(view);
	if (!window.inUpdate)
		return visible;
	uint64 stamp = (uint64(window.layoutStamp) << 32) | window.updateStamp;
	if (data.drawClipStamp != stamp) {
		data.drawClip = visible;
		data.drawClip.IntersectWith(window.updating);
		data.drawClipStamp = stamp;
	}
	return data.drawClip;
}

BView* ViewAccess::ViewAt(BView* root, BPoint point)
{
	const ViewData& data = Data(root);
	if (data.hidden)
		return nullptr;
	IntRect area = PixelRect(ConvertToWindow(root, root->Bounds()));
	if (!area.Contains(PixelCoordinate(point.x), PixelCoordinate(point.y)))
		return nullptr;
	for (auto child = data.children.rbegin(); child != data.children.rend(); ++child) {
		if (BView* found = ViewAt(*child, point))
			return found;
	}
	return root;
}

bool ViewAccess::Contains(const BView* ancestor, const BView* view)
{
	for (; view != nullptr; view = Data(view).parent) {
		if (view == ancestor)
			return true;
	}
	return false;
}

}

BView::BView(BRect frame, const char* name, uint32 resizingMode, uint32 flags)
	:
	BHandler(name),
	fViewData(std::make_unique<ViewData>())
{
	fViewData->frame = frame;
	fViewData->resizingMode = resizingMode;
	fViewData->flags = flags;
}

BView::~BView()
{
	ViewData& data = *fViewData;
	for (BPrivate::ScrollFollower* bar : data.scrollBars) {
		if (bar != nullptr)
			bar->TargetDeleted();
	}
	if (data.parent != nullptr)
		data.parent->RemoveChild(this);
	else if (data.window != nullptr)
		_Detach();
	for (BView* child : data.children) {
		ViewAccess::Data(child).parent = nullptr;
		delete child;
	}
}

void BView::AttachedToWindow() {}
void BView::AllAttached() {}
void BView::DetachedFromWindow() {}
void BView::AllDetached() {}
void BView::Draw(BRect) {}
void BView::MouseDown(BPoint) {}
void BView::MouseUp(BPoint) {}
void BView::MouseMoved(BPoint, uint32, const BMessage*) {}
void BView::KeyDown(const char*, int32) {}
void BView::KeyUp(const char*, int32) {}
void BView::FrameMoved(BPoint) {}
void BView::FrameResized(float, float) {}
void BView::WindowActivated(bool) {}

void BView::MakeFocus(bool focus)
{
	BWindow* window = fViewData->window;
	if (window == nullptr)
		return;
	BView* current = window->CurrentFocus();
	if (focus) {
		// The view losing the focus hears of it first.
		if (current != nullptr && current != this)
			current->MakeFocus(false);
		WindowAccess::SetFocus(window, this);
	} else if (current == this)
		WindowAccess::SetFocus(window, nullptr);
}

void BView::MessageReceived(BMessage* message)
{
	if (message->what == B_MOUSE_WHEEL_CHANGED && BPrivate::ScrollByWheel(this, message))
		return;
	BHandler::MessageReceived(message);
}

void BView::AddChild(BView* child, BView* before)
{
	ViewData& data = *fViewData;
	if (child == nullptr || child == this || child->fViewData->parent != nullptr
		|| child->fViewData->window != nullptr || ViewAccess::Contains(child, this))
		return;
	auto at = std::find(data.children.begin(), data.children.end(), before);
	data.children.insert(at, child);
	child->fViewData->parent = this;
	if (data.window != nullptr) {
		WindowAccess::LayoutChanged(data.window);
		child->_Attach(data.window);
		InvalidateFrame(child);
	}
}

bool BView::RemoveChild(BView* child)
{
	ViewData& data = *fViewData;
	if (child == nullptr || child->fViewData->parent != this)
		return false;
	if (data.window != nullptr) {
		InvalidateFrame(child);
		child->_Detach();
		WindowAccess::LayoutChanged(data.window);
	}
	std::erase(data.children, child);
	child->fViewData->parent = nullptr;
	return true;
}

bool BView::RemoveSelf()
{
	return fViewData->parent != nullptr && fViewData->parent->RemoveChild(this);
}

void BView::_Attach(BWindow* window)
{
	AttachTree(this, window);
	CallAttached(this);
	CallAllAttached(this);
}

void BView::_Detach()
{
	BWindow* window = fViewData->window;
	CallDetached(this);
	CallAllDetached(this);
	WindowAccess::ViewRemoved(window, this);
	DetachTree(this, window);
}

int32 BView::CountChildren() const
{
	return int32(fViewData->children.size());
}

BView* BView::ChildAt(int32 index) const
{
	const std::vector<BView*>& children = fViewData->children;
	return index >= 0 && index < int32(children.size()) ? children[index] : nullptr;
}

BView* BView::NextSibling() const
{
	const BView* parent = fViewData->parent;
	return parent != nullptr ? parent->ChildAt(IndexInParent(this) + 1) : nullptr;
}

BView* BView::PreviousSibling() const
{
	const BView* parent = fViewData->parent;
	return parent != nullptr ? parent->ChildAt(IndexInParent(this) - 1) : nullptr;
}

BView* BView::Parent() const
{
	return fViewData->parent;
}

BWindow* BView::Window() const
{
	return fViewData->window;
}

BView* BView::FindView(const char* name) const
{
	if (name == nullptr)
		return nullptr;
	if (Name() != nullptr && strcmp(Name(), name) == 0)
		return const_cast<BView*>(this);
	for (BView* child : fViewData->children) {
		if (BView* found = child->FindView(name))
			return found;
	}
	return nullptr;
}

bool BView::IsFocus() const
{
	return fViewData->window != nullptr && fViewData->window->CurrentFocus() == this;
}

BRect BView::Frame() const
{
	return fViewData->frame;
}

BRect BView::Bounds() const
{
	const ViewData& data = *fViewData;
	return BRect(data.origin.x, data.origin.y, data.origin.x + data.frame.Width(),
		data.origin.y + data.frame.Height());
}

void BView::MoveTo(BPoint where)
{
	ViewData& data = *fViewData;
	if (where == data.frame.LeftTop())
		return;
	InvalidateFrame(this);
	data.frame.OffsetTo(where);
	if (data.window != nullptr)
		WindowAccess::LayoutChanged(data.window);
	InvalidateFrame(this);
	PostFrameEvent(this, B_VIEW_MOVED, where);
}

void BView::MoveTo(float x, float y)
{
	MoveTo(BPoint(x, y));
}

void BView::MoveBy(float dx, float dy)
{
	MoveTo(fViewData->frame.LeftTop() + BPoint(dx, dy));
}

void BView::ResizeTo(float width, float height)
{
	ResizeBy(width - fViewData->frame.Width(), height - fViewData->frame.Height());
}

void BView::ResizeBy(float dx, float dy)
{
	ViewData& data = *fViewData;
	if (dx == 0 && dy == 0)
		return;
	InvalidateFrame(this);
	data.frame.right += dx;
	data.frame.bottom += dy;
	std::vector<BView*> children = data.children;
	for (BView* child : children)
		child->_ParentResized(dx, dy);
	if (data.window != nullptr)
		WindowAccess::LayoutChanged(data.window);
	InvalidateFrame(this);
	PostFrameEvent(this, B_VIEW_RESIZED, BPoint(data.frame.Width(), data.frame.Height()));
}

void BView::_ParentResized(float dx, float dy)
{
	ViewData& data = *fViewData;
	uint32 mode = data.resizingMode;
	BRect frame = data.frame;
	frame.top += EdgeShift((mode >> 12) & 0xf, dy);
	frame.left += EdgeShift((mode >> 8) & 0xf, dx);
	frame.bottom += EdgeShift((mode >> 4) & 0xf, dy);
	frame.right += EdgeShift(mode & 0xf, dx);
	if (frame.LeftTop() != data.frame.LeftTop())
		MoveTo(frame.LeftTop());
	ResizeTo(frame.Width(), frame.Height());
}

void BView::ScrollTo(BPoint where)
{
	ViewData& data = *fViewData;
	if (where == data.origin)
		return;
	data.origin = where;
	if (data.window != nullptr) {
		WindowAccess::LayoutChanged(data.window);
		Invalidate();
	}
	for (BPrivate::ScrollFollower* bar : data.scrollBars) {
		if (bar != nullptr)
			bar->TargetScrolled(where);
	}
}

void BView::ScrollBy(float dx, float dy)
{
	ScrollTo(fViewData->origin + BPoint(dx, dy));
}

uint32 BView::ResizingMode() const
{
	return fViewData->resizingMode;
}

void BView::SetResizingMode(uint32 mode)
{
	fViewData->resizingMode = mode;
}

uint32 BView::Flags() const
{
	return fViewData->flags;
}

void BView::SetFlags(uint32 flags)
{
	fViewData->flags = flags;
	if (fViewData->window != nullptr)
		WindowAccess::LayoutChanged(fViewData->window);
}

void BView::Hide()
{
	if (fViewData->hidden)
		return;
	InvalidateFrame(this);
	fViewData->hidden = true;
	if (fViewData->window != nullptr)
		WindowAccess::LayoutChanged(fViewData->window);
}

void BView::Show()
{
	if (!fViewData->hidden)
		return;
	fViewData->hidden = false;
	if (fViewData->window != nullptr)
		WindowAccess::LayoutChanged(fViewData->window);
	InvalidateFrame(this);
}

bool BView::IsHidden() const
{
	for (const BView* view = this; view != nullptr; view = view->fViewData->parent) {
		if (view->fViewData->hidden)
			return true;
	}
	return fViewData->window != nullptr && fViewData->window->IsHidden();
}

BPoint BView::ConvertToParent(BPoint point) const
{
	return point - fViewData->origin + fViewData->frame.LeftTop();
}

void BView::ConvertToParent(BPoint* point) const
{
	*point = ConvertToParent(*point);
}

BRect BView::ConvertToParent(BRect rect) const
{
	BPoint offset = fViewData->frame.LeftTop() - fViewData->origin;
	return rect.OffsetByCopy(offset.x, offset.y);
}

void BView::ConvertToParent(BRect* rect) const
{
	*rect = ConvertToParent(*rect);
}

BPoint BView::ConvertFromParent(BPoint point) const
{
	return point + fViewData->origin - fViewData->frame.LeftTop();
}

void BView::ConvertFromParent(BPoint* point) const
{
	*point = ConvertFromParent(*point);
}

BRect BView::ConvertFromParent(BRect rect) const
{
	BPoint offset = fViewData->origin - fViewData->frame.LeftTop();
	return rect.OffsetByCopy(offset.x, offset.y);
}

void BView::ConvertFromParent(BRect* rect) const
{
	*rect = ConvertFromParent(*rect);
}

BPoint BView::ConvertToScreen(BPoint point) const
{
	BPoint inWindow = point + ViewAccess::WindowOrigin(this);
	return fViewData->window != nullptr ? fViewData->window->ConvertToScreen(inWindow)
		: inWindow;
}

void BView::ConvertToScreen(BPoint* point) const
{
	*point = ConvertToScreen(*point);
}

BRect BView::ConvertToScreen(BRect rect) const
{
	BPoint offset = ConvertToScreen(B_ORIGIN);
	return rect.OffsetByCopy(offset.x, offset.y);
}

void BView::ConvertToScreen(BRect* rect) const
{
	*rect = ConvertToScreen(*rect);
}

BPoint BView::ConvertFromScreen(BPoint point) const
{
	return point - ConvertToScreen(B_ORIGIN);
}

void BView::ConvertFromScreen(BPoint* point) const
{
	*point = ConvertFromScreen(*point);
}

BRect BView::ConvertFromScreen(BRect rect) const
{
	BPoint offset = ConvertToScreen(B_ORIGIN);
	return rect.OffsetByCopy(-offset.x, -offset.y);
}

void BView::ConvertFromScreen(BRect* rect) const
{
	*rect = ConvertFromScreen(*rect);
}

void BView::GetMouse(BPoint* location, uint32* buttons, bool)
{
	BPoint screen;
	uint32 held;
	BPrivate::Display::Default().GetPointer(&screen, &held);
	if (location != nullptr)
		*location = ConvertFromScreen(screen);
	if (buttons != nullptr)
		*buttons = held;
}

void BView::Invalidate(BRect rect)
{
	BWindow* window = fViewData->window;
	if (window == nullptr)
		return;
	rect = rect & Bounds();
	if (rect.IsValid())
		WindowAccess::Invalidate(window, PixelRect(ViewAccess::ConvertToWindow(this, rect)));
}

void BView::Invalidate()
{
	Invalidate(Bounds());
}

void BView::Flush() const
{
	if (fViewData->window != nullptr)
		WindowAccess::Present(fViewData->window);
}

void BView::Sync() const
{
	Flush();
}
