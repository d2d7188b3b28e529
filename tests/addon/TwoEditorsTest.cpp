// Two editors at once share the palette and take each other's views, whatever is closed when.

#include <cmath>
#include <cstdlib>
#include <memory>

#include <gtest/gtest.h>

#include <Button.h>
#include <Cursor.h>
#include <OutlineListView.h>
#include <Screen.h>
#include <ScrollView.h>

#include "addon/ViewEditor.h"
#include "archive/ViewTree.h"
#include "palette/WidgetWindow.h"
#include "support/TestWindow.h"
#include "work/WorkBackgroundView.h"
#include "work/WorkView.h"

using namespace BResEditor;

namespace {


// An editor in a window of its own, as the host opens it.
class OpenEditor {
public:
	OpenEditor(BResourceCollection& collection, int32 id, BPoint leftTop) :
		fArgs { &collection }, fUser(fArgs),
		fWindow(new BWindow(BRect(leftTop, leftTop + BPoint(640, 420)), "editor", B_TITLED_WINDOW,
			B_ASYNCHRONOUS_CONTROLS))
	{
		BView root(BRect(0, 0, 180, 150), "root", B_FOLLOW_LEFT | B_FOLLOW_TOP, B_WILL_DRAW);
		root.AddChild(new BButton(BRect(20, 20, 119, 45), "button", "Press", NULL));
		BMessage archive;
		root.Archive(&archive, true);
		std::string bytes(static_cast<size_t>(archive.FlattenedSize()), '\0');
		archive.Flatten(bytes.data(), static_cast<ssize_t>(bytes.size()));
		BResourceHandle item;
		BResourceCollection* writable = fUser.WriteLock(NULL);
		writable->AddItem(&item, 'ARCV', id, "", bytes.data(), bytes.size());
		fUser.WriteUnlock(writable);

		fEditor = new ViewEditor(fArgs, item);
		fWindow->Lock();
		const BRect bounds = fWindow->Bounds();
		fWindow->AddChild(fEditor);
		fEditor->ResizeTo(bounds.Width(), bounds.Height());
		fWindow->Unlock();
		fWindow->Show();
		Driver::WaitUntilIdle();
	}

	~OpenEditor() { Close(); }

	void Close()
	{
		if (fWindow == nullptr)
			return;
		fWindow->Lock();
		fEditor->RemoveSelf();
		delete static_cast<BFullItemEditor*>(fEditor);
		fWindow->Quit();
		fWindow = nullptr;
		Driver::WaitUntilIdle();
	}

	BWindow* Window() { return fWindow; }
	WorkView* Work() { return static_cast<WorkView*>(fEditor->FindView("WorkView")); }
	BView* Root() { return Work()->EditView(); }
	BView* Find(const char* name) { return Root()->FindView(name); }
	BView* Panels() { return fEditor->ChildAt(0); }

private:
	BResourceAddonArgs fArgs;
	BResourceAddonBase fUser;
	BWindow* fWindow; // ends with Quit()
	ViewEditor* fEditor;
};


class TwoEditors : public testing::Test {
protected:
	TwoEditors() : left(collection, 1, BPoint(20, 40)), right(collection, 2, BPoint(700, 40))
	{
		PlacePalette(BPoint(20, 560));
	}

	static void PlacePalette(BPoint leftTop)
	{
		widgetWindow->Lock();
		widgetWindow->MoveTo(leftTop);
		widgetWindow->Unlock();
		Driver::WaitUntilIdle();
	}

	// Where the palette's entry is on the screen.
	static BPoint Entry(int32 index)
	{
		widgetWindow->Lock();
		BOutlineListView* list = dynamic_cast<BOutlineListView*>(
			dynamic_cast<BScrollView*>(widgetWindow->ChildAt(0))->Target());
		const BPoint place = list->ConvertToScreen(BPoint(60, list->ItemFrame(index).top + 5));
		widgetWindow->Unlock();
		return place;
	}

	// With the button down, over the other view.
	void BeginDrag(BPoint from, BPoint to)
	{
		driver.MoveTo(from);
		driver.Press();
		for (int i = 1; i <= 4; i++)
			driver.MoveTo(BPoint(std::floor(from.x + (to.x - from.x) * i / 4),
				std::floor(from.y + (to.y - from.y) * i / 4)));
	}

	BPoint Selected(OpenEditor& editor, const char* name)
	{
		driver.ActivateWindow(editor.Window()); // the first click would do no more
		driver.Click(editor.Find(name), BPoint(10, 10));
		return Driver::PointIn(editor.Find(name), BPoint(10, 10));
	}

	BApplication application { "application/x-vnd.Archway-test" };
	Driver driver;
	BResourceCollection collection;
	OpenEditor left;
	OpenEditor right;
};


constexpr int32 kButtonEntry = 5;


} // namespace


TEST_F(TwoEditors, ShareThePaletteWhicheverIsClosedFirst)
{
	WidgetWindow* palette = widgetWindow;
	EXPECT_EQ(2, widgetWindowCount);
	left.Close();
	EXPECT_EQ(palette, widgetWindow);
	OpenEditor third(collection, 3, BPoint(20, 40));
	EXPECT_EQ(palette, widgetWindow);
	right.Close();
	EXPECT_EQ(palette, widgetWindow);
	third.Close();
	EXPECT_EQ(NULL, widgetWindow);
	EXPECT_EQ(0, widgetWindowCount);
}


