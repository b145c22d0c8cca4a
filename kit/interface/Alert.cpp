#include <Alert.h>

#include <algorithm>
#include <cctype>
#include <cmath>

#include <Button.h>
#include <Invoker.h>
#include <Message.h>
#include <Screen.h>
#include <TextView.h>

#include "AlertIcons.h"
#include "ControlLook.h"
#include "ModalHandoff.h"

namespace look = BPrivate::ControlLook;

namespace {

constexpr uint32 kButtonPressed = '_ABP';
constexpr float kWidth = 310;
constexpr float kMargin = 10;
// The darker stripe along the left edge, and the icon that overlaps it.
constexpr float kStripeWidth = 30;
constexpr BPoint kIconPosition(18, 6);
constexpr float kTextLeft = 55;
constexpr float kButtonGap = 7;
// The extra room B_OFFSET_SPACING leaves after the first button.
constexpr float kOffsetGap = 30;

class AlertView : public BView {
public:
	AlertView(BRect frame, alert_type type)
		: BView(frame, "_bg_", B_FOLLOW_ALL, B_WILL_DRAW), fType(type)
	{
		SetViewColor(look::kFace);
	}

	void Draw(BRect) override
	{
		if (fType == B_EMPTY_ALERT)
			return;
		SetHighColor(look::kLightShadow);
		FillRect(BRect(0, 0, kStripeWidth - 1, Bounds().bottom));
		BPrivate::DrawAlertIcon(this, kIconPosition, fType);
	}

private:
	alert_type fType;
};

}

namespace BPrivate {

// What a synchronous Go waits for; it outlives the alert.
struct AlertOutcome {
	ModalHandoff handoff;
	int32 which = -1;
};

struct AlertData {
	BButton* buttons[3] = {nullptr, nullptr, nullptr};
	char shortcuts[3] = {0, 0, 0};
	int32 count = 0;
	BTextView* textView = nullptr;
	std::shared_ptr<AlertOutcome> outcome;
	std::unique_ptr<BInvoker> invoker;
};

}

BAlert::BAlert(const char* title, const char* text, const char* button0, const char* button1,
	const char* button2, button_width widthStyle, alert_type type)
	: BAlert(title, text, button0, button1, button2, widthStyle, B_EVEN_SPACING, type)
{
}

BAlert::BAlert(const char* title, const char* text, const char* button0, const char* button1,
	const char* button2, button_width widthStyle, button_spacing spacing, alert_type type)
	:
	BWindow(BRect(0, 0, kWidth - 1, 99), title, B_MODAL_WINDOW_LOOK,
		B_MODAL_APP_WINDOW_FEEL, B_NOT_RESIZABLE | B_NOT_CLOSABLE | B_NOT_ZOOMABLE
			| B_NOT_MINIMIZABLE),
	fAlertData(std::make_unique<BPrivate::AlertData>())
{
	const char* const labels[3] = {button0, button1, button2};
	_Init(text, labels, widthStyle, spacing, type);
}

