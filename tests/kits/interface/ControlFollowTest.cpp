// Controls of every class follow a parent that is resized by their mode.
#include <Box.h>
#include <Button.h>
#include <ChannelSlider.h>
#include <CheckBox.h>
#include <ColorControl.h>
#include <Dragger.h>
#include <ListView.h>
#include <MenuBar.h>
#include <MenuField.h>
#include <OptionPopUp.h>
#include <OutlineListView.h>
#include <PictureButton.h>
#include <RadioButton.h>
#include <ScrollBar.h>
#include <ScrollView.h>
#include <Slider.h>
#include <StatusBar.h>
#include <StringView.h>
#include <TabView.h>
#include <TextControl.h>
#include <TextView.h>

#include "ControlFixture.h"

namespace {

const BRect kFrame(20, 20, 179, 79);

std::vector<BView*>
OneOfEachClass()
{
	return {
		new BBox(kFrame, "box"),
		new BButton(kFrame, "button", "Label", NULL),
		new BChannelSlider(kFrame, "channels", "Label", NULL, 3),
		new BCheckBox(kFrame, "check", "Label", NULL),
		new BColorControl(kFrame.LeftTop(), B_CELLS_32x8, 6, "color"),
		new BDragger(kFrame, NULL),
		new BOptionPopUp(kFrame, "options", "Label", NULL),
		new BPictureButton(kFrame, "picture", NULL),
		new BRadioButton(kFrame, "radio", "Label", NULL),
		new BSlider(kFrame, "slider", "Label", NULL, 0, 100),
		new BStatusBar(kFrame, "status", "Label"),
		new BStringView(kFrame, "string", "Text"),
		new BTabView(kFrame, "tabs"),
		new BTextControl(kFrame, "field", "Label", "Text", NULL),
		new BTextView(kFrame, "text", kFrame.OffsetToCopy(0, 0), 0, B_WILL_DRAW),
		new BListView(kFrame, "list"),
		new BOutlineListView(kFrame, "outline"),
		new BScrollView("scroller", new BView(kFrame, "target", B_FOLLOW_ALL, B_WILL_DRAW)),
		new BScrollBar(kFrame, "bar", NULL, 0, 10, B_VERTICAL),
		new BMenuField(kFrame, "menu field", "Label", new BMenu("menu")),
		new BMenuBar(kFrame, "menu bar", 0, B_ITEMS_IN_ROW, false),
	};
}

} // namespace


TEST(ControlFollow, EveryClassKeepsItsMode)
{
	ControlFixture fixture;
	for (const uint32 mode : { B_FOLLOW_LEFT | B_FOLLOW_TOP, B_FOLLOW_RIGHT | B_FOLLOW_BOTTOM,
			 B_FOLLOW_LEFT_RIGHT | B_FOLLOW_TOP, B_FOLLOW_ALL_SIDES }) {
		for (BView* view : OneOfEachClass()) {
			view->SetResizingMode(mode);
			fixture.Add(view);
			const BRect before = fixture.Locked([&] { return view->Frame(); });
			fixture.Locked([&] { fixture.window->ResizeBy(30, 10); });

			BRect expected = before;
			if ((mode & 0x0f00) == (B_FOLLOW_RIGHT & 0x0f00))
				expected.left += 30;
			if ((mode & 0x000f) == (B_FOLLOW_RIGHT & 0x000f))
				expected.right += 30;
			if ((mode & 0xf000) == (B_FOLLOW_BOTTOM & 0xf000))
				expected.top += 10;
			if ((mode & 0x00f0) == (B_FOLLOW_BOTTOM & 0x00f0))
				expected.bottom += 10;
			fixture.Locked([&] {
				EXPECT_EQ(expected, view->Frame()) << view->Name() << ", mode " << mode;
				view->RemoveSelf();
				fixture.window->ResizeBy(-30, -10);
			});
			delete view;
		}
	}
}
