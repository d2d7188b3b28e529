// What lists ask of classes made from them and from their items.
#include <ListItem.h>
#include <ListView.h>
#include <OutlineListView.h>
#include <ScrollBar.h>
#include <ScrollView.h>
#include <StringItem.h>

#include <memory>
#include <string>
#include <vector>

#include "ControlFixture.h"

namespace {

const BRect kFrame(10, 10, 209, 109);


class NotingItem : public BListItem {
public:
	explicit NotingItem(float height = 20) : fHeight(height) {}

	void DrawItem(BView* owner, BRect frame, bool) override
	{
		drawn.push_back(frame);
		owner->SetHighColor(255, 0, 0);
		owner->FillRect(frame);
	}

	void Update(BView* owner, const BFont* font) override
	{
		updates++;
		BListItem::Update(owner, font);
		SetHeight(fHeight);
	}

	std::vector<BRect> drawn;
	int updates = 0;

private:
	float fHeight;
};


class BaselineItem : public BStringItem {
public:
	using BStringItem::BStringItem;
	float Baseline() const { return BaselineOffset(); }
};


// A list of three items, which it outlives.
struct Items {
	explicit Items(BListView* list)
	{
		for (auto& item : all)
			list->AddItem(&item);
	}

	BStringItem all[3] = { BStringItem("a"), BStringItem("b"), BStringItem("c") };
};

} // namespace


TEST(ListHooks, AnItemIsUpdatedAndDrawnByItsList)
{
	ControlFixture fixture;
	NotingItem first, second(30);
	BListView* list = new BListView(kFrame, "list");
	list->AddItem(&first);
	list->AddItem(&second);
	EXPECT_EQ(0, first.updates) << "before it is attached";
	fixture.Add(list);
	EXPECT_EQ(1, first.updates) << "Update()";
	ASSERT_FALSE(second.drawn.empty());
	const BRect frame = fixture.Locked([&] { return list->ItemFrame(1); });
	EXPECT_EQ(frame, second.drawn.back());
	EXPECT_EQ(30, frame.Height() + 1);
	EXPECT_EQ(
		(rgb_color { 255, 0, 0, 255 }), fixture.driver.PixelAt(list, BPoint(100, frame.top + 2)));

	fixture.Locked([&] {
		BFont font(be_plain_font);
		font.SetSize(20);
		list->SetFont(&font);
		EXPECT_EQ(2, first.updates);
		list->MakeEmpty();
	});
}


TEST(ListHooks, ABListItemTakesTheHeightOfTheFont)
{
	class Plain : public BListItem {
	public:
		void DrawItem(BView*, BRect, bool) override {}
	};
	BApplication app("application/x-vnd.Archway-test");
	BListView list(kFrame, "list");
	Plain item;
	item.Update(&list, be_plain_font);
	font_height height;
	be_plain_font->GetHeight(&height);
	EXPECT_FLOAT_EQ(height.ascent + height.descent + height.leading, item.Height());
	EXPECT_EQ(list.Bounds().Width(), item.Width());
	EXPECT_EQ(B_ERROR, item.Perform('none', NULL));
}


TEST(ListHooks, ABStringItemHasItsTextOnTheBaseline)
{
	BApplication app("application/x-vnd.Archway-test");
	BListView list(kFrame, "list");
	BaselineItem item("Text");
	item.Update(&list, be_plain_font);
	font_height height;
	be_plain_font->GetHeight(&height);
	EXPECT_GE(item.Baseline(), height.ascent) << "BaselineOffset()";
	EXPECT_LE(item.Baseline() + height.descent, item.Height());
	EXPECT_GE(item.Height(), height.ascent + height.descent);
	EXPECT_GE(item.Width(), be_plain_font->StringWidth("Text"));
}


TEST(ListHooks, ABListItemKnowsWhetherItIsSeen)
{
	BApplication app("application/x-vnd.Archway-test");
	BOutlineListView list(kFrame, "list");
	BStringItem top("top"), under("under");
	list.AddItem(&top);
	list.AddUnder(&under, &top);
	EXPECT_TRUE(under.IsItemVisible());
	list.Collapse(&top);
	EXPECT_FALSE(under.IsItemVisible());
	EXPECT_TRUE(top.IsItemVisible());
	list.Expand(&top);
	EXPECT_TRUE(under.IsItemVisible());
	list.MakeEmpty();
}


