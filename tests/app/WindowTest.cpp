// The main window: its two layouts, the menus and their enabling, the routing
// of commands, Help and the title.

#include "support/AppFixture.h"

#include <Alert.h>
#include <Menu.h>
#include <MenuBar.h>
#include <MenuItem.h>
#include <ScrollBar.h>
#include <TextView.h>

#include <filesystem>

#include "Commands.h"
#include "GvFilesView.h"
#include "GvRenView.h"
#include "GvScrollView.h"
#include "RosterPrivate.h"

using namespace AppTest;

namespace {

class WindowTest : public AppFixture {
protected:
	void TearDown() override
	{
		BPrivate::Headless::SetScreenSize(1024, 768);
		BPrivate::SetLaunchHook(nullptr);
		AppFixture::TearDown();
	}

	BRect FrameOf(const char* name)
	{
		return Locked([&] { return window->FindView(name)->Frame(); });
	}

	// The enabled state of Files items 0, 1, 2, 4 and 6 after MenusBeginning.
	std::string MenuState()
	{
		return Locked([&] {
			window->MenusBeginning();
			std::string state;
			for (int32 index : { 0, 1, 2, 4, 6 })
				state += window->filesMenu->ItemAt(index)->IsEnabled() ? '1' : '0';
			return state;
		});
	}

	std::string OpenLabel()
	{
		return Locked([&] { return std::string(window->filesMenu->ItemAt(0)->Label()); });
	}

	// The alerts on screen, by their text.
	std::vector<std::string> Alerts()
	{
		std::vector<std::string> texts;
		for (const auto& info : BPrivate::Headless::ListWindows()) {
			BWindow* shown = const_cast<BWindow*>(info.window);
			if (BAlert* alert = dynamic_cast<BAlert*>(shown)) {
				alert->Lock();
				texts.push_back(alert->TextView()->Text());
				alert->Unlock();
			}
		}
		return texts;
	}

	void PressEnterInAlert()
	{
		for (const auto& info : BPrivate::Headless::ListWindows()) {
			if (dynamic_cast<const BAlert*>(info.window) != nullptr) {
				ASSERT_EQ(B_OK, BPrivate::Headless::PostKey(info.window, "\n"));
			}
		}
		Idle();
	}
};

}

TEST_F(WindowTest, LargeScreenGetsTheLargeLayout)
{
	Start();
	EXPECT_EQ(BRect(60, 60, 739, 510), Locked([&] { return window->Frame(); }));
	EXPECT_EQ(BRect(0, 0, 679, 450), Locked([&] { return window->Bounds(); }));
	EXPECT_EQ(BRect(0, 19, 215, 451), FrameOf("Folders"));
	EXPECT_EQ(BRect(216, 19, 681, 451), FrameOf("Files"));
	Locked([&] {
		EXPECT_EQ(BRect(1, 1, 199, 416), tree->Frame());
		EXPECT_EQ(BRect(1, 1, 449, 416), window->fileList->Frame());
		EXPECT_EQ(BRect(0, 418, 200, 432), tree->ScrollBar(B_HORIZONTAL)->Frame());
		EXPECT_EQ(BRect(201, 0, 215, 417), tree->ScrollBar(B_VERTICAL)->Frame());
		EXPECT_STREQ("hbar", tree->ScrollBar(B_HORIZONTAL)->Name());
		EXPECT_STREQ("vbar", tree->ScrollBar(B_VERTICAL)->Name());
		EXPECT_EQ(0, window->menuBar->Frame().top);
		EXPECT_STREQ("Files", window->menuBar->ItemAt(0)->Label());
		EXPECT_STREQ("Help", window->menuBar->ItemAt(1)->Label());
	});
}

TEST_F(WindowTest, ScreenOf640PixelsGetsTheSmallLayout)
{
	BPrivate::Headless::SetScreenSize(640, 480);
	Start();
	EXPECT_EQ(BRect(40, 40, 619, 440), Locked([&] { return window->Frame(); }));
	EXPECT_EQ(BRect(0, 19, 185, 401), FrameOf("Folders"));
	EXPECT_EQ(BRect(186, 19, 581, 401), FrameOf("Files"));
	EXPECT_EQ(BRect(1, 1, 169, 366), Locked([&] { return tree->Frame(); }));
}

TEST_F(WindowTest, LayoutIsChosenByTheScreenFramesWidth)
{
	// The frame of a 642-pixel screen is 0 to 641: 641 wide, the first large.
	BPrivate::Headless::SetScreenSize(642, 480);
	EXPECT_FALSE(GvWindow::IsSmallScreen());
	EXPECT_EQ(BRect(60, 60, 739, 510), GvWindow::FrameForScreen());
	BPrivate::Headless::SetScreenSize(640, 480);
	EXPECT_TRUE(GvWindow::IsSmallScreen());
	EXPECT_EQ(BRect(40, 40, 619, 440), GvWindow::FrameForScreen());
}

TEST_F(WindowTest, GrowingTheWindowStretchesTheFileListFrame)
{
	Start();
	Locked([&] { window->ResizeBy(100, 100); });
	Idle();
	EXPECT_EQ(BRect(216, 19, 781, 551), FrameOf("Files"));
	EXPECT_EQ(BRect(0, 19, 215, 551), FrameOf("Folders"));
	Locked([&] {
		GvScrollView* frame = window->fileList->scrollFrame;
		EXPECT_EQ(BRect(0, 0, 550, 517), frame->borderRect);
		EXPECT_EQ(BRect(1, 1, 549, 516), window->fileList->Frame());
	});
}

