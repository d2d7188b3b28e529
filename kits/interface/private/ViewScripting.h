// What views and windows answer to scripts.
#pragma once

#include <SupportDefs.h>

class BMessage;
class BView;
class BWindow;
struct property_info;

namespace BPrivate {


// The child that a specifier of the property "View" names; NULL if there is none.
BView* find_child(const BView* parent, BMessage* specifier, int32 form);
BView* find_child(const BWindow* parent, BMessage* specifier, int32 form);

// The property of the message's current specifier as an index into the list, or -1.
int32 match_property(property_info* properties, BMessage* message);

// Whether the message asked for a property of the class, and was answered.
bool handle_view_property(BView* view, BMessage* message);
bool handle_window_property(BWindow* window, BMessage* message);

} // namespace BPrivate
