// Archives of the samples are revived, shown, and written again without a difference.
#include <gtest/gtest.h>

#include <algorithm>
#include <cstring>
#include <memory>

#include <Archivable.h>
#include <File.h>
#include <Message.h>
#include <Resources.h>
#include <ScrollView.h>
#include <View.h>
#include <Window.h>

#include "support/Dump.h"
#include "support/TestWindow.h"

namespace {

struct Archive {
	std::string where;
	BMessage message;
};


std::vector<Archive>
sample_archives()
{
	std::vector<Archive> archives;
	for (const std::string& path : test::sample_files()) {
		BFile file(path.c_str(), B_READ_ONLY);
		BResources resources;
		if (resources.SetTo(&file) != B_OK)
			continue;
		type_code type;
		int32 id;
		const char* name;
		size_t size;
		for (int32 i = 0; resources.GetResourceInfo(i, &type, &id, &name, &size); i++) {
			const void* data = resources.LoadResource(type, id, &size);
			BMemoryIO stream(data, size);
			Archive archive { path + " " + std::to_string(id), BMessage() };
			if (type == 'ARCV' && archive.message.Unflatten(&stream) == B_OK)
				archives.push_back(std::move(archive));
		}
	}
	return archives;
}


std::unique_ptr<BView>
revive(BMessage archive)
{
	BArchivable* object = instantiate_object(&archive);
	BView* view = dynamic_cast<BView*>(object);
	if (view == nullptr)
		delete object;
	return std::unique_ptr<BView>(view);
}

} // namespace


TEST(ViewArchive, SamplesComeOutAsTheyWereRead)
{
	if (test::samples_folder().empty())
		GTEST_SKIP() << "no samples";
	TestWindow window;
	int32 tested = 0;
	for (const Archive& archive : sample_archives()) {
		std::unique_ptr<BView> view = revive(archive.message);
		if (view == nullptr)
			continue;
		BMessage unattached;
		ASSERT_EQ(B_OK, view->Archive(&unattached));
		EXPECT_EQ("", test::first_difference(archive.message, unattached)) << archive.where;

		window.Add(view.get());
		window.Locked([&] { view->RemoveSelf(); });
		BMessage shown;
		ASSERT_EQ(B_OK, view->Archive(&shown));
		EXPECT_EQ("", test::first_difference(archive.message, shown)) << archive.where << ", shown";
		tested++;
	}
	EXPECT_GT(tested, 20);
}


// #pragma mark - the fields of BView


namespace {

BMessage
archive_of(const BView& view, bool deep = true)
{
	BMessage archive;
	EXPECT_EQ(B_OK, view.Archive(&archive, deep));
	return archive;
}


// What the add-ons of a program do: a class with fields of its own and plain calls.
class NoteView : public BView {
public:
	NoteView() : BView(BRect(0, 0, 9, 9), "note", B_FOLLOW_NONE, 0) {}
	explicit NoteView(BMessage* archive) : BView(archive) { fNote = archive->FindInt32("note"); }

	status_t Archive(BMessage* archive, bool deep) const override
	{
		BView::Archive(archive, deep);
		if (fNote >= 0)
			archive->AddInt32("note", fNote);
		return archive->AddString("late", "added without a look");
	}

	int32 fNote = 1;
};

} // namespace


