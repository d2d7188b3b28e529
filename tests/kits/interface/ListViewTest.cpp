#include <ListView.h>

#include <gtest/gtest.h>

#include <vector>

#include <List.h>
#include <Message.h>
#include <ScrollBar.h>
#include <ScrollView.h>

#include "support/TestWindow.h"

namespace {

constexpr uint32 kSelected = 'slct';
constexpr uint32 kInvoked = 'invk';

struct Event {
	uint32 what;
	std::vector<int32> indices;
	bool operator==(const Event& other) const = default;
};

std::ostream&
operator<<(std::ostream& stream, const Event& event)
{
	stream << (event.what == kSelected ? "selected" : "invoked");
	for (int32 index : event.indices)
		stream << ' ' << index;
	return stream;
}

typedef std::vector<Event> Events;

struct ListWindow : BWindow {
	ListWindow() :
		BWindow(BRect(50, 50, 449, 349), "list", B_TITLED_WINDOW, B_ASYNCHRONOUS_CONTROLS)
	{
	}

	void MessageReceived(BMessage* message) override
	{
		if (message->what != kSelected && message->what != kInvoked) {
			BWindow::MessageReceived(message);
			return;
		}
		Event event { message->what, {} };
		int32 index;
		for (int32 i = 0; message->FindInt32("index", i, &index) == B_OK; i++)
			event.indices.push_back(index);
		events.push_back(event);
		message->FindPointer("source", &source);
	}

	Events events;
	void* source = NULL;
};

struct DragList : BListView {
	using BListView::BListView;

	bool InitiateDrag(BPoint point, int32 index, bool wasSelected) override
	{
		drags.push_back(index);
		dragPoint = point;
		dragWasSelected = wasSelected;
		return drag;
	}

	void SelectionChanged() override { changes++; }

	std::vector<int32> drags;
	BPoint dragPoint;
	bool dragWasSelected = false;
	bool drag = false;
	int32 changes = 0;
};

struct Lists {
	explicit Lists(list_view_type type = B_SINGLE_SELECTION_LIST) :
		app("application/x-vnd.Archway-test"), window(new ListWindow),
		list(new DragList(BRect(10, 10, 159, 159), "list", type))
	{
		for (const char* name : { "alpha", "beta", "gamma", "delta", "Brook" }) {
			items.push_back(new BStringItem(name));
			list->AddItem(items.back());
		}
		list->SetSelectionMessage(new BMessage(kSelected));
		list->SetInvocationMessage(new BMessage(kInvoked));
		window->AddChild(list);
		window->Show();
		Driver::WaitUntilIdle();
	}

	~Lists()
	{
		window->Lock();
		window->Quit();
		for (BListItem* item : items)
			delete item;
	}

	void Locked(const std::function<void()>& function)
	{
		window->Lock();
		function();
		window->Unlock();
		Driver::WaitUntilIdle();
	}

	BPoint Item(int32 index)
	{
		BRect frame;
		Locked([&] { frame = list->ItemFrame(index); });
		return BPoint(30, (frame.top + frame.bottom) / 2);
	}

	Events TakeEvents()
	{
		Events events;
		Locked([&] { events.swap(window->events); });
		return events;
	}

	BApplication app;
	Driver driver;
	ListWindow* window;
	DragList* list;
	std::vector<BListItem*> items;
};

} // namespace


TEST(ListView, StartsEmptyAndWhite)
{
	BApplication app("application/x-vnd.Archway-test");
	BListView list(BRect(0, 0, 99, 49), "list");
	EXPECT_EQ(B_SINGLE_SELECTION_LIST, list.ListType());
	EXPECT_TRUE(list.IsEmpty());
	EXPECT_EQ(-1, list.CurrentSelection());
	EXPECT_EQ(nullptr, list.SelectionMessage());
	EXPECT_EQ(nullptr, list.InvocationMessage());
	EXPECT_EQ((rgb_color { 255, 255, 255, 255 }), list.ViewColor());
	EXPECT_EQ((rgb_color { 255, 255, 255, 255 }), list.LowColor());
	float width, height;
	list.GetPreferredSize(&width, &height);
	EXPECT_EQ(99, width);
	EXPECT_EQ(49, height);
}


