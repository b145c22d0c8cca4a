#include <ScrollBar.h>

#include <algorithm>
#include <cmath>

#include <Message.h>
#include <Window.h>

#include "AutoRepeat.h"
#include "ControlLook.h"
#include "ViewData.h"

namespace look = BPrivate::ControlLook;

namespace {

constexpr uint32 kRepeat = '_SBR';
constexpr float kMinThumb = 12;

enum class Part {
	kNone,
	kLessArrow,
	kMoreArrow,
	kLessTrack,
	kMoreTrack,
	kThumb
};

}

namespace BPrivate {

struct ScrollBarData final : ScrollFollower {
	BScrollBar* bar = nullptr;
	BView* target = nullptr;
	orientation direction = B_VERTICAL;
	float value = 0;
	float min = 0;
	float max = 0;
	float proportion = 0;
	float smallStep = 1;
	float largeStep = 10;
	// Set while the target's own scrolling moves the bar.
	bool following = false;

	Part pressed = Part::kNone;
	// Along the bar: where the pointer holds the thumb, and where it is now.
	float grip = 0;
	float pointer = 0;
	std::unique_ptr<AutoRepeat> repeat;

	void TargetScrolled(BPoint origin) override
	{
		following = true;
		bar->SetValue(direction == B_VERTICAL ? origin.y : origin.x);
		following = false;
	}

	void TargetDeleted() override { target = nullptr; }

	// Positions along the bar, in its own coordinates.
	float Length() const
	{
		BRect bounds = bar->Bounds();
		return direction == B_VERTICAL ? bounds.Height() : bounds.Width();
	}
	float Thickness() const
	{
		BRect bounds = bar->Bounds();
		return direction == B_VERTICAL ? bounds.Width() : bounds.Height();
	}
	float Along(BPoint point) const
	{
		BRect bounds = bar->Bounds();
		return direction == B_VERTICAL ? point.y - bounds.top : point.x - bounds.left;
	}
	BRect Span(float from, float to) const
	{
		BRect bounds = bar->Bounds();
		return direction == B_VERTICAL
			? BRect(bounds.left, bounds.top + from, bounds.right, bounds.top + to)
			: BRect(bounds.left + from, bounds.top, bounds.left + to, bounds.bottom);
	}
	// The same within the bar's outline.
	BRect Inside(float from, float to) const
	{
		return Span(from, to).InsetByCopy(direction == B_VERTICAL ? 1 : 0,
			direction == B_VERTICAL ? 0 : 1);
	}

	float TrackStart() const { return Thickness() + 1; }
	float TrackEnd() const { return Length() - Thickness() - 1; }
	bool HasThumb() const
	{
		return max > min && TrackEnd() - TrackStart() + 1 >= kMinThumb;
	}
	float ThumbLength() const
	{
		float track = TrackEnd() - TrackStart() + 1;
		float length = proportion > 0 ? std::round(track * proportion) : track / 4;
		return std::clamp(length, kMinThumb, track);
	}
	float ThumbStart() const
	{
		float room = TrackEnd() - TrackStart() + 1 - ThumbLength();
		return TrackStart() + std::round((value - min) / (max - min) * room);
	}

	Part PartAt(float along) const
	{
		if (along < TrackStart())
			return Part::kLessArrow;
		if (along > TrackEnd())
			return Part::kMoreArrow;
		if (!HasThumb())
			return Part::kNone;
		float thumb = ThumbStart();
		if (along < thumb)
			return Part::kLessTrack;
		return along < thumb + ThumbLength() ? Part::kThumb : Part::kMoreTrack;
	}

	// One step of the part held down; track steps stop under the pointer.
	void Step()
	{
		switch (pressed) {
			case Part::kLessArrow:
				bar->SetValue(value - smallStep);
				break;
			case Part::kMoreArrow:
				bar->SetValue(value + smallStep);
				break;
			case Part::kLessTrack:
				if (pointer < ThumbStart())
					bar->SetValue(value - largeStep);
				break;
			case Part::kMoreTrack:
				if (pointer >= ThumbStart() + ThumbLength())
					bar->SetValue(value + largeStep);
				break;
			default:
				break;
		}
	}

	void DragThumbTo(float along)
	{
		float room = TrackEnd() - TrackStart() + 1 - ThumbLength();
		if (room <= 0)
			return;
		float start = along - grip;
		bar->SetValue(min + (start - TrackStart()) / room * (max - min));
	}

