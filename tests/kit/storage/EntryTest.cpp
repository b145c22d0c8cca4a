#include <algorithm>
#include <cstring>
#include <sys/wait.h>

#include <gtest/gtest.h>

#include <Directory.h>
#include <Entry.h>
#include <File.h>
#include <Path.h>

#include "StorageTestSupport.h"

using namespace StorageTest;

namespace {

std::string PathOf(const entry_ref& ref)
{
	BPath path(&ref);
	return path.InitCheck() == B_OK ? path.Path() : "";
}

}

TEST(EntryTest, RefsFollowFoldersTheKitRenamesAndMoves)
{
	Scratch scratch;
	scratch.Folder("a/b");
	scratch.Folder("elsewhere");
	scratch.File("a/b/note", "kept");
	entry_ref inner;
	ASSERT_EQ(B_OK, get_ref_for_path((scratch / "a/b/note").c_str(), &inner));
	entry_ref folderRef;
	ASSERT_EQ(B_OK, get_ref_for_path((scratch / "a").c_str(), &folderRef));

	BEntry folder(&folderRef);
	ASSERT_EQ(B_OK, folder.Rename("renamed"));
	EXPECT_EQ(scratch / "renamed/b/note", PathOf(inner));

	BDirectory elsewhere((scratch / "elsewhere").c_str());
	ASSERT_EQ(B_OK, folder.MoveTo(&elsewhere));
	EXPECT_EQ(scratch / "elsewhere/renamed/b/note", PathOf(inner));
	BFile file(&inner, B_READ_ONLY);
	char text[8] = {};
	EXPECT_EQ(4, file.Read(text, sizeof(text)));
	EXPECT_STREQ("kept", text);

	// Moved behind the kit's back, the ref no longer resolves rather than
	// naming some other place.
	ASSERT_EQ(0, rename((scratch / "elsewhere/renamed").c_str(),
		(scratch / "outside").c_str()));
	EXPECT_EQ(B_ENTRY_NOT_FOUND, BEntry(&inner).InitCheck());

	// While its folder is open, a ref follows it wherever it goes, and a
	// name that would leave the folder is still refused.
	{
		BDirectory open((scratch / "outside/b").c_str());
		ASSERT_EQ(0, rename((scratch / "outside").c_str(),
			(scratch / "again").c_str()));
		EXPECT_EQ(B_OK, BFile(&inner, B_READ_ONLY).InitCheck());
		EXPECT_EQ(scratch / "again/b/note", PathOf(inner));
		entry_ref up(inner.device, inner.directory, "../b");
		EXPECT_EQ(B_BAD_VALUE, BFile(&up, B_READ_ONLY).InitCheck());
		up.set_name("..");
		EXPECT_EQ(B_BAD_VALUE, BNode(&up).InitCheck());
	}
	ASSERT_EQ(0, rename((scratch / "again").c_str(),
		(scratch / "outside").c_str()));
	EXPECT_EQ(B_ENTRY_NOT_FOUND, BFile(&inner, B_READ_ONLY).InitCheck());
	EXPECT_EQ(B_ENTRY_NOT_FOUND, BEntry(&inner).InitCheck());
}

