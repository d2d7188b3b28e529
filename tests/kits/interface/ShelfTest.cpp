#include <cstring>

#include <DataIO.h>
#include <MenuItem.h>
#include <MessageFilter.h>

#include "ShelfWindows.h"

namespace {

const rgb_color kPanel = { 216, 216, 216, 255 };

} // namespace


TEST(Shelf, HasTheDefaultsOfItsClass)
{
	BApplication app("application/x-vnd.Archway-test");
	BView view(BRect(0, 0, 99, 99), "container", B_FOLLOW_NONE, 0);
	BShelf shelf(&view);
	EXPECT_TRUE(shelf.AllowsDragging());
	EXPECT_TRUE(shelf.AllowsZombies());
	EXPECT_FALSE(shelf.DisplaysZombies());
	EXPECT_FALSE(shelf.IsTypeEnforced());
	EXPECT_FALSE(shelf.IsDirty());
	EXPECT_EQ(0, shelf.CountReplicants());
	EXPECT_EQ(nullptr, shelf.ReplicantAt(0));
	EXPECT_EQ(nullptr, shelf.SaveLocation(NULL));
	EXPECT_EQ(nullptr, shelf.Name());
	EXPECT_EQ(B_ERROR, shelf.Save());
	EXPECT_NE(B_OK, shelf.Perform(0, NULL));
	BShelf typed(&view, false, "type");
	EXPECT_STREQ("type", typed.Name());
	EXPECT_FALSE(typed.AllowsDragging());
}


TEST(Shelf, HasNoArchive)
{
	BApplication app("application/x-vnd.Archway-test");
	BView view(BRect(0, 0, 99, 99), "container", B_FOLLOW_NONE, 0);
	BShelf shelf(&view);
	BMessage archive;
	EXPECT_EQ(B_ERROR, shelf.Archive(&archive));
	archive.AddString("class", "BShelf");
	EXPECT_EQ(nullptr, BShelf::Instantiate(&archive));
	EXPECT_EQ(nullptr, instantiate_object(&archive));
	BShelf empty(&archive);
	EXPECT_EQ(B_NO_INIT, empty.AddReplicant(&archive, BPoint(0, 0)));
}


TEST(Shelf, TakesWhatIsDroppedFromAnotherWindow)
{
	ShelfWindows windows;
	BDragger* dragger = windows.AddText();
	windows.DropOnOther(dragger, BPoint(200, 150));
	ASSERT_EQ(1, windows.Count());
	// The outline held the view 116, 26 from its corner.
	EXPECT_EQ(BRect(84, 124, 203, 153), windows.FrameAt(0));
	EXPECT_EQ(windows.FrameAt(0), windows.shelf->asked);
	windows.LockedOther([&] {
		BView* view;
		uint32 id;
		status_t error;
		BMessage* archive = windows.shelf->ReplicantAt(0, &view, &id, &error);
		ASSERT_NE(nullptr, archive);
		EXPECT_FALSE(archive->HasPoint("_drop_point_"));
		EXPECT_FALSE(archive->HasInt32("be:actions"));
		EXPECT_EQ(B_OK, error);
		EXPECT_EQ(windows.drops, view->Parent());
		EXPECT_STREQ("A replicant", dynamic_cast<BStringView*>(view)->Text());
		EXPECT_EQ(0, windows.shelf->IndexOf(archive));
		EXPECT_EQ(0, windows.shelf->IndexOf(view));
		EXPECT_EQ(0, windows.shelf->IndexOf(id));
		EXPECT_EQ(-1, windows.shelf->IndexOf(id + 1));
		EXPECT_TRUE(windows.shelf->IsDirty());
		EXPECT_EQ(windows.other, windows.shelf->Looper());
	});
	EXPECT_TRUE(windows.DraggerAt(0)->InShelf());
	// The original stays where it was.
	windows.Locked([&] { EXPECT_EQ(windows.ground, dragger->Target()->Parent()); });
	EXPECT_FALSE(dragger->InShelf());
}


