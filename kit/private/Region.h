#ifndef KIT_PRIVATE_REGION_H
#define KIT_PRIVATE_REGION_H

#include <vector>

#include <Rect.h>

namespace BPrivate {

// A rectangle of whole pixels, edges included.
struct IntRect {
	int32 left = 0;
	int32 top = 0;
	int32 right = -1;
	int32 bottom = -1;

	IntRect() = default;
	IntRect(int32 l, int32 t, int32 r, int32 b) : left(l), top(t), right(r), bottom(b) {}

	bool IsValid() const { return left <= right && top <= bottom; }
	int32 Width() const { return right - left + 1; }
	int32 Height() const { return bottom - top + 1; }
	bool Contains(int32 x, int32 y) const
	{
		return x >= left && x <= right && y >= top && y <= bottom;
	}
	IntRect operator&(const IntRect& other) const;
	// The smallest rectangle holding both; an invalid side is ignored.
	IntRect operator|(const IntRect& other) const;
	bool operator==(const IntRect& other) const
	{
		return left == other.left && top == other.top && right == other.right
			&& bottom == other.bottom;
	}
	BRect ToBRect() const { return BRect(left, top, right, bottom); }
};

// Pixel coordinates of a point: the nearest whole pixel.
int32 PixelCoordinate(float value);
IntRect PixelRect(BRect rect);

// A set of pixels kept as disjoint rectangles.
class Region {
public:
	Region() = default;
	explicit Region(const IntRect& rect) { Include(rect); }

	bool IsEmpty() const { return fRects.empty(); }
	const std::vector<IntRect>& Rects() const { return fRects; }
	IntRect Bounds() const;

	void MakeEmpty() { fRects.clear(); }
	void Include(const IntRect& rect);
	void Exclude(const IntRect& rect);
	void IntersectWith(const Region& region);

private:
	std::vector<IntRect> fRects;
};

}

#endif
