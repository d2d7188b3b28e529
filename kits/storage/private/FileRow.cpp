#include "storage/private/FileRow.h"

#include <time.h>

#include <algorithm>
#include <cmath>
#include <cstdio>

#include <Font.h>
#include <ScrollBar.h>
#include <String.h>

#include "interface/private/Look.h"

namespace BPrivate {

namespace {


constexpr float kPadding = 4; // above and below the text, together
constexpr float kIconSize = 12;
constexpr float kInset = 4;
constexpr float kTextLeft = kInset + kIconSize + 6;
constexpr float kDateWidth = 112; // at the right
constexpr float kSizeWidth = 70; // left of that
constexpr float kColumnGap = 8;
constexpr float kListBorder = 2; // of the list's scroll view
constexpr float kHeaderBaseline = 5; // from the bottom

constexpr rgb_color kFolderColor = { 255, 203, 0, 255 };
constexpr rgb_color kFolderShade = { 184, 140, 0, 255 };
constexpr rgb_color kPaperColor = { 255, 255, 255, 255 };
constexpr rgb_color kPaperShade = { 96, 96, 96, 255 };
constexpr rgb_color kLinkColor = { 0, 0, 229, 255 };


std::string
SizeText(off_t bytes)
{
	const char* const kUnits[] = { "bytes", "KB", "MB", "GB", "TB", "PB", "EB" };
	double amount = static_cast<double>(bytes);
	size_t unit = 0;
	while (amount >= 1024 && unit + 1 < std::size(kUnits)) {
		amount /= 1024;
		unit++;
	}
	char text[32];
	snprintf(text, sizeof(text), unit == 0 ? "%.0f %s" : "%.1f %s", amount, kUnits[unit]);
	return text;
}


std::string
DateText(time_t when)
{
	struct tm fields;
	char text[32];
	if (localtime_r(&when, &fields) == nullptr
		|| strftime(text, sizeof(text), "%Y-%m-%d %H:%M", &fields) == 0)
		return "";
	return text;
}


} // namespace


FileRow::FileRow(const FolderItem& item) :
	BStringItem(item.name.c_str()), fItem(item), fSize(item.isFolder ? "" : SizeText(item.size)),
	fDate(DateText(item.modified))
{
}


void
FileRow::DrawItem(BView* owner, BRect frame, bool complete)
{
	owner->PushState();
	const rgb_color background = Look::BaseColor(owner);
	const rgb_color ground = IsSelected() ? Look::ListSelectionColor(background) : background;
	owner->SetLowColor(ground);
	owner->SetHighColor(ground);
	owner->FillRect(frame);
	_DrawIcon(owner, BPoint(frame.left + kInset, frame.top + std::floor((frame.Height() - 9) / 2)));

	const float baseline = frame.top + BaselineOffset();
	const float dateLeft = frame.right - kDateWidth;
	const float nameRight = dateLeft - kSizeWidth - kColumnGap;
	owner->SetHighColor(Look::TextColor());
	BString name(fItem.name.c_str());
	owner->TruncateString(&name, B_TRUNCATE_MIDDLE, nameRight - frame.left - kTextLeft);
	owner->DrawString(name.String(), BPoint(frame.left + kTextLeft, baseline));
	const float sizeLeft = dateLeft - kColumnGap - owner->StringWidth(fSize.c_str());
	owner->DrawString(fSize.c_str(), BPoint(std::floor(sizeLeft), baseline));
	owner->DrawString(fDate.c_str(), BPoint(dateLeft + kColumnGap, baseline));
	owner->PopState();
}


// As wide as the list: the columns stand at its right.
void
FileRow::Update(BView* owner, const BFont* font)
{
	BStringItem::Update(owner, font);
	SetWidth(owner->Bounds().Width());
	SetHeight(std::max(Height(), kIconSize + kPadding));
}


void
FileRow::_DrawIcon(BView* owner, BPoint leftTop) const
{
	BRect body(leftTop.x, leftTop.y, leftTop.x + kIconSize - 1, leftTop.y + 9);
	if (fItem.isFolder) {
		const BRect tab(body.left, body.top - 2, body.left + 5, body.top);
		owner->SetHighColor(kFolderColor);
		owner->FillRect(tab);
		owner->FillRect(body);
		owner->SetHighColor(kFolderShade);
		owner->StrokeRect(tab);
		owner->StrokeRect(body);
		owner->SetHighColor(kFolderColor);
		owner->StrokeLine(BPoint(tab.left + 1, body.top), BPoint(tab.right - 1, body.top));
	} else {
		body.left += 1;
		body.right -= 2;
		body.top -= 2;
		owner->SetHighColor(kPaperColor);
		owner->FillRect(body);
		owner->SetHighColor(kPaperShade);
		owner->StrokeRect(body);
		for (float y = body.top + 3; y < body.bottom; y += 2)
			owner->StrokeLine(BPoint(body.left + 2, y), BPoint(body.right - 2, y));
	}
	if (fItem.isLink) {
		owner->SetHighColor(kLinkColor);
		owner->FillRect(BRect(body.left, body.bottom - 3, body.left + 3, body.bottom));
	}
}


// #pragma mark - header


FileHeader::FileHeader(BRect frame) :
	BView(
		frame, "header", B_FOLLOW_LEFT_RIGHT | B_FOLLOW_TOP, B_WILL_DRAW | B_FULL_UPDATE_ON_RESIZE)
{
	SetViewColor(Look::PanelColor());
	SetLowColor(Look::PanelColor());
}


void
FileHeader::Draw(BRect)
{
	// The list's right edge lies left of its scroll bar.
	const float right = Bounds().right - kListBorder - B_V_SCROLL_BAR_WIDTH;
	const float dateLeft = right - kDateWidth;
	const float baseline = Bounds().bottom - kHeaderBaseline;
	SetHighColor(Look::TextColor());
	DrawString("Name", BPoint(kListBorder + kTextLeft, baseline));
	DrawString("Size", BPoint(dateLeft - kColumnGap - std::ceil(StringWidth("Size")), baseline));
	DrawString("Modified", BPoint(dateLeft + kColumnGap, baseline));
}

} // namespace BPrivate
