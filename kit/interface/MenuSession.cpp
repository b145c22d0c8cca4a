#include "MenuPrivate.h"

#include <algorithm>

#include <MenuBar.h>
#include <Message.h>
#include <Screen.h>

#include "Display.h"
#include "WindowData.h"
#include "WindowHooks.h"

namespace BPrivate {

namespace {

// The window a menu is shown in while it is open. It hands all input to
// the session, in screen coordinates.
class MenuWindow : public BWindow {
public:
	MenuWindow(std::shared_ptr<MenuSession> session, BMenu* menu, BRect frame)
		:
		BWindow(frame, menu->Name(), B_NO_BORDER_WINDOW_LOOK, kMenuWindowFeel,
			B_AVOID_FOCUS | B_NOT_MOVABLE | B_NOT_RESIZABLE | B_NOT_CLOSABLE),
		fSession(std::move(session)),
		fMenu(menu)
	{
		menu->MoveTo(0, 0);
		menu->ResizeTo(frame.Width(), frame.Height());
		AddChild(menu);
	}

	void DispatchMessage(BMessage* message, BHandler* handler) override
	{
		if (handler != this || !_Handle(message))
			BWindow::DispatchMessage(message, handler);
	}

private:
	bool _Handle(BMessage* message)
	{
		switch (message->what) {
			case B_MOUSE_DOWN:
			case B_MOUSE_UP:
			case B_MOUSE_MOVED:
			{
				BPoint screen;
				if (message->FindPoint("screen_where", &screen) != B_OK) {
					BPoint where;
					message->FindPoint("where", &where);
					screen = ConvertToScreen(where);
				}
				fSession->MouseEvent(message->what, screen,
					uint32(message->GetInt32("buttons", 0)));
				return true;
			}
			case B_KEY_DOWN:
				fSession->KeyEvent(message->GetString("bytes", ""));
				return true;
			case kMenuClose:
			{
				void* marked;
				if (message->FindPointer("marked", &marked) == B_OK)
					static_cast<BMenuItem*>(marked)->SetMarked(true);
				// Hidden, the window takes input no more; what reached it
				// before still goes to the session ahead of the quit.
				Hide();
				RemoveChild(fMenu);
				fSession->Released(fMenu);
				PostMessage(B_QUIT_REQUESTED);
				return true;
			}
			default:
				return false;
		}
	}

