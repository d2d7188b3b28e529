#include "StringItem.h"

#include <cmath>
#include <cstdlib>
#include <cstring>

#include <Message.h>
#include <View.h>

#include "interface/private/Look.h"
#include "interface/private/ViewArchive.h"

using namespace BPrivate;

namespace {

constexpr float kInset = 4; // of the text from the left
constexpr float kPadding = 4; // above and below the text, together

} // namespace


BStringItem::BStringItem(const char* text, uint32 outlineLevel, bool expanded) :
	BListItem(outlineLevel, expanded), fText(text != NULL ? strdup(text) : NULL), fBaselineOffset(0)
{
}


BStringItem::BStringItem(BMessage* archive) : BListItem(archive), fText(NULL), fBaselineOffset(0)
{
	const char* text;
	if (archive->FindString("_label", &text) == B_OK)
		fText = strdup(text);
}


BStringItem::~BStringItem()
{
	free(fText);
}


BArchivable*
BStringItem::Instantiate(BMessage* archive)
{
	return validate_instantiation(archive, "BStringItem") ? new BStringItem(archive) : NULL;
}


status_t
BStringItem::Archive(BMessage* archive, bool deep) const
{
	const status_t status = BListItem::Archive(archive, deep);
	if (status != B_OK)
		return status;
	ArchiveWriter writer(archive);
	writer.String("_label", fText, NULL);
	return writer.Status();
}


// The owner's high colour is the text's.
void
BStringItem::DrawItem(BView* owner, BRect frame, bool complete)
{
	owner->PushState();
	const rgb_color background = Look::BaseColor(owner);
	const rgb_color color = owner->HighColor();
	if (IsSelected() || complete) {
		owner->SetHighColor(IsSelected() ? Look::ListSelectionColor(background) : background);
		owner->FillRect(frame);
	}
	if (fText != NULL) {
		owner->SetHighColor(IsEnabled() ? color : Look::TextColor(Look::kDisabled));
		owner->SetDrawingMode(B_OP_OVER);
		owner->DrawString(fText, BPoint(frame.left + kInset, frame.top + fBaselineOffset));
	}
	owner->PopState();
}


void
BStringItem::SetText(const char* text)
{
	char* copy = text != NULL ? strdup(text) : NULL;
	free(fText);
	fText = copy;
}


const char*
BStringItem::Text() const
{
	return fText;
}


void
BStringItem::Update(BView* owner, const BFont* font)
{
	font_height height;
	font->GetHeight(&height);
	SetWidth(kInset * 2 + (fText != NULL ? std::ceil(font->StringWidth(fText)) : 0));
	SetHeight(std::ceil(height.ascent) + std::ceil(height.descent) + std::ceil(height.leading)
		+ kPadding);
	fBaselineOffset = kPadding / 2 + std::ceil(height.ascent + height.leading / 2);
}


status_t
BStringItem::Perform(perform_code code, void* data)
{
	return BListItem::Perform(code, data);
}


float
BStringItem::BaselineOffset() const
{
	return fBaselineOffset;
}
