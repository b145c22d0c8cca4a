#ifndef _ALERT_H
#define _ALERT_H

#include <memory>

#include <Window.h>

class BButton;
class BInvoker;
class BTextView;

namespace BPrivate {
struct AlertData;
}

enum alert_type {
	B_EMPTY_ALERT = 0,
	B_INFO_ALERT,
	B_IDEA_ALERT,
	B_WARNING_ALERT,
	B_STOP_ALERT
};

enum button_spacing {
	B_EVEN_SPACING = 0,
	B_OFFSET_SPACING
};

enum button_width {
	B_WIDTH_AS_USUAL,
	B_WIDTH_FROM_WIDEST,
	B_WIDTH_FROM_LABEL
};

// A modal panel with an icon for its type, a text (with line breaks where
// it has newlines) and up to three buttons, numbered 0 to 2 from the left.
// The rightmost button is the default one: Enter presses it. Other keys
// press a button only when SetShortcut gave it one (an alert with a Cancel
// button would give it B_ESCAPE). Allocate it with new: it deletes itself
// once a button is pressed.
class BAlert : public BWindow {
public:
	BAlert(const char* title, const char* text, const char* button0,
		const char* button1 = NULL, const char* button2 = NULL,
		button_width widthStyle = B_WIDTH_AS_USUAL, alert_type type = B_INFO_ALERT);
	BAlert(const char* title, const char* text, const char* button0, const char* button1,
		const char* button2, button_width widthStyle, button_spacing spacing,
		alert_type type = B_INFO_ALERT);
	virtual ~BAlert();

	virtual void MessageReceived(BMessage* message);
	virtual void DispatchMessage(BMessage* message, BHandler* handler);

	void SetShortcut(int32 index, char key);
	char Shortcut(int32 index) const;

	// Shows the alert and blocks the calling thread until a button is
	// pressed; returns its index. The calling window keeps showing what it
	// showed meanwhile.
	int32 Go();
	// Shows the alert and returns at once. The pressed button's index is
	// added as "which" (int32) to a copy of invoker's message, which is then
	// sent; the alert deletes the invoker. NULL sends nothing.
	status_t Go(BInvoker* invoker);

	BButton* ButtonAt(int32 index) const;
	BTextView* TextView() const;

	// Where an alert of this size goes: centred across the screen, a little
	// above the middle.
	static BPoint AlertPosition(float width, float height);

private:
	void _Init(const char* text, const char* const labels[3], button_width widthStyle,
		button_spacing spacing, alert_type type);
	void _Pressed(int32 index);

	std::unique_ptr<BPrivate::AlertData> fAlertData;
};

#endif
