// The tree's rows: the full list, the chain of shown rows and its count.

#include "support/AppFixture.h"

#include "Commands.h"

using namespace AppTest;

namespace {

class TreeListTest : public AppFixture {
protected:
	enum { kDataDevice = 12, kMoreDevice = 13 };

	FolderItem* NewItem(const std::string& path, const FolderItem* parent)
	{
		entry_ref ref = Ref(path);
		return new FolderItem(&ref, parent->level + 1, parent->status);
	}
};

}

TEST_F(TreeListTest, CollapsingKeepsTheSubtreeForTheNextExpansion)
{
	Folder("boot/a/a1/a11");
	Folder("boot/a/a2");
	Start();
	FolderItem* a = Item(boot + "/a");
	ASSERT_NE(nullptr, a);
	EXPECT_EQ(3u, Rows().size());

	Locked([&] {
		EXPECT_EQ(1, tree->Expand(a));
		EXPECT_EQ(1, tree->Expand(Item(boot + "/a/a1")));
		EXPECT_EQ(5, tree->lastVisible);
		EXPECT_EQ(1, tree->Collapse(a));
		EXPECT_EQ(2, tree->lastVisible);
		FolderItem* a11 = Item(boot + "/a/a1/a11");
		ASSERT_NE(nullptr, a11);
		EXPECT_EQ(-1, tree->IndexOf(a11));

		EXPECT_EQ(1, tree->Expand(a));
		EXPECT_EQ(5, tree->lastVisible);
		EXPECT_EQ(tree->IndexOf(a) + 2, tree->IndexOf(a11));
		EXPECT_EQ(nullptr, tree->ItemAt(6));
		EXPECT_EQ(nullptr, tree->ItemAt(-1));
		EXPECT_EQ(2, tree->Expand(NULL));
		EXPECT_EQ(2, tree->Collapse(NULL));
		EXPECT_EQ(2, tree->AddUnder(NULL, NULL));
		EXPECT_EQ(0, tree->AddUnder(a, NULL));
		EXPECT_EQ(2, tree->RemoveItem(NULL));
	});
	Rows();
}

TEST_F(TreeListTest, AddItemStartsAnEmptyTreeOnly)
{
	Folder("boot/a");
	Start();
	Locked([&] {
		tree->RemoveAll();
		EXPECT_EQ(-1, tree->lastVisible);
		EXPECT_EQ(nullptr, tree->FindLast());
		entry_ref ref = Ref(boot + "/a");
		FolderItem* item = new FolderItem(&ref, 0, GV_FOLDER_ORDINARY);
		EXPECT_EQ(1, tree->AddItem(NULL, item));
		EXPECT_EQ(item, tree->first);
		EXPECT_EQ(0, tree->lastVisible);
		FolderItem other(&ref, 0, GV_FOLDER_ORDINARY);
		EXPECT_EQ(2, tree->AddItem(NULL, &other));
		EXPECT_EQ(0, tree->AddItem(item, NULL));
		EXPECT_EQ(item, tree->FindLast());
	});
}

// Rows added inside hidden subtrees are not shown and not counted; a volume
// mounted after a collapsed last volume is shown all the same.
TEST_F(TreeListTest, TheCountFollowsTheShownRowsWhereverRowsGo)
{
	std::string a = Folder("boot/a/a1");
	std::string data = Folder("data");
	std::string b = Folder("data/b/b1");
	AddVolume(kDataDevice, "data", "Data", B_FS_IS_PERSISTENT);
	Start();
	std::string late = Folder("boot/a/late");
	Locked([&] {
		FolderItem* aRow = Item(boot + "/a");
		tree->Expand(aRow);
		tree->Collapse(aRow);
		FolderItem* lateRow = NewItem(late, aRow);
		int32 before = tree->lastVisible;
		EXPECT_EQ(1, tree->AddUnder(aRow, lateRow));
		EXPECT_EQ(before, tree->lastVisible);
		EXPECT_EQ(-1, tree->IndexOf(lateRow));
		EXPECT_EQ(1, tree->RemoveItem(lateRow));
		EXPECT_EQ(before, tree->lastVisible);

		FolderItem* dataRow = Item(data);
		tree->Expand(dataRow);
		tree->Expand(Item(data + "/b"));
		tree->Collapse(dataRow);
	});

	BPrivate::VolumeEntry more;
	more.device = kMoreDevice;
	more.root = Folder("more");
	more.name = "More";
	more.flags = B_FS_IS_PERSISTENT;
	ASSERT_EQ(B_OK, BPrivate::VolumeTable::Default().Mount(more));
	Idle();
	std::vector<std::string> rows = Rows();
	ASSERT_GE(rows.size(), 2u);
	EXPECT_EQ("More", rows.back());
	EXPECT_EQ("Data", rows[rows.size() - 2]);
}

TEST_F(TreeListTest, RemovingARowAfterACollapsedSiblingKeepsTheChain)
{
	std::string data = Folder("data");
	Folder("data/x/x1");
	Folder("data/y");
	AddVolume(kDataDevice, "data", "Data", B_FS_IS_PERSISTENT);
	Start();
	Locked([&] {
		FolderItem* dataRow = Item(data);
		ASSERT_NE(nullptr, dataRow);
		// Children added in a known order, before the volume is ever read.
		FolderItem* x = NewItem(data + "/x", dataRow);
		int32 before = tree->lastVisible;
		EXPECT_EQ(1, tree->AddUnder(dataRow, x));
		EXPECT_EQ(before + 1, tree->lastVisible);
		FolderItem* x1 = NewItem(data + "/x/x1", x);
		tree->AddUnder(x, x1);
		FolderItem* y = NewItem(data + "/y", dataRow);
		tree->AddUnder(dataRow, y);
		EXPECT_EQ(y, x1->next);

		// Reading x finds the row it already has.
		EXPECT_EQ(1, tree->Expand(x));
		EXPECT_EQ(y, x1->next);
		tree->Collapse(x);
		EXPECT_EQ(y, x->nextVisible);
		tree->RemoveItem(y);
		EXPECT_EQ(nullptr, x->nextVisible);
		EXPECT_EQ(x, tree->ItemAt(tree->lastVisible));
		tree->Expand(x);
		EXPECT_EQ(x1, tree->ItemAt(tree->lastVisible));
	});
	Rows();
}

TEST_F(TreeListTest, OpeningAFolderReadsAndExpandsEveryFolderOnTheWay)
{
	std::string data = Folder("data");
	std::string deep = Folder("data/d1/d2/d3");
	Folder("data/other");
	AddVolume(kDataDevice, "data", "Data", B_FS_IS_PERSISTENT);
	Start();

	OpenInTree(deep, kDataDevice);
	int32 d1 = IndexOf(data + "/d1");
	EXPECT_GT(d1, 0);
	EXPECT_EQ(d1 + 1, IndexOf(data + "/d1/d2"));
	EXPECT_EQ(d1 + 2, IndexOf(deep));
	Rows();
	EXPECT_EQ(Item(deep), Locked([&] { return tree->selected; }));
	EXPECT_TRUE(Locked([&] { return tree->IsFocus(); }));
	EXPECT_EQ("Varnel  (   " + deep + "   )", Title());

	// A folder that has gone opens nothing.
	std::filesystem::remove(deep);
	size_t count = Rows().size();
	OpenInTree(deep, kDataDevice);
	EXPECT_EQ(count, Rows().size());
}