TEST(ListView, ItemsAreStackedFromTheTop)
{
	Lists lists;
	lists.Locked([&] {
		float top = 0;
		for (int32 i = 0; i < 5; i++) {
			const BRect frame = lists.list->ItemFrame(i);
			EXPECT_EQ(top, frame.top);
			EXPECT_EQ(ceilf(lists.items[i]->Height()), frame.Height() + 1);
			EXPECT_EQ(i, lists.list->IndexOf(BPoint(5, frame.top)));
			EXPECT_EQ(i, lists.list->IndexOf(BPoint(5, frame.bottom)));
			top = frame.bottom + 1;
		}
		EXPECT_EQ(-1, lists.list->IndexOf(BPoint(5, top + 1)));
		EXPECT_FALSE(lists.list->ItemFrame(5).IsValid());
		float width, height;
		lists.list->GetPreferredSize(&width, &height);
		EXPECT_EQ(top - 1, height);
		EXPECT_EQ(lists.items[2]->Width(), width);
	});
}


TEST(ListView, AddingAndRemovingKeepsTheSelectionOnItsItems)
{
	Lists lists(B_MULTIPLE_SELECTION_LIST);
	lists.Locked([&] {
		lists.list->Select(1);
		lists.list->Select(3, true);
		lists.items.push_back(new BStringItem("first"));
		EXPECT_TRUE(lists.list->AddItem(lists.items.back(), 0));
		EXPECT_FALSE(lists.list->AddItem(lists.items.back(), 9));
		EXPECT_EQ(2, lists.list->CurrentSelection(0));
		EXPECT_EQ(4, lists.list->CurrentSelection(1));
		EXPECT_EQ(-1, lists.list->CurrentSelection(2));
		EXPECT_EQ(lists.items[1], lists.list->RemoveItem(static_cast<int32>(2)));
		EXPECT_EQ(3, lists.list->CurrentSelection(0));
		EXPECT_EQ(-1, lists.list->CurrentSelection(1));
		EXPECT_EQ(-1, lists.list->IndexOf(lists.items[1]));
		EXPECT_TRUE(lists.items[1]->IsSelected());
		lists.list->MakeEmpty();
		EXPECT_EQ(0, lists.list->CountItems());
		EXPECT_EQ(-1, lists.list->CurrentSelection());
	});
}


TEST(ListView, AClickSelectsAndADoubleClickInvokes)
{
	Lists lists;
	lists.driver.Click(lists.list, lists.Item(2));
	EXPECT_EQ((Events { { kSelected, { 2 } } }), lists.TakeEvents());
	EXPECT_EQ(lists.list, lists.window->source);
	lists.driver.Click(lists.list, lists.Item(0));
	EXPECT_EQ((Events { { kSelected, { 0 } } }), lists.TakeEvents());
	lists.driver.Click(lists.list, lists.Item(0));
	EXPECT_EQ(Events(), lists.TakeEvents());
	lists.driver.Click(lists.list, lists.Item(1), 2);
	EXPECT_EQ((Events { { kSelected, { 1 } }, { kInvoked, { 1 } } }), lists.TakeEvents());
	lists.driver.Click(lists.list, BPoint(20, 140));
	EXPECT_EQ((Events { { kSelected, {} } }), lists.TakeEvents());
	EXPECT_EQ(-1, lists.list->CurrentSelection());
}


TEST(ListView, ShiftExtendsAndControlTogglesInAMultipleList)
{
	Lists lists(B_MULTIPLE_SELECTION_LIST);
	lists.driver.Click(lists.list, lists.Item(1));
	lists.driver.Click(lists.list, lists.Item(3), 1, 1, B_SHIFT_KEY);
	EXPECT_EQ((Events { { kSelected, { 1 } }, { kSelected, { 1, 2, 3 } } }), lists.TakeEvents());
	lists.driver.Click(lists.list, lists.Item(2), 1, 1, B_CONTROL_KEY);
	EXPECT_EQ((Events { { kSelected, { 1, 3 } } }), lists.TakeEvents());
	lists.driver.Click(lists.list, lists.Item(1));
	EXPECT_EQ((Events { { kSelected, { 1 } } }), lists.TakeEvents());
}


