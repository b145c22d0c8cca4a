#include <cstring>
#include <sys/mount.h>
#include <sys/xattr.h>

#include <gtest/gtest.h>

#include <Directory.h>
#include <Entry.h>
#include <File.h>
#include <Node.h>
#include <Path.h>
#include <SymLink.h>
#include <TypeConstants.h>

#include "StorageTestSupport.h"

using namespace StorageTest;

namespace {

std::string RawAttribute(const std::string& path, const std::string& name)
{
	char value[256];
	ssize_t length = getxattr(path.c_str(), name.c_str(), value, sizeof(value));
	return length >= 0 ? std::string(value, length) : "";
}

// Copies every attribute of from to to as the copy engine does.
void CopyAttributes(BNode& from, BNode& to)
{
	char name[B_ATTR_NAME_LENGTH];
	from.RewindAttrs();
	while (from.GetNextAttrName(name) == B_OK) {
		attr_info info;
		ASSERT_EQ(B_OK, from.GetAttrInfo(name, &info));
		std::vector<char> data(info.size);
		ASSERT_EQ(info.size,
			from.ReadAttr(name, info.type, 0, data.data(), data.size()));
		ASSERT_EQ(info.size,
			to.WriteAttr(name, info.type, 0, data.data(), data.size()));
	}
}

}

TEST(NodeTest, FilesReadWriteSeekAndSize)
{
	Scratch scratch;
	std::string path = scratch / "data";
	BFile file(path.c_str(), B_READ_WRITE | B_CREATE_FILE | B_FAIL_IF_EXISTS);
	ASSERT_EQ(B_OK, file.InitCheck());
	EXPECT_TRUE(file.IsReadable());
	EXPECT_TRUE(file.IsWritable());
	EXPECT_EQ(10, file.Write("0123456789", 10));
	EXPECT_EQ(3, file.WriteAt(20, "end", 3));
	off_t size;
	ASSERT_EQ(B_OK, file.GetSize(&size));
	EXPECT_EQ(23, size);
	EXPECT_EQ(4, file.Seek(4, SEEK_SET));
	char buffer[8] = {};
	EXPECT_EQ(3, file.Read(buffer, 3));
	EXPECT_STREQ("456", buffer);
	EXPECT_EQ(7, file.Position());
	EXPECT_EQ(3, file.ReadAt(20, buffer, sizeof(buffer)));
	EXPECT_EQ(0, file.ReadAt(100, buffer, sizeof(buffer)));
	ASSERT_EQ(B_OK, file.SetSize(2));
	EXPECT_EQ("01", Contents(path));
	EXPECT_EQ(B_BAD_VALUE, file.SetSize(-1));

	EXPECT_EQ(B_FILE_EXISTS, BFile(path.c_str(),
		B_WRITE_ONLY | B_CREATE_FILE | B_FAIL_IF_EXISTS).InitCheck());
	BFile reader(path.c_str(), B_READ_ONLY);
	EXPECT_FALSE(reader.IsWritable());
	EXPECT_LT(reader.Write("x", 1), 0);
	BFile eraser(path.c_str(), B_WRITE_ONLY | B_ERASE_FILE);
	EXPECT_EQ("", Contents(path));
	BFile appender(path.c_str(), B_WRITE_ONLY | B_OPEN_AT_END);
	appender.Write("a", 1);
	appender.Write("b", 1);
	EXPECT_EQ("ab", Contents(path));

	EXPECT_EQ(B_IS_A_DIRECTORY,
		BFile(scratch.Path().c_str(), B_READ_ONLY).InitCheck());
	EXPECT_EQ(B_ENTRY_NOT_FOUND,
		BFile((scratch / "none").c_str(), B_READ_ONLY).InitCheck());
	BFile unset;
	EXPECT_EQ(B_NO_INIT, unset.Read(buffer, 1));
	EXPECT_FALSE(unset.IsReadable());
}