TEST(ViewArchive, ANewViewWritesItsFieldsInOrder)
{
	BView view(BRect(1, 2, 30, 40), "name", B_FOLLOW_ALL, B_WILL_DRAW);
	BMessage archive = archive_of(view);
	EXPECT_EQ(0u, archive.what);
	EXPECT_STREQ("BView", archive.FindString("class"));
	EXPECT_STREQ("name", archive.FindString("_name"));
	EXPECT_EQ(BRect(1, 2, 30, 40), archive.FindRect("_frame"));
	EXPECT_EQ(int32(B_FOLLOW_ALL), archive.FindInt32("_resize_mode"));
	EXPECT_EQ(int32(B_WILL_DRAW), archive.FindInt32("_flags"));
	EXPECT_EQ(0x000000ff, archive.FindInt32("_color", 0));
	EXPECT_EQ(-1, archive.FindInt32("_color", 2));
	for (const char* name : { "_evmask", "_fname", "_fflt", "_origin", "_psize", "_ploc",
			 "_lmcapjoin", "_lmmiter", "_blend", "_dmod", "_views", "_show" }) {
		type_code type;
		EXPECT_NE(B_OK, archive.GetInfo(name, &type)) << name;
	}

	view.SetEventMask(5, 4);
	BFont font(be_bold_font);
	view.SetFont(&font);
	view.SetHighColor(1, 2, 3, 4);
	view.SetViewColor(B_TRANSPARENT_COLOR);
	view.SetOrigin(5, 6);
	view.SetPenSize(2);
	view.MovePenTo(7, 8);
	view.SetLineMode(B_ROUND_CAP, B_BEVEL_JOIN, 5);
	view.SetBlendingMode(B_CONSTANT_ALPHA, B_ALPHA_COMPOSITE);
	view.SetDrawingMode(B_OP_ALPHA);
	view.Hide();
	BView* child = new BView(BRect(0, 0, 5, 5), "child", 0, 0);
	view.AddChild(child);
	archive = archive_of(view);
	std::string names;
	char* name;
	type_code type;
	for (int32 i = 0; archive.GetInfo(B_ANY_TYPE, i, &name, &type) == B_OK; i++)
		names += std::string(name) + " ";
	EXPECT_EQ("class _name _frame _resize_mode _flags _evmask _fname _fflt _color _origin _psize "
			  "_ploc _lmcapjoin _lmmiter _blend _dmod _show _views ",
		names);
	EXPECT_EQ(5, archive.FindInt32("_evmask", 0));
	EXPECT_EQ(4, archive.FindInt32("_evmask", 1));
	EXPECT_EQ(0x01020304, archive.FindInt32("_color", 0));
	EXPECT_EQ(0x77747700, archive.FindInt32("_color", 2));
	EXPECT_EQ(B_ROUND_CAP, archive.FindInt16("_lmcapjoin", 0));
	EXPECT_EQ(B_BEVEL_JOIN, archive.FindInt16("_lmcapjoin", 1));
	EXPECT_EQ(B_CONSTANT_ALPHA, archive.FindInt16("_blend", 0));
	EXPECT_EQ(B_OP_ALPHA, archive.FindInt32("_dmod"));
	BMessage nested;
	ASSERT_EQ(B_OK, archive.FindMessage("_views", &nested));
	EXPECT_STREQ("child", nested.FindString("_name"));
	EXPECT_FALSE(archive_of(view, false).HasMessage("_views"));

	std::unique_ptr<BView> copy = revive(archive);
	ASSERT_NE(nullptr, copy);
	EXPECT_EQ(5u, copy->EventMask());
	EXPECT_EQ((rgb_color { 1, 2, 3, 4 }), copy->HighColor());
	EXPECT_EQ(B_TRANSPARENT_COLOR, copy->ViewColor());
	EXPECT_EQ(BPoint(5, 6), copy->Origin());
	EXPECT_EQ(BPoint(7, 8), copy->PenLocation());
	EXPECT_EQ(B_BEVEL_JOIN, copy->LineJoinMode());
	EXPECT_EQ(B_OP_ALPHA, copy->DrawingMode());
	EXPECT_TRUE(copy->IsHidden());
	BFont revived;
	copy->GetFont(&revived);
	EXPECT_EQ(font, revived);
	EXPECT_EQ(1, copy->CountChildren());
}


