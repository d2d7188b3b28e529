// Whether an item's bytes can be opened in an editor for archived objects.
#pragma once

#include <string>

namespace BResEditor {
class BResourceItem;
}

// Empty when the bytes are an archive of a class that is available here; else a sentence that says
// what is wrong and where. Makes no object to find out. Read lock.
std::string WhyNoArchivedObject(const BResEditor::BResourceItem* item);
