#include "archive/ViewTree.h"

#include <cstring>

#include <gtest/gtest.h>

#include <AppDefs.h>
#include <Bitmap.h>
#include <Box.h>
#include <Button.h>
#include <ListView.h>
#include <Menu.h>
#include <MenuBar.h>
#include <MenuItem.h>
#include <ScrollBar.h>
#include <ScrollView.h>
#include <TabView.h>
#include <TextControl.h>
#include <TextView.h>

#include "archive/BitmapView.h"
#include "support/TestWindow.h"

namespace {


constexpr rgb_color kRed = { 255, 0, 0, 255 };
constexpr rgb_color kGreen = { 0, 255, 0, 255 };
constexpr rgb_color kBlue = { 0, 0, 255, 255 };


bool
SameColor(rgb_color a, rgb_color b)
{
	return a.red == b.red && a.green == b.green && a.blue == b.blue && a.alpha == b.alpha;
}


BView*
MakeView(float left, float top, float right, float bottom, const char* name = NULL)
{
	return new BView(
		BRect(left, top, right, bottom), name, B_FOLLOW_LEFT | B_FOLLOW_TOP, B_WILL_DRAW);
}


BScrollView*
MakeScrollView(BView* target)
{
	return new BScrollView("scroll", target, B_FOLLOW_LEFT | B_FOLLOW_TOP, 0, true, true);
}


} // namespace


TEST(ColorfulAddChild, KeepsTheColorsOfAWholeTree)
{
	TestWindow window;
	BView* parent = MakeView(0, 0, 299, 199);
	parent->SetViewColor(kBlue);
	window.Add(parent);

	BBox* box = new BBox(BRect(10, 10, 200, 150), "box");
	box->SetViewColor(kRed);
	box->SetLowColor(kGreen);
	BButton* button = new BButton(BRect(5, 20, 80, 40), "button", "B", NULL);
	button->SetViewColor(kGreen);
	box->AddChild(button);

	window.Locked([&] { EXPECT_EQ(box, ColorfulAddChild(parent, box)); });

	EXPECT_TRUE(SameColor(kRed, box->ViewColor()));
	EXPECT_TRUE(SameColor(kGreen, box->LowColor()));
	EXPECT_TRUE(SameColor(kGreen, button->ViewColor()));
}


TEST(ColorfulAddChild, KeepsTheColorsOfTheSelectedPage)
{
	TestWindow window;
	BView* parent = MakeView(0, 0, 299, 199);
	parent->SetViewColor(kBlue);
	window.Add(parent);

	BTabView* tabs = new BTabView(BRect(0, 0, 200, 150), "tabs");
	BView* page = MakeView(0, 0, 150, 100, "page");
	page->SetViewColor(kRed);
	BBox* inner = new BBox(BRect(10, 10, 60, 60), "inner");
	inner->SetViewColor(kGreen);
	page->AddChild(inner);
	tabs->AddTab(page);
	tabs->AddTab(MakeView(0, 0, 150, 100, "second"));
	tabs->ContainerView()->SetViewColor(kBlue);

	window.Locked([&] { ColorfulAddChild(parent, tabs); });

	ASSERT_EQ(tabs->ContainerView(), page->Parent());
	EXPECT_TRUE(SameColor(kRed, page->ViewColor()));
	EXPECT_TRUE(SameColor(kGreen, inner->ViewColor()));
	EXPECT_TRUE(SameColor(kBlue, tabs->ContainerView()->ViewColor()));
}


