// Move to trash, New Folder, renaming and the refresh hub, checked on disk,
// in the rows and in what the file list is sent.

#include "support/AppFixture.h"

#include <cstdio>

#include "Commands.h"
#include "GvRenView.h"

using namespace AppTest;

namespace {

class TreeCommandsTest : public AppFixture {
protected:
	enum { kDataDevice = 31 };

	void Command(uint32 what, const std::string& path)
	{
		BMessage message(what);
		message.AddInt32(GV_TREE_INDEX, IndexOf(path));
		Post(&message);
	}

	// The rename editor's answer for a row.
	void Renamed(float position, const char* name)
	{
		BMessage message(GV_RENAMED);
		message.AddString(GV_NAME, name);
		message.AddFloat(GV_POSITION, position);
		Post(&message);
	}
};

}

TEST_F(TreeCommandsTest, DeleteNamesClashesAfterTheFirstName)
{
	Folder("boot/Photos/inner");
	Folder("boot/home/.local/share/Trash/files/Photos");
	Folder("boot/home/.local/share/Trash/files/Photos copy 1");
	Start();
	Command(GV_DELETE, boot + "/Photos");
	EXPECT_TRUE(Exists(trash + "/Photos copy 2/inner"));
	EXPECT_FALSE(Exists(boot + "/Photos"));
	EXPECT_FALSE(Exists(boot + "/Photos copy 1"));
	EXPECT_EQ(nullptr, Item(boot + "/Photos"));
	Rows();
}

TEST_F(TreeCommandsTest, ProtectedRowsAndFoldersThatCannotLeaveStay)
{
	std::string data = Folder("data/elsewhere");
	std::string name(250, 'n');
	Folder("boot/" + name);
	Folder("boot/home/.local/share/Trash/files/" + name);
	AddVolume(kDataDevice, "data", "Data", B_FS_IS_PERSISTENT);
	Start();
	OpenInTree(trash);
	OpenInTree(desktop);
	OpenInTree(data, kDataDevice);
	size_t rows = Rows().size();

	for (const std::string& path : { desktop, trash, boot, data, boot + "/" + name }) {
		Command(GV_DELETE, path);
		EXPECT_TRUE(Exists(path)) << path;
		EXPECT_NE(nullptr, Item(path)) << path;
	}
	EXPECT_EQ(rows, Rows().size());
	EXPECT_EQ(1, std::distance(std::filesystem::directory_iterator(trash),
		std::filesystem::directory_iterator()));
}

TEST_F(TreeCommandsTest, DeletingTheSelectedFolderShowsTheBootVolume)
{
	Folder("boot/gone");
	Start();
	MessageLog* fileList = LogFileList();
	Locked([&] { tree->Select(tree->IndexOf(Item(boot + "/gone"))); });
	fileList->Take();
	BMessage command(GV_DELETE);
	Post(&command);
	EXPECT_EQ(Locked([&] { return tree->first; }), Locked([&] { return tree->selected; }));
	std::vector<BMessage> sent = fileList->Take();
	ASSERT_EQ(1u, sent.size());
	entry_ref shown;
	ASSERT_EQ(B_OK, sent[0].FindRef(GV_PARENT_REF, &shown));
	EXPECT_EQ(Ref(boot), shown);
	EXPECT_TRUE(sent[0].GetBool(GV_VOLUME, false));

	// The selection inside a folder that goes moves to the first row too.
	OpenInTree(Folder("boot/outer/inner"));
	fileList->Take();
	Command(GV_DELETE, boot + "/outer");
	EXPECT_TRUE(Exists(trash + "/outer/inner"));
	EXPECT_EQ(Locked([&] { return tree->first; }), Locked([&] { return tree->selected; }));
	EXPECT_EQ("Varnel  (   " + boot + "   )", Title());
}

TEST_F(TreeCommandsTest, NewFolderNumbersAndOpensTheEditor)
{
	Folder("boot/a");
	Start();
	Command(GV_NEW_FOLDER, boot + "/a");
	EXPECT_EQ("New Folder", Editor());
	Key("\x1b");
	EXPECT_EQ("", Editor());
	Command(GV_NEW_FOLDER, boot + "/a");
	EXPECT_EQ("New Folder 2", Editor());
	EXPECT_TRUE(Exists(boot + "/a/New Folder"));
	EXPECT_TRUE(Exists(boot + "/a/New Folder 2"));
	int32 row = IndexOf(boot + "/a/New Folder 2");
	EXPECT_EQ(IndexOf(boot + "/a") + 2, row);
	EXPECT_EQ(BPoint(23 + 18 + 34, 20 * row + 5),
		Locked([&] { return tree->renameView->Frame().LeftTop(); }));

	// Typing a name and Enter renames the new folder.
	Key("N");
	Key("\n");
	EXPECT_EQ("", Editor());
	EXPECT_TRUE(Exists(boot + "/a/N"));
	EXPECT_NE(nullptr, Item(boot + "/a/N"));
	EXPECT_EQ(row, IndexOf(boot + "/a/N"));
}

