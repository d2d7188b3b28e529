#include <Point.h>

#include <algorithm>
#include <stdio.h>

#include <Rect.h>

const BPoint B_ORIGIN(0, 0);


void
BPoint::ConstrainTo(BRect rect)
{
	x = std::max(rect.left, std::min(x, rect.right));
	y = std::max(rect.top, std::min(y, rect.bottom));
}


void
BPoint::PrintToStream() const
{
	printf("BPoint(x:%f, y:%f)\n", x, y);
}


BPoint&
BPoint::operator+=(const BPoint& other)
{
	x += other.x;
	y += other.y;
	return *this;
}


BPoint&
BPoint::operator-=(const BPoint& other)
{
	x -= other.x;
	y -= other.y;
	return *this;
}
