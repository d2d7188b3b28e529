// What views hear of the pointer's way: entered, inside, exited, outside.
#include <random>
#include <string>
#include <vector>

#include <Cursor.h>
#include <View.h>

#include "ControlFixture.h"

namespace {

using Log = std::vector<std::string>;


class WatchingView : public BView {
public:
	WatchingView(const char* name, BRect frame, Log& log) :
		BView(frame, name, B_FOLLOW_NONE, B_WILL_DRAW), fLog(log)
	{
	}

	void MouseDown(BPoint) override { SetMouseEventMask(mask, options); }

	void MouseMoved(BPoint where, uint32 transit, const BMessage*) override
	{
		static const char* const kNames[] = { " entered", " inside", " exited", " outside" };
		fLog.push_back(Name() + std::string(kNames[transit]));
		if (transit == B_ENTERED_VIEW || transit == B_INSIDE_VIEW) {
			EXPECT_TRUE(Bounds().Contains(where)) << Name();
		}
	}

	void KeyDown(const char* bytes, int32) override
	{
		fLog.push_back(Name() + std::string(" key ") + bytes);
	}

	uint32 mask = 0, options = 0;

private:
	Log& fLog;
};


// Two views beside each other, the second with a child.
class Transit : public testing::Test {
protected:
	void SetUp() override
	{
		left = fixture.Add(new WatchingView("left", BRect(20, 20, 119, 119), log));
		right = fixture.Add(new WatchingView("right", BRect(140, 20, 299, 119), log));
		child = new WatchingView("child", BRect(40, 40, 99, 79), log);
		fixture.Locked([this] { right->AddChild(child); });
		fixture.driver.MoveTo(BPoint(1000, 800));
		log.clear();
	}

	Log MovedTo(BPoint screen)
	{
		fixture.driver.MoveTo(screen);
		return std::move(log);
	}

	Log MovedTo(BView* view) { return MovedTo(Driver::PointIn(view, BPoint(5, 5))); }

	ControlFixture fixture;
	Log log;
	WatchingView* left;
	WatchingView* right;
	WatchingView* child;
};


std::string
Code(bool was, bool is)
{
	return is ? (was ? " inside" : " entered") : (was ? " exited" : " outside");
}

} // namespace


TEST_F(Transit, OnlyTheViewsUnderThePointerHear)
{
	EXPECT_EQ((Log { "left entered" }), MovedTo(left));
	EXPECT_EQ((Log { "left inside" }), MovedTo(Driver::PointIn(left, BPoint(9, 9))));
	EXPECT_EQ((Log { "left exited", "right entered" }), MovedTo(right));
	EXPECT_EQ((Log { "right exited", "child entered" }), MovedTo(child));
	EXPECT_EQ((Log { "child exited", "right entered" }), MovedTo(right));
	EXPECT_EQ((Log { "right exited" }), MovedTo(BPoint(1000, 800)));
	EXPECT_EQ((Log {}), MovedTo(BPoint(1010, 800)));
}


TEST_F(Transit, AMaskedViewHearsEverythingFirst)
{
	fixture.Locked([this] { left->SetEventMask(B_POINTER_EVENTS); });
	EXPECT_EQ((Log { "left outside", "right entered" }), MovedTo(right));
	EXPECT_EQ((Log { "left entered", "right exited" }), MovedTo(left));
	EXPECT_EQ((Log { "left exited" }), MovedTo(BPoint(1000, 800)));
	EXPECT_EQ((Log { "left outside" }), MovedTo(BPoint(1010, 800)));
	fixture.Locked([this] { left->SetEventMask(0); });
	EXPECT_EQ((Log {}), MovedTo(BPoint(1000, 800)));
}


TEST_F(Transit, AViewThatIsTakenOutOrHiddenHearsNoExit)
{
	MovedTo(left);
	fixture.Locked([this] { left->RemoveSelf(); });
	EXPECT_EQ((Log { "right entered" }), MovedTo(right));
	fixture.Locked([this] { right->Hide(); });
	log.clear();
	EXPECT_EQ((Log {}), MovedTo(BPoint(1000, 800)));
	delete left;
}


TEST_F(Transit, WalksFollowTheRule)
{
	std::mt19937 random(7);
	WatchingView* const views[] = { left, right, child };
	std::vector<WatchingView*> masked;
	BView* before = nullptr;
	BPoint last(1000, 800);
	for (int step = 0; step < 150; step++) {
		if (random() % 5 == 0) {
			WatchingView* view = views[random() % 3];
			const auto found = std::find(masked.begin(), masked.end(), view);
			const bool set = found == masked.end();
			fixture.Locked([&] { view->SetEventMask(set ? B_POINTER_EVENTS : 0); });
			if (set)
				masked.push_back(view);
			else
				masked.erase(found);
		}
		BPoint screen = Driver::PointIn(fixture.ground, BPoint(random() % 340, random() % 160));
		if (screen == last)
			screen.x++;
		last = screen;
		BView* under = fixture.Locked([&] {
			BView* found = fixture.window->FindView(fixture.window->ConvertFromScreen(screen));
			return found != fixture.ground ? found : nullptr;
		});

		const auto isMasked = [&](BView* view) {
			return std::find(masked.begin(), masked.end(), view) != masked.end();
		};
		Log expected;
		for (WatchingView* view : masked)
			expected.push_back(view->Name() + Code(view == before, view == under));
		if (before != nullptr && before != under && !isMasked(before))
			expected.push_back(std::string(before->Name()) + " exited");
		if (under != nullptr && !isMasked(under))
			expected.push_back(under->Name() + Code(under == before, true));
		ASSERT_EQ(expected, MovedTo(screen)) << "step " << step;
		before = under;
	}
}


