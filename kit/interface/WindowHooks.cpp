#include "WindowHooks.h"

#include <mutex>

#include "WindowData.h"

namespace BPrivate {

namespace {

std::mutex sDragLock;
std::shared_ptr<DragSession> sDrag;

}

void SetShortcutHandler(BWindow* window, ShortcutHandler* handler)
{
	WindowAccess::Data(window).shortcuts = handler;
}

void SetDefaultButton(BWindow* window, BView* button)
{
	WindowAccess::Data(window).defaultButton = button;
}

BView* DefaultButton(const BWindow* window)
{
	return WindowAccess::Data(window).defaultButton;
}

void SetDragSession(std::shared_ptr<DragSession> session)
{
	std::lock_guard<std::mutex> guard(sDragLock);
	sDrag = std::move(session);
}

std::shared_ptr<DragSession> CurrentDragSession()
{
	std::lock_guard<std::mutex> guard(sDragLock);
	return sDrag;
}

}
