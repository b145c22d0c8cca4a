// A window's menu bar: menus opened with the mouse and the keyboard, items
// invoked, shortcuts, and the window's menu hooks.

#include <Menu.h>
#include <MenuBar.h>
#include <MenuItem.h>

#include "ControlTestSupport.h"

using namespace ControlTest;
using BPrivate::Headless::PostMouse;

namespace {

class MenuTest : public ControlWindowTest {
protected:
	void SetUp() override
	{
		fWindow = MakeRecordingWindow(BRect(100, 100, 399, 299));
		fBar = new BMenuBar(BRect(0, 0, 299, 40), "bar");
		fFiles = new BMenu("Files");
		fFiles->AddItem(new BMenuItem("Open", new BMessage('open'), 'O'));
		fFiles->AddItem(new BMenuItem("Rename", new BMessage('arnm'), 'R'));
		fFiles->AddSeparatorItem();
		fFiles->AddItem(new BMenuItem("Save as", new BMessage('save'), 'S', B_SHIFT_KEY));
		BMenu* help = new BMenu("Help");
		help->AddItem(new BMenuItem("About", new BMessage('abou')));
		fBar->AddItem(fFiles);
		fBar->AddItem(help);
		fWindow->AddChild(fBar);
		fWindow->Show();
		Idle();
	}

	BPoint Title(int32 index)
	{
		BRect frame = fBar->ItemAt(index)->Frame();
		return BPoint((frame.left + frame.right) / 2, (frame.top + frame.bottom) / 2);
	}

	// The middle of item index of the open menu, in the window's coordinates.
	BPoint Item(int32 index)
	{
		std::vector<BPrivate::Headless::WindowInfo> menus = OpenMenus();
		EXPECT_EQ(menus.size(), 1u);
		if (menus.empty())
			return BPoint(-100, -100);
		static const float kMiddles[] = {11, 28, 41, 53};
		return fWindow->ConvertFromScreen(menus[0].frame.LeftTop() + BPoint(30, kMiddles[index]));
	}

	// Clicks a title and waits for what follows.
	void ClickTitle(int32 index)
	{
		Click(fWindow, Title(index));
		Idle();
	}

	// The title of the one open menu, empty when not exactly one is open.
	static std::string OpenTitle()
	{
		std::vector<BPrivate::Headless::WindowInfo> menus = OpenMenus();
		return menus.size() == 1 ? menus[0].title : std::string();
	}

	void Shortcut(const char* key, uint32 modifiers = B_CONTROL_KEY)
	{
		BPrivate::Headless::SetModifiers(modifiers);
		Key(fWindow, key);
		Idle();
		BPrivate::Headless::SetModifiers(0);
	}

	void SetEnabled(BMenuItem* item, bool enabled)
	{
		ASSERT_TRUE(fWindow->Lock());
		item->SetEnabled(enabled);
		fWindow->Unlock();
	}

