#include <gtest/gtest.h>

#include <thread>

#include <Bitmap.h>
#include <MimeType.h>

#include "SystemPalette.h"
#include "TypeIcons.h"
#include "TypeTestSupport.h"

using namespace TypeTest;

namespace {

const char* const kFolderType = "application/x-vnd.be-directory";
const char* const kVolumeType = "application/x-vnd.be-volume";

const Rgba kRed = {255, 0, 0, 255};
const Rgba kBlue = {0, 0, 255, 255};
const Rgba kGreen = {0, 255, 0, 255};
const Rgba kClear = {0, 0, 0, 0};

// Left half opaque colour, right half clear; along the top row the alpha
// climbs through the half-way mark.
void WriteIcon(const TempFolder& root, const std::string& file, int32 size,
	Rgba color)
{
	WritePng(root.Path() + "/icons/" + file, size, [&](int32 x, int32 y) {
		if (y == 0 && x < 4)
			return Rgba{color.red, color.green, color.blue, uint8(126 + x)};
		return x < size / 2 ? color : kClear;
	});
}

uint8 IndexOf(Rgba color)
{
	return BPrivate::IndexForColor(color.red, color.green, color.blue);
}

std::vector<uint8> Pixels(const BBitmap& bitmap)
{
	int32 size = bitmap.Bounds().IntegerWidth() + 1;
	std::vector<uint8> pixels;
	for (int32 y = 0; y < size; y++) {
		const uint8* row = static_cast<const uint8*>(bitmap.Bits())
			+ y * bitmap.BytesPerRow();
		pixels.insert(pixels.end(), row, row + size);
	}
	return pixels;
}

std::vector<uint8> TypeIcon(const char* type, icon_size size,
	status_t expected = B_OK)
{
	BBitmap bitmap(BRect(0, 0, size - 1, size - 1), B_CMAP8);
	EXPECT_EQ(expected, BMimeType(type).GetIcon(&bitmap, size)) << type;
	return Pixels(bitmap);
}

class TypeIconTest : public testing::Test {
protected:
	IconEnvironment fEnvironment;
	const TempFolder& fRoot = fEnvironment.Root();
};

}

TEST_F(TypeIconTest, ThemeIconsOfBothSizesKeepTheirTransparency)
{
	WriteTheme(fRoot, "Adwaita");
	WriteIcon(fRoot, "Adwaita/16x16/places/folder.png", 16, kRed);
	WriteIcon(fRoot, "Adwaita/32x32/places/folder.png", 32, kBlue);

	std::vector<uint8> mini = TypeIcon(kFolderType, B_MINI_ICON);
	std::vector<uint8> large = TypeIcon(kFolderType, B_LARGE_ICON);

	// Alpha 126 and 127 are transparent, 128 and 129 are not.
	EXPECT_EQ(B_TRANSPARENT_MAGIC_CMAP8, mini[0]);
	EXPECT_EQ(B_TRANSPARENT_MAGIC_CMAP8, mini[1]);
	EXPECT_EQ(IndexOf(kRed), mini[2]);
	EXPECT_EQ(IndexOf(kRed), mini[3]);
	EXPECT_EQ(IndexOf(kRed), mini[16 * 15 + 7]);
	EXPECT_EQ(B_TRANSPARENT_MAGIC_CMAP8, mini[16 * 15 + 8]);
	EXPECT_EQ(IndexOf(kBlue), large[32 * 31 + 15]);
	EXPECT_EQ(B_TRANSPARENT_MAGIC_CMAP8, large[32 * 31 + 16]);
}

TEST_F(TypeIconTest, InheritedThemesAndHicolorFillTheGaps)
{
	WriteTheme(fRoot, "Adwaita", "Parent");
	WriteTheme(fRoot, "Parent", "hicolor");
	WriteTheme(fRoot, "hicolor");
	WriteIcon(fRoot, "Parent/16x16/places/folder.png", 16, kRed);
	WriteIcon(fRoot, "hicolor/16x16/places/folder.png", 16, kBlue);
	WriteIcon(fRoot, "hicolor/16x16/devices/drive-harddisk.png", 16, kGreen);
	// Wrong size: skipped as if absent.
	WriteIcon(fRoot, "Adwaita/16x16/mimetypes/text-plain.png", 20, kRed);
	WriteIcon(fRoot, "hicolor/16x16/mimetypes/text-x-generic.png", 16, kBlue);

	EXPECT_EQ(IndexOf(kRed), TypeIcon(kFolderType, B_MINI_ICON)[16 * 8]);
	EXPECT_EQ(IndexOf(kGreen), TypeIcon(kVolumeType, B_MINI_ICON)[16 * 8]);
	EXPECT_EQ(IndexOf(kBlue), TypeIcon("TEXT/Plain", B_MINI_ICON)[16 * 8]);
}

TEST_F(TypeIconTest, WithoutAThemeTheKitDrawsItsOwnTypes)
{
	std::vector<uint8> folder = TypeIcon(kFolderType, B_MINI_ICON);
	std::vector<uint8> volume = TypeIcon(kVolumeType, B_MINI_ICON);
	std::vector<uint8> link = TypeIcon("application/x-vnd.be-symlink",
		B_LARGE_ICON);
	EXPECT_NE(folder, volume);
	for (const std::vector<uint8>* icon : {&folder, &volume, &link}) {
		EXPECT_NE(std::count(icon->begin(), icon->end(),
			B_TRANSPARENT_MAGIC_CMAP8), (long)icon->size());
	}
	TypeIcon("text/plain", B_MINI_ICON, B_ENTRY_NOT_FOUND);
}

TEST_F(TypeIconTest, EachFileIsDecodedOnce)
{
	WriteTheme(fRoot, "Adwaita");
	WriteIcon(fRoot, "Adwaita/16x16/places/folder.png", 16, kRed);
	WriteIcon(fRoot, "Adwaita/16x16/mimetypes/text-x-generic.png", 16, kBlue);
	int32 before = BPrivate::IconDecodeCount();

	std::vector<uint8> first = TypeIcon(kFolderType, B_MINI_ICON);
	EXPECT_EQ(first, TypeIcon(kFolderType, B_MINI_ICON));
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
	WriteTheme(fRoot, "Adwaita");
	WriteIcon(fRoot, "Adwaita/32x32/places/folder.png", 32, kRed);
	int32 before = BPrivate::IconDecodeCount();

	std::vector<std::thread> threads;
	std::vector<std::vector<uint8>> results(4);
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
