#include "support/private/ManagedArchive.h"

#include <cstring>
#include <vector>

#include "app/private/ManagedNote.h"
#include "app/private/MessageData.h"
#include "app/private/MessagePrivate.h"
#include "app/private/TwinFields.h"

namespace BPrivate {

namespace {

constexpr const char* kMark = "_managed_archive";
constexpr int32 kMostTries = 4; // to find places for tabs' views; one is enough for sound archives
constexpr const char* kObjects = "_managed_archivable";
constexpr const char* kViews = "_views";
constexpr const char* kTabs = "_l_items";
constexpr const char* kTabViews = "_view_list";
constexpr int32 kNoObject = -42;

// Fields that hold other objects of the archive: messages here, tokens in the managed form. They
// are visited in this order. A list view's items have the name of a tab view's tabs, but are
// messages in both forms.
constexpr const char* kObjectFields[] = { kViews, kTabs, kTabViews };

// Fields that hold tokens in both forms: of layouts and their items, which are no views.
constexpr const char* kTokenFields[] = { "BView:layout", "BTextControl:textViewItem",
	"BMenuField:labelItem", "BMenuField:barItem" };


int32
count_of(const BMessage& message, const char* name, type_code type)
{
	type_code found;
	int32 count = 0;
	return message.GetInfo(name, &found, &count) == B_OK && found == type ? count : 0;
}


// A tab view's tabs are objects of the archive; they come with the views behind them.
bool
holds_objects(const BMessage& message, const char* name)
{
	return name != kTabs || count_of(message, kTabViews, B_MESSAGE_TYPE) > 0;
}


// Puts one field of the second message into the place of the field of that name, or adds it.
status_t
put_field(BMessage* message, const char* name, const BMessage& from)
{
	MessageData* data = MessagePrivate(message).OwnData();
	if (data == nullptr)
		return B_NO_MEMORY;
	const MessageData* source = MessagePrivate(&from).Data();
	const int32 field = source->Find(name);
	const int32 place = data->Find(name);
	return place < 0 ? data->CopyField(*source, uint32(field))
					 : data->CopyFieldOver(uint32(place), *source, uint32(field));
}


// Puts a field where the model has it: behind the nearest field in front of it that both have.
status_t
put_field_like(BMessage* message, const BMessage& model, const char* name, const BMessage& from)
{
	const MessageData* order = MessagePrivate(&model).Data();
	const MessageData* data = MessagePrivate(message).Data();
	const int32 place = order != nullptr ? order->Find(name) : -1;
	if (place < 0 || data == nullptr || data->Find(name) >= 0)
		return put_field(message, name, from);

	int32 before = -1;
	for (int32 i = place - 1; i >= 0 && before < 0; i--)
		before = corresponding_field(*data, *order, uint32(i));
	MessageData* arranged = MessageData::Create();
	if (arranged == nullptr)
		return B_NO_MEMORY;
	const MessageData* source = MessagePrivate(&from).Data();
	status_t status = B_OK;
	for (int32 i = -1; i < int32(data->CountFields()) && status == B_OK; i++) {
		if (i >= 0)
			status = arranged->CopyField(*data, uint32(i));
		if (i == before && status == B_OK)
			status = arranged->CopyField(*source, uint32(source->Find(name)));
	}
	if (status == B_OK) {
		arranged->SetNote(data->Note());
		MessagePrivate(message).SetData(arranged);
	}
	arranged->Release();
	return status;
}


// Whether several fields have that name, so that nobody could say which holds the objects.
bool
is_ambiguous(const BMessage& message, const char* name)
{
	const MessageData* data = MessagePrivate(&message).Data();
	const int32 field = data != nullptr ? data->Find(name) : -1;
	return field >= 0 && next_of_name(*data, uint32(field)) >= 0;
}


ManagedNote*
note_of(const BMessage& message)
{
	const MessageData* data = MessagePrivate(&message).Data();
	return data != nullptr ? data->Note() : nullptr;
}


void
set_note(BMessage* message, ManagedNote* note)
{
	// The note is part of the contents, so they must be this message's own.
	if (MessageData* data = MessagePrivate(message).OwnData())
		data->SetNote(note);
}


// #pragma mark - managed to nested


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
		for (const char* name : kObjectFields) {
			if (status == B_OK)
				status = _ConvertField(object, name, depth);
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

	status_t _ConvertField(BMessage* object, const char* name, int32 depth)
	{
		const int32 count = count_of(*object, name, B_INT32_TYPE);
		if (count == 0)
			return B_OK;
		// Views cannot lie in each other deeper than messages can.
		if (depth >= B_MAX_MESSAGE_NESTING - 1)
			return B_BAD_DATA;

		BMessage children;
		for (int32 i = 0; i < count; i++) {
			const int32 token = object->FindInt32(name, i);
			if (token < 0
				|| (name == kViews && token <= fOrigin->objectCount && fIsTabView[size_t(token)]))
				continue;
			// An object in two places could not be written back.
			if (token == 0 || token > fOrigin->objectCount || fPlaced[size_t(token)])
				return B_BAD_DATA;
			fPlaced[size_t(token)] = true;
			BMessage child;
			status_t status = fOrigin->root.FindMessage(kObjects, token - 1, &child);
			if (status == B_OK)
				status = _ConvertObject(&child, token, depth + 1);
			if (status == B_OK)
				status = children.AddMessage(name, &child);
			if (status != B_OK)
				return status;
		}
		return children.IsEmpty() ? object->RemoveName(name) : put_field(object, name, children);
	}

	ManagedOrigin* fOrigin; // a reference
	std::vector<bool> fPlaced; // by token
	std::vector<bool> fIsTabView;
	int32 fTries = 0;
};


// #pragma mark - nested to managed


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
	// Indices of the objects in each of kObjectFields.
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

