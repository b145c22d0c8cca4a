#ifndef _FONT_H
#define _FONT_H

#include <SupportDefs.h>

namespace BPrivate {
class FontAccess;
}

#define B_FONT_FAMILY_LENGTH 63
#define B_FONT_STYLE_LENGTH 63

typedef char font_family[B_FONT_FAMILY_LENGTH + 1];
typedef char font_style[B_FONT_STYLE_LENGTH + 1];

// Faces.
enum {
	B_ITALIC_FACE = 0x0001,
	B_UNDERSCORE_FACE = 0x0002,
	B_NEGATIVE_FACE = 0x0004,
	B_OUTLINED_FACE = 0x0008,
	B_STRIKEOUT_FACE = 0x0010,
	B_BOLD_FACE = 0x0020,
	B_REGULAR_FACE = 0x0040
};

// Which properties BView::SetFont copies.
enum {
	B_FONT_FAMILY_AND_STYLE = 0x00000001,
	B_FONT_SIZE = 0x00000002,
	B_FONT_SHEAR = 0x00000004,
	B_FONT_ROTATION = 0x00000008,
	B_FONT_SPACING = 0x00000010,
	B_FONT_ENCODING = 0x00000020,
	B_FONT_FACE = 0x00000040,
	B_FONT_FLAGS = 0x00000080,
	B_FONT_FALSE_BOLD_WIDTH = 0x00000100,
	B_FONT_ALL = 0x000001FF
};

// Flags of get_font_family.
enum {
	B_IS_FIXED = 0x00000001,
	B_HAS_TUNED_FONT = 0x00010000
};

struct font_height {
	float ascent;
	float descent;
	float leading;
};

// A font as a family, a style, a size in pixels and a shear. Fonts are plain
// values: copying one is cheap and they may be used from any thread.
class BFont {
public:
	BFont();
	BFont(const BFont& font);
	BFont(const BFont* font);
	BFont& operator=(const BFont& font);
	bool operator==(const BFont& font) const;
	bool operator!=(const BFont& font) const { return !(*this == font); }

	// Fails with B_NAME_NOT_FOUND, leaving the font as it was, when the
	// family (or the style in it) is not installed.
	status_t SetFamilyAndStyle(const font_family family, const font_style style);
	status_t SetFamilyAndFace(const font_family family, uint16 face);
	void GetFamilyAndStyle(font_family* family, font_style* style) const;

	void SetFace(uint16 face);
	uint16 Face() const;
	void SetSize(float size);
	float Size() const;
	// 90 degrees is upright; less leans the glyphs to the right.
	void SetShear(float shear);
	float Shear() const;

	float StringWidth(const char* string) const;
	float StringWidth(const char* string, int32 length) const;
	void GetHeight(font_height* height) const;

private:
	friend class BView;
	friend class BPrivate::FontAccess;

	void _SetFrom(const BFont& font, uint32 mask);

	font_family fFamily;
	font_style fStyle;
	float fSize;
	float fShear;
	uint16 fFace;
};

extern const BFont* be_plain_font;
extern const BFont* be_bold_font;
extern const BFont* be_fixed_font;

// The installed families in fontconfig's order.
int32 count_font_families();
status_t get_font_family(int32 index, font_family* name, uint32* flags = NULL);

#endif
