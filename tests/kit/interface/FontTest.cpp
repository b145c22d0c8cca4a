// Fonts: the standard fonts, families, faces, metrics and measuring from
// several threads.

#include <atomic>
#include <cstring>
#include <set>
#include <thread>

#include <Font.h>

#include "InterfaceTestSupport.h"

using namespace InterfaceTest;

namespace {

TEST(FontTest, StandardFontsAreDejaVuSans)
{
	font_family family;
	font_style style;
	be_plain_font->GetFamilyAndStyle(&family, &style);
	EXPECT_STREQ(family, "DejaVu Sans");
	EXPECT_STREQ(style, "Book");
	be_bold_font->GetFamilyAndStyle(&family, &style);
	EXPECT_STREQ(style, "Bold");
	EXPECT_EQ(be_bold_font->Face(), B_BOLD_FACE);

	// Size n is n pixels: at 10 the ascent is 10 and the descent 3.
	BFont plain(be_plain_font);
	plain.SetSize(10);
	font_height height;
	plain.GetHeight(&height);
	EXPECT_EQ(height.ascent, 10);
	EXPECT_EQ(height.descent, 3);
	EXPECT_GE(height.leading, 0);
	EXPECT_GT(be_bold_font->StringWidth("Varnel"), plain.StringWidth("Varnel"));
}

TEST(FontTest, FamiliesAreListedOnceEach)
{
	int32 count = count_font_families();
	ASSERT_GT(count, 0);
	std::set<std::string> names;
	bool dejaVu = false;
	for (int32 i = 0; i < count; i++) {
		font_family family;
		uint32 flags = 0xffff;
		ASSERT_EQ(get_font_family(i, &family, &flags), B_OK);
		EXPECT_TRUE(names.insert(family).second) << family;
		dejaVu |= strcmp(family, "DejaVu Sans") == 0;
		if (strcmp(family, "DejaVu Sans Mono") == 0) {
			EXPECT_EQ(flags & B_IS_FIXED, uint32(B_IS_FIXED));
		}
	}
	EXPECT_TRUE(dejaVu);
	font_family family;
	EXPECT_EQ(get_font_family(count, &family), B_BAD_VALUE);
	EXPECT_EQ(get_font_family(-1, &family), B_BAD_VALUE);
}

TEST(FontTest, FacesAndUnknownFamilies)
{
	BFont font;
	EXPECT_EQ(font.SetFamilyAndFace("No Such Family Here", B_REGULAR_FACE), B_NAME_NOT_FOUND);
	EXPECT_EQ(font.SetFamilyAndStyle("DejaVu Sans", "No Such Style"), B_NAME_NOT_FOUND);
	font_family family;
	font.GetFamilyAndStyle(&family, nullptr);
	EXPECT_STREQ(family, "DejaVu Sans");

	ASSERT_EQ(font.SetFamilyAndFace("DejaVu Sans", B_BOLD_FACE), B_OK);
	font_style style;
	font.GetFamilyAndStyle(nullptr, &style);
	EXPECT_STREQ(style, "Bold");
	EXPECT_EQ(font.Face(), B_BOLD_FACE);
	EXPECT_NE(font, BFont());
	BFont copy(&font);
	EXPECT_EQ(copy, font);
}

// The leftmost inked column of a row of a drawn "l".
int32 LeftmostInk(const BWindow* window, int32 y)
{
	for (int32 x = 0; x < 60; x++) {
		if (BPrivate::Headless::PixelAt(window, x, y) != kWhite)
			return x;
	}
	return -1;
}

using FontDrawingTest = WindowTest;

TEST_F(FontDrawingTest, ItalicLeansToTheRight)
{
	BFont upright;
	upright.SetSize(40);
	BFont italic(upright);
	italic.SetFace(B_ITALIC_FACE);
	BWindow* window = ShowView(new DrawView(BRect(0, 0, 119, 59), [&](BView* view) {
		view->SetFont(&upright);
		view->DrawString("l", BPoint(10, 45));
		view->SetFont(&italic);
		view->DrawString("l", BPoint(70, 45));
	}), BRect(0, 0, 119, 59));
	EXPECT_EQ(LeftmostInk(window, 44), LeftmostInk(window, 20));
	// The italic stroke is further right at the top than at the bottom.
	int32 top = -1;
	int32 bottom = -1;
	for (int32 x = 60; x < 120; x++) {
		if (top < 0 && Pixel(window, x, 20) != kWhite)
			top = x;
		if (bottom < 0 && Pixel(window, x, 44) != kWhite)
			bottom = x;
	}
	EXPECT_GT(top, bottom + 2);
}

TEST(FontTest, WidthsAddUpAndOddBytesAreSafe)
{
	BFont font;
	font.SetSize(12);
	EXPECT_EQ(font.StringWidth(""), 0);
	EXPECT_EQ(font.StringWidth(nullptr), 0);
	EXPECT_EQ(font.StringWidth("ab"), font.StringWidth("a") + font.StringWidth("b"));
	EXPECT_EQ(font.StringWidth("abcdef", 2), font.StringWidth("ab"));
	EXPECT_EQ(font.StringWidth("ab\0cd", 5), font.StringWidth("ab"));
	// A byte that is not UTF-8 shows as one replacement character.
	EXPECT_EQ(font.StringWidth("a\xff" "b"), font.StringWidth("a\xef\xbf\xbd" "b"));
	EXPECT_GT(font.StringWidth("\xe2\x82"), 0);
	EXPECT_GT(font.StringWidth("$`\"'\n"), 0);
}

TEST(FontTest, MeasuringFromManyThreads)
{
	BFont font;
	float expected = font.StringWidth("Contents of  ");
	std::vector<std::thread> threads;
	std::atomic<int32> mismatches{0};
	for (int32 t = 0; t < 4; t++) {
		threads.emplace_back([&, t] {
			BFont own(font);
			for (int32 i = 0; i < 200; i++) {
				own.SetSize(9 + (i + t) % 5);
				own.StringWidth("Folder");
				own.SetSize(10);
				if (own.StringWidth("Contents of  ") != expected)
					mismatches++;
			}
		});
	}
	for (std::thread& thread : threads)
		thread.join();
	EXPECT_EQ(mismatches, 0);
}

}
