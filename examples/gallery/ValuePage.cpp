// The page of controls that have several values to choose from, or to set.
#include "Groups.h"

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

} // namespace


BView*
NewValuePage(BRect frame)
{
	BView* page = new BView(frame, "Options and channels", B_FOLLOW_ALL, B_WILL_DRAW);
	page->SetViewColor(216, 216, 216);
	page->AddChild(NewOptions(BPoint(10, 10), "Quality:"));
	BOptionPopUp* disabled = NewOptions(BPoint(10, 36), "Disabled:");
	disabled->SetEnabled(false);
	page->AddChild(disabled);
	return page;
}
