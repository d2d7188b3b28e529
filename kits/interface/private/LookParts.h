// LookParts: the strokes that the look's pictures are made of. For the look's own sources only.
#pragma once

#include <initializer_list>

#include <View.h>

#include "interface/private/Look.h"

namespace BPrivate::Look {


struct Line {
	BPoint from;
	BPoint to;
	rgb_color color;
};

// Gives the view the plain pen that the look draws with, and its own state back in the end.
class PlainPen {
public:
	explicit PlainPen(BView* view) :
		fView(view), fHigh(view->HighColor()), fLow(view->LowColor()), fPen(view->PenLocation()),
		fPenSize(view->PenSize()), fMode(view->DrawingMode())
	{
		if (fPenSize != 1.0f)
			fView->SetPenSize(1.0f);
		if (fMode != B_OP_COPY)
			fView->SetDrawingMode(B_OP_COPY);
	}

	~PlainPen()
	{
		fView->SetHighColor(fHigh);
		fView->SetLowColor(fLow);
		fView->MovePenTo(fPen);
		if (fPenSize != 1.0f)
			fView->SetPenSize(fPenSize);
		if (fMode != B_OP_COPY)
			fView->SetDrawingMode(fMode);
	}

	PlainPen(const PlainPen&) = delete;
	PlainPen& operator=(const PlainPen&) = delete;

private:
	BView* fView;
	rgb_color fHigh;
	rgb_color fLow;
	BPoint fPen;
	float fPenSize;
	drawing_mode fMode;
};


void DrawLines(BView* view, std::initializer_list<Line> lines);
void Fill(BView* view, BRect frame, rgb_color color);
// A ring without its four corner pixels.
void DrawRoundRing(BView* view, BRect frame, rgb_color color);
// The left and the top line of a ring.
void DrawLeftTop(BView* view, BRect frame, rgb_color color);
// A ring whose top line leaves out the columns of the gap.
void DrawBrokenRing(BView* view, BRect frame, rgb_color leftTop, rgb_color rightBottom, BRect gap);
// The colour between the two.
rgb_color Blend(rgb_color a, rgb_color b);
BRect Inset(BRect frame, float by);

} // namespace BPrivate::Look
