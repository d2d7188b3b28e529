#include <stdlib.h>
#include <unistd.h>

#include <algorithm>
#include <condition_variable>
#include <memory>
#include <mutex>
#include <string>
#include <thread>
#include <vector>

#include <Application.h>
#include <Bitmap.h>
#include <Entry.h>
#include <File.h>
#include <Looper.h>
#include <Message.h>
#include <Messenger.h>
#include <Mime.h>
#include <NodeInfo.h>

#include "MimeFixture.h"

namespace {

// A change in one line.
std::string
AsText(const BMessage& change)
{
	static const std::pair<int32, const char*> kBits[] = { { B_ICON_CHANGED, "icon" },
		{ B_PREFERRED_APP_CHANGED, "app" }, { B_ATTR_INFO_CHANGED, "attributes" },
		{ B_FILE_EXTENSIONS_CHANGED, "extensions" }, { B_SHORT_DESCRIPTION_CHANGED, "short" },
		{ B_LONG_DESCRIPTION_CHANGED, "long" }, { B_ICON_FOR_TYPE_CHANGED, "icon for" },
		{ B_APP_HINT_CHANGED, "hint" }, { B_MIME_TYPE_CREATED, "created" },
		{ B_MIME_TYPE_DELETED, "deleted" }, { B_SNIFFER_RULE_CHANGED, "rule" },
		{ B_SUPPORTED_TYPES_CHANGED, "supported" } };
	std::string text = change.what == B_META_MIME_CHANGED ? "" : "not a change: ";
	text += change.FindString("be:type");
	for (const auto& [bit, name] : kBits) {
		if (change.FindInt32("be:which") == bit)
			text += std::string(" ") + name;
	}
	const char* extra;
	if (change.FindString("be:extra_type", &extra) == B_OK)
		text += std::string(" ") + extra;
	bool large;
	if (change.FindBool("be:large_icon", &large) == B_OK)
		text += large ? " large" : " mini";
	return text;
}


// Collects what it is told, in a thread of its own.
class Watcher : public BLooper {
public:
	void MessageReceived(BMessage* message) override
	{
		std::lock_guard<std::mutex> guard(fChangesLock);
		if (message->what == 'last')
			message->SendReply('done');
		else
			fChanges.push_back(AsText(*message));
		fCame.notify_all();
	}

	// All that came so far, once this one did.
	std::vector<std::string> TakeUntil(const std::string& last)
	{
		std::unique_lock<std::mutex> guard(fChangesLock);
		const bool came = fCame.wait_for(guard, std::chrono::seconds(30),
			[&] { return std::find(fChanges.begin(), fChanges.end(), last) != fChanges.end(); });
		EXPECT_TRUE(came) << "No " << last;
		return std::move(fChanges);
	}

	// All that was sent before.
	std::vector<std::string> Take()
	{
		BMessage reply;
		EXPECT_EQ(B_OK, BMessenger(this).SendMessage('last', &reply));
		std::unique_lock<std::mutex> guard(fChangesLock);
		return std::move(fChanges);
	}

private:
	std::mutex fChangesLock;
	std::condition_variable fCame;
	std::vector<std::string> fChanges;
};


class MimeWatchTest : public MimeDatabaseTest {
public:
	void SetUp() override
	{
		MimeDatabaseTest::SetUp();
		fWatcher = new Watcher;
		fWatcher->Run();
		fTarget = BMessenger(fWatcher);
	}

	void TearDown() override
	{
		BMimeType::StopWatching(fTarget);
		fWatcher->Lock();
		fWatcher->Quit();
	}

	// Runs a part of this program as a program of its own.
	static int RunOther(const char* part)
	{
		const std::string command = "ARCHWAY_TEST_USER=same /proc/" + std::to_string(getpid())
			+ "/exe --gtest_filter=MimeProgramTest." + part + " > /dev/null";
		return system(command.c_str());
	}

