#include <unistd.h>

#include <cstdlib>
#include <filesystem>
#include <memory>
#include <string>
#include <vector>

#include <Alert.h>
#include <AppDefs.h>
#include <Application.h>
#include <Autolock.h>
#include <Button.h>
#include <Directory.h>
#include <FilePanel.h>
#include <ListView.h>
#include <MenuBar.h>
#include <MenuField.h>
#include <MenuItem.h>
#include <Message.h>
#include <Messenger.h>
#include <Path.h>
#include <StringItem.h>
#include <TextControl.h>
#include <Window.h>
#include <gtest/gtest.h>

#include "TemporaryFolder.h"
#include "support/Driver.h"

namespace {

namespace fs = std::filesystem;


// Notes what it is sent.
class Receiver : public BLooper {
public:
	Receiver() { Run(); }

	void MessageReceived(BMessage* message) override { received.push_back(*message); }

	std::vector<BMessage> received;
};


class NotingPanel : public BFilePanel {
public:
	using BFilePanel::BFilePanel;

	void WasHidden() override { hidden++; }
	void SelectionChanged() override { selections++; }

	int hidden = 0;
	int selections = 0;
};


// A folder with two folders and three files in it, and a panel that shows it.
class FilePanelTest : public testing::Test {
protected:
	FilePanelTest()
	{
		setenv("HOME", folder.Path().c_str(), 1);
		setenv("XDG_CONFIG_HOME", (folder / "settings").c_str(), 1);
		fs::create_directories(folder / "files/Inner");
		fs::create_directories(folder / "files/other folder");
		WriteFile(folder / "files/alpha.rsrc", "a");
		WriteFile(folder / "files/beta.rsrc", std::string(2048, 'b'));
		WriteFile(folder / "files/beta.txt", "text");
		WriteFile(folder / "files/.hidden", "");
		WriteFile(folder / "files/Inner/deep.rsrc", "deep");
		app = std::make_unique<BApplication>("application/x-vnd.Archway-test");
		receiver = new Receiver;
	}

	~FilePanelTest() override
	{
		panel.reset();
		receiver->Lock();
		receiver->Quit();
	}

	void Show(file_panel_mode mode, uint32 flavors = 0, bool many = true, BRefFilter* filter = NULL,
		BMessage* message = NULL, bool hideWhenDone = true)
	{
		entry_ref ref;
		ASSERT_EQ(B_OK, get_ref_for_path((folder / "files").c_str(), &ref));
		BMessenger target(receiver);
		panel = std::make_unique<NotingPanel>(
			mode, &target, &ref, flavors, many, message, filter, false, hideWhenDone);
		panel->Show();
		Driver::WaitUntilIdle();
	}

	template<class View> View* Find(const char* name)
	{
		BAutolock lock(panel->Window());
		return dynamic_cast<View*>(panel->Window()->FindView(name));
	}

	std::vector<std::string> Names()
	{
		std::vector<std::string> names;
		BListView* list = Find<BListView>("files");
		BAutolock lock(panel->Window());
		for (int32 i = 0; i < list->CountItems(); i++)
			names.push_back(static_cast<BStringItem*>(list->ItemAt(i))->Text());
		return names;
	}

	std::string Typed()
	{
		BTextControl* field = Find<BTextControl>("text view");
		BAutolock lock(panel->Window());
		return field->Text();
	}

	std::string PanelFolder()
	{
		entry_ref ref;
		panel->GetPanelDirectory(&ref);
		return BPath(&ref).Path();
	}

	void ClickRow(int32 index, int32 times = 1, uint32 modifiers = 0)
	{
		BListView* list = Find<BListView>("files");
		BRect frame;
		{
			BAutolock lock(panel->Window());
			frame = list->ItemFrame(index);
		}
		driver.Click(list, BPoint(40, (frame.top + frame.bottom) / 2), times, 1, modifiers);
	}

