// Items on the desktop's clipboard, between the files of one or several editors.
#pragma once

#include <string>
#include <vector>

#include <SupportDefs.h>

namespace BResEditor {
class BResourceItem;
}


struct ClipboardItem {
	type_code type;
	int32 id;
	std::string name;
	std::string data;
};

// Replaces what the clipboard holds. Under the read lock of the items.
status_t CopyToClipboard(const std::vector<const BResEditor::BResourceItem*>& items);

// What is there; empty when the clipboard holds something else.
std::vector<ClipboardItem> ItemsOnClipboard();
