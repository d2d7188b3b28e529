// What is dropped on a design by the mouse: widgets of the palette, and files of the desktop.

#include <cmath>
#include <cstdio>
#include <filesystem>
#include <string>

#include <gtest/gtest.h>

#include <Bitmap.h>
#include <Box.h>
#include <Button.h>
#include <CheckBox.h>
#include <Entry.h>
#include <File.h>
#include <MenuBar.h>
#include <NodeInfo.h>
#include <Resources.h>

#include "addon/EditorScene.h"
#include "archive/BitmapView.h"
#include "work/WorkBackgroundView.h"

namespace {


// Takes views as a file manager does: makes the file, and has the drag's source write it.
class FolderView : public BView {
public:
	FolderView(const std::string& path) :
		BView(BRect(0, 0, 199, 99), "folder", B_FOLLOW_NONE, B_WILL_DRAW), fPath(path)
	{
	}

	void MessageReceived(BMessage* message) override
	{
		const char* name;
		int32 action;
		entry_ref directory;
		if (!message->WasDropped() || message->FindString("be:clip_name", &name) != B_OK
			|| message->FindInt32("be:actions", &action) != B_OK
			|| get_ref_for_path(fPath.c_str(), &directory) != B_OK) {
			BView::MessageReceived(message);
			return;
		}
		BFile((fPath + '/' + name).c_str(), B_READ_WRITE | B_CREATE_FILE);
		BMessage reply(static_cast<uint32>(action));
		reply.AddRef("directory", &directory);
		reply.AddString("name", name);
		message->SendReply(&reply);
	}

private:
	std::string fPath;
};


class DropTest : public testing::Test {
protected:
	DropTest()
	{
		BView root(BRect(0, 0, 399, 299), "root", B_FOLLOW_LEFT | B_FOLLOW_TOP, B_WILL_DRAW);
		root.AddChild(new BBox(BRect(150, 20, 349, 279), "box"));
		BMessage archive;
		root.Archive(&archive, true);
		scene.Open(archive);
		box = scene.Root()->FindView("box");

		char name[] = "/tmp/archway-drops-XXXXXX";
		folder = mkdtemp(name);
	}

	~DropTest() override { std::filesystem::remove_all(folder); }

	// A file that holds the view as one that was dragged into a folder.
	std::string FileOf(const BView& view)
	{
		const std::string path = folder + "/dragged view";
		BMessage archive('drop');
		view.Archive(&archive, true);
		std::string bytes(static_cast<size_t>(archive.FlattenedSize()), '\0');
		archive.Flatten(bytes.data(), static_cast<ssize_t>(bytes.size()));
		BFile file(path.c_str(), B_READ_WRITE | B_CREATE_FILE | B_ERASE_FILE);
		BResources resources(&file, true);
		resources.AddResource('ARCV', 1, bytes.data(), bytes.size(), "zetka");
		resources.Sync();
		return path;
	}

	void DragWidget(const char* entry, BView* to, BPoint where)
	{
		scene.Input().Drag(scene.PaletteEntry(entry), Driver::PointIn(to, where));
	}

	// The file as which the dragged view ends in a folder; a button is expected.
	void ExpectFile(BPoint from)
	{
		BWindow* window = new BWindow(BRect(1260, 500, 1459, 599), "folder", B_TITLED_WINDOW, 0);
		FolderView* view = new FolderView(folder);
		window->AddChild(view);
		window->Show();
		Driver::WaitUntilIdle();
		input.ActivateWindow(scene.Window()); // the first click would do no more
		input.Drag(from, Driver::PointIn(view, BPoint(100, 50)));
		window->Lock();
		window->Quit();

		const std::string path = folder + "/DragMe Success";
		BFile file(path.c_str(), B_READ_ONLY);
		BResources resources(&file);
		size_t size = 0;
		const void* bytes = resources.LoadResource('ARCV', 1, &size);
		ASSERT_NE(nullptr, bytes);
		const char* name;
		int32 id;
		type_code type;
		ASSERT_TRUE(resources.GetResourceInfo(0, &type, &id, &name, &size));
		EXPECT_STREQ("zetka", name);
		EXPECT_FALSE(resources.GetResourceInfo(1, &type, &id, &name, &size));
		BMessage archive;
		ASSERT_EQ(B_OK, archive.Unflatten(static_cast<const char*>(bytes)));
		EXPECT_EQ(uint32('drop'), archive.what);
		EXPECT_STREQ("BButton", archive.FindString("class"));
		char mime[B_MIME_TYPE_LENGTH + 1];
		BNodeInfo info(&file);
		ASSERT_EQ(B_OK, info.GetType(mime));
		EXPECT_STREQ("application/x-tamvex-resource", mime);

		const BView* before = scene.Work()->SelectedView();
		input.DropFile(path.c_str(), Driver::PointIn(box, BPoint(30, 150)));
		EXPECT_NE(before, scene.Work()->SelectedView());
		EXPECT_NE(nullptr, dynamic_cast<BButton*>(scene.Work()->SelectedView()));
		EXPECT_EQ(BPoint(30, 150), scene.Work()->SelectedView()->Frame().LeftTop());
	}

