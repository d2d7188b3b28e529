// A user who does anything to any design: the selection stays sound, the highlight stays at it, and
// what is saved comes back as it was.
//
// ARCHWAY_SESSIONS says how many sessions there are, of 100 steps each; ARCHWAY_SEED the seed of the
// first, which is printed: to see one again, say its seed and 1 session of part 0.

#include <cstdarg>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <filesystem>
#include <memory>
#include <random>
#include <string>
#include <typeinfo>
#include <vector>

#include <gtest/gtest.h>

#include <Application.h>
#include <Box.h>
#include <ColorControl.h>
#include <MenuBar.h>
#include <MenuField.h>
#include <OutlineListView.h>
#include <Region.h>
#include <ScrollView.h>
#include <TabView.h>
#include <TextControl.h>

#include "addon/EditorScene.h"
#include "archive/ViewArchive.h"
#include "archive/ViewTree.h"
#include "palette/WidgetCatalogue.h"

namespace {


constexpr int32 kParts = 8;
constexpr int32 kSteps = 100;
constexpr int32 kStepsBetweenArchives = 10;

constexpr const char* kKinds[] = { "BView", "BView (custom)", "BBox", "BStringView", "BButton",
	"BCheckBox", "BRadioButton", "BTextControl", "BSlider", "BColorControl", "BMenuField",
	"BStatusBar", "BTextView", "BScrollView with BView", "BScrollView with BTextView", "BTabView",
	"BListView", "BOutlineListView", "BMenuBar" };


int32
NumberFrom(const char* variable, int32 otherwise)
{
	const char* text = getenv(variable);
	return text != nullptr ? atoi(text) : otherwise;
}


std::vector<BView*>
ViewsOf(BView* root)
{
	std::vector<BView*> views;
	if (root == nullptr)
		return views;
	views.push_back(root);
	for (BView* child = root->ChildAt(0); child != nullptr; child = child->NextSibling()) {
		const std::vector<BView*> below = ViewsOf(child);
		views.insert(views.end(), below.begin(), below.end());
	}
	return views;
}


bool
HasChild(BView* parent, const char* name)
{
	for (BView* child = parent->ChildAt(0); child != nullptr; child = child->NextSibling()) {
		if (child->Name() != NULL && strcmp(child->Name(), name) == 0
			&& dynamic_cast<BTextControl*>(child) != nullptr)
			return true;
	}
	return false;
}


// Controls make the inner views that they lack when they are revived.
bool
LacksInnerViews(BView* root)
{
	for (BView* view : ViewsOf(root)) {
		if (const BMenuField* field = dynamic_cast<BMenuField*>(view)) {
			if (field->MenuBar() == nullptr)
				return true;
		}
		if (dynamic_cast<BColorControl*>(view) != nullptr) {
			for (const char* name : { "_red", "_green", "_blue" }) {
				if (!HasChild(view, name))
					return true;
			}
		}
	}
	return false;
}


BMessage
ArchiveOf(BView* view)
{
	BMessage archive;
	EXPECT_EQ(B_OK, view->Archive(&archive, true));
	return archive;
}


BMessage
RevivedAndArchived(const BMessage& archive)
{
	BMessage copy(archive);
	const std::unique_ptr<BArchivable> object(instantiate_object(&copy));
	BView* view = dynamic_cast<BView*>(object.get());
	EXPECT_NE(nullptr, view);
	return view != nullptr ? ArchiveOf(view) : BMessage();
}


class Session {
public:
	Session(EditorScene& scene, uint32 seed, const std::string& folder) :
		fScene(scene), fInput(scene.Input()), fRandom(seed), fFolder(folder)
	{
		fScene.Open(_RandomDesign());
	}

	void Run()
	{
		for (int32 i = 0; i < kSteps && !testing::Test::HasFailure(); i++) {
			fLog += std::to_string(i) + ' ';
			_Step();
			_AnswerQuestions();
			_CheckSelection();
			if (i % kStepsBetweenArchives == kStepsBetweenArchives - 1)
				_CheckArchive();
		}
		_CheckArchive();
	}

	const std::string& Log() const { return fLog; }

private:
	int32 _Number(int32 from, int32 to) // both are included
	{
		return std::uniform_int_distribution<int32>(from, std::max(from, to))(fRandom);
	}

