// BTextView: its text, its runs, its history, and the clipboard.
#include "TextView.h"

#include <algorithm>
#include <cstdlib>
#include <cstring>

#include <Beep.h>
#include <Clipboard.h>
#include <File.h>
#include <Message.h>

#include "interface/private/TextHistory.h"
#include "interface/private/TextLayout.h"
#include "interface/private/TextViewPrivate.h"

using namespace BPrivate;

namespace {

// The part of the font that the mask names.
void
merge_font(BFont& to, const BFont& from, uint32 mask)
{
	if (mask & B_FONT_FAMILY_AND_STYLE)
		to.SetFamilyAndStyle(from.FamilyAndStyle());
	if (mask & B_FONT_SIZE)
		to.SetSize(from.Size());
	if (mask & B_FONT_SHEAR)
		to.SetShear(from.Shear());
	if (mask & B_FONT_ROTATION)
		to.SetRotation(from.Rotation());
	if (mask & B_FONT_SPACING)
		to.SetSpacing(from.Spacing());
	if (mask & B_FONT_ENCODING)
		to.SetEncoding(from.Encoding());
	if (mask & B_FONT_FACE)
		to.SetFace(from.Face());
	if (mask & B_FONT_FLAGS)
		to.SetFlags(from.Flags());
}


// The mask's bits in which the two agree.
uint32
common_font_bits(const BFont& a, const BFont& b, uint32 mask)
{
	const auto drop = [&mask](uint32 bit, bool same) {
		if (!same)
			mask &= ~bit;
	};
	drop(B_FONT_FAMILY_AND_STYLE, a.FamilyAndStyle() == b.FamilyAndStyle());
	drop(B_FONT_SIZE, a.Size() == b.Size());
	drop(B_FONT_SHEAR, a.Shear() == b.Shear());
	drop(B_FONT_ROTATION, a.Rotation() == b.Rotation());
	drop(B_FONT_SPACING, a.Spacing() == b.Spacing());
	drop(B_FONT_ENCODING, a.Encoding() == b.Encoding());
	drop(B_FONT_FACE, a.Face() == b.Face());
	drop(B_FONT_FLAGS, a.Flags() == b.Flags());
	return mask;
}


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


// #pragma mark - clipboard


void
BTextView::Cut(BClipboard* clipboard)
{
	if (_Start() == _End() || !fEditable || fHidesTyping || clipboard == NULL) {
		beep();
		return;
	}
	Copy(clipboard);
	_EndComposition(true);
	_Edit(B_UNDO_CUT, _Start(), _End(), NULL, 0, NULL);
	ScrollToSelection();
}


void
BTextView::Copy(BClipboard* clipboard)
{
	if (_Start() == _End() || fHidesTyping || clipboard == NULL || !clipboard->Lock()) {
		beep();
		return;
	}
	clipboard->Clear();
	if (BMessage* data = clipboard->Data()) {
		_AddToMessage(data, _Start(), _End());
		clipboard->Commit();
	}
	clipboard->Unlock();
}


void
BTextView::Paste(BClipboard* clipboard)
{
	if (!fEditable || clipboard == NULL || !clipboard->Lock()) {
		beep();
		return;
	}
	_EndComposition(true);
	const BMessage* data = clipboard->Data();
	const bool pasted = data != NULL && _InsertFrom(data, B_UNDO_PASTE, -1);
	clipboard->Unlock();
	if (pasted)
		ScrollToSelection();
	else
		beep();
}


void
BTextView::Clear()
{
	Delete();
}


bool
BTextView::AcceptsPaste(BClipboard* clipboard)
{
	if (!fEditable || clipboard == NULL || !clipboard->Lock())
		return false;
	const BMessage* data = clipboard->Data();
	type_code type;
	const bool accepts =
		data != NULL && data->GetInfo(kTextType, &type) == B_OK && type == B_MIME_TYPE;
	clipboard->Unlock();
	return accepts;
}


bool
BTextView::AcceptsDrop(const BMessage* message)
{
	type_code type;
	return fEditable && message != NULL && message->GetInfo(kTextType, &type) == B_OK
		&& type == B_MIME_TYPE;
}


void
BTextView::_AddToMessage(BMessage* data, int32 from, int32 to) const
{
	const std::string text = fModel->Buffer().String(from, to - from);
	data->AddData(kTextType, B_MIME_TYPE, text.data(), text.size());
	if (!fStylable)
		return;
	text_run_array* runs = RunArray(from, to);
	int32 size;
	void* flat = FlattenRunArray(runs, &size);
	data->AddData(kRunsType, B_MIME_TYPE, flat, size);
	free(flat);
	FreeRunArray(runs);
}


// Replaces the selection, or inserts at the offset if that is not negative. The caret goes behind
// what was inserted. False if there is no text.
bool
BTextView::_InsertFrom(const BMessage* data, undo_state kind, int32 offset)
{
	const void* bytes;
	ssize_t size;
	if (data->FindData(kTextType, B_MIME_TYPE, &bytes, &size) != B_OK)
		return false;
	const std::string text = _Allowed(static_cast<const char*>(bytes), static_cast<int32>(size));

	text_run_array* runs = NULL;
	const void* flat;
	ssize_t flatSize;
	if (fStylable && data->FindData(kRunsType, B_MIME_TYPE, &flat, &flatSize) == B_OK)
		runs = unflatten_runs(flat, flatSize);

	const int32 from = offset >= 0 ? offset : _Start();
	const int32 to = offset >= 0 ? offset : _End();
	_SetSelection(to, to);
	_Edit(kind, from, to, text.data(), static_cast<int32>(text.size()), runs);
	FreeRunArray(runs);
	return true;
}


// #pragma mark - looks


void
BTextView::SetFontAndColor(const BFont* font, uint32 mode, const rgb_color* color)
{
	if (_Start() != _End() || !fStylable) {
		SetFontAndColor(_Start(), _End(), font, mode, color);
		return;
	}
	TextStyle style = fModel->StyleForInsertion(fCaret);
	if (font != NULL)
		merge_font(style.font, *font, mode);
	if (color != NULL)
		style.color = *color;
	fModel->SetPendingStyle(fCaret, style);
	if (TextLength() == 0)
		_LayOutAgain();
}


void
BTextView::SetFontAndColor(
	int32 startOffset, int32 endOffset, const BFont* font, uint32 mode, const rgb_color* color)
{
	int32 from = _Clamp(startOffset);
	int32 to = _Clamp(endOffset);
	if (!fStylable) {
		from = 0;
		to = TextLength();
	}
	if (from > to || (from == to && TextLength() > 0))
		return;

	TextRuns runs = fModel->CopyRuns(from, to);
	for (TextRun& run : runs) {
		if (font != NULL)
			merge_font(run.style.font, *font, mode);
		if (color != NULL)
			run.style.color = *color;
	}
	fModel->SetRuns(from, to, runs);
	_StyleChanged(from, to);
}


void
BTextView::GetFontAndColor(int32 offset, BFont* _font, rgb_color* _color) const
{
	const TextStyle& style = fModel->StyleAt(_Clamp(offset));
	if (_font != NULL)
		*_font = style.font;
	if (_color != NULL)
		*_color = style.color;
}


void
BTextView::GetFontAndColor(BFont* _font, uint32* _mode, rgb_color* _color, bool* _sameColor) const
{
	TextStyle style = fModel->StyleForInsertion(fCaret);
	uint32 mode = B_FONT_ALL;
	bool sameColor = true;
	if (_Start() != _End()) {
		const TextRuns runs = fModel->CopyRuns(_Start(), _End());
		style = runs.front().style;
		for (const TextRun& run : runs) {
			mode = common_font_bits(style.font, run.style.font, mode);
			sameColor = sameColor && run.style.color == style.color;
		}
	}
	if (_font != NULL)
		*_font = style.font;
	if (_mode != NULL)
		*_mode = mode;
	if (_color != NULL)
		*_color = style.color;
	if (_sameColor != NULL)
		*_sameColor = sameColor;
}


void
BTextView::SetRunArray(int32 startOffset, int32 endOffset, const text_run_array* runs)
{
	if (runs == NULL || runs->count <= 0)
		return;
	const int32 from = _Clamp(startOffset);
	const int32 to = _Clamp(endOffset);
	if (!fStylable) {
		fModel->SetStyle({ runs->runs[0].font, runs->runs[0].color });
		_StyleChanged(0, TextLength());
		return;
	}
	if (from > to)
		return;
	fModel->SetRuns(from, to, runs_from_array(runs, to - from, fModel->StyleAt(from)));
	_StyleChanged(from, to);
}


text_run_array*
BTextView::RunArray(int32 startOffset, int32 endOffset, int32* _size) const
{
	const int32 from = _Clamp(startOffset);
	const int32 to = std::max(from, _Clamp(endOffset));
	const TextRuns runs = fModel->CopyRuns(from, to);
	text_run_array* array = AllocRunArray(static_cast<int32>(runs.size()), _size);
	if (array == NULL)
		return NULL;
	for (size_t i = 0; i < runs.size(); i++)
		array->runs[i] = { runs[i].offset, runs[i].style.font, runs[i].style.color };
	return array;
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
