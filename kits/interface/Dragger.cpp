#include <Dragger.h>

#include <cmath>
#include <string>

#include <AppDefs.h>
#include <Beep.h>
#include <Bitmap.h>
#include <MenuItem.h>
#include <Message.h>
#include <MessageRunner.h>
#include <PopUpMenu.h>
#include <Shelf.h>
#include <Window.h>

#include "interface/private/ArchivedState.h"
#include "interface/private/DraggerList.h"
#include "interface/private/Look.h"
#include "interface/private/Replicants.h"
#include "interface/private/ViewArchive.h"
#include "interface/private/ViewPrivate.h"

namespace Look = BPrivate::Look;

using BPrivate::DraggerList;
using BPrivate::ViewPrivate;

namespace {

constexpr uint32 kHeld = '_DHL'; // from the timer of a press
constexpr float kDragDistance = 3; // pixels in one direction that make a press a drag


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
BDragger::MouseDown(BPoint where)
{
	const BMessage* message = Window() != NULL ? Window()->CurrentMessage() : NULL;
	if (message == NULL || !_IsDrawn() || _LiveTarget() == NULL)
		return;
	const int32 buttons = message->GetInt32("buttons", 0);
	if ((buttons & B_PRIMARY_MOUSE_BUTTON) == 0) {
		if (InShelf() && (buttons & B_SECONDARY_MOUSE_BUTTON) != 0)
			_ShowPopUp(where);
		return;
	}

	SetMouseEventMask(B_POINTER_EVENTS);
	fIsPressed = true;
	fPressed = where;
	bigtime_t delay;
	if (InShelf() && get_click_speed(&delay) == B_OK) {
		const BMessage held(kHeld);
		fHold = std::make_unique<BMessageRunner>(BMessenger(this), &held, delay, 1);
	}
}


void
BDragger::MouseUp(BPoint where)
{
	_EndPress();
	BView::MouseUp(where);
}


void
BDragger::MouseMoved(BPoint where, uint32 transit, const BMessage* dragMessage)
{
	const BPoint way = where - fPressed;
	if (fIsPressed && (std::abs(way.x) >= kDragDistance || std::abs(way.y) >= kDragDistance)) {
		_EndPress();
		_StartDrag();
	}
	BView::MouseMoved(where, transit, dragMessage);
}


void
BDragger::MessageReceived(BMessage* message)
{
	switch (message->what) {
		case _SHOW_DRAG_HANDLES_:
			_UpdateVisibility();
			break;

		case kHeld:
			// The button may have been released while the message waited.
			if (fIsPressed) {
				_EndPress();
				_ShowPopUp(fPressed);
			}
			break;

		case B_TRASH_TARGET:
			if (InShelf()) {
				BMessage removal(BPrivate::kRemoveReplicant);
				removal.AddInt32(BPrivate::kReplicantId, static_cast<int32>(fReplicant));
				BMessenger(fShelf).SendMessage(&removal);
			} else {
				beep(); // the original of a replicant stays
			}
			break;

		default:
			BView::MessageReceived(message);
			break;
	}
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


// #pragma mark - drags


BBitmap*
BDragger::DragBitmap(BPoint* _offset, drawing_mode* _mode)
{
	return NULL;
}


status_t
BDragger::_ArchiveReplicant(BMessage* archive) const
{
	const BView* target = _LiveTarget();
	if (target == NULL)
		return B_ERROR;
	const int32 relation = _RelationTo(target);
	if (relation == kTargetIsChild)
		return Archive(archive, true);
	status_t status = target->Archive(archive, true);
	if (status != B_OK || relation == kTargetIsParent)
		return status;
	// The dragger was left out, and what the target was made of may still have another one.
	BMessage own;
	status = Archive(&own, true);
	archive->RemoveName(BPrivate::kSiblingDragger);
	return status == B_OK ? archive->AddMessage(BPrivate::kSiblingDragger, &own) : status;
}


// Of what is dragged, in own coordinates.
BRect
BDragger::_ReplicantFrame() const
{
	const BView* target = _LiveTarget();
	switch (_RelationTo(target)) {
		case kTargetIsParent:
			return ConvertFromParent(target->Bounds());
		case kTargetIsSibling:
			return ConvertFromParent(target->Frame());
		default:
			return Bounds();
	}
}


void
BDragger::_StartDrag()
{
	BMessage dragged(B_ARCHIVED_OBJECT);
	const status_t status = fShelf != NULL ? fShelf->_ArchiveReplicant(fReplicant, &dragged)
										   : _ArchiveReplicant(&dragged);
	if (status != B_OK) {
		beep();
		return;
	}
	dragged.what = B_ARCHIVED_OBJECT;
	dragged.AddInt32("be:actions", B_TRASH_TARGET);

	BPoint offset;
	drawing_mode mode = B_OP_COPY;
	if (BBitmap* bitmap = DragBitmap(&offset, &mode)) {
		DragMessage(&dragged, bitmap, mode, offset, this);
		return;
	}
	// The pointer holds the outline where it was pressed, though it has moved since.
	BPoint pointer;
	GetMouse(&pointer, NULL, false);
	DragMessage(&dragged, _ReplicantFrame().OffsetByCopy(pointer - fPressed), this);
}


void
BDragger::_EndPress()
{
	fIsPressed = false;
	fHold.reset();
}


// #pragma mark - menu


status_t
BDragger::SetPopUp(BPopUpMenu* menu)
{
	if (menu == NULL && !fHasOwnPopUp && !fPopUpChanged) {
		fPopUpChanged = true;
		return B_OK;
	}
	if (menu != fPopUp.get())
		fPopUp.reset(menu);
	fHasOwnPopUp = menu != NULL;
	fPopUpChanged = true;
	return B_OK;
}


BPopUpMenu*
BDragger::PopUp() const
{
	if (fPopUp == nullptr)
		const_cast<BDragger*>(this)->_BuildPopUp();
	return fPopUp.get();
}


void
BDragger::_BuildPopUp()
{
	fPopUp = std::make_unique<BPopUpMenu>("Shelf", false, false);
	const BView* target = _LiveTarget();
	const char* name = target != NULL ? target->Name() : NULL;
	const std::string about =
		std::string("About ") + (name != NULL && name[0] != '\0' ? name : "Replicant") + "…";
	fPopUp->AddItem(new BMenuItem(about.c_str(), new BMessage(B_ABOUT_REQUESTED)));
	fPopUp->AddSeparatorItem();
	fPopUp->AddItem(new BMenuItem("Remove Replicant", new BMessage(BPrivate::kRemoveReplicant)));
}


// The usual menu is made anew, since the target's name and place may have changed.
void
BDragger::_ShowPopUp(BPoint where)
{
	if (!fHasOwnPopUp) {
		_BuildPopUp();
		fPopUp->ItemAt(0)->SetTarget(_LiveTarget());
		BMenuItem* removal = fPopUp->ItemAt(fPopUp->CountItems() - 1);
		removal->Message()->AddInt32(BPrivate::kReplicantId, static_cast<int32>(fReplicant));
		removal->SetTarget(fShelf);
	}
	PopUp()->Go(ConvertToScreen(where), true, true, true);
}
