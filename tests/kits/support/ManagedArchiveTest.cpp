// Trees that come in the managed form: nested for those who read them, managed again when written.

#include <string>
#include <vector>

#include <gtest/gtest.h>

#include <Message.h>
#include <MessageForm.h>
#include <Resources.h>

#include "support/Dump.h"
#include "support/private/ManagedArchive.h"

using namespace BPrivate;

namespace {

BMessage
object(const char* className, std::vector<int32> views = {})
{
	BMessage message;
	message.AddString("class", className);
	message.AddInt32("before", 1);
	for (int32 view : views)
		message.AddInt32("_views", view);
	message.AddInt32("BView:layout", -42);
	message.AddInt32("after", 2);
	return message;
}


// A root with two boxes; the first has a button, the second a text and a layout.
BMessage
managed_tree()
{
	BMessage root = object("BView", { 1, 3 });
	BMessage second = object("BBox", { 4 });
	second.ReplaceInt32("BView:layout", 5);
	BMessage objects[] = { object("BBox", { 2 }), object("BButton"), second, object("BStringView"),
		object("MyLayout") };
	root.RemoveName("after");
	for (const BMessage& child : objects)
		root.AddMessage("_managed_archivable", &child);
	root.AddBool("_managed_archive", true);
	root.AddInt32("after", 2);
	return root;
}


// Classes by depth, as "BView(BBox(BButton) BBox())".
std::string
tree_of(const BMessage& message)
{
	std::string text = message.FindString("class");
	BMessage child;
	std::string children;
	for (int32 i = 0; message.FindMessage("_views", i, &child) == B_OK; i++)
		children += (i > 0 ? " " : "") + tree_of(child);
	return children.empty() ? text : text + "(" + children + ")";
}


// Changes child i of the tree; the function gets the child.
template<typename Function>
void
change_child(BMessage* parent, int32 index, Function function)
{
	BMessage child;
	ASSERT_EQ(B_OK, parent->FindMessage("_views", index, &child));
	function(&child);
	ASSERT_EQ(B_OK, parent->ReplaceMessage("_views", index, &child));
}

} // namespace


TEST(ManagedArchive, BecomesNestedAndManagedAgain)
{
	const BMessage original = managed_tree();
	BMessage archive(original);
	ASSERT_TRUE(is_managed_archive(archive));
	ASSERT_EQ(B_OK, unmanage_archive(&archive));
	EXPECT_FALSE(is_managed_archive(archive));
	EXPECT_EQ("BView(BBox(BButton) BBox(BStringView))", tree_of(archive));
	EXPECT_FALSE(archive.HasMessage("_managed_archivable"));
	EXPECT_TRUE(is_managed_root(archive));
	EXPECT_TRUE(keeps_foreign_objects(archive));

	ASSERT_EQ(B_OK, manage_archive(&archive));
	EXPECT_TRUE(archive.HasSameData(original, false, true));
	EXPECT_FALSE(has_managed_note(archive));
}


TEST(ManagedArchive, TheMarkKeepsItsByte)
{
	BMessage archive = managed_tree();
	const uint8 odd = 0x25;
	ASSERT_EQ(B_OK, archive.ReplaceData("_managed_archive", B_BOOL_TYPE, &odd, sizeof(odd)));
	const BMessage original(archive);
	ASSERT_EQ(B_OK, unmanage_archive(&archive));
	ASSERT_EQ(B_OK, manage_archive(&archive));
	EXPECT_EQ("", test::first_difference(original, archive));
}


TEST(ManagedArchive, WhatIsNestedStaysNested)
{
	BMessage root = object("BView");
	BMessage child = object("BBox");
	root.AddMessage("_views", &child);
	const BMessage original(root);
	EXPECT_EQ(B_OK, unmanage_archive(&root));
	EXPECT_EQ(B_OK, manage_archive(&root));
	EXPECT_TRUE(root.HasSameData(original, false, true));
}


TEST(ManagedArchive, AMarkOnANestedTreeIsAFieldLikeOthers)
{
	BMessage archive = object("BView");
	const BMessage child = object("BBox");
	archive.AddMessage("_views", &child);
	archive.AddBool("_managed_archive", true);
	const BMessage original(archive);
	EXPECT_FALSE(is_managed_archive(archive));
	ASSERT_EQ(B_OK, unmanage_archive(&archive));
	EXPECT_FALSE(has_managed_note(archive));
	ASSERT_EQ(B_OK, manage_archive(&archive));
	EXPECT_EQ("", test::first_difference(original, archive));

	archive.RemoveName("_views");
	EXPECT_TRUE(is_managed_archive(archive));
}