TEST_F(TwoEditors, AViewIsDraggedFromOneToTheOther)
{
	const BPoint from = Selected(left, "button");
	driver.Drag(from, Driver::PointIn(right.Root(), BPoint(40, 110)));
	EXPECT_EQ(NULL, left.Find("button"));
	EXPECT_EQ(left.Root(), left.Work()->SelectedView());
	ASSERT_EQ(2, right.Root()->CountChildren());
	BView* arrived = right.Root()->ChildAt(1);
	EXPECT_STREQ("button", arrived->Name());
	EXPECT_EQ(BPoint(30, 100), arrived->Frame().LeftTop());
	EXPECT_EQ(arrived, right.Work()->SelectedView());
	EXPECT_TRUE(arrived->Window()->IsActive());
}


TEST_F(TwoEditors, TheSourceIsClosedDuringADrag)
{
	BeginDrag(Selected(left, "button"), Driver::PointIn(right.Root(), BPoint(40, 110)));
	left.Close();
	driver.Release();
	ASSERT_EQ(2, right.Root()->CountChildren());
	EXPECT_STREQ("button", right.Root()->ChildAt(1)->Name());
	EXPECT_EQ(B_CURSOR_ID_SYSTEM_DEFAULT, driver.CursorAt(BPoint(710, 60)));
}


TEST_F(TwoEditors, TheTargetIsClosedDuringADrag)
{
	BeginDrag(Selected(left, "button"), Driver::PointIn(right.Root(), BPoint(40, 110)));
	right.Close();
	driver.Release();
	EXPECT_EQ(NULL, left.Find("button")); // dropped on nothing
	EXPECT_EQ(left.Root(), left.Work()->SelectedView());
	driver.Click(left.Root(), BPoint(150, 140));
	EXPECT_EQ(1, widgetWindowCount);
}


TEST_F(TwoEditors, ThePaletteClosesDuringItsDrag)
{
	BeginDrag(Entry(kButtonEntry), Driver::PointIn(right.Root(), BPoint(90, 110)));
	left.Close();
	right.Close();
	EXPECT_EQ(NULL, widgetWindow);
	driver.Release();
	driver.MoveTo(BPoint(100, 100));
	EXPECT_EQ(B_CURSOR_ID_SYSTEM_DEFAULT, driver.CursorAt(BPoint(100, 100)));
}


// Desktops show a close button all the same.
TEST_F(TwoEditors, ThePaletteStaysWhenTheUserClosesIt)
{
	const WidgetWindow* palette = widgetWindow;
	driver.CloseWindow(widgetWindow);
	EXPECT_EQ(palette, widgetWindow);
	const BPoint where = Driver::PointIn(left.Root(), BPoint(90, 110));
	BeginDrag(Entry(kButtonEntry), where);
	driver.Release();
	EXPECT_EQ(2, left.Root()->CountChildren());
}


// As when the program ends all its windows, in whatever order.
TEST_F(TwoEditors, CloseAfterThePalette)
{
	widgetWindow->Lock();
	widgetWindow->Quit();
	left.Close();
	right.Close();
	EXPECT_EQ(NULL, widgetWindow);
	EXPECT_EQ(0, widgetWindowCount);
	OpenEditor another(collection, 3, BPoint(20, 40));
	EXPECT_STREQ("Widgets", widgetWindow->Title());
}


TEST_F(TwoEditors, ThePointerTellsWhereAWidgetIsTaken)
{
	const BPoint entry = Entry(kButtonEntry);
	const BPoint view = Driver::PointIn(left.Root(), BPoint(90, 110));
	const BPoint ground = Driver::PointIn(left.Work()->Container(), BPoint(195, 160));
	const BPoint panel = Driver::PointIn(left.Panels(), BPoint(30, 340));
	BeginDrag(entry, entry + BPoint(10, 20));
	EXPECT_EQ(B_CURSOR_ID_NOT_ALLOWED, driver.CursorAt(entry));
	driver.MoveTo(view);
	EXPECT_EQ(B_CURSOR_ID_GRABBING, driver.CursorAt(view));
	driver.MoveTo(panel);
	EXPECT_EQ(B_CURSOR_ID_NOT_ALLOWED, driver.CursorAt(panel));
	driver.MoveTo(ground);
	EXPECT_EQ(B_CURSOR_ID_GRABBING, driver.CursorAt(ground));
	driver.MoveTo(view);
	driver.Release();
	EXPECT_EQ(B_CURSOR_ID_SYSTEM_DEFAULT, driver.CursorAt(view));
	EXPECT_EQ(2, left.Root()->CountChildren());
}


TEST_F(TwoEditors, ThePointerIsTheUsualOneAfterADropOnNothing)
{
	BeginDrag(Entry(kButtonEntry), Driver::PointIn(left.Panels(), BPoint(30, 340)));
	driver.Release();
	EXPECT_EQ(B_CURSOR_ID_SYSTEM_DEFAULT, driver.CursorAt(BPoint(1590, 990)));
	EXPECT_EQ(1, left.Root()->CountChildren());
}


TEST(PalettePlace, IsOnTheScreenHoweverSmall)
{
	for (const auto& [size, leftTop] : { std::pair("1600x1000", BPoint(800, 400)),
			 std::pair("800x600", BPoint(593, 313)), std::pair("640x200", BPoint(433, 26)) }) {
		setenv("ARCHWAY_SCREEN", size, 1);
		BApplication application("application/x-vnd.Archway-test");
		BResourceCollection collection;
		OpenEditor editor(collection, 1, BPoint(10, 30));
		EXPECT_EQ(leftTop, widgetWindow->Frame().LeftTop()) << size;
	}
}
