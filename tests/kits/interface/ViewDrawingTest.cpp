// The drawing calls of BView, by the pixels that they make.
#include <gtest/gtest.h>

#include <functional>

#include <Application.h>
#include <Bitmap.h>
#include <Polygon.h>
#include <Region.h>
#include <Shape.h>
#include <String.h>
#include <View.h>

namespace {

constexpr uint32 kWhite = 0xffffffff;
constexpr uint32 kBlack = 0xff000000;
const BRect kShape(10, 10, 30, 30);


// A view of 41 × 41 white pixels to draw on.
class ViewDrawing : public testing::Test {
protected:
	ViewDrawing() :
		app("application/x-vnd.Archway-test"), bitmap(BRect(0, 0, 40, 40), B_RGBA32, true)
	{
		view = new BView(bitmap.Bounds(), "canvas", B_FOLLOW_NONE, B_WILL_DRAW);
		bitmap.Lock();
		bitmap.AddChild(view);
		Clear();
	}

	~ViewDrawing() override { bitmap.Unlock(); }

	void Clear()
	{
		view->SetHighColor(255, 255, 255);
		view->FillRect(view->Bounds());
		view->SetHighColor(0, 0, 0);
		view->Sync();
	}

	uint32 At(int32 x, int32 y)
	{
		view->Sync();
		return static_cast<const uint32*>(bitmap.Bits())[y * bitmap.BytesPerRow() / 4 + x];
	}

	int32 CountDark()
	{
		int32 dark = 0;
		for (int32 y = 0; y <= 40; y++) {
			for (int32 x = 0; x <= 40; x++)
				dark += (At(x, y) & 0xff) < 128 ? 1 : 0;
		}
		return dark;
	}

	// The outline leaves the middle as it is, the filled one does not; neither leaves its frame.
	void CheckOutlineAndFill(
		const std::function<void()>& stroke, const std::function<void()>& fill, BPoint middle)
	{
		Clear();
		stroke();
		const int32 outline = CountDark();
		EXPECT_GT(outline, 10);
		EXPECT_EQ(kWhite, At(int32(middle.x), int32(middle.y)));
		Clear();
		fill();
		EXPECT_GT(CountDark(), outline);
		EXPECT_EQ(kBlack, At(int32(middle.x), int32(middle.y)));
		for (int32 at = 0; at <= 40; at++) {
			EXPECT_EQ(kWhite, At(at, 8));
			EXPECT_EQ(kWhite, At(at, 32));
			EXPECT_EQ(kWhite, At(8, at));
			EXPECT_EQ(kWhite, At(32, at));
		}
	}

	BApplication app;
	BBitmap bitmap;
	BView* view; // child
};

} // namespace


TEST_F(ViewDrawing, RoundRectsEllipsesAndArcs)
{
	const BPoint middle(20, 20);
	CheckOutlineAndFill([&] { view->StrokeRoundRect(kShape, 5, 5); },
		[&] { view->FillRoundRect(kShape, 5, 5); }, middle);
	EXPECT_EQ(kWhite, At(10, 10));
	CheckOutlineAndFill(
		[&] { view->StrokeEllipse(kShape); }, [&] { view->FillEllipse(kShape); }, middle);
	CheckOutlineAndFill([&] { view->StrokeEllipse(middle, 10, 10); },
		[&] { view->FillEllipse(middle, 10, 10); }, middle);

	Clear();
	view->FillArc(middle, 10, 10, 0, 90); // the right upper quarter
	EXPECT_EQ(kBlack, At(24, 16));
	EXPECT_EQ(kWhite, At(16, 16));
	EXPECT_EQ(kWhite, At(24, 24));
	Clear();
	view->StrokeArc(kShape, 180, 90); // the left lower one
	EXPECT_NE(kWhite, At(10, 20));
	EXPECT_EQ(kWhite, At(30, 20));
	EXPECT_EQ(kWhite, At(20, 10));
}


TEST_F(ViewDrawing, TrianglesPolygonsShapesAndCurves)
{
	const BPoint a(10, 10), b(30, 10), c(10, 30);
	CheckOutlineAndFill([&] { view->StrokeTriangle(a, b, c); },
		[&] { view->FillTriangle(a, b, c); }, BPoint(15, 15));

	const BPoint corners[] = { BPoint(10, 10), BPoint(30, 10), BPoint(30, 30), BPoint(10, 30) };
	const BPolygon polygon(corners, 4);
	CheckOutlineAndFill([&] { view->StrokePolygon(&polygon); },
		[&] { view->FillPolygon(&polygon); }, BPoint(20, 20));

	BShape shape;
	shape.MoveTo(BPoint(10, 10));
	shape.LineTo(BPoint(30, 10));
	shape.LineTo(BPoint(30, 30));
	shape.LineTo(BPoint(10, 30));
	shape.Close();
	view->MovePenTo(0, 0);
	CheckOutlineAndFill(
		[&] { view->StrokeShape(&shape); }, [&] { view->FillShape(&shape); }, BPoint(20, 20));

	BPoint curve[] = { BPoint(10, 30), BPoint(10, 5), BPoint(30, 5), BPoint(30, 30) };
	Clear();
	view->StrokeBezier(curve);
	EXPECT_NE(kWhite, At(10, 30));
	EXPECT_NE(kWhite, At(30, 30));
	EXPECT_EQ(kWhite, At(20, 25));
	Clear();
	view->FillBezier(curve);
	EXPECT_EQ(kBlack, At(20, 25));
}


