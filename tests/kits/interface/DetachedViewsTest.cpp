// Views that are in no window: everything may be called, and what needs a window does nothing.
#include <memory>

#include <Application.h>
#include <InterfaceKit.h>
#include <gtest/gtest.h>

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

} // namespace


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
