// Text views and input methods: text that is shown before it is confirmed.
#include "TextView.h"

#include <algorithm>
#include <cstring>

#include <AppDefs.h>
#include <Beep.h>
#include <Message.h>
#include <ScrollBar.h>
#include <Window.h>

#include "interface/private/TextHistory.h"
#include "interface/private/TextLayout.h"
#include "interface/private/TextViewPrivate.h"

using namespace BPrivate;

namespace {

// What an input method says in "be:opcode".
constexpr int32 kMethodStarted = 0;
constexpr int32 kMethodStopped = 1;
constexpr int32 kMethodChanged = 2;
constexpr int32 kMethodLocationRequest = 3;

} // namespace


// What is composed stands in the text while it is, and in the history once it is confirmed.
void
BTextView::_HandleInputMethod(BMessage* message)
{
	int32 code;
	if (message->FindInt32("be:opcode", &code) != B_OK || !fEditable)
		return;
	switch (code) {
		case kMethodStarted: {
			_EndComposition(true);
			fComposition = std::make_unique<Composition>();
			message->FindMessenger("be:reply_to", &fComposition->method);
			if (_Start() != _End())
				_Edit(B_UNDO_TYPING, _Start(), _End(), NULL, 0, NULL);
			fComposition->offset = _Start();
			break;
		}

		case kMethodStopped:
			_EndComposition(false);
			break;

		case kMethodChanged:
			_Compose(message);
			break;

		case kMethodLocationRequest:
			_SendCompositionPlaces();
			break;
	}
}


void
BTextView::_Compose(BMessage* message)
{
	if (fComposition == nullptr)
		return;
	const char* string;
	if (message->FindString("be:string", &string) != B_OK)
		string = "";
	const std::string text = _Allowed(string, static_cast<int32>(strlen(string)));
	bool confirmed;
	if (message->FindBool("be:confirmed", &confirmed) != B_OK)
		confirmed = false;

	_RemoveComposed();
	const int32 offset = fComposition->offset;
	if (confirmed) {
		_Edit(B_UNDO_TYPING, offset, offset, text.data(), static_cast<int32>(text.size()), NULL);
		fComposition->offset = _Start();
	} else if (!text.empty()) {
		fComposition->length =
			_InsertLimited(offset, text.data(), static_cast<int32>(text.size()), NULL);
		int32 from = fComposition->length;
		int32 to = from;
		if (message->FindInt32("be:selection", 0, &from) != B_OK
			|| message->FindInt32("be:selection", 1, &to) != B_OK)
			from = to = fComposition->length;
		_SetSelection(_Clamp(offset + std::clamp<int32>(from, 0, fComposition->length)),
			_Clamp(offset + std::clamp<int32>(to, 0, fComposition->length)));
	}
	ScrollToOffset(fCaret);
}


void
BTextView::_RemoveComposed()
{
	const int32 from = std::min(fComposition->offset, TextLength());
	const int32 to = std::min(from + fComposition->length, TextLength());
	fComposition->length = 0;
	if (from < to)
		DeleteText(from, to);
	_SetSelection(from, from);
}


// Somebody else wants to edit, or the method is done: what is not confirmed goes, or is taken as if
// it had been typed.
void
BTextView::_EndComposition(bool keepText)
{
	if (fComposition == nullptr)
		return;
	const std::unique_ptr<Composition> composition = std::move(fComposition);
	const int32 from = std::min(composition->offset, TextLength());
	const int32 to = std::min(from + composition->length, TextLength());
	if (from == to)
		return;
	const std::string text = fModel->Buffer().String(from, to - from);
	DeleteText(from, to);
	_SetSelection(from, from);
	if (keepText)
		_Edit(B_UNDO_TYPING, from, from, text.data(), static_cast<int32>(text.size()), NULL);
}


// Where the characters are on the screen, for the method's own windows.
void
BTextView::_SendCompositionPlaces()
{
	if (fComposition == nullptr || Window() == NULL)
		return;
	BMessage places(B_INPUT_METHOD_EVENT);
	places.AddInt32("be:opcode", kMethodLocationRequest);
	const int32 end = fComposition->offset + fComposition->length;
	for (int32 at = fComposition->offset; at <= end; at = fModel->NextCharacter(at)) {
		float height;
		const BPoint point = PointAt(at, &height);
		places.AddPoint("be:location_reply", ConvertToScreen(point));
		places.AddFloat("be:height_reply", height);
		if (at == end)
			break;
	}
	fComposition->method.SendMessage(&places);
}


void
BTextView::_DrawComposition(BRect)
{
	if (fComposition == nullptr || fComposition->length == 0)
		return;
	const int32 from = fComposition->offset;
	const int32 to = from + fComposition->length;
	for (int32 line = LineAt(from); line <= LineAt(to); line++) {
		const int32 end = std::min(to, fLayout->VisibleEnd(line));
		const float y = fTextRect.top + fLayout->Top(line) + fLayout->Ascent(line) + 1;
		const float left = _LineLeft(line);
		std::vector<TextLayout::Span> spans;
		fLayout->GetSpans(line, from, end, spans);
		for (const TextLayout::Span& span : spans) {
			const float right = std::min(span.right, fLayout->Width(line));
			if (span.left < right)
				StrokeLine(BPoint(left + span.left, y), BPoint(left + right, y));
		}
	}
}
