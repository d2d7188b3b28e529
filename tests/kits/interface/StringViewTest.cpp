#include <StringView.h>

#include <cmath>

#include <Font.h>

#include "ControlFixture.h"

namespace {

// The first and the last column of the view that holds something else than its ground.
std::pair<float, float>
InkColumns(ControlFixture& fixture, BView* view, float width, float height)
{
	float first = width;
	float last = -1;
	for (float x = 0; x <= width; x++) {
		for (float y = 0; y <= height; y++) {
			if (fixture.driver.PixelAt(view, BPoint(x, y)) == rgb_color { 216, 216, 216, 255 })
				continue;
			first = std::min(first, x);
			last = std::max(last, x);
		}
	}
	return { first, last };
}

} // namespace


TEST(StringView, HasTheDefaultsOfItsClass)
{
	BApplication app("application/x-vnd.Archway-test");
	BStringView view(BRect(0, 0, 50, 20), "s", "Text");
	EXPECT_EQ(static_cast<uint32>(B_WILL_DRAW | B_FULL_UPDATE_ON_RESIZE), view.Flags());
	EXPECT_EQ(static_cast<uint32>(B_FOLLOW_LEFT | B_FOLLOW_TOP), view.ResizingMode());
	EXPECT_EQ(B_ALIGN_LEFT, view.Alignment());
	EXPECT_STREQ("Text", view.Text());
	BStringView none(BRect(0, 0, 50, 20), "s", NULL);
	EXPECT_EQ(nullptr, none.Text());
}


TEST(StringView, PrefersRoomForItsLines)
{
	BApplication app("application/x-vnd.Archway-test");
	BStringView view(BRect(0, 0, 5, 5), "s", "A text");
	float width;
	float height;
	view.GetPreferredSize(&width, &height);
	EXPECT_EQ(std::ceil(be_plain_font->StringWidth("A text")), width);

	view.SetText("A text\nof two lines");
	float twoLines;
	view.GetPreferredSize(&width, &twoLines);
	EXPECT_EQ(std::ceil(be_plain_font->StringWidth("of two lines")), width);
	EXPECT_EQ(2 * height, twoLines);
}


TEST(StringView, DrawsWhereItIsAlignedTo)
{
	ControlFixture fixture;
	BStringView* view = fixture.Add(new BStringView(BRect(10, 10, 109, 29), "s", "HHHH"));
	auto [first, last] = InkColumns(fixture, view, 99, 19);
	EXPECT_GE(first, 0);
	EXPECT_LE(first, 2);

	fixture.Locked([&] { view->SetAlignment(B_ALIGN_RIGHT); });
	std::tie(first, last) = InkColumns(fixture, view, 99, 19);
	EXPECT_GE(last, 96);
	EXPECT_LE(last, 99);

	fixture.Locked([&] { view->SetAlignment(B_ALIGN_CENTER); });
	std::tie(first, last) = InkColumns(fixture, view, 99, 19);
	EXPECT_NEAR(99, first + last, 2);
}


TEST(StringView, DrawsAnotherTextAtOnce)
{
	ControlFixture fixture;
	BStringView* view = fixture.Add(new BStringView(BRect(10, 10, 109, 29), "s", ""));
	EXPECT_EQ(-1, InkColumns(fixture, view, 99, 19).second);
	fixture.Locked([&] { view->SetText("HH"); });
	const float narrow = InkColumns(fixture, view, 99, 19).second;
	fixture.Locked([&] { view->SetText("HHHH"); });
	EXPECT_GT(InkColumns(fixture, view, 99, 19).second, narrow);
	fixture.Locked([&] { view->SetText(NULL); });
	EXPECT_EQ(-1, InkColumns(fixture, view, 99, 19).second);
}


TEST(StringView, RevivesWhatItWrote)
{
	ControlFixture fixture;
	BStringView view(BRect(1, 2, 103, 44), "s", "Text", B_FOLLOW_RIGHT);
	EXPECT_EQ("_text _align", OwnFieldNames(ArchiveOf(view)));
	ExpectRoundTrip(fixture, view);
	view.SetAlignment(B_ALIGN_CENTER);
	view.SetTruncation(B_TRUNCATE_MIDDLE);
	view.SetText(NULL);
	EXPECT_EQ("_truncation _align", OwnFieldNames(ArchiveOf(view)));
	ExpectRoundTrip(fixture, view);
}


TEST(StringView, ATextThatDoesNotFitIsCutAsItIsTold)
{
	ControlFixture fixture;
	BStringView* view =
		fixture.Add(new BStringView(BRect(10, 10, 69, 29), "s", "A text that does not fit"));
	EXPECT_EQ(static_cast<uint32>(B_NO_TRUNCATION), view->Truncation());
	const auto picture = [&] {
		std::string pixels;
		for (float y = 0; y <= 19; y++) {
			for (float x = 0; x <= 59; x++)
				pixels += static_cast<char>(fixture.driver.PixelAt(view, BPoint(x, y)).red);
		}
		return pixels;
	};
	const std::string whole = picture();
	std::vector<std::string> pictures = { whole };
	for (const uint32 mode : { B_TRUNCATE_END, B_TRUNCATE_MIDDLE, B_TRUNCATE_BEGINNING }) {
		fixture.Locked([&] { view->SetTruncation(mode); });
		EXPECT_EQ(mode, view->Truncation());
		for (const std::string& other : pictures)
			EXPECT_NE(other, picture()) << mode;
		pictures.push_back(picture());
	}
	fixture.Locked([&] { view->SetTruncation(B_NO_TRUNCATION); });
	EXPECT_EQ(whole, picture());
}


TEST(StringView, ResizeToPreferredShowsItsText)
{
	ControlFixture fixture;
	BStringView* view = fixture.Add(new BStringView(BRect(10, 10, 20, 20), "s", "A longer text"));
	fixture.Locked([&] {
		view->ResizeToPreferred();
		float width, height;
		view->GetPreferredSize(&width, &height);
		EXPECT_EQ(width, view->Frame().Width());
		EXPECT_EQ(height, view->Frame().Height());
		EXPECT_GE(width, view->StringWidth("A longer text"));
	});
}
