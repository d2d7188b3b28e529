// What the rows of the panels are made of.
#pragma once

#include <initializer_list>

#include <Box.h>
#include <Message.h>
#include <Rect.h>
#include <SupportDefs.h>
#include <View.h>

class BButton;
class BCheckBox;
class BMenu;
class BMenuField;
class BRadioButton;
class BTextControl;
class FloatControl;
class IntControl;
class LiveColorControl;

constexpr uint32 kFollowLeftTop = B_FOLLOW_LEFT | B_FOLLOW_TOP;
constexpr uint32 kFollowRightTop = B_FOLLOW_RIGHT | B_FOLLOW_TOP;
constexpr uint32 kFollowWidth = B_FOLLOW_LEFT_RIGHT | B_FOLLOW_TOP;
constexpr uint32 kControlFlags = B_WILL_DRAW | B_NAVIGABLE;
constexpr uint32 kGroupFlags = B_WILL_DRAW | B_NAVIGABLE_JUMP | B_FRAME_EVENTS;

// A rectangle by its left top and its size (right - left, bottom - top).
BRect FrameAt(float left, float top, float width, float height);

// Make a control without a name and add it to the panel, which owns it.
BTextControl* AddTextControl(BView* panel, BRect frame, const char* label, uint32 code,
	float divider, uint32 resizingMode = kFollowLeftTop);
IntControl* AddIntControl(BView* panel, BRect frame, const char* label, uint32 code, int value,
	int min, int max, float divider, uint32 resizingMode = kFollowLeftTop);
FloatControl* AddFloatControl(BView* panel, BRect frame, const char* label, uint32 code,
	float value, float min, float max, float divider, uint32 resizingMode = kFollowLeftTop);
BCheckBox* AddCheckBox(BView* panel, BRect frame, const char* label, uint32 code);
BButton* AddButton(BView* panel, BRect frame, const char* label, uint32 code,
	uint32 resizingMode = kFollowLeftTop);
BRadioButton* AddRadioButton(
	BView* panel, BRect frame, const char* label, uint32 code, uint32 resizingMode);
void AddSentence(BView* panel, BRect frame, const char* text, uint32 resizingMode = kFollowLeftTop);
void AddSeparator(BView* panel, BRect frame);
BMenuField* AddMenuField(
	BView* panel, BRect frame, const char* label, BMenu* menu, float divider, uint32 resizingMode);

// A menu that shows the chosen item. An item's index is the platform's value that it stands for.
BMenu* MakeChoiceMenu(std::initializer_list<const char*> labels, uint32 code);
BMenu* MakeAlignmentMenu(uint32 code);
BMenu* MakeBorderMenu(uint32 code);
void MarkChoice(BMenu* menu, int32 index); // nothing is marked for an index that no item has
int32 Choice(const BMenu* menu); // -1 when nothing is marked

// A check box's value as a switch. Setting it sends nothing.
bool IsOn(const BCheckBox* box);
void SetOn(BCheckBox* box, bool on);

// What the text begins with; a number beyond the type counts as the type's own limit.
int32 NumberFromText(const char* text);

// A number without its fraction, or the type's limit where it is beyond that.
int32 WholeNumber(float number);

// Four-character codes as text, the most significant byte first. What is typed is shown as the code
// that it was taken for.
uint32 TakeCode(BTextControl* control);
void ShowCode(BTextControl* control, uint32 code);
void ShowMessageCode(BTextControl* control, const BMessage* message); // "----" for NULL

// Gives the message the code that was typed, and leaves its fields alone. Without a message, hands a
// new one over.
template<class Give>
void
TakeMessageCode(BTextControl* control, BMessage* message, const Give& give)
{
	const uint32 code = TakeCode(control);
	if (message != NULL)
		message->what = code;
	else
		give(new BMessage(code));
}

bool SameRGB(rgb_color a, rgb_color b);

// The group with which a bar's colour is chosen: the control, a swatch that shows the colour, and a
// button for the default. What they send is kLiveColorChanged, kColorComponentTyped and:
constexpr uint32 kDefaultColorPressed = 'dflt';
struct BarColorGroup {
	LiveColorControl* control;
	BBox* swatch;
};
// The origin is the colour control's, in the group.
BarColorGroup AddBarColorGroup(BView* panel, BRect frame, BPoint origin);
// Loads both parts. The control's message comes to nothing while the panel is not shown.
void ShowBarColor(const BarColorGroup& group, rgb_color color);
// Carries out one of the codes. Gives the control's colour in place of the present one, and returns
// whether it is another: loading the control reports the present colour too.
bool TakeBarColor(
	const BarColorGroup& group, uint32 code, rgb_color defaultColor, rgb_color* color);
// The same for the view that has the bar.
template<class View>
void
ApplyBarColor(const BarColorGroup& group, uint32 code, rgb_color defaultColor, View* bar)
{
	rgb_color color = bar->BarColor();
	if (!TakeBarColor(group, code, defaultColor, &color))
		return;
	bar->SetBarColor(color);
	bar->Invalidate();
}
void ShowSwatch(BBox* swatch, rgb_color color);
BBox* AddSwatch(BView* panel, BRect frame);
