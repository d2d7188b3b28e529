// The palette: its window, its list, and the samples that are dragged from it.

#include "palette/WidgetCatalogue.h"
#include "palette/WidgetListView.h"
#include "palette/WidgetWindow.h"

#include <cmath>
#include <memory>
#include <string>

#include <gtest/gtest.h>

#include <Box.h>
#include <Button.h>
#include <ColorControl.h>
#include <MenuBar.h>
#include <MenuField.h>
#include <MenuItem.h>
#include <Message.h>
#include <ScrollBar.h>
#include <ScrollView.h>
#include <Slider.h>
#include <StatusBar.h>
#include <StringView.h>
#include <TabView.h>
#include <TextControl.h>
#include <TextView.h>

#include "archive/ViewArchive.h"
#include "support/TestWindow.h"

namespace {


constexpr const char* kKinds[] = { "BView", "BView (custom)", "BBox", "BStringView", "BButton",
	"BCheckBox", "BRadioButton", "BTextControl", "BSlider", "BColorControl", "BMenuField",
	"BStatusBar", "BTextView", "BScrollView with BView", "BScrollView with BTextView", "BTabView",
	"BListView", "BOutlineListView", "BMenuBar" };


// Keeps what is dropped on it.
class Receiver : public BView {
public:
	Receiver() : BView(BRect(0, 0, 299, 299), "receiver", B_FOLLOW_NONE, B_WILL_DRAW) {}

	void MessageReceived(BMessage* message) override
	{
		if (message->WasDropped()) {
			drops++;
			dropped = *message;
		} else
			BView::MessageReceived(message);
	}

	int drops = 0;
	BMessage dropped;
};


// A window to drop on, and the palette beside it.
class PaletteTest : public testing::Test {
protected:
	PaletteTest() :
		window(BRect(20, 20, 319, 319)), receiver(window.Add(new Receiver)),
		palette(new WidgetWindow(BPoint(500, 40)))
	{
		palette->Lock();
		palette->Show();
		palette->Unlock();
		Driver::WaitUntilIdle();
		list = dynamic_cast<WidgetListView*>(
			dynamic_cast<BScrollView*>(palette->ChildAt(0))->Target());
	}

	~PaletteTest() override
	{
		palette->Lock();
		palette->Quit();
	}

	int32 IndexOf(const std::string& text)
	{
		for (int32 i = 0; i < list->CountItems(); i++) {
			if (static_cast<BStringItem*>(list->ItemAt(i))->Text() == text)
				return i;
		}
		return -1;
	}

	// Scrolls the entry into sight and drags it over.
	void DragEntry(const char* text)
	{
		const int32 index = IndexOf(text);
		ASSERT_GE(index, 0) << text;
		palette->Lock();
		list->ScrollTo(BPoint(0, std::max(0.0f, list->ItemFrame(index).top - 40)));
		const BRect frame = list->ItemFrame(index);
		palette->Unlock();
		window.driver.Drag(list, BPoint(60, frame.top + 6), receiver, BPoint(150, 150));
	}

	TestWindow window;
	Receiver* receiver;
	WidgetWindow* palette;
	WidgetListView* list;
};


BMessage
ArchiveOf(const char* entry)
{
	const std::unique_ptr<BView> sample(MakeSample(entry));
	BMessage archive;
	sample->Archive(&archive, true);
	return archive;
}


} // namespace


TEST_F(PaletteTest, HasItsWindow)
{
	EXPECT_STREQ("Widgets", palette->Title());
	EXPECT_EQ(BRect(500, 40, 700, 320), palette->Frame());
	EXPECT_EQ(B_FLOATING_WINDOW_LOOK, palette->Look());
	EXPECT_EQ(B_FLOATING_APP_WINDOW_FEEL, palette->Feel());
	EXPECT_EQ(0x82070u, palette->Flags());
	float minWidth, maxWidth, minHeight, maxHeight;
	palette->GetSizeLimits(&minWidth, &maxWidth, &minHeight, &maxHeight);
	EXPECT_EQ(200, minWidth);
	EXPECT_EQ(200, maxWidth);
	EXPECT_EQ(201, minHeight);
	EXPECT_EQ(600, maxHeight);
}


TEST_F(PaletteTest, ListsTheKinds)
{
	std::string text;
	for (int32 i = 0; i < list->FullListCountItems(); i++) {
		const BStringItem* item = static_cast<BStringItem*>(list->FullListItemAt(i));
		text += std::to_string(item->OutlineLevel()) + item->Text() + (item->IsEnabled() ? "" : "!")
			+ ";";
	}
	EXPECT_EQ("0BView;1BView (custom);1BBox;1BStringView;1BControl!;2BButton;2BCheckBox;"
			  "2BRadioButton;2BTextControl;2BSlider;2BColorControl;1BMenuField;1BStatusBar;"
			  "1BTextView;1BScrollView containing...!;2BScrollView with BView;"
			  "2BScrollView with BTextView;1BTabView;1BListView;1BOutlineListView;1BMenuBar;",
		text);
}