TEST(ListHooks, ABListItemKeepsItsFieldsInArchives)
{
	BApplication app("application/x-vnd.Archway-test");
	BStringItem item("Text", 3, false);
	item.SetEnabled(false);
	item.Select();
	const BMessage archive = ArchiveOf(item);
	EXPECT_TRUE(archive.GetBool("_disable", false));
	EXPECT_TRUE(archive.GetBool("_sel", false));
	EXPECT_EQ(3, archive.GetInt32("_li_outline_level", 0));
	EXPECT_FALSE(archive.HasBool("_li_expanded")) << "it is collapsed";
	const std::unique_ptr<BStringItem> revived = Revive<BStringItem>(archive);
	EXPECT_FALSE(revived->IsEnabled());
	EXPECT_TRUE(revived->IsSelected());
	EXPECT_EQ(3u, revived->OutlineLevel());
	EXPECT_FALSE(revived->IsExpanded());
}


TEST(ListHooks, EveryRearrangementOfABListViewGoesThroughDoMiscellaneous)
{
	class Noting : public BListView {
	public:
		using BListView::BListView;
		bool DoMiscellaneous(MiscCode code, MiscData* data) override
		{
			codes += std::to_string(code) + " ";
			return refuse ? false : BListView::DoMiscellaneous(code, data);
		}
		std::string codes;
		bool refuse = false;
		const char* Expected() const
		{
			static const std::string kCodes = std::to_string(B_SWAP_OP) + " "
				+ std::to_string(B_MOVE_OP) + " " + std::to_string(B_REPLACE_OP) + " ";
			return kCodes.c_str();
		}
	};
	BApplication app("application/x-vnd.Archway-test");
	Noting list(kFrame, "list");
	Items items(&list);
	BStringItem other("other");
	EXPECT_TRUE(list.SwapItems(0, 2));
	EXPECT_EQ(&items.all[2], list.ItemAt(0));
	EXPECT_TRUE(list.MoveItem(0, 1));
	EXPECT_EQ(&items.all[2], list.ItemAt(1));
	EXPECT_TRUE(list.ReplaceItem(0, &other));
	EXPECT_EQ(&other, list.ItemAt(0));
	EXPECT_EQ(list.Expected(), list.codes);
	list.refuse = true;
	EXPECT_FALSE(list.SwapItems(0, 1));
	EXPECT_EQ(&other, list.ItemAt(0));
	list.MakeEmpty();
}


TEST(ListHooks, ABListViewHasTheSizeOfItsItems)
{
	ControlFixture fixture;
	BListView* list = fixture.Add(new BListView(kFrame, "list"));
	BOutlineListView* outline =
		fixture.Add(new BOutlineListView(kFrame.OffsetByCopy(0, 120), "outline"));
	BStringItem item("A text"), longer("A text that is longer");
	BStringItem third("A text"), fourth("A text that is longer");
	fixture.Locked([&] {
		list->AddItem(&item);
		list->AddItem(&longer);
		outline->AddItem(&third);
		outline->AddItem(&fourth);
		for (BListView* each : { list, static_cast<BListView*>(outline) }) {
			each->ResizeToPreferred();
			EXPECT_EQ(each->ItemFrame(1).bottom, each->Bounds().bottom);
			EXPECT_GE(each->Bounds().right, each->StringWidth("A text that is longer"));
		}
		list->MakeEmpty();
		outline->MakeEmpty();
	});
}


TEST(ListHooks, ABListViewIsToldOfItsScrollView)
{
	class Targeted : public BListView {
	public:
		using BListView::BListView;
		void TargetedByScrollView(BScrollView* view) override
		{
			scroller = view;
			BListView::TargetedByScrollView(view);
		}
		BScrollView* scroller = NULL;
	};
	ControlFixture fixture;
	Targeted* list = new Targeted(kFrame, "list");
	BScrollView* scroller = fixture.Add(new BScrollView("scroller", list, 0, 0, false, true));
	EXPECT_EQ(scroller, list->scroller) << "TargetedByScrollView()";
	fixture.Focus(list);
	EXPECT_TRUE(fixture.Locked([&] { return scroller->IsBorderHighlighted(); }));
	fixture.Locked([&] {
		scroller->SetTarget(NULL);
		EXPECT_EQ(nullptr, list->scroller);
	});
	delete list;
}


TEST(ListHooks, ABScrollViewHasNoSizeOfItsOwn)
{
	ControlFixture fixture;
	BListView* list = new BListView(kFrame, "list");
	Items items(list);
	BScrollView* scroller = fixture.Add(new BScrollView("scroller", list, 0, 0, false, true));
	fixture.Locked([&] {
		const BRect frame = scroller->Frame();
		float width, height;
		scroller->GetPreferredSize(&width, &height);
		EXPECT_EQ(frame.Width(), width);
		EXPECT_EQ(frame.Height(), height);
		scroller->ResizeToPreferred();
		EXPECT_EQ(frame, scroller->Frame());
		list->MakeEmpty();
	});
}