	// The alert or other window that is in front of the panel, or NULL.
	BWindow* Question(const char* title)
	{
		Driver::WaitUntilIdle();
		for (int32 i = 0; i < app->CountWindows(); i++) {
			BWindow* window = app->WindowAt(i);
			BAutolock lock(window);
			if (std::string(window->Title()) == title && !window->IsHidden())
				return window;
		}
		return NULL;
	}

	int32 CountAlerts()
	{
		Driver::WaitUntilIdle();
		int32 count = 0;
		for (int32 i = 0; i < app->CountWindows(); i++)
			count += dynamic_cast<BAlert*>(app->WindowAt(i)) != NULL ? 1 : 0;
		return count;
	}

	std::vector<BMessage> Received(uint32 what)
	{
		Driver::WaitUntilIdle();
		std::vector<BMessage> result;
		BAutolock lock(receiver);
		for (const BMessage& message : receiver->received) {
			if (message.what == what)
				result.push_back(message);
		}
		return result;
	}

	// The paths of the refs of the only message with this code.
	std::vector<std::string> ReceivedPaths(uint32 what = B_REFS_RECEIVED)
	{
		std::vector<std::string> paths;
		const std::vector<BMessage> messages = Received(what);
		EXPECT_EQ(1u, messages.size());
		entry_ref ref;
		for (int32 i = 0; !messages.empty() && messages[0].FindRef("refs", i, &ref) == B_OK; i++)
			paths.push_back(BPath(&ref).Path());
		return paths;
	}

	using Paths = std::vector<std::string>;

	TemporaryFolder folder;
	std::unique_ptr<BApplication> app;
	Receiver* receiver;
	std::unique_ptr<NotingPanel> panel;
	Driver driver;
};


class SuffixFilter : public BRefFilter {
public:
	bool Filter(const entry_ref* ref, BNode* node, struct stat* stat, const char* type) override
	{
		EXPECT_EQ(B_OK, node->InitCheck());
		EXPECT_NE(nullptr, type);
		return S_ISDIR(stat->st_mode) || std::string(ref->name).ends_with(".rsrc");
	}
};


} // namespace


TEST_F(FilePanelTest, IsHiddenAtFirstAndShowsItsFolder)
{
	BFilePanel fresh;
	EXPECT_FALSE(fresh.IsShowing());
	EXPECT_EQ(B_OPEN_PANEL, fresh.PanelMode());
	EXPECT_TRUE(fresh.HidesWhenDone());
	EXPECT_EQ(nullptr, fresh.RefFilter());
	EXPECT_TRUE(fresh.Messenger() == be_app_messenger);

	Show(B_OPEN_PANEL);
	EXPECT_TRUE(panel->IsShowing());
	EXPECT_TRUE(panel->Messenger() == BMessenger(receiver));
	EXPECT_EQ(folder / "files", PanelFolder());
	EXPECT_EQ((Paths { "Inner", "other folder", "alpha.rsrc", "beta.rsrc", "beta.txt" }), Names());
	BAutolock lock(panel->Window());
	EXPECT_STREQ("Open", panel->Window()->Title());
}


TEST_F(FilePanelTest, TheFileThatWasDoubleClickedIsSent)
{
	Show(B_OPEN_PANEL);
	ClickRow(3, 2);
	EXPECT_EQ(Paths { folder / "files/beta.rsrc" }, ReceivedPaths());
	EXPECT_FALSE(panel->IsShowing());
	EXPECT_EQ(1, panel->hidden);
	EXPECT_TRUE(Received(B_CANCEL).empty());
}


