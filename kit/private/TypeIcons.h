#ifndef KIT_PRIVATE_TYPE_ICONS_H
#define KIT_PRIVATE_TYPE_ICONS_H

#include <functional>
#include <map>
#include <memory>
#include <string>
#include <vector>

#include <Mime.h>

class BBitmap;

namespace BPrivate {

// A square icon in the system palette, row after row without padding.
// Pixels less than half opaque in the source are B_TRANSPARENT_MAGIC_CMAP8.
struct IconPixels {
	int32 size;
	std::vector<uint8> indices;
};

typedef std::shared_ptr<const IconPixels> IconRef;

// Decodes a PNG of exactly size x size pixels; null when it is anything
// else or cannot be read.
IconRef DecodePngIcon(const char* path, int32 size);
IconRef DecodePngIcon(const void* data, size_t length, int32 size);

// How many PNGs were decoded since the program started.
int32 IconDecodeCount();

enum class BuiltinIcon {
	kFile,
	kFolder,
	kVolume,
	kLink
};

// Icons drawn by the kit, so that a machine without an icon theme still
// shows something.
IconRef GetBuiltinIcon(BuiltinIcon which, int32 size);

// The installed icon themes as the environment shows them when the object
// is made: Adwaita, the themes it inherits, then hicolor, each looked up in
// $HOME/.icons, $XDG_DATA_HOME/icons and every $XDG_DATA_DIRS/icons. Not
// thread-safe; the icon cache serialises its use.
class IconTheme {
public:
	IconTheme();
	~IconTheme();

	IconTheme(const IconTheme&) = delete;
	IconTheme& operator=(const IconTheme&) = delete;

	// Offers load the PNGs of names in the folders of size x size icons,
	// every name in a theme before the theme it inherits, until load gives
	// an icon; null when it never did.
	IconRef Find(const std::vector<std::string>& names, int32 size,
		const std::function<IconRef(const std::string& path)>& load);

private:
	struct Theme {
		std::string name;
		// The icon folders its index lists, relative to the theme, with
		// the size of their icons.
		std::vector<std::pair<std::string, int32>> folders;
	};
	typedef std::vector<std::vector<std::string>> FoldersPerTheme;

	const FoldersPerTheme& _FoldersFor(int32 size);

	std::vector<std::string> fBaseFolders;
	std::vector<Theme> fThemes;
	// Per size: for each theme, its existing folders of icons of that size.
	std::map<int32, FoldersPerTheme> fFolders;
};

// The icon of a normalized type: from the theme, else drawn by the kit for
// its own folder, volume and link types; null when there is none. Each PNG
// is decoded once and each answer kept per type and size. Thread-safe.
IconRef IconForType(const std::string& type, int32 size);

// Forgets every kept icon and looks for the themes again, as the
// environment shows them now.
void FlushIconCache();

// The platform's name for a node's or a program's own icon of a size:
// "BEOS:L:STD_ICON" or "BEOS:M:STD_ICON".
const char* StandardIconName(icon_size size);

// B_BAD_VALUE unless size is one of the two icon sizes and bitmap a B_CMAP8
// bitmap of exactly size x size.
status_t CheckIconBitmap(const BBitmap* bitmap, icon_size size);

// Copies icon into a bitmap that passed CheckIconBitmap for its size.
void CopyIconToBitmap(const IconPixels& icon, BBitmap* bitmap);

}

#endif
