// BytesEditor: shows the bytes of an item that no add-on edits, as text or as a table of numbers.
#pragma once

#include <string>

#include <View.h>

#include "host/library/ItemEditor.h"

class BTextView;


// Text (UTF-8, perhaps with a final zero) can be changed; other bytes are shown only.
class BytesEditor : public BResEditor::BFullItemEditor, public BView {
public:
	// The note, if there is one, is shown above the bytes: why there is no better editor.
	BytesEditor(const BResEditor::BResourceAddonArgs& args, BResEditor::BResourceHandle handle,
		const std::string& note);
	~BytesEditor() override;

	BView* View() override;
	void UpdateValue(const char* operation) override;

	void AllAttached() override;
	void DetachedFromWindow() override;
	void MessageReceived(BMessage* message) override;

private:
	void _Load();

	BTextView* fTextView; // child of a scroll view
	bool fIsText;
	bool fHadFinalZero;
	std::string fLoadedText;
};
