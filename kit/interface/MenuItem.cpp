#include <MenuItem.h>

#include <cmath>

#include <Menu.h>
#include <Message.h>

#include "ControlLook.h"
#include "InvokerPrivate.h"
#include "MenuPrivate.h"

namespace look = BPrivate::ControlLook;
using BPrivate::MenuAccess;
using BPrivate::kItemLeftMargin;
using BPrivate::kItemRightMargin;
using BPrivate::kRowMargin;
using BPrivate::MenuItemData;

BMenuItem::BMenuItem(const char* label, BMessage* message, char shortcut, uint32 modifiers)
	:
	BInvoker(message, BMessenger()),
	fMenuItemData(std::make_unique<MenuItemData>())
{
	fMenuItemData->label = label != nullptr ? label : "";
	fMenuItemData->shortcut = shortcut;
	fMenuItemData->modifiers = modifiers;
}

BMenuItem::BMenuItem(BMenu* menu, BMessage* message)
	: BMenuItem(menu != nullptr ? menu->Name() : nullptr, message)
{
	fMenuItemData->submenu = menu;
	if (menu != nullptr)
		MenuAccess::Data(menu).superitem = this;
}

BMenuItem::~BMenuItem()
{
	delete fMenuItemData->submenu;
}

void BMenuItem::SetLabel(const char* name)
{
	fMenuItemData->label = name != nullptr ? name : "";
	if (BMenu* menu = Menu()) {
		MenuAccess::Layout(menu);
		menu->Invalidate();
	}
}

const char* BMenuItem::Label() const
{
	return fMenuItemData->label.c_str();
}

void BMenuItem::SetEnabled(bool enabled)
{
	if (enabled == fMenuItemData->enabled)
		return;
	fMenuItemData->enabled = enabled;
	if (BMenu* menu = Menu())
		menu->Invalidate(Frame());
}

bool BMenuItem::IsEnabled() const
{
	for (const BMenuItem* item = this; item != nullptr; ) {
		const MenuItemData& data = *item->fMenuItemData;
		if (!data.enabled || (data.menu != nullptr && !data.menu->IsEnabled()))
			return false;
		item = data.menu != nullptr ? data.menu->Superitem() : nullptr;
	}
	return true;
}

void BMenuItem::SetMarked(bool marked)
{
	if (marked == fMenuItemData->marked)
		return;
	fMenuItemData->marked = marked;
	BMenu* menu = Menu();
	if (menu == nullptr)
		return;
	menu->Invalidate(Frame());
	if (!marked)
		return;
	if (menu->IsRadioMode()) {
		for (int32 i = 0; BMenuItem* other = menu->ItemAt(i); i++) {
			if (other != this)
				other->SetMarked(false);
		}
	}
	if (menu->IsLabelFromMarked() && menu->Superitem() != nullptr)
		menu->Superitem()->SetLabel(Label());
}

bool BMenuItem::IsMarked() const
{
	return fMenuItemData->marked;
}

void BMenuItem::SetShortcut(char shortcut, uint32 modifiers)
{
	fMenuItemData->shortcut = shortcut;
	fMenuItemData->modifiers = modifiers;
	if (BMenu* menu = Menu()) {
		MenuAccess::Layout(menu);
		menu->Invalidate();
	}
}

char BMenuItem::Shortcut(uint32* modifiers) const
{
	if (modifiers != nullptr)
		*modifiers = fMenuItemData->modifiers;
	return fMenuItemData->shortcut;
}

BMenu* BMenuItem::Submenu() const
{
	return fMenuItemData->submenu;
}

BMenu* BMenuItem::Menu() const
{
	return fMenuItemData->menu;
}

BRect BMenuItem::Frame() const
{
	return fMenuItemData->frame;
}

bool BMenuItem::IsSelected() const
{
	BMenu* menu = Menu();
	return menu != nullptr && MenuAccess::Data(menu).selected >= 0
		&& menu->ItemAt(MenuAccess::Data(menu).selected) == this;
}