TEST(ViewArchive, MissingAndStrangeFieldsGiveTheDefaults)
{
	BMessage archive;
	archive.AddString("class", "BView");
	archive.AddInt16("_flags", 3);
	archive.AddInt32("_evmask", 7);
	archive.AddString("_fname", "No such family");
	archive.AddString("_fname", "Style");
	archive.AddFloat("_fflt", -1);
	archive.AddFloat("_fflt", 100);
	std::unique_ptr<BView> view = revive(archive);
	ASSERT_NE(nullptr, view);
	EXPECT_EQ(BRect(0, 0, -1, -1), view->Frame());
	EXPECT_EQ(0u, view->Flags());
	EXPECT_EQ(0u, view->EventMask());
	EXPECT_EQ(NULL, view->Name());
	BFont font;
	view->GetFont(&font);
	EXPECT_EQ(be_plain_font->Size(), font.Size());
	EXPECT_EQ(100, font.Shear());
	EXPECT_EQ("", test::first_difference(archive, archive_of(*view)));

	view->SetName("new");
	view->SetFlags(B_WILL_DRAW);
	BMessage changed = archive_of(*view);
	EXPECT_EQ(int32(B_WILL_DRAW), changed.FindInt32("_flags"));
	EXPECT_STREQ("new", changed.FindString("_name"));
}


TEST(ViewArchive, OnlyWhatWasChangedIsWrittenAnewAndInItsPlace)
{
	BMessage archive('what');
	archive.AddInt32("before", 1);
	archive.AddString("class", "BView");
	archive.AddString("class", "Other");
	archive.AddInt32("_color", 0x010203ff);
	archive.AddRect("_frame", BRect(0.4, 0, 10.3, 10));
	archive.AddInt32("between", 2);
	archive.AddInt32("_flags", 0);
	archive.AddString("_name", "n");
	archive.AddInt32("after", 3);
	std::unique_ptr<BView> view = revive(archive);
	EXPECT_EQ(BRect(0, 0, 10, 10), view->Frame());
	EXPECT_EQ("", test::first_difference(archive, archive_of(*view)));

	view->MoveTo(5, 5);
	BMessage expected('what');
	expected.AddInt32("before", 1);
	expected.AddString("class", "BView");
	expected.AddString("class", "Other");
	expected.AddInt32("_color", 0x010203ff);
	expected.AddRect("_frame", BRect(5, 5, 15, 15));
	expected.AddInt32("between", 2);
	expected.AddInt32("_flags", 0);
	expected.AddString("_name", "n");
	expected.AddInt32("after", 3);
	EXPECT_EQ("", test::first_difference(expected, archive_of(*view)));
	view->MoveTo(0, 0);
	EXPECT_EQ("", test::first_difference(archive, archive_of(*view)));
}


TEST(ViewArchive, AColourThatFollowsTheInterfaceStopsWhenItIsSet)
{
	BMessage archive;
	archive.AddString("class", "BView");
	for (int32 value : { 0x11111111, 0x22222222, 0x33333333 })
		archive.AddInt32("_color", value);
	for (int32 which : { 0, 0, int32(B_PANEL_BACKGROUND_COLOR) })
		archive.AddInt32("_uicolor", which);
	for (int32 i = 0; i < 3; i++)
		archive.AddFloat("_uitint", 1);
	std::unique_ptr<BView> view = revive(archive);
	EXPECT_EQ((rgb_color { 216, 216, 216, 255 }), view->ViewColor());
	EXPECT_EQ("", test::first_difference(archive, archive_of(*view)));
	view->SetViewColor(1, 2, 3);
	BMessage changed = archive_of(*view);
	EXPECT_EQ(0x11111111, changed.FindInt32("_color", 0));
	EXPECT_EQ(0x010203ff, changed.FindInt32("_color", 2));
	EXPECT_EQ(0, changed.FindInt32("_uicolor", 2));
}