TEST_F(ViewDrawing, RegionsAndInversion)
{
	BRegion region;
	region.Include(BRect(2, 2, 4, 4));
	region.Include(BRect(20, 20, 22, 22));
	view->FillRegion(&region);
	EXPECT_EQ(18, CountDark());
	EXPECT_EQ(kBlack, At(22, 22));
	view->InvertRect(BRect(0, 0, 4, 4));
	EXPECT_EQ(kWhite, At(3, 3) | 0xff000000);
	EXPECT_EQ(kBlack, At(0, 0) | 0xff000000);
}


TEST_F(ViewDrawing, LineArraysHaveTheirOwnColours)
{
	view->BeginLineArray(2);
	view->AddLine(BPoint(1, 1), BPoint(5, 1), rgb_color { 255, 0, 0, 255 });
	view->AddLine(BPoint(1, 3), BPoint(5, 3), rgb_color { 0, 0, 255, 255 });
	view->EndLineArray();
	EXPECT_EQ(0xffff0000, At(1, 1));
	EXPECT_EQ(0xffff0000, At(5, 1));
	EXPECT_EQ(0xff0000ff, At(3, 3));
	EXPECT_EQ((rgb_color { 0, 0, 0, 255 }), view->HighColor());
}


TEST_F(ViewDrawing, BitsAreCopiedAndBitmapsDrawn)
{
	view->FillRect(BRect(0, 0, 3, 3));
	view->CopyBits(BRect(0, 0, 3, 3), BRect(10, 10, 13, 13));
	EXPECT_EQ(kBlack, At(13, 13));
	EXPECT_EQ(kWhite, At(14, 14));

	BBitmap picture(BRect(0, 0, 1, 1), B_RGB32);
	const uint32 red[4] = { 0xffff0000, 0xffff0000, 0xffff0000, 0xffff0000 };
	picture.SetBits(red, sizeof(red), 0, B_RGB32);
	view->DrawBitmapAsync(&picture, BPoint(20, 20));
	EXPECT_EQ(0xffff0000, At(21, 21));
	EXPECT_EQ(kWhite, At(22, 22));
	view->DrawBitmap(&picture, BRect(30, 30, 35, 35));
	EXPECT_EQ(0xffff0000, At(35, 35));
}


TEST_F(ViewDrawing, StringsLeaveThePenBehindThem)
{
	view->DrawString("Text", BPoint(2, 20));
	EXPECT_EQ(BPoint(2 + view->StringWidth("Text"), 20), view->PenLocation());
	EXPECT_GT(CountDark(), 5);
	Clear();
	view->DrawChar('X', BPoint(2, 20));
	EXPECT_GT(CountDark(), 3);
	view->MovePenTo(1, 2);
	view->MovePenBy(3, 4);
	EXPECT_EQ(BPoint(4, 6), view->PenLocation());

	char* strings[] = { const_cast<char*>("one"), const_cast<char*>("three") };
	int32 lengths[] = { 3, 5 };
	float widths[2];
	view->GetStringWidths(strings, lengths, 2, widths);
	EXPECT_EQ(view->StringWidth("one"), widths[0]);
	EXPECT_EQ(view->StringWidth("three"), widths[1]);

	BString text("A text that is far too long");
	view->TruncateString(&text, B_TRUNCATE_END, 60);
	EXPECT_LE(view->StringWidth(text.String()), 60);
	EXPECT_LT(text.Length(), 27);
}


TEST_F(ViewDrawing, TheStateIsAskedForWhatWasSet)
{
	view->SetPenSize(3);
	EXPECT_EQ(3, view->PenSize());
	view->SetLineMode(B_ROUND_CAP, B_BEVEL_JOIN, 4);
	EXPECT_EQ(B_ROUND_CAP, view->LineCapMode());
	EXPECT_EQ(B_BEVEL_JOIN, view->LineJoinMode());
	EXPECT_EQ(4, view->LineMiterLimit());
	view->SetBlendingMode(B_CONSTANT_ALPHA, B_ALPHA_COMPOSITE);
	source_alpha source;
	alpha_function function;
	view->GetBlendingMode(&source, &function);
	EXPECT_EQ(B_CONSTANT_ALPHA, source);
	EXPECT_EQ(B_ALPHA_COMPOSITE, function);

	view->PushState();
	view->SetScale(2);
	view->SetOrigin(BPoint(5, 5));
	EXPECT_EQ(2, view->Scale());
	view->FillRect(BRect(0, 0, 1, 1));
	EXPECT_EQ(kBlack, At(7, 7));
	EXPECT_EQ(kWhite, At(4, 4));
	view->PopState();
	EXPECT_EQ(1, view->Scale());
}
