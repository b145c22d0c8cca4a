// The status bar driven by messages from another thread, as the progress
// window's engine drives it.

#include <cmath>
#include <thread>

#include <StatusBar.h>

#include "ControlTestSupport.h"

using namespace ControlTest;

namespace {

class StatusBarTest : public ControlWindowTest {
protected:
	void SetUp() override
	{
		fBar = new BStatusBar(BRect(20, 10, 279, 30), "bar", "Copying: ", " items remaining");
		fWindow = ShowView(fBar, BRect(100, 100, 399, 159));
	}

	template<typename Check>
	void Locked(Check check)
	{
		ASSERT_TRUE(fWindow->Lock());
		check();
		fWindow->Unlock();
	}

	BWindow* fWindow;
	BStatusBar* fBar;
};

TEST_F(StatusBarTest, TakesTheHeightOfItsTextAndBar)
{
	font_height height;
	be_plain_font->GetHeight(&height);
	Locked([&] {
		EXPECT_EQ(fBar->Frame().Height(),
			std::ceil(height.ascent) + std::ceil(height.descent) + 3 + 16 - 1);
		EXPECT_EQ(fBar->Frame().Width(), 259);
		EXPECT_EQ(fBar->MaxValue(), 100);
		EXPECT_STREQ(fBar->Label(), "Copying: ");
		EXPECT_STREQ(fBar->TrailingLabel(), " items remaining");
	});
}

TEST_F(StatusBarTest, UpdatesFromAnotherThreadAddUp)
{
	Locked([&] { fBar->SetMaxValue(1000); });
	std::thread engine([this] {
		BMessage update(B_UPDATE_STATUS_BAR);
		update.AddFloat("delta", 1.0f);
		for (int32 i = 0; i < 300; i++)
			fWindow->PostMessage(&update, fBar);
		BMessage texts(B_UPDATE_STATUS_BAR);
		texts.AddFloat("delta", 0.5f);
		texts.AddString("text", "file.txt");
		texts.AddString("trailing_text", "7");
		fWindow->PostMessage(&texts, fBar);
	});
	engine.join();
	Idle();
	Locked([&] {
		EXPECT_EQ(fBar->CurrentValue(), 300.5f);
		EXPECT_STREQ(fBar->Text(), "file.txt");
		EXPECT_STREQ(fBar->TrailingText(), "7");
	});
}

TEST_F(StatusBarTest, ResetStartsAgainWithNewLabels)
{
	Locked([&] {
		fBar->SetMaxValue(10);
		fBar->Update(25, "x", "y");
		// The value stays within the maximum.
		EXPECT_EQ(fBar->CurrentValue(), 10);
	});
	BMessage reset(B_RESET_STATUS_BAR);
	reset.AddString("label", "Deleting ");
	reset.AddString("trailing_label", " items remaining");
	fWindow->PostMessage(&reset, fBar);
	Idle();
	Locked([&] {
		EXPECT_EQ(fBar->CurrentValue(), 0);
		EXPECT_EQ(fBar->MaxValue(), 100);
		EXPECT_STREQ(fBar->Label(), "Deleting ");
		EXPECT_STREQ(fBar->Text(), "");
		EXPECT_STREQ(fBar->TrailingText(), "");
	});
	// Without labels, a reset clears them.
	fWindow->PostMessage(B_RESET_STATUS_BAR, fBar);
	Idle();
	Locked([&] { EXPECT_STREQ(fBar->Label(), ""); });
}

TEST_F(StatusBarTest, TheBarFillsInItsColour)
{
	Locked([&] {
		fBar->SetBarColor(make_color(200, 0, 0));
		fBar->Update(50);
	});
	Idle();
	BRect frame;
	Locked([&] { frame = fBar->Frame(); });
	int32 y = int32(frame.bottom) - 8;
	EXPECT_EQ(Pixel(fWindow, int32(frame.left) + 10, y), make_color(200, 0, 0));
	EXPECT_EQ(Pixel(fWindow, int32(frame.right) - 10, y), make_color(255, 255, 255));
}

}
