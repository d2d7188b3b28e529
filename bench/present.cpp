// From painted to shown: a window's present against a bare program that draws an image to a backing
// store. Both paint in a thread of their own and flush on the display thread. Needs a display; run
// it with QT_QPA_PLATFORM=offscreen where there is none.

#include <cstdlib>
#include <memory>

#include <QBackingStore>
#include <QImage>
#include <QPainter>
#include <QWindow>

#include "SideBySide.h"
#include "kernel/private/Activity.h"
#include "server/Desktop.h"
#include "server/ServerWindow.h"
#include "server/WindowRecord.h"
#include "server/paint/Surface.h"

using namespace BPrivate;

namespace {

constexpr int kWidth = 1200, kHeight = 700;


class Silent : public WindowClient, public ApplicationClient {
public:
	void PostInput(BMessage* message) override { delete message; }
	void PostToApplication(BMessage* message) override { delete message; }
};


struct Bare {
	QWindow window;
	std::unique_ptr<QBackingStore> store;
	QImage image { kWidth, kHeight, QImage::Format_RGB32 };

	Bare()
	{
		window.setSurfaceType(QSurface::RasterSurface);
		window.resize(kWidth, kHeight);
		store = std::make_unique<QBackingStore>(&window);
		store->resize(QSize(kWidth, kHeight));
		window.show();
	}

	void Show(const QRect& part)
	{
		store->beginPaint(part);
		{
			QPainter painter(store->paintDevice());
			painter.setCompositionMode(QPainter::CompositionMode_Source);
			painter.drawImage(part, image, part);
		}
		store->endPaint();
		store->flush(part);
	}
};


bool
Compare(const char* what, ServerWindow& window, Bare& bare, const QRect& part)
{
	Desktop* desktop = Desktop::Get();
	BRegion damage;
	damage.Set(BRect(part.left(), part.top(), part.right(), part.bottom()));
	uint32 color = 0;
	const auto ours = [&] {
		color += 0x010305;
		for (int y = part.top(); y <= part.bottom(); y++)
			std::fill_n(window.Back().Row(y) + part.left(), part.width(), 0xff000000 | color);
		window.Present(damage);
		desktop->RunOnDisplay([] {});
	};
	const auto theirs = [&] {
		color += 0x010305;
		for (int y = part.top(); y <= part.bottom(); y++) {
			auto* row = reinterpret_cast<uint32*>(bare.image.scanLine(y));
			std::fill_n(row + part.left(), part.width(), 0xff000000 | color);
		}
		desktop->RunOnDisplay([&] { bare.Show(part); });
	};
	return bench::compare(what, 1.3, ours, theirs);
}


// Twenty presents of a part: as many flushes at most, of just that area.
bool
CountFlushes(ServerWindow& window)
{
	constexpr int kPresents = 20;
	Desktop* desktop = Desktop::Get();
	desktop->RunOnDisplay([] {});
	const WindowRecord& record = window.Record();
	const int64 flushes = record.flushes, pixels = record.flushedPixels;
	BRegion damage;
	damage.Include(BRect(10, 10, 109, 59));
	damage.Include(BRect(500, 300, 519, 309));
	int64 changed = 0;
	for (int i = 0; i < kPresents; i++) {
		window.Present(damage);
		desktop->RunOnDisplay([] {});
		changed += 100 * 50 + 20 * 10;
	}
	const double perPresent = double(record.flushes - flushes) / kPresents;
	const double area = double(record.flushedPixels - pixels) / double(changed);
	printf("flushes per present %.2f, flushed area / changed area %.3f (goal 1.25)\n", perPresent,
		area);
	return perPresent == 1 && area <= 1.25;
}

} // namespace


int
main()
{
	setenv("ARCHWAY_BACKEND", "qt", 1);
	unsetenv("ARCHWAY_SCALE");
	Silent silent;
	if (Desktop::Start(&silent) != B_OK)
		return 2;

	Desktop* desktop = Desktop::Get();
	bool met = true;
	{
		ServerWindow window(&silent, BRect(0, 0, kWidth - 1, kHeight - 1), "present", 1, 0, 0);
		window.Show();
		std::unique_ptr<Bare> bare;
		desktop->RunOnDisplay([&] { bare = std::make_unique<Bare>(); });
		BRegion all;
		all.Set(window.Back().LogicalBounds());
		window.Present(all);
		wait_until_idle(5000000);
		desktop->RunOnDisplay([] {});

		met = Compare("a label of 100 x 20", window, *bare, QRect(40, 40, 100, 20)) && met;
		met = Compare("a panel of 400 x 300", window, *bare, QRect(40, 40, 400, 300)) && met;
		met =
			Compare("the whole of 1200 x 700", window, *bare, QRect(0, 0, kWidth, kHeight)) && met;
		met = CountFlushes(window) && met;
		desktop->RunOnDisplay([&] { bare.reset(); });
	}
	Desktop::Stop();
	return met ? 0 : 1;
}
