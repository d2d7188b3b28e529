// Calls and hooks of windows and views that need no input.
#include <Alert.h>
#include <Bitmap.h>
#include <Button.h>
#include <Screen.h>
#include <TextControl.h>
#include <Window.h>

#include "ControlFixture.h"
#include "support/PaintCounter.h"

namespace {

const rgb_color kRed = { 255, 0, 0, 255 };
const rgb_color kWhite = { 255, 255, 255, 255 };


class CountingView : public BView {
public:
	CountingView() : BView(BRect(20, 20, 119, 119), "counting", 0, B_WILL_DRAW) {}
	void Draw(BRect) override { drawn++; }
	int drawn = 0;
};

} // namespace


TEST(WindowCalls, TheHooksOfABWindowTellOfTheScreen)
{
	class Hooked : public BWindow {
	public:
		Hooked() : BWindow(BRect(50, 50, 149, 149), "Hooked", B_TITLED_WINDOW, 0) {}
		void ScreenChanged(BRect frame, color_space format) override
		{
			screen = frame;
			space = format;
		}
		void WorkspacesChanged(uint32 before, uint32 now) override
		{
			oldWorkspaces = before;
			newWorkspaces = now;
		}
		void WorkspaceActivated(int32 which, bool state) override
		{
			workspace = which;
			activated = state;
		}
		BRect screen;
		color_space space = B_NO_COLOR_SPACE;
		uint32 oldWorkspaces = 0, newWorkspaces = 0;
		int32 workspace = -1;
		bool activated = false;
	};
	BApplication app("application/x-vnd.Archway-test");
	Hooked* window = new Hooked;
	window->Show();
	const BMessenger target(window);
	BMessage screen(B_SCREEN_CHANGED), changed(B_WORKSPACES_CHANGED), active(B_WORKSPACE_ACTIVATED);
	screen.AddRect("frame", BRect(0, 0, 639, 479));
	screen.AddInt32("mode", B_RGB16);
	changed.AddInt32("old", 1);
	changed.AddInt32("new", 6);
	active.AddInt32("workspace", 3);
	active.AddBool("active", true);
	for (BMessage* message : { &screen, &changed, &active })
		target.SendMessage(message);
	Driver::WaitUntilIdle();
	window->Lock();
	EXPECT_EQ(BRect(0, 0, 639, 479), window->screen);
	EXPECT_EQ(B_RGB16, window->space);
	EXPECT_EQ(1u, window->oldWorkspaces);
	EXPECT_EQ(6u, window->newWorkspaces);
	EXPECT_EQ(3, window->workspace);
	EXPECT_TRUE(window->activated);
	window->Quit();
}


TEST(WindowCalls, TheDefaultButtonIsTheOneThatWasSetLast)
{
	ControlFixture fixture;
	BButton* first = fixture.Add(new BButton(BRect(10, 10, 99, 40), "a", "A", NULL));
	BButton* second = fixture.Add(new BButton(BRect(10, 60, 99, 90), "b", "B", NULL));
	fixture.Locked([&] {
		EXPECT_EQ(nullptr, fixture.window->DefaultButton());
		fixture.window->SetDefaultButton(first);
		EXPECT_EQ(first, fixture.window->DefaultButton());
		fixture.window->SetDefaultButton(second);
		EXPECT_EQ(second, fixture.window->DefaultButton());
		EXPECT_FALSE(first->IsDefault());
		second->RemoveSelf();
		EXPECT_EQ(nullptr, fixture.window->DefaultButton());
	});
	delete second;
}


TEST(WindowCalls, UpdatesWaitWhileTheyAreDisabled)
{
	ControlFixture fixture;
	CountingView* view = fixture.Add(new CountingView);
	BWindow* window = fixture.window;
	const int drawn = view->drawn;
	fixture.Locked([&] {
		window->DisableUpdates();
		view->Invalidate();
		window->UpdateIfNeeded();
	});
	EXPECT_EQ(drawn, view->drawn) << "DisableUpdates()";
	fixture.Locked([&] { EXPECT_TRUE(window->NeedsUpdate()); });
	fixture.Locked([&] { window->EnableUpdates(); });
	EXPECT_EQ(drawn + 1, view->drawn) << "EnableUpdates()";
	fixture.Locked([&] { EXPECT_FALSE(window->NeedsUpdate()); });
}


