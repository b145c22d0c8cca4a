#include "GvRenView.h"

#include <Message.h>
#include <Window.h>

#include "Commands.h"

namespace {

BRect TextRectFor(BRect frame)
{
	BRect textRect = frame.OffsetToCopy(0, 0);
	textRect.InsetBy(2, 2);
	return textRect;
}

}

GvRenView::GvRenView(const BFont& font, BRect frame)
	: BTextView(frame, "", TextRectFor(frame), B_FOLLOW_LEFT_RIGHT | B_FOLLOW_TOP,
		B_WILL_DRAW | B_NAVIGABLE)
{
	SetFontAndColor(&font, B_FONT_ALL);
	MakeResizable(true);
}

void GvRenView::DetachedFromWindow()
{
	SelectAll();
	Delete();
	BTextView::DetachedFromWindow();
}

void GvRenView::Draw(BRect updateRect)
{
	StrokeRect(Bounds(), B_SOLID_HIGH);
	BTextView::Draw(updateRect);
}

void GvRenView::KeyDown(const char* bytes, int32 numBytes)
{
	switch (bytes[0]) {
		case B_ENTER:
		{
			BView* pane = Parent();
			BMessage message(GV_RENAMED);
			message.AddString(GV_NAME, Text());
			message.AddFloat(GV_POSITION, ConvertToParent(BPoint(0, 0)).y);
			Window()->PostMessage(&message, pane);
			RemoveSelf();
			break;
		}
		case B_ESCAPE:
			RemoveSelf();
			break;
		default:
			BTextView::KeyDown(bytes, numBytes);
	}
}
