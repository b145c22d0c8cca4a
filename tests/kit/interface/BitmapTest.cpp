// The system palette, bitmaps as pixel containers and views drawing into
// bitmaps.

#include <cstdlib>
#include <set>
#include <thread>

#include <Bitmap.h>

#include "InterfaceTestSupport.h"
#include "SystemPalette.h"

using namespace InterfaceTest;
using BPrivate::ColorForIndex;
using BPrivate::IndexForColor;

namespace {

TEST(SystemPaletteTest, EveryColourIsDistinctAndFindsItself)
{
	std::set<uint32> seen;
	for (int32 index = 0; index < 255; index++) {
		rgb_color color = ColorForIndex(index);
		EXPECT_EQ(color.alpha, 255);
		seen.insert((color.red << 16) | (color.green << 8) | color.blue);
		EXPECT_EQ(IndexForColor(color), index);
	}
	EXPECT_EQ(seen.size(), 255u);
	EXPECT_EQ(ColorForIndex(B_TRANSPARENT_MAGIC_CMAP8), B_TRANSPARENT_COLOR);
	EXPECT_EQ(ColorForIndex(0), kBlack);
	EXPECT_EQ(ColorForIndex(63), kWhite);
	// The interface greys are exact.
	for (uint8 grey : {152, 184, 216, 232})
		EXPECT_EQ(ColorForIndex(IndexForColor(grey, grey, grey)), make_color(grey, grey, grey));
	// Others go to a near colour, never to the transparent index.
	EXPECT_EQ(ColorForIndex(IndexForColor(205, 205, 205)), make_color(208, 208, 208));
	EXPECT_NE(IndexForColor(0x77, 0x74, 0x77), B_TRANSPARENT_MAGIC_CMAP8);
	rgb_color orange = ColorForIndex(IndexForColor(250, 130, 10));
	EXPECT_LE(std::abs(orange.red - 250) + std::abs(orange.green - 130)
		+ std::abs(orange.blue - 10), 60);
}

TEST(BitmapTest, RowsArePaddedAndBadBitmapsSaySo)
{
	BBitmap icon(BRect(0, 0, 16, 1), B_CMAP8);
	ASSERT_EQ(icon.InitCheck(), B_OK);
	EXPECT_EQ(icon.BytesPerRow(), 20);
	EXPECT_EQ(icon.BitsLength(), 40);
	EXPECT_EQ(static_cast<uint8*>(icon.Bits())[0], B_TRANSPARENT_MAGIC_CMAP8);
	EXPECT_EQ(BBitmap(BRect(0, 0, 2, 0), B_RGB32).BytesPerRow(), 12);

	BBitmap upsideDown(BRect(0, 10, 5, 0), B_RGB32);
	EXPECT_EQ(upsideDown.InitCheck(), B_BAD_VALUE);
	EXPECT_EQ(upsideDown.Bits(), nullptr);
	EXPECT_EQ(upsideDown.BitsLength(), 0);
	EXPECT_EQ(BBitmap(BRect(0, 0, 5, 5), B_RGB16).InitCheck(), B_BAD_VALUE);
	EXPECT_EQ(BBitmap(BRect(0, 0, 1e6, 1e6), B_RGB32).InitCheck(), B_BAD_VALUE);
	upsideDown.SetBits("abc", 3, 0, B_CMAP8);
	BView refused(BRect(0, 0, 1, 1), "refused", 0, 0);
	upsideDown.AddChild(&refused);
	EXPECT_EQ(upsideDown.CountChildren(), 0);
	EXPECT_EQ(refused.Window(), nullptr);
}

TEST(BitmapTest, SetBitsConvertsAndStopsAtTheEnd)
{
	BBitmap bitmap(BRect(0, 0, 2, 1), B_RGBA32);
	uint8 indexes[8] = {0, 63, B_TRANSPARENT_MAGIC_CMAP8, 9, 63, 0, 0, 9};
	bitmap.SetBits(indexes, sizeof(indexes), 0, B_CMAP8);
	const uint8* bits = static_cast<const uint8*>(bitmap.Bits());
	auto pixel = [&](int32 x, int32 y) {
		const uint8* p = bits + y * bitmap.BytesPerRow() + x * 4;
		return make_color(p[2], p[1], p[0], p[3]);
	};
	EXPECT_EQ(pixel(0, 0), kBlack);
	EXPECT_EQ(pixel(1, 0), kWhite);
	EXPECT_EQ(pixel(2, 0).alpha, 0);
	EXPECT_EQ(pixel(0, 1), kWhite);

	// Same colour space: a plain copy from offset, cut at the end.
	BBitmap copy(BRect(0, 0, 1, 0), B_CMAP8);
	uint8 data[64] = {1, 2, 3, 4, 5};
	copy.SetBits(data, sizeof(data), 1, B_CMAP8);
	const uint8* copied = static_cast<const uint8*>(copy.Bits());
	EXPECT_EQ(copied[0], B_TRANSPARENT_MAGIC_CMAP8);
	EXPECT_EQ(copied[1], 1);
	copy.SetBits(data, 4, -1, B_CMAP8);
	copy.SetBits(data, 4, 100, B_CMAP8);
	EXPECT_EQ(copied[1], 1);

	BBitmap duplicate(&copy);
	EXPECT_EQ(static_cast<const uint8*>(duplicate.Bits())[1], 1);
}

// Draws once, when attached, as the drag image view does.
class ImageView : public BView {
public:
	explicit ImageView(BRect frame, bool* deleted)
		: BView(frame, "image", B_FOLLOW_NONE, B_WILL_DRAW), fDeleted(deleted) {}
	~ImageView() override { *fDeleted = true; }

	void AttachedToWindow() override { Draw(Bounds()); }
	void Draw(BRect) override
	{
		SetLowColor(205, 205, 205);
		FillRect(Bounds(), B_SOLID_LOW);
		SetHighColor(0, 0, 0);
		StrokeRect(BRect(2, 2, 5, 5));
		SetHighColor(B_TRANSPARENT_COLOR);
		FillRect(BRect(7, 0, 7, 7));
		Sync();
	}

private:
	bool* fDeleted;
};

TEST(BitmapTest, AViewAddedToABitmapDrawsIntoIt)
{
	bool deleted = false;
	{
		BBitmap image(BRect(0, 0, 7, 7), B_CMAP8, true);
		image.AddChild(new ImageView(image.Bounds(), &deleted));
		ASSERT_EQ(image.CountChildren(), 1);
		EXPECT_NE(image.FindView("image"), nullptr);
		const uint8* bits = static_cast<const uint8*>(image.Bits());
		auto at = [&](int32 x, int32 y) { return bits[y * image.BytesPerRow() + x]; };
		EXPECT_EQ(at(0, 0), IndexForColor(205, 205, 205));
		EXPECT_EQ(at(2, 2), IndexForColor(0, 0, 0));
		EXPECT_EQ(at(3, 3), IndexForColor(205, 205, 205));
		EXPECT_EQ(at(7, 3), B_TRANSPARENT_MAGIC_CMAP8);

		// Any thread may lock it.
		std::thread([&] {
			EXPECT_TRUE(image.Lock());
			EXPECT_TRUE(image.IsLocked());
			image.ChildAt(0)->Invalidate();
			image.Unlock();
		}).join();
		EXPECT_FALSE(deleted);
	}
	EXPECT_TRUE(deleted);
}

}
