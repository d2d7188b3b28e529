#include "kits/server/DesktopFixture.h"

#include <Entry.h>
#include <Handler.h>
#include <Looper.h>
#include <Path.h>
#include <TypeConstants.h>

#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <fstream>

#include <sys/stat.h>
#include <sys/xattr.h>

#include "app/private/Delivery.h"
#include "kernel/private/Activity.h"
#include "server/ServerWindow.h"

namespace BPrivate {

namespace {

constexpr uint32 kDragged = 'drag';


class Drag : public DesktopTest {
protected:
	void SetUp() override
	{
		DesktopTest::SetUp();
		source = std::make_unique<TestWindow>(BRect(0, 0, 99, 99));
		target = std::make_unique<TestWindow>(BRect(200, 0, 299, 99));
		source->server.Activate();
		Settle();
		source->Take();
		target->Take();
	}

	void TearDown() override
	{
		source.reset();
		target.reset();
		DesktopTest::TearDown();
	}

	void StartDrag()
	{
		auto message = std::make_unique<BMessage>(kDragged);
		message->AddString("payload", "gold");
		DragImage image;
		image.width = 20;
		image.height = 10;
		image.offset.Set(5, 6);
		Desktop::Get()->StartDrag(source->server, std::move(message), image);
		Settle();
	}

	void PressSource()
	{
		input.BeginGesture();
		input.Move(BPoint(50, 50));
		input.Press(1);
		Settle();
		for (const std::unique_ptr<BMessage>& down : source->Take(B_MOUSE_DOWN))
			source->server.BeginInput(*down);
	}

	std::unique_ptr<TestWindow> source, target;
};


// The source of a drag that writes a file when it is asked to, as the negotiation demands.
class FileWriter : public BHandler {
public:
	void MessageReceived(BMessage* message) override
	{
		if (message->what != B_COPY_TARGET) {
			BHandler::MessageReceived(message);
			return;
		}
		asked++;
		isReply = message->IsReply() && message->Previous() != nullptr
			&& message->Previous()->what == B_SIMPLE_DATA;
		entry_ref directory;
		const char* name;
		if (message->FindRef("directory", &directory) != B_OK
			|| message->FindString("name", &name) != B_OK)
			return;
		BPath path(&directory);
		path.Append(name);
		if (std::FILE* file = std::fopen(path.Path(), "r+")) {
			std::fputs("written", file);
			std::fclose(file);
		}
	}