	bool _Chance(int32 percent) { return _Number(1, 100) <= percent; }

	BMessage _RandomDesign()
	{
		const std::unique_ptr<BView> root(
			new BView(BRect(_Number(0, 20), _Number(0, 20), _Number(100, 600), _Number(80, 500)),
				"root", B_FOLLOW_LEFT | B_FOLLOW_TOP, B_WILL_DRAW));
		std::vector<BView*> parents = { root.get() };
		const int32 count = _Number(0, 20);
		for (int32 i = 0; i < count; i++) {
			BView* view = MakeSample(kKinds[_Number(0, std::size(kKinds) - 1)]);
			FinishAttachedSample(view);
			if (_Chance(80))
				view->SetName(("view " + std::to_string(i)).c_str());
			BView* parent = parents[_Number(0, static_cast<int32>(parents.size()) - 1)];
			view->MoveTo(_Number(-20, parent->Bounds().IntegerWidth()),
				_Number(-20, parent->Bounds().IntegerHeight()));
			parent->AddChild(view);
			if (BTabView* tabs = dynamic_cast<BTabView*>(view))
				parents.push_back(tabs->ViewForTab(_Number(0, 1)));
			else if (typeid(*view) == typeid(BView) || dynamic_cast<BBox*>(view) != nullptr)
				parents.push_back(view);
		}
		BMessage archive = ArchiveOf(root.get());
		SwapInheritedViews(&archive, 0);
		return archive;
	}

	WorkView* Work() { return fScene.Work(); }

	void _Note(const char* format, ...) __attribute__((format(printf, 2, 3)))
	{
		char text[200];
		va_list arguments;
		va_start(arguments, format);
		vsnprintf(text, sizeof(text), format, arguments);
		va_end(arguments);
		fLog += std::string(text) + '\n';
	}

	// Somewhere on the screen, mostly on a view of the design.
	BPoint _AnyPoint()
	{
		BPoint point;
		fScene.Locked([&] {
			const std::vector<BView*> views = ViewsOf(fScene.Root());
			BView* view = views[_Number(0, static_cast<int32>(views.size()) - 1)];
			if (_Chance(10))
				view = Work()->Target();
			const BRect bounds = view->Bounds();
			point = view->ConvertToScreen(bounds.LeftTop()
				+ BPoint(_Number(-2, bounds.IntegerWidth() + 2),
					_Number(-2, bounds.IntegerHeight() + 2)));
			const BRect sight = Work()->Target()->ConvertToScreen(Work()->Target()->Bounds());
			if (!sight.Contains(point) && !_Chance(5)) {
				point.x = _Number(static_cast<int32>(sight.left), static_cast<int32>(sight.right));
				point.y = _Number(static_cast<int32>(sight.top), static_cast<int32>(sight.bottom));
			}
		});
		point.Set(std::floor(std::clamp(point.x, 0.0f, 1599.0f)),
			std::floor(std::clamp(point.y, 0.0f, 999.0f)));
		return point;
	}

	BPoint _PointOnSelection(bool corner)
	{
		BPoint point;
		fScene.Locked([&] {
			BView* view = Work()->SelectedView();
			if (view == nullptr)
				return;
			const BRect bounds = view->Bounds();
			point = view->ConvertToScreen(corner
					? bounds.RightBottom() - BPoint(_Number(0, 5), _Number(0, 5))
					: BPoint(
						_Number(0, bounds.IntegerWidth()), _Number(0, bounds.IntegerHeight())));
		});
		return BPoint(std::floor(point.x), std::floor(point.y));
	}

	void _Step()
	{
		const int32 choice = _Number(1, 100);
		if (choice <= 30)
			_Click();
		else if (choice <= 50)
			_Drag();
		else if (choice <= 62)
			_Resize();
		else if (choice <= 82)
			_Keys();
		else if (choice <= 92)
			_DropFromPalette();
		else if (choice <= 95)
			_DropFile();
		else if (choice <= 97)
			_Scroll();
		else
			_Save();
	}

