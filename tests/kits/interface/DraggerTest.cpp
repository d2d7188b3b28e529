#include <cstring>
#include <functional>
#include <random>

#include <Bitmap.h>
#include <MenuItem.h>
#include <PopUpMenu.h>

#include "ReplicantWindows.h"

namespace {

const BRect kFrame(20, 20, 99, 59);
const BRect kHandle(72, 32, 79, 39);
const rgb_color kPanel = { 216, 216, 216, 255 };
const rgb_color kRed = { 200, 0, 0, 255 };

enum { kChild = 1, kParent = 2, kSibling = 3 };


int32
RelationOf(const BDragger& dragger)
{
	return ArchiveOf(dragger).GetInt32("_rel", -1);
}


// Shows all handles again, whatever happens in the test.
struct HandlesShown {
	~HandlesShown() { BDragger::ShowAllDraggers(); }
};

} // namespace


TEST(Dragger, HasTheDefaultsOfItsClass)
{
	BApplication app("application/x-vnd.Archway-test");
	BView target(kFrame, "target", B_FOLLOW_NONE, 0);
	BDragger dragger(kHandle, &target);
	EXPECT_STREQ("_dragger_", dragger.Name());
	EXPECT_EQ(static_cast<uint32>(B_WILL_DRAW), dragger.Flags());
	EXPECT_EQ(B_FOLLOW_NONE, dragger.ResizingMode());
	EXPECT_EQ(&target, dragger.Target());
	EXPECT_FALSE(dragger.InShelf());
	EXPECT_TRUE(BDragger::AreDraggersDrawn());
	EXPECT_EQ(nullptr, dragger.DragBitmap(NULL, NULL));
	float width, height;
	dragger.GetPreferredSize(&width, &height);
	EXPECT_EQ(7, width);
	EXPECT_EQ(7, height);
	dragger.ResizeToPreferred();
	EXPECT_EQ(kHandle, dragger.Frame());
	EXPECT_NE(B_OK, dragger.Perform(0, NULL));
	BMessage message(B_GET_PROPERTY), specifier;
	message.AddSpecifier("Frame");
	EXPECT_EQ(
		&dragger, dragger.ResolveSpecifier(&message, 0, &specifier, B_DIRECT_SPECIFIER, "Frame"));
	BMessage suites;
	EXPECT_EQ(B_OK, dragger.GetSupportedSuites(&suites));
	EXPECT_STREQ("suite/vnd.Be-view", suites.GetString("suites", ""));
}


TEST(Dragger, FindsTheRelationToItsTargetWhenAttached)
{
	ControlFixture fixture;
	BView* target = new BView(kFrame, "target", B_FOLLOW_NONE, B_WILL_DRAW);
	BDragger* inside = new BDragger(kHandle, target);
	target->AddChild(inside);
	fixture.Add(target);
	BDragger* beside = fixture.Add(new BDragger(kHandle.OffsetByCopy(100, 0), target));
	BView* held = new BView(kFrame, "held", B_FOLLOW_NONE, B_WILL_DRAW);
	BDragger* around = new BDragger(kFrame.OffsetByCopy(100, 100), held);
	around->AddChild(held);
	fixture.Add(around);
	fixture.Locked([&] {
		EXPECT_EQ(kParent, RelationOf(*inside));
		EXPECT_EQ(kSibling, RelationOf(*beside));
		EXPECT_EQ(kChild, RelationOf(*around));
		EXPECT_EQ(target, inside->Target());
		EXPECT_EQ(target, beside->Target());
		EXPECT_EQ(held, around->Target());
	});
}


