#ifndef _STATUS_BAR_H
#define _STATUS_BAR_H

#include <memory>

#include <View.h>

namespace BPrivate {
struct StatusBarData;
}

// A progress bar with a line of text above it: on the left the label
// followed by the text, on the right the trailing text followed by the
// trailing label. The value runs from 0 to the maximum (100 by default).
// Posted messages drive it from other threads: B_UPDATE_STATUS_BAR with
// float "delta" and optional strings "text" and "trailing_text" calls
// Update; B_RESET_STATUS_BAR with optional strings "label" and
// "trailing_label" calls Reset.
class BStatusBar : public BView {
public:
	BStatusBar(BRect frame, const char* name, const char* label = NULL,
		const char* trailingLabel = NULL);
	virtual ~BStatusBar();

	// Takes the height the text and the bar need.
	virtual void AttachedToWindow();
	virtual void Draw(BRect updateRect);
	virtual void MessageReceived(BMessage* message);

	virtual void SetBarColor(rgb_color color);
	rgb_color BarColor() const;
	virtual void SetBarHeight(float height);
	float BarHeight() const;
	virtual void SetText(const char* string);
	const char* Text() const;
	virtual void SetTrailingText(const char* string);
	const char* TrailingText() const;
	virtual void SetMaxValue(float max);
	float MaxValue() const;
	float CurrentValue() const;
	const char* Label() const;
	const char* TrailingLabel() const;

	// Adds delta to the value, which stays within 0 and the maximum; text and
	// trailingText replace the texts when given.
	virtual void Update(float delta, const char* text = NULL,
		const char* trailingText = NULL);
	// Back to value 0 and maximum 100 with no texts, and new labels.
	virtual void Reset(const char* label = NULL, const char* trailingLabel = NULL);

	virtual void GetPreferredSize(float* width, float* height);

private:
	void _SetValue(float value);

	std::unique_ptr<BPrivate::StatusBarData> fStatusBarData;
};

#endif