TEST(ListView, DisabledItemsAreNotSelected)
{
	Lists lists;
	lists.Locked([&] { lists.items[1]->SetEnabled(false); });
	lists.driver.Click(lists.list, lists.Item(1));
	EXPECT_EQ(Events(), lists.TakeEvents());
	lists.Locked([&] { lists.list->Select(0); });
	lists.driver.Key("Down");
	EXPECT_EQ((Events { { kSelected, { 0 } }, { kSelected, { 2 } } }), lists.TakeEvents());
}


TEST(ListView, KeysMoveTheSelectionAndInvoke)
{
	Lists lists;
	lists.Locked([&] { lists.list->MakeFocus(); });
	lists.driver.Key("Down", 0, 2);
	EXPECT_EQ((Events { { kSelected, { 0 } }, { kSelected, { 1 } } }), lists.TakeEvents());
	lists.driver.Key("End");
	lists.driver.Key("Up");
	lists.driver.Key("Home");
	EXPECT_EQ((Events { { kSelected, { 4 } }, { kSelected, { 3 } }, { kSelected, { 0 } } }),
		lists.TakeEvents());
	lists.driver.Key("Return");
	lists.driver.Key("Space");
	EXPECT_EQ((Events { { kInvoked, { 0 } }, { kInvoked, { 0 } } }), lists.TakeEvents());
}


TEST(ListView, ShiftArrowsExtendInAMultipleList)
{
	Lists lists(B_MULTIPLE_SELECTION_LIST);
	lists.driver.Click(lists.list, lists.Item(1));
	lists.driver.Key("Down", B_SHIFT_KEY, 2);
	lists.driver.Key("Up", B_SHIFT_KEY);
	EXPECT_EQ((Events { { kSelected, { 1 } }, { kSelected, { 1, 2 } }, { kSelected, { 1, 2, 3 } },
				  { kSelected, { 1, 2 } } }),
		lists.TakeEvents());
	lists.driver.Key("a", B_COMMAND_KEY);
	EXPECT_EQ((Events { { kSelected, { 0, 1, 2, 3, 4 } } }), lists.TakeEvents());
}


TEST(ListView, TypingFindsItemsByTheirBeginning)
{
	Lists lists;
	lists.Locked([&] { lists.list->MakeFocus(); });
	lists.driver.Type("g");
	EXPECT_EQ(2, lists.list->CurrentSelection());
	lists.TakeEvents();
}


TEST(ListView, TheSameLetterAgainGoesToTheNextItem)
{
	Lists lists;
	lists.Locked([&] { lists.list->MakeFocus(); });
	lists.driver.Type("b");
	EXPECT_EQ(1, lists.list->CurrentSelection());
	lists.driver.Type("b");
	EXPECT_EQ(4, lists.list->CurrentSelection());
	lists.driver.Type("b");
	EXPECT_EQ(1, lists.list->CurrentSelection());
}


TEST(ListView, WordsAreTypedOn)
{
	Lists lists;
	lists.Locked([&] { lists.list->MakeFocus(); });
	lists.driver.Type("br");
	EXPECT_EQ(4, lists.list->CurrentSelection());
}


TEST(ListView, DragIsOfferedOnceThePointerHasMovedFivePixels)
{
	Lists lists;
	lists.Locked([&] { lists.list->drag = true; });
	const BPoint press = lists.Item(3);
	lists.driver.MoveTo(lists.list, press);
	lists.driver.Press();
	lists.driver.MoveTo(lists.list, press + BPoint(4, 0));
	EXPECT_TRUE(lists.list->drags.empty());
	lists.driver.MoveTo(lists.list, press + BPoint(5, 0));
	EXPECT_EQ(std::vector<int32> { 3 }, lists.list->drags);
	EXPECT_EQ(press, lists.list->dragPoint);
	EXPECT_FALSE(lists.list->dragWasSelected);
	lists.driver.MoveTo(lists.list, lists.Item(0));
	lists.driver.Release();
	EXPECT_EQ(3, lists.list->CurrentSelection());
	EXPECT_EQ(1u, lists.list->drags.size());

	lists.driver.Drag(lists.list, press, lists.list, press + BPoint(20, 0));
	EXPECT_TRUE(lists.list->dragWasSelected);
}


