// The panels of controls, boxes, string views, text controls, menu fields and lists.

#include "editors/EditBox.h"
#include "editors/EditButton.h"
#include "editors/EditCheckBox.h"
#include "editors/EditColorControl.h"
#include "editors/EditControl.h"
#include "editors/EditInherited.h"
#include "editors/EditListView.h"
#include "editors/EditMenuField.h"
#include "editors/EditOutlineListView.h"
#include "editors/EditRadioButton.h"
#include "editors/EditStringView.h"
#include "editors/EditTextControl.h"

#include <Box.h>
#include <ColorControl.h>
#include <Menu.h>
#include <OutlineListView.h>
#include <RadioButton.h>
#include <Slider.h>
#include <StringView.h>

#include "PanelFixture.h"
#include "archive/LayoutInheritedView.h"

namespace {


const BRect kFrame(20, 20, 160, 60);


} // namespace


class EditControlTest : public PanelFixture<EditControl> {};


TEST_F(EditControlTest, ShowsWhatTheControlHas)
{
	BCheckBox* box = new BCheckBox(kFrame, "c", "Label", new BMessage('abcd'));
	box->SetValue(1);
	box->SetEnabled(false);
	Use(box);
	EXPECT_EQ("Label", Shown("Label: "));
	EXPECT_EQ("abcd", Shown("Message: "));
	EXPECT_EQ("1", Shown("Value: "));
	EXPECT_FALSE(IsTicked("Enabled"));
	ExpectDeclined();
}


TEST_F(EditControlTest, GivesAMessageToAControlThatHasNone)
{
	BButton* button = Use(new BButton(kFrame, "b", "Label", NULL));
	EXPECT_EQ("----", Shown("Message: "));
	TypeOver("Message: ", "abcd");
	ASSERT_NE(nullptr, button->Message());
	EXPECT_EQ(uint32('abcd'), button->Message()->what);
}


TEST_F(EditControlTest, AnotherCodeKeepsTheMessagesFields)
{
	BMessage* message = new BMessage('abcd');
	message->AddInt32("kept", 7);
	BButton* button = Use(new BButton(kFrame, "b", "Label", message));
	TypeOver("Message: ", "ab");
	EXPECT_EQ(0x61620000u, button->Message()->what);
	EXPECT_EQ(7, button->Message()->GetInt32("kept", 0));
}


TEST_F(EditControlTest, ChangesLabelValueAndState)
{
	BCheckBox* box = Use(new BCheckBox(kFrame, "c", "Old", NULL));
	TypeOver("Label: ", "New");
	EXPECT_STREQ("New", box->Label());
	TypeOver("Value: ", "1x");
	EXPECT_EQ(1, box->Value());
	TypeOver("Value: ", "abc");
	EXPECT_EQ(0, box->Value());
	Tick("Enabled");
	EXPECT_FALSE(box->IsEnabled());
	Tick("Enabled");
	EXPECT_TRUE(box->IsEnabled());
}


TEST_F(EditControlTest, ShowsWhatWasSetAndNotWhatWasTyped)
{
	BSlider* slider = Use(new BSlider(kFrame, "s", "Slide:", NULL, 0, 99));
	TypeOver("Value: ", "12x");
	EXPECT_EQ(12, slider->Value());
	EXPECT_EQ("12", Shown("Value: "));
	TypeOver("Value: ", "99999999999999999999");
	EXPECT_EQ(99, slider->Value());
	EXPECT_EQ("99", Shown("Value: "));
	TypeOver("Message: ", "abcdef");
	EXPECT_EQ("abcd", Shown("Message: "));
}


TEST_F(EditControlTest, ABytesSignSpillsIntoTheHigherOnes)
{
	BButton* button = Use(new BButton(kFrame, "b", "Label", NULL));
	TypeOver("Message: ", "a\xc3\xa4z"); // a, c3, a4, z
	ASSERT_NE(nullptr, button->Message());
	EXPECT_EQ(0xffffa47au, button->Message()->what);
}


TEST_F(EditControlTest, AnEmptyCodeIsZero)
{
	BButton* button = Use(new BButton(kFrame, "b", "Label", new BMessage('abcd')));
	TypeOver("Message: ", "");
	EXPECT_EQ(0u, button->Message()->what);
	EXPECT_EQ("", Shown("Message: "));
}


class EditButtonTest : public PanelFixture<EditButton> {};


TEST_F(EditButtonTest, MakesTheButtonDefaultAndBack)
{
	BButton* button = Use(new BButton(kFrame, "b", "Label", NULL));
	EXPECT_FALSE(IsTicked("Default"));
	Tick("Default");
	EXPECT_TRUE(button->IsDefault());
	Reload(button);
	EXPECT_TRUE(IsTicked("Default"));
	Tick("Default");
	EXPECT_FALSE(button->IsDefault());
	ExpectDeclined();
}


