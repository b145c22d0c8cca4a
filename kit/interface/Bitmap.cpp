#include <Bitmap.h>

#include <cstring>
#include <new>

#include <View.h>
#include <Window.h>

#include "PixelFormat.h"

namespace BPrivate {

struct BitmapData {
	BRect bounds;
	color_space space = B_NO_COLOR_SPACE;
	int32 width = 0;
	int32 height = 0;
	int32 bytesPerRow = 0;
	std::unique_ptr<uint8[]> bits;
	status_t status = B_NO_INIT;
	// The hidden window holding the views of a bitmap that accepts them;
	// declared after the pixels it draws on, so that it goes first.
	std::unique_ptr<BWindow> window;
};

}

using BPrivate::BitmapData;

namespace {

// Far beyond any screen; keeps width * height * 4 well inside int32.
constexpr int32 kMaxSide = 16384;

}

BBitmap::BBitmap(BRect bounds, color_space space, bool acceptsViews, bool)
	:
	fData(std::make_unique<BitmapData>())
{
	_Init(bounds, space, acceptsViews);
}

BBitmap::BBitmap(const BBitmap* source, bool acceptsViews, bool)
	:
	fData(std::make_unique<BitmapData>())
{
	if (source == NULL || source->InitCheck() != B_OK) {
		fData->status = B_BAD_VALUE;
		return;
	}
	_Init(source->Bounds(), source->ColorSpace(), acceptsViews);
	if (InitCheck() == B_OK)
		memcpy(Bits(), source->Bits(), BitsLength());
}

void BBitmap::_Init(BRect bounds, color_space space, bool acceptsViews)
{
	BitmapData& data = *fData;
	data.bounds = bounds;
	data.space = space;
	if (!bounds.IsValid() || BPrivate::BytesPerPixel(space) == 0) {
		data.status = B_BAD_VALUE;
		return;
	}
	data.width = bounds.IntegerWidth() + 1;
	data.height = bounds.IntegerHeight() + 1;
	if (data.width > kMaxSide || data.height > kMaxSide) {
		data.status = B_BAD_VALUE;
		return;
	}
	data.bytesPerRow = BPrivate::BytesPerRowFor(space, data.width);
	size_t length = size_t(data.bytesPerRow) * data.height;
	data.bits.reset(new (std::nothrow) uint8[length]);
	if (!data.bits) {
		data.status = B_NO_MEMORY;
		return;
	}
	// New bitmaps start fully transparent, as an icon with nothing drawn.
	if (space == B_CMAP8)
		memset(data.bits.get(), B_TRANSPARENT_MAGIC_CMAP8, length);
	else
		memset(data.bits.get(), 0, length);
	data.status = B_OK;
	if (acceptsViews)
		data.window.reset(new BWindow(this));
}

BBitmap::~BBitmap() = default;

status_t BBitmap::InitCheck() const
{
	return fData->status;
}

bool BBitmap::IsValid() const
{
	return fData->status == B_OK;
}

BRect BBitmap::Bounds() const
{
	return fData->bounds;
}

void* BBitmap::Bits() const
{
	return fData->bits.get();
}

int32 BBitmap::BitsLength() const
{
	return fData->bytesPerRow * fData->height;
}

int32 BBitmap::BytesPerRow() const
{
	return fData->bytesPerRow;
}

color_space BBitmap::ColorSpace() const
{
	return fData->space;
}

void BBitmap::SetBits(const void* data, int32 length, int32 offset,
	color_space colorSpace)
{
	const BitmapData& bitmap = *fData;
	int32 sourceBpp = BPrivate::BytesPerPixel(colorSpace);
	if (data == NULL || !IsValid() || length <= 0 || offset < 0
		|| offset >= BitsLength() || sourceBpp == 0)
		return;

	if (colorSpace == bitmap.space) {
		memcpy(bitmap.bits.get() + offset, data, min_c(length, BitsLength() - offset));
		return;
	}

	const uint8* source = static_cast<const uint8*>(data);
	int32 bpp = BPrivate::BytesPerPixel(bitmap.space);
	int32 sourceBpr = BPrivate::BytesPerRowFor(colorSpace, bitmap.width);
	int32 startRow = offset / bitmap.bytesPerRow;
	int32 startColumn = (offset % bitmap.bytesPerRow) / bpp;
	int32 sourceStart = startRow * sourceBpr + startColumn * sourceBpp;
	for (int32 row = startRow; row < bitmap.height; row++) {
		for (int32 column = row == startRow ? startColumn : 0; column < bitmap.width;
				column++) {
			int32 at = row * sourceBpr + column * sourceBpp - sourceStart;
			if (at + sourceBpp > length)
				return;
			BPrivate::WritePixel(bitmap.bits.get() + row * bitmap.bytesPerRow
					+ column * bpp, bitmap.space,
				BPrivate::ReadPixel(source + at, colorSpace));
		}
	}
}

void BBitmap::AddChild(BView* view)
{
	if (fData->window != nullptr)
		fData->window->AddChild(view);
}

bool BBitmap::RemoveChild(BView* view)
{
	return fData->window != nullptr && fData->window->RemoveChild(view);
}

int32 BBitmap::CountChildren() const
{
	return fData->window != nullptr ? fData->window->CountChildren() : 0;
}

BView* BBitmap::ChildAt(int32 index) const
{
	return fData->window != nullptr ? fData->window->ChildAt(index) : nullptr;
}

BView* BBitmap::FindView(const char* name) const
{
	return fData->window != nullptr ? fData->window->FindView(name) : nullptr;
}

BView* BBitmap::FindView(BPoint point) const
{
	return fData->window != nullptr ? fData->window->FindView(point) : nullptr;
}

bool BBitmap::Lock()
{
	return fData->window != nullptr && fData->window->Lock();
}

void BBitmap::Unlock()
{
	if (fData->window != nullptr)
		fData->window->Unlock();
}

bool BBitmap::IsLocked() const
{
	return fData->window != nullptr && fData->window->IsLocked();
}
