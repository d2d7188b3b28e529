// ItemList: the items of a document, one row each, in the document's order.
#pragma once

#include <vector>

#include <ListView.h>

#include "host/library/ResourceHandle.h"

namespace BResEditor {
class BResourceCollection;
}
class ItemRow;


// Owns its rows. Enter and a double click post kOpenItem to the window, Delete and Backspace
// kDeleteItem.
class ItemList : public BListView {
public:
	explicit ItemList(BRect frame);
	~ItemList() override;

	// Shows what the collection has now of that item: a new row, a changed one, or none. True for
	// a new one. Read lock.
	bool Update(const BResEditor::BResourceCollection* collection,
		const BResEditor::BResourceHandle& handle);

	// The selected items, from the top; none gives an invalid handle for the first.
	std::vector<BResEditor::BResourceHandle> SelectedItems() const;
	BResEditor::BResourceHandle FirstSelected() const;
	void SelectItems(const std::vector<BResEditor::BResourceHandle>& handles);

	void KeyDown(const char* bytes, int32 numBytes) override;

private:
	ItemRow* _RowAt(int32 index) const; // NULL when out of range
	int32 _IndexOf(const BResEditor::BResourceHandle& handle) const; // -1 when it has no row
};
