#include <algorithm>
#include <dirent.h>
#include <set>

#include <gtest/gtest.h>

#include <Directory.h>
#include <Entry.h>
#include <File.h>
#include <Path.h>
#include <SymLink.h>

#include "StorageTestSupport.h"

using namespace StorageTest;

namespace {

std::vector<std::string> SystemOrder(const std::string& folder)
{
	std::vector<std::string> names;
	DIR* dir = opendir(folder.c_str());
	while (dirent* entry = readdir(dir)) {
		if (strcmp(entry->d_name, ".") != 0 && strcmp(entry->d_name, "..") != 0)
			names.push_back(entry->d_name);
	}
	closedir(dir);
	return names;
}

std::vector<std::string> Walk(BDirectory& dir)
{
	std::vector<std::string> names;
	entry_ref ref;
	while (dir.GetNextRef(&ref) == B_OK)
		names.push_back(ref.name);
	return names;
}

}

TEST(DirectoryTest, WalksInTheFileSystemsOwnOrder)
{
	Scratch scratch;
	// Long names, so that the folder takes several reads.
	for (int i = 0; i < 400; i++)
		scratch.File(std::string(200, 'f') + std::to_string((i * 7919) % 997));
	scratch.Folder("sub");
	BDirectory dir(scratch.Path().c_str());
	ASSERT_EQ(B_OK, dir.InitCheck());

	EXPECT_EQ(401, dir.CountEntries());
	entry_ref first;
	ASSERT_EQ(B_OK, dir.GetNextRef(&first));
	// Counting reads the folder on its own: the walk goes on where it was.
	EXPECT_EQ(401, dir.CountEntries());
	std::vector<std::string> rest = Walk(dir);
	rest.insert(rest.begin(), first.name);
	EXPECT_EQ(SystemOrder(scratch.Path()), rest);

	entry_ref ref;
	EXPECT_EQ(B_ENTRY_NOT_FOUND, dir.GetNextRef(&ref));
	EXPECT_EQ(B_ENTRY_NOT_FOUND, dir.GetNextRef(&ref));
	BEntry entry;
	EXPECT_EQ(B_ENTRY_NOT_FOUND, dir.GetNextEntry(&entry));
	EXPECT_EQ(B_NO_INIT, entry.InitCheck());

	ASSERT_EQ(B_OK, dir.Rewind());
	EXPECT_EQ(rest, Walk(dir));

	BDirectory empty(scratch.Folder("empty").c_str());
	EXPECT_EQ(0, empty.CountEntries());
	EXPECT_EQ(B_ENTRY_NOT_FOUND, empty.GetNextRef(&ref));
}

TEST(DirectoryTest, StatForNamesTheEntryItself)
{
	Scratch scratch;
	scratch.Folder("folder");
	scratch.File("file", "12345");
	ASSERT_EQ(0, symlink("folder", (scratch / "link").c_str()));
	ASSERT_EQ(0, symlink("gone", (scratch / "dangling").c_str()));
	ASSERT_EQ(0, mkfifo((scratch / "fifo").c_str(), 0600));
	BDirectory dir(scratch.Path().c_str());

	struct stat st;
	ASSERT_EQ(B_OK, dir.GetStatFor("link", &st));
	EXPECT_TRUE(S_ISLNK(st.st_mode));
	ASSERT_EQ(B_OK, dir.GetStatFor("dangling", &st));
	EXPECT_TRUE(S_ISLNK(st.st_mode));
	ASSERT_EQ(B_OK, dir.GetStatFor("file", &st));
	EXPECT_EQ(5, st.st_size);
	ASSERT_EQ(B_OK, dir.GetStatFor("folder", &st));
	EXPECT_TRUE(S_ISDIR(st.st_mode));
	EXPECT_EQ(B_ENTRY_NOT_FOUND, dir.GetStatFor("none", &st));
	EXPECT_EQ(B_BAD_VALUE, dir.GetStatFor("", &st));

	// Every entry's stat and ref agree on the device, so the device of a
	// listed folder compares with volume ids.
	entry_ref ref;
	while (dir.GetNextRef(&ref) == B_OK) {
		ASSERT_EQ(B_OK, dir.GetStatFor(ref.name, &st));
		EXPECT_EQ(ref.device, st.st_dev) << ref.name;
	}

	// A pipe is listed and stat'ed, and opening it does not hang.
	EXPECT_TRUE(dir.Contains("fifo"));
	BNode pipeNode((scratch / "fifo").c_str());
	EXPECT_EQ(B_OK, pipeNode.InitCheck());
	BFile pipeFile((scratch / "fifo").c_str(), B_READ_ONLY);
	EXPECT_EQ(B_NOT_ALLOWED, pipeFile.InitCheck());
}

