// Mouse, keys and drags of views.
#include <View.h>

#include <algorithm>
#include <cmath>
#include <cstring>
#include <vector>

#include <AppDefs.h>
#include <Bitmap.h>
#include <Cursor.h>
#include <Message.h>
#include <Messenger.h>
#include <Window.h>

#include "app/private/Delivery.h"
#include "app/private/LooperPrivate.h"
#include "interface/private/BitmapAccess.h"
#include "interface/private/ViewPrivate.h"
#include "interface/private/ViewState.h"
#include "interface/private/WindowInternals.h"
#include "kernel/private/Activity.h"
#include "server/Desktop.h"

using namespace BPrivate;

namespace {

// How long a program that polls the mouse waits for news, so that it neither turns in circles nor
// keeps others waiting for it.
constexpr bigtime_t kPollPause = 10000;


// The bitmap's pixels, opaque unless the drag's mode looks at transparency.
std::vector<uint32>
drag_pixels(const Surface& image, drawing_mode mode)
{
	const auto width = static_cast<size_t>(image.Width());
	std::vector<uint32> pixels(width * image.Height());
	const bool keepsAlpha = mode != B_OP_COPY && image.Format() == SurfaceFormat::kAlpha;
	const bool hasClear = mode != B_OP_COPY && image.Format() == SurfaceFormat::kOpaque;
	const uint32 opaque = keepsAlpha ? 0 : 0xff000000;
	uint32* to = pixels.data();
	for (int32 y = 0; y < image.Height(); y++, to += width) {
		const uint32* row = image.Row(y);
		for (size_t x = 0; x < width; x++)
			to[x] =
				hasClear && (row[x] & 0xffffff) == B_TRANSPARENT_MAGIC_RGBA32 ? 0 : row[x] | opaque;
	}
	return pixels;
}

} // namespace


void
BView::MouseDown(BPoint where)
{
}


void
BView::MouseUp(BPoint where)
{
}


void
BView::MouseMoved(BPoint where, uint32 transit, const BMessage* dragMessage)
{
}


void
BView::KeyDown(const char* bytes, int32 numBytes)
{
	if (fOwner == nullptr || numBytes < 1 || bytes[0] != B_TAB)
		return;
	const BMessage* message = fOwner->CurrentMessage();
	const uint32 held =
		message != nullptr ? static_cast<uint32>(message->GetInt32("modifiers", 0)) : 0;
	WindowInternals::Of(fOwner).Navigate(
		this, (held & B_SHIFT_KEY) != 0, (held & B_CONTROL_KEY) != 0);
}


void
BView::KeyUp(const char* bytes, int32 numBytes)
{
}


void
BView::GetMouse(BPoint* location, uint32* buttons, bool checkMessageQueue)
{
	BPoint screen;
	uint32 held = 0;
	Desktop* desktop = Desktop::Get();
	if (fOwner == nullptr || desktop == nullptr || !_CheckOwnerLock()) {
		if (location != nullptr)
			*location = BPoint(0, 0);
		if (buttons != nullptr)
			*buttons = 0;
		return;
	}

	WindowInternals& internals = WindowInternals::Of(fOwner);
	Worker& activity = LooperPrivate(fOwner).Activity();
	const int32 knownWork = activity.CountWork();
	const uint32 serial = desktop->PointerSerial();
	if (!checkMessageQueue)
		desktop->GetMouse(&screen, &held);
	else if (!internals.TakePointer(&screen, &held)) {
		{
			WaitingScope waiting(&activity, knownWork);
			desktop->WaitForPointer(serial, kPollPause);
		}
		if (!internals.TakePointer(&screen, &held))
			internals.GetPointer(&screen, &held);
	}
	if (location != nullptr)
		*location = ConvertFromScreen(screen);
	if (buttons != nullptr)
		*buttons = held;
}


// #pragma mark - event masks


void
BView::SetEventMask(uint32 mask, uint32 options)
{
	const uint32 oldMask = fExtras != nullptr ? fExtras->eventMask : 0;
	const uint32 oldOptions = fExtras != nullptr ? fExtras->eventOptions : 0;
	if (mask == oldMask && options == oldOptions)
		return;
	_CheckLock();
	_Extras()->eventMask = mask;
	_Extras()->eventOptions = options;
	fTouched |= kTouchedEventMask;
	if (fOwner != nullptr)
		WindowInternals::Of(fOwner).EventMaskChanged(this);
}


uint32
BView::EventMask()
{
	return fExtras != nullptr ? fExtras->eventMask : 0;
}


void
BView::SetMouseEventMask(uint32 mask, uint32 options)
{
	if (fOwner == nullptr || !_CheckOwnerLock())
		return;
	WindowInternals& internals = WindowInternals::Of(fOwner);
	if (!internals.inMouseDown)
		return;
	_Extras()->mouseEventMask |= mask;
	_Extras()->mouseEventOptions |= options;
	internals.EventMaskChanged(this);
}


