// The groups of text fields, menu fields, lists and text.
#include "Groups.h"

#include <memory>
#include <utility>
#include <vector>

#include <Box.h>
#include <ListView.h>
#include <MenuField.h>
#include <MenuItem.h>
#include <Message.h>
#include <OutlineListView.h>
#include <PopUpMenu.h>
#include <ScrollView.h>
#include <StringItem.h>
#include <TextControl.h>
#include <TextView.h>

namespace {

constexpr float kLeft = 12; // of what stands in a box
constexpr float kTop = 20;

// A list leaves its items to the program.
template<class List> class OwningList : public List {
public:
	using List::List;
	~OwningList() override { this->MakeEmpty(); }

	void Add(std::unique_ptr<BStringItem> item)
	{
		this->AddItem(item.get());
		fItems.push_back(std::move(item));
	}

private:
	std::vector<std::unique_ptr<BStringItem>> fItems;
};


BBox*
NewBox(BRect frame, const char* label)
{
	BBox* box = new BBox(frame, label);
	box->SetLabel(label);
	return box;
}


BMessage*
NewMessage()
{
	return new BMessage('used');
}


BMenuField*
NewMenuField(float top, const char* label)
{
	BPopUpMenu* menu = new BPopUpMenu("Choose");
	for (const char* item : { "Apples", "Pears", "Cherries" })
		menu->AddItem(new BMenuItem(item, NewMessage()));
	menu->ItemAt(1)->SetMarked(true);
	BMenuField* field =
		new BMenuField(BRect(kLeft, top, kLeft + 216, top + 20), label, label, menu);
	field->SetDivider(70);
	return field;
}

} // namespace


BView*
NewFieldGroup(BRect frame)
{
	BBox* box = NewBox(frame, "Fields");
	float top = kTop;
	const auto addText = [&](const char* label, const char* text) {
		BTextControl* control = new BTextControl(
			BRect(kLeft, top, kLeft + 216, top + 19), label, label, text, NewMessage());
		control->SetDivider(70);
		box->AddChild(control);
		top += 24;
		return control;
	};
	addText("Name:", "A text to change");
	addText("Disabled:", "Not to be changed")->SetEnabled(false);
	addText("Number:", "42")->SetAlignment(B_ALIGN_RIGHT, B_ALIGN_RIGHT);

	box->AddChild(NewMenuField(top, "Fruit:"));
	BMenuField* disabled = NewMenuField(top + 25, "Disabled:");
	disabled->SetEnabled(false);
	box->AddChild(disabled);
	return box;
}


BView*
NewListGroup(BRect frame)
{
	BBox* box = NewBox(frame, "Lists");
	auto list =
		new OwningList<BListView>(BRect(kLeft + 2, kTop + 2, kLeft + 84, kTop + 91), "list");
	for (const char* item :
		{ "Monday", "Tuesday", "Wednesday", "Thursday", "Friday", "Saturday", "Sunday" }) {
		list->Add(std::make_unique<BStringItem>(item));
	}
	list->ItemAt(3)->SetEnabled(false);
	list->Select(1);
	box->AddChild(
		new BScrollView("list scroller", list, B_FOLLOW_LEFT | B_FOLLOW_TOP, 0, false, true));

	auto outline = new OwningList<BOutlineListView>(
		BRect(kLeft + 118, kTop + 2, kLeft + 200, kTop + 91), "outline");
	outline->Add(std::make_unique<BStringItem>("Plants"));
	outline->Add(std::make_unique<BStringItem>("Trees", 1));
	outline->Add(std::make_unique<BStringItem>("Oak", 2));
	outline->Add(std::make_unique<BStringItem>("Grass", 1));
	outline->Add(std::make_unique<BStringItem>("Animals", 0, false));
	outline->Add(std::make_unique<BStringItem>("Cat", 1));
	box->AddChild(
		new BScrollView("outline scroller", outline, B_FOLLOW_LEFT | B_FOLLOW_TOP, 0, false, true));
	return box;
}


BView*
NewTextGroup(BRect frame)
{
	BBox* box = NewBox(frame, "Text");
	const BRect place(kLeft + 2, kTop, kLeft + 198, kTop + 86);
	BRect textRect = place.OffsetToCopy(0, 0);
	textRect.InsetBy(3, 3);
	BTextView* text = new BTextView(place, "text", textRect, B_FOLLOW_LEFT | B_FOLLOW_TOP,
		B_WILL_DRAW | B_PULSE_NEEDED | B_NAVIGABLE);
	text->SetText("A text view wraps its lines at the right edge, takes the keys and the mouse, "
				  "and knows the clipboard.\n\nGrüße, žluťoučký kůň, καλημέρα, здравствуйте.");
	text->SetStylable(true);
	const rgb_color blue = { 0, 0, 229, 255 };
	text->SetFontAndColor(0, 11, be_bold_font, B_FONT_ALL, &blue);
	box->AddChild(
		new BScrollView("text scroller", text, B_FOLLOW_LEFT | B_FOLLOW_TOP, 0, false, true));
	return box;
}
