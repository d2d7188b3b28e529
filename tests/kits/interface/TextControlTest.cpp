#include <TextControl.h>

#include <gtest/gtest.h>

#include <vector>

#include <Message.h>
#include <TextView.h>

#include "support/TestWindow.h"

namespace {

constexpr uint32 kInvoked = 'invk';
constexpr uint32 kModified = 'modf';

// A window that remembers the codes it is sent, and the fields of the last message.
struct Recorder : BWindow {
	Recorder() :
		BWindow(BRect(50, 50, 449, 349), "recorder", B_TITLED_WINDOW, B_ASYNCHRONOUS_CONTROLS)
	{
	}

	void MessageReceived(BMessage* message) override
	{
		if (message->what == kInvoked || message->what == kModified) {
			codes.push_back(message->what);
			last = *message;
		} else {
			BWindow::MessageReceived(message);
		}
	}

	std::vector<uint32> codes;
	BMessage last;
};

struct Fields {
	Fields() : app("application/x-vnd.Archway-test"), window(new Recorder)
	{
		first = new BTextControl(
			BRect(10, 10, 209, 30), "first", "Label:", "text", new BMessage(kInvoked));
		second = new BTextControl(BRect(10, 50, 209, 70), "second", NULL, "other", NULL);
		window->AddChild(first);
		window->AddChild(second);
		window->Show();
		Driver::WaitUntilIdle();
	}

	~Fields()
	{
		window->Lock();
		window->Quit();
	}

	void Locked(const std::function<void()>& function)
	{
		window->Lock();
		function();
		window->Unlock();
		Driver::WaitUntilIdle();
	}

	std::vector<uint32> TakeCodes()
	{
		std::vector<uint32> codes;
		Locked([&] { codes.swap(window->codes); });
		return codes;
	}

	BApplication app;
	Driver driver;
	Recorder* window;
	BTextControl* first;
	BTextControl* second;
};

typedef std::vector<uint32> Codes;

} // namespace


TEST(TextControl, HasItsFieldRightOfTheDivider)
{
	BApplication app("application/x-vnd.Archway-test");
	const std::unique_ptr<BTextControl> control(
		new BTextControl(BRect(10, 10, 210, 40), "name", "Label:", "text", NULL));
	EXPECT_EQ(100, control->Divider());
	BTextView* input = control->TextView();
	ASSERT_EQ(input, control->FindView("_input_"));
	EXPECT_EQ(BRect(102, 2, 198, 28), input->Frame());
	EXPECT_EQ(B_FOLLOW_ALL, input->ResizingMode());
	EXPECT_TRUE(input->Flags() & B_NAVIGABLE);
	EXPECT_FALSE(control->Flags() & B_NAVIGABLE);
	EXPECT_TRUE(control->Flags() & B_FRAME_EVENTS);
	EXPECT_FALSE(input->DoesWordWrap());
	EXPECT_STREQ("text", control->Text());

	control->SetDivider(40.4f);
	EXPECT_EQ(40, control->Divider());
	EXPECT_EQ(BRect(42, 2, 198, 28), input->Frame());
}


TEST(TextControl, WithoutLabelTheFieldTakesTheWholeWidth)
{
	BApplication app("application/x-vnd.Archway-test");
	const std::unique_ptr<BTextControl> control(
		new BTextControl(BRect(0, 0, 100, 30), "name", NULL, NULL, NULL));
	EXPECT_EQ(0, control->Divider());
	EXPECT_EQ(2, control->TextView()->Frame().left);
}


TEST(TextControl, IsRaisedToTheHeightOfItsFont)
{
	BApplication app("application/x-vnd.Archway-test");
	const std::unique_ptr<BTextControl> control(
		new BTextControl(BRect(0, 0, 100, 5), "name", "x", "y", NULL));
	font_height height;
	control->GetFontHeight(&height);
	EXPECT_EQ(
		ceilf(height.ascent + height.descent + height.leading) + 4, control->Bounds().Height());
}