	int32 asked = 0;
	bool isReply = false;
};


void
ExpectDragIn(const BMessage& moved)
{
	BMessage dragged;
	EXPECT_EQ(B_OK, moved.FindMessage("be:drag_message", &dragged));
	EXPECT_EQ(kDragged, dragged.what);
	EXPECT_STREQ("gold", dragged.FindString("payload"));
	EXPECT_EQ(int32(kDragged), moved.FindInt32("_msg_what_"));
}

} // namespace


TEST_F(Drag, MovesOverAnyWindowCarryTheMessage)
{
	PressSource();
	StartDrag();
	input.Move(BPoint(60, 50));
	input.Move(BPoint(250, 50));
	Settle();

	const Messages left = source->Take(B_MOUSE_MOVED);
	ASSERT_EQ(2u, left.size());
	ExpectDragIn(*left[0]);
	EXPECT_FALSE(IsElsewhere(*left[0]));
	EXPECT_TRUE(IsElsewhere(*left[1]));
	const Messages moves = target->Take(B_MOUSE_MOVED);
	ASSERT_EQ(1u, moves.size());
	ExpectDragIn(*moves[0]);
}


TEST_F(Drag, ReleaseComesBeforeTheDrop)
{
	PressSource();
	StartDrag();
	input.Move(BPoint(250, 50));
	Settle();
	source->Take();
	target->Take();
	input.Release(1);
	Settle();

	EXPECT_EQ(1u, source->Take(B_MOUSE_UP).size());
	const Messages messages = target->Take();
	ASSERT_LE(2u, messages.size());
	EXPECT_EQ(uint32(B_MOUSE_UP), messages[0]->what);
	const BMessage& drop = *messages[1];
	EXPECT_EQ(uint32(_MESSAGE_DROPPED_), drop.what);
	EXPECT_EQ(int32(kDragged), drop.FindInt32("_original_what"));
	EXPECT_EQ(BPoint(250, 50), drop.FindPoint("_drop_point_"));
	EXPECT_EQ(BPoint(5, 6), drop.FindPoint("_drop_offset_"));
	EXPECT_EQ(1, drop.FindInt32("buttons"));
	EXPECT_STREQ("gold", drop.FindString("payload"));
}


TEST_F(Drag, NothingIsDraggedAfterTheDrop)
{
	PressSource();
	StartDrag();
	input.Release(1);
	Settle();
	source->Take();
	input.Move(BPoint(55, 55));
	Settle();
	const Messages moves = source->Take(B_MOUSE_MOVED);
	ASSERT_EQ(1u, moves.size());
	EXPECT_FALSE(moves[0]->HasMessage("be:drag_message"));
}


TEST_F(Drag, DragOfAFinishedPressDropsWhereItWasReleased)
{
	PressSource();
	input.Move(BPoint(70, 50));
	input.Move(BPoint(250, 50));
	input.Release(1);
	// The user has gone on since.
	input.Move(BPoint(30, 80));
	Settle();
	source->Take();
	target->Take();
	StartDrag();

	const Messages replayed = source->Take();
	ASSERT_EQ(3u, replayed.size());
	ExpectDragIn(*replayed[0]);
	EXPECT_EQ(BPoint(70, 50), replayed[0]->FindPoint("where"));
	EXPECT_TRUE(IsElsewhere(*replayed[1]));
	EXPECT_EQ(kDragDecided, replayed[2]->what);
	const Messages messages = target->Take();
	ASSERT_EQ(2u, messages.size());
	ExpectDragIn(*messages[0]);
	EXPECT_EQ(uint32(_MESSAGE_DROPPED_), messages[1]->what);
	EXPECT_EQ(BPoint(250, 50), messages[1]->FindPoint("_drop_point_"));
}


TEST_F(Drag, DragBelongsToThePressThatIsHandled)
{
	PressSource();
	input.Release(1);
	// A second press, elsewhere, is under way when the first one is handled.
	input.BeginGesture();
	input.Move(BPoint(20, 20));
	input.Press(1);
	Settle();
	source->Take();
	StartDrag();

	const Messages drops = source->Take(_MESSAGE_DROPPED_);
	ASSERT_EQ(1u, drops.size());
	EXPECT_EQ(BPoint(50, 50), drops[0]->FindPoint("_drop_point_"));
	input.Move(BPoint(25, 20));
	Settle();
	for (const std::unique_ptr<BMessage>& move : source->Take(B_MOUSE_MOVED))
		EXPECT_FALSE(move->HasMessage("be:drag_message"));
}


TEST_F(Drag, DropOnNoWindowIsThrownAway)
{
	PressSource();
	StartDrag();
	input.Move(BPoint(500, 500));
	input.Release(1);
	Settle();
	EXPECT_EQ(1u, source->Take(B_MOUSE_UP).size());
	EXPECT_TRUE(target->Take(_MESSAGE_DROPPED_).empty());
	// The pointer is free again.
	Click(BPoint(50, 50));
	EXPECT_EQ(1u, source->Take(B_MOUSE_DOWN).size());
}


TEST_F(Drag, DragThatLeftAllWindowsComesHome)
{
	PressSource();
	StartDrag();
	input.Move(BPoint(500, 500));
	input.Move(BPoint(250, 50));
	Settle();
	const Messages moves = target->Take(B_MOUSE_MOVED);
	ASSERT_EQ(1u, moves.size());
	ExpectDragIn(*moves[0]);
	input.Release(1);
	Settle();
	EXPECT_EQ(1u, source->Take(B_MOUSE_UP).size());
	EXPECT_EQ(1u, target->Take(_MESSAGE_DROPPED_).size());
	Click(BPoint(50, 50));
	EXPECT_EQ(1u, source->Take(B_MOUSE_DOWN).size());
}


TEST_F(Drag, PictureFollowsThePointer)
{
	const auto at = [](BPoint where) {
		return Desktop::Get()->Picture(BRect(where.x, where.y, where.x, where.y)).bits;
	};
	const std::vector<uint8> before = at(BPoint(145, 44));
	PressSource();
	StartDrag();
	input.Move(BPoint(150, 50));
	Settle();
	EXPECT_NE(before, at(BPoint(145, 44)));
	input.Release(1);
	Settle();
	EXPECT_EQ(before, at(BPoint(145, 44)));
}


TEST_F(Drag, WindowsMayGoDuringADrag)
{
	PressSource();
	StartDrag();
	input.Move(BPoint(250, 50));
	Settle();
	target.reset();
	source.reset();
	input.Move(BPoint(240, 50));
	input.Release(1);
	Settle();
	source = std::make_unique<TestWindow>(BRect(0, 0, 99, 99));
	Settle();
	Click(BPoint(50, 50));
	EXPECT_EQ(1u, source->Take(B_MOUSE_DOWN).size());
}


TEST_F(Drag, FileFromElsewhereArrivesAsRefs)
{
	BMessage data;
	const char list[] = "file:///tmp/one%20file\r\n";
	data.AddData("text/uri-list", B_MIME_TYPE, list, sizeof(list) - 1, false);
	input.Move(BPoint(250, 50));
	input.ForeignDrag(BackendEvent::Type::DragEntered, data);
	input.ForeignDrag(BackendEvent::Type::DragMoved, data);
	input.ForeignDrag(BackendEvent::Type::Dropped, data);
	Settle();

	const Messages drops = target->Take(_MESSAGE_DROPPED_);
	ASSERT_EQ(1u, drops.size());
	EXPECT_EQ(int32(B_SIMPLE_DATA), drops[0]->FindInt32("_original_what"));
	entry_ref ref;
	ASSERT_EQ(B_OK, drops[0]->FindRef("refs", &ref));
	EXPECT_STREQ("one file", ref.name);
}


TEST_F(Drag, FileCanBeDroppedOnAFolder)
{
	char folder[] = "/tmp/drag-test-XXXXXX", from[] = "/tmp/drag-test-XXXXXX";
	ASSERT_NE(nullptr, mkdtemp(folder));
	ASSERT_NE(nullptr, mkdtemp(from));
	const std::string path = std::string(from) + "/a file";
	std::FILE* file = std::fopen(path.c_str(), "w");
	ASSERT_NE(nullptr, file);
	std::fputs("contents", file);
	std::fclose(file);
	ASSERT_EQ(0, setxattr(path.c_str(), "user.BEOS:TYPE", "text/x-a", 8, 0));

	PressSource();
	auto message = std::make_unique<BMessage>(B_SIMPLE_DATA);
	entry_ref ref;
	ASSERT_EQ(B_OK, get_ref_for_path(path.c_str(), &ref));
	message->AddRef("refs", &ref);
	Desktop::Get()->StartDrag(source->server, std::move(message), DragImage());
	input.Leave();
	input.DropOnFolder(folder);
	Settle();
	const std::string copy = std::string(folder) + "/a file";
	EXPECT_TRUE(std::filesystem::exists(copy));
	char type[9] = "";
	EXPECT_EQ(8, getxattr(copy.c_str(), "user.BEOS:TYPE", type, 8));
	EXPECT_STREQ("text/x-a", type);
	EXPECT_EQ(1u, source->Take(B_MOUSE_UP).size());
	std::filesystem::remove_all(folder);
	std::filesystem::remove_all(from);
}


TEST_F(Drag, FileIsWrittenOnceWhenTheFolderAsks)
{
	char folder[] = "/tmp/drag-test-XXXXXX";
	ASSERT_NE(nullptr, mkdtemp(folder));
	auto* looper = new BLooper("writer");
	FileWriter writer;
	looper->AddHandler(&writer);
	looper->Run();

	PressSource();
	auto message = std::make_unique<BMessage>(B_SIMPLE_DATA);
	message->AddString("be:types", "application/octet-stream");
	message->AddInt32("be:actions", B_COPY_TARGET);
	message->AddString("be:clip_name", "a/widget");
	Delivery::Of(*message).replyTo = BMessenger(&writer);
	Desktop::Get()->StartDrag(source->server, std::move(message), DragImage());
	input.Leave();
	input.DropOnFolder(folder);
	// The display thread goes on with other tasks while it waits for the file.
	ASSERT_TRUE(wait_until_idle(20000000));

	std::ifstream file(std::string(folder) + "/a-widget");
	std::string contents;
	std::getline(file, contents);
	EXPECT_EQ("written", contents);
	const mode_t mask = umask(0);
	umask(mask);
	struct stat written;
	ASSERT_EQ(0, stat((std::string(folder) + "/a-widget").c_str(), &written));
	EXPECT_EQ(0666 & ~mask, written.st_mode & 0777);
	EXPECT_EQ(1, writer.asked);
	EXPECT_TRUE(writer.isReply);

	looper->Lock();
	looper->RemoveHandler(&writer);
	looper->Quit();
	std::filesystem::remove_all(folder);
}


TEST_F(Drag, SourceThatIsGoneOffersNoFile)
{
	char folder[] = "/tmp/drag-test-XXXXXX";
	ASSERT_NE(nullptr, mkdtemp(folder));
	PressSource();
	auto message = std::make_unique<BMessage>(B_SIMPLE_DATA);
	message->AddString("be:types", "application/octet-stream");
	message->AddInt32("be:actions", B_COPY_TARGET);
	Desktop::Get()->StartDrag(source->server, std::move(message), DragImage());
	input.Leave();
	input.DropOnFolder(folder);
	Settle();
	EXPECT_TRUE(std::filesystem::is_empty(folder));
	EXPECT_EQ(1u, source->Take(B_MOUSE_UP).size());
	std::filesystem::remove_all(folder);
}


} // namespace BPrivate