// A drop on a replicant that does not want it comes up to the container.
TEST(Shelf, TakesWhatIsDroppedOnAReplicant)
{
	ShelfWindows windows;
	BDragger* dragger = windows.AddText();
	windows.DropOnOther(dragger, BPoint(200, 150));
	windows.DropOnOther(dragger, BPoint(190, 140));
	EXPECT_EQ(2, windows.Count());
	EXPECT_EQ(BRect(74, 114, 193, 143), windows.FrameAt(1));
}


TEST(Shelf, MovesItsReplicants)
{
	ShelfWindows windows;
	windows.DropOnOther(windows.AddText(), BPoint(200, 150));
	const BRect before = windows.FrameAt(0);
	BView* view = windows.ViewAt(0);
	windows.LockedOther([&] { windows.shelf->SetDirty(false); });
	windows.driver.Drag(windows.DraggerAt(0), BPoint(4, 4), windows.drops, BPoint(230, 200));
	EXPECT_EQ(1, windows.Count());
	EXPECT_EQ(view, windows.ViewAt(0));
	EXPECT_EQ(before.OffsetByCopy(30, 50), windows.FrameAt(0));
	EXPECT_TRUE(windows.shelf->IsDirty());

	windows.shelf->adjustment = BPoint(-7, 3);
	windows.driver.Drag(windows.DraggerAt(0), BPoint(4, 4), windows.drops, BPoint(200, 150));
	EXPECT_EQ(before.OffsetByCopy(-7, 3), windows.FrameAt(0));
}


TEST(Shelf, MovesADraggerBesideItsReplicantWithIt)
{
	ShelfWindows windows;
	BStringView* target = windows.Add(new BStringView(BRect(20, 20, 99, 39), "target", "Target"));
	BDragger* beside = windows.Add(new BDragger(BRect(101, 22, 108, 29), target));
	windows.DropOnOther(beside, BPoint(150, 150));
	ASSERT_EQ(1, windows.Count());
	EXPECT_EQ(BRect(65, 144, 144, 163), windows.FrameAt(0));
	BDragger* dragger =
		windows.LockedOther([&] { return dynamic_cast<BDragger*>(windows.drops->ChildAt(0)); });
	ASSERT_NE(nullptr, dragger);
	EXPECT_TRUE(dragger->InShelf());
	EXPECT_EQ(windows.ViewAt(0), dragger->Target());
	EXPECT_EQ(BRect(146, 146, 153, 153), dragger->Frame());

	windows.driver.Drag(dragger, BPoint(4, 4), windows.drops, BPoint(170, 180));
	EXPECT_EQ(BRect(85, 174, 164, 193), windows.FrameAt(0));
	EXPECT_EQ(BRect(166, 176, 173, 183), dragger->Frame());
	windows.LockedOther([&] {
		EXPECT_EQ(B_OK, windows.shelf->DeleteReplicant(int32(0)));
		EXPECT_EQ(0, windows.drops->CountChildren());
	});
}


TEST(Shelf, GivesADraggerToAReplicantWithout)
{
	ShelfWindows windows;
	BMessage archive = TextArchive("bare", false);
	windows.LockedOther(
		[&] { EXPECT_EQ(B_OK, windows.shelf->AddReplicant(&archive, BPoint(50, 60))); });
	BDragger* dragger = windows.DraggerAt(0);
	ASSERT_NE(nullptr, dragger);
	EXPECT_EQ(BRect(92, 22, 99, 29), dragger->Frame());
	windows.driver.Drag(dragger, BPoint(4, 4), windows.drops, BPoint(166, 106));
	EXPECT_EQ(BRect(70, 80, 169, 109), windows.FrameAt(0));
}


