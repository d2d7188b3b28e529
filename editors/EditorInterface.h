// EditorInterface: base of the property panels, a labelled box with a target view.
#pragma once

#include <Box.h>

#include "archive/ViewWatch.h"


// A panel shows and edits the properties that one platform class gives to a view. It changes the
// live view directly, under the lock of the view's window, and tells nobody. The editor makes each
// panel once and shows it while UseView() accepts the selection.
class EditorInterface : public BBox {
public:
	// Tells that the target was moved or resized in the work area; does nothing by default.
	virtual void FrameChanged();

	// Takes the view as the target if it is of the panel's class, loads every control from it, and
	// returns whether it is. The view is borrowed; NULL for none.
	virtual bool UseView(BView* view) = 0;

	void AllAttached() override;

	// Has ApplyEdit() carry the message out with the target's window locked, and passes on what
	// is none of the panel's codes after the lock was released.
	void MessageReceived(BMessage* message) override;

protected:
	// The label is "Properties from BButton" and the like; the height is in pixels less one.
	EditorInterface(const char* name, const char* label, float height);

	// Sets the target, which a panel has tested to be of its class. Returns whether there is one.
	bool TakeTarget(BView* view);

	// Whether there is a target and it still exists: messages may come after it was deleted.
	bool TargetLives() const;

	// Carries out an edit on the target, which exists and whose window is locked. Returns false,
	// and changes nothing, for a code that is none of the panel's.
	virtual bool ApplyEdit(BMessage* message);

	// The place of the rows: margins at the left and right, the top of the first row.
	BRect RowArea() const;

	// The one row of a panel whose class adds nothing.
	void AddOnlySentence(const char* text);

	// The two halves of a row that has a text at the left and a menu at the right.
	BRect TextBesideMenuFrame() const;
	BRect MenuBesideTextFrame() const;

	BView* target; // borrowed; NULL when the panel has no view

private:
	bool _WaitsForTypedText(const BMessage* message);

	ViewWatch fTargetWatch;
};


// A panel whose targets are views of one class. Both calls need the class to be complete.
template<class View> class PanelOf : public EditorInterface {
protected:
	using EditorInterface::EditorInterface;

	// Returns whether the view is of the class, and so the target.
	bool TakeTarget(BView* view) { return EditorInterface::TakeTarget(dynamic_cast<View*>(view)); }

	View* _Target() const { return static_cast<View*>(target); }
};


// The layout that the panels share, in pixels.
constexpr float kSentencePanelHeight = 38;
constexpr float kOneRowPanelHeight = 42;
constexpr float kTwoRowPanelHeight = 70;
constexpr float kRowStep = 28;
constexpr float kRowHeight = 12;
constexpr float kColumnWidth = 100;
constexpr float kColumnStep = 120;
