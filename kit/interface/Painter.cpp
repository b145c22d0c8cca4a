#include "Painter.h"

#include <algorithm>
#include <cstdlib>
#include <cstring>

#include <Bitmap.h>

#include "FontEngine.h"
#include "PixelFormat.h"

namespace BPrivate {

namespace {

bool IsSolid(const pattern& p, uint8 value)
{
	for (uint8 row : p.data) {
		if (row != value)
			return false;
	}
	return true;
}

bool PatternHigh(const pattern& p, int32 x, int32 y)
{
	return (p.data[y & 7] & (0x80 >> (x & 7))) != 0;
}

uint8 Mix(uint8 from, uint8 to, int32 amount)
{
	return uint8((from * (255 - amount) + to * amount + 127) / 255);
}

rgb_color MixColors(rgb_color from, rgb_color to, int32 amount)
{
	return make_color(Mix(from.red, to.red, amount), Mix(from.green, to.green, amount),
		Mix(from.blue, to.blue, amount));
}

rgb_color Channelwise(rgb_color a, rgb_color b, uint8 (*op)(int32, int32))
{
	return make_color(op(a.red, b.red), op(a.green, b.green), op(a.blue, b.blue));
}

}

uint8* Surface::PixelAt(int32 x, int32 y) const
{
	return bits + ptrdiff_t(y) * bytesPerRow + ptrdiff_t(x) * BytesPerPixel(space);
}

Painter::Painter(const Surface& surface, const Region& clip, BPoint origin,
	const DrawState& state)
	:
	fSurface(surface),
	fClip(clip),
	fOrigin(origin),
	fState(state)
{
}

IntRect Painter::_DeviceRect(BRect rect) const
{
	return PixelRect(rect.OffsetByCopy(fOrigin.x, fOrigin.y));
}

int32 Painter::_PenWidth() const
{
	return max_c(int32(1), PixelCoordinate(fState.penSize));
}

template <typename AreaFunction>
void Painter::_ForEachArea(const IntRect& rect, AreaFunction draw)
{
	for (const IntRect& clip : fClip.Rects()) {
		IntRect area = rect & clip & fSurface.Bounds();
		if (!area.IsValid())
			continue;
		fTouched = fTouched | area;
		draw(area);
	}
}

template <typename PlotFunction>
void Painter::_ForEachPixel(const IntRect& rect, PlotFunction plot)
{
	_ForEachArea(rect, [&](const IntRect& area) {
		for (int32 y = area.top; y <= area.bottom; y++) {
			for (int32 x = area.left; x <= area.right; x++)
				plot(fSurface.PixelAt(x, y), x, y);
		}
	});
}

void Painter::_Plot(uint8* pixel, rgb_color color, bool high)
{
	color_space space = fSurface.space;
	rgb_color destination;
	switch (fState.mode) {
		case B_OP_COPY:
			WritePixel(pixel, space, color);
			return;
		case B_OP_OVER:
			if (high)
				WritePixel(pixel, space, color);
			return;
		case B_OP_ERASE:
			if (high)
				WritePixel(pixel, space, fState.low);
			return;
		default:
			break;
	}
	destination = ReadPixel(pixel, space);
	switch (fState.mode) {
		case B_OP_INVERT:
			if (high) {
				color = make_color(255 - destination.red, 255 - destination.green,
					255 - destination.blue);
			} else
				return;
			break;
		case B_OP_ADD:
			color = Channelwise(destination, color,
				[](int32 a, int32 b) { return uint8(min_c(a + b, int32(255))); });
			break;
		case B_OP_SUBTRACT:
			color = Channelwise(destination, color,
				[](int32 a, int32 b) { return uint8(max_c(a - b, int32(0))); });
			break;
		case B_OP_BLEND:
			color = Channelwise(destination, color,
				[](int32 a, int32 b) { return uint8((a + b) / 2); });
			break;
		case B_OP_MIN:
			color = Channelwise(destination, color,
				[](int32 a, int32 b) { return uint8(min_c(a, b)); });
			break;
		case B_OP_MAX:
			color = Channelwise(destination, color,
				[](int32 a, int32 b) { return uint8(max_c(a, b)); });
			break;
		case B_OP_SELECT:
			if (destination == fState.high)
				color = fState.low;
			else if (destination == fState.low)
				color = fState.high;
			else
				return;
			break;
		case B_OP_ALPHA:
			color = MixColors(destination, color, color.alpha);
			break;
		default:
			return;
	}
	color.alpha = 255;
	WritePixel(pixel, space, color);
}

void Painter::_Fill(const IntRect& rect, const pattern& p)
{
	bool solidHigh = IsSolid(p, 0xff);
	bool solidLow = IsSolid(p, 0);
	bool copies = fState.mode == B_OP_COPY || (fState.mode == B_OP_OVER && solidHigh);
	if (fState.mode == B_OP_OVER && solidLow)
		return;

	if (copies && (solidHigh || solidLow) && BytesPerPixel(fSurface.space) == 4) {
		// The common case: one colour over whole rows.
		uint8 encoded[4];
		WritePixel(encoded, fSurface.space, solidHigh ? fState.high : fState.low);
		uint32 value;
		memcpy(&value, encoded, 4);
		_ForEachArea(rect, [&](const IntRect& area) {
			for (int32 y = area.top; y <= area.bottom; y++) {
				uint32* row = reinterpret_cast<uint32*>(fSurface.PixelAt(area.left, y));
				std::fill(row, row + area.Width(), value);
			}
		});
		return;
	}

	_ForEachPixel(rect, [&](uint8* pixel, int32 x, int32 y) {
		bool high = PatternHigh(p, x, y);
		_Plot(pixel, high ? fState.high : fState.low, high);
	});
}

void Painter::_FillRegion(const Region& region, const pattern& p)
{
	for (const IntRect& rect : region.Rects())
		_Fill(rect, p);
}

void Painter::FillRect(BRect rect, const pattern& p)
{
	if (rect.IsValid())
		_Fill(_DeviceRect(rect), p);
}

void Painter::StrokeRect(BRect rect, const pattern& p)
{
	if (!rect.IsValid())
		return;
	IntRect r = _DeviceRect(rect);
	int32 width = _PenWidth();
	int32 before = width / 2;
	int32 after = width - 1 - before;
	// A region, so that corners shared by two sides are drawn once.
	Region outline;
	outline.Include(IntRect(r.left, r.top - before, r.right, r.top + after));
	outline.Include(IntRect(r.left, r.bottom - before, r.right, r.bottom + after));
	outline.Include(IntRect(r.left - before, r.top, r.left + after, r.bottom));
	outline.Include(IntRect(r.right - before, r.top, r.right + after, r.bottom));
	_FillRegion(outline, p);
}

void Painter::StrokeLine(BPoint start, BPoint end, const pattern& p)
{
	int32 x0 = PixelCoordinate(start.x + fOrigin.x);
	int32 y0 = PixelCoordinate(start.y + fOrigin.y);
	int32 x1 = PixelCoordinate(end.x + fOrigin.x);
	int32 y1 = PixelCoordinate(end.y + fOrigin.y);
	int32 width = _PenWidth();
	int32 before = width / 2;
	int32 after = width - 1 - before;
	int32 dx = x1 - x0;
	int32 dy = y1 - y0;

	if (dx == 0 || dy == 0) {
		IntRect box(min_c(x0, x1), min_c(y0, y1), max_c(x0, x1), max_c(y0, y1));
		_Fill(dy == 0 ? IntRect(box.left, box.top - before, box.right, box.bottom + after)
			: IntRect(box.left - before, box.top, box.right + after, box.bottom), p);
		return;
	}
	// Each step along the major axis draws one run of the pen's width across
	// it; runs of different steps never overlap.
	bool xMajor = std::abs(dx) >= std::abs(dy);
	int32 steps = max_c(std::abs(dx), std::abs(dy));
	auto offset = [steps](int32 delta, int32 step) {
		int64 scaled = 2 * int64(step) * delta;
		return int32((scaled + (delta > 0 ? steps : -steps)) / (2 * steps));
	};
	for (int32 step = 0; step <= steps; step++) {
		int32 x = x0 + offset(dx, step);
		int32 y = y0 + offset(dy, step);
		_Fill(xMajor ? IntRect(x, y - before, x, y + after)
			: IntRect(x - before, y, x + after, y), p);
	}
}

void Painter::InvertRect(BRect rect)
{
	if (!rect.IsValid())
		return;
	_ForEachPixel(_DeviceRect(rect), [&](uint8* pixel, int32, int32) {
		rgb_color color = ReadPixel(pixel, fSurface.space);
		WritePixel(pixel, fSurface.space,
			make_color(255 - color.red, 255 - color.green, 255 - color.blue));
	});
}

float Painter::DrawString(const char* text, int32 length, BPoint baseline)
{
	std::vector<PlacedGlyph> glyphs;
	float advance = LayoutText(fState.font, text, length, &glyphs);
	int32 penX = PixelCoordinate(baseline.x + fOrigin.x);
	// Letters rest on the baseline's row: their bitmaps end just below it.
	int32 bottom = PixelCoordinate(baseline.y + fOrigin.y) + 1;

	for (const PlacedGlyph& placed : glyphs) {
		const Glyph& glyph = *placed.glyph;
		if (glyph.width == 0 || glyph.height == 0)
			continue;
		int32 left = penX + placed.x + glyph.left;
		int32 top = bottom - glyph.top;
		IntRect box(left, top, left + glyph.width - 1, top + glyph.height - 1);
		_ForEachPixel(box, [&](uint8* pixel, int32 x, int32 y) {
			int32 coverage = glyph.coverage[size_t(y - top) * glyph.width + (x - left)];
			if (coverage == 0)
				return;
			switch (fState.mode) {
				case B_OP_COPY:
					// As on the platform, copied text is smoothed against the
					// low colour, not against what lies below.
					WritePixel(pixel, fSurface.space,
						MixColors(fState.low, fState.high, coverage));
					break;
				case B_OP_OVER:
					WritePixel(pixel, fSurface.space,
						MixColors(ReadPixel(pixel, fSurface.space), fState.high, coverage));
					break;
				default:
					if (coverage >= 128)
						_Plot(pixel, fState.high, true);
					break;
			}
		});
	}
	return advance;
}

void Painter::DrawBitmap(const BBitmap& bitmap, BRect source, BRect destination)
{
	if (bitmap.InitCheck() != B_OK || !source.IsValid() || !destination.IsValid())
		return;
	BRect bounds = bitmap.Bounds();
	IntRect from = PixelRect(source.OffsetByCopy(-bounds.left, -bounds.top))
		& IntRect(0, 0, bounds.IntegerWidth(), bounds.IntegerHeight());
	IntRect to = _DeviceRect(destination);
	if (!from.IsValid())
		return;

	const uint8* bits = static_cast<const uint8*>(bitmap.Bits());
	int32 bytesPerRow = bitmap.BytesPerRow();
	color_space space = bitmap.ColorSpace();
	int32 bpp = BytesPerPixel(space);
	IntRect sourceRect = PixelRect(source.OffsetByCopy(-bounds.left, -bounds.top));
	_ForEachPixel(to, [&](uint8* pixel, int32 x, int32 y) {
		// Nearest pixel when the rectangles differ in size.
		int32 sx = sourceRect.left
			+ int32(int64(x - to.left) * sourceRect.Width() / to.Width());
		int32 sy = sourceRect.top
			+ int32(int64(y - to.top) * sourceRect.Height() / to.Height());
		if (!from.Contains(sx, sy))
			return;
		rgb_color color = ReadPixel(bits + ptrdiff_t(sy) * bytesPerRow + sx * bpp, space);
		switch (fState.mode) {
			case B_OP_COPY:
				WritePixel(pixel, fSurface.space, color);
				break;
			case B_OP_OVER:
			case B_OP_ALPHA:
				if (color.alpha == 255)
					WritePixel(pixel, fSurface.space, color);
				else if (color.alpha != 0) {
					WritePixel(pixel, fSurface.space,
						MixColors(ReadPixel(pixel, fSurface.space), color, color.alpha));
				}
				break;
			default:
				if (color.alpha >= 128)
					_Plot(pixel, color, true);
				break;
		}
	});
}

}