TEST(EntryTest, RefsCompareAcrossWaysOfGettingThem)
{
	Scratch scratch;
	scratch.Folder("dir/sub");
	entry_ref byPath;
	ASSERT_EQ(B_OK, get_ref_for_path((scratch / "dir/sub").c_str(), &byPath));
	// Through a link to the folder, and with . and .. on the way.
	ASSERT_EQ(0, symlink((scratch / "dir").c_str(), (scratch / "link").c_str()));
	entry_ref viaLink;
	ASSERT_EQ(B_OK, get_ref_for_path((scratch / "link/./sub/../sub").c_str(),
		&viaLink));
	EXPECT_EQ(byPath, viaLink);

	BDirectory dir((scratch / "dir").c_str());
	entry_ref listed;
	ASSERT_EQ(B_OK, dir.GetNextRef(&listed));
	EXPECT_EQ(byPath, listed);
	BEntry entry(&listed);
	entry_ref back;
	ASSERT_EQ(B_OK, entry.GetRef(&back));
	EXPECT_EQ(byPath, back);
	BDirectory parentDir;
	ASSERT_EQ(B_OK, entry.GetParent(&parentDir));
	EXPECT_TRUE(parentDir == dir);

	// A missing leaf still has a ref; a missing folder has none.
	entry_ref missing;
	EXPECT_EQ(B_OK, get_ref_for_path((scratch / "dir/nothing").c_str(),
		&missing));
	EXPECT_FALSE(BEntry(&missing).Exists());
	EXPECT_EQ(B_ENTRY_NOT_FOUND,
		get_ref_for_path((scratch / "none/x").c_str(), &missing));

	// A ref's name never leads out of its folder.
	for (const char* name : { "../dir", "a/b", "..", "" }) {
		entry_ref bad(byPath.device, byPath.directory, name);
		EXPECT_EQ(B_BAD_VALUE, BEntry(&bad).InitCheck()) << name;
	}
	entry_ref unknown(byPath.device, 1, "x");
	EXPECT_EQ(B_ENTRY_NOT_FOUND, BEntry(&unknown).InitCheck());

	entry_ref root;
	ASSERT_EQ(B_OK, get_ref_for_path("/", &root));
	EXPECT_EQ("/", PathOf(root));
	BEntry rootEntry(&root);
	BEntry parent;
	EXPECT_EQ(B_ENTRY_NOT_FOUND, rootEntry.GetParent(&parent));
}

TEST(EntryTest, RenameRefusesNamesThatLeaveTheFolder)
{
	Scratch scratch;
	scratch.Folder("sub");
	std::string file = scratch.File("file", "data");
	BEntry entry(file.c_str());
	for (const char* name : { "", ".", "..", "sub/file", "../file", "/tmp/x" })
		EXPECT_EQ(B_BAD_VALUE, entry.Rename(name)) << name;
	EXPECT_EQ(B_BAD_VALUE, entry.Rename(nullptr));
	EXPECT_EQ("data", Contents(file));

	EXPECT_EQ(B_NAME_TOO_LONG, entry.Rename(std::string(256, 'n').c_str()));
	std::string longest(255, 'n');
	ASSERT_EQ(B_OK, entry.Rename(longest.c_str()));
	EXPECT_EQ("data", Contents(scratch / longest));
	char name[B_FILE_NAME_LENGTH];
	ASSERT_EQ(B_OK, entry.GetName(name));
	EXPECT_EQ(longest, name);
	EXPECT_EQ(B_OK, entry.Rename(longest.c_str()));
}

TEST(EntryTest, NoClobberLeavesBothEntriesAlone)
{
	Scratch scratch;
	scratch.Folder("dest/taken");
	std::string source = scratch.File("taken", "mine");
	std::string other = scratch.File("other", "theirs");
	BEntry entry(source.c_str());

	EXPECT_EQ(B_FILE_EXISTS, entry.Rename("other"));
	EXPECT_EQ("mine", Contents(source));
	EXPECT_EQ("theirs", Contents(other));

	BDirectory dest((scratch / "dest").c_str());
	EXPECT_EQ(B_FILE_EXISTS, entry.MoveTo(&dest));
	EXPECT_TRUE(Exists(scratch / "dest/taken/"));
	EXPECT_EQ("mine", Contents(source));

	ASSERT_EQ(B_OK, entry.Rename("other", true));
	EXPECT_EQ("mine", Contents(other));
	EXPECT_FALSE(Exists(source));

	// A folder never moves into itself.
	BEntry folder((scratch / "dest").c_str());
	BDirectory inside((scratch / "dest/taken").c_str());
	EXPECT_NE(B_OK, folder.MoveTo(&inside));
	EXPECT_TRUE(Exists(scratch / "dest/taken"));
}