	BWindow* Question()
	{
		for (int32 i = 0; BWindow* window = be_app->WindowAt(i); i++) {
			if (std::string(window->Title()) == "Warning!")
				return window;
		}
		return nullptr;
	}

	EditorScene scene;
	Driver& input { scene.Input() };
	BView* box;
	std::string folder;
};


} // namespace


TEST_F(DropTest, AWidgetFallsIntoTheBoxWhereItsPictureWas)
{
	BWindow* other = new BWindow(BRect(1300, 600, 1400, 700), "other", B_TITLED_WINDOW, 0);
	other->Show();
	Driver::WaitUntilIdle();
	ASSERT_FALSE(scene.Window()->IsActive());

	DragWidget("BCheckBox", box, BPoint(90, 60));
	ASSERT_EQ(1, box->CountChildren());
	BView* dropped = box->ChildAt(0);
	EXPECT_NE(nullptr, dynamic_cast<BCheckBox*>(dropped));
	const BRect frame = dropped->Frame();
	EXPECT_NEAR(90, (frame.left + frame.right) / 2, 1);
	EXPECT_NEAR(60, (frame.top + frame.bottom) / 2, 1);
	EXPECT_EQ(std::floor(frame.left), frame.left);
	EXPECT_EQ(dropped, scene.Work()->SelectedView());
	EXPECT_TRUE(scene.Window()->IsActive());

	other->Lock();
	other->Quit();
}


TEST_F(DropTest, AMenuBarGoesToTheLeftTopOfWhatTakesIt)
{
	DragWidget("BMenuBar", box, BPoint(90, 60));
	ASSERT_EQ(1, box->CountChildren());
	EXPECT_NE(nullptr, dynamic_cast<BMenuBar*>(box->ChildAt(0)));
	EXPECT_EQ(BPoint(0, 0), box->ChildAt(0)->Frame().LeftTop());
	EXPECT_EQ(box->ChildAt(0), scene.Work()->SelectedView());
}


TEST_F(DropTest, AHeadingIsNotDragged)
{
	for (const char* heading : { "BControl", "BScrollView containing..." })
		DragWidget(heading, box, BPoint(90, 60));
	EXPECT_EQ(0, box->CountChildren());
	EXPECT_EQ(scene.Root(), scene.Work()->SelectedView());
}


TEST_F(DropTest, EscapeKeepsTheDesignFromAWidgetOnTheGround)
{
	BView* root = scene.Root();
	DragWidget("BButton", scene.Work()->Container(), BPoint(430, 200));
	ASSERT_NE(nullptr, Question());
	EXPECT_EQ(root, scene.Root());
	input.Key("Escape");
	EXPECT_EQ(nullptr, Question());
	EXPECT_EQ(root, scene.Root());
	EXPECT_EQ(box, root->ChildAt(0));
	EXPECT_EQ(1, scene.Work()->Container()->CountChildren());
}


