// ArchivedState: what the fields of an archived view say.
#pragma once

#include <Message.h>
#include <Rect.h>

#include "server/paint/DrawState.h"

namespace BPrivate {


// By the rules for missing and strange ones.
struct ArchivedState {
	static constexpr int32 kColors = 3; // high, low, view

	BRect frame { 0, 0, -1, -1 };
	uint32 mode = 0;
	uint32 flags = 0;
	uint32 eventMask = 0;
	uint32 eventOptions = 0;
	rgb_color colors[kColors] = { { 0, 0, 0, 255 }, { 255, 255, 255, 255 },
		{ 255, 255, 255, 255 } };
	int16 hideCount = 0;
	DrawState draw;
};

ArchivedState read_archived_state(const BMessage& archive);

// The form that a colour has in an archive.
uint32 packed(rgb_color color);
rgb_color unpacked(uint32 value);

// As far as archives say it.
bool same_font(const FontSpec& a, const FontSpec& b);
bool is_default(const DrawState& draw);


} // namespace BPrivate