TEST(EntryTest, MovesAcrossVolumesFailWithoutCopying)
{
	Scratch scratch;
	FakeVolumes volumes({ Volume(1, scratch.Folder("boot"), "Boot", 0, true),
		Volume(2, scratch.Folder("boot/usb"), "Stick") });
	std::string source = scratch.File("boot/file", "x");
	BEntry entry(source.c_str());
	BDirectory usb((scratch / "boot/usb").c_str());
	EXPECT_EQ(B_CROSS_DEVICE_LINK, entry.MoveTo(&usb));
	EXPECT_TRUE(Exists(source));
	EXPECT_FALSE(Exists(scratch / "boot/usb/file"));

	// A volume's root stays where it is mounted.
	BEntry root((scratch / "boot/usb").c_str());
	EXPECT_EQ(B_BUSY, root.Rename("moved"));
}

TEST(EntryTest, OddNamesAreCarriedExactly)
{
	Scratch scratch;
	const std::vector<std::string> names = { "with space", "quote'\"",
		"$HOME and `date`", "new\nline", "bad\xff\xfe utf-8", "-dash", "*" };
	BDirectory dir(scratch.Path().c_str());
	for (const std::string& name : names) {
		BFile file;
		ASSERT_EQ(B_OK, dir.CreateFile(name.c_str(), &file, true)) << name;
		EXPECT_EQ(static_cast<ssize_t>(name.size()),
			file.Write(name.data(), name.size()));
	}
	std::vector<std::string> listed;
	entry_ref ref;
	while (dir.GetNextRef(&ref) == B_OK) {
		listed.push_back(ref.name);
		EXPECT_EQ(ref.name, Contents(PathOf(ref)));
		BEntry entry(&ref);
		std::string renamed = std::string(ref.name) + " 'moved' $x";
		ASSERT_EQ(B_OK, entry.Rename(renamed.c_str()));
		EXPECT_EQ(ref.name, Contents(scratch / renamed));
	}
	std::sort(listed.begin(), listed.end());
	std::vector<std::string> expected = names;
	std::sort(expected.begin(), expected.end());
	EXPECT_EQ(expected, listed);
}

TEST(EntryTest, LinksAreFollowedOnlyWhenAsked)
{
	Scratch scratch;
	std::string target = scratch.File("target", "t");
	ASSERT_EQ(0, symlink("target", (scratch / "link").c_str()));
	ASSERT_EQ(0, symlink("missing", (scratch / "dangling").c_str()));
	ASSERT_EQ(0, symlink("loop2", (scratch / "loop1").c_str()));
	ASSERT_EQ(0, symlink("loop1", (scratch / "loop2").c_str()));

	BEntry link((scratch / "link").c_str());
	EXPECT_TRUE(link.IsSymLink());
	BEntry followed((scratch / "link").c_str(), true);
	EXPECT_TRUE(followed.IsFile());
	BPath path;
	ASSERT_EQ(B_OK, followed.GetPath(&path));
	EXPECT_STREQ(target.c_str(), path.Path());

	EXPECT_TRUE(BEntry((scratch / "dangling").c_str()).IsSymLink());
	EXPECT_EQ(B_ENTRY_NOT_FOUND,
		BEntry((scratch / "dangling").c_str(), true).InitCheck());
	EXPECT_EQ(B_LINK_LIMIT,
		BEntry((scratch / "loop1").c_str(), true).InitCheck());

	entry_ref ref;
	ASSERT_EQ(B_OK, get_ref_for_path((scratch / "link").c_str(), &ref));
	EXPECT_STREQ("link", ref.name);
	BEntry traversed(&ref, true);
	ASSERT_EQ(B_OK, traversed.GetRef(&ref));
	EXPECT_STREQ("target", ref.name);
}