TEST(TextControl, FocusByKeyboardSelectsAllAndByMousePlacesTheCaret)
{
	Fields fields;
	fields.Locked([&] { fields.first->MakeFocus(); });
	int32 start, end;
	fields.first->TextView()->GetSelection(&start, &end);
	EXPECT_EQ(0, start);
	EXPECT_EQ(4, end);
	fields.driver.Click(fields.second->TextView(), BPoint(90, 8));
	fields.second->TextView()->GetSelection(&start, &end);
	EXPECT_EQ(5, start);
	EXPECT_EQ(5, end);
	EXPECT_TRUE(fields.second->TextView()->IsFocus());
	fields.driver.Key("Tab");
	EXPECT_TRUE(fields.first->TextView()->IsFocus());
}


TEST(TextControl, EnterInvokesOnlyAfterAChange)
{
	Fields fields;
	fields.Locked([&] { fields.first->MakeFocus(); });
	fields.driver.Key("Return");
	EXPECT_EQ(Codes(), fields.TakeCodes());
	fields.driver.Type("new\n");
	EXPECT_EQ(Codes { kInvoked }, fields.TakeCodes());
	EXPECT_STREQ("new", fields.first->Text());
	int32 start, end;
	fields.first->TextView()->GetSelection(&start, &end);
	EXPECT_EQ(0, start);
	EXPECT_EQ(3, end);
	fields.driver.Key("Return");
	EXPECT_EQ(Codes(), fields.TakeCodes());

	void* source = NULL;
	EXPECT_EQ(B_OK, fields.window->last.FindPointer("source", &source));
	EXPECT_EQ(fields.first, source);
	EXPECT_TRUE(fields.window->last.HasInt64("when"));
}


TEST(TextControl, LosingTheFocusInvokesAfterAChange)
{
	Fields fields;
	fields.Locked([&] { fields.first->MakeFocus(); });
	fields.driver.Type("x");
	fields.driver.Key("Tab");
	EXPECT_EQ(Codes { kInvoked }, fields.TakeCodes());
	fields.driver.Key("Tab");
	fields.driver.Key("Tab");
	EXPECT_EQ(Codes(), fields.TakeCodes());
	fields.driver.Click(fields.first->TextView(), BPoint(20, 8));
	fields.driver.Type("y");
	fields.driver.Click(fields.second->TextView());
	EXPECT_EQ(Codes { kInvoked }, fields.TakeCodes());
}


TEST(TextControl, RemovalOfTheFocusedFieldInvokesAfterAChange)
{
	Fields fields;
	fields.Locked([&] { fields.first->MakeFocus(); });
	fields.driver.Type("z");
	fields.Locked([&] { fields.first->RemoveSelf(); });
	EXPECT_EQ(Codes { kInvoked }, fields.TakeCodes());
	delete fields.first;
}


TEST(TextControl, SetTextNeverInvokes)
{
	Fields fields;
	fields.Locked([&] { fields.first->MakeFocus(); });
	fields.driver.Type("typed");
	fields.Locked([&] { fields.first->SetText("loaded"); });
	fields.driver.Key("Return");
	fields.driver.Key("Tab");
	EXPECT_EQ(Codes(), fields.TakeCodes());
	EXPECT_STREQ("loaded", fields.first->Text());
}


TEST(TextControl, EveryInsertionAndDeletionSendsTheModificationMessage)
{
	Fields fields;
	fields.Locked([&] {
		fields.first->SetModificationMessage(new BMessage(kModified));
		fields.first->MakeFocus();
	});
	fields.driver.Key("End");
	fields.driver.Type("ab");
	EXPECT_EQ((Codes { kModified, kModified }), fields.TakeCodes());
	fields.driver.Key("Backspace");
	EXPECT_EQ(Codes { kModified }, fields.TakeCodes());
	fields.Locked([&] { fields.first->SetText("texta"); });
	EXPECT_EQ((Codes { kModified, kModified }), fields.TakeCodes());
}


TEST(TextControl, LineBreaksBecomeBlanks)
{
	Fields fields;
	fields.Locked([&] { fields.first->SetText("two\nlines"); });
	EXPECT_STREQ("two lines", fields.first->Text());
}


