// The parts that a control is made of: children with names of their own.
#pragma once

#include <cstring>

#include <View.h>

namespace BPrivate {


// The child with that name, or NULL. FindView() would find the control itself, if it bears the name,
// and views that lie deeper.
inline BView*
inner_child(const BView* control, const char* name)
{
	for (BView* child = control->ChildAt(0); child != NULL; child = child->NextSibling()) {
		if (child->Name() != NULL && std::strcmp(child->Name(), name) == 0)
			return child;
	}
	return NULL;
}


} // namespace BPrivate
