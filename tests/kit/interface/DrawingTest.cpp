// The drawing rules, pixel by pixel, in the headless backend.

#include <Bitmap.h>

#include "InterfaceTestSupport.h"
#include "SystemPalette.h"
#include "ViewData.h"

using namespace InterfaceTest;

namespace {

class DrawingTest : public WindowTest {
protected:
	// A white 120 x 80 view filling a window, drawn by draw.
	BWindow* Drawn(std::function<void(BView*)> draw)
	{
		return ShowView(new DrawView(BRect(0, 0, 119, 79), std::move(draw)),
			BRect(50, 50, 169, 129));
	}
};

TEST_F(DrawingTest, RectanglesIncludeTheirEdges)
{
	BWindow* window = Drawn([](BView* view) {
		view->FillRect(BRect(10, 10, 19, 19));
		view->StrokeRect(BRect(40, 10, 49, 19));
		// One pixel wide or high, and upside down (nothing).
		view->FillRect(BRect(70, 10, 70, 10));
		view->FillRect(BRect(90, 19, 99, 10));
	});
	EXPECT_EQ(Row(window, 9, 8, 21), "..............");
	EXPECT_EQ(Row(window, 10, 8, 21), "..##########..");
	EXPECT_EQ(Row(window, 19, 8, 21), "..##########..");
	EXPECT_EQ(Row(window, 20, 8, 21), "..............");
	EXPECT_EQ(Column(window, 15, 8, 21), "..##########..");

	EXPECT_EQ(Row(window, 10, 39, 50), ".##########.");
	EXPECT_EQ(Row(window, 15, 39, 50), ".#........#.");
	EXPECT_EQ(Row(window, 19, 39, 50), ".##########.");
	EXPECT_EQ(Column(window, 44, 9, 20), ".#........#.");

	EXPECT_EQ(Row(window, 10, 69, 71), ".#.");
	EXPECT_EQ(Row(window, 11, 69, 71), "...");
	EXPECT_EQ(Row(window, 15, 89, 100), "............");
}

TEST_F(DrawingTest, LinesRunFromStartToEndAndThickenUpAndLeft)
{
	BWindow* window = Drawn([](BView* view) {
		view->StrokeLine(BPoint(10, 5), BPoint(15, 5));
		view->StrokeLine(BPoint(30, 0), BPoint(35, 5));
		// The plus of the copy badge: pen size 2 draws the row or column
		// before the line's own, so the mark is centred in (10, 30)-(19, 39).
		view->SetPenSize(2);
		view->StrokeLine(BPoint(12, 35), BPoint(17, 35));
		view->StrokeLine(BPoint(14, 32), BPoint(14, 37));
		view->SetPenSize(3);
		view->StrokeLine(BPoint(40, 50), BPoint(45, 50));
	});
	EXPECT_EQ(Row(window, 5, 8, 17), "..######..");
	for (int32 i = 0; i <= 5; i++)
		EXPECT_EQ(Row(window, i, 29, 36), std::string(i + 1, '.') + "#" + std::string(6 - i, '.'));

	EXPECT_EQ(Row(window, 33, 10, 19), "...##.....");
	EXPECT_EQ(Row(window, 34, 10, 19), "..######..");
	EXPECT_EQ(Row(window, 35, 10, 19), "..######..");
	EXPECT_EQ(Row(window, 36, 10, 19), "...##.....");
	EXPECT_EQ(Column(window, 13, 30, 39), "..######..");
	EXPECT_EQ(Column(window, 15, 30, 39), "....##....");

	EXPECT_EQ(Column(window, 42, 47, 53), "..###..");
	EXPECT_EQ(Row(window, 50, 39, 46), ".######.");
}

TEST_F(DrawingTest, StrokeLineToAPointStartsAtThePenAndMovesIt)
{
	BPoint pen;
	BWindow* window = Drawn([&](BView* view) {
		view->MovePenTo(5, 5);
		view->StrokeLine(BPoint(5, 8));
		view->StrokeLine(BPoint(8, 8));
		pen = view->PenLocation();
	});
	EXPECT_EQ(pen, BPoint(8, 8));
	EXPECT_EQ(Column(window, 5, 4, 9), ".####.");
	EXPECT_EQ(Row(window, 8, 4, 9), ".####.");
}

TEST_F(DrawingTest, ModesAndPatterns)
{
	BWindow* window = Drawn([](BView* view) {
		view->SetLowColor(kRed);
		view->FillRect(BRect(0, 0, 9, 9), B_SOLID_LOW);
		// In B_OP_OVER only the high colour of a pattern is drawn.
		view->SetDrawingMode(B_OP_OVER);
		view->FillRect(BRect(10, 0, 19, 9), B_SOLID_LOW);
		view->FillRect(BRect(20, 0, 29, 9), B_MIXED_COLORS);

		view->SetDrawingMode(B_OP_COPY);
		view->SetHighColor(0, 0, 255);
		view->FillRect(BRect(0, 20, 9, 29));
		view->SetHighColor(0, 0, 0);
		view->FillRect(BRect(10, 20, 19, 29));
		view->SetHighColor(150, 150, 150);
		view->SetDrawingMode(B_OP_MAX);
		view->FillRect(BRect(0, 20, 29, 29));
	});
	EXPECT_EQ(Pixel(window, 5, 5), kRed);
	EXPECT_EQ(Pixel(window, 15, 5), kWhite);
	EXPECT_EQ(Row(window, 0, 20, 27), "#.#.#.#.");
	EXPECT_EQ(Row(window, 1, 20, 27), ".#.#.#.#");
	EXPECT_EQ(Row(window, 1, 20, 27, kWhite), "#.#.#.#.");

	EXPECT_EQ(Pixel(window, 5, 25), make_color(150, 150, 255));
	EXPECT_EQ(Pixel(window, 15, 25), make_color(150, 150, 150));
	EXPECT_EQ(Pixel(window, 25, 25), kWhite);
}

TEST_F(DrawingTest, PushAndPopStateRestoreEverything)
{
	std::vector<rgb_color> highs;
	BPoint pen;
	Drawn([&](BView* view) {
		view->SetHighColor(kRed);
		view->MovePenTo(3, 4);
		view->PushState();
		view->SetHighColor(kBlue);
		view->SetPenSize(5);
		view->SetDrawingMode(B_OP_MAX);
		view->MovePenTo(9, 9);
		{
			BPrivate::StateGuard guard(view);
			view->SetHighColor(kWhite);
		}
		highs.push_back(view->HighColor());
		view->PopState();
		view->PopState();
		highs.push_back(view->HighColor());
		pen = view->PenLocation();
		EXPECT_EQ(view->PenSize(), 1);
		EXPECT_EQ(view->DrawingMode(), B_OP_COPY);
	});
	ASSERT_EQ(highs.size(), 2u);
	EXPECT_EQ(highs[0], kBlue);
	EXPECT_EQ(highs[1], kRed);
	EXPECT_EQ(pen, BPoint(3, 4));
}

TEST_F(DrawingTest, BitmapsHonourTransparencyInOverMode)
{
	BBitmap icon(BRect(0, 0, 3, 3), B_CMAP8);
	std::vector<uint8> indexes(icon.BitsLength(), B_TRANSPARENT_MAGIC_CMAP8);
	uint8 black = BPrivate::IndexForColor(0, 0, 0);
	for (int32 i = 0; i < 4; i++)
		indexes[i * icon.BytesPerRow() + i] = black;
	icon.SetBits(indexes.data(), icon.BitsLength(), 0, B_CMAP8);

	BBitmap translucent(BRect(0, 0, 1, 0), B_RGBA32);
	uint8 pixels[] = {0, 0, 255, 128, 0, 0, 255, 0};
	translucent.SetBits(pixels, sizeof(pixels), 0, B_RGBA32);

	BWindow* window = Drawn([&](BView* view) {
		view->DrawBitmap(&icon, BPoint(10, 10));
		view->SetDrawingMode(B_OP_OVER);
		view->MovePenTo(20, 10);
		view->DrawBitmapAsync(&icon);
		view->DrawBitmap(&translucent, BPoint(30, 10));
		view->DrawBitmap(&icon, icon.Bounds(), BRect(40, 10, 47, 17));
	});
	// Copied, the transparent index shows its own colour.
	EXPECT_EQ(Pixel(window, 11, 10), make_color(0x77, 0x74, 0x77));
	EXPECT_EQ(Row(window, 12, 10, 13), "..#.");
	EXPECT_EQ(Row(window, 12, 20, 23), "..#.");
	EXPECT_EQ(Row(window, 12, 20, 23, kWhite), "##.#");
	EXPECT_EQ(Pixel(window, 30, 10), make_color(255, 127, 127));
	EXPECT_EQ(Pixel(window, 31, 10), kWhite);
	// Scaled to twice the size.
	EXPECT_EQ(Row(window, 12, 40, 47), "..##....");
	EXPECT_EQ(Row(window, 13, 40, 47), "..##....");
	EXPECT_EQ(Row(window, 14, 40, 47), "....##..");
}

TEST_F(DrawingTest, TextRestsOnTheBaselineAndAdvancesThePen)
{
	BFont font;
	font.SetSize(20);
	float width = font.StringWidth("HH");
	BPoint penAfter;
	BWindow* window = Drawn([&](BView* view) {
		view->SetFont(&font);
		view->MovePenTo(10, 30);
		view->DrawString("HH");
		penAfter = view->PenLocation();
		view->DrawString("H", BPoint(10, 60));
	});
	EXPECT_EQ(penAfter, BPoint(10 + width, 30));
	EXPECT_GT(width, 20);

	// Rows and columns with ink (anything not white).
	auto inked = [&](int32 y) {
		return Row(window, y, 0, 119, kWhite).find('.') != std::string::npos;
	};
	int32 top = -1;
	int32 bottom = -1;
	for (int32 y = 0; y < 45; y++) {
		if (inked(y)) {
			if (top < 0)
				top = y;
			bottom = y;
		}
	}
	font_height height;
	font.GetHeight(&height);
	EXPECT_EQ(bottom, 30);
	EXPECT_GE(top, 30 - height.ascent + 1);
	EXPECT_LE(top, 30 - 10);
	EXPECT_GE(Row(window, 25, 0, 119, kWhite).find('.'), 10u);
	EXPECT_TRUE(inked(60));
	EXPECT_FALSE(inked(61));
}

TEST_F(DrawingTest, CopiedTextIsSmoothedAgainstTheLowColour)
{
	BFont font;
	font.SetSize(30);
	auto smoothing = [&](drawing_mode mode) {
		BWindow* window = Drawn([&](BView* view) {
			view->SetFont(&font);
			view->SetHighColor(kRed);
			view->FillRect(view->Bounds());
			view->SetHighColor(kBlack);
			view->SetLowColor(kWhite);
			view->SetDrawingMode(mode);
			view->DrawString("O", BPoint(10, 40));
		});
		// Edge pixels mix black with the low colour (greys) or with the red
		// below (reds).
		int32 greys = 0;
		int32 reds = 0;
		for (int32 y = 0; y < 80; y++) {
			for (int32 x = 0; x < 120; x++) {
				rgb_color color = Pixel(window, x, y);
				if (color == kRed || color == kBlack)
					continue;
				if (color.red == color.green && color.green == color.blue)
					greys++;
				else if (color.green == 0 && color.blue == 0)
					reds++;
			}
		}
		return std::make_pair(greys, reds);
	};
	auto copied = smoothing(B_OP_COPY);
	EXPECT_GT(copied.first, 0);
	EXPECT_EQ(copied.second, 0);
	auto over = smoothing(B_OP_OVER);
	EXPECT_EQ(over.first, 0);
	EXPECT_GT(over.second, 0);
}

}
