// Every class passes on what its base does, and calls the hooks of a class made from it.
#include <functional>
#include <memory>

#include <Box.h>
#include <Button.h>
#include <ChannelSlider.h>
#include <CheckBox.h>
#include <ColorControl.h>
#include <Dragger.h>
#include <ListView.h>
#include <MenuBar.h>
#include <MenuField.h>
#include <MenuItem.h>
#include <OptionPopUp.h>
#include <OutlineListView.h>
#include <PictureButton.h>
#include <RadioButton.h>
#include <ScrollBar.h>
#include <ScrollView.h>
#include <SeparatorView.h>
#include <Slider.h>
#include <StatusBar.h>
#include <StringView.h>
#include <TabView.h>
#include <TextControl.h>
#include <TextView.h>

#include "ControlFixture.h"

namespace {


struct HookCounts {
	int attached = 0, allAttached = 0, detached = 0, allDetached = 0;
	int moved = 0, resized = 0, active = 0, inactive = 0;
};


template<class View> class Hooked : public View {
public:
	template<class... Arguments>
	explicit Hooked(HookCounts& counts, Arguments... arguments) :
		View(arguments...), fCounts(counts)
	{
	}

	void AttachedToWindow() override
	{
		fCounts.attached++;
		View::AttachedToWindow();
		EXPECT_NE(nullptr, this->Window());
	}

	void AllAttached() override
	{
		fCounts.allAttached++;
		View::AllAttached();
	}

	void DetachedFromWindow() override
	{
		fCounts.detached++;
		EXPECT_NE(nullptr, this->Window());
		View::DetachedFromWindow();
	}

	void AllDetached() override
	{
		fCounts.allDetached++;
		View::AllDetached();
	}

	void FrameMoved(BPoint place) override
	{
		fCounts.moved++;
		View::FrameMoved(place);
	}

	void FrameResized(float width, float height) override
	{
		fCounts.resized++;
		View::FrameResized(width, height);
	}

	void WindowActivated(bool active) override
	{
		(active ? fCounts.active : fCounts.inactive)++;
		View::WindowActivated(active);
	}

private:
	HookCounts& fCounts;
};


const BRect kFrame(20, 20, 119, 59);


void
ExpectHooks(const char* name, const std::function<BView*(HookCounts&)>& make)
{
	SCOPED_TRACE(name);
	ControlFixture fixture;
	BWindow* other = new BWindow(BRect(600, 50, 700, 150), "Other", B_TITLED_WINDOW, 0);
	other->Show();
	fixture.driver.ActivateWindow(fixture.window);

	HookCounts counts;
	std::unique_ptr<BView> view(make(counts));
	view->SetFlags(view->Flags() | B_FRAME_EVENTS);
	fixture.Add(view.get());
	EXPECT_EQ(1, counts.attached);
	EXPECT_EQ(1, counts.allAttached);

	const HookCounts before = counts;
	fixture.Locked([&] { view->ResizeTo(view->Frame().Width() + 7, view->Frame().Height() + 5); });
	EXPECT_EQ(before.resized + 1, counts.resized);
	EXPECT_EQ(before.moved, counts.moved);
	fixture.Locked([&] { view->MoveBy(3, 4); });
	EXPECT_EQ(before.moved + 1, counts.moved);

	fixture.driver.ActivateWindow(other);
	EXPECT_EQ(before.inactive + 1, counts.inactive);
	fixture.driver.ActivateWindow(fixture.window);
	EXPECT_EQ(before.active + 1, counts.active);

	fixture.Locked([&] { view->RemoveSelf(); });
	EXPECT_EQ(1, counts.detached);
	EXPECT_EQ(1, counts.allDetached);
	EXPECT_EQ(nullptr, view->Window());
	BMessenger(other).SendMessage(B_QUIT_REQUESTED);
	Driver::WaitUntilIdle();
}

} // namespace


