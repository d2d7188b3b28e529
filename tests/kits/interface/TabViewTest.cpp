#include <TabView.h>

#include <cmath>

#include <Button.h>
#include <Font.h>

#include "ControlFixture.h"
#include "support/Dump.h"

namespace {

BView*
NewPage(const char* name)
{
	return new BView(BRect(0, 0, 99, 59), name, B_FOLLOW_ALL, B_WILL_DRAW);
}


BTabView*
NewTabView(int32 pages = 3)
{
	BTabView* view = new BTabView(BRect(20, 20, 319, 219), "tabs");
	const char* const names[] = { "First", "Second", "Third", "Fourth", "Fifth" };
	for (int32 i = 0; i < pages; i++)
		view->AddTab(NewPage(names[i]));
	return view;
}


std::string
Labels(const BTabView* view)
{
	std::string result;
	for (int32 i = 0; i < view->CountTabs(); i++)
		result += std::string(i == 0 ? "" : " ") + view->TabAt(i)->Label();
	return result;
}


BPoint
MiddleOfTab(const BTabView* view, int32 index)
{
	const BRect frame = view->TabFrame(index);
	return BPoint(std::floor((frame.left + frame.right) / 2), std::floor(frame.bottom / 2));
}

} // namespace


TEST(TabView, HasTheDefaultsOfItsClass)
{
	BApplication app("application/x-vnd.Archway-test");
	BTabView view(BRect(0, 0, 299, 199), "tabs");
	EXPECT_EQ(static_cast<uint32>(B_FULL_UPDATE_ON_RESIZE | B_WILL_DRAW | B_NAVIGABLE_JUMP
				  | B_FRAME_EVENTS | B_NAVIGABLE),
		view.Flags());
	EXPECT_EQ(static_cast<uint32>(B_FOLLOW_ALL), view.ResizingMode());
	EXPECT_EQ(B_WIDTH_AS_USUAL, view.TabWidth());
	font_height height;
	be_plain_font->GetHeight(&height);
	EXPECT_EQ(std::ceil(height.ascent + height.descent + height.leading) + 8, view.TabHeight());

	ASSERT_EQ(1, view.CountChildren());
	EXPECT_EQ(view.ContainerView(), view.ChildAt(0));
	EXPECT_STREQ("view container", view.ContainerView()->Name());
	EXPECT_EQ(BRect(3, view.TabHeight() + 3, 296, 196), view.ContainerView()->Frame());
	EXPECT_EQ(0, view.CountTabs());
	EXPECT_LT(view.Selection(), 0);
}


TEST(TabView, OnlyTheSelectedPageIsInTheTree)
{
	ControlFixture fixture;
	BTabView* view = fixture.Add(NewTabView());
	fixture.Locked([&] {
		EXPECT_EQ(0, view->Selection());
		EXPECT_EQ(view->ContainerView(), view->ViewForTab(0)->Parent());
		EXPECT_EQ(nullptr, view->ViewForTab(1)->Parent());
		EXPECT_EQ(nullptr, view->ViewForTab(1)->Window());
		EXPECT_EQ(nullptr, view->FindView("Second"));

		view->Select(1);
		EXPECT_EQ(1, view->Selection());
		EXPECT_EQ(nullptr, view->ViewForTab(0)->Parent());
		EXPECT_EQ(view->ContainerView(), view->ViewForTab(1)->Parent());
		EXPECT_FALSE(view->TabAt(0)->IsSelected());
		EXPECT_TRUE(view->TabAt(1)->IsSelected());
		view->Select(17);
		EXPECT_EQ(1, view->Selection());
	});
}


TEST(TabView, TheFirstTabOfAnAttachedViewIsSelectedTheNextOnesAreNot)
{
	ControlFixture fixture;
	BTabView* view = fixture.Add(NewTabView(0));
	fixture.Locked([&] {
		view->AddTab(NewPage("a"));
		EXPECT_EQ(0, view->Selection());
		view->AddTab(NewPage("b"));
		EXPECT_EQ(0, view->Selection());
	});
}


