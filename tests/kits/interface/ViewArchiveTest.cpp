// Archives of the samples are revived, shown, and written again without a difference.
#include <gtest/gtest.h>

#include <algorithm>
#include <cstring>
#include <memory>

#include <Archivable.h>
#include <File.h>
#include <Message.h>
#include <Resources.h>
#include <ScrollView.h>
#include <View.h>
#include <Window.h>

#include "support/Dump.h"
#include "support/TestWindow.h"

namespace {

// The first difference of two messages, as a path; empty when there is none.
std::string
first_difference(const BMessage& read, const BMessage& written)
{
	if (read.what != written.what)
		return ": what";
	char* name;
	type_code type;
	int32 count;
	for (int32 i = 0; read.GetInfo(B_ANY_TYPE, i, &name, &type, &count) == B_OK; i++) {
		char* otherName = nullptr;
		type_code otherType;
		int32 otherCount;
		if (written.GetInfo(B_ANY_TYPE, i, &otherName, &otherType, &otherCount) != B_OK)
			return std::string(": no field ") + name;
		if (std::strcmp(name, otherName) != 0)
			return std::string(": ") + otherName + " in the place of " + name;
		if (type != otherType || count != otherCount)
			return std::string(": type or count of ") + name;
		for (int32 k = 0; k < count; k++) {
			const std::string path = std::string(".") + name + "[" + std::to_string(k) + "]";
			BMessage a, b;
			if (type == B_MESSAGE_TYPE && read.FindMessage(name, k, &a) == B_OK
				&& written.FindMessage(name, k, &b) == B_OK) {
				const std::string nested = first_difference(a, b);
				if (!nested.empty())
					return path + nested;
				continue;
			}
			const void* data;
			const void* otherData;
			ssize_t size, otherSize;
			read.FindData(name, type, k, &data, &size);
			written.FindData(name, type, k, &otherData, &otherSize);
			if (size != otherSize || std::memcmp(data, otherData, size) != 0)
				return path + ": bytes";
		}
	}
	if (written.GetInfo(B_ANY_TYPE, read.CountNames(B_ANY_TYPE), &name, &type, &count) == B_OK)
		return std::string(": new field ") + name;
	return "";
}


struct Archive {
	std::string where;
	BMessage message;
};


std::vector<Archive>
sample_archives()
{
	std::vector<Archive> archives;
	for (const std::string& path : test::sample_files()) {
		BFile file(path.c_str(), B_READ_ONLY);
		BResources resources;
		if (resources.SetTo(&file) != B_OK)
			continue;
		type_code type;
		int32 id;
		const char* name;
		size_t size;
		for (int32 i = 0; resources.GetResourceInfo(i, &type, &id, &name, &size); i++) {
			const void* data = resources.LoadResource(type, id, &size);
			BMemoryIO stream(data, size);
			Archive archive { path + " " + std::to_string(id), BMessage() };
			if (type == 'ARCV' && archive.message.Unflatten(&stream) == B_OK)
				archives.push_back(std::move(archive));
		}
	}
	return archives;
}


std::unique_ptr<BView>
revive(BMessage archive)
{
	BArchivable* object = instantiate_object(&archive);
	BView* view = dynamic_cast<BView*>(object);
	if (view == nullptr)
		delete object;
	return std::unique_ptr<BView>(view);
}

} // namespace


TEST(ViewArchive, SamplesComeOutAsTheyWereRead)
{
	if (test::samples_folder().empty())
		GTEST_SKIP() << "no samples";
	TestWindow window;
	int32 tested = 0;
	for (const Archive& archive : sample_archives()) {
		std::unique_ptr<BView> view = revive(archive.message);
		if (view == nullptr)
			continue;
		BMessage unattached;
		ASSERT_EQ(B_OK, view->Archive(&unattached));
		EXPECT_EQ("", first_difference(archive.message, unattached)) << archive.where;

		window.Add(view.get());
		window.Locked([&] { view->RemoveSelf(); });
		BMessage shown;
		ASSERT_EQ(B_OK, view->Archive(&shown));
		EXPECT_EQ("", first_difference(archive.message, shown)) << archive.where << ", shown";
		tested++;
	}
	EXPECT_GT(tested, 20);
}
