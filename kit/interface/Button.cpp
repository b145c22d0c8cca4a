#include <Button.h>

#include <algorithm>
#include <cmath>

#include <OS.h>
#include <Window.h>

#include "ControlLook.h"
#include "ViewData.h"
#include "WindowHooks.h"

namespace look = BPrivate::ControlLook;

namespace {

constexpr float kMinWidth = 75;
// How long a key press shows the button pressed.
constexpr bigtime_t kFlash = 60000;

}

namespace BPrivate {

struct ButtonData {
	bool isDefault = false;
	bool tracking = false;
};

}

BButton::BButton(BRect frame, const char* name, const char* label, BMessage* message,
	uint32 resizingMode, uint32 flags)
	:
	BControl(frame, name, label, message, resizingMode, flags),
	fButtonData(std::make_unique<BPrivate::ButtonData>())
{
}

BButton::~BButton() = default;

void BButton::AttachedToWindow()
{
	BControl::AttachedToWindow();
	if (fButtonData->isDefault)
		MakeDefault(true);
}

void BButton::DetachedFromWindow()
{
	if (BPrivate::DefaultButton(Window()) == this)
		BPrivate::SetDefaultButton(Window(), nullptr);
	BControl::DetachedFromWindow();
}

void BButton::Draw(BRect)
{
	BPrivate::StateGuard state(this);
	SetDrawingMode(B_OP_COPY);
	SetPenSize(1);
	BRect frame = Bounds();
	if (fButtonData->isDefault) {
		SetHighColor(look::kDarkShadow);
		StrokeRect(frame);
		frame.InsetBy(2, 2);
	}
	bool pressed = Value() == B_CONTROL_ON;
	SetHighColor(pressed ? look::kLightShadow : look::kFace);
	FillRect(frame.InsetByCopy(1, 1));
	SetHighColor(IsEnabled() ? look::kDarkShadow : look::kShadow);
	StrokeRect(frame);
	look::DrawBevel(this, frame.InsetByCopy(1, 1), !pressed);

	float width = StringWidth(Label());
	float x = std::floor((frame.left + frame.right + 1 - width) / 2);
	float baseline = look::CenteredBaseline(this, frame);
	SetHighColor(IsEnabled() ? look::kText : look::kDisabledText);
	SetLowColor(pressed ? look::kLightShadow : look::kFace);
	DrawString(Label(), BPoint(x, baseline));
	if (IsFocus() && Window()->IsActive()) {
		SetHighColor(ui_color(B_KEYBOARD_NAVIGATION_COLOR));
		StrokeLine(BPoint(x, baseline + 2), BPoint(x + width - 1, baseline + 2));
	}
}

void BButton::MouseDown(BPoint)
{
	if (!IsEnabled())
		return;
	fButtonData->tracking = true;
	SetValue(B_CONTROL_ON);
}

void BButton::MouseMoved(BPoint where, uint32, const BMessage*)
{
	if (fButtonData->tracking)
		SetValue(Bounds().Contains(where) ? B_CONTROL_ON : B_CONTROL_OFF);
}

void BButton::MouseUp(BPoint where)
{
	if (!fButtonData->tracking)
		return;
	fButtonData->tracking = false;
	SetValue(B_CONTROL_OFF);
	if (Bounds().Contains(where))
		Invoke();
}

void BButton::KeyDown(const char* bytes, int32 numBytes)
{
	if (!IsEnabled() || (bytes[0] != B_ENTER && bytes[0] != B_SPACE)) {
		BControl::KeyDown(bytes, numBytes);
		return;
	}
	// Show the press before the message goes.
	if (BWindow* window = Window()) {
		SetValue(B_CONTROL_ON);
		window->UpdateIfNeeded();
		snooze(kFlash);
		SetValue(B_CONTROL_OFF);
	}
	Invoke();
}

void BButton::WindowActivated(bool)
{
	if (IsFocus())
		Invalidate();
}

void BButton::MakeDefault(bool flag)
{
	BWindow* window = Window();
	if (window != nullptr) {
		BButton* previous = dynamic_cast<BButton*>(BPrivate::DefaultButton(window));
		if (flag && previous != nullptr && previous != this)
			previous->MakeDefault(false);
		if (flag)
			BPrivate::SetDefaultButton(window, this);
		else if (previous == this)
			BPrivate::SetDefaultButton(window, nullptr);
	}
	if (flag != fButtonData->isDefault) {
		fButtonData->isDefault = flag;
		Invalidate();
	}
}

bool BButton::IsDefault() const
{
	return fButtonData->isDefault;
}

void BButton::GetPreferredSize(float* width, float* height)
{
	font_height fontHeight;
	GetFontHeight(&fontHeight);
	float ring = fButtonData->isDefault ? 4 : 0;
	if (width != nullptr)
		*width = std::max(kMinWidth, std::ceil(StringWidth(Label())) + 20) + ring;
	if (height != nullptr)
		*height = std::ceil(fontHeight.ascent + fontHeight.descent) + 12 + ring;
}

