#include "ControlLook.h"

#include <algorithm>
#include <cmath>

#include <InterfaceDefs.h>
#include <View.h>

namespace BPrivate::ControlLook {

void DrawBevel(BView* view, BRect rect, bool raised)
{
	view->SetHighColor(raised ? kLight : kShadow);
	view->StrokeLine(rect.LeftBottom(), rect.LeftTop());
	view->StrokeLine(rect.LeftTop(), rect.RightTop());
	view->SetHighColor(raised ? kShadow : kLight);
	view->StrokeLine(rect.RightTop() + BPoint(0, 1), rect.RightBottom());
	view->StrokeLine(rect.RightBottom(), rect.LeftBottom() + BPoint(1, 0));
}

void FillTriangle(BView* view, BPoint a, BPoint b, BPoint c, rgb_color color)
{
	view->SetHighColor(color);
	const BPoint corners[3] = {a, b, c};
	float top = std::min({a.y, b.y, c.y});
	float bottom = std::max({a.y, b.y, c.y});
	for (float y = std::floor(top); y <= bottom; y++) {
		// Where the row through the pixel centres crosses the edges.
		float left = 1e9f;
		float right = -1e9f;
		for (int i = 0; i < 3; i++) {
			BPoint p = corners[i];
			BPoint q = corners[(i + 1) % 3];
			if (p.y == q.y) {
				if (y == p.y) {
					left = std::min({left, p.x, q.x});
					right = std::max({right, p.x, q.x});
				}
				continue;
			}
			if (y < std::min(p.y, q.y) || y > std::max(p.y, q.y))
				continue;
			float x = p.x + (y - p.y) * (q.x - p.x) / (q.y - p.y);
			left = std::min(left, x);
			right = std::max(right, x);
		}
		if (left <= right)
			view->StrokeLine(BPoint(std::round(left), y), BPoint(std::round(right), y));
	}
}

void FillEllipse(BView* view, BRect rect, rgb_color color)
{
	view->SetHighColor(color);
	float cx = (rect.left + rect.right) / 2;
	float cy = (rect.top + rect.bottom) / 2;
	float rx = rect.Width() / 2 + 0.5f;
	float ry = rect.Height() / 2 + 0.5f;
	for (float y = rect.top; y <= rect.bottom; y++) {
		float dy = (y - cy) / ry;
		if (dy * dy > 1)
			continue;
		float half = rx * std::sqrt(1 - dy * dy);
		view->StrokeLine(BPoint(std::round(cx - half + 0.25f), y),
			BPoint(std::round(cx + half - 0.25f), y));
	}
}

void DrawArrow(BView* view, BRect rect, char direction, rgb_color color)
{
	BPoint center((rect.left + rect.right) / 2, (rect.top + rect.bottom) / 2);
	float size = std::floor(std::min(rect.Width(), rect.Height()) / 2) - 1;
	float half = size / 2;
	center.x = std::floor(center.x);
	center.y = std::floor(center.y);
	switch (direction) {
		case B_UP_ARROW:
			FillTriangle(view, center + BPoint(0, -half), center + BPoint(-size, half),
				center + BPoint(size, half), color);
			break;
		case B_DOWN_ARROW:
			FillTriangle(view, center + BPoint(0, half), center + BPoint(-size, -half),
				center + BPoint(size, -half), color);
			break;
		case B_LEFT_ARROW:
			FillTriangle(view, center + BPoint(-half, 0), center + BPoint(half, -size),
				center + BPoint(half, size), color);
			break;
		default:
			FillTriangle(view, center + BPoint(half, 0), center + BPoint(-half, -size),
				center + BPoint(-half, size), color);
			break;
	}
}

float CenteredBaseline(const BView* view, BRect rect)
{
	font_height height;
	view->GetFontHeight(&height);
	float textHeight = std::ceil(height.ascent) + std::ceil(height.descent);
	return std::floor(rect.top + (rect.Height() + 1 - textHeight) / 2 + height.ascent);
}

}
