#include <SeparatorView.h>

#include <limits>

#include <StringView.h>

#include "ControlFixture.h"

namespace {

const rgb_color kPanel = { 216, 216, 216, 255 };
const BRect kFrame(20, 20, 119, 40);


BSeparatorView*
Placed(BSeparatorView* line, BRect frame = kFrame)
{
	line->MoveTo(frame.LeftTop());
	line->ResizeTo(frame.Width(), frame.Height());
	return line;
}


// How many of the columns (or rows) of the view's own middle line are drawn on.
int
CountDrawn(ControlFixture& fixture, BView* view, bool upright)
{
	const BRect bounds = fixture.Locked([&] { return view->Bounds(); });
	int drawn = 0;
	for (float i = 0; i <= (upright ? bounds.bottom : bounds.right); i++) {
		const BPoint where = upright ? BPoint(bounds.right / 2, i) : BPoint(i, bounds.bottom / 2);
		drawn += fixture.driver.PixelAt(view, where) != kPanel ? 1 : 0;
	}
	return drawn;
}

} // namespace


TEST(SeparatorView, HasTheDefaultsOfItsClass)
{
	BApplication app("application/x-vnd.Archway-test");
	BSeparatorView plain(B_VERTICAL);
	EXPECT_EQ(nullptr, plain.Name());
	EXPECT_EQ(nullptr, plain.Label());
	EXPECT_EQ(nullptr, plain.LabelView());
	const BMessage archive = ArchiveOf(plain);
	EXPECT_EQ(static_cast<int32>(B_VERTICAL), archive.GetInt32("_orientation", -1));
	EXPECT_EQ(B_PLAIN_BORDER, archive.GetInt32("_border", -1));
	BSeparatorView named("name", "Label");
	EXPECT_STREQ("name", named.Name());
	EXPECT_STREQ("Label", named.Label());
	BSeparatorView labelled("Label");
	EXPECT_EQ(nullptr, labelled.Name());
	EXPECT_STREQ("Label", labelled.Label());
	BStringView* view = new BStringView(BRect(0, 0, 29, 14), NULL, "text");
	BSeparatorView viewed(view);
	EXPECT_EQ(view, viewed.LabelView());
	EXPECT_EQ(nullptr, viewed.Label());
	EXPECT_NE(B_OK, viewed.Perform(0, NULL));
}


TEST(SeparatorView, DrawsALineAcross)
{
	ControlFixture fixture;
	BSeparatorView* line = fixture.Add(Placed(new BSeparatorView(B_HORIZONTAL)));
	EXPECT_EQ(100, CountDrawn(fixture, line, false));
	EXPECT_EQ(1, CountDrawn(fixture, line, true));
	fixture.Locked([&] { line->SetBorderStyle(B_FANCY_BORDER); });
	EXPECT_EQ(2, CountDrawn(fixture, line, true));
	fixture.Locked([&] { line->SetBorderStyle(B_NO_BORDER); });
	EXPECT_EQ(0, CountDrawn(fixture, line, false));
	fixture.Locked([&] {
		line->SetBorderStyle(B_FANCY_BORDER);
		line->SetOrientation(B_VERTICAL);
	});
	EXPECT_EQ(21, CountDrawn(fixture, line, true));
	EXPECT_EQ(2, CountDrawn(fixture, line, false));
}


TEST(SeparatorView, LeavesRoomForItsLabel)
{
	ControlFixture fixture;
	BStringView* label = new BStringView(BRect(0, 0, 29, 10), NULL, "");
	BSeparatorView* line = fixture.Add(Placed(new BSeparatorView("line", label)));
	const auto place = [&](alignment horizontal, vertical_alignment vertical) {
		return fixture.Locked([&] {
			line->SetAlignment(BAlignment(horizontal, vertical));
			return label->Frame().LeftTop();
		});
	};
	EXPECT_EQ(BPoint(35, 5), place(B_ALIGN_HORIZONTAL_CENTER, B_ALIGN_MIDDLE));
	// A gap of 5 pixels on both sides.
	EXPECT_EQ(62, CountDrawn(fixture, line, false));
	EXPECT_EQ(BPoint(15, 0), place(B_ALIGN_LEFT, B_ALIGN_TOP));
	EXPECT_EQ(BPoint(55, 10), place(B_ALIGN_RIGHT, B_ALIGN_BOTTOM));
	fixture.Locked([&] { line->ResizeBy(40, 0); });
	fixture.Locked([&] { EXPECT_EQ(BPoint(95, 10), label->Frame().LeftTop()); });
}


