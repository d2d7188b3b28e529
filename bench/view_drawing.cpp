// Drawing calls of a view against those of a raw QPainter: fill, frame, line, label. Both draw on
// memory of the same size; each pair is measured alternately by --benchmark_enable_random_interleaving.
#include <QGuiApplication>
#include <QImage>
#include <QPainter>
#include <benchmark/benchmark.h>
#include <stdlib.h>

#include <Application.h>
#include <Bitmap.h>
#include <View.h>

namespace {

constexpr int32 kWidth = 1600;
constexpr int32 kHeight = 1000;
constexpr const char* kLabel = "Label 16 letters";


// Spreads the calls over the image, so that neither side works in the cache alone.
class Place {
public:
	int32 X() { return (fAt += 97) % (kWidth - 120); }
	int32 Y() const { return fAt * 31 % (kHeight - 40) + 12; }

private:
	uint32 fAt = 0;
};


class Ours {
public:
	Ours() : bitmap(BRect(0, 0, kWidth - 1, kHeight - 1), B_RGB32, true)
	{
		view = new BView(bitmap.Bounds(), "canvas", B_FOLLOW_NONE, B_WILL_DRAW);
		bitmap.Lock();
		bitmap.AddChild(view);
		view->SetFontSize(12);
	}
	~Ours() { bitmap.Unlock(); }

	BBitmap bitmap;
	BView* view; // child
};


class Theirs {
public:
	Theirs() : image(kWidth, kHeight, QImage::Format_RGB32), painter(&image)
	{
		QFont font("Liberation Sans");
		font.setPixelSize(12);
		painter.setFont(font);
		painter.setPen(QColor(0, 0, 0));
		painter.fillRect(image.rect(), Qt::white);
	}

	QImage image;
	QPainter painter;
};


template<typename Draw>
void
Measure(benchmark::State& state, Draw draw)
{
	Place place;
	for (auto _ : state) {
		const int32 x = place.X();
		draw(x, place.Y());
	}
}


void
ViewFill(benchmark::State& state)
{
	Ours ours;
	Measure(state, [&](int32 x, int32 y) { ours.view->FillRect(BRect(x, y, x + 89, y + 23)); });
}


void
QtFill(benchmark::State& state)
{
	Theirs theirs;
	Measure(state, [&](int32 x, int32 y) { theirs.painter.fillRect(x, y, 90, 24, Qt::black); });
}


void
ViewFrame(benchmark::State& state)
{
	Ours ours;
	Measure(state, [&](int32 x, int32 y) { ours.view->StrokeRect(BRect(x, y, x + 89, y + 23)); });
}


void
QtFrame(benchmark::State& state)
{
	Theirs theirs;
	Measure(state, [&](int32 x, int32 y) { theirs.painter.drawRect(x, y, 89, 23); });
}


void
ViewLine(benchmark::State& state)
{
	Ours ours;
	Measure(
		state, [&](int32 x, int32 y) { ours.view->StrokeLine(BPoint(x, y), BPoint(x + 89, y)); });
}


void
QtLine(benchmark::State& state)
{
	Theirs theirs;
	Measure(state, [&](int32 x, int32 y) { theirs.painter.drawLine(x, y, x + 89, y); });
}


void
ViewLabel(benchmark::State& state)
{
	Ours ours;
	Measure(state, [&](int32 x, int32 y) { ours.view->DrawString(kLabel, BPoint(x, y)); });
}


void
QtLabel(benchmark::State& state)
{
	Theirs theirs;
	const QString label(kLabel);
	Measure(state, [&](int32 x, int32 y) { theirs.painter.drawText(QPoint(x, y), label); });
}

} // namespace

BENCHMARK(ViewFill);
BENCHMARK(QtFill);
BENCHMARK(ViewFrame);
BENCHMARK(QtFrame);
BENCHMARK(ViewLine);
BENCHMARK(QtLine);
BENCHMARK(ViewLabel);
BENCHMARK(QtLabel);


int
main(int argc, char** argv)
{
	setenv("ARCHWAY_BACKEND", "headless", 1);
	setenv("QT_QPA_PLATFORM", "offscreen", 1);
	QGuiApplication qtApplication(argc, argv);
	BApplication application("application/x-vnd.Archway-bench");
	benchmark::Initialize(&argc, argv);
	benchmark::RunSpecifiedBenchmarks();
	return 0;
}
