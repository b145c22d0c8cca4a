#include <Window.h>

#include <algorithm>
#include <cstring>

#include <View.h>

#include "Display.h"
#include "Painter.h"
#include "ViewData.h"
#include "WindowData.h"

using BPrivate::IntRect;
using BPrivate::ViewAccess;
using BPrivate::ViewData;
using BPrivate::WindowData;

namespace {

// Fills the part of the view being updated with its view colour, then lets it
// draw, then its children.
void DrawTree(BView* view)
{
	ViewData& data = ViewAccess::Data(view);
	if (data.hidden)
		return;
	const BPrivate::Region& clip = ViewAccess::DrawClip(view);
	if (!clip.IsEmpty()) {
		WindowData& window = BPrivate::WindowAccess::Data(data.window);
		if (data.viewColor != B_TRANSPARENT_COLOR) {
			BPrivate::DrawState erase;
			erase.high = data.viewColor;
			BPrivate::Painter painter(window.surface, clip, B_ORIGIN, erase);
			painter.FillRect(clip.Bounds().ToBRect(), B_SOLID_HIGH);
			window.dirty = window.dirty | painter.Touched();
		}
		if ((data.flags & B_WILL_DRAW) != 0) {
			BPoint origin = ViewAccess::WindowOrigin(view);
			view->Draw(clip.Bounds().ToBRect().OffsetByCopy(-origin.x, -origin.y));
		}
	}
	std::vector<BView*> children = data.children;
	for (BView* child : children) {
		if (child->Parent() == view)
			DrawTree(child);
	}
}

}

namespace BPrivate {

void WindowAccess::Invalidate(BWindow* window, const IntRect& rect)
{
	WindowData& data = Data(window);
	IntRect area = rect & data.surface.Bounds();
	if (data.bitmap != nullptr || !area.IsValid())
		return;
	data.invalid.Include(area);
	if (!data.updatePending) {
		data.updatePending = true;
		window->PostMessage(kUpdateMessage);
	}
}

void WindowAccess::Drawn(BWindow* window, const IntRect& touched)
{
	WindowData& data = Data(window);
	if (!touched.IsValid() || data.bitmap != nullptr)
		return;
	data.dirty = data.dirty | touched;
	// The window's thread presents after each message; others ask it to.
	if (find_thread(NULL) != window->Thread() && !data.flushPosted.exchange(true))
		window->PostMessage(kFlushMessage);
}

void WindowAccess::Update(BWindow* window)
{
	WindowData& data = Data(window);
	if (data.inUpdate || data.invalid.IsEmpty() || window->IsHidden())
		return;
	data.updating = std::move(data.invalid);
	data.invalid = Region();
	data.inUpdate = true;
	data.updateStamp++;
	DrawTree(data.topView);
	data.inUpdate = false;
	data.updateStamp++;
	data.updating.MakeEmpty();
	Present(window);
}

void WindowAccess::Present(BWindow* window)
{
	WindowData& data = Data(window);
	IntRect dirty = data.dirty & data.surface.Bounds();
	data.dirty = IntRect();
	if (!dirty.IsValid() || data.display == nullptr)
		return;
	{
		DisplayWindow& display = *data.display;
		std::lock_guard<std::mutex> guard(display.lock);
		const Surface& surface = data.surface;
		if (display.width != surface.width || display.height != surface.height) {
			display.width = surface.width;
			display.height = surface.height;
			dirty = surface.Bounds();
		}
		display.pixels.resize(data.framebuffer.size());
		for (int32 y = dirty.top; y <= dirty.bottom; y++) {
			size_t at = size_t(y) * surface.width + dirty.left;
			std::copy_n(data.framebuffer.begin() + at, dirty.Width(), display.pixels.begin() + at);
		}
	}
	Display::Default().Driver().Present(data.display);
}

}
