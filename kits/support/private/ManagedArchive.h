// The managed form of a deep archive: children as numbers into a list that the root carries.
#pragma once

#include <Message.h>

namespace BPrivate {


// Whether the message is a managed archive's root: it carries the mark, and its children, if it has
// any, are not nested.
bool is_managed_archive(const BMessage& archive);

// Turns a managed archive into the nested form in place: each token of "_views", and of a tab view's
// "_l_items" and "_view_list", becomes the message that it names. A page that both "_view_list" and
// the tab view's container name is left in "_view_list" only, as the nested form has it, and goes
// into both again on the way back (the container of the selected page, "_sel"). A tab without a
// page, a negative token, has an empty message there; a list of negative tokens alone stays. A note
// stays with the message and with each child (no field: it is not flattened, and goes along with
// copies) of where it came from, and with the root of all objects that are no children of a view.
// B_BAD_DATA, and nothing is changed, for a token that is out of range, or would put a view into
// itself or into two places, and when several fields have one of these names. Does nothing to an
// archive that is not managed. instantiate_object() does this before the class sees the archive, and
// gives the caller's message back as it was.
status_t unmanage_archive(BMessage* archive);

// The opposite, for a tree whose root carries a note: collects the children below "_views" into the
// list in the order that the form asks for (unchanged trees: the order that was read) and
// renumbers every token field through one map. A child without a note is new; one with a note of
// another archive too.
status_t manage_archive(BMessage* archive);

// The note of where an archive came from. Give a freshly written archive the note of its source,
// child and root alike, before the parent adds it to "_views".
void copy_managed_note(const BMessage& from, BMessage* to);
void clear_managed_note(BMessage* archive);
bool has_managed_note(const BMessage& archive); // any
bool is_managed_root(const BMessage& archive); // of the root

// Whether objects that are no views, and may hold tokens in fields that we do not know, are kept.
bool keeps_foreign_objects(const BMessage& archive);


} // namespace BPrivate
