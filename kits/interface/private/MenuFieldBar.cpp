#include "interface/private/MenuFieldBar.h"

#include <algorithm>
#include <cmath>

#include <MenuField.h>
#include <Message.h>
#include <String.h>
#include <Window.h>

#include "interface/private/Look.h"
#include "interface/private/ViewArchive.h"

using namespace BPrivate;

namespace {

constexpr float kMarginTop = 2;
constexpr float kMarginBottom = 2;

} // namespace


_BMCMenuBar_::_BMCMenuBar_(BRect frame, bool fixedSize) :
	BMenuBar(frame, "_mc_mb_", B_FOLLOW_LEFT | B_FOLLOW_TOP, B_ITEMS_IN_ROW, !fixedSize)
{
	SetBorder(B_BORDER_CONTENTS);
	_TakeMargins();
}


_BMCMenuBar_::_BMCMenuBar_(BMessage* archive) : BMenuBar(archive)
{
	_TakeMargins();
}


_BMCMenuBar_::~_BMCMenuBar_() = default;


BArchivable*
_BMCMenuBar_::Instantiate(BMessage* archive)
{
	return validate_instantiation(archive, "_BMCMenuBar_") ? new _BMCMenuBar_(archive) : NULL;
}


BMenuField*
_BMCMenuBar_::Field() const
{
	return dynamic_cast<BMenuField*>(Parent());
}


void
_BMCMenuBar_::_TakeMargins()
{
	const float margin = std::ceil(be_plain_font->Size() / 2);
	SetItemMargins(margin, kMarginTop, margin + Look::kPopUpMarkWidth, kMarginBottom);
}


// It never becomes the key menu bar.
void
_BMCMenuBar_::AttachedToWindow()
{
	BMenu::AttachedToWindow();
	_StretchItem();
}


void
_BMCMenuBar_::FrameResized(float width, float height)
{
	BMenuBar::FrameResized(width, height);
	_StretchItem();
}


void
_BMCMenuBar_::Draw(BRect)
{
	BMenuField* field = Field();
	const bool enabled = IsEnabled() && (field == NULL || field->IsEnabled());
	uint32 state = enabled ? Look::kNormal : Look::kDisabled;
	if (field != NULL && field->IsFocus() && Window()->IsActive())
		state |= Look::kFocused;
	const rgb_color base = field != NULL ? Look::BaseColor(field) : LowColor();
	const bool marker = field == NULL || field->fPopUpMarker;
	Look::DrawMenuField(this, Bounds(), base, marker, state);

	const BMenuItem* item = ItemAt(0);
	if (item == NULL || item->Label() == NULL)
		return;
	BFont font;
	GetFont(&font);
	font_height height;
	font.GetHeight(&height);
	float left;
	GetItemMargins(&left, NULL, NULL, NULL);
	// A long label comes as close as a pixel to the arrow, which does not fill its place.
	BString label(item->Label());
	font.TruncateString(
		&label, B_TRUNCATE_END, Bounds().Width() - left - Look::kPopUpMarkWidth + 1);
	const float text = std::ceil(height.ascent) + std::ceil(height.descent);
	const float baseline =
		std::floor((Bounds().Height() + 1 - text) / 2) + std::ceil(height.ascent);
	PushState();
	SetDrawingMode(B_OP_OVER);
	SetHighColor(Look::TextColor(state));
	DrawString(label.String(), BPoint(left, baseline));
	PopState();
}


void
_BMCMenuBar_::MouseDown(BPoint where)
{
	if (BMenuField* field = Field())
		field->_OpenMenu(false);
	else
		BMenuBar::MouseDown(where);
}


void
_BMCMenuBar_::GetPreferredSize(float* _width, float* _height)
{
	BMenu::GetPreferredSize(_width, _height);
}


// The keyboard's focus is the field's.
void
_BMCMenuBar_::MakeFocus(bool)
{
}


void
_BMCMenuBar_::_LayoutChanged()
{
	BMenuField* field = Field();
	if (field != NULL && !is_revived(this))
		field->_FitBar();
	_StretchItem();
}


void
_BMCMenuBar_::_StretchItem()
{
	_ValidateLayout();
	if (BMenuItem* item = ItemAt(0))
		item->fBounds = Bounds();
}


// #pragma mark - _BMCItem_


_BMCItem_::_BMCItem_(BMessage* archive) : BMenuItem(archive)
{
}


BArchivable*
_BMCItem_::Instantiate(BMessage* archive)
{
	return validate_instantiation(archive, "_BMCItem_") ? new _BMCItem_(archive) : NULL;
}
