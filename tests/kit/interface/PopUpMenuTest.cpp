// Pop-up menus opened from a view's MouseDown, chosen and dismissed by input
// posted while the view's window waits in Go.

#include <atomic>
#include <string>

#include <MenuItem.h>
#include <PopUpMenu.h>

#include "ControlTestSupport.h"

using namespace ControlTest;
using BPrivate::Headless::PostMouse;

namespace {

// Opens a menu of three items ("Open", a separator, "Rename", "Delete" which
// is disabled) at each press, as the panes do.
class PopUpView : public RecordingView {
public:
	explicit PopUpView(BRect frame) : RecordingView(frame) {}

	void MouseDown(BPoint where) override
	{
		BPopUpMenu* menu = new BPopUpMenu("popup", false, false);
		menu->AddItem(new BMenuItem("Open", new BMessage('open')));
		menu->AddSeparatorItem();
		menu->AddItem(new BMenuItem("Rename", new BMessage('arnm')));
		BMenuItem* disabled = new BMenuItem("Delete", new BMessage('delt'));
		disabled->SetEnabled(false);
		menu->AddItem(disabled);
		if (targeted)
			menu->SetTargetForItems(this);
		BPoint screen = ConvertToScreen(where);
		BMenuItem* chosen = menu->Go(screen, deliversMessage, openAnyway,
			BRect(screen - BPoint(5, 5), screen + BPoint(5, 5)));
		std::lock_guard<std::mutex> guard(fLock);
		fResult = chosen != nullptr ? chosen->Label() : "(none)";
		fReturns++;
		delete menu;
	}

	std::string Result()
	{
		std::lock_guard<std::mutex> guard(fLock);
		return fResult;
	}

	int32 Returns()
	{
		std::lock_guard<std::mutex> guard(fLock);
		return fReturns;
	}

	bool deliversMessage = true;
	bool openAnyway = true;
	bool targeted = true;

private:
	std::mutex fLock;
	std::string fResult;
	int32 fReturns = 0;
};

class PopUpMenuTest : public ControlWindowTest {
protected:
	void SetUp() override
	{
		fView = new PopUpView(BRect(0, 0, 199, 149));
		fWindow = MakeRecordingWindow(BRect(100, 100, 299, 249));
		fWindow->AddChild(fView);
		fWindow->Show();
		Idle();
	}

	// Presses at where in the window and returns the menu's frame.
	BRect Open(BPoint where = BPoint(50, 40))
	{
		PostMouse(fWindow, B_MOUSE_MOVED, where, 0);
		PostMouse(fWindow, B_MOUSE_DOWN, where);
		Idle();
		std::vector<BPrivate::Headless::WindowInfo> menus = OpenMenus();
		EXPECT_EQ(menus.size(), 1u);
		return menus.empty() ? BRect() : menus[0].frame;
	}

	// The middle of item index in screen coordinates (items are 17 high and
	// start 3 below the menu's top; the separator is 8 high).
	static BPoint ItemPoint(BRect menu, int32 index)
	{
		static const float kMiddles[] = {11, 24, 36, 53};
		return BPoint(menu.left + 20, menu.top + kMiddles[index]);
	}

	// Posts a mouse event at a screen point to the view's window, as the
	// display would deliver it there.
	void Post(uint32 what, BPoint screen, uint32 buttons)
	{
		PostMouse(fWindow, what, fWindow->ConvertFromScreen(screen), buttons);
	}

	// Drags the pointer, the button still held since the press, to screen
	// and releases it there.
	void ReleaseAt(BPoint screen)
	{
		Post(B_MOUSE_MOVED, screen, B_PRIMARY_MOUSE_BUTTON);
		Post(B_MOUSE_UP, screen, 0);
		Idle();
	}

