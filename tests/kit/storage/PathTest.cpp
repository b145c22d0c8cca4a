#include <gtest/gtest.h>

#include <Directory.h>
#include <Entry.h>
#include <Message.h>
#include <Path.h>

#include "StorageTestSupport.h"

using namespace StorageTest;

TEST(PathTest, NormalisesOnlyWhenAskedOrNeeded)
{
	Scratch scratch;
	scratch.Folder("a/b");
	ASSERT_EQ(0, symlink("a", (scratch / "link").c_str()));

	// Kept as given: the folder need not exist, links stay.
	EXPECT_STREQ("/no/such/place", BPath("/no/such", "place").Path());
	EXPECT_EQ(scratch / "link/b", BPath((scratch / "link").c_str(), "b").Path());
	EXPECT_EQ(scratch / "a/b",
		BPath((scratch / "link").c_str(), "b", true).Path());
	EXPECT_EQ(scratch / "a",
		BPath((scratch / "a/b/.././/").c_str()).Path());
	EXPECT_EQ(B_ENTRY_NOT_FOUND, BPath("/no/such/../x").InitCheck());
	EXPECT_EQ(B_BAD_VALUE, BPath("/tmp", "/absolute").InitCheck());
	EXPECT_EQ(B_BAD_VALUE, BPath("").InitCheck());
	EXPECT_EQ(nullptr, BPath().Path());

	BPath path((scratch / "a").c_str());
	ASSERT_EQ(B_OK, path.Append("b/new leaf"));
	EXPECT_STREQ("new leaf", path.Leaf());
	BPath parent;
	ASSERT_EQ(B_OK, path.GetParent(&parent));
	EXPECT_EQ(scratch / "a/b", parent.Path());
	EXPECT_TRUE(parent == (scratch / "a/b").c_str());
	EXPECT_TRUE(parent != path);
	BPath root("/");
	EXPECT_STREQ("", root.Leaf());
	EXPECT_EQ(B_ENTRY_NOT_FOUND, root.GetParent(&parent));

	BDirectory dir((scratch / "a").c_str());
	EXPECT_EQ(scratch / "a/x", BPath(&dir, "x").Path());
}

TEST(PathTest, TravelsInMessagesAsARef)
{
	Scratch scratch;
	std::string file = scratch.File("odd 'name' $x");
	BPath path(file.c_str());
	EXPECT_EQ(static_cast<type_code>(B_REF_TYPE), path.TypeCode());

	BMessage message('copy');
	ASSERT_EQ(B_OK, message.AddFlat("refs", &path));
	entry_ref ref;
	ASSERT_EQ(B_OK, message.FindRef("refs", &ref));
	entry_ref expected;
	ASSERT_EQ(B_OK, get_ref_for_path(file.c_str(), &expected));
	EXPECT_EQ(expected, ref);
	BPath back;
	ASSERT_EQ(B_OK, message.FindFlat("refs", &back));
	EXPECT_EQ(path, back);

	// A ref added to a message reads back as a path too.
	ASSERT_EQ(B_OK, message.AddRef("ref", &expected));
	ASSERT_EQ(B_OK, message.FindFlat("ref", &back));
	EXPECT_EQ(file, back.Path());
}
