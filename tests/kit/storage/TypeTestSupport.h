// PNGs, icon bitmaps and icon themes for the type and icon tests.

#ifndef TYPE_TEST_SUPPORT_H
#define TYPE_TEST_SUPPORT_H

#include <functional>

#include <png.h>

#include <Bitmap.h>
#include <MimeType.h>

#include "StorageTestSupport.h"
#include "TypeIcons.h"

namespace TypeTest {

using StorageTest::Scratch;

struct Rgba {
	uint8 red, green, blue, alpha;
};

inline std::string Png(int32 size,
	const std::function<Rgba(int32 x, int32 y)>& pixel)
{
	std::vector<Rgba> pixels;
	for (int32 i = 0; i < size * size; i++)
		pixels.push_back(pixel(i % size, i / size));
	png_image image = {};
	image.version = PNG_IMAGE_VERSION;
	image.width = size;
	image.height = size;
	image.format = PNG_FORMAT_RGBA;
	png_alloc_size_t length = 0;
	png_image_write_to_memory(&image, nullptr, &length, 0, pixels.data(), 0,
		nullptr);
	std::string encoded(length, '\0');
	png_image_write_to_memory(&image, encoded.data(), &length, 0,
		pixels.data(), 0, nullptr);
	return encoded;
}

inline std::string Png(int32 size, Rgba color)
{
	return Png(size, [color](int32, int32) { return color; });
}

// The pixels of a B_CMAP8 bitmap, without row padding.
inline std::vector<uint8> Pixels(const BBitmap& bitmap)
{
	int32 width = bitmap.Bounds().IntegerWidth() + 1;
	const uint8* bits = static_cast<const uint8*>(bitmap.Bits());
	std::vector<uint8> pixels;
	for (int32 offset = 0; offset < bitmap.BitsLength();
			offset += bitmap.BytesPerRow())
		pixels.insert(pixels.end(), bits + offset, bits + offset + width);
	return pixels;
}

inline std::vector<uint8> TypeIcon(const char* type, icon_size size,
	status_t expected = B_OK)
{
	BBitmap bitmap(BRect(0, 0, size - 1, size - 1), B_CMAP8);
	EXPECT_EQ(expected, BMimeType(type).GetIcon(&bitmap, size)) << type;
	return Pixels(bitmap);
}

// A private home, and XDG_DATA_DIRS pointing into it, so icons come only
// from what a test puts there. GIO reads its MIME database folders once, so
// it is asked something first, while XDG_DATA_DIRS is still the system's.
class IconEnvironment {
public:
	IconEnvironment()
	{
		char description[B_MIME_TYPE_LENGTH];
		BMimeType("text/plain").GetShortDescription(description);
		const char* dataDirs = getenv("XDG_DATA_DIRS");
		if (dataDirs != nullptr)
			fDataDirs = dataDirs;
		setenv("XDG_DATA_DIRS", Root().Folder("share").c_str(), 1);
		BPrivate::FlushIconCache();
	}

	~IconEnvironment()
	{
		if (fDataDirs)
			setenv("XDG_DATA_DIRS", fDataDirs->c_str(), 1);
		else
			unsetenv("XDG_DATA_DIRS");
		BPrivate::FlushIconCache();
	}

	const Scratch& Root() const { return fHome.Root(); }

	// A theme with the usual folders of both sizes, and a scalable one that
	// must be passed over.
	void WriteTheme(const std::string& theme,
		const std::string& inherits = "") const
	{
		std::string folders = "scalable/places";
		std::string sections = "[scalable/places]\nSize=16\nType=Scalable\n";
		for (const char* size : {"16", "32"}) {
			for (const char* context : {"places", "mimetypes", "devices"}) {
				std::string folder = std::string(size) + "x" + size + "/"
					+ context;
				folders += "," + folder;
				sections += "[" + folder + "]\nSize=" + size
					+ "\nType=Fixed\n";
			}
		}
		WriteIcon(theme + "/index.theme", "[Icon Theme]\nInherits="
			+ inherits + "\nDirectories=" + folders + "\n" + sections);
	}

	// A file below share/icons.
	void WriteIcon(const std::string& file, const std::string& content) const
	{
		std::string path = "share/icons/" + file;
		Root().Folder(path.substr(0, path.rfind('/')));
		Root().File(path, content);
	}

private:
	StorageTest::PrivateHome fHome;
	std::optional<std::string> fDataDirs;
};

}

#endif
