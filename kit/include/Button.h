#ifndef _BUTTON_H
#define _BUTTON_H

#include <memory>

#include <Control.h>

namespace BPrivate {
struct ButtonData;
}

// A push button: clicking it, or Space and Enter while it has the focus,
// invokes it. The window's default button also answers Enter wherever the
// focus is, and wears a dark ring inside its frame.
class BButton : public BControl {
public:
	BButton(BRect frame, const char* name, const char* label, BMessage* message,
		uint32 resizingMode = B_FOLLOW_LEFT | B_FOLLOW_TOP,
		uint32 flags = B_WILL_DRAW | B_NAVIGABLE);
	virtual ~BButton();

	virtual void AttachedToWindow();
	virtual void DetachedFromWindow();
	virtual void Draw(BRect updateRect);
	virtual void MouseDown(BPoint where);
	virtual void MouseMoved(BPoint where, uint32 transit, const BMessage* dragMessage);
	virtual void MouseUp(BPoint where);
	virtual void KeyDown(const char* bytes, int32 numBytes);
	virtual void WindowActivated(bool active);

	// The window has one default button at a time: making this one the
	// default takes the part from the previous one.
	virtual void MakeDefault(bool flag);
	bool IsDefault() const;

	virtual void GetPreferredSize(float* width, float* height);

private:
	std::unique_ptr<BPrivate::ButtonData> fButtonData;
};

#endif