	void Release()
	{
		repeat.reset();
		if (pressed != Part::kNone) {
			pressed = Part::kNone;
			bar->Invalidate();
		}
	}

	void DrawArrowBox(BRect box, bool less, bool down)
	{
		bar->SetHighColor(look::kFace);
		bar->FillRect(box);
		look::DrawBevel(bar, box, !down);
		char arrow = direction == B_VERTICAL ? (less ? B_UP_ARROW : B_DOWN_ARROW)
			: (less ? B_LEFT_ARROW : B_RIGHT_ARROW);
		look::DrawArrow(bar, box, arrow, max > min ? look::kText : look::kShadow);
	}
};

}

using BPrivate::ScrollBarData;

BScrollBar::BScrollBar(BRect frame, const char* name, BView* target, float min, float max,
	orientation direction)
	:
	BView(frame, name, direction == B_VERTICAL
		? B_FOLLOW_TOP_BOTTOM | B_FOLLOW_RIGHT : B_FOLLOW_LEFT_RIGHT | B_FOLLOW_BOTTOM,
		B_WILL_DRAW | B_FULL_UPDATE_ON_RESIZE | B_FRAME_EVENTS),
	fScrollBarData(std::make_unique<ScrollBarData>())
{
	fScrollBarData->bar = this;
	fScrollBarData->direction = direction;
	SetViewColor(B_TRANSPARENT_COLOR);
	SetRange(min, max);
	SetTarget(target);
}

BScrollBar::~BScrollBar()
{
	SetTarget(nullptr);
}

void BScrollBar::DetachedFromWindow()
{
	fScrollBarData->Release();
	BView::DetachedFromWindow();
}

void BScrollBar::Draw(BRect)
{
	ScrollBarData& data = *fScrollBarData;
	BPrivate::StateGuard state(this);
	SetDrawingMode(B_OP_COPY);
	SetPenSize(1);
	BRect bounds = Bounds();
	float thickness = data.Thickness();

	SetHighColor(look::kShadow);
	StrokeRect(bounds);
	data.DrawArrowBox(data.Inside(1, thickness - 1), true, data.pressed == Part::kLessArrow);
	data.DrawArrowBox(data.Inside(data.Length() - thickness + 1, data.Length() - 1), false,
		data.pressed == Part::kMoreArrow);
	// The lines between the arrows and the track.
	SetHighColor(look::kShadow);
	for (float along : {data.TrackStart() - 1, data.TrackEnd() + 1}) {
		BRect line = data.Span(along, along);
		StrokeLine(line.LeftTop(), line.RightBottom());
	}
	BRect track = data.Inside(data.TrackStart(), data.TrackEnd());
	if (!track.IsValid())
		return;
	SetHighColor(look::kLightShadow);
	FillRect(track);
	if (!data.HasThumb())
		return;

	float start = data.ThumbStart();
	BRect thumb = data.Inside(start, start + data.ThumbLength() - 1);
	SetHighColor(look::kFace);
	FillRect(thumb);
	look::DrawBevel(this, thumb.InsetByCopy(1, 1), true);
	SetHighColor(look::kShadow);
	StrokeRect(thumb);
	// Three grip lines across the middle of the thumb.
	BPoint middle((thumb.left + thumb.right) / 2, (thumb.top + thumb.bottom) / 2);
	middle.x = std::floor(middle.x);
	middle.y = std::floor(middle.y);
	for (float offset = -2; offset <= 2; offset += 2) {
		if (data.direction == B_VERTICAL) {
			StrokeLine(BPoint(thumb.left + 3, middle.y + offset),
				BPoint(thumb.right - 3, middle.y + offset));
		} else {
			StrokeLine(BPoint(middle.x + offset, thumb.top + 3),
				BPoint(middle.x + offset, thumb.bottom - 3));
		}
	}
}

void BScrollBar::MouseDown(BPoint where)
{
	ScrollBarData& data = *fScrollBarData;
	if (data.max <= data.min)
		return;
	data.pointer = data.Along(where);
	data.pressed = data.PartAt(data.pointer);
	if (data.pressed == Part::kThumb) {
		data.grip = data.pointer - data.ThumbStart();
		Invalidate();
		return;
	}
	Invalidate();
	data.Step();
	if (data.pressed != Part::kNone)
		data.repeat = std::make_unique<BPrivate::AutoRepeat>(BMessenger(this), kRepeat);
}

