#include "SystemPalette.h"

#include <array>
#include <cmath>
#include <vector>

namespace BPrivate {

namespace {

constexpr int kCubeLevels[6] = {0, 51, 102, 153, 204, 255};

// Each bin of the 15-bit colour cube lists the entries that can be nearest
// to some colour in it: those within the distance of the nearest to the
// bin's centre plus the bin's diagonal. A lookup then only compares those.
struct PaletteTables {
	std::array<rgb_color, 256> colors;
	std::array<uint32, 32769> binStart;
	std::vector<uint8> candidates;
};

int32 Distance(const rgb_color& color, int32 red, int32 green, int32 blue)
{
	int32 dr = color.red - red;
	int32 dg = color.green - green;
	int32 db = color.blue - blue;
	return dr * dr + dg * dg + db * db;
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
	// Twice the farthest a colour lies from its bin's centre (4 times the
	// square root of 3, rounded up).
	const double kReach = 2 * 7.0;
	std::array<int32, 255> distances;
	for (int32 bin = 0; bin < 32768; bin++) {
		tables.binStart[bin] = uint32(tables.candidates.size());
		int32 red = ((bin >> 10) << 3) + 4;
		int32 green = (((bin >> 5) & 31) << 3) + 4;
		int32 blue = ((bin & 31) << 3) + 4;
		int32 nearest = 1 << 30;
		for (int32 i = 0; i < 255; i++) {
			distances[i] = Distance(tables.colors[i], red, green, blue);
			nearest = min_c(nearest, distances[i]);
		}
		double limit = std::sqrt(double(nearest)) + kReach;
		for (int32 i = 0; i < 255; i++) {
			if (distances[i] <= limit * limit)
				tables.candidates.push_back(uint8(i));
		}
	}
	tables.binStart[32768] = uint32(tables.candidates.size());
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
	int32 bin = ((red >> 3) << 10) | ((green >> 3) << 5) | (blue >> 3);
	uint8 best = 0;
	int32 bestDistance = 1 << 30;
	for (uint32 i = tables.binStart[bin]; i < tables.binStart[bin + 1]; i++) {
		uint8 index = tables.candidates[i];
		int32 distance = Distance(tables.colors[index], red, green, blue);
		if (distance < bestDistance || (distance == bestDistance && index < best)) {
			bestDistance = distance;
			best = index;
		}
	}
	return best;
}

}