status_t BMenuItem::Invoke(BMessage* message)
{
	if (!IsEnabled())
		return B_ERROR;
	std::unique_ptr<BMessage> copy = BPrivate::StampedCopy(this, message, this);
	if (copy == nullptr)
		return B_BAD_VALUE;
	copy->AddInt32("index", Menu() != nullptr ? Menu()->IndexOf(this) : -1);
	return BInvoker::Invoke(copy.get());
}

void BMenuItem::GetContentSize(float* width, float* height)
{
	BMenu* menu = Menu();
	font_height fontHeight;
	be_plain_font->GetHeight(&fontHeight);
	if (width != nullptr)
		*width = std::ceil(menu != nullptr ? menu->StringWidth(Label())
			: be_plain_font->StringWidth(Label()));
	if (height != nullptr)
		*height = std::ceil(fontHeight.ascent) + std::ceil(fontHeight.descent);
}

void BMenuItem::Draw()
{
	BMenu* menu = Menu();
	BRect frame = Frame();
	bool selected = IsSelected();
	menu->SetDrawingMode(B_OP_COPY);
	menu->SetHighColor(selected ? look::kSelection : look::kFace);
	menu->FillRect(frame);
	menu->SetLowColor(selected ? look::kSelection : look::kFace);
	menu->SetHighColor(IsEnabled() ? look::kText : look::kDisabledText);
	DrawContent();

	if (menu->Layout() == B_ITEMS_IN_ROW)
		return;
	float baseline = ContentLocation().y;
	std::string shortcut = MenuAccess::ShortcutLabel(this);
	if (!shortcut.empty()) {
		float x = frame.right - kItemRightMargin + 1
			- std::ceil(menu->StringWidth(shortcut.c_str()));
		menu->DrawString(shortcut.c_str(), BPoint(x, baseline));
	}
	if (Submenu() != nullptr) {
		BRect room(frame.right - kItemRightMargin, frame.top, frame.right - 2, frame.bottom);
		look::DrawArrow(menu, room, B_RIGHT_ARROW, menu->HighColor());
	}
	if (IsMarked()) {
		// A check mark in the left margin.
		BPoint corner(frame.left + 5, baseline - 3);
		menu->SetPenSize(2);
		menu->StrokeLine(corner, corner + BPoint(2, 3));
		menu->StrokeLine(corner + BPoint(2, 3), corner + BPoint(7, -4));
		menu->SetPenSize(1);
	}
}

void BMenuItem::DrawContent()
{
	Menu()->DrawString(Label(), ContentLocation());
}

BPoint BMenuItem::ContentLocation() const
{
	BMenu* menu = Menu();
	BRect frame = Frame();
	float margin = menu->Layout() == B_ITEMS_IN_ROW ? kRowMargin : kItemLeftMargin;
	return BPoint(frame.left + margin, look::CenteredBaseline(menu, frame));
}

BSeparatorItem::BSeparatorItem()
	: BMenuItem("", nullptr)
{
	BMenuItem::SetEnabled(false);
}

BSeparatorItem::~BSeparatorItem() = default;

void BSeparatorItem::SetEnabled(bool)
{
}

void BSeparatorItem::GetContentSize(float* width, float* height)
{
	if (width != nullptr)
		*width = 0;
	if (height != nullptr)
		*height = 4;
}

void BSeparatorItem::Draw()
{
	BMenu* menu = Menu();
	BRect frame = Frame();
	float y = std::floor((frame.top + frame.bottom) / 2);
	menu->SetHighColor(look::kFace);
	menu->FillRect(frame);
	menu->SetHighColor(look::kShadow);
	menu->StrokeLine(BPoint(frame.left + 1, y), BPoint(frame.right - 1, y));
	menu->SetHighColor(look::kLight);
	menu->StrokeLine(BPoint(frame.left + 1, y + 1), BPoint(frame.right - 1, y + 1));
}
