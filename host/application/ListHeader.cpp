#include "host/application/ListHeader.h"

#include <InterfaceDefs.h>

#include "host/application/ItemRow.h"

namespace {


constexpr rgb_color kPanelColor = { 216, 216, 216, 255 };
constexpr rgb_color kShadeColor = { 152, 152, 152, 255 };
constexpr rgb_color kTextColor = { 0, 0, 0, 255 };
constexpr float kBorder = 2; // of the list's scroll view
constexpr float kBaselineInset = 5;


} // namespace


ListHeader::ListHeader(BRect frame) :
	BView(
		frame, "header", B_FOLLOW_LEFT_RIGHT | B_FOLLOW_TOP, B_WILL_DRAW | B_FULL_UPDATE_ON_RESIZE)
{
	SetViewColor(kPanelColor);
	SetLowColor(kPanelColor);
}


void
ListHeader::Draw(BRect updateRect)
{
	const BRect bounds = Bounds();
	SetHighColor(kShadeColor);
	StrokeLine(bounds.LeftBottom(), bounds.RightBottom());

	SetHighColor(kTextColor);
	const float baseline = bounds.bottom - kBaselineInset;
	const ItemRow::Columns& columns = ItemRow::kColumns;
	DrawString("Type", BPoint(columns.type + kBorder, baseline));
	DrawString("ID", BPoint(columns.id + kBorder, baseline));
	DrawString("Name", BPoint(columns.name + kBorder, baseline));
	DrawString("Bytes", BPoint(columns.size + kBorder, baseline));
	DrawString("Content", BPoint(columns.preview + kBorder, baseline));
}
