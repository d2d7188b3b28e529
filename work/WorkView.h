// WorkView: the design surface, where the edited views are shown, selected, moved and resized.
#pragma once

#include <memory>
#include <vector>

#include <ScrollView.h>

#include "archive/ViewWatch.h"

class HiliteView;
class WorkBackgroundView;


// The edited views are ordinary views that know nothing of the editor: a filter on the window takes
// the mouse from them, so that a click on a button selects the button. One work view a window; the
// filter finds it by its name, "WorkView". All calls with the window locked.
class WorkView : public BScrollView {
public:
	// The editor is told, by posted messages, of a new selection (kSelectionChanged) and of a move
	// or resize of the selected view (kSelectionMoved). It is borrowed and outlives this view.
	WorkView(BRect frame, uint32 resizingMode, BHandler* editor);

	void AttachedToWindow() override;
	void DetachedFromWindow() override;
	void FrameResized(float width, float height) override;
	void KeyDown(const char* bytes, int32 numBytes) override;
	void MessageReceived(BMessage* message) override;
	void MouseMoved(BPoint where, uint32 transit, const BMessage* drag) override;
	void MouseUp(BPoint where) override;

	// Replaces the edited tree, deletes the former one, and selects the new root. Takes ownership;
	// NULL for no tree.
	void SetEditView(BView* view);
	BView* EditView() const;
	BPoint ScrollOrigin() const;

	// The view must be in the edited tree.
	void SetSelectedView(BView* view);
	BView* SelectedView() const; // NULL for none, also when the view is gone

	// A view stands in the place of another one, perhaps of the root. It is selected; the former one
	// is the caller's.
	void ReplaceView(BView* former, BView* view);

	WorkBackgroundView* Container() const;

	// What the user looks at, in a form that outlives the tree: for a tree that is replaced by one
	// of the same make.
	struct Place {
		std::vector<int32> selection; // PathTo() the selected view
		BPoint scrolled;
	};
	Place PresentPlace() const;
	void ReturnTo(const Place& place);

	// Has the highlight drawn after the updates that are pending.
	void PostHiliteRedraw();

	// A press of the primary button on an edited view.
	void HandleFilteredMouse(BMessage* message, BView* view, int32 modifiers);

	// Something dropped on an edited view, or on the container: a view, a picture, or a file that a
	// view was dragged into.
	void HandleFilteredDrop(BMessage* message, BView* target);

private:
	void _TakeKeyboard();
	void _SendTypedText();
	bool _MayMove(const BView* view) const;
	void _BeginResize(BPoint where);
	void _BeginMove(BView* view, BPoint where, bool copy);
	bool _PutBack(BMessage* drop);
	void _AddDropped(BMessage* message, BView* target, BView* view);
	void _ReplaceTree(BView* view);
	void _DeleteSelection();
	void _HandleKey(char key);
	void _MoveSelection(float x, float y);
	void _NotifyEditor(BMessage* message);

	BPoint fScrollOrigin; // where SetEditView() last scrolled the container to
	bool fResizing;
	BPoint fLastResizePoint; // in the selected view's coordinates
	int32 fRangeWidth;
	int32 fRangeHeight;
	WorkBackgroundView* fContainer; // child of the scroll target
	BHandler* fEditor; // borrowed
	BView* fEditView; // child of the container, or NULL
	HiliteView* fHiliteView; // child of the scroll target
	ViewWatch fSelectedView;
	int32 fFieldsLeft; // whose text may still be on its way to the panels

	// What our last drag took away, for the case that it is dropped where it was: two clicks must
	// not change even what an archive does not hold. NULL when the drag copied.
	std::unique_ptr<BView> fTaken;
	ViewWatch fTakenFrom; // its parent
	ViewWatch fTakenBefore; // its next sibling, if any
	BPoint fTakenLeftTop;
	BPoint fTakenAt; // where the drag began, on the screen
};