TEST(Dragger, FindsItsTargetAgainAfterReviving)
{
	ControlFixture fixture;
	BView tree(kFrame, "tree", B_FOLLOW_NONE, B_WILL_DRAW);
	BView* target = new BView(BRect(0, 0, 9, 9), "target", B_FOLLOW_NONE, B_WILL_DRAW);
	BView* held = new BView(BRect(0, 0, 9, 9), "held", B_FOLLOW_NONE, B_WILL_DRAW);
	BDragger* around = new BDragger(BRect(20, 0, 39, 9), held);
	around->AddChild(held);
	tree.AddChild(target);
	tree.AddChild(new BDragger(BRect(2, 2, 9, 9), target));
	tree.AddChild(around);
	tree.AddChild(new BDragger(BRect(40, 0, 47, 7), &tree));

	BView* revived = fixture.Add(Revive<BView>(ArchiveOf(tree)).release());
	fixture.Locked([&] {
		const auto targetOf = [&](int32 child) {
			return dynamic_cast<BDragger*>(revived->ChildAt(child))->Target();
		};
		EXPECT_EQ(revived->ChildAt(0), targetOf(1));
		EXPECT_EQ(revived->ChildAt(2)->ChildAt(0), targetOf(2));
		EXPECT_EQ(revived, targetOf(3));
		EXPECT_TRUE(ArchiveOf(tree).HasSameData(ArchiveOf(*revived), false, true));

		// What the relation says is found among the views that are there.
		BView* first = revived->ChildAt(0);
		first->RemoveSelf();
		delete first;
		EXPECT_EQ(revived->ChildAt(1), targetOf(0));
	});
}


TEST(Dragger, DragsTheArchiveOfItsTarget)
{
	ReplicantWindows windows;
	BDragger* dragger = windows.AddText();
	windows.DropOnOther(dragger, BPoint(150, 100));
	ASSERT_EQ(1u, windows.drops->dropped.size());
	const BMessage& dropped = windows.drops->dropped[0];
	EXPECT_EQ(static_cast<uint32>(B_ARCHIVED_OBJECT), dropped.what);
	EXPECT_STREQ("BStringView", dropped.GetString("class", ""));
	EXPECT_STREQ("A replicant", dropped.GetString("_text", ""));
	EXPECT_EQ(B_TRASH_TARGET, dropped.GetInt32("be:actions", 0));
	BMessage child;
	EXPECT_EQ(B_OK, dropped.FindMessage("_views", &child));
	EXPECT_STREQ("BDragger", child.GetString("class", ""));
	// The outline keeps its place under the pointer.
	BPoint offset;
	dropped.DropPoint(&offset);
	EXPECT_EQ(BPoint(116, 26), offset);
	BLooper* looper;
	EXPECT_EQ(dragger, dropped.ReturnAddress().Target(&looper));
	EXPECT_EQ(windows.window, looper);
}


TEST(Dragger, DragsItselfAroundAChildAndBesideASibling)
{
	ReplicantWindows windows;
	BStringView* held = new BStringView(BRect(0, 0, 50, 20), "held", "Held");
	BDragger* around = new BDragger(BRect(20, 20, 80, 50), held);
	around->AddChild(held);
	windows.Add(around);
	windows.driver.Drag(around, BPoint(58, 28), windows.drops, BPoint(100, 100));
	ASSERT_EQ(1u, windows.drops->dropped.size());
	EXPECT_STREQ("BDragger", windows.drops->dropped[0].GetString("class", ""));
	EXPECT_TRUE(windows.drops->dropped[0].HasMessage("_views"));

	BStringView* target = windows.Add(new BStringView(BRect(20, 80, 80, 99), "target", "Target"));
	BDragger* beside = windows.Add(new BDragger(BRect(81, 92, 88, 99), target));
	windows.driver.Drag(beside, BPoint(4, 4), windows.drops, BPoint(100, 100));
	ASSERT_EQ(2u, windows.drops->dropped.size());
	const BMessage& dropped = windows.drops->dropped[1];
	EXPECT_STREQ("BStringView", dropped.GetString("class", ""));
	BMessage widget;
	EXPECT_EQ(B_OK, dropped.FindMessage("__widget", &widget));
	EXPECT_STREQ("BDragger", widget.GetString("class", ""));
	BPoint offset;
	dropped.DropPoint(&offset);
	EXPECT_EQ(BPoint(65, 16), offset);
}


