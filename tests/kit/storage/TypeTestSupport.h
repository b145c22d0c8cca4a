// Temporary folders, environment and PNG files for the type and icon tests.

#ifndef TYPE_TEST_SUPPORT_H
#define TYPE_TEST_SUPPORT_H

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <functional>
#include <string>
#include <vector>

#include <png.h>

#include <MimeType.h>

#include "TypeIcons.h"

namespace TypeTest {

class TempFolder {
public:
	TempFolder()
	{
		char pattern[] = "/tmp/varnel-types-XXXXXX";
		fPath = mkdtemp(pattern);
	}

	~TempFolder() { std::filesystem::remove_all(fPath); }

	const std::string& Path() const { return fPath; }

	std::string Make(const std::string& relative) const
	{
		std::string path = fPath + "/" + relative;
		std::filesystem::create_directories(
			std::filesystem::path(path).parent_path());
		return path;
	}

	std::string Write(const std::string& relative,
		const std::string& content) const
	{
		std::string path = Make(relative);
		std::ofstream(path, std::ios::binary) << content;
		return path;
	}

private:
	std::string fPath;
};

// Sets variables for the lifetime of the object, then restores them.
class ScopedEnvironment {
public:
	void Set(const char* name, const std::string& value)
	{
		const char* old = getenv(name);
		fSaved.push_back({name, old != nullptr, old != nullptr ? old : ""});
		setenv(name, value.c_str(), 1);
	}

	~ScopedEnvironment()
	{
		for (auto saved = fSaved.rbegin(); saved != fSaved.rend(); saved++) {
			if (saved->existed)
				setenv(saved->name.c_str(), saved->value.c_str(), 1);
			else
				unsetenv(saved->name.c_str());
		}
	}

private:
	struct Saved {
		std::string name;
		bool existed;
		std::string value;
	};
	std::vector<Saved> fSaved;
};

struct Rgba {
	uint8 red, green, blue, alpha;
};

inline std::vector<uint8> EncodePng(int32 size,
	const std::function<Rgba(int32 x, int32 y)>& pixel)
{
	std::vector<Rgba> pixels;
	for (int32 y = 0; y < size; y++) {
		for (int32 x = 0; x < size; x++)
			pixels.push_back(pixel(x, y));
	}
	png_image image = {};
	image.version = PNG_IMAGE_VERSION;
	image.width = size;
	image.height = size;
	image.format = PNG_FORMAT_RGBA;
	png_alloc_size_t length = 0;
	png_image_write_to_memory(&image, nullptr, &length, 0, pixels.data(), 0,
		nullptr);
	std::vector<uint8> encoded(length);
	png_image_write_to_memory(&image, encoded.data(), &length, 0,
		pixels.data(), 0, nullptr);
	return encoded;
}

inline void WritePng(const std::string& path, int32 size,
	const std::function<Rgba(int32 x, int32 y)>& pixel)
{
	std::vector<uint8> encoded = EncodePng(size, pixel);
	std::ofstream(path, std::ios::binary).write(
		reinterpret_cast<const char*>(encoded.data()), encoded.size());
}

// An icon theme folder under root/icons/theme with the usual icon folders
// of both sizes.
inline void WriteTheme(const TempFolder& root, const std::string& theme,
	const std::string& inherits = "")
{
	std::string index = "[Icon Theme]\nName=" + theme
		+ "\nInherits=" + inherits
		+ "\nDirectories=16x16/places,16x16/mimetypes,16x16/devices,"
		"32x32/places,32x32/mimetypes,32x32/devices,scalable/places\n";
	for (const char* folder : {"16x16/places", "16x16/mimetypes",
			"16x16/devices", "32x32/places", "32x32/mimetypes",
			"32x32/devices"}) {
		index += std::string("[") + folder + "]\nSize=" + std::string(folder, 2)
			+ "\nType=Fixed\n";
		root.Make("icons/" + theme + "/" + folder + "/");
	}
	index += "[scalable/places]\nSize=16\nType=Scalable\n";
	root.Write("icons/" + theme + "/index.theme", index);
}

// Points HOME and the XDG folders at a fresh folder, so icons come only from
// what a test puts there. GIO reads its MIME database folders once, so it is
// asked something first, while they are still the system's.
class IconEnvironment {
public:
	IconEnvironment()
	{
		char description[B_MIME_TYPE_LENGTH];
		BMimeType("text/plain").GetShortDescription(description);
		fEnvironment.Set("HOME", fRoot.Make("home"));
		fEnvironment.Set("XDG_DATA_HOME", fRoot.Make("home/.local/share"));
		fEnvironment.Set("XDG_DATA_DIRS", fRoot.Path());
		BPrivate::FlushIconCache();
	}

	~IconEnvironment() { BPrivate::FlushIconCache(); }

	const TempFolder& Root() const { return fRoot; }

private:
	TempFolder fRoot;
	ScopedEnvironment fEnvironment;
};

}

#endif