TEST(WindowCalls, NothingIsShownUntilTheTransactionEnds)
{
	ControlFixture fixture;
	BView* view = fixture.Add(new BView(BRect(20, 20, 119, 119), "view", 0, B_WILL_DRAW));
	BWindow* window = fixture.window;
	PaintCounter counter(window);
	window->Lock();
	window->OpenViewTransaction();
	EXPECT_TRUE(window->InViewTransaction());
	view->SetHighColor(kRed);
	view->FillRect(view->Bounds());
	window->Flush();
	view->Sync();
	EXPECT_EQ(0, counter.Flushes()) << "Flush() shows nothing in between";
	window->CommitViewTransaction();
	EXPECT_FALSE(window->InViewTransaction());
	window->Flush();
	window->Unlock();
	Driver::WaitUntilIdle();
	EXPECT_EQ(1, counter.Flushes());
	EXPECT_EQ(kRed, fixture.driver.PixelAt(view, BPoint(50, 50)));
}


TEST(WindowCalls, WindowsLieOnWholePixels)
{
	ControlFixture fixture;
	BWindow* window = fixture.window;
	window_alignment mode;
	int32 h, hOffset, width, widthOffset, v, vOffset, height, heightOffset;
	EXPECT_EQ(B_OK,
		window->GetWindowAlignment(
			&mode, &h, &hOffset, &width, &widthOffset, &v, &vOffset, &height, &heightOffset));
	EXPECT_EQ(B_PIXEL_ALIGNMENT, mode);
	for (const int32 one : { h, width, v, height })
		EXPECT_EQ(1, one);
	for (const int32 zero : { hOffset, widthOffset, vOffset, heightOffset })
		EXPECT_EQ(0, zero);
	EXPECT_EQ(B_UNSUPPORTED, window->SetWindowAlignment(B_BYTE_ALIGNMENT, 8));
}


TEST(WindowCalls, ABAlertMayBeAskedToQuitAndResized)
{
	class Noting : public BAlert {
	public:
		Noting() : BAlert("Title", "Text", "Cancel", "OK") {}
		void FrameResized(float width, float height) override
		{
			BAlert::FrameResized(width, height);
			resized = BPoint(width, height);
		}
		BPoint resized;
	};
	BApplication app("application/x-vnd.Archway-test");
	Noting* alert = new Noting;
	BMessenger target(alert);
	alert->Go(NULL);
	Driver::WaitUntilIdle();
	ASSERT_TRUE(target.LockTarget());
	const BRect button = alert->ButtonAt(1)->Frame();
	alert->ResizeBy(30, 20);
	alert->Unlock();
	Driver::WaitUntilIdle();
	ASSERT_TRUE(target.LockTarget());
	EXPECT_EQ(BPoint(alert->Bounds().Width(), alert->Bounds().Height()), alert->resized);
	EXPECT_EQ(button.OffsetByCopy(30, 20), alert->ButtonAt(1)->Frame());
	EXPECT_TRUE(alert->QuitRequested());
	alert->Unlock();
	target.SendMessage(B_QUIT_REQUESTED);
	Driver::WaitUntilIdle();
	EXPECT_FALSE(target.IsValid());
}


TEST(ViewCalls, ABViewHasNoOverlaysAndDoesNotPrint)
{
	ControlFixture fixture;
	BView* view = fixture.Add(new BView(BRect(20, 20, 119, 119), "view", 0, B_WILL_DRAW));
	BBitmap bitmap(BRect(0, 0, 7, 7), B_RGB32);
	rgb_color key;
	fixture.Locked([&] {
		EXPECT_EQ(B_UNSUPPORTED, view->SetViewOverlay(&bitmap, &key));
		view->ClearViewOverlay();
		EXPECT_FALSE(view->IsPrinting());
	});
	EXPECT_EQ(kWhite, fixture.driver.PixelAt(view, BPoint(3, 3)));
}


