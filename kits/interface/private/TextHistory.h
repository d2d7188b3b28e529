// TextHistory: what was done to a text, to be taken back and done again.
#pragma once

#include <string>
#include <vector>

#include <TextView.h>

#include "interface/private/TextModel.h"

namespace BPrivate {


// One insertion or removal, as it happened.
struct TextChange {
	bool inserted;
	int32 offset;
	std::string text;
	TextRuns runs;
};


// What one Undo() takes back. Changes are in the order in which they were made.
struct TextStep {
	undo_state kind;
	std::vector<TextChange> changes;
	int32 startBefore, endBefore; // the selection before the first change
	size_t bytes = 0;
};


// Changes are noted while a step is open; typing on goes into the step before. The history forgets
// its oldest steps when it holds too much.
class TextHistory {
public:
	// Steps nest: the outermost gives the kind.
	void Begin(undo_state kind, int32 selectionStart, int32 selectionEnd);
	void End();
	bool IsOpen() const { return fDepth > 0; }

	void Note(bool inserted, int32 offset, std::string text, TextRuns runs);
	// What is typed next begins a step of its own.
	void BreakTyping() { fMayJoin = false; }
	void Clear();

	// The step to be applied backwards (undo) or forwards, which changes sides; NULL if none. Valid
	// until the next call.
	const TextStep* TakeUndo();
	const TextStep* TakeRedo();
	bool CanUndo() const { return !fDone.empty(); }
	bool CanRedo() const { return !fUndone.empty(); }
	undo_state UndoKind() const;
	undo_state RedoKind() const;

	// While replaying nothing is noted.
	void SetReplaying(bool replaying) { fReplaying = replaying; }
	bool IsReplaying() const { return fReplaying; }

private:
	bool _Join(TextStep& step, TextChange& change);
	void _Trim();

	std::vector<TextStep> fDone;
	std::vector<TextStep> fUndone; // the last is done again first
	TextStep fOpen;
	size_t fBytes = 0;
	int32 fDepth = 0;
	bool fMayJoin = false;
	bool fReplaying = false;
};


} // namespace BPrivate