TEST_F(FilePanelTest, AllSelectedFilesAreSentTogether)
{
	Show(B_OPEN_PANEL);
	ClickRow(2);
	ClickRow(4, 1, B_COMMAND_KEY | B_CONTROL_KEY);
	EXPECT_EQ(2, panel->selections);
	entry_ref ref;
	EXPECT_EQ(B_OK, panel->GetNextSelectedRef(&ref));
	EXPECT_STREQ("alpha.rsrc", ref.name);
	EXPECT_EQ(B_OK, panel->GetNextSelectedRef(&ref));
	EXPECT_STREQ("beta.txt", ref.name);
	EXPECT_EQ(B_ENTRY_NOT_FOUND, panel->GetNextSelectedRef(&ref));
	panel->Rewind();
	EXPECT_EQ(B_OK, panel->GetNextSelectedRef(&ref));
	EXPECT_STREQ("alpha.rsrc", ref.name);

	driver.Click(Find<BButton>("default button"));
	EXPECT_EQ((Paths { folder / "files/alpha.rsrc", folder / "files/beta.txt" }), ReceivedPaths());
}


TEST_F(FilePanelTest, OneFileIsChosenWhereManyAreNotAllowed)
{
	Show(B_OPEN_PANEL, 0, false);
	ClickRow(2);
	ClickRow(4, 1, B_COMMAND_KEY | B_CONTROL_KEY);
	driver.Click(Find<BButton>("default button"));
	EXPECT_EQ(Paths { folder / "files/beta.txt" }, ReceivedPaths());
}


TEST_F(FilePanelTest, IsUsedByKeysAlone)
{
	Show(B_OPEN_PANEL);
	driver.Type("inner");
	driver.Key("Return");
	EXPECT_EQ(folder / "files/Inner", PanelFolder());
	EXPECT_EQ(Paths { "deep.rsrc" }, Names());

	driver.Key("Backspace");
	EXPECT_EQ(folder / "files", PanelFolder());
	driver.Key("End");
	driver.Key("Return");
	EXPECT_EQ(Paths { folder / "files/beta.txt" }, ReceivedPaths());
}


TEST_F(FilePanelTest, TheEnclosingFolderAndTheHomeFolderHaveShortcuts)
{
	Show(B_OPEN_PANEL);
	driver.Key("Up", B_COMMAND_KEY | B_CONTROL_KEY);
	EXPECT_EQ(folder.Path(), PanelFolder());
	panel->SetPanelDirectory("/");
	driver.Key("h", B_COMMAND_KEY | B_CONTROL_KEY);
	EXPECT_EQ(folder.Path(), PanelFolder());
}


TEST_F(FilePanelTest, ATypedPathIsOpenedWhereverItLeads)
{
	Show(B_OPEN_PANEL);
	driver.Key("Tab");
	driver.Type("~/files/Inner/deep.rsrc\n");
	EXPECT_EQ(Paths { folder / "files/Inner/deep.rsrc" }, ReceivedPaths());
}


TEST_F(FilePanelTest, ATypedFolderIsGoneTo)
{
	Show(B_OPEN_PANEL);
	driver.Key("Tab");
	driver.Type("Inner\n");
	EXPECT_EQ(folder / "files/Inner", PanelFolder());
	EXPECT_EQ("", Typed());
	EXPECT_TRUE(Received(B_REFS_RECEIVED).empty());
}


TEST_F(FilePanelTest, ATypedNameIsCompleted)
{
	Show(B_OPEN_PANEL);
	driver.Key("Tab");
	driver.Type("al");
	EXPECT_EQ("alpha.rsrc", Typed());
	driver.Key("Backspace");
	EXPECT_EQ("al", Typed());
	driver.Key("Backspace", 0, 2);
	driver.Type("beta.t");
	EXPECT_EQ("beta.txt", Typed());
	driver.Key("Return");
	EXPECT_EQ(Paths { folder / "files/beta.txt" }, ReceivedPaths());
}


TEST_F(FilePanelTest, APathIsCompletedInItsOwnFolder)
{
	Show(B_OPEN_PANEL);
	driver.Key("Tab");
	driver.Type("In");
	EXPECT_EQ("Inner/", Typed());
	driver.Key("End");
	driver.Type("d");
	EXPECT_EQ("Inner/deep.rsrc", Typed());
}