TEST(TabView, RemovingATabKeepsOneSelected)
{
	ControlFixture fixture;
	BTabView* view = fixture.Add(NewTabView(4));
	fixture.Locked([&] {
		view->Select(2);
		delete view->RemoveTab(0);
		EXPECT_EQ("Second Third Fourth", Labels(view));
		EXPECT_EQ(1, view->Selection());
		EXPECT_EQ(view->ContainerView(), view->ViewForTab(1)->Parent());

		delete view->RemoveTab(1);
		EXPECT_EQ(0, view->Selection());
		EXPECT_EQ(view->ContainerView(), view->ViewForTab(0)->Parent());
		delete view->RemoveTab(0);
		EXPECT_EQ("Fourth", Labels(view));
		EXPECT_EQ(0, view->Selection());
		EXPECT_EQ(view->ContainerView(), view->ViewForTab(0)->Parent());

		delete view->RemoveTab(0);
		EXPECT_EQ(0, view->CountTabs());
		EXPECT_EQ(0, view->ContainerView()->CountChildren());
		EXPECT_EQ(nullptr, view->RemoveTab(0));
		view->AddTab(NewPage("new"));
		EXPECT_EQ(0, view->Selection());
	});
}


TEST(TabView, ARemovedTabIsTheCallers)
{
	ControlFixture fixture;
	BTabView* view = fixture.Add(NewTabView(2));
	fixture.Locked([&] {
		BTab* tab = view->RemoveTab(0);
		ASSERT_NE(nullptr, tab);
		EXPECT_STREQ("First", tab->Label());
		EXPECT_EQ(nullptr, tab->View()->Parent());
		view->AddTab(tab->View(), tab);
		EXPECT_EQ("Second First", Labels(view));
	});
}


TEST(TabView, ATabsLabelIsTheNameOfItsPage)
{
	BApplication app("application/x-vnd.Archway-test");
	BTabView view(BRect(0, 0, 299, 199), "tabs");
	BTab* tab = new BTab;
	tab->SetLabel("ignored");
	view.AddTab(NewPage(NULL), tab);
	EXPECT_STREQ("", tab->Label());
	tab->SetLabel("Named");
	EXPECT_STREQ("Named", tab->Label());
	EXPECT_STREQ("Named", tab->View()->Name());
}


TEST(TabView, ThePageKeepsItsFrameAndFollowsTheContainer)
{
	ControlFixture fixture;
	BTabView* view = fixture.Add(NewTabView(2));
	fixture.Locked([&] {
		EXPECT_EQ(BRect(0, 0, 99, 59), view->ViewForTab(0)->Frame());
		view->ResizeBy(20, 10);
		EXPECT_EQ(BRect(0, 0, 119, 69), view->ViewForTab(0)->Frame());
		EXPECT_EQ(BRect(0, 0, 99, 59), view->ViewForTab(1)->Frame());
	});
}


TEST(TabView, TabHeightMovesTheContainersTop)
{
	BApplication app("application/x-vnd.Archway-test");
	BTabView view(BRect(0, 0, 299, 199), "tabs");
	view.SetTabHeight(40);
	EXPECT_EQ(40, view.TabHeight());
	EXPECT_EQ(BRect(3, 43, 296, 196), view.ContainerView()->Frame());
}


TEST(TabView, TabsStandSideBySideInTheChosenWidth)
{
	BApplication app("application/x-vnd.Archway-test");
	std::unique_ptr<BTabView> view(NewTabView(3));
	const auto width = [&](int32 i) { return view->TabFrame(i).Width(); };
	EXPECT_EQ(80, width(0));
	EXPECT_EQ(view->TabFrame(0).right, view->TabFrame(1).left);

	const auto labelWidth = [](const char* label) {
		return std::ceil(be_plain_font->StringWidth(label)) + 16;
	};
	view->SetTabWidth(B_WIDTH_FROM_LABEL);
	EXPECT_EQ(labelWidth("First"), width(0));
	EXPECT_EQ(labelWidth("Third"), width(2));
	EXPECT_EQ(view->TabFrame(1).right, view->TabFrame(2).left);
	view->SetTabWidth(B_WIDTH_FROM_WIDEST);
	EXPECT_EQ(labelWidth("Second"), width(0));
	EXPECT_EQ(labelWidth("Second"), width(2));
}


