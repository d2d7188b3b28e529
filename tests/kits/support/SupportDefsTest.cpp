// What checks and prints is tried in release builds, too.
#undef NDEBUG

#include <cerrno>
#include <cstring>

#include <gtest/gtest.h>

#include <BlockCache.h>
#include <ByteOrder.h>
#include <Debug.h>
#include <SupportDefs.h>


TEST(Atomics, GiveTheValueBefore)
{
	vint32 value = 5;
	EXPECT_EQ(5, atomic_add(&value, 3));
	EXPECT_EQ(8, atomic_and(&value, 12));
	EXPECT_EQ(8, atomic_or(&value, 3));
	EXPECT_EQ(11, atomic_set(&value, 1));
	EXPECT_EQ(1, atomic_test_and_set(&value, 2, 7));
	EXPECT_EQ(1, atomic_test_and_set(&value, 2, 1));
	EXPECT_EQ(2, atomic_get(&value));
	int32 plain = 1;
	EXPECT_EQ(1, atomic_add(&plain, 1));

	vint64 large = int64(1) << 40;
	EXPECT_EQ(int64(1) << 40, atomic_add64(&large, 1));
	EXPECT_EQ((int64(1) << 40) + 1, atomic_test_and_set64(&large, 4, 0));
	EXPECT_EQ((int64(1) << 40) + 1, atomic_set64(&large, 6));
	EXPECT_EQ(6, atomic_and64(&large, 3));
	EXPECT_EQ(2, atomic_or64(&large, 5));
	EXPECT_EQ(7, atomic_get64(&large));
}


TEST(ByteOrder, SwappedIntegersAreUnsigned)
{
	EXPECT_EQ(0x8000, B_SWAP_INT16(0x0080));
	EXPECT_EQ(0x80000000u, B_SWAP_INT32(0x80));
	EXPECT_EQ(uint64(0x80) << 56, B_SWAP_INT64(0x80));
	EXPECT_EQ(0xff00, B_HOST_TO_BENDIAN_INT16(B_BENDIAN_TO_HOST_INT16(0xff00)));
	EXPECT_EQ(0x2211, __swap_int16(0x1122));
	EXPECT_EQ(0x44332211u, __swap_int32(0x11223344));
}


TEST(BlockCache, GivesBackWhatWasSaved)
{
	for (const uint32 type : { B_OBJECT_CACHE, B_MALLOC_CACHE }) {
		BBlockCache cache(2, 64, type);
		void* first = cache.Get(64);
		void* second = cache.Get(64);
		void* third = cache.Get(64); // beyond what is kept
		ASSERT_TRUE(first != nullptr && second != nullptr && third != nullptr);
		EXPECT_TRUE(first != second && second != third && first != third);
		cache.Save(second, 64);
		EXPECT_EQ(second, cache.Get(64));
		void* other = cache.Get(1000);
		ASSERT_NE(nullptr, other);
		cache.Save(other, 1000);
		cache.Save(first, 64);
		cache.Save(second, 64);
		cache.Save(third, 64);
		cache.Save(nullptr, 64);
	}
}


TEST(BlockCache, WithoutRoomStillGivesBlocks)
{
	BBlockCache cache(0, 16, B_MALLOC_CACHE);
	void* block = cache.Get(16);
	ASSERT_NE(nullptr, block);
	cache.Save(block, 16);
}


TEST(Debug, PrintingCanBeSwitchedOff)
{
	EXPECT_TRUE(IS_DEBUG_ENABLED());
	SET_DEBUG_ENABLED(false);
	testing::internal::CaptureStdout();
	PRINT(("unseen %d", 1));
	TRACE();
	SET_DEBUG_ENABLED(true);
	PRINT(("seen %d", 2));
	EXPECT_EQ("seen 2", testing::internal::GetCapturedStdout());
	ASSERT_WITH_MESSAGE(true, "not said");
	STATIC_ASSERT(sizeof(int32) == 4);
}


TEST(Errors, HaveTexts)
{
	EXPECT_STREQ("No error", strerror(B_OK));
	EXPECT_STREQ("Invalid argument", strerror(B_BAD_VALUE));
	EXPECT_STREQ("No such file or directory", strerror(B_ENTRY_NOT_FOUND));
	EXPECT_STREQ("General error", strerror(B_ERROR));
	EXPECT_STREQ("Operation not permitted", strerror(EPERM)); // the host's own
	EXPECT_NE(nullptr, strstr(strerror(-4711), "-4711"));
}
