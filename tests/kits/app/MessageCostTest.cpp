// What work with messages costs, in pieces and bytes of memory: it grows with the message and not
// with its square, and nesting copies nothing again and again.

#include <functional>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include <Message.h>
#include <MessageForm.h>
#include <Rect.h>

#include "support/AllocationMeter.h"

namespace {

struct Cost {
	size_t pieces;
	size_t bytes;
};


Cost
cost_of(const std::function<void()>& work)
{
	const AllocationMeter meter;
	work();
	return { meter.Count(), meter.Total() };
}


#define SKIP_WITHOUT_COUNTS()                                                                      \
	if (!AllocationMeter::IsCounting())                                                            \
	GTEST_SKIP() << "the sanitizer has the heap"


BMessage
view(int number)
{
	BMessage message;
	message.AddString("class", "BButton");
	message.AddString("_name", "a view of the form");
	message.AddRect("_frame", BRect(10, 20, 100, 44));
	message.AddInt32("_flags", number);
	return message;
}


BMessage
chain(int depth)
{
	BMessage inner = view(0);
	for (int i = 1; i < depth; i++) {
		BMessage outer = view(i);
		outer.AddMessage("_views", &inner);
		inner = outer;
	}
	return inner;
}


std::string
flatten(const BMessage& message)
{
	std::string bytes(size_t(message.FlattenedSize()), '\0');
	EXPECT_EQ(B_OK, message.Flatten(bytes.data(), ssize_t(bytes.size())));
	return bytes;
}


// Ten times as much must not cost more than a little over ten times.
void
expect_linear(const std::function<void(int)>& work)
{
	const Cost few = cost_of([&] { work(1000); });
	const Cost some = cost_of([&] { work(3000); });
	const Cost many = cost_of([&] { work(10000); });
	EXPECT_LE(some.pieces, few.pieces * 4);
	EXPECT_LE(many.pieces, few.pieces * 12);
	EXPECT_LE(some.bytes, few.bytes * 5); // a doubling comes early or late
	EXPECT_LE(many.bytes, few.bytes * 17);
}

} // namespace


TEST(MessageCost, AddingFieldsIsNoAllocationEach)
{
	SKIP_WITHOUT_COUNTS();
	std::vector<std::string> names;
	for (int i = 0; i < 1000; i++)
		names.push_back("field number " + std::to_string(i));
	const Cost cost = cost_of([&] {
		BMessage message;
		for (const std::string& name : names)
			message.AddInt32(name.c_str(), 1);
	});
	EXPECT_LE(cost.pieces, 40u);
}


TEST(MessageCost, AViewIsBuiltInFewPieces)
{
	SKIP_WITHOUT_COUNTS();
	const Cost cost = cost_of([] { view(1); });
	EXPECT_LE(cost.pieces, 2u);
}


TEST(MessageCost, BuildingGrowsWithTheFields)
{
	SKIP_WITHOUT_COUNTS();
	expect_linear([](int count) {
		BMessage message;
		char name[16];
		for (int i = 0; i < count; i++) {
			snprintf(name, sizeof(name), "%d", i);
			message.AddInt32(name, i);
		}
	});
}


TEST(MessageCost, BuildingGrowsWithTheChildren)
{
	SKIP_WITHOUT_COUNTS();
	expect_linear([](int count) {
		BMessage message;
		for (int i = 0; i < count; i++) {
			const BMessage child = view(i);
			message.AddMessage("_views", &child);
		}
	});
}


TEST(MessageCost, NestingCopiesNoLevelOften)
{
	SKIP_WITHOUT_COUNTS();
	for (const int depth : { 10, 50, 100, 200 }) {
		const size_t size = flatten(chain(depth)).size();
		const Cost cost = cost_of([&] { chain(depth); });
		// Each view's own fields twice in a store that doubles, and its record.
		EXPECT_LE(cost.bytes, 3 * size + size_t(depth) * 1200) << depth;
		EXPECT_LE(cost.pieces, size_t(depth) * 6) << depth;
	}
}


TEST(MessageCost, AWalkThroughWhatWasReadCopiesNothing)
{
	SKIP_WITHOUT_COUNTS();
	for (const int depth : { 10, 50, 100, 200 }) {
		const std::string bytes = flatten(chain(depth));
		BMessage message;
		ASSERT_EQ(B_OK, unflatten_message(&message, bytes.data(), bytes.size()));
		int levels = 1;
		const Cost cost = cost_of([&] {
			BMessage level = message;
			BMessage inner;
			while (level.FindMessage("_views", &inner) == B_OK) {
				level = inner;
				levels++;
			}
		});
		EXPECT_EQ(depth, levels);
		// One record for each message, whatever lies in it.
		EXPECT_LE(cost.pieces, size_t(depth) * 2) << depth;
		EXPECT_LE(cost.bytes, size_t(depth) * 700) << depth;
	}
}


TEST(MessageCost, ReadingTakesTheBytesAndOneRecord)
{
	SKIP_WITHOUT_COUNTS();
	BMessage tree;
	for (int i = 0; i < 10000; i++) {
		const BMessage child = view(i);
		tree.AddMessage("_views", &child);
	}
	const std::string bytes = flatten(tree);
	const Cost cost = cost_of([&] {
		BMessage message;
		ASSERT_EQ(B_OK, unflatten_message(&message, bytes.data(), bytes.size()));
	});
	EXPECT_LE(cost.pieces, 8u);
	EXPECT_LE(cost.bytes, bytes.size() * 5 / 4);
}


TEST(MessageCost, ACopyIsShared)
{
	SKIP_WITHOUT_COUNTS();
	const BMessage tree = chain(100);
	const Cost cost = cost_of([&] {
		const BMessage copy(tree);
		EXPECT_EQ(tree.CountNames(B_ANY_TYPE), copy.CountNames(B_ANY_TYPE));
	});
	EXPECT_EQ(0u, cost.pieces);
}
