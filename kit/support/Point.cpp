#include <Point.h>
#include <Rect.h>

#include <algorithm>
#include <cstdio>

const BPoint B_ORIGIN(0, 0);

void BPoint::ConstrainTo(BRect rect)
{
	x = std::max(std::min(x, rect.right), rect.left);
	y = std::max(std::min(y, rect.bottom), rect.top);
}

void BPoint::PrintToStream() const
{
	std::printf("BPoint(x:%.0f, y:%.0f)\n", x, y);
}
