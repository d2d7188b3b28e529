// BMenuItem: how it is measured and drawn.
#include "MenuItem.h"

#include <cctype>
#include <cmath>
#include <cstring>

#include <String.h>

#include "interface/private/Look.h"

using namespace BPrivate;


namespace {

constexpr float kShortcutGap = 20; // between label and shortcut
constexpr float kMarkSize = 11;

} // namespace


void
BMenuItem::GetContentSize(float* _width, float* _height)
{
	font_height height;
	fSuper->GetFontHeight(&height);
	if (_width != NULL)
		*_width = std::ceil(_LabelWidth());
	if (_height != NULL)
		*_height = std::ceil(height.ascent + height.descent + height.leading);
}


void
BMenuItem::TruncateLabel(float maxWidth, char* newLabel)
{
	BString label(fLabel);
	BFont font;
	fSuper->GetFont(&font);
	font.TruncateString(&label, B_TRUNCATE_SMART, maxWidth);
	strcpy(newLabel, label.String());
}


void
BMenuItem::DrawContent()
{
	if (fLabel == NULL)
		return;
	font_height height;
	fSuper->GetFontHeight(&height);
	BPoint baseline = fSuper->PenLocation();
	const float room = fContentHeight - std::ceil(height.ascent + height.descent + height.leading);
	baseline.y += std::floor(room / 2) + std::ceil(height.ascent);

	const float limit = fSuper->MaxContentWidth();
	if (limit > 0 && _LabelWidth() > limit) {
		std::string label(strlen(fLabel) + 4, '\0');
		TruncateLabel(limit, label.data());
		fSuper->DrawString(label.c_str(), baseline);
		return;
	}
	fSuper->DrawString(fLabel, baseline);
	_DrawTrigger(baseline);
}


void
BMenuItem::Draw()
{
	const uint32 state = _LookState();
	const bool lit = fSelected && (IsEnabled() || fSubmenu != NULL);
	fSuper->PushState();
	if (lit)
		Look::DrawMenuItemBackground(fSuper, fBounds, fSuper->LowColor(), state | Look::kPressed);
	fSuper->SetDrawingMode(B_OP_OVER);
	fSuper->SetHighColor(Look::TextColor(state & Look::kDisabled));
	fSuper->MovePenTo(ContentLocation());
	DrawContent();

	if (fSuper->Layout() == B_ITEMS_IN_COLUMN) {
		const float middle = std::floor((fBounds.top + fBounds.bottom) / 2);
		const BRect mark(fBounds.left + 1, middle - kMarkSize / 2, fBounds.left + kMarkSize,
			middle + kMarkSize / 2);
		if (fMarked)
			Look::DrawMenuCheckMark(fSuper, mark, state);
		if (fSubmenu != NULL) {
			BRect arrow = mark;
			arrow.OffsetTo(fBounds.right - kMarkSize - 2, mark.top);
			Look::DrawSubmenuMark(fSuper, arrow, state);
		}
		if (const std::string text = _ShortcutText(); !text.empty()) {
			font_height height;
			fSuper->GetFontHeight(&height);
			const BPoint baseline(fBounds.right - fSuper->fMarginRight / 2
					- std::ceil(fSuper->StringWidth(text.c_str())),
				fBounds.top + fSuper->fMarginTop + std::ceil(height.ascent));
			fSuper->SetHighColor(Look::TextColor(state & Look::kDisabled));
			fSuper->DrawString(text.c_str(), baseline);
		}
	}
	fSuper->PopState();
}


void
BMenuItem::Highlight(bool)
{
	fSuper->Invalidate(fBounds);
}


bool
BMenuItem::IsSelected() const
{
	return fSelected;
}


BPoint
BMenuItem::ContentLocation() const
{
	return BPoint(fBounds.left + fSuper->fMarginLeft, fBounds.top + fSuper->fMarginTop);
}


// The caller holds the lock of the window that shows the menu.
void
BMenuItem::_Select(bool selected)
{
	if (fSelected == selected)
		return;
	fSelected = selected;
	if (fSuper != NULL && fSuper->Window() != NULL)
		Highlight(selected);
}


uint32
BMenuItem::_LookState() const
{
	uint32 state = IsEnabled() ? Look::kNormal : Look::kDisabled;
	if (fSelected)
		state |= Look::kFocused;
	if (fMarked)
		state |= Look::kOn;
	return state;
}


float
BMenuItem::_LabelWidth()
{
	if (fLabelWidth < 0)
		fLabelWidth = fLabel != NULL ? fSuper->StringWidth(fLabel) : 0;
	return fLabelWidth;
}


// With the gap before it; 0 without a shortcut.
float
BMenuItem::_ShortcutWidth() const
{
	const std::string text = _ShortcutText();
	return text.empty() ? 0 : kShortcutGap + std::ceil(fSuper->StringWidth(text.c_str()));
}


// The names of the keys as a user of this desktop knows them: its Ctrl key is the command key.
std::string
BMenuItem::_ShortcutText() const
{
	if (fShortcut == 0)
		return std::string();
	std::string text;
	if (fModifiers & (B_COMMAND_KEY | B_CONTROL_KEY))
		text += "Ctrl+";
	if (fModifiers & B_OPTION_KEY)
		text += "Alt+";
	if (fModifiers & B_SHIFT_KEY)
		text += "Shift+";
	switch (fShortcut) {
		case B_ENTER:
			return text + "Enter";
		case B_BACKSPACE:
			return text + "Backspace";
		case B_DELETE:
			return text + "Del";
		case B_SPACE:
			return text + "Space";
		case B_TAB:
			return text + "Tab";
		case B_ESCAPE:
			return text + "Esc";
		case B_INSERT:
			return text + "Ins";
		case B_HOME:
			return text + "Home";
		case B_END:
			return text + "End";
		case B_PAGE_UP:
			return text + "PgUp";
		case B_PAGE_DOWN:
			return text + "PgDn";
		case B_LEFT_ARROW:
			return text + "Left";
		case B_RIGHT_ARROW:
			return text + "Right";
		case B_UP_ARROW:
			return text + "Up";
		case B_DOWN_ARROW:
			return text + "Down";
		default:
			return text + static_cast<char>(toupper(static_cast<uchar>(fShortcut)));
	}
}


// Where the trigger stands in the label, or -1.
int32
BMenuItem::_TriggerOffset() const
{
	if (fTrigger == 0 || fLabel == NULL)
		return -1;
	if (const char* exact = strchr(fLabel, fTrigger))
		return static_cast<int32>(exact - fLabel);
	for (int32 i = 0; fLabel[i] != '\0'; i++) {
		if (tolower(static_cast<uchar>(fLabel[i])) == tolower(static_cast<uchar>(fTrigger)))
			return i;
	}
	return -1;
}


void
BMenuItem::_DrawTrigger(BPoint baseline) const
{
	const int32 offset = _TriggerOffset();
	if (offset < 0 || !fSuper->fShowTriggers || !IsEnabled())
		return;
	const float left = baseline.x + fSuper->StringWidth(fLabel, offset);
	const float width = fSuper->StringWidth(fLabel + offset, 1);
	fSuper->StrokeLine(BPoint(std::floor(left), baseline.y + 2),
		BPoint(std::floor(left + width) - 1, baseline.y + 2));
}