TEST(Dragger, AClickDragsNothing)
{
	ReplicantWindows windows;
	BDragger* dragger = windows.AddText();
	windows.driver.Click(dragger);
	windows.driver.MoveTo(windows.drops);
	windows.driver.Click(windows.drops);
	EXPECT_EQ(0u, windows.drops->dropped.size());
	windows.Locked([&] {
		dragger->MakeFocus(true);
		EXPECT_TRUE(dragger->IsFocus());
	});
}


// The target that was given is gone; its address may belong to anything.
TEST(Dragger, DragsNothingOnceItsTargetIsGone)
{
	ReplicantWindows windows;
	BView* target = windows.Add(new BView(kFrame, "target", B_FOLLOW_NONE, B_WILL_DRAW));
	BDragger* dragger = windows.Add(new BDragger(kHandle, target));
	windows.Locked([&] {
		target->RemoveSelf();
		delete target;
	});
	windows.DropOnOther(dragger, BPoint(100, 100));
	EXPECT_EQ(0u, windows.drops->dropped.size());
}


TEST(Dragger, ShowsItsOwnPictureWhileDragged)
{
	class Pictured : public BDragger {
	public:
		using BDragger::BDragger;

		BBitmap* DragBitmap(BPoint* _offset, drawing_mode* _mode) override
		{
			*_offset = BPoint(3, 5);
			*_mode = B_OP_COPY;
			BBitmap* bitmap = new BBitmap(BRect(0, 0, 15, 15), B_RGB32);
			memset(bitmap->Bits(), 0x40, bitmap->BitsLength());
			return bitmap;
		}
	};

	ReplicantWindows windows;
	BView* target = windows.Add(new BView(kFrame, "target", B_FOLLOW_NONE, B_WILL_DRAW));
	BDragger* dragger = windows.Add(new Pictured(kHandle.OffsetByCopy(100, 0), target));
	windows.DropOnOther(dragger, BPoint(100, 100));
	ASSERT_EQ(1u, windows.drops->dropped.size());
	BPoint offset;
	windows.drops->dropped[0].DropPoint(&offset);
	EXPECT_EQ(BPoint(3, 5), offset);
}


TEST(Dragger, DrawsAHandleInItsRightBottomCorner)
{
	ControlFixture fixture;
	BView* target = fixture.Add(new BView(kFrame, "target", B_FOLLOW_NONE, B_WILL_DRAW));
	BDragger* dragger = fixture.Add(new BDragger(BRect(120, 20, 149, 49), target));
	EXPECT_EQ(kPanel, fixture.driver.PixelAt(dragger, BPoint(21, 21)));
	EXPECT_NE(kPanel, fixture.driver.PixelAt(dragger, BPoint(22, 22)));
	EXPECT_NE(kPanel, fixture.driver.PixelAt(dragger, BPoint(29, 29)));

	fixture.Locked([&] {
		dragger->SetFlags(dragger->Flags() | B_FRAME_EVENTS);
		dragger->ResizeBy(10, 10);
		dragger->MoveBy(1, 1);
	});
	EXPECT_EQ(kPanel, fixture.driver.PixelAt(dragger, BPoint(29, 29)));
	EXPECT_NE(kPanel, fixture.driver.PixelAt(dragger, BPoint(39, 39)));
}


