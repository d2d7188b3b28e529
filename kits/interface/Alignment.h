// BAlignment: where something stands in a larger frame.
#pragma once

#include <InterfaceDefs.h>


// A value. What is unset is left to who places the thing.
class BAlignment {
public:
	alignment horizontal;
	vertical_alignment vertical;

	BAlignment() : horizontal(B_ALIGN_HORIZONTAL_UNSET), vertical(B_ALIGN_VERTICAL_UNSET) {}
	BAlignment(alignment horizontalAlignment, vertical_alignment verticalAlignment) :
		horizontal(horizontalAlignment), vertical(verticalAlignment)
	{
	}

	alignment Horizontal() const { return horizontal; }
	vertical_alignment Vertical() const { return vertical; }

	// Parts of the frame: 0 is the left or top edge, 1 the other one. The middle for all others.
	float RelativeHorizontal() const
	{
		return horizontal == B_ALIGN_LEFT ? 0.0f : horizontal == B_ALIGN_RIGHT ? 1.0f : 0.5f;
	}
	float RelativeVertical() const
	{
		return vertical == B_ALIGN_TOP ? 0.0f : vertical == B_ALIGN_BOTTOM ? 1.0f : 0.5f;
	}

	void SetHorizontal(alignment value) { horizontal = value; }
	void SetVertical(vertical_alignment value) { vertical = value; }

	bool IsHorizontalSet() const { return horizontal != B_ALIGN_HORIZONTAL_UNSET; }
	bool IsVerticalSet() const { return vertical != B_ALIGN_VERTICAL_UNSET; }

	bool operator==(const BAlignment& other) const
	{
		return horizontal == other.horizontal && vertical == other.vertical;
	}
	bool operator!=(const BAlignment& other) const { return !(*this == other); }
};
