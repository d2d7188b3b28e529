// Fields that bear a known name but a type that nobody writes there.

#include <memory>
#include <ostream>
#include <string>

#include <gtest/gtest.h>

#include <Application.h>
#include <Box.h>
#include <Button.h>
#include <ChannelSlider.h>
#include <ListView.h>
#include <Message.h>
#include <Slider.h>
#include <StatusBar.h>
#include <TextView.h>

#include "support/Dump.h"

namespace {

struct Field {
	const char* className;
	const char* name;
};


std::ostream&
operator<<(std::ostream& out, const Field& field)
{
	return out << field.className << ' ' << field.name;
}


class FieldTypes : public testing::TestWithParam<Field> {
protected:
	static std::unique_ptr<BView> Make()
	{
		const BRect frame(0, 0, 99, 49);
		const std::string name = GetParam().className;
		if (name == "BView")
			return std::make_unique<BView>(frame, "view", B_FOLLOW_NONE, B_WILL_DRAW);
		if (name == "BBox")
			return std::make_unique<BBox>(frame, "box");
		if (name == "BButton")
			return std::make_unique<BButton>(frame, "button", "Press", new BMessage('pres'));
		if (name == "BChannelSlider")
			return std::make_unique<BChannelSlider>(frame, "channels", "How much", nullptr, 2);
		if (name == "BListView")
			return std::make_unique<BListView>(frame, "list");
		if (name == "BSlider")
			return std::make_unique<BSlider>(frame, "slider", "How much", nullptr, 0, 9);
		if (name == "BStatusBar")
			return std::make_unique<BStatusBar>(frame, "bar");
		return std::make_unique<BTextView>(frame, "text", frame, B_FOLLOW_NONE, B_WILL_DRAW);
	}

	BApplication fApplication { "application/x-vnd.Archway-test" };
};

} // namespace


TEST_P(FieldTypes, OfNoUseAreCarriedAlong)
{
	BMessage archive;
	ASSERT_EQ(B_OK, Make()->Archive(&archive));
	archive.RemoveName(GetParam().name);
	ASSERT_EQ(B_OK, archive.AddInt8(GetParam().name, 5));

	const std::unique_ptr<BArchivable> object(instantiate_object(&archive));
	ASSERT_NE(nullptr, object);
	BMessage written;
	ASSERT_EQ(B_OK, object->Archive(&written));
	EXPECT_EQ("", test::first_difference(archive, written));
}


INSTANTIATE_TEST_SUITE_P(Of, FieldTypes,
	testing::Values(Field { "BView", "_evmask" }, Field { "BView", "_frame" },
		Field { "BView", "_origin" }, Field { "BBox", "_lblview" }, Field { "BButton", "_default" },
		Field { "BButton", "_disable" }, Field { "BChannelSlider", "_orient" },
		Field { "BListView", "_l_items" }, Field { "BSlider", "_minlbl" },
		Field { "BStatusBar", "_ltext" }, Field { "BTextView", "_nsel" }),
	[](const auto& info) { return std::string(info.param.className) + info.param.name; });


TEST(FieldTypesOfAFrame, GiveWayWhenTheViewIsMoved)
{
	BApplication application("application/x-vnd.Archway-test");
	BMessage archive;
	ASSERT_EQ(B_OK, BView(BRect(), "view", B_FOLLOW_NONE, 0).Archive(&archive));
	archive.RemoveName("_frame");
	archive.AddString("_frame", "somewhere");
	const std::unique_ptr<BView> view(dynamic_cast<BView*>(instantiate_object(&archive)));
	ASSERT_NE(nullptr, view);
	view->MoveTo(3, 4);
	BMessage written;
	ASSERT_EQ(B_OK, view->Archive(&written));
	BRect frame;
	EXPECT_EQ(B_OK, written.FindRect("_frame", &frame));
	EXPECT_EQ(view->Frame(), frame);
}
