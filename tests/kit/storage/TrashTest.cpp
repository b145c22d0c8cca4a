#include <regex>

#include <gtest/gtest.h>

#include <Directory.h>
#include <Entry.h>
#include <FindDirectory.h>
#include <Path.h>

#include "StorageTestSupport.h"

using namespace StorageTest;

namespace {

struct Trash {
	std::string files;
	std::string info;

	std::string Record(const std::string& name) const
	{
		return Contents(info + "/" + name + ".trashinfo");
	}
};

Trash FindTrash()
{
	BPath path;
	EXPECT_EQ(B_OK, find_directory(B_TRASH_DIRECTORY, &path));
	std::string files = path.Path();
	return { files, files.substr(0, files.rfind('/')) + "/info" };
}

// The record without its deletion date, which is checked for its form.
std::string WithoutDate(const std::string& record)
{
	std::smatch match;
	std::regex date("DeletionDate=(\\d{4}-\\d\\d-\\d\\dT\\d\\d:\\d\\d:\\d\\d)\n$");
	EXPECT_TRUE(std::regex_search(record, match, date)) << record;
	return record.substr(0, match.position(0));
}

status_t MoveToTrash(const std::string& path, const char* name = nullptr)
{
	BEntry entry(path.c_str());
	BDirectory trash(FindTrash().files.c_str());
	return entry.MoveTo(&trash, name);
}

}

TEST(TrashTest, IsMadeWhereMissing)
{
	PrivateHome home;
	char path[B_PATH_NAME_LENGTH];
	ASSERT_EQ(B_OK, find_directory(B_TRASH_DIRECTORY, 0, false, path,
		sizeof(path)));
	std::string trash = home.Home() + "/.local/share/Trash";
	EXPECT_EQ(trash + "/files", path);
	for (const char* folder : { "", "/files", "/info" }) {
		struct stat st;
		ASSERT_EQ(0, stat((trash + folder).c_str(), &st)) << folder;
		EXPECT_EQ(0700u, st.st_mode & 0777) << folder;
	}
	EXPECT_EQ(B_NAME_TOO_LONG, find_directory(B_TRASH_DIRECTORY, 0, false,
		path, 4));
}

TEST(TrashTest, RecordsMatchThoseOfGioTrash)
{
	PrivateHome home;
	if (std::system("gio help trash >/dev/null 2>&1") != 0)
		GTEST_SKIP() << "gio (libglib2.0-bin) is not installed";
	Trash trash = FindTrash();
	for (std::string name : { std::string("plain.txt"),
			std::string("it's \"$HOME\" `date` 100% [x]&y"),
			std::string("new\nline \xff\xfe"), std::string("caf\xc3\xa9") }) {
		std::string folder = home.Root().Folder("home/sub dir");
		std::string original = folder + "/" + name;
		std::ofstream(original) << "gio";
		std::string command = "gio trash '" + std::regex_replace(original,
			std::regex("'"), "'\\''") + "'";
		ASSERT_EQ(0, std::system(command.c_str())) << command;
		std::string theirs = trash.Record(name);
		ASSERT_FALSE(theirs.empty()) << name;
		ASSERT_EQ(0, unlink((trash.files + "/" + name).c_str()));
		ASSERT_EQ(0, unlink((trash.info + "/" + name + ".trashinfo").c_str()));

		std::ofstream(original) << "ours";
		ASSERT_EQ(B_OK, MoveToTrash(original)) << name;
		EXPECT_EQ("ours", Contents(trash.files + "/" + name));
		EXPECT_EQ(WithoutDate(theirs), WithoutDate(trash.Record(name)));
	}
}

