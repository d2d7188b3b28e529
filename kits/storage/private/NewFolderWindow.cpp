#include "storage/private/NewFolderWindow.h"

#include <Button.h>
#include <Message.h>
#include <TextControl.h>

#include "interface/private/Look.h"
#include "storage/private/FilePanelCodes.h"

namespace BPrivate {

namespace {


constexpr uint32 kMake = 'Make';
constexpr float kWidth = 300;
constexpr float kHeight = 76;
constexpr float kMargin = 10;
constexpr float kButtonWidth = 75;


} // namespace


NewFolderWindow::NewFolderWindow(BWindow* panel) :
	BWindow(BRect(0, 0, kWidth, kHeight), "New folder", B_TITLED_WINDOW_LOOK,
		B_MODAL_SUBSET_WINDOW_FEEL,
		B_NOT_RESIZABLE | B_NOT_ZOOMABLE | B_ASYNCHRONOUS_CONTROLS | B_CLOSE_ON_ESCAPE),
	fPanel(panel)
{
	BView* ground = new BView(Bounds(), "ground", B_FOLLOW_ALL_SIDES, B_WILL_DRAW);
	ground->SetViewColor(Look::PanelColor());
	AddChild(ground);

	BRect frame(kMargin, kMargin, kWidth - kMargin, kMargin + 20);
	fName = new BTextControl(frame, "name", "Name:", "New folder", NULL);
	fName->SetDivider(40);
	ground->AddChild(fName);

	frame.Set(kWidth - kMargin - kButtonWidth, kHeight - kMargin - 24, kWidth - kMargin,
		kHeight - kMargin);
	BButton* button = new BButton(frame, "make", "Create", new BMessage(kMake));
	frame.OffsetBy(-kButtonWidth - kMargin, 0);
	ground->AddChild(new BButton(frame, "cancel", "Cancel", new BMessage(B_QUIT_REQUESTED)));
	ground->AddChild(button);
	button->MakeDefault(true);
	fName->MakeFocus(true);

	AddToSubset(panel);
	CenterIn(panel->Frame());
}


void
NewFolderWindow::MessageReceived(BMessage* message)
{
	if (message->what != kMake) {
		BWindow::MessageReceived(message);
		return;
	}
	BMessage make(kPanelMakeFolder);
	make.AddString("name", fName->Text());
	fPanel.SendMessage(&make);
	PostMessage(B_QUIT_REQUESTED);
}

} // namespace BPrivate
