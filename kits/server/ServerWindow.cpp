#include "server/ServerWindow.h"

#include <algorithm>

#include "server/Desktop.h"
#include "server/DesktopThread.h"
#include "server/WindowRecord.h"
#include "server/input/MouseMessage.h"
#include "server/input/PointerInput.h"
#include "server/paint/Surface.h"

namespace BPrivate {

namespace {

constexpr int32 kMaxSide = 8000; // logical; with the scale it stays within a surface's limits


DesktopThread&
Display()
{
	return Desktop::Get()->Thread();
}


// A window always has a pixel, whatever size a program asks for; not even a number need it be.
int32
PixelsOf(float extent)
{
	return extent > 0 ? static_cast<int32>(std::min(extent, float(kMaxSide - 1))) + 1 : 1;
}

} // namespace


ServerWindow::ServerWindow(
	WindowClient* client, BRect frame, const char* title, uint32 look, uint32 feel, uint32 flags)
{
	WindowRecord::Properties properties;
	properties.title = title != nullptr ? title : "";
	properties.frame = frame;
	properties.look = look;
	properties.feel = feel;
	properties.flags = flags;
	fRecord = Display().AddWindow(client, properties);
	fBack = std::make_unique<Surface>();
	Prepare();
}


ServerWindow::~ServerWindow()
{
	fRecord->Detach();
	if (Desktop::Get() != nullptr)
		Display().RemoveWindow(fRecord);
}


uint32
ServerWindow::Id() const
{
	return fRecord->Id();
}


void
ServerWindow::SetTitle(const char* title)
{
	fRecord->Change([title](auto& properties) { properties.title = title ? title : ""; });
	Display().Post([window = fRecord] { Display().ApplyTraits(window); });
}


void
ServerWindow::SetKind(uint32 look, uint32 feel, uint32 flags)
{
	fRecord->Change([&](auto& properties) {
		properties.look = look;
		properties.feel = feel;
		properties.flags = flags;
	});
	Display().Post([window = fRecord] { Display().ApplyTraits(window); });
}


void
ServerWindow::SetSizeLimits(float minWidth, float maxWidth, float minHeight, float maxHeight)
{
	fRecord->Change([&](auto& properties) {
		properties.minWidth = minWidth;
		properties.maxWidth = maxWidth;
		properties.minHeight = minHeight;
		properties.maxHeight = maxHeight;
	});
	Display().Post([window = fRecord] { Display().ApplyTraits(window); });
}


void
ServerWindow::AddToSubset(const ServerWindow& main)
{
	Display().Post([window = fRecord, id = main.Id()] {
		window->subset.push_back(id);
		Display().UpdateOwners();
		Display().UpdateFloating();
	});
}


void
ServerWindow::RemoveFromSubset(const ServerWindow& main)
{
	Display().Post([window = fRecord, id = main.Id()] {
		std::erase(window->subset, id);
		Display().UpdateOwners();
		Display().UpdateFloating();
	});
}


BRect
ServerWindow::Frame() const
{
	return fRecord->Frame();
}


void
ServerWindow::SetFrame(BRect frame)
{
	fRecord->BeginFrame(frame);
	Display().Post([window = fRecord] {
		// Of several changes that wait the last one holds; it alone is applied and reported.
		if (window->FrameApplied())
			Display().ApplyTraits(window);
	});
}


void
ServerWindow::Show()
{
	fRecord->shown = true;
	Display().Post([window = fRecord] {
		Display().Show(window, true);
		Display().Activate(window);
	});
}


void
ServerWindow::Hide()
{
	fRecord->shown = false;
	Display().Post([window = fRecord] { Display().Show(window, false); });
}


void
ServerWindow::Minimize(bool minimize)
{
	Display().Post([window = fRecord, minimize] {
		if (window->native != nullptr)
			window->native->SetMinimized(minimize);
	});
}


void
ServerWindow::Activate(bool activate)
{
	Display().Post([window = fRecord, activate] {
		if (activate)
			Display().Activate(window);
		else if (window->native != nullptr)
			window->native->PutBehind(nullptr);
	});
}


void
ServerWindow::SendBehind(const ServerWindow* other)
{
	Display().Post([window = fRecord, behind = other != nullptr ? other->fRecord : nullptr] {
		if (window->native != nullptr)
			window->native->PutBehind(behind != nullptr ? behind->native.get() : nullptr);
	});
}


bool
ServerWindow::IsShown() const
{
	return fRecord->shown;
}


bool
ServerWindow::IsActive() const
{
	return fRecord->active;
}


bool
ServerWindow::IsFront() const
{
	return fRecord->inFront;
}


void
ServerWindow::SetWantsAllPointerEvents(bool wants)
{
	fRecord->wantsAllPointerEvents = wants;
	if (!fRecord->IsMenu())
		return;
	Display().Post([] { Display().Pointer().UpdateGrab(); });
}


void
ServerWindow::BeginInput(const BMessage& message)
{
	int32 press = 0;
	if (message.FindInt32(kPressField, &press) == B_OK)
		fRecord->handledPress = press;
}


void
ServerWindow::SetCursor(const CursorShape& shape)
{
	Display().Post([window = fRecord, shape] { Display().SetWindowCursor(window, shape); });
}


void
ServerWindow::SetTextSpot(BRect screen)
{
	Display().Post([window = fRecord, screen] {
		if (window->native != nullptr)
			window->native->SetTextSpot(screen);
	});
}


float
ServerWindow::Scale() const
{
	return Display().Scale();
}


Surface&
ServerWindow::Back()
{
	return *fBack;
}


bool
ServerWindow::Prepare()
{
	const BRect frame = Frame();
	const int32 width = PixelsOf(frame.Width());
	const int32 height = PixelsOf(frame.Height());
	const float scale = Scale();
	if (fBack->IsValid() && fBack->Width() == width && fBack->Height() == height
		&& fBack->Scale() == scale)
		return false;
	return fBack->Resize(width, height, scale) == B_OK;
}


void
ServerWindow::Present(const BRegion& damage)
{
	fRecord->Front().CopyFrom(*fBack, damage);
	if (!fRecord->flushPending.exchange(true))
		Display().Post([window = fRecord] { Display().Flush(window); });
}


} // namespace BPrivate
