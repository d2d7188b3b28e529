#include <OptionPopUp.h>

#include <MenuBar.h>
#include <MenuField.h>
#include <MenuItem.h>
#include <PopUpMenu.h>

#include "ControlFixture.h"
#include "support/ControlUser.h"

namespace {

constexpr uint32 kInvoked = 'invk';

BOptionPopUp*
NewPopUp()
{
	BOptionPopUp* popUp =
		new BOptionPopUp(BRect(20, 20, 219, 45), "options", "Size:", new BMessage(kInvoked));
	popUp->AddOption("Small", 10);
	popUp->AddOption("Medium", 20);
	popUp->AddOption("Large", 30);
	return popUp;
}


std::string
Shown(BOptionPopUp* popUp)
{
	return popUp->MenuField()->MenuItem()->Label();
}

} // namespace


TEST(OptionPopUp, HoldsItsOptionsInAMenuField)
{
	BApplication app("application/x-vnd.Archway-test");
	const std::unique_ptr<BOptionPopUp> popUp(NewPopUp());
	EXPECT_EQ(static_cast<uint32>(B_WILL_DRAW), popUp->Flags());
	EXPECT_EQ(popUp->MenuField(), popUp->FindView("_menu"));
	EXPECT_EQ(1, popUp->CountChildren());
	EXPECT_STREQ("Size:", popUp->MenuField()->Label());
	EXPECT_NE(0u, popUp->MenuField()->Flags() & B_NAVIGABLE);
	BMenu* menu = popUp->MenuField()->Menu();
	ASSERT_NE(nullptr, dynamic_cast<BPopUpMenu*>(menu));
	ASSERT_EQ(3, menu->CountItems());
	EXPECT_EQ(static_cast<uint32>(B_OPTION_VALUE), menu->ItemAt(1)->Message()->what);
	EXPECT_EQ(20, menu->ItemAt(1)->Message()->GetInt32("be:value", 0));
}


TEST(OptionPopUp, TheFirstOptionAddedIsTheValue)
{
	BApplication app("application/x-vnd.Archway-test");
	const std::unique_ptr<BOptionPopUp> popUp(NewPopUp());
	EXPECT_EQ(10, popUp->Value());
	const char* name = nullptr;
	int32 value = 0;
	EXPECT_EQ(0, popUp->SelectedOption(&name, &value));
	EXPECT_STREQ("Small", name);
	EXPECT_EQ(10, value);
	EXPECT_EQ("Small", Shown(popUp.get()));

	BOptionPopUp empty(BRect(0, 0, 99, 20), "e", NULL, NULL);
	EXPECT_EQ(-1, empty.SelectedOption());
	EXPECT_EQ(0, empty.CountOptions());
	EXPECT_FALSE(empty.GetOptionAt(0, NULL, NULL));
}


TEST(OptionPopUp, OptionsComeAndGoAtTheirPlaces)
{
	BApplication app("application/x-vnd.Archway-test");
	const std::unique_ptr<BOptionPopUp> popUp(NewPopUp());
	EXPECT_EQ(B_OK, popUp->AddOptionAt("Tiny", 5, 0));
	EXPECT_EQ(B_BAD_VALUE, popUp->AddOptionAt("Far", 5, 5));
	EXPECT_EQ(B_BAD_VALUE, popUp->AddOptionAt("Before", 5, -1));
	EXPECT_EQ(B_BAD_VALUE, popUp->AddOptionAt(NULL, 5, 0));
	ASSERT_EQ(4, popUp->CountOptions());
	const char* name;
	int32 value;
	ASSERT_TRUE(popUp->GetOptionAt(0, &name, &value));
	EXPECT_STREQ("Tiny", name);
	EXPECT_EQ(5, value);
	EXPECT_EQ(1, popUp->SelectedOption()) << "an option before it moves the chosen one";

	popUp->RemoveOptionAt(1);
	EXPECT_EQ(-1, popUp->SelectedOption());
	EXPECT_EQ(10, popUp->Value());
	popUp->RemoveOptionAt(17);
	EXPECT_EQ(3, popUp->CountOptions());
}


