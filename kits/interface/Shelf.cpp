#include <Shelf.h>

#include <cstdio>

#include <AppDefs.h>
#include <Debug.h>
#include <Dragger.h>
#include <Entry.h>
#include <Message.h>
#include <View.h>
#include <Window.h>

#include "interface/private/Replicants.h"
#include "interface/private/ViewPrivate.h"
#include "interface/private/ViewState.h"

using BPrivate::Replicant;
using BPrivate::ViewPrivate;


BShelf::BShelf(BView* view, bool allowDrags, const char* shelfType) :
	BHandler(shelfType), fAllowsDragging(allowDrags)
{
	_Init(view);
}


BShelf::BShelf(BMessage* archive) : BHandler(archive), fAllowsDragging(true)
{
}


BShelf::~BShelf()
{
	if (fContainer == NULL)
		return;
	if (IsDirty())
		Save();
	for (const auto& replicant : fReplicants) {
		if (replicant->dragger != nullptr)
			replicant->dragger->_SetShelf(NULL, 0);
	}
	ViewPrivate(fContainer).SetShelf(NULL);
}


BArchivable*
BShelf::Instantiate(BMessage* archive)
{
	return NULL;
}


status_t
BShelf::Archive(BMessage* archive, bool deep) const
{
	return B_ERROR;
}


void
BShelf::_Init(BView* view)
{
	fContainer = view;
	if (view == NULL) {
		debugger("BShelf: a shelf needs a container view.");
		return;
	}
	ViewPrivate(view).SetShelf(this);
}


// The container is being deleted, and the replicants' views with it.
void
BShelf::_ContainerGone()
{
	if (IsDirty())
		Save();
	for (const auto& replicant : fReplicants) {
		if (replicant->dragger != nullptr)
			replicant->dragger->_SetShelf(NULL, 0);
	}
	fReplicants.clear();
	if (Looper() != NULL)
		Looper()->RemoveHandler(this);
	fContainer = NULL;
}


// The program has deleted a replicant's view by itself.
void
BShelf::_DraggerGone(const BDragger* dragger)
{
	for (const auto& replicant : fReplicants) {
		if (replicant->dragger == dragger)
			replicant->dragger = nullptr;
	}
}


// #pragma mark - messages


void
BShelf::MessageReceived(BMessage* message)
{
	switch (message->what) {
		case B_ARCHIVED_OBJECT:
			if (message->WasDropped())
				_TakeDrop(message);
			else
				BHandler::MessageReceived(message);
			break;

		case BPrivate::kRemoveReplicant: {
			int32 id;
			if (message->FindInt32(BPrivate::kReplicantId, &id) == B_OK)
				DeleteReplicant(IndexOf(static_cast<uint32>(id)));
			break;
		}

		case B_COUNT_PROPERTIES:
		case B_CREATE_PROPERTY:
		case B_DELETE_PROPERTY:
		case B_GET_PROPERTY:
			if (!_HandleProperty(message))
				BHandler::MessageReceived(message);
			break;

		default:
			BHandler::MessageReceived(message);
			break;
	}
}


status_t
BShelf::Perform(perform_code code, void* argument)
{
	return BHandler::Perform(code, argument);
}


// #pragma mark - settings


void
BShelf::SetDirty(bool dirty)
{
	fIsDirty = dirty;
}


bool
BShelf::IsDirty() const
{
	return fIsDirty;
}


bool
BShelf::AllowsDragging() const
{
	return fAllowsDragging;
}


void
BShelf::SetAllowsDragging(bool allows)
{
	fAllowsDragging = allows;
	for (const auto& replicant : fReplicants) {
		if (replicant->dragger != nullptr)
			replicant->dragger->_UpdateVisibility();
	}
}


bool
BShelf::AllowsZombies() const
{
	return fAllowsZombies;
}


void
BShelf::SetAllowsZombies(bool allows)
{
	fAllowsZombies = allows;
}


bool
BShelf::DisplaysZombies() const
{
	return fDisplaysZombies;
}


void
BShelf::SetDisplaysZombies(bool displays)
{
	fDisplaysZombies = displays;
}


bool
BShelf::IsTypeEnforced() const
{
	return fIsTypeEnforced;
}


void
BShelf::SetTypeEnforced(bool enforced)
{
	fIsTypeEnforced = enforced;
}


// #pragma mark - hooks


bool
BShelf::CanAcceptReplicantMessage(BMessage* archive) const
{
	return true;
}


bool
BShelf::CanAcceptReplicantView(BRect destination, BView* view, BMessage* archive) const
{
	return true;
}


BPoint
BShelf::AdjustReplicantBy(BRect destination, BMessage* archive) const
{
	return BPoint(0, 0);
}


void
BShelf::ReplicantDeleted(int32 index, const BMessage* archive, const BView* replicant)
{
}