TEST(TabView, AClickOnATabSelectsIt)
{
	ControlFixture fixture;
	BTabView* view = fixture.Add(NewTabView());
	fixture.driver.Click(view, MiddleOfTab(view, 2));
	fixture.Locked([&] { EXPECT_EQ(2, view->Selection()); });
	fixture.Locked([&] { view->TabAt(1)->SetEnabled(false); });
	fixture.driver.Click(view, MiddleOfTab(view, 1));
	fixture.Locked([&] { EXPECT_EQ(2, view->Selection()); });
}


TEST(TabView, KeysMoveTheFocusAndSelect)
{
	ControlFixture fixture;
	BTabView* view = fixture.Add(NewTabView());
	fixture.Focus(view);
	fixture.Locked([&] { EXPECT_EQ(0, view->FocusTab()); });
	fixture.driver.Key("Right");
	fixture.Locked([&] {
		EXPECT_EQ(1, view->FocusTab());
		EXPECT_EQ(0, view->Selection());
	});
	fixture.driver.Type(" ");
	fixture.Locked([&] { EXPECT_EQ(1, view->Selection()); });
	fixture.driver.Key("Left", 0, 2);
	fixture.driver.Type("\n");
	fixture.Locked([&] { EXPECT_EQ(2, view->Selection()); });
}


TEST(TabView, RevivesWhatItWrote)
{
	ControlFixture fixture;
	BTabView* model = NewTabView(3);
	model->ViewForTab(1)->AddChild(new BButton(BRect(5, 5, 80, 30), "inside", "Inside", NULL));
	EXPECT_EQ("_but_width _high _sel _l_items _view_list", OwnFieldNames(ArchiveOf(*model)));
	ExpectRoundTrip(fixture, *model);

	fixture.Add(model);
	fixture.Locked([&] {
		model->Select(1);
		model->TabAt(2)->SetEnabled(false);
	});
	const BMessage archive = fixture.Locked([&] { return ArchiveOf(*model); });
	BMessage container;
	ASSERT_EQ(B_OK, archive.FindMessage("_views", &container));
	EXPECT_FALSE(container.HasMessage("_views"));
	fixture.Locked([&] { EXPECT_EQ(model->ContainerView(), model->ViewForTab(1)->Parent()); });
	ExpectArchiveRoundTrip<BTabView>(fixture, archive);

	std::unique_ptr<BTabView> revived = Revive<BTabView>(archive);
	EXPECT_EQ("First Second Third", Labels(revived.get()));
	EXPECT_EQ(1, revived->Selection());
	EXPECT_NE(nullptr, revived->FindView("inside"));
	EXPECT_FALSE(revived->TabAt(2)->IsEnabled());
	EXPECT_TRUE(revived->TabAt(1)->IsEnabled());
}


TEST(TabView, ADisabledTabOfAnotherSystemIsDisabled)
{
	BApplication app("application/x-vnd.Archway-test");
	BMessage archive;
	archive.AddString("class", "BTab");
	archive.AddBool("_disable", false);
	archive.AddString("stranger", "stays");
	std::unique_ptr<BTab> tab = Revive<BTab>(archive);
	EXPECT_FALSE(tab->IsEnabled());
	EXPECT_TRUE(archive.HasSameData(ArchiveOf(*tab), false, true));
	tab->SetEnabled(true);
	EXPECT_FALSE(ArchiveOf(*tab).HasBool("_disable"));
	EXPECT_TRUE(ArchiveOf(*tab).HasString("stranger"));
}


TEST(TabView, TakesThePagesOfAnArchiveWithoutAList)
{
	BApplication app("application/x-vnd.Archway-test");
	std::unique_ptr<BTabView> model(NewTabView(2));
	BMessage archive = ArchiveOf(*model);
	archive.RemoveName("_view_list");
	for (int32 i = 0; i < 2; i++) {
		const BMessage page = ArchiveOf(*model->ViewForTab(i));
		archive.AddMessage("_views", &page);
	}
	std::unique_ptr<BTabView> revived = Revive<BTabView>(archive);
	EXPECT_EQ("First Second", Labels(revived.get()));
	EXPECT_TRUE(archive.HasSameData(ArchiveOf(*revived), false, true));
}


