// What all panels do alike with messages.

#include "editors/EditButton.h"

#include "PanelFixture.h"

namespace {


constexpr uint32 kForeignCode = 'frgn';


// Stands behind the panel, and so gets what the panel passes on.
class Listener : public BView {
public:
	explicit Listener(BRect frame) : BView(frame, "listener", B_FOLLOW_NONE, B_WILL_DRAW) {}

	void MessageReceived(BMessage* message) override
	{
		if (message->what == kForeignCode || message->what == 'dflt') {
			received = message->what;
			wasLocked = watched->IsLocked();
			return;
		}
		BView::MessageReceived(message);
	}

	BWindow* watched = nullptr; // borrowed
	uint32 received = 0;
	bool wasLocked = false;
};


class WatchedPanel : public EditButton {
public:
	int32 asked = 0;
	int32 askedUnderLock = 0;

protected:
	bool ApplyEdit(BMessage* message) override
	{
		asked++;
		askedUnderLock += target->Window()->IsLocked() ? 1 : 0;
		return EditButton::ApplyEdit(message);
	}
};


// The panel in one window, its target in another.
class EditorInterfaceTest : public testing::Test {
protected:
	EditorInterfaceTest() :
		others(new BWindow(BRect(500, 50, 699, 249), "others", B_TITLED_WINDOW, 0)),
		listener(window.Add(new Listener(BRect(0, 0, 399, 99)))), panel(new WatchedPanel),
		button(new BButton(BRect(10, 10, 90, 34), "button", "Button", NULL))
	{
		others->AddChild(button);
		others->Show();
		Driver::WaitUntilIdle();
		listener->watched = others;
		window.Locked([&] {
			listener->AddChild(panel);
			panel->UseView(button);
		});
		window.driver.ActivateWindow(window.Window());
	}

	~EditorInterfaceTest() override
	{
		if (others->Lock())
			others->Quit();
	}

	void Post(uint32 code)
	{
		window.Window()->PostMessage(code, panel);
		Driver::WaitUntilIdle();
	}

	TestWindow window;
	BWindow* others; // ends with Quit()
	Listener* listener; // child
	WatchedPanel* panel; // child
	BButton* button; // child
};


} // namespace


TEST_F(EditorInterfaceTest, ALockForAForeignCodeEndsBeforeItIsPassedOn)
{
	Post(kForeignCode);
	EXPECT_EQ(1, panel->asked);
	EXPECT_EQ(1, panel->askedUnderLock);
	EXPECT_EQ(kForeignCode, listener->received);
	EXPECT_FALSE(listener->wasLocked);
}


TEST_F(EditorInterfaceTest, AnOwnCodeIsNotPassedOn)
{
	window.driver.Click(ControlUser::Find<BCheckBox>(panel, "Default"));
	EXPECT_EQ(1, panel->askedUnderLock);
	EXPECT_TRUE(button->IsDefault());
	EXPECT_EQ(0u, listener->received);
	// Nobody has kept the lock.
	EXPECT_TRUE(others->Lock());
	others->Unlock();
	EXPECT_FALSE(others->IsLocked());
}


TEST_F(EditorInterfaceTest, WithoutATargetEveryCodeIsPassedOn)
{
	window.Locked([&] { EXPECT_FALSE(panel->UseView(NULL)); });
	Post('dflt');
	EXPECT_EQ(0, panel->asked);
	EXPECT_EQ(uint32('dflt'), listener->received);
	EXPECT_FALSE(button->IsDefault());
}
