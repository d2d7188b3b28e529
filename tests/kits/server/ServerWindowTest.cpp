#include "kits/server/DesktopFixture.h"

#include <TypeConstants.h>

#include "kernel/private/Activity.h"
#include "server/Desktop.h"
#include "server/WindowRecord.h"
#include "server/paint/Surface.h"
#include "server/play/Picture.h"

namespace BPrivate {

using ServerWindowTest = DesktopTest;

namespace {

void
Fill(Surface& surface, uint32 pixel)
{
	for (int32 y = 0; y < surface.DeviceHeight(); y++)
		std::fill_n(surface.Row(y), surface.DeviceWidth(), pixel);
}


uint32
ScreenPixel(BPoint where)
{
	const BRect place(where.x, where.y, where.x, where.y);
	return ToPixel(color_at(Desktop::Get()->Picture(place), 0, 0));
}

} // namespace


TEST_F(ServerWindowTest, OnlyWhatIsPresentedIsShown)
{
	TestWindow window(BRect(10, 10, 29, 29));
	Fill(window.server.Back(), 0xff0000ff);
	BRegion part;
	part.Set(BRect(0, 0, 19, 19));
	window.server.Present(part);
	Settle();
	EXPECT_EQ(0xff0000ffu, ScreenPixel(BPoint(12, 12)));

	Fill(window.server.Back(), 0xffff0000);
	part.Set(BRect(0, 0, 4, 4));
	window.server.Present(part);
	Settle();
	EXPECT_EQ(0xffff0000u, ScreenPixel(BPoint(14, 14)));
	EXPECT_EQ(0xff0000ffu, ScreenPixel(BPoint(15, 15)));
}


TEST_F(ServerWindowTest, OnePresentIsOneFlush)
{
	TestWindow window(BRect(10, 10, 29, 29));
	Settle();
	const WindowRecord& record = window.server.Record();
	const int64 before = record.flushes;
	BRegion damage;
	damage.Include(BRect(0, 0, 3, 3));
	damage.Include(BRect(10, 10, 12, 12));
	window.server.Present(damage);
	Settle();
	EXPECT_EQ(before + 1, record.flushes);
}


TEST_F(ServerWindowTest, PresentsThatPileUpShareAFlush)
{
	TestWindow window(BRect(10, 10, 29, 29));
	Settle();
	const WindowRecord& record = window.server.Record();
	const int64 before = record.flushes;
	BRegion damage;
	damage.Set(BRect(0, 0, 3, 3));
	Desktop::Get()->RunOnDisplay([&] {
		for (int i = 0; i < 10; i++)
			window.server.Present(damage);
	});
	Settle();
	EXPECT_EQ(before + 1, record.flushes);
}


TEST_F(ServerWindowTest, FrameOfTheProgramIsReportedBack)
{
	TestWindow window(BRect(10, 10, 29, 29));
	Settle();
	window.Take();
	window.server.SetFrame(BRect(20, 30, 119, 59));
	EXPECT_EQ(BRect(20, 30, 119, 59), window.server.Frame());
	Settle();
	const Messages messages = window.Take();
	ASSERT_EQ(2u, messages.size());
	EXPECT_EQ(uint32(B_WINDOW_MOVED), messages[0]->what);
	EXPECT_EQ(BPoint(20, 30), messages[0]->FindPoint("where"));
	EXPECT_EQ(uint32(B_WINDOW_RESIZED), messages[1]->what);
	EXPECT_EQ(99, messages[1]->FindInt32("width"));
	EXPECT_EQ(29, messages[1]->FindInt32("height"));
}


TEST_F(ServerWindowTest, UsersFrameIsWithinTheLimits)
{
	TestWindow window(BRect(10, 10, 109, 109));
	window.server.SetSizeLimits(50, 150, 60, 160);
	Settle();
	window.Take();
	BackendEvent event;
	event.type = BackendEvent::Type::WindowChanged;
	event.frame.Set(10, 10, 20, 500);
	Desktop::Get()->Inject(event, window.server.Id());
	Settle();
	EXPECT_EQ(BRect(10, 10, 60, 170), window.server.Frame());
}


TEST_F(ServerWindowTest, BackSurfaceFollowsTheFrameAndKeepsItsPixels)
{
	TestWindow window(BRect(0, 0, 19, 19));
	Fill(window.server.Back(), 0xff112233);
	window.server.SetFrame(BRect(0, 0, 39, 29));
	EXPECT_TRUE(window.server.Prepare());
	EXPECT_FALSE(window.server.Prepare());
	EXPECT_EQ(40, window.server.Back().Width());
	EXPECT_EQ(30, window.server.Back().Height());
	EXPECT_EQ(0xff112233u, window.server.Back().Row(10)[10]);
}


TEST_F(ServerWindowTest, WindowOfNoSizeHasAPixel)
{
	TestWindow window(BRect(0, 0, -5, -5));
	EXPECT_EQ(1, window.server.Back().Width());
	EXPECT_EQ(1, window.server.Back().Height());
}


TEST_F(ServerWindowTest, ManyThreadsMayOpenAndCloseWindows)
{
	std::vector<std::thread> threads;
	for (int i = 0; i < 4; i++) {
		threads.emplace_back([] {
			for (int n = 0; n < 20; n++) {
				TestWindow window(BRect(0, 0, 49, 49));
				BRegion damage;
				damage.Set(BRect(0, 0, 49, 49));
				window.server.Present(damage);
				window.server.SetFrame(BRect(5, 5, 60, 60));
				window.server.Prepare();
				window.server.Present(damage);
			}
		});
	}
	for (int i = 0; i < 100; i++)
		Click(BPoint(20, 20));
	for (std::thread& thread : threads)
		thread.join();
	EXPECT_TRUE(wait_until_idle(10000000));
}


TEST_F(ServerWindowTest, ClipboardGivesBackWhatWasPut)
{
	BMessage data(B_MIME_DATA);
	data.AddData("text/plain", B_MIME_TYPE, "hello", 5, false);
	const uint32 before = Desktop::Get()->ClipboardSerial();
	Desktop::Get()->SetClipboard(data);
	EXPECT_NE(before, Desktop::Get()->ClipboardSerial());
	BMessage read;
	ASSERT_EQ(B_OK, Desktop::Get()->GetClipboard(&read));
	EXPECT_TRUE(read.HasSameData(data));
	Settle();
	const Messages messages = application.Take();
	ASSERT_EQ(1u, messages.size());
	EXPECT_EQ(uint32(kClipboardChanged), messages[0]->what);
}


} // namespace BPrivate
