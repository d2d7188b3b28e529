// EditView: font, drawing mode and pen size.

#include <cfloat>
#include <cstdio>
#include <cstring>

#include <Font.h>
#include <Menu.h>
#include <MenuField.h>
#include <MenuItem.h>
#include <Message.h>

#include "archive/ViewTree.h"
#include "editors/EditView.h"
#include "editors/FloatControl.h"
#include "editors/PanelRows.h"

namespace {


constexpr uint32 kPlainFontChosen = 'plnf';
constexpr uint32 kBoldFontChosen = 'bldf';
constexpr uint32 kFixedFontChosen = 'fixf';
constexpr uint32 kFamilyChosen = 'font';
constexpr uint32 kStyleChosen = 'styl';
constexpr uint32 kSizeChanged = 'fsiz';
constexpr uint32 kShearChanged = 'fshr';
constexpr uint32 kRotationChanged = 'frot';
constexpr uint32 kModeChosen = 'mode';
constexpr uint32 kPenSizeChanged = 'psiz';

constexpr float kFieldHeight = 20;
constexpr float kNumberHeight = 16;
constexpr float kNumberWidth = 70;
constexpr float kNumberStep = 80;

// Their places in the font menu.
constexpr int32 kPlainFontIndex = 0;
constexpr int32 kBoldFontIndex = 1;
constexpr int32 kFixedFontIndex = 2;


BMenu*
MakeFontMenu()
{
	BMenu* menu = new BMenu("", B_ITEMS_IN_COLUMN);
	menu->SetLabelFromMarked(true);
	menu->AddItem(new BMenuItem("be_plain_font", new BMessage(kPlainFontChosen)));
	menu->AddItem(new BMenuItem("be_bold_font", new BMessage(kBoldFontChosen)));
	menu->AddItem(new BMenuItem("be_fixed_font", new BMessage(kFixedFontChosen)));
	menu->AddSeparatorItem();

	const int32 count = count_font_families();
	for (int32 i = 0; i < count; i++) {
		font_family family;
		if (get_font_family(i, &family) == B_OK)
			menu->AddItem(new BMenuItem(family, new BMessage(kFamilyChosen)));
	}
	return menu;
}


BMenuItem*
FindLabel(BMenu* menu, const char* label)
{
	for (int32 i = 0; BMenuItem* item = menu->ItemAt(i); i++) {
		if (item->Label() != NULL && strcmp(item->Label(), label) == 0)
			return item;
	}
	return nullptr;
}


} // namespace


void
EditView::_AddFontRows(BRect area)
{
	fFontMenu = MakeFontMenu();
	AddMenuField(this, FrameAt(area.left, area.top, 200, kFieldHeight), "Font:", fFontMenu, 40,
		kFollowLeftTop);
	fStyleMenu = MakeChoiceMenu({}, kStyleChosen);
	AddMenuField(this, BRect(area.left + 220, area.top, area.right, area.top + kFieldHeight),
		"Font style:", fStyleMenu, 60, kFollowLeftTop);

	BRect frame = FrameAt(area.left + 140, area.top + 32, kNumberWidth, kNumberHeight);
	fSizeControl = AddFloatControl(this, frame, "Size: ", kSizeChanged, 0, 0, FLT_MAX, 30);
	frame.OffsetBy(kNumberStep, 0);
	fShearControl = AddFloatControl(this, frame, "Shear: ", kShearChanged, 90, 45, 135, 36);
	frame.OffsetBy(kNumberStep, 0);
	fRotationControl =
		AddFloatControl(this, frame, "Rotation: ", kRotationChanged, 0, -FLT_MAX, FLT_MAX, 46);
}


void
EditView::_AddDrawingRow(BRect area)
{
	// The index of an item is its drawing_mode.
	fModeMenu = MakeChoiceMenu(
		{ "B_OP_COPY", "B_OP_OVER", "B_OP_ERASE", "B_OP_INVERT", "B_OP_ADD", "B_OP_SUBTRACT",
			"B_OP_BLEND", "B_OP_MIN", "B_OP_MAX", "B_OP_SELECT", "B_OP_ALPHA" },
		kModeChosen);
	AddMenuField(this, FrameAt(area.left, area.top, 220, kFieldHeight), "Drawing mode:", fModeMenu,
		76, kFollowLeftTop);
	fPenSizeControl =
		AddFloatControl(this, FrameAt(area.left + 240, area.top + 2, 100, kNumberHeight),
			"Pen size: ", kPenSizeChanged, 0, 0, FLT_MAX, 50);
}