void
BView::SetViewCursor(const BCursor* cursor, bool sync)
{
	_CheckLock();
	if (cursor == nullptr && fExtras == nullptr)
		return;
	_Extras()->cursor = cursor != nullptr ? std::make_unique<BCursor>(*cursor) : nullptr;
	if (fOwner != nullptr)
		WindowInternals::Of(fOwner).ApplyCursor();
}


// #pragma mark - drags


void
BView::DragMessage(BMessage* message, BRect dragRect, BHandler* replyTo)
{
	BPoint pointer;
	GetMouse(&pointer, nullptr, false);
	_StartDrag(message, nullptr, B_OP_COPY, dragRect, pointer - dragRect.LeftTop(), replyTo);
}


void
BView::DragMessage(BMessage* message, BBitmap* bitmap, BPoint offset, BHandler* replyTo)
{
	DragMessage(message, bitmap, B_OP_COPY, offset, replyTo);
}


void
BView::DragMessage(
	BMessage* message, BBitmap* bitmap, drawing_mode dragMode, BPoint offset, BHandler* replyTo)
{
	_StartDrag(message, bitmap, dragMode, BRect(), offset, replyTo);
	delete bitmap;
}


bool
BView::_StartDrag(BMessage* message, BBitmap* bitmap, drawing_mode mode, BRect rect, BPoint offset,
	BHandler* replyTo)
{
	Desktop* desktop = Desktop::Get();
	if (message == nullptr || fOwner == nullptr || desktop == nullptr || !_CheckOwnerLock())
		return false;
	WindowInternals& internals = WindowInternals::Of(fOwner);
	if (internals.server == nullptr)
		return false;

	BHandler* source = replyTo != nullptr ? replyTo : this;
	if (source->Looper() == nullptr) {
		debugger("DragMessage(): the reply target must belong to a looper.");
		return false;
	}
	auto dragged = std::make_unique<BMessage>(*message);
	Delivery::Of(*dragged).replyTo = BMessenger(source);

	DragImage image;
	image.offset = offset;
	std::vector<uint32> pixels;
	if (bitmap != nullptr) {
		if (const std::shared_ptr<const Surface> surface = BitmapAccess::Pixels(*bitmap)) {
			pixels = drag_pixels(*surface, mode);
			image.bits = pixels.data();
			image.width = surface->Width();
			image.height = surface->Height();
			image.bytesPerRow = image.width * 4;
		}
	} else if (rect.IsValid()) {
		image.width = static_cast<int32>(std::ceil(rect.Width())) + 1;
		image.height = static_cast<int32>(std::ceil(rect.Height())) + 1;
	}
	internals.AwaitDrag();
	desktop->StartDrag(*internals.server, std::move(dragged), image);
	return true;
}


// #pragma mark - rectangle tracking


// The outline is drawn after the view itself, so that it needs no care when either changes.
void
BView::BeginRectTracking(BRect startRect, uint32 style)
{
	if (fOwner == nullptr || !_CheckOwnerLock())
		return;
	EndRectTracking();
	BPoint pointer;
	WindowInternals& internals = WindowInternals::Of(fOwner);
	GetMouse(&pointer, nullptr, false);
	_Extras()->tracking.reset(new RectTracking { startRect, startRect, pointer, style });
	internals.rectTracker = this;
	_InvalidateTracking();
}


void
BView::EndRectTracking()
{
	if (fExtras == nullptr || fExtras->tracking == nullptr)
		return;
	_InvalidateTracking();
	fExtras->tracking.reset();
	if (fOwner != nullptr && WindowInternals::Of(fOwner).rectTracker == this)
		WindowInternals::Of(fOwner).rectTracker = nullptr;
}


void
BView::_InvalidateTracking()
{
	const BRect rect = fExtras->tracking->rect;
	Invalidate(BRect(rect.left, rect.top, rect.right, rect.top));
	Invalidate(BRect(rect.left, rect.bottom, rect.right, rect.bottom));
	Invalidate(BRect(rect.left, rect.top, rect.left, rect.bottom));
	Invalidate(BRect(rect.right, rect.top, rect.right, rect.bottom));
}


// A corner that is dragged beyond the fixed one stops there.
void
RectTracking::Follow(BPoint pointer)
{
	rect = start;
	const BPoint way = pointer - pressed;
	if (style == B_TRACK_WHOLE_RECT) {
		rect.OffsetBy(way);
		return;
	}
	rect.right = std::max(rect.left, rect.right + way.x);
	rect.bottom = std::max(rect.top, rect.bottom + way.y);
}


void
ViewPrivate::TrackRect(BPoint screen)
{
	RectTracking& tracking = *Extras()->tracking;
	fView->_InvalidateTracking();
	tracking.Follow(fView->ConvertFromScreen(screen));
	fView->_InvalidateTracking();
}


void
ViewPrivate::DrawTracking()
{
	if (Extras() == nullptr || Extras()->tracking == nullptr)
		return;
	fView->PushState();
	fView->SetDrawingMode(B_OP_INVERT);
	fView->SetPenSize(1);
	fView->StrokeRect(Extras()->tracking->rect);
	fView->PopState();
}