TEST(ManagedArchive, ARemovedViewGoesAndTheOthersAreRenumbered)
{
	BMessage archive = managed_tree();
	ASSERT_EQ(B_OK, unmanage_archive(&archive));
	ASSERT_EQ(B_OK, archive.RemoveData("_views", 0));
	ASSERT_EQ(B_OK, manage_archive(&archive));
	EXPECT_EQ(1, archive.FindInt32("_views"));
	type_code type;
	int32 count;
	ASSERT_EQ(B_OK, archive.GetInfo("_managed_archivable", &type, &count));
	EXPECT_EQ(3, count);
	BMessage box;
	ASSERT_EQ(B_OK, archive.FindMessage("_managed_archivable", 0, &box));
	EXPECT_EQ(2, box.FindInt32("_views"));
	EXPECT_EQ(3, box.FindInt32("BView:layout"));
	BMessage layout;
	ASSERT_EQ(B_OK, archive.FindMessage("_managed_archivable", 2, &layout));
	EXPECT_STREQ("MyLayout", layout.FindString("class"));
	ASSERT_EQ(B_OK, unmanage_archive(&archive));
	EXPECT_EQ("BView(BBox(BStringView))", tree_of(archive));
}


TEST(ManagedArchive, ObjectsOutsideTheTreeStayTogether)
{
	BMessage root = object("BView", { 1 });
	BMessage objects[] = { object("BBox"), object("MyOwner", { 3 }), object("MyPart") };
	for (const BMessage& child : objects)
		root.AddMessage("_managed_archivable", &child);
	root.AddBool("_managed_archive", true);
	BMessage archive(root);
	ASSERT_EQ(B_OK, unmanage_archive(&archive));
	ASSERT_EQ(B_OK, archive.RemoveName("_views"));
	ASSERT_EQ(B_OK, manage_archive(&archive));

	// The box is gone; the owner is the first now, and its part the second.
	BMessage owner;
	ASSERT_EQ(B_OK, archive.FindMessage("_managed_archivable", 0, &owner));
	EXPECT_STREQ("MyOwner", owner.FindString("class"));
	EXPECT_EQ(2, owner.FindInt32("_views"));
	BMessage part;
	ASSERT_EQ(B_OK, archive.FindMessage("_managed_archivable", 1, &part));
	EXPECT_STREQ("MyPart", part.FindString("class"));
	EXPECT_FALSE(archive.HasMessage("_managed_archivable", 2));
}


TEST(ManagedArchive, NewAndCopiedAndMovedViewsFindTheirNumbers)
{
	BMessage archive = managed_tree();
	ASSERT_EQ(B_OK, unmanage_archive(&archive));
	BMessage button;
	change_child(&archive, 0, [&](BMessage* box) {
		ASSERT_EQ(B_OK, box->FindMessage("_views", &button));
		const BMessage fresh = object("BCheckBox");
		box->AddMessage("_views", &fresh);
	});
	change_child(&archive, 1, [&](BMessage* box) { box->AddMessage("_views", &button); });
	const std::string tree = tree_of(archive);
	EXPECT_EQ("BView(BBox(BButton BCheckBox) BBox(BStringView BButton))", tree);

	ASSERT_EQ(B_OK, manage_archive(&archive));
	int32 count;
	type_code type;
	ASSERT_EQ(B_OK, archive.GetInfo("_managed_archivable", &type, &count));
	EXPECT_EQ(7, count);
	ASSERT_EQ(B_OK, unmanage_archive(&archive));
	EXPECT_EQ(tree, tree_of(archive));
}


TEST(ManagedArchive, AViewOnItsOwnForgetsItsNumbers)
{
	BMessage archive = managed_tree();
	ASSERT_EQ(B_OK, unmanage_archive(&archive));
	BMessage box;
	ASSERT_EQ(B_OK, archive.FindMessage("_views", 1, &box));
	EXPECT_TRUE(has_managed_note(box));
	EXPECT_FALSE(is_managed_root(box));
	EXPECT_EQ(5, box.FindInt32("BView:layout"));
	clear_managed_note(&box);
	EXPECT_EQ(-42, box.FindInt32("BView:layout"));
	EXPECT_FALSE(has_managed_note(box));
}


