// Finding, replacing and removing cost the same in a large message as in a small one, counted in
// instructions.

#include <functional>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include <Message.h>
#include <MessageForm.h>

#include "support/StepCounter.h"

namespace {

constexpr int kFew = 300;
constexpr int kMany = 10000;
constexpr int kLookUps = 8;


BMessage
with_items(int count)
{
	BMessage message;
	for (int i = 0; i < count; i++)
		message.AddString("text", ("item " + std::to_string(i)).c_str());
	return message;
}


BMessage
with_children(int count)
{
	BMessage message;
	for (int i = 0; i < count; i++) {
		BMessage child;
		child.AddInt32("number", i);
		message.AddMessage("_views", &child);
	}
	return message;
}


BMessage
with_fields(int count)
{
	BMessage message;
	for (int32 i = 0; i < count; i++)
		message.AddInt32(("field " + std::to_string(i)).c_str(), i);
	return message;
}


BMessage
read_from(const BMessage& message, message_form form)
{
	std::string bytes(size_t(flattened_message_size(message, form)), '\0');
	EXPECT_EQ(B_OK, flatten_message(message, form, bytes.data(), ssize_t(bytes.size())));
	BMessage read;
	EXPECT_EQ(B_OK, unflatten_message(&read, bytes.data(), bytes.size()));
	return read;
}


// The same number of look-ups, spread over all that there are.
typedef std::function<void(BMessage& message, int place)> look_up;

void
expect_same_cost(
	const std::function<BMessage(int)>& make, const look_up& work, const std::string& what)
{
	int64_t steps[2];
	int64_t* result = steps;
	for (const int count : { kFew, kMany }) {
		BMessage message = make(count);
		work(message, 0); // what is made once, at the first question
		*result++ = test::count_steps([&] {
			for (int i = 0; i < kLookUps; i++)
				work(message, int(int64_t(i) * (count - 1) / kLookUps));
		});
	}
	if (steps[0] == 0)
		GTEST_SKIP() << "processes may not look into each other";
	EXPECT_LE(double(steps[1]), double(steps[0]) * 1.3) << what;
}


struct Source {
	const char* name;
	BMessage (*prepare)(const BMessage& message);
};

const Source kSources[] = {
	{ "built", [](const BMessage& message) { return message; } },
	{ "read from the R5 form",
		[](const BMessage& message) { return read_from(message, B_R5_FORM); } },
	{ "read from the wide R5 form",
		[](const BMessage& message) { return read_from(message, B_R5_WIDE_FORM); } },
	{ "read from the Haiku form",
		[](const BMessage& message) { return read_from(message, B_HAIKU_FORM); } },
};

} // namespace


TEST(MessageGrowth, AnItemIsFoundWithoutThoseBeforeIt)
{
	for (const Source& source : kSources) {
		const look_up find = [](BMessage& message, int place) {
			const char* text;
			if (message.FindString("text", place, &text) != B_OK)
				abort();
		};
		expect_same_cost(
			[&](int count) { return source.prepare(with_items(count)); }, find, source.name);
	}
}


TEST(MessageGrowth, AChildIsFoundWithoutThoseBeforeIt)
{
	for (const Source& source : kSources) {
		const look_up find = [](BMessage& message, int place) {
			BMessage child;
			if (message.FindMessage("_views", place, &child) != B_OK
				|| child.FindInt32("number") != place)
				abort();
		};
		expect_same_cost(
			[&](int count) { return source.prepare(with_children(count)); }, find, source.name);
	}
}


TEST(MessageGrowth, AFieldIsFoundWithoutTheOthers)
{
	std::vector<std::string> names;
	for (int i = 0; i < kMany; i++)
		names.push_back("field " + std::to_string(i));
	for (const Source& source : kSources) {
		const look_up find = [&](BMessage& message, int place) {
			if (message.FindInt32(names[size_t(place)].c_str()) != place)
				abort();
		};
		expect_same_cost(
			[&](int count) { return source.prepare(with_fields(count)); }, find, source.name);
	}
}


TEST(MessageGrowth, AnItemIsReplacedWithoutMovingOthers)
{
	for (const Source& source : kSources) {
		const look_up replace = [](BMessage& message, int place) {
			if (message.ReplaceString("text", place, "another item, which is longer") != B_OK)
				abort();
		};
		expect_same_cost(
			[&](int count) { return source.prepare(with_items(count)); }, replace, source.name);
	}
}