TEST(TrashTest, RecordsFollowTheEntries)
{
	PrivateHome home;
	Trash trash = FindTrash();
	std::string original = home.Root().File("home/doc", "d");
	ASSERT_EQ(B_OK, MoveToTrash(original));
	std::string record = trash.Record("doc");
	EXPECT_NE(std::string::npos, record.find("Path=" + original + "\n"));

	// Renamed inside the trash, it keeps where it came from.
	BEntry trashed((trash.files + "/doc").c_str());
	ASSERT_EQ(B_OK, trashed.Rename("doc 2"));
	EXPECT_EQ(record, trash.Record("doc 2"));
	EXPECT_FALSE(Exists(trash.info + "/doc.trashinfo"));

	// Restored, it has no record; trashed again and removed, neither.
	BDirectory homeDir(home.Home().c_str());
	ASSERT_EQ(B_OK, trashed.MoveTo(&homeDir, "doc"));
	EXPECT_FALSE(Exists(trash.info + "/doc 2.trashinfo"));
	ASSERT_EQ(B_OK, MoveToTrash(original));
	BEntry again((trash.files + "/doc").c_str());
	ASSERT_EQ(B_OK, again.Remove());
	EXPECT_FALSE(Exists(trash.info + "/doc.trashinfo"));

	// Entries below the trash's top level have no records of their own.
	std::string folder = home.Root().Folder("home/folder");
	home.Root().File("home/folder/inner");
	ASSERT_EQ(B_OK, MoveToTrash(folder));
	ASSERT_EQ(B_OK, BEntry((trash.files + "/folder/inner").c_str()).Remove());
	EXPECT_TRUE(Exists(trash.info + "/folder.trashinfo"));
}

TEST(TrashTest, ClashesAndFailuresLeaveNoStrayRecord)
{
	PrivateHome home;
	Trash trash = FindTrash();
	std::string first = home.Root().File("home/same", "first");
	ASSERT_EQ(B_OK, MoveToTrash(first));
	std::string record = trash.Record("same");
	std::string second = home.Root().File("home/same", "second");
	EXPECT_EQ(B_FILE_EXISTS, MoveToTrash(second));
	EXPECT_EQ(record, trash.Record("same"));
	EXPECT_EQ("first", Contents(trash.files + "/same"));
	EXPECT_EQ("second", Contents(second));

	// An item without a record still blocks the name; the record written
	// for the failed move is taken back.
	home.Root().File("home/.local/share/Trash/files/bare", "bare");
	std::string bare = home.Root().File("home/bare", "mine");
	EXPECT_EQ(B_FILE_EXISTS, MoveToTrash(bare));
	EXPECT_FALSE(Exists(trash.info + "/bare.trashinfo"));

	// A record whose item is gone does not block the name.
	home.Root().File("home/.local/share/Trash/info/orphan.trashinfo", "old");
	std::string orphan = home.Root().File("home/orphan");
	ASSERT_EQ(B_OK, MoveToTrash(orphan));
	EXPECT_NE("old", trash.Record("orphan"));

	// A name too long for its record is refused before anything moves.
	std::string longName(250, 'l');
	std::string tooLong = home.Root().File("home/" + longName);
	EXPECT_EQ(B_NAME_TOO_LONG, MoveToTrash(tooLong));
	EXPECT_TRUE(Exists(tooLong));

	// With clobber the replaced item's record gives way to the new one.
	std::string third = home.Root().File("home/third", "third");
	BEntry entry(third.c_str());
	BDirectory trashDir(trash.files.c_str());
	ASSERT_EQ(B_OK, entry.MoveTo(&trashDir, "same", true));
	EXPECT_EQ("third", Contents(trash.files + "/same"));
	EXPECT_NE(std::string::npos,
		trash.Record("same").find("Path=" + home.Home() + "/third\n"));
	BDirectory info(trash.info.c_str());
	EXPECT_EQ(2, info.CountEntries());
}

TEST(FindDirectoryTest, UserFoldersFollowTheXdgSettings)
{
	PrivateHome home;
	BPath path;
	ASSERT_EQ(B_OK, find_directory(B_DESKTOP_DIRECTORY, &path));
	EXPECT_EQ(home.Home() + "/Desktop", path.Path());
	home.Root().File("home/.config/user-dirs.dirs",
		"# written by xdg-user-dirs-update\n"
		"XDG_DOCUMENTS_DIR=\"$HOME/Docs\"\n"
		"XDG_DESKTOP_DIR=\"$HOME/Schreib \\\"tisch\\\"\"\n");
	ASSERT_EQ(B_OK, find_directory(B_DESKTOP_DIRECTORY, &path, true));
	EXPECT_EQ(home.Home() + "/Schreib \"tisch\"", path.Path());
	EXPECT_TRUE(Exists(path.Path()));

	ASSERT_EQ(B_OK, find_directory(B_USER_DIRECTORY, &path));
	EXPECT_EQ(home.Home(), path.Path());
	ASSERT_EQ(B_OK, find_directory(B_USER_SETTINGS_DIRECTORY, &path));
	EXPECT_EQ(home.Home() + "/.config", path.Path());
	EXPECT_EQ(B_BAD_VALUE,
		find_directory(static_cast<directory_which>(12345), &path));
}
