#include <Shape.h>

#include <gtest/gtest.h>
#include <math.h>
#include <memory>
#include <string>

#include <Message.h>
#include <Polygon.h>

namespace {

class Recorder : public BShapeIterator {
public:
	virtual status_t IterateMoveTo(BPoint*)
	{
		text += "M ";
		return B_OK;
	}
	virtual status_t IterateLineTo(int32 count, BPoint*)
	{
		text += "L" + std::to_string(count) + " ";
		return B_OK;
	}
	virtual status_t IterateBezierTo(int32 count, BPoint*)
	{
		text += "B" + std::to_string(count) + " ";
		return B_OK;
	}
	virtual status_t IterateClose()
	{
		text += "C ";
		return B_OK;
	}

	std::string text;
};


void
Build(BShape& shape)
{
	shape.MoveTo(BPoint(1, 2));
	shape.LineTo(BPoint(10, 2));
	shape.LineTo(BPoint(10, 20));
	shape.BezierTo(BPoint(8, 22), BPoint(4, 22), BPoint(1, 20));
	shape.Close();
}

} // namespace


TEST(Shape, IteratorJoinsEqualParts)
{
	BShape shape;
	Build(shape);
	Recorder recorder;
	EXPECT_EQ(B_OK, recorder.Iterate(&shape));
	EXPECT_EQ("M L2 B1 C ", recorder.text);
}


TEST(Shape, ArchiveRoundTripIsEqual)
{
	BShape shape;
	Build(shape);
	BMessage archive;
	ASSERT_EQ(B_OK, shape.Archive(&archive));
	std::unique_ptr<BArchivable> copy(BShape::Instantiate(&archive));
	ASSERT_NE(nullptr, dynamic_cast<BShape*>(copy.get()));
	EXPECT_EQ(shape, *dynamic_cast<BShape*>(copy.get()));
}


TEST(Shape, MissingPointsEndTheShape)
{
	BShape shape;
	Build(shape);
	BMessage archive;
	shape.Archive(&archive);
	archive.RemoveData("pts", 5);
	BShape copy(&archive);
	Recorder recorder;
	recorder.Iterate(&copy);
	EXPECT_EQ("M L2 ", recorder.text);
}


TEST(Shape, BoundsHoldAllPoints)
{
	BShape shape;
	EXPECT_FALSE(shape.Bounds().IsValid());
	Build(shape);
	EXPECT_EQ(BRect(1, 2, 10, 22), shape.Bounds());
	EXPECT_EQ(BPoint(1, 20), shape.CurrentPosition());
}


TEST(Shape, LineWithoutAStartBeginsAtTheOrigin)
{
	BShape shape;
	shape.LineTo(BPoint(5, 5));
	EXPECT_EQ(BRect(0, 0, 5, 5), shape.Bounds());
}


TEST(Shape, ArcEndsWhereItShould)
{
	BShape shape;
	shape.MoveTo(BPoint(0, 10));
	shape.ArcTo(10, 10, 0, false, false, BPoint(10, 0));
	EXPECT_EQ(BPoint(10, 0), shape.CurrentPosition());
	// With the clock, y downwards: a quarter round (10, 10), whose control points stay within.
	EXPECT_NEAR(0, shape.Bounds().left, 0.001);
	EXPECT_NEAR(0, shape.Bounds().top, 0.001);
	EXPECT_EQ(BPoint(10, 10), shape.Bounds().RightBottom());
}


TEST(Shape, AddingItselfDoublesIt)
{
	BShape shape;
	Build(shape);
	shape.AddShape(&shape);
	Recorder recorder;
	recorder.Iterate(&shape);
	EXPECT_EQ("M L2 B1 C M L2 B1 C ", recorder.text);
}


TEST(Polygon, FrameHoldsAllPoints)
{
	const BPoint points[] = { BPoint(1, 7), BPoint(5, 2), BPoint(3, 9) };
	BPolygon polygon(points, 3);
	EXPECT_EQ(3, polygon.CountPoints());
	EXPECT_EQ(BRect(1, 2, 5, 9), polygon.Frame());
	polygon.MapTo(BRect(1, 2, 5, 9), BRect(0, 0, 8, 14));
	EXPECT_EQ(BRect(0, 0, 8, 14), polygon.Frame());
	EXPECT_FALSE(BPolygon().Frame().IsValid());
}
