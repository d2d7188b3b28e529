#include <Dragger.h>

#include <Message.h>
#include <MessageRunner.h>
#include <PopUpMenu.h>
#include <Shelf.h>
#include <Window.h>

#include "interface/private/ArchivedState.h"
#include "interface/private/DraggerList.h"
#include "interface/private/Look.h"
#include "interface/private/ViewArchive.h"
#include "interface/private/ViewPrivate.h"

namespace Look = BPrivate::Look;

using BPrivate::DraggerList;
using BPrivate::ViewPrivate;

namespace {

// Hidden once more than the archive shall say. A count that was read stays as it was.
void
ArchiveHideCount(BMessage* view, int16 count)
{
	BPrivate::ArchiveWriter writer(view);
	if (writer.Keep("_show", count == BPrivate::read_archived_state(writer.Source()).hideCount))
		return;
	view->RemoveName("_show");
	if (count != 0)
		view->AddInt16("_show", count);
}

} // namespace


BDragger::BDragger(BRect frame, BView* target, uint32 resizingMode, uint32 flags) :
	BView(frame, "_dragger_", resizingMode, flags), fTarget(target), fRelation(kUnknown),
	fShelf(NULL), fReplicant(0), fHasOwnPopUp(false), fPopUpChanged(false), fIsHiddenHandle(false),
	fIsVisibilityChanging(false), fIsPressed(false)
{
}


BDragger::BDragger(BMessage* archive) :
	BView(archive), fTarget(NULL), fRelation(kUnknown), fShelf(NULL), fReplicant(0),
	fHasOwnPopUp(false), fPopUpChanged(false), fIsHiddenHandle(false), fIsVisibilityChanging(false),
	fIsPressed(false)
{
	int32 relation;
	if (archive->FindInt32("_rel", &relation) == B_OK)
		fRelation = relation;
	BMessage popUp;
	if (archive->FindMessage("_popup", &popUp) == B_OK) {
		BArchivable* object = instantiate_object(&popUp);
		fPopUp.reset(dynamic_cast<BPopUpMenu*>(object));
		fHasOwnPopUp = fPopUp != nullptr;
		if (!fHasOwnPopUp)
			delete object;
	}
}


BDragger::~BDragger()
{
	if (fShelf != NULL)
		fShelf->_DraggerGone(this);
}


BArchivable*
BDragger::Instantiate(BMessage* archive)
{
	return validate_instantiation(archive, "BDragger") ? new BDragger(archive) : NULL;
}


status_t
BDragger::Archive(BMessage* archive, bool deep) const
{
	status_t status = BView::Archive(archive, deep);
	if (status != B_OK)
		return status;

	if (fIsHiddenHandle)
		ArchiveHideCount(archive, static_cast<int16>(ViewPrivate(this).Node()->HideCount() - 1));
	BPrivate::ArchiveWriter writer(archive);
	BMessage popUp;
	if (fHasOwnPopUp) {
		status = fPopUp->Archive(&popUp, deep);
		if (status == B_OK)
			writer.Message("_popup", &popUp);
	} else {
		// A menu that could not be revived is carried along.
		writer.Keep("_popup", !fPopUpChanged);
	}
	// A target that was given may have come after the dragger.
	const int32 relation = fRelation == kUnknown ? _RelationTo(fTarget) : fRelation;
	writer.Int32("_rel", relation, kUnknown);
	return status == B_OK ? writer.Status() : status;
}


// #pragma mark - target


// Nothing is asked of the target itself, which may have gone.
int32
BDragger::_RelationTo(const BView* target) const
{
	if (target == NULL)
		return kUnknown;
	if (Parent() == target)
		return kTargetIsParent;
	for (const BView* child = ChildAt(0); child != NULL; child = child->NextSibling()) {
		if (child == target)
			return kTargetIsChild;
	}
	for (const BView* view = PreviousSibling(); view != NULL; view = view->PreviousSibling()) {
		if (view == target)
			return kTargetIsSibling;
	}
	for (const BView* view = NextSibling(); view != NULL; view = view->NextSibling()) {
		if (view == target)
			return kTargetIsSibling;
	}
	return kUnknown;
}


