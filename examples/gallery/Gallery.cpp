// A window with every control in every state, to look at and to play with.
#include <Alert.h>
#include <Application.h>
#include <MenuBar.h>
#include <MenuItem.h>
#include <Message.h>
#include <Window.h>

#include "Groups.h"

namespace {

constexpr uint32 kShowAlert = 'alrt';
constexpr float kMargin = 12;
constexpr float kColumnWidth = 240;

class GalleryWindow : public BWindow {
public:
	GalleryWindow();

	void MessageReceived(BMessage* message) override;
	bool QuitRequested() override;

private:
	void _AddMenus();
	void _AddGroups(float top);
	void _ShowAlert(int32 type);

	BView* fGround; // child
	BMenuBar* fMenuBar; // child
};


GalleryWindow::GalleryWindow() :
	BWindow(BRect(60, 40, 60 + 3 * kColumnWidth + 4 * kMargin - 1, 40 + 521), "Gallery",
		B_TITLED_WINDOW, B_ASYNCHRONOUS_CONTROLS | B_NOT_RESIZABLE | B_NOT_ZOOMABLE)
{
	_AddMenus();
	BRect frame = Bounds();
	frame.top = fMenuBar->Frame().bottom + 1;
	fGround = new BView(frame, "ground", B_FOLLOW_ALL, B_WILL_DRAW);
	fGround->SetViewColor(216, 216, 216);
	AddChild(fGround);
	_AddGroups(kMargin);
}


void
GalleryWindow::_AddMenus()
{
	fMenuBar = new BMenuBar(BRect(0, 0, Bounds().right, 18), "menu bar");
	BMenu* file = new BMenu("Gallery");
	file->AddItem(new BMenuItem("About…", new BMessage(B_ABOUT_REQUESTED)));
	file->AddSeparatorItem();
	file->AddItem(new BMenuItem("Quit", new BMessage(B_QUIT_REQUESTED), 'Q'));
	fMenuBar->AddItem(file);

	BMenu* alerts = new BMenu("Alerts");
	const char* const names[] = { "Empty", "Info", "Idea", "Warning", "Stop" };
	for (int32 type = B_EMPTY_ALERT; type <= static_cast<int32>(B_STOP_ALERT); type++) {
		BMessage* message = new BMessage(kShowAlert);
		message->AddInt32("type", type);
		alerts->AddItem(new BMenuItem(names[type], message));
	}
	fMenuBar->AddItem(alerts);

	BMenu* states = new BMenu("States");
	states->AddItem(new BMenuItem("Marked", NULL));
	states->ItemAt(0)->SetMarked(true);
	states->AddItem(new BMenuItem("Disabled", NULL));
	states->ItemAt(1)->SetEnabled(false);
	BMenu* deeper = new BMenu("Deeper");
	deeper->AddItem(new BMenuItem("Deepest", NULL));
	states->AddItem(deeper);
	fMenuBar->AddItem(states);
	AddChild(fMenuBar);
}


void
GalleryWindow::_AddGroups(float top)
{
	const auto column = [](int index, float top, float height) {
		const float left = kMargin + index * (kColumnWidth + kMargin);
		return BRect(left, top, left + kColumnWidth - 1, top + height - 1);
	};
	// Three columns of groups that end on one line, and the pages below them all.
	const float bottom = top + 368;
	const auto fill = [&](int index, float top) { return column(index, top, bottom - top); };

	const float choices = top + 90 + kMargin;
	const float strings = choices + 126 + kMargin;
	fGround->AddChild(NewButtonGroup(column(0, top, 90)));
	fGround->AddChild(NewChoiceGroup(column(0, choices, 126)));
	fGround->AddChild(NewStringGroup(fill(0, strings)));

	const float sliders = top + 150 + kMargin;
	fGround->AddChild(NewFieldGroup(column(1, top, 150)));
	fGround->AddChild(NewSliderGroup(fill(1, sliders)));

	const float text = top + 127 + kMargin;
	const float status = text + 118 + kMargin;
	fGround->AddChild(NewListGroup(column(2, top, 127)));
	fGround->AddChild(NewTextGroup(column(2, text, 118)));
	fGround->AddChild(NewStatusGroup(fill(2, status)));

	const float pages = bottom + kMargin;
	fGround->AddChild(NewPageGroup(BRect(
		kMargin, pages, 3 * kColumnWidth + 3 * kMargin - 1, fGround->Bounds().bottom - kMargin)));
}


void
GalleryWindow::MessageReceived(BMessage* message)
{
	switch (message->what) {
		case kShowAlert:
			_ShowAlert(message->GetInt32("type", B_INFO_ALERT));
			break;
		case B_ABOUT_REQUESTED:
			(new BAlert("About", "Every control in every state.", "OK"))->Go(NULL);
			break;
		case 'used':
			break;
		default:
			BWindow::MessageReceived(message);
			break;
	}
}


void
GalleryWindow::_ShowAlert(int32 type)
{
	BAlert* alert = new BAlert("Alert",
		"The rightmost button answers Enter, the first one Escape. Do you want to go on?", "Cancel",
		"No", "Yes", B_WIDTH_AS_USUAL, B_OFFSET_SPACING, static_cast<alert_type>(type));
	alert->SetShortcut(0, B_ESCAPE);
	alert->Go(NULL);
}


bool
GalleryWindow::QuitRequested()
{
	be_app->PostMessage(B_QUIT_REQUESTED);
	return true;
}

} // namespace


int
main()
{
	BApplication application("application/x-vnd.Archway-gallery");
	(new GalleryWindow)->Show();
	application.Run();
	return 0;
}