TEST(TabView, TakesThePagesThatAnArchiveHasInTheContainer)
{
	BApplication app("application/x-vnd.Archway-test");
	std::unique_ptr<BTabView> model(NewTabView(2));
	BMessage archive = ArchiveOf(*model);
	archive.RemoveName("_view_list");
	BMessage container;
	ASSERT_EQ(B_OK, archive.FindMessage("_views", &container));
	for (int32 i = 0; i < 2; i++) {
		const BMessage page = ArchiveOf(*model->ViewForTab(i));
		container.AddMessage("_views", &page);
	}
	archive.ReplaceMessage("_views", &container);
	archive.ReplaceInt32("_sel", 1);

	std::unique_ptr<BTabView> revived = Revive<BTabView>(archive);
	EXPECT_EQ("First Second", Labels(revived.get()));
	EXPECT_EQ(revived->ContainerView(), revived->ViewForTab(1)->Parent());
	EXPECT_TRUE(archive.HasSameData(ArchiveOf(*revived), false, true));
}


// Such containers do things of their own with the views that come and go in them.
TEST(TabView, AContainerOfAnyClassComesOutAsItWasRead)
{
	BApplication app("application/x-vnd.Archway-test");
	for (const char* className : { "BBox", "BButton", "BTabView", "BMenuBar", "BScrollView",
			 "BTextControl", "BMenuField", "BTextView", "BListView", "NoClassOfThisName" }) {
		for (const int32 selection : { -1, 0, 1 }) {
			SCOPED_TRACE(std::string(className) + " " + std::to_string(selection));
			std::unique_ptr<BTabView> model(NewTabView(2));
			BMessage archive = ArchiveOf(*model);
			BMessage container;
			ASSERT_EQ(B_OK, archive.FindMessage("_views", &container));
			container.ReplaceString("class", className);
			const BMessage part = ArchiveOf(BView(BRect(1, 1, 9, 9), "part", B_FOLLOW_NONE, 0));
			container.AddMessage("_views", &part);
			container.AddData("_views", B_MESSAGE_TYPE, "no message", 10, false);
			archive.ReplaceMessage("_views", &container);
			archive.ReplaceInt32("_sel", selection);

			std::unique_ptr<BTabView> revived = Revive<BTabView>(archive);
			EXPECT_EQ("First Second", Labels(revived.get()));
			EXPECT_TRUE(archive.HasSameData(ArchiveOf(*revived), false, true));
			revived->Select(1);
			revived->Select(0);
			archive.ReplaceInt32("_sel", 0);
			EXPECT_TRUE(archive.HasSameData(ArchiveOf(*revived), false, true));
		}
	}
}


TEST(TabView, WhatIsInAStrangeContainerCanBeChanged)
{
	BApplication app("application/x-vnd.Archway-test");
	std::unique_ptr<BTabView> model(NewTabView(2));
	BMessage archive = ArchiveOf(*model);
	BMessage container;
	ASSERT_EQ(B_OK, archive.FindMessage("_views", &container));
	container.ReplaceString("class", "NoClassOfThisName");
	const BMessage part = ArchiveOf(BView(BRect(1, 1, 9, 9), "part", B_FOLLOW_NONE, 0));
	container.AddMessage("_views", &part);
	archive.ReplaceMessage("_views", &container);
	archive.ReplaceInt32("_sel", 1);

	std::unique_ptr<BTabView> revived = Revive<BTabView>(archive);
	revived->ContainerView()->FindView("part")->MoveTo(4, 4);
	BMessage read;
	ASSERT_EQ(B_OK, ArchiveOf(*revived).FindMessage("_views", &container));
	EXPECT_STREQ("NoClassOfThisName", container.FindString("class"));
	EXPECT_FALSE(container.HasMessage("_views", 1));
	ASSERT_EQ(B_OK, container.FindMessage("_views", &read));
	EXPECT_EQ(BRect(4, 4, 12, 12), read.FindRect("_frame"));
}


