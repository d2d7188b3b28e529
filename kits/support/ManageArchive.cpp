// From the nested form back to the managed one.

#include <cstring>
#include <vector>

#include "app/private/ManagedNote.h"
#include "app/private/MessagePrivate.h"
#include "support/private/ManagedArchive.h"
#include "support/private/ManagedFields.h"

namespace BPrivate {

namespace {

class Manager {
public:
	explicit Manager(ManagedOrigin* origin) :
		fOrigin(origin), fNewToken(size_t(origin->objectCount) + 1, kNoObject)
	{
	}

	status_t Convert(BMessage* archive)
	{
		_Collect(*archive, 0);
		_NumberObjects();
		status_t status = _MakeObjects(*archive);
		BMessage root = *archive;
		if (status == B_OK)
			status = _ConvertObject(&root, fRootChildren, fOrigin->root);
		if (status == B_OK)
			status = _AddObjects(&root);
		if (status != B_OK)
			return status;
		clear_note(&root);
		MessagePrivate(archive).SetData(MessagePrivate(&root).Data());
		return B_OK;
	}

private:
	// Indices of the objects in each of kObjectFields, kNoObject for the page that a tab lacks.
	struct Children {
		std::vector<int32> objects[3];
	};

	struct Object {
		BMessage message;
		int32 oldToken; // kNoObject for a new one
		int32 token;
		Children children;
	};

	static void clear_note(BMessage* message) { set_note(message, nullptr); }

	static bool is_no_page(const BMessage& view)
	{
		return view.IsEmpty() && view.what == 0 && note_of(view) == nullptr;
	}

	// False for an item that names nothing: it is negative, or has another size.
	static bool find_token(const BMessage& object, const char* name, int32 index, int32* _token)
	{
		const void* data;
		ssize_t size;
		if (object.FindData(name, B_INT32_TYPE, index, &data, &size) != B_OK
			|| size != sizeof(*_token))
			return false;
		std::memcpy(_token, data, sizeof(*_token));
		return *_token >= 0;
	}

	// Parents come first, in the order in which the form numbers its objects.
	Children _Collect(const BMessage& parent, int32 depth)
	{
		Children children;
		for (size_t f = 0; f < 3; f++) {
			if (!holds_objects(parent, kObjectFields[f]))
				continue;
			const bool ofPages =
				strcmp(kObjectFields[f], kTabViews) == 0 && !children.objects[1].empty();
			BMessage child;
			for (int32 i = 0; parent.FindMessage(kObjectFields[f], i, &child) == B_OK; i++) {
				if (ofPages && is_no_page(child)) {
					children.objects[f].push_back(kNoObject);
					continue;
				}
				const auto index = int32(fObjects.size());
				fObjects.push_back({ child, _OldToken(child), kNoObject, {} });
				children.objects[f].push_back(index);
				Children below = _Collect(child, depth + 1);
				fObjects[size_t(index)].children = std::move(below);
			}
		}
		if (depth == 0)
			fRootChildren = children;
		return children;
	}

	// An object that is there twice, as after copying a view, is new the second time.
	int32 _OldToken(const BMessage& object)
	{
		const ManagedNote* note = note_of(object);
		if (note == nullptr || note->Origin() != fOrigin || note->Token() <= 0
			|| note->Token() > fOrigin->objectCount
			|| fNewToken[size_t(note->Token())] != kNoObject)
			return kNoObject;
		fNewToken[size_t(note->Token())] = 0; // taken
		return note->Token();
	}

	// What was read keeps its order, and its numbers too if nothing has gone; what is new follows.
	void _NumberObjects()
	{
		std::vector<int32> byOldToken(fNewToken.size(), -1);
		for (size_t i = 0; i < fObjects.size(); i++) {
			if (fObjects[i].oldToken > 0)
				byOldToken[size_t(fObjects[i].oldToken)] = int32(i);
		}
		int32 next = 1;
		for (int32 old = 1; old <= fOrigin->objectCount; old++) {
			const int32 index = byOldToken[size_t(old)];
			if (index < 0 && !_IsForeign(old))
				continue;
			fNewToken[size_t(old)] = next;
			fOrder.push_back(index >= 0 ? index : -old);
			if (index >= 0)
				fObjects[size_t(index)].token = next;
			next++;
		}
		for (size_t i = 0; i < fObjects.size(); i++) {
			if (fObjects[i].oldToken > 0)
				continue;
			fOrder.push_back(int32(i));
			fObjects[i].token = next++;
		}
		fNewToken[0] = 0;
	}

	// Whether an object was read that is not in the tree below the root.
	bool _IsForeign(int32 token)
	{
		if (fIsPlaced.empty()) {
			fIsPlaced.resize(fNewToken.size());
			std::vector<int32> found;
			_NotePlaced(fOrigin->root, &found);
			while (!found.empty()) {
				const int32 next = found.back();
				found.pop_back();
				BMessage object;
				if (fOrigin->root.FindMessage(kObjects, next - 1, &object) == B_OK)
					_NotePlaced(object, &found);
			}
		}
		return !fIsPlaced[size_t(token)];
	}

