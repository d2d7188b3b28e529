// The settings of a mail program: a window's worth of the usual controls.

#include "Panels.h"

#include <Box.h>
#include <Button.h>
#include <CheckBox.h>
#include <Font.h>
#include <MenuField.h>
#include <MenuItem.h>
#include <Message.h>
#include <PopUpMenu.h>
#include <RadioButton.h>
#include <Slider.h>
#include <StatusBar.h>
#include <StringView.h>
#include <TextControl.h>
#include <TextView.h>

namespace {


constexpr float kFieldDivider = 70;


BTextControl*
MakeField(BRect frame, const char* name, const char* label, const char* text, uint32 what)
{
	BTextControl* field = new BTextControl(
		frame, name, label, text, new BMessage(what), B_FOLLOW_LEFT_RIGHT | B_FOLLOW_TOP);
	field->SetDivider(kFieldDivider);
	return field;
}


BBox*
MakeGroup(BRect frame, const char* name, const char* label, uint32 resizingMode)
{
	BBox* box = new BBox(frame, name, resizingMode);
	box->SetLabel(label);
	return box;
}


BView*
MakeAccountGroup()
{
	BBox* box = MakeGroup(
		BRect(12, 44, 347, 164), "account", "Account", B_FOLLOW_LEFT_RIGHT | B_FOLLOW_TOP);
	box->AddChild(MakeField(BRect(12, 18, 323, 37), "name", "Your name:", "Ada Example", 'name'));
	box->AddChild(
		MakeField(BRect(12, 42, 323, 61), "server", "Server:", "mail.example.org", 'serv'));

	BPopUpMenu* protocols = new BPopUpMenu("protocols");
	for (const char* protocol : { "IMAP", "POP3", "Local folder" })
		protocols->AddItem(new BMenuItem(protocol, new BMessage('prot')));
	protocols->ItemAt(0)->SetMarked(true);
	BMenuField* field = new BMenuField(BRect(12, 66, 250, 86), "protocol", "Protocol:", protocols);
	field->SetDivider(kFieldDivider);
	box->AddChild(field);

	BCheckBox* keep = new BCheckBox(
		BRect(81, 92, 300, 109), "keep", "Leave mail on the server", new BMessage('keep'));
	keep->SetValue(B_CONTROL_ON);
	box->AddChild(keep);
	return box;
}


BView*
MakeCheckingGroup()
{
	BBox* box = MakeGroup(
		BRect(12, 174, 172, 268), "checking", "Look for new mail", B_FOLLOW_LEFT | B_FOLLOW_TOP);
	const char* choices[][2] = { { "often", "Every five minutes" }, { "hourly", "Every hour" },
		{ "never", "When I ask for it" } };
	float top = 18;
	for (const auto& [name, label] : choices) {
		box->AddChild(
			new BRadioButton(BRect(12, top, 150, top + 17), name, label, new BMessage('chek')));
		top += 23;
	}
	static_cast<BRadioButton*>(box->FindView("hourly"))->SetValue(B_CONTROL_ON);
	return box;
}


BView*
MakeSoundGroup()
{
	BBox* box =
		MakeGroup(BRect(182, 174, 347, 268), "sound", "Sound", B_FOLLOW_LEFT_RIGHT | B_FOLLOW_TOP);
	BSlider* slider = new BSlider(BRect(12, 18, 153, 80), "volume", "Volume", new BMessage('volu'),
		0, 10, B_TRIANGLE_THUMB, B_FOLLOW_LEFT_RIGHT | B_FOLLOW_TOP);
	slider->SetLimitLabels("quiet", "loud");
	slider->SetHashMarks(B_HASH_MARKS_BOTTOM);
	slider->SetHashMarkCount(11);
	const rgb_color fill = { 70, 120, 200, 255 };
	slider->UseFillColor(true, &fill);
	slider->SetValue(6);
	box->AddChild(slider);
	return box;
}


void
AddButtons(BView* panel)
{
	constexpr uint32 kFollow = B_FOLLOW_RIGHT | B_FOLLOW_BOTTOM;
	panel->AddChild(new BButton(BRect(12, 327, 91, 350), "defaults", "Defaults",
		new BMessage('dflt'), B_FOLLOW_LEFT | B_FOLLOW_BOTTOM));
	panel->AddChild(new BButton(
		BRect(172, 327, 251, 350), "cancel", "Cancel", new BMessage(B_QUIT_REQUESTED), kFollow));
	BButton* save =
		new BButton(BRect(266, 327, 345, 350), "save", "Save", new BMessage('save'), kFollow);
	save->MakeDefault(true);
	panel->AddChild(save);
}


} // namespace


BView*
MakePanel(BRect frame, const char* name, uint32 resizingMode)
{
	BView* panel = new BView(frame, name, resizingMode, B_WILL_DRAW);
	panel->SetViewColor(kPanelColor);
	panel->SetLowColor(kPanelColor);
	return panel;
}


BView*
MakePreferences()
{
	BView* panel = MakePanel(BRect(0, 0, 359, 361), "preferences");

	BStringView* title = new BStringView(BRect(12, 12, 347, 34), "title", "Mail preferences");
	BFont font(be_bold_font);
	font.SetSize(16);
	title->SetFont(&font);
	title->SetHighColor(40, 70, 130);
	panel->AddChild(title);

	panel->AddChild(MakeAccountGroup());
	panel->AddChild(MakeCheckingGroup());
	panel->AddChild(MakeSoundGroup());

	BStatusBar* space =
		new BStatusBar(BRect(12, 276, 347, 312), "space", "Mailbox", "250 of 400 MB");
	space->SetResizingMode(B_FOLLOW_LEFT_RIGHT | B_FOLLOW_TOP);
	space->SetMaxValue(400);
	space->Update(250);
	panel->AddChild(space);

	AddButtons(panel);
	return panel;
}


BView*
MakeAboutPanel()
{
	BView* panel = MakePanel(BRect(0, 0, 299, 179), "about");
	const BRect frame(12, 12, 287, 132);
	BTextView* text = new BTextView(
		frame, "text", frame.OffsetToCopy(0, 0).InsetByCopy(4, 4), B_FOLLOW_ALL_SIDES);
	text->SetText("A mail program that does not exist.\n\nIts panels are here to be taken apart: "
				  "move a button, change a label, drag a new view in from the list. Undo brings "
				  "everything back.");
	text->MakeEditable(false);
	panel->AddChild(text);
	panel->AddChild(new BButton(BRect(208, 144, 287, 167), "ok", "OK",
		new BMessage(B_QUIT_REQUESTED), B_FOLLOW_RIGHT | B_FOLLOW_BOTTOM));
	return panel;
}
