#ifndef _CONTROL_H
#define _CONTROL_H

#include <memory>

#include <Invoker.h>
#include <View.h>

namespace BPrivate {
struct ControlData;
}

enum {
	B_CONTROL_OFF = 0,
	B_CONTROL_ON = 1
};

// A view the user operates to send its message: a label, a value and an
// enabled state. Attached to a window without a target of its own, it
// targets the window, and it takes the view and low colours of its parent.
class BControl : public BView, public BInvoker {
public:
	BControl(BRect frame, const char* name, const char* label, BMessage* message,
		uint32 resizingMode, uint32 flags);
	virtual ~BControl();

	virtual void AttachedToWindow();
	virtual void MakeFocus(bool focus = true);
	// Space and Enter toggle the value and invoke.
	virtual void KeyDown(const char* bytes, int32 numBytes);

	virtual void SetLabel(const char* label);
	const char* Label() const;
	virtual void SetValue(int32 value);
	int32 Value() const;
	// A disabled control ignores the mouse and the keyboard.
	virtual void SetEnabled(bool enabled);
	bool IsEnabled() const;

	// Adds "when" (int64) and "source" (the control, a pointer) to the copy
	// it sends.
	virtual status_t Invoke(BMessage* message = NULL);

private:
	std::unique_ptr<BPrivate::ControlData> fControlData;
};

#endif
