#include <Alert.h>

#include <Button.h>
#include <Invoker.h>
#include <MenuBar.h>
#include <MenuItem.h>
#include <Screen.h>
#include <TextView.h>

#include <atomic>
#include <thread>

#include "ControlFixture.h"

namespace {

BAlert*
NewAlert(button_width width = B_WIDTH_AS_USUAL, button_spacing spacing = B_EVEN_SPACING)
{
	return new BAlert(
		"Title", "Do you want it?", "Cancel", "No", "Yes", width, spacing, B_WARNING_ALERT);
}


// Waits until the alert's window is shown, which another thread does.
void
WaitUntilShown(BAlert* alert)
{
	for (;;) {
		if (alert->Lock()) {
			const bool shown = !alert->IsHidden();
			alert->Unlock();
			if (shown)
				break;
		}
		std::this_thread::yield();
	}
	Driver::WaitUntilIdle();
}


// Makes an alert and runs it in a thread that has no window, as an application's main thread may.
class Runner {
public:
	explicit Runner(char escapeOfFirst = 0) :
		fThread([this, escapeOfFirst] {
			BAlert* alert = NewAlert();
			alert->SetShortcut(0, escapeOfFirst);
			fAlert = alert;
			fResult = alert->Go();
		})
	{
		while (fAlert == nullptr)
			std::this_thread::yield();
		WaitUntilShown(fAlert);
	}

	BAlert* Alert() const { return fAlert; }

	int32 Result()
	{
		fThread.join();
		return fResult;
	}

private:
	std::atomic<BAlert*> fAlert { nullptr };
	std::atomic<int32> fResult { -2 };
	std::thread fThread;
};

} // namespace


TEST(Alert, HasItsPartsInPlace)
{
	BApplication app("application/x-vnd.Archway-test");
	BAlert* alert = NewAlert();
	EXPECT_EQ(B_MODAL_WINDOW_LOOK, alert->Look());
	EXPECT_EQ(B_MODAL_APP_WINDOW_FEEL, alert->Feel());
	EXPECT_STREQ("Do you want it?", alert->TextView()->Text());
	EXPECT_FALSE(alert->TextView()->IsEditable());
	EXPECT_STREQ("_master_", alert->ChildAt(0)->Name());
	EXPECT_STREQ("_tv_", alert->TextView()->Name());

	BRect buttons[3];
	for (int32 i = 0; i < 3; i++) {
		ASSERT_NE(nullptr, alert->ButtonAt(i));
		buttons[i] = alert->ButtonAt(i)->Frame();
		EXPECT_TRUE(alert->Bounds().Contains(buttons[i]));
		EXPECT_GE(buttons[i].Width(), 75);
		EXPECT_FALSE(buttons[i].Intersects(alert->TextView()->Frame()));
		EXPECT_EQ(i == 2, alert->ButtonAt(i)->IsDefault());
	}
	EXPECT_LT(buttons[0].right, buttons[1].left);
	EXPECT_LT(buttons[1].right, buttons[2].left);
	EXPECT_EQ(alert->Bounds().right - 6, buttons[2].right);
	EXPECT_EQ(nullptr, alert->ButtonAt(3));
	alert->Quit();
}


TEST(Alert, SpacingMovesTheFirstButtonAway)
{
	BApplication app("application/x-vnd.Archway-test");
	BAlert* even = NewAlert();
	BAlert* offset = NewAlert(B_WIDTH_AS_USUAL, B_OFFSET_SPACING);
	const auto gap = [](BAlert* alert) {
		return alert->ButtonAt(1)->Frame().left - alert->ButtonAt(0)->Frame().right;
	};
	EXPECT_EQ(6, gap(even));
	EXPECT_EQ(32, gap(offset));
	even->Quit();
	offset->Quit();
}


TEST(Alert, GrowsWithItsText)
{
	BApplication app("application/x-vnd.Archway-test");
	std::string text;
	for (int i = 0; i < 100; i++)
		text += "many words ";
	BAlert* low = new BAlert("", "Short", "Ok");
	BAlert* high = new BAlert("", text.c_str(), "Ok");
	EXPECT_GT(high->Bounds().Height(), low->Bounds().Height() + 50);
	EXPECT_LE(high->TextView()->Frame().bottom, high->ButtonAt(0)->Frame().top);
	low->Quit();
	high->Quit();
}


TEST(Alert, GoAnswersThePressedButton)
{
	BApplication app("application/x-vnd.Archway-test");
	Driver driver;
	Runner runner;
	driver.Click(runner.Alert()->ButtonAt(1));
	EXPECT_EQ(1, runner.Result());
}


TEST(Alert, EnterPressesTheDefaultButton)
{
	BApplication app("application/x-vnd.Archway-test");
	Driver driver;
	Runner runner;
	driver.Type("\n");
	EXPECT_EQ(2, runner.Result());
}


TEST(Alert, AShortcutPressesItsButton)
{
	BApplication app("application/x-vnd.Archway-test");
	Driver driver;
	Runner runner(B_ESCAPE);
	EXPECT_EQ(B_ESCAPE, runner.Alert()->Shortcut(0));
	driver.Key("Escape");
	EXPECT_EQ(0, runner.Result());
}


TEST(Alert, GoAnswersMinusOneWhenItIsAskedToQuit)
{
	BApplication app("application/x-vnd.Archway-test");
	Runner runner;
	runner.Alert()->PostMessage(B_QUIT_REQUESTED);
	EXPECT_EQ(-1, runner.Result());
}


