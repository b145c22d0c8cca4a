#include <gtest/gtest.h>

#include <fstream>
#include <regex>

#include <unistd.h>

#include <AppFileInfo.h>
#include <Bitmap.h>
#include <File.h>

#include "AppResources.h"
#include "SystemPalette.h"
#include "TypeTestSupport.h"

using namespace TypeTest;

namespace {

std::string RunningProgram()
{
	char path[PATH_MAX];
	ssize_t length = readlink("/proc/self/exe", path, sizeof(path) - 1);
	return std::string(path, std::max<ssize_t>(length, 0));
}

// The version the project's CMakeLists.txt declares, as "x.y.z".
std::string DeclaredVersion()
{
	std::string source = __FILE__;
	std::ifstream lists(source.substr(0, source.rfind("/tests/"))
		+ "/CMakeLists.txt");
	std::string text((std::istreambuf_iterator<char>(lists)),
		std::istreambuf_iterator<char>());
	std::smatch match;
	std::regex_search(text, match,
		std::regex("VERSION ([0-9]+\\.[0-9]+\\.[0-9]+)"));
	return match.size() > 1 ? match[1].str() : "";
}

// Registered for one test.
class ScopedResource {
public:
	ScopedResource(const char* name, std::vector<uint8> data)
		: fName(name), fData(std::move(data))
	{
		BPrivate::RegisterAppResource(fName, fData.data(), fData.size());
	}

	~ScopedResource() { BPrivate::RegisterAppResource(fName, nullptr, 0); }

private:
	const char* fName;
	std::vector<uint8> fData;
};

}

TEST(AppFileInfoTest, VersionOfTheRunningProgramIsTheBuilds)
{
	BFile program(RunningProgram().c_str(), B_READ_ONLY);
	BAppFileInfo info(&program);
	ASSERT_EQ(B_OK, info.InitCheck());

	std::string text = "Two panes\n";
	ScopedResource shortInfo(BPrivate::kShortInfoResource,
		std::vector<uint8>(text.begin(), text.end()));
	version_info version;
	ASSERT_EQ(B_OK, info.GetVersionInfo(&version, B_APP_VERSION_KIND));
	EXPECT_EQ(DeclaredVersion(), std::to_string(version.major) + "."
		+ std::to_string(version.middle) + "." + std::to_string(version.minor));
	EXPECT_STREQ("Two panes", version.short_info);
	EXPECT_STREQ("", version.long_info);

	EXPECT_EQ(B_ENTRY_NOT_FOUND, info.GetVersionInfo(&version,
		B_SYSTEM_VERSION_KIND));
	EXPECT_EQ(B_BAD_VALUE, info.GetVersionInfo(NULL, B_APP_VERSION_KIND));
}

TEST(AppFileInfoTest, IconIsTheCompiledInPng)
{
	BFile program(RunningProgram().c_str(), B_READ_ONLY);
	BAppFileInfo info(&program);
	BBitmap icon(BRect(0, 0, 31, 31), B_CMAP8);
	EXPECT_EQ(B_ENTRY_NOT_FOUND, info.GetIcon(&icon, B_LARGE_ICON));

	{
		ScopedResource png("BEOS:L:STD_ICON", EncodePng(32, [](int32 x, int32) {
			return Rgba{255, 0, 0, uint8(x < 16 ? 255 : 0)};
		}));
		ASSERT_EQ(B_OK, info.GetIcon(&icon, B_LARGE_ICON));
		const uint8* bits = static_cast<const uint8*>(icon.Bits());
		EXPECT_EQ(BPrivate::IndexForColor(255, 0, 0), bits[15]);
		EXPECT_EQ(B_TRANSPARENT_MAGIC_CMAP8, bits[16]);
		BBitmap mini(BRect(0, 0, 15, 15), B_CMAP8);
		EXPECT_EQ(B_ENTRY_NOT_FOUND, info.GetIcon(&mini, B_MINI_ICON));
	}
	ScopedResource broken("BEOS:L:STD_ICON", {1, 2, 3});
	EXPECT_EQ(B_BAD_DATA, info.GetIcon(&icon, B_LARGE_ICON));
}

TEST(AppFileInfoTest, OtherFilesHaveNoProgramResources)
{
	TempFolder root;
	BFile other(root.Write("tool", "#!/bin/sh\n").c_str(), B_READ_ONLY);
	BAppFileInfo info(&other);
	ASSERT_EQ(B_OK, info.InitCheck());
	version_info version;
	EXPECT_EQ(B_ENTRY_NOT_FOUND, info.GetVersionInfo(&version,
		B_APP_VERSION_KIND));
	BBitmap icon(BRect(0, 0, 31, 31), B_CMAP8);
	EXPECT_EQ(B_ENTRY_NOT_FOUND, info.GetIcon(&icon, B_LARGE_ICON));

	EXPECT_EQ(B_BAD_VALUE, info.SetTo(NULL));
	EXPECT_EQ(B_NO_INIT, info.GetVersionInfo(&version, B_APP_VERSION_KIND));
}