TEST(SentencePanels, SayThatTheClassAddsNothing)
{
	TestWindow window;
	struct Case {
		EditorInterface* panel;
		BView* view;
		const char* text;
	};
	const Case cases[] = {
		{ new EditCheckBox, new BCheckBox(kFrame, NULL, "", NULL),
			"The BCheckBox adds no extra settings." },
		{ new EditRadioButton, new BRadioButton(kFrame, NULL, "", NULL),
			"The BRadioButton adds no extra settings." },
		{ new EditOutlineListView, new BOutlineListView(kFrame, NULL),
			"The BOutlineListView adds no extra settings." },
	};
	for (const Case& each : cases) {
		window.Add(each.panel);
		window.Add(each.view);
		window.Locked([&] {
			EXPECT_TRUE(each.panel->UseView(each.view));
			EXPECT_FALSE(each.panel->UseView(each.panel));
			EXPECT_STREQ(each.text, dynamic_cast<BStringView*>(each.panel->ChildAt(0))->Text());
			EXPECT_EQ(38, each.panel->Bounds().Height());
		});
	}
}


class EditBoxTest : public PanelFixture<EditBox> {};


TEST_F(EditBoxTest, ChangesLabelAndBorder)
{
	BBox* box = Use(new BBox(kFrame, "b"));
	EXPECT_EQ("", Shown("Label: "));
	EXPECT_EQ("B_FANCY_BORDER", Chosen(""));
	TypeOver("Label: ", "Title");
	EXPECT_STREQ("Title", box->Label());
	Choose("", "B_NO_BORDER");
	EXPECT_EQ(B_NO_BORDER, box->Border());
	Reload(box);
	EXPECT_EQ("B_NO_BORDER", Chosen(""));
	EXPECT_EQ("Title", Shown("Label: "));
	ExpectDeclined();
}


TEST_F(EditBoxTest, WithoutABorderTheFrameIsGoneAtOnce)
{
	BBox* box = Use(new BBox(BRect(20, 20, 160, 90), "b"));
	const rgb_color ground = window.driver.PixelAt(box, BPoint(70, 40));
	auto hasFrame = [&] {
		for (int x = 136; x <= 140; x++) {
			if (window.driver.PixelAt(box, BPoint(x, 40)).red != ground.red)
				return true;
		}
		return false;
	};
	EXPECT_TRUE(hasFrame());
	Choose("", "B_NO_BORDER");
	EXPECT_FALSE(hasFrame());
	Choose("", "B_PLAIN_BORDER");
	EXPECT_TRUE(hasFrame());
}


TEST_F(EditBoxTest, AnEmptyLabelIsPassedOn)
{
	BBox* box = new BBox(kFrame, "b");
	box->SetLabel("Title");
	Use(box);
	TypeOver("Label: ", "");
	EXPECT_TRUE(box->Label() == NULL || box->Label()[0] == '\0');
}


class EditStringViewTest : public PanelFixture<EditStringView> {};


TEST_F(EditStringViewTest, ChangesTextAndAlignment)
{
	BStringView* view = new BStringView(kFrame, "s", "Hello");
	view->SetAlignment(B_ALIGN_RIGHT);
	Use(view);
	EXPECT_EQ("Hello", Shown("Text: "));
	EXPECT_EQ("B_ALIGN_RIGHT", Chosen(""));
	TypeOver("Text: ", "Goodbye");
	EXPECT_STREQ("Goodbye", view->Text());
	Choose("", "B_ALIGN_CENTER");
	EXPECT_EQ(B_ALIGN_CENTER, view->Alignment());
	ExpectDeclined();
}


class EditTextControlTest : public PanelFixture<EditTextControl> {};


TEST_F(EditTextControlTest, ChangesAlignmentsAndDivider)
{
	BTextControl* control = Use(new BTextControl(kFrame, "t", "Label", "text", NULL));
	Choose("Text:", "B_ALIGN_CENTER");
	alignment label, text;
	control->GetAlignment(&label, &text);
	EXPECT_EQ(B_ALIGN_LEFT, label);
	EXPECT_EQ(B_ALIGN_CENTER, text);
	Choose("Label:", "B_ALIGN_RIGHT");
	control->GetAlignment(&label, &text);
	EXPECT_EQ(B_ALIGN_RIGHT, label);
	EXPECT_EQ(B_ALIGN_CENTER, text);

	TypeOver("Divider:", "33");
	EXPECT_EQ(33, control->Divider());
	TypeOver("Divider:", "-5");
	EXPECT_EQ(-5, control->Divider());
	ExpectDeclined();
}