TEST_F(FilePanelTest, SaysThatATypedFileIsNotThere)
{
	Show(B_OPEN_PANEL);
	driver.Key("Tab");
	driver.Type("nothing like it\n");
	EXPECT_TRUE(Received(B_REFS_RECEIVED).empty());
	EXPECT_TRUE(panel->IsShowing());
	EXPECT_EQ(1, CountAlerts());
}


TEST_F(FilePanelTest, EscapeAndTheCloseButtonCancel)
{
	BMessage own('Mine');
	Show(B_OPEN_PANEL, 0, true, NULL, &own);
	driver.Key("Escape");
	EXPECT_FALSE(panel->IsShowing());
	EXPECT_EQ(1, panel->hidden);
	ASSERT_EQ(1u, Received(B_CANCEL).size());
	const BMessage cancel = Received(B_CANCEL)[0];
	void* source = nullptr;
	EXPECT_EQ(static_cast<int32>('Mine'), cancel.GetInt32("old_what", 0));
	EXPECT_EQ(B_OK, cancel.FindPointer("source", &source));
	EXPECT_EQ(static_cast<BFilePanel*>(panel.get()), source);

	panel->Show();
	driver.CloseWindow(panel->Window());
	EXPECT_FALSE(panel->IsShowing());
	EXPECT_EQ(2u, Received(B_CANCEL).size());
	panel->Show();
	driver.Click(Find<BButton>("cancel button"));
	EXPECT_EQ(3u, Received(B_CANCEL).size());
}


TEST_F(FilePanelTest, HidingItByProgramTellsNobody)
{
	Show(B_OPEN_PANEL);
	panel->Hide();
	Driver::WaitUntilIdle();
	EXPECT_FALSE(panel->IsShowing());
	EXPECT_EQ(0, panel->hidden);
	EXPECT_TRUE(Received(B_CANCEL).empty());
}


TEST_F(FilePanelTest, SendsTheProgramsOwnMessageAndMayStay)
{
	BMessage own('Mine');
	own.AddString("extra", "kept");
	Show(B_OPEN_PANEL, 0, true, NULL, &own, false);
	ClickRow(2, 2);
	EXPECT_EQ(Paths { folder / "files/alpha.rsrc" }, ReceivedPaths('Mine'));
	EXPECT_STREQ("kept", Received('Mine')[0].GetString("extra", ""));
	EXPECT_TRUE(panel->IsShowing());
	ClickRow(3, 2);
	EXPECT_EQ(2u, Received('Mine').size());
}


TEST_F(FilePanelTest, TheFilterHidesFiles)
{
	SuffixFilter filter;
	Show(B_OPEN_PANEL, 0, true, &filter);
	EXPECT_EQ((Paths { "Inner", "other folder", "alpha.rsrc", "beta.rsrc" }), Names());
	panel->SetRefFilter(NULL);
	EXPECT_EQ(5u, Names().size());
}


TEST_F(FilePanelTest, FoldersCanBeChosen)
{
	Show(B_OPEN_PANEL, B_DIRECTORY_NODE);
	EXPECT_EQ((Paths { "Inner", "other folder" }), Names());
	ClickRow(1);
	driver.Click(Find<BButton>("default button"));
	EXPECT_EQ(Paths { folder / "files/other folder" }, ReceivedPaths());
}


TEST_F(FilePanelTest, TheShownFolderIsChosenWhereFoldersAreAndNothingIsSelected)
{
	Show(B_OPEN_PANEL, B_DIRECTORY_NODE);
	ClickRow(0, 2);
	driver.Click(Find<BButton>("default button"));
	EXPECT_EQ(Paths { folder / "files/Inner" }, ReceivedPaths());
}