TEST(OptionPopUp, TheMarkFollowsTheValue)
{
	BApplication app("application/x-vnd.Archway-test");
	const std::unique_ptr<BOptionPopUp> popUp(NewPopUp());
	popUp->SetValue(30);
	EXPECT_EQ(2, popUp->SelectedOption());
	EXPECT_EQ("Large", Shown(popUp.get()));
	EXPECT_EQ(B_OK, popUp->SelectOptionFor("Medium"));
	EXPECT_EQ(20, popUp->Value());
	EXPECT_EQ(1, popUp->SelectedOption());
	EXPECT_EQ(B_OK, popUp->SelectOptionFor(10));
	EXPECT_EQ(0, popUp->SelectedOption());
	EXPECT_EQ(B_ERROR, popUp->SelectOptionFor(11));

	// A value that no option has marks nothing anew.
	popUp->SetValue(99);
	EXPECT_EQ(99, popUp->Value());
	EXPECT_EQ(0, popUp->SelectedOption());
}


TEST(OptionPopUp, AChoiceByTheMouseSetsTheValueAndInvokes)
{
	ControlFixture fixture;
	BOptionPopUp* popUp = fixture.Add(NewPopUp());
	ControlUser(fixture.driver).Choose(popUp->MenuField(), "Large");
	const std::vector<BMessage> sent = fixture.Received(kInvoked);
	ASSERT_EQ(1u, sent.size());
	ExpectInvocationFields(sent[0], popUp, 30);
	fixture.Locked([&] {
		EXPECT_EQ(30, popUp->Value());
		EXPECT_EQ(2, popUp->SelectedOption());
		EXPECT_EQ("Large", Shown(popUp));
	});
}


TEST(OptionPopUp, AnOptionAddedWhileShownIsChosenLikeTheOthers)
{
	ControlFixture fixture;
	BOptionPopUp* popUp = fixture.Add(NewPopUp());
	fixture.Locked([&] { EXPECT_EQ(B_OK, popUp->AddOption("Huge", 40)); });
	ControlUser(fixture.driver).Choose(popUp->MenuField(), "Huge");
	EXPECT_EQ(1, fixture.CountReceived(kInvoked));
	fixture.Locked([&] { EXPECT_EQ(40, popUp->Value()); });
}


TEST(OptionPopUp, KeysChooseToo)
{
	ControlFixture fixture;
	BOptionPopUp* popUp = fixture.Add(NewPopUp());
	fixture.Focus(popUp);
	fixture.Locked([&] { EXPECT_TRUE(popUp->MenuField()->IsFocus()); });
	fixture.driver.Key("Space");
	fixture.driver.Key("Down");
	fixture.driver.Key("Return");
	fixture.Locked([&] { EXPECT_EQ(20, popUp->Value()); });
	const std::vector<BMessage> sent = fixture.Received(kInvoked);
	ASSERT_EQ(1u, sent.size());
	ExpectInvocationFields(sent[0], popUp, 20);
}


TEST(OptionPopUp, ADisabledOneIsNotOpened)
{
	ControlFixture fixture;
	BOptionPopUp* popUp = fixture.Add(NewPopUp());
	fixture.Locked([&] {
		popUp->SetEnabled(false);
		EXPECT_FALSE(popUp->MenuField()->IsEnabled());
	});
	fixture.driver.Click(popUp->MenuField()->MenuBar());
	fixture.Locked([&] {
		EXPECT_EQ(nullptr, popUp->MenuField()->Menu()->Window());
		popUp->SetEnabled(true);
		EXPECT_TRUE(popUp->MenuField()->IsEnabled());
	});
	ControlUser(fixture.driver).Choose(popUp->MenuField(), "Medium");
	EXPECT_EQ(1, fixture.CountReceived(kInvoked));
}


TEST(OptionPopUp, LabelAndSizeAreThoseOfTheField)
{
	ControlFixture fixture;
	BOptionPopUp* popUp = fixture.Add(NewPopUp());
	fixture.Locked([&] {
		popUp->SetLabel("A longer label:");
		EXPECT_STREQ("A longer label:", popUp->Label());
		EXPECT_STREQ("A longer label:", popUp->MenuField()->Label());
		popUp->ResizeToPreferred();
	});
	fixture.Locked([&] {
		float width;
		float height;
		popUp->GetPreferredSize(&width, &height);
		EXPECT_EQ(width, popUp->Bounds().Width());
		EXPECT_EQ(height, popUp->Bounds().Height());
		EXPECT_EQ(popUp->Bounds(), popUp->MenuField()->Frame());
		const float label = popUp->StringWidth("A longer label:");
		EXPECT_NEAR(label + 8, popUp->MenuField()->Divider(), 1);

		// Every option has room.
		popUp->SelectOptionFor("Medium");
		float bar;
		popUp->MenuField()->MenuBar()->GetPreferredSize(&bar, NULL);
		EXPECT_LE(popUp->MenuField()->MenuBar()->Frame().left + bar, width);
		popUp->SetLabel(NULL);
		EXPECT_EQ(nullptr, popUp->MenuField()->Label());
		popUp->ResizeToPreferred();
		EXPECT_EQ(0, popUp->MenuField()->Divider());
	});
}


