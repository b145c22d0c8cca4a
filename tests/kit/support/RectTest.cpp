#include <gtest/gtest.h>

#include <Rect.h>

// Edges are inclusive: BRect(0, 0, 9, 9) is 10 x 10 pixels wide, Width() 9.

TEST(Rect, WidthAndContainsCountTheEdges)
{
	BRect rect(0, 0, 9, 4);
	EXPECT_EQ(9, rect.Width());
	EXPECT_EQ(4, rect.Height());
	EXPECT_TRUE(rect.Contains(BPoint(0, 0)));
	EXPECT_TRUE(rect.Contains(BPoint(9, 4)));
	EXPECT_FALSE(rect.Contains(BPoint(9.5f, 4)));
	EXPECT_FALSE(rect.Contains(BPoint(-0.5f, 0)));
	EXPECT_TRUE(rect.Contains(rect));
	EXPECT_FALSE(rect.Contains(BRect(0, 0, 10, 4)));

	// One pixel: left == right is still valid and contains its corner.
	BRect pixel(3, 3, 3, 3);
	EXPECT_TRUE(pixel.IsValid());
	EXPECT_EQ(0, pixel.Width());
	EXPECT_TRUE(pixel.Contains(BPoint(3, 3)));
}

TEST(Rect, DefaultAndInvertedRectsAreInvalid)
{
	EXPECT_FALSE(BRect().IsValid());
	EXPECT_FALSE(BRect(5, 0, 4, 9).IsValid());
	EXPECT_FALSE(BRect(0, 5, 9, 4).IsValid());
	EXPECT_FALSE(BRect().Contains(BRect(0, 0, -1, -1)));
}

TEST(Rect, IntersectionAndUnion)
{
	BRect a(0, 0, 9, 9);
	BRect b(5, 5, 14, 14);
	EXPECT_EQ(BRect(5, 5, 9, 9), a & b);
	EXPECT_EQ(BRect(0, 0, 14, 14), a | b);
	EXPECT_TRUE(a.Intersects(b));

	// Sharing an edge column is an intersection of one pixel column.
	BRect touching(9, 0, 20, 9);
	EXPECT_EQ(BRect(9, 0, 9, 9), a & touching);
	EXPECT_TRUE(a.Intersects(touching));

	BRect apart(10, 0, 20, 9);
	EXPECT_FALSE((a & apart).IsValid());
	EXPECT_FALSE(a.Intersects(apart));
}

TEST(Rect, InsetAndOffsetKeepOrMoveTheEdges)
{
	BRect rect(10, 20, 29, 39);
	EXPECT_EQ(BRect(12, 21, 27, 38), rect.InsetByCopy(2, 1));
	EXPECT_EQ(BRect(8, 20, 31, 39), rect.InsetByCopy(-2, 0));
	// Insetting past the middle leaves an invalid rectangle.
	EXPECT_FALSE(rect.InsetByCopy(11, 0).IsValid());

	EXPECT_EQ(BRect(15, 15, 34, 34), rect.OffsetByCopy(5, -5));
	BRect moved = rect;
	moved.OffsetTo(0, 0);
	EXPECT_EQ(BRect(0, 0, 19, 19), moved);
	EXPECT_EQ(rect.Width(), moved.Width());
	EXPECT_EQ(BRect(-3, 4, 16, 23), rect.OffsetToCopy(BPoint(-3, 4)));
}

TEST(Point, ConstrainToClampsIntoTheRect)
{
	BPoint point(-4, 50);
	point.ConstrainTo(BRect(0, 0, 9, 9));
	EXPECT_EQ(BPoint(0, 9), point);
	EXPECT_EQ(BPoint(3, -1), BPoint(1, 2) + BPoint(2, -3));
}
