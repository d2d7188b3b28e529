// The page of controls that have several values to choose from, or to set.
#include "Groups.h"

#include <ChannelSlider.h>
#include <MenuField.h>
#include <Message.h>
#include <OptionPopUp.h>

namespace {

BOptionPopUp*
NewOptions(BPoint place, const char* label)
{
	BOptionPopUp* options =
		new BOptionPopUp(BRect(place, place + BPoint(170, 20)), label, label, new BMessage('used'));
	options->AddOption("Low", 10);
	options->AddOption("Medium", 20);
	options->AddOption("Very high", 30);
	options->SelectOptionFor(20);
	options->MenuField()->SetDivider(60);
	return options;
}


BChannelSlider*
NewChannels(BRect frame, const char* label, orientation posture, int32 channels)
{
	BChannelSlider* slider = new BChannelSlider(frame, label, label, new BMessage('used'), posture,
		channels, B_FOLLOW_LEFT | B_FOLLOW_TOP, B_WILL_DRAW | B_NAVIGABLE);
	for (int32 i = 0; i < channels; i++)
		slider->SetValueFor(i, 30 + 20 * i);
	return slider;
}

} // namespace


BView*
NewValuePage(BRect frame)
{
	BView* page = new BView(frame, "Channels", B_FOLLOW_ALL, B_WILL_DRAW);
	page->SetViewColor(216, 216, 216);
	page->AddChild(NewOptions(BPoint(10, 10), "Quality:"));
	BOptionPopUp* disabled = NewOptions(BPoint(10, 36), "Disabled:");
	disabled->SetEnabled(false);
	page->AddChild(disabled);

	BChannelSlider* stereo = NewChannels(BRect(200, 8, 370, 70), "Stereo", B_HORIZONTAL, 2);
	stereo->SetLimitLabels("soft", "loud");
	page->AddChild(stereo);
	BChannelSlider* bands = NewChannels(BRect(400, 2, 470, 72), "Bands", B_VERTICAL, 4);
	page->AddChild(bands);
	BChannelSlider* grey = NewChannels(BRect(500, 8, 670, 70), "Out of use", B_HORIZONTAL, 2);
	grey->SetLimitLabels("soft", "loud");
	grey->SetEnabled(false);
	page->AddChild(grey);
	return page;
}