TEST(ViewHooks, OfGroupsAndTextsAreCalled)
{
	// By AddChild(), RemoveSelf(), MoveBy(), ResizeTo() and ActivateWindow().
	ExpectHooks("BView", [](HookCounts& counts) {
		return new Hooked<BView>(counts, kFrame, "view", B_FOLLOW_NONE, B_WILL_DRAW);
	});
	ExpectHooks("BBox", [](HookCounts& counts) { return new Hooked<BBox>(counts, kFrame, "box"); });
	ExpectHooks("BStringView",
		[](HookCounts& counts) { return new Hooked<BStringView>(counts, kFrame, "text", "Text"); });
	ExpectHooks("BSeparatorView",
		[](HookCounts& counts) { return new Hooked<BSeparatorView>(counts, "line", "Label"); });
	ExpectHooks("BStatusBar",
		[](HookCounts& counts) { return new Hooked<BStatusBar>(counts, kFrame, "bar", "Label"); });
	ExpectHooks("BDragger", [](HookCounts& counts) {
		return new Hooked<BDragger>(counts, kFrame, static_cast<BView*>(nullptr));
	});
	ExpectHooks("BTextView", [](HookCounts& counts) {
		return new Hooked<BTextView>(
			counts, kFrame, "text", kFrame.OffsetToCopy(0, 0), B_FOLLOW_NONE, B_WILL_DRAW);
	});
}


TEST(ViewHooks, OfControlsAreCalled)
{
	// By AddChild(), RemoveSelf(), MoveBy(), ResizeTo() and ActivateWindow().
	ExpectHooks("BButton", [](HookCounts& counts) {
		return new Hooked<BButton>(counts, kFrame, "b", "Label", nullptr);
	});
	ExpectHooks("BCheckBox", [](HookCounts& counts) {
		return new Hooked<BCheckBox>(counts, kFrame, "b", "Label", nullptr);
	});
	ExpectHooks("BRadioButton", [](HookCounts& counts) {
		return new Hooked<BRadioButton>(counts, kFrame, "b", "Label", nullptr);
	});
	ExpectHooks("BTextControl", [](HookCounts& counts) {
		return new Hooked<BTextControl>(counts, kFrame, "t", "Label", "Text", nullptr);
	});
	ExpectHooks("BSlider", [](HookCounts& counts) {
		return new Hooked<BSlider>(counts, kFrame, "s", "Label", nullptr, 0, 10);
	});
	ExpectHooks("BOptionPopUp", [](HookCounts& counts) {
		return new Hooked<BOptionPopUp>(counts, kFrame, "o", "Label", nullptr);
	});
	ExpectHooks("BChannelSlider", [](HookCounts& counts) {
		return new Hooked<BChannelSlider>(counts, kFrame, "c", "Label", nullptr, 3);
	});
	ExpectHooks("BColorControl", [](HookCounts& counts) {
		return new Hooked<BColorControl>(counts, BPoint(20, 20), B_CELLS_32x8, 6.0f, "c");
	});
	ExpectHooks("BControl", [](HookCounts& counts) {
		return new Hooked<BControl>(
			counts, kFrame, "c", "Label", nullptr, uint32(B_FOLLOW_NONE), uint32(B_WILL_DRAW));
	});
}


TEST(ViewHooks, OfListsMenusAndBarsAreCalled)
{
	// By AddChild(), RemoveSelf(), MoveBy(), ResizeTo() and ActivateWindow().
	ExpectHooks("BListView",
		[](HookCounts& counts) { return new Hooked<BListView>(counts, kFrame, "list"); });
	ExpectHooks("BOutlineListView",
		[](HookCounts& counts) { return new Hooked<BOutlineListView>(counts, kFrame, "list"); });
	ExpectHooks("BTabView",
		[](HookCounts& counts) { return new Hooked<BTabView>(counts, kFrame, "tabs"); });
	ExpectHooks("BScrollView", [](HookCounts& counts) {
		BView* target = new BView(kFrame, "target", 0, B_WILL_DRAW);
		return new Hooked<BScrollView>(counts, "scroller", target);
	});
	ExpectHooks("BScrollBar", [](HookCounts& counts) {
		return new Hooked<BScrollBar>(counts, kFrame, "bar", nullptr, 0, 10, B_VERTICAL);
	});
	ExpectHooks("BMenuField", [](HookCounts& counts) {
		return new Hooked<BMenuField>(counts, kFrame, "field", "Label", new BMenu("menu"));
	});
	ExpectHooks("BMenuBar", [](HookCounts& counts) {
		return new Hooked<BMenuBar>(
			counts, kFrame, "bar", uint32(B_FOLLOW_NONE), B_ITEMS_IN_ROW, false);
	});
}


