// Scroll bars and their targets, moved by the bar's parts, by the target and
// by the wheel.

#include <ScrollBar.h>

#include "ControlTestSupport.h"

using namespace ControlTest;
using BPrivate::Headless::PostMouse;

namespace {

class ScrollBarTest : public ControlWindowTest {
protected:
	void SetUp() override
	{
		fTarget = new BView(BRect(0, 0, 99, 199), "target", B_FOLLOW_ALL, B_WILL_DRAW);
		// A track of 170 pixels between the arrows (0-14 and 185-199).
		fBar = new BScrollBar(BRect(100, 0, 114, 199), "vbar", fTarget, 0, 0, B_VERTICAL);
		fWindow = MakeWindow(BRect(100, 100, 219, 299));
		fWindow->AddChild(fTarget);
		fWindow->AddChild(fBar);
		fWindow->Show();
		ASSERT_TRUE(fWindow->Lock());
		// The thumb is 43 pixels long, leaving 127 to move in, 2 units a pixel.
		fBar->SetRange(0, 254);
		fBar->SetProportion(0.25f);
		fBar->SetSteps(5, 40);
		fWindow->Unlock();
		Idle();
	}

	float Value()
	{
		fWindow->Lock();
		float value = fBar->Value();
		fWindow->Unlock();
		return value;
	}

	float TargetTop()
	{
		fWindow->Lock();
		float top = fTarget->Bounds().top;
		fWindow->Unlock();
		return top;
	}

	void Press(BPoint where)
	{
		PostMouse(fWindow, B_MOUSE_DOWN, where);
		PostMouse(fWindow, B_MOUSE_UP, where, 0);
		Idle();
	}

	BWindow* fWindow;
	BView* fTarget;
	BScrollBar* fBar;
};

TEST_F(ScrollBarTest, TheTargetFindsItsBarsAndTheyMoveTogether)
{
	ASSERT_TRUE(fWindow->Lock());
	EXPECT_EQ(fTarget->ScrollBar(B_VERTICAL), fBar);
	EXPECT_EQ(fTarget->ScrollBar(B_HORIZONTAL), nullptr);
	EXPECT_EQ(fBar->Target(), fTarget);
	EXPECT_EQ(fBar->Orientation(), B_VERTICAL);
	EXPECT_EQ(fBar->ResizingMode(), uint32(B_FOLLOW_TOP_BOTTOM | B_FOLLOW_RIGHT));

	fBar->SetValue(50);
	EXPECT_EQ(fTarget->Bounds().top, 50);
	fTarget->ScrollTo(0, 120);
	EXPECT_EQ(fBar->Value(), 120);
	// Out of range, the bar shows its end without pulling the target back.
	fTarget->ScrollTo(0, 400);
	EXPECT_EQ(fBar->Value(), 254);
	EXPECT_EQ(fTarget->Bounds().top, 400);
	// A range that shrinks below the value scrolls the target back in.
	fBar->SetRange(0, 100);
	EXPECT_EQ(fBar->Value(), 100);
	EXPECT_EQ(fTarget->Bounds().top, 100);
	fBar->SetValue(-20);
	EXPECT_EQ(fBar->Value(), 0);
	fBar->SetRange(10, 5);
	float min;
	float max;
	fBar->GetRange(&min, &max);
	EXPECT_EQ(min, 10);
	EXPECT_EQ(max, 10);
	fWindow->Unlock();
}

TEST_F(ScrollBarTest, ArrowsStepSmallAndTheTrackLarge)
{
	Press(BPoint(107, 192));
	EXPECT_EQ(Value(), 5);
	EXPECT_EQ(TargetTop(), 5);
	Press(BPoint(107, 7));
	EXPECT_EQ(Value(), 0);
	// Below the thumb (15-57), then above it.
	Press(BPoint(107, 150));
	EXPECT_EQ(Value(), 40);
	Press(BPoint(107, 17));
	EXPECT_EQ(Value(), 0);
}

TEST_F(ScrollBarTest, DraggingTheThumbFollowsThePointer)
{
	PostMouse(fWindow, B_MOUSE_DOWN, BPoint(107, 30));
	PostMouse(fWindow, B_MOUSE_MOVED, BPoint(107, 40));
	Idle();
	EXPECT_EQ(Value(), 20);
	// Far beyond the end, the value stops at the range's end.
	PostMouse(fWindow, B_MOUSE_MOVED, BPoint(40, 500));
	PostMouse(fWindow, B_MOUSE_UP, BPoint(40, 500), 0);
	Idle();
	EXPECT_EQ(Value(), 254);
	EXPECT_EQ(TargetTop(), 254);
}

TEST_F(ScrollBarTest, AnEmptyRangeIgnoresTheMouse)
{
	ASSERT_TRUE(fWindow->Lock());
	fBar->SetRange(0, 0);
	fWindow->Unlock();
	Press(BPoint(107, 192));
	Press(BPoint(107, 150));
	EXPECT_EQ(Value(), 0);
}

TEST_F(ScrollBarTest, TheWheelScrollsThroughTheVerticalBar)
{
	PostMouse(fWindow, B_MOUSE_MOVED, BPoint(50, 50), 0);
	ASSERT_EQ(BPrivate::Headless::PostWheel(fWindow, 0, 2), B_OK);
	Idle();
	// Three small steps a notch.
	EXPECT_EQ(Value(), 30);
	EXPECT_EQ(TargetTop(), 30);
}

TEST_F(ScrollBarTest, TheThumbShowsTheValue)
{
	rgb_color track = Pixel(fWindow, 107, 150);
	ASSERT_TRUE(fWindow->Lock());
	fBar->SetValue(254);
	fWindow->Unlock();
	Idle();
	// The thumb left the top of the track for its bottom.
	EXPECT_EQ(Pixel(fWindow, 107, 30), track);
	EXPECT_NE(Pixel(fWindow, 107, 160), track);
}

TEST_F(ScrollBarTest, DeletingTheTargetFirstLeavesTheBarUsable)
{
	ASSERT_TRUE(fWindow->Lock());
	fTarget->RemoveSelf();
	delete fTarget;
	EXPECT_EQ(fBar->Target(), nullptr);
	fBar->SetValue(30);
	EXPECT_EQ(fBar->Value(), 30);
	fWindow->Unlock();
}

}