TEST_F(WindowTest, TitleFollowsTheShownFolderWhateverItsLength)
{
	std::string deep = "boot";
	for (int i = 0; i < 12; i++)
		deep += "/" + std::string(120, 'a' + i);
	Folder(deep);
	Folder("boot/odd \"$name\" `x`");
	Start();
	EXPECT_EQ("Varnel  (   " + boot + "   )", Title());

	OpenInTree(Folder(deep));
	EXPECT_EQ("Varnel  (   " + Folder(deep) + "   )", Title());
	EXPECT_GT(Title().size(), 1036u);

	OpenInTree(Folder("boot/odd \"$name\" `x`"));
	EXPECT_EQ("Varnel  (   " + boot + "/odd \"$name\" `x`   )", Title());
}

TEST_F(WindowTest, MenusFollowTheFocusedPaneAndItsStatus)
{
	Folder("boot/plain");
	Folder("ro");
	AddVolume(12, "ro", "Archive", B_FS_IS_PERSISTENT | B_FS_IS_READONLY);
	Start();
	File("boot/home/.local/share/Trash/files/junk");

	// Items 0, 1, 2, 4 and 6 in that order; the trash holds one entry.
	EXPECT_EQ("10011", MenuState()) << "volume root";
	EXPECT_EQ("Expand/Collapse", OpenLabel());
	OpenInTree(boot + "/plain");
	EXPECT_EQ("11111", MenuState()) << "ordinary folder";
	OpenInTree(desktop);
	EXPECT_EQ("10011", MenuState()) << "Desktop";
	OpenInTree(trash);
	EXPECT_EQ("10001", MenuState()) << "Trash";
	OpenInTree(Folder("ro"), 12);
	EXPECT_EQ("10001", MenuState()) << "read-only volume";

	std::filesystem::remove(trash + "/junk");
	Locked([&] { window->fileList->MakeFocus(true); });
	EXPECT_EQ("10010", MenuState()) << "file list, nothing selected";
	EXPECT_EQ("Open", OpenLabel());

	// The rename editor holds the focus: no pane has it.
	Locked([&] {
		window->fileList->AddChild(window->fileList->renameView);
		window->fileList->renameView->MakeFocus(true);
	});
	EXPECT_EQ("00000", MenuState());
	EXPECT_EQ("Open", OpenLabel());
}

TEST_F(WindowTest, CommandsGoToTheFocusedPaneOrElseToTheFileList)
{
	Folder("boot/plain");
	Start();
	OpenInTree(boot + "/plain");
	BMessage rename(GV_ASK_RENAME);
	ASSERT_EQ(B_OK, window->PostMessage(&rename));
	Idle();
	EXPECT_TRUE(Locked([&] { return tree->renameView->Parent() == tree; }));
	Key("\x1b");

	// With no pane focused a New Folder reaches the file list, which hands it
	// to the tree: the folder appears in the selected folder.
	Locked([&] {
		window->fileList->MakeFocus(true);
		window->fileList->RemoveSelf();
	});
	EXPECT_EQ(nullptr, Locked([&] { return window->CurrentFocus(); }));
	ASSERT_EQ(B_OK, window->PostMessage(GV_NEW_FOLDER));
	Idle();
	Locked([&] { window->FindView("Files")->AddChild(window->fileList); });
	EXPECT_TRUE(Exists(boot + "/plain/New Folder"));
}

TEST_F(WindowTest, HelpOpensThePageBesideTheProgramOrSaysItIsMissing)
{
	Start();
	std::vector<std::string> launched;
	BPrivate::SetLaunchHook([&](const char* path) {
		launched.push_back(path);
		return B_OK;
	});
	std::string page = std::filesystem::canonical("/proc/self/exe").parent_path() / "help.html";
	std::filesystem::remove(page);

	ASSERT_EQ(B_OK, window->PostMessage(GV_HELP));
	Idle();
	EXPECT_EQ(std::vector<std::string>{ "Help is unavailable at this time :\n"
		"I couldn't find the proper files in my directory" }, Alerts());
	PressEnterInAlert();
	EXPECT_TRUE(Alerts().empty());
	EXPECT_TRUE(launched.empty());

	std::ofstream(page) << "<html></html>";
	ASSERT_EQ(B_OK, window->PostMessage(GV_HELP));
	Idle();
	EXPECT_TRUE(Alerts().empty());
	EXPECT_EQ(std::vector<std::string>{ page }, launched);

	BPrivate::SetLaunchHook([](const char*) { return B_LAUNCH_FAILED; });
	ASSERT_EQ(B_OK, window->PostMessage(GV_HELP));
	Idle();
	EXPECT_EQ(std::vector<std::string>{ "Unable to open help files" }, Alerts());
	PressEnterInAlert();
	std::filesystem::remove(page);
}

TEST_F(WindowTest, QuitClosesTheWindowAndEndsTheApplication)
{
	Start();
	ASSERT_EQ(B_OK, window->PostMessage(B_QUIT_REQUESTED));
	Idle();
	for (const auto& info : BPrivate::Headless::ListWindows())
		EXPECT_NE(window, info.window);
}
