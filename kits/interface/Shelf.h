// BShelf: makes a view take replicants, and keeps them.
#pragma once

#include <memory>
#include <vector>

#include <Handler.h>
#include <Point.h>
#include <Rect.h>

class BDataIO;
class BDragger;
class BEntry;
class BView;
struct entry_ref;

namespace BPrivate {
struct Replicant;
class ViewPrivate;
} // namespace BPrivate


// Takes the archives (B_ARCHIVED_OBJECT) that are dropped on its container view or on a view in it
// that does not want them, and makes child views of them. The shelf belongs to the program, the
// views belong to the container; a shelf outlives its container as an empty one. Use it under the
// container's window's lock, where it is a handler of that window. A replicant's numbers: its index
// is its place among the others, its id is its own as long as the shelf is kept.
class _EXPORT BShelf : public BHandler {
public:
	// The type becomes the shelf's name. What was saved in the file or stream comes back.
	BShelf(BView* view, bool allowDrags = true, const char* shelfType = NULL);
	BShelf(const entry_ref* ref, BView* view, bool allowDrags = true, const char* shelfType = NULL);
	// The stream stays the caller's and is read and written from its present position on.
	BShelf(BDataIO* stream, BView* view, bool allowDrags = true, const char* shelfType = NULL);
	// A shelf has no archive: it stays without a container.
	BShelf(BMessage* archive);
	// Saves what has changed.
	virtual ~BShelf();

	static BArchivable* Instantiate(BMessage* archive); // NULL
	virtual status_t Archive(BMessage* archive, bool deep = true) const; // B_ERROR

	virtual void MessageReceived(BMessage* message);

	// Writes all replicants as one flattened message; a file is replaced as a whole. B_ERROR when
	// no place was given.
	status_t Save();
	virtual void SetDirty(bool dirty);
	bool IsDirty() const;

	virtual BHandler* ResolveSpecifier(
		BMessage* message, int32 index, BMessage* specifier, int32 form, const char* property);
	virtual status_t GetSupportedSuites(BMessage* data);
	virtual status_t Perform(perform_code code, void* argument);

	// Whether replicants are dropped and moved by the user. Their handles are hidden if not.
	bool AllowsDragging() const;
	void SetAllowsDragging(bool allows);
	// Whether archives of unavailable classes are taken (usually so), and shown (usually not). Each
	// holds for what is added from then on. A zombie's archive is kept as it came.
	bool AllowsZombies() const;
	void SetAllowsZombies(bool allows);
	bool DisplaysZombies() const;
	void SetDisplaysZombies(bool displays);
	// Whether an archive whose "shelf_type" is not the shelf's name is refused.
	bool IsTypeEnforced() const;
	void SetTypeEnforced(bool enforced);

	status_t SetSaveLocation(BDataIO* stream);
	status_t SetSaveLocation(const entry_ref* ref);
	// The stream; NULL and *_ref when it is a file.
	BDataIO* SaveLocation(entry_ref* _ref) const;

	// The message is copied. The location is the left top corner in the container's coordinates.
	status_t AddReplicant(BMessage* archive, BPoint location);
	// B_BAD_VALUE when the shelf has no such replicant. Deletes its views.
	status_t DeleteReplicant(BView* replicant);
	status_t DeleteReplicant(BMessage* archive);
	status_t DeleteReplicant(int32 index);
	int32 CountReplicants() const;
	// The archive stays the shelf's. The error is B_OK unless the replicant is a zombie.
	BMessage* ReplicantAt(
		int32 index, BView** _view = NULL, uint32* _id = NULL, status_t* _error = NULL) const;
	// -1 when there is none. An archive is that which ReplicantAt() returns.
	int32 IndexOf(const BView* replicant) const;
	int32 IndexOf(const BMessage* archive) const;
	int32 IndexOf(uint32 id) const;

protected:
	// Asked before the view is made, and before it is added: its future frame in the container.
	virtual bool CanAcceptReplicantMessage(BMessage* archive) const;
	virtual bool CanAcceptReplicantView(BRect destination, BView* view, BMessage* archive) const;
	// By how much a replicant that is added or moved to that frame shall be shifted.
	virtual BPoint AdjustReplicantBy(BRect destination, BMessage* archive) const;
	// It is out of the list and of the container, and not yet deleted.
	virtual void ReplicantDeleted(int32 index, const BMessage* archive, const BView* replicant);

private:
	friend class BDragger;
	friend class BPrivate::ViewPrivate;
	friend class BView;

	struct Views; // of one replicant, on their way into the container

	void _Init(BView* view);
	void _ContainerGone();
	void _DraggerGone(const BDragger* dragger);
	status_t _Add(const BMessage& archive, const BPoint* location, uint32 id);
	status_t _CheckArchive(BMessage* archive) const;
	status_t _MakeViews(BPrivate::Replicant& replicant, Views& views) const;
	status_t _FindParts(const BMessage& archive, Views& views) const;
	status_t _Place(BPrivate::Replicant& replicant, Views& views, const BPoint* location);
	void _TakeDrop(BMessage* message);
	void _Move(BPrivate::Replicant& replicant, BPoint location, BMessage* message);
	BView* _ViewOf(const BPrivate::Replicant& replicant) const;
	BView* _TopOf(const BPrivate::Replicant& replicant) const;
	status_t _ArchiveReplicant(uint32 id, BMessage* archive) const;
	status_t _ArchiveReplicant(const BPrivate::Replicant& replicant, BMessage* archive) const;

	status_t _WriteTo(BMessage* saved) const;
	void _ReadFrom(const BMessage& saved);
	void _ReadStream(BDataIO* stream);
	status_t _SaveToFile(const char* bytes, size_t size) const;
	status_t _SaveToStream(const char* bytes, size_t size) const;
	bool _HandleProperty(BMessage* message);
	int32 _IndexOf(BMessage* specifier, int32 form) const;

	BView* fContainer = NULL; // borrowed; NULL once it is gone
	BDataIO* fStream = NULL; // borrowed
	off_t fStreamStart = 0;
	std::unique_ptr<entry_ref> fFile; // NULL when the shelf is not saved in a file
	BMessage fSaved; // what was read, for fields that others have put there
	std::vector<std::unique_ptr<BPrivate::Replicant>> fReplicants;
	uint32 fNextId = 1;
	bool fIsDirty = false;
	bool fAllowsDragging;
	bool fAllowsZombies = true;
	bool fDisplaysZombies = false;
	bool fIsTypeEnforced = false;
};
