#include <Control.h>

#include <CheckBox.h>
#include <Messenger.h>

#include "ControlFixture.h"

namespace {

constexpr uint32 kInvoked = 'invk';

class PlainControl : public BControl {
public:
	PlainControl(uint32 flags = B_WILL_DRAW | B_NAVIGABLE) :
		BControl(BRect(10, 10, 109, 29), "control", "Label", new BMessage(kInvoked), B_FOLLOW_NONE,
			flags)
	{
	}

	void Draw(BRect) override { fDraws++; }

	using BControl::IsFocusChanging;
	using BControl::IsTracking;
	using BControl::SetValueNoUpdate;

	void MakeFocus(bool focused) override
	{
		BControl::MakeFocus(focused);
		fWasChanging = IsFocusChanging();
	}

	int32 fDraws = 0;
	bool fWasChanging = true;
};

} // namespace


TEST(Control, StartsOffEnabledAndUntracked)
{
	BApplication app("application/x-vnd.Archway-test");
	PlainControl control;
	EXPECT_EQ(B_CONTROL_OFF, control.Value());
	EXPECT_TRUE(control.IsEnabled());
	EXPECT_FALSE(control.IsTracking());
	EXPECT_STREQ("Label", control.Label());
	EXPECT_EQ(kInvoked, control.Command());
	EXPECT_FALSE(control.Messenger().IsValid());
}


TEST(Control, AnEmptyLabelIsNoLabel)
{
	BApplication app("application/x-vnd.Archway-test");
	PlainControl control;
	control.SetLabel("");
	EXPECT_EQ(nullptr, control.Label());
	control.SetLabel("again");
	EXPECT_STREQ("again", control.Label());
	control.SetLabel(NULL);
	EXPECT_EQ(nullptr, control.Label());
}


TEST(Control, DrawsAgainOnlyWhenSomethingChanged)
{
	ControlFixture fixture;
	PlainControl* control = fixture.Add(new PlainControl);
	const auto drawsAfter = [&](auto change) {
		fixture.Locked([&] {
			control->fDraws = 0;
			change();
		});
		return fixture.Locked([&] { return control->fDraws; });
	};

	EXPECT_EQ(0, drawsAfter([&] { control->SetValue(0); }));
	EXPECT_EQ(1, drawsAfter([&] { control->SetValue(1); }));
	EXPECT_EQ(0, drawsAfter([&] { control->SetValueNoUpdate(0); }));
	EXPECT_EQ(0, drawsAfter([&] { control->SetLabel("Label"); }));
	EXPECT_EQ(1, drawsAfter([&] { control->SetLabel("Other"); }));
	EXPECT_EQ(0, drawsAfter([&] { control->SetEnabled(true); }));
	EXPECT_EQ(1, drawsAfter([&] { control->SetEnabled(false); }));
	EXPECT_EQ(1, drawsAfter([&] { control->MakeFocus(true); }));
	EXPECT_FALSE(control->fWasChanging);
}


TEST(Control, TakesTheColoursOfItsParentWhenAttached)
{
	ControlFixture fixture;
	fixture.Locked([&] { fixture.ground->SetViewColor(10, 20, 30); });
	PlainControl* control = fixture.Add(new PlainControl);
	fixture.Locked([&] {
		EXPECT_EQ((rgb_color { 10, 20, 30, 255 }), control->ViewColor());
		EXPECT_EQ((rgb_color { 10, 20, 30, 255 }), control->LowColor());
	});
}


TEST(Control, TakesThePanelColourFromATransparentParent)
{
	ControlFixture fixture;
	fixture.Locked([&] { fixture.ground->SetViewColor(B_TRANSPARENT_COLOR); });
	PlainControl* control = fixture.Add(new PlainControl);
	fixture.Locked([&] { EXPECT_EQ((rgb_color { 216, 216, 216, 255 }), control->ViewColor()); });
}


TEST(Control, TargetsItsWindowUnlessItHasATarget)
{
	ControlFixture fixture;
	PlainControl* first = fixture.Add(new PlainControl);
	PlainControl* second = new PlainControl;
	second->SetTarget(BMessenger(first));
	fixture.Add(second);
	fixture.Locked([&] {
		EXPECT_EQ(fixture.window, first->Target());
		EXPECT_EQ(first, second->Target());
	});
}


