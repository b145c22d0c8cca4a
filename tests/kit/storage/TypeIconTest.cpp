#include <gtest/gtest.h>

#include <algorithm>
#include <thread>

#include "SystemPalette.h"
#include "TypeTestSupport.h"

using namespace TypeTest;

namespace {

const char* const kFolderType = "application/x-vnd.be-directory";
const char* const kVolumeType = "application/x-vnd.be-volume";

const Rgba kRed = {255, 0, 0, 255};
const Rgba kBlue = {0, 0, 255, 255};
const Rgba kGreen = {0, 255, 0, 255};

uint8 IndexOf(Rgba color)
{
	return BPrivate::IndexForColor(color.red, color.green, color.blue);
}

// Left half opaque, right half clear; along the top row the alpha climbs
// through the half-way mark.
std::string HalfIcon(int32 size, Rgba color)
{
	return Png(size, [&](int32 x, int32 y) {
		if (y == 0 && x < 4)
			return Rgba{color.red, color.green, color.blue, uint8(126 + x)};
		return x < size / 2 ? color : Rgba{0, 0, 0, 0};
	});
}

class TypeIconTest : public testing::Test {
protected:
	IconEnvironment fTheme;
};

}

TEST_F(TypeIconTest, ThemeIconsOfBothSizesKeepTheirTransparency)
{
	fTheme.WriteTheme("Adwaita");
	fTheme.WriteIcon("Adwaita/16x16/places/folder.png", HalfIcon(16, kRed));
	fTheme.WriteIcon("Adwaita/32x32/places/folder.png", HalfIcon(32, kBlue));

	std::vector<uint8> mini = TypeIcon(kFolderType, B_MINI_ICON);
	std::vector<uint8> large = TypeIcon(kFolderType, B_LARGE_ICON);
	// Alpha 126 and 127 are transparent, 128 and 129 are not.
	EXPECT_EQ(std::vector<uint8>({B_TRANSPARENT_MAGIC_CMAP8,
		B_TRANSPARENT_MAGIC_CMAP8, IndexOf(kRed), IndexOf(kRed)}),
		std::vector<uint8>(mini.begin(), mini.begin() + 4));
	EXPECT_EQ(IndexOf(kRed), mini[16 * 15 + 7]);
	EXPECT_EQ(B_TRANSPARENT_MAGIC_CMAP8, mini[16 * 15 + 8]);
	EXPECT_EQ(IndexOf(kBlue), large[32 * 31 + 15]);
	EXPECT_EQ(B_TRANSPARENT_MAGIC_CMAP8, large[32 * 31 + 16]);
}

TEST_F(TypeIconTest, InheritedThemesAndHicolorFillTheGaps)
{
	fTheme.WriteTheme("Adwaita", "Parent");
	fTheme.WriteTheme("Parent", "hicolor");
	fTheme.WriteTheme("hicolor");
	// Passed over: a scalable folder, and a PNG of the wrong size.
	fTheme.WriteIcon("Adwaita/scalable/places/folder.png", Png(16, kGreen));
	fTheme.WriteIcon("Adwaita/16x16/mimetypes/text-plain.png", Png(20, kRed));
	fTheme.WriteIcon("Parent/16x16/places/folder.png", Png(16, kRed));
	fTheme.WriteIcon("hicolor/16x16/places/folder.png", Png(16, kBlue));
	fTheme.WriteIcon("hicolor/16x16/devices/drive-harddisk.png",
		Png(16, kGreen));
	fTheme.WriteIcon("hicolor/16x16/mimetypes/text-x-generic.png",
		Png(16, kBlue));

	EXPECT_EQ(IndexOf(kRed), TypeIcon(kFolderType, B_MINI_ICON)[0]);
	EXPECT_EQ(IndexOf(kGreen), TypeIcon(kVolumeType, B_MINI_ICON)[0]);
	EXPECT_EQ(IndexOf(kBlue), TypeIcon("TEXT/Plain", B_MINI_ICON)[0]);
}

TEST_F(TypeIconTest, WithoutAThemeTheKitDrawsItsOwnTypes)
{
	std::vector<uint8> folder = TypeIcon(kFolderType, B_MINI_ICON);
	std::vector<uint8> volume = TypeIcon(kVolumeType, B_MINI_ICON);
	std::vector<uint8> link = TypeIcon("application/x-vnd.be-symlink",
		B_LARGE_ICON);
	EXPECT_NE(folder, volume);
	for (const std::vector<uint8>* icon : {&folder, &volume, &link}) {
		EXPECT_NE((long)icon->size(), std::count(icon->begin(), icon->end(),
			B_TRANSPARENT_MAGIC_CMAP8));
	}
	TypeIcon("text/plain", B_MINI_ICON, B_ENTRY_NOT_FOUND);
}

TEST_F(TypeIconTest, EachFileIsDecodedOnce)
{
	fTheme.WriteTheme("Adwaita");
	fTheme.WriteIcon("Adwaita/16x16/places/folder.png", Png(16, kRed));
	fTheme.WriteIcon("Adwaita/16x16/mimetypes/text-x-generic.png",
		Png(16, kBlue));
	int32 before = BPrivate::IconDecodeCount();

	EXPECT_EQ(TypeIcon(kFolderType, B_MINI_ICON),
		TypeIcon(kFolderType, B_MINI_ICON));
	EXPECT_EQ(before + 1, BPrivate::IconDecodeCount());
	// Both types fall back on the same generic file.
	TypeIcon("text/plain", B_MINI_ICON);
	TypeIcon("text/x-readme", B_MINI_ICON);
	EXPECT_EQ(before + 2, BPrivate::IconDecodeCount());

	BPrivate::FlushIconCache();
	TypeIcon(kFolderType, B_MINI_ICON);
	EXPECT_EQ(before + 3, BPrivate::IconDecodeCount());
}

TEST_F(TypeIconTest, ThreadsShareOneDecodedIcon)
{
	fTheme.WriteTheme("Adwaita");
	fTheme.WriteIcon("Adwaita/32x32/places/folder.png", HalfIcon(32, kRed));
	int32 before = BPrivate::IconDecodeCount();

	std::vector<std::vector<uint8>> results(4);
	std::vector<std::thread> threads;
	for (auto& result : results) {
		threads.emplace_back([&result] {
			for (int i = 0; i < 50; i++)
				result = TypeIcon(kFolderType, B_LARGE_ICON);
		});
	}
	for (std::thread& thread : threads)
		thread.join();

	EXPECT_EQ(before + 1, BPrivate::IconDecodeCount());
	for (const auto& result : results)
		EXPECT_EQ(results[0], result);
}

TEST_F(TypeIconTest, RefusesBitmapsOfAnotherShape)
{
	BMimeType folder(kFolderType);
	BBitmap rgb(BRect(0, 0, 15, 15), B_RGB32);
	BBitmap large(BRect(0, 0, 31, 31), B_CMAP8);
	EXPECT_EQ(B_BAD_VALUE, folder.GetIcon(&rgb, B_MINI_ICON));
	EXPECT_EQ(B_BAD_VALUE, folder.GetIcon(&large, B_MINI_ICON));
	EXPECT_EQ(B_BAD_VALUE, folder.GetIcon(NULL, B_MINI_ICON));
	EXPECT_EQ(B_NO_INIT, BMimeType().GetIcon(&large, B_LARGE_ICON));
}