	void _Click()
	{
		const BPoint where = _AnyPoint();
		const int32 times = _Number(1, 3);
		const bool waits = _Chance(60);
		const uint32 button = _Chance(92) ? B_PRIMARY_MOUSE_BUTTON : B_SECONDARY_MOUSE_BUTTON;
		const uint32 modifiers = _Chance(10) ? B_CONTROL_KEY : 0;
		_Note("click %g,%g times %d waits %d button %u modifiers %u", where.x, where.y,
			static_cast<int>(times), waits, static_cast<unsigned>(button),
			static_cast<unsigned>(modifiers));
		fInput.MoveTo(where);
		fInput.SetWaiting(waits);
		fInput.Click(where, times, button, modifiers);
		fInput.SetWaiting(true);
		Driver::WaitUntilIdle();
		// The other buttons reach the view; one with a menu has opened it.
		if (button != B_PRIMARY_MOUSE_BUTTON)
			fInput.Key("Escape");
	}

	void _Drag()
	{
		const BPoint from = _Chance(60) ? _PointOnSelection(false) : _AnyPoint();
		const BPoint to = _AnyPoint();
		const uint32 modifiers = _Chance(20) ? B_CONTROL_KEY : 0;
		const bool waits = _Chance(70);
		_Note("drag %g,%g to %g,%g waits %d modifiers %u", from.x, from.y, to.x, to.y, waits,
			static_cast<unsigned>(modifiers));
		fInput.SetWaiting(waits);
		fInput.Drag(from, to, _Number(1, 4), B_PRIMARY_MOUSE_BUTTON, modifiers);
		fInput.SetWaiting(true);
		Driver::WaitUntilIdle();
	}

	void _Resize()
	{
		const BPoint from = _PointOnSelection(true);
		const BPoint to = from + BPoint(_Number(-80, 80), _Number(-60, 60));
		_Note("resize %g,%g to %g,%g", from.x, from.y, to.x, to.y);
		fInput.Drag(from, to, _Number(1, 4));
	}

	void _Keys()
	{
		constexpr const char* kKeys[] = { "Left", "Right", "Up", "Down", "Left", "Right", "Up",
			"Down", "Delete", "Backspace", "a", "Home", "Escape" };
		const char* key = kKeys[_Number(0, std::size(kKeys) - 1)];
		const int32 times = strlen(key) > 5 ? 1 : _Number(1, 6);
		_Note("key %s times %d", key, static_cast<int>(times));
		fInput.SetWaiting(_Chance(70));
		fInput.Key(key, 0, times);
		fInput.SetWaiting(true);
		Driver::WaitUntilIdle();
	}

	void _DropFromPalette()
	{
		const int32 index = _Number(0, 20);
		BPoint from;
		widgetWindow->Lock();
		BOutlineListView* list = dynamic_cast<BOutlineListView*>(
			dynamic_cast<BScrollView*>(widgetWindow->ChildAt(0))->Target());
		list->ScrollTo(BPoint(0, std::max(0.0f, list->ItemFrame(index).top - 60)));
		from = list->ConvertToScreen(BPoint(60, list->ItemFrame(index).top + 5));
		widgetWindow->Unlock();
		const BPoint to = _AnyPoint();
		_Note("palette %d to %g,%g", static_cast<int>(index), to.x, to.y);
		fInput.Drag(from, to, _Number(2, 4));
	}

	void _DropFile()
	{
		constexpr const char* kFiles[] = { "picture.png", "view.rsrc", "rubbish.txt",
			"no such file" };
		const char* name = kFiles[_Number(0, std::size(kFiles) - 1)];
		const BPoint to = _AnyPoint();
		_Note("file %s to %g,%g", name, to.x, to.y);
		fInput.DropFile((fFolder + '/' + name).c_str(), to);
	}

	void _Scroll()
	{
		const BPoint where = _AnyPoint();
		const float amount = static_cast<float>(_Number(-3, 3));
		_Note("wheel %g,%g by %g", where.x, where.y, amount);
		fInput.Wheel(where, _Chance(30) ? amount : 0, amount);
	}

	void _Save()
	{
		_Note("save");
		fScene.Locked([&] { fScene.Editor()->ApplyChanges(); });
	}

	// A drop on the ground asks; more than one may wait.
	void _AnswerQuestions()
	{
		for (;;) {
			BWindow* alert = nullptr;
			for (int32 i = be_app->CountWindows() - 1; i >= 0 && alert == nullptr; i--) {
				BWindow* window = be_app->WindowAt(i);
				if (strcmp(window->Title(), "Warning!") == 0)
					alert = window;
			}
			if (alert == nullptr)
				return;
			alert->Lock();
			BView* button = alert->FindView(_Chance(25) ? "_b0_" : "_b1_");
			alert->Unlock();
			_Note("answer %s", button->Name());
			fInput.Click(button);
		}
	}