TEST_F(EditTextControlTest, ShowsWhatTheControlHas)
{
	BTextControl* control = new BTextControl(kFrame, "t", "Label", "text", NULL);
	control->SetAlignment(B_ALIGN_RIGHT, B_ALIGN_CENTER);
	control->SetDivider(77);
	control->SetModificationMessage(new BMessage('wxyz'));
	Use(control);
	EXPECT_EQ("B_ALIGN_RIGHT", Chosen("Label:"));
	EXPECT_EQ("B_ALIGN_CENTER", Chosen("Text:"));
	EXPECT_EQ("77", Shown("Divider:"));
	EXPECT_EQ("wxyz", Shown("Invocation message:"));
}


TEST_F(EditTextControlTest, EditsTheModificationMessage)
{
	BTextControl* control =
		Use(new BTextControl(kFrame, "t", "Label", "text", new BMessage('invk')));
	EXPECT_EQ("----", Shown("Invocation message:"));
	TypeOver("Invocation message:", "abcd");
	ASSERT_NE(nullptr, control->ModificationMessage());
	EXPECT_EQ(0x61626364u, control->ModificationMessage()->what);
	EXPECT_EQ(uint32('invk'), control->Message()->what);
	TypeOver("Invocation message:", "ab");
	EXPECT_EQ(0x61620000u, control->ModificationMessage()->what);
}


class EditInheritedTest : public PanelFixture<EditInherited> {};


TEST_F(EditInheritedTest, ChangesTheClassNameInTheArchive)
{
	LayoutInheritedView* view =
		Use(new LayoutInheritedView(kFrame, "p", B_FOLLOW_NONE, B_WILL_DRAW));
	EXPECT_STREQ("Properties of YOUR Class", panel->Label());
	EXPECT_EQ("MyBView", Shown("Class name: "));
	TypeOver("Class name: ", "Gadget");
	EXPECT_STREQ("Gadget", view->ClassName());
	BMessage archive;
	view->Archive(&archive);
	const char* name;
	ASSERT_EQ(B_OK, archive.FindString("class", 1, &name));
	EXPECT_STREQ("Gadget", name);

	TypeOver("Class name: ", "");
	EXPECT_STREQ("", view->ClassName());
	BMessage unnamed;
	view->Archive(&unnamed);
	ASSERT_EQ(B_OK, unnamed.FindString("class", 1, &name));
	EXPECT_STREQ("", name);
	ExpectDeclined();
}


TEST_F(EditInheritedTest, TheDrawnNameWaitsForTheNextDrawing)
{
	auto view = Use(new Counting<LayoutInheritedView>(kFrame, "p", B_FOLLOW_NONE, B_WILL_DRAW));
	const int draws = view->draws;
	TypeOver("Class name: ", "Gadget");
	EXPECT_EQ(draws, view->draws);
}


class EditColorControlTest : public PanelFixture<EditColorControl> {};


TEST_F(EditColorControlTest, ShowsAndAppliesTheLayout)
{
	BColorControl* control = Use(new BColorControl(BPoint(5, 5), B_CELLS_16x16, 8, "c"));
	EXPECT_EQ("B_CELLS_16x16", Chosen("Cell layout:"));
	EXPECT_EQ("8", Shown("Cell size:"));
	Choose("Cell layout:", "B_CELLS_64x4");
	EXPECT_EQ(B_CELLS_64x4, control->Layout());

	// Shown as the one before it: that is how it is meant to be.
	Reload(control);
	EXPECT_EQ("B_CELLS_32x8", Chosen("Cell layout:"));
	window.Locked([&] { control->SetLayout(B_CELLS_4x64); });
	Reload(control);
	EXPECT_EQ("B_CELLS_4x64", Chosen("Cell layout:"));
	ExpectDeclined();
}


TEST_F(EditColorControlTest, ShowsAndSetsEveryLayout)
{
	BColorControl* control = Use(new BColorControl(BPoint(5, 5), B_CELLS_32x8, 8, "c"));
	EXPECT_EQ("B_CELLS_32x8", Chosen("Cell layout:"));
	const struct {
		const char* label;
		color_control_layout layout;
	} kLayouts[] = { { "B_CELLS_4x64", B_CELLS_4x64 }, { "B_CELLS_8x32", B_CELLS_8x32 },
		{ "B_CELLS_16x16", B_CELLS_16x16 }, { "B_CELLS_32x8", B_CELLS_32x8 } };
	for (const auto& each : kLayouts) {
		Choose("Cell layout:", each.label);
		EXPECT_EQ(each.layout, control->Layout());
		Reload(control);
		EXPECT_EQ(each.label, Chosen("Cell layout:"));
	}
}


TEST_F(EditColorControlTest, ClampsTheCellSize)
{
	BColorControl* control = Use(new BColorControl(BPoint(5, 5), B_CELLS_32x8, 8, "c"));
	TypeOver("Cell size:", "9");
	EXPECT_EQ(9, control->CellSize());
	TypeOver("Cell size:", "-3");
	EXPECT_EQ("1", Shown("Cell size:"));
}