TEST(SeparatorView, ChangesItsLabel)
{
	ControlFixture fixture;
	BSeparatorView* line = fixture.Add(Placed(new BSeparatorView("line", "First")));
	float width, height, shorter;
	fixture.Locked([&] {
		line->GetPreferredSize(&width, &height);
		EXPECT_GT(height, 5);
		line->SetLabel("1");
		line->GetPreferredSize(&shorter, NULL);
		EXPECT_LT(shorter, width);
		BStringView* first = new BStringView(BRect(0, 0, 29, 10), "first", "");
		line->SetLabel(first, true);
		EXPECT_EQ(first, line->LabelView());
		EXPECT_EQ(nullptr, line->Label());
		BStringView* second = new BStringView(BRect(0, 0, 29, 10), NULL, "");
		line->SetLabel(second, false);
		EXPECT_EQ(nullptr, first->Parent());
		delete first;
		EXPECT_NE(nullptr, second->Name());
		line->SetLabel("text again");
		EXPECT_EQ(0, line->CountChildren());
		EXPECT_EQ(nullptr, line->LabelView());
		EXPECT_STREQ("text again", line->Label());
		line->SetLabel(NULL);
		EXPECT_EQ(nullptr, line->Label());
		// A label view may be taken out by others.
		BStringView* third = new BStringView(BRect(0, 0, 29, 10), "third", "");
		line->SetLabel(third, true);
		third->RemoveSelf();
		delete third;
		EXPECT_EQ(nullptr, line->LabelView());
	});
	EXPECT_EQ(100, CountDrawn(fixture, line, false));
}


TEST(SeparatorView, RevivesWhatItWrote)
{
	ControlFixture fixture;
	BSeparatorView line(
		"line", "Label", B_VERTICAL, B_NO_BORDER, BAlignment(B_ALIGN_RIGHT, B_ALIGN_TOP));
	const BMessage archive = ArchiveOf(line);
	EXPECT_EQ("_label _orientation _halignment _valignment _border", OwnFieldNames(archive));
	EXPECT_EQ(B_ALIGN_RIGHT, archive.GetInt32("_halignment", -1));
	EXPECT_EQ(B_ALIGN_TOP, archive.GetInt32("_valignment", -1));
	EXPECT_STREQ("Label", Revive<BSeparatorView>(archive)->Label());
	ExpectRoundTrip(fixture, line);

	line.SetLabel(new BStringView(BRect(0, 0, 29, 10), "label", "Text"), true);
	const BMessage viewed = ArchiveOf(line);
	EXPECT_EQ("_labelview _orientation _halignment _valignment _border", OwnFieldNames(viewed));
	const auto revived = Revive<BSeparatorView>(viewed);
	ASSERT_NE(nullptr, revived->LabelView());
	EXPECT_STREQ("label", revived->LabelView()->Name());
	ExpectRoundTrip(fixture, line);
	revived->SetLabel("Label");
	EXPECT_FALSE(ArchiveOf(*revived).HasString("_labelview"));
}


TEST(SeparatorView, KeepsWhatItCannotUse)
{
	ControlFixture fixture;
	const BMessage archive = ArchiveOf(BSeparatorView("line", "Label"));
	BMessage lost = archive;
	lost.AddString("_labelview", "no child of this name");
	ExpectArchiveRoundTrip<BSeparatorView>(fixture, lost);
	for (const char* name : { "_label", "_orientation", "_halignment", "_valignment", "_border" }) {
		SCOPED_TRACE(name);
		BMessage changed = archive;
		changed.RemoveName(name);
		ExpectArchiveRoundTrip<BSeparatorView>(fixture, changed);
		changed.AddInt8(name, 5);
		ExpectArchiveRoundTrip<BSeparatorView>(fixture, changed);
		for (const int32 value : { -3, 2, 0x12345678, std::numeric_limits<int32>::min() }) {
			changed.RemoveName(name);
			changed.AddInt32(name, value);
			changed.AddInt32(name, 1);
			ExpectArchiveRoundTrip<BSeparatorView>(fixture, changed);
		}
		for (const BRect frame : { BRect(0, 0, -1, -1), BRect(0, 0, 0, 0), BRect(9, 9, 3, 3),
				 BRect(-1e30f, -1e30f, 1e30f, 1e30f) }) {
			changed.ReplaceRect("_frame", frame);
			ExpectArchiveRoundTrip<BSeparatorView>(fixture, changed);
		}
	}
}
