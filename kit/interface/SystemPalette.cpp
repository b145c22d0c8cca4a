#include "SystemPalette.h"

#include <algorithm>
#include <array>

namespace BPrivate {

namespace {

constexpr int kCubeLevels[6] = {0, 51, 102, 153, 204, 255};

struct PaletteTables {
	std::array<rgb_color, 256> colors;
	// Packed 0xRRGGBB of each opaque entry, sorted, with its index alongside.
	std::array<uint32, 255> sortedKeys;
	std::array<uint8, 255> sortedIndex;
	std::array<uint8, 32768> nearest;
};

uint32 PackKey(uint8 red, uint8 green, uint8 blue)
{
	return (uint32(red) << 16) | (uint32(green) << 8) | blue;
}

uint8 SearchNearest(const std::array<rgb_color, 256>& colors, int red, int green,
	int blue)
{
	int best = 0;
	int bestDistance = 1 << 30;
	for (int i = 0; i < 255; i++) {
		int dr = colors[i].red - red;
		int dg = colors[i].green - green;
		int db = colors[i].blue - blue;
		int distance = dr * dr + dg * dg + db * db;
		if (distance < bestDistance) {
			bestDistance = distance;
			best = i;
		}
	}
	return uint8(best);
}

void FillColors(std::array<rgb_color, 256>& colors)
{
	for (int i = 0; i < 32; i++)
		colors[i] = make_color(i * 8, i * 8, i * 8);

	int index = 32;
	for (int primary = 0; primary < 3; primary++) {
		for (int tenth = 10; tenth >= 2; tenth--) {
			uint8 level = uint8((255 * tenth + 5) / 10);
			colors[index++] = primary == 0 ? make_color(0, 0, level)
				: primary == 1 ? make_color(level, 0, 0) : make_color(0, level, 0);
		}
	}

	colors[63] = make_color(255, 255, 255);
	for (int r : kCubeLevels) {
		for (int g : kCubeLevels) {
			for (int b : kCubeLevels) {
				bool grey = r == g && g == b;
				int primaries = (r != 0) + (g != 0) + (b != 0);
				if (grey || primaries == 1)
					continue;
				if (index == 63)
					index++;
				colors[index++] = make_color(r, g, b);
			}
		}
	}
	colors[B_TRANSPARENT_MAGIC_CMAP8] = B_TRANSPARENT_COLOR;
}

PaletteTables BuildTables()
{
	PaletteTables tables;
	FillColors(tables.colors);

	std::array<std::pair<uint32, uint8>, 255> keyed;
	for (int i = 0; i < 255; i++) {
		const rgb_color& c = tables.colors[i];
		keyed[i] = {PackKey(c.red, c.green, c.blue), uint8(i)};
	}
	std::sort(keyed.begin(), keyed.end());
	for (int i = 0; i < 255; i++) {
		tables.sortedKeys[i] = keyed[i].first;
		tables.sortedIndex[i] = keyed[i].second;
	}

	for (int bin = 0; bin < 32768; bin++) {
		tables.nearest[bin] = SearchNearest(tables.colors,
			((bin >> 10) << 3) + 4, (((bin >> 5) & 31) << 3) + 4, ((bin & 31) << 3) + 4);
	}
	return tables;
}

const PaletteTables& Tables()
{
	static const PaletteTables tables = BuildTables();
	return tables;
}

}

rgb_color ColorForIndex(uint8 index)
{
	return Tables().colors[index];
}

uint8 IndexForColor(uint8 red, uint8 green, uint8 blue)
{
	const PaletteTables& tables = Tables();
	uint32 key = PackKey(red, green, blue);
	auto found = std::lower_bound(tables.sortedKeys.begin(), tables.sortedKeys.end(), key);
	if (found != tables.sortedKeys.end() && *found == key)
		return tables.sortedIndex[found - tables.sortedKeys.begin()];
	return tables.nearest[((red >> 3) << 10) | ((green >> 3) << 5) | (blue >> 3)];
}

}
