#include <Menu.h>

#include <algorithm>
#include <cctype>
#include <cmath>
#include <cstring>

#include <MenuBar.h>
#include <MenuItem.h>
#include <Message.h>
#include <Window.h>

#include "ControlLook.h"
#include "MenuPrivate.h"
#include "ViewData.h"

namespace look = BPrivate::ControlLook;
using BPrivate::MenuAccess;
using BPrivate::MenuData;

namespace {

// Space between a column menu's edge and its items: the border, the bevel
// and a pixel of padding.
constexpr float kColumnInset = 3;
constexpr float kItemPadding = 4;

// The first item of menu or of its submenus, depth first, that matches.
template<typename Match>
BMenuItem* FindIn(const BMenu* menu, const Match& match)
{
	for (int32 i = 0; BMenuItem* item = menu->ItemAt(i); i++) {
		if (match(item))
			return item;
		if (item->Submenu() != nullptr) {
			if (BMenuItem* found = FindIn(item->Submenu(), match))
				return found;
		}
	}
	return nullptr;
}

// The menu key is Ctrl on a PC keyboard (B_COMMAND_KEY in an item's
// shortcut), and Alt, which the platform calls B_COMMAND_KEY, is no part of
// a shortcut. -1 for keys held that make no shortcut.
int32 ShortcutModifiers(uint32 held)
{
	if ((held & B_CONTROL_KEY) == 0 || (held & B_COMMAND_KEY) != 0)
		return -1;
	return int32(B_COMMAND_KEY | (held & (B_SHIFT_KEY | B_OPTION_KEY)));
}

}

namespace BPrivate {

BPoint MenuAccess::Layout(BMenu* menu)
{
	MenuData& data = Data(menu);
	bool row = data.layout == B_ITEMS_IN_ROW;
	float x = row ? 2 : kColumnInset - 1;
	float y = row ? 1 : kColumnInset;
	float widest = 0;
	std::vector<BPoint> sizes;
	for (BMenuItem* item : data.items) {
		BPoint size;
		item->GetContentSize(&size.x, &size.y);
		if (row)
			size.x += 2 * kRowMargin;
		else {
			size.x += kItemLeftMargin + kItemRightMargin;
			std::string shortcut = ShortcutLabel(item);
			if (!shortcut.empty())
				size.x += kShortcutGap + std::ceil(menu->StringWidth(shortcut.c_str()));
			if (item->Submenu() != nullptr)
				size.x += kSubmenuRoom;
		}
		size.y += kItemPadding;
		widest = std::max(widest, size.x);
		sizes.push_back(size);
	}

	font_height height;
	menu->GetFontHeight(&height);
	float lineHeight = std::ceil(height.ascent) + std::ceil(height.descent) + kItemPadding;
	for (size_t i = 0; i < data.items.size(); i++) {
		BRect& frame = Data(data.items[i]).frame;
		if (row) {
			frame.Set(x, y, x + sizes[i].x - 1, y + lineHeight - 1);
			x += sizes[i].x;
		} else {
			frame.Set(x, y, x + widest - 1, y + sizes[i].y - 1);
			y += sizes[i].y;
		}
	}
	if (row)
		return BPoint(x + 1, lineHeight + 2);
	return BPoint(std::max(widest, 40.0f) + 2 * kColumnInset - 1, y + kColumnInset - 1);
}

bool MenuAccess::IsSelectable(const BMenuItem* item)
{
	return item->IsEnabled() && dynamic_cast<const BSeparatorItem*>(item) == nullptr;
}

int32 MenuAccess::SelectableAt(const BMenu* menu, BPoint point)
{
	const std::vector<BMenuItem*>& items = Data(menu).items;
	for (size_t i = 0; i < items.size(); i++) {
		if (items[i]->Frame().Contains(point))
			return IsSelectable(items[i]) ? int32(i) : -1;
	}
	return -1;
}

int32 MenuAccess::NextSelectable(const BMenu* menu, int32 index, int32 direction)
{
	int32 count = menu->CountItems();
	// From no selection, down starts at the first item and up at the last.
	int32 candidate = index >= 0 ? index : direction > 0 ? -1 : count;
	for (int32 step = 0; step < count; step++) {
		candidate = (candidate + direction + count) % count;
		if (IsSelectable(menu->ItemAt(candidate)))
			return candidate;
	}
	return -1;
}

BMenuItem* MenuAccess::FindShortcut(const BMenu* menu, char key, uint32 modifiers)
{
	int32 held = ShortcutModifiers(modifiers);
	if (held < 0)
		return nullptr;
	return FindIn(menu, [&](BMenuItem* item) {
		uint32 itemModifiers;
		char shortcut = item->Shortcut(&itemModifiers);
		uint32 wanted = B_COMMAND_KEY | (itemModifiers & (B_SHIFT_KEY | B_OPTION_KEY));
		return shortcut != 0 && tolower(uint8(shortcut)) == tolower(uint8(key))
			&& uint32(held) == wanted;
	});
}

void MenuAccess::Install(BMenu* menu, BLooper* looper)
{
	for (BMenuItem* item : Data(menu).items) {
		if (!item->Messenger().IsValid())
			item->SetTarget(looper);
		if (item->Submenu() != nullptr)
			Install(item->Submenu(), looper);
	}
}

std::string MenuAccess::ShortcutLabel(const BMenuItem* item)
{
	uint32 modifiers;
	char shortcut = item->Shortcut(&modifiers);
	if (shortcut == 0)
		return std::string();
	std::string label;
	if ((modifiers & B_SHIFT_KEY) != 0)
		label += "Shift+";
	if ((modifiers & B_OPTION_KEY) != 0)
		label += "Super+";
	label += "Ctrl+";
	label += char(toupper(uint8(shortcut)));
	return label;
}

}

