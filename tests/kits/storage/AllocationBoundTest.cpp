// Damaged files take no more memory than four times their size, whatever they claim.

#include <string.h>

#include <DataIO.h>
#include <Message.h>
#include <MessageForm.h>
#include <Rect.h>
#include <ResourceForm.h>
#include <Resources.h>

#include "TemporaryFolder.h"
#include "support/AllocationMeter.h"

namespace {

constexpr uint32 kExtremes[] = { 0, 1, 0x7fffffff, 0x80000000, 0xffffffff, 0xfffffff0, 0x10000000,
	10000, 0x10000 };
constexpr size_t kMostTimes = 4;
constexpr size_t kDenseTimes = 10; // in files of nothing but tiny pieces
constexpr size_t kObjects = 16 * 1024; // what any file takes, an empty one too


// Returns a sum, so that no look is left out.
size_t
Look(const BMessage& message)
{
	size_t sum = 0;
	char* name;
	type_code type;
	int32 count;
	for (int32 i = 0; message.GetInfo(B_ANY_TYPE, i, &name, &type, &count) == B_OK; i++) {
		for (int32 k = 0; k < count; k++) {
			const void* data;
			ssize_t size;
			BMessage nested;
			if (type == B_MESSAGE_TYPE && message.FindMessage(name, k, &nested) == B_OK)
				sum += Look(nested);
			else if (message.FindData(name, type, k, &data, &size) == B_OK)
				sum += static_cast<size_t>(size);
		}
	}
	return sum;
}


size_t
PeakOfMessage(const std::string& bytes)
{
	const AllocationMeter meter;
	BMessage message;
	size_t seen = 0;
	if (unflatten_message(&message, bytes.data(), bytes.size()) == B_OK)
		seen = Look(message);
	// Bytes can be seen twice only where a nested message is no message.
	EXPECT_LE(seen, bytes.size());
	return meter.Peak();
}


size_t
PeakOfResources(const std::string& bytes)
{
	const AllocationMeter meter;
	BMemoryIO stream(static_cast<const void*>(bytes.data()), bytes.size());
	std::vector<resource_damage> damages;
	std::vector<resource_place> places;
	examine_resource_file(&stream, NULL, &places, &damages);
	return meter.Peak();
}


std::string
Flatten(const BMessage& message, message_form form)
{
	std::string bytes(flattened_message_size(message, form), '\0');
	EXPECT_EQ(B_OK, flatten_message(message, form, bytes.data(), bytes.size()));
	return bytes;
}


// A tree of some views with fields of fixed and variable size.
BMessage
Tree(int views)
{
	BMessage tree;
	tree.AddString("class", "BView");
	for (int i = 0; i < views; i++) {
		BMessage view;
		view.AddString("class", "BButton");
		view.AddString("_name", "a view of the form");
		view.AddRect("_frame", BRect(1, 2, 3, 4));
		view.AddString("_fname", "Family");
		view.AddString("_fname", "Style");
		tree.AddMessage("_views", &view);
	}
	return tree;
}


template<typename Measure>
void
ExpectBoundWithExtremes(const std::string& bytes, size_t step, Measure peakOf)
{
	size_t most = 0;
	for (size_t place = 0; place + 4 <= bytes.size(); place += step) {
		for (const uint32 value : kExtremes) {
			for (const bool swapped : { false, true }) {
				const uint32 written = swapped ? __builtin_bswap32(value) : value;
				std::string damaged = bytes;
				memcpy(damaged.data() + place, &written, sizeof(written));
				most = std::max(most, peakOf(damaged));
			}
		}
	}
	EXPECT_LE(most, kMostTimes * bytes.size() + kObjects);
}


template<typename Measure>
void
ExpectBoundWithChangedBytes(const std::string& bytes, Measure peakOf)
{
	size_t most = 0;
	for (size_t place = 0; place < bytes.size(); place++) {
		const uint8 old = bytes[place];
		std::vector<uint8> values = { 0, 255, static_cast<uint8>(old + 1) };
		for (int bit = 0; bit < 8; bit++)
			values.push_back(old ^ (1 << bit));
		for (const uint8 value : values) {
			std::string damaged = bytes;
			damaged[place] = static_cast<char>(value);
			most = std::max(most, peakOf(damaged));
		}
	}
	EXPECT_LE(most, kMostTimes * bytes.size() + kObjects);
}

} // namespace


