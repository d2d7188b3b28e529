// What the classes say to scripts.
#include <functional>
#include <memory>

#include <Alert.h>
#include <Box.h>
#include <Button.h>
#include <ChannelSlider.h>
#include <CheckBox.h>
#include <ColorControl.h>
#include <ListView.h>
#include <MenuBar.h>
#include <MenuField.h>
#include <OptionPopUp.h>
#include <OutlineListView.h>
#include <PopUpMenu.h>
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


const BRect kFrame(20, 20, 119, 59);

std::string
SuitesOf(BHandler& handler)
{
	BMessage data;
	EXPECT_EQ(B_OK, handler.GetSupportedSuites(&data));
	std::string suites;
	const char* suite;
	for (int32 i = 0; data.FindString("suites", i, &suite) == B_OK; i++)
		suites += (i > 0 ? " " : "") + std::string(suite);
	return suites;
}

// A script's message: the property is asked of the view, which the window holds.
BMessage
Ask(BWindow* window, BMessage message, const char* property, const char* view = NULL)
{
	message.AddSpecifier(property);
	if (view != NULL)
		message.AddSpecifier("View", view);
	BMessage answer;
	EXPECT_EQ(B_OK, BMessenger(window).SendMessage(&message, &answer));
	return answer;
}


BMessage
Setting(const BRect& value)
{
	BMessage message(B_SET_PROPERTY);
	message.AddRect("data", value);
	return message;
}


BMessage
Setting(bool value)
{
	BMessage message(B_SET_PROPERTY);
	message.AddBool("data", value);
	return message;
}

} // namespace


TEST(Scripting, EveryClassNamesItsSuites)
{
	BApplication app("application/x-vnd.Archway-test");
	BView view(kFrame, "", 0, 0);
	const std::string base = SuitesOf(view);
	EXPECT_NE("", base);

	BButton button(kFrame, "", "", NULL);
	BCheckBox check(kFrame, "", "", NULL);
	BRadioButton radio(kFrame, "", "", NULL);
	BTextControl field(kFrame, "", "", "", NULL);
	BSlider slider(kFrame, "", "", NULL, 0, 1);
	BColorControl color(BPoint(0, 0), B_CELLS_16x16, 4, "");
	BOptionPopUp options(kFrame, "", "", NULL);
	BControl* const controls[] = { &button, &check, &radio, &field, &slider, &color, &options };
	for (BControl* control : controls)
		EXPECT_EQ("suite/vnd.Be-control " + base, SuitesOf(*control)) << "GetSupportedSuites()";

	BChannelSlider channels(kFrame, "", "", NULL);
	EXPECT_EQ("suite/vnd.Be-channel-control suite/vnd.Be-control " + base, SuitesOf(channels));

	BListView list(kFrame, "");
	BOutlineListView outline(kFrame, "");
	EXPECT_EQ("suite/vnd.Be-list-view " + base, SuitesOf(list));
	EXPECT_EQ("suite/vnd.Be-list-view " + base, SuitesOf(outline));
	BMenu menu("menu");
	BMenuBar bar(kFrame, "");
	BPopUpMenu popUp("");
	for (BMenu* each : { &menu, static_cast<BMenu*>(&bar), static_cast<BMenu*>(&popUp) })
		EXPECT_EQ("suite/vnd.Be-menu " + base, SuitesOf(*each));
	BTextView text(kFrame, "", kFrame, 0, 0);
	EXPECT_NE(std::string::npos, SuitesOf(text).find("suite/vnd.Be-text-view"));

	BBox box(kFrame);
	BStatusBar status(kFrame, "");
	BStringView string(kFrame, "", "");
	BTabView tabs(kFrame, "");
	BScrollView scroller("", NULL);
	BScrollBar scrollBar(kFrame, "", NULL, 0, 1, B_VERTICAL);
	BMenuField menuField(kFrame, "", "", new BMenu(""));
	BView* const plain[] = { &box, &status, &string, &tabs, &scroller, &scrollBar, &menuField };
	for (BView* each : plain)
		EXPECT_EQ(base, SuitesOf(*each)) << typeid(*each).name();
	BHandler handler;
	EXPECT_EQ("suite/vnd.Be-view " + SuitesOf(handler), base);
}


