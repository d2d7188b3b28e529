// Views of all sample files: looking at them changes nothing.

#include <cstring>
#include <memory>
#include <string>

#include <gtest/gtest.h>

#include <Message.h>
#include <MessageForm.h>
#include <Resources.h>
#include <View.h>

#include "support/Dump.h"
#include "support/TestWindow.h"

namespace {

// Names the fields that differ, those of nested messages by their path.
void
describe_difference(const BMessage& before, const BMessage& after, const std::string& path)
{
	char* name;
	type_code type;
	int32 count;
	for (int32 i = 0; before.GetInfo(B_ANY_TYPE, i, &name, &type, &count) == B_OK; i++) {
		type_code newType;
		int32 newCount;
		if (after.GetInfo(name, &newType, &newCount) != B_OK) {
			ADD_FAILURE() << path << name << " is gone";
			continue;
		}
		if (newType != type || newCount != count) {
			ADD_FAILURE() << path << name << " has " << newCount << " instead of " << count
						  << " entries, or another type";
			continue;
		}
		for (int32 j = 0; j < count; j++) {
			const void* a;
			const void* b;
			ssize_t sizeA, sizeB;
			BMessage inner, newInner;
			if (type == B_MESSAGE_TYPE && before.FindMessage(name, j, &inner) == B_OK
				&& after.FindMessage(name, j, &newInner) == B_OK) {
				describe_difference(
					inner, newInner, path + name + "[" + std::to_string(j) + "] > ");
			} else if (before.FindData(name, type, j, &a, &sizeA) != B_OK
				|| after.FindData(name, type, j, &b, &sizeB) != B_OK || sizeA != sizeB
				|| memcmp(a, b, sizeA) != 0) {
				ADD_FAILURE() << path << name << "[" << j << "] differs";
			}
		}
	}
	for (int32 i = 0; after.GetInfo(B_ANY_TYPE, i, &name, &type, &count) == B_OK; i++) {
		if (before.GetInfo(name, &type, &count) != B_OK)
			ADD_FAILURE() << path << name << " is new";
	}
}


std::string
flatten(const BMessage& message)
{
	std::string bytes(size_t(message.FlattenedSize()), '\0');
	EXPECT_EQ(B_OK, message.Flatten(bytes.data(), ssize_t(bytes.size())));
	return bytes;
}

} // namespace


TEST(ViewSamples, ShownAndArchivedAgainTheyAreTheSame)
{
	if (test::samples_folder().empty())
		GTEST_SKIP() << "ARCHWAY_SAMPLES names no folder";
	TestWindow window(BRect(20, 20, 819, 619));
	int views = 0;
	for (const std::string& path : test::sample_files()) {
		BResources resources(path.c_str());
		type_code type;
		int32 id;
		const char* name;
		size_t size;
		for (int32 i = 0; resources.GetResourceInfo(i, &type, &id, &name, &size); i++) {
			SCOPED_TRACE(path + " " + std::to_string(id));
			const void* data = resources.LoadResource(type, id, &size);
			BMessage archive;
			if (type != 'ARCV' || data == NULL || unflatten_message(&archive, data, size) != B_OK)
				continue;
			const std::string before = flatten(archive);
			BArchivable* object = instantiate_object(&archive);
			BView* view = dynamic_cast<BView*>(object);
			if (view == NULL) {
				delete object;
				continue;
			}
			views++;
			window.Add(view);
			BMessage after;
			window.Locked([&] {
				EXPECT_TRUE(view->RemoveSelf());
				after.what = archive.what;
				EXPECT_EQ(B_OK, view->Archive(&after));
			});
			delete view;
			if (flatten(after) != before) {
				ADD_FAILURE() << "not the same bytes";
				BMessage clean;
				clean.Unflatten(before.c_str());
				describe_difference(clean, after, "");
			}
		}
	}
	EXPECT_LT(30, views);
}
