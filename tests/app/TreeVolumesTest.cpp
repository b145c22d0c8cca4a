// The volumes in the tree, their mounts and unmounts, and lazy reading.

#include "support/AppFixture.h"

#include "Commands.h"

using namespace AppTest;

namespace {

class TreeVolumesTest : public AppFixture {
protected:
	enum { kRamDevice = 21, kDataDevice = 22, kDiskDevice = 23, kLateDevice = 24 };

	static BPrivate::VolumeEntry Entry(dev_t device, const std::string& root,
		const std::string& name, uint32 flags)
	{
		BPrivate::VolumeEntry volume;
		volume.device = device;
		volume.root = root;
		volume.name = name;
		volume.flags = flags;
		return volume;
	}

	static int32 CountBare(const std::vector<BMessage>& messages)
	{
		int32 count = 0;
		for (const BMessage& message : messages)
			count += message.what == GV_REFRESH && message.IsEmpty();
		return count;
	}
};

}

TEST_F(TreeVolumesTest, TheBootVolumeComesFirstAndExpandedThenPersistentOnes)
{
	Folder("ram/r");
	Folder("data/d");
	Folder("disk/sub");
	AddVolume(kRamDevice, "ram", "Ram", 0);
	AddVolume(kDataDevice, "data", "Data", B_FS_IS_PERSISTENT);
	AddVolume(kDiskDevice, "disk", "Disk", B_FS_IS_PERSISTENT | B_FS_IS_READONLY);
	Start();

	std::vector<std::string> rows = Rows();
	ASSERT_EQ(4u, rows.size());
	EXPECT_EQ("Boot", rows[0]);
	EXPECT_EQ(" home", rows[1]);
	EXPECT_EQ("Data", rows[2]);
	EXPECT_EQ("Disk  (read-only)", rows[3]);

	Locked([&] {
		EXPECT_TRUE(tree->first->expanded);
		EXPECT_TRUE(tree->first->isVolume);
		FolderItem* disk = tree->ItemAt(3);
		EXPECT_FALSE(disk->expanded);
		EXPECT_EQ(1, disk->subdirCount);
		EXPECT_EQ(1, tree->Expand_Collapse(disk));
		FolderItem* sub = tree->ItemAt(4);
		char label[B_FILE_NAME_LENGTH];
		sub->GetName(label);
		EXPECT_STREQ("sub", label);
		EXPECT_EQ(GV_FOLDER_READ_ONLY, sub->status);

		// A read-only folder is 1, a writable volume root 4.
		tree->Select(4);
		EXPECT_EQ(GV_STATUS_READ_ONLY, tree->GetStatus());
		tree->Select(3);
		EXPECT_EQ(GV_STATUS_READ_ONLY, tree->GetStatus());
		tree->Select(2);
		EXPECT_EQ(GV_STATUS_VOLUME, tree->GetStatus());
		tree->Select(1);
		EXPECT_EQ(GV_STATUS_ORDINARY, tree->GetStatus());
	});
}

TEST_F(TreeVolumesTest, TheDesktopAndTheTrashAreMarked)
{
	Folder("boot/home/.local/share/Trash/files/old");
	Start();
	Locked([&] {
		tree->Expand_Collapse(tree->ItemAt(1));
		FolderItem* desktopRow = Item(desktop);
		ASSERT_NE(nullptr, desktopRow);
		EXPECT_EQ(GV_FOLDER_DESKTOP, desktopRow->status);
		tree->Select(tree->IndexOf(desktopRow));
		EXPECT_EQ(GV_STATUS_DESKTOP_OR_NONE, tree->GetStatus());
	});

	// Nothing inside the trash is read, found or made: opening a folder
	// there selects the trash row.
	OpenInTree(trash + "/old");
	EXPECT_EQ(nullptr, Item(trash + "/old"));
	Locked([&] {
		FolderItem* trashRow = tree->selected;
		EXPECT_EQ(Item(trash), trashRow);
		EXPECT_EQ(GV_FOLDER_TRASH, trashRow->status);
		EXPECT_EQ(0, trashRow->subdirCount);
		EXPECT_EQ(GV_STATUS_PROTECTED, tree->GetStatus());
		entry_ref old = Ref(trash + "/old");
		EXPECT_EQ(trashRow, tree->FindItemUnder(trashRow, &old));
	});
}