TEST(ListView, ADragThatNobodyWantsSelects)
{
	Lists lists(B_MULTIPLE_SELECTION_LIST);
	lists.driver.Drag(lists.list, lists.Item(1), lists.list, lists.Item(3));
	int32 count = 0;
	for (int32 i = 1; i <= 3; i++)
		count += lists.list->IsItemSelected(i) ? 1 : 0;
	EXPECT_EQ(3, count);
}


TEST(ListView, PressingOneOfSeveralSelectedItemsKeepsThemForADrag)
{
	Lists lists(B_MULTIPLE_SELECTION_LIST);
	lists.Locked([&] {
		lists.list->Select(1, 3);
		lists.list->drag = true;
	});
	lists.driver.Drag(lists.list, lists.Item(2), lists.list, lists.Item(2) + BPoint(20, 0));
	EXPECT_EQ(1, lists.list->CurrentSelection(0));
	EXPECT_EQ(3, lists.list->CurrentSelection(2));
	lists.driver.Click(lists.list, lists.Item(2));
	EXPECT_EQ(2, lists.list->CurrentSelection(0));
	EXPECT_EQ(-1, lists.list->CurrentSelection(1));
}


TEST(ListView, ProgrammaticSelectionSendsTheMessageAndCallsTheHook)
{
	Lists lists;
	lists.Locked([&] {
		lists.list->Select(2);
		lists.list->Select(2);
		lists.list->DeselectAll();
	});
	EXPECT_EQ((Events { { kSelected, { 2 } }, { kSelected, {} } }), lists.TakeEvents());
	EXPECT_EQ(2, lists.list->changes);
}


TEST(ListView, SortsSwapsMovesAndReplaces)
{
	Lists lists;
	lists.Locked([&] {
		lists.list->Select(2);
		lists.list->SortItems([](const void* a, const void* b) {
			return strcasecmp((*static_cast<const BStringItem* const*>(a))->Text(),
				(*static_cast<const BStringItem* const*>(b))->Text());
		});
		const auto text = [&](int32 index) {
			return std::string(static_cast<BStringItem*>(lists.list->ItemAt(index))->Text());
		};
		EXPECT_EQ("alpha", text(0));
		EXPECT_EQ("Brook", text(2));
		EXPECT_EQ("gamma", text(4));
		EXPECT_EQ(4, lists.list->CurrentSelection());
		EXPECT_TRUE(lists.list->SwapItems(0, 4));
		EXPECT_EQ("gamma", text(0));
		EXPECT_EQ(0, lists.list->CurrentSelection());
		EXPECT_TRUE(lists.list->MoveItem(0, 2));
		EXPECT_EQ("gamma", text(2));
		lists.items.push_back(new BStringItem("new"));
		EXPECT_TRUE(lists.list->ReplaceItem(2, lists.items.back()));
		EXPECT_EQ("new", text(2));
		EXPECT_EQ(-1, lists.list->CurrentSelection());
		EXPECT_FALSE(lists.list->SwapItems(0, 7));
	});
}


