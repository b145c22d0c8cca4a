// The rows' popup menu, driven by keys as the user can (keys skip disabled
// items, so what they reach tells what is enabled), and the drags a press
// on the selected row starts.

#include "support/AppFixture.h"

#include <Path.h>

#include "Commands.h"
#include "GvRenView.h"
#include "WindowHooks.h"

using namespace AppTest;
using BPrivate::Headless::PostMouse;

namespace {

const char kDown[] = "\x1f";

class TreePopupTest : public AppFixture {
protected:
	enum { kDiskDevice = 41 };

	// The point of a row's label in the window.
	BPoint LabelPoint(const std::string& path)
	{
		return Locked([&] {
			FolderItem* item = Item(path);
			BPoint where(18 * item->level + 5 + 40, 20 * tree->IndexOf(item) + 5 + 8);
			return window->ConvertFromScreen(tree->ConvertToScreen(where));
		});
	}

	// Right-clicks a row's label; whether a menu opened.
	bool PopUp(const std::string& path)
	{
		BPoint point = LabelPoint(path);
		EXPECT_EQ(B_OK, PostMouse(window, B_MOUSE_DOWN, point, B_SECONDARY_MOUSE_BUTTON));
		EXPECT_EQ(B_OK, PostMouse(window, B_MOUSE_UP, point, 0));
		Idle();
		for (const auto& info : BPrivate::Headless::ListWindows()) {
			if (info.feel == BPrivate::kMenuWindowFeel)
				return true;
		}
		return false;
	}

	// Chooses with the keyboard the item reached by pressing Down steps times.
	void Choose(int steps)
	{
		for (int i = 0; i < steps; i++)
			Key(kDown);
		Key("\n");
	}

	// The message of the drag that a press on the selected row starts with
	// modifiers held; the drag then ends on the tree.
	BMessage Drag(const std::string& path, uint32 modifiers)
	{
		Locked([&] { tree->Select(tree->IndexOf(Item(path))); });
		BPoint point = LabelPoint(path);
		BPrivate::Headless::SetModifiers(modifiers);
		EXPECT_EQ(B_OK, PostMouse(window, B_MOUSE_DOWN, point));
		Idle();
		std::shared_ptr<BPrivate::DragSession> session = BPrivate::CurrentDragSession();
		BMessage message = session != nullptr ? *session->Message() : BMessage();
		EXPECT_EQ(B_OK, PostMouse(window, B_MOUSE_UP, point, 0));
		BPrivate::Headless::SetModifiers(0);
		Idle();
		return message;
	}

	void ExpectPath(const BMessage& message, const std::string& path)
	{
		BPath flat;
		ASSERT_EQ(B_OK, message.FindFlat(GV_SOURCE_PATH, &flat));
		EXPECT_STREQ(path.c_str(), flat.Path());
	}
};

}

TEST_F(TreePopupTest, VolumesOfferOnlyOpeningAndNewFolders)
{
	Folder("disk/inside");
	AddVolume(kDiskDevice, "disk", "Disk", B_FS_IS_PERSISTENT | B_FS_IS_READONLY);
	Start();
	ASSERT_TRUE(PopUp(boot));
	Choose(2);
	EXPECT_TRUE(Exists(boot + "/New Folder"));
	EXPECT_EQ("New Folder", Editor());
	Key("\x1b", 1);

	// On a read-only volume only the first item, which toggles the row.
	std::string disk = Folder("disk");
	ASSERT_TRUE(PopUp(disk));
	Choose(2);
	EXPECT_FALSE(Exists(disk + "/New Folder"));
	EXPECT_TRUE(Locked([&] { return Item(disk)->expanded; }));
}

TEST_F(TreePopupTest, FoldersOfferRenameAndTheDesktopDoesNot)
{
	Folder("boot/a/a1");
	Start();
	FolderItem* first = Locked([&] { return tree->first; });
	ASSERT_TRUE(PopUp(boot + "/a"));
	Choose(2);
	EXPECT_EQ("a", Editor());
	EXPECT_EQ(first, Locked([&] { return tree->selected; }));
	Key("\x1b", 1);

	ASSERT_TRUE(PopUp(boot + "/a"));
	Choose(1);
	EXPECT_TRUE(Locked([&] { return Item(boot + "/a")->expanded; }));
	ASSERT_TRUE(PopUp(boot + "/a"));
	Choose(3);
	EXPECT_TRUE(Exists(trash + "/a/a1"));

	Locked([&] { tree->Expand_Collapse(Item(home)); });
	ASSERT_TRUE(PopUp(desktop));
	Choose(2);
	EXPECT_TRUE(Exists(desktop + "/New Folder"));

	// The trash row has no menu.
	Key("\x1b", 1);
	Locked([&] {
		entry_ref trashRef = Ref(trash);
		tree->FindAndOpen(&trashRef, kBootDevice);
	});
	EXPECT_FALSE(PopUp(trash));
}

TEST_F(TreePopupTest, DragsCarryTheModeTheModifiersAndTheRowAllow)
{
	Folder("boot/a");
	std::string inside = Folder("disk/inside");
	AddVolume(kDiskDevice, "disk", "Disk", B_FS_IS_PERSISTENT | B_FS_IS_READONLY);
	Start();
	Locked([&] { tree->Expand_Collapse(Item(Folder("disk"))); });

	BMessage move = Drag(boot + "/a", 0);
	EXPECT_EQ(GV_MOVE, move.what);
	EXPECT_EQ(Ref(boot + "/a"), [&] {
		entry_ref ref;
		move.FindRef(GV_SOURCE_REF, &ref);
		return ref;
	}());
	EXPECT_FALSE(move.HasRef(GV_SOURCE_PATH));
	EXPECT_TRUE(move.GetBool(GV_FOLDER, false));
	BMessage copy = Drag(boot + "/a", B_CONTROL_KEY);
	EXPECT_EQ(GV_COPY, copy.what);
	ExpectPath(copy, boot + "/a");
	EXPECT_EQ(GV_LINK, Drag(boot + "/a", B_CONTROL_KEY | B_SHIFT_KEY).what);

	// Volumes are only linked to; nothing moves off a read-only volume.
	BMessage volume = Drag(boot, 0);
	EXPECT_EQ(GV_LINK, volume.what);
	ExpectPath(volume, boot);
	EXPECT_EQ(GV_LINK, Drag(boot, B_CONTROL_KEY).what);
	EXPECT_EQ(GV_COPY, Drag(inside, 0).what);
	EXPECT_EQ(GV_LINK, Drag(inside, B_CONTROL_KEY | B_SHIFT_KEY).what);
	EXPECT_TRUE(Exists(boot + "/a"));
}