	Watcher* fWatcher; // borrowed: a looper deletes itself
	BMessenger fTarget;
};

// Parts of this program that are run as programs of their own.
using MimeProgramTest = MimeDatabaseTest;

using Changes = std::vector<std::string>;

} // namespace


// #pragma mark - what other programs do


TEST_F(MimeProgramTest, SetsADescription)
{
	EXPECT_EQ(B_OK, BMimeType("x-test/other").SetShortDescription("Set by another program"));
}


TEST_F(MimeProgramTest, SetsManyTimes)
{
	for (int32 i = 0; i < 100; i++) {
		const std::string text = "other " + std::to_string(i);
		EXPECT_EQ(B_OK, BMimeType("x-test/both").SetLongDescription(text.c_str()));
	}
}


TEST_F(MimeProgramTest, DeletesAType)
{
	EXPECT_EQ(B_OK, BMimeType("x-test/other").Install());
	EXPECT_EQ(B_OK, BMimeType("x-test/other").Delete());
}


// The looper runs and watches until the program is gone.
TEST_F(MimeProgramTest, EndsWhileItWatches)
{
	auto* watcher = new Watcher;
	watcher->Run();
	ASSERT_EQ(B_OK, BMimeType::StartWatching(BMessenger(watcher)));
	EXPECT_EQ(B_OK, BMimeType("x-test/other").Install());
	EXPECT_EQ(Changes({ "x-test/other created" }), watcher->Take());
}


// #pragma mark - what watchers are told


TEST_F(MimeWatchTest, EachValueThatIsSetIsTold)
{
	ASSERT_EQ(B_OK, BMimeType::StartWatching(fTarget));
	BMimeType type("X-Test/Watched");
	ASSERT_EQ(B_OK, type.Install());
	EXPECT_EQ(Changes({ "x-test/watched created" }), fWatcher->Take());
	ASSERT_EQ(B_OK, type.SetShortDescription("short"));
	ASSERT_EQ(B_OK, type.SetLongDescription("long"));
	ASSERT_EQ(B_OK, type.SetPreferredApp("application/x-app"));
	ASSERT_EQ(B_OK, type.SetSnifferRule("0.5 (a)"));
	BMessage list;
	list.AddString("extensions", "watched");
	ASSERT_EQ(B_OK, type.SetFileExtensions(&list));
	ASSERT_EQ(B_OK, type.SetAttrInfo(&list));
	ASSERT_EQ(B_OK, type.SetSupportedTypes(&list));
	entry_ref ref;
	ASSERT_EQ(B_OK, get_ref_for_path("/tmp", &ref));
	ASSERT_EQ(B_OK, type.SetAppHint(&ref));
	EXPECT_EQ(Changes({ "x-test/watched short", "x-test/watched long", "x-test/watched app",
				  "x-test/watched rule", "x-test/watched extensions", "x-test/watched attributes",
				  "x-test/watched supported", "x-test/watched hint" }),
		fWatcher->Take());
	ASSERT_EQ(B_OK, type.SetSnifferRule(NULL));
	ASSERT_EQ(B_OK, type.Delete());
	EXPECT_EQ(Changes({ "x-test/watched rule", "x-test/watched deleted" }), fWatcher->Take());
}


TEST_F(MimeWatchTest, IconsAreToldWithTheirSizeAndType)
{
	BApplication application("application/x-vnd.Archway-test");
	const BBitmap large(BRect(0, 0, 31, 31), B_CMAP8);
	const BBitmap mini(BRect(0, 0, 15, 15), B_CMAP8);
	BMimeType type("x-test/watched");
	ASSERT_EQ(B_OK, type.Install());
	ASSERT_EQ(B_OK, BMimeType::StartWatching(fTarget));
	ASSERT_EQ(B_OK, type.SetIcon(&large, B_LARGE_ICON));
	ASSERT_EQ(B_OK, type.SetIcon(&mini, B_MINI_ICON));
	ASSERT_EQ(B_OK, type.SetIconForType("Text/Plain", &large, B_LARGE_ICON));
	ASSERT_EQ(B_OK, type.SetIconForType("text/plain", &mini, B_MINI_ICON));
	EXPECT_EQ(Changes({ "x-test/watched icon large", "x-test/watched icon mini",
				  "x-test/watched icon for text/plain large",
				  "x-test/watched icon for text/plain mini" }),
		fWatcher->Take());
}


