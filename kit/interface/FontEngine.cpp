#include "FontEngine.h"

#include <cmath>
#include <cstdio>
#include <cstring>
#include <map>
#include <mutex>
#include <string>
#include <strings.h>

#include <fontconfig/fontconfig.h>
#include <ft2build.h>
#include FT_FREETYPE_H

namespace BPrivate {

namespace {

// The lean of a synthesised italic, as x per y (fontconfig uses the same).
constexpr double kSyntheticItalicSlope = 0.2;
// Glyph caches are dropped whole when they grow past this many glyphs.
constexpr size_t kMaxCachedGlyphs = 16384;

struct CachedGlyph {
	std::shared_ptr<const Glyph> glyph;
	int32 advance = 0;
};

struct GlyphKey {
	int32 size;
	int32 slope;
	uint32 codepoint;

	bool operator<(const GlyphKey& other) const
	{
		if (size != other.size)
			return size < other.size;
		if (slope != other.slope)
			return slope < other.slope;
		return codepoint < other.codepoint;
	}
};

struct FontFace {
	FT_Face face = NULL;
	bool slanted = false;
	int32 size = -1;
	int32 slope = 0;
	std::map<GlyphKey, CachedGlyph> glyphs;
};

uint32 DecodeUtf8(const uint8*& p, const uint8* end)
{
	uint8 lead = *p++;
	if (lead < 0x80)
		return lead;
	int extra = lead >= 0xf0 && lead < 0xf5 ? 3 : lead >= 0xe0 ? 2 : lead >= 0xc2 ? 1 : -1;
	if (lead >= 0xf5 || extra < 0 || end - p < extra)
		return 0xfffd;
	uint32 codepoint = lead & (0x3f >> extra);
	for (int i = 0; i < extra; i++) {
		if ((p[i] & 0xc0) != 0x80)
			return 0xfffd;
		codepoint = (codepoint << 6) | (p[i] & 0x3f);
	}
	static const uint32 kSmallest[4] = {0, 0x80, 0x800, 0x10000};
	if (codepoint < kSmallest[extra] || codepoint > 0x10ffff
		|| (codepoint >= 0xd800 && codepoint <= 0xdfff))
		return 0xfffd;
	p += extra;
	return codepoint;
}

FcPattern* MatchPattern(FcPattern* pattern)
{
	FcConfigSubstitute(NULL, pattern, FcMatchPattern);
	FcDefaultSubstitute(pattern);
	FcResult result;
	FcPattern* match = FcFontMatch(NULL, pattern, &result);
	FcPatternDestroy(pattern);
	return match;
}

bool PatternHasFamily(FcPattern* pattern, const char* family)
{
	FcChar8* name;
	for (int i = 0; FcPatternGetString(pattern, FC_FAMILY, i, &name) == FcResultMatch; i++) {
		if (strcasecmp(reinterpret_cast<const char*>(name), family) == 0)
			return true;
	}
	return false;
}

bool PatternIsSlanted(FcPattern* pattern)
{
	int slant = FC_SLANT_ROMAN;
	FcPatternGetInteger(pattern, FC_SLANT, 0, &slant);
	return slant != FC_SLANT_ROMAN;
}

class Engine {
public:
	Engine()
	{
		FcInit();
		if (FT_Init_FreeType(&fLibrary) != 0)
			fLibrary = NULL;
	}

	~Engine()
	{
		for (auto& entry : fFaces) {
			if (entry.second->face != NULL)
				FT_Done_Face(entry.second->face);
		}
		if (fLibrary != NULL)
			FT_Done_FreeType(fLibrary);
	}

	float Layout(const BFont& font, const char* text, int32 length,
		std::vector<PlacedGlyph>* placed)
	{
		if (text == NULL || length <= 0)
			return 0;
		std::lock_guard<std::mutex> guard(fLock);
		FontFace* face = _Prepare(font);
		if (face == NULL)
			return 0;
		const uint8* p = reinterpret_cast<const uint8*>(text);
		const uint8* end = p + strnlen(text, length);
		int32 x = 0;
		while (p < end) {
			const CachedGlyph& cached = _Glyph(face, DecodeUtf8(p, end));
			if (placed != NULL)
				placed->push_back({cached.glyph, x});
			x += cached.advance;
		}
		return x;
	}

	void Height(const BFont& font, font_height* height)
	{
		std::lock_guard<std::mutex> guard(fLock);
		FontFace* face = _Prepare(font);
		if (face == NULL) {
			*height = font_height{0, 0, 0};
			return;
		}
		const FT_Size_Metrics& metrics = face->face->size->metrics;
		height->ascent = metrics.ascender / 64.0f;
		height->descent = -metrics.descender / 64.0f;
		height->leading = max_c(0.0f,
			(metrics.height - metrics.ascender + metrics.descender) / 64.0f);
	}