TEST(DirectoryTest, CreatesEntriesAndFindsThem)
{
	Scratch scratch;
	BDirectory dir(scratch.Path().c_str());
	BDirectory sub;
	ASSERT_EQ(B_OK, dir.CreateDirectory("sub", &sub));
	EXPECT_EQ(B_OK, sub.InitCheck());
	EXPECT_EQ(B_FILE_EXISTS, dir.CreateDirectory("sub", nullptr));

	BFile file;
	ASSERT_EQ(B_OK, dir.CreateFile("sub/file", &file, true));
	EXPECT_EQ(3, file.Write("abc", 3));
	EXPECT_EQ(B_FILE_EXISTS, dir.CreateFile("sub/file", &file, true));
	EXPECT_EQ("abc", Contents(scratch / "sub/file"));
	// Without failIfExists an existing file is emptied.
	ASSERT_EQ(B_OK, dir.CreateFile("sub/file", nullptr));
	EXPECT_EQ("", Contents(scratch / "sub/file"));

	BSymLink link;
	ASSERT_EQ(B_OK, dir.CreateSymLink("link", "sub/file", &link));
	char target[B_PATH_NAME_LENGTH];
	EXPECT_EQ(8, link.ReadLink(target, sizeof(target)));
	EXPECT_STREQ("sub/file", target);
	EXPECT_EQ(B_FILE_EXISTS, dir.CreateSymLink("link", "x", nullptr));
	EXPECT_EQ(B_BAD_VALUE, dir.CreateSymLink("", "x", nullptr));
	EXPECT_EQ(B_NAME_TOO_LONG,
		dir.CreateDirectory(std::string(256, 'd').c_str(), nullptr));
	EXPECT_EQ(B_ENTRY_NOT_FOUND, dir.CreateFile("none/file", nullptr));

	EXPECT_TRUE(dir.Contains("sub", B_DIRECTORY_NODE));
	EXPECT_FALSE(dir.Contains("sub", B_FILE_NODE));
	EXPECT_TRUE(dir.Contains("link", B_SYMLINK_NODE));
	BEntry deep((scratch / "sub/file").c_str());
	EXPECT_TRUE(dir.Contains(&deep));
	EXPECT_FALSE(sub.Contains(&deep, B_DIRECTORY_NODE));
	BEntry outside("/etc");
	EXPECT_FALSE(dir.Contains(&outside));

	BEntry found;
	ASSERT_EQ(B_OK, dir.FindEntry("link", &found, true));
	BPath path(&found);
	EXPECT_EQ(scratch / "sub/file", path.Path());
	EXPECT_EQ(B_ENTRY_NOT_FOUND, dir.FindEntry("missing", &found));
	EXPECT_EQ(B_NO_INIT, found.InitCheck());

	BEntry self;
	ASSERT_EQ(B_OK, sub.GetEntry(&self));
	EXPECT_EQ(B_OK, BPath(&self).InitCheck());
	EXPECT_EQ(scratch / "sub", BPath(&self).Path());
	EXPECT_FALSE(sub.IsRootDirectory());
	EXPECT_TRUE(BDirectory("/").IsRootDirectory());

	node_ref node;
	ASSERT_EQ(B_OK, sub.GetNodeRef(&node));
	BDirectory again(&node);
	EXPECT_EQ(B_OK, again.InitCheck());
	EXPECT_TRUE(again == sub);

	EXPECT_EQ(B_OK, create_directory((scratch / "x/y/z").c_str(), 0755));
	EXPECT_EQ(B_NOT_A_DIRECTORY,
		create_directory((scratch / "sub/file/q").c_str(), 0755));
}

TEST(DirectoryTest, FoldersThatCannotBeReadOrAreGone)
{
	Scratch scratch;
	EXPECT_EQ(B_ENTRY_NOT_FOUND, BDirectory((scratch / "none").c_str())
		.InitCheck());
	EXPECT_EQ(B_NOT_A_DIRECTORY, BDirectory(scratch.File("file").c_str())
		.InitCheck());
	ASSERT_EQ(0, symlink("loop", (scratch / "loop").c_str()));
	EXPECT_EQ(B_LINK_LIMIT, BDirectory((scratch / "loop").c_str()).InitCheck());

	// A folder removed while open reads as empty and has no entry any more.
	std::string doomed = scratch.Folder("doomed");
	BDirectory dir(doomed.c_str());
	ASSERT_EQ(0, rmdir(doomed.c_str()));
	entry_ref ref;
	EXPECT_EQ(B_ENTRY_NOT_FOUND, dir.GetNextRef(&ref));
	BEntry entry;
	EXPECT_EQ(B_ENTRY_NOT_FOUND, dir.GetEntry(&entry));
	EXPECT_EQ(B_ENTRY_NOT_FOUND, dir.CreateFile("x", nullptr));

	BDirectory unset;
	EXPECT_EQ(B_NO_INIT, unset.GetNextRef(&ref));
	EXPECT_EQ(B_NO_INIT, unset.CountEntries());
}
