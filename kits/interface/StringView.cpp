#include <StringView.h>

#include <algorithm>
#include <cmath>
#include <string_view>

#include <Message.h>
#include <String.h>

#include "interface/private/Label.h"
#include "interface/private/Look.h"
#include "interface/private/ViewArchive.h"

namespace Look = BPrivate::Look;

using BPrivate::is_revived;
using BPrivate::LabelMetrics;

namespace {

constexpr float kInset = 0; // of the text, at the left and at the right

// Calls `action(line)` for every line of the text, with a std::string.
template<typename Action>
void
ForEachLine(std::string_view text, Action action)
{
	size_t start = 0;
	for (;;) {
		const size_t end = text.find('\n', start);
		action(std::string(text.substr(start, end == text.npos ? end : end - start)));
		if (end == text.npos)
			return;
		start = end + 1;
	}
}


float
CountLines(std::string_view text)
{
	return 1 + static_cast<float>(std::count(text.begin(), text.end(), '\n'));
}

} // namespace


BStringView::BStringView(
	BRect frame, const char* name, const char* text, uint32 resizingMode, uint32 flags) :
	BView(frame, name, resizingMode, flags | B_FULL_UPDATE_ON_RESIZE),
	fText(text != NULL ? text : ""), fHasText(text != NULL), fAlign(B_ALIGN_LEFT),
	fTruncation(B_NO_TRUNCATION)
{
}


BStringView::BStringView(BMessage* archive) :
	BView(archive), fHasText(false), fAlign(B_ALIGN_LEFT), fTruncation(B_NO_TRUNCATION)
{
	const char* text;
	if (archive->FindString("_text", &text) == B_OK) {
		fText = text;
		fHasText = true;
	}
	int32 truncation;
	if (archive->FindInt32("_truncation", &truncation) == B_OK)
		fTruncation = static_cast<uint32>(truncation);
	int32 align;
	if (archive->FindInt32("_align", &align) == B_OK)
		fAlign = static_cast<alignment>(align);
}


BStringView::~BStringView()
{
}


BArchivable*
BStringView::Instantiate(BMessage* archive)
{
	return validate_instantiation(archive, "BStringView") ? new BStringView(archive) : NULL;
}


status_t
BStringView::Archive(BMessage* archive, bool deep) const
{
	const status_t status = BView::Archive(archive, deep);
	if (status != B_OK)
		return status;

	BPrivate::ArchiveWriter writer(archive);
	writer.String("_text", Text(), NULL);
	writer.Int32("_truncation", static_cast<int32>(fTruncation),
		static_cast<int32>(B_NO_TRUNCATION), fTruncation != B_NO_TRUNCATION);
	writer.Int32("_align", fAlign, B_ALIGN_LEFT);
	return writer.Status();
}


// #pragma mark - properties


void
BStringView::SetText(const char* text)
{
	const bool hasText = text != NULL;
	if (hasText == fHasText && (!hasText || fText == text))
		return;
	fText = hasText ? text : "";
	fHasText = hasText;
	Invalidate();
}


const char*
BStringView::Text() const
{
	return fHasText ? fText.c_str() : NULL;
}


void
BStringView::SetAlignment(alignment flag)
{
	fAlign = flag;
	Invalidate();
}


alignment
BStringView::Alignment() const
{
	return fAlign;
}


void
BStringView::SetTruncation(uint32 truncationMode)
{
	if (truncationMode == fTruncation)
		return;
	fTruncation = truncationMode;
	Invalidate();
}


uint32
BStringView::Truncation() const
{
	return fTruncation;
}


void
BStringView::GetPreferredSize(float* _width, float* _height)
{
	if (_width != NULL) {
		float widest = 0;
		ForEachLine(fText, [&](const std::string& line) {
			widest = std::max(widest, BPrivate::label_width(this, line.c_str()));
		});
		*_width = widest + 2 * kInset;
	}
	if (_height != NULL)
		*_height = LabelMetrics(this).lineHeight * CountLines(fText);
}


void
BStringView::ResizeToPreferred()
{
	BView::ResizeToPreferred();
}


// #pragma mark - drawing


void
BStringView::Draw(BRect updateRect)
{
	if (!fHasText)
		return;

	const LabelMetrics metrics(this);
	float baseline =
		Bounds().bottom - metrics.descent - (CountLines(fText) - 1) * metrics.lineHeight;
	ForEachLine(fText, [&](const std::string& line) {
		if (baseline + metrics.descent >= updateRect.top
			&& baseline - metrics.ascent <= updateRect.bottom) {
			_DrawLine(line.c_str(), baseline);
		}
		baseline += metrics.lineHeight;
	});
}


void
BStringView::_DrawLine(const char* line, float baseline)
{
	const BRect bounds = Bounds();
	BString shown(line);
	if (fTruncation != B_NO_TRUNCATION)
		TruncateString(&shown, fTruncation, bounds.Width() + 1 - 2 * kInset);

	float left = bounds.left + kInset;
	if (fAlign == B_ALIGN_RIGHT)
		left = bounds.right + 1 - kInset - StringWidth(shown.String());
	else if (fAlign == B_ALIGN_CENTER)
		left = bounds.left + (bounds.Width() + 1 - StringWidth(shown.String())) / 2;
	DrawString(shown.String(), BPoint(std::floor(left), baseline));
}


// #pragma mark - hooks


void
BStringView::AttachedToWindow()
{
	if (!is_revived(this)) {
		const rgb_color color = Look::ColorOfParent(this);
		SetViewColor(color);
		SetLowColor(color);
	}
	BView::AttachedToWindow();
}


void
BStringView::DetachedFromWindow()
{
	BView::DetachedFromWindow();
}


void
BStringView::AllAttached()
{
	BView::AllAttached();
}


void
BStringView::AllDetached()
{
	BView::AllDetached();
}


void
BStringView::MessageReceived(BMessage* message)
{
	BView::MessageReceived(message);
}


void
BStringView::MouseDown(BPoint where)
{
	BView::MouseDown(where);
}


void
BStringView::MouseUp(BPoint where)
{
	BView::MouseUp(where);
}


void
BStringView::MouseMoved(BPoint where, uint32 transit, const BMessage* dragMessage)
{
	BView::MouseMoved(where, transit, dragMessage);
}


void
BStringView::MakeFocus(bool focused)
{
	BView::MakeFocus(focused);
}


void
BStringView::FrameMoved(BPoint newPosition)
{
	BView::FrameMoved(newPosition);
}


void
BStringView::FrameResized(float newWidth, float newHeight)
{
	BView::FrameResized(newWidth, newHeight);
}


void
BStringView::WindowActivated(bool active)
{
	BView::WindowActivated(active);
}


BHandler*
BStringView::ResolveSpecifier(
	BMessage* message, int32 index, BMessage* specifier, int32 what, const char* property)
{
	return BView::ResolveSpecifier(message, index, specifier, what, property);
}


status_t
BStringView::GetSupportedSuites(BMessage* message)
{
	return BView::GetSupportedSuites(message);
}


status_t
BStringView::Perform(perform_code code, void* data)
{
	return BView::Perform(code, data);
}
