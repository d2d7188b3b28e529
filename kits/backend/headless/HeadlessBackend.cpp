#include "backend/headless/HeadlessBackend.h"

#include <algorithm>
#include <cmath>
#include <cstdio>
#include <cstdlib>

#include "backend/ScreenPainter.h"
#include "backend/headless/HeadlessWindow.h"

namespace BPrivate {

namespace {

constexpr int32 kMaxScreenSide = 8192;

} // namespace


std::unique_ptr<Backend>
make_headless_backend()
{
	return std::make_unique<HeadlessBackend>();
}


HeadlessBackend::HeadlessBackend() = default;


HeadlessBackend::~HeadlessBackend() = default;


status_t
HeadlessBackend::Open(BackendSink* sink)
{
	fSink = sink;
	if (const char* size = std::getenv("ARCHWAY_SCREEN")) {
		int width = 0, height = 0;
		if (std::sscanf(size, "%dx%d", &width, &height) != 2 || width < 1 || height < 1
			|| width > kMaxScreenSide || height > kMaxScreenSide) {
			std::fprintf(stderr, "ARCHWAY_SCREEN=%s: a size such as 1600x1000 is expected\n", size);
			return B_BAD_VALUE;
		}
		fWidth = width;
		fHeight = height;
	}
	return scale_of_environment(&fScale);
}


void
HeadlessBackend::Run()
{
	while (!fStopped)
		fTasks.RunNext(B_INFINITE_TIMEOUT);
}


void
HeadlessBackend::Stop()
{
	fStopped = true;
}


void
HeadlessBackend::Post(std::function<void()> task)
{
	fTasks.Post(std::move(task));
}


void
HeadlessBackend::PostLater(bigtime_t delay, std::function<void()> task)
{
	fTasks.PostLater(delay, std::move(task));
}


void
HeadlessBackend::RunNested(bigtime_t timeout)
{
	fTasks.RunNext(timeout);
}


BRect
HeadlessBackend::ScreenFrame() const
{
	return BRect(0, 0, fWidth - 1, fHeight - 1);
}


// #pragma mark - windows


std::unique_ptr<BackendWindow>
HeadlessBackend::MakeWindow(FrontImage* image, const WindowTraits& traits)
{
	return std::make_unique<HeadlessWindow>(*this, image, traits);
}


BackendWindow*
HeadlessBackend::WindowAt(BPoint screen) const
{
	for (auto it = fWindows.rbegin(); it != fWindows.rend(); ++it) {
		if ((*it)->IsOnScreen() && (*it)->Contains(screen))
			return *it;
	}
	return nullptr;
}


void
HeadlessBackend::AddWindow(HeadlessWindow* window)
{
	fWindows.push_back(window);
	RaiseWindow(window);
}


void
HeadlessBackend::RemoveWindow(HeadlessWindow* window)
{
	std::erase(fWindows, window);
	if (fPressed == window)
		fPressed = nullptr;
	fDrag.WindowGone(window);
	if (fActive == window)
		SetActive(_NextActive());
}


void
HeadlessBackend::RaiseWindow(HeadlessWindow* window)
{
	std::erase(fWindows, window);
	const auto above = [window](HeadlessWindow* other) { return other->Layer() > window->Layer(); };
	fWindows.insert(std::find_if(fWindows.begin(), fWindows.end(), above), window);
}


void
HeadlessBackend::LowerWindow(HeadlessWindow* window, BackendWindow* behind)
{
	std::erase(fWindows, window);
	const auto place = std::find_if(fWindows.begin(), fWindows.end(), [&](HeadlessWindow* other) {
		return behind != nullptr ? other == behind : other->Layer() >= window->Layer();
	});
	fWindows.insert(place, window);
	if (fActive == window)
		SetActive(_NextActive());
}


void
HeadlessBackend::ShownChanged(HeadlessWindow* window)
{
	if (window->IsOnScreen()) {
		_Report(BackendEvent::Type::WindowShown, window);
		return;
	}
	if (fPressed == window)
		fPressed = nullptr;
	if (fActive == window)
		SetActive(_NextActive());
}


HeadlessWindow*
HeadlessBackend::_NextActive() const
{
	for (auto it = fWindows.rbegin(); it != fWindows.rend(); ++it) {
		if ((*it)->IsOnScreen() && (*it)->Traits().takesFocus)
			return *it;
	}
	return nullptr;
}


void
HeadlessBackend::SetActive(HeadlessWindow* window)
{
	if (fActive == window)
		return;
	fActive = window;
	_Report(BackendEvent::Type::WindowActivated, window);
}


void
HeadlessBackend::ReportFrame(HeadlessWindow* window)
{
	BackendEvent event;
	event.type = BackendEvent::Type::WindowChanged;
	event.window = window;
	event.frame = window->Traits().frame;
	fSink->HandleEvent(event);
}


void
HeadlessBackend::_Report(BackendEvent::Type type, HeadlessWindow* window)
{
	BackendEvent event;
	event.type = type;
	event.window = window;
	event.when = system_time();
	fSink->HandleEvent(event);
}


// #pragma mark - input


void
HeadlessBackend::Inject(const BackendEvent& event)
{
	using Type = BackendEvent::Type;

	BackendEvent entered = event;
	if (entered.when == 0)
		entered.when = system_time();

	switch (event.type) {
		case Type::PointerMoved:
		case Type::ButtonPressed:
		case Type::ButtonReleased:
		case Type::WheelTurned:
		case Type::PointerLeft:
			_InjectPointer(entered);
			break;

		case Type::FolderDropped:
			fDrag.DropOnFolder(entered, *fSink);
			break;

		case Type::WindowChanged:
			static_cast<HeadlessWindow*>(event.window)->TakeFrame(event.frame);
			break;

		case Type::WindowActivated:
			if (event.window != nullptr)
				static_cast<HeadlessWindow*>(event.window)->Activate();
			else
				SetActive(nullptr); // as if another program's window were active
			break;

		case Type::DragMoved:
		case Type::Dropped:
			fPointer = event.where;
			fSink->HandleEvent(entered);
			break;

		default:
			fSink->HandleEvent(entered);
			break;
	}
}


// The window of a press hears of the pointer until the last button is up, as on every desktop.
void
HeadlessBackend::_InjectPointer(BackendEvent event)
{
	using Type = BackendEvent::Type;

	fPointer = event.where;
	auto* under = static_cast<HeadlessWindow*>(WindowAt(event.where));
	if (fDrag.IsActive()) {
		fDrag.Follow(event, under, *fSink);
		return;
	}

	event.window = fPressed != nullptr ? fPressed : under;
	if (event.type == Type::ButtonPressed && fPressed == nullptr)
		fPressed = under;
	if (event.buttons == 0)
		fPressed = nullptr;
	fSink->HandleEvent(event);
}


// #pragma mark - drags


void
HeadlessBackend::SetDragPicture(const ScreenPicture* picture, BPoint offset)
{
	fDragPicture = picture != nullptr ? *picture : ScreenPicture();
	fDragOffset = offset;
}


bool
HeadlessBackend::StartDesktopDrag(const DataOffer& offer, int32 session, uint32 buttons)
{
	fDrag.Start(offer, session);
	fPressed = nullptr;
	return true;
}


// #pragma mark - clipboard and pictures


void
HeadlessBackend::SetClipboard(const DataOffer& offer)
{
	fClipboard = offer;
}


ScreenPicture
HeadlessBackend::Picture(BRect screen)
{
	ScreenPainter painter(screen, fScale);
	for (HeadlessWindow* window : fWindows) {
		if (window->IsOnScreen())
			painter.DrawWindow(window->Traits().frame, window->Image());
	}
	if (fDragPicture.width > 0)
		painter.DrawPicture(fPointer - fDragOffset, fDragPicture);
	return painter.Take();
}


} // namespace BPrivate
