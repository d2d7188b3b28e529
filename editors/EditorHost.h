// What a panel needs from the editor that shows it; defined there.
#pragma once

class BView;

// Whether the panel stands in an editor.
bool HasEditor(const BView* panel);

// Selects a view of the edited tree in the panel's editor, which then loads its panels anew.
// Returns false when the panel stands in no editor.
bool SelectInEditor(const BView* panel, BView* view);
