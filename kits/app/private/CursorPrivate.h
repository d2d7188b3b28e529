// CursorPrivate: a cursor in the desktop's terms.
#pragma once

#include <Cursor.h>

#include "server/CursorShape.h"

namespace BPrivate {


class CursorPrivate {
public:
	// The arrow for a cursor that is no good.
	static CursorShape Shape(const BCursor& cursor);
};


} // namespace BPrivate