TEST(Scripting, EveryClassFindsItsChildrenByNameAndPlace)
{
	BApplication app("application/x-vnd.Archway-test");
	BView view(kFrame, "", 0, 0);
	BBox box(kFrame);
	BButton button(kFrame, "", "", NULL);
	BCheckBox check(kFrame, "", "", NULL);
	BRadioButton radio(kFrame, "", "", NULL);
	BTextControl field(kFrame, "", "", "", NULL);
	BSlider slider(kFrame, "", "", NULL, 0, 1);
	BColorControl color(BPoint(0, 0), B_CELLS_16x16, 4, "");
	BStatusBar status(kFrame, "");
	BStringView string(kFrame, "", "");
	BTextView text(kFrame, "", kFrame, 0, 0);
	BListView list(kFrame, "");
	BOutlineListView outline(kFrame, "");
	BTabView tabs(kFrame, "");
	BScrollView scroller("", NULL);
	BScrollBar bar(kFrame, "", NULL, 0, 1, B_VERTICAL);
	BMenuField menuField(kFrame, "", "", new BMenu(""));
	BMenuBar menuBar(kFrame, "");
	BPopUpMenu popUp("");
	BMenu menu("menu");
	BControl control(kFrame, "", "", NULL, 0, 0);
	BChannelSlider channels(kFrame, "", "", NULL);
	BOptionPopUp options(kFrame, "", "", NULL);
	BView* const views[] = { &view, &box, &button, &check, &radio, &field, &slider, &color, &status,
		&string, &text, &list, &outline, &tabs, &scroller, &bar, &menuField, &menuBar, &popUp,
		&menu, &control, &options, &channels };
	for (BView* each : views) {
		SCOPED_TRACE(typeid(*each).name());
		BView* inner = new BView(BRect(0, 0, 5, 5), "inner", 0, 0);
		each->AddChild(inner);
		BMessage byName(B_GET_PROPERTY);
		byName.AddSpecifier("View", "inner");
		int32 index, form;
		BMessage specifier;
		const char* property;
		ASSERT_EQ(B_OK, byName.GetCurrentSpecifier(&index, &specifier, &form, &property));
		EXPECT_EQ(inner, each->ResolveSpecifier(&byName, index, &specifier, form, property));

		BMessage byPlace(B_GET_PROPERTY);
		byPlace.AddSpecifier("View", each->CountChildren() - 1);
		ASSERT_EQ(B_OK, byPlace.GetCurrentSpecifier(&index, &specifier, &form, &property));
		EXPECT_EQ(inner, each->ResolveSpecifier(&byPlace, index, &specifier, form, property));

		BMessage unknown(B_GET_PROPERTY);
		unknown.AddSpecifier("View", "nobody");
		ASSERT_EQ(B_OK, unknown.GetCurrentSpecifier(&index, &specifier, &form, &property));
		EXPECT_EQ(nullptr, each->ResolveSpecifier(&unknown, index, &specifier, form, property));
	}
}


TEST(Scripting, AWindowFindsItsViewsAndControlsAnswer)
{
	ControlFixture fixture;
	BWindow* window = fixture.window;
	BCheckBox* check = fixture.Add(new BCheckBox(kFrame, "check", "A label", NULL));
	fixture.Locked([&] {
		EXPECT_EQ(SuitesOf(*fixture.window), SuitesOf(*window));
		BMessage direct(B_GET_PROPERTY);
		direct.AddSpecifier("View", "check");
		int32 index, form;
		BMessage specifier;
		const char* property;
		ASSERT_EQ(B_OK, direct.GetCurrentSpecifier(&index, &specifier, &form, &property));
		EXPECT_EQ(check, window->ResolveSpecifier(&direct, index, &specifier, form, property));
	});

	BMessage ask(B_GET_PROPERTY), answer;
	ask.AddSpecifier("Label");
	ask.AddSpecifier("View", "check");
	ASSERT_EQ(B_OK, BMessenger(window).SendMessage(&ask, &answer));
	EXPECT_STREQ("A label", answer.GetString("result", ""));

	BMessage set(B_SET_PROPERTY), done;
	set.AddSpecifier("Value");
	set.AddSpecifier("View", "check");
	set.AddInt32("data", 1);
	ASSERT_EQ(B_OK, BMessenger(window).SendMessage(&set, &done));
	EXPECT_EQ(B_OK, done.GetInt32("error", B_ERROR));
	EXPECT_EQ(1, fixture.Locked([&] { return check->Value(); }));
}