// A revived tab view without a selection takes none when it is attached.
TEST(ColorfulAddChild, KeepsTheColorsBesideATabViewThatShowsNoPage)
{
	TestWindow window;
	BTabView tabs(BRect(0, 0, 99, 99), "tabs");
	tabs.AddTab(new BView(BRect(0, 0, 50, 50), "page", B_FOLLOW_NONE, B_WILL_DRAW));
	BMessage archive;
	tabs.Archive(&archive, true);
	archive.ReplaceInt32("_sel", -1);

	BView* parent = new BView(BRect(0, 0, 299, 299), "parent", B_FOLLOW_NONE, B_WILL_DRAW);
	window.Add(parent);
	BView* group = new BView(BRect(0, 0, 199, 199), "group", B_FOLLOW_NONE, B_WILL_DRAW);
	group->AddChild(new BTabView(&archive));
	BView* last = new BView(BRect(100, 0, 199, 99), "last", B_FOLLOW_NONE, B_WILL_DRAW);
	last->SetLowColor(1, 2, 3);
	group->AddChild(last);
	window.Locked([&] { ColorfulAddChild(parent, group); });
	EXPECT_EQ(2, last->LowColor().green);
}


TEST(ColorfulAddChild, KeepsTheColorsInAWindowAndInABitmap)
{
	TestWindow window;
	BBitmap bitmap(BRect(0, 0, 99, 99), B_RGBA32, true);
	BButton* inWindow = new BButton(BRect(5, 5, 80, 30), "inner", "B", NULL);
	BButton inBitmap(BRect(5, 5, 80, 30), "inner", "B", NULL);
	for (BView* view : { static_cast<BView*>(inWindow), static_cast<BView*>(&inBitmap) }) {
		view->SetViewColor(kRed);
		view->SetLowColor(kGreen);
	}
	window.Locked([&] { EXPECT_EQ(inWindow, ColorfulAddChild(window.Window(), inWindow)); });
	bitmap.Lock();
	EXPECT_EQ(&inBitmap, ColorfulAddChild(&bitmap, &inBitmap));
	for (const BView* view : { static_cast<BView*>(inWindow), static_cast<BView*>(&inBitmap) }) {
		EXPECT_NE(nullptr, view->Window() != nullptr ? view : view->Parent());
		EXPECT_TRUE(SameColor(kRed, view->ViewColor()));
		EXPECT_TRUE(SameColor(kGreen, view->LowColor()));
	}
	bitmap.RemoveChild(&inBitmap);
	bitmap.Unlock();
}


TEST(ColorfulAddChild, DoesNothingForNull)
{
	TestWindow window;
	BView* parent = window.Add(MakeView(0, 0, 99, 99));
	window.Locked([&] { EXPECT_EQ(NULL, ColorfulAddChild(parent, NULL)); });
	EXPECT_EQ(0, parent->CountChildren());
}


TEST(FrameControled, IsTrueForViewsThatTheirParentsPlace)
{
	TestWindow window;
	BView* target = MakeView(0, 0, 50, 50);
	BScrollView* scroll = window.Add(MakeScrollView(target));
	BTextControl* text = window.Add(new BTextControl(BRect(0, 100, 99, 120), "t", "L", "", NULL));
	BTabView* tabs = window.Add(new BTabView(BRect(100, 0, 299, 199), "tabs"));
	BView* page = MakeView(0, 0, 50, 50);
	window.Locked([&] {
		tabs->AddTab(page);
		tabs->Select(0);
	});

	BListView* list = window.Add(new BListView(BRect(0, 150, 90, 190), "list"));
	BView* inList = MakeView(0, 0, 10, 10);
	window.Locked([&] { list->AddChild(inList); });
	EXPECT_TRUE(FrameControled(inList));
	EXPECT_TRUE(FrameControled(scroll->ScrollBar(B_VERTICAL)));
	EXPECT_FALSE(FrameControled(list));

	EXPECT_TRUE(FrameControled(target));
	EXPECT_TRUE(FrameControled(text->TextView()));
	EXPECT_TRUE(FrameControled(page));
	EXPECT_TRUE(FrameControled(tabs->ContainerView()));
	EXPECT_FALSE(FrameControled(scroll));
	EXPECT_FALSE(FrameControled(NULL));
}


