#include "archive/ViewArchive.h"

#include <string>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <Application.h>
#include <Message.h>
#include <Point.h>

namespace {


typedef std::vector<std::string> Names;


BMessage
WithClasses(const Names& names)
{
	BMessage archive;
	for (const std::string& name : names)
		archive.AddString("class", name.c_str());
	return archive;
}


Names
ClassesOf(const BMessage& archive)
{
	Names names;
	const char* name;
	for (int32 i = 0; archive.FindString("class", i, &name) == B_OK; i++)
		names.push_back(name);
	return names;
}


Names
Swapped(const Names& names)
{
	BMessage archive = WithClasses(names);
	SwapInheritedViews(&archive, 0);
	return ClassesOf(archive);
}


std::string
Dumped(const BMessage* message, int depth)
{
	testing::internal::CaptureStdout();
	DumpMessage(message, depth);
	fflush(stdout);
	return testing::internal::GetCapturedStdout();
}


} // namespace


TEST(SwapInheritedViews, BringsThePlaceholderToTheFrontAndBack)
{
	EXPECT_EQ((Names { "LayoutInheritedView", "MyBView", "BView" }),
		Swapped({ "MyBView", "BView", "LayoutInheritedView" }));
	EXPECT_EQ((Names { "MyBView", "BView", "LayoutInheritedView" }),
		Swapped({ "LayoutInheritedView", "MyBView", "BView" }));
}


TEST(SwapInheritedViews, TakesThePlaceholderToTheEnd)
{
	EXPECT_EQ(
		(Names { "BView", "LayoutInheritedView" }), Swapped({ "LayoutInheritedView", "BView" }));
}


TEST(SwapInheritedViews, LeavesASingleNameAndForeignNamesAlone)
{
	EXPECT_EQ((Names { "LayoutInheritedView" }), Swapped({ "LayoutInheritedView" }));
	EXPECT_EQ((Names { "MyButton", "BButton" }), Swapped({ "MyButton", "BButton" }));
	EXPECT_EQ(
		(Names { "A", "LayoutInheritedView", "B" }), Swapped({ "A", "LayoutInheritedView", "B" }));
}


TEST(SwapInheritedViews, LeavesAClassFieldOfAnotherTypeAlone)
{
	BMessage archive;
	archive.AddInt32("class", 1);
	archive.AddInt32("class", 2);
	const BMessage before(archive);
	SwapInheritedViews(&archive, 0);
	EXPECT_TRUE(Equal(&before, &archive));
}


TEST(SwapInheritedViews, ReachesNestedArchivesAndKeepsTheirOrder)
{
	BMessage inner = WithClasses({ "Deep", "LayoutInheritedView" });
	BMessage middle = WithClasses({ "BView" });
	middle.AddMessage("_views", &inner);
	BMessage other = WithClasses({ "BBox" });
	BMessage root = WithClasses({ "BView" });
	root.AddMessage("_views", &middle);
	root.AddMessage("_views", &other);

	SwapInheritedViews(&root, 0);

	BMessage child, grandchild;
	ASSERT_EQ(B_OK, root.FindMessage("_views", 0, &child));
	EXPECT_EQ((Names { "BView" }), ClassesOf(child));
	ASSERT_EQ(B_OK, child.FindMessage("_views", 0, &grandchild));
	EXPECT_EQ((Names { "LayoutInheritedView", "Deep" }), ClassesOf(grandchild));
	ASSERT_EQ(B_OK, root.FindMessage("_views", 1, &child));
	EXPECT_EQ((Names { "BBox" }), ClassesOf(child));
}


TEST(SwapInheritedViews, IsItsOwnInverse)
{
	BMessage child = WithClasses({ "Mine", "BBox", "LayoutInheritedView" });
	BMessage root = WithClasses({ "Yours", "LayoutInheritedView" });
	root.AddMessage("_views", &child);
	const BMessage before(root);

	SwapInheritedViews(&root, 0);
	EXPECT_FALSE(Equal(&before, &root));
	SwapInheritedViews(&root, 0);
	EXPECT_TRUE(Equal(&before, &root));
}


