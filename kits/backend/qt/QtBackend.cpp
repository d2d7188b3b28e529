#include "backend/qt/QtBackend.h"

#include <algorithm>
#include <cmath>
#include <cstdio>

#include <QClipboard>
#include <QPixmap>
#include <QScreen>
#include <QTimer>

#include "backend/ScreenPainter.h"
#include "backend/qt/DragPicture.h"
#include "backend/qt/QtMime.h"
#include "backend/qt/QtWindow.h"
#include "server/paint/Surface.h"

namespace BPrivate {

namespace {

constexpr float kScaleStep = 0.25f;
constexpr qreal kUsualDpi = 96;

// The application keeps references to these.
char sName[] = "archway";
char* sArguments[] = { sName, nullptr };
int sArgumentCount = 1;


class TaskEvent : public QEvent {
public:
	static QEvent::Type Kind()
	{
		static const int kind = QEvent::registerEventType();
		return static_cast<QEvent::Type>(kind);
	}

	explicit TaskEvent(std::function<void()> task) : QEvent(Kind()), fTask(std::move(task)) {}
	void Run() { fTask(); }

private:
	std::function<void()> fTask;
};


// Qt warns of an application that is not made on the main thread, which is how this one works.
void
DropMessages(QtMsgType type, const QMessageLogContext& context, const QString& text)
{
	if (type == QtFatalMsg || type == QtCriticalMsg
		|| !text.contains(QLatin1String("main() thread")))
		std::fprintf(stderr, "%s\n", qPrintable(text));
}

} // namespace


std::unique_ptr<Backend>
make_qt_backend()
{
	return std::make_unique<QtBackend>();
}


QtBackend::QtBackend() = default;


QtBackend::~QtBackend()
{
	fDragPicture.reset();
}


status_t
QtBackend::Open(BackendSink* sink)
{
	fSink = sink;
	// Painting is sharp at every scale by itself.
	qputenv("QT_ENABLE_HIGHDPI_SCALING", "0");
	const QtMessageHandler before = qInstallMessageHandler(DropMessages);
	fApplication = std::make_unique<QGuiApplication>(sArgumentCount, sArguments);
	qInstallMessageHandler(before);
	QGuiApplication::setQuitOnLastWindowClosed(false);
	if (QGuiApplication::primaryScreen() == nullptr)
		return B_ERROR;

	_FindScale();
	const status_t status = scale_of_environment(&fScale);
	if (status != B_OK)
		return status;

	connect(fApplication.get(), &QGuiApplication::focusWindowChanged, this,
		[this](QWindow* window) { _FocusChanged(window); });
	const auto changed = [this](BackendEvent::Type type) {
		BackendEvent event;
		event.type = type;
		fSink->HandleEvent(event);
	};
	connect(QGuiApplication::clipboard(), &QClipboard::dataChanged, this,
		[changed] { changed(BackendEvent::Type::ClipboardChanged); });
	connect(QGuiApplication::primaryScreen(), &QScreen::geometryChanged, this,
		[changed] { changed(BackendEvent::Type::ScreenChanged); });
	return B_OK;
}


void
QtBackend::_FindScale()
{
	const QScreen* screen = QGuiApplication::primaryScreen();
	fRatio = static_cast<float>(screen->devicePixelRatio());
	const qreal dots = screen->logicalDotsPerInch() / kUsualDpi;
	const float scale = fRatio * static_cast<float>(dots);
	fScale = std::clamp(std::round(scale / kScaleStep) * kScaleStep, 1.0f, 4.0f);
}


// #pragma mark - the loop


void
QtBackend::Run()
{
	fApplication->exec();
}


void
QtBackend::Stop()
{
	QCoreApplication::quit();
}


void
QtBackend::Post(std::function<void()> task)
{
	QCoreApplication::postEvent(this, new TaskEvent(std::move(task)));
}


void
QtBackend::PostLater(bigtime_t delay, std::function<void()> task)
{
	QTimer::singleShot(static_cast<int>(delay / 1000), this, std::move(task));
}


void
QtBackend::RunNested(bigtime_t timeout)
{
	bool over = false;
	QTimer timer;
	timer.setSingleShot(true);
	connect(&timer, &QTimer::timeout, this, [&over] { over = true; });
	timer.start(static_cast<int>(timeout / 1000));
	QCoreApplication::processEvents(QEventLoop::AllEvents | QEventLoop::WaitForMoreEvents);
}


bool
QtBackend::event(QEvent* event)
{
	if (event->type() != TaskEvent::Kind())
		return QObject::event(event);
	static_cast<TaskEvent*>(event)->Run();
	return true;
}


// #pragma mark - coordinates


BRect
QtBackend::ScreenFrame() const
{
	// Only what is on it as a whole.
	const QRect screen = QGuiApplication::primaryScreen()->geometry();
	const float factor = fRatio / fScale;
	const float left = std::ceil(static_cast<float>(screen.x()) * factor);
	const float top = std::ceil(static_cast<float>(screen.y()) * factor);
	return BRect(left, top, left + std::floor(static_cast<float>(screen.width()) * factor) - 1,
		top + std::floor(static_cast<float>(screen.height()) * factor) - 1);
}


QRect
QtBackend::ToQt(BRect screen) const
{
	const auto edge = [this](float logical) {
		const int32 device = Surface::DeviceEdge(static_cast<int32>(std::floor(logical)), fScale);
		return static_cast<int>(std::lround(device / fRatio));
	};
	const int left = edge(screen.left), top = edge(screen.top);
	const int right = edge(screen.left + std::max(0.0f, screen.Width()) + 1);
	const int bottom = edge(screen.top + std::max(0.0f, screen.Height()) + 1);
	return QRect(left, top, std::max(1, right - left), std::max(1, bottom - top));
}


BRect
QtBackend::FromQt(const QRect& screen) const
{
	const float factor = fRatio / fScale;
	const float left = std::round(static_cast<float>(screen.x()) * factor);
	const float top = std::round(static_cast<float>(screen.y()) * factor);
	const float width = std::max(1.0f, std::round(static_cast<float>(screen.width()) * factor));
	const float height = std::max(1.0f, std::round(static_cast<float>(screen.height()) * factor));
	return BRect(left, top, left + width - 1, top + height - 1);
}


BPoint
QtBackend::FromQt(const QPointF& screen) const
{
	const auto logical = [this](qreal position) {
		const int32 device = static_cast<int32>(std::floor(position * fRatio));
		return static_cast<float>(Surface::LogicalAt(device, fScale));
	};
	return BPoint(logical(screen.x()), logical(screen.y()));
}


// #pragma mark - windows


std::unique_ptr<BackendWindow>
QtBackend::MakeWindow(FrontImage* image, const WindowTraits& traits)
{
	return std::make_unique<QtWindow>(*this, image, traits);
}


void
QtBackend::AddWindow(QtWindow* window)
{
	fWindows.push_back(window);
	const auto* active = dynamic_cast<QtWindow*>(QGuiApplication::focusWindow());
	window->FloatAbove(active != nullptr && active->Traits().kind != WindowTraits::Kind::Modal);
}


void
QtBackend::RemoveWindow(QtWindow* window)
{
	std::erase(fWindows, window);
	fSimulated.WindowGone(window);
	for (QtWindow** known : { &fActivated, &fRequested, &fGrabbing, &fScriptPressed }) {
		if (*known == window)
			*known = nullptr;
	}
}


BackendWindow*
QtBackend::WindowAt(BPoint screen) const
{
	const QRect place = ToQt(BRect(screen.x, screen.y, screen.x, screen.y));
	QWindow* top = QGuiApplication::topLevelAt(place.topLeft());
	if (fDragPicture == nullptr || top != fDragPicture.get())
		return dynamic_cast<QtWindow*>(top);

	// Where the picture's hole does not count: the one below it, as far as we know their order.
	const auto rank = [](const QtWindow& window) { return static_cast<int>(window.Traits().kind); };
	QtWindow* best = nullptr;
	for (QtWindow* window : fWindows) {
		const bool there = window->isVisible() && window->geometry().contains(place.topLeft());
		if (there && (best == nullptr || rank(*window) >= rank(*best)))
			best = window;
	}
	return best;
}


void
QtBackend::NoteRequest(QtWindow* window)
{
	fRequested = window;
}


void
QtBackend::_FocusChanged(QWindow* focus)
{
	auto* window = dynamic_cast<QtWindow*>(focus);
	if (window != nullptr) {
		std::erase(fWindows, window);
		fWindows.push_back(window);
		fActivated = window != fRequested ? window : nullptr;
		fActivatedAt = system_time();
	}
	fRequested = nullptr;
	const bool above = window != nullptr && window->Traits().kind != WindowTraits::Kind::Modal;
	for (QtWindow* other : fWindows)
		other->FloatAbove(above);
	fModifiers.Clear();
	_ReportModifiers();

	BackendEvent event;
	event.type = BackendEvent::Type::WindowActivated;
	event.window = window;
	fSink->HandleEvent(event);
}


// The desktop gives the keyboard to a window first and then hands it the press, which is older.
// Both clocks count milliseconds since the start of the system, the desktop's in 32 bits.
bool
QtBackend::ActivatedByPress(const BackendWindow* window) const
{
	if (fActivated == nullptr || fActivated != window || fPressTime == 0)
		return false;
	const auto since = static_cast<int32>(
		static_cast<uint32>(fActivatedAt / 1000) - static_cast<uint32>(fPressTime));
	return since >= 0 && since < 2000;
}


} // namespace BPrivate