TEST(NodeTest, TypedAttributesRoundTrip)
{
	Scratch scratch;
	std::string path = scratch.File("file");
	BNode node(path.c_str());
	int32 number = 0x12345678;
	EXPECT_EQ(4, node.WriteAttr("count", B_INT32_TYPE, 0, &number, 4));
	EXPECT_EQ(5, node.WriteAttr("text", B_STRING_TYPE, 0, "text", 5));
	EXPECT_EQ(3, node.WriteAttr("raw", B_RAW_TYPE, 0, "\0\1\2", 3));

	attr_info info;
	ASSERT_EQ(B_OK, node.GetAttrInfo("count", &info));
	EXPECT_EQ(static_cast<uint32>(B_INT32_TYPE), info.type);
	EXPECT_EQ(4, info.size);
	int32 read = 0;
	EXPECT_EQ(4, node.ReadAttr("count", B_INT32_TYPE, 0, &read, 4));
	EXPECT_EQ(number, read);
	char tail[8] = {};
	EXPECT_EQ(3, node.ReadAttr("text", B_STRING_TYPE, 2, tail, sizeof(tail)));
	EXPECT_STREQ("xt", tail);

	// How they lie on disk: typed with their type in front, raw as is.
	type_code stored = B_INT32_TYPE;
	EXPECT_EQ(std::string(reinterpret_cast<char*>(&stored), 4)
		+ std::string(reinterpret_cast<char*>(&number), 4),
		RawAttribute(path, "user.haiku.count"));
	EXPECT_EQ(std::string("\0\1\2", 3), RawAttribute(path, "user.raw"));

	// Writing the other form replaces the first; an offset keeps the head.
	EXPECT_EQ(2, node.WriteAttr("raw", B_STRING_TYPE, 1, "xy", 2));
	EXPECT_EQ("", RawAttribute(path, "user.raw"));
	ASSERT_EQ(B_OK, node.GetAttrInfo("raw", &info));
	EXPECT_EQ(static_cast<uint32>(B_STRING_TYPE), info.type);
	EXPECT_EQ(3, info.size);

	std::vector<std::string> names;
	char name[B_ATTR_NAME_LENGTH];
	while (node.GetNextAttrName(name) == B_OK)
		names.push_back(name);
	std::sort(names.begin(), names.end());
	EXPECT_EQ((std::vector<std::string>{ "count", "raw", "text" }), names);
	EXPECT_EQ(B_ENTRY_NOT_FOUND, node.GetNextAttrName(name));

	EXPECT_EQ(B_OK, node.RemoveAttr("count"));
	EXPECT_EQ(B_ENTRY_NOT_FOUND, node.RemoveAttr("count"));
	EXPECT_EQ(B_ENTRY_NOT_FOUND, node.GetAttrInfo("count", &info));
	EXPECT_EQ(B_ENTRY_NOT_FOUND, node.ReadAttr("count", 0, 0, &read, 4));
	EXPECT_EQ(B_NAME_TOO_LONG,
		node.WriteAttr(std::string(245, 'a').c_str(), B_RAW_TYPE, 0, "", 0));
	EXPECT_EQ(B_BAD_VALUE, node.WriteAttr("", B_RAW_TYPE, 0, "", 0));
}

TEST(NodeTest, ForeignAttributesCopyByteForByte)
{
	Scratch scratch;
	std::string source = scratch.File("source");
	std::string binary("\0\xff\n user data", 13);
	ASSERT_EQ(0, setxattr(source.c_str(), "user.xdg.origin.url", binary.data(),
		binary.size(), 0));
	ASSERT_EQ(0, setxattr(source.c_str(), "user.mime_type", "text/x-foo", 10,
		0));
	BNode from(source.c_str());
	double typed = 2.5;
	from.WriteAttr("score", B_DOUBLE_TYPE, 0, &typed, sizeof(typed));

	attr_info info;
	ASSERT_EQ(B_OK, from.GetAttrInfo("xdg.origin.url", &info));
	EXPECT_EQ(static_cast<uint32>(B_RAW_TYPE), info.type);
	EXPECT_EQ(13, info.size);

	std::string target = scratch.File("target");
	BNode to(target.c_str());
	CopyAttributes(from, to);
	for (const char* name : { "user.xdg.origin.url", "user.mime_type",
			"user.haiku.score" }) {
		EXPECT_EQ(RawAttribute(source, name), RawAttribute(target, name))
			<< name;
	}
	EXPECT_EQ(binary, RawAttribute(target, "user.xdg.origin.url"));
}

