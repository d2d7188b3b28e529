// The backend of real windows, on a platform without a screen.

#include "kits/server/DesktopFixture.h"

#include <algorithm>
#include <cstdlib>

#include <TypeConstants.h>

#include "kernel/private/Activity.h"
#include "server/WindowRecord.h"
#include "server/paint/Surface.h"
#include "server/play/Picture.h"

namespace BPrivate {

namespace {

class QtBackend : public DesktopTest {
protected:
	void SetUp() override
	{
		setenv("ARCHWAY_BACKEND", "qt", 1);
		setenv("QT_QPA_PLATFORM", "offscreen", 1);
		DesktopTest::SetUp();
	}

	static void WaitUntilIdle() { ASSERT_TRUE(wait_until_idle(20000000)); }
};


uint32
ScreenPixel(BPoint where)
{
	const BRect place(where.x, where.y, where.x, where.y);
	return ToPixel(color_at(Desktop::Get()->Picture(place), 0, 0));
}

} // namespace


TEST_F(QtBackend, ShowsWhatIsPresented)
{
	EXPECT_EQ("qt", Desktop::Get()->BackendName());
	TestWindow window(BRect(20, 30, 119, 129));
	WaitUntilIdle();
	Surface& back = window.server.Back();
	for (int32 y = 0; y < back.DeviceHeight(); y++)
		std::fill_n(back.Row(y), back.DeviceWidth(), 0xff00ff00);
	const int64 flushes = window.server.Record().flushes;
	BRegion all;
	all.Set(back.LogicalBounds());
	window.server.Present(all);
	WaitUntilIdle();
	EXPECT_EQ(flushes + 1, window.server.Record().flushes);
	EXPECT_EQ(0xff00ff00u, ScreenPixel(BPoint(20, 30)));
	EXPECT_EQ(0xff00ff00u, ScreenPixel(BPoint(119, 129)));
	EXPECT_NE(0xff00ff00u, ScreenPixel(BPoint(120, 129)));
}


TEST_F(QtBackend, ActivatesAWindowThatIsShown)
{
	TestWindow window(BRect(20, 30, 119, 129));
	WaitUntilIdle();
	EXPECT_TRUE(window.server.IsActive());
	EXPECT_EQ(1u, window.Take(B_WINDOW_ACTIVATED).size());
}


TEST_F(QtBackend, ReportsFrames)
{
	TestWindow window(BRect(20, 30, 119, 129));
	WaitUntilIdle();
	window.Take();
	window.server.SetFrame(BRect(40, 50, 239, 149));
	WaitUntilIdle();
	EXPECT_EQ(BRect(40, 50, 239, 149), window.server.Frame());
	const Messages sizes = window.Take(B_WINDOW_RESIZED);
	ASSERT_EQ(1u, sizes.size());
	EXPECT_EQ(199, sizes[0]->FindInt32("width"));
	EXPECT_EQ(99, sizes[0]->FindInt32("height"));
}


TEST_F(QtBackend, RoutesThePointerAndKeys)
{
	TestWindow window(BRect(20, 30, 119, 129));
	WaitUntilIdle();
	window.Take();
	input.Move(BPoint(30, 50));
	input.Press(1);
	input.Release(1);
	input.KeyDown(stroke_of_character("k"));
	WaitUntilIdle();

	const Messages all = window.Take();
	ASSERT_LE(4u, all.size());
	EXPECT_EQ(uint32(B_MOUSE_MOVED), all[0]->what);
	EXPECT_EQ(uint32(B_MOUSE_DOWN), all[1]->what);
	EXPECT_EQ(BPoint(10, 20), all[1]->FindPoint("where"));
	EXPECT_EQ(uint32(B_MOUSE_UP), all[2]->what);
	EXPECT_STREQ("k", all.back()->FindString("bytes"));
}


TEST_F(QtBackend, DragsFromWindowToWindow)
{
	TestWindow target(BRect(200, 30, 299, 129));
	TestWindow source(BRect(20, 30, 119, 129));
	WaitUntilIdle();
	input.Move(BPoint(50, 50));
	input.Press(1);
	Settle();
	DragImage image;
	image.width = image.height = 10;
	Desktop::Get()->StartDrag(source.server, std::make_unique<BMessage>('drag'), image);
	input.Move(BPoint(60, 60));
	input.Move(BPoint(250, 60));
	input.Release(1);
	WaitUntilIdle();
	const Messages drops = target.Take(_MESSAGE_DROPPED_);
	ASSERT_EQ(1u, drops.size());
	EXPECT_EQ(BPoint(250, 60), drops[0]->FindPoint("_drop_point_"));
}


TEST_F(QtBackend, KeepsTheClipboard)
{
	BMessage data(B_MIME_DATA), read;
	data.AddData("text/plain", B_MIME_TYPE, "h\xc3\xa9llo", 6, false);
	Desktop::Get()->SetClipboard(data);
	ASSERT_EQ(B_OK, Desktop::Get()->GetClipboard(&read));
	EXPECT_TRUE(read.HasSameData(data));
}


TEST_F(QtBackend, TasksRunInTheirOrder)
{
	std::vector<int> order;
	for (int i = 0; i < 100; i++)
		Desktop::Get()->Post([&order, i] { order.push_back(i); });
	Settle();
	ASSERT_EQ(100u, order.size());
	EXPECT_TRUE(std::is_sorted(order.begin(), order.end()));
}


} // namespace BPrivate