TEST(Shelf, MovesAndTakesNothingWithoutDragging)
{
	ShelfWindows windows;
	BDragger* original = windows.AddText();
	windows.DropOnOther(original, BPoint(200, 150));
	const BRect before = windows.FrameAt(0);
	BDragger* dragger = windows.DraggerAt(0);
	windows.LockedOther([&] {
		windows.shelf->SetAllowsDragging(false);
		EXPECT_FALSE(windows.shelf->AllowsDragging());
		EXPECT_TRUE(dragger->IsHidden());
	});
	windows.driver.Drag(windows.drops, BPoint(200, 150), windows.drops, BPoint(230, 200));
	windows.DropOnOther(original, BPoint(100, 60));
	EXPECT_EQ(1, windows.Count());
	EXPECT_EQ(before, windows.FrameAt(0));
	windows.LockedOther([&] {
		windows.shelf->SetAllowsDragging(true);
		EXPECT_FALSE(dragger->IsHidden());
	});
}


// #pragma mark - the menu


TEST(Shelf, RemovesAReplicantByItsMenu)
{
	ShelfWindows windows;
	BDragger* original = windows.AddText();
	windows.DropOnOther(original, BPoint(200, 100));
	windows.DropOnOther(original, BPoint(200, 200));
	BView* first = windows.ViewAt(0);
	BDragger* dragger = windows.DraggerAt(1);
	windows.OpenMenu(dragger);
	ASSERT_EQ(3, dragger->PopUp()->CountItems());
	EXPECT_STREQ("About text…", dragger->PopUp()->ItemAt(0)->Label());
	windows.ChooseItem(dragger->PopUp(), 2);
	ASSERT_EQ(1, windows.Count());
	EXPECT_EQ(first, windows.ViewAt(0));
	EXPECT_EQ(std::vector<int32> { 1 }, windows.shelf->deleted);
	windows.LockedOther([&] { EXPECT_EQ(1, windows.drops->CountChildren()); });
	EXPECT_EQ(kPanel, windows.driver.PixelAt(windows.drops, BPoint(200, 200)));
}


TEST(Shelf, AsksTheReplicantWhatItIsAbout)
{
	ShelfWindows windows;
	windows.DropOnOther(windows.AddText(), BPoint(200, 100));
	windows.drops->notes = false;
	// What the view does not understand goes up to the window.
	struct AboutFilter : BMessageFilter {
		AboutFilter() : BMessageFilter(B_ABOUT_REQUESTED) {}
		filter_result Filter(BMessage*, BHandler** target) override
		{
			asked = *target;
			return B_SKIP_MESSAGE;
		}
		BHandler* asked = NULL;
	};
	AboutFilter* filter = new AboutFilter;
	windows.LockedOther([&] { windows.other->AddCommonFilter(filter); });
	BDragger* dragger = windows.DraggerAt(0);
	windows.OpenMenu(dragger);
	windows.ChooseItem(dragger->PopUp(), 0);
	EXPECT_EQ(windows.ViewAt(0), filter->asked);
	EXPECT_EQ(1, windows.Count());
}


TEST(Shelf, OpensTheMenuOfAHeldDragger)
{
	ShelfWindows windows;
	windows.DropOnOther(windows.AddText(), BPoint(200, 100));
	BDragger* dragger = windows.DraggerAt(0);
	windows.driver.MoveTo(dragger, BPoint(4, 4));
	windows.driver.Press();
	// The kit's own timer says that the press has become a long one.
	EXPECT_EQ(B_OK, BMessenger(dragger).SendMessage('_DHL'));
	Driver::WaitUntilIdle();
	EXPECT_NE(nullptr, dragger->PopUp()->Window());
	windows.driver.Release();
	windows.driver.Key("Escape");
	EXPECT_EQ(nullptr, dragger->PopUp()->Window());
	// Without a press the same message opens nothing.
	EXPECT_EQ(B_OK, BMessenger(dragger).SendMessage('_DHL'));
	Driver::WaitUntilIdle();
	EXPECT_EQ(nullptr, dragger->PopUp()->Window());
	EXPECT_EQ(1, windows.Count());
}