TEST(ManagedArchive, TokensThatNameNothingOrTwiceAreRefused)
{
	for (int32 token : { 6, 1, 0, 0x7fffffff }) {
		BMessage archive = managed_tree();
		archive.ReplaceInt32("_views", 1, token);
		const BMessage original(archive);
		EXPECT_EQ(B_BAD_DATA, unmanage_archive(&archive)) << token;
		EXPECT_TRUE(archive.HasSameData(original, false, true));
	}

	// Each view is the child of the other.
	BMessage circle = object("BView", { 1 });
	const BMessage first = object("BView", { 2 });
	const BMessage second = object("BView", { 1 });
	circle.AddMessage("_managed_archivable", &first);
	circle.AddMessage("_managed_archivable", &second);
	circle.AddBool("_managed_archive", true);
	EXPECT_EQ(B_BAD_DATA, unmanage_archive(&circle));
}


// Nobody could say which of the two holds the objects.
TEST(ManagedArchive, AmbiguousObjectsAreRefusedAndOtherTwinsKeepTheirPlaces)
{
	for (const char* name : { "_managed_archive", "_managed_archivable", "_views" }) {
		SCOPED_TRACE(name);
		BMessage archive = managed_tree();
		archive.AddInt32("its twin", 7);
		ASSERT_EQ(B_OK, archive.Rename("its twin", name));
		const BMessage original(archive);
		EXPECT_EQ(B_BAD_DATA, unmanage_archive(&archive));
		EXPECT_TRUE(original.HasSameData(archive, false, true));
	}

	BMessage archive = managed_tree();
	archive.Rename("before", "BView:layout");
	archive.Rename("after", "class");
	const BMessage original(archive);
	ASSERT_EQ(B_OK, unmanage_archive(&archive));
	ASSERT_EQ(B_OK, manage_archive(&archive));
	EXPECT_EQ("", test::first_difference(original, archive));
}


TEST(ManagedArchive, AChainWithoutEndIsRefused)
{
	BMessage root = object("BView", { 1 });
	for (int32 i = 2; i <= 100000; i++) {
		const BMessage link = object("BView", { i });
		root.AddMessage("_managed_archivable", &link);
	}
	root.AddBool("_managed_archive", true);
	EXPECT_EQ(B_BAD_DATA, unmanage_archive(&root));
}


TEST(ManagedArchive, ATabViewOwnsTheViewOfItsFrontTab)
{
	BMessage root = object("BTabView", { 1 });
	root.AddInt32("_sel", 1);
	for (int32 token : { 2, 4 })
		root.AddInt32("_l_items", token);
	for (int32 token : { 3, 5 })
		root.AddInt32("_view_list", token);
	const BMessage objects[] = { object("BView", { 5 }), object("BTab"), object("BView"),
		object("BTab"), object("BBox") };
	for (const BMessage& child : objects)
		root.AddMessage("_managed_archivable", &child);
	root.AddBool("_managed_archive", true);

	BMessage archive(root);
	ASSERT_EQ(B_OK, unmanage_archive(&archive));
	BMessage container;
	ASSERT_EQ(B_OK, archive.FindMessage("_views", &container));
	EXPECT_FALSE(container.HasMessage("_views"));
	BMessage front;
	ASSERT_EQ(B_OK, archive.FindMessage("_view_list", 1, &front));
	EXPECT_STREQ("BBox", front.FindString("class"));
	EXPECT_TRUE(archive.HasMessage("_l_items", 1));

	ASSERT_EQ(B_OK, manage_archive(&archive));
	EXPECT_TRUE(archive.HasSameData(root, false, true));
}


// Else the page of the second tab would be shown by the first.
TEST(ManagedArchive, ATabWithoutAPageKeepsTheNumbersOfTheOthers)
{
	BMessage root = object("BTabView", { 1 });
	root.AddInt32("_sel", 0);
	for (int32 token : { 2, 3 })
		root.AddInt32("_l_items", token);
	for (int32 token : { -42, 4 })
		root.AddInt32("_view_list", token);
	for (const char* name : { "BView", "BTab", "BTab", "BBox" }) {
		const BMessage child = object(name);
		root.AddMessage("_managed_archivable", &child);
	}
	root.AddBool("_managed_archive", true);

	BMessage archive(root);
	ASSERT_EQ(B_OK, unmanage_archive(&archive));
	BMessage page;
	ASSERT_EQ(B_OK, archive.FindMessage("_view_list", 0, &page));
	EXPECT_TRUE(page.IsEmpty());
	ASSERT_EQ(B_OK, archive.FindMessage("_view_list", 1, &page));
	EXPECT_STREQ("BBox", page.FindString("class"));
	ASSERT_EQ(B_OK, manage_archive(&archive));
	EXPECT_EQ("", test::first_difference(root, archive));
}


