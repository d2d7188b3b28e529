#include "Groups.h"

#include <Box.h>
#include <Button.h>
#include <CheckBox.h>
#include <ColorControl.h>
#include <Dragger.h>
#include <Message.h>
#include <PictureButton.h>
#include <RadioButton.h>
#include <Shelf.h>
#include <Slider.h>
#include <StatusBar.h>
#include <StringView.h>
#include <TabView.h>

namespace {

constexpr float kLeft = 12; // of what stands in a box
constexpr float kTop = 20;

// A slider that says its value.
class NumberSlider : public BSlider {
public:
	using BSlider::BSlider;

	const char* UpdateText() const override
	{
		fText = std::to_string(Value());
		return fText.c_str();
	}

private:
	mutable std::string fText;
};


// A field that keeps the replicants which are dropped on it.
class ShelfView : public BView {
public:
	explicit ShelfView(BRect frame) :
		BView(frame, "shelf", B_FOLLOW_LEFT | B_FOLLOW_TOP, B_WILL_DRAW), fShelf(this)
	{
		SetViewColor(152, 152, 152);
	}

private:
	BShelf fShelf;
};


BBox*
NewBox(BRect frame, const char* label, border_style border = B_FANCY_BORDER)
{
	BBox* box = new BBox(frame, label, B_FOLLOW_LEFT | B_FOLLOW_TOP,
		B_WILL_DRAW | B_FRAME_EVENTS | B_NAVIGABLE_JUMP, border);
	box->SetLabel(label);
	return box;
}


template<class Control>
Control*
Disabled(Control* control)
{
	control->SetEnabled(false);
	return control;
}


template<class Control>
Control*
WithValue(Control* control, int32 value)
{
	control->SetValue(value);
	return control;
}


BMessage*
NewMessage()
{
	return new BMessage('used');
}


BButton*
NewButton(float left, float top, const char* label)
{
	return new BButton(BRect(left, top, left + 92, top + 24), label, label, NewMessage());
}

} // namespace


BView*
NewButtonGroup(BRect frame)
{
	BBox* box = NewBox(frame, "Buttons");
	BButton* standard = NewButton(kLeft + 3, kTop + 3, "Default");
	box->AddChild(standard);
	standard->MakeDefault(true);
	BButton* normal = NewButton(kLeft + 112, kTop + 3, "Normal");
	box->AddChild(normal);
	box->AddChild(WithValue(NewButton(kLeft + 3, kTop + 36, "Pressed"), B_CONTROL_ON));
	box->AddChild(Disabled(NewButton(kLeft + 112, kTop + 36, "Disabled")));
	return box;
}


BView*
NewChoiceGroup(BRect frame)
{
	BBox* box = NewBox(frame, "Choices");
	const auto place = [](int column, int row) {
		const float left = kLeft + column * 112;
		const float top = kTop + row * 20;
		return BRect(left, top, left + 106, top + 18);
	};
	const auto check = [&](int row, const char* label, int32 value) {
		BCheckBox* control = new BCheckBox(place(0, row), label, label, NewMessage());
		control->SetValue(value);
		box->AddChild(control);
		return control;
	};
	const auto radio = [&](BView* group, BRect frame, const char* label, int32 value) {
		BRadioButton* control = new BRadioButton(frame, label, label, NewMessage());
		group->AddChild(control);
		control->SetValue(value);
		return control;
	};

	check(0, "Off", B_CONTROL_OFF);
	check(1, "On", B_CONTROL_ON);
	check(2, "Partly on", B_CONTROL_PARTIALLY_ON);
	Disabled(check(3, "Disabled off", B_CONTROL_OFF));
	Disabled(check(4, "Disabled on", B_CONTROL_ON));
	radio(box, place(1, 0), "Not chosen", B_CONTROL_OFF);
	radio(box, place(1, 1), "Chosen", B_CONTROL_ON);
	Disabled(radio(box, place(1, 2), "Disabled", B_CONTROL_OFF));

	// A group of its own, so that it can have a chosen one as well.
	BBox* inner = new BBox(BRect(kLeft + 112, kTop + 58, kLeft + 212, kTop + 98), "inner",
		B_FOLLOW_LEFT | B_FOLLOW_TOP, B_WILL_DRAW | B_FRAME_EVENTS, B_NO_BORDER);
	box->AddChild(inner);
	Disabled(radio(inner, BRect(0, 2, 100, 20), "Disabled on", B_CONTROL_ON));
	return box;
}


BView*
NewStringGroup(BRect frame)
{
	BBox* box = new BBox(frame, "Strings");
	BCheckBox* label = new BCheckBox(BRect(0, 0, 110, 18), "label", "Strings and boxes", NULL);
	label->SetValue(B_CONTROL_ON);
	box->SetLabel(label);
	label->ResizeToPreferred();

	float top = kTop + 2;
	const auto add = [&](const char* text, alignment align) {
		BStringView* view = new BStringView(BRect(kLeft, top, kLeft + 216, top + 14), text, text);
		view->SetAlignment(align);
		box->AddChild(view);
		top += 16;
	};
	add("Aligned to the left", B_ALIGN_LEFT);
	add("In the middle", B_ALIGN_CENTER);
	add("Aligned to the right", B_ALIGN_RIGHT);

	top += 4;
	const border_style borders[] = { B_FANCY_BORDER, B_PLAIN_BORDER, B_NO_BORDER };
	const char* const names[] = { "Fancy", "Plain", "None" };
	for (int i = 0; i < 3; i++) {
		const float left = kLeft + i * 73.0f;
		BBox* sample = NewBox(BRect(left, top, left + 68, top + 36), names[i], borders[i]);
		box->AddChild(sample);
	}
	return box;
}