TEST_F(TreeCommandsTest, NewFolderInCollapsedFoldersGivesOneShownRow)
{
	Folder("boot/unread/sub");
	Folder("boot/read/sub");
	Start();
	// A folder never read is read with the new folder among the others.
	Command(GV_NEW_FOLDER, boot + "/unread");
	int32 row = IndexOf(boot + "/unread/New Folder");
	EXPECT_GT(row, IndexOf(boot + "/unread"));
	EXPECT_GT(IndexOf(boot + "/unread/sub"), IndexOf(boot + "/unread"));
	EXPECT_EQ("New Folder", Editor());
	EXPECT_EQ(20 * row + 5, Locked([&] { return tree->renameView->Frame().top; }));
	Key("\x1b");

	// A folder read, then collapsed, is opened before the row goes in.
	Locked([&] {
		FolderItem* read = Item(boot + "/read");
		tree->Expand(read);
		tree->Collapse(read);
	});
	Command(GV_NEW_FOLDER, boot + "/read");
	EXPECT_TRUE(Locked([&] { return Item(boot + "/read")->expanded; }));
	EXPECT_EQ(IndexOf(boot + "/read") + 1, IndexOf(boot + "/read/sub"));
	EXPECT_EQ(IndexOf(boot + "/read") + 2, IndexOf(boot + "/read/New Folder"));
	std::vector<std::string> rows = Rows();
	EXPECT_EQ(2, std::count(rows.begin(), rows.end(), "  New Folder"));

	// In the trash the folder is made and gets no row.
	Key("\x1b");
	OpenInTree(trash);
	size_t count = Rows().size();
	Command(GV_NEW_FOLDER, trash);
	EXPECT_TRUE(Exists(trash + "/New Folder"));
	EXPECT_EQ(count, Rows().size());
	EXPECT_EQ("", Editor());
}

TEST_F(TreeCommandsTest, RenamesTheFileSystemRefusesKeepTheName)
{
	Folder("boot/a");
	Folder("boot/taken");
	Start();
	MessageLog* fileList = LogFileList();
	float position = 20 * IndexOf(boot + "/a") + 5;
	for (const char* name : { "x/y", "", ".", "..", "taken" }) {
		Renamed(position + 3, name);
		EXPECT_TRUE(Exists(boot + "/a")) << name;
		EXPECT_NE(nullptr, Item(boot + "/a")) << name;
	}
	EXPECT_EQ(5u, fileList->Take().size());

	// Above the first row and on a volume row nothing is renamed or sent.
	Renamed(2, "b");
	Renamed(5, "b");
	EXPECT_TRUE(fileList->Take().empty());

	Renamed(position, "b");
	EXPECT_TRUE(Exists(boot + "/b"));
	EXPECT_EQ(position, 20 * IndexOf(boot + "/b") + 5);
	std::vector<BMessage> sent = fileList->Take();
	ASSERT_EQ(1u, sent.size());
	EXPECT_TRUE(sent[0].IsEmpty());
}

TEST_F(TreeCommandsTest, NotificationsAreAppliedInTheirOrder)
{
	Folder("boot/from/moved");
	Folder("boot/to/other");
	Start();
	MessageLog* fileList = LogFileList();
	Locked([&] {
		tree->Expand(Item(boot + "/from"));
		tree->Expand(Item(boot + "/to"));
	});
	entry_ref oldRef = Ref(boot + "/from/moved");
	ASSERT_EQ(0, std::rename((boot + "/from/moved").c_str(), (boot + "/to/moved").c_str()));
	entry_ref newRef = Ref(boot + "/to/moved");
	entry_ref toRef = Ref(boot + "/to");

	BMessage moved(GV_REFRESH);
	moved.AddInt32(GV_EVENT, GV_DELETE);
	moved.AddInt32(GV_EVENT, GV_NEW_FOLDER);
	moved.AddRef(GV_DELETED_REF, &oldRef);
	moved.AddRef(GV_PARENT_REF, &toRef);
	moved.AddRef(GV_NEW_REF, &newRef);
	Post(&moved);
	EXPECT_EQ(nullptr, Locked([&] { return tree->FindItem(&oldRef); }));
	EXPECT_EQ(IndexOf(boot + "/to") + 2, IndexOf(boot + "/to/moved"));
	EXPECT_EQ("", Editor());
	EXPECT_EQ(1u, fileList->Take().size());

	// A bare refresh redraws and reads nothing.
	Folder("boot/to/unseen");
	BMessage bare(GV_REFRESH);
	Post(&bare);
	EXPECT_EQ(nullptr, Item(boot + "/to/unseen"));
	EXPECT_TRUE(fileList->Take().empty());
}
