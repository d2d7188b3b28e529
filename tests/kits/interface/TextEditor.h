// A text view to type into.
#pragma once

#include <TextView.h>

#include <gtest/gtest.h>

#include "support/TestWindow.h"


const BRect kFrame(10, 10, 309, 209);

inline BTextView*
make_view(BRect frame = kFrame)
{
	BRect textRect = frame;
	textRect.OffsetTo(0, 0);
	textRect.InsetBy(2, 2);
	return new BTextView(frame, "text", textRect, B_FOLLOW_ALL, B_WILL_DRAW);
}


inline void
expect_selection(const BTextView* view, int32 from, int32 to)
{
	int32 start, end;
	view->GetSelection(&start, &end);
	EXPECT_EQ(from, start);
	EXPECT_EQ(to, end);
}

// A focused text view in a window.
struct Editor : TestWindow {
	Editor() : view(Add(make_view()))
	{
		Locked([this] { view->MakeFocus(); });
	}

	BTextView* view;
};
