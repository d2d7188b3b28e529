// BTextView: its text, its runs, its history, and the clipboard.
#include "TextView.h"

#include <algorithm>
#include <cstring>

#include <Beep.h>
#include <File.h>

#include "interface/private/TextHistory.h"
#include "interface/private/TextLayout.h"
#include "interface/private/TextViewPrivate.h"

using namespace BPrivate;

namespace {

// Where a position goes when the bytes between are removed.
int32
after_removal(int32 position, int32 from, int32 to)
{
	if (position <= from)
		return position;
	return position >= to ? position - (to - from) : from;
}

} // namespace


void
BTextView::SetText(const char* text, const text_run_array* runs)
{
	SetText(text, text != NULL ? static_cast<int32>(strlen(text)) : 0, runs);
}


// The history ends here: what it knows is about another text.
void
BTextView::SetText(const char* text, int32 length, const text_run_array* runs)
{
	_EndComposition(true);
	fHistory.reset();
	if (TextLength() > 0)
		DeleteText(0, TextLength());
	_SetSelection(0, 0);
	if (text != NULL && length > 0)
		_InsertLimited(0, text, length, runs);
	_SetSelection(0, 0);
	if (Window() != NULL && ScrollBar(B_VERTICAL) == NULL)
		_KeepInView();
	fCaretX = -1;
}


void
BTextView::SetText(BFile* file, int32 offset, int32 length, const text_run_array* runs)
{
	if (file == NULL || offset < 0 || length <= 0)
		return;
	off_t size;
	if (file->GetSize(&size) != B_OK || offset >= size)
		return;
	std::string text(std::min<off_t>(length, size - offset), '\0');
	const ssize_t count = file->ReadAt(offset, text.data(), text.size());
	if (count >= 0)
		SetText(text.data(), static_cast<int32>(count), runs);
}


void
BTextView::Insert(const char* text, const text_run_array* runs)
{
	if (text != NULL)
		Insert(_Start(), text, static_cast<int32>(strlen(text)), runs);
}


void
BTextView::Insert(const char* text, int32 length, const text_run_array* runs)
{
	Insert(_Start(), text, length, runs);
}


void
BTextView::Insert(int32 offset, const char* text, int32 length, const text_run_array* runs)
{
	if (text == NULL || length <= 0)
		return;
	_EndComposition(true);
	length = static_cast<int32>(strnlen(text, length));
	offset = _Clamp(offset);
	_Edit(B_UNDO_PASTE, offset, offset, text, length, runs);
}


void
BTextView::Delete()
{
	Delete(_Start(), _End());
}


void
BTextView::Delete(int32 startOffset, int32 endOffset)
{
	_EndComposition(true);
	startOffset = _Clamp(startOffset);
	endOffset = _Clamp(endOffset);
	if (startOffset < endOffset)
		_Edit(B_UNDO_CLEAR, startOffset, endOffset, NULL, 0, NULL);
}


const char*
BTextView::Text() const
{
	return fModel->Buffer().Text();
}


int32
BTextView::TextLength() const
{
	return fModel->Length();
}


void
BTextView::GetText(int32 offset, int32 length, char* buffer) const
{
	if (buffer == NULL)
		return;
	offset = std::clamp<int32>(offset, 0, TextLength());
	length = std::clamp<int32>(length, 0, TextLength() - offset);
	fModel->Buffer().Copy(offset, length, buffer);
	buffer[length] = '\0';
}


uchar
BTextView::ByteAt(int32 offset) const
{
	if (offset < 0 || offset >= TextLength())
		return 0;
	return static_cast<uchar>(fModel->Buffer().ByteAt(offset));
}


// #pragma mark - history


void
BTextView::Undo(BClipboard*)
{
	if (!fEditable || fHistory == nullptr) {
		beep();
		return;
	}
	_EndComposition(true);
	if (fHistory->CanUndo())
		_ApplyStep(true);
	else if (fHistory->CanRedo())
		_ApplyStep(false);
	else
		beep();
}


void
BTextView::Redo(BClipboard*)
{
	if (!fEditable || fHistory == nullptr || !fHistory->CanRedo()) {
		beep();
		return;
	}
	_EndComposition(true);
	_ApplyStep(false);
}


undo_state
BTextView::UndoState(bool* _isRedo) const
{
	const bool canUndo = fHistory != nullptr && fHistory->CanUndo();
	const bool isRedo = !canUndo && fHistory != nullptr && fHistory->CanRedo();
	if (_isRedo != NULL)
		*_isRedo = isRedo;
	if (fHistory == nullptr)
		return B_UNDO_UNAVAILABLE;
	return isRedo ? fHistory->RedoKind() : fHistory->UndoKind();
}