BView*
NewSliderGroup(BRect frame)
{
	BBox* box = NewBox(frame, "Sliders");
	const BRect first(kLeft, kTop, kLeft + 150, kTop + 40);
	BSlider* block = new NumberSlider(first, "block", "Block", NewMessage(), 0, 100);
	block->SetLimitLabels("0", "100");
	block->SetHashMarks(B_HASH_MARKS_BOTH);
	block->SetHashMarkCount(11);
	block->SetValue(30);
	box->AddChild(block);

	BSlider* triangle = new BSlider(first.OffsetByCopy(0, 66), "triangle", "Triangle, filled",
		NewMessage(), 0, 100, B_TRIANGLE_THUMB);
	const rgb_color fill = { 50, 150, 255, 255 };
	triangle->UseFillColor(true, &fill);
	triangle->SetHashMarks(B_HASH_MARKS_BOTTOM);
	triangle->SetHashMarkCount(5);
	triangle->SetValue(50);
	box->AddChild(triangle);

	BSlider* disabled =
		new BSlider(first.OffsetByCopy(0, 122), "disabled", "Disabled", NewMessage(), 0, 100);
	disabled->SetValue(70);
	box->AddChild(Disabled(disabled));

	const BRect upright(kLeft + 162, kTop, kLeft + 216, kTop + 164);
	BSlider* vertical = new BSlider(
		upright, "vertical", "Upright", NewMessage(), 0, 100, B_VERTICAL, B_BLOCK_THUMB);
	vertical->SetLimitLabels("low", "high");
	vertical->SetHashMarks(B_HASH_MARKS_RIGHT);
	vertical->SetHashMarkCount(5);
	vertical->SetValue(25);
	box->AddChild(vertical);
	return box;
}


BView*
NewStatusGroup(BRect frame)
{
	BBox* box = NewBox(frame, "Status bars");
	const BRect first(kLeft, kTop, kLeft + 216, kTop + 30);
	BStatusBar* bar = new BStatusBar(first, "bar", "Copying:", "of 12");
	bar->Update(60, "pictures", "7");
	box->AddChild(bar);

	BStatusBar* slim = new BStatusBar(first.OffsetByCopy(0, 40), "slim", "Slim and green");
	slim->SetBarHeight(10);
	slim->SetBarColor({ 60, 180, 60, 255 });
	slim->Update(25);
	box->AddChild(slim);
	return box;
}


BView*
NewPageGroup(BRect frame)
{
	BTabView* tabs = new BTabView(frame, "tabs", B_WIDTH_AS_USUAL, B_FOLLOW_LEFT | B_FOLLOW_TOP);
	const BRect page(0, 0, frame.Width() - 6, frame.Height() - tabs->TabHeight() - 6);

	BView* colors = new BView(page, "Colours", B_FOLLOW_ALL, B_WILL_DRAW);
	colors->SetViewColor(216, 216, 216);
	BColorControl* control =
		new BColorControl(BPoint(10, 8), B_CELLS_32x8, 6, "colour", NewMessage());
	control->SetValue({ 51, 102, 152, 255 });
	colors->AddChild(control);
	BColorControl* disabled =
		new BColorControl(BPoint(306, 8), B_CELLS_32x8, 6, "disabled", NewMessage());
	disabled->SetValue({ 200, 80, 40, 255 });
	colors->AddChild(Disabled(disabled));
	BPictureButton* picture = new BPictureButton(BRect(604, 14, 696, 52), "picture", NewMessage());
	picture->SetLabel("Picture button");
	picture->SetToolTip("A tool tip\nof two lines");
	colors->AddChild(picture);
	tabs->AddTab(colors);

	BView* second = new BView(page, "Second", B_FOLLOW_ALL, B_WILL_DRAW);
	second->SetViewColor(216, 216, 216);
	second->AddChild(new BStringView(BRect(10, 8, 209, 24), "text", "The second page"));
	BStringView* replicant = new BStringView(BRect(10, 36, 159, 55), "replicant", "To the shelf");
	replicant->AddChild(new BDragger(BRect(142, 12, 149, 19), replicant));
	second->AddChild(replicant);
	second->AddChild(new ShelfView(BRect(300, 8, 696, 60)));
	tabs->AddTab(second);
	tabs->AddTab(NewValuePage(page));
	tabs->AddTab(new BView(page, "Disabled", B_FOLLOW_ALL, B_WILL_DRAW));
	tabs->TabAt(3)->SetEnabled(false);
	return tabs;
}