TEST(TextControl, DisabledFieldTakesNeitherKeysNorFocus)
{
	Fields fields;
	fields.Locked([&] {
		fields.second->MakeFocus();
		fields.first->SetEnabled(false);
	});
	fields.driver.Key("Tab");
	EXPECT_FALSE(fields.first->TextView()->IsFocus());
	EXPECT_FALSE(fields.first->TextView()->IsEditable());
	fields.Locked([&] { fields.first->SetEnabled(true); });
	fields.driver.Key("Tab");
	EXPECT_TRUE(fields.first->TextView()->IsFocus());
	fields.driver.Type("on");
	EXPECT_STREQ("on", fields.first->Text());
}


TEST(TextControl, ResizeToPreferredPutsTheDividerBehindTheLabel)
{
	Fields fields;
	fields.Locked([&] {
		fields.first->SetDivider(150);
		fields.first->ResizeToPreferred();
		EXPECT_EQ(ceilf(fields.first->StringWidth("Label:")) + 2, fields.first->Divider());
		fields.second->ResizeToPreferred();
		EXPECT_EQ(0, fields.second->Divider());
		EXPECT_EQ(199, fields.second->Bounds().Width());
	});
}


TEST(TextControl, ArchiveRoundTripKeepsEverything)
{
	BApplication app("application/x-vnd.Archway-test");
	const std::unique_ptr<BTextControl> control(
		new BTextControl(BRect(10, 10, 210, 40), "name", "Label:", "text", new BMessage(kInvoked)));
	control->SetModificationMessage(new BMessage(kModified));
	control->SetAlignment(B_ALIGN_RIGHT, B_ALIGN_CENTER);
	control->SetDivider(70);
	control->TextView()->SetMaxBytes(3);
	control->SetEnabled(false);
	BMessage archive;
	ASSERT_EQ(B_OK, control->Archive(&archive));

	const std::unique_ptr<BTextControl> revived(
		dynamic_cast<BTextControl*>(instantiate_object(&archive)));
	ASSERT_NE(nullptr, revived);
	alignment label, text;
	revived->GetAlignment(&label, &text);
	EXPECT_EQ(B_ALIGN_RIGHT, label);
	EXPECT_EQ(B_ALIGN_CENTER, text);
	EXPECT_EQ(70, revived->Divider());
	EXPECT_EQ(3, revived->TextView()->MaxBytes());
	EXPECT_STREQ("tex", revived->Text());
	EXPECT_FALSE(revived->IsEnabled());
	ASSERT_NE(nullptr, revived->ModificationMessage());
	EXPECT_EQ(kModified, revived->ModificationMessage()->what);
	BMessage again;
	ASSERT_EQ(B_OK, revived->Archive(&again));
	EXPECT_TRUE(again.HasSameData(archive));
}


TEST(TextControl, RevivedControlIsNotAdjustedByAttaching)
{
	TestWindow window;
	BTextControl original(BRect(10, 10, 210, 40), "name", "Label:", "text", NULL);
	BMessage archive;
	ASSERT_EQ(B_OK, original.Archive(&archive));
	BRect squeezed(10, 10, 210, 14);
	archive.ReplaceRect("_frame", squeezed);
	archive.ReplaceFloat("_divide", 33.5f);
	BTextControl* revived = dynamic_cast<BTextControl*>(instantiate_object(&archive));
	ASSERT_NE(nullptr, revived);
	window.Add(revived);
	window.Locked([&] {
		EXPECT_EQ(squeezed, revived->Frame());
		EXPECT_EQ(33.5f, revived->Divider());
		BMessage again;
		EXPECT_EQ(B_OK, revived->Archive(&again));
		EXPECT_TRUE(again.HasSameData(archive));
	});
}


TEST(TextControl, HasATextThoughItBearsThatsName)
{
	BApplication app("application/x-vnd.Archway-test");
	BMessage archive;
	archive.AddString("class", "BTextControl");
	archive.AddString("_name", "_input_");
	archive.AddRect("_frame", BRect(0, 0, 99, 19));
	const std::unique_ptr<BTextControl> revived(
		dynamic_cast<BTextControl*>(instantiate_object(&archive)));
	ASSERT_NE(nullptr, revived);
	ASSERT_NE(nullptr, revived->TextView());
	EXPECT_EQ(revived.get(), revived->TextView()->Parent());
}