TEST(Equal, IgnoresTheOrderOfFields)
{
	BMessage a, b;
	a.AddInt32("one", 1);
	a.AddString("two", "2");
	b.AddString("two", "2");
	b.AddInt32("one", 1);
	EXPECT_TRUE(Equal(&a, &b));
}


TEST(Equal, MindsTheOrderOfEntries)
{
	BMessage a, b;
	a.AddInt32("n", 1);
	a.AddInt32("n", 2);
	b.AddInt32("n", 2);
	b.AddInt32("n", 1);
	EXPECT_FALSE(Equal(&a, &b));
}


TEST(Equal, ComparesFloatsByTheirBits)
{
	BMessage a, b;
	a.AddFloat("f", 0.0f);
	b.AddFloat("f", -0.0f);
	EXPECT_FALSE(Equal(&a, &b));
}


TEST(Equal, ComparesCodes)
{
	BMessage a(1), b(2), c(1);
	EXPECT_FALSE(Equal(&a, &b));
	EXPECT_TRUE(Equal(&a, &c));
}


TEST(Equal, IsFalseForNull)
{
	BMessage message;
	EXPECT_FALSE(Equal(NULL, &message));
	EXPECT_FALSE(Equal(&message, NULL));
	EXPECT_FALSE(Equal(NULL, NULL));
}


TEST(Equal, SeesAMissingFieldATypeAndACount)
{
	BMessage a, b, c, d;
	a.AddInt32("a", 1);
	b.AddInt32("b", 1);
	c.AddInt64("a", 1);
	d.AddInt32("a", 1);
	d.AddInt32("a", 1);
	EXPECT_FALSE(Equal(&a, &b));
	EXPECT_FALSE(Equal(&a, &c));
	EXPECT_FALSE(Equal(&a, &d));
	EXPECT_FALSE(Equal(&d, &a));
}


TEST(Equal, ComparesUnreadableArchivesByTheirBytes)
{
	BMessage a, b, c, d;
	a.AddData("_views", B_MESSAGE_TYPE, "no archive", 10, false);
	b.AddData("_views", B_MESSAGE_TYPE, "no archive", 10, false);
	c.AddData("_views", B_MESSAGE_TYPE, "no Archive", 10, false);
	const BMessage nested;
	d.AddMessage("_views", &nested);
	EXPECT_TRUE(Equal(&a, &b));
	EXPECT_FALSE(Equal(&a, &c));
	EXPECT_FALSE(Equal(&a, &d));
	EXPECT_FALSE(Equal(&d, &a));
}


TEST(Equal, DescendsIntoNestedArchives)
{
	BMessage inner(1), otherInner(1);
	inner.AddInt32("a", 1);
	inner.AddInt32("b", 2);
	otherInner.AddInt32("b", 2);
	otherInner.AddInt32("a", 1);
	BMessage a, b;
	a.AddMessage("m", &inner);
	b.AddMessage("m", &otherInner);
	EXPECT_TRUE(Equal(&a, &b));

	otherInner.ReplaceInt32("a", 3);
	b.ReplaceMessage("m", &otherInner);
	EXPECT_FALSE(Equal(&a, &b));
}


TEST(DumpMessage, SaysWhenThereIsNone)
{
	EXPECT_EQ("\t\tMESSAGE POINTER IS NULL\n", Dumped(NULL, 2));
}


TEST(DumpMessage, PrintsClassNamesPointsAndNestedMessages)
{
	BMessage nested('nest');
	BMessage message('ABCD');
	message.AddString("class", "BView");
	message.AddString("text", "not shown");
	message.AddPoint("at", BPoint(1.5, -2));
	message.AddMessage("_views", &nested);

	EXPECT_EQ(" What = ABCD\n"
			  "    1 CSTR \"class\" BView \n"
			  "    1 CSTR \"text\"\n"
			  "    1 BPNT \"at\" [1.5,-2]\n"
			  "    1 MSGG \"_views\"\n"
			  "\t What = nest\n",
		Dumped(&message, 0));
}


TEST(ViewFromResource, IsNullWithoutSuchAResource)
{
	BApplication application("application/x-vnd.Archway-test");
	EXPECT_EQ(NULL, ViewFromResource("none"));
	EXPECT_EQ(NULL, ViewFromResource("none"));
	EXPECT_EQ(NULL, ViewFromResource(4711));
}
