// What a panel needs from the editor that shows it; defined there.
#pragma once

class BView;

// Whether the panel stands in an editor.
bool HasEditor(const BView* panel);

// Tells the panel's editor that a view has taken the place of another one, which is about to be
// deleted. The editor selects the new view and then loads its panels anew. Returns false when the
// panel stands in no editor.
bool ReplaceInEditor(const BView* panel, BView* former, BView* view);