TEST(ManagedArchive, FieldsThatNameNoObjectStayAsTheyAre)
{
	for (const char* name : { "_views", "_l_items", "_view_list" }) {
		SCOPED_TRACE(name);
		BMessage child = object("BButton");
		child.RemoveName("_views");
		child.AddInt32(name, -1);
		child.AddInt32(name, -2);
		BMessage root = object("BView", { 1 });
		root.AddMessage("_managed_archivable", &child);
		root.AddBool("_managed_archive", true);
		BMessage archive(root);
		ASSERT_EQ(B_OK, unmanage_archive(&archive));
		BMessage button;
		ASSERT_EQ(B_OK, archive.FindMessage("_views", &button));
		EXPECT_TRUE(button.HasInt32(name, 1));
		ASSERT_EQ(B_OK, manage_archive(&archive));
		EXPECT_EQ("", test::first_difference(root, archive));
	}
}


TEST(ManagedArchive, ItemsThatAreLongerThanTokensAreNone)
{
	BMessage foreign = object("MyLayout");
	const char bytes[] = { 3, 0, 0, 0, 127 };
	for (int32 i = 0; i < 2; i++)
		ASSERT_EQ(B_OK, foreign.AddData("_l_items", B_INT32_TYPE, bytes, sizeof(bytes), false));
	BMessage root = object("BView", { 1 });
	const BMessage child = object("BBox");
	root.AddMessage("_managed_archivable", &child);
	root.AddMessage("_managed_archivable", &foreign);
	root.AddBool("_managed_archive", true);

	BMessage archive(root);
	ASSERT_EQ(B_OK, unmanage_archive(&archive));
	ASSERT_EQ(B_OK, manage_archive(&archive));
	EXPECT_EQ("", test::first_difference(root, archive));
}


TEST(ManagedArchive, SamplesComeBackExactly)
{
	if (test::samples_folder().empty())
		GTEST_SKIP() << "ARCHWAY_SAMPLES names no folder";
	int managed = 0;
	for (const std::string& path : test::sample_files()) {
		BResources resources(path.c_str());
		int32 id;
		const char* name;
		size_t size;
		for (int32 i = 0; resources.GetResourceInfo('ARCV', i, &id, &name, &size); i++) {
			SCOPED_TRACE(path + " " + std::to_string(id));
			const void* data = resources.LoadResource('ARCV', id, &size);
			BMessage archive;
			ASSERT_EQ(B_OK, unflatten_message(&archive, data, size));
			if (!is_managed_archive(archive))
				continue;
			managed++;
			const BMessage original(archive);
			ASSERT_EQ(B_OK, unmanage_archive(&archive));
			EXPECT_FALSE(archive.HasInt32("_views"));
			ASSERT_EQ(B_OK, manage_archive(&archive));
			EXPECT_TRUE(archive.HasSameData(original, false, true));
			std::string bytes(size_t(flattened_message_size(archive, B_HAIKU_FORM)), '\0');
			ASSERT_EQ(
				B_OK, flatten_message(archive, B_HAIKU_FORM, bytes.data(), ssize_t(bytes.size())));
			EXPECT_TRUE(bytes == std::string(static_cast<const char*>(data), size));
		}
	}
	EXPECT_LE(25, managed);
}


// It would be lost as a child, since nothing but itself has a place for it.
TEST(ManagedArchive, AViewThatNamesItselfAsATabsViewIsRefused)
{
	BMessage child = object("BColorControl");
	child.AddInt32("_view_list", 1);
	BMessage root = object("BView", { 1 });
	root.AddMessage("_managed_archivable", &child);
	root.AddBool("_managed_archive", true);
	BMessage archive(root);
	EXPECT_EQ(B_BAD_DATA, unmanage_archive(&archive));
	EXPECT_TRUE(archive.HasSameData(root, true, true));
	EXPECT_TRUE(archive.HasInt32("_views"));
}
