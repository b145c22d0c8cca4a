#include "Region.h"

#include <cmath>

namespace BPrivate {

IntRect IntRect::operator&(const IntRect& other) const
{
	return IntRect(max_c(left, other.left), max_c(top, other.top),
		min_c(right, other.right), min_c(bottom, other.bottom));
}

IntRect IntRect::operator|(const IntRect& other) const
{
	if (!IsValid())
		return other;
	if (!other.IsValid())
		return *this;
	return IntRect(min_c(left, other.left), min_c(top, other.top),
		max_c(right, other.right), max_c(bottom, other.bottom));
}

int32 PixelCoordinate(float value)
{
	return int32(std::floor(value + 0.5f));
}

IntRect PixelRect(BRect rect)
{
	return IntRect(PixelCoordinate(rect.left), PixelCoordinate(rect.top),
		PixelCoordinate(rect.right), PixelCoordinate(rect.bottom));
}

IntRect Region::Bounds() const
{
	IntRect bounds;
	for (const IntRect& rect : fRects)
		bounds = bounds | rect;
	return bounds;
}

void Region::Include(const IntRect& rect)
{
	if (!rect.IsValid())
		return;
	Exclude(rect);
	fRects.push_back(rect);
}

void Region::Exclude(const IntRect& cut)
{
	if (!cut.IsValid())
		return;
	std::vector<IntRect> kept;
	kept.reserve(fRects.size() + 4);
	for (const IntRect& rect : fRects) {
		IntRect common = rect & cut;
		if (!common.IsValid()) {
			kept.push_back(rect);
			continue;
		}
		// What remains: full-width bands above and below, pieces left and right.
		IntRect above(rect.left, rect.top, rect.right, common.top - 1);
		IntRect below(rect.left, common.bottom + 1, rect.right, rect.bottom);
		IntRect leftPart(rect.left, common.top, common.left - 1, common.bottom);
		IntRect rightPart(common.right + 1, common.top, rect.right, common.bottom);
		for (const IntRect& piece : {above, below, leftPart, rightPart}) {
			if (piece.IsValid())
				kept.push_back(piece);
		}
	}
	fRects.swap(kept);
}

void Region::IntersectWith(const Region& region)
{
	std::vector<IntRect> kept;
	for (const IntRect& rect : fRects) {
		for (const IntRect& other : region.fRects) {
			IntRect common = rect & other;
			if (common.IsValid())
				kept.push_back(common);
		}
	}
	fRects.swap(kept);
}

}