void BAlert::_Init(const char* text, const char* const labels[3], button_width widthStyle,
	button_spacing spacing, alert_type type)
{
	BPrivate::AlertData& data = *fAlertData;
	// The buttons that are given, leftmost first; at least one.
	float widths[3];
	float widest = 0;
	float height = 0;
	for (int32 i = 0; i < 3; i++) {
		if (labels[i] == nullptr)
			break;
		BMessage* message = new BMessage(kButtonPressed);
		message->AddInt32("which", i);
		BButton* button = new BButton(BRect(0, 0, 74, 23), labels[i], labels[i], message,
			B_FOLLOW_RIGHT | B_FOLLOW_BOTTOM);
		data.buttons[data.count++] = button;
	}
	if (data.count == 0)
		data.buttons[data.count++] = new BButton(BRect(0, 0, 74, 23), "", "",
			new BMessage(kButtonPressed), B_FOLLOW_RIGHT | B_FOLLOW_BOTTOM);
	data.buttons[data.count - 1]->MakeDefault(true);
	for (int32 i = 0; i < data.count; i++) {
		BButton* button = data.buttons[i];
		button->GetPreferredSize(&widths[i], nullptr);
		if (widthStyle == B_WIDTH_FROM_LABEL) {
			widths[i] = std::ceil(button->StringWidth(button->Label())) + 20
				+ (button->IsDefault() ? 4 : 0);
		}
		widest = std::max(widest, widths[i]);
		float buttonHeight;
		button->GetPreferredSize(nullptr, &buttonHeight);
		height = std::max(height, buttonHeight);
	}
	float total = 0;
	for (int32 i = 0; i < data.count; i++) {
		if (widthStyle == B_WIDTH_FROM_WIDEST)
			widths[i] = widest;
		total += widths[i] + (i > 0 ? kButtonGap : 0);
	}
	if (spacing == B_OFFSET_SPACING && data.count > 1)
		total += kOffsetGap;

	float width = std::max(kWidth, kStripeWidth + 2 * kMargin + total);
	float textLeft = type == B_EMPTY_ALERT ? kMargin : kTextLeft;
	BRect textFrame(textLeft, kMargin, width - kMargin, kMargin + 10);
	BTextView* textView = new BTextView(textFrame, "_tv_",
		textFrame.OffsetToCopy(0, 0), B_FOLLOW_LEFT_RIGHT | B_FOLLOW_TOP, B_WILL_DRAW);
	textView->SetViewColor(look::kFace);
	textView->MakeEditable(false);
	textView->MakeSelectable(false);
	textView->SetText(text);
	float textHeight = textView->TextHeight(0, textView->CountLines() - 1);
	textView->ResizeTo(textFrame.Width(), textHeight - 1);
	data.textView = textView;

	float contentBottom = std::max(kMargin + textHeight,
		type == B_EMPTY_ALERT ? 0 : kIconPosition.y + 32);
	float buttonsTop = std::ceil(contentBottom) + 12;
	BRect bounds(0, 0, width - 1, buttonsTop + height + kMargin - 1);
	AlertView* background = new AlertView(bounds, type);
	background->AddChild(textView);
	// From the right edge leftwards; buttons share a middle line.
	float right = bounds.right - kMargin;
	for (int32 i = data.count - 1; i >= 0; i--) {
		float buttonHeight;
		data.buttons[i]->GetPreferredSize(nullptr, &buttonHeight);
		float top = std::floor(buttonsTop + (height - buttonHeight) / 2);
		data.buttons[i]->ResizeTo(widths[i] - 1, buttonHeight - 1);
		data.buttons[i]->MoveTo(right - widths[i] + 1, top);
		right -= widths[i] + kButtonGap + (i == 1 && spacing == B_OFFSET_SPACING ? kOffsetGap : 0);
		background->AddChild(data.buttons[i]);
	}
	ResizeTo(bounds.Width(), bounds.Height());
	MoveTo(AlertPosition(bounds.Width() + 1, bounds.Height() + 1));
	AddChild(background);
}

BAlert::~BAlert()
{
	// Closed some other way, a synchronous Go still returns.
	if (fAlertData->outcome != nullptr)
		fAlertData->outcome->handoff.Signal();
}

void BAlert::MessageReceived(BMessage* message)
{
	if (message->what == kButtonPressed)
		_Pressed(message->GetInt32("which", 0));
	else
		BWindow::MessageReceived(message);
}

void BAlert::DispatchMessage(BMessage* message, BHandler* handler)
{
	if (message->what == B_KEY_DOWN) {
		char key = message->GetString("bytes", "")[0];
		for (int32 i = 0; i < fAlertData->count; i++) {
			char shortcut = fAlertData->shortcuts[i];
			if (shortcut != 0 && tolower(uint8(shortcut)) == tolower(uint8(key))) {
				const char enter[] = {B_ENTER, '\0'};
				fAlertData->buttons[i]->KeyDown(enter, 1);
				return;
			}
		}
	}
	BWindow::DispatchMessage(message, handler);
}

void BAlert::SetShortcut(int32 index, char key)
{
	if (index >= 0 && index < fAlertData->count)
		fAlertData->shortcuts[index] = key;
}

char BAlert::Shortcut(int32 index) const
{
	return index >= 0 && index < fAlertData->count ? fAlertData->shortcuts[index] : 0;
}

int32 BAlert::Go()
{
	std::shared_ptr<BPrivate::AlertOutcome> outcome
		= std::make_shared<BPrivate::AlertOutcome>();
	fAlertData->outcome = outcome;
	Show();
	outcome->handoff.Wait();
	return outcome->which;
}

status_t BAlert::Go(BInvoker* invoker)
{
	fAlertData->invoker.reset(invoker);
	Show();
	return B_OK;
}

BButton* BAlert::ButtonAt(int32 index) const
{
	return index >= 0 && index < fAlertData->count ? fAlertData->buttons[index] : nullptr;
}

BTextView* BAlert::TextView() const
{
	return fAlertData->textView;
}

BPoint BAlert::AlertPosition(float width, float height)
{
	BRect screen = BScreen().Frame();
	return BPoint(std::floor(screen.left + (screen.Width() + 1 - width) / 2),
		std::floor(screen.top + (screen.Height() + 1 - height) / 3));
}

void BAlert::_Pressed(int32 index)
{
	BPrivate::AlertData& data = *fAlertData;
	if (data.outcome != nullptr) {
		data.outcome->which = index;
		data.outcome->handoff.Signal();
		data.outcome.reset();
	} else if (data.invoker != nullptr && data.invoker->Message() != nullptr) {
		BMessage copy(*data.invoker->Message());
		copy.AddInt32("which", index);
		data.invoker->Invoke(&copy);
	}
	// Off the screen at once, no longer blocking the other windows.
	Hide();
	Quit();
}