TEST(Scripting, AnAlertIsAWindow)
{
	BApplication app("application/x-vnd.Archway-test");
	BAlert* alert = new BAlert("Title", "Text", "OK");
	BWindow* window = new BWindow(BRect(0, 0, 9, 9), "", B_TITLED_WINDOW, 0);
	EXPECT_EQ(SuitesOf(*window), SuitesOf(*alert)) << "GetSupportedSuites()";
	BMessage ask(B_GET_PROPERTY);
	ask.AddSpecifier("View", "_tv_");
	int32 index, form;
	BMessage specifier;
	const char* property;
	ASSERT_EQ(B_OK, ask.GetCurrentSpecifier(&index, &specifier, &form, &property));
	EXPECT_EQ(alert->TextView(), alert->ResolveSpecifier(&ask, index, &specifier, form, property));
	alert->Quit();
	window->Quit();
}


TEST(Scripting, ViewsTellAndChangeTheirFrameAndVisibility)
{
	ControlFixture fixture;
	BView* view = fixture.Add(new BView(kFrame, "view", B_FOLLOW_NONE, B_WILL_DRAW));
	BWindow* window = fixture.window;
	BRect frame;
	EXPECT_EQ(B_OK, Ask(window, B_GET_PROPERTY, "Frame", "view").FindRect("result", &frame));
	EXPECT_EQ(kFrame, frame);
	EXPECT_FALSE(Ask(window, B_GET_PROPERTY, "Hidden", "view").GetBool("result", true));
	EXPECT_EQ(1, Ask(window, B_COUNT_PROPERTIES, "View", "ground").GetInt32("result", -1));

	const BRect other(3, 4, 50, 60);
	EXPECT_EQ(B_OK, Ask(window, Setting(other), "Frame", "view").GetInt32("error", B_ERROR));
	EXPECT_EQ(other, fixture.Locked([&] { return view->Frame(); }));
	EXPECT_EQ(B_OK, Ask(window, Setting(true), "Hidden", "view").GetInt32("error", B_ERROR));
	EXPECT_EQ(B_OK, Ask(window, Setting(true), "Hidden", "view").GetInt32("error", B_ERROR));
	EXPECT_TRUE(fixture.Locked([&] { return view->IsHidden(); }));
	EXPECT_EQ(B_OK, Ask(window, Setting(false), "Hidden", "view").GetInt32("error", B_ERROR));
	EXPECT_FALSE(fixture.Locked([&] { return view->IsHidden(); })) << "hidden once";

	EXPECT_EQ(B_BAD_VALUE, Ask(window, Setting(true), "Frame", "view").GetInt32("error", B_OK));
	EXPECT_EQ(uint32(B_MESSAGE_NOT_UNDERSTOOD), Ask(window, B_GET_PROPERTY, "Bogus").what);
}


TEST(Scripting, WindowsTellAndChangeTheirProperties)
{
	ControlFixture fixture;
	BWindow* window = fixture.window;
	const auto number = [&](const char* property) {
		return Ask(window, B_GET_PROPERTY, property).GetInt32("result", -1);
	};
	EXPECT_STREQ("Controls", Ask(window, B_GET_PROPERTY, "Title").GetString("result", ""));
	EXPECT_EQ(B_TITLED_WINDOW_LOOK, number("Look"));
	EXPECT_EQ(B_NORMAL_WINDOW_FEEL, number("Feel"));
	EXPECT_EQ(B_ASYNCHRONOUS_CONTROLS, number("Flags"));
	EXPECT_EQ(1, Ask(window, B_COUNT_PROPERTIES, "View").GetInt32("result", -1));
	EXPECT_FALSE(Ask(window, B_GET_PROPERTY, "Hidden").GetBool("result", true));

	BMessage title(B_SET_PROPERTY);
	title.AddString("data", "Renamed");
	EXPECT_EQ(B_OK, Ask(window, title, "Title").GetInt32("error", B_ERROR));
	BMessage look(B_SET_PROPERTY);
	look.AddInt32("data", B_DOCUMENT_WINDOW_LOOK);
	EXPECT_EQ(B_OK, Ask(window, look, "Look").GetInt32("error", B_ERROR));
	const BRect frame(20, 30, 220, 180);
	EXPECT_EQ(B_OK, Ask(window, Setting(frame), "Frame").GetInt32("error", B_ERROR));
	EXPECT_EQ(B_OK, Ask(window, Setting(true), "Hidden").GetInt32("error", B_ERROR));
	fixture.Locked([&] {
		EXPECT_STREQ("Renamed", window->Title());
		EXPECT_EQ(B_DOCUMENT_WINDOW_LOOK, window->Look());
		EXPECT_EQ(frame, window->Frame());
		EXPECT_TRUE(window->IsHidden());
	});
}
