#include <StatusBar.h>

#include <algorithm>
#include <cmath>
#include <string>

#include <Message.h>

#include "ControlLook.h"
#include "ViewData.h"

namespace look = BPrivate::ControlLook;

namespace {

constexpr float kDefaultMax = 100;
constexpr float kTextGap = 3;

std::string StringOrEmpty(const char* string)
{
	return string != nullptr ? string : "";
}

}

namespace BPrivate {

struct StatusBarData {
	std::string label;
	std::string trailingLabel;
	std::string text;
	std::string trailingText;
	float value = 0;
	float max = kDefaultMax;
	float barHeight = 16;
	rgb_color barColor = {50, 150, 255, 255};
};

}

BStatusBar::BStatusBar(BRect frame, const char* name, const char* label,
	const char* trailingLabel)
	:
	BView(frame, name, B_FOLLOW_LEFT | B_FOLLOW_TOP, B_WILL_DRAW | B_FRAME_EVENTS),
	fStatusBarData(std::make_unique<BPrivate::StatusBarData>())
{
	fStatusBarData->label = StringOrEmpty(label);
	fStatusBarData->trailingLabel = StringOrEmpty(trailingLabel);
}

BStatusBar::~BStatusBar() = default;

void BStatusBar::AttachedToWindow()
{
	if (Parent() != nullptr) {
		SetViewColor(Parent()->ViewColor());
		SetLowColor(Parent()->ViewColor());
	}
	float height;
	GetPreferredSize(nullptr, &height);
	ResizeTo(Bounds().Width(), height);
	BView::AttachedToWindow();
}

void BStatusBar::Draw(BRect)
{
	const BPrivate::StatusBarData& data = *fStatusBarData;
	BPrivate::StateGuard state(this);
	SetDrawingMode(B_OP_COPY);
	SetPenSize(1);
	BRect bounds = Bounds();
	font_height height;
	GetFontHeight(&height);
	float baseline = bounds.top + std::ceil(height.ascent);

	SetHighColor(look::kText);
	std::string left = data.label + data.text;
	DrawString(left.c_str(), BPoint(bounds.left, baseline));
	std::string right = data.trailingText + data.trailingLabel;
	DrawString(right.c_str(), BPoint(bounds.right + 1 - std::ceil(StringWidth(right.c_str())),
		baseline));

	BRect bar(bounds.left, bounds.bottom - data.barHeight + 1, bounds.right, bounds.bottom);
	look::DrawBevel(this, bar, false);
	BRect inside = bar.InsetByCopy(1, 1);
	SetHighColor(look::kDarkShadow);
	StrokeRect(inside);
	inside.InsetBy(1, 1);
	if (!inside.IsValid())
		return;
	float filled = data.max > 0 ? std::round(data.value / data.max * (inside.Width() + 1)) : 0;
	SetHighColor(look::kLight);
	FillRect(inside);
	if (filled >= 1) {
		SetHighColor(data.barColor);
		FillRect(BRect(inside.left, inside.top, inside.left + filled - 1, inside.bottom));
	}
}

void BStatusBar::MessageReceived(BMessage* message)
{
	switch (message->what) {
		case B_UPDATE_STATUS_BAR:
			Update(message->GetFloat("delta", 0), message->GetString("text"),
				message->GetString("trailing_text"));
			break;
		case B_RESET_STATUS_BAR:
			Reset(message->GetString("label"), message->GetString("trailing_label"));
			break;
		default:
			BView::MessageReceived(message);
			break;
	}
}

void BStatusBar::SetBarColor(rgb_color color)
{
	fStatusBarData->barColor = color;
	Invalidate();
}

rgb_color BStatusBar::BarColor() const
{
	return fStatusBarData->barColor;
}

void BStatusBar::SetBarHeight(float height)
{
	fStatusBarData->barHeight = std::max(height, 3.0f);
	if (Window() != nullptr) {
		float preferred;
		GetPreferredSize(nullptr, &preferred);
		ResizeTo(Bounds().Width(), preferred);
	}
	Invalidate();
}

float BStatusBar::BarHeight() const
{
	return fStatusBarData->barHeight;
}

void BStatusBar::SetText(const char* string)
{
	fStatusBarData->text = StringOrEmpty(string);
	Invalidate();
}

const char* BStatusBar::Text() const
{
	return fStatusBarData->text.c_str();
}

void BStatusBar::SetTrailingText(const char* string)
{
	fStatusBarData->trailingText = StringOrEmpty(string);
	Invalidate();
}

const char* BStatusBar::TrailingText() const
{
	return fStatusBarData->trailingText.c_str();
}

void BStatusBar::SetMaxValue(float max)
{
	fStatusBarData->max = std::max(max, 0.0f);
	_SetValue(fStatusBarData->value);
}

float BStatusBar::MaxValue() const
{
	return fStatusBarData->max;
}

float BStatusBar::CurrentValue() const
{
	return fStatusBarData->value;
}

const char* BStatusBar::Label() const
{
	return fStatusBarData->label.c_str();
}

const char* BStatusBar::TrailingLabel() const
{
	return fStatusBarData->trailingLabel.c_str();
}

void BStatusBar::Update(float delta, const char* text, const char* trailingText)
{
	if (text != nullptr)
		fStatusBarData->text = text;
	if (trailingText != nullptr)
		fStatusBarData->trailingText = trailingText;
	_SetValue(fStatusBarData->value + delta);
}

void BStatusBar::Reset(const char* label, const char* trailingLabel)
{
	BPrivate::StatusBarData& data = *fStatusBarData;
	data.label = StringOrEmpty(label);
	data.trailingLabel = StringOrEmpty(trailingLabel);
	data.text.clear();
	data.trailingText.clear();
	data.max = kDefaultMax;
	_SetValue(0);
}

void BStatusBar::GetPreferredSize(float* width, float* height)
{
	const BPrivate::StatusBarData& data = *fStatusBarData;
	font_height fontHeight;
	GetFontHeight(&fontHeight);
	if (width != nullptr) {
		std::string line = data.label + data.text + data.trailingText + data.trailingLabel;
		*width = std::ceil(StringWidth(line.c_str())) + 20;
	}
	if (height != nullptr) {
		*height = std::ceil(fontHeight.ascent) + std::ceil(fontHeight.descent) + kTextGap
			+ data.barHeight - 1;
	}
}

void BStatusBar::_SetValue(float value)
{
	fStatusBarData->value = std::clamp(value, 0.0f, fStatusBarData->max);
	Invalidate();
}
