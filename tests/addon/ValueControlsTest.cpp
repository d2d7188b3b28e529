// Controls without a panel of their own are live views in the editor, and change only as edited.

#include "EditorFixture.h"

#include <ChannelSlider.h>
#include <MenuField.h>
#include <OptionPopUp.h>

namespace {


class ValueControls : public EditorFixture {
protected:
	ValueControls()
	{
		BView* root =
			new BView(BRect(0, 0, 399, 299), "root", B_FOLLOW_LEFT | B_FOLLOW_TOP, B_WILL_DRAW);
		BOptionPopUp* options =
			new BOptionPopUp(BRect(20, 20, 219, 50), "options", "Size:", new BMessage('opti'));
		options->AddOption("Small", 1);
		options->AddOption("Large", 2);
		root->AddChild(options);
		BChannelSlider* channels = new BChannelSlider(
			BRect(20, 80, 219, 150), "channels", "Volume", new BMessage('chan'), 2);
		channels->SetLimitLabels("soft", "loud");
		channels->SetAllValue(40);
		root->AddChild(channels);
		item = Add(1, root);
		Open(item);
	}

	BMessage Written(int32 index)
	{
		window.Locked([&] { editor->UpdateValue(NULL); });
		BMessage child;
		EXPECT_EQ(B_OK, Archive(item).FindMessage("_views", index, &child));
		return child;
	}

	BResEditor::BResourceHandle item;
};


} // namespace


TEST_F(ValueControls, AreLiveAndWrittenBackAsTheyWere)
{
	ASSERT_NE(nullptr, Find<BOptionPopUp>("options"));
	ASSERT_NE(nullptr, Find<BChannelSlider>("channels"));
	const std::string before = Bytes(item);
	window.Locked([&] { editor->UpdateValue(NULL); });
	EXPECT_EQ(before, Bytes(item));
}


TEST_F(ValueControls, AreSelectedAndMovedNotOperated)
{
	BChannelSlider* channels = Find<BChannelSlider>("channels");
	Select(channels);
	driver.Drag(channels, BPoint(100, 25), channels, BPoint(110, 32));
	channels = Find<BChannelSlider>("channels");
	ASSERT_NE(nullptr, channels);
	const BMessage written = Written(1);
	EXPECT_EQ(BRect(30, 87, 229, 157), written.GetRect("_frame", BRect()));
	EXPECT_EQ(40, written.GetInt32("be:_m_channel_val", 0, 0));
	EXPECT_EQ(40, written.GetInt32("be:_m_channel_val", 1, 0));
}


TEST_F(ValueControls, TakeTheSettingsOfControls)
{
	Select(Find("channels"));
	person.TypeOver(Field("EditControl", "Label: "), "Loudness");
	EXPECT_STREQ("Loudness", Find<BChannelSlider>("channels")->Label());
	EXPECT_STREQ("Loudness", Written(1).GetString("_label", ""));
	EXPECT_EQ(2, Written(1).GetInt32("be:_m_channel_count", 0));
}
