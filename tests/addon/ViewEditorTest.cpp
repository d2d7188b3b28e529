#include "EditorFixture.h"

#include <cstring>
#include <string>
#include <vector>

#include <Button.h>
#include <DataIO.h>
#include <File.h>
#include <Message.h>
#include <OS.h>
#include <Resources.h>
#include <TextControl.h>

#include "archive/ViewArchive.h"
#include "editors/EditView.h"
#include "kernel/private/Debugger.h"
#include "palette/WidgetWindow.h"
#include "support/Dump.h"

using namespace BResEditor;

namespace {


class ViewEditorTest : public EditorFixture {
protected:
	ViewEditorTest() : EditorFixture(BRect(30, 30, 829, 459))
	{
		item = Add(1, MakeTree("root"));
		other = Add(2, MakeTree("other"));
	}

	static BView* MakeTree(const char* name)
	{
		BView* root =
			new BView(BRect(0, 0, 299, 199), name, B_FOLLOW_LEFT | B_FOLLOW_TOP, B_WILL_DRAW);
		root->AddChild(new BButton(BRect(20, 20, 119, 45), "button", "Press", NULL));
		root->AddChild(
			new BView(BRect(20, 80, 119, 139), "plain", B_FOLLOW_LEFT | B_FOLLOW_TOP, B_WILL_DRAW));
		return root;
	}

	void Open() { EditorFixture::Open(item); }

	void Set(const BResourceHandle& handle, const std::vector<char>& bytes)
	{
		BResourceCollection* writable = owner.WriteLock(NULL);
		writable->WriteItem(handle)->SetData(bytes.data(), bytes.size());
		owner.WriteUnlock(writable);
		Driver::WaitUntilIdle();
	}

	BResourceHandle item;
	BResourceHandle other;
};


} // namespace


TEST_F(ViewEditorTest, HasTwoColumns)
{
	Open();
	EXPECT_EQ(static_cast<BView*>(editor), editor->View());
	ASSERT_EQ(2, editor->CountChildren());
	EXPECT_EQ(408, Column()->Frame().right);
	EXPECT_EQ(216, Column()->ViewColor().red);
	EXPECT_EQ(BPoint(412, 1), workView->Frame().LeftTop() + BPoint(2, 2));
	float width, height;
	editor->GetPreferredSize(&width, &height);
	EXPECT_EQ(800, width);
	EXPECT_EQ(430, height);
}


TEST_F(ViewEditorTest, ShowsTheItemsTreeWithItsRootSelected)
{
	Open();
	ASSERT_NE(nullptr, workView->EditView());
	EXPECT_STREQ("root", workView->EditView()->Name());
	EXPECT_EQ(workView->EditView(), workView->SelectedView());
	ASSERT_EQ(1, Column()->CountChildren());
	EXPECT_EQ(BPoint(4, 4), Column()->ChildAt(0)->Frame().LeftTop());
	EXPECT_EQ(400, Column()->ChildAt(0)->Bounds().Width());
}


TEST_F(ViewEditorTest, AnUnchangedTreeWritesNothing)
{
	const std::string before = Bytes(item);
	Open();
	uint32 changes;
	while (collection.GetNextChange(&owner, &changes).IsValid())
		;
	Close();
	EXPECT_EQ(before, Bytes(item));
	EXPECT_FALSE(collection.GetNextChange(&owner, &changes).IsValid());
}


TEST_F(ViewEditorTest, AMovedViewIsWrittenBackWhenTheEditorCloses)
{
	Open();
	window.driver.Click(Find("plain"));
	window.driver.Key("Right", 0, 4);
	Close();

	BMessage archive, child;
	ASSERT_EQ(B_OK, archive.Unflatten(Bytes(item).data()));
	ASSERT_EQ(B_OK, archive.FindMessage("_views", 1, &child));
	BRect frame;
	ASSERT_EQ(B_OK, child.FindRect("_frame", &frame));
	EXPECT_EQ(BRect(24, 80, 123, 139), frame);
	ASSERT_EQ(B_OK, archive.FindMessage("_views", 0, &child));
	ASSERT_EQ(B_OK, child.FindRect("_frame", &frame));
	EXPECT_EQ(BRect(20, 20, 119, 45), frame);
}


TEST_F(ViewEditorTest, MovingBackGivesTheOriginalBytes)
{
	const std::string before = Bytes(item);
	Open();
	window.driver.Click(Find("plain"));
	window.driver.Key("Right");
	window.Locked([&] { editor->ApplyChanges(); });
	EXPECT_NE(before, Bytes(item));
	window.driver.Key("Left");
	window.Locked([&] { editor->ApplyChanges(); });
	Close();
	EXPECT_EQ(before, Bytes(item));
}


TEST_F(ViewEditorTest, ASaveKeepsTheSelection)
{
	Open();
	window.driver.Click(Find("plain"));
	window.driver.Key("Down");
	BView* before = workView->EditView();
	window.Locked([&] { editor->ApplyChanges(); });
	EXPECT_NE(before, workView->EditView()); // the tree was read again
	EXPECT_STREQ("plain", workView->SelectedView()->Name());
	window.driver.Key("Down");
	EXPECT_EQ(82, Find("plain")->Frame().top);
}


TEST_F(ViewEditorTest, TheHostsDataReplacesTheTree)
{
	Open();
	Set(item, Flatten(MakeTree("changed")));
	EXPECT_STREQ("changed", workView->EditView()->Name());
	EXPECT_EQ(workView->EditView(), workView->SelectedView());
}