TEST(Dragger, AllAreHiddenAndShownTogether)
{
	class Noting : public BDragger {
	public:
		using BDragger::BDragger;
		using BDragger::IsVisibilityChanging;

		void Hide() override
		{
			hides += IsVisibilityChanging() ? 1 : 100;
			BDragger::Hide();
		}

		void Show() override
		{
			shows += IsVisibilityChanging() ? 1 : 100;
			BDragger::Show();
		}

		int hides = 0, shows = 0;
	};

	HandlesShown shown;
	ReplicantWindows windows;
	BView* target = windows.Add(new BView(kFrame, "target", B_FOLLOW_NONE, B_WILL_DRAW));
	Noting* dragger = windows.Add(new Noting(kHandle.OffsetByCopy(100, 0), target));
	BMessage before;
	windows.Locked([&] { before = ArchiveOf(*dragger); });

	EXPECT_EQ(B_OK, BDragger::HideAllDraggers());
	EXPECT_FALSE(BDragger::AreDraggersDrawn());
	Driver::WaitUntilIdle();
	windows.Locked([&] {
		EXPECT_TRUE(dragger->IsHidden());
		EXPECT_TRUE(before.HasSameData(ArchiveOf(*dragger), false, true));
		EXPECT_FALSE(dragger->IsVisibilityChanging());
	});
	windows.driver.Drag(windows.ground, BPoint(176, 36), windows.drops, BPoint(100, 100));
	EXPECT_EQ(0u, windows.drops->dropped.size());

	EXPECT_EQ(B_OK, BDragger::ShowAllDraggers());
	Driver::WaitUntilIdle();
	windows.Locked([&] { EXPECT_FALSE(dragger->IsHidden()); });
	EXPECT_EQ(1, dragger->hides);
	EXPECT_EQ(1, dragger->shows);
	windows.DropOnOther(dragger, BPoint(100, 100));
	EXPECT_EQ(1u, windows.drops->dropped.size());
}


// A dragger that holds its target keeps showing that.
TEST(Dragger, LosesOnlyItsHandleAroundAChild)
{
	HandlesShown shown;
	BDragger::HideAllDraggers();
	ReplicantWindows windows;
	BView* held = new BView(BRect(0, 0, 19, 19), "held", B_FOLLOW_NONE, B_WILL_DRAW);
	held->SetViewColor(200, 0, 0);
	BDragger* around = new BDragger(kFrame, held);
	around->AddChild(held);
	windows.Add(around);
	windows.Locked([&] { EXPECT_FALSE(around->IsHidden()); });
	EXPECT_EQ(kRed, windows.driver.PixelAt(around, BPoint(10, 10)));
	EXPECT_EQ(kPanel, windows.driver.PixelAt(around, BPoint(79, 39)));
	windows.driver.Drag(around, BPoint(76, 36), windows.drops, BPoint(100, 100));
	EXPECT_EQ(0u, windows.drops->dropped.size());
}


TEST(Dragger, OutsideOfAShelfIsNotThrownAway)
{
	ReplicantWindows windows;
	BDragger* dragger = windows.AddText();
	const int32 beeps = Driver::CountBeeps();
	EXPECT_EQ(B_OK, BMessenger(dragger).SendMessage(B_TRASH_TARGET));
	Driver::WaitUntilIdle();
	EXPECT_EQ(beeps + 1, Driver::CountBeeps());
	windows.Locked([&] {
		EXPECT_NE(nullptr, dragger->Window());
		BView* target = dragger->Target();
		dragger->RemoveSelf();
		EXPECT_EQ(nullptr, dragger->Window());
		target->AddChild(dragger);
	});
}


// #pragma mark - archives


TEST(Dragger, ArchivesItsRelationAndItsMenu)
{
	ControlFixture fixture;
	BView target(kFrame, "target", B_FOLLOW_NONE, B_WILL_DRAW);
	BDragger* dragger = new BDragger(kHandle, &target);
	target.AddChild(dragger);
	EXPECT_EQ("_rel", OwnFieldNames(ArchiveOf(*dragger)));
	EXPECT_EQ(B_OK, dragger->PopUp()->AddItem(new BMenuItem("Mine", NULL)) ? B_OK : B_ERROR);
	EXPECT_EQ("_rel", OwnFieldNames(ArchiveOf(*dragger)));

	BPopUpMenu* menu = new BPopUpMenu("own", false, false);
	menu->AddItem(new BMenuItem("First", new BMessage('frst'), 'F'));
	EXPECT_EQ(B_OK, dragger->SetPopUp(menu));
	EXPECT_EQ(menu, dragger->PopUp());
	const BMessage archive = ArchiveOf(*dragger);
	EXPECT_EQ("_popup _rel", OwnFieldNames(archive));
	const auto revived = Revive<BDragger>(archive);
	EXPECT_STREQ("First", revived->PopUp()->ItemAt(0)->Label());
	ExpectRoundTrip(fixture, *dragger);
	ExpectRoundTrip(fixture, target);

	EXPECT_EQ(B_OK, revived->SetPopUp(NULL));
	EXPECT_EQ("_rel", OwnFieldNames(ArchiveOf(*revived)));
	ASSERT_EQ(3, revived->PopUp()->CountItems());
	EXPECT_STREQ("Remove Replicant", revived->PopUp()->ItemAt(2)->Label());
}