TEST_F(MimeWatchTest, WhatStaysIsNoChange)
{
	BMimeType type("x-test/watched");
	ASSERT_EQ(B_OK, type.SetShortDescription("short"));
	ASSERT_EQ(B_OK, BMimeType::StartWatching(fTarget));
	ASSERT_EQ(B_OK, BMimeType::StartWatching(fTarget));
	ASSERT_EQ(B_OK, type.SetShortDescription("short"));
	ASSERT_EQ(B_OK, type.Install());
	EXPECT_EQ(Changes(), fWatcher->Take());
	ASSERT_EQ(B_OK, type.SetShortDescription("other"));
	EXPECT_EQ(Changes({ "x-test/watched short" }), fWatcher->Take());
}


TEST_F(MimeWatchTest, ATypeOfTheSharedDatabaseIsNeitherMadeNorDeleted)
{
	ASSERT_EQ(B_OK, BMimeType::StartWatching(fTarget));
	BMimeType type("text/plain");
	ASSERT_EQ(B_OK, type.SetShortDescription("short"));
	ASSERT_EQ(B_OK, type.Delete());
	EXPECT_EQ(Changes({ "text/plain short", "text/plain short" }), fWatcher->Take());
	EXPECT_TRUE(type.IsInstalled());
}


TEST_F(MimeWatchTest, WhoStoppedIsToldNothing)
{
	ASSERT_EQ(B_OK, BMimeType::StartWatching(fTarget));
	ASSERT_EQ(B_OK, BMimeType::StopWatching(fTarget));
	ASSERT_EQ(B_OK, BMimeType("x-test/watched").Install());
	EXPECT_EQ(Changes(), fWatcher->Take());
	EXPECT_EQ(B_ENTRY_NOT_FOUND, BMimeType::StopWatching(fTarget));
	EXPECT_EQ(B_BAD_VALUE, BMimeType::StartWatching(BMessenger()));

	// What happened meanwhile is not told later.
	ASSERT_EQ(B_OK, BMimeType::StartWatching(fTarget));
	ASSERT_EQ(B_OK, BMimeType("x-test/watched").SetShortDescription("short"));
	EXPECT_EQ(Changes({ "x-test/watched short" }), fWatcher->Take());
}


TEST_F(MimeWatchTest, AWatcherThatIsGoneIsForgotten)
{
	auto* other = new Watcher;
	other->Run();
	const BMessenger gone(other);
	ASSERT_EQ(B_OK, BMimeType::StartWatching(gone));
	other->Lock();
	other->Quit();
	ASSERT_EQ(B_OK, BMimeType("x-test/watched").Install());
	EXPECT_EQ(B_ENTRY_NOT_FOUND, BMimeType::StopWatching(gone));
	ASSERT_EQ(B_OK, BMimeType::StartWatching(fTarget));
	ASSERT_EQ(B_OK, BMimeType("x-test/watched").Delete());
	EXPECT_EQ(Changes({ "x-test/watched deleted" }), fWatcher->Take());
}


