// The replicants of a shelf: how they come, move and go.
#include <Shelf.h>

#include <cstring>

#include <AppDefs.h>
#include <Dragger.h>
#include <Entry.h>
#include <Message.h>
#include <Messenger.h>
#include <View.h>
#include <Window.h>

#include "interface/private/Look.h"
#include "interface/private/Replicants.h"
#include "interface/private/StandInView.h"

using BPrivate::Replicant;

namespace Look = BPrivate::Look;


// What becomes a child of the container; owned until it is.
struct BShelf::Views {
	std::unique_ptr<BView> top;
	std::unique_ptr<BDragger> sibling; // a dragger beside the top view
	BDragger* dragger = nullptr; // one of these two, or a child of the top view
	BView* target = nullptr; // the replicant itself: the top view or a child of it
};

namespace {

// What a drag has added is no part of the archive.
void
RemoveDragFields(BMessage* archive)
{
	for (const char* name : { "_drop_point_", "_drop_offset_", "buttons", "be:actions" })
		archive->RemoveName(name);
}


BDragger*
FindDragger(const BView* parent)
{
	for (BView* child = parent->ChildAt(0); child != NULL; child = child->NextSibling()) {
		if (BDragger* dragger = dynamic_cast<BDragger*>(child))
			return dragger;
	}
	return NULL;
}

} // namespace


// #pragma mark - adding


status_t
BShelf::AddReplicant(BMessage* archive, BPoint location)
{
	if (archive == NULL)
		return B_BAD_VALUE;
	return _Add(*archive, &location, fNextId);
}


// Without a location the replicant goes where its archive says.
status_t
BShelf::_Add(const BMessage& archive, const BPoint* location, uint32 id)
{
	if (fContainer == NULL)
		return B_NO_INIT;
	auto replicant = std::make_unique<Replicant>();
	replicant->id = id;
	replicant->archive = std::make_unique<BMessage>(archive);
	RemoveDragFields(replicant->archive.get());
	status_t status = _CheckArchive(replicant->archive.get());
	if (status != B_OK)
		return status;

	Views views;
	status = _MakeViews(*replicant, views);
	if (status == B_OK && views.top != nullptr)
		status = _Place(*replicant, views, location);
	else if (location != NULL)
		replicant->location = *location;
	if (status != B_OK)
		return status;

	if (id >= fNextId)
		fNextId = id + 1;
	fReplicants.push_back(std::move(replicant));
	SetDirty(true);
	return B_OK;
}


status_t
BShelf::_CheckArchive(BMessage* archive) const
{
	const char* type;
	if (fIsTypeEnforced && Name() != NULL && archive->FindString("shelf_type", &type) == B_OK
		&& std::strcmp(type, Name()) != 0)
		return B_MISMATCHED_VALUES;
	return CanAcceptReplicantMessage(archive) ? B_OK : B_ERROR;
}


// A replicant without views is a zombie that is not shown.
status_t
BShelf::_MakeViews(Replicant& replicant, Views& views) const
{
	BMessage archive(*replicant.archive);
	archive.RemoveName(BPrivate::kSiblingDragger);
	image_id image = B_ERROR;
	BArchivable* object = instantiate_object(&archive, &image);
	if (object != NULL) {
		views.top.reset(dynamic_cast<BView*>(object));
		if (views.top == nullptr) {
			delete object;
			return B_BAD_TYPE;
		}
		return _FindParts(*replicant.archive, views);
	}

	replicant.error = image < B_OK ? image : B_ERROR;
	replicant.isZombie = true;
	if (!fAllowsZombies)
		return replicant.error;
	if (fDisplaysZombies) {
		views.top = std::make_unique<BPrivate::StandInView>(&archive);
		return _FindParts(*replicant.archive, views);
	}
	return B_OK;
}


// The dragger is the archive's top view, a child of it, or came along as its sibling. A replicant
// that has none gets one as a child, or else nobody could move it.
status_t
BShelf::_FindParts(const BMessage& archive, Views& views) const
{
	BView* top = views.top.get();
	views.target = top;
	views.dragger = dynamic_cast<BDragger*>(top);
	if (views.dragger != NULL) {
		views.target = top->ChildAt(0);
		return views.target != NULL ? B_OK : B_BAD_VALUE;
	}
	views.dragger = FindDragger(top);
	if (views.dragger != NULL)
		return B_OK;

	BMessage own;
	if (archive.FindMessage(BPrivate::kSiblingDragger, &own) == B_OK) {
		BArchivable* object = instantiate_object(&own);
		views.sibling.reset(dynamic_cast<BDragger*>(object));
		if (views.sibling == nullptr)
			delete object;
	}
	if (views.sibling != nullptr) {
		views.dragger = views.sibling.get();
		return B_OK;
	}
	BRect frame = top->Bounds();
	frame.left = frame.right - Look::kDragHandleSize + 1;
	frame.top = frame.bottom - Look::kDragHandleSize + 1;
	views.dragger = new BDragger(frame, top, B_FOLLOW_RIGHT | B_FOLLOW_BOTTOM);
	top->AddChild(views.dragger);
	return B_OK;
}