TEST(ListView, ScrollBarFollowsTheItemsAndKeysScroll)
{
	TestWindow window;
	BListView* list = new BListView(BRect(10, 10, 109, 69), "list");
	window.Add(new BScrollView("scroll", list, B_FOLLOW_LEFT_TOP, 0, false, true));
	std::vector<std::unique_ptr<BListItem>> items;
	window.Locked([&] {
		for (int i = 0; i < 30; i++) {
			items.push_back(std::make_unique<BStringItem>("item"));
			list->AddItem(items.back().get());
		}
		list->MakeFocus();
		float minimum, maximum;
		list->ScrollBar(B_VERTICAL)->GetRange(&minimum, &maximum);
		EXPECT_EQ(list->ItemFrame(29).bottom - 59, maximum);
	});
	window.driver.Key("End");
	window.Locked([&] { EXPECT_EQ(list->ItemFrame(29).bottom, list->Bounds().bottom); });
	window.driver.Key("PageUp");
	window.Locked([&] {
		EXPECT_LT(list->CurrentSelection(), 28);
		EXPECT_TRUE(list->Bounds().Contains(list->ItemFrame(list->CurrentSelection()).LeftTop()));
		list->RemoveItems(5, 25);
	});
	window.driver.Wheel(list, 0, 3);
	window.Locked([&] {
		EXPECT_GT(list->Bounds().top, 0);
		list->MakeEmpty();
		float minimum, maximum;
		list->ScrollBar(B_VERTICAL)->GetRange(&minimum, &maximum);
		EXPECT_EQ(0, maximum);
	});
}


TEST(ListView, SelectedItemIsDrawnDarker)
{
	Lists lists;
	BPoint right;
	lists.Locked([&] { right = BPoint(140, lists.list->ItemFrame(1).top + 3); });
	EXPECT_EQ(255, lists.driver.PixelAt(lists.list, right).red);
	lists.Locked([&] { lists.list->Select(1); });
	EXPECT_LT(lists.driver.PixelAt(lists.list, right).red, 200);
	lists.Locked([&] { lists.list->DeselectAll(); });
	EXPECT_EQ(255, lists.driver.PixelAt(lists.list, right).red);
}


TEST(ListView, ArchiveRoundTripKeepsItemsSelectionAndMessages)
{
	BApplication app("application/x-vnd.Archway-test");
	BListView list(BRect(0, 0, 99, 99), "list", B_MULTIPLE_SELECTION_LIST);
	BStringItem one("one"), two("two", 1, false);
	two.SetEnabled(false);
	list.AddItem(&one);
	list.AddItem(&two);
	list.Select(0);
	list.SetSelectionMessage(new BMessage(kSelected));
	list.SetInvocationMessage(new BMessage(kInvoked));
	BMessage archive;
	ASSERT_EQ(B_OK, list.Archive(&archive));
	BMessage strange;
	strange.AddString("class", "StrangeItem");
	strange.AddInt32("own", 42);
	archive.AddMessage("_l_items", &strange);

	const std::unique_ptr<BListView> revived(
		dynamic_cast<BListView*>(instantiate_object(&archive)));
	ASSERT_NE(nullptr, revived);
	EXPECT_EQ(B_MULTIPLE_SELECTION_LIST, revived->ListType());
	ASSERT_EQ(3, revived->CountItems());
	EXPECT_STREQ("two", static_cast<BStringItem*>(revived->ItemAt(1))->Text());
	EXPECT_EQ(1u, revived->ItemAt(1)->OutlineLevel());
	EXPECT_FALSE(revived->ItemAt(1)->IsEnabled());
	EXPECT_FALSE(revived->ItemAt(1)->IsExpanded());
	EXPECT_EQ(0, revived->CurrentSelection());
	EXPECT_EQ(kSelected, revived->SelectionCommand());
	EXPECT_EQ(kInvoked, revived->InvocationCommand());
	BMessage again;
	ASSERT_EQ(B_OK, revived->Archive(&again));
	EXPECT_TRUE(again.HasSameData(archive));
}


TEST(ListView, RevivedItemThatWasRemovedBelongsToTheProgram)
{
	BApplication app("application/x-vnd.Archway-test");
	BListView list(BRect(0, 0, 99, 99), "list");
	BStringItem one("one"), two("two");
	list.AddItem(&one);
	list.AddItem(&two);
	BMessage archive;
	ASSERT_EQ(B_OK, list.Archive(&archive));
	BListView* revived = dynamic_cast<BListView*>(instantiate_object(&archive));
	ASSERT_NE(nullptr, revived);
	BListItem* item = revived->RemoveItem(static_cast<int32>(0));
	delete revived->ItemAt(0); // as programs do before they delete the list
	delete revived;
	EXPECT_STREQ("one", static_cast<BStringItem*>(item)->Text());
	delete item;
}
