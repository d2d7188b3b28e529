#include "kits/server/DesktopFixture.h"

namespace BPrivate {

using WindowPolicy = DesktopTest;

namespace {

const BRect kLeft(0, 0, 99, 99);
const BRect kRight(200, 0, 299, 99);
const BPoint kInLeft(50, 50);
const BPoint kInRight(250, 50);
const BRect kBelow(0, 200, 99, 299);
const BPoint kInBelow(50, 250);


void
ActivateOtherProgram()
{
	BackendEvent event;
	event.type = BackendEvent::Type::WindowActivated;
	Desktop::Get()->Inject(event);
	Desktop::Get()->RunOnDisplay([] {});
}


// Whether the pointer finds the window there.
bool
IsOnScreen(TestWindow& window, ScriptedInput& input, BPoint where)
{
	input.Move(BPoint(1500, 900));
	input.Move(where);
	Desktop::Get()->RunOnDisplay([] {});
	for (const std::unique_ptr<BMessage>& message : window.Take(B_MOUSE_MOVED)) {
		if (!IsElsewhere(*message) && message->FindPoint("screen_where") == where)
			return true;
	}
	return false;
}

} // namespace


TEST_F(WindowPolicy, ShownWindowBecomesActiveAndTheOtherIsTold)
{
	TestWindow first(kLeft);
	Settle();
	Messages told = first.Take(B_WINDOW_ACTIVATED);
	ASSERT_EQ(1u, told.size());
	EXPECT_TRUE(told[0]->FindBool("active"));

	TestWindow second(kRight);
	Settle();
	told = first.Take(B_WINDOW_ACTIVATED);
	ASSERT_EQ(1u, told.size());
	EXPECT_FALSE(told[0]->FindBool("active"));
	EXPECT_FALSE(first.server.IsActive());
	EXPECT_TRUE(second.server.IsActive());
	EXPECT_EQ(second.server.Id(), Desktop::Get()->ActiveWindow());
}


TEST_F(WindowPolicy, FirstClickActivatesAndIsThrownAway)
{
	TestWindow window(kLeft), active(kRight);
	Settle();
	window.Take();
	Click(kInLeft);
	EXPECT_TRUE(window.server.IsActive());
	const Messages messages = window.Take();
	for (const std::unique_ptr<BMessage>& message : messages) {
		EXPECT_NE(uint32(B_MOUSE_DOWN), message->what);
		EXPECT_NE(uint32(B_MOUSE_UP), message->what);
	}
	Click(kInLeft);
	EXPECT_EQ(1u, window.Take(B_MOUSE_DOWN).size());
}


TEST_F(WindowPolicy, WindowThatAcceptsTheFirstClickGetsItUnactivated)
{
	TestWindow window(kLeft, TestWindow::kNormalFeel, TestWindow::kAcceptsFirstClick);
	TestWindow active(kRight);
	Settle();
	Click(kInLeft);
	EXPECT_FALSE(window.server.IsActive());
	EXPECT_EQ(1u, window.Take(B_MOUSE_DOWN).size());
}


TEST_F(WindowPolicy, WindowThatAvoidsTheFocusIsNeverActive)
{
	TestWindow window(kLeft, TestWindow::kNormalFeel, TestWindow::kAvoidFocus);
	Settle();
	EXPECT_EQ(0u, Desktop::Get()->ActiveWindow());
	Click(kInLeft);
	EXPECT_FALSE(window.server.IsActive());
	EXPECT_EQ(1u, window.Take(B_MOUSE_DOWN).size());
}


TEST_F(WindowPolicy, ModalWindowKeepsPressesFromTheOthers)
{
	TestWindow window(kLeft);
	TestWindow floating(kBelow, TestWindow::kFloatingAppFeel);
	TestWindow modal(kRight, TestWindow::kModalAppFeel);
	Settle();
	window.Take();
	Click(kInLeft);
	Click(kInBelow);
	EXPECT_TRUE(modal.server.IsActive());
	EXPECT_TRUE(floating.Take(B_MOUSE_DOWN).empty());

	bool moved = false;
	for (const std::unique_ptr<BMessage>& message : window.Take()) {
		EXPECT_NE(uint32(B_MOUSE_DOWN), message->what);
		EXPECT_NE(uint32(B_MOUSE_UP), message->what);
		moved = moved || message->what == B_MOUSE_MOVED;
	}
	EXPECT_TRUE(moved);
	Click(kInRight);
	EXPECT_EQ(1u, modal.Take(B_MOUSE_DOWN).size());
}


TEST_F(WindowPolicy, ModalWindowLetsGoWhenItIsHidden)
{
	TestWindow window(kLeft);
	TestWindow modal(kRight, TestWindow::kModalAppFeel);
	modal.server.Hide();
	Settle();
	EXPECT_TRUE(window.server.IsActive());
	Click(kInLeft);
	EXPECT_EQ(1u, window.Take(B_MOUSE_DOWN).size());
}


TEST_F(WindowPolicy, LaterModalWindowBlocksTheEarlier)
{
	TestWindow first(kLeft, TestWindow::kModalAppFeel);
	TestWindow second(kRight, TestWindow::kModalAppFeel);
	Settle();
	Click(kInLeft);
	EXPECT_TRUE(first.Take(B_MOUSE_DOWN).empty());
	Click(kInRight);
	EXPECT_EQ(1u, second.Take(B_MOUSE_DOWN).size());
}


TEST_F(WindowPolicy, FloatingWindowStaysAboveAWindowThatIsActivated)
{
	TestWindow floating(kLeft, TestWindow::kFloatingAppFeel, TestWindow::kAvoidFocus);
	TestWindow window(BRect(0, 0, 199, 199));
	window.server.Activate();
	Settle();
	Click(kInLeft);
	EXPECT_EQ(1u, floating.Take(B_MOUSE_DOWN).size());
	EXPECT_TRUE(window.Take(B_MOUSE_DOWN).empty());
}


TEST_F(WindowPolicy, FloatingWindowsLeaveWithTheirProgramAndComeBackWithIt)
{
	TestWindow window(kLeft);
	TestWindow floating(kRight, TestWindow::kFloatingAppFeel, TestWindow::kAvoidFocus);
	TestWindow above(kBelow, TestWindow::kFloatingAllFeel, TestWindow::kAvoidFocus);
	Settle();
	ActivateOtherProgram();
	EXPECT_FALSE(IsOnScreen(floating, input, kInRight));
	EXPECT_TRUE(IsOnScreen(above, input, kInBelow));
	EXPECT_TRUE(IsOnScreen(window, input, kInLeft));
	EXPECT_TRUE(floating.server.IsShown()) << "as far as the program knows";

	Click(kInLeft);
	EXPECT_TRUE(window.server.IsActive());
	EXPECT_TRUE(IsOnScreen(floating, input, kInRight));
}


TEST_F(WindowPolicy, FloatingWindowThatIsShownInTheBackgroundWaitsForItsProgram)
{
	TestWindow window(kLeft);
	Settle();
	ActivateOtherProgram();
	TestWindow floating(kRight, TestWindow::kFloatingAppFeel, TestWindow::kAvoidFocus);
	Settle();
	EXPECT_FALSE(IsOnScreen(floating, input, kInRight));
	window.server.Activate();
	Settle();
	EXPECT_TRUE(IsOnScreen(floating, input, kInRight));
	floating.server.Hide();
	Settle();
	ActivateOtherProgram();
	window.server.Activate();
	Settle();
	EXPECT_FALSE(IsOnScreen(floating, input, kInRight)) << "the program has hidden it";
}


TEST_F(WindowPolicy, FloatingWindowStaysWhenItIsAllThatItsProgramShows)
{
	TestWindow window(kLeft);
	TestWindow floating(kRight, TestWindow::kFloatingAppFeel, TestWindow::kAvoidFocus);
	Settle();
	ActivateOtherProgram();
	window.server.Hide();
	Settle();
	EXPECT_TRUE(IsOnScreen(floating, input, kInRight));
}


TEST_F(WindowPolicy, FloatingWindowOfASubsetIsShownWithThatAlone)
{
	TestWindow main(kLeft), other(kBelow);
	TestWindow floating(kRight, TestWindow::kFloatingSubsetFeel, TestWindow::kAvoidFocus);
	floating.server.AddToSubset(main.server);
	other.server.Activate();
	Settle();
	EXPECT_FALSE(IsOnScreen(floating, input, kInRight));
	main.server.Activate();
	Settle();
	EXPECT_TRUE(IsOnScreen(floating, input, kInRight));
	floating.server.RemoveFromSubset(main.server);
	Settle();
	EXPECT_FALSE(IsOnScreen(floating, input, kInRight));
}


TEST_F(WindowPolicy, OpenMenuTakesKeysAndThePressesBesideIt)
{
	TestWindow window(kLeft);
	TestWindow menu(kRight, kMenuWindowFeel);
	menu.server.SetWantsAllPointerEvents(true);
	Settle();
	EXPECT_TRUE(window.server.IsActive());
	window.Take();

	KeyStroke stroke;
	ASSERT_TRUE(stroke_of_name("Down", &stroke));
	input.KeyDown(stroke);
	Click(kInLeft);
	EXPECT_TRUE(window.Take(B_MOUSE_DOWN).empty());
	EXPECT_TRUE(window.Take(B_KEY_DOWN).empty());

	bool key = false, press = false;
	for (const std::unique_ptr<BMessage>& message : menu.Take()) {
		key = key || message->what == B_KEY_DOWN;
		press = press || (message->what == B_MOUSE_DOWN && IsElsewhere(*message));
	}
	EXPECT_TRUE(key);
	EXPECT_TRUE(press);
}


TEST_F(WindowPolicy, PressCanBeReleasedOverAMenu)
{
	TestWindow window(kLeft);
	Settle();
	input.Move(kInLeft);
	input.Press(1);
	TestWindow menu(kRight, kMenuWindowFeel);
	input.Move(kInRight);
	input.Release(1);
	Settle();

	bool move = false, release = false;
	for (const std::unique_ptr<BMessage>& message : menu.Take()) {
		const bool here = !IsElsewhere(*message);
		move = move || (message->what == B_MOUSE_MOVED && here);
		release = release || (message->what == B_MOUSE_UP && here);
	}
	EXPECT_TRUE(move);
	EXPECT_TRUE(release);
	EXPECT_EQ(1u, window.Take(B_MOUSE_UP).size());
}


TEST_F(WindowPolicy, ApplicationHearsWhetherItIsActive)
{
	auto window = std::make_unique<TestWindow>(kLeft);
	Settle();
	window.reset();
	Settle();
	const Messages messages = application.Take();
	ASSERT_EQ(2u, messages.size());
	EXPECT_EQ(uint32(B_APP_ACTIVATED), messages[0]->what);
	EXPECT_TRUE(messages[0]->FindBool("active"));
	EXPECT_FALSE(messages[1]->FindBool("active"));
}


TEST_F(WindowPolicy, CloseAsksTheWindow)
{
	TestWindow window(kLeft);
	BackendEvent event;
	event.type = BackendEvent::Type::CloseRequested;
	Desktop::Get()->Inject(event, window.server.Id());
	Settle();
	EXPECT_EQ(1u, window.Take(B_QUIT_REQUESTED).size());
}


} // namespace BPrivate
