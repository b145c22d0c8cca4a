#include <gtest/gtest.h>

#include <algorithm>

#include <sys/stat.h>
#include <sys/xattr.h>
#include <unistd.h>

#include <Entry.h>
#include <Node.h>
#include <NodeInfo.h>
#include <SymLink.h>
#include <TypeConstants.h>

#include "SystemPalette.h"
#include "TypeTestSupport.h"

using namespace TypeTest;

namespace {

const std::string kPngStart("\x89PNG\r\n\x1a\n\0\0\0\rIHDR", 16);

std::string TypeOf(BNode&& node)
{
	char type[B_MIME_TYPE_LENGTH] = "";
	EXPECT_EQ(B_OK, BNodeInfo(&node).GetType(type));
	return type;
}

std::string TypeAt(const std::string& path)
{
	return TypeOf(BNode(path.c_str()));
}

std::vector<uint8> TrackerIcon(const std::string& path, icon_size size)
{
	entry_ref ref;
	EXPECT_EQ(B_OK, BEntry(path.c_str()).GetRef(&ref));
	BBitmap bitmap(BRect(0, 0, size - 1, size - 1), B_CMAP8);
	EXPECT_EQ(B_OK, BNodeInfo::GetTrackerIcon(&ref, &bitmap, size));
	return Pixels(bitmap);
}

class NodeInfoTest : public testing::Test {
protected:
	IconEnvironment fTheme;
	const Scratch& fRoot = fTheme.Root();
};

}

TEST_F(NodeInfoTest, TypeComesFromTheNameThenTheContent)
{
	EXPECT_EQ("text/plain", TypeAt(fRoot.File("notes.txt", "")));
	EXPECT_EQ("image/png", TypeAt(fRoot.File("picture", kPngStart)));
	EXPECT_EQ("text/plain", TypeAt(fRoot.File("letter", "plain words\n")));
	// A name that says something is believed over the content.
	EXPECT_EQ("text/plain", TypeAt(fRoot.File("fake.txt", kPngStart)));
	EXPECT_EQ("text/plain",
		TypeAt(fRoot.File("it's $HOME `x`\n\"q\".txt", "")));
	EXPECT_EQ("text/plain", TypeAt(fRoot.File("caf\xe9.txt", "")));

	// Special files are never opened for reading.
	std::string fifo = fRoot.Path() + "/pipe";
	ASSERT_EQ(0, mkfifo(fifo.c_str(), 0600));
	EXPECT_EQ("inode/fifo", TypeAt(fifo));
}

TEST_F(NodeInfoTest, TypeAttributeWinsAndTravelsAsUserMimeType)
{
	std::string path = fRoot.File("data.txt", "x");
	// As another program writes it.
	ASSERT_EQ(0, setxattr(path.c_str(), "user.mime_type", "image/png", 9, 0));
	EXPECT_EQ("image/png", TypeAt(path));

	BNode node(path.c_str());
	BNodeInfo info(&node);
	EXPECT_EQ(B_OK, info.SetType("application/x-Varnel"));
	char raw[64];
	ssize_t length = getxattr(path.c_str(), "user.mime_type", raw,
		sizeof(raw));
	EXPECT_EQ("application/x-Varnel",
		std::string(raw, std::max<ssize_t>(length, 0)));
	EXPECT_EQ(B_BAD_VALUE, info.SetType("not a type"));
	EXPECT_EQ("application/x-Varnel", TypeAt(path));

	EXPECT_EQ(B_OK, info.SetType(NULL));
	EXPECT_EQ(B_OK, info.SetType(NULL));
	EXPECT_EQ("text/plain", TypeAt(path));

	// Garbage in the attribute is not a type.
	ASSERT_EQ(0, setxattr(path.c_str(), "user.mime_type", "a b\xff", 4, 0));
	EXPECT_EQ("text/plain", TypeAt(path));
}