void
EditView::FontChanged()
{
	while (BMenuItem* item = fStyleMenu->RemoveItem((int32)0))
		delete item;

	BFont font;
	target->GetFont(&font);
	_MarkStandardFont(font);

	font_family family;
	font_style style;
	font.GetFamilyAndStyle(&family, &style);
	BMenuItem* familyItem = FindLabel(fFontMenu, family);
	if (familyItem == nullptr) {
		MarkChoice(fFontMenu, kPlainFontIndex);
		return;
	}

	familyItem->SetMarked(true);
	_LoadStyles(family, style);
	fSizeControl->ShowFloatValue(font.Size());
	fShearControl->ShowFloatValue(font.Shear());
	fRotationControl->ShowFloatValue(font.Rotation());
}


void
EditView::_MarkStandardFont(const BFont& font)
{
	if (font == *be_bold_font)
		MarkChoice(fFontMenu, kBoldFontIndex);
	else if (font == *be_fixed_font)
		MarkChoice(fFontMenu, kFixedFontIndex);
	else if (font == *be_plain_font)
		MarkChoice(fFontMenu, kPlainFontIndex);
}


void
EditView::_LoadStyles(const char* family, const char* style)
{
	font_family familyName;
	snprintf(familyName, sizeof(familyName), "%s", family);
	const int32 count = count_font_styles(familyName);
	for (int32 i = 0; i < count; i++) {
		font_style name;
		if (get_font_style(familyName, i, &name) != B_OK)
			continue;
		BMenuItem* item = new BMenuItem(name, new BMessage(kStyleChosen));
		fStyleMenu->AddItem(item);
		if (strcmp(name, style) == 0)
			item->SetMarked(true);
	}
	::SetTarget(fStyleMenu, this, nullptr);
}


void
EditView::_LoadFontAndDrawing()
{
	FontChanged();

	BFont font;
	target->GetFont(&font);
	fSizeControl->SetFloatValue(font.Size());
	fShearControl->SetFloatValue(font.Shear());
	fRotationControl->SetFloatValue(font.Rotation());

	MarkChoice(fModeMenu, target->DrawingMode());
	fPenSizeControl->SetFloatValue(target->PenSize());
}


bool
EditView::_ApplyFontEdit(BMessage* message)
{
	switch (message->what) {
		case kPlainFontChosen:
			_ApplyFont(be_plain_font);
			break;
		case kBoldFontChosen:
			_ApplyFont(be_bold_font);
			break;
		case kFixedFontChosen:
			_ApplyFont(be_fixed_font);
			break;
		case kFamilyChosen:
		case kStyleChosen:
			_ApplyFamilyAndStyle();
			break;
		case kSizeChanged:
			target->SetFontSize(fSizeControl->FloatValue());
			break;
		case kShearChanged:
			_ApplyShear();
			break;
		case kRotationChanged:
			_ApplyRotation();
			break;
		case kModeChosen:
			target->SetDrawingMode(static_cast<drawing_mode>(Choice(fModeMenu)));
			break;
		case kPenSizeChanged:
			target->SetPenSize(fPenSizeControl->FloatValue());
			break;
		default:
			return false;
	}
	target->Invalidate();
	return true;
}


void
EditView::_ApplyFont(const BFont* font)
{
	target->SetFont(font, B_FONT_ALL);
	FontChanged();
}


void
EditView::_ApplyFamilyAndStyle()
{
	const BMenuItem* family = fFontMenu->FindMarked();
	if (family == nullptr)
		return;

	BFont font;
	target->GetFont(&font);
	font_family familyName;
	snprintf(familyName, sizeof(familyName), "%s", family->Label());
	font.SetFamilyAndStyle(familyName, NULL);
	if (const BMenuItem* style = fStyleMenu->FindMarked()) {
		font_style styleName;
		snprintf(styleName, sizeof(styleName), "%s", style->Label());
		font.SetFamilyAndStyle(familyName, styleName);
	}
	_ApplyFont(&font);
}


void
EditView::_ApplyShear()
{
	BFont font;
	target->GetFont(&font);
	font.SetShear(fShearControl->FloatValue());
	target->SetFont(&font, B_FONT_ALL);
}


void
EditView::_ApplyRotation()
{
	BFont font;
	target->GetFont(&font);
	font.SetRotation(fRotationControl->FloatValue());
	target->SetFont(&font, B_FONT_ALL);
}