class EditListViewTest : public PanelFixture<EditListView> {};


TEST_F(EditListViewTest, ChangesTypeAndMessages)
{
	BListView* list = new BListView(kFrame, "l", B_MULTIPLE_SELECTION_LIST);
	list->SetSelectionMessage(new BMessage('abcd'));
	Use(list);
	EXPECT_TRUE(IsTicked("Multiple Selection"));
	EXPECT_EQ("abcd", Shown("Select Message:"));
	EXPECT_EQ("----", Shown("Invoke Message:"));

	Tick("Multiple Selection");
	EXPECT_EQ(B_SINGLE_SELECTION_LIST, list->ListType());
	TypeOver("Invoke Message:", "invk");
	EXPECT_EQ(uint32('invk'), list->InvocationCommand());
	TypeOver("Select Message:", "----");
	EXPECT_EQ(0x2d2d2d2du, list->SelectionCommand());
	ExpectDeclined();
}


TEST_F(EditListViewTest, ShowsWhatTheListHas)
{
	BListView* list = new BListView(kFrame, "l", B_SINGLE_SELECTION_LIST);
	list->SetInvocationMessage(new BMessage('invk'));
	Use(list);
	EXPECT_FALSE(IsTicked("Multiple Selection"));
	EXPECT_EQ("----", Shown("Select Message:"));
	EXPECT_EQ("invk", Shown("Invoke Message:"));
	Tick("Multiple Selection");
	EXPECT_EQ(B_MULTIPLE_SELECTION_LIST, list->ListType());
}


TEST_F(EditListViewTest, ANewCodeDropsTheFieldsOfTheFormerMessage)
{
	BMessage* message = new BMessage('abcd');
	message->AddInt32("dropped", 7);
	BListView* list = new BListView(kFrame, "l");
	list->SetSelectionMessage(message);
	Use(list);
	TypeOver("Select Message:", "efgh");
	ASSERT_NE(nullptr, list->SelectionMessage());
	EXPECT_EQ(uint32('efgh'), list->SelectionMessage()->what);
	EXPECT_TRUE(list->SelectionMessage()->IsEmpty());
}


class EditMenuFieldTest : public PanelFixture<EditMenuField> {};


TEST_F(EditMenuFieldTest, ChangesEverything)
{
	BMenu* menu = new BMenu("menu");
	menu->AddItem(new BMenuItem("item", NULL));
	BMenuField* field = Use(new BMenuField(kFrame, "f", "Sounds:", menu));
	EXPECT_EQ("Sounds:", Shown("Label: "));
	EXPECT_TRUE(IsTicked("Enabled"));
	TypeOver("Label: ", "Colours:");
	EXPECT_STREQ("Colours:", field->Label());
	Choose("", "B_ALIGN_RIGHT");
	EXPECT_EQ(B_ALIGN_RIGHT, field->Alignment());
	TypeOver("Divider:", "-10");
	EXPECT_EQ(-10, field->Divider());
	Tick("Enabled");
	EXPECT_FALSE(field->IsEnabled());
	ExpectDeclined();
}


TEST_F(EditMenuFieldTest, ShowsWhatTheFieldHas)
{
	BMenuField* field = new BMenuField(kFrame, "f", "Sounds:", new BMenu("menu"));
	field->SetAlignment(B_ALIGN_CENTER);
	field->SetDivider(33);
	field->SetEnabled(false);
	Use(field);
	EXPECT_EQ("B_ALIGN_CENTER", Chosen(""));
	EXPECT_EQ("33", Shown("Divider:"));
	EXPECT_FALSE(IsTicked("Enabled"));
}


TEST_F(EditMenuFieldTest, AnEmptyLabelIsPassedOn)
{
	BMenuField* field = Use(new BMenuField(kFrame, "f", "Sounds:", new BMenu("menu")));
	TypeOver("Label: ", "");
	EXPECT_STREQ("", field->Label());
}


TEST_F(EditMenuFieldTest, EveryChangeDrawsTheFieldAnew)
{
	auto field = Use(new Counting<BMenuField>(kFrame, "f", "Sounds:", new BMenu("menu")));
	int draws = field->draws;
	auto expectDrawn = [&](const char* what) {
		EXPECT_GT(field->draws, draws) << what;
		draws = field->draws;
	};
	TypeOver("Label: ", "Colours:");
	expectDrawn("label");
	Choose("", "B_ALIGN_RIGHT");
	expectDrawn("alignment");
	TypeOver("Divider:", "60");
	expectDrawn("divider");
	Tick("Enabled");
	expectDrawn("enabled");
}
