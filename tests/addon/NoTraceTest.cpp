// What is painted step by step looks as if it were painted at once, on screens of any sharpness.

#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <iterator>
#include <string>
#include <unistd.h>

#include <gtest/gtest.h>

#include <Box.h>
#include <Button.h>
#include <ChannelSlider.h>
#include <CheckBox.h>
#include <Slider.h>
#include <StringView.h>

#include "addon/EditorScene.h"
#include "archive/ViewTree.h"

namespace {


struct Screen {
	explicit Screen(const char* scale) { setenv("ARCHWAY_SCALE", scale, 1); }
};


BMessage
Design()
{
	BView root(BRect(0, 0, 299, 249), "root", B_FOLLOW_LEFT | B_FOLLOW_TOP, B_WILL_DRAW);
	root.SetViewColor(216, 216, 216);
	BBox* box = new BBox(BRect(11, 13, 280, 190), "box");
	root.AddChild(box);
	box->AddChild(new BButton(BRect(21, 33, 119, 57), "button", "Press", NULL));
	box->AddChild(new BSlider(BRect(21, 83, 219, 120), "slider", "How much", NULL, 0, 99));
	box->AddChild(new BCheckBox(BRect(131, 37, 230, 53), "check", "Check", NULL));
	root.AddChild(new BChannelSlider(BRect(161, 197, 291, 247), "channels", "Both", NULL, 2));
	root.AddChild(new BStringView(BRect(17, 203, 150, 220), "text", "Some text"));
	BMessage archive;
	root.Archive(&archive, true);
	return archive;
}


class NoTrace : private Screen,
				public testing::Test,
				public testing::WithParamInterface<const char*> {
protected:
	NoTrace() : Screen(GetParam()), scene(BRect(10, 20, 759, 569)) { scene.Open(Design()); }

	std::string Picture()
	{
		char path[] = "/tmp/archway-no-trace-XXXXXX"; // tests run side by side
		close(mkstemp(path));
		EXPECT_TRUE(scene.Input().Screenshot(path));
		std::ifstream file(path, std::ios::binary);
		const std::string bytes { std::istreambuf_iterator<char>(file), {} };
		std::remove(path);
		return bytes;
	}

	void ExpectNoTrace(const std::string& after)
	{
		const std::string before = Picture();
		scene.Locked([&] { InvalidateViewTree(scene.Editor()); });
		EXPECT_TRUE(before == Picture()) << after;
	}

	EditorScene scene;
};


} // namespace


TEST_P(NoTrace, IsLeftByKeysResizesAndDrags)
{
	Driver& input = scene.Input();
	for (const char* name : { "button", "slider", "check", "text", "channels", "box" }) {
		BView* view = scene.Root()->FindView(name);
		input.Click(view, BPoint(3, 3));
		ASSERT_EQ(view, scene.Work()->SelectedView()) << name;
		for (const char* key : { "Right", "Right", "Down", "Down", "Down", "Left", "Up" })
			input.Key(key);
		ExpectNoTrace(std::string("keys on ") + name);

		const BPoint corner = view->Bounds().RightBottom() - BPoint(2, 2);
		input.MoveTo(view, corner);
		const BPoint start = Driver::PointIn(view, corner);
		input.Press();
		for (float step = 1; step <= 5; step++)
			input.MoveTo(start + BPoint(-step, step));
		ExpectNoTrace(std::string("a resize of ") + name);
		input.Release();

		input.Drag(
			Driver::PointIn(view, BPoint(3, 3)), Driver::PointIn(scene.Root(), BPoint(37, 231)));
		ExpectNoTrace(std::string("a drag of ") + name);
	}
}


INSTANTIATE_TEST_SUITE_P(
	AtScale, NoTrace, testing::Values("1", "1.25", "1.5", "2"), [](const auto& info) {
		std::string name = std::string("Of") + info.param;
		std::replace(name.begin(), name.end(), '.', '_');
		return name;
	});
