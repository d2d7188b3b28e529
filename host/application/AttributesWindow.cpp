#include "host/application/AttributesWindow.h"

#include <cerrno>
#include <cstdlib>

#include <Alert.h>
#include <Button.h>
#include <Message.h>
#include <String.h>
#include <TextControl.h>
#include <TextView.h>

#include "host/application/Codes.h"
#include "host/application/FourCharacters.h"
#include "host/library/ResourceItem.h"

using namespace BResEditor;

namespace {


constexpr float kWidth = 300;
constexpr float kHeight = 122;
constexpr float kMargin = 10;
constexpr float kRowHeight = 24;
constexpr float kDivider = 46;
constexpr float kButtonWidth = 75;
constexpr float kButtonHeight = 24;
constexpr uint32 kConfirm = 'Conf';
constexpr rgb_color kPanelColor = { 216, 216, 216, 255 };


bool
ParseID(const char* text, int32* _id)
{
	char* end;
	errno = 0;
	const long number = strtol(text, &end, 0);
	*_id = static_cast<int32>(number);
	return end != text && *end == '\0' && errno == 0 && number == *_id;
}


void
Tell(const char* text)
{
	(new BAlert("Archway", text, "OK", NULL, NULL, B_WIDTH_AS_USUAL, B_WARNING_ALERT))->Go(NULL);
}


} // namespace


AttributesWindow::AttributesWindow(
	BRect over, const BMessenger& target, const BResourceItem* item) :
	BWindow(BRect(0, 0, kWidth, kHeight), "Attributes", B_TITLED_WINDOW_LOOK, B_NORMAL_WINDOW_FEEL,
		B_NOT_RESIZABLE | B_NOT_ZOOMABLE | B_ASYNCHRONOUS_CONTROLS | B_CLOSE_ON_ESCAPE),
	fTarget(target)
{
	MoveTo(over.left + (over.Width() - kWidth) / 2, over.top + (over.Height() - kHeight) / 2);
	BView* ground = new BView(Bounds(), "ground", B_FOLLOW_ALL_SIDES, B_WILL_DRAW);
	ground->SetViewColor(kPanelColor);
	AddChild(ground);

	fType = _AddField("Type:", FourCharacters(item->Type()).c_str(), 0);
	fID = _AddField("ID:", (BString() << item->ID()).String(), 1);
	fName = _AddField("Name:", item->Name(), 2);
	_AddButtons();
	fName->MakeFocus(true);
}


void
AttributesWindow::MessageReceived(BMessage* message)
{
	if (message->what == kConfirm)
		_Send();
	else
		BWindow::MessageReceived(message);
}


// #pragma mark - private


BTextControl*
AttributesWindow::_AddField(const char* label, const char* text, int32 row)
{
	const float top = kMargin + static_cast<float>(row) * kRowHeight;
	BTextControl* field =
		new BTextControl(BRect(kMargin, top, kWidth - kMargin, top + kRowHeight - 4), label, label,
			text, NULL, B_FOLLOW_LEFT_RIGHT | B_FOLLOW_TOP);
	field->SetDivider(kDivider);
	ChildAt(0)->AddChild(field);
	return field;
}


void
AttributesWindow::_AddButtons()
{
	BRect frame(0, 0, kButtonWidth, kButtonHeight);
	frame.OffsetTo(kWidth - kMargin - kButtonWidth, kHeight - kMargin - kButtonHeight);
	BButton* confirm =
		new BButton(frame, "OK", "OK", new BMessage(kConfirm), B_FOLLOW_RIGHT | B_FOLLOW_BOTTOM);
	frame.OffsetBy(-kButtonWidth - kMargin, 0);
	ChildAt(0)->AddChild(new BButton(frame, "Cancel", "Cancel", new BMessage(B_QUIT_REQUESTED),
		B_FOLLOW_RIGHT | B_FOLLOW_BOTTOM));
	ChildAt(0)->AddChild(confirm);
	SetDefaultButton(confirm);
}


void
AttributesWindow::_Send()
{
	type_code type;
	int32 id;
	if (!ParseFourCharacters(fType->Text(), &type)) {
		Tell("A type is four characters, or a number in the form 0x41524356.");
		return;
	}
	if (!ParseID(fID->Text(), &id)) {
		Tell("An ID is a whole number from -2147483648 to 2147483647.");
		return;
	}
	BMessage chosen(kAttributesChosen);
	chosen.AddInt32("type", static_cast<int32>(type));
	chosen.AddInt32("id", id);
	chosen.AddString("name", fName->Text());
	fTarget.SendMessage(&chosen);
}
