// The codes and names that cross the editor's folders.
#pragma once

#include <SupportDefs.h>

// The resource type of an archived object.
constexpr type_code kArchiveType = 'ARCV';

// From the work view to the editor: the selection changed (pointer "what": the selected view), and
// the selected view's frame changed.
constexpr uint32 kSelectionChanged = 'clik';
constexpr uint32 kSelectionMoved = 'move';
constexpr const char* kSelectedViewField = "what";

// From the work view to itself, behind what a field sends that has lost the keyboard.
constexpr uint32 kFieldLeft = 'left';

// From the work view to the highlight: draw now.
constexpr uint32 kDrawHilite = 'draw';

// Codes of dragged views, beside B_SIMPLE_DATA.
constexpr uint32 kDroppedView = 'drop';
constexpr uint32 kDroppedProperty = 'drpp';
