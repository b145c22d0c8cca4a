// Emptying the trash: what goes, in what order, what stays, the bar, and
// Escape.

#include "support/AppFixture.h"

#include <Directory.h>
#include <Menu.h>
#include <MenuItem.h>
#include <StatusBar.h>

#include "Commands.h"
#include "CopyWindow.h"

using namespace AppTest;

namespace {

class EmptyTrashTest : public AppFixture {
protected:
	// Moves a new item of the boot volume into the trash through the kit,
	// which writes its trash record.
	void Trash(const std::string& relative)
	{
		BEntry entry((boot + "/" + relative).c_str());
		BDirectory trashFolder(trash.c_str());
		ASSERT_EQ(B_OK, entry.MoveTo(&trashFolder));
	}

	std::string Record(const std::string& name)
	{
		return home + "/.local/share/Trash/info/" + name + ".trashinfo";
	}

	// Runs Empty Trash in a progress window of the test's own.
	CopyWindow* EmptyInOwnWindow(int32* result)
	{
		CopyWindow* progress = new CopyWindow(BRect(100, 100, 300, 160));
		Idle();
		*result = progress->EmptyTrash();
		Idle();
		return progress;
	}

	static void Close(CopyWindow* progress)
	{
		if (progress->Lock())
			progress->Quit();
	}
};

}

TEST_F(EmptyTrashTest, EverythingGoesFoldersEmptiedFirstLinksNotFollowed)
{
	Folder("boot/F/G");
	File("boot/F/a");
	File("boot/F/G/b");
	File("boot/it's \"$x\" `y`");
	Folder("outside/kept");
	File("outside/kept/precious");
	Start();
	Trash("F");
	Trash("it's \"$x\" `y`");
	ASSERT_EQ(0, symlink(Folder("outside/kept").c_str(), (trash + "/link").c_str()));
	ASSERT_TRUE(Exists(Record("F")));

	int32 result = 0;
	CopyWindow* progress = EmptyInOwnWindow(&result);
	EXPECT_EQ(1, result);
	progress->Lock();
	// F, G, a and b, the file and the link: six items, all counted down.
	EXPECT_EQ(6, progress->bar->MaxValue());
	EXPECT_EQ(6, progress->bar->CurrentValue());
	EXPECT_STREQ("0", progress->bar->TrailingText());
	EXPECT_STREQ("Deleting ", progress->bar->Label());
	EXPECT_EQ(rgb_color({ 200, 0, 0, 255 }), progress->bar->BarColor());
	EXPECT_EQ(0u, progress->itemsRemaining);
	progress->Unlock();
	Close(progress);

	EXPECT_TRUE(std::filesystem::is_empty(trash));
	EXPECT_TRUE(Exists(trash));
	EXPECT_FALSE(Exists(Record("F")));
	EXPECT_FALSE(Exists(Record("it's \"$x\" `y`")));
	EXPECT_TRUE(Exists(Folder("outside/kept") + "/precious"));
}

TEST_F(EmptyTrashTest, EscapeStopsBeforeTheNextItem)
{
	File("boot/one");
	Start();
	Trash("one");
	CopyWindow* progress = new CopyWindow(BRect(100, 100, 300, 160));
	Idle();
	ASSERT_EQ(B_OK, BPrivate::Headless::PostKey(progress, "\x1b", 1));
	Idle();
	EXPECT_TRUE(progress->cancel);
	EXPECT_EQ(3, progress->EmptyTrash());
	Close(progress);
	EXPECT_TRUE(Exists(trash + "/one"));
	EXPECT_TRUE(Exists(Record("one")));
}

TEST_F(EmptyTrashTest, TheMenuCommandEmptiesAndDisablesItself)
{
	File("boot/one");
	Start();
	Trash("one");
	auto emptyTrashEnabled = [&] {
		return Locked([&] {
			window->MenusBeginning();
			return window->filesMenu->ItemAt(GV_FILES_ITEM_EMPTY_TRASH)->IsEnabled();
		});
	};
	EXPECT_TRUE(emptyTrashEnabled());
	ASSERT_EQ(B_OK, window->PostMessage(GV_EMPTY_TRASH));
	Idle();
	EXPECT_FALSE(Exists(trash + "/one"));
	EXPECT_FALSE(emptyTrashEnabled());
	// The progress window came and went.
	for (const auto& info : BPrivate::Headless::ListWindows())
		EXPECT_EQ(nullptr, dynamic_cast<const CopyWindow*>(info.window));
}
