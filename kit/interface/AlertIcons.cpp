#include "AlertIcons.h"

#include <View.h>

#include "ControlLook.h"
#include "ViewData.h"

namespace BPrivate {

namespace {

constexpr rgb_color kOutline = {0, 0, 0, 255};
constexpr rgb_color kWhite = {255, 255, 255, 255};
constexpr rgb_color kInfoBlue = {0, 90, 200, 255};
constexpr rgb_color kBulbYellow = {255, 220, 0, 255};
constexpr rgb_color kWarningYellow = {255, 200, 0, 255};
constexpr rgb_color kStopRed = {210, 0, 0, 255};
constexpr rgb_color kSocketGrey = {150, 150, 150, 255};

// A disc with a one-pixel outline.
void Disc(BView* view, BRect rect, rgb_color fill)
{
	ControlLook::FillEllipse(view, rect, kOutline);
	ControlLook::FillEllipse(view, rect.InsetByCopy(1, 1), fill);
}

void Fill(BView* view, BRect rect, rgb_color color)
{
	view->SetHighColor(color);
	view->FillRect(rect);
}

}

void DrawAlertIcon(BView* view, BPoint leftTop, alert_type type)
{
	StateGuard state(view);
	view->SetDrawingMode(B_OP_COPY);
	view->SetPenSize(1);
	auto at = [leftTop](float left, float top, float right, float bottom) {
		return BRect(left, top, right, bottom).OffsetByCopy(leftTop);
	};
	switch (type) {
		case B_INFO_ALERT:
			Disc(view, at(0, 0, 31, 31), kInfoBlue);
			ControlLook::FillEllipse(view, at(14, 5, 17, 8), kWhite);
			Fill(view, at(14, 12, 17, 24), kWhite);
			Fill(view, at(12, 24, 19, 25), kWhite);
			break;
		case B_IDEA_ALERT:
			Disc(view, at(4, 0, 27, 23), kBulbYellow);
			Fill(view, at(10, 20, 21, 24), kBulbYellow);
			ControlLook::FillEllipse(view, at(9, 5, 13, 10), kWhite);
			Fill(view, at(10, 25, 21, 30), kSocketGrey);
			view->SetHighColor(kOutline);
			view->StrokeRect(at(10, 25, 21, 30));
			view->StrokeLine(at(10, 27, 21, 27).LeftTop(), at(10, 27, 21, 27).RightTop());
			view->StrokeLine(at(9, 20, 9, 24).LeftTop(), at(9, 20, 9, 24).LeftBottom());
			view->StrokeLine(at(22, 20, 22, 24).LeftTop(), at(22, 20, 22, 24).LeftBottom());
			break;
		case B_WARNING_ALERT:
			ControlLook::FillTriangle(view, leftTop + BPoint(15.5f, 0), leftTop + BPoint(0, 30),
				leftTop + BPoint(31, 30), kOutline);
			ControlLook::FillTriangle(view, leftTop + BPoint(15.5f, 3), leftTop + BPoint(3, 29),
				leftTop + BPoint(28, 29), kWarningYellow);
			Fill(view, at(14, 10, 17, 20), kOutline);
			Fill(view, at(14, 23, 17, 26), kOutline);
			break;
		case B_STOP_ALERT:
			Disc(view, at(0, 0, 31, 31), kStopRed);
			Fill(view, at(6, 13, 25, 18), kWhite);
			break;
		case B_EMPTY_ALERT:
			break;
	}
}

}