TEST_F(DropTest, YesMakesAWidgetOnTheGroundTheDesign)
{
	for (const char* answer : { "_b1_", "_b0_" }) {
		DragWidget("BButton", scene.Work()->Container(), BPoint(430, 200));
		BWindow* question = Question();
		ASSERT_NE(nullptr, question);
		question->Lock();
		BView* button = question->FindView(answer);
		question->Unlock();
		input.Click(button);
		EXPECT_EQ(nullptr, Question());
		const bool kept =
			scene.Root()->Name() != NULL && std::string("root") == scene.Root()->Name();
		EXPECT_EQ(std::string("_b1_") == answer, kept);
	}
	EXPECT_NE(nullptr, dynamic_cast<BButton*>(scene.Root()));
	EXPECT_EQ(BPoint(0, 0), scene.Root()->Frame().LeftTop());
	EXPECT_EQ(scene.Root(), scene.Work()->SelectedView());
	EXPECT_EQ(1, scene.Work()->Container()->CountChildren());
}


TEST_F(DropTest, APictureBecomesABitmapViewNamedAfterItsFile)
{
	const std::string path = folder + "/a picture.png";
	BView* square = new BView(BRect(10, 10, 59, 59), "", B_FOLLOW_NONE, B_WILL_DRAW);
	square->SetViewColor(200, 30, 40);
	scene.Locked([&] { box->AddChild(square); });
	ASSERT_TRUE(input.Screenshot(path.c_str()));
	const BPoint colored = Driver::PointIn(square, BPoint(25, 25));

	input.DropFile(path.c_str(), Driver::PointIn(scene.Root(), BPoint(20, 30)));
	BitmapView* view = dynamic_cast<BitmapView*>(scene.Work()->SelectedView());
	ASSERT_NE(nullptr, view);
	EXPECT_EQ(scene.Root(), view->Parent());
	EXPECT_STREQ("a picture.png", view->Name());
	EXPECT_EQ(BRect(20, 30, 20 + 1599, 30 + 999), view->Frame());
	EXPECT_EQ(uint32(B_FOLLOW_LEFT | B_FOLLOW_TOP), view->ResizingMode());
	EXPECT_EQ(0u, view->Flags());

	// That part of the picture is moved into sight.
	scene.Locked([&] { view->MoveTo(BPoint(120, 130) - colored); });
	const rgb_color shown = input.PixelAt(scene.Root(), BPoint(120, 130));
	EXPECT_EQ(200, shown.red);
	EXPECT_EQ(30, shown.green);
}


TEST_F(DropTest, AFileOfAViewBecomesTheView)
{
	const BButton button(BRect(0, 0, 70, 24), "filed", "Filed", NULL);
	input.DropFile(FileOf(button).c_str(), Driver::PointIn(box, BPoint(30, 50)));
	BView* view = scene.Root()->FindView("filed");
	ASSERT_NE(nullptr, dynamic_cast<BButton*>(view));
	EXPECT_EQ(box, view->Parent());
	EXPECT_EQ(BRect(30, 50, 100, 74), view->Frame());
	EXPECT_EQ(view, scene.Work()->SelectedView());
}


TEST_F(DropTest, AWidgetOfThePaletteBecomesAFileInAFolder)
{
	ExpectFile(scene.PaletteEntry("BButton"));
	EXPECT_EQ(1, box->CountChildren());
}


TEST_F(DropTest, AViewOfTheDesignBecomesAFileInAFolder)
{
	BButton* button = new BButton(BRect(10, 20, 80, 44), "button", "Press", NULL);
	scene.Locked([&] { box->AddChild(button); });
	input.Click(button);
	ExpectFile(Driver::PointIn(button, BPoint(10, 10)));
	EXPECT_EQ(1, box->CountChildren()); // the one that came back
	EXPECT_STREQ("button", box->ChildAt(0)->Name());
}


TEST_F(DropTest, AFileOfNothingUsefulBeeps)
{
	const std::string path = folder + "/notes.txt";
	FILE* file = fopen(path.c_str(), "w");
	fputs("no picture, no view", file);
	fclose(file);
	const int32 beeps = Driver::CountBeeps();
	for (const std::string& name : { path, folder, folder + "/missing" })
		input.DropFile(name.c_str(), Driver::PointIn(box, BPoint(30, 50)));
	EXPECT_EQ(beeps + 3, Driver::CountBeeps());
	EXPECT_EQ(0, box->CountChildren());
}