BView*
BDragger::Target() const
{
	if (fTarget != NULL)
		return fTarget;
	switch (fRelation) {
		case kTargetIsChild:
			return ChildAt(0);
		case kTargetIsParent:
			return Parent();
		case kTargetIsSibling:
			return PreviousSibling() != NULL ? PreviousSibling() : NextSibling();
		default:
			return NULL;
	}
}


// A target that was given and has left its place may be anything by now.
BView*
BDragger::_LiveTarget() const
{
	if (fTarget != NULL && _RelationTo(fTarget) == kUnknown)
		return NULL;
	return Target();
}


void
BDragger::_SetTarget(BView* target)
{
	fTarget = target;
	fRelation = _RelationTo(target);
}


void
BDragger::_SetShelf(BShelf* shelf, uint32 replicant)
{
	fShelf = shelf;
	fReplicant = replicant;
	_UpdateVisibility();
}


bool
BDragger::InShelf() const
{
	return fShelf != NULL;
}


// #pragma mark - hooks


void
BDragger::AttachedToWindow()
{
	if (!BPrivate::is_revived(this)) {
		SetViewColor(Look::ColorOfParent(this));
		SetLowColor(ViewColor());
	}
	if (fTarget != NULL)
		fRelation = _RelationTo(fTarget);
	DraggerList::Add(this);
	_UpdateVisibility();
}


void
BDragger::DetachedFromWindow()
{
	DraggerList::Remove(this);
	_EndPress();
	if (fIsHiddenHandle) {
		fIsHiddenHandle = false;
		Show();
	}
}


void
BDragger::AllAttached()
{
	BView::AllAttached();
}


void
BDragger::AllDetached()
{
	BView::AllDetached();
}


void
BDragger::Draw(BRect updateRect)
{
	if (_IsDrawn())
		Look::DrawDragHandle(this, Bounds().RightBottom(), Look::BaseColor(this));
}


void
BDragger::FrameMoved(BPoint newPosition)
{
	BView::FrameMoved(newPosition);
}


// The handle stays in its corner.
void
BDragger::FrameResized(float newWidth, float newHeight)
{
	Invalidate();
	BView::FrameResized(newWidth, newHeight);
}


BHandler*
BDragger::ResolveSpecifier(
	BMessage* message, int32 index, BMessage* specifier, int32 form, const char* property)
{
	return BView::ResolveSpecifier(message, index, specifier, form, property);
}


status_t
BDragger::GetSupportedSuites(BMessage* data)
{
	return BView::GetSupportedSuites(data);
}


status_t
BDragger::Perform(perform_code code, void* argument)
{
	return BView::Perform(code, argument);
}


void
BDragger::ResizeToPreferred()
{
	BView::ResizeToPreferred();
}


void
BDragger::GetPreferredSize(float* _width, float* _height)
{
	BView::GetPreferredSize(_width, _height);
}


void
BDragger::MakeFocus(bool focusState)
{
	BView::MakeFocus(focusState);
}


// #pragma mark - visibility


status_t
BDragger::ShowAllDraggers()
{
	DraggerList::SetDrawn(true);
	return B_OK;
}


status_t
BDragger::HideAllDraggers()
{
	DraggerList::SetDrawn(false);
	return B_OK;
}


bool
BDragger::AreDraggersDrawn()
{
	return DraggerList::IsDrawn();
}


bool
BDragger::IsVisibilityChanging() const
{
	return fIsVisibilityChanging;
}


bool
BDragger::_IsDrawn() const
{
	return AreDraggersDrawn() && (fShelf == NULL || fShelf->AllowsDragging());
}


// A dragger that holds its target stays, and only its handle goes.
void
BDragger::_UpdateVisibility()
{
	if (Window() == NULL)
		return;
	const bool hides = !_IsDrawn() && fRelation != kTargetIsChild;
	fIsVisibilityChanging = true;
	if (hides != fIsHiddenHandle) {
		fIsHiddenHandle = hides;
		if (hides)
			Hide();
		else
			Show();
	}
	fIsVisibilityChanging = false;
	Invalidate();
}