	status_t MatchStyle(const char* family, uint16 face, font_style* style)
	{
		std::lock_guard<std::mutex> guard(fLock);
		FcPattern* pattern = FcPatternCreate();
		FcPatternAddString(pattern, FC_FAMILY, reinterpret_cast<const FcChar8*>(family));
		FcPatternAddInteger(pattern, FC_WEIGHT,
			(face & B_BOLD_FACE) != 0 ? FC_WEIGHT_BOLD : FC_WEIGHT_REGULAR);
		FcPatternAddInteger(pattern, FC_SLANT,
			(face & B_ITALIC_FACE) != 0 ? FC_SLANT_ITALIC : FC_SLANT_ROMAN);
		FcPatternAddInteger(pattern, FC_WIDTH, FC_WIDTH_NORMAL);
		FcPattern* match = MatchPattern(pattern);
		if (match == NULL)
			return B_NAME_NOT_FOUND;
		status_t status = B_NAME_NOT_FOUND;
		FcChar8* name;
		if (PatternHasFamily(match, family)
			&& FcPatternGetString(match, FC_STYLE, 0, &name) == FcResultMatch) {
			snprintf(*style, sizeof(font_style), "%s", reinterpret_cast<const char*>(name));
			status = B_OK;
		}
		FcPatternDestroy(match);
		return status;
	}

	bool HasStyle(const char* family, const char* style)
	{
		std::lock_guard<std::mutex> guard(fLock);
		FcPattern* pattern = FcPatternBuild(NULL, FC_FAMILY, FcTypeString, family,
			FC_STYLE, FcTypeString, style, static_cast<char*>(NULL));
		FcObjectSet* objects = FcObjectSetBuild(FC_FILE, static_cast<char*>(NULL));
		FcFontSet* fonts = FcFontList(NULL, pattern, objects);
		bool found = fonts != NULL && fonts->nfont > 0;
		if (fonts != NULL)
			FcFontSetDestroy(fonts);
		FcObjectSetDestroy(objects);
		FcPatternDestroy(pattern);
		return found;
	}

	const std::vector<std::pair<std::string, uint32>>& Families()
	{
		std::lock_guard<std::mutex> guard(fLock);
		if (!fFamiliesListed) {
			_ListFamilies();
			fFamiliesListed = true;
		}
		return fFamilies;
	}

private:
	void _ListFamilies()
	{
		FcPattern* pattern = FcPatternCreate();
		FcObjectSet* objects = FcObjectSetBuild(FC_FAMILY, FC_SPACING,
			static_cast<char*>(NULL));
		FcFontSet* fonts = FcFontList(NULL, pattern, objects);
		for (int i = 0; fonts != NULL && i < fonts->nfont; i++) {
			FcChar8* name;
			if (FcPatternGetString(fonts->fonts[i], FC_FAMILY, 0, &name) != FcResultMatch)
				continue;
			std::string family(reinterpret_cast<const char*>(name));
			family.resize(min_c(family.size(), size_t(B_FONT_FAMILY_LENGTH)));
			int spacing = FC_PROPORTIONAL;
			FcPatternGetInteger(fonts->fonts[i], FC_SPACING, 0, &spacing);
			uint32 flags = spacing == FC_MONO ? B_IS_FIXED : 0;
			bool known = false;
			for (auto& entry : fFamilies) {
				if (entry.first == family) {
					entry.second &= flags;
					known = true;
				}
			}
			if (!known)
				fFamilies.emplace_back(family, flags);
		}
		if (fonts != NULL)
			FcFontSetDestroy(fonts);
		FcObjectSetDestroy(objects);
		FcPatternDestroy(pattern);
	}

	FontFace* _Prepare(const BFont& font)
	{
		font_family family;
		font_style style;
		font.GetFamilyAndStyle(&family, &style);
		FontFace* face = _Face(family, style);
		if (face == NULL)
			return NULL;

		int32 size = int32(max_c(1.0f, font.Size()) * 64 + 0.5f);
		double slope = 0;
		if (font.Shear() != 90.0f)
			slope = 1.0 / std::tan(font.Shear() * M_PI / 180.0);
		if ((font.Face() & B_ITALIC_FACE) != 0 && !face->slanted)
			slope += kSyntheticItalicSlope;
		int32 slopeKey = int32(std::lround(slope * 1000));

		if (face->size != size) {
			FT_Set_Char_Size(face->face, 0, size, 72, 72);
			face->size = size;
		}
		if (face->slope != slopeKey) {
			FT_Matrix matrix = {0x10000, FT_Fixed(slope * 0x10000), 0, 0x10000};
			FT_Set_Transform(face->face, slopeKey != 0 ? &matrix : NULL, NULL);
			face->slope = slopeKey;
		}
		return face;
	}

