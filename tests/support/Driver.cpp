#include "support/Driver.h"

#include <cstdio>
#include <cstdlib>

#include <Message.h>
#include <View.h>
#include <Window.h>

#include "backend/FolderDrop.h"
#include "backend/headless/HeadlessBackend.h"
#include "interface/private/WindowInternals.h"
#include "kernel/private/Activity.h"
#include "server/Desktop.h"
#include "server/DesktopThread.h"
#include "server/play/Picture.h"
#include "server/play/ScriptedInput.h"

using namespace BPrivate;

namespace {

constexpr bigtime_t kPatience = 60000000;


// The window stays locked for as long as its view is asked.
class WindowLock {
public:
	explicit WindowLock(BWindow* window) : fWindow(window)
	{
		if (fWindow == nullptr || !fWindow->Lock()) {
			std::fprintf(stderr, "Driver: the view is in no window\n");
			std::abort();
		}
	}

	~WindowLock() { fWindow->Unlock(); }

private:
	BWindow* fWindow; // borrowed
};

} // namespace


Driver::Driver() : fInput(std::make_unique<ScriptedInput>())
{
}


Driver::~Driver() = default;


BPoint
Driver::PointIn(BView* view, BPoint where)
{
	WindowLock lock(view->Window());
	return view->ConvertToScreen(where);
}


BPoint
Driver::MiddleOf(BView* view)
{
	WindowLock lock(view->Window());
	BRect visible = view->ConvertToScreen(view->Bounds());
	for (BView* parent = view->Parent(); parent != nullptr; parent = parent->Parent())
		visible = visible & parent->ConvertToScreen(parent->Bounds());
	visible = visible & view->Window()->Frame();
	if (!visible.IsValid()) {
		std::fprintf(stderr, "Driver: nothing of \"%s\" is visible\n", view->Name());
		std::abort();
	}
	return BPoint(
		(int32)((visible.left + visible.right) / 2), (int32)((visible.top + visible.bottom) / 2));
}


void
Driver::WaitUntilIdle()
{
	if (!wait_until_idle(kPatience)) {
		std::fprintf(stderr, "Driver: the program does not become idle\n");
		std::abort();
	}
}


void
Driver::_Wait() const
{
	if (fWait)
		WaitUntilIdle();
}


void
Driver::SetSpacing(bigtime_t spacing)
{
	fInput->SetSpacing(spacing);
}


bigtime_t
Driver::DoubleClickTime()
{
	return Desktop::Get()->DoubleClickTime();
}


// #pragma mark - mouse


void
Driver::MoveTo(BPoint screen, uint32 modifiers)
{
	_Wait();
	fInput->SetModifiers(modifiers);
	fInput->Move(screen);
	_Wait();
}


void
Driver::MoveTo(BView* view)
{
	_Wait();
	MoveTo(MiddleOf(view));
}


void
Driver::MoveTo(BView* view, BPoint where, uint32 modifiers)
{
	_Wait();
	MoveTo(PointIn(view, where), modifiers);
}


void
Driver::Press(uint32 button, uint32 modifiers, int32 clicks)
{
	_Wait();
	fInput->SetModifiers(modifiers);
	if (clicks == 1)
		fInput->BeginGesture();
	for (int32 i = 1; i < clicks; i++) {
		fInput->Press(button);
		fInput->Release(button);
	}
	fInput->Press(button);
	_Wait();
}


void
Driver::Release(uint32 button, uint32 modifiers)
{
	_Wait();
	fInput->SetModifiers(modifiers);
	fInput->Release(button);
	_Wait();
}


void
Driver::Click(BPoint screen, int32 times, uint32 button, uint32 modifiers)
{
	MoveTo(screen, modifiers);
	fInput->BeginGesture();
	for (int32 i = 0; i < times; i++) {
		fInput->Press(button);
		_Wait();
		fInput->Release(button);
		_Wait();
	}
	fInput->SetModifiers(0);
	_Wait();
}


void
Driver::Click(BView* view, int32 times, uint32 button, uint32 modifiers)
{
	_Wait();
	Click(MiddleOf(view), times, button, modifiers);
}


void
Driver::Click(BView* view, BPoint where, int32 times, uint32 button, uint32 modifiers)
{
	_Wait();
	Click(PointIn(view, where), times, button, modifiers);
}


void
Driver::Drag(BPoint from, BPoint to, int32 steps, uint32 button, uint32 modifiers)
{
	MoveTo(from, modifiers);
	Press(button, modifiers);
	for (int32 i = 1; i <= steps; i++) {
		const float part = static_cast<float>(i) / steps;
		MoveTo(BPoint((int32)(from.x + (to.x - from.x) * part),
				   (int32)(from.y + (to.y - from.y) * part)),
			modifiers);
	}
	Release(button, modifiers);
	fInput->SetModifiers(0);
	_Wait();
}


void
Driver::Drag(BView* from, BPoint fromWhere, BView* to, BPoint toWhere, int32 steps)
{
	_Wait();
	const BPoint start = PointIn(from, fromWhere);
	Drag(start, PointIn(to, toWhere), steps);
}