	PopUpView* fView;
	RecordingWindow* fWindow;
};

TEST_F(PopUpMenuTest, AClickOpensItAndASecondClickChooses)
{
	BRect menu = Open();
	EXPECT_EQ(menu.LeftTop(), BPoint(150, 140));
	// The release right after the press keeps it open.
	Post(B_MOUSE_UP, BPoint(150, 140), 0);
	Idle();
	ASSERT_EQ(OpenMenus().size(), 1u);
	EXPECT_EQ(fView->Returns(), 0);

	BPoint rename = ItemPoint(menu, 2);
	Post(B_MOUSE_MOVED, rename, 0);
	Post(B_MOUSE_DOWN, rename, B_PRIMARY_MOUSE_BUTTON);
	Post(B_MOUSE_UP, rename, 0);
	Idle();
	EXPECT_TRUE(OpenMenus().empty());
	EXPECT_EQ(fView->Result(), "Rename");
	ASSERT_EQ(fView->recorder.Count('arnm'), 1);
	EXPECT_EQ(fView->recorder.Messages()[0].GetInt32("index", -1), 2);
}

TEST_F(PopUpMenuTest, PressDragAndReleaseChooses)
{
	ReleaseAt(ItemPoint(Open(), 0));
	EXPECT_EQ(fView->Result(), "Open");
	EXPECT_EQ(fView->recorder.Count('open'), 1);
}

TEST_F(PopUpMenuTest, DisabledItemsAndSeparatorsChooseNothing)
{
	BRect menu = Open();
	Post(B_MOUSE_UP, menu.LeftTop(), 0);
	for (int32 index : {1, 3}) {
		Post(B_MOUSE_DOWN, ItemPoint(menu, index), B_PRIMARY_MOUSE_BUTTON);
		Post(B_MOUSE_UP, ItemPoint(menu, index), 0);
	}
	Idle();
	EXPECT_EQ(OpenMenus().size(), 1u);
	EXPECT_EQ(fView->Returns(), 0);
	Key(fWindow, "\x1b", 1);
	Idle();
	EXPECT_EQ(fView->Result(), "(none)");
	EXPECT_TRUE(fView->recorder.Messages().empty());
}

TEST_F(PopUpMenuTest, AClickOutsideDismissesIt)
{
	BRect menu = Open();
	Post(B_MOUSE_UP, menu.LeftTop(), 0);
	// Elsewhere in the window that waits, as the user would click.
	Click(fWindow, BPoint(5, 5));
	Idle();
	EXPECT_TRUE(OpenMenus().empty());
	EXPECT_EQ(fView->Result(), "(none)");
	EXPECT_TRUE(fView->recorder.Messages().empty());
	// The window is its old self: the next press opens a new menu.
	Open();
	Key(fWindow, "\x1b", 1);
	Idle();
	EXPECT_EQ(fView->Returns(), 2);
}

TEST_F(PopUpMenuTest, KeyboardMovesOverSelectableItemsOnly)
{
	BRect menu = Open();
	Post(B_MOUSE_UP, menu.LeftTop(), 0);
	// Down selects "Open", then "Rename", skipping the separator; Up from
	// the top wraps to the last selectable item.
	Key(fWindow, "\x1f");
	Key(fWindow, "\x1f");
	Key(fWindow, "\n");
	Idle();
	EXPECT_EQ(fView->Result(), "Rename");

	Open();
	Post(B_MOUSE_UP, menu.LeftTop(), 0);
	Key(fWindow, "\x1e");
	Key(fWindow, "\n");
	Idle();
	EXPECT_EQ(fView->Result(), "Rename");
	EXPECT_EQ(fView->recorder.Count('arnm'), 2);
}

TEST_F(PopUpMenuTest, ReleasingFarAwayClosesWithoutOpenAnyway)
{
	fView->openAnyway = false;
	Open();
	ReleaseAt(BPoint(110, 230));
	EXPECT_TRUE(OpenMenus().empty());
	EXPECT_EQ(fView->Result(), "(none)");
}

TEST_F(PopUpMenuTest, WithoutDeliveryOnlyTheResultTells)
{
	fView->deliversMessage = false;
	ReleaseAt(ItemPoint(Open(), 0));
	EXPECT_EQ(fView->Result(), "Open");
	EXPECT_TRUE(fView->recorder.Messages().empty());
	EXPECT_TRUE(fWindow->recorder.Messages().empty());
}

TEST_F(PopUpMenuTest, ItemsWithoutTargetGoToTheOpeningWindow)
{
	fView->targeted = false;
	ReleaseAt(ItemPoint(Open(), 0));
	EXPECT_EQ(fWindow->recorder.Count('open'), 1);
}

TEST_F(PopUpMenuTest, MenusStayOnTheScreen)
{
	BPrivate::Headless::SetScreenSize(320, 260);
	BRect menu = Open(BPoint(195, 145));
	BPrivate::Headless::SetScreenSize(1024, 768);
	EXPECT_LE(menu.right, 319);
	EXPECT_LE(menu.bottom, 259);
	EXPECT_GE(menu.left, 0);
	EXPECT_GE(menu.top, 0);
	Key(fWindow, "\x1b", 1);
	Idle();
}

class CountedMenu : public BPopUpMenu {
public:
	explicit CountedMenu(std::atomic<int32>* deleted) : BPopUpMenu("async"), fDeleted(deleted) {}
	~CountedMenu() override { (*fDeleted)++; }

private:
	std::atomic<int32>* fDeleted;
};

TEST_F(PopUpMenuTest, AsynchronousMenusReturnAtOnceAndCanDeleteThemselves)
{
	std::atomic<int32> deleted{0};
	CountedMenu* menu = new CountedMenu(&deleted);
	menu->AddItem(new BMenuItem("First", new BMessage('frst')));
	menu->SetTargetForItems(BMessenger(fView));
	menu->SetAsyncAutoDestruct(true);
	EXPECT_EQ(menu->Go(BPoint(400, 300), true, false, true), nullptr);
	Idle();
	std::vector<BPrivate::Headless::WindowInfo> menus = OpenMenus();
	ASSERT_EQ(menus.size(), 1u);
	BPoint item = menus[0].frame.LeftTop() + BPoint(20, 11);
	Post(B_MOUSE_DOWN, item, B_PRIMARY_MOUSE_BUTTON);
	Post(B_MOUSE_UP, item, 0);
	Idle();
	EXPECT_EQ(fView->recorder.Count('frst'), 1);
	EXPECT_EQ(deleted, 1);
}

}
