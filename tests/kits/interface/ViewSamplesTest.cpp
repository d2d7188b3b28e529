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
				BMessage clean;
				clean.Unflatten(before.c_str());
				ADD_FAILURE() << "not the same bytes" << test::first_difference(clean, after);
			}
		}
	}
	EXPECT_LT(30, views);
}
