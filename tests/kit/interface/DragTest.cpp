// Drags started in a view's MouseDown and dropped on views of any window.

#include <atomic>

#include <Bitmap.h>

#include "ControlTestSupport.h"

using namespace ControlTest;
using BPrivate::Headless::PostMouse;

namespace {

class CountedBitmap : public BBitmap {
public:
	CountedBitmap(std::atomic<int32>* deleted)
		: BBitmap(BRect(0, 0, 29, 19), B_RGB32), fDeleted(deleted) {}
	~CountedBitmap() override { (*fDeleted)++; }

private:
	std::atomic<int32>* fDeleted;
};

// Starts a drag of a 'move' message with a red image at each press, and
// notes the modifiers of the press.
class SourceView : public RecordingView {
public:
	SourceView(BRect frame, std::atomic<int32>* deleted) : RecordingView(frame, "source"),
		fDeleted(deleted) {}

	void MouseDown(BPoint) override
	{
		pressModifiers = Window()->CurrentMessage()->GetInt32("modifiers", -1);
		if (dragsRectangle) {
			BMessage drag('link');
			DragMessage(&drag, BRect(40, 40, 59, 49));
			return;
		}
		BBitmap* image = new CountedBitmap(fDeleted);
		uint32 red = 0xffff0000;
		for (int32 i = 0; i < image->BitsLength() / 4; i++)
			static_cast<uint32*>(image->Bits())[i] = red;
		BMessage drag('move');
		drag.AddInt32("row", 3);
		DragMessage(&drag, image, BPoint(-18, -10));
	}

	std::atomic<int32> pressModifiers{-1};
	std::atomic<bool> dragsRectangle{false};

private:
	std::atomic<int32>* fDeleted;
};

class DragTest : public ControlWindowTest {
protected:
	void SetUp() override
	{
		fSource = new SourceView(BRect(0, 0, 99, 99), &fDeleted);
		fSourceWindow = ShowView(fSource, BRect(100, 100, 199, 199));
		fTarget = new RecordingView(BRect(10, 10, 89, 89), "target");
		fTargetWindow = ShowView(fTarget, BRect(300, 100, 399, 199));
	}

	std::vector<BPrivate::Headless::WindowInfo> DragImages()
	{
		std::vector<BPrivate::Headless::WindowInfo> images;
		for (const auto& info : BPrivate::Headless::ListWindows()) {
			if (info.title == "drag")
				images.push_back(info);
		}
		return images;
	}

	// Moves and releases the pointer at screen, as the display sends a press's
	// events to the window that got the press.
	void DragTo(BPoint screen)
	{
		BPoint where = fSourceWindow->ConvertFromScreen(screen);
		PostMouse(fSourceWindow, B_MOUSE_MOVED, where);
		PostMouse(fSourceWindow, B_MOUSE_UP, where, 0);
		Idle();
	}

	std::atomic<int32> fDeleted{0};
	SourceView* fSource;
	BWindow* fSourceWindow;
	RecordingView* fTarget;
	BWindow* fTargetWindow;
};

TEST_F(DragTest, TheImageFollowsThePointerAndTheDropReachesAnotherWindow)
{
	BPrivate::Headless::SetModifiers(B_CONTROL_KEY);
	PostMouse(fSourceWindow, B_MOUSE_DOWN, BPoint(20, 30));
	Idle();
	BPrivate::Headless::SetModifiers(0);
	EXPECT_EQ(fSource->pressModifiers, B_CONTROL_KEY);
	std::vector<BPrivate::Headless::WindowInfo> images = DragImages();
	ASSERT_EQ(images.size(), 1u);
	// 18 right of and 10 below the pointer, at (120, 130).
	EXPECT_EQ(images[0].frame, BRect(138, 140, 167, 159));
	EXPECT_EQ(Pixel(images[0].window, 5, 5), make_color(255, 0, 0));

	PostMouse(fSourceWindow, B_MOUSE_MOVED, BPoint(230, 60));
	Idle();
	EXPECT_EQ(DragImages()[0].frame.LeftTop(), BPoint(348, 170));

	DragTo(BPoint(340, 160));
	std::vector<BMessage> drops = fTarget->recorder.Messages();
	ASSERT_EQ(drops.size(), 1u);
	EXPECT_EQ(drops[0].what, uint32('move'));
	EXPECT_TRUE(drops[0].WasDropped());
	BPoint offset;
	EXPECT_EQ(drops[0].DropPoint(&offset), BPoint(340, 160));
	EXPECT_EQ(offset, BPoint(-18, -10));
	EXPECT_EQ(drops[0].GetInt32("row", 0), 3);
	EXPECT_TRUE(DragImages().empty());
	EXPECT_EQ(fDeleted, 1);
	EXPECT_TRUE(fSource->recorder.Messages().empty());
}

TEST_F(DragTest, ADropOnTheSourceReachesTheSource)
{
	PostMouse(fSourceWindow, B_MOUSE_DOWN, BPoint(20, 30));
	DragTo(BPoint(160, 160));
	ASSERT_EQ(fSource->recorder.Count('move'), 1);
	EXPECT_TRUE(fSource->recorder.Messages()[0].WasDropped());
	EXPECT_TRUE(fTarget->recorder.Messages().empty());
}

TEST_F(DragTest, ADropWhereNoWindowIsTakesNothing)
{
	PostMouse(fSourceWindow, B_MOUSE_DOWN, BPoint(20, 30));
	DragTo(BPoint(700, 600));
	EXPECT_TRUE(fSource->recorder.Messages().empty());
	EXPECT_TRUE(fTarget->recorder.Messages().empty());
	EXPECT_TRUE(DragImages().empty());
	EXPECT_EQ(fDeleted, 1);
	// The next press starts a new drag.
	PostMouse(fSourceWindow, B_MOUSE_DOWN, BPoint(20, 30));
	DragTo(BPoint(320, 120));
	EXPECT_EQ(fTarget->recorder.Count('move'), 1);
}

TEST_F(DragTest, AReleaseSeenByAnotherWindowEndsThePressToo)
{
	PostMouse(fSourceWindow, B_MOUSE_DOWN, BPoint(20, 30));
	Idle();
	PostMouse(fTargetWindow, B_MOUSE_UP, BPoint(40, 40), 0);
	Idle();
	EXPECT_EQ(fTarget->recorder.Count('move'), 1);
	// The source window's next press goes where it falls, not to the source.
	RecordingView* other = new RecordingView(BRect(0, 0, 9, 9), "other");
	ASSERT_TRUE(fSourceWindow->Lock());
	fSource->MoveTo(10, 10);
	fSourceWindow->AddChild(other);
	fSourceWindow->Unlock();
	PostMouse(fSourceWindow, B_MOUSE_DOWN, BPoint(5, 5));
	PostMouse(fSourceWindow, B_MOUSE_UP, BPoint(5, 5), 0);
	Idle();
	EXPECT_TRUE(DragImages().empty());
}

TEST_F(DragTest, ARectangleCanStandForTheImage)
{
	fSource->dragsRectangle = true;
	PostMouse(fSourceWindow, B_MOUSE_DOWN, BPoint(50, 50));
	Idle();
	ASSERT_EQ(DragImages().size(), 1u);
	EXPECT_EQ(DragImages()[0].frame, BRect(140, 140, 159, 149));
	DragTo(BPoint(330, 130));
	ASSERT_EQ(fTarget->recorder.Count('link'), 1);
	BPoint offset;
	fTarget->recorder.Messages()[0].DropPoint(&offset);
	EXPECT_EQ(offset, BPoint(10, 10));
}

}