TEST(Shelf, OpensTheMenuThatWasSet)
{
	ShelfWindows windows;
	windows.DropOnOther(windows.AddText(), BPoint(200, 100));
	BDragger* dragger = windows.DraggerAt(0);
	BPopUpMenu* menu = new BPopUpMenu("own", false, false);
	menu->AddItem(new BMenuItem("Own", NULL));
	windows.LockedOther([&] { dragger->SetPopUp(menu); });
	windows.OpenMenu(dragger);
	EXPECT_NE(nullptr, menu->Window());
	windows.driver.Key("Escape");
	EXPECT_EQ(nullptr, menu->Window());
}


TEST(Shelf, ThrowsAReplicantAway)
{
	ShelfWindows windows;
	windows.DropOnOther(windows.AddText(), BPoint(200, 100));
	EXPECT_EQ(B_OK, BMessenger(windows.DraggerAt(0)).SendMessage(B_TRASH_TARGET));
	Driver::WaitUntilIdle();
	EXPECT_EQ(0, windows.Count());
}


// #pragma mark - adding and deleting


TEST(Shelf, AddsAndDeletesReplicants)
{
	ShelfWindows windows;
	windows.LockedOther([&] {
		BShelf& shelf = *windows.shelf;
		for (const char* text : { "a", "b", "c", "d" }) {
			BMessage archive = TextArchive(text);
			EXPECT_EQ(B_OK, shelf.AddReplicant(&archive, BPoint(20, 20)));
		}
		ASSERT_EQ(4, shelf.CountReplicants());
		BView* b = NULL;
		uint32 id = 0;
		shelf.ReplicantAt(1, &b, &id);
		EXPECT_STREQ("b", b->Name());
		EXPECT_EQ(B_OK, shelf.DeleteReplicant(b));
		EXPECT_EQ(-1, shelf.IndexOf(id));
		EXPECT_EQ(B_OK, shelf.DeleteReplicant(shelf.ReplicantAt(1)));
		EXPECT_EQ(B_OK, shelf.DeleteReplicant(int32(1)));
		ASSERT_EQ(1, shelf.CountReplicants());
		BView* a = NULL;
		shelf.ReplicantAt(0, &a);
		EXPECT_STREQ("a", a->Name());
		EXPECT_EQ((std::vector<int32> { 1, 1, 1 }), windows.shelf->deleted);
		EXPECT_EQ(B_BAD_VALUE, shelf.DeleteReplicant(int32(1)));
		EXPECT_EQ(B_BAD_VALUE, shelf.DeleteReplicant(int32(-1)));
		EXPECT_EQ(B_BAD_VALUE, shelf.DeleteReplicant(static_cast<BView*>(windows.drops)));
		EXPECT_EQ(B_BAD_VALUE, shelf.DeleteReplicant(static_cast<BMessage*>(NULL)));
		EXPECT_EQ(1, windows.drops->CountChildren());
	});
}


TEST(Shelf, RefusesWhatItsHooksRefuse)
{
	ShelfWindows windows;
	BMessage archive = TextArchive();
	windows.LockedOther([&] {
		NotingShelf& shelf = *windows.shelf;
		shelf.takesMessages = false;
		EXPECT_EQ(B_ERROR, shelf.AddReplicant(&archive, BPoint(5, 6)));
		shelf.takesMessages = true;
		shelf.takesViews = false;
		EXPECT_EQ(B_ERROR, shelf.AddReplicant(&archive, BPoint(5, 6)));
		EXPECT_EQ(BRect(5, 6, 104, 35), shelf.asked);
		EXPECT_EQ(0, shelf.CountReplicants());
		EXPECT_EQ(0, windows.drops->CountChildren());
		EXPECT_FALSE(shelf.IsDirty());
		EXPECT_EQ(B_BAD_VALUE, shelf.AddReplicant(NULL, BPoint(0, 0)));
		BMessage item(archive);
		item.ReplaceString("class", "BStringItem");
		EXPECT_EQ(B_BAD_TYPE, shelf.AddReplicant(&item, BPoint(0, 0)));
	});
}


