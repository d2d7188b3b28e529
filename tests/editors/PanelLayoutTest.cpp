// Every panel's controls as text: kind, label, code, left, top and right edge, resizing mode and
// divider. Heights are the controls' own.

#include <string>

#include <gtest/gtest.h>

#include <ColorControl.h>
#include <MenuField.h>
#include <MenuItem.h>
#include <Message.h>
#include <OutlineListView.h>
#include <RadioButton.h>
#include <ScrollView.h>
#include <StringView.h>
#include <TextControl.h>

#include "addon/PanelTable.h"
#include "editors/EditView.h"
#include "support/TestWindow.h"

namespace {


std::string
Code(const BMessage* message)
{
	if (message == nullptr)
		return "-";
	const uint32 what = message->what;
	return { static_cast<char>(what >> 24), static_cast<char>(what >> 16),
		static_cast<char>(what >> 8), static_cast<char>(what) };
}


std::string
Quoted(const char* text)
{
	return std::string("\"") + (text != nullptr ? text : "") + "\"";
}


std::string
Number(float number)
{
	return std::to_string(static_cast<int>(number));
}


std::string
Place(const BView* view)
{
	const BRect frame = view->Frame();
	char mode[16];
	snprintf(mode, sizeof(mode), "%04x", view->ResizingMode());
	return " " + Number(frame.left) + "," + Number(frame.top) + "," + Number(frame.right) + " "
		+ mode;
}


std::string
Items(BMenu* menu)
{
	std::string text;
	for (int32 i = 0; BMenuItem* item = menu->ItemAt(i); i++) {
		// The installed fonts follow the separator.
		if (dynamic_cast<BSeparatorItem*>(item) != nullptr)
			break;
		text += std::string(i == 0 ? ": " : ", ") + item->Label();
	}
	return text;
}


std::string
Row(BView* view)
{
	if (auto field = dynamic_cast<BTextControl*>(view)) {
		return "field " + Quoted(field->Label()) + " " + Code(field->Message()) + Place(view) + " "
			+ Number(field->Divider());
	}
	if (auto colors = dynamic_cast<BColorControl*>(view))
		return "colors " + Code(colors->Message()) + Place(view);
	if (auto menu = dynamic_cast<BMenuField*>(view)) {
		const BMenuItem* first = menu->Menu()->ItemAt(0);
		return "menu " + Quoted(menu->Label()) + " "
			+ Code(first != nullptr ? first->Message() : nullptr) + Place(view) + " "
			+ Number(menu->Divider()) + Items(menu->Menu());
	}
	if (auto control = dynamic_cast<BControl*>(view))
		return "control " + Quoted(control->Label()) + " " + Code(control->Message()) + Place(view);
	if (auto text = dynamic_cast<BStringView*>(view))
		return "text " + Quoted(text->Text()) + Place(view);
	if (auto box = dynamic_cast<BBox*>(view))
		return "box " + Quoted(box->Label()) + Place(view);
	if (auto list = dynamic_cast<BOutlineListView*>(view))
		return "list " + Code(list->SelectionMessage()) + Place(view);
	return dynamic_cast<BScrollView*>(view) != nullptr ? "scroll" + Place(view) : "";
}


void
AddRows(BView* view, const std::string& indent, std::string& text)
{
	for (BView* child = view->ChildAt(0); child != nullptr; child = child->NextSibling()) {
		const std::string row = Row(child);
		if (row.empty())
			continue;
		text += indent + row + "\n";
		if (dynamic_cast<BBox*>(child) != nullptr || dynamic_cast<BScrollView*>(child) != nullptr)
			AddRows(child, indent + "\t", text);
	}
}


// The first line of a panel is its name, label and bottom edge, and how it follows its parent.
constexpr const char* kPanels[] = {
	// EditView
	"EditView Properties from BView 330 0,0,400 1214\n"
	"field \"Name: \" name 6,16,394 1234 80\n"
	"text \"Frame:\" 6,44,36 1212\n"
	"field \"L:\" rect 46,44,94 1212 10\n"
	"field \"T:\" rect 96,44,144 1212 10\n"
	"field \"R:\" rect 146,44,194 1212 10\n"
	"field \"B:\" rect 196,44,244 1212 10\n"
	"control \"preferred\" pref 250,41,298 1212\n"
	"control \"zoom\" zoom 327,41,375 1214\n"
	"menu \"Resizing:\" xxxx 6,72,156 1212 50: Left, Right, Left & Right, H. Center\n"
	"menu \"Resizing:\" yyyy 244,72,394 0404 50: Top, Bottom, Top & Bottom, V. Center\n"
	"menu \"Flags:\" flag 6,100,394 0202 50: B_FULL_UPDATE_ON_RESIZE, _B_RESERVED1_, "
	"B_WILL_DRAW, B_PULSE_NEEDED, B_NAVIGABLE_JUMP, B_FRAME_EVENTS, B_NAVIGABLE, "
	"B_SUBPIXEL_PRECISE, B_DRAW_ON_CHILDREN, B_INPUT_METHOD_AWARE, _B_RESERVED7_\n"
	"menu \"Font:\" plnf 6,128,206 1212 40: be_plain_font, be_bold_font, be_fixed_font\n"
	"menu \"Font style:\" - 226,128,394 1212 60\n"
	"field \"Size: \" fsiz 146,160,216 1212 30\n"
	"field \"Shear: \" fshr 226,160,296 1212 36\n"
	"field \"Rotation: \" frot 306,160,376 1212 46\n"
	"menu \"Drawing mode:\" mode 6,192,226 1212 76: B_OP_COPY, B_OP_OVER, B_OP_ERASE, "
	"B_OP_INVERT, B_OP_ADD, B_OP_SUBTRACT, B_OP_BLEND, B_OP_MIN, B_OP_MAX, B_OP_SELECT, "
	"B_OP_ALPHA\n"
	"field \"Pen size: \" psiz 246,194,346 1212 50\n"
	"box \"View (background), High, and Low Color\" 6,224,394 1234\n"
	"\tcolors colr 6,10,279 1212\n"
	"\tbox \"\" 285,10,322 0204\n"
	"\tbox \"\" 285,39,322 0204\n"
	"\tbox \"\" 285,68,322 0204\n"
	"\tcontrol \"216 Gray\" dflt 6,59,90 1212\n"
	"\tcontrol \"Use Parent\" prnt 96,59,180 1212\n"
	"\tcontrol \"Set Children\" chld 186,59,270 1212\n"
	"\tcontrol \"View\" view 328,10,382 0404\n"
	"\tcontrol \"High\" high 328,39,382 0404\n"
	"\tcontrol \"Low\" low  328,68,382 0404\n",
	// EditControl
	"EditControl Properties from BControl 70 0,0,400 1214\n"
	"field \"Label: \" labl 6,16,394 0204 60\n"
	"control \"Enabled\" enbl 6,44,106 1212\n"
	"field \"Message: \" mssg 126,44,226 1212 50\n"
	"field \"Value: \" valu 246,44,346 1212 50\n",
	// EditButton
	"EditButton Properties from BButton 42 0,0,400 1214\n"
	"control \"Default\" dflt 6,16,106 1212\n",
	// EditStringView
	"EditStringView Properties from BStringView 42 0,0,400 1214\n"
	"field \"Text: \" text 6,16,274 1234 40\n"
	"menu \"\" algn 284,14,394 0404 0: B_ALIGN_LEFT, B_ALIGN_RIGHT, B_ALIGN_CENTER\n",
	// EditBox
	"EditBox Properties from BBox 42 0,0,400 1214\n"
	"field \"Label: \" labl 6,16,274 1234 40\n"
	"menu \"\" brdr 284,14,394 0404 0: B_PLAIN_BORDER, B_FANCY_BORDER, B_NO_BORDER\n",
	// EditCheckBox
	"EditCheckBox Properties from BCheckBox 38 0,0,400 1214\n"
	"text \"The BCheckBox adds no extra settings.\" 6,16,394 1212\n",
	// EditRadioButton
	"EditRadioButton Properties from BRadioButton 38 0,0,400 1214\n"
	"text \"The BRadioButton adds no extra settings.\" 6,16,394 1212\n",
	// EditStatusBar
	"EditStatusBar Properties from BStatusBar 177 0,0,400 1214\n"
	"field \"Label:\" labl 6,16,136 0202 40\n"
	"field \"Trailing label:\" tlab 214,16,394 0404 90\n"
	"field \"Text:\" text 6,44,136 0202 40\n"
	"field \"Trailing text: \" ttxt 214,44,394 0404 90\n"
	"field \"Value:\" valu 6,72,116 0202 40\n"
	"field \"Max:\" max  145,72,255 0505 30\n"
	"field \"Bar height:\" barh 284,72,394 0404 50\n"
	"box \"Bar Color\" 6,100,394 1234\n"
	"\tcolors colr 12,12,285 1212\n"
	"\tbox \"\" 292,12,384 0204\n"
	"\tcontrol \"Use Default\" dflt 292,42,384 0204\n",
	// EditTextControl
	"EditTextControl Properties from BTextControl 70 0,0,400 1214\n"
	"menu \"Label:\" laln 6,16,186 0202 40: B_ALIGN_LEFT, B_ALIGN_RIGHT, B_ALIGN_CENTER\n"
	"menu \"Text:\" taln 214,16,394 0404 40: B_ALIGN_LEFT, B_ALIGN_RIGHT, B_ALIGN_CENTER\n"
	"field \"Divider:\" dvdr 6,44,106 1212 40\n"
	"field \"Invocation message:\" mssg 244,44,394 1414 110\n",
	// EditTextView
	"EditTextView Properties from BTextView 154 0,0,400 1214\n"
	"menu \"Offscreen:\" csps 6,16,186 0202 60: B_NO_COLOR_SPACE, B_RGB32, B_RGB24, "
	"B_RGB16, B_RGB15, B_RGBA15, B_CMAP8, B_GRAY8, B_GRAY1, B_RGB32_BIG, B_RGBA32_BIG, "
	"B_RGB24_BIG, B_RGB16_BIG, B_RGB15_BIG, B_RGBA15_BIG\n"
	"menu \"Text:\" taln 214,16,394 0404 40: B_ALIGN_LEFT, B_ALIGN_RIGHT, B_ALIGN_CENTER\n"
	"control \"Editable\" edit 6,44,76 1212\n"
	"control \"Auto Indent\" idnt 91,44,171 1212\n"
	"control \"Selectable\" slct 186,44,256 1212\n"
	"field \"Max bytes:\" maxb 271,44,394 1214 56\n"
	"control \"Stylable\" styl 6,68,76 1212\n"
	"control \"Word Wrap\" wrap 91,68,171 1212\n"
	"control \"Resizable\" rsiz 186,68,256 1212\n"
	"field \"Tab width:\" tabw 271,68,394 1214 56\n"
	"box \"\" 36,94,364 1214\n"
	"text \"Hint: Changing \"High Color\" makes special call to "
	"BTextView::SetFontAndColor().\" 7,102,394 1214\n"
	"text \"Hint: Left-click the view and type text into it.\" 7,117,394 1214\n"
	"text \"Hint: Mark \"stylable\" and paste from Be's StyleEdit application.\" "
	"7,132,394 1214\n",
	// EditSlider
	"EditSlider Properties from BSlider 232 0,0,400 1214\n"
	"field \"Snooze:\" snoz 6,16,394 0204 60\n"
	"field \"Min Label:\" minl 6,44,240 0204 60\n"
	"field \"Min Value:\" minv 274,44,394 0404 60\n"
	"field \"Max Label:\" maxl 6,72,240 0204 60\n"
	"field \"Max Value:\" maxv 274,72,394 0404 60\n"
	"menu \"Hash marks:\" hash 6,100,241 0404 61: none, top, bottom, top & bottom\n"
	"menu \"Thumb:\" styl 274,100,395 0404 61: block, triangle\n"
	"field \"Key Increment:\" kinc 6,128,146 0202 80\n"
	"field \"Num Hash Marks:\" mark 244,128,394 0404 90\n"
	"box \"Bar Color\" 6,156,394 1234\n"
	"\tcolors colr 4,12,277 1212\n"
	"\tbox \"\" 284,12,384 0204\n"
	"\tcontrol \"Use Default\" dflt 284,42,384 0204\n",
	// EditScrollView
	"EditScrollView Properties from BScrollView 98 0,0,400 1214\n"
	"menu \"Border style:\" brdr 6,16,394 0204 80: B_PLAIN_BORDER, B_FANCY_BORDER, "
	"B_NO_BORDER\n"
	"control \"Horizontal\" huse 6,44,66 1212\n"
	"field \"Total width:\" htot 86,44,186 1212 60\n"
	"field \"Small step:\" hsml 206,44,291 0404 55\n"
	"field \"Big step:\" hbig 311,44,394 0404 53\n"
	"control \"Vertical\" vuse 6,72,66 1212\n"
	"field \"Total height:\" vtot 86,72,186 1212 60\n"
	"field \"Small step:\" vsml 206,72,291 0404 55\n"
	"field \"Big step:\" vbig 311,72,394 0404 53\n",
	// EditColorControl
	"EditColorControl Properties from BColorControl 48 0,0,400 1214\n"
	"menu \"Cell layout:\" cell 6,16,186 0202 70: B_CELLS_4x64, B_CELLS_8x32, "
	"B_CELLS_16x16, B_CELLS_32x8, B_CELLS_64x4\n"
	"field \"Cell size:\" size 294,16,394 1414 70\n",
	// EditTabView
	"EditTabView Properties from BTabView 74 0,0,400 1214\n"
	"field \"Tab height:\" hght 6,16,106 1214 55\n"
	"menu \"Tab widgh:\" wdth 194,14,394 1414 60: B_WIDTH_AS_USUAL, B_WIDTH_FROM_WIDEST, "
	"B_WIDTH_FROM_LABEL\n"
	"text \"Selected tab:\" 6,44,75 1212\n"
	"control \"forward\" forw 86,44,155 1212\n"
	"control \"backward\" bacw 166,44,235 1212\n"
	"control \"delete\" delt 246,44,315 1212\n"
	"control \"insert\" inst 326,44,395 1212\n",
	// EditListView
	"EditListView Properties from BListView 70 0,0,400 1214\n"
	"control \"Multiple Selection\" msel 6,16,126 1212\n"
	"field \"Select Message:\" mssg 136,16,256 1212 82\n"
	"field \"Invoke Message:\" imsg 276,16,396 1212 82\n",
	// EditOutlineListView
	"EditOutlineListView Properties from BOutlineListView 38 0,0,400 1214\n"
	"text \"The BOutlineListView adds no extra settings.\" 6,16,394 1212\n",
	// EditMenuField
	"EditMenuField Properties from BMenuField 70 0,0,400 1214\n"
	"field \"Label: \" labl 6,16,274 1234 40\n"
	"menu \"\" algn 284,14,394 0404 0: B_ALIGN_LEFT, B_ALIGN_RIGHT, B_ALIGN_CENTER\n"
	"field \"Divider:\" dvdr 6,44,106 1212 40\n"
	"control \"Enabled\" enbl 136,44,236 1212\n",
	// EditMenuBar
	"EditMenuBar Properties from BMenuBar 300 0,0,400 1214\n"
	"menu \"\" brdr 254,14,394 0404 0: B_BORDER_FRAME, B_BORDER_CONTENTS, "
	"B_BORDER_EACH_ITEM\n"
	"box \"\" 30,44,370 1214\n"
	"scroll 8,54,392 1234\n"
	"\tlist list 2,2,368 1234\n"
	"field \"Label: \" labl 6,182,394 0204 40\n"
	"control \"Enabled\" enbl 6,210,76 1212\n"
	"field \"Message: \" mssg 116,210,196 1212 50\n"
	"menu \"\" mode 246,210,392 0404 0: Normal Selection, Radio Selection, Radio & Set "
	"Label\n"
	"control \"Add Before\" befr 6,238,76 1212\n"
	"control \"Add After\" aftr 96,238,166 1212\n"
	"control \"Delete\" dlte 186,238,256 1212\n"
	"control \"Add Submenu\" asub 276,238,346 1212\n",
	// EditInherited
	"EditInherited Properties of YOUR Class 42 0,0,400 1214\n"
	"field \"Class name: \" name 6,16,394 1234 80\n",
};


std::string
Layout(BView* panel)
{
	std::string text = std::string(panel->Name()) + " "
		+ dynamic_cast<EditorInterface*>(panel)->Label() + " " + Number(panel->Frame().bottom)
		+ Place(panel) + "\n";
	AddRows(panel, "", text);
	return text;
}


} // namespace


TEST(PanelLayout, EveryPanelHasItsControlsInPlace)
{
	TestWindow window;
	EditorInterface* panels[std::size(kPanels) + 1] = { new EditView };
	ASSERT_EQ(std::size(kPanels) - 1, MakePanels(panels + 1, std::size(kPanels)));
	for (size_t i = 0; i < std::size(kPanels); i++) {
		window.Add(panels[i]);
		EXPECT_EQ(kPanels[i], Layout(panels[i]));
	}
}
