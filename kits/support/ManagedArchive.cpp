#include "support/private/ManagedArchive.h"

#include "app/private/ManagedNote.h"
#include "support/private/ManagedFields.h"

namespace BPrivate {


bool
is_managed_archive(const BMessage& archive)
{
	if (!archive.HasBool(kMark))
		return false;
	// Children that are there themselves, and no list: such a tree is nested whatever its mark says.
	return archive.HasMessage(kObjects)
		|| (count_of(archive, kViews, B_MESSAGE_TYPE) == 0
			&& count_of(archive, kTabViews, B_MESSAGE_TYPE) == 0);
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
