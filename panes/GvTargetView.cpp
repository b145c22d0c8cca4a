#include "GvTargetView.h"

#include <cstring>

GvTargetView::GvTargetView(BRect frame, const char* name, uint32 resizingMode,
	uint32 flags)
	: BView(frame, name, resizingMode, flags),
	  plainFont(be_plain_font),
	  boldFont(be_bold_font),
	  scrollFrame(NULL)
{
	font_family family;
	if (FindDutchFamily(&family)) {
		plainFont.SetFamilyAndFace(family, B_REGULAR_FACE);
		boldFont.SetFamilyAndFace(family, B_BOLD_FACE);
	}
	plainFont.SetSize(10);
	boldFont.SetSize(13);
	SetFont(&plainFont, B_FONT_ALL);
}

bool GvTargetView::FindDutchFamily(font_family* found)
{
	bool matched = false;
	int32 familyCount = count_font_families();
	for (int32 i = 0; i < familyCount; i++) {
		font_family family;
		if (get_font_family(i, &family) == B_OK && std::strncmp(family, "Dutch", 5) == 0) {
			std::memcpy(*found, family, sizeof(font_family));
			matched = true;
		}
	}
	return matched;
}
