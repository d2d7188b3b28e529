// ControlUser: uses controls as a person does, by mouse and keys.
#pragma once

#include <string>
#include <string_view>
#include <vector>

#include <View.h>

#include "support/Driver.h"

class BButton;
class BCheckBox;
class BMenuField;
class BMenuItem;
class BOutlineListView;
class BTextControl;


// Views are only looked at to find out where they are. With no window locked.
class ControlUser {
public:
	explicit ControlUser(Driver& driver) : fDriver(driver) {}

	// Clicks into the field, replaces all of its text, and leaves it to the caller to confirm.
	void Replace(BTextControl* field, std::string_view text);
	void Paste(BTextControl* field, const std::string& text); // the same with the clipboard's text
	void TypeOver(BTextControl* field, std::string_view text); // and confirms

	// Opens the field's menu and lets go of the button over the item.
	void Choose(BMenuField* field, const char* label);

	// Opens everything and clicks on the entry.
	void ClickEntry(BOutlineListView* list, const char* text);

	// The same without the click: where the entry is on the screen.
	BPoint PlaceOfEntry(BOutlineListView* list, const char* text);

	// The n-th control of a class with that label below a view, in the order of the children.
	template<class Control> static Control* Find(BView* root, const std::string& label, int n = 0)
	{
		return _Find<Control>(root, label, n);
	}

	// Every view of a class below a view, in the order of the children.
	template<class View> static std::vector<View*> All(BView* root)
	{
		std::vector<View*> views;
		_Collect(root, views);
		return views;
	}

private:
	template<class View> static void _Collect(BView* root, std::vector<View*>& views)
	{
		for (BView* child = root->ChildAt(0); child != nullptr; child = child->NextSibling()) {
			if (View* view = dynamic_cast<View*>(child))
				views.push_back(view);
			_Collect(child, views);
		}
	}

	template<class Control> static Control* _Find(BView* root, const std::string& label, int& n)
	{
		for (BView* child = root->ChildAt(0); child != nullptr; child = child->NextSibling()) {
			Control* control = dynamic_cast<Control*>(child);
			const char* text = control != nullptr ? control->Label() : nullptr;
			if (control != nullptr && (text != nullptr ? text : "") == label && n-- == 0)
				return control;
			if (Control* found = _Find<Control>(child, label, n))
				return found;
		}
		return nullptr;
	}

	void _EnterAndClear(BTextControl* field);
	bool _Expand(BOutlineListView* list);
	void _ScrollTo(BOutlineListView* list, int32 index);

	Driver& fDriver;
};
