#include "host/application/PathWindow.h"

#include <cmath>

#include <AppDefs.h>
#include <Button.h>
#include <Message.h>
#include <Screen.h>
#include <String.h>
#include <TextControl.h>

#include "host/application/Codes.h"

namespace {


constexpr uint32 kChoose = 'Chse';
constexpr float kWidth = 420;
constexpr float kHeight = 76;
constexpr float kMargin = 10;
constexpr float kButtonWidth = 75;
constexpr rgb_color kPanelColor = { 216, 216, 216, 255 };


BRect
CenteredFrame()
{
	const BRect screen = BScreen().Frame();
	const BRect frame(0, 0, kWidth, kHeight);
	return frame.OffsetToCopy(std::floor(screen.left + (screen.Width() - kWidth) / 2),
		std::floor(screen.top + (screen.Height() - kHeight) / 3));
}


} // namespace


PathWindow::PathWindow(
	const char* title, const char* action, const char* path, const BMessenger& target) :
	BWindow(CenteredFrame(), title, B_TITLED_WINDOW,
		B_NOT_RESIZABLE | B_NOT_ZOOMABLE | B_ASYNCHRONOUS_CONTROLS),
	fTarget(target)
{
	BView* ground = new BView(Bounds(), "ground", B_FOLLOW_ALL_SIDES, B_WILL_DRAW);
	ground->SetViewColor(kPanelColor);
	AddChild(ground);

	BRect frame(kMargin, kMargin, kWidth - kMargin, kMargin + 20);
	fPathControl = new BTextControl(frame, "path", "File:", path, NULL);
	fPathControl->SetDivider(32);
	ground->AddChild(fPathControl);

	frame.Set(kWidth - kMargin - kButtonWidth, kHeight - kMargin - 24, kWidth - kMargin,
		kHeight - kMargin);
	BButton* button = new BButton(frame, "choose", action, new BMessage(kChoose));
	ground->AddChild(button);
	button->MakeDefault(true);

	frame.OffsetBy(-kButtonWidth - kMargin, 0);
	ground->AddChild(new BButton(frame, "cancel", "Cancel", new BMessage(B_QUIT_REQUESTED)));
	fPathControl->MakeFocus(true);
}


void
PathWindow::MessageReceived(BMessage* message)
{
	if (message->what != kChoose) {
		BWindow::MessageReceived(message);
		return;
	}

	if (fPathControl->Text()[0] != '\0') {
		BMessage chosen(kPathChosen);
		chosen.AddString("path", fPathControl->Text());
		fTarget.SendMessage(&chosen);
	}
	PostMessage(B_QUIT_REQUESTED);
}
