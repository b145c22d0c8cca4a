// Theme PNGs become palette icons here.

#include <atomic>
#include <cstring>

#include <png.h>

#include <GraphicsDefs.h>

#include "SystemPalette.h"
#include "TypeIcons.h"

namespace BPrivate {

namespace {

std::atomic<int32> sDecodeCount{0};

struct PngImage {
	png_image image;

	PngImage()
	{
		memset(&image, 0, sizeof(image));
		image.version = PNG_IMAGE_VERSION;
	}

	~PngImage() { png_image_free(&image); }
};

// Finishes a started read: straight RGBA, then one palette index per pixel.
IconRef FinishDecode(PngImage& png, int32 size)
{
	if (png.image.width != (png_uint_32)size
		|| png.image.height != (png_uint_32)size)
		return nullptr;

	png.image.format = PNG_FORMAT_RGBA;
	std::vector<uint8> rgba(PNG_IMAGE_SIZE(png.image));
	if (!png_image_finish_read(&png.image, nullptr, rgba.data(), 0, nullptr))
		return nullptr;
	sDecodeCount++;

	auto icon = std::make_shared<IconPixels>();
	icon->size = size;
	icon->indices.resize(size * size);
	for (int32 i = 0; i < size * size; i++) {
		const uint8* pixel = &rgba[i * 4];
		icon->indices[i] = pixel[3] < 128 ? B_TRANSPARENT_MAGIC_CMAP8
			: IndexForColor(pixel[0], pixel[1], pixel[2]);
	}
	return icon;
}

}

IconRef DecodePngIcon(const char* path, int32 size)
{
	PngImage png;
	if (!png_image_begin_read_from_file(&png.image, path))
		return nullptr;
	return FinishDecode(png, size);
}

IconRef DecodePngIcon(const void* data, size_t length, int32 size)
{
	PngImage png;
	if (!png_image_begin_read_from_memory(&png.image, data, length))
		return nullptr;
	return FinishDecode(png, size);
}

int32 IconDecodeCount()
{
	return sDecodeCount;
}

}
