// BDragger: presses, drags and the menu.
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

#include "interface/private/Replicants.h"

namespace {

constexpr uint32 kHeld = '_DHL'; // from the timer of a press
constexpr float kDragDistance = 3; // pixels in one direction that make a press a drag

} // namespace


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