// Whatever the hooks make of the changes, the offsets are limited to the text that there is.
void
BTextView::_ApplyStep(bool undo)
{
	// A copy: a hook may edit the text, and so the history.
	const TextStep step = undo ? *fHistory->TakeUndo() : *fHistory->TakeRedo();
	fHistory->SetReplaying(true);
	const auto apply = [this, undo](const TextChange& change) {
		const int32 length = static_cast<int32>(change.text.size());
		const int32 offset = std::min(change.offset, TextLength());
		if (change.inserted == undo) {
			const int32 end = std::min(offset + length, TextLength());
			if (offset < end)
				DeleteText(offset, end);
			_SetSelection(offset, offset);
			return;
		}
		text_run_array* runs = AllocRunArray(static_cast<int32>(change.runs.size()));
		for (size_t i = 0; i < change.runs.size(); i++) {
			const TextRun& run = change.runs[i];
			runs->runs[i] = { run.offset, run.style.font, run.style.color };
		}
		InsertText(change.text.data(), length, offset, fStylable ? runs : NULL);
		FreeRunArray(runs);
		const int32 end = std::min(offset + length, TextLength());
		_SetSelection(end, end);
	};
	if (undo)
		std::for_each(step.changes.rbegin(), step.changes.rend(), apply);
	else
		std::for_each(step.changes.begin(), step.changes.end(), apply);
	if (fHistory != nullptr)
		fHistory->SetReplaying(false);
	if (undo)
		_SetSelection(_Clamp(step.startBefore), _Clamp(step.endBefore));
	ScrollToSelection();
}


// #pragma mark - changes


void
BTextView::InsertText(const char* text, int32 length, int32 offset, const text_run_array* runs)
{
	if (text == NULL || length <= 0)
		return;
	offset = std::clamp<int32>(offset, 0, TextLength());
	if (fStylable && runs != NULL) {
		const TextRuns given = runs_from_array(runs, length, fModel->StyleForInsertion(offset));
		fModel->Insert(offset, text, length, &given);
	} else {
		fModel->Insert(offset, text, length, NULL);
	}
	if (fHistory != nullptr && fHistory->IsOpen()) {
		fHistory->Note(
			true, offset, std::string(text, length), fModel->CopyRuns(offset, offset + length));
	}
	if (fAnchor >= offset)
		fAnchor += length;
	if (fCaret >= offset)
		fCaret += length;
	_TextChanged(offset, 0, length);
}


void
BTextView::DeleteText(int32 fromOffset, int32 toOffset)
{
	const int32 from = std::clamp<int32>(fromOffset, 0, TextLength());
	const int32 to = std::clamp<int32>(toOffset, from, TextLength());
	if (from == to)
		return;
	if (fHistory != nullptr && fHistory->IsOpen()) {
		fHistory->Note(
			false, from, fModel->Buffer().String(from, to - from), fModel->CopyRuns(from, to));
	}
	fModel->Remove(from, to);
	fAnchor = after_removal(fAnchor, from, to);
	fCaret = after_removal(fCaret, from, to);
	_TextChanged(from, to - from, 0);
}


// The start of the character that a given offset lies in.
int32
BTextView::_Clamp(int32 offset) const
{
	return fModel->CharacterStart(offset);
}


// Inserts whole characters as far as there is room for them; returns how many bytes.
int32
BTextView::_InsertLimited(int32 offset, const char* text, int32 length, const text_run_array* runs)
{
	const int32 room = std::max<int32>(0, fMaxBytes - TextLength());
	if (length > room) {
		length = room;
		while (length > 0 && (text[length] & 0xc0) == 0x80)
			length--;
	}
	if (length > 0)
		InsertText(text, length, offset, runs);
	return length;
}


// Replaces a part as one step of the history; an empty selection inside of it ends behind the text.
void
BTextView::_Edit(undo_state kind, int32 from, int32 to, const char* text, int32 length,
	const text_run_array* runs)
{
	if (fDoesUndo && fEditable && fHistory == nullptr)
		fHistory = std::make_unique<TextHistory>();
	if (fHistory != nullptr)
		fHistory->Begin(kind, _Start(), _End());
	if (from < to)
		DeleteText(from, to);
	if (length > 0)
		_InsertLimited(std::min(from, TextLength()), text, length, runs);
	if (fHistory != nullptr)
		fHistory->End();
	fCaretX = -1;
}