// The folder does not exist at first. What this program did in between is not told once more when
// the folder tells of it: both come in order.
TEST_F(MimeWatchTest, WhatOtherProgramsSetIsToldOnce)
{
	ASSERT_EQ(B_OK, BMimeType::StartWatching(fTarget));
	ASSERT_EQ(0, RunOther("SetsADescription"));
	EXPECT_EQ(Changes({ "x-test/other created", "x-test/other short" }),
		fWatcher->TakeUntil("x-test/other short"));
	ASSERT_EQ(B_OK, BMimeType("x-test/watched").SetShortDescription("short"));
	ASSERT_EQ(B_OK, BMimeType("x-test/watched").SetShortDescription("other"));
	ASSERT_EQ(0, RunOther("DeletesAType"));
	EXPECT_EQ(Changes({ "x-test/watched created", "x-test/watched short", "x-test/watched short",
				  "x-test/other deleted" }),
		fWatcher->TakeUntil("x-test/other deleted"));
	ASSERT_EQ(0, RunOther("SetsADescription"));
	EXPECT_EQ(Changes({ "x-test/other created", "x-test/other short" }),
		fWatcher->TakeUntil("x-test/other short"));
}


// Each reads the settings, changes them and writes them back: neither undoes the other's change.
TEST_F(MimeWatchTest, ProgramsThatSetAtOnceKeepEachOthersValues)
{
	BMimeType type("x-test/both");
	int32 lost = 0;
	std::thread other([] { EXPECT_EQ(0, RunOther("SetsManyTimes")); });
	for (int32 i = 0; i < 100; i++) {
		const std::string text = "this " + std::to_string(i);
		EXPECT_EQ(B_OK, type.SetShortDescription(text.c_str()));
		char found[B_MIME_TYPE_LENGTH + 1] = "";
		type.GetShortDescription(found);
		lost += text != found;
	}
	other.join();
	char found[B_MIME_TYPE_LENGTH + 1] = "";
	EXPECT_EQ(B_OK, type.GetShortDescription(found));
	EXPECT_STREQ("this 99", found);
	EXPECT_EQ(B_OK, type.GetLongDescription(found));
	EXPECT_STREQ("other 99", found);
	EXPECT_EQ(0, lost);
}


TEST_F(MimeWatchTest, AFolderThatGoesIsWaitedFor)
{
	ASSERT_EQ(B_OK, BMimeType("x-test/watched").Install());
	ASSERT_EQ(B_OK, BMimeType::StartWatching(fTarget));
	std::filesystem::rename(fFolder / "config", fFolder / "away");
	std::filesystem::remove_all(fFolder / "away");
	EXPECT_EQ(Changes({ "x-test/watched deleted" }), fWatcher->TakeUntil("x-test/watched deleted"));
	ASSERT_EQ(0, RunOther("SetsADescription"));
	EXPECT_EQ(Changes({ "x-test/other created", "x-test/other short" }),
		fWatcher->TakeUntil("x-test/other short"));
}


TEST_F(MimeWatchTest, AProgramMayEndWhileItWatches)
{
	for (int32 i = 0; i < 10; i++) {
		EXPECT_EQ(0, RunOther("EndsWhileItWatches"));
		ASSERT_EQ(B_OK, BMimeType("x-test/other").Delete());
	}
}


TEST_F(MimeWatchTest, ManyThreadsSetAndWatch)
{
	constexpr int32 kThreads = 4;
	std::vector<std::thread> threads;
	for (int32 i = 0; i < kThreads; i++) {
		threads.emplace_back([i] {
			auto* watcher = new Watcher;
			watcher->Run();
			BMimeType type(("x-test/thread-" + std::to_string(i)).c_str());
			for (int32 round = 0; round < 5; round++) {
				EXPECT_EQ(B_OK, BMimeType::StartWatching(BMessenger(watcher)));
				EXPECT_EQ(B_OK, type.SetShortDescription(round % 2 == 0 ? "even" : "odd"));
				const Changes changes = watcher->Take();
				const std::string own = std::string(type.Type()) + " short";
				EXPECT_EQ(1, std::count(changes.begin(), changes.end(), own));
				EXPECT_EQ(B_OK, BMimeType::StopWatching(BMessenger(watcher)));
				watcher->Take();
			}
			watcher->Lock();
			watcher->Quit();
		});
	}
	for (std::thread& thread : threads)
		thread.join();
}