TEST(Alert, TheInvokerGetsTheButton)
{
	ControlFixture fixture;
	BAlert* alert = NewAlert();
	BButton* button = alert->ButtonAt(0);
	BMessage* message = new BMessage('answ');
	message->AddPointer("source", alert);
	EXPECT_EQ(B_OK, alert->Go(new BInvoker(message, fixture.window)));
	Driver::WaitUntilIdle();
	fixture.driver.Click(button);
	const std::vector<BMessage> sent = fixture.Received('answ');
	ASSERT_EQ(1u, sent.size());
	EXPECT_EQ(0, sent[0].GetInt32("which", -1));
}


namespace {

// Asks in its own thread, as a button's handler does, and counts how often it was drawn.
class AskingView : public BView {
public:
	AskingView() : BView(BRect(0, 0, 99, 99), "asking", B_FOLLOW_NONE, B_WILL_DRAW) {}

	void Draw(BRect) override { fDraws++; }

	void MessageReceived(BMessage* message) override
	{
		if (message->what == 'ask!') {
			fAlert = NewAlert();
			fAnswer = fAlert.load()->Go();
		} else if (message->what == 'late')
			fLate = true;
		else
			BView::MessageReceived(message);
	}

	std::atomic<BAlert*> fAlert { nullptr };
	std::atomic<int32> fAnswer { -2 };
	std::atomic<int32> fDraws { 0 };
	std::atomic<bool> fLate { false };
};

} // namespace


TEST(Alert, TheAskingWindowGetsNothingElseMeanwhile)
{
	ControlFixture fixture;
	AskingView* view = fixture.Add(new AskingView);
	BMessenger messenger(view);
	messenger.SendMessage('ask!');
	while (view->fAlert == nullptr)
		std::this_thread::yield();
	WaitUntilShown(view->fAlert);
	messenger.SendMessage('late');
	EXPECT_FALSE(view->fLate);

	BButton* button = view->fAlert.load()->ButtonAt(1);
	fixture.driver.Click(button);
	Driver::WaitUntilIdle();
	EXPECT_EQ(1, view->fAnswer);
	EXPECT_TRUE(view->fLate);
}


TEST(Alert, AnOpenMenuOfTheAskingWindowCloses)
{
	ControlFixture fixture;
	AskingView* view = fixture.Add(new AskingView);
	BMenu* menu = new BMenu("Menu");
	menu->AddItem(new BMenuItem("Item", new BMessage('item')));
	BMenuBar* bar = new BMenuBar(BRect(0, 120, 99, 139), "bar");
	bar->AddItem(menu);
	fixture.Add(bar);
	fixture.driver.Click(bar, BPoint(15, 8));
	ASSERT_NE(nullptr, menu->Window());

	BMessenger(view).SendMessage('ask!');
	while (view->fAlert == nullptr)
		std::this_thread::yield();
	WaitUntilShown(view->fAlert);
	EXPECT_EQ(nullptr, menu->Window());
	fixture.driver.MoveTo(BPoint(20, 20));
	fixture.driver.Click(view->fAlert.load()->ButtonAt(2));
	EXPECT_EQ(2, view->fAnswer);
}


TEST(Alert, IsPlacedInTheUpperPartOfTheScreen)
{
	BApplication app("application/x-vnd.Archway-test");
	const BRect screen = BScreen().Frame();
	const BPoint place = BAlert::AlertPosition(300, 90);
	EXPECT_EQ(std::floor(screen.Width() / 2 - 150), place.x);
	EXPECT_EQ(std::floor(screen.Height() / 4 - 30), place.y);
}


TEST(Alert, IsArchivedWithItsPartsAndWhatItDoesNotKnow)
{
	ControlFixture fixture;
	BAlert* alert = NewAlert(B_WIDTH_FROM_LABEL);
	alert->SetShortcut(0, B_ESCAPE);
	alert->SetShortcut(2, 'y');
	BMessage archive = ArchiveOf(*alert);
	alert->Quit();

	EXPECT_STREQ("Do you want it?", archive.GetString("_text", ""));
	EXPECT_EQ(B_WARNING_ALERT, archive.GetInt32("_atype", -1));
	EXPECT_EQ(B_WIDTH_FROM_LABEL, archive.GetInt32("_but_width", -1));
	EXPECT_EQ(B_ESCAPE, archive.GetInt8("_but_key", 0, 0));
	EXPECT_EQ('y', archive.GetInt8("_but_key", 2, 0));

	archive.AddString("unknown", "kept");
	archive.AddInt32("another", 7);
	std::unique_ptr<BAlert> revived = Revive<BAlert>(archive);
	ASSERT_NE(nullptr, revived);
	EXPECT_EQ(B_WARNING_ALERT, revived->Type());
	EXPECT_EQ('y', revived->Shortcut(2));
	EXPECT_STREQ("Do you want it?", revived->TextView()->Text());
	EXPECT_STREQ("Yes", revived->ButtonAt(2)->Label());
	EXPECT_TRUE(archive.HasSameData(ArchiveOf(*revived), false, true));

	revived->SetShortcut(2, 0);
	EXPECT_EQ(0, ArchiveOf(*revived).GetInt8("_but_key", 2, 1));
	EXPECT_STREQ("kept", ArchiveOf(*revived).GetString("unknown", ""));
}


TEST(Alert, StandsInItsPlaceBeforeItIsShown)
{
	ControlFixture fixture;
	BAlert* alert = NewAlert();
	const BRect frame = alert->Frame();
	EXPECT_EQ(BAlert::AlertPosition(frame.Width(), frame.Height()), frame.LeftTop());
	alert->MoveTo(17, 19);
	EXPECT_EQ(B_OK, alert->Go(NULL));
	Driver::WaitUntilIdle();
	ASSERT_TRUE(alert->Lock());
	EXPECT_EQ(BPoint(17, 19), alert->Frame().LeftTop()) << "where the program has moved it";
	alert->Quit();
}
