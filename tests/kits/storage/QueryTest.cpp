#include <gtest/gtest.h>

#include <Entry.h>
#include <Query.h>
#include <String.h>
#include <Volume.h>
#include <VolumeRoster.h>


TEST(BQuery, ThePushedPiecesMakeAPredicate)
{
	BQuery query;
	query.PushAttr("name");
	query.PushString("a*b");
	query.PushOp(B_CONTAINS);
	query.PushAttr("size");
	query.PushInt32(-5);
	query.PushOp(B_GE);
	query.PushOp(B_AND);
	query.PushOp(B_NOT);
	BString predicate;
	ASSERT_EQ(B_OK, query.GetPredicate(&predicate));
	EXPECT_STREQ("(!((name==\"*a\\*b*\")&&(size>=-5)))", predicate.String());
	EXPECT_EQ(size_t(predicate.Length()) + 1, query.PredicateLength());
	char buffer[64];
	EXPECT_EQ(B_BAD_VALUE, query.GetPredicate(buffer, predicate.Length()));
	EXPECT_EQ(B_OK, query.GetPredicate(buffer, predicate.Length() + 1));
	EXPECT_TRUE(predicate == buffer);

	query.Clear();
	query.PushAttr("name");
	query.PushString("Ab1", true);
	query.PushOp(B_BEGINS_WITH);
	query.GetPredicate(&predicate);
	EXPECT_STREQ("(name==\"[aA][bB]1*\")", predicate.String());
}


TEST(BQuery, PiecesThatDoNotFitMakeNone)
{
	BString predicate;
	BQuery query;
	EXPECT_EQ(B_NO_INIT, query.GetPredicate(&predicate));
	EXPECT_EQ(0u, query.PredicateLength());
	query.PushOp(B_AND);
	EXPECT_EQ(B_NO_INIT, query.GetPredicate(&predicate));
	query.Clear();
	query.PushInt32(1);
	query.PushAttr("size");
	query.PushOp(B_EQ);
	EXPECT_EQ(B_NO_INIT, query.GetPredicate(&predicate));
	query.Clear();
	query.PushAttr("size");
	EXPECT_EQ(B_NO_INIT, query.GetPredicate(&predicate));
	EXPECT_EQ(B_BAD_VALUE, query.SetPredicate(NULL));
	EXPECT_EQ(B_OK, query.SetPredicate("size>5"));
	EXPECT_EQ(B_OK, query.GetPredicate(&predicate));
	EXPECT_STREQ("size>5", predicate.String());
}


TEST(BQuery, NeedsAVolumeAndAPredicateAndIsFetchedOnce)
{
	BQuery query;
	BEntry entry;
	BVolume volume;
	EXPECT_EQ(B_BAD_VALUE, query.SetVolume(NULL));
	EXPECT_EQ(B_BAD_VALUE, query.SetVolume(&volume));
	EXPECT_EQ(B_FILE_ERROR, query.GetNextEntry(&entry));
	EXPECT_EQ(B_NO_INIT, query.Fetch());
	BVolumeRoster().GetBootVolume(&volume);
	EXPECT_EQ(B_OK, query.SetVolume(&volume));
	EXPECT_EQ(volume.Device(), query.TargetDevice());
	EXPECT_EQ(B_NO_INIT, query.Fetch());
	EXPECT_EQ(B_OK, query.SetPredicate("size>5"));
	EXPECT_FALSE(query.IsLive());
	EXPECT_EQ(B_BAD_VALUE, query.SetTarget(BMessenger()));
	EXPECT_EQ(B_UNSUPPORTED, query.Fetch());
	EXPECT_EQ(B_ENTRY_NOT_FOUND, query.GetNextEntry(&entry));
	EXPECT_EQ(B_NOT_ALLOWED, query.Fetch());
	EXPECT_EQ(B_NOT_ALLOWED, query.SetPredicate("size>6"));
	EXPECT_EQ(B_NOT_ALLOWED, query.SetVolume(&volume));
}