// Brings the views to their place and gives them to the container.
status_t
BShelf::_Place(Replicant& replicant, Views& views, const BPoint* location)
{
	BView* top = views.top.get();
	BMessage* archive = replicant.archive.get();
	BRect frame = top->Frame();
	if (location != NULL)
		frame.OffsetTo(*location);
	if (!CanAcceptReplicantView(frame, views.target, archive))
		return B_ERROR;
	const BPoint way = frame.LeftTop() + AdjustReplicantBy(frame, archive) - top->Frame().LeftTop();

	top->MoveBy(way.x, way.y);
	fContainer->AddChild(views.top.release());
	if (views.sibling != nullptr) {
		// Of siblings that overlap, the first one gets the mouse.
		views.sibling->MoveBy(way.x, way.y);
		fContainer->AddChild(views.sibling.release(), top);
	}
	replicant.dragger = views.dragger;
	replicant.dragger->_SetTarget(views.target);
	replicant.dragger->_SetShelf(this, replicant.id);
	return B_OK;
}


// #pragma mark - drops


void
BShelf::_TakeDrop(BMessage* message)
{
	status_t status = B_NOT_ALLOWED;
	if (fAllowsDragging && fContainer != NULL) {
		BPoint offset;
		const BPoint screen = message->DropPoint(&offset);
		const BPoint location = fContainer->ConvertFromScreen(screen - offset);
		BLooper* looper;
		const BHandler* source = message->ReturnAddress().Target(&looper);
		for (const auto& replicant : fReplicants) {
			if (source != NULL && replicant->dragger == source) {
				_Move(*replicant, location, message);
				return;
			}
		}
		status = _Add(*message, &location, fNextId);
	}
	if (message->IsSourceWaiting()) {
		BMessage reply(B_REPLY);
		reply.AddInt32("error", status);
		message->SendReply(&reply);
	}
}


void
BShelf::_Move(Replicant& replicant, BPoint location, BMessage* message)
{
	BView* top = _TopOf(replicant);
	if (top == NULL)
		return;
	BRect frame = top->Frame();
	frame.OffsetTo(location);
	const BPoint way = frame.LeftTop() + AdjustReplicantBy(frame, message) - top->Frame().LeftTop();
	top->MoveBy(way.x, way.y);
	if (replicant.dragger->Parent() == fContainer && replicant.dragger != top)
		replicant.dragger->MoveBy(way.x, way.y);
	SetDirty(true);
}


// #pragma mark - looking up


int32
BShelf::CountReplicants() const
{
	return static_cast<int32>(fReplicants.size());
}


BMessage*
BShelf::ReplicantAt(int32 index, BView** _view, uint32* _id, status_t* _error) const
{
	const bool exists = index >= 0 && index < CountReplicants();
	const Replicant* replicant = exists ? fReplicants[index].get() : nullptr;
	if (_view != NULL)
		*_view = exists ? _ViewOf(*replicant) : NULL;
	if (_id != NULL)
		*_id = exists ? replicant->id : ~static_cast<uint32>(0);
	if (_error != NULL)
		*_error = exists ? replicant->error : B_BAD_INDEX;
	return exists ? replicant->archive.get() : NULL;
}


int32
BShelf::IndexOf(const BView* view) const
{
	for (int32 i = 0; view != NULL && i < CountReplicants(); i++) {
		if (_ViewOf(*fReplicants[i]) == view)
			return i;
	}
	return -1;
}


int32
BShelf::IndexOf(const BMessage* archive) const
{
	for (int32 i = 0; archive != NULL && i < CountReplicants(); i++) {
		if (fReplicants[i]->archive.get() == archive)
			return i;
	}
	return -1;
}


int32
BShelf::IndexOf(uint32 id) const
{
	for (int32 i = 0; i < CountReplicants(); i++) {
		if (fReplicants[i]->id == id)
			return i;
	}
	return -1;
}


// NULL for what is not shown, and for what the program has taken out of the container.
BView*
BShelf::_ViewOf(const Replicant& replicant) const
{
	return _TopOf(replicant) != NULL ? replicant.dragger->_LiveTarget() : NULL;
}


BView*
BShelf::_TopOf(const Replicant& replicant) const
{
	BDragger* dragger = replicant.dragger;
	BView* target = dragger != NULL ? dragger->_LiveTarget() : NULL;
	if (target == NULL)
		return NULL;
	BView* top = target->Parent() == dragger ? dragger : target;
	return top->Parent() == fContainer ? top : NULL;
}


// #pragma mark - removing


status_t
BShelf::DeleteReplicant(BView* replicant)
{
	return DeleteReplicant(IndexOf(replicant));
}


status_t
BShelf::DeleteReplicant(BMessage* archive)
{
	return DeleteReplicant(IndexOf(archive));
}


status_t
BShelf::DeleteReplicant(int32 index)
{
	if (index < 0 || index >= CountReplicants())
		return B_BAD_VALUE;
	const std::unique_ptr<Replicant> replicant = std::move(fReplicants[index]);
	fReplicants.erase(fReplicants.begin() + index);

	const BView* target = _ViewOf(*replicant);
	const std::unique_ptr<BView> top(_TopOf(*replicant));
	std::unique_ptr<BView> sibling;
	if (BDragger* dragger = replicant->dragger) {
		if (dragger != top.get() && dragger->Parent() == fContainer)
			sibling.reset(dragger);
		dragger->_SetShelf(NULL, 0);
	}
	for (BView* view : { top.get(), sibling.get() }) {
		if (view != NULL)
			view->RemoveSelf();
	}
	ReplicantDeleted(index, replicant->archive.get(), target);
	SetDirty(true);
	return B_OK;
}
