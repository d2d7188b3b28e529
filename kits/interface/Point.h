// BPoint: a place; x grows to the right, y downwards, and whole numbers name centres of pixels.
#pragma once

#include <SupportDefs.h>

class BRect;


class BPoint {
public:
	float x;
	float y;

	BPoint() : x(0), y(0) {}
	BPoint(float x, float y) : x(x), y(y) {}
	BPoint(const BPoint& other) = default;
	BPoint& operator=(const BPoint& other) = default;

	void Set(float newX, float newY)
	{
		x = newX;
		y = newY;
	}

	// Moves the point to the nearest place inside the rectangle, its edges included.
	void ConstrainTo(BRect rect);
	void PrintToStream() const;

	BPoint operator-() const { return BPoint(-x, -y); }
	BPoint operator+(const BPoint& other) const { return BPoint(x + other.x, y + other.y); }
	BPoint operator-(const BPoint& other) const { return BPoint(x - other.x, y - other.y); }
	BPoint& operator+=(const BPoint& other);
	BPoint& operator-=(const BPoint& other);
	bool operator==(const BPoint& other) const { return x == other.x && y == other.y; }
	bool operator!=(const BPoint& other) const { return !(*this == other); }
};

extern _IMPORT const BPoint B_ORIGIN; // (0, 0)