TEST(EntryTest, RemoveAndVanishedEntries)
{
	Scratch scratch;
	scratch.Folder("full/inside");
	scratch.Folder("empty");
	BEntry file(scratch.File("file").c_str());
	BEntry full((scratch / "full").c_str());
	BEntry empty((scratch / "empty").c_str());

	EXPECT_EQ(B_DIRECTORY_NOT_EMPTY, full.Remove());
	EXPECT_EQ(B_OK, empty.Remove());
	EXPECT_EQ(B_OK, file.Remove());
	EXPECT_FALSE(file.Exists());
	EXPECT_EQ(B_OK, file.InitCheck());
	EXPECT_EQ(B_ENTRY_NOT_FOUND, file.Remove());
	EXPECT_EQ(B_ENTRY_NOT_FOUND, file.Rename("again"));
	struct stat st;
	EXPECT_EQ(B_ENTRY_NOT_FOUND, file.GetStat(&st));

	BEntry unset;
	EXPECT_EQ(B_NO_INIT, unset.Remove());
	EXPECT_EQ(B_NO_INIT, unset.GetStat(&st));
}

TEST(EntryTest, PermissionDeniedIsReported)
{
	// The kit may run threads of its own by now: the child starts afresh.
	GTEST_FLAG_SET(death_test_style, "threadsafe");
	Scratch scratch;
	std::string closed = scratch.Folder("closed");
	scratch.File("closed/secret", "s");
	chmod(closed.c_str(), 0);
	chmod(scratch.Path().c_str(), 0555);
	// Root passes every permission check: the child looks as an ordinary
	// user, then cleans up after itself as root again.
	EXPECT_EXIT({
		bool root = geteuid() == 0;
		if (root && (setegid(65534) != 0 || seteuid(65534) != 0))
			_exit(2);
		struct stat st;
		bool denied = BDirectory(closed.c_str()).InitCheck()
				== B_PERMISSION_DENIED
			&& BEntry((closed + "/secret").c_str()).GetStat(&st)
				== B_PERMISSION_DENIED
			&& BEntry(closed.c_str()).Rename("open") == B_PERMISSION_DENIED;
		if (root && (seteuid(0) != 0 || setegid(0) != 0))
			_exit(3);
		chmod(scratch.Path().c_str(), 0755);
		std::filesystem::remove_all(scratch.Path());
		_exit(denied ? 0 : 1);
	}, ::testing::ExitedWithCode(0), "");
	chmod(scratch.Path().c_str(), 0755);
	chmod(closed.c_str(), 0755);
}

TEST(EntryTest, StatChangesReachTheEntryOrItsNode)
{
	Scratch scratch;
	std::string path = scratch.File("file");
	BEntry entry(path.c_str());
	ASSERT_EQ(B_OK, entry.SetPermissions(0640));
	ASSERT_EQ(B_OK, entry.SetModificationTime(1000000000));
	BNode node(path.c_str());
	mode_t mode;
	time_t modified;
	ASSERT_EQ(B_OK, node.GetPermissions(&mode));
	EXPECT_EQ(0640u, mode);
	ASSERT_EQ(B_OK, node.GetModificationTime(&modified));
	EXPECT_EQ(1000000000, modified);
	ASSERT_EQ(B_OK, node.SetAccessTime(2000000000));
	time_t accessed;
	ASSERT_EQ(B_OK, entry.GetAccessTime(&accessed));
	EXPECT_EQ(2000000000, accessed);

	// A link's own mode cannot change on Linux; its target is not touched.
	ASSERT_EQ(0, symlink("file", (scratch / "link").c_str()));
	EXPECT_NE(B_OK, BEntry((scratch / "link").c_str()).SetPermissions(0600));
	ASSERT_EQ(B_OK, node.GetPermissions(&mode));
	EXPECT_EQ(0640u, mode);
}