TEST(Control, SpaceAndEnterToggleAndInvoke)
{
	ControlFixture fixture;
	PlainControl* control = fixture.Add(new PlainControl);
	fixture.Focus(control);

	fixture.driver.Type(" ");
	std::vector<BMessage> sent = fixture.Received(kInvoked);
	ASSERT_EQ(1u, sent.size());
	ExpectInvocationFields(sent[0], control, 1);

	fixture.driver.Type("\n");
	sent = fixture.Received(kInvoked);
	ASSERT_EQ(2u, sent.size());
	ExpectInvocationFields(sent[1], control, 0);

	fixture.driver.Type("x");
	EXPECT_EQ(2, fixture.CountReceived(kInvoked));
}


TEST(Control, ADisabledOneIsDeafAndNotNavigable)
{
	ControlFixture fixture;
	PlainControl* control = fixture.Add(new PlainControl);
	fixture.Focus(control);
	fixture.Locked([&] { control->SetEnabled(false); });
	fixture.driver.Type(" ");
	EXPECT_EQ(0, fixture.CountReceived(kInvoked));
	fixture.Locked([&] {
		EXPECT_EQ(0u, control->Flags() & B_NAVIGABLE);
		control->SetEnabled(true);
		EXPECT_NE(0u, control->Flags() & B_NAVIGABLE);
	});
}


TEST(Control, EnablingGivesNoNavigationToOneThatHadNone)
{
	BApplication app("application/x-vnd.Archway-test");
	PlainControl control(B_WILL_DRAW);
	control.SetEnabled(false);
	control.SetEnabled(true);
	EXPECT_EQ(0u, control.Flags() & B_NAVIGABLE);
}


TEST(Control, InvokeWithoutAMessageIsAnError)
{
	ControlFixture fixture;
	PlainControl* control = fixture.Add(new PlainControl);
	fixture.Locked([&] {
		control->SetMessage(NULL);
		EXPECT_EQ(B_BAD_VALUE, control->Invoke());
		BMessage other('othr');
		EXPECT_EQ(B_OK, control->Invoke(&other));
		EXPECT_FALSE(other.HasPointer("source"));
	});
	ASSERT_EQ(1, fixture.CountReceived('othr'));
}


TEST(Control, WritesOnlyWhatDiffersFromANewOne)
{
	BApplication app("application/x-vnd.Archway-test");
	BControl control(BRect(0, 0, 9, 9), "c", NULL, NULL, B_FOLLOW_NONE, B_WILL_DRAW);
	EXPECT_EQ("", OwnFieldNames(ArchiveOf(control)));

	control.SetMessage(new BMessage(kInvoked));
	control.SetLabel("Label");
	control.SetValue(7);
	control.SetEnabled(false);
	const BMessage archive = ArchiveOf(control);
	EXPECT_EQ("_msg _label _val _disable", OwnFieldNames(archive));
	EXPECT_EQ(7, archive.GetInt32("_val", 0));
	EXPECT_TRUE(archive.GetBool("_disable", false));
}


TEST(Control, RevivesWhatItWrote)
{
	ControlFixture fixture;
	BControl control(BRect(5, 6, 70, 80), "c", "Label", new BMessage(kInvoked), B_FOLLOW_RIGHT,
		B_WILL_DRAW | B_NAVIGABLE);
	control.SetValue(-3);
	ExpectRoundTrip(fixture, control);

	std::unique_ptr<BControl> revived = Revive<BControl>(ArchiveOf(control));
	EXPECT_STREQ("Label", revived->Label());
	EXPECT_EQ(-3, revived->Value());
	EXPECT_EQ(kInvoked, revived->Command());
	EXPECT_EQ(BRect(5, 6, 70, 80), revived->Frame());
}


TEST(Control, AFieldThatIsNoLongerTrueIsGone)
{
	BApplication app("application/x-vnd.Archway-test");
	BControl control(BRect(0, 0, 9, 9), "c", "Label", NULL, B_FOLLOW_NONE, B_WILL_DRAW);
	control.SetEnabled(false);
	BMessage archive = ArchiveOf(control);
	archive.AddString("stranger", "stays");

	std::unique_ptr<BControl> revived = Revive<BControl>(archive);
	revived->SetEnabled(true);
	const BMessage again = ArchiveOf(*revived);
	EXPECT_FALSE(again.HasBool("_disable"));
	EXPECT_STREQ("stays", again.GetString("stranger", ""));
}


