#ifndef KIT_PRIVATE_PAINTER_H
#define KIT_PRIVATE_PAINTER_H

#include <Font.h>
#include <GraphicsDefs.h>

#include "Region.h"

class BBitmap;

namespace BPrivate {

// Pixels to draw on: a window's framebuffer (B_RGB32) or a bitmap's bits.
struct Surface {
	uint8* bits = NULL;
	int32 bytesPerRow = 0;
	color_space space = B_RGB32;
	int32 width = 0;
	int32 height = 0;

	IntRect Bounds() const { return IntRect(0, 0, width - 1, height - 1); }
	uint8* PixelAt(int32 x, int32 y) const;
};

// One level of a view's drawing state stack.
struct DrawState {
	rgb_color high = {0, 0, 0, 255};
	rgb_color low = {255, 255, 255, 255};
	drawing_mode mode = B_OP_COPY;
	float penSize = 1.0f;
	BPoint pen;
	BFont font;
};

// Draws one primitive at a time in a view's coordinates: origin is where the
// view's (0, 0) lies on the surface, clip the surface pixels it may touch.
class Painter {
public:
	Painter(const Surface& surface, const Region& clip, BPoint origin,
		const DrawState& state);

	void FillRect(BRect rect, const pattern& p);
	void StrokeRect(BRect rect, const pattern& p);
	void StrokeLine(BPoint start, BPoint end, const pattern& p);
	void InvertRect(BRect rect);
	// Returns the pen's advance.
	float DrawString(const char* text, int32 length, BPoint baseline);
	void DrawBitmap(const BBitmap& bitmap, BRect source, BRect destination);

	// The surface pixels drawn so far.
	IntRect Touched() const { return fTouched; }

private:
	IntRect _DeviceRect(BRect rect) const;
	int32 _PenWidth() const;
	// Calls draw with each part of rect that may be drawn.
	template <typename AreaFunction>
	void _ForEachArea(const IntRect& rect, AreaFunction draw);
	template <typename PlotFunction>
	void _ForEachPixel(const IntRect& rect, PlotFunction plot);
	void _Fill(const IntRect& rect, const pattern& p);
	void _FillRegion(const Region& region, const pattern& p);
	void _Plot(uint8* pixel, rgb_color color, bool high);

	const Surface& fSurface;
	const Region& fClip;
	BPoint fOrigin;
	const DrawState& fState;
	IntRect fTouched;
};

}

#endif
