// BDragger: the handle by which a view is dragged away as a replicant of itself.
#pragma once

#include <memory>

#include <View.h>

class BBitmap;
class BMessageRunner;
class BPopUpMenu;
class BShelf;


// The target is the dragger's parent, its only child or a sibling; the target is not owned. Dragging
// the handle sends the target's archive (B_ARCHIVED_OBJECT). In a shelf, a press with the secondary
// button, or one that is held, opens the menu of the replicant.
class _EXPORT BDragger : public BView {
public:
	// The relation to the target is found when the dragger is attached to a window.
	BDragger(BRect frame, BView* target, uint32 resizingMode = B_FOLLOW_NONE,
		uint32 flags = B_WILL_DRAW);
	// The target is found by the archived relation; that to a sibling means the one before, or the
	// next one of a first child.
	BDragger(BMessage* archive);
	virtual ~BDragger();

	static BArchivable* Instantiate(BMessage* archive);
	virtual status_t Archive(BMessage* archive, bool deep = true) const;

	virtual void AttachedToWindow();
	virtual void DetachedFromWindow();
	virtual void AllAttached();
	virtual void AllDetached();
	virtual void Draw(BRect updateRect);
	virtual void MouseDown(BPoint where);
	virtual void MouseUp(BPoint where);
	virtual void MouseMoved(BPoint where, uint32 transit, const BMessage* dragMessage);
	virtual void MessageReceived(BMessage* message);
	virtual void FrameMoved(BPoint newPosition);
	virtual void FrameResized(float newWidth, float newHeight);

	// For all draggers of this program, at any time and in any thread. A handle that is not drawn
	// takes no mouse.
	static status_t ShowAllDraggers();
	static status_t HideAllDraggers();
	static bool AreDraggersDrawn();

	virtual BHandler* ResolveSpecifier(
		BMessage* message, int32 index, BMessage* specifier, int32 form, const char* property);
	virtual status_t GetSupportedSuites(BMessage* data);
	virtual status_t Perform(perform_code code, void* argument);
	virtual void ResizeToPreferred();
	virtual void GetPreferredSize(float* _width, float* _height);
	virtual void MakeFocus(bool focusState = true);

	// The menu is taken over and the one before deleted. NULL brings the usual one back.
	status_t SetPopUp(BPopUpMenu* menu);
	// The one that was set, or the usual one. It stays the dragger's.
	BPopUpMenu* PopUp() const;

	bool InShelf() const;
	// NULL when there is none, as before a revived dragger has got its neighbours.
	BView* Target() const;

	// What follows the pointer: the caller owns it. By default NULL, for the target's outline.
	virtual BBitmap* DragBitmap(BPoint* _offset, drawing_mode* _mode);

protected:
	// While the dragger is shown or hidden because all are.
	bool IsVisibilityChanging() const;

private:
	friend class BShelf;

	// Where the target stands; the numbers are those of the archive.
	enum Relation : int32 { kUnknown = 0, kTargetIsChild, kTargetIsParent, kTargetIsSibling };

	int32 _RelationTo(const BView* target) const;
	BView* _LiveTarget() const;
	void _SetTarget(BView* target);
	void _SetShelf(BShelf* shelf, uint32 replicant);
	bool _IsDrawn() const;
	void _UpdateVisibility();
	status_t _ArchiveReplicant(BMessage* archive) const;
	BRect _ReplicantFrame() const;
	void _StartDrag();
	void _EndPress();
	void _ShowPopUp(BPoint where);
	void _BuildPopUp();

	BView* fTarget; // borrowed; NULL where the relation tells the target
	int32 fRelation; // as it was read, also when it is none of the relations
	BShelf* fShelf; // borrowed; NULL outside of shelves
	uint32 fReplicant; // its number in the shelf
	std::unique_ptr<BPopUpMenu> fPopUp; // NULL until somebody needs it
	bool fHasOwnPopUp; // the menu was set
	bool fPopUpChanged; // since the archive was read
	bool fIsHiddenHandle; // Hide() was called because no handles are drawn
	bool fIsVisibilityChanging;
	bool fIsPressed;
	BPoint fPressed; // where
	std::unique_ptr<BMessageRunner> fHold; // while a press may become a long one
};