TEST(Control, AnArchivedEmptyLabelStaysInTheArchive)
{
	BApplication app("application/x-vnd.Archway-test");
	BControl control(BRect(0, 0, 9, 9), "c", NULL, NULL, B_FOLLOW_NONE, B_WILL_DRAW);
	BMessage archive = ArchiveOf(control);
	archive.AddString("_label", "");
	std::unique_ptr<BControl> revived = Revive<BControl>(archive);
	EXPECT_EQ(nullptr, revived->Label());
	EXPECT_TRUE(archive.HasSameData(ArchiveOf(*revived), false, true));
}


TEST(Control, ARevivedOneKeepsItsColoursWhenAttached)
{
	ControlFixture fixture;
	BControl control(BRect(0, 0, 9, 9), "c", NULL, NULL, B_FOLLOW_NONE, B_WILL_DRAW);
	control.SetViewColor(1, 2, 3);
	BControl* revived = fixture.Add(Revive<BControl>(ArchiveOf(control)).release());
	fixture.Locked([&] { EXPECT_EQ((rgb_color { 1, 2, 3, 255 }), revived->ViewColor()); });
}


TEST(Control, AnswersScriptsForItsProperties)
{
	ControlFixture fixture;
	PlainControl* control = fixture.Add(new PlainControl);
	BMessenger messenger(control);

	BMessage get(B_GET_PROPERTY);
	get.AddSpecifier("Label");
	BMessage reply;
	ASSERT_EQ(B_OK, messenger.SendMessage(&get, &reply));
	EXPECT_STREQ("Label", reply.GetString("result", ""));

	BMessage set(B_SET_PROPERTY);
	set.AddSpecifier("Value");
	set.AddInt32("data", 5);
	ASSERT_EQ(B_OK, messenger.SendMessage(&set, &reply));
	fixture.Locked([&] { EXPECT_EQ(5, control->Value()); });
}


TEST(Control, ADisabledControlIsReachedByKeysAgainAfterAnArchive)
{
	ControlFixture fixture;
	BMessage archive;
	{
		BCheckBox box(BRect(0, 0, 99, 19), "box", "Box", NULL);
		ASSERT_EQ(B_OK, box.Archive(&archive));
		EXPECT_FALSE(archive.HasBool("be:wants_nav"));
		box.SetEnabled(false);
		archive.MakeEmpty();
		ASSERT_EQ(B_OK, box.Archive(&archive));
		EXPECT_TRUE(archive.FindBool("be:wants_nav"));
	}
	const BMessage read(archive);
	BCheckBox revived(&archive);
	EXPECT_EQ(0u, revived.Flags() & B_NAVIGABLE);
	BMessage again;
	ASSERT_EQ(B_OK, revived.Archive(&again));
	EXPECT_TRUE(again.HasSameData(read, true, true));

	revived.SetEnabled(true);
	EXPECT_NE(0u, revived.Flags() & B_NAVIGABLE);
}


TEST(Control, TheFlagsOfAnEnabledControlAreAllThatChangesWithThem)
{
	ControlFixture fixture;
	for (const uint32 flags : { uint32(B_WILL_DRAW), uint32(B_WILL_DRAW | B_NAVIGABLE) }) {
		BMessage archive;
		{
			BCheckBox box(BRect(0, 0, 99, 19), "box", "Box", NULL, B_FOLLOW_NONE, flags);
			ASSERT_EQ(B_OK, box.Archive(&archive));
		}
		BMessage expected(archive);
		BCheckBox revived(&archive);
		revived.SetFlags(revived.Flags() ^ B_NAVIGABLE);
		BMessage changed;
		ASSERT_EQ(B_OK, revived.Archive(&changed));
		expected.ReplaceInt32("_flags", int32(revived.Flags()));
		EXPECT_TRUE(changed.HasSameData(expected, true, true));
	}
}


TEST(Control, DisablingARevivedControlSaysThatItWasReachedByKeys)
{
	ControlFixture fixture;
	BMessage archive;
	{
		BCheckBox box(BRect(0, 0, 99, 19), "box", "Box", NULL);
		ASSERT_EQ(B_OK, box.Archive(&archive));
	}
	BCheckBox revived(&archive);
	revived.SetEnabled(false);
	BMessage again;
	ASSERT_EQ(B_OK, revived.Archive(&again));
	EXPECT_TRUE(again.FindBool("be:wants_nav"));
	BCheckBox second(&again);
	second.SetEnabled(true);
	EXPECT_NE(0u, second.Flags() & B_NAVIGABLE);
}