TEST(NodeTest, LocksAreExclusive)
{
	Scratch scratch;
	std::string path = scratch.File("locked");
	BNode first(path.c_str());
	BFile second(path.c_str(), B_READ_ONLY);
	EXPECT_EQ(B_BAD_VALUE, first.Unlock());
	ASSERT_EQ(B_OK, first.Lock());
	EXPECT_EQ(B_BUSY, first.Lock());
	EXPECT_EQ(B_BUSY, second.Lock());
	// A copy of the node is another holder.
	BNode copy(first);
	EXPECT_EQ(B_BUSY, copy.Lock());
	ASSERT_EQ(B_OK, first.Unlock());
	EXPECT_EQ(B_OK, second.Lock());
	second.Unset();
	EXPECT_EQ(B_OK, first.Lock());
}

TEST(NodeTest, SymLinksAreTheLinksThemselves)
{
	Scratch scratch;
	scratch.Folder("folder");
	ASSERT_EQ(0, symlink("folder/../target", (scratch / "relative").c_str()));
	ASSERT_EQ(0, symlink("/etc", (scratch / "absolute").c_str()));
	BSymLink relative((scratch / "relative").c_str());
	ASSERT_EQ(B_OK, relative.InitCheck());
	EXPECT_TRUE(relative.IsSymLink());
	EXPECT_FALSE(relative.IsAbsolute());
	char buffer[6];
	EXPECT_EQ(5, relative.ReadLink(buffer, sizeof(buffer)));
	EXPECT_STREQ("folde", buffer);
	BPath linked;
	BDirectory dir(scratch.Path().c_str());
	EXPECT_GT(relative.MakeLinkedPath(&dir, &linked), 0);
	EXPECT_EQ(scratch / "target", linked.Path());
	EXPECT_TRUE(BSymLink((scratch / "absolute").c_str()).IsAbsolute());
	BSymLink copy(relative);
	EXPECT_TRUE(copy.IsSymLink());

	// Linux keeps no user attributes on links.
	EXPECT_EQ(B_NOT_ALLOWED, relative.WriteAttr("a", B_RAW_TYPE, 0, "x", 1));
	BSymLink notALink(scratch.File("plain").c_str());
	EXPECT_EQ(B_BAD_VALUE, notALink.ReadLink(buffer, sizeof(buffer)));
}

TEST(NodeTest, FullAndReadOnlyVolumes)
{
	if (geteuid() != 0)
		GTEST_SKIP() << "mounting a small and a read-only tmpfs needs root";
	Scratch scratch;
	std::string small = scratch.Folder("small");
	std::string readOnly = scratch.Folder("readonly");
	ASSERT_EQ(0, mount("tmpfs", small.c_str(), "tmpfs", 0, "size=64k"));
	ASSERT_EQ(0, mount("tmpfs", readOnly.c_str(), "tmpfs", MS_RDONLY, ""));

	BFile file((small + "/big").c_str(), B_WRITE_ONLY | B_CREATE_FILE);
	std::vector<char> data(256 * 1024, 'x');
	ssize_t written = file.Write(data.data(), data.size());
	EXPECT_GT(written, 0);
	EXPECT_LT(written, static_cast<ssize_t>(data.size()));
	EXPECT_EQ(B_DEVICE_FULL, file.Write(data.data(), data.size()));

	BDirectory locked(readOnly.c_str());
	EXPECT_EQ(B_READ_ONLY_DEVICE, locked.CreateFile("x", nullptr));
	EXPECT_EQ(B_READ_ONLY_DEVICE, locked.WriteAttr("a", B_RAW_TYPE, 0, "", 0));

	umount2(small.c_str(), MNT_DETACH);
	umount2(readOnly.c_str(), MNT_DETACH);
}