namespace {

class HookedOutline : public BOutlineListView {
public:
	using BOutlineListView::BOutlineListView;

	void ExpandOrCollapse(BListItem* item, bool expand) override
	{
		calls += expand ? "expand " : "collapse ";
		if (!refuse)
			BOutlineListView::ExpandOrCollapse(item, expand);
	}

	BRect LatchRect(BRect itemRect, int32 level) const override
	{
		BRect rect = BOutlineListView::LatchRect(itemRect, level);
		rect.OffsetBy(shift, 0);
		return rect;
	}

	void DrawLatch(
		BRect itemRect, int32 level, bool collapsed, bool highlighted, bool misTracked) override
	{
		latches++;
		BOutlineListView::DrawLatch(itemRect, level, collapsed, highlighted, misTracked);
	}

	void DrawItem(BListItem* item, BRect frame, bool complete) override
	{
		itemLeft = frame.left;
		items++;
		BOutlineListView::DrawItem(item, frame, complete);
	}

	BRect Latch(int32 index) { return LatchRect(ItemFrame(index), 0); }

	std::string calls;
	bool refuse = false;
	float shift = 0, itemLeft = -1;
	int latches = 0, items = 0;
};

} // namespace


TEST(ListHooks, OfABOutlineListViewDrawLatchesAndItems)
{
	ControlFixture fixture;
	BStringItem top("top"), under("under");
	HookedOutline* list = new HookedOutline(kFrame, "list");
	list->AddItem(&top);
	list->AddUnder(&under, &top);
	fixture.Add(list);
	fixture.Locked([&] {
		list->latches = list->items = 0;
		list->Invalidate();
	});
	EXPECT_EQ(1, list->latches) << "DrawLatch() for the item with others under it";
	EXPECT_EQ(2, list->items) << "DrawItem()";
	EXPECT_EQ(0, list->itemLeft);
	fixture.Locked([&] { list->MakeEmpty(); });
}


TEST(ListHooks, AClickInTheLatchRectCallsExpandOrCollapse)
{
	ControlFixture fixture;
	BStringItem top("top"), under("under");
	HookedOutline* list = new HookedOutline(kFrame, "list");
	list->AddItem(&top);
	list->AddUnder(&under, &top);
	list->shift = 100;
	fixture.Add(list);
	const BRect latch = fixture.Locked([&] { return list->Latch(0); });
	const BPoint middle((latch.left + latch.right) / 2, (latch.top + latch.bottom) / 2);
	fixture.driver.Click(list, middle - BPoint(100, 0));
	EXPECT_EQ("", list->calls) << "LatchRect() has moved it";
	fixture.driver.Click(list, middle);
	EXPECT_EQ("collapse ", list->calls);
	EXPECT_EQ(1, list->CountItems());
	fixture.Locked([&] { list->refuse = true; });
	fixture.driver.Click(list, middle);
	EXPECT_EQ("collapse expand ", list->calls);
	EXPECT_EQ(1, list->CountItems());
	fixture.Locked([&] { list->MakeEmpty(); });
}


TEST(ListHooks, RearrangementsOfABOutlineListViewGoThroughDoMiscellaneous)
{
	class Noting : public BOutlineListView {
	public:
		using BOutlineListView::BOutlineListView;
		bool DoMiscellaneous(MiscCode code, MiscData* data) override
		{
			calls++;
			return BOutlineListView::DoMiscellaneous(code, data);
		}
		int calls = 0;
	};
	BApplication app("application/x-vnd.Archway-test");
	Noting list(kFrame, "list");
	Items items(&list);
	EXPECT_TRUE(list.SwapItems(0, 1));
	EXPECT_EQ(1, list.calls);
	EXPECT_EQ(&items.all[1], list.ItemAt(0));
	list.MakeEmpty();
}


TEST(ListView, TheKeysBeginWithTheFirstItemWhereNothingIsSelected)
{
	ControlFixture fixture;
	BListView* list = fixture.Add(new BListView(kFrame, "list"));
	NotingItem items[3];
	fixture.Locked([&] {
		for (NotingItem& item : items)
			list->AddItem(&item);
		list->MakeFocus();
	});
	for (const char* key : { "Down", "Up" }) {
		fixture.Locked([&] {
			list->Select(1);
			list->DeselectAll();
		});
		fixture.driver.Key(key);
		fixture.Locked([&] { EXPECT_EQ(0, list->CurrentSelection()) << key; });
	}
	fixture.Locked([&] { list->MakeEmpty(); });
}
