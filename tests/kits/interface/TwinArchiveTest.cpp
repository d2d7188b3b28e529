// Archives that hold several fields of one name: views are made from the first, and lose none.
#include <gtest/gtest.h>

#include <MessageForm.h>
#include <StringView.h>
#include <View.h>

#include "ControlFixture.h"

namespace {

// As the bytes of a file would hold it: the i-th string's name becomes that of the other field.
BMessage
WithTwin(BMessage archive, const char* name)
{
	archive.AddString("its twin", "twin");
	EXPECT_EQ(B_OK, archive.Rename("its twin", name));
	std::vector<char> bytes(archive.FlattenedSize());
	EXPECT_EQ(B_OK, archive.Flatten(bytes.data(), bytes.size()));
	BMessage read;
	EXPECT_EQ(B_OK, unflatten_message(&read, bytes.data(), bytes.size()));
	return read;
}


BMessage
ParentArchive()
{
	BView parent(BRect(0, 0, 99, 99), "parent", B_FOLLOW_NONE, 0);
	parent.AddChild(new BStringView(BRect(5, 5, 60, 20), "child", "Text"));
	BMessage archive = ArchiveOf(parent);
	archive.AddInt32("unknown", 5);
	return archive;
}


std::string
LastField(const BMessage& message)
{
	const int32 last = message.CountNames(B_ANY_TYPE) - 1;
	char* name;
	type_code type;
	EXPECT_EQ(B_OK, message.GetInfo(B_ANY_TYPE, last, &name, &type));
	const void* data;
	ssize_t size;
	EXPECT_EQ(B_OK, find_field_data(message, last, 0, &data, &size));
	return std::string(name) + "=" + static_cast<const char*>(data);
}

} // namespace


TEST(TwinArchive, ComesOutAsItWasRead)
{
	ControlFixture fixture;
	for (const char* name : { "class", "_name", "_frame", "_views", "_flags", "unknown" }) {
		SCOPED_TRACE(name);
		const BMessage archive = WithTwin(ParentArchive(), name);
		ExpectArchiveRoundTrip<BView>(fixture, archive);
		const BMessage written = ArchiveOf(*Revive<BView>(archive));
		EXPECT_EQ(std::string(name) + "=twin", LastField(written));
	}
}


TEST(TwinArchive, AChangeChangesTheFirst)
{
	ControlFixture fixture;
	const BMessage archive = WithTwin(WithTwin(ParentArchive(), "_name"), "_frame");
	const auto view = Revive<BView>(archive);
	EXPECT_STREQ("parent", view->Name());
	EXPECT_EQ(1, view->CountChildren());
	view->SetName("changed");
	view->MoveTo(7, 8);
	BMessage written = ArchiveOf(*view);
	EXPECT_STREQ("changed", written.FindString("_name"));
	EXPECT_EQ(BRect(7, 8, 106, 107), written.FindRect("_frame"));
	EXPECT_EQ("_frame=twin", LastField(written));
	EXPECT_EQ(archive.CountNames(B_ANY_TYPE), written.CountNames(B_ANY_TYPE));
	written.ReplaceString("_name", "parent");
	written.ReplaceRect("_frame", BRect(0, 0, 99, 99));
	EXPECT_TRUE(archive.HasSameData(written, false, true));
}


TEST(TwinArchive, OfAChildOrAnUnknownClassStays)
{
	ControlFixture fixture;
	BMessage archive = ParentArchive();
	BMessage child;
	ASSERT_EQ(B_OK, archive.FindMessage("_views", &child));
	child = WithTwin(child, "_text");
	archive.ReplaceMessage("_views", &child);
	child.ReplaceString("class", "NoClassOfThisName");
	archive.AddMessage("_views", &child);
	ExpectArchiveRoundTrip<BView>(fixture, archive);

	const auto view = Revive<BView>(archive);
	view->ChildAt(0)->MoveBy(1, 1);
	view->ChildAt(1)->MoveBy(1, 1);
	const BMessage written = ArchiveOf(*view);
	for (int32 i = 0; i < 2; i++) {
		ASSERT_EQ(B_OK, written.FindMessage("_views", i, &child));
		EXPECT_EQ("_text=twin", LastField(child));
		EXPECT_EQ(BRect(6, 6, 61, 21), child.FindRect("_frame"));
	}
}


// The value that was first is gone, so that the twin is found when the archive is read again.
TEST(TwinArchive, StaysWhenTheFirstGoes)
{
	ControlFixture fixture;
	BMessage archive = ParentArchive();
	archive.AddInt16("_show", 1);
	archive = WithTwin(archive, "_show");
	const auto view = Revive<BView>(archive);
	ASSERT_TRUE(view->IsHidden());
	view->Show();
	const BMessage written = ArchiveOf(*view);
	EXPECT_EQ("_show=twin", LastField(written));
	EXPECT_EQ(archive.CountNames(B_ANY_TYPE) - 1, written.CountNames(B_ANY_TYPE));
	EXPECT_FALSE(Revive<BView>(written)->IsHidden());
}