TEST(PointInView, FindsTheDeepestAndEarlierView)
{
	TestWindow window;
	BView* root = MakeView(0, 0, 199, 199);
	BView* first = MakeView(10, 10, 99, 99);
	BView* second = MakeView(50, 50, 149, 149);
	BView* inner = MakeView(5, 5, 20, 20);
	first->AddChild(inner);
	root->AddChild(first);
	root->AddChild(second);
	window.Add(root);

	window.Locked([&] {
		EXPECT_EQ(NULL, PointInView(root, BPoint(300, 5), NULL));
		EXPECT_EQ(first, PointInView(root, BPoint(60, 60), NULL));
		EXPECT_EQ(inner, PointInView(root, BPoint(20, 20), NULL));
		EXPECT_EQ(root, PointInView(root, BPoint(1, 1), NULL));
		EXPECT_EQ(second, PointInView(root, BPoint(60, 60), first));
		EXPECT_EQ(NULL, PointInView(root, BPoint(60, 60), root));
	});
}


TEST(PointInView, NeverFindsScrollBars)
{
	TestWindow window;
	BView* target = MakeView(0, 0, 50, 50);
	BScrollView* scroll = window.Add(MakeScrollView(target));
	window.Locked([&] {
		const BRect bar = scroll->ScrollBar(B_VERTICAL)->Frame();
		EXPECT_EQ(scroll, PointInView(scroll, BPoint(bar.left + 3, bar.top + 20), NULL));
		EXPECT_EQ(target, PointInView(scroll, BPoint(20, 20), NULL));
	});
}


TEST(ViewAttached, FindsAViewByItsAddress)
{
	BView root(BRect(0, 0, 99, 99), NULL, 0, 0);
	BView* child = MakeView(0, 0, 9, 9);
	BView* grandchild = MakeView(0, 0, 5, 5);
	child->AddChild(grandchild);
	root.AddChild(child);
	BView stranger(BRect(0, 0, 9, 9), NULL, 0, 0);

	EXPECT_EQ(&root, ViewAttached(&root, &root));
	EXPECT_EQ(grandchild, ViewAttached(&root, grandchild));
	EXPECT_EQ(NULL, ViewAttached(&root, &stranger));
	EXPECT_EQ(NULL, ViewAttached(&root, NULL));
	EXPECT_EQ(NULL, ViewAttached(NULL, &root));

	EXPECT_EQ(grandchild, LiveViewAttached(&root, grandchild));
	EXPECT_EQ(NULL, LiveViewAttached(child, &root));
}


TEST(PathTo, LeadsBackToTheView)
{
	BView root(BRect(0, 0, 99, 99), NULL, 0, 0);
	root.AddChild(MakeView(0, 0, 9, 9));
	BView* second = MakeView(0, 0, 9, 9);
	root.AddChild(second);
	BView* inner = MakeView(0, 0, 5, 5);
	second->AddChild(inner);

	EXPECT_EQ((std::vector<int32> { 1, 0 }), PathTo(&root, inner));
	EXPECT_EQ(inner, ViewAtPath(&root, PathTo(&root, inner)));
	EXPECT_EQ(&root, ViewAtPath(&root, {}));
	EXPECT_EQ(second, ViewAtPath(&root, { 1, 7, 2 }));
}


TEST(SetTarget, AimsControlsAndNestedMenuItems)
{
	TestWindow window;
	BView* root = MakeView(0, 0, 299, 199);
	BButton* button = new BButton(BRect(0, 30, 80, 50), "b", "B", new BMessage('prss'));
	root->AddChild(button);
	BMenuBar* bar = new BMenuBar(BRect(0, 0, 299, 15), "bar");
	BMenu* menu = new BMenu("Menu");
	BMenu* submenu = new BMenu("Sub");
	BMenuItem* item = new BMenuItem("Item", new BMessage('item'));
	submenu->AddItem(item);
	menu->AddItem(submenu);
	bar->AddItem(menu);
	root->AddChild(bar);
	window.Add(root);

	window.Locked([&] {
		SetTarget(root, root, NULL);
		EXPECT_EQ(root, button->Target());
		EXPECT_EQ(root, item->Target());
		SetTarget(root, BMessenger(button));
		EXPECT_EQ(button, button->Target());
		EXPECT_EQ(button, item->Target());
	});
}


