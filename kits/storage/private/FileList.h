// FileList: the list of a file panel.
#pragma once

#include <ListView.h>

#include "storage/private/FileRow.h"

namespace BPrivate {

// From the list to its window.
constexpr uint32 kPanelSelection = 'PSel'; // sent only for what the user selects
constexpr uint32 kPanelInvoked = 'PInv';
constexpr uint32 kPanelParent = 'PPar';


// Owns its rows.
class FileList : public BListView {
public:
	FileList(BRect frame, list_view_type type);
	~FileList() override;

	// What was selected and is still there stays selected.
	void SetItems(const std::vector<FolderItem>& items);
	FileRow* RowAt(int32 index) const;
	bool SelectName(const std::string& name); // without telling the window
	void SelectNothing();

	void SelectionChanged() override;
	void KeyDown(const char* bytes, int32 numBytes) override;

private:
	void _DeleteRows();

	bool fQuiet;
};

} // namespace BPrivate
