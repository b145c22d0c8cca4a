#ifndef KIT_PRIVATE_SYSTEM_PALETTE_H
#define KIT_PRIVATE_SYSTEM_PALETTE_H

#include <GraphicsDefs.h>

namespace BPrivate {

// The 256-colour map behind B_CMAP8, laid out as the platform describes its
// system colour map (our own derivation from that description, not a copy of
// any table):
//   0-31     a grey ramp from black, in steps of 8 (0, 8, ... 248), so the
//            usual interface greys (152, 184, 216, 232) are exact;
//   32-40    a blue ramp, 41-49 red, 50-58 green: 255 down to 51 in tenths;
//   59-62 and 64-254
//            the 6 x 6 x 6 colour cube over 0, 51, 102, 153, 204, 255 without
//            its greys and its single-primary colours (already in the ramps),
//            red varying slowest;
//   63       white;
//   255      B_TRANSPARENT_MAGIC_CMAP8, shown as B_TRANSPARENT_COLOR.
rgb_color ColorForIndex(uint8 index);

// The index of the nearest opaque colour by distance in RGB (never the
// transparent index); colours of the map give their own index.
uint8 IndexForColor(uint8 red, uint8 green, uint8 blue);

inline uint8 IndexForColor(rgb_color color)
{
	return IndexForColor(color.red, color.green, color.blue);
}

}

#endif
