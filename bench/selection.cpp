// How long a design of 1,000 views takes to open in the view editor, how long a click on one of them
// takes until its highlight is on the screen, and how much longer a click, an arrow key and the
// start of a drag take in a design of 10,000 views than in one of 100. The display is the one in
// memory. The goal for one step is a frame of 16 ms; for the panels, a twentieth of the 95 ms that
// a list of properties takes in a designer of forms, which shows its handles 3.8 ms after a click.

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
constexpr int32 kEnough = 2000; // to fill half a screen
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


void
Check(bool holds, const char* what)
{
	if (holds)
		return;
	fprintf(stderr, "%s\n", what);
	abort();
}


// What a user does to one view of a design, each step until all of it is done.
class User {
public:
	User(BRect frame, int32 views) : fScene(frame, views), fViews(std::min(views, kFew))
	{
		fScene.Open();
		fName = ControlUser::Find<BTextControl>(fScene.Editor(), "Name: ");
	}

	// The first click on a window in the background only brings it to the front.
	void Activate()
	{
		if (!fScene.Window()->IsActive())
			fDriver.ActivateWindow(fScene.Window());
	}

	// Until the highlight is on the screen and the panels show the view.
	void Click()
	{
		Activate();
		fView = fScene.Next(fViews);
		fDriver.Click(fView);
		Check(IsHighlighted(fDriver, fView), "the clicked view has no highlight");
		Check(strcmp(fName->Text(), fView->Name()) == 0, "the panels show another view");
	}

	void Nudge()
	{
		const float left = fView->Frame().left;
		fDriver.Key(fStep++ % 2 == 0 ? "Right" : "Left");
		Check(left != fView->Frame().left, "the view did not move");
	}

	// The view is taken along, and put back in its place by the release.
	void StartDrag()
	{
		const WorkView* work = static_cast<WorkView*>(fScene.Editor()->FindView("WorkView"));
		fDriver.MoveTo(Driver::PointIn(fView, BPoint(1, 1)));
		fDriver.Press();
		Check(work->SelectedView() == work->EditView(), "the view is not taken along");
		fDriver.Release();
		fView = work->SelectedView();
		Check(fView != work->EditView(), "the view did not come back");
	}

private:
	EditorScene fScene;
	Driver fDriver;
	int32 fViews;
	BTextControl* fName; // borrowed
	BView* fView = nullptr; // the selected one
	int32 fStep = 0;
};


void
PutPaletteAside()
{
	widgetWindow->Lock();
	widgetWindow->MoveTo(kBesideThem);
	widgetWindow->Unlock();
}


void
CompareClicksAndKeys()
{
	User few(kUpperHalf, kFew);
	User many(kLowerHalf, kMany);
	PutPaletteAside();
	bench::compare(
		"click to highlight and panels, 10,000 / 100 views", 1.15, [&] { many.Click(); },
		[&] { few.Click(); });

	// Only the active window hears the keys; each is measured in its turn.
	const auto nudge = [](User& user) {
		user.Activate();
		for (int32 i = 0; i < 20; i++)
			user.Nudge();
	};
	bench::compare(
		"twenty arrow keys, 10,000 / 100 views", 1.15, [&] { nudge(many); }, [&] { nudge(few); });
}


// The ground is marked as what would take the view, behind all others that are in sight. So it is
// compared with a design that fills its window, too.
void
CompareDrags()
{
	User some(kUpperHalf, kEnough);
	User many(kLowerHalf, kMany);
	PutPaletteAside();
	const auto drag = [](User& user) {
		user.Activate();
		user.Click();
		user.StartDrag();
	};
	bench::compare(
		"click and start of a drag, 10,000 / 2,000 views", 1.15, [&] { drag(many); },
		[&] { drag(some); });
}


} // namespace


int
main(int argc, char** argv)
{
	setenv("ARCHWAY_BACKEND", "headless", 1);
	BApplication application("application/x-vnd.Archway-bench");
	CompareClicksAndKeys();
	CompareDrags();
	benchmark::Initialize(&argc, argv);
	benchmark::RunSpecifiedBenchmarks();
	return 0;
}
