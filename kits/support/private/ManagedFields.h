// The fields of the managed form, and how both ways between the forms treat them.
#pragma once

#include <Message.h>

namespace BPrivate {

class ManagedNote;

inline constexpr const char* kMark = "_managed_archive";
inline constexpr const char* kObjects = "_managed_archivable";
inline constexpr const char* kViews = "_views";
inline constexpr const char* kTabs = "_l_items";
inline constexpr const char* kTabViews = "_view_list";
inline constexpr int32 kNoObject = -42;

// Fields that hold other objects of the archive: messages here, tokens in the managed form. They
// are visited in this order. A list view's items have the name of a tab view's tabs, but are
// messages in both forms.
inline constexpr const char* kObjectFields[] = { kViews, kTabs, kTabViews };

// Fields that hold tokens in both forms: of layouts and their items, which are no views.
inline constexpr const char* kTokenFields[] = { "BView:layout", "BTextControl:textViewItem",
	"BMenuField:labelItem", "BMenuField:barItem" };

int32 count_of(const BMessage& message, const char* name, type_code type);

// A tab view's tabs are objects of the archive; they come with the views behind them.
bool holds_objects(const BMessage& message, const char* name);

// Puts one field of the second message into the place of the field of that name, or adds it.
status_t put_field(BMessage* message, const char* name, const BMessage& from);

// Puts a field where the model has it: behind the nearest field in front of it that both have.
status_t put_field_like(
	BMessage* message, const BMessage& model, const char* name, const BMessage& from);

// Whether several fields have that name, so that nobody could say which holds the objects.
bool is_ambiguous(const BMessage& message, const char* name);

ManagedNote* note_of(const BMessage& message);

void set_note(BMessage* message, ManagedNote* note);

} // namespace BPrivate
