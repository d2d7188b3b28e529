#include <Clipboard.h>

#include <gtest/gtest.h>
#include <string.h>
#include <thread>

#include <AppDefs.h>
#include <Application.h>
#include <Message.h>

#include "tests/kits/app/RecordingLooper.h"

namespace {

void
Copy(BClipboard& clipboard, const char* text)
{
	ASSERT_TRUE(clipboard.Lock());
	clipboard.Clear();
	clipboard.Data()->AddData("text/plain", B_MIME_TYPE, text, ssize_t(strlen(text)));
	EXPECT_EQ(B_OK, clipboard.Commit());
	clipboard.Unlock();
}

std::string
Paste(BClipboard& clipboard)
{
	std::string text;
	clipboard.Lock();
	const void* data = NULL;
	ssize_t size = 0;
	if (clipboard.Data()->FindData("text/plain", B_MIME_TYPE, &data, &size) == B_OK)
		text.assign(static_cast<const char*>(data), size_t(size));
	clipboard.Unlock();
	return text;
}

} // namespace


TEST(Clipboard, KeepsWhatIsCommitted)
{
	BClipboard clipboard("private");
	EXPECT_STREQ("private", clipboard.Name());

	Copy(clipboard, "hello");

	EXPECT_EQ("hello", Paste(clipboard));
	BClipboard same("private");
	EXPECT_EQ("hello", Paste(same));
	BClipboard other("other");
	EXPECT_EQ("", Paste(other));
}


TEST(Clipboard, NeedsItsLock)
{
	BClipboard clipboard("private");

	EXPECT_FALSE(clipboard.IsLocked());
	EXPECT_EQ(nullptr, clipboard.Data());
	EXPECT_EQ(B_NOT_ALLOWED, clipboard.Clear());
	EXPECT_EQ(B_NOT_ALLOWED, clipboard.Commit());
	EXPECT_EQ(B_NOT_ALLOWED, clipboard.Revert());
	ASSERT_TRUE(clipboard.Lock());
	EXPECT_TRUE(clipboard.IsLocked());
	std::thread([&] { EXPECT_FALSE(clipboard.IsLocked()); }).join();
	clipboard.Unlock();
}


TEST(Clipboard, RevertDropsWhatWasNotCommitted)
{
	BClipboard clipboard("private");
	Copy(clipboard, "hello");
	clipboard.Lock();
	clipboard.Clear();
	EXPECT_TRUE(clipboard.Data()->IsEmpty());

	EXPECT_EQ(B_OK, clipboard.Revert());

	EXPECT_FALSE(clipboard.Data()->IsEmpty());
	clipboard.Unlock();
	EXPECT_EQ("hello", Paste(clipboard));
}


TEST(Clipboard, TellsThoseWhoWatch)
{
	BClipboard clipboard("private");
	Running<RecordingLooper> watcher("w");
	EXPECT_EQ(B_BAD_VALUE, clipboard.StartWatching(BMessenger()));
	ASSERT_EQ(B_OK, clipboard.StartWatching(BMessenger(watcher.Get())));
	const uint32 count = clipboard.SystemCount();

	Copy(clipboard, "hello");
	watcher->Sync();
	EXPECT_EQ((Log { "w:CLCH" }), watcher->log);
	EXPECT_NE(count, clipboard.SystemCount());
	EXPECT_EQ(clipboard.SystemCount(), clipboard.LocalCount());

	EXPECT_EQ(B_OK, clipboard.StopWatching(BMessenger(watcher.Get())));
	EXPECT_EQ(B_BAD_VALUE, clipboard.StopWatching(BMessenger(watcher.Get())));
	Copy(clipboard, "again");
	watcher->Sync();
	EXPECT_EQ((Log { "w:CLCH" }), watcher->log);
}


TEST(Clipboard, TheApplicationsIsTheDesktops)
{
	BApplication app("application/x-vnd.Archway-test");
	ASSERT_NE(nullptr, be_clipboard);
	EXPECT_STREQ("system", be_clipboard->Name());

	Copy(*be_clipboard, "hello");

	EXPECT_EQ("hello", Paste(*be_clipboard));
	EXPECT_TRUE(be_clipboard->DataSource() == be_app_messenger);
}
