#ifndef KIT_PRIVATE_FONT_ENGINE_H
#define KIT_PRIVATE_FONT_ENGINE_H

#include <memory>
#include <vector>

#include <Font.h>

namespace BPrivate {

// A rendered glyph: coverage 0-255, width x height, placed left pixels right
// of the pen and top pixels above the baseline.
struct Glyph {
	int32 left = 0;
	int32 top = 0;
	int32 width = 0;
	int32 height = 0;
	std::vector<uint8> coverage;
};

struct PlacedGlyph {
	std::shared_ptr<const Glyph> glyph;
	// Whole pixels from the pen to this glyph's origin.
	int32 x = 0;
};

// Text goes through FreeType: UTF-8 (a byte that does not decode shows as
// U+FFFD), whole-pixel advances, glyphs cached per face, size and shear. All
// of it may be called from any thread.
float TextWidth(const BFont& font, const char* text, int32 length);
// Fills glyphs and returns the advance of the whole text.
float LayoutText(const BFont& font, const char* text, int32 length,
	std::vector<PlacedGlyph>* glyphs);
void FontHeight(const BFont& font, font_height* height);

// The installed style of family closest to face (bold or regular weight,
// italic or upright), as fontconfig matches it; B_NAME_NOT_FOUND when the
// family is not installed. An italic request may answer with an upright
// style: the glyphs are then slanted when drawn.
status_t MatchFontStyle(const char* family, uint16 face, font_style* style);
bool HasFontStyle(const char* family, const char* style);

// Families in fontconfig's order, each once.
int32 CountFontFamilies();
status_t GetFontFamily(int32 index, font_family* name, uint32* flags);

}

#endif
