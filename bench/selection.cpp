// How long a design of 1,000 views takes to open in the view editor, and how long a click on one of
// them takes until its highlight is on the screen. The display is the one in memory. The goal is
// 50 ms for the click on a machine of today.

#include <stdlib.h>
#include <vector>

#include <benchmark/benchmark.h>

#include <Button.h>
#include <Message.h>

#include "addon/ViewEditor.h"
#include "support/TestWindow.h"
#include "work/WorkView.h"

using namespace BResEditor;

namespace {


constexpr int32 kColumns = 40;
constexpr int32 kRows = 25;
constexpr float kWidth = 18;
constexpr float kHeight = 14;


std::vector<char>
FlattenedDesign()
{
	BView root(BRect(0, 0, kColumns * 20 - 1, kRows * 16 - 1), "root", B_FOLLOW_NONE, B_WILL_DRAW);
	for (int32 i = 0; i < kColumns * kRows; i++) {
		const BPoint at(
			static_cast<float>(i % kColumns) * 20, static_cast<float>(i / kColumns) * 16);
		root.AddChild(new BButton(
			BRect(at, at + BPoint(kWidth, kHeight)), "child", "", new BMessage('pres')));
	}
	BMessage archive;
	root.Archive(&archive, true);
	std::vector<char> bytes(static_cast<size_t>(archive.FlattenedSize()));
	archive.Flatten(bytes.data(), static_cast<ssize_t>(bytes.size()));
	return bytes;
}


// The design in an editor, in a window that shows all of it.
class Scene {
public:
	Scene() : fWindow(BRect(10, 10, 1409, 609)), fArgs { &fCollection }, fUser(fArgs)
	{
		const std::vector<char> bytes = FlattenedDesign();
		BResourceCollection* writable = fUser.WriteLock(NULL);
		writable->AddItem(&fItem, 'ARCV', 1, "", bytes.data(), bytes.size());
		fUser.WriteUnlock(writable);
	}

	~Scene() { Close(); }

	void Open()
	{
		fEditor = new ViewEditor(fArgs, fItem);
		fWindow.Locked([&] {
			// Only what is attached has its children follow.
			const BRect bounds = fWindow.Window()->Bounds();
			fWindow.Window()->AddChild(fEditor);
			fEditor->ResizeTo(bounds.Width(), bounds.Height());
		});
	}

	// As the host does: out of the window first.
	void Close()
	{
		if (fEditor == nullptr)
			return;
		fWindow.Locked([&] { fEditor->RemoveSelf(); });
		delete static_cast<BFullItemEditor*>(fEditor);
		fEditor = nullptr;
	}

	BView* Child(int32 index)
	{
		return static_cast<WorkView*>(fEditor->FindView("WorkView"))->EditView()->ChildAt(index);
	}

	Driver& Input() { return fWindow.driver; }

private:
	TestWindow fWindow;
	BResourceCollection fCollection;
	BResourceAddonArgs fArgs;
	BResourceAddonBase fUser;
	BResourceHandle fItem;
	ViewEditor* fEditor = nullptr; // owned
};


bool
IsHighlighted(Scene& scene, BView* view)
{
	const rgb_color edge = scene.Input().PixelAt(view, BPoint(0, kHeight / 2));
	return edge.red == 0 && edge.green == 0 && edge.blue == 255;
}


void
BM_OpenThousandViews(benchmark::State& state)
{
	Scene scene;
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
	Scene scene;
	scene.Open();
	int32 index = 0;
	for (auto _ : state) {
		index = (index + 7) % (kColumns * kRows);
		scene.Input().Click(scene.Child(index));
	}
	if (!IsHighlighted(scene, scene.Child(index)))
		state.SkipWithError("the clicked view has no highlight");
}
BENCHMARK(BM_ClickOneOfThousandViews)->Unit(benchmark::kMillisecond)->UseRealTime();


} // namespace


int
main(int argc, char** argv)
{
	setenv("ARCHWAY_BACKEND", "headless", 1);
	benchmark::Initialize(&argc, argv);
	benchmark::RunSpecifiedBenchmarks();
	return 0;
}