TEST(Dragger, KeepsWhatItCannotUse)
{
	ControlFixture fixture;
	BDragger dragger(kHandle, NULL);
	BMessage popUp;
	popUp.AddString("class", "MenuOfAnotherProgram");
	popUp.AddInt32("its field", 5);
	for (const int32 relation : { -1, 0, 1, 2, 3, 4, 77, 0x7fffffff }) {
		BMessage archive = ArchiveOf(dragger);
		archive.ReplaceInt32("_rel", relation);
		archive.AddInt32("_rel", 9);
		archive.AddMessage("_popup", &popUp);
		archive.AddMessage("_popup", &popUp);
		archive.AddString("stranger", "of another program");
		archive.AddInt16("_show", 1);
		ExpectArchiveRoundTrip<BDragger>(fixture, archive);
	}
	BMessage archive = ArchiveOf(dragger);
	archive.RemoveName("_rel");
	ExpectArchiveRoundTrip<BDragger>(fixture, archive);
	archive.AddFloat("_rel", 2);
	archive.AddString("_popup", "text");
	ExpectArchiveRoundTrip<BDragger>(fixture, archive);
	const auto revived = Revive<BDragger>(archive);
	EXPECT_EQ(B_OK, revived->SetPopUp(NULL));
	EXPECT_FALSE(ArchiveOf(*revived).HasString("_popup"));
}


// Hidden handles do not tell in an archive, also where that hides the view by itself.
TEST(Dragger, ArchivesNoHidingOfAll)
{
	HandlesShown shown;
	BDragger::HideAllDraggers();
	ControlFixture fixture;
	BDragger dragger(kHandle, NULL);
	for (const int16 count : { 0, 1, 3, -2 }) {
		BMessage archive = ArchiveOf(dragger);
		archive.AddInt16("_show", count);
		std::unique_ptr<BDragger> revived = Revive<BDragger>(archive);
		fixture.Add(revived.get());
		fixture.Locked([&] {
			EXPECT_TRUE(archive.HasSameData(ArchiveOf(*revived), false, true));
			revived->Hide();
			EXPECT_EQ(count + 1, ArchiveOf(*revived).GetInt16("_show", 0));
			revived->Show();
			revived->RemoveSelf();
			EXPECT_TRUE(archive.HasSameData(ArchiveOf(*revived), false, true));
		});
	}
}


// Trees of draggers with any relation, which are attached, pressed and taken out again.
TEST(Dragger, BearsAnyValues)
{
	ReplicantWindows windows;
	std::mt19937 random(7);
	const std::function<BMessage(int)> make = [&](int depth) {
		BDragger dragger(BRect(float(random() % 30), float(random() % 30), 99, 79), NULL);
		BMessage archive = ArchiveOf(dragger);
		const uint32 kind = random() % 4;
		if (kind < 3)
			archive.ReplaceInt32("_rel", kind == 0 ? int32(random()) : int32(random() % 5));
		for (uint32 i = 0; depth < 4 && i < random() % 3; i++) {
			const BMessage child = make(depth + 1);
			archive.AddMessage(random() % 5 == 0 ? "_popup" : "_views", &child);
		}
		return archive;
	};
	for (int i = 0; i < 60; i++) {
		const BMessage archive = make(0);
		std::unique_ptr<BDragger> revived = Revive<BDragger>(archive);
		windows.Add(revived.get());
		windows.driver.Drag(windows.ground, BPoint(90, 70), windows.drops, BPoint(20, 20), 2);
		windows.Locked([&] {
			revived->RemoveSelf();
			EXPECT_TRUE(archive.HasSameData(ArchiveOf(*revived), false, true)) << i;
		});
	}
}
