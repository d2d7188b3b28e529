// BTextView with a long text.
#include <TextView.h>

#include <gtest/gtest.h>

#include <ScrollBar.h>
#include <ScrollView.h>

#include "support/PaintCounter.h"
#include "support/TestWindow.h"

namespace {

constexpr int32 kLines = 100000;
constexpr int32 kLineLength = 100; // bytes, with the line break


std::string
long_text()
{
	std::string line(kLineLength - 1, 'x');
	for (size_t i = 7; i < line.size(); i += 8)
		line[i] = ' ';
	line += '\n';
	std::string text;
	text.reserve(size_t(kLines) * kLineLength);
	for (int32 i = 0; i < kLines; i++)
		text += line;
	return text;
}

} // namespace


// Ten million bytes in 100,000 lines, the caret in the middle. What a key costs is counted; the
// milliseconds are told for comparison.
TEST(TextViewSpeed, AKeyInTheMiddleOfALongTextLaysOutAndPaintsItsLineAlone)
{
	TestWindow window(BRect(20, 20, 819, 619));
	BTextView* view = new BTextView(
		BRect(10, 10, 700, 500), "text", BRect(2, 2, 680, 480), B_FOLLOW_ALL, B_WILL_DRAW);
	window.Add(new BScrollView("scroll", view, B_FOLLOW_ALL, 0, true, true));
	const std::string text = long_text();
	window.Locked([&] {
		view->SetWordWrap(false);
		view->SetText(text.data(), static_cast<int32>(text.size()));
		view->MakeFocus();
		view->Select(kLines / 2 * kLineLength + 50, kLines / 2 * kLineLength + 50);
		view->ScrollToSelection();
	});
	ASSERT_EQ(kLines + 1, view->CountLines());

	window.driver.Type("first"); // what is prepared once
	bigtime_t slowest = 0;
	PaintCounter counter(window.Window());
	const int64 linePixels = static_cast<int64>(view->Bounds().Width() + 1) * 20;
	for (const char* key : { "a", "b", "\n", "c", "d" }) {
		counter.Reset();
		const int64 laidOut = PaintCounter::LinesLaidOut();
		const bigtime_t start = system_time();
		window.driver.Type(key);
		slowest = std::max(slowest, system_time() - start);
		EXPECT_LE(PaintCounter::LinesLaidOut() - laidOut, key[0] == '\n' ? 4 : 2) << key;
		// A line break moves what is below, and the bars show it.
		if (key[0] != '\n') {
			EXPECT_LE(counter.FlushedPixels(), 2 * linePixels) << key;
		}
	}
	EXPECT_EQ(kLines + 2, view->CountLines());
	RecordProperty("microseconds", static_cast<int>(slowest));
	printf("slowest key: %d microseconds\n", static_cast<int>(slowest));
}
