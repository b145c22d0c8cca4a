// Icons reach callers as B_CMAP8 bitmaps of exactly the icon's size.

#include <cstring>

#include <Bitmap.h>

#include "TypeIcons.h"

namespace BPrivate {

const char* StandardIconName(icon_size size)
{
	return size == B_LARGE_ICON ? "BEOS:L:STD_ICON" : "BEOS:M:STD_ICON";
}

status_t CheckIconBitmap(const BBitmap* bitmap, icon_size size)
{
	if ((size != B_MINI_ICON && size != B_LARGE_ICON) || bitmap == nullptr
		|| bitmap->InitCheck() != B_OK
		|| bitmap->ColorSpace() != B_CMAP8
		|| bitmap->Bounds() != BRect(0, 0, size - 1, size - 1))
		return B_BAD_VALUE;
	return B_OK;
}

void CopyIconToBitmap(const IconPixels& icon, BBitmap* bitmap)
{
	uint8* row = static_cast<uint8*>(bitmap->Bits());
	for (int32 y = 0; y < icon.size; y++, row += bitmap->BytesPerRow())
		memcpy(row, &icon.indices[y * icon.size], icon.size);
}

}
