// BTextView: what goes to the clipboard and comes from it.
#include "TextView.h"

#include <cstdlib>

#include <Beep.h>
#include <Clipboard.h>
#include <Message.h>

#include "interface/private/TextHistory.h"
#include "interface/private/TextLayout.h"
#include "interface/private/TextViewPrivate.h"

using namespace BPrivate;


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
