// Items on the desktop's clipboard, between the files of one or several editors.
#pragma once

#include <string>
#include <vector>

#include <SupportDefs.h>

#include "host/library/ResourceItem.h"


struct ClipboardItem {
	type_code type;
	int32 id;
	std::string name;
	std::string data;
};

// Replaces what the clipboard holds. The items are copies, so that no lock of theirs is needed.
status_t CopyToClipboard(const std::vector<BResEditor::BResourceItem>& items);

// What is there; empty when the clipboard holds something else.
std::vector<ClipboardItem> ItemsOnClipboard();
