#ifndef KIT_PRIVATE_PIXEL_FORMAT_H
#define KIT_PRIVATE_PIXEL_FORMAT_H

#include <GraphicsDefs.h>

#include "SystemPalette.h"

namespace BPrivate {

// The colour spaces the kit stores and draws into; 0 for the others.
inline int32 BytesPerPixel(color_space space)
{
	switch (space) {
		case B_CMAP8:
			return 1;
		case B_RGB32:
		case B_RGBA32:
			return 4;
		default:
			return 0;
	}
}

// Rows are padded to four bytes.
inline int32 BytesPerRowFor(color_space space, int32 width)
{
	return (width * BytesPerPixel(space) + 3) & ~3;
}

// Transparent pixels read with alpha 0: the magic index and the magic colour
// of B_RGB32 read as B_TRANSPARENT_COLOR; B_RGBA32 keeps its own alpha.
inline rgb_color ReadPixel(const uint8* pixel, color_space space)
{
	if (space == B_CMAP8)
		return ColorForIndex(pixel[0]);
	rgb_color color = make_color(pixel[2], pixel[1], pixel[0], pixel[3]);
	if (space == B_RGB32) {
		color.alpha = 255;
		if (color.red == B_TRANSPARENT_32_BIT.red && color.green == B_TRANSPARENT_32_BIT.green
			&& color.blue == B_TRANSPARENT_32_BIT.blue)
			return B_TRANSPARENT_32_BIT;
	}
	return color;
}

// B_CMAP8 takes the transparent index for alpha below one half; B_RGB32
// stores the colour alone.
inline void WritePixel(uint8* pixel, color_space space, rgb_color color)
{
	if (space == B_CMAP8) {
		pixel[0] = color.alpha < 128 ? B_TRANSPARENT_MAGIC_CMAP8 : IndexForColor(color);
		return;
	}
	pixel[0] = color.blue;
	pixel[1] = color.green;
	pixel[2] = color.red;
	pixel[3] = space == B_RGB32 ? 255 : color.alpha;
}

}

#endif
