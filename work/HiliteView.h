// HiliteView: the transparent overlay that frames the selected view.
#pragma once

#include <View.h>

class WorkView;


// Lies above the container. The frame is drawn after every update of the window, for updating the
// views below wipes it out.
class HiliteView : public BView {
public:
	HiliteView(BRect frame, const char* name, uint32 resizingMode, uint32 flags, WorkView* owner);

	void Draw(BRect updateRect) override;
	void MessageReceived(BMessage* message) override;

	// Frames the selected view where it is visible, and marks its resize zone if it has one.
	void DrawHilite();

	// Erases the frame, by having the selected view draw that part of itself again.
	void InvalidateSelection();

private:
	BView* _Selection() const;

	WorkView* fOwner; // borrowed: our grandparent
};