TEST_F(TreeVolumesTest, MountsAndUnmountsFollowWhileRunning)
{
	std::string data = Folder("data/d");
	AddVolume(kDataDevice, "data", "Data", B_FS_IS_PERSISTENT);
	Start();
	MessageLog* fileList = LogFileList();
	auto& table = BPrivate::VolumeTable::Default();

	ASSERT_EQ(B_OK, table.Mount(Entry(kLateDevice, Folder("late"), "Late",
		B_FS_IS_PERSISTENT)));
	ASSERT_EQ(B_OK, table.Mount(Entry(kRamDevice, Folder("ram"), "Ram", 0)));
	Idle();
	EXPECT_EQ((std::vector<std::string>{ "Boot", " home", "Data", "Late" }), Rows());
	EXPECT_EQ(2, CountBare(fileList->Take()));

	// The selection inside an unmounted volume goes back to the first row.
	OpenInTree(data, kDataDevice);
	fileList->Take();
	ASSERT_EQ(B_OK, table.Unmount(kDataDevice));
	Idle();
	EXPECT_EQ((std::vector<std::string>{ "Boot", " home", "Late" }), Rows());
	EXPECT_EQ(Locked([&] { return tree->first; }), Locked([&] { return tree->selected; }));
	std::vector<BMessage> sent = fileList->Take();
	ASSERT_FALSE(sent.empty());
	entry_ref shown;
	ASSERT_EQ(B_OK, sent.front().FindRef(GV_PARENT_REF, &shown));
	EXPECT_EQ(Ref(boot), shown);
	EXPECT_EQ("Varnel  (   " + boot + "   )", Title());

	// The selected first volume goes too; the next one takes its place.
	ASSERT_EQ(B_OK, table.Unmount(kBootDevice));
	Idle();
	EXPECT_EQ((std::vector<std::string>{ "Late" }), Rows());
	EXPECT_EQ(Locked([&] { return tree->first; }), Locked([&] { return tree->selected; }));
	ASSERT_EQ(B_OK, table.Unmount(kLateDevice));
	Idle();
	EXPECT_TRUE(Rows().empty());
	Locked([&] {
		EXPECT_EQ(nullptr, tree->selected);
		EXPECT_EQ(GV_STATUS_PROTECTED, tree->GetStatus());
		EXPECT_EQ(1, tree->Select(0));
	});
}

TEST_F(TreeVolumesTest, FoldersAreReadOnceWithTheirFirstExpansion)
{
	Folder("boot/a/a1");
	Folder("boot/leaf");
	Start();
	std::string added = Folder("boot/a/a2");
	Locked([&] {
		FolderItem* a = Item(boot + "/a");
		FolderItem* leaf = Item(boot + "/leaf");
		EXPECT_FALSE(a->subdirsRead);
		EXPECT_EQ(1, a->subdirCount);
		EXPECT_EQ(1, tree->Expand_Collapse(leaf));
		EXPECT_FALSE(leaf->expanded);

		EXPECT_EQ(1, tree->Expand_Collapse(a));
		EXPECT_TRUE(a->expanded);
		EXPECT_TRUE(tree->enabled);
		EXPECT_EQ(1, tree->Expand_Collapse(a));
		EXPECT_FALSE(a->expanded);
	});
	std::filesystem::remove(added);
	Folder("boot/a/a3");
	Locked([&] { tree->Expand_Collapse(Item(boot + "/a")); });
	EXPECT_NE(nullptr, Item(added));
	EXPECT_EQ(nullptr, Item(boot + "/a/a3"));
}
