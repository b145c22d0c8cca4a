#include <MenuBar.h>

#include <MenuItem.h>
#include <Message.h>
#include <Window.h>

#include "ControlLook.h"
#include "MenuPrivate.h"
#include "ViewData.h"
#include "WindowHooks.h"

namespace look = BPrivate::ControlLook;
using BPrivate::MenuAccess;

namespace BPrivate {

struct MenuBarData : ShortcutHandler {
	explicit MenuBarData(BMenuBar* owner) : bar(owner) {}

	bool HandleShortcut(BWindow* window, BMessage* keyDown) override
	{
		int32 raw = keyDown->GetInt32("raw_char", 0);
		char key = raw > 0 && raw < 0x80 ? char(raw) : keyDown->GetString("bytes", "")[0];
		BMenuItem* item = MenuAccess::FindShortcut(bar, key,
			uint32(keyDown->GetInt32("modifiers", 0)));
		if (item == nullptr)
			return false;
		// The window may enable or disable the item now.
		window->MenusBeginning();
		if (item->IsEnabled())
			item->Invoke();
		window->MenusEnded();
		return true;
	}

	// Input the bar's window still receives while its menus are open (the
	// menus take it as soon as they show).
	void Forward(uint32 what, BPoint where)
	{
		if (session == nullptr)
			return;
		const BMessage* message = bar->Window()->CurrentMessage();
		uint32 buttons = message != nullptr ? uint32(message->GetInt32("buttons", 0)) : 0;
		session->MouseEvent(what, bar->ConvertToScreen(where), buttons);
	}

	void CloseMenus()
	{
		if (session != nullptr)
			session->Close();
	}

	BMenuBar* bar;
	std::shared_ptr<MenuSession> session;
};

}

BMenuBar::BMenuBar(BRect frame, const char* name, uint32 resizingMode, menu_layout layout,
	bool resizeToFit)
	:
	BMenu(frame, name, resizingMode, B_WILL_DRAW | B_FRAME_EVENTS, layout, resizeToFit),
	fMenuBarData(std::make_unique<BPrivate::MenuBarData>(this))
{
}

BMenuBar::~BMenuBar()
{
	fMenuBarData->CloseMenus();
}

void BMenuBar::AttachedToWindow()
{
	BMenu::AttachedToWindow();
	MenuAccess::Install(this, Window());
	BPrivate::SetShortcutHandler(Window(), fMenuBarData.get());
	if (!MenuAccess::Data(this).resizeToFit)
		return;
	BPoint size = MenuAccess::Layout(this);
	// A bar that follows both sides of its parent keeps its width.
	uint32 mode = ResizingMode();
	bool keepsWidth = ((mode >> 8) & 0xf) == _VIEW_LEFT_ && (mode & 0xf) == _VIEW_RIGHT_;
	ResizeTo(keepsWidth ? Bounds().Width() : size.x, size.y);
}

void BMenuBar::DetachedFromWindow()
{
	fMenuBarData->CloseMenus();
	BPrivate::SetShortcutHandler(Window(), nullptr);
	BMenu::DetachedFromWindow();
}

void BMenuBar::Draw(BRect updateRect)
{
	BPrivate::StateGuard state(this);
	BRect bounds = Bounds();
	SetHighColor(look::kLight);
	StrokeLine(bounds.LeftTop(), bounds.RightTop());
	SetHighColor(look::kShadow);
	StrokeLine(bounds.LeftBottom(), bounds.RightBottom());
	for (int32 i = 0; BMenuItem* item = ItemAt(i); i++) {
		if (item->Frame().Intersects(updateRect)) {
			BPrivate::StateGuard itemState(this);
			MenuAccess::DrawItem(item);
		}
	}
}

void BMenuBar::MouseDown(BPoint where)
{
	BPrivate::MenuBarData& data = *fMenuBarData;
	if (data.session != nullptr) {
		data.Forward(B_MOUSE_DOWN, where);
		return;
	}
	int32 index = MenuAccess::SelectableAt(this, where);
	BMenuItem* item = ItemAt(index);
	if (item == nullptr)
		return;
	Window()->MenusBeginning();
	if (item->Submenu() == nullptr) {
		// A command right on the bar.
		if (item->IsEnabled())
			item->Invoke();
		Window()->MenusEnded();
		return;
	}
	data.session = BPrivate::MenuSession::StartBar(this, index, false);
}

void BMenuBar::MouseMoved(BPoint where, uint32, const BMessage*)
{
	fMenuBarData->Forward(B_MOUSE_MOVED, where);
}

void BMenuBar::MouseUp(BPoint where)
{
	fMenuBarData->Forward(B_MOUSE_UP, where);
}

void BMenuBar::MessageReceived(BMessage* message)
{
	if (message->what != BPrivate::kMenusEnded) {
		BMenu::MessageReceived(message);
		return;
	}
	fMenuBarData->session.reset();
	BMessage deselect(BPrivate::kMenuSelect);
	deselect.AddInt32("index", -1);
	BMenu::MessageReceived(&deselect);
	BPrivate::ForgetPress(Window());
	Window()->MenusEnded();
}