BMenu::BMenu(const char* name, menu_layout layout)
	:
	BView(BRect(0, 0, 10, 10), name, B_FOLLOW_LEFT | B_FOLLOW_TOP, B_WILL_DRAW),
	fMenuData(std::make_unique<MenuData>())
{
	_Init(layout, true);
}

BMenu::BMenu(BRect frame, const char* name, uint32 resizingMode, uint32 flags,
	menu_layout layout, bool resizeToFit)
	:
	BView(frame, name, resizingMode, flags),
	fMenuData(std::make_unique<MenuData>())
{
	_Init(layout, resizeToFit);
}

void BMenu::_Init(menu_layout layout, bool resizeToFit)
{
	fMenuData->layout = layout;
	fMenuData->resizeToFit = resizeToFit;
	SetViewColor(look::kFace);
	SetLowColor(look::kFace);
}

BMenu::~BMenu()
{
	for (BMenuItem* item : fMenuData->items) {
		MenuAccess::Data(item).menu = nullptr;
		delete item;
	}
}

void BMenu::Draw(BRect updateRect)
{
	BPrivate::StateGuard state(this);
	SetPenSize(1);
	BRect bounds = Bounds();
	if (fMenuData->layout != B_ITEMS_IN_ROW) {
		SetHighColor(look::kDarkShadow);
		StrokeRect(bounds);
		look::DrawBevel(this, bounds.InsetByCopy(1, 1), true);
	}
	for (BMenuItem* item : fMenuData->items) {
		if (item->Frame().Intersects(updateRect)) {
			BPrivate::StateGuard itemState(this);
			MenuAccess::DrawItem(item);
		}
	}
}

void BMenu::MessageReceived(BMessage* message)
{
	if (message->what != BPrivate::kMenuSelect) {
		BView::MessageReceived(message);
		return;
	}
	int32 index = message->GetInt32("index", -1);
	if (index == fMenuData->selected)
		return;
	for (int32 changed : {fMenuData->selected, index}) {
		if (BMenuItem* item = ItemAt(changed))
			Invalidate(item->Frame());
	}
	fMenuData->selected = index;
}

bool BMenu::AddItem(BMenuItem* item)
{
	return AddItem(item, CountItems());
}

bool BMenu::AddItem(BMenuItem* item, int32 index)
{
	MenuData& data = *fMenuData;
	if (item == nullptr || item->Menu() != nullptr || index < 0 || index > CountItems())
		return false;
	data.items.insert(data.items.begin() + index, item);
	MenuAccess::Data(item).menu = this;
	// Items join the menu bar of a window as if they had been there.
	BMenu* top = this;
	while (top->Supermenu() != nullptr)
		top = top->Supermenu();
	if (top->Window() != nullptr && dynamic_cast<BMenuBar*>(top) != nullptr)
		MenuAccess::Install(top, top->Window());
	MenuAccess::Layout(this);
	Invalidate();
	return true;
}

bool BMenu::AddItem(BMenu* menu)
{
	return AddItem(menu, CountItems());
}

bool BMenu::AddItem(BMenu* menu, int32 index)
{
	if (menu == nullptr || menu->Superitem() != nullptr)
		return false;
	BMenuItem* item = new BMenuItem(menu);
	if (AddItem(item, index))
		return true;
	MenuAccess::Data(menu).superitem = nullptr;
	MenuAccess::Data(item).submenu = nullptr;
	delete item;
	return false;
}