	void _NotePlaced(const BMessage& object, std::vector<int32>* _found)
	{
		for (const char* name : kObjectFields) {
			int32 token;
			for (int32 i = 0; object.FindInt32(name, i, &token) == B_OK; i++) {
				if (token > 0 && token <= fOrigin->objectCount && !fIsPlaced[size_t(token)]) {
					fIsPlaced[size_t(token)] = true;
					_found->push_back(token);
				}
			}
		}
	}

	status_t _MakeObjects(const BMessage& root)
	{
		status_t status = B_OK;
		for (size_t i = 0; i < fObjects.size() && status == B_OK; i++) {
			Object& object = fObjects[i];
			BMessage model = object.message;
			if (object.oldToken > 0)
				fOrigin->root.FindMessage(kObjects, object.oldToken - 1, &model);
			status = _ConvertObject(&object.message, object.children, model);
		}
		for (size_t i = 0; i < fObjects.size() && status == B_OK; i++)
			status = _RestoreFrontTab(fObjects[i].message, fObjects[i].children);
		if (status == B_OK)
			status = _RestoreFrontTab(root, fRootChildren);
		return status;
	}

	// Children as tokens, and the tokens of other objects by their new numbers.
	status_t _ConvertObject(BMessage* message, const Children& children, const BMessage& model)
	{
		status_t status = B_OK;
		for (size_t f = 0; f < 3 && status == B_OK; f++) {
			const char* name = kObjectFields[f];
			if (children.objects[f].empty())
				continue;
			BMessage tokens;
			for (int32 index : children.objects[f])
				tokens.AddInt32(name, index < 0 ? kNoObject : fObjects[size_t(index)].token);
			status = put_field(message, name, tokens);
		}
		const bool isOfOrigin =
			note_of(*message) != nullptr && note_of(*message)->Origin() == fOrigin;
		for (const char* name : kTokenFields) {
			if (status == B_OK)
				status = _Renumber(message, name, isOfOrigin);
		}
		if (status == B_OK && note_of(*message) != nullptr)
			clear_note(message);
		return status;
	}

	status_t _Renumber(BMessage* message, const char* name, bool isOfOrigin)
	{
		status_t status = B_OK;
		const int32 count = count_of(*message, name, B_INT32_TYPE);
		for (int32 i = 0; i < count && status == B_OK; i++) {
			int32 token;
			if (!find_token(*message, name, i, &token))
				continue;
			// A number from somewhere else names nothing here.
			const bool known = isOfOrigin && token <= fOrigin->objectCount;
			const int32 newToken = known ? fNewToken[size_t(token)] : kNoObject;
			if (newToken != token)
				status = message->ReplaceInt32(name, i, newToken);
		}
		return status;
	}

	// An object that is kept as it was read names others by numbers alone.
	status_t _RenumberForeign(BMessage* object)
	{
		status_t status = B_OK;
		for (const char* name : kObjectFields) {
			if (status == B_OK)
				status = _Renumber(object, name, true);
		}
		for (const char* name : kTokenFields) {
			if (status == B_OK)
				status = _Renumber(object, name, true);
		}
		return status;
	}

	// The managed form shows the view of the tab in front inside the tab view's container too.
	status_t _RestoreFrontTab(const BMessage& tabView, const Children& children)
	{
		const std::vector<int32>& views = children.objects[2];
		const int32 front = tabView.FindInt32("_sel");
		if (children.objects[0].empty() || !tabView.HasInt32("_sel") || front < 0
			|| size_t(front) >= views.size() || views[size_t(front)] < 0)
			return B_OK;

		Object& container = fObjects[size_t(children.objects[0][0])];
		BMessage model;
		if (container.oldToken > 0)
			fOrigin->root.FindMessage(kObjects, container.oldToken - 1, &model);
		BMessage tokens;
		tokens.AddInt32(kViews, fObjects[size_t(views[size_t(front)])].token);
		return put_field_like(&container.message, model, kViews, tokens);
	}

	status_t _AddObjects(BMessage* root)
	{
		BMessage list;
		for (int32 index : fOrder) {
			BMessage object;
			status_t status = B_OK;
			if (index >= 0)
				object = fObjects[size_t(index)].message;
			else {
				status = fOrigin->root.FindMessage(kObjects, -index - 1, &object);
				if (status == B_OK)
					status = _RenumberForeign(&object);
			}
			if (status == B_OK)
				status = list.AddMessage(kObjects, &object);
			if (status != B_OK)
				return status;
		}
		status_t status = B_OK;
		if (!fOrder.empty())
			status = put_field_like(root, fOrigin->root, kObjects, list);
		if (status == B_OK)
			status = put_field_like(root, fOrigin->root, kMark, fOrigin->root);
		return status;
	}

	ManagedOrigin* fOrigin; // borrowed
	std::vector<int32> fNewToken; // by the one that was read
	std::vector<bool> fIsPlaced;
	std::vector<Object> fObjects;
	std::vector<int32> fOrder; // of the list: an object, or the negative token of a kept one
	Children fRootChildren;
};

} // namespace


status_t
manage_archive(BMessage* archive)
{
	if (!is_managed_root(*archive))
		return B_OK;
	ManagedOrigin* origin = note_of(*archive)->Origin();
	origin->Acquire();
	const status_t status = Manager(origin).Convert(archive);
	origin->Release();
	return status;
}


} // namespace BPrivate
