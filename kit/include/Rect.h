#ifndef _RECT_H
#define _RECT_H

#include <Point.h>

// A rectangle with inclusive edges: BRect(0, 0, 9, 9) covers 10 x 10 pixels,
// while Width() and Height() are right - left and bottom - top.
class BRect {
public:
	float left;
	float top;
	float right;
	float bottom;

	// The default rectangle is invalid (left > right).
	constexpr BRect() : left(0), top(0), right(-1), bottom(-1) {}
	constexpr BRect(float l, float t, float r, float b)
		: left(l), top(t), right(r), bottom(b) {}
	constexpr BRect(BPoint leftTop, BPoint rightBottom)
		: left(leftTop.x), top(leftTop.y), right(rightBottom.x), bottom(rightBottom.y) {}

	void Set(float l, float t, float r, float b) { left = l; top = t; right = r; bottom = b; }

	BPoint LeftTop() const { return BPoint(left, top); }
	BPoint RightBottom() const { return BPoint(right, bottom); }
	BPoint LeftBottom() const { return BPoint(left, bottom); }
	BPoint RightTop() const { return BPoint(right, top); }
	void SetLeftTop(BPoint p) { left = p.x; top = p.y; }
	void SetRightBottom(BPoint p) { right = p.x; bottom = p.y; }

	float Width() const { return right - left; }
	float Height() const { return bottom - top; }
	int32 IntegerWidth() const;
	int32 IntegerHeight() const;

	bool IsValid() const { return left <= right && top <= bottom; }

	BRect& InsetBy(float dx, float dy);
	BRect& InsetBy(BPoint delta) { return InsetBy(delta.x, delta.y); }
	BRect& OffsetBy(float dx, float dy);
	BRect& OffsetBy(BPoint delta) { return OffsetBy(delta.x, delta.y); }
	BRect& OffsetTo(float x, float y);
	BRect& OffsetTo(BPoint where) { return OffsetTo(where.x, where.y); }
	BRect InsetByCopy(float dx, float dy) const;
	BRect InsetByCopy(BPoint delta) const { return InsetByCopy(delta.x, delta.y); }
	BRect OffsetByCopy(float dx, float dy) const;
	BRect OffsetByCopy(BPoint delta) const { return OffsetByCopy(delta.x, delta.y); }
	BRect OffsetToCopy(float x, float y) const;
	BRect OffsetToCopy(BPoint where) const { return OffsetToCopy(where.x, where.y); }

	bool Contains(BPoint point) const;
	bool Contains(BRect rect) const;
	bool Intersects(BRect rect) const;

	// Intersection and union; the intersection of disjoint rectangles is invalid.
	BRect operator&(BRect other) const;
	BRect operator|(BRect other) const;
	bool operator==(BRect other) const;
	bool operator!=(BRect other) const { return !(*this == other); }

	void PrintToStream() const;
};

#endif
