#include <Font.h>

#include <cstdio>
#include <cstring>

#include "FontEngine.h"

namespace {

constexpr float kPlainSize = 10.0f;
constexpr float kBoldSize = 12.0f;

void CopyName(char* destination, const char* source, size_t size)
{
	snprintf(destination, size, "%s", source);
}

}

namespace BPrivate {

// The standard fonts are set up without asking fontconfig, before main.
class FontAccess {
public:
	static BFont Make(const char* family, const char* style, uint16 face, float size)
	{
		BFont font;
		CopyName(font.fFamily, family, sizeof(font.fFamily));
		CopyName(font.fStyle, style, sizeof(font.fStyle));
		font.fFace = face;
		font.fSize = size;
		return font;
	}
};

}

using BPrivate::FontAccess;

BFont::BFont()
	:
	fSize(kPlainSize),
	fShear(90.0f),
	fFace(B_REGULAR_FACE)
{
	CopyName(fFamily, "DejaVu Sans", sizeof(fFamily));
	CopyName(fStyle, "Book", sizeof(fStyle));
}

BFont::BFont(const BFont& font) = default;

BFont::BFont(const BFont* font)
	:
	BFont(font != NULL ? *font : BFont())
{
}

BFont& BFont::operator=(const BFont& font) = default;

bool BFont::operator==(const BFont& font) const
{
	return strcmp(fFamily, font.fFamily) == 0 && strcmp(fStyle, font.fStyle) == 0
		&& fSize == font.fSize && fShear == font.fShear && fFace == font.fFace;
}

status_t BFont::SetFamilyAndStyle(const font_family family, const font_style style)
{
	if (family == NULL || style == NULL || !BPrivate::HasFontStyle(family, style))
		return B_NAME_NOT_FOUND;
	CopyName(fFamily, family, sizeof(fFamily));
	CopyName(fStyle, style, sizeof(fStyle));
	return B_OK;
}

status_t BFont::SetFamilyAndFace(const font_family family, uint16 face)
{
	font_style style;
	if (family == NULL || BPrivate::MatchFontStyle(family, face, &style) != B_OK)
		return B_NAME_NOT_FOUND;
	CopyName(fFamily, family, sizeof(fFamily));
	CopyName(fStyle, style, sizeof(fStyle));
	fFace = face;
	return B_OK;
}

void BFont::GetFamilyAndStyle(font_family* family, font_style* style) const
{
	if (family != NULL)
		CopyName(*family, fFamily, sizeof(font_family));
	if (style != NULL)
		CopyName(*style, fStyle, sizeof(font_style));
}

void BFont::SetFace(uint16 face)
{
	if (face == fFace)
		return;
	font_style style;
	if (BPrivate::MatchFontStyle(fFamily, face, &style) == B_OK)
		CopyName(fStyle, style, sizeof(fStyle));
	fFace = face;
}

uint16 BFont::Face() const
{
	return fFace;
}

void BFont::SetSize(float size)
{
	if (size > 0)
		fSize = size;
}

float BFont::Size() const
{
	return fSize;
}

void BFont::SetShear(float shear)
{
	fShear = min_c(max_c(shear, 45.0f), 135.0f);
}

float BFont::Shear() const
{
	return fShear;
}

float BFont::StringWidth(const char* string) const
{
	return string != NULL ? StringWidth(string, strlen(string)) : 0;
}

float BFont::StringWidth(const char* string, int32 length) const
{
	return BPrivate::TextWidth(*this, string, length);
}

void BFont::GetHeight(font_height* height) const
{
	if (height != NULL)
		BPrivate::FontHeight(*this, height);
}

void BFont::_SetFrom(const BFont& font, uint32 mask)
{
	if ((mask & B_FONT_FAMILY_AND_STYLE) != 0) {
		CopyName(fFamily, font.fFamily, sizeof(fFamily));
		CopyName(fStyle, font.fStyle, sizeof(fStyle));
	}
	if ((mask & B_FONT_SIZE) != 0)
		fSize = font.fSize;
	if ((mask & B_FONT_SHEAR) != 0)
		fShear = font.fShear;
	if ((mask & (B_FONT_FACE | B_FONT_FAMILY_AND_STYLE)) != 0)
		fFace = font.fFace;
}

static const BFont sPlainFont;
static const BFont sBoldFont = FontAccess::Make("DejaVu Sans", "Bold", B_BOLD_FACE,
	kBoldSize);
static const BFont sFixedFont = FontAccess::Make("DejaVu Sans Mono", "Book",
	B_REGULAR_FACE, kBoldSize);

const BFont* be_plain_font = &sPlainFont;
const BFont* be_bold_font = &sBoldFont;
const BFont* be_fixed_font = &sFixedFont;

int32 count_font_families()
{
	return BPrivate::CountFontFamilies();
}

status_t get_font_family(int32 index, font_family* name, uint32* flags)
{
	return BPrivate::GetFontFamily(index, name, flags);
}