namespace {

template<class View> class Pulsing : public View {
public:
	template<class... Arguments>
	explicit Pulsing(sem_id came, Arguments... arguments) : View(arguments...), fCame(came)
	{
		this->SetFlags(this->Flags() | B_PULSE_NEEDED);
	}

	void Pulse() override
	{
		View::Pulse();
		release_sem(fCame);
	}

private:
	sem_id fCame;
};

} // namespace


TEST(ViewHooks, PulseComesToABSliderABScrollBarAndABTabViewThatNeedIt)
{
	ControlFixture fixture;
	fixture.Locked([&] { fixture.window->SetPulseRate(10000); });
	const auto expectPulse = [&](sem_id came, BView* view) {
		fixture.Add(view);
		EXPECT_EQ(B_OK, acquire_sem_etc(came, 2, B_RELATIVE_TIMEOUT, 20000000)) << view->Name();
		fixture.Locked([&] { view->RemoveSelf(); });
		delete view;
		delete_sem(came);
	};
	const auto newSem = [] { return create_sem(0, "pulses"); };
	sem_id came = newSem();
	expectPulse(came, new Pulsing<BSlider>(came, kFrame, "slider", "Label", nullptr, 0, 10));
	came = newSem();
	expectPulse(came, new Pulsing<BScrollBar>(came, kFrame, "bar", nullptr, 0, 10, B_VERTICAL));
	came = newSem();
	expectPulse(came, new Pulsing<BTabView>(came, kFrame, "tabs"));
	fixture.Locked([&] { fixture.window->SetPulseRate(0); });
}


TEST(ViewHooks, AnUnknownPerformIsRefusedByEveryClass)
{
	BApplication app("application/x-vnd.Archway-test");
	BView view(kFrame, "", 0, 0);
	BBox box(kFrame);
	BButton button(kFrame, "", "", NULL);
	BCheckBox check(kFrame, "", "", NULL);
	BRadioButton radio(kFrame, "", "", NULL);
	BTextControl field(kFrame, "", "", "", NULL);
	BSlider slider(kFrame, "", "", NULL, 0, 1);
	BColorControl color(BPoint(0, 0), B_CELLS_16x16, 4, "");
	BStatusBar status(kFrame, "");
	BStringView string(kFrame, "", "");
	BTextView text(kFrame, "", kFrame, 0, 0);
	BListView list(kFrame, "");
	BOutlineListView outline(kFrame, "");
	BTabView tabs(kFrame, "");
	BScrollView scroller("", NULL);
	BScrollBar bar(kFrame, "", NULL, 0, 1, B_VERTICAL);
	BMenuField menuField(kFrame, "", "", new BMenu(""));
	BMenuBar menuBar(kFrame, "");
	BView* const views[] = { &view, &box, &button, &check, &radio, &field, &slider, &color, &status,
		&string, &text, &list, &outline, &tabs, &scroller, &bar, &menuField, &menuBar };
	for (BView* each : views)
		EXPECT_EQ(B_ERROR, each->Perform('none', NULL)) << typeid(*each).name();
	BControl* const controls[] = { &button, &field, &slider, &color };
	for (BControl* each : controls)
		EXPECT_EQ(B_ERROR, each->Perform('none', NULL));
	BTab tab;
	EXPECT_EQ(B_ERROR, tab.Perform('none', NULL));
}
