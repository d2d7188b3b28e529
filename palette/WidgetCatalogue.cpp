#include "palette/WidgetCatalogue.h"

#include <cstring>

#include <Box.h>
#include <Button.h>
#include <CheckBox.h>
#include <ColorControl.h>
#include <ListView.h>
#include <MenuBar.h>
#include <MenuField.h>
#include <MenuItem.h>
#include <Message.h>
#include <OutlineListView.h>
#include <RadioButton.h>
#include <ScrollBar.h>
#include <ScrollView.h>
#include <Slider.h>
#include <StatusBar.h>
#include <StringView.h>
#include <TabView.h>
#include <TextControl.h>
#include <TextView.h>

#include "archive/LayoutInheritedView.h"

namespace {


constexpr rgb_color kSampleColor = { 255, 255, 204, 255 };
constexpr rgb_color kScrolledColor = { 204, 255, 244, 255 };
constexpr rgb_color kPageColor = { 255, 232, 216, 255 };

constexpr uint32 kLeftTop = B_FOLLOW_LEFT | B_FOLLOW_TOP;
constexpr uint32 kControlFlags = B_WILL_DRAW | B_NAVIGABLE;
constexpr uint32 kListFlags = B_WILL_DRAW | B_FRAME_EVENTS | B_NAVIGABLE;
constexpr uint32 kItemCode = 'xxxx';
constexpr float kScrolledHeight = 200;

constexpr const char* kSampleText =
	"Mark \"stylable,\" right-click here, then paste from StyleEdit application.";


BRect
Sized(float width, float height)
{
	return BRect(0, 0, width, height);
}


void
SetGround(BView* view, rgb_color color)
{
	view->SetViewColor(color);
	view->SetLowColor(color);
}


void
AddItems(BMenu* menu, std::initializer_list<const char*> labels)
{
	for (const char* label : labels)
		menu->AddItem(new BMenuItem(label, new BMessage(kItemCode)));
}


BView*
MakeView()
{
	return new BView(Sized(64, 32), NULL, kLeftTop, B_WILL_DRAW);
}


BView*
MakeCustomView()
{
	return new LayoutInheritedView(Sized(64, 32), NULL, kLeftTop, B_WILL_DRAW);
}


BView*
MakeButton()
{
	return new BButton(
		Sized(80, 18), NULL, "button", new BMessage('clik'), kLeftTop, kControlFlags);
}


BView*
MakeStringView()
{
	return new BStringView(Sized(180, 15), NULL, "String View", kLeftTop, B_WILL_DRAW);
}


BView*
MakeBox()
{
	return new BBox(Sized(64, 32), NULL, kLeftTop, B_WILL_DRAW | B_NAVIGABLE_JUMP | B_FRAME_EVENTS,
		B_FANCY_BORDER);
}


BView*
MakeCheckBox()
{
	return new BCheckBox(
		Sized(80, 16), NULL, "checkbox", new BMessage('cbox'), kLeftTop, kControlFlags);
}


BView*
MakeRadioButton()
{
	return new BRadioButton(
		Sized(80, 16), NULL, "radiobutton", new BMessage('rado'), kLeftTop, kControlFlags);
}


BView*
MakeStatusBar()
{
	return new BStatusBar(Sized(220, 30), NULL, "Copying:", "items remaining");
}


BView*
MakeTextControl()
{
	return new BTextControl(
		Sized(120, 16), NULL, "Text:", "Hello!", new BMessage('tval'), kLeftTop, kControlFlags);
}


BView*
MakeSlider()
{
	BSlider* slider = new BSlider(Sized(220, 16), "", "Toast:", new BMessage('sldr'), 0, 99,
		B_BLOCK_THUMB, kLeftTop, kListFlags);
	slider->SetHashMarks(B_HASH_MARKS_BOTTOM);
	slider->SetHashMarkCount(11);
	slider->SetLimitLabels("light", "dark");
	return slider;
}


BView*
MakeColorControl()
{
	return new BColorControl(BPoint(0, 0), B_CELLS_32x8, 1, "Quib", new BMessage('colr'), false);
}


BTextView*
MakeTextViewWith(uint32 resizingMode)
{
	BTextView* view = new BTextView(Sized(120, 40), "", BRect(2, 2, 118, 38), resizingMode,
		B_WILL_DRAW | B_PULSE_NEEDED | B_FRAME_EVENTS);
	view->SetText(kSampleText);
	return view;
}


BView*
MakeTextView()
{
	return MakeTextViewWith(kLeftTop);
}


BScrollView*
MakeScrollViewRound(BView* target)
{
	return new BScrollView("", target, kLeftTop, 0, true, true, B_FANCY_BORDER);
}


BView*
MakeScrolledTextView()
{
	return MakeScrollViewRound(MakeTextViewWith(B_FOLLOW_ALL_SIDES));
}


// The target scrolls as if it were higher than it is.
BView*
MakeScrolledView()
{
	BView* target = new BView(Sized(224, 128), NULL, B_FOLLOW_ALL_SIDES, B_WILL_DRAW);
	SetGround(target, kScrolledColor);
	BScrollView* scrollView = MakeScrollViewRound(target);

	BScrollBar* bar = scrollView->ScrollBar(B_HORIZONTAL);
	bar->SetRange(0, 0);
	bar->SetProportion(1);
	bar->SetSteps(10, 30);

	const float height = target->Bounds().Height();
	bar = scrollView->ScrollBar(B_VERTICAL);
	if (kScrolledHeight - height >= 0) {
		bar->SetRange(0, kScrolledHeight - height);
		bar->SetProportion(height / kScrolledHeight);
		bar->SetSteps(5, 10);
	}
	return scrollView;
}


BView*
MakeTabView()
{
	BTabView* tabView = new BTabView(Sized(256, 192), "", B_WIDTH_AS_USUAL, B_FOLLOW_ALL_SIDES,
		B_FULL_UPDATE_ON_RESIZE | B_WILL_DRAW | B_NAVIGABLE_JUMP | B_FRAME_EVENTS | B_NAVIGABLE);
	BRect frame = tabView->Bounds();
	frame.left += 3;
	frame.top += 2;
	frame.right -= 4;
	frame.bottom -= 5 + tabView->TabHeight();

	for (const char* label : { "Tab 1", "Tab 2" }) {
		BTab* tab = new BTab;
		BView* page = new BView(frame, NULL, B_FOLLOW_ALL_SIDES, B_WILL_DRAW);
		tabView->AddTab(page, tab);
		SetGround(page, kPageColor);
		tab->SetLabel(label);
	}
	return tabView;
}


BView*
MakeListView()
{
	return new BListView(Sized(128, 192), "", B_SINGLE_SELECTION_LIST, kLeftTop, kListFlags);
}


BView*
MakeOutlineListView()
{
	return new BOutlineListView(Sized(128, 192), "", B_SINGLE_SELECTION_LIST, kLeftTop, kListFlags);
}


BView*
MakeMenuField()
{
	BMenu* menu = new BMenu("select...", B_ITEMS_IN_COLUMN);
	menu->SetLabelFromMarked(true);
	AddItems(menu, { "Snap", "Crackel", "Pop!" });
	BMenuField* field =
		new BMenuField(Sized(140, 20), "", "Sounds:", menu, true, kLeftTop, kControlFlags);
	field->SetDivider(40);
	return field;
}


BView*
MakeMenuBar()
{
	BMenuBar* bar =
		new BMenuBar(Sized(140, 20), "", B_FOLLOW_LEFT_RIGHT | B_FOLLOW_TOP, B_ITEMS_IN_ROW, true);
	BMenu* menu = new BMenu("File", B_ITEMS_IN_COLUMN);
	AddItems(menu, { "New", "Open...", "Save", "Save As..", "Close", "Quit" });
	bar->AddItem(menu);
	return bar;
}


struct Kind {
	const char* entry;
	BView* (*make)();
};

constexpr Kind kKinds[] = { { "BView", MakeView }, { "BView (custom)", MakeCustomView },
	{ "BButton", MakeButton }, { "BStringView", MakeStringView }, { "BBox", MakeBox },
	{ "BCheckBox", MakeCheckBox }, { "BRadioButton", MakeRadioButton },
	{ "BStatusBar", MakeStatusBar }, { "BTextControl", MakeTextControl }, { "BSlider", MakeSlider },
	{ "BColorControl", MakeColorControl }, { "BTextView", MakeTextView },
	{ "BScrollView with BTextView", MakeScrolledTextView },
	{ "BScrollView with BView", MakeScrolledView }, { "BTabView", MakeTabView },
	{ "BListView", MakeListView }, { "BOutlineListView", MakeOutlineListView },
	{ "BMenuField", MakeMenuField }, { "BMenuBar", MakeMenuBar } };


} // namespace


BView*
MakeSample(const char* entry)
{
	for (const Kind& kind : kKinds) {
		if (strcmp(entry, kind.entry) != 0)
			continue;

		BView* sample = kind.make();
		if (dynamic_cast<BTabView*>(sample) == nullptr
			&& dynamic_cast<BListView*>(sample) == nullptr)
			SetGround(sample, kSampleColor);
		sample->ResizeToPreferred();
		return sample;
	}
	return nullptr;
}


void
FinishAttachedSample(BView* sample)
{
	if (BStatusBar* bar = dynamic_cast<BStatusBar*>(sample))
		bar->Update(65, "Tolva.jpg", "12");
}