TEST(SetRange, IsEmptyForAContentThatFits)
{
	TestWindow window;
	BScrollView* scroll = window.Add(MakeScrollView(MakeView(0, 0, 100, 100)));
	float minimum, maximum;
	window.Locked([&] {
		SetRange(scroll, 60, 250.5);
		scroll->ScrollBar(B_HORIZONTAL)->GetRange(&minimum, &maximum);
		EXPECT_EQ(0, minimum);
		EXPECT_EQ(0, maximum);
		scroll->ScrollBar(B_VERTICAL)->GetRange(&minimum, &maximum);
		EXPECT_EQ(151, maximum);
		EXPECT_FLOAT_EQ(100.0f / 251.0f, scroll->ScrollBar(B_VERTICAL)->Proportion());
		SetRange((BScrollView*)NULL, 1, 1);
	});
}


TEST(SetProportions, ShowAllOfATargetWithoutExtent)
{
	TestWindow window;
	BScrollView* scroll = window.Add(MakeScrollView(MakeView(0, 0, 0, 100)));
	window.Locked([&] {
		scroll->ScrollBar(B_HORIZONTAL)->SetRange(0, 0);
		scroll->ScrollBar(B_VERTICAL)->SetRange(0, 300);
		SetProportions(scroll);
		EXPECT_EQ(1, scroll->ScrollBar(B_HORIZONTAL)->Proportion());
		EXPECT_EQ(0.25f, scroll->ScrollBar(B_VERTICAL)->Proportion());
		SetProportions(NULL);
	});
}


TEST(MoveScrolledViews, AndBackLeavesEveryFrame)
{
	TestWindow window;
	BView* target = MakeView(0, 0, 100, 100);
	BView* child = MakeView(20, 30, 40, 50);
	target->AddChild(child);
	BScrollView* scroll = window.Add(MakeScrollView(target));
	window.Locked([&] {
		target->ScrollTo(BPoint(5, 7));
		EXPECT_EQ(BPoint(5, 7), ScrolledBy(child));
		EXPECT_EQ(BPoint(0, 0), ScrolledBy(scroll));

		const BRect before = child->Frame();
		MoveScrolledViews(scroll, false);
		EXPECT_EQ(before.OffsetByCopy(5, 7), child->Frame());
		MoveScrolledViews(scroll, true);
		EXPECT_EQ(before, child->Frame());
	});
}


TEST(DrawView, ShowsScrollBarsAsFlatBoxes)
{
	TestWindow window;
	BBitmap bitmap(BRect(0, 0, 119, 119), B_RGBA32, true);
	BView* target = MakeView(0, 0, 80, 80);
	BScrollView* scroll = MakeScrollView(target);
	scroll->MoveTo(0, 0);

	bitmap.Lock();
	ColorfulAddChild(&bitmap, scroll);
	EraseBackground(scroll);
	DrawView(scroll);
	const BRect bar = scroll->ScrollBar(B_VERTICAL)->Frame();
	scroll->Sync();
	auto pixel = [&bitmap](float x, float y) {
		const uint8* bits = static_cast<const uint8*>(bitmap.Bits())
			+ static_cast<int32>(y) * bitmap.BytesPerRow() + static_cast<int32>(x) * 4;
		return rgb_color { bits[2], bits[1], bits[0], 255 };
	};
	EXPECT_TRUE(SameColor({ 152, 152, 152, 255 }, pixel(bar.right, bar.top + 20)));
	EXPECT_TRUE(SameColor({ 240, 240, 240, 255 }, pixel(bar.left + 6, bar.top + 20)));
	EXPECT_TRUE(SameColor({ 255, 255, 255, 255 }, pixel(bar.left + 1, bar.top + 20)));
	EXPECT_TRUE(SameColor({ 255, 255, 255, 255 }, pixel(40, 40)));
	bitmap.RemoveChild(scroll);
	bitmap.Unlock();
	delete scroll;
}