void
Driver::DropFile(const char* path, BPoint screen)
{
	const std::string list = uri_of_path(path) + "\r\n";
	BMessage data;
	data.AddData(
		"text/uri-list", B_MIME_TYPE, list.data(), static_cast<ssize_t>(list.size()), false);
	MoveTo(screen);
	for (const BackendEvent::Type type : { BackendEvent::Type::DragEntered,
			 BackendEvent::Type::DragMoved, BackendEvent::Type::Dropped }) {
		fInput->ForeignDrag(type, data);
		_Wait();
	}
}


void
Driver::Wheel(BPoint screen, float deltaX, float deltaY)
{
	MoveTo(screen);
	fInput->Wheel(BPoint(deltaX, deltaY));
	_Wait();
}


void
Driver::Wheel(BView* view, float deltaX, float deltaY)
{
	_Wait();
	Wheel(MiddleOf(view), deltaX, deltaY);
}


// #pragma mark - keyboard


void
Driver::Type(std::string_view utf8)
{
	while (!utf8.empty()) {
		const size_t length = character_length(utf8);
		const KeyStroke stroke = stroke_of_character(utf8.substr(0, length));
		_Wait();
		fInput->KeyDown(stroke);
		_Wait();
		fInput->KeyUp(stroke);
		utf8.remove_prefix(length);
	}
	_Wait();
}


void
Driver::Key(const char* name, uint32 modifiers, int32 times)
{
	for (int32 i = 0; i < times; i++) {
		KeyDown(name, modifiers);
		KeyUp(name, modifiers);
	}
	fInput->SetModifiers(0);
	_Wait();
}


void
Driver::KeyThatTypes(std::string_view bytes)
{
	const KeyStroke stroke { .text = std::string(bytes) };
	_Wait();
	fInput->KeyDown(stroke);
	_Wait();
	fInput->KeyUp(stroke);
	_Wait();
}


void
Driver::KeyDown(const char* name, uint32 modifiers)
{
	_Key(true, name, modifiers);
}


void
Driver::KeyUp(const char* name, uint32 modifiers)
{
	_Key(false, name, modifiers);
}


void
Driver::_Key(bool down, const char* name, uint32 modifiers)
{
	KeyStroke stroke;
	if (!stroke_of_name(name, &stroke)) {
		std::fprintf(stderr, "Driver: there is no key \"%s\"\n", name);
		std::abort();
	}
	_Wait();
	fInput->SetModifiers(modifiers);
	if (down)
		fInput->KeyDown(stroke);
	else
		fInput->KeyUp(stroke);
	_Wait();
}


// #pragma mark - windows


void
Driver::_Window(BWindow* window, BackendEvent event)
{
	_Wait();
	if (Desktop* desktop = Desktop::Get())
		desktop->Inject(event, WindowInternals::Of(window).server->Id());
	_Wait();
}


void
Driver::ResizeWindow(BWindow* window, float width, float height)
{
	const BPoint leftTop = window->Frame().LeftTop();
	BackendEvent event;
	event.type = BackendEvent::Type::WindowChanged;
	event.frame = BRect(leftTop.x, leftTop.y, leftTop.x + width, leftTop.y + height);
	_Window(window, event);
}


void
Driver::MoveWindow(BWindow* window, BPoint leftTop)
{
	BackendEvent event;
	event.type = BackendEvent::Type::WindowChanged;
	event.frame = window->Frame().OffsetToCopy(leftTop);
	_Window(window, event);
}


void
Driver::CloseWindow(BWindow* window)
{
	BackendEvent event;
	event.type = BackendEvent::Type::CloseRequested;
	_Window(window, event);
}


void
Driver::ActivateWindow(BWindow* window)
{
	BackendEvent event;
	event.type = BackendEvent::Type::WindowActivated;
	_Window(window, event);
}


int32
Driver::CountBeeps()
{
	WaitUntilIdle();
	int32 count = 0;
	Desktop* desktop = Desktop::Get();
	desktop->RunOnDisplay([desktop, &count] {
		count = dynamic_cast<HeadlessBackend&>(desktop->Thread().GetBackend()).CountBeeps();
	});
	return count;
}


// #pragma mark - pictures


int32
Driver::CursorAt(BPoint screen)
{
	_Wait();
	return Desktop::Get()->CursorAt(screen).id;
}


rgb_color
Driver::PixelAt(BPoint screen)
{
	_Wait();
	const BRect place(screen.x, screen.y, screen.x, screen.y);
	return color_at(Desktop::Get()->Picture(place), 0, 0);
}


rgb_color
Driver::PixelAt(BView* view, BPoint where)
{
	_Wait();
	return PixelAt(PointIn(view, where));
}


bool
Driver::Screenshot(const char* path)
{
	_Wait();
	Desktop* desktop = Desktop::Get();
	return desktop->SavePicture(path, desktop->ScreenFrame()) == B_OK;
}