void BScrollBar::MouseMoved(BPoint where, uint32, const BMessage*)
{
	ScrollBarData& data = *fScrollBarData;
	if (data.pressed == Part::kNone)
		return;
	data.pointer = data.Along(where);
	if (data.pressed == Part::kThumb)
		data.DragThumbTo(data.pointer);
}

void BScrollBar::MouseUp(BPoint)
{
	fScrollBarData->Release();
}

void BScrollBar::FrameResized(float, float)
{
	Invalidate();
}

void BScrollBar::MessageReceived(BMessage* message)
{
	if (message->what == kRepeat)
		fScrollBarData->Step();
	else
		BView::MessageReceived(message);
}

void BScrollBar::SetValue(float value)
{
	ScrollBarData& data = *fScrollBarData;
	value = std::clamp(value, data.min, data.max);
	if (value == data.value)
		return;
	data.value = value;
	Invalidate();
	ValueChanged(value);
}

float BScrollBar::Value() const
{
	return fScrollBarData->value;
}

void BScrollBar::SetProportion(float proportion)
{
	proportion = std::clamp(proportion, 0.0f, 1.0f);
	if (proportion == fScrollBarData->proportion)
		return;
	fScrollBarData->proportion = proportion;
	Invalidate();
}

float BScrollBar::Proportion() const
{
	return fScrollBarData->proportion;
}

void BScrollBar::ValueChanged(float newValue)
{
	ScrollBarData& data = *fScrollBarData;
	if (data.target == nullptr || data.following)
		return;
	BPoint origin = data.target->Bounds().LeftTop();
	if (data.direction == B_VERTICAL)
		origin.y = newValue;
	else
		origin.x = newValue;
	data.target->ScrollTo(origin);
}

void BScrollBar::SetRange(float min, float max)
{
	ScrollBarData& data = *fScrollBarData;
	data.min = min;
	data.max = std::max(min, max);
	Invalidate();
	SetValue(data.value);
}

void BScrollBar::GetRange(float* min, float* max) const
{
	if (min != nullptr)
		*min = fScrollBarData->min;
	if (max != nullptr)
		*max = fScrollBarData->max;
}

void BScrollBar::SetSteps(float smallStep, float largeStep)
{
	fScrollBarData->smallStep = smallStep;
	fScrollBarData->largeStep = largeStep;
}

void BScrollBar::GetSteps(float* smallStep, float* largeStep) const
{
	if (smallStep != nullptr)
		*smallStep = fScrollBarData->smallStep;
	if (largeStep != nullptr)
		*largeStep = fScrollBarData->largeStep;
}

void BScrollBar::SetTarget(BView* target)
{
	ScrollBarData& data = *fScrollBarData;
	if (data.target != nullptr) {
		BPrivate::ScrollFollower*& link
			= BPrivate::ViewAccess::Data(data.target).scrollBars[data.direction];
		if (link == &data)
			link = nullptr;
	}
	data.target = target;
	if (target != nullptr)
		BPrivate::ViewAccess::Data(target).scrollBars[data.direction] = &data;
}

BView* BScrollBar::Target() const
{
	return fScrollBarData->target;
}

orientation BScrollBar::Orientation() const
{
	return fScrollBarData->direction;
}

// Only scroll bars follow views, so every follower is a scroll bar's.
BScrollBar* BView::ScrollBar(orientation posture) const
{
	BPrivate::ScrollFollower* follower = fViewData->scrollBars[posture];
	return follower != nullptr ? static_cast<ScrollBarData*>(follower)->bar : nullptr;
}

namespace BPrivate {

bool ScrollByWheel(BView* view, const BMessage* wheel)
{
	bool scrolled = false;
	const struct {
		const char* field;
		orientation direction;
	} axes[] = {{"be:wheel_delta_y", B_VERTICAL}, {"be:wheel_delta_x", B_HORIZONTAL}};
	for (const auto& axis : axes) {
		float delta = wheel->GetFloat(axis.field, 0);
		BScrollBar* bar = view->ScrollBar(axis.direction);
		if (bar == nullptr || delta == 0)
			continue;
		// Three small steps a notch, as the arrows would.
		float step;
		bar->GetSteps(&step, nullptr);
		bar->SetValue(bar->Value() + delta * step * 3);
		scrolled = true;
	}
	return scrolled;
}

}