TEST_F(FilePanelTest, LinksAreFollowedUnlessTheyAreAskedFor)
{
	fs::create_symlink("alpha.rsrc", folder / "files/link");
	fs::create_symlink("nowhere", folder / "files/broken");
	Show(B_OPEN_PANEL);
	EXPECT_EQ("link", Names().back());
	EXPECT_EQ(6u, Names().size());
	ClickRow(5, 2);
	EXPECT_EQ(Paths { folder / "files/alpha.rsrc" }, ReceivedPaths());
}


TEST_F(FilePanelTest, HiddenFilesAreShownOnDemand)
{
	Show(B_OPEN_PANEL);
	driver.Key("i", B_COMMAND_KEY | B_CONTROL_KEY);
	EXPECT_EQ(".hidden", Names()[2]);
	driver.Key("i", B_COMMAND_KEY | B_CONTROL_KEY);
	EXPECT_EQ(5u, Names().size());
}


TEST_F(FilePanelTest, ANewNameIsSavedIntoTheShownFolder)
{
	Show(B_SAVE_PANEL);
	panel->SetSaveText("untitled.rsrc");
	Driver::WaitUntilIdle();
	// The name is selected up to its suffix, so that typing replaces it.
	driver.Type("fresh\n");
	ASSERT_EQ(1u, Received(B_SAVE_REQUESTED).size());
	const BMessage save = Received(B_SAVE_REQUESTED)[0];
	entry_ref directory;
	EXPECT_EQ(B_OK, save.FindRef("directory", &directory));
	EXPECT_EQ(folder / "files", BPath(&directory).Path());
	EXPECT_STREQ("fresh.rsrc", save.GetString("name", ""));
	EXPECT_FALSE(panel->IsShowing());
}


TEST_F(FilePanelTest, AsksBeforeAFileIsReplaced)
{
	Show(B_SAVE_PANEL);
	driver.Type("alpha.rsrc\n");
	BWindow* question = Question("Replace");
	ASSERT_NE(nullptr, question);
	driver.Key("Escape");
	EXPECT_TRUE(Received(B_SAVE_REQUESTED).empty());
	EXPECT_TRUE(panel->IsShowing());

	driver.Key("Return");
	ASSERT_NE(nullptr, Question("Replace"));
	driver.Key("Return");
	ASSERT_EQ(1u, Received(B_SAVE_REQUESTED).size());
	EXPECT_STREQ("alpha.rsrc", Received(B_SAVE_REQUESTED)[0].GetString("name", ""));
}


TEST_F(FilePanelTest, ASavedPathMayNameAnotherFolder)
{
	Show(B_SAVE_PANEL);
	driver.Type("Inner/other.rsrc\n");
	ASSERT_EQ(1u, Received(B_SAVE_REQUESTED).size());
	entry_ref directory;
	Received(B_SAVE_REQUESTED)[0].FindRef("directory", &directory);
	EXPECT_EQ(folder / "files/Inner", BPath(&directory).Path());
	EXPECT_STREQ("other.rsrc", Received(B_SAVE_REQUESTED)[0].GetString("name", ""));
}


TEST_F(FilePanelTest, ANameToSaveIsNotCompleted)
{
	Show(B_SAVE_PANEL);
	driver.Type("alp");
	EXPECT_EQ("alp", Typed());
}


TEST_F(FilePanelTest, NothingIsSavedIntoAFolderThatIsNotThere)
{
	Show(B_SAVE_PANEL);
	driver.Type("no such folder/name\n");
	EXPECT_EQ(1, CountAlerts());
	EXPECT_TRUE(Received(B_SAVE_REQUESTED).empty());
	EXPECT_TRUE(panel->IsShowing());
}


TEST_F(FilePanelTest, ANewFolderIsMadeAndEntered)
{
	Show(B_SAVE_PANEL);
	driver.Type("name.rsrc");
	driver.Key("n", B_COMMAND_KEY | B_CONTROL_KEY);
	ASSERT_NE(nullptr, Question("New folder"));
	driver.Type("made\n");
	EXPECT_TRUE(fs::is_directory(folder / "files/made"));
	EXPECT_EQ(folder / "files/made", PanelFolder());
	EXPECT_EQ("name.rsrc", Typed());
}