	std::shared_ptr<MenuSession> fSession;
	BMenu* fMenu;
};

// Where a menu of size goes: at preferred, or where it would stick out of
// the screen, at flipped along that axis, and still on the screen.
BRect Place(BPoint size, BPoint preferred, BPoint flipped)
{
	BRect screen = BScreen().Frame();
	BRect frame(preferred, preferred + size);
	if (frame.right > screen.right)
		frame.OffsetTo(flipped.x, frame.top);
	if (frame.bottom > screen.bottom)
		frame.OffsetTo(frame.left, flipped.y);
	frame.OffsetBy(std::min(0.0f, screen.right - frame.right),
		std::min(0.0f, screen.bottom - frame.bottom));
	frame.OffsetBy(std::max(0.0f, screen.left - frame.left),
		std::max(0.0f, screen.top - frame.top));
	return frame;
}

bool ButtonsHeld()
{
	BPoint pointer;
	uint32 buttons;
	Display::Default().GetPointer(&pointer, &buttons);
	return buttons != 0;
}

}

void ForgetPress(BWindow* window)
{
	if (!ButtonsHeld())
		WindowAccess::Data(window).mouseView = nullptr;
}

MenuSession::MenuSession(const Options& options)
	: fOptions(options), fSticky(!ButtonsHeld())
{
}

std::shared_ptr<MenuSession> MenuSession::StartPopUp(BMenu* menu, BPoint where,
	const Options& options)
{
	std::shared_ptr<MenuSession> session(new MenuSession(options));
	std::lock_guard<std::mutex> guard(session->fLock);
	session->fRoot = menu;
	session->_Open({menu, BRect(where, where), Placement::kAtPoint, false, 0});
	return session;
}

std::shared_ptr<MenuSession> MenuSession::StartBar(BMenuBar* bar, int32 index, bool byKeyboard)
{
	Options options;
	options.deliversMessage = true;
	std::shared_ptr<MenuSession> session(new MenuSession(options));
	std::lock_guard<std::mutex> guard(session->fLock);
	session->fSticky = session->fSticky || byKeyboard;
	session->fLevels.push_back({bar, bar->ConvertToScreen(bar->Bounds()), BMessenger(bar),
		BMessenger(), -1, true});
	session->_Select(0, index);
	session->_OpenSubmenu(0, byKeyboard);
	return session;
}

MenuSession::Hit MenuSession::_HitTest(BPoint screenWhere) const
{
	Hit hit;
	for (int32 level = int32(fLevels.size()) - 1; level >= 0; level--) {
		const Level& candidate = fLevels[level];
		if (candidate.frame.Contains(screenWhere)) {
			hit.level = level;
			hit.index = MenuAccess::SelectableAt(candidate.menu,
				screenWhere - candidate.frame.LeftTop());
			break;
		}
	}
	return hit;
}

void MenuSession::MouseEvent(uint32 what, BPoint screenWhere, uint32 buttons)
{
	std::lock_guard<std::mutex> guard(fLock);
	if (fDone)
		return;
	Hit hit = _HitTest(screenWhere);
	switch (what) {
		case B_MOUSE_MOVED:
			_Hover(hit);
			break;
		case B_MOUSE_DOWN:
			// A click outside closes the menus, and so does a click on the
			// title whose menu is open.
			if (hit.level < 0 || (fSticky && fLevels[hit.level].isBar
					&& hit.index == fLevels[hit.level].selected)) {
				_End(nullptr);
			} else
				_Hover(hit);
			break;
		case B_MOUSE_UP:
		{
			if (buttons != 0)
				break;
			if (!fSticky && fOptions.hasClickRect && fOptions.clickRect.Contains(screenWhere)) {
				fSticky = true;
				break;
			}
			BMenuItem* item = hit.level >= 0 ? fLevels[hit.level].menu->ItemAt(hit.index)
				: nullptr;
			if (item != nullptr && item->Submenu() == nullptr)
				_Choose(item);
			else if (!fSticky) {
				if (hit.level >= 0 || fOptions.openAnyway)
					fSticky = true;
				else
					_End(nullptr);
			}
			break;
		}
	}
}

void MenuSession::KeyEvent(const char* bytes)
{
	std::lock_guard<std::mutex> guard(fLock);
	if (fDone || fLevels.empty())
		return;
	fSticky = true;
	int32 deepest = int32(fLevels.size()) - 1;
	const Level& level = fLevels[deepest];
	BMenuItem* selected = level.menu->ItemAt(level.selected);
	// A submenu of a menu, rather than a menu of the bar.
	bool cascaded = deepest > 0 && !fLevels[deepest - 1].isBar;
	switch (bytes[0]) {
		case B_ESCAPE:
			if (cascaded)
				_CloseFrom(deepest);
			else
				_End(nullptr);
			break;
		case B_UP_ARROW:
		case B_DOWN_ARROW:
			if (!level.isBar) {
				_Select(deepest, MenuAccess::NextSelectable(level.menu, level.selected,
					bytes[0] == B_UP_ARROW ? -1 : 1));
			}
			break;
		case B_LEFT_ARROW:
			if (cascaded)
				_CloseFrom(deepest);
			else if (fLevels[0].isBar)
				_SwitchBar(-1);
			break;
		case B_RIGHT_ARROW:
			if (selected != nullptr && selected->Submenu() != nullptr)
				_OpenSubmenu(deepest, true);
			else if (fLevels[0].isBar)
				_SwitchBar(1);
			break;
		case B_ENTER:
		case B_SPACE:
			if (selected != nullptr && selected->Submenu() != nullptr)
				_OpenSubmenu(deepest, true);
			else if (selected != nullptr)
				_Choose(selected);
			break;
	}
}

void MenuSession::_Hover(const Hit& hit)
{
	if (hit.level < 0) {
		// Off the menus: nothing stays selected in the innermost one.
		if (!fLevels.back().isBar)
			_Select(int32(fLevels.size()) - 1, -1);
		return;
	}
	const Level& level = fLevels[hit.level];
	BMenuItem* item = level.menu->ItemAt(hit.index);
	bool opens = item != nullptr && item->Submenu() != nullptr;
	if (hit.index == level.selected) {
		// Back on the item whose submenu is open: only deeper menus close.
		_CloseFrom(hit.level + (opens ? 2 : 1));
		return;
	}
	// The bar keeps its title selected between titles.
	if (level.isBar && hit.index < 0)
		return;
	_CloseFrom(hit.level + 1);
	_Select(hit.level, hit.index);
	if (opens)
		_OpenSubmenu(hit.level, false);
}

void MenuSession::_Select(int32 level, int32 index)
{
	Level& changed = fLevels[level];
	if (changed.selected == index)
		return;
	changed.selected = index;
	fChanges++;
	BMessage select(kMenuSelect);
	select.AddInt32("index", index);
	changed.view.SendMessage(&select);
}

void MenuSession::_CloseFrom(int32 level)
{
	while (int32(fLevels.size()) > level) {
		fLevels.back().window.SendMessage(kMenuClose);
		fLevels.pop_back();
		fChanges++;
	}
}

void MenuSession::_Open(const Opening& opening)
{
	BMenu* menu = opening.menu;
	// A menu closed a moment ago may still be in its window: it opens when
	// the window lets it go, unless the menus change meanwhile.
	if (std::find(fAttached.begin(), fAttached.end(), menu) != fAttached.end()) {
		fPending = opening;
		fPending.changes = fChanges;
		return;
	}
	BPoint size = MenuAccess::Layout(menu);
	BRect anchor = opening.anchor;
	BRect frame;
	switch (opening.placement) {
		case Placement::kAtPoint:
			frame = Place(size, anchor.LeftTop(),
				BPoint(anchor.left - size.x - 1, anchor.top - size.y - 1));
			break;
		case Placement::kBelow:
			frame = Place(size, anchor.LeftBottom() + BPoint(0, 1),
				BPoint(anchor.right - size.x, anchor.top - size.y - 1));
			break;
		case Placement::kBeside:
			frame = Place(size, BPoint(anchor.right - 1, anchor.top - 3),
				BPoint(anchor.left - size.x + 1, anchor.bottom + 3 - size.y));
			break;
	}
	int32 selected = opening.selectFirst ? MenuAccess::NextSelectable(menu, -1, 1) : -1;
	MenuAccess::Data(menu).selected = selected;
	MenuWindow* window = new MenuWindow(shared_from_this(), menu, frame);
	fLevels.push_back({menu, frame, BMessenger(menu), BMessenger(window), selected, false});
	fAttached.push_back(menu);
	fChanges++;
	window->Show();
}

void MenuSession::_OpenSubmenu(int32 level, bool selectFirst)
{
	const Level& parent = fLevels[level];
	BMenuItem* item = parent.menu->ItemAt(parent.selected);
	if (item == nullptr || item->Submenu() == nullptr)
		return;
	BRect anchor = item->Frame().OffsetByCopy(parent.frame.LeftTop());
	if (!parent.isBar)
		anchor.right = parent.frame.right;
	_Open({item->Submenu(), anchor, parent.isBar ? Placement::kBelow : Placement::kBeside,
		selectFirst, 0});
}

void MenuSession::_SwitchBar(int32 direction)
{
	const Level& bar = fLevels[0];
	int32 index = MenuAccess::NextSelectable(bar.menu, bar.selected, direction);
	if (index < 0 || index == bar.selected)
		return;
	_CloseFrom(1);
	_Select(0, index);
	_OpenSubmenu(0, true);
}

void MenuSession::_Choose(BMenuItem* item)
{
	if (fOptions.deliversMessage)
		item->Invoke();
	_End(item);
}

void MenuSession::_End(BMenuItem* chosen)
{
	fDone = true;
	fChosen = chosen;
	BMenu* markedMenu = chosen != nullptr && chosen->Menu()->IsRadioMode()
		? chosen->Menu() : nullptr;
	for (auto level = fLevels.rbegin(); level != fLevels.rend(); ++level) {
		if (level->isBar) {
			level->view.SendMessage(kMenusEnded);
			continue;
		}
		BMessage close(kMenuClose);
		if (level->menu == markedMenu)
			close.AddPointer("marked", chosen);
		level->window.SendMessage(&close);
	}
	fLevels.clear();
	fChanged.notify_all();
}

void MenuSession::Cancel()
{
	std::lock_guard<std::mutex> guard(fLock);
	if (!fDone)
		_End(nullptr);
}

void MenuSession::Released(BMenu* menu)
{
	std::unique_lock<std::mutex> lock(fLock);
	std::erase(fAttached, menu);
	if (fPending.menu == menu) {
		Opening pending = fPending;
		fPending.menu = nullptr;
		if (!fDone && pending.changes == fChanges)
			_Open(pending);
	}
	bool deleteMenu = fOptions.autoDelete && menu == fRoot && fDone;
	bool finished = _IsFinished();
	fChanged.notify_all();
	lock.unlock();
	if (deleteMenu)
		delete menu;
	if (finished && fOptions.waited)
		fHandoff.Signal();
}

BMenuItem* MenuSession::Wait()
{
	fHandoff.Wait();
	std::lock_guard<std::mutex> guard(fLock);
	return fChosen;
}

bool MenuSession::IsOpen() const
{
	std::lock_guard<std::mutex> guard(fLock);
	return !_IsFinished();
}

void MenuSession::Close()
{
	std::unique_lock<std::mutex> lock(fLock);
	fOptions.autoDelete = false;
	if (!fDone)
		_End(nullptr);
	fChanged.wait(lock, [this] { return fAttached.empty(); });
}

}
