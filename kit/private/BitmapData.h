#ifndef KIT_PRIVATE_BITMAP_DATA_H
#define KIT_PRIVATE_BITMAP_DATA_H

#include <memory>

#include <Bitmap.h>

namespace BPrivate {

struct BitmapData {
	BRect bounds;
	color_space space = B_NO_COLOR_SPACE;
	int32 width = 0;
	int32 height = 0;
	int32 bytesPerRow = 0;
	std::unique_ptr<uint8[]> bits;
	status_t status = B_NO_INIT;
	bool acceptsViews = false;
};

}

#endif
