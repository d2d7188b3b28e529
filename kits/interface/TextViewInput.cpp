// BTextView: the selection and keys.
#include "TextView.h"

#include <algorithm>
#include <cstring>

#include <AppDefs.h>
#include <Beep.h>
#include <Message.h>
#include <ScrollBar.h>
#include <Window.h>

#include "interface/private/EventModifiers.h"
#include "interface/private/TextHistory.h"
#include "interface/private/TextLayout.h"
#include "interface/private/TextViewPrivate.h"

using namespace BPrivate;


void
BTextView::Select(int32 startOffset, int32 endOffset)
{
	const int32 start = _Clamp(startOffset);
	const int32 end = _Clamp(endOffset);
	if (start > end)
		return;
	_EndComposition(true);
	_SetSelection(start, end);
	fCaretX = -1;
}


void
BTextView::SelectAll()
{
	Select(0, TextLength());
}


void
BTextView::GetSelection(int32* _start, int32* _end) const
{
	if (_start != NULL)
		*_start = _Start();
	if (_end != NULL)
		*_end = _End();
}


void
BTextView::_SetSelection(int32 anchor, int32 caret, bool isBehind)
{
	if (anchor == fAnchor && caret == fCaret) {
		_SetCaretBehind(isBehind);
		return;
	}
	const int32 oldStart = _Start();
	const int32 oldEnd = _End();
	const BRect oldCaret = _CaretRect(fCaret);
	fAnchor = anchor;
	fCaret = caret;
	fCaretBehind = isBehind;
	if (fHistory != nullptr && !fHistory->IsOpen())
		fHistory->BreakTyping();
	if (fAnchor != fCaret || fAnchor != oldStart)
		fModel->ForgetPendingStyle();
	if (Window() == NULL || !fActive)
		return;

	// Only what changes sides is drawn again.
	if (oldStart < oldEnd && _Start() < _End() && oldStart < _End() && _Start() < oldEnd) {
		_InvalidateRange(std::min(oldStart, _Start()), std::max(oldStart, _Start()));
		_InvalidateRange(std::min(oldEnd, _End()), std::max(oldEnd, _End()));
	} else {
		_InvalidateRange(oldStart, oldEnd);
		_InvalidateRange(_Start(), _End());
	}
	Invalidate(oldCaret);
	_RestartBlinking();
}


void
BTextView::_SetCaretBehind(bool isBehind)
{
	if (isBehind == fCaretBehind)
		return;
	const BRect oldCaret = _CaretRect(fCaret);
	fCaretBehind = isBehind;
	if (Window() == NULL || !fActive)
		return;
	Invalidate(oldCaret);
	_RestartBlinking();
}


// #pragma mark - keys


void
BTextView::KeyDown(const char* bytes, int32 numBytes)
{
	if (numBytes <= 0)
		return;
	const char key = bytes[0];
	const uint32 modifiers = event_modifiers(*this);

	if (!fEditable && !fSelectable) {
		if (!_ScrollByKey(key))
			BView::KeyDown(bytes, numBytes);
		return;
	}
	_EndComposition(true);
	if (numBytes == 1 && _HandleNavigation(key, modifiers))
		return;
	if (!fEditable) {
		BView::KeyDown(bytes, numBytes);
		return;
	}

	const bool byWord = (modifiers & (B_COMMAND_KEY | B_CONTROL_KEY)) != 0;
	switch (key) {
		case B_BACKSPACE:
			_HandleErasing(false, byWord);
			break;

		case B_DELETE:
			_HandleErasing(true, byWord);
			break;

		case B_ENTER:
			_HandleEnter();
			break;

		case B_ESCAPE:
		case B_INSERT:
		case B_FUNCTION_KEY:
			BView::KeyDown(bytes, numBytes);
			break;

		default:
			_HandleTyping(bytes, numBytes);
			break;
	}
}


bool
BTextView::_HandleNavigation(char key, uint32 modifiers)
{
	const bool extend = (modifiers & B_SHIFT_KEY) != 0;
	const bool far = (modifiers & (B_COMMAND_KEY | B_CONTROL_KEY)) != 0;
	switch (key) {
		case B_LEFT_ARROW:
		case B_RIGHT_ARROW:
			_MoveCaret(_PlaceBesideCaret(key == B_RIGHT_ARROW, extend, far), extend);
			return true;

		case B_UP_ARROW:
		case B_DOWN_ARROW:
			_MoveByLines(key == B_UP_ARROW ? -1 : 1, extend);
			return true;

		case B_HOME:
			_MoveCaret(far ? 0 : fLayout->LineStart(LineAt(fCaret)), extend);
			return true;

		case B_END: {
			const int32 line = LineAt(fCaret);
			int32 end = fLayout->VisibleEnd(line);
			// The end of a wrapped line is the start of the next.
			if (end == fLayout->LineEnd(line) && line + 1 < CountLines())
				end = fLayout->PreviousPlace(end);
			_MoveCaret(far ? TextLength() : end, extend);
			return true;
		}

		case B_PAGE_UP:
		case B_PAGE_DOWN: {
			const float height = std::max(1.0f, LineHeight(LineAt(fCaret)));
			const int32 lines = std::max(1, static_cast<int>(Bounds().Height() / height) - 1);
			_MoveByLines(key == B_PAGE_UP ? -lines : lines, extend);
			return true;
		}

		default:
			return false;
	}
}


TextPlace
BTextView::_CaretPlace() const
{
	return { fCaret, fCaretBehind };
}