	RecordingWindow* fWindow;
	BMenuBar* fBar;
	BMenu* fFiles;
};

TEST_F(MenuTest, TheBarFitsItsFontAndLaysTitlesInARow)
{
	EXPECT_EQ(fBar->Frame(), BRect(0, 0, 299, 19));
	EXPECT_EQ(fBar->CountItems(), 2);
	EXPECT_EQ(fBar->SubmenuAt(0), fFiles);
	BRect files = fBar->ItemAt(0)->Frame();
	BRect help = fBar->ItemAt(1)->Frame();
	EXPECT_EQ(help.left, files.right + 1);
	EXPECT_EQ(help.top, files.top);
	EXPECT_EQ(fFiles->ItemAt(3)->Label(), std::string("Save as"));
	EXPECT_EQ(fFiles->FindItem('arnm'), fFiles->ItemAt(1));
}

TEST_F(MenuTest, ShortcutsShowAsCtrlLettersAtTheRight)
{
	ClickTitle(0);
	const BWindow* menu = OpenMenus()[0].window;
	BRect frame = OpenMenus()[0].frame;
	// Where the ink of a row begins, right of the labels.
	auto inkFrom = [&](int32 top) {
		for (int32 x = 60; x < frame.Width(); x++) {
			for (int32 y = top; y < top + 15; y++) {
				if (Pixel(menu, x, y).red < 100)
					return float(x);
			}
		}
		return -1.0f;
	};
	// Text ends 10 pixels inside the menu's item column, which ends 3 inside.
	float right = frame.Width() - 3 - 10 + 1;
	EXPECT_NEAR(inkFrom(4), right - be_plain_font->StringWidth("Ctrl+O"), 2);
	EXPECT_NEAR(inkFrom(46), right - be_plain_font->StringWidth("Shift+Ctrl+S"), 2);
	Key(fWindow, "\x1b", 1);
	Idle();
}

TEST_F(MenuTest, ShortcutsInvokeEnabledItemsOnly)
{
	Shortcut("o");
	EXPECT_EQ(fWindow->recorder.Count('open'), 1);
	// The window hears first, so that it can set the items' states.
	EXPECT_EQ(fWindow->menusBeginning, 1);
	EXPECT_EQ(fWindow->menusEnded, 1);

	SetEnabled(fFiles->ItemAt(0), false);
	Shortcut("o");
	EXPECT_EQ(fWindow->recorder.Count('open'), 1);
	// A disabled menu disables its items too.
	SetEnabled(fFiles->ItemAt(0), true);
	ASSERT_TRUE(fWindow->Lock());
	fFiles->SetEnabled(false);
	fWindow->Unlock();
	Shortcut("o");
	EXPECT_EQ(fWindow->recorder.Count('open'), 1);
	ASSERT_TRUE(fWindow->Lock());
	fFiles->SetEnabled(true);
	fWindow->Unlock();

	// Shift must match; without Ctrl, or with Alt, a letter is just a letter.
	Shortcut("s");
	EXPECT_EQ(fWindow->recorder.Count('save'), 0);
	Shortcut("S", B_CONTROL_KEY | B_SHIFT_KEY);
	EXPECT_EQ(fWindow->recorder.Count('save'), 1);
	Shortcut("r", 0);
	Shortcut("r", B_COMMAND_KEY);
	Shortcut("r", B_COMMAND_KEY | B_CONTROL_KEY);
	EXPECT_EQ(fWindow->recorder.Count('arnm'), 0);
	Shortcut("r");
	ASSERT_EQ(fWindow->recorder.Count('arnm'), 1);
	BMessage invoked = fWindow->recorder.Messages().back();
	EXPECT_EQ(invoked.GetInt32("index", -1), 1);
	EXPECT_TRUE(invoked.HasInt64("when"));
}

TEST_F(MenuTest, AClickOpensAMenuAndAnotherChoosesAnItem)
{
	ClickTitle(0);
	EXPECT_EQ(fWindow->menusBeginning, 1);
	EXPECT_EQ(OpenTitle(), "Files");
	// Below its title.
	EXPECT_EQ(OpenMenus()[0].frame.LeftTop(),
		fWindow->ConvertToScreen(fBar->ItemAt(0)->Frame().LeftBottom() + BPoint(0, 1)));

	Click(fWindow, Item(1));
	Idle();
	EXPECT_TRUE(OpenMenus().empty());
	EXPECT_EQ(fWindow->recorder.Count('arnm'), 1);
	EXPECT_EQ(fWindow->menusEnded, 1);
	// The press on the bar is over: the window's next click goes where it
	// falls.
	Click(fWindow, BPoint(150, 100));
	Idle();
	EXPECT_TRUE(OpenMenus().empty());
}

TEST_F(MenuTest, PressingDraggingAndReleasingChooses)
{
	PostMouse(fWindow, B_MOUSE_DOWN, Title(0));
	Idle();
	BPoint open = Item(0);
	PostMouse(fWindow, B_MOUSE_MOVED, open);
	PostMouse(fWindow, B_MOUSE_UP, open, 0);
	Idle();
	EXPECT_EQ(fWindow->recorder.Count('open'), 1);
	EXPECT_TRUE(OpenMenus().empty());
}

TEST_F(MenuTest, MovingAlongTheBarSwitchesMenus)
{
	Click(fWindow, Title(0));
	PostMouse(fWindow, B_MOUSE_MOVED, Title(1), 0);
	Idle();
	EXPECT_EQ(OpenTitle(), "Help");
	// A click on the open title closes it.
	ClickTitle(1);
	EXPECT_TRUE(OpenMenus().empty());
	EXPECT_EQ(fWindow->menusBeginning, 1);
	EXPECT_EQ(fWindow->menusEnded, 1);
	EXPECT_TRUE(fWindow->recorder.Messages().empty());
}

TEST_F(MenuTest, DisabledItemsAreGreyAndStayPut)
{
	SetEnabled(fFiles->ItemAt(1), false);
	ClickTitle(0);
	const BWindow* menu = OpenMenus()[0].window;
	// Black ink in the enabled label's row, none in the disabled one's.
	auto inked = [&](int32 y) {
		for (int32 x = 18; x < 60; x++) {
			if (Pixel(menu, x, y).red < 60)
				return true;
		}
		return false;
	};
	bool enabledInk = false;
	bool disabledInk = false;
	for (int32 y = 4; y < 19; y++)
		enabledInk = enabledInk || inked(y);
	for (int32 y = 21; y < 36; y++)
		disabledInk = disabledInk || inked(y);
	EXPECT_TRUE(enabledInk);
	EXPECT_FALSE(disabledInk);

	Click(fWindow, Item(1));
	Idle();
	EXPECT_EQ(OpenMenus().size(), 1u);
	EXPECT_EQ(fWindow->recorder.Count('arnm'), 0);
	Key(fWindow, "\x1b", 1);
	Idle();
	EXPECT_TRUE(OpenMenus().empty());
}

TEST_F(MenuTest, TheKeyboardWorksInAnOpenMenu)
{
	// Keys go to the menu once it is open.
	ClickTitle(0);
	// Down twice: Open, Rename; Up twice wraps past the top to "Save as".
	Key(fWindow, "\x1f");
	Key(fWindow, "\x1f");
	Key(fWindow, "\x1e");
	Key(fWindow, "\x1e");
	Key(fWindow, "\n");
	Idle();
	EXPECT_EQ(fWindow->recorder.Count('save'), 1);

	// Right moves to the next menu, with its first item selected.
	ClickTitle(0);
	Key(fWindow, "\x1d");
	Idle();
	EXPECT_EQ(OpenTitle(), "Help");
	Key(fWindow, "\n");
	Idle();
	EXPECT_EQ(fWindow->recorder.Count('abou'), 1);

	// Escape closes without a choice.
	ClickTitle(1);
	Key(fWindow, "\x1b", 1);
	Idle();
	EXPECT_TRUE(OpenMenus().empty());
	EXPECT_EQ(fWindow->recorder.Messages().size(), 2u);
	EXPECT_EQ(fWindow->menusBeginning, 3);
	EXPECT_EQ(fWindow->menusEnded, 3);
}

TEST_F(MenuTest, AMenuStillClosingReopensOnceItsWindowLetsItGo)
{
	ClickTitle(0);
	// Left may well come while "Files" is still in its closing window.
	Key(fWindow, "\x1d");
	Key(fWindow, "\x1c");
	Idle();
	EXPECT_EQ(OpenTitle(), "Files");
	Key(fWindow, "\n");
	Idle();
	EXPECT_EQ(fWindow->recorder.Count('open'), 1);
}

TEST_F(MenuTest, TargetsAndLabelsCanChange)
{
	RecordingView* view = new RecordingView(BRect(0, 30, 50, 60));
	ASSERT_TRUE(fWindow->Lock());
	fWindow->AddChild(view);
	fFiles->SetTargetForItems(view);
	fFiles->ItemAt(0)->SetLabel("Expand/Collapse");
	fWindow->Unlock();
	ClickTitle(0);
	// The menu widened for the longer label.
	EXPECT_GT(OpenMenus()[0].frame.Width(), 100);
	Click(fWindow, Item(0));
	Idle();
	EXPECT_EQ(view->recorder.Count('open'), 1);
	EXPECT_EQ(fWindow->recorder.Count('open'), 0);
}

TEST_F(MenuTest, ClosingTheWindowClosesItsMenus)
{
	ClickTitle(0);
	ASSERT_EQ(OpenMenus().size(), 1u);
	ASSERT_TRUE(fWindow->Lock());
	fWindow->Quit();
	Forget(fWindow);
	Idle();
	EXPECT_TRUE(OpenMenus().empty());
}

}
