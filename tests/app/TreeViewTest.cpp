// What the tree draws, how it scrolls, and its answers to keys and clicks.

#include "support/AppFixture.h"

#include <ScrollBar.h>

#include "Commands.h"
#include "GvRenView.h"

using namespace AppTest;

namespace {

const rgb_color kPane = { 205, 205, 205, 255 };
const rgb_color kBox = { 80, 80, 80, 255 };
const rgb_color kHighlight = { 150, 150, 150, 255 };

class TreeViewTest : public AppFixture {
protected:
	rgb_color Pixel(float x, float y) { return PixelOf(tree, BPoint(x, y)); }

	// Whether some pixel of the rectangle satisfies test.
	template<typename Test>
	bool Any(BRect area, Test test)
	{
		for (float y = area.top; y <= area.bottom; y++) {
			for (float x = area.left; x <= area.right; x++) {
				if (test(Pixel(x, y)))
					return true;
			}
		}
		return false;
	}

	void Expand(const std::string& path)
	{
		Locked([&] { tree->Expand_Collapse(Item(path)); });
		Idle();
	}
};

bool IsInk(rgb_color color)
{
	return color.red < 120 && color.green < 120 && color.blue < 120;
}

}

TEST_F(TreeViewTest, RowsAreDrawnAtTheirPlaces)
{
	Folder("boot/top/mid/low");
	Start();
	Expand(boot + "/top");
	int32 row = IndexOf(boot + "/top/mid");
	ASSERT_GT(row, 0);
	float y = 20 * row + 5;

	// Level 2: origin 41, box 44 to 52, a plus while collapsed.
	EXPECT_EQ(kBox, Pixel(44, y + 3));
	EXPECT_EQ(kBox, Pixel(52, y + 11));
	EXPECT_EQ(kPane, Pixel(45, y + 4));
	EXPECT_EQ(kBox, Pixel(46, y + 7));
	EXPECT_EQ(kBox, Pixel(48, y + 5));
	EXPECT_FALSE(Any(BRect(41, y, 43, y + 15), IsInk));
	EXPECT_FALSE(Any(BRect(53, y, 54, y + 15), [](rgb_color c) { return c != kPane; }));
	EXPECT_TRUE(Any(BRect(55, y, 70, y + 15), [](rgb_color c) { return c != kPane; }));
	// The label rests on its baseline at y + 11 from x 75 on.
	EXPECT_FALSE(Any(BRect(71, y, 74, y + 15), IsInk));
	EXPECT_TRUE(Any(BRect(75, y + 11, 80, y + 11), IsInk));
	EXPECT_FALSE(Any(BRect(75, y + 12, 100, y + 15), IsInk));

	Expand(boot + "/top/mid");
	EXPECT_EQ(kBox, Pixel(46, y + 7));
	EXPECT_EQ(kPane, Pixel(48, y + 5));
	// Without subfolders, no box.
	int32 lowRow = IndexOf(boot + "/top/mid/low");
	EXPECT_FALSE(Any(BRect(62, 20 * lowRow + 8, 70, 20 * lowRow + 16), IsInk));
}

TEST_F(TreeViewTest, NamesStartingWithBeAreBlueAndRed)
{
	Folder("boot/Beta");
	Folder("boot/beta");
	Start();
	auto blue = [](rgb_color c) { return c.blue > 150 && c.red < 100 && c.green < 100; };
	auto red = [](rgb_color c) { return c.red > 150 && c.blue < 100 && c.green < 100; };
	float y = 20 * IndexOf(boot + "/Beta") + 5;
	EXPECT_TRUE(Any(BRect(57, y, 64, y + 12), blue));
	EXPECT_TRUE(Any(BRect(61, y, 70, y + 12), red));
	EXPECT_TRUE(Any(BRect(66, y, 85, y + 12), IsInk));
	y = 20 * IndexOf(boot + "/beta") + 5;
	EXPECT_FALSE(Any(BRect(57, y, 85, y + 12), blue));
	EXPECT_FALSE(Any(BRect(57, y, 85, y + 12), red));
}

TEST_F(TreeViewTest, TheSelectedRowIsHighlightedAndShown)
{
	Folder("boot/a");
	Start();
	MessageLog* fileList = LogFileList();
	int32 row = IndexOf(boot + "/a");
	float y = 20 * row + 5;
	// Between the icon (from x 37) and the label (from x 57) of level 1.
	EXPECT_EQ(kPane, Pixel(55, y + 1));

	Locked([&] { tree->Select(row); });
	Idle();
	EXPECT_EQ(kHighlight, Pixel(55, y + 1));
	EXPECT_EQ(kHighlight, Pixel(54, y + 8));
	EXPECT_EQ(kPane, Pixel(5, 8));
	EXPECT_EQ("Varnel  (   " + boot + "/a   )", Title());
	std::vector<BMessage> sent = fileList->Take();
	ASSERT_EQ(1u, sent.size());
	entry_ref shown;
	EXPECT_EQ(B_OK, sent[0].FindRef(GV_PARENT_REF, &shown));
	EXPECT_EQ(Ref(boot + "/a"), shown);
	EXPECT_FALSE(sent[0].GetBool(GV_READ_ONLY, true));
	EXPECT_FALSE(sent[0].GetBool(GV_VOLUME, true));
	EXPECT_EQ(kBootDevice, sent[0].GetInt32(GV_DEVICE, 0));

	// Out of range selects the first row.
	Locked([&] { tree->Select(tree->lastVisible + 1); });
	EXPECT_EQ(Locked([&] { return tree->first; }), Locked([&] { return tree->selected; }));
	Locked([&] { tree->Select(-1); });
	EXPECT_EQ(2u, fileList->Take().size());
}

