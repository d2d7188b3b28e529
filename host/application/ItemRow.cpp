#include "host/application/ItemRow.h"

#include <cmath>

#include <DataIO.h>
#include <Font.h>
#include <Message.h>
#include <View.h>

#include "host/application/FourCharacters.h"
#include "host/library/ResourceItem.h"

using namespace BResEditor;

namespace {


constexpr float kRowPadding = 4;
constexpr float kColumnGap = 8;
constexpr size_t kPreviewBytes = 48;
constexpr rgb_color kSelectionColor = { 190, 190, 190, 255 };
constexpr rgb_color kGroundColor = { 255, 255, 255, 255 };
constexpr rgb_color kTextColor = { 0, 0, 0, 255 };


// The archived class, or the first characters of a text, or nothing.
BString
PreviewOf(const BResourceItem* item)
{
	BMessage message;
	const char* text;
	BMemoryIO data(item->Data(), item->Size());
	if (item->Size() > 0 && message.Unflatten(&data) == B_OK) {
		if (message.FindString("class", &text) != B_OK)
			return "message";
		BString preview(text);
		if (message.FindString("_name", &text) == B_OK)
			preview << " \"" << text << "\"";
		return preview;
	}

	BString preview;
	const char* bytes = static_cast<const char*>(item->Data());
	for (size_t i = 0; i < item->Size() && i < kPreviewBytes && bytes[i] != '\0'; i++) {
		const uint8 byte = static_cast<uint8>(bytes[i]);
		if (byte < 0x20 || byte >= 0x7f)
			return "";
		preview << bytes[i];
	}
	return preview;
}


void
DrawColumn(BView* owner, const BString& text, float left, float right, float baseline)
{
	BString cut(text);
	owner->TruncateString(&cut, B_TRUNCATE_END, right - left - kColumnGap);
	owner->DrawString(cut.String(), BPoint(left, baseline));
}


} // namespace


const ItemRow::Columns ItemRow::kColumns = { 6, 58, 108, 258, 320 };


ItemRow::ItemRow(const BResourceItem* item) : BStringItem("")
{
	SetTo(item);
}


const BResourceHandle&
ItemRow::Handle() const
{
	return fHandle;
}


void
ItemRow::SetTo(const BResourceItem* item)
{
	fHandle = item->Handle();
	fType = FourCharacters(item->Type()).c_str();
	fID.SetTo("");
	fID << item->ID();
	fName = item->Name();
	fSize.SetTo("");
	fSize << static_cast<uint64>(item->Size());
	fPreview = PreviewOf(item);
	SetText((BString(fType) << ":" << fID).String());
}


void
ItemRow::DrawItem(BView* owner, BRect frame, bool complete)
{
	const rgb_color ground = IsSelected() ? kSelectionColor : kGroundColor;
	owner->SetLowColor(ground);
	owner->SetHighColor(ground);
	owner->FillRect(frame);
	owner->SetHighColor(kTextColor);

	const float baseline = frame.top + fBaseline;
	const float left = frame.left;
	DrawColumn(owner, fType, left + kColumns.type, left + kColumns.id, baseline);
	DrawColumn(owner, fID, left + kColumns.id, left + kColumns.name, baseline);
	DrawColumn(owner, fName, left + kColumns.name, left + kColumns.size, baseline);
	DrawColumn(owner, fSize, left + kColumns.size, left + kColumns.preview, baseline);
	DrawColumn(owner, fPreview, left + kColumns.preview, frame.right, baseline);
}


void
ItemRow::Update(BView* owner, const BFont* font)
{
	font_height metrics;
	font->GetHeight(&metrics);
	SetWidth(owner->Bounds().Width());
	SetHeight(std::ceil(metrics.ascent) + std::ceil(metrics.descent) + kRowPadding);
	fBaseline = kRowPadding / 2 + std::ceil(metrics.ascent);
}
