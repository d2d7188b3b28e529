#include "kits/server/DesktopFixture.h"

#include <InterfaceDefs.h>

namespace BPrivate {

using PointerInput = DesktopTest;


TEST_F(PointerInput, PressTellsEverythingAboutItself)
{
	TestWindow window(BRect(100, 50, 299, 249));
	Settle();
	window.Take();
	input.SetModifiers(B_SHIFT_KEY);
	input.Move(BPoint(120, 80));
	input.Press(2);
	Settle();

	const Messages downs = window.Take(B_MOUSE_DOWN);
	ASSERT_EQ(1u, downs.size());
	const BMessage& down = *downs[0];
	EXPECT_EQ(BPoint(20, 30), down.FindPoint("where"));
	EXPECT_EQ(BPoint(120, 80), down.FindPoint("screen_where"));
	EXPECT_EQ(2, down.FindInt32("buttons"));
	EXPECT_EQ(1, down.FindInt32("clicks"));
	EXPECT_EQ(B_SHIFT_KEY | B_LEFT_SHIFT_KEY, down.FindInt32("modifiers"));
	EXPECT_GT(down.FindInt64("when"), 0);
	EXPECT_FALSE(IsElsewhere(down));
}


TEST_F(PointerInput, PressesInOneGestureAreCounted)
{
	TestWindow window(BRect(0, 0, 99, 99));
	input.BeginGesture();
	input.Move(BPoint(10, 10));
	for (int i = 0; i < 3; i++) {
		input.Press(1);
		input.Release(1);
	}
	Settle();

	const Messages downs = window.Take(B_MOUSE_DOWN);
	ASSERT_EQ(3u, downs.size());
	for (int32 i = 0; i < 3; i++)
		EXPECT_EQ(i + 1, downs[i]->FindInt32("clicks"));
}


TEST_F(PointerInput, AnotherPlaceButtonOrGestureBeginsTheCountAgain)
{
	TestWindow window(BRect(0, 0, 99, 99));
	const auto press = [this](BPoint where, uint32 button) {
		input.Move(where);
		input.Press(button);
		input.Release(button);
	};
	input.BeginGesture();
	press(BPoint(10, 10), 1);
	press(BPoint(30, 10), 1);
	press(BPoint(30, 10), 2);
	input.BeginGesture();
	press(BPoint(30, 10), 2);
	Settle();

	const Messages downs = window.Take(B_MOUSE_DOWN);
	ASSERT_EQ(4u, downs.size());
	for (const std::unique_ptr<BMessage>& down : downs)
		EXPECT_EQ(1, down->FindInt32("clicks"));
}


TEST_F(PointerInput, SecondButtonSendsNothingUntilAllAreReleased)
{
	TestWindow window(BRect(0, 0, 99, 99));
	input.Move(BPoint(10, 10));
	Settle();
	window.Take();
	input.Press(1);
	input.Press(2);
	input.Release(1);
	Settle();
	Messages messages = window.Take();
	ASSERT_EQ(1u, messages.size());
	EXPECT_EQ(uint32(B_MOUSE_DOWN), messages[0]->what);

	input.Release(2);
	Settle();
	messages = window.Take();
	ASSERT_EQ(1u, messages.size());
	EXPECT_EQ(uint32(B_MOUSE_UP), messages[0]->what);
	EXPECT_EQ(0, messages[0]->FindInt32("buttons"));
}


TEST_F(PointerInput, PressHoldsThePointerForItsWindow)
{
	TestWindow left(BRect(0, 0, 99, 99)), right(BRect(200, 0, 299, 99));
	left.server.Activate();
	input.Move(BPoint(50, 50));
	input.Press(1);
	Settle();
	left.Take();
	right.Take();

	input.Move(BPoint(250, 50));
	Settle();
	const Messages moves = left.Take(B_MOUSE_MOVED);
	ASSERT_EQ(1u, moves.size());
	EXPECT_TRUE(IsElsewhere(*moves[0]));
	EXPECT_EQ(BPoint(250, 50), moves[0]->FindPoint("where"));
	EXPECT_EQ(1, moves[0]->FindInt32("buttons"));
	EXPECT_TRUE(right.Take().empty());

	input.Release(1);
	Settle();
	const Messages ups = left.Take(B_MOUSE_UP);
	ASSERT_EQ(1u, ups.size());
	EXPECT_TRUE(IsElsewhere(*ups[0]));
	// The pointer is free again, and rests on the other window.
	const Messages after = right.Take();
	ASSERT_EQ(1u, after.size());
	EXPECT_EQ(uint32(B_MOUSE_MOVED), after[0]->what);
}


TEST_F(PointerInput, WindowIsToldOnceThatThePointerLeftIt)
{
	TestWindow left(BRect(0, 0, 99, 99)), right(BRect(200, 0, 299, 99));
	input.Move(BPoint(50, 50));
	Settle();
	left.Take();
	input.Move(BPoint(250, 50));
	input.Move(BPoint(251, 50));
	Settle();

	const Messages moves = left.Take(B_MOUSE_MOVED);
	ASSERT_EQ(1u, moves.size());
	EXPECT_TRUE(IsElsewhere(*moves[0]));
	EXPECT_EQ(2u, right.Take(B_MOUSE_MOVED).size());
}


TEST_F(PointerInput, FrontmostWindowIsUnderThePointer)
{
	input.Move(BPoint(500, 500));
	TestWindow back(BRect(0, 0, 99, 99)), front(BRect(50, 0, 149, 99));
	Settle();
	back.Take();
	front.Take();
	input.Move(BPoint(75, 50));
	Settle();
	EXPECT_TRUE(back.Take(B_MOUSE_MOVED).empty());
	EXPECT_EQ(1u, front.Take(B_MOUSE_MOVED).size());
}


TEST_F(PointerInput, WatcherHearsOfEverythingElsewhere)
{
	TestWindow watcher(BRect(0, 0, 99, 99)), other(BRect(200, 0, 299, 99));
	watcher.server.SetWantsAllPointerEvents(true);
	Settle();
	watcher.Take();
	Click(BPoint(250, 50));

	const Messages messages = watcher.Take();
	ASSERT_EQ(3u, messages.size());
	EXPECT_EQ(uint32(B_MOUSE_MOVED), messages[0]->what);
	EXPECT_EQ(uint32(B_MOUSE_DOWN), messages[1]->what);
	EXPECT_EQ(uint32(B_MOUSE_UP), messages[2]->what);
	for (const std::unique_ptr<BMessage>& message : messages)
		EXPECT_TRUE(IsElsewhere(*message));
}


TEST_F(PointerInput, WheelGoesToTheWindowUnderThePointer)
{
	TestWindow window(BRect(0, 0, 99, 99));
	input.Move(BPoint(50, 50));
	input.Wheel(BPoint(0, 2));
	Settle();
	const Messages turns = window.Take(B_MOUSE_WHEEL_CHANGED);
	ASSERT_EQ(1u, turns.size());
	EXPECT_EQ(2, turns[0]->FindFloat("be:wheel_delta_y"));
	EXPECT_EQ(0, turns[0]->FindFloat("be:wheel_delta_x"));
}


TEST_F(PointerInput, WindowThatAppearsUnderTheRestingPointerIsTold)
{
	input.Move(BPoint(50, 50));
	Settle();
	TestWindow window(BRect(0, 0, 99, 99));
	Settle();
	const Messages moves = window.Take(B_MOUSE_MOVED);
	ASSERT_EQ(1u, moves.size());
	EXPECT_TRUE(moves[0]->FindBool("be:transit_only"));
}


TEST_F(PointerInput, WindowMayGoWhileItsButtonIsHeld)
{
	auto window = std::make_unique<TestWindow>(BRect(0, 0, 99, 99));
	TestWindow below(BRect(0, 0, 99, 99));
	window->server.Activate();
	input.Move(BPoint(50, 50));
	input.Press(1);
	Settle();
	window.reset();
	input.Move(BPoint(60, 50));
	input.Release(1);
	Settle();
	Click(BPoint(60, 50));
	EXPECT_EQ(1u, below.Take(B_MOUSE_DOWN).size());
}


TEST_F(PointerInput, MouseStateIsReadable)
{
	TestWindow window(BRect(0, 0, 99, 99));
	input.Move(BPoint(33, 44));
	const uint32 before = Desktop::Get()->PointerSerial();
	input.Press(1);
	Settle();
	BPoint where;
	uint32 buttons;
	Desktop::Get()->GetMouse(&where, &buttons);
	EXPECT_EQ(BPoint(33, 44), where);
	EXPECT_EQ(1u, buttons);
	EXPECT_TRUE(Desktop::Get()->WaitForPointer(before, 0));
	EXPECT_FALSE(Desktop::Get()->WaitForPointer(Desktop::Get()->PointerSerial(), 1000));
}


} // namespace BPrivate