TEST(ViewArchive, PlainCallsOfASubclassNeitherDoubleNorMoveAField)
{
	BMessage archive;
	archive.AddInt32("late_place", 1);
	archive.AddString("late", "read");
	archive.AddInt32("note", 5);
	archive.AddString("class", "NoteView");
	archive.AddInt32("unknown", 6);
	BMessage copy(archive);
	NoteView view(&copy);
	BMessage written;
	view.Archive(&written, true);
	int32 count;
	type_code type;
	EXPECT_EQ(B_OK, written.GetInfo("late", &type, &count));
	EXPECT_EQ(1, count);
	EXPECT_STREQ("added without a look", written.FindString("late"));
	EXPECT_EQ(5, written.FindInt32("note"));
	std::string names;
	char* name;
	for (int32 i = 0; written.GetInfo(B_ANY_TYPE, i, &name, &type) == B_OK; i++)
		names += std::string(name) + " ";
	EXPECT_EQ("late_place late note class unknown ", names);

	// Looked up, and no longer written: gone.
	view.fNote = -1;
	BMessage without;
	view.Archive(&without, true);
	EXPECT_FALSE(without.HasInt32("note"));
	EXPECT_TRUE(without.HasInt32("unknown"));
}


TEST(ViewArchive, AnUnknownClassIsStoodInForAndWrittenBack)
{
	BMessage grandchild;
	grandchild.AddString("class", "BView");
	grandchild.AddRect("_frame", BRect(1, 1, 2, 2));
	BMessage child('what');
	child.AddString("class", "Some::UnknownView");
	child.AddString("class", "BView");
	child.AddRect("_frame", BRect(5, 5, 50, 50));
	child.AddData("strange", 'TYPE', "bytes", 5);
	child.AddMessage("_views", &grandchild);
	BMessage archive;
	archive.AddString("class", "BView");
	archive.AddRect("_frame", BRect(0, 0, 99, 99));
	archive.AddMessage("_views", &child);
	BMessage noView;
	noView.AddString("class", "BStringItem");
	archive.AddMessage("_views", &noView);

	TestWindow window;
	BView* view = window.Add(revive(archive).release());
	ASSERT_EQ(2, view->CountChildren());
	EXPECT_EQ(BRect(5, 5, 50, 50), view->ChildAt(0)->Frame());
	EXPECT_EQ(1, view->ChildAt(0)->CountChildren());
	window.Locked([&] {
		EXPECT_EQ("", test::first_difference(archive, archive_of(*view)));
		view->ChildAt(0)->MoveTo(6, 6);
		BMessage changed = archive_of(*view);
		BMessage written;
		ASSERT_EQ(B_OK, changed.FindMessage("_views", 0, &written));
		BMessage expected(child);
		expected.ReplaceRect("_frame", BRect(6, 6, 51, 51));
		EXPECT_EQ("", test::first_difference(expected, written));
	});
}


TEST(ViewArchive, ChildrenThatComeAndGoAreWritten)
{
	BMessage child;
	child.AddString("class", "BView");
	child.AddString("_name", "old");
	child.AddInt32("unknown", 1);
	BMessage archive;
	archive.AddString("class", "BView");
	archive.AddMessage("_views", &child);
	archive.AddInt32("last", 1);
	std::unique_ptr<BView> view = revive(archive);
	view->AddChild(new BView(BRect(0, 0, 5, 5), "new", 0, 0), view->ChildAt(0));
	BMessage written = archive_of(*view);
	BMessage second;
	ASSERT_EQ(B_OK, written.FindMessage("_views", 1, &second));
	EXPECT_EQ("", test::first_difference(child, second));
	char* name;
	type_code type;
	ASSERT_EQ(B_OK, written.GetInfo(B_ANY_TYPE, written.CountNames(B_ANY_TYPE) - 1, &name, &type));
	EXPECT_STREQ("last", name);

	while (BView* gone = view->ChildAt(0)) {
		gone->RemoveSelf();
		delete gone;
	}
	EXPECT_FALSE(archive_of(*view).HasMessage("_views"));
}


TEST(ViewArchive, ALookAtTheArchiveAfterwardsDisturbsNothing)
{
	BMessage archive;
	archive.AddString("class", "BView");
	archive.AddInt32("unknown", 1);
	std::unique_ptr<BView> view(dynamic_cast<BView*>(instantiate_object(&archive)));
	EXPECT_EQ(1, archive.FindInt32("unknown"));
	EXPECT_EQ(1, archive_of(*view).FindInt32("unknown"));
}
