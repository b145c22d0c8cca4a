#include "GvDragView.h"

#include <Bitmap.h>

#include <cstdio>

#include "Commands.h"
#include "Look.h"

namespace {
const rgb_color kBlack = { 0, 0, 0, 255 };
const BRect kBadge(10, 10, 19, 19);
const BPoint kNameOrigin(18, 11);
}

GvDragView::GvDragView(BRect frame, BBitmap* dragIcon, const char* dragName,
	int32 dragMode)
	: BView(frame, "", B_FOLLOW_NONE, 0),
	  mode(dragMode),
	  icon(dragIcon)
{
	std::snprintf(name, sizeof(name), "%s", dragName != NULL ? dragName : "");
}

GvDragView::~GvDragView()
{
	delete icon;
}

void GvDragView::AttachedToWindow()
{
	Draw(Bounds());
}

void GvDragView::Draw(BRect)
{
	if (mode == GV_COPY)
		DrawCopy();
	else if (mode == GV_LINK)
		DrawLink();
	else
		DrawMove();
	Sync();
}

void GvDragView::DrawCopy()
{
	DrawIcon();
	DrawBadge(BPoint(12, 15), BPoint(17, 15), BPoint(14, 12), BPoint(14, 17));
}

void GvDragView::DrawLink()
{
	DrawIcon();
	DrawBadge(BPoint(13, 12), BPoint(13, 17), BPoint(13, 17), BPoint(16, 17));
}

void GvDragView::DrawMove()
{
	DrawIcon();
	MovePenTo(kNameOrigin);
	DrawString(name);
}

// The start every image shares: grey background, icon drawn over it.
void GvDragView::DrawIcon()
{
	SetHighColor(kBlack);
	SetLowColor(GV_GREY);
	FillRect(Bounds(), B_SOLID_LOW);
	SetDrawingMode(B_OP_OVER);
	MovePenTo(0, 0);
	if (icon != NULL)
		DrawBitmap(icon);
}

// A framed square on the icon's corner with a two-stroke mark, then the name.
void GvDragView::DrawBadge(BPoint firstStart, BPoint firstEnd, BPoint secondStart,
	BPoint secondEnd)
{
	SetDrawingMode(B_OP_COPY);
	FillRect(kBadge, B_SOLID_LOW);
	StrokeRect(kBadge, B_SOLID_HIGH);
	SetPenSize(2);
	StrokeLine(firstStart, firstEnd, B_SOLID_HIGH);
	StrokeLine(secondStart, secondEnd, B_SOLID_HIGH);
	MovePenTo(kNameOrigin);
	DrawString(name);
}
