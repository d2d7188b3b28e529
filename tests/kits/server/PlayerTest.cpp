#include "server/play/Player.h"

#include <cstdio>
#include <cstdlib>
#include <deque>
#include <fstream>
#include <sstream>
#include <sys/stat.h>
#include <unistd.h>

#include <gtest/gtest.h>

#include <Alert.h>
#include <Application.h>
#include <Button.h>
#include <CheckBox.h>
#include <Entry.h>
#include <ListView.h>
#include <Menu.h>
#include <MenuBar.h>
#include <MenuField.h>
#include <MenuItem.h>
#include <Message.h>
#include <PopUpMenu.h>
#include <ScrollView.h>
#include <StringItem.h>
#include <StringView.h>
#include <TextControl.h>
#include <Window.h>

#include "server/Desktop.h"

namespace BPrivate {

namespace {

// Takes drops and the wheel, and says so in its name.
class Target : public BView {
public:
	Target(BRect frame) : BView(frame, "target", B_FOLLOW_NONE, B_WILL_DRAW)
	{
		SetViewColor(10, 20, 30);
	}

	void MessageReceived(BMessage* message) override
	{
		entry_ref ref;
		if (message->WasDropped() && message->FindRef("refs", &ref) == B_OK)
			SetName(ref.name);
		else if (message->what == B_MOUSE_WHEEL_CHANGED)
			SetName("turned");
		else
			BView::MessageReceived(message);
	}

	void MouseDown(BPoint where) override
	{
		int32 clicks = 0, buttons = 0;
		Window()->CurrentMessage()->FindInt32("clicks", &clicks);
		Window()->CurrentMessage()->FindInt32("buttons", &buttons);
		char name[64];
		std::snprintf(name, sizeof(name), "%g,%g clicks %d buttons %d", where.x, where.y,
			static_cast<int>(clicks), static_cast<int>(buttons));
		SetName(name);
	}
};


class PlayWindow : public BWindow {
public:
	PlayWindow() : BWindow(BRect(100, 100, 499, 499), "A play", B_TITLED_WINDOW, 0)
	{
		auto* bar = new BMenuBar(BRect(0, 0, 399, 19), "bar");
		auto* file = new BMenu("File");
		file->AddItem(new BMenuItem("Open" B_UTF8_ELLIPSIS, new BMessage('open')));
		auto* closed = new BMenuItem("Closed", new BMessage('clos'));
		closed->SetEnabled(false);
		file->AddItem(closed);
		auto* more = new BMenu("More");
		more->AddItem(new BMenuItem("Deep", new BMessage('deep')));
		file->AddItem(more);
		file->AddItem(new BMenuItem("Ask", new BMessage('ask ')));
		bar->AddItem(file);
		AddChild(bar);

		auto* back = new BView(BRect(0, 30, 399, 399), "back", B_FOLLOW_ALL, 0);
		AddChild(back);
		back->AddChild(new BButton(BRect(10, 10, 99, 34), "ok", "OK", new BMessage('ok  ')));
		back->AddChild(
			new BCheckBox(BRect(10, 40, 199, 59), "check", "Check", new BMessage('chec')));
		back->AddChild(new BTextControl(
			BRect(10, 70, 199, 89), "text", "Text: ", "old", new BMessage('text')));
		auto* colors = new BPopUpMenu("color");
		for (const char* name : { "Red", "Green", "Blue" })
			colors->AddItem(new BMenuItem(name, new BMessage('colr')));
		colors->ItemAt(0)->SetMarked(true);
		back->AddChild(new BMenuField(BRect(10, 100, 199, 119), "color", "Color", colors));
		back->AddChild(new Target(BRect(210, 10, 309, 109)));
		auto* list = new BListView(BRect(0, 0, 99, 79), "list");
		// A list leaves its items to the program.
		static std::deque<BStringItem> sItems;
		for (int i = 0; i < 50; i++)
			list->AddItem(&sItems.emplace_back(("item " + std::to_string(i)).c_str()));
		list->MoveTo(210, 130);
		back->AddChild(new BScrollView("scroll", list, B_FOLLOW_NONE, 0, false, true));
		back->AddChild(fStatus = new BStringView(BRect(10, 330, 389, 349), "status", "nothing"));
	}

	void MessageReceived(BMessage* message) override
	{
		switch (message->what) {
			case 'ask ':
				fStatus->SetText(
					(new BAlert("ask", "Sure?", "No", "Yes"))->Go() == 1 ? "yes" : "no");
				break;
			case 'open':
			case 'deep':
			case 'clos':
			case 'ok  ':
			case 'chec':
			case 'text':
			case 'colr': {
				const uint32 code = message->what;
				const char text[] = { char(code >> 24), char(code >> 16), char(code >> 8),
					char(code), 0 };
				fStatus->SetText(text);
				break;
			}
			default:
				BWindow::MessageReceived(message);
		}
	}

private:
	BStringView* fStatus; // child
};


class PlayerTest : public testing::Test {
protected:
	PlayerTest() : fApplication("application/x-vnd.Archway-test")
	{
		char folder[] = "/tmp/play-test-XXXXXX";
		EXPECT_NE(nullptr, mkdtemp(folder));
		fFolder = folder;
		setenv("ARCHWAY_PLAY_OUT", (fFolder + "/out").c_str(), 1);
		fPlayer = std::make_unique<Player>(Desktop::Get()->Thread(), [] { return false; });
		fPlayer->OpenOutput();
		(new PlayWindow)->Show();
	}

