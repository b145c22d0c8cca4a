// Plain folder, file, volume and link pictures for machines without an icon
// theme, drawn on a 16-unit grid and scaled up for the large size.

#include <GraphicsDefs.h>

#include "SystemPalette.h"
#include "TypeIcons.h"

namespace BPrivate {

namespace {

const rgb_color kEdge = {0, 0, 0, 255};
const rgb_color kPaper = {255, 255, 255, 255};
const rgb_color kFold = {184, 184, 184, 255};
const rgb_color kManila = {255, 204, 102, 255};
const rgb_color kManilaEdge = {153, 102, 0, 255};
const rgb_color kCase = {184, 184, 184, 255};
const rgb_color kCaseTop = {232, 232, 232, 255};
const rgb_color kLamp = {0, 204, 0, 255};
const rgb_color kArrow = {0, 0, 255, 255};

class Sketch {
public:
	explicit Sketch(int32 size)
		:
		fScale(size / 16),
		fIcon(std::make_shared<IconPixels>())
	{
		fIcon->size = size;
		fIcon->indices.assign(size * size, B_TRANSPARENT_MAGIC_CMAP8);
	}

	// Grid units, both corners included.
	void Fill(int32 left, int32 top, int32 right, int32 bottom, rgb_color color)
	{
		uint8 index = IndexForColor(color);
		for (int32 y = top * fScale; y < (bottom + 1) * fScale; y++) {
			for (int32 x = left * fScale; x < (right + 1) * fScale; x++)
				fIcon->indices[y * fIcon->size + x] = index;
		}
	}

	// A filled rectangle with a one-unit edge.
	void Box(int32 left, int32 top, int32 right, int32 bottom, rgb_color fill,
		rgb_color edge)
	{
		Fill(left, top, right, bottom, edge);
		Fill(left + 1, top + 1, right - 1, bottom - 1, fill);
	}

	IconRef Result() const { return fIcon; }

private:
	int32 fScale;
	std::shared_ptr<IconPixels> fIcon;
};

IconRef Draw(BuiltinIcon which, int32 size)
{
	Sketch sketch(size);
	switch (which) {
		case BuiltinIcon::kFolder:
			sketch.Box(1, 2, 7, 5, kManila, kManilaEdge);
			sketch.Box(1, 4, 14, 13, kManila, kManilaEdge);
			break;
		case BuiltinIcon::kVolume:
			sketch.Box(1, 4, 14, 11, kCase, kEdge);
			sketch.Fill(2, 5, 13, 6, kCaseTop);
			sketch.Fill(11, 9, 12, 9, kLamp);
			break;
		case BuiltinIcon::kFile:
		case BuiltinIcon::kLink:
			sketch.Box(3, 1, 12, 14, kPaper, kEdge);
			sketch.Fill(10, 2, 11, 3, kFold);
			if (which == BuiltinIcon::kLink) {
				sketch.Fill(8, 6, 8, 12, kArrow);
				sketch.Fill(7, 7, 9, 7, kArrow);
				sketch.Fill(6, 8, 10, 8, kArrow);
			}
			break;
	}
	return sketch.Result();
}

}

IconRef GetBuiltinIcon(BuiltinIcon which, int32 size)
{
	if (size != B_MINI_ICON && size != B_LARGE_ICON)
		return nullptr;
	static const std::map<std::pair<BuiltinIcon, int32>, IconRef> sIcons = [] {
		std::map<std::pair<BuiltinIcon, int32>, IconRef> icons;
		for (BuiltinIcon which : {BuiltinIcon::kFile, BuiltinIcon::kFolder,
				BuiltinIcon::kVolume, BuiltinIcon::kLink}) {
			icons[{which, B_MINI_ICON}] = Draw(which, B_MINI_ICON);
			icons[{which, B_LARGE_ICON}] = Draw(which, B_LARGE_ICON);
		}
		return icons;
	}();
	return sIcons.at({which, size});
}

}