TEST(OptionPopUp, DrawsWhatIsChosenAndGreyWhenDisabled)
{
	ControlFixture fixture;
	BOptionPopUp* popUp = fixture.Add(NewPopUp());
	const auto darkPixels = [&] {
		int32 count = 0;
		for (float x = 0; x < 30; x++) {
			for (float y = 0; y < 24; y++) {
				if (fixture.driver.PixelAt(popUp, BPoint(x, y)).red < 60)
					count++;
			}
		}
		return count;
	};
	EXPECT_LT(10, darkPixels());
	fixture.Locked([&] { popUp->SetEnabled(false); });
	EXPECT_EQ(0, darkPixels());
}


TEST(OptionPopUp, AnswersAsAControlDoes)
{
	ControlFixture fixture;
	BOptionPopUp* popUp = fixture.Add(NewPopUp());
	BMessage set(B_SET_PROPERTY);
	set.AddSpecifier("Value");
	set.AddInt32("data", 30);
	BMessage reply;
	ASSERT_EQ(B_OK, BMessenger(popUp).SendMessage(&set, &reply));
	EXPECT_EQ(B_OK, reply.GetInt32("error", B_ERROR));
	fixture.Locked([&] { EXPECT_EQ(2, popUp->SelectedOption()); });
}


TEST(OptionPopUp, ArchiveRoundTripKeepsEverything)
{
	ControlFixture fixture;
	const std::unique_ptr<BOptionPopUp> popUp(NewPopUp());
	popUp->SetValue(20);
	popUp->SetEnabled(false);
	const BMessage archive = ArchiveOf(*popUp);
	EXPECT_EQ("_msg _label _val _disable", OwnFieldNames(archive));
	BMessage child;
	ASSERT_EQ(B_OK, archive.FindMessage("_views", &child));
	EXPECT_STREQ("BMenuField", child.GetString("class", ""));
	EXPECT_STREQ("_menu", child.GetString("_name", ""));
	ExpectArchiveRoundTrip<BOptionPopUp>(fixture, archive);

	const std::unique_ptr<BOptionPopUp> revived = Revive<BOptionPopUp>(archive);
	ASSERT_EQ(3, revived->CountOptions());
	EXPECT_EQ(1, revived->SelectedOption());
	EXPECT_EQ(20, revived->Value());
	EXPECT_FALSE(revived->IsEnabled());
	EXPECT_EQ(1, revived->CountChildren());
}


TEST(OptionPopUp, ARevivedOneWorks)
{
	ControlFixture fixture;
	std::unique_ptr<BOptionPopUp> original(NewPopUp());
	BOptionPopUp* popUp = fixture.Add(Revive<BOptionPopUp>(ArchiveOf(*original)).release());
	ControlUser(fixture.driver).Choose(popUp->MenuField(), "Medium");
	const std::vector<BMessage> sent = fixture.Received(kInvoked);
	ASSERT_EQ(1u, sent.size());
	ExpectInvocationFields(sent[0], popUp, 20);
}


TEST(OptionPopUp, AnArchiveWithoutMenuFieldStaysSoUntilAnOptionIsAdded)
{
	ControlFixture fixture;
	const std::unique_ptr<BOptionPopUp> original(NewPopUp());
	const BMessage archive = ArchiveOf(*original, false);
	EXPECT_FALSE(archive.HasMessage("_views"));
	ExpectArchiveRoundTrip<BOptionPopUp>(fixture, archive);

	BOptionPopUp* popUp = fixture.Add(Revive<BOptionPopUp>(archive).release());
	fixture.Locked([&] {
		EXPECT_EQ(0, popUp->CountOptions());
		EXPECT_EQ(-1, popUp->SelectedOption());
		popUp->RemoveOptionAt(0);
		popUp->ResizeToPreferred();
		EXPECT_EQ(B_OK, popUp->AddOption("Only", 7));
		EXPECT_STREQ("Size:", popUp->MenuField()->Label());
		EXPECT_EQ(7, popUp->Value());
	});
	ControlUser(fixture.driver).Choose(popUp->MenuField(), "Only");
	EXPECT_EQ(1, fixture.CountReceived(kInvoked));
}
