#include "Headless.h"

#include <cctype>
#include <cstdio>
#include <memory>

#include <png.h>

#include <AppDefs.h>

#include "Display.h"
#include "ErrnoStatus.h"
#include "HeadlessDriver.h"
#include "MainLoop.h"

namespace BPrivate::Headless {

namespace {

HeadlessDriver* Driver()
{
	return dynamic_cast<HeadlessDriver*>(&Display::Default().Driver());
}

std::shared_ptr<DisplayWindow> Find(const BWindow* window)
{
	return Driver() != nullptr ? Display::Default().Find(window) : nullptr;
}

struct FileCloser {
	void operator()(FILE* file) const { fclose(file); }
};

}

bool IsActive()
{
	return Driver() != nullptr;
}

void SetScreenSize(int32 width, int32 height)
{
	if (HeadlessDriver* driver = Driver())
		driver->SetScreenSize(width, height);
}

std::vector<WindowInfo> ListWindows()
{
	std::vector<WindowInfo> windows;
	if (Driver() == nullptr)
		return windows;
	for (const auto& window : Display::Default().Windows()) {
		std::lock_guard<std::mutex> guard(window->lock);
		if (window->visible) {
			windows.push_back({window->owner, window->title, window->frame, window->visible,
				window->feel});
		}
	}
	return windows;
}

status_t PostMouse(const BWindow* window, uint32 what, BPoint where, uint32 buttons,
	int32 clicks)
{
	std::shared_ptr<DisplayWindow> target = Find(window);
	if (target == nullptr)
		return B_BAD_VALUE;
	Display::Default().PostMouse(*target, what, where, buttons, clicks);
	return B_OK;
}

status_t PostWheel(const BWindow* window, float dx, float dy)
{
	std::shared_ptr<DisplayWindow> target = Find(window);
	if (target == nullptr)
		return B_BAD_VALUE;
	Display::Default().PostWheel(*target, dx, dy);
	return B_OK;
}

status_t PostKey(const BWindow* window, const char* bytes, int32 key)
{
	std::shared_ptr<DisplayWindow> target = Find(window);
	if (target == nullptr || bytes == nullptr || bytes[0] == '\0')
		return B_BAD_VALUE;
	uint8 first = uint8(bytes[0]);
	int32 rawChar = first < 0x80 ? tolower(first) : first;
	Display::Default().PostKey(*target, B_KEY_DOWN, bytes, key, rawChar);
	return B_OK;
}

void SetModifiers(uint32 modifiers)
{
	Display::Default().SetModifiers(modifiers);
}

bool WaitForIdle(bigtime_t timeout)
{
	return WaitForIdleLoopers(timeout);
}

status_t ReadPixels(const BWindow* window, std::vector<uint32>* pixels, int32* width,
	int32* height)
{
	std::shared_ptr<DisplayWindow> source = Find(window);
	if (source == nullptr)
		return B_BAD_VALUE;
	std::lock_guard<std::mutex> guard(source->lock);
	*pixels = source->pixels;
	*width = source->width;
	*height = source->height;
	return B_OK;
}

rgb_color PixelAt(const BWindow* window, int32 x, int32 y)
{
	std::shared_ptr<DisplayWindow> source = Find(window);
	if (source == nullptr)
		return B_TRANSPARENT_COLOR;
	std::lock_guard<std::mutex> guard(source->lock);
	if (x < 0 || y < 0 || x >= source->width || y >= source->height)
		return B_TRANSPARENT_COLOR;
	uint32 pixel = source->pixels[size_t(y) * source->width + x];
	return make_color((pixel >> 16) & 0xff, (pixel >> 8) & 0xff, pixel & 0xff);
}

status_t SaveScreenshot(const BWindow* window, const char* path)
{
	std::vector<uint32> pixels;
	int32 width;
	int32 height;
	status_t status = ReadPixels(window, &pixels, &width, &height);
	if (status != B_OK || path == nullptr)
		return status != B_OK ? status : B_BAD_VALUE;
	if (width <= 0 || height <= 0)
		return B_NO_INIT;

	std::unique_ptr<FILE, FileCloser> file(fopen(path, "wb"));
	if (file == nullptr)
		return StatusFromErrno();
	png_structp png = png_create_write_struct(PNG_LIBPNG_VER_STRING, nullptr, nullptr,
		nullptr);
	png_infop info = png != nullptr ? png_create_info_struct(png) : nullptr;
	if (info == nullptr) {
		png_destroy_write_struct(&png, nullptr);
		return B_NO_MEMORY;
	}
	std::vector<png_byte> row(size_t(width) * 3);
	if (setjmp(png_jmpbuf(png)) != 0) {
		png_destroy_write_struct(&png, &info);
		return B_IO_ERROR;
	}
	png_init_io(png, file.get());
	png_set_IHDR(png, info, width, height, 8, PNG_COLOR_TYPE_RGB, PNG_INTERLACE_NONE,
		PNG_COMPRESSION_TYPE_DEFAULT, PNG_FILTER_TYPE_DEFAULT);
	png_write_info(png, info);
	for (int32 y = 0; y < height; y++) {
		for (int32 x = 0; x < width; x++) {
			uint32 pixel = pixels[size_t(y) * width + x];
			row[x * 3] = (pixel >> 16) & 0xff;
			row[x * 3 + 1] = (pixel >> 8) & 0xff;
			row[x * 3 + 2] = pixel & 0xff;
		}
		png_write_row(png, row.data());
	}
	png_write_end(png, info);
	png_destroy_write_struct(&png, &info);
	return fflush(file.get()) == 0 ? B_OK : StatusFromErrno();
}

}