TEST(TabView, AnArchiveWithoutContainerStaysOne)
{
	BApplication app("application/x-vnd.Archway-test");
	std::unique_ptr<BTabView> model(NewTabView(2));
	BMessage archive = ArchiveOf(*model);
	archive.RemoveName("_views");
	archive.ReplaceInt32("_sel", 1);
	std::unique_ptr<BTabView> revived = Revive<BTabView>(archive);
	EXPECT_EQ(revived->ContainerView(), revived->ViewForTab(1)->Parent());
	EXPECT_TRUE(archive.HasSameData(ArchiveOf(*revived), false, true));
}


TEST(TabView, APageOfAnUnknownClassStaysWhatItIs)
{
	BApplication app("application/x-vnd.Archway-test");
	std::unique_ptr<BTabView> model(NewTabView(2));
	BMessage archive = ArchiveOf(*model);
	BMessage page;
	ASSERT_EQ(B_OK, archive.FindMessage("_view_list", 1, &page));
	page.ReplaceString("class", "ThisClassDoesNotExist");
	page.AddInt32("itsField", 17);
	archive.ReplaceMessage("_view_list", 1, &page);
	BMessage tab;
	ASSERT_EQ(B_OK, archive.FindMessage("_l_items", 0, &tab));
	tab.ReplaceString("class", "NoTabThatIsKnown");
	archive.ReplaceMessage("_l_items", 0, &tab);

	std::unique_ptr<BTabView> revived = Revive<BTabView>(archive);
	ASSERT_EQ(2, revived->CountTabs());
	EXPECT_STREQ("Second", revived->TabAt(1)->Label());
	EXPECT_TRUE(archive.HasSameData(ArchiveOf(*revived), false, true));
}


// The objects by their numbers: the container, then each tab and its page. The page in front is
// named by the list and by the container.
BMessage
ManagedArchiveOf(const BTabView& view)
{
	BMessage archive = ArchiveOf(view);
	BMessage container;
	EXPECT_EQ(B_OK, archive.FindMessage("_views", &container));
	container.AddInt32("_views", 3 + 2 * view.Selection());
	archive.AddMessage("_managed_archivable", &container);
	for (const char* name : { "_views", "_l_items", "_view_list" })
		archive.RemoveName(name);
	archive.AddInt32("_views", 1);
	for (int32 i = 0; i < view.CountTabs(); i++) {
		archive.AddInt32("_l_items", 2 + 2 * i);
		archive.AddInt32("_view_list", 3 + 2 * i);
		const BMessage tab = ArchiveOf(*view.TabAt(i));
		archive.AddMessage("_managed_archivable", &tab);
		const BMessage page = ArchiveOf(*view.ViewForTab(i));
		archive.AddMessage("_managed_archivable", &page);
	}
	archive.AddBool("_managed_archive", true);
	return archive;
}


TEST(TabView, AManagedArchiveOfATabViewStaysManaged)
{
	BApplication app("application/x-vnd.Archway-test");
	std::unique_ptr<BTabView> model(NewTabView(2));
	model->Select(1);
	BMessage archive = ManagedArchiveOf(*model);
	std::unique_ptr<BTabView> revived = Revive<BTabView>(archive);
	EXPECT_EQ("First Second", Labels(revived.get()));
	EXPECT_EQ(revived->ContainerView(), revived->ViewForTab(1)->Parent());
	EXPECT_TRUE(archive.HasSameData(ArchiveOf(*revived), true, true));
}


TEST(TabView, APageThatAManagedArchiveLacksMovesNoOther)
{
	ControlFixture fixture;
	std::unique_ptr<BTabView> model(NewTabView(3));
	model->Select(0);
	BMessage archive = ManagedArchiveOf(*model);
	archive.ReplaceInt32("_view_list", 1, -42);
	BTabView* revived = fixture.Add(Revive<BTabView>(archive).release());
	fixture.driver.Click(revived, MiddleOfTab(revived, 1));
	EXPECT_EQ(1, revived->Selection());
	fixture.driver.Click(revived, MiddleOfTab(revived, 2));
	const BMessage written = fixture.Locked([&] {
		EXPECT_EQ(3, revived->CountTabs());
		EXPECT_STREQ("Third", revived->TabAt(2)->Label());
		revived->Select(0);
		return ArchiveOf(*revived);
	});
	EXPECT_EQ("", test::first_difference(archive, written));
}
