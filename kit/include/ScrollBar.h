#ifndef _SCROLL_BAR_H
#define _SCROLL_BAR_H

#include <memory>

#include <View.h>

namespace BPrivate {
struct ScrollBarData;
}

#define B_V_SCROLL_BAR_WIDTH 14.0f
#define B_H_SCROLL_BAR_HEIGHT 14.0f

// A scroll bar: an arrow at each end, and between them a track with a thumb
// whose size shows the visible proportion of the target. Its value is the
// target's scroll position along the bar's orientation: changing it scrolls
// the target, and the bar follows when the target scrolls itself. The
// target finds its bars with BView::ScrollBar.
class BScrollBar : public BView {
public:
	BScrollBar(BRect frame, const char* name, BView* target, float min, float max,
		orientation direction);
	virtual ~BScrollBar();

	virtual void DetachedFromWindow();
	virtual void Draw(BRect updateRect);
	virtual void MouseDown(BPoint where);
	virtual void MouseMoved(BPoint where, uint32 transit, const BMessage* dragMessage);
	virtual void MouseUp(BPoint where);
	virtual void FrameResized(float width, float height);
	virtual void MessageReceived(BMessage* message);

	// Clamped to the range.
	void SetValue(float value);
	float Value() const;
	// The visible part of the target, from 0 to 1; 0 when unknown.
	void SetProportion(float proportion);
	float Proportion() const;
	// Called whenever the value changes; scrolls the target, unless the change
	// comes from the target scrolling itself.
	virtual void ValueChanged(float newValue);

	// A range whose max is below min becomes empty (max = min); the bar then
	// shows no thumb and ignores the mouse.
	void SetRange(float min, float max);
	void GetRange(float* min, float* max) const;
	// The arrows move by smallStep, clicks in the track by largeStep.
	void SetSteps(float smallStep, float largeStep);
	void GetSteps(float* smallStep, float* largeStep) const;

	void SetTarget(BView* target);
	BView* Target() const;
	orientation Orientation() const;

private:
	std::unique_ptr<BPrivate::ScrollBarData> fScrollBarData;
};

#endif