// As it is seen: a selection ends at that side of it, and a line that starts at the right goes on
// to the left.
TextPlace
BTextView::_PlaceBesideCaret(bool toRight, bool extend, bool byWord) const
{
	if (byWord)
		return _WordEdge(fCaret, toRight != fLayout->StartsAtRight(LineAt(fCaret)));
	if (extend || _Start() == _End())
		return fLayout->PlaceBeside(_CaretPlace(), toRight);
	const int32 line = LineAt(_Start());
	const bool endIsRight = line != LineAt(_End())
		|| fLayout->XAt(line, _Start()) <= fLayout->XAt(line, { _End(), true });
	return toRight == endIsRight ? TextPlace(_End(), true) : TextPlace(_Start());
}


void
BTextView::_MoveCaret(TextPlace to, bool extend)
{
	_SetSelection(extend ? fAnchor : to.offset, to.offset, to.behind);
	fCaretX = -1;
	ScrollToOffset(to.offset);
	_RestartBlinking();
}


// Keeps the column, also over shorter lines in between.
void
BTextView::_MoveByLines(int32 lines, bool extend)
{
	const int32 line = LineAt(fCaret);
	if (fCaretX < 0)
		fCaretX = _LineLeft(line) + fLayout->XAt(line, _CaretPlace());
	const float x = fCaretX;
	const int32 target = line + lines;
	TextPlace to;
	if (target < 0)
		to = 0;
	else if (target >= CountLines())
		to = TextLength();
	else
		to = fLayout->PlaceAtX(target, x - _LineLeft(target));
	_MoveCaret(to, extend);
	fCaretX = x;
}


int32
BTextView::_WordEdge(int32 from, bool forward) const
{
	const auto is_blank = [this](int32 offset) {
		const char byte = fModel->Buffer().ByteAt(offset);
		return byte == ' ' || byte == '\t' || byte == '\n';
	};
	int32 offset = from;
	if (forward) {
		while (offset < TextLength() && is_blank(offset))
			offset++;
	} else {
		while (offset > 0 && is_blank(offset - 1))
			offset--;
		if (offset > 0)
			offset = fModel->PreviousCharacter(offset);
	}
	if (offset >= TextLength() || (!forward && offset == 0 && is_blank(0)))
		return offset;
	int32 start, end;
	const_cast<BTextView*>(this)->FindWord(offset, &start, &end);
	return forward ? end : start;
}


void
BTextView::_HandleErasing(bool forward, bool word)
{
	int32 from = _Start();
	int32 to = _End();
	if (from == to) {
		if (forward)
			to = word ? _WordEdge(to, true) : fLayout->NextPlace(to);
		else
			from = word ? _WordEdge(from, false) : fModel->PreviousCharacter(from);
	}
	if (from == to)
		return;
	const TextStyle style = fModel->StyleAt(from);
	_Edit(B_UNDO_TYPING, from, to, NULL, 0, NULL);
	// What is typed next looks like what was erased.
	if (fStylable && from == _Start())
		fModel->SetPendingStyle(from, style);
	ScrollToOffset(fCaret);
}


void
BTextView::_HandleEnter()
{
	std::string text = "\n";
	if (fAutoindent) {
		const int32 start = _Start();
		int32 offset = start;
		while (offset > 0 && ByteAt(offset - 1) != '\n')
			offset--;
		for (; offset < start && (ByteAt(offset) == ' ' || ByteAt(offset) == '\t'); offset++)
			text += static_cast<char>(ByteAt(offset));
	}
	_HandleTyping(text.data(), static_cast<int32>(text.size()));
}


void
BTextView::_HandleTyping(const char* bytes, int32 numBytes)
{
	const std::string text = _Allowed(bytes, numBytes);
	const int32 room = fMaxBytes - (TextLength() - (_End() - _Start()));
	if (text.empty() || static_cast<int32>(text.size()) > room) {
		beep();
		return;
	}
	const int32 from = _Start();
	const int32 to = _End();
	if (from < to)
		_SetSelection(to, to);
	_Edit(B_UNDO_TYPING, from, to, text.data(), static_cast<int32>(text.size()), NULL);
	// Where letters run both ways, it stays at what was typed.
	_SetCaretBehind(true);
	ScrollToOffset(fCaret);
}


// A view that shows its text only.
bool
BTextView::_ScrollByKey(char key)
{
	BScrollBar* bar =
		ScrollBar(key == B_LEFT_ARROW || key == B_RIGHT_ARROW ? B_HORIZONTAL : B_VERTICAL);
	if (bar == NULL)
		return false;
	float minimum, maximum, small, large;
	bar->GetRange(&minimum, &maximum);
	bar->GetSteps(&small, &large);
	switch (key) {
		case B_LEFT_ARROW:
		case B_UP_ARROW:
			bar->SetValue(bar->Value() - small);
			return true;

		case B_RIGHT_ARROW:
		case B_DOWN_ARROW:
			bar->SetValue(bar->Value() + small);
			return true;

		case B_PAGE_UP:
			bar->SetValue(bar->Value() - large);
			return true;

		case B_PAGE_DOWN:
			bar->SetValue(bar->Value() + large);
			return true;

		case B_HOME:
			bar->SetValue(minimum);
			return true;

		case B_END:
			bar->SetValue(maximum);
			return true;

		default:
			return false;
	}
}


bool
BTextView::_IsAllowed(uint32 character) const
{
	return std::find(fDisallowed.begin(), fDisallowed.end(), character) == fDisallowed.end();
}


// Without the characters that are not allowed; ends at a zero.
std::string
BTextView::_Allowed(const char* text, int32 length) const
{
	std::string result;
	for (int32 offset = 0; offset < length && text[offset] != '\0';) {
		const int32 count = character_length(text + offset, length - offset);
		if (_IsAllowed(decode_character(text + offset, count)))
			result.append(text + offset, count);
		offset += count;
	}
	return result;
}
