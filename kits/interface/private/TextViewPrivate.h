// What the sources of BTextView share.
#pragma once

#include <MessageRunner.h>
#include <Messenger.h>
#include <TextView.h>

namespace BPrivate {

constexpr bigtime_t kBlinkTime = 450000; // microseconds; a little less than a pulse
constexpr uint32 kAutoScroll = '_TAS';
constexpr const char* kTextType = "text/plain";
constexpr const char* kRunsType = "application/x-vnd.Be-text_run_array";

// Checks everything against the size; NULL for what is no run array.
text_run_array* unflatten_runs(const void* data, ssize_t size);

} // namespace BPrivate


// What an input method composes.
struct BTextView::Composition {
	int32 offset = 0; // of the composed text
	int32 length = 0; // bytes
	BMessenger method; // who asks where the characters are; may be invalid
};


// A press of the mouse until its release.
struct BTextView::Tracking {
	BPoint press;
	int32 from, to; // what the press itself selected
	int32 clicks; // 1 to 3
	bool mayDrag; // the press hit the selection and has not moved yet
	std::unique_ptr<BMessageRunner> scroller; // while the pointer is outside
};
