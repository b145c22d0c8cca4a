#include <gtest/gtest.h>

#include <regex>

#include <unistd.h>

#include <AppFileInfo.h>
#include <File.h>

#include "AppResources.h"
#include "SystemPalette.h"
#include "TypeTestSupport.h"

using namespace TypeTest;

namespace {

// The version the project's CMakeLists.txt declares, as "x.y.z".
std::string DeclaredVersion()
{
	std::string source = __FILE__;
	std::ifstream lists(source.substr(0, source.rfind("/tests/"))
		+ "/CMakeLists.txt");
	std::string text((std::istreambuf_iterator<char>(lists)), {});
	std::smatch match;
	std::regex_search(text, match,
		std::regex("project\\([^)]*VERSION ([0-9.]+)"));
	return match.size() > 1 ? match[1].str() : "";
}

// A resource of this test program while the object lives.
class ScopedResource {
public:
	ScopedResource(const char* name, const std::string& data)
		: fName(name), fData(data)
	{
		BPrivate::RegisterAppResource(fName, fData.data(), fData.size());
	}

	~ScopedResource() { BPrivate::RegisterAppResource(fName, nullptr, 0); }

private:
	const char* fName;
	std::string fData;
};

class AppFileInfoTest : public testing::Test {
protected:
	void SetUp() override
	{
		char path[PATH_MAX];
		ssize_t length = readlink("/proc/self/exe", path, sizeof(path) - 1);
		path[std::max<ssize_t>(length, 0)] = '\0';
		ASSERT_EQ(B_OK, fProgram.SetTo(path, B_READ_ONLY));
		ASSERT_EQ(B_OK, fInfo.SetTo(&fProgram));
	}

	BFile fProgram;
	BAppFileInfo fInfo;
};

}

TEST_F(AppFileInfoTest, VersionOfTheRunningProgramIsTheBuilds)
{
	ScopedResource shortInfo(BPrivate::kShortInfoResource, "Two panes\n");
	version_info version;
	ASSERT_EQ(B_OK, fInfo.GetVersionInfo(&version, B_APP_VERSION_KIND));
	EXPECT_EQ(DeclaredVersion(), std::to_string(version.major) + "."
		+ std::to_string(version.middle) + "." + std::to_string(version.minor));
	EXPECT_STREQ("Two panes", version.short_info);
	EXPECT_STREQ("", version.long_info);

	EXPECT_EQ(B_ENTRY_NOT_FOUND, fInfo.GetVersionInfo(&version,
		B_SYSTEM_VERSION_KIND));
	EXPECT_EQ(B_BAD_VALUE, fInfo.GetVersionInfo(NULL, B_APP_VERSION_KIND));
}

TEST_F(AppFileInfoTest, IconIsTheCompiledInPng)
{
	BBitmap icon(BRect(0, 0, 31, 31), B_CMAP8);
	BBitmap mini(BRect(0, 0, 15, 15), B_CMAP8);
	EXPECT_EQ(B_ENTRY_NOT_FOUND, fInfo.GetIcon(&icon, B_LARGE_ICON));
	{
		ScopedResource png("BEOS:L:STD_ICON", Png(32, [](int32 x, int32) {
			return Rgba{255, 0, 0, uint8(x < 16 ? 255 : 0)};
		}));
		ASSERT_EQ(B_OK, fInfo.GetIcon(&icon, B_LARGE_ICON));
		EXPECT_EQ(BPrivate::IndexForColor(255, 0, 0), Pixels(icon)[15]);
		EXPECT_EQ(B_TRANSPARENT_MAGIC_CMAP8, Pixels(icon)[16]);
		EXPECT_EQ(B_ENTRY_NOT_FOUND, fInfo.GetIcon(&mini, B_MINI_ICON));
	}
	ScopedResource broken("BEOS:L:STD_ICON", "\x01\x02\x03");
	EXPECT_EQ(B_BAD_DATA, fInfo.GetIcon(&icon, B_LARGE_ICON));
}

TEST_F(AppFileInfoTest, OtherFilesHaveNoProgramResources)
{
	Scratch root;
	BFile other(root.File("tool", "#!/bin/sh\n").c_str(), B_READ_ONLY);
	ASSERT_EQ(B_OK, fInfo.SetTo(&other));
	version_info version;
	EXPECT_EQ(B_ENTRY_NOT_FOUND, fInfo.GetVersionInfo(&version,
		B_APP_VERSION_KIND));
	BBitmap icon(BRect(0, 0, 31, 31), B_CMAP8);
	EXPECT_EQ(B_ENTRY_NOT_FOUND, fInfo.GetIcon(&icon, B_LARGE_ICON));

	EXPECT_EQ(B_BAD_VALUE, fInfo.SetTo(NULL));
	EXPECT_EQ(B_NO_INIT, fInfo.GetVersionInfo(&version, B_APP_VERSION_KIND));
}