TEST_F(PaletteTest, IsMadeHigherButNotWider)
{
	const BRect before = list->Frame();
	window.driver.ResizeWindow(palette, 320, 500);
	EXPECT_EQ(BRect(500, 40, 700, 540), palette->Frame());
	EXPECT_EQ(before.Width(), list->Bounds().Width());
	EXPECT_EQ(before.Height() + 220, list->Bounds().Height());
	window.driver.ResizeWindow(palette, 120, 900);
	EXPECT_EQ(BRect(500, 40, 700, 640), palette->Frame());
	window.driver.ResizeWindow(palette, 200, 50);
	EXPECT_EQ(BRect(500, 40, 700, 241), palette->Frame());
}


TEST_F(PaletteTest, AHeadingIsNeitherSelectedNorDragged)
{
	for (const char* heading : { "BControl", "BScrollView containing..." }) {
		DragEntry(heading);
		window.driver.Click(list, BPoint(60, list->ItemFrame(IndexOf(heading)).top + 5));
		EXPECT_EQ(-1, list->CurrentSelection());
		EXPECT_EQ(0, receiver->drops);
	}
}


// Pale yellow over white, of which a quarter shows; the pointer is in the middle.
TEST_F(PaletteTest, TheDragImageIsTheSampleInItsSize)
{
	for (const char* kind : { "BView", "BView (custom)", "BCheckBox" }) {
		const std::unique_ptr<BView> sample(MakeSample(kind));
		const BRect bounds = sample->Bounds();
		const BRect image = bounds.OffsetByCopy(
			std::floor(150 - bounds.Width() / 2), std::floor(150 - bounds.Height() / 2));
		const int32 index = IndexOf(kind);
		palette->Lock();
		list->ScrollTo(BPoint(0, std::max(0.0f, list->ItemFrame(index).top - 40)));
		const BPoint from(60, list->ItemFrame(index).top + 6);
		palette->Unlock();
		window.driver.MoveTo(list, from);
		window.driver.Press();
		window.driver.MoveTo(list, from + BPoint(-20, 10));
		window.driver.MoveTo(receiver, BPoint(150, 150));

		for (const BPoint& corner :
			{ image.LeftTop(), image.RightTop(), image.LeftBottom(), image.RightBottom() }) {
			const BPoint outwards(corner.x < 150 ? -2.0f : 2.0f, corner.y < 150 ? -2.0f : 2.0f);
			const rgb_color inside = window.driver.PixelAt(receiver, corner - outwards);
			EXPECT_EQ(255, inside.red) << kind;
			EXPECT_NEAR(204 * 192 / 255 + 63, inside.blue, 1) << kind;
			EXPECT_EQ(255, window.driver.PixelAt(receiver, corner + outwards).blue) << kind;
		}
		window.driver.Release();
	}
	EXPECT_EQ(3, receiver->drops);
}


TEST_F(PaletteTest, DragsASampleOfEachKind)
{
	for (const char* kind : kKinds) {
		receiver->drops = 0;
		DragEntry(kind);
		ASSERT_EQ(1, receiver->drops) << kind;
		EXPECT_EQ(uint32('DATA'), receiver->dropped.what);

		BMessage archive;
		ASSERT_EQ(B_OK, receiver->dropped.FindMessage("dropped view", &archive)) << kind;
		EXPECT_EQ(uint32('drop'), archive.what);
		const std::unique_ptr<BView> sample(MakeSample(kind));
		const std::unique_ptr<BView> view(dynamic_cast<BView*>(instantiate_object(&archive)));
		ASSERT_NE(nullptr, view) << kind;
		EXPECT_EQ(sample->Bounds(), view->Bounds()) << kind;
		EXPECT_EQ(sample->Flags(), view->Flags()) << kind;
		EXPECT_EQ(sample->ResizingMode(), view->ResizingMode()) << kind;
	}
}


TEST_F(PaletteTest, TheDragMessageOffersAFile)
{
	DragEntry("BButton");
	const BMessage& drag = receiver->dropped;
	EXPECT_STREQ("application/octet-stream", drag.GetString("be:types", ""));
	EXPECT_STREQ("application/x-be-resource", drag.GetString("be:filetypes", ""));
	int32 action;
	ASSERT_EQ(B_OK, drag.FindInt32("be:actions", 0, &action));
	EXPECT_EQ(int32('DDCP'), action);
	ASSERT_EQ(B_OK, drag.FindInt32("be:actions", 1, &action));
	EXPECT_EQ(int32('DDRM'), action);
	EXPECT_STREQ("DragMe Success", drag.GetString("be:clip_name", ""));
}