	~PlayerTest() override
	{
		unsetenv("ARCHWAY_PLAY_OUT");
		const std::string command = "rm -rf '" + fFolder + "'";
		EXPECT_EQ(0, std::system(command.c_str()));
	}

	// What the command complained of, "" when it was carried out.
	std::string Play(const std::string& line)
	{
		try {
			fPlayer->WaitUntilIdle();
			PlayTokenReader reader(play_tokens(line));
			fPlayer->Perform(reader);
			fPlayer->WaitUntilIdle();
		} catch (const PlayError& error) {
			return error.expected + ", " + error.found;
		}
		return "";
	}

	std::string Output() const
	{
		std::ifstream file(fFolder + "/out");
		std::ostringstream text;
		text << file.rdbuf();
		return text.str();
	}

	BApplication fApplication;
	std::string fFolder;
	std::unique_ptr<Player> fPlayer;
};

} // namespace


TEST_F(PlayerTest, ClickPressesAButton)
{
	EXPECT_EQ("", Play("click \"OK\""));
	EXPECT_EQ("", Play("expect \"status\" text \"ok  \""));
}


TEST_F(PlayerTest, ClickTellsPlaceTimesAndButton)
{
	EXPECT_EQ("", Play("click Target at right-9,20 times 2"));
	EXPECT_EQ("", Play("expect Target name \"90,20 clicks 2 buttons 1\""));
	EXPECT_EQ("", Play("click Target at 5,6 button 2"));
	EXPECT_EQ("", Play("expect Target name \"5,6 clicks 1 buttons 2\""));
	// Two clicks of their own, however quick, are no double click.
	EXPECT_EQ("", Play("click Target at 7,8"));
	EXPECT_EQ("", Play("click Target at 7,8"));
	EXPECT_EQ("", Play("expect Target name \"7,8 clicks 1 buttons 1\""));
}


TEST_F(PlayerTest, GestureIsReleasedByItself)
{
	EXPECT_EQ("", Play("press \"ok\""));
	EXPECT_EQ("", Play("move Target"));
	EXPECT_EQ("", Play("release"));
	EXPECT_EQ("", Play("expect \"status\" text nothing"));
	EXPECT_NE("", Play("release"));
}


TEST_F(PlayerTest, TypedTextReachesTheField)
{
	EXPECT_EQ("", Play("click \"text\" > BTextView+ times 2"));
	EXPECT_EQ("", Play("type \"n\xc3\xa9w \\\"text\\\"\\n\""));
	EXPECT_EQ("", Play("expect \"text\" text \"n\xc3\xa9w \\\"text\\\"\""));
	EXPECT_EQ("", Play("expect \"status\" text text"));
}


TEST_F(PlayerTest, KeysHaveModifiersAndRepeat)
{
	EXPECT_EQ("", Play("click \"text\" > BTextView+ times 2"));
	EXPECT_EQ("", Play("key a with Control"));
	EXPECT_EQ("", Play("key x times 3"));
	EXPECT_EQ("", Play("key Left with Shift"));
	EXPECT_EQ("", Play("key y"));
	EXPECT_EQ("", Play("expect \"text\" > BTextView+ text xxy"));
	EXPECT_EQ("a key, Retrun", Play("key Retrun"));
}


TEST_F(PlayerTest, MenuItemIsChosenAtAnyDepth)
{
	EXPECT_EQ("", Play("menu \"File\" \"Open...\""));
	EXPECT_EQ("", Play("expect \"status\" text open"));
	EXPECT_EQ("", Play("menu \"File\" \"More\" \"Deep\""));
	EXPECT_EQ("", Play("expect \"status\" text deep"));
}


TEST_F(PlayerTest, MenuItemThatIsMissingOrDisabledIsAnError)
{
	EXPECT_EQ("menu \"Edit\", no such menu", Play("menu \"Edit\" \"Open\""));
	EXPECT_EQ("menu item \"Closed\", it is disabled", Play("menu \"File\" \"Closed\""));
}


TEST_F(PlayerTest, FieldsItemIsChosen)
{
	EXPECT_EQ("", Play("expect \"color\" marked Red"));
	EXPECT_EQ("", Play("choose \"color\" \"Blue\""));
	EXPECT_EQ("", Play("expect \"color\" marked Blue"));
	EXPECT_EQ("", Play("expect \"status\" text colr"));
}


TEST_F(PlayerTest, AlertIsAnsweredThoughItsWindowWaits)
{
	EXPECT_EQ("", Play("menu \"File\" \"Ask\""));
	EXPECT_EQ("an alert with \"Maybe\", one without", Play("answer \"Maybe\""));
	EXPECT_EQ("", Play("answer \"Yes\""));
	EXPECT_EQ("", Play("expect window \"A play\" > \"status\" text yes"));
	EXPECT_EQ("an alert with \"Yes\", no alert", Play("answer \"Yes\""));
}


TEST_F(PlayerTest, ScrolledAwayItemIsBroughtIntoView)
{
	EXPECT_EQ("", Play("click item \"item 40\""));
	EXPECT_EQ("", Play("expect \"list\" selection 40"));
	EXPECT_EQ("", Play("expect \"list\" count 50"));
	EXPECT_EQ("", Play("click item \"item 41\" with Shift"));
}


TEST_F(PlayerTest, FileIsDroppedOnAView)
{
	EXPECT_EQ("", Play("run \"touch '" + fFolder + "/a file'\""));
	EXPECT_EQ("", Play("drop \"" + fFolder + "/a file\" on Target"));
	EXPECT_EQ("", Play("expect Target name \"a file\""));
	EXPECT_NE("", Play("drop \"" + fFolder + "/none\" on Target"));
}


TEST_F(PlayerTest, DragToAFolderNeedsSomethingDragged)
{
	EXPECT_EQ("a drag, nothing is dragged", Play("drag Target to folder '" + fFolder + "'"));
	EXPECT_EQ("", Play("click Target"));
}


TEST_F(PlayerTest, WheelTurnsOverAView)
{
	EXPECT_EQ("", Play("wheel \"target\" 0,1"));
	EXPECT_EQ("", Play("expect Target name turned"));
}


TEST_F(PlayerTest, WindowIsHandledByItsFrame)
{
	EXPECT_EQ("", Play("resize window \"play\" 299,199"));
	EXPECT_EQ("", Play("expect window \"play\" frame 100,100,399,299"));
	EXPECT_EQ("", Play("windows 1"));
	EXPECT_EQ("2 windows, 1: \"A play\"", Play("windows 2"));
	EXPECT_EQ("", Play("close window \"play\""));
	EXPECT_EQ("", Play("windows 0"));
}


TEST_F(PlayerTest, ExpectationThatDoesNotHoldSaysWhatItFound)
{
	EXPECT_EQ("\"status\" text \"x\", \"nothing\"", Play("expect \"status\" text x"));
	EXPECT_EQ("", Play("expect \"status\" text ~ thin"));
	EXPECT_EQ("\"status\" text ~ \"x\", \"nothing\"", Play("expect \"status\" text ~ x"));
	EXPECT_EQ("\"gone\", no such view", Play("expect \"gone\" text x"));
	EXPECT_EQ("a property, colour", Play("expect \"status\" colour x"));
	EXPECT_EQ("", Play("absent \"gone\""));
	EXPECT_EQ("no \"status\", there is one", Play("absent \"status\""));
	EXPECT_EQ("a command, clik", Play("clik \"OK\""));
	EXPECT_EQ("\"gone\", not within 0 seconds", Play("wait \"gone\" 0"));
	EXPECT_EQ("status 0 of exit 3, status 3", Play("run \"exit 3\""));
}


TEST_F(PlayerTest, PropertiesArePrinted)
{
	EXPECT_EQ("", Play("show Target frame"));
	EXPECT_EQ("", Play("show \"ok\" label"));
	EXPECT_EQ("", Play("show Target view-color"));
	EXPECT_EQ("", Play("show Target pixel 3,3"));
	EXPECT_EQ("", Play("show \"check\" value"));
	EXPECT_EQ("", Play("show \"color\" class"));
	EXPECT_EQ("", Play("echo \"the end\""));
	EXPECT_EQ("210,10,309,109\nOK\n10,20,30\n10,20,30\n0\nBMenuField\nthe end\n", Output());
}


TEST_F(PlayerTest, TreeShowsEveryViewIndented)
{
	EXPECT_EQ("", Play("click \"Check\""));
	EXPECT_EQ("", Play("tree \"back\""));
	const std::string tree = Output();
	EXPECT_EQ(0u, tree.find("BView \"back\" frame 0,30,399,399 screen 100,130,499,499"));
	EXPECT_NE(std::string::npos, tree.find("\n  BButton \"ok\" frame 10,10,99,34"));
	EXPECT_NE(std::string::npos, tree.find("\"OK\""));
	EXPECT_NE(std::string::npos, tree.find("\n      item frame"));
}


TEST_F(PlayerTest, PictureIsWritten)
{
	EXPECT_EQ("", Play("picture " + fFolder + "/all.png"));
	EXPECT_EQ("", Play("picture " + fFolder + "/ok.png \"ok\""));
	for (const char* name : { "/all.png", "/ok.png" }) {
		struct stat status;
		ASSERT_EQ(0, stat((fFolder + name).c_str(), &status));
		EXPECT_GT(status.st_size, 100);
	}
}


} // namespace BPrivate