TEST_F(NodeInfoTest, FoldersLinksAndVolumes)
{
	std::string folder = fRoot.Folder("folder");
	std::string link = fRoot.Path() + "/link";
	ASSERT_EQ(0, symlink("folder", link.c_str()));

	EXPECT_EQ("application/x-vnd.be-directory", TypeAt(folder));
	EXPECT_EQ("application/x-vnd.be-directory", TypeAt(link));
	EXPECT_EQ("application/x-vnd.be-symlink", TypeOf(BSymLink(link.c_str())));

	BNode node(folder.c_str());
	EXPECT_EQ(B_OK, BNodeInfo(&node).SetType("application/x-vnd.be-volume"));
	EXPECT_EQ("application/x-vnd.be-volume", TypeAt(folder));

	char type[B_MIME_TYPE_LENGTH];
	BNodeInfo unset;
	EXPECT_EQ(B_NO_INIT, unset.GetType(type));
	EXPECT_EQ(B_BAD_VALUE, unset.SetTo(NULL));
	BNode missing((fRoot.Path() + "/missing").c_str());
	EXPECT_EQ(B_BAD_VALUE, BNodeInfo(&missing).InitCheck());
}

TEST_F(NodeInfoTest, TrackerIconsPreferTheNodesOwnThenItsType)
{
	fTheme.WriteTheme("Adwaita");
	fTheme.WriteIcon("Adwaita/16x16/mimetypes/text-x-generic.png",
		Png(16, Rgba{0, 0, 255, 255}));
	std::string own = fRoot.File("own.txt", "");
	std::string unknown = fRoot.File("c.varnel-unknown", "\x01\x02");

	// Many files of one type decode one PNG.
	int32 before = BPrivate::IconDecodeCount();
	for (int i = 0; i < 100; i++) {
		std::string file = fRoot.File("f" + std::to_string(i) + ".txt");
		EXPECT_EQ(std::vector<uint8>(256, BPrivate::IndexForColor(0, 0, 255)),
			TrackerIcon(file, B_MINI_ICON));
	}
	EXPECT_EQ(before + 1, BPrivate::IconDecodeCount());

	BNode node(own.c_str());
	BBitmap icon(BRect(0, 0, 15, 15), B_CMAP8);
	EXPECT_EQ(B_ENTRY_NOT_FOUND, BNodeInfo(&node).GetIcon(&icon, B_MINI_ICON));
	std::vector<uint8> pixels(256, 42);
	ASSERT_EQ(256, node.WriteAttr("BEOS:M:STD_ICON", B_MINI_ICON_TYPE, 0,
		pixels.data(), pixels.size()));
	EXPECT_EQ(pixels, TrackerIcon(own, B_MINI_ICON));
	// No large icon of its own, none of its type: the drawn file picture.
	std::vector<uint8> plain = TrackerIcon(own, B_LARGE_ICON);
	EXPECT_EQ(plain, TrackerIcon(unknown, B_LARGE_ICON));
	EXPECT_NE(1024, std::count(plain.begin(), plain.end(),
		B_TRANSPARENT_MAGIC_CMAP8));
	EXPECT_EQ(B_BAD_VALUE,
		BNodeInfo(&node).GetTrackerIcon(&icon, B_LARGE_ICON));
}

TEST_F(NodeInfoTest, FoldersAndBrokenLinksGetTheirPictures)
{
	std::string link = fRoot.Path() + "/dangling";
	ASSERT_EQ(0, symlink("nowhere", link.c_str()));
	EXPECT_EQ(TypeIcon("application/x-vnd.be-symlink", B_MINI_ICON),
		TrackerIcon(link, B_MINI_ICON));
	EXPECT_EQ(TypeIcon("application/x-vnd.be-directory", B_LARGE_ICON),
		TrackerIcon(fRoot.Folder("folder"), B_LARGE_ICON));

	entry_ref missing(0, 0, "missing");
	BBitmap icon(BRect(0, 0, 15, 15), B_CMAP8);
	EXPECT_NE(B_OK, BNodeInfo::GetTrackerIcon(&missing, &icon, B_MINI_ICON));
	EXPECT_EQ(B_BAD_VALUE, BNodeInfo::GetTrackerIcon(NULL, &icon, B_MINI_ICON));
}