TEST_F(TreeViewTest, SelectionScrollsTheRowIntoView)
{
	for (int i = 0; i < 40; i++)
		Folder("boot/f" + std::to_string(i));
	Start();
	Locked([&] {
		BRect bounds = tree->Bounds();
		int32 partly = int32((bounds.bottom - 5) / 20);
		tree->Select(partly);
		EXPECT_EQ(20, tree->Bounds().top);
		tree->Select(35);
		EXPECT_EQ(BPoint(0, 705), tree->Bounds().LeftTop());
		tree->Select(30);
		EXPECT_EQ(605, tree->Bounds().top);
		tree->Select(0);
		EXPECT_EQ(0, tree->Bounds().top);

		// The vertical bar: 42 rows; the horizontal one follows the labels.
		float min, max;
		tree->verticalBar->GetRange(&min, &max);
		EXPECT_EQ(42 * 20 + 5 - bounds.Height(), max);
		tree->AdjustScrollBars(100, 105);
		tree->verticalBar->GetRange(&min, &max);
		EXPECT_EQ(740, max);
		EXPECT_FLOAT_EQ(105.0f / 845, tree->verticalBar->Proportion());
		tree->AdjustScrollBars(100, 1000);
		tree->verticalBar->GetRange(&min, &max);
		EXPECT_EQ(0, max);
		EXPECT_GT(tree->widestRow, 40);
	});
}

TEST_F(TreeViewTest, KeysMoveTheSelectionToggleAndRefresh)
{
	Folder("boot/a/a1");
	Start();
	MessageLog* fileList = LogFileList();
	FolderItem* a = Item(boot + "/a");
	int32 last = Locked([&] { return tree->lastVisible; });
	Key("\x1e");
	EXPECT_EQ(0, Locked([&] { return tree->IndexOf(tree->selected); }));
	for (int32 i = 0; i < last; i++)
		Key("\x1f");
	EXPECT_EQ(last, Locked([&] { return tree->IndexOf(tree->selected); }));
	Key("\x1f");
	EXPECT_EQ(0, Locked([&] { return tree->IndexOf(tree->selected); }));

	Locked([&] { tree->Select(tree->IndexOf(a)); });
	Key("\x1d");
	EXPECT_TRUE(Locked([&] { return a->expanded; }));
	Key("\x1c");
	EXPECT_FALSE(Locked([&] { return a->expanded; }));
	fileList->Take();

	char function[] = { B_FUNCTION_KEY, 0 };
	Key(function, B_F1_KEY);
	EXPECT_TRUE(fileList->Take().empty());
	Key(function, B_F5_KEY);
	std::vector<BMessage> sent = fileList->Take();
	ASSERT_EQ(1u, sent.size());
	EXPECT_TRUE(sent[0].IsEmpty());
}

TEST_F(TreeViewTest, ClicksSelectOnLabelsAndToggleOnBoxes)
{
	Folder("boot/a/a1");
	Folder("boot/leaf");
	Start();
	FolderItem* a = Item(boot + "/a");
	float aTop = 20 * IndexOf(boot + "/a") + 5;
	float leafTop = 20 * IndexOf(boot + "/leaf") + 5;

	Click(BPoint(23 + 7, aTop + 7));
	EXPECT_TRUE(Locked([&] { return a->expanded; }));
	EXPECT_EQ(Locked([&] { return tree->first; }), Locked([&] { return tree->selected; }));
	Click(BPoint(23 + 7, aTop + 7));
	EXPECT_FALSE(Locked([&] { return a->expanded; }));
	// Between box and icon, and right of the label: nothing.
	Click(BPoint(23 + 13, aTop + 5));
	Click(BPoint(23 + 34 + Locked([&] { return a->textWidth; }) + 5, aTop + 5));
	EXPECT_EQ(Locked([&] { return tree->first; }), Locked([&] { return tree->selected; }));

	Click(BPoint(23 + 40, leafTop + 5));
	EXPECT_EQ(Item(boot + "/leaf"), Locked([&] { return tree->selected; }));
	EXPECT_EQ("Varnel  (   " + boot + "/leaf   )", Title());

	// A double click on another row selects it, then toggles it.
	Click(BPoint(23 + 40, aTop + 5), B_PRIMARY_MOUSE_BUTTON, 1);
	Click(BPoint(23 + 40, aTop + 5), B_PRIMARY_MOUSE_BUTTON, 2);
	EXPECT_EQ(a, Locked([&] { return tree->selected; }));
	EXPECT_TRUE(Locked([&] { return a->expanded; }));
}
