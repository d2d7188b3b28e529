// Drawing calls against those of a raw QPainter on an image of the same size: fill, frame, line,
// label, and measuring a label.
#include <QFontMetricsF>
#include <QGuiApplication>
#include <QImage>
#include <QPainter>
#include <benchmark/benchmark.h>

#include "server/paint/FontEngine.h"
#include "server/paint/Painter.h"

using namespace BPrivate;

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
	int32 fAt = 0;
};


class Ours {
public:
	Ours() : painter(surface)
	{
		surface.SetTo(kWidth, kHeight);
		painter.SetState(&state);
		painter.FillRect(BRect(0, 0, kWidth - 1, kHeight - 1), B_SOLID_LOW);
		clip.Set(BRect(0, 0, kWidth - 1, kHeight - 1));
		painter.SetClip(&clip);
		state.font.size = 12;
	}

	Surface surface;
	Painter painter;
	DrawState state;
	BRegion clip;
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


void
OurFill(benchmark::State& state)
{
	Ours ours;
	Place place;
	for (auto _ : state) {
		const float x = place.X();
		ours.painter.FillRect(BRect(x, place.Y(), x + 89, place.Y() + 23));
	}
}


void
QtFill(benchmark::State& state)
{
	Theirs theirs;
	Place place;
	for (auto _ : state) {
		const int x = place.X();
		theirs.painter.fillRect(x, place.Y(), 90, 24, Qt::black);
	}
}


void
OurFrame(benchmark::State& state)
{
	Ours ours;
	Place place;
	for (auto _ : state) {
		const float x = place.X();
		ours.painter.StrokeRect(BRect(x, place.Y(), x + 89, place.Y() + 23));
	}
}


void
QtFrame(benchmark::State& state)
{
	Theirs theirs;
	Place place;
	for (auto _ : state) {
		const int x = place.X();
		theirs.painter.drawRect(x, place.Y(), 89, 23);
	}
}


void
OurLine(benchmark::State& state)
{
	Ours ours;
	Place place;
	for (auto _ : state) {
		const float x = place.X();
		ours.painter.StrokeLine(BPoint(x, place.Y()), BPoint(x + 89, place.Y()));
	}
}


void
QtLine(benchmark::State& state)
{
	Theirs theirs;
	Place place;
	for (auto _ : state) {
		const int x = place.X();
		theirs.painter.drawLine(x, place.Y(), x + 89, place.Y());
	}
}


void
OurSlantedLine(benchmark::State& state)
{
	Ours ours;
	Place place;
	for (auto _ : state) {
		const float x = place.X();
		ours.painter.StrokeLine(BPoint(x, place.Y()), BPoint(x + 89, place.Y() + 23));
	}
}


void
QtSlantedLine(benchmark::State& state)
{
	Theirs theirs;
	Place place;
	for (auto _ : state) {
		const int x = place.X();
		theirs.painter.drawLine(x, place.Y(), x + 89, place.Y() + 23);
	}
}


void
OurLabel(benchmark::State& state)
{
	Ours ours;
	Place place;
	for (auto _ : state) {
		const float x = place.X();
		ours.painter.DrawString(kLabel, BPoint(x, place.Y()));
	}
}


void
QtLabel(benchmark::State& state)
{
	Theirs theirs;
	Place place;
	const QString label(kLabel);
	for (auto _ : state) {
		const int x = place.X();
		theirs.painter.drawText(QPoint(x, place.Y()), label);
	}
}


void
OurWidth(benchmark::State& state)
{
	FontSpec spec;
	spec.size = 12;
	for (auto _ : state)
		benchmark::DoNotOptimize(FontEngine::Get().StringWidth(spec, kLabel));
}


void
QtWidth(benchmark::State& state)
{
	QFont font("Liberation Sans");
	font.setPixelSize(12);
	const QFontMetricsF metrics(font);
	const QString label(kLabel);
	for (auto _ : state)
		benchmark::DoNotOptimize(metrics.horizontalAdvance(label));
}


void
OurEllipse(benchmark::State& state)
{
	Ours ours;
	Place place;
	for (auto _ : state) {
		const float x = place.X();
		ours.painter.FillEllipse(BRect(x, place.Y(), x + 12, place.Y() + 12));
	}
}


void
QtEllipse(benchmark::State& state)
{
	Theirs theirs;
	theirs.painter.setRenderHint(QPainter::Antialiasing);
	theirs.painter.setPen(Qt::NoPen);
	theirs.painter.setBrush(Qt::black);
	Place place;
	for (auto _ : state) {
		const int x = place.X();
		theirs.painter.drawEllipse(x, place.Y(), 13, 13);
	}
}

} // namespace

BENCHMARK(OurFill);
BENCHMARK(QtFill);
BENCHMARK(OurFrame);
BENCHMARK(QtFrame);
BENCHMARK(OurLine);
BENCHMARK(QtLine);
BENCHMARK(OurSlantedLine);
BENCHMARK(QtSlantedLine);
BENCHMARK(OurLabel);
BENCHMARK(QtLabel);
BENCHMARK(OurWidth);
BENCHMARK(QtWidth);
BENCHMARK(OurEllipse);
BENCHMARK(QtEllipse);


int
main(int argc, char** argv)
{
	qputenv("QT_QPA_PLATFORM", "offscreen");
	QGuiApplication application(argc, argv);
	benchmark::Initialize(&argc, argv);
	benchmark::RunSpecifiedBenchmarks();
	return 0;
}
