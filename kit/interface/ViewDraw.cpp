#include <View.h>

#include <cstring>

#include <Bitmap.h>
#include <Window.h>

#include "Painter.h"
#include "ViewData.h"
#include "WindowData.h"

using BPrivate::DrawState;
using BPrivate::Painter;
using BPrivate::ViewAccess;
using BPrivate::ViewData;
using BPrivate::WindowAccess;
using BPrivate::WindowData;

namespace {

// Runs draw with a painter for view, when the view can draw at all.
template <typename DrawFunction>
void Paint(const BView* view, DrawFunction draw)
{
	ViewData& data = ViewAccess::Data(view);
	if (data.window == nullptr)
		return;
	const WindowData& window = WindowAccess::Data(data.window);
	if (window.surface.bits == nullptr)
		return;
	const BPrivate::Region& clip = ViewAccess::DrawClip(view);
	if (clip.IsEmpty())
		return;
	Painter painter(window.surface, clip, ViewAccess::WindowOrigin(view), data.State());
	draw(painter);
	WindowAccess::Drawn(data.window, painter.Touched());
}

}

void BView::SetViewColor(rgb_color color)
{
	fViewData->viewColor = color;
}

void BView::SetViewColor(uint8 red, uint8 green, uint8 blue, uint8 alpha)
{
	SetViewColor(make_color(red, green, blue, alpha));
}

rgb_color BView::ViewColor() const
{
	return fViewData->viewColor;
}

void BView::SetHighColor(rgb_color color)
{
	fViewData->State().high = color;
}

void BView::SetHighColor(uint8 red, uint8 green, uint8 blue, uint8 alpha)
{
	SetHighColor(make_color(red, green, blue, alpha));
}

rgb_color BView::HighColor() const
{
	return fViewData->State().high;
}

void BView::SetLowColor(rgb_color color)
{
	fViewData->State().low = color;
}

void BView::SetLowColor(uint8 red, uint8 green, uint8 blue, uint8 alpha)
{
	SetLowColor(make_color(red, green, blue, alpha));
}

rgb_color BView::LowColor() const
{
	return fViewData->State().low;
}

void BView::SetDrawingMode(drawing_mode mode)
{
	fViewData->State().mode = mode;
}

drawing_mode BView::DrawingMode() const
{
	return fViewData->State().mode;
}

void BView::SetPenSize(float size)
{
	fViewData->State().penSize = max_c(size, 0.0f);
}

float BView::PenSize() const
{
	return fViewData->State().penSize;
}

void BView::MovePenTo(BPoint point)
{
	fViewData->State().pen = point;
}

void BView::MovePenTo(float x, float y)
{
	MovePenTo(BPoint(x, y));
}

void BView::MovePenBy(float x, float y)
{
	fViewData->State().pen += BPoint(x, y);
}

BPoint BView::PenLocation() const
{
	return fViewData->State().pen;
}

void BView::SetFont(const BFont* font, uint32 mask)
{
	if (font != nullptr)
		fViewData->State().font._SetFrom(*font, mask);
}

void BView::GetFont(BFont* font) const
{
	if (font != nullptr)
		*font = fViewData->State().font;
}

void BView::SetFontSize(float size)
{
	fViewData->State().font.SetSize(size);
}

void BView::GetFontHeight(font_height* height) const
{
	fViewData->State().font.GetHeight(height);
}

float BView::StringWidth(const char* string) const
{
	return fViewData->State().font.StringWidth(string);
}

float BView::StringWidth(const char* string, int32 length) const
{
	return fViewData->State().font.StringWidth(string, length);
}

void BView::PushState()
{
	fViewData->states.push_back(fViewData->State());
}

void BView::PopState()
{
	if (fViewData->states.size() > 1)
		fViewData->states.pop_back();
}

void BView::StrokeLine(BPoint toPoint, const pattern& p)
{
	StrokeLine(PenLocation(), toPoint, p);
}

void BView::StrokeLine(BPoint start, BPoint end, const pattern& p)
{
	Paint(this, [&](Painter& painter) { painter.StrokeLine(start, end, p); });
	MovePenTo(end);
}

void BView::StrokeRect(BRect rect, const pattern& p)
{
	Paint(this, [&](Painter& painter) { painter.StrokeRect(rect, p); });
}

void BView::FillRect(BRect rect, const pattern& p)
{
	Paint(this, [&](Painter& painter) { painter.FillRect(rect, p); });
}

void BView::InvertRect(BRect rect)
{
	Paint(this, [&](Painter& painter) { painter.InvertRect(rect); });
}

void BView::DrawString(const char* string)
{
	DrawString(string, PenLocation());
}

void BView::DrawString(const char* string, int32 length)
{
	DrawString(string, length, PenLocation());
}

void BView::DrawString(const char* string, BPoint where)
{
	if (string != nullptr)
		DrawString(string, int32(strlen(string)), where);
}

void BView::DrawString(const char* string, int32 length, BPoint where)
{
	if (string == nullptr || length <= 0)
		return;
	float advance = -1;
	Paint(this, [&](Painter& painter) {
		advance = painter.DrawString(string, length, where);
	});
	if (advance < 0)
		advance = StringWidth(string, length);
	MovePenTo(where.x + advance, where.y);
}

void BView::DrawBitmap(const BBitmap* bitmap)
{
	DrawBitmap(bitmap, PenLocation());
}

void BView::DrawBitmap(const BBitmap* bitmap, BPoint where)
{
	if (bitmap == nullptr)
		return;
	BRect bounds = bitmap->Bounds();
	DrawBitmap(bitmap, bounds, bounds.OffsetToCopy(where.x, where.y));
}

void BView::DrawBitmap(const BBitmap* bitmap, BRect bitmapRect, BRect viewRect)
{
	if (bitmap == nullptr)
		return;
	Paint(this, [&](Painter& painter) {
		painter.DrawBitmap(*bitmap, bitmapRect, viewRect);
	});
}

// Drawing is done when the call returns, so the asynchronous forms are the
// same calls.
void BView::DrawBitmapAsync(const BBitmap* bitmap)
{
	DrawBitmap(bitmap);
}

void BView::DrawBitmapAsync(const BBitmap* bitmap, BPoint where)
{
	DrawBitmap(bitmap, where);
}

void BView::DrawBitmapAsync(const BBitmap* bitmap, BRect bitmapRect, BRect viewRect)
{
	DrawBitmap(bitmap, bitmapRect, viewRect);
}