TEST(ViewCalls, ABViewKnowsWhetherItHasTheFocus)
{
	ControlFixture fixture;
	BView* view = new BView(BRect(20, 20, 119, 119), "view", 0, B_WILL_DRAW);
	view->MakeFocus();
	EXPECT_FALSE(view->IsFocus()) << "it is in no window";
	fixture.Add(view);
	fixture.Focus(view);
	EXPECT_TRUE(view->IsFocus());
	fixture.Locked([&] { view->MakeFocus(false); });
	EXPECT_FALSE(view->IsFocus());
}


TEST(ViewCalls, TextOfABViewIsSmoothUnlessItIsForced)
{
	class Text : public BView {
	public:
		Text() : BView(BRect(20, 20, 119, 59), "text", 0, B_WILL_DRAW) {}
		void Draw(BRect) override { DrawString("Archway @&%", BPoint(5, 20)); }
	};
	ControlFixture fixture;
	Text* view = fixture.Add(new Text);
	const auto shades = [&] {
		int count = 0;
		for (float y = 5; y < 25; y++) {
			for (float x = 0; x < 90; x++) {
				const rgb_color pixel = fixture.driver.PixelAt(view, BPoint(x, y));
				count += pixel.red != 0 && pixel.red != 255;
			}
		}
		return count;
	};
	EXPECT_GT(shades(), 0);
	fixture.Locked([&] {
		view->ForceFontAliasing(true);
		view->Invalidate();
	});
	EXPECT_EQ(0, shades());
	fixture.Locked([&] {
		view->ForceFontAliasing(false);
		view->Invalidate();
	});
	EXPECT_GT(shades(), 0);
}


TEST(ViewCalls, TheScaleOfABViewIsArchived)
{
	BApplication app("application/x-vnd.Archway-test");
	BView view(BRect(0, 0, 9, 9), "view", 0, 0);
	view.SetScale(2.5f);
	const BMessage archive = ArchiveOf(view);
	EXPECT_EQ(2.5f, archive.GetFloat("_scale", 0));
	EXPECT_EQ(2.5f, Revive<BView>(archive)->Scale());
}


TEST(BitmapCalls, BitsMayBeLockedAndFlagsAreKept)
{
	BApplication app("application/x-vnd.Archway-test");
	BBitmap bitmap(BRect(0, 0, 7, 7), B_BITMAP_ACCEPTS_VIEWS | B_BITMAP_IS_CONTIGUOUS, B_RGB32);
	EXPECT_NE(0u, bitmap.Flags() & B_BITMAP_ACCEPTS_VIEWS);
	EXPECT_EQ(static_cast<uint32>(B_BITMAP_IS_CONTIGUOUS), bitmap.Flags() & B_BITMAP_IS_CONTIGUOUS);
	EXPECT_EQ(B_OK, bitmap.LockBits());
	static_cast<uint32*>(bitmap.Bits())[0] = 0x12345678;
	bitmap.UnlockBits();
	EXPECT_EQ(0x12345678u, static_cast<uint32*>(bitmap.Bits())[0]);
	BBitmap none(BRect(0, 0, -1, -1), B_RGB32);
	EXPECT_NE(B_OK, none.LockBits());
}


TEST(BitmapCalls, AnOldArchiveNamesItsFlagsOneByOne)
{
	BApplication app("application/x-vnd.Archway-test");
	BBitmap bitmap(BRect(0, 0, 7, 7), B_RGB32);
	for (const char* name : { "_contiguous", "_continguous" }) {
		BMessage archive = ArchiveOf(bitmap);
		archive.RemoveName("_bmflags");
		archive.AddBool("_view_ok", true);
		archive.AddBool(name, true);
		const std::unique_ptr<BBitmap> revived = Revive<BBitmap>(archive);
		ASSERT_NE(nullptr, revived);
		EXPECT_NE(0u, revived->Flags() & B_BITMAP_ACCEPTS_VIEWS) << name;
		EXPECT_EQ(
			static_cast<uint32>(B_BITMAP_IS_CONTIGUOUS), revived->Flags() & B_BITMAP_IS_CONTIGUOUS)
			<< name;
	}
}