// Tells whether it was shown as in an active window, and keeps its high colour to the end.
class ActiveView : public BView {
public:
	ActiveView(BRect frame) : BView(frame, "active", B_FOLLOW_NONE, B_WILL_DRAW)
	{
		SetViewColor(kRed);
		SetHighColor(kGreen);
	}

	void WindowActivated(bool active) override { activated = active; }

	bool activated = false;
};


TEST(EraseBackground, PaintsTheGroundOfEveryViewButScrollBars)
{
	TestWindow window;
	BBitmap picture(BRect(0, 0, 19, 19), B_RGBA32);
	memset(picture.Bits(), 0x80, static_cast<size_t>(picture.BitsLength()));
	BBitmap bitmap(BRect(0, 0, 119, 119), B_RGBA32, true);
	memset(bitmap.Bits(), 0, static_cast<size_t>(bitmap.BitsLength()));
	ActiveView* root = new ActiveView(BRect(0, 0, 119, 119));
	BitmapView* image = new BitmapView(BRect(10, 10, 49, 49), "", B_FOLLOW_NONE, B_WILL_DRAW);
	image->SetViewColor(kGreen);
	image->SetBitmap(&picture);
	root->AddChild(image);
	BScrollBar* bar = new BScrollBar(BRect(80, 10, 94, 99), "", NULL, 0, 0, B_VERTICAL);
	bar->SetViewColor(kGreen);
	root->AddChild(bar);

	bitmap.Lock();
	ColorfulAddChild(&bitmap, root);
	EraseBackground(root);
	EraseBackground(NULL);
	root->Sync();
	const auto pixel = [&bitmap](int32 x, int32 y) {
		const uint8* bits =
			static_cast<const uint8*>(bitmap.Bits()) + y * bitmap.BytesPerRow() + x * 4;
		return rgb_color { bits[2], bits[1], bits[0], 255 };
	};
	EXPECT_TRUE(SameColor(kRed, pixel(5, 5)));
	EXPECT_TRUE(SameColor({ 0x80, 0x80, 0x80, 255 }, pixel(15, 15)));
	// A view draws nothing where its children are.
	const rgb_color untouched = { 0, 0, 0, 255 };
	EXPECT_TRUE(SameColor(untouched, pixel(40, 40))); // the picture is drawn once
	EXPECT_TRUE(SameColor(untouched, pixel(87, 50))); // in the scroll bar
	EXPECT_TRUE(root->activated);
	EXPECT_TRUE(SameColor(kGreen, root->HighColor()));
	bitmap.RemoveChild(root);
	bitmap.Unlock();
	delete root;
}


TEST(WatchMessages, PrintsAllButTheFrequentCodes)
{
	testing::internal::CaptureStdout();
	BMessage message('Code'), pulse(B_PULSE), moved(B_MOUSE_MOVED), pending('_EVP');
	BHandler* target = NULL;
	BMessageFilter filter(B_ANY_DELIVERY, B_ANY_SOURCE);
	for (BMessage* each : { &message, &pulse, &moved, &pending })
		EXPECT_EQ(B_DISPATCH_MESSAGE, WatchMessages(each, &target, &filter));
	fflush(stdout);
	EXPECT_EQ("Code\n", testing::internal::GetCapturedStdout());
}


TEST(ActivateOnClick, ActivatesTheClickedWindow)
{
	TestWindow window;
	BWindow* other = new BWindow(BRect(500, 50, 599, 149), "other", B_TITLED_WINDOW, 0);
	other->Show();
	Driver::WaitUntilIdle();
	window.Locked([&] {
		window.Window()->AddCommonFilter(
			new BMessageFilter(B_ANY_DELIVERY, B_ANY_SOURCE, ActivateOnClick));
	});
	ASSERT_TRUE(other->IsActive());

	BMessage press(B_MOUSE_DOWN);
	window.Window()->PostMessage(&press);
	Driver::WaitUntilIdle();
	EXPECT_TRUE(window.Window()->IsActive());
	EXPECT_FALSE(other->IsActive());

	other->Lock();
	other->Quit();
}
