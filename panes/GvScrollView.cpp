#include "GvScrollView.h"

#include <ScrollBar.h>

#include "GvTargetView.h"
#include "Look.h"

namespace {
// The thickness of a scroll bar's rectangle; it covers 15 pixels.
const float kBarSize = 14;
}

GvScrollView::GvScrollView(const char* name, GvTargetView* pane, uint32 resizingMode)
	: BView(pane->Frame(), name, resizingMode, B_WILL_DRAW | B_FRAME_EVENTS),
	  borderRect(0, 0, -1, -1),
	  borderShown(false),
	  target(pane),
	  hbar(NULL),
	  vbar(NULL)
{
	SetHighColor(GV_FOCUS);
	SetLowColor(GV_GREY);

	target->MoveTo(0, 0);
	borderRect = target->Bounds();
	target->ResizeBy(-2, -2);
	target->MoveBy(1, 1);

	BRect horizontal(0, 0, borderRect.Width(), kBarSize);
	horizontal.OffsetBy(0, borderRect.Height() + 1);
	BRect vertical(0, 0, kBarSize, borderRect.Height());
	vertical.OffsetBy(borderRect.Width() + 1, 0);
	hbar = new BScrollBar(horizontal, "hbar", target, 0, 0, B_HORIZONTAL);
	vbar = new BScrollBar(vertical, "vbar", target, 0, 0, B_VERTICAL);

	ResizeBy(kBarSize + 1, kBarSize + 1);

	AddChild(target);
	AddChild(vbar);
	AddChild(hbar);
	target->scrollFrame = this;
}

void GvScrollView::Draw(BRect)
{
	StrokeRect(borderRect, borderShown ? B_SOLID_HIGH : B_SOLID_LOW);
}

void GvScrollView::FrameResized(float width, float height)
{
	borderRect.right = width - (kBarSize + 1);
	borderRect.bottom = height - (kBarSize + 1);
	Invalidate();
}

void GvScrollView::SetBorder(bool shown)
{
	if (shown == borderShown)
		return;
	borderShown = shown;
	Invalidate();
}
