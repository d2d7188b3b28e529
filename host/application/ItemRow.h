// ItemRow: one item of a document in the list of a file window.
#pragma once

#include <ListItem.h>
#include <String.h>

#include "host/library/ResourceHandle.h"

namespace BResEditor {
class BResourceItem;
}


// Its text is TYPE:ID, as the command line writes it; scripts find the row by it.
class ItemRow : public BStringItem {
public:
	// Where the columns start, in pixels from the left edge of the list.
	struct Columns {
		float type, id, name, size, preview;
	};
	static const Columns kColumns;

	explicit ItemRow(const BResEditor::BResourceItem* item);

	const BResEditor::BResourceHandle& Handle() const;

	// Shows what the item is now.
	void SetTo(const BResEditor::BResourceItem* item);

	void DrawItem(BView* owner, BRect frame, bool complete = false) override;
	void Update(BView* owner, const BFont* font) override;

private:
	BResEditor::BResourceHandle fHandle;
	BString fType;
	BString fID;
	BString fName;
	BString fSize;
	BString fPreview;
	float fBaseline = 0; // from the top of the row
};