	void _CheckSelection()
	{
		BView* selection = nullptr;
		std::vector<BPoint> edge;
		fScene.Locked([&] {
			selection = Work()->SelectedView();
			if (selection == nullptr)
				return;
			ASSERT_NE(nullptr, ViewAttached(fScene.Root(), selection));
			edge = _VisibleEdge(selection);
		});
		for (const BPoint& point : edge) {
			const rgb_color color = fInput.PixelAt(point);
			EXPECT_TRUE(color.red == 0 && color.green == 0 && color.blue == 255)
				<< "no highlight at " << point.x << ", " << point.y << " of "
				<< typeid(*selection).name();
		}
	}

	// Points of the frame that the highlight draws, where the view is to be seen.
	std::vector<BPoint> _VisibleEdge(BView* view)
	{
		std::vector<BPoint> edge;
		const BRect bounds = view->Bounds();
		if (bounds.Width() < 4 || bounds.Height() < 4)
			return edge;
		BRegion visible;
		view->GetClippingRegion(&visible);
		const float right = std::floor(bounds.Width());
		const float bottom = std::floor(bounds.Height());
		const BRect screen(0, 0, 1599, 999);
		for (const BPoint& offset : { BPoint(0, 0), BPoint(right, 0), BPoint(0, bottom),
				 BPoint(std::floor(right / 2), 0), BPoint(0, std::floor(bottom / 2)),
				 BPoint(right, std::floor(bottom / 3)), BPoint(std::floor(right / 3), bottom) }) {
			const BPoint point = bounds.LeftTop() + offset;
			const BPoint onScreen = view->ConvertToScreen(point);
			if (visible.Contains(point) && screen.Contains(onScreen))
				edge.push_back(onScreen);
		}
		return edge;
	}

	void _CheckArchive()
	{
		fScene.Locked([&] {
			if (fScene.Root() == nullptr)
				return;
			BMessage archive = ArchiveOf(fScene.Root());
			if (LacksInnerViews(fScene.Root()))
				archive = RevivedAndArchived(archive);
			const BMessage again = RevivedAndArchived(archive);
			EXPECT_TRUE(Equal(&archive, &again));
			if (testing::Test::HasFailure()) {
				DumpMessage(&archive, 0);
				DumpMessage(&again, 0);
			}
		});
	}

	EditorScene& fScene;
	Driver& fInput;
	std::mt19937 fRandom;
	std::string fFolder;
	std::string fLog;
};


class RandomSessions : public testing::TestWithParam<int32> {
protected:
	RandomSessions()
	{
		char name[] = "/tmp/archway-sessions-XXXXXX";
		folder = mkdtemp(name);
		std::filesystem::copy_file(
			ARCHWAY_SOURCES "/docs/pictures/editor.png", folder + "/picture.png");
		std::filesystem::copy_file(
			ARCHWAY_TEST_DATA "/resources/01-view.rsrc", folder + "/view.rsrc");
		FILE* rubbish = fopen((folder + "/rubbish.txt").c_str(), "w");
		fputs("This is neither a picture nor a view.\n", rubbish);
		fclose(rubbish);
	}

	~RandomSessions() override { std::filesystem::remove_all(folder); }

	std::string folder;
};


} // namespace


TEST_P(RandomSessions, KeepTheDesignSound)
{
	const int32 sessions = NumberFrom("ARCHWAY_SESSIONS", 200);
	const int32 first = NumberFrom("ARCHWAY_SEED", 1);
	EditorScene scene;
	for (int32 i = GetParam(); i < sessions && !HasFailure(); i += kParts) {
		const uint32 seed = static_cast<uint32>(first + i);
		fprintf(stderr, "session with seed %u\n", static_cast<unsigned>(seed));
		Session session(scene, seed, folder);
		session.Run();
		if (HasFailure())
			fprintf(stderr, "%s", session.Log().c_str());
	}
}


INSTANTIATE_TEST_SUITE_P(Parts, RandomSessions, testing::Range<int32>(0, kParts));
