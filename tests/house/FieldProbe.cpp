// Whether an archived field is shown: objects that differ in it alone are pictured and compared.

#include "ClassTable.h"

#include <deque>
#include <functional>
#include <memory>

#include <Archivable.h>
#include <Box.h>
#include <Button.h>
#include <ChannelSlider.h>
#include <CheckBox.h>
#include <ColorControl.h>
#include <ListView.h>
#include <MenuBar.h>
#include <MenuField.h>
#include <MenuItem.h>
#include <Message.h>
#include <OutlineListView.h>
#include <PopUpMenu.h>
#include <RadioButton.h>
#include <ScrollBar.h>
#include <ScrollView.h>
#include <SeparatorView.h>
#include <Slider.h>
#include <StatusBar.h>
#include <StringItem.h>
#include <StringView.h>
#include <TabView.h>
#include <TextControl.h>
#include <TextView.h>
#include <Window.h>

#include "server/Desktop.h"
#include "server/ScreenPicture.h"
#include "support/Driver.h"

namespace {


const BRect kFrame(20, 20, 219, 119);
const BRect kWindow(50, 50, 349, 249);

// What is archived, and the field that the class's own archive lies in, NULL for the whole.
struct Sample {
	std::function<BView*()> make;
	const char* inside = nullptr;
};


BListView*
Filled(BListView* list)
{
	// A list leaves its items to the program.
	static std::deque<BStringItem> sItems;
	for (const char* text : { "One", "Two", "Three" })
		list->AddItem(&sItems.emplace_back(text));
	return list;
}


BMenuBar*
FilledBar()
{
	BMenuBar* bar = new BMenuBar(kFrame, "bar");
	BMenuItem* item = new BMenuItem("First", new BMessage('item'), 'F');
	bar->AddItem(item);
	bar->AddItem(new BMenuItem("Second", new BMessage('item')));
	return bar;
}


BTabView*
FilledTabs()
{
	BTabView* tabs = new BTabView(kFrame, "tabs", B_WIDTH_AS_USUAL, B_FOLLOW_NONE);
	for (const char* name : { "Front", "Back" }) {
		BView* page = new BView(BRect(0, 0, 100, 50), name, B_FOLLOW_NONE, B_WILL_DRAW);
		page->SetViewColor(
			name[0] == 'F' ? rgb_color { 200, 0, 0, 255 } : rgb_color { 0, 0, 200, 255 });
		tabs->AddTab(page);
	}
	tabs->Select(0);
	return tabs;
}


BScrollView*
Scrolled()
{
	BView* target = new BView(BRect(20, 20, 119, 89), "target", B_FOLLOW_NONE, B_WILL_DRAW);
	return new BScrollView("scroll", target, B_FOLLOW_NONE, 0, true, true);
}


BSlider*
FilledSlider()
{
	BSlider* slider = new BSlider(kFrame, "slider", "Slider", NULL, 0, 100);
	slider->SetLimitLabels("low", "high");
	slider->SetHashMarks(B_HASH_MARKS_BOTH);
	slider->SetHashMarkCount(5);
	slider->SetValue(40);
	return slider;
}


BChannelSlider*
FilledChannels()
{
	BChannelSlider* slider =
		new BChannelSlider(kFrame, "channels", "Channels", NULL, B_HORIZONTAL, 3);
	slider->SetLimitLabels("low", "high");
	slider->SetAllValue(40);
	return slider;
}


BMenuField*
FilledField()
{
	BPopUpMenu* menu = new BPopUpMenu("menu");
	menu->AddItem(new BMenuItem("Chosen", NULL));
	menu->ItemAt(0)->SetMarked(true);
	return new BMenuField(kFrame, "field", "Field:", menu);
}


BStatusBar*
FilledStatus()
{
	BStatusBar* bar = new BStatusBar(kFrame, "status", "Label", "Trailing");
	bar->Update(30, "text", "trailing");
	return bar;
}


const std::map<std::string, Sample>&
Samples()
{
	static const std::map<std::string, Sample> kSamples = {
		{ "BView", { [] { return new BView(kFrame, "view", B_FOLLOW_NONE, B_WILL_DRAW); } } },
		{ "BControl", { [] { return new BButton(kFrame, "control", "Label", NULL); } } },
		{ "BButton", { [] { return new BButton(kFrame, "button", "Label", NULL); } } },
		{ "BCheckBox", { [] { return new BCheckBox(kFrame, "box", "Label", NULL); } } },
		{ "BRadioButton", { [] { return new BRadioButton(kFrame, "radio", "Label", NULL); } } },
		{ "BTextControl",
			{ [] { return new BTextControl(kFrame, "control", "Label", "Text", NULL); } } },
		{ "BSlider", { FilledSlider } },
		{ "BChannelControl", { FilledChannels } },
		{ "BChannelSlider", { FilledChannels } },
		{ "BColorControl",
			{ [] { return new BColorControl(BPoint(20, 20), B_CELLS_32x8, 4, "color"); } } },
		{ "BStatusBar", { FilledStatus } },
		{ "BStringView", { [] { return new BStringView(kFrame, "string", "Text"); } } },
		{ "BSeparatorView", { [] {
			 BSeparatorView* line = new BSeparatorView("line", "Label");
			 line->MoveTo(kFrame.LeftTop());
			 line->ResizeTo(kFrame.Width(), kFrame.Height());
			 return line;
		 } } },
		{ "BBox", { [] {
			 BBox* box = new BBox(kFrame, "box");
			 box->SetLabel("Label");
			 return box;
		 } } },
		{ "BTextView", { [] {
			 BTextView* view =
				 new BTextView(kFrame, "text", BRect(5, 5, 150, 90), B_FOLLOW_NONE, B_WILL_DRAW);
			 view->SetText("Some\ttext that is\twrapped at the edge of a rectangle");
			 return view;
		 } } },
		{ "BScrollView", { Scrolled } },
		{ "BScrollBar", { [] {
			 BScrollBar* bar =
				 new BScrollBar(BRect(20, 20, 34, 119), "bar", NULL, 0, 100, B_VERTICAL);
			 bar->SetProportion(0.3f);
			 bar->SetValue(40);
			 return bar;
		 } } },
		{ "BTabView", { FilledTabs } },
		{ "BTab", { FilledTabs, "_l_items" } },
		{ "BListView", { [] { return Filled(new BListView(kFrame, "list")); } } },
		{ "BOutlineListView", { [] { return Filled(new BOutlineListView(kFrame, "list")); } } },
		{ "BListItem", { [] { return Filled(new BListView(kFrame, "list")); }, "_l_items" } },
		{ "BStringItem", { [] { return Filled(new BListView(kFrame, "list")); }, "_l_items" } },
		{ "BMenuField", { FilledField } },
		{ "BMenu", { FilledBar } },
		{ "BMenuBar", { FilledBar } },
		{ "BMenuItem", { FilledBar, "_items" } },
	};
	return kSamples;
}


// Puts the n-th value of the type into the field; false when there are no more.
bool
Change(BMessage* archive, const char* field, const std::string& type, size_t n)
{
	archive->RemoveName(field);
	if (type == "Bool")
		return n < 2 && archive->AddBool(field, n == 0) == B_OK;
	if (type == "String") {
		const char* const kTexts[] = { "Another", "X" };
		return n < std::size(kTexts) && archive->AddString(field, kTexts[n]) == B_OK;
	}
	if (type == "Rect")
		return n < 1 && archive->AddRect(field, BRect(10, 10, 60, 40)) == B_OK;
	if (type == "Point")
		return n < 1 && archive->AddPoint(field, BPoint(7, 9)) == B_OK;

	const int32 kNumbers[] = { 0, 1, 2, 3, 16, 60, 0x1234, 0x00ff8000 };
	if (n >= std::size(kNumbers))
		return false;
	if (type == "Int32")
		return archive->AddInt32(field, kNumbers[n]) == B_OK;
	if (type == "Int16")
		return archive->AddInt16(field, static_cast<int16>(kNumbers[n])) == B_OK;
	if (type == "Int8")
		return archive->AddInt8(field, static_cast<int8>(kNumbers[n])) == B_OK;
	if (type == "Float" || type == "Floats") {
		const float value = static_cast<float>(kNumbers[n] % 1000) / (n == 1 ? 2 : 1);
		return archive->AddFloat(field, value) == B_OK
			&& archive->AddFloat(field, value * 2) == B_OK;
	}
	return false;
}


// What the screen shows of the object in a window of its own.
std::vector<uint8>
PictureOf(const BMessage& archive)
{
	BMessage copy(archive);
	BView* view = dynamic_cast<BView*>(instantiate_object(&copy));
	BWindow* window = new BWindow(kWindow, "probe", B_TITLED_WINDOW, B_ASYNCHRONOUS_CONTROLS);
	BView* ground = new BView(window->Bounds(), "ground", B_FOLLOW_ALL, B_WILL_DRAW);
	ground->SetViewColor(216, 216, 216);
	window->AddChild(ground);
	if (view != NULL)
		ground->AddChild(view);
	window->Show();
	Driver::WaitUntilIdle();
	std::vector<uint8> picture = BPrivate::Desktop::Get()->Picture(kWindow).bits;
	window->Lock();
	window->Quit();
	Driver::WaitUntilIdle();
	return picture;
}


// Inside: every entry of the field that the class's own archives lie in is changed alike.
bool
ChangeSample(
	BMessage* archive, const char* inside, const char* field, const std::string& type, size_t n)
{
	if (inside == nullptr)
		return Change(archive, field, type, n);
	BMessage item;
	for (int32 i = 0; archive->FindMessage(inside, i, &item) == B_OK; i++) {
		if (!Change(&item, field, type, n) || archive->ReplaceMessage(inside, i, &item) != B_OK)
			return false;
	}
	return true;
}


} // namespace


std::string
IsShown(const std::string& className, const std::string& field, const std::string& type)
{
	const auto found = Samples().find(className);
	if (found == Samples().end())
		return "";
	const Sample& sample = found->second;
	BMessage archive;
	const std::unique_ptr<BView> made(sample.make());
	if (made->Archive(&archive, true) != B_OK)
		return "";
	const std::vector<uint8> usual = PictureOf(archive);

	bool tried = false;
	for (size_t n = 0;; n++) {
		BMessage changed(archive);
		if (!ChangeSample(&changed, sample.inside, field.c_str(), type, n))
			break;
		tried = true;
		if (PictureOf(changed) != usual)
			return "yes";
	}
	return tried ? "no" : "";
}