	// Parents come first, in the order in which the form numbers its objects.
	Children _Collect(const BMessage& parent, int32 depth)
	{
		Children children;
		for (size_t f = 0; f < 3; f++) {
			if (!holds_objects(parent, kObjectFields[f]))
				continue;
			BMessage child;
			for (int32 i = 0; parent.FindMessage(kObjectFields[f], i, &child) == B_OK; i++) {
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
				tokens.AddInt32(name, fObjects[size_t(index)].token);
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
			const int32 token = message->FindInt32(name, i);
			if (token < 0)
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
			|| size_t(front) >= views.size())
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
		BMessage mark;
		mark.AddBool(kMark, true);
		const bool hadMark = fOrigin->root.FindBool(kMark);
		if (status == B_OK) {
			status = put_field_like(root, fOrigin->root, kMark, hadMark ? mark : fOrigin->root);
		}
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


// #pragma mark -


bool
is_managed_archive(const BMessage& archive)
{
	return archive.HasBool(kMark);
}


status_t
unmanage_archive(BMessage* archive)
{
	if (!is_managed_archive(*archive))
		return B_OK;
	return Unmanager(*archive).Convert(archive);
}


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


void
copy_managed_note(const BMessage& from, BMessage* to)
{
	if (note_of(from) != note_of(*to))
		set_note(to, note_of(from));
}


// Numbers into a list that is no longer there would name other objects one day.
void
clear_managed_note(BMessage* archive)
{
	if (note_of(*archive) == nullptr)
		return;
	set_note(archive, nullptr);
	for (const char* name : kTokenFields) {
		int32 token;
		for (int32 i = 0; archive->FindInt32(name, i, &token) == B_OK; i++) {
			if (token >= 0)
				archive->ReplaceInt32(name, i, kNoObject);
		}
	}
}


bool
has_managed_note(const BMessage& archive)
{
	return note_of(archive) != nullptr;
}


bool
is_managed_root(const BMessage& archive)
{
	return note_of(archive) != nullptr && note_of(archive)->Token() == 0;
}


bool
keeps_foreign_objects(const BMessage& archive)
{
	return note_of(archive) != nullptr && note_of(archive)->Origin()->hasForeignObjects;
}


} // namespace BPrivate
