#include <Window.h>

#include <cstring>

#include <AppDefs.h>
#include <Message.h>
#include <View.h>

#include "Display.h"
#include "ViewData.h"
#include "WindowData.h"
#include "WindowHooks.h"

using BPrivate::ViewAccess;
using BPrivate::WindowAccess;
using BPrivate::WindowData;

namespace {

void SetPointField(BMessage* message, const char* name, BPoint point)
{
	if (message->ReplacePoint(name, point) != B_OK)
		message->AddPoint(name, point);
}

BPoint ToView(const BView* view, BPoint windowPoint)
{
	return windowPoint - ViewAccess::WindowOrigin(view);
}

void DeliverMouse(BWindow* window, BMessage* message)
{
	WindowData& data = WindowAccess::Data(window);
	BPoint where;
	message->FindPoint("where", &where);
	int32 buttons = message->GetInt32("buttons", 0);
	BView* under = ViewAccess::ViewAt(data.topView, where);
	if (message->what == B_MOUSE_DOWN && data.mouseView == nullptr)
		data.mouseView = under;
	BView* target = data.mouseView != nullptr ? data.mouseView : under;
	std::shared_ptr<BPrivate::DragSession> drag = BPrivate::CurrentDragSession();
	const BMessage* dragMessage = drag != nullptr ? drag->Message() : nullptr;
	if (target == nullptr) {
		// The pointer left the window.
		BView* last = data.lastMouseView;
		data.lastMouseView = nullptr;
		if (message->what == B_MOUSE_MOVED && last != nullptr)
			last->MouseMoved(ToView(last, where), B_EXITED_VIEW, dragMessage);
		return;
	}

	BPoint local = ToView(target, where);
	SetPointField(message, "where", local);
	SetPointField(message, "be:view_where", local);

	switch (message->what) {
		case B_MOUSE_DOWN:
			target->MouseDown(local);
			break;
		case B_MOUSE_UP:
		{
			if (buttons == 0)
				data.mouseView = nullptr;
			target->MouseUp(local);
			if (drag != nullptr && buttons == 0) {
				BPrivate::SetDragSession(nullptr);
				drag->Released(window->ConvertToScreen(where));
			}
			break;
		}
		case B_MOUSE_MOVED:
		{
			if (drag != nullptr)
				drag->Moved(window->ConvertToScreen(where));
			if (data.mouseView != nullptr) {
				// A pressed view follows the pointer wherever it goes.
				bool inside = target->Bounds().Contains(local);
				target->MouseMoved(local, inside ? B_INSIDE_VIEW : B_OUTSIDE_VIEW,
					dragMessage);
				break;
			}
			BView* last = data.lastMouseView;
			data.lastMouseView = under;
			if (last != under && last != nullptr)
				last->MouseMoved(ToView(last, where), B_EXITED_VIEW, dragMessage);
			under->MouseMoved(local, last != under ? B_ENTERED_VIEW : B_INSIDE_VIEW,
				dragMessage);
			break;
		}
	}
}

void DeliverKey(BWindow* window, BMessage* message)
{
	WindowData& data = WindowAccess::Data(window);
	uint32 modifiers = message->GetInt32("modifiers", 0);
	if (message->what == B_KEY_DOWN && (modifiers & (B_CONTROL_KEY | B_COMMAND_KEY)) != 0
		&& data.shortcuts != nullptr && data.shortcuts->HandleShortcut(window, message))
		return;
	const char* bytes = message->GetString("bytes", "");
	BView* target = message->what == B_KEY_DOWN && bytes[0] == B_ENTER
		&& data.defaultButton != nullptr ? data.defaultButton : data.focus;
	// With no focus view the window itself hears the keys, as on the platform.
	if (target == nullptr) {
		window->MessageReceived(message);
		return;
	}
	if (message->what == B_KEY_DOWN)
		target->KeyDown(bytes, int32(strlen(bytes)));
	else
		target->KeyUp(bytes, int32(strlen(bytes)));
}

// Wheel turns go to the view under the pointer.
void DeliverWheel(BWindow* window, BMessage* message)
{
	BPoint screen;
	uint32 buttons;
	BPrivate::Display::Default().GetPointer(&screen, &buttons);
	if (BView* view = window->FindView(window->ConvertFromScreen(screen)))
		view->MessageReceived(message);
}

void DeliverDrop(BWindow* window, BMessage* message)
{
	BView* view = window->FindView(window->ConvertFromScreen(message->DropPoint()));
	if (view != nullptr)
		view->MessageReceived(message);
	else
		window->MessageReceived(message);
}

void SetActive(BWindow* window, bool active)
{
	WindowData& data = WindowAccess::Data(window);
	if (data.active == active)
		return;
	data.active = active;
	window->WindowActivated(active);
	std::vector<BView*> views = {data.topView};
	for (size_t i = 0; i < views.size(); i++) {
		for (int32 child = 0; child < views[i]->CountChildren(); child++)
			views.push_back(views[i]->ChildAt(child));
		if (i > 0)
			views[i]->WindowActivated(active);
	}
}

bool DispatchToWindow(BWindow* window, BMessage* message)
{
	WindowData& data = WindowAccess::Data(window);
	switch (message->what) {
		case B_MOUSE_DOWN:
		case B_MOUSE_UP:
		case B_MOUSE_MOVED:
			DeliverMouse(window, message);
			return true;
		case B_KEY_DOWN:
		case B_KEY_UP:
			DeliverKey(window, message);
			return true;
		case B_MOUSE_WHEEL_CHANGED:
			DeliverWheel(window, message);
			return true;
		case BPrivate::kUpdateMessage:
			data.updatePending = false;
			WindowAccess::Update(window);
			return true;
		case BPrivate::kFlushMessage:
			data.flushPosted = false;
			return true;
		case B_WINDOW_ACTIVATED:
			SetActive(window, message->GetBool("active", false));
			return true;
		case B_WINDOW_MOVED:
		{
			BPoint where;
			if (message->FindPoint("where", &where) == B_OK) {
				data.frame.OffsetTo(where);
				WindowAccess::Publish(window);
				window->FrameMoved(where);
			}
			return true;
		}
		case B_WINDOW_RESIZED:
		{
			float width = message->GetFloat("width", data.frame.Width());
			float height = message->GetFloat("height", data.frame.Height());
			WindowAccess::Resize(window, width, height);
			WindowAccess::Publish(window);
			window->FrameResized(width, height);
			return true;
		}
		default:
			if (message->WasDropped()) {
				DeliverDrop(window, message);
				return true;
			}
			return false;
	}
}

bool DispatchToView(BView* view, BMessage* message)
{
	switch (message->what) {
		case B_VIEW_RESIZED:
			view->FrameResized(message->GetFloat("width", 0), message->GetFloat("height", 0));
			return true;
		case B_VIEW_MOVED:
		{
			BPoint where;
			message->FindPoint("where", &where);
			view->FrameMoved(where);
			return true;
		}
		default:
			return false;
	}
}

}

namespace BPrivate {

void WindowAccess::ViewRemoved(BWindow* window, BView* view)
{
	WindowData& data = Data(window);
	for (BView** pointer : {&data.focus, &data.mouseView, &data.lastMouseView,
			&data.defaultButton}) {
		if (ViewAccess::Contains(view, *pointer))
			*pointer = nullptr;
	}
}

void WindowAccess::SetFocus(BWindow* window, BView* view)
{
	Data(window).focus = view;
}

}

void BWindow::DispatchMessage(BMessage* message, BHandler* handler)
{
	bool handled = false;
	if (handler == this)
		handled = DispatchToWindow(this, message);
	else if (BView* view = dynamic_cast<BView*>(handler))
		handled = DispatchToView(view, message);
	if (!handled)
		BLooper::DispatchMessage(message, handler);
	WindowAccess::Present(this);
}
