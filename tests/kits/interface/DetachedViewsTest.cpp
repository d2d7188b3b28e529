// Views that are in no window: everything may be called, and what needs a window does nothing.
#include <limits>
#include <memory>
#include <vector>

#include <Application.h>
#include <InterfaceKit.h>
#include <gtest/gtest.h>

#include "support/Dump.h"

namespace {

const BRect kFrame(10, 10, 109, 39);

constexpr const char* kKeys[] = { "\n", " ", "\t", "\x1b", "\x08", "\x7f", "\x1c", "\x1d", "\x1e",
	"\x1f", "\x01", "\x04", "\x0b", "\x0c", "a" };


class DetachedViews : public testing::TestWithParam<BView* (*)()> {
public:
	BApplication app { "application/x-vnd.Archway-test" };
	std::unique_ptr<BView> view { GetParam()() };
};


void
UseInput(BView* view)
{
	for (const char* key : kKeys) {
		view->KeyDown(key, 1);
		view->KeyUp(key, 1);
	}
	view->MouseDown(BPoint(5, 5));
	view->MouseMoved(BPoint(6, 6), B_INSIDE_VIEW, nullptr);
	view->MouseUp(BPoint(6, 6));
	view->MakeFocus(true);
	view->WindowActivated(true);
	view->FrameMoved(BPoint(1, 1));
	view->FrameResized(9, 9);
	view->Pulse();
}

// Values that count as none, in the field and behind it.
void
PutNoNumbers(BMessage* archive, const char* name, type_code type, size_t floats)
{
	const std::vector<float> none(floats, std::numeric_limits<float>::quiet_NaN());
	const auto size = static_cast<ssize_t>(floats * sizeof(float));
	archive->RemoveName(name);
	for (int32 i = 0; i < 4; i++)
		ASSERT_EQ(B_OK, archive->AddData(name, type, none.data(), size));
}

} // namespace


TEST_P(DetachedViews, WriteNumbersThatAreNoneAsTheyWere)
{
	BMessage usual;
	ASSERT_EQ(B_OK, view->Archive(&usual));
	for (const char* name : { "_scale", "_psize", "_lmmiter" })
		usual.AddFloat(name, 1);
	usual.AddInt16("_lmcapjoin", B_BUTT_CAP);
	usual.AddInt16("_lmcapjoin", B_MITER_JOIN);
	for (const char* name : { "_origin", "_ploc" })
		usual.AddPoint(name, BPoint(0, 0));

	char* name;
	type_code type;
	for (int32 i = 0; usual.GetInfo(B_ANY_TYPE, i, &name, &type) == B_OK; i++) {
		const size_t floats = type == B_FLOAT_TYPE ? 1
			: type == B_POINT_TYPE                 ? 2
			: type == B_RECT_TYPE                  ? 4
												   : 0;
		if (floats == 0)
			continue;
		SCOPED_TRACE(name);
		BMessage archive(usual);
		PutNoNumbers(&archive, name, type, floats);
		BMessage read(archive);
		const std::unique_ptr<BArchivable> object(instantiate_object(&read));
		ASSERT_NE(nullptr, object);
		BMessage written;
		ASSERT_EQ(B_OK, object->Archive(&written));
		EXPECT_EQ("", test::first_difference(archive, written));
	}
}


TEST_P(DetachedViews, TakeInputWithoutAWindow)
{
	UseInput(view.get());
	EXPECT_FALSE(view->IsFocus());
	EXPECT_EQ(nullptr, view->Window());
}


TEST_P(DetachedViews, AnswerGettersAndIgnoreDrawing)
{
	view->Draw(view->Bounds());
	view->Invalidate();
	BRegion region(kFrame);
	view->GetClippingRegion(&region);
	EXPECT_EQ(0, region.CountRects());
	EXPECT_FALSE(view->RemoveSelf());

	BPoint where(7, 8);
	view->ConvertToScreen(&where);
	EXPECT_EQ(BPoint(7, 8), where);

	view->GetPreferredSize(nullptr, nullptr);
	view->ResizeToPreferred();
	const int32 hidden = view->IsHidden() ? 1 : 0;
	view->Hide();
	EXPECT_TRUE(view->IsHidden());
	view->Show();
	EXPECT_EQ(hidden, view->IsHidden() ? 1 : 0);
}


INSTANTIATE_TEST_SUITE_P(Classes, DetachedViews,
	testing::Values(
		+[]() -> BView* { return new BView(kFrame, nullptr, 0, B_WILL_DRAW); },
		+[]() -> BView* { return new BBox(kFrame); },
		+[]() -> BView* { return new BButton(kFrame, nullptr, nullptr, nullptr); },
		+[]() -> BView* { return new BChannelSlider(kFrame, nullptr, nullptr, nullptr, 2); },
		+[]() -> BView* { return new BCheckBox(kFrame, nullptr, nullptr, nullptr); },
		+[]() -> BView* { return new BColorControl(BPoint(0, 0), B_CELLS_32x8, 8, nullptr); },
		+[]() -> BView* { return new BDragger(kFrame, nullptr); },
		+[]() -> BView* { return new BListView(kFrame, nullptr); },
		+[]() -> BView* { return new BMenuBar(kFrame, nullptr); },
		+[]() -> BView* {
			return new BMenuField(kFrame, nullptr, nullptr, new BPopUpMenu("menu"));
		},
		+[]() -> BView* { return new BOptionPopUp(kFrame, nullptr, nullptr, nullptr); },
		+[]() -> BView* { return new BOutlineListView(kFrame, nullptr); },
		+[]() -> BView* { return new BPictureButton(kFrame, nullptr, nullptr); },
		+[]() -> BView* { return new BRadioButton(kFrame, nullptr, nullptr, nullptr); },
		+[]() -> BView* { return new BScrollBar(kFrame, nullptr, nullptr, 0, 9, B_VERTICAL); },
		+[]() -> BView* { return new BScrollView(nullptr, nullptr); },
		+[]() -> BView* { return new BSeparatorView("label"); },
		+[]() -> BView* { return new BSlider(kFrame, nullptr, nullptr, nullptr, 3, 3); },
		+[]() -> BView* { return new BStatusBar(kFrame, nullptr); },
		+[]() -> BView* { return new BStringView(kFrame, nullptr, nullptr); },
		+[]() -> BView* { return new BTabView(kFrame, nullptr); },
		+[]() -> BView* { return new BTextControl(kFrame, nullptr, nullptr, nullptr, nullptr); },
		+[]() -> BView* { return new BTextView(kFrame, nullptr, BRect(), B_FOLLOW_ALL); }));