	FontFace* _Face(const char* family, const char* style)
	{
		std::string key = std::string(family) + '\n' + style;
		auto found = fFaces.find(key);
		if (found != fFaces.end())
			return found->second.get();
		if (fLibrary == NULL)
			return NULL;

		FcPattern* match = MatchPattern(FcPatternBuild(NULL, FC_FAMILY, FcTypeString,
			family, FC_STYLE, FcTypeString, style, static_cast<char*>(NULL)));
		if (match == NULL)
			return NULL;
		auto face = std::make_unique<FontFace>();
		FcChar8* file;
		int index = 0;
		FcPatternGetInteger(match, FC_INDEX, 0, &index);
		if (FcPatternGetString(match, FC_FILE, 0, &file) != FcResultMatch
			|| FT_New_Face(fLibrary, reinterpret_cast<const char*>(file), index,
				&face->face) != 0) {
			FcPatternDestroy(match);
			return NULL;
		}
		face->slanted = PatternIsSlanted(match);
		FcPatternDestroy(match);
		return fFaces.emplace(key, std::move(face)).first->second.get();
	}

	const CachedGlyph& _Glyph(FontFace* face, uint32 codepoint)
	{
		GlyphKey key{face->size, face->slope, codepoint};
		auto found = face->glyphs.find(key);
		if (found != face->glyphs.end())
			return found->second;
		if (face->glyphs.size() >= kMaxCachedGlyphs)
			face->glyphs.clear();

		CachedGlyph cached;
		auto glyph = std::make_shared<Glyph>();
		FT_UInt index = FT_Get_Char_Index(face->face, codepoint);
		if (FT_Load_Glyph(face->face, index, FT_LOAD_DEFAULT) == 0
			&& FT_Render_Glyph(face->face->glyph, FT_RENDER_MODE_NORMAL) == 0) {
			FT_GlyphSlot slot = face->face->glyph;
			const FT_Bitmap& bitmap = slot->bitmap;
			glyph->left = slot->bitmap_left;
			glyph->top = slot->bitmap_top;
			glyph->width = bitmap.width;
			glyph->height = bitmap.rows;
			glyph->coverage.resize(size_t(bitmap.width) * bitmap.rows);
			for (unsigned row = 0; row < bitmap.rows; row++) {
				memcpy(glyph->coverage.data() + size_t(row) * bitmap.width,
					bitmap.buffer + ptrdiff_t(row) * bitmap.pitch, bitmap.width);
			}
			cached.advance = int32((slot->advance.x + 32) >> 6);
		}
		cached.glyph = std::move(glyph);
		return face->glyphs.emplace(key, std::move(cached)).first->second;
	}

	std::mutex fLock;
	FT_Library fLibrary = NULL;
	std::map<std::string, std::unique_ptr<FontFace>> fFaces;
	std::vector<std::pair<std::string, uint32>> fFamilies;
	bool fFamiliesListed = false;
};

Engine& TheEngine()
{
	static Engine engine;
	return engine;
}

}

float TextWidth(const BFont& font, const char* text, int32 length)
{
	return TheEngine().Layout(font, text, length, NULL);
}

float LayoutText(const BFont& font, const char* text, int32 length,
	std::vector<PlacedGlyph>* glyphs)
{
	return TheEngine().Layout(font, text, length, glyphs);
}

void FontHeight(const BFont& font, font_height* height)
{
	TheEngine().Height(font, height);
}

status_t MatchFontStyle(const char* family, uint16 face, font_style* style)
{
	return TheEngine().MatchStyle(family, face, style);
}

bool HasFontStyle(const char* family, const char* style)
{
	return TheEngine().HasStyle(family, style);
}

int32 CountFontFamilies()
{
	return int32(TheEngine().Families().size());
}

status_t GetFontFamily(int32 index, font_family* name, uint32* flags)
{
	const auto& families = TheEngine().Families();
	if (name == NULL || index < 0 || index >= int32(families.size()))
		return B_BAD_VALUE;
	snprintf(*name, sizeof(font_family), "%s", families[index].first.c_str());
	if (flags != NULL)
		*flags = families[index].second;
	return B_OK;
}

}