TEST_F(ViewEditorTest, OtherItemsAndOtherChangesAreIgnored)
{
	Open();
	BView* root = workView->EditView();
	Set(other, Flatten(MakeTree("changed")));
	EXPECT_EQ(root, workView->EditView());

	window.Locked([&] {
		BResourceCollection* writable = editor->WriteLock(NULL);
		writable->WriteItem(item)->SetName("renamed");
		editor->WriteUnlock(writable);
	});
	EXPECT_EQ(root, workView->EditView());

	window.Locked([&] {
		const BResourceCollection* readable = editor->ReadLock();
		editor->ExecDataChanged(readable, item, 0);
		editor->ExecDataChanged(readable, item, 0x7);
		editor->ReadUnlock(readable);
	});
	EXPECT_EQ(root, workView->EditView());
}


TEST_F(ViewEditorTest, BytesThatAreNoViewKeepTheOldTree)
{
	Open();
	BView* root = workView->EditView();
	Set(item, { 'n', 'o' });
	EXPECT_EQ(root, workView->EditView());
}


TEST_F(ViewEditorTest, RetargetShowsTheOtherItem)
{
	Open();
	window.Locked([&] { EXPECT_EQ(B_OK, editor->Retarget(other)); });
	EXPECT_STREQ("other", workView->EditView()->Name());
}


TEST_F(ViewEditorTest, AChangeWithoutTheWindowsLockStopsInTheDebugger)
{
	Open();
	static std::string sText;
	sText.clear();
	BPrivate::set_debugger_hook([](const char* text) { sText = text; });
	const BResourceCollection* readable = owner.ReadLock();
	editor->ExecDataChanged(readable, item, 0x8);
	owner.ReadUnlock(readable);
	BPrivate::set_debugger_hook(NULL);
	EXPECT_EQ("ExecDataChanged() called without window locked", sText);
}


TEST_F(ViewEditorTest, EditorsShareOnePalette)
{
	EXPECT_EQ(0, widgetWindowCount);
	Open();
	EXPECT_EQ(1, widgetWindowCount);
	WidgetWindow* palette = widgetWindow;
	ASSERT_NE(nullptr, palette);

	ViewEditor* second = new ViewEditor(args, other);
	window.Locked([&] { window.Window()->AddChild(second); });
	EXPECT_EQ(2, widgetWindowCount);
	EXPECT_EQ(palette, widgetWindow);

	Close();
	EXPECT_EQ(1, widgetWindowCount);
	EXPECT_EQ(palette, widgetWindow);

	window.Locked([&] { second->RemoveSelf(); });
	delete static_cast<BFullItemEditor*>(second);
	EXPECT_EQ(0, widgetWindowCount);
	EXPECT_EQ(NULL, widgetWindow);
}


TEST_F(ViewEditorTest, TheWindowGrowsForThePanelsAndDoesNotShrink)
{
	window.Locked([&] { window.Window()->ResizeTo(700, 200); });
	Open();
	const float height = window.Window()->Bounds().Height();
	EXPECT_EQ(4 + 330 + 6, height);
	window.driver.Click(Find("plain"));
	EXPECT_EQ(height, window.Window()->Bounds().Height());
}


TEST_F(ViewEditorTest, AnEarlierClickOnADeletedViewIsIgnored)
{
	Open();
	BView* plain = Find("plain");
	window.Locked([&] {
		workView->SetSelectedView(plain);
		workView->SetSelectedView(workView->EditView());
		plain->RemoveSelf();
		delete plain;
	});
	EXPECT_EQ(workView->EditView(), workView->SelectedView());
}


TEST_F(ViewEditorTest, ANameTypedInThePanelReachesTheItem)
{
	Open();
	window.driver.Click(Find("plain"));
	person.TypeOver(ControlUser::Find<BTextControl>(Column(), "Name: "), "fresh");
	Close();

	BMessage archive, child;
	ASSERT_EQ(B_OK, archive.Unflatten(Bytes(item).data()));
	ASSERT_EQ(B_OK, archive.FindMessage("_views", 1, &child));
	EXPECT_STREQ("fresh", child.GetString("_name", ""));
}


// Its missing class name is written as an empty one.
static bool
IsNamelessPlaceholder(const BMessage& archive)
{
	const char* name;
	return !archive.HasString("class", 1) && archive.FindString("class", &name) == B_OK
		&& strcmp(name, "LayoutInheritedView") == 0;
}


// The tree is attached, drawn, archived again: nothing of that may show in the item.
TEST_F(ViewEditorTest, ANewNameOfTheRootChangesNothingElseOfAnySample)
{
	if (test::samples_folder().empty())
		GTEST_SKIP() << "there are no samples";
	int views = 0;
	for (const std::string& path : test::sample_files()) {
		BFile file(path.c_str(), B_READ_ONLY);
		BResources resources(&file);
		int32 id;
		const char* name;
		size_t size;
		for (int32 i = 0; resources.GetResourceInfo('ARCV', i, &id, &name, &size); i++) {
			const char* data = static_cast<const char*>(resources.LoadResource('ARCV', id, &size));
			BMessage before;
			BMemoryIO original(data, size);
			if (before.Unflatten(&original) != B_OK || IsNamelessPlaceholder(before))
				continue;
			SCOPED_TRACE(path + " ARCV:" + std::to_string(id));
			Set(item, std::vector<char>(data, data + size));
			Open();
			if (workView->SelectedView() == NULL) {
				Close();
				continue;
			}
			person.Replace(ControlUser::Find<BTextControl>(Column(), "Name: "), "fresh");
			window.driver.Key("Tab");
			Close();

			BMessage after;
			ASSERT_EQ(B_OK, after.Unflatten(Bytes(item).data()));
			EXPECT_STREQ("fresh", after.GetString("_name", ""));
			before.RemoveName("_name");
			after.RemoveName("_name");
			EXPECT_TRUE(Equal(&before, &after));
			views++;
		}
	}
	EXPECT_LT(50, views);
}
