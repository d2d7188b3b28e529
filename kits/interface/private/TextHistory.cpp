#include "interface/private/TextHistory.h"

namespace BPrivate {

namespace {

constexpr size_t kMaxSteps = 10000;
constexpr size_t kMaxBytes = 64 * 1024 * 1024;

} // namespace


void
TextHistory::Begin(undo_state kind, int32 selectionStart, int32 selectionEnd)
{
	if (fDepth++ > 0)
		return;
	fOpen = TextStep { kind, {}, selectionStart, selectionEnd };
}


void
TextHistory::End()
{
	if (fDepth == 0 || --fDepth > 0 || fOpen.changes.empty())
		return;

	fUndone.clear();
	const bool typing = fOpen.kind == B_UNDO_TYPING;
	if (typing && fMayJoin && !fDone.empty() && fDone.back().kind == B_UNDO_TYPING
		&& fOpen.changes.size() == 1 && _Join(fDone.back(), fOpen.changes.front())) {
		fOpen.changes.clear();
	} else {
		for (const TextChange& change : fOpen.changes)
			fOpen.bytes += change.text.size() + change.runs.size() * sizeof(TextRun);
		fBytes += fOpen.bytes;
		fDone.push_back(std::move(fOpen));
		fOpen.changes.clear();
	}
	fMayJoin = typing;
	_Trim();
}


void
TextHistory::Note(bool inserted, int32 offset, std::string text, TextRuns runs)
{
	if (fReplaying || fDepth == 0 || text.empty())
		return;
	fOpen.changes.push_back({ inserted, offset, std::move(text), std::move(runs) });
}


void
TextHistory::Clear()
{
	fDone.clear();
	fUndone.clear();
	fOpen.changes.clear();
	fBytes = 0;
	fMayJoin = false;
}


const TextStep*
TextHistory::TakeUndo()
{
	if (fDone.empty())
		return nullptr;
	fUndone.push_back(std::move(fDone.back()));
	fDone.pop_back();
	fBytes -= fUndone.back().bytes;
	fMayJoin = false;
	return &fUndone.back();
}


const TextStep*
TextHistory::TakeRedo()
{
	if (fUndone.empty())
		return nullptr;
	fDone.push_back(std::move(fUndone.back()));
	fUndone.pop_back();
	fBytes += fDone.back().bytes;
	fMayJoin = false;
	return &fDone.back();
}


undo_state
TextHistory::UndoKind() const
{
	return fDone.empty() ? B_UNDO_UNAVAILABLE : fDone.back().kind;
}


undo_state
TextHistory::RedoKind() const
{
	return fUndone.empty() ? B_UNDO_UNAVAILABLE : fUndone.back().kind;
}


// Typing goes on behind the last insertion, deleting goes on at either side of the last removal.
bool
TextHistory::_Join(TextStep& step, TextChange& change)
{
	TextChange& last = step.changes.back();
	const int32 length = static_cast<int32>(change.text.size());
	if (change.inserted != last.inserted || change.runs.size() != 1 || last.runs.size() != 1
		|| !(change.runs.front().style == last.runs.front().style))
		return false;

	if (change.inserted) {
		const int32 end = last.offset + static_cast<int32>(last.text.size());
		if (change.offset != end || last.text.back() == '\n')
			return false;
		last.text += change.text;
	} else if (change.offset == last.offset) {
		last.text += change.text;
	} else if (change.offset + length == last.offset) {
		last.text.insert(0, change.text);
		last.offset = change.offset;
	} else {
		return false;
	}
	step.bytes += length;
	fBytes += length;
	return true;
}


// The newest step always stays.
void
TextHistory::_Trim()
{
	size_t count = 0;
	while (fDone.size() - count > 1 && (fDone.size() - count > kMaxSteps || fBytes > kMaxBytes)) {
		fBytes -= fDone[count].bytes;
		count++;
	}
	fDone.erase(fDone.begin(), fDone.begin() + count);
}


} // namespace BPrivate