TEST(Shelf, AcceptsEverythingUnlessAHookIsOverridden)
{
	ShelfWindows windows;
	BMessage archive = TextArchive();
	windows.LockedOther([&] {
		const NotingShelf& shelf = *windows.shelf;
		const BRect frame(0, 0, 9, 9);
		EXPECT_TRUE(shelf.CanAcceptReplicantMessage(&archive));
		EXPECT_TRUE(shelf.CanAcceptReplicantView(frame, windows.drops, &archive));
		EXPECT_EQ(BPoint(0, 0), shelf.AdjustReplicantBy(frame, &archive));
		windows.shelf->ReplicantDeleted(5, &archive, NULL);
		EXPECT_EQ(std::vector<int32> { 5 }, shelf.deleted);
	});
}


TEST(Shelf, EnforcesItsType)
{
	ShelfWindows windows;
	windows.LockedOther([&] {
		BShelf& shelf = *windows.shelf;
		BMessage other = TextArchive();
		other.AddString("shelf_type", "shelf of another kind");
		EXPECT_EQ(B_OK, shelf.AddReplicant(&other, BPoint(0, 0)));
		shelf.SetTypeEnforced(true);
		EXPECT_TRUE(shelf.IsTypeEnforced());
		EXPECT_EQ(B_MISMATCHED_VALUES, shelf.AddReplicant(&other, BPoint(0, 0)));
		other.ReplaceString("shelf_type", "shelf of a kind");
		EXPECT_EQ(B_OK, shelf.AddReplicant(&other, BPoint(0, 0)));
		BMessage any = TextArchive();
		EXPECT_EQ(B_OK, shelf.AddReplicant(&any, BPoint(0, 0)));
	});
}


// The program may take a replicant's view out by itself.
TEST(Shelf, BearsTheLossOfAView)
{
	ShelfWindows windows;
	windows.LockedOther([&] {
		for (const bool hasDragger : { true, false }) {
			BMessage archive = TextArchive("lost", hasDragger);
			EXPECT_EQ(B_OK, windows.shelf->AddReplicant(&archive, BPoint(20, 20)));
			BView* view = NULL;
			windows.shelf->ReplicantAt(hasDragger ? 0 : 1, &view);
			view->RemoveSelf();
			delete view;
		}
		BView* view;
		EXPECT_NE(nullptr, windows.shelf->ReplicantAt(0, &view));
		EXPECT_EQ(nullptr, view);
		BMallocIO stream;
		windows.shelf->SetSaveLocation(&stream);
		EXPECT_EQ(B_OK, windows.shelf->Save());
		EXPECT_EQ(B_OK, windows.shelf->DeleteReplicant(int32(1)));
		EXPECT_EQ(B_OK, windows.shelf->DeleteReplicant(int32(0)));
		EXPECT_EQ(0, windows.drops->CountChildren());
		windows.shelf->SetDirty(false);
		windows.shelf->SetSaveLocation(static_cast<BDataIO*>(NULL));
	});
}


TEST(Shelf, OutlivesItsContainer)
{
	ShelfWindows windows;
	windows.LockedOther([&] {
		BView* container = new BView(BRect(0, 0, 99, 99), "container", B_FOLLOW_NONE, 0);
		windows.drops->AddChild(container);
		BShelf shelf(container);
		EXPECT_EQ(windows.other, shelf.Looper());
		BMessage archive = TextArchive();
		EXPECT_EQ(B_OK, shelf.AddReplicant(&archive, BPoint(20, 20)));
		container->RemoveSelf();
		EXPECT_EQ(nullptr, shelf.Looper());
		EXPECT_EQ(1, shelf.CountReplicants());
		delete container;
		EXPECT_EQ(0, shelf.CountReplicants());
		EXPECT_EQ(B_NO_INIT, shelf.AddReplicant(&archive, BPoint(20, 20)));
	});
}