TEST(WidgetCatalogue, KnowsNothingElse)
{
	BApplication application("application/x-vnd.Archway-test");
	EXPECT_EQ(NULL, MakeSample("BControl"));
	EXPECT_EQ(NULL, MakeSample("bview"));
	EXPECT_EQ(NULL, MakeSample(""));
}


TEST(WidgetCatalogue, SamplesHaveTheirTextsAndMessages)
{
	BApplication application("application/x-vnd.Archway-test");
	const std::unique_ptr<BView> button(MakeSample("BButton"));
	EXPECT_STREQ("button", dynamic_cast<BButton*>(button.get())->Label());
	EXPECT_EQ(uint32('clik'), dynamic_cast<BButton*>(button.get())->Command());
	EXPECT_EQ(NULL, button->Name());

	const std::unique_ptr<BView> text(MakeSample("BTextControl"));
	EXPECT_STREQ("Hello!", dynamic_cast<BTextControl*>(text.get())->Text());
	EXPECT_EQ(uint32('tval'), dynamic_cast<BTextControl*>(text.get())->Command());

	const std::unique_ptr<BView> view(MakeSample("BSlider"));
	const BSlider* slider = dynamic_cast<BSlider*>(view.get());
	EXPECT_STREQ("Toast:", slider->Label());
	EXPECT_STREQ("light", slider->MinLimitLabel());
	EXPECT_STREQ("dark", slider->MaxLimitLabel());
	EXPECT_EQ(11, slider->HashMarkCount());
	EXPECT_EQ(B_HASH_MARKS_BOTTOM, slider->HashMarks());

	const std::unique_ptr<BView> bar(MakeSample("BMenuBar"));
	BMenu* menu = dynamic_cast<BMenuBar*>(bar.get())->SubmenuAt(0);
	ASSERT_NE(nullptr, menu);
	EXPECT_EQ(6, menu->CountItems());
	EXPECT_STREQ("Save As..", menu->ItemAt(3)->Label());
	EXPECT_EQ(uint32('xxxx'), menu->ItemAt(3)->Command());

	const std::unique_ptr<BView> field(MakeSample("BMenuField"));
	EXPECT_EQ(40, dynamic_cast<BMenuField*>(field.get())->Divider());
	EXPECT_STREQ("Crackel", dynamic_cast<BMenuField*>(field.get())->Menu()->ItemAt(1)->Label());
}


TEST(WidgetCatalogue, SamplesArePaleYellowButForTabsAndLists)
{
	BApplication application("application/x-vnd.Archway-test");
	for (const char* kind : kKinds) {
		const std::unique_ptr<BView> sample(MakeSample(kind));
		const rgb_color color = sample->ViewColor();
		const bool isPale = color.red == 255 && color.green == 255 && color.blue == 204;
		const std::string name = kind;
		const bool keepsItsOwn =
			name == "BTabView" || name == "BListView" || name == "BOutlineListView";
		EXPECT_EQ(!keepsItsOwn, isPale) << kind;
	}
}


TEST(WidgetCatalogue, TheScrolledViewScrolls)
{
	BApplication application("application/x-vnd.Archway-test");
	const std::unique_ptr<BView> view(MakeSample("BScrollView with BView"));
	const BScrollView* scroll = dynamic_cast<BScrollView*>(view.get());
	float minimum, maximum, small, big;
	scroll->ScrollBar(B_VERTICAL)->GetRange(&minimum, &maximum);
	EXPECT_EQ(72, maximum);
	scroll->ScrollBar(B_VERTICAL)->GetSteps(&small, &big);
	EXPECT_EQ(5, small);
	EXPECT_EQ(10, big);
	scroll->ScrollBar(B_HORIZONTAL)->GetSteps(&small, &big);
	EXPECT_EQ(10, small);
	EXPECT_EQ(30, big);
}


TEST(WidgetCatalogue, ArchivesSurviveARevival)
{
	BApplication application("application/x-vnd.Archway-test");
	for (const char* kind : kKinds) {
		const BMessage before = ArchiveOf(kind);
		BMessage copy(before);
		const std::unique_ptr<BView> view(dynamic_cast<BView*>(instantiate_object(&copy)));
		ASSERT_NE(nullptr, view) << kind;
		BMessage after;
		view->Archive(&after, true);
		EXPECT_TRUE(Equal(&before, &after)) << kind;
	}
}