TEST_F(FilePanelTest, FavoritesOutliveThePanel)
{
	Show(B_OPEN_PANEL);
	driver.Key("t", B_COMMAND_KEY | B_CONTROL_KEY);
	panel.reset();
	Show(B_OPEN_PANEL);
	panel->SetPanelDirectory("/");
	BMenuBar* bar = Find<BMenuBar>("menu bar");
	BPoint title;
	{
		BAutolock lock(panel->Window());
		BMenu* favorites = bar->SubmenuAt(1);
		ASSERT_NE(nullptr, favorites->FindItem("files"));
		const BRect frame = bar->ItemAt(1)->Frame();
		title = BPoint((frame.left + frame.right) / 2, (frame.top + frame.bottom) / 2);
	}
	driver.Click(bar, title);
	driver.Key("f");
	EXPECT_EQ(folder / "files", PanelFolder());
}


TEST_F(FilePanelTest, TheFolderMenuLeadsToTheFoldersAbove)
{
	Show(B_OPEN_PANEL);
	panel->SetPanelDirectory((folder / "files/Inner").c_str());
	BMenuField* field = Find<BMenuField>("folder");
	BAutolock lock(panel->Window());
	EXPECT_STREQ("Inner", field->MenuItem()->Label());
	EXPECT_STREQ("Inner", field->Menu()->ItemAt(0)->Label());
	EXPECT_STREQ("files", field->Menu()->ItemAt(1)->Label());
	EXPECT_STREQ("/", field->Menu()->ItemAt(field->Menu()->CountItems() - 1)->Label());
}


TEST_F(FilePanelTest, FilesThatHaveComeAreShownOnActivation)
{
	Show(B_OPEN_PANEL);
	ClickRow(2);
	WriteFile(folder / "files/aaa", "");
	// A time of its own, whatever the file system's clock.
	fs::last_write_time(folder / "files", fs::file_time_type::clock::now() + std::chrono::hours(1));
	BWindow* other = new BWindow(BRect(0, 0, 50, 50), "other", B_TITLED_WINDOW, 0);
	other->Show();
	driver.ActivateWindow(panel->Window());
	EXPECT_EQ("aaa", Names()[2]);
	entry_ref ref;
	EXPECT_EQ(B_OK, panel->GetNextSelectedRef(&ref));
	EXPECT_STREQ("alpha.rsrc", ref.name);
	other->Lock();
	other->Quit();
}


TEST_F(FilePanelTest, SurvivesItsFolder)
{
	Show(B_OPEN_PANEL);
	fs::remove_all(folder / "files");
	panel->Refresh();
	Driver::WaitUntilIdle();
	EXPECT_EQ("/", PanelFolder());
}


TEST_F(FilePanelTest, DoesNotKeepTheApplicationFromQuitting)
{
	Show(B_OPEN_PANEL);
	EXPECT_TRUE(app->QuitRequested());
	EXPECT_EQ(nullptr, panel->Window());
	panel->Show();
	EXPECT_FALSE(panel->IsShowing());
	EXPECT_EQ(1u, Received(B_CANCEL).size());
}


TEST_F(FilePanelTest, ButtonsTakeOtherLabels)
{
	Show(B_OPEN_PANEL);
	panel->SetButtonLabel(B_DEFAULT_BUTTON, "Import these files");
	panel->SetButtonLabel(B_CANCEL_BUTTON, "Leave it");
	BButton* choose = Find<BButton>("default button");
	BButton* cancel = Find<BButton>("cancel button");
	BAutolock lock(panel->Window());
	EXPECT_STREQ("Import these files", choose->Label());
	EXPECT_STREQ("Leave it", cancel->Label());
	EXPECT_LT(cancel->Frame().right, choose->Frame().left);
	EXPECT_GT(choose->Frame().Width(), choose->StringWidth("Import these files"));
}
