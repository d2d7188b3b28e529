// How long a design of 1,000 views takes to open in the view editor, how long a click on one of them
// takes until its highlight is on the screen, and how much longer until its panels are shown in a
// design of 10,000 views than in one of 100. The display is the one in memory. The goal is 50 ms
// for the click on a machine of today, and for the panels a twentieth of the 95 ms that a list of
// properties takes in a designer of forms.

#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <cstring>

#include <benchmark/benchmark.h>

#include <Application.h>
#include <TextControl.h>

#include "EditorScene.h"
#include "SideBySide.h"
#include "palette/WidgetWindow.h"
#include "support/ControlUser.h"

using bench::EditorScene;

namespace {


const BRect kWholeScreen(10, 10, 1409, 609);
const BRect kUpperHalf(10, 10, 1369, 489);
const BRect kLowerHalf(10, 510, 1369, 989);
const BPoint kBesideThem(1380, 100); // for the palette
constexpr int32 kInSight = 1000; // of any number of views
constexpr int32 kFew = 100;
constexpr int32 kMany = 10000;


bool
IsHighlighted(Driver& driver, BView* view)
{
	const rgb_color edge = driver.PixelAt(view, BPoint(0, EditorScene::kHeight / 2));
	return edge.red == 0 && edge.green == 0 && edge.blue == 255;
}


void
BM_OpenThousandViews(benchmark::State& state)
{
	EditorScene scene(kWholeScreen, kInSight);
	for (auto _ : state) {
		scene.Open();
		state.PauseTiming();
		scene.Close();
		state.ResumeTiming();
	}
}
BENCHMARK(BM_OpenThousandViews)->Unit(benchmark::kMillisecond)->UseRealTime();


// Press and release, with everything that they cause: selection, panels, highlight.
void
BM_ClickOneOfThousandViews(benchmark::State& state)
{
	EditorScene scene(kWholeScreen, kInSight);
	scene.Open();
	Driver driver;
	BView* view = nullptr;
	for (auto _ : state) {
		view = scene.Next(kInSight);
		driver.Click(view);
	}
	if (!IsHighlighted(driver, view))
		state.SkipWithError("the clicked view has no highlight");
}
BENCHMARK(BM_ClickOneOfThousandViews)->Unit(benchmark::kMillisecond)->UseRealTime();


// A click, until the panels show the view that was clicked.
class PanelClick {
public:
	PanelClick(BRect frame, int32 views) : fScene(frame, views), fViews(std::min(views, kInSight))
	{
		fScene.Open();
		fName = ControlUser::Find<BTextControl>(fScene.Editor(), "Name: ");
	}

	void operator()()
	{
		// The first click on a window in the background only brings it to the front.
		if (!fScene.Window()->IsActive())
			fDriver.ActivateWindow(fScene.Window());
		BView* view = fScene.Next(fViews);
		fDriver.Click(view);
		if (strcmp(fName->Text(), view->Name()) != 0) {
			fprintf(stderr, "the panels show \"%s\", not \"%s\"\n", fName->Text(), view->Name());
			abort();
		}
	}

private:
	EditorScene fScene;
	Driver fDriver;
	int32 fViews;
	BTextControl* fName; // borrowed
};


void
ComparePanels()
{
	PanelClick few(kUpperHalf, kFew);
	PanelClick many(kLowerHalf, kMany);
	widgetWindow->Lock();
	widgetWindow->MoveTo(kBesideThem);
	widgetWindow->Unlock();
	bench::compare(
		"click to panels shown, 10,000 / 100 views", 1.2, [&] { many(); }, [&] { few(); });
}


} // namespace


int
main(int argc, char** argv)
{
	setenv("ARCHWAY_BACKEND", "headless", 1);
	BApplication application("application/x-vnd.Archway-bench");
	ComparePanels();
	benchmark::Initialize(&argc, argv);
	benchmark::RunSpecifiedBenchmarks();
	return 0;
}