TEST(AllocationBound, HoldsForMessagesWithAnyNumberInThem)
{
	if (!AllocationMeter::IsCounting())
		GTEST_SKIP() << "the sanitizer has the heap";
	for (const message_form form : { B_R5_FORM, B_R5_WIDE_FORM, B_HAIKU_FORM })
		ExpectBoundWithExtremes(Flatten(Tree(20), form), 1, PeakOfMessage);
}


TEST(AllocationBound, HoldsForLargeMessagesWithAnyNumberInThem)
{
	if (!AllocationMeter::IsCounting())
		GTEST_SKIP() << "the sanitizer has the heap";
	for (const message_form form : { B_R5_WIDE_FORM, B_HAIKU_FORM })
		ExpectBoundWithExtremes(Flatten(Tree(1000), form), 997, PeakOfMessage);
}


TEST(AllocationBound, HoldsForMessagesWithAnyByteInThem)
{
	if (!AllocationMeter::IsCounting())
		GTEST_SKIP() << "the sanitizer has the heap";
	for (const message_form form : { B_R5_FORM, B_R5_WIDE_FORM, B_HAIKU_FORM })
		ExpectBoundWithChangedBytes(Flatten(Tree(10), form), PeakOfMessage);
}


TEST(AllocationBound, HoldsForTruncatedMessages)
{
	if (!AllocationMeter::IsCounting())
		GTEST_SKIP() << "the sanitizer has the heap";
	for (const message_form form : { B_R5_FORM, B_HAIKU_FORM }) {
		const std::string bytes = Flatten(Tree(40), form);
		for (size_t size = 0; size <= bytes.size(); size++)
			ASSERT_LE(PeakOfMessage(bytes.substr(0, size)), kMostTimes * size + kObjects);
	}
}


TEST(AllocationBound, HoldsForResourceFilesWithAnyNumberInThem)
{
	if (!AllocationMeter::IsCounting())
		GTEST_SKIP() << "the sanitizer has the heap";
	for (const char* name : { "51-ids-and-names.rsrc", "70-in-elf.bin" }) {
		const std::string bytes = ReadFile(std::string(ARCHWAY_TEST_DATA "/resources/") + name);
		ASSERT_FALSE(bytes.empty());
		ExpectBoundWithExtremes(bytes, 4, PeakOfResources);
	}
}


// Each piece of a dozen bytes needs a record of its own. All of them together take more, but still
// a fixed number of times the file.
TEST(AllocationBound, HoldsForFilesOfNothingButSmallPieces)
{
	if (!AllocationMeter::IsCounting())
		GTEST_SKIP() << "the sanitizer has the heap";
	BMessage fields;
	for (int i = 0; i < 20000; i++)
		fields.AddBool(std::to_string(i).c_str(), true);
	BMessage items;
	for (int i = 0; i < 20000; i++)
		items.AddString("text", "");
	BMessage messages;
	for (int i = 0; i < 5000; i++) {
		const BMessage empty;
		messages.AddMessage("message", &empty);
	}
	for (const BMessage* message : { &fields, &items, &messages }) {
		for (const message_form form : { B_R5_FORM, B_HAIKU_FORM }) {
			const std::string bytes = Flatten(*message, form);
			const AllocationMeter meter;
			PeakOfMessage(bytes);
			EXPECT_LE(meter.Largest(), kMostTimes * bytes.size());
			EXPECT_LE(meter.Peak(), kDenseTimes * bytes.size());
		}
	}

	TemporaryFolder folder;
	WriteFile(folder / "many", "");
	{
		BResources resources((folder / "many").c_str());
		for (int32 i = 0; i < 9000; i++)
			resources.AddResource('TINY', i, "", 0);
	}
	const std::string bytes = ReadFile(folder / "many");
	const AllocationMeter meter;
	PeakOfResources(bytes);
	EXPECT_LE(meter.Largest(), kMostTimes * bytes.size());
	EXPECT_LE(meter.Peak(), kDenseTimes * bytes.size());
}