bool BMenu::AddSeparatorItem()
{
	return AddItem(new BSeparatorItem());
}

BMenuItem* BMenu::RemoveItem(int32 index)
{
	MenuData& data = *fMenuData;
	BMenuItem* item = ItemAt(index);
	if (item == nullptr)
		return nullptr;
	data.items.erase(data.items.begin() + index);
	MenuAccess::Data(item).menu = nullptr;
	if (data.selected >= index)
		data.selected = -1;
	MenuAccess::Layout(this);
	Invalidate();
	return item;
}

bool BMenu::RemoveItem(BMenuItem* item)
{
	return RemoveItem(IndexOf(item)) != nullptr;
}

bool BMenu::RemoveItems(int32 index, int32 count, bool deleteItems)
{
	if (index < 0 || count < 0 || index + count > CountItems())
		return false;
	for (int32 i = 0; i < count; i++) {
		BMenuItem* item = RemoveItem(index);
		if (deleteItems)
			delete item;
	}
	return true;
}

BMenuItem* BMenu::ItemAt(int32 index) const
{
	const std::vector<BMenuItem*>& items = fMenuData->items;
	return index >= 0 && index < int32(items.size()) ? items[index] : nullptr;
}

BMenu* BMenu::SubmenuAt(int32 index) const
{
	BMenuItem* item = ItemAt(index);
	return item != nullptr ? item->Submenu() : nullptr;
}

int32 BMenu::CountItems() const
{
	return int32(fMenuData->items.size());
}

int32 BMenu::IndexOf(BMenuItem* item) const
{
	const std::vector<BMenuItem*>& items = fMenuData->items;
	auto found = std::find(items.begin(), items.end(), item);
	return found != items.end() ? int32(found - items.begin()) : -1;
}

int32 BMenu::IndexOf(BMenu* menu) const
{
	return menu != nullptr ? IndexOf(menu->Superitem()) : -1;
}

BMenuItem* BMenu::FindItem(uint32 command) const
{
	return FindIn(this, [command](BMenuItem* item) {
		return item->Message() != nullptr && item->Command() == command;
	});
}

BMenuItem* BMenu::FindItem(const char* label) const
{
	if (label == nullptr)
		return nullptr;
	return FindIn(this, [label](BMenuItem* item) { return strcmp(item->Label(), label) == 0; });
}

BMenuItem* BMenu::FindMarked()
{
	for (BMenuItem* item : fMenuData->items) {
		if (item->IsMarked())
			return item;
	}
	return nullptr;
}

status_t BMenu::SetTargetForItems(BHandler* target)
{
	status_t status = B_OK;
	for (BMenuItem* item : fMenuData->items) {
		status_t itemStatus = item->SetTarget(target);
		if (itemStatus != B_OK)
			status = itemStatus;
	}
	return status;
}

status_t BMenu::SetTargetForItems(BMessenger messenger)
{
	for (BMenuItem* item : fMenuData->items)
		item->SetTarget(messenger);
	return B_OK;
}

void BMenu::SetEnabled(bool enabled)
{
	if (enabled == fMenuData->enabled)
		return;
	fMenuData->enabled = enabled;
	Invalidate();
	if (BMenu* super = Supermenu())
		super->Invalidate(Superitem()->Frame());
}

bool BMenu::IsEnabled() const
{
	return fMenuData->enabled;
}

void BMenu::SetRadioMode(bool flag)
{
	fMenuData->radioMode = flag;
}

bool BMenu::IsRadioMode() const
{
	return fMenuData->radioMode;
}

void BMenu::SetLabelFromMarked(bool flag)
{
	fMenuData->labelFromMarked = flag;
	if (flag)
		fMenuData->radioMode = true;
}

bool BMenu::IsLabelFromMarked()
{
	return fMenuData->labelFromMarked;
}

BMenu* BMenu::Supermenu() const
{
	return fMenuData->superitem != nullptr ? fMenuData->superitem->Menu() : nullptr;
}

BMenuItem* BMenu::Superitem() const
{
	return fMenuData->superitem;
}

menu_layout BMenu::Layout() const
{
	return fMenuData->layout;
}

void BMenu::GetPreferredSize(float* width, float* height)
{
	BPoint size = MenuAccess::Layout(this);
	if (width != nullptr)
		*width = size.x;
	if (height != nullptr)
		*height = size.y;
}

