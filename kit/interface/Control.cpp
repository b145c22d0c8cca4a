#include <Control.h>

#include <string>

#include <Message.h>
#include <Window.h>

#include "InvokerPrivate.h"

namespace BPrivate {

struct ControlData {
	std::string label;
	int32 value = B_CONTROL_OFF;
	bool enabled = true;
};

}

BControl::BControl(BRect frame, const char* name, const char* label, BMessage* message,
	uint32 resizingMode, uint32 flags)
	:
	BView(frame, name, resizingMode, flags),
	BInvoker(message, BMessenger()),
	fControlData(std::make_unique<BPrivate::ControlData>())
{
	fControlData->label = label != nullptr ? label : "";
}

BControl::~BControl() = default;

void BControl::AttachedToWindow()
{
	if (Parent() != nullptr) {
		SetViewColor(Parent()->ViewColor());
		SetLowColor(Parent()->ViewColor());
	}
	if (!Messenger().IsValid())
		SetTarget(Window());
	BView::AttachedToWindow();
}

void BControl::MakeFocus(bool focus)
{
	if (focus == IsFocus())
		return;
	BView::MakeFocus(focus);
	Invalidate();
}

void BControl::KeyDown(const char* bytes, int32 numBytes)
{
	if (IsEnabled() && (bytes[0] == B_SPACE || bytes[0] == B_ENTER)) {
		SetValue(Value() == B_CONTROL_OFF ? B_CONTROL_ON : B_CONTROL_OFF);
		Invoke();
		return;
	}
	BView::KeyDown(bytes, numBytes);
}

void BControl::SetLabel(const char* label)
{
	fControlData->label = label != nullptr ? label : "";
	Invalidate();
}

const char* BControl::Label() const
{
	return fControlData->label.c_str();
}

void BControl::SetValue(int32 value)
{
	if (value == fControlData->value)
		return;
	fControlData->value = value;
	Invalidate();
}

int32 BControl::Value() const
{
	return fControlData->value;
}

void BControl::SetEnabled(bool enabled)
{
	if (enabled == fControlData->enabled)
		return;
	fControlData->enabled = enabled;
	if (!enabled && IsFocus())
		MakeFocus(false);
	Invalidate();
}

bool BControl::IsEnabled() const
{
	return fControlData->enabled;
}

status_t BControl::Invoke(BMessage* message)
{
	std::unique_ptr<BMessage> copy = BPrivate::StampedCopy(this, message, this);
	return copy != nullptr ? BInvoker::Invoke(copy.get()) : B_BAD_VALUE;
}
