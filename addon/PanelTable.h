// The class panels, in the order in which they are stacked.
#pragma once

#include <SupportDefs.h>

class EditorInterface;

// Makes one panel of each kind; the caller owns them. Fills at most capacity - 1 entries, ends
// them with NULL, and returns how many panels there are.
int32 MakePanels(EditorInterface** panels, int32 capacity);
