// From the managed form to the nested one.

#include <cstring>
#include <vector>

#include <MessageForm.h>

#include "app/private/ManagedNote.h"
#include "app/private/MessagePrivate.h"
#include "support/private/ManagedArchive.h"
#include "support/private/ManagedFields.h"

namespace BPrivate {

namespace {

constexpr int32 kMostTries = 4; // to find places for tabs' views; one is enough for sound archives


class Unmanager {
public:
	explicit Unmanager(const BMessage& archive) : fOrigin(new ManagedOrigin)
	{
		fOrigin->root = archive;
		fOrigin->objectCount = count_of(archive, kObjects, B_MESSAGE_TYPE);
		fPlaced.resize(size_t(fOrigin->objectCount) + 1);
	}

	~Unmanager() { fOrigin->Release(); }

	status_t Convert(BMessage* archive)
	{
		if (is_ambiguous(*archive, kMark) || is_ambiguous(*archive, kObjects))
			return B_BAD_DATA;
		status_t status = _FindTabViews(*archive);
		if (status != B_OK)
			return status;
		BMessage nested;
		do {
			nested = *archive;
			fPlaced.assign(fPlaced.size(), false);
			fPlaced[0] = true;
			nested.RemoveName(kMark);
			nested.RemoveName(kObjects);
			status = _ConvertObject(&nested, 0, 0);
			if (status != B_OK)
				return status;
		} while (_GiveBackTabViews());
		for (size_t token = 0; token < fPlaced.size(); token++)
			fOrigin->hasForeignObjects |= !fPlaced[token];
		MessagePrivate(archive).SetData(MessagePrivate(&nested).Data());
		return B_OK;
	}

private:
	// The view of the tab in front is named twice. It belongs to its tab here.
	status_t _FindTabViews(const BMessage& root)
	{
		fIsTabView.resize(fPlaced.size());
		_NoteTabViews(root);
		BMessage object;
		for (int32 i = 0; i < fOrigin->objectCount; i++) {
			if (root.FindMessage(kObjects, i, &object) != B_OK)
				return B_BAD_DATA;
			_NoteTabViews(object);
		}
		return B_OK;
	}

	// A view that only an object without a place names as its tab's is a child like any other.
	// Whether there is one; none is found twice.
	bool _GiveBackTabViews()
	{
		bool found = false;
		for (size_t token = 0; token < fPlaced.size(); token++) {
			if (fIsTabView[token] && !fPlaced[token]) {
				fIsTabView[token] = false;
				found = true;
			}
		}
		return found && fTries++ < kMostTries;
	}

	void _NoteTabViews(const BMessage& object)
	{
		int32 token;
		for (int32 i = 0; object.FindInt32(kTabViews, i, &token) == B_OK; i++) {
			if (token > 0 && token <= fOrigin->objectCount)
				fIsTabView[size_t(token)] = true;
		}
	}

	status_t _ConvertObject(BMessage* object, int32 token, int32 depth)
	{
		const status_t status = _ConvertFields(object, depth);
		if (status != B_OK)
			return status;
		ManagedNote* note = new ManagedNote(fOrigin, token);
		set_note(object, note);
		note->Release();
		return B_OK;
	}

	status_t _ConvertFields(BMessage* object, int32 depth)
	{
		status_t status = B_OK;
		for (const char* name : kObjectFields) {
			if (is_ambiguous(*object, name))
				return B_BAD_DATA;
		}
		const bool hasTabs = count_of(*object, kTabs, B_INT32_TYPE) > 0;
		for (const char* name : kObjectFields) {
			if (status == B_OK)
				status =
					_ConvertField(object, name, hasTabs && strcmp(name, kTabViews) == 0, depth);
		}
		for (const char* name : kObjectFields) {
			if (status == B_OK && holds_objects(*object, name))
				status = _ConvertNested(object, name, depth);
		}
		return status;
	}

	// Children that lie in the archive as messages are objects of it too once it is written, so
	// what looks like tokens in them must be some.
	status_t _ConvertNested(BMessage* object, const char* name, int32 depth)
	{
		const int32 count = count_of(*object, name, B_MESSAGE_TYPE);
		BMessage child;
		for (int32 i = 0; i < count; i++) {
			// What cannot be read names nothing; what has been a token is done.
			if (object->FindMessage(name, i, &child) != B_OK || note_of(child) != nullptr)
				continue;
			status_t status = _ConvertFields(&child, depth + 1);
			if (status == B_OK)
				status = object->ReplaceMessage(name, i, &child);
			if (status != B_OK)
				return status;
		}
		return B_OK;
	}

	// Pages keep their numbers, so a tab without one gets an empty message. Other fields that name no
	// object at all are no lists of objects and stay as they are.
	status_t _ConvertField(BMessage* object, const char* name, bool ofPages, int32 depth)
	{
		const int32 count = count_of(*object, name, B_INT32_TYPE);
		if (count == 0)
			return B_OK;
		// Views cannot lie in each other deeper than messages can.
		if (depth >= B_MAX_MESSAGE_NESTING - 1)
			return B_BAD_DATA;

		BMessage children;
		bool namesNone = true;
		for (int32 i = 0; i < count; i++) {
			const int32 token = object->FindInt32(name, i);
			namesNone &= token < 0 && !ofPages;
			if (token < 0 ? !ofPages : _IsShownPage(name, token))
				continue;
			BMessage child;
			status_t status = token < 0 ? B_OK : _Place(token, &child, depth);
			if (status == B_OK)
				status = children.AddMessage(name, &child);
			if (status != B_OK)
				return status;
		}
		if (namesNone)
			return B_OK;
		return children.IsEmpty() ? object->RemoveName(name) : put_field(object, name, children);
	}

	// Whether a container names it only because it is the view of the tab in front.
	bool _IsShownPage(const char* name, int32 token) const
	{
		return strcmp(name, kViews) == 0 && token <= fOrigin->objectCount
			&& fIsTabView[size_t(token)];
	}

	status_t _Place(int32 token, BMessage* _object, int32 depth)
	{
		// An object in two places could not be written back.
		if (token == 0 || token > fOrigin->objectCount || fPlaced[size_t(token)])
			return B_BAD_DATA;
		fPlaced[size_t(token)] = true;
		const status_t status = fOrigin->root.FindMessage(kObjects, token - 1, _object);
		return status == B_OK ? _ConvertObject(_object, token, depth + 1) : status;
	}

	ManagedOrigin* fOrigin; // a reference
	std::vector<bool> fPlaced; // by token
	std::vector<bool> fIsTabView;
	int32 fTries = 0;
};

} // namespace


status_t
unmanage_archive(BMessage* archive)
{
	if (!is_managed_archive(*archive))
		return B_OK;
	return Unmanager(*archive).Convert(archive);
}


} // namespace BPrivate