TEST_F(Transit, APressMayKeepKeysFromTheFocusView)
{
	right->mask = B_POINTER_EVENTS;
	right->options = B_SUSPEND_VIEW_FOCUS;
	fixture.Focus(left);
	MovedTo(right);
	fixture.driver.Press();
	log.clear();
	fixture.driver.Key("a");
	EXPECT_EQ((Log {}), log);
	EXPECT_EQ((Log { "right exited" }), Log(MovedTo(BPoint(1000, 800))));
	fixture.driver.Release();
	log.clear();
	fixture.driver.Key("b");
	EXPECT_EQ((Log { "left key b" }), log);
}


TEST_F(Transit, TheCursorOfTheViewUnderThePointerIsShown)
{
	const BCursor cursor(B_CURSOR_ID_I_BEAM);
	const BPoint outside(1000, 800), inLeft = Driver::PointIn(left, BPoint(5, 5));
	const int32 plain = fixture.driver.CursorAt(outside);
	MovedTo(inLeft);
	EXPECT_EQ(plain, fixture.driver.CursorAt(inLeft));
	fixture.Locked([&] { left->SetViewCursor(&cursor); });
	EXPECT_EQ(static_cast<int32>(B_CURSOR_ID_I_BEAM), fixture.driver.CursorAt(inLeft));
	MovedTo(right);
	EXPECT_EQ(plain, fixture.driver.CursorAt(Driver::PointIn(right, BPoint(5, 5))));
	MovedTo(inLeft);
	EXPECT_EQ(static_cast<int32>(B_CURSOR_ID_I_BEAM), fixture.driver.CursorAt(inLeft));
	fixture.Locked([&] { left->SetViewCursor(NULL); });
	EXPECT_EQ(plain, fixture.driver.CursorAt(inLeft));
}


TEST_F(Transit, GetMouseTellsPlaceAndButtons)
{
	MovedTo(left);
	BPoint where;
	uint32 buttons = 99;
	fixture.Locked([&] { left->GetMouse(&where, &buttons, false); });
	EXPECT_EQ(BPoint(5, 5), where);
	EXPECT_EQ(0u, buttons);
	fixture.driver.Press(2);
	fixture.Locked([&] { right->GetMouse(&where, &buttons, false); });
	EXPECT_EQ(BPoint(25, 25) - BPoint(140, 20), where);
	EXPECT_EQ(static_cast<uint32>(B_SECONDARY_MOUSE_BUTTON), buttons);
	fixture.driver.Release(2);
	fixture.Locked([&] { left->GetMouse(NULL, &buttons, false); });
	EXPECT_EQ(0u, buttons);
}


TEST_F(Transit, ATrackedRectangleFollowsThePointer)
{
	const rgb_color white = { 255, 255, 255, 255 }, black = { 0, 0, 0, 255 };
	const auto at = [this](float x, float y) { return fixture.driver.PixelAt(left, BPoint(x, y)); };
	MovedTo(Driver::PointIn(left, BPoint(10, 10)));
	fixture.Locked([this] { left->BeginRectTracking(BRect(5, 5, 24, 24)); });
	EXPECT_EQ(black, at(5, 5));
	EXPECT_EQ(black, at(24, 14));
	EXPECT_EQ(white, at(14, 14)) << "the outline alone";
	MovedTo(Driver::PointIn(left, BPoint(40, 30)));
	EXPECT_EQ(white, at(5, 5));
	EXPECT_EQ(black, at(35, 25));
	EXPECT_EQ(black, at(54, 44));
	fixture.Locked([this] { left->Invalidate(); });
	EXPECT_EQ(black, at(35, 25)) << "an update keeps it";
	fixture.Locked([this] { left->EndRectTracking(); });
	EXPECT_EQ(white, at(35, 25));
	MovedTo(Driver::PointIn(left, BPoint(10, 10)));
	EXPECT_EQ(white, at(5, 5));

	fixture.Locked([this] { left->BeginRectTracking(BRect(5, 5, 10, 10), B_TRACK_RECT_CORNER); });
	MovedTo(Driver::PointIn(left, BPoint(60, 50)));
	EXPECT_EQ(black, at(5, 5));
	EXPECT_EQ(black, at(60, 50));
	fixture.Locked([this] { left->EndRectTracking(); });
}
