// Two quick clicks on a view lose nothing, whatever the view and however quick they are.

#include <algorithm>
#include <cstdlib>
#include <cstring>
#include <memory>
#include <string>
#include <tuple>
#include <typeinfo>
#include <vector>

#include <gtest/gtest.h>

#include <Message.h>
#include <MessageForm.h>
#include <Resources.h>

#include "addon/EditorScene.h"
#include "archive/ViewArchive.h"
#include "archive/ViewTree.h"
#include "support/Dump.h"

namespace {


std::string
Flattened(const BMessage& message)
{
	std::string bytes(static_cast<size_t>(message.FlattenedSize()), '\0');
	message.Flatten(bytes.data(), static_cast<ssize_t>(bytes.size()));
	return bytes;
}


// A view by itself, and its children.
struct ViewRecord {
	std::string text;
	std::vector<ViewRecord> children;

	bool operator==(const ViewRecord& other) const = default;
};


ViewRecord
Record(BView* view)
{
	BMessage archive;
	view->Archive(&archive, false);
	const BRect frame = view->Frame();
	ViewRecord record;
	record.text = std::string(typeid(*view).name()) + ' ' + std::to_string(frame.left) + ' '
		+ std::to_string(frame.top) + ' ' + std::to_string(frame.right) + ' '
		+ std::to_string(frame.bottom) + ' ' + Flattened(archive);
	for (BView* child = view->ChildAt(0); child != nullptr; child = child->NextSibling())
		record.children.push_back(Record(child));
	return record;
}


// The names of the fields that only one has, or that differ.
std::string
DifferingFields(const BMessage& a, const BMessage& b)
{
	std::string names;
	for (const auto& [one, other, sign] : { std::tuple(&a, &b, '-'), std::tuple(&b, &a, '+') }) {
		char* name;
		type_code type, otherType;
		int32 count, otherCount;
		for (int32 i = 0; one->GetInfo(B_ANY_TYPE, i, &name, &type, &count) == B_OK; i++) {
			bool same =
				other->GetInfo(name, &otherType, &otherCount) == B_OK && otherCount == count;
			for (int32 j = 0; same && j < count; j++) {
				const void *data, *otherData;
				ssize_t size, otherSize;
				BMessage inner, otherInner;
				same = one->FindData(name, type, j, &data, &size) == B_OK
					&& other->FindData(name, type, j, &otherData, &otherSize) == B_OK
					&& size == otherSize && memcmp(data, otherData, size) == 0;
				if (!same && type == B_MESSAGE_TYPE && one->FindMessage(name, j, &inner) == B_OK
					&& other->FindMessage(name, j, &otherInner) == B_OK)
					names += std::string(name) + '[' + std::to_string(j) + "]("
						+ DifferingFields(inner, otherInner) + ')';
			}
			if (!same)
				names += std::string(1, sign) + name + ' ';
		}
	}
	return names;
}


// The whole archive of one view, with what is left out of a shallow one: items, tabs, bitmaps.
BMessage
ArchiveOf(BView* view)
{
	BMessage archive;
	view->Archive(&archive, true);
	return archive;
}


// Where the first of them has something else.
std::string
Difference(const ViewRecord& a, const ViewRecord& b)
{
	if (a.text != b.text)
		return a.text.substr(0, 60) + " became " + b.text.substr(0, 60);
	if (a.children.size() != b.children.size())
		return a.text.substr(0, 60) + " has " + std::to_string(b.children.size())
			+ " children instead of " + std::to_string(a.children.size());
	for (size_t i = 0; i < a.children.size(); i++) {
		if (!(a.children[i] == b.children[i]))
			return Difference(a.children[i], b.children[i]);
	}
	return std::string();
}


// The record with the view at the path last among its siblings.
ViewRecord
WithLast(ViewRecord record, const std::vector<int32>& path)
{
	if (path.empty())
		return record;
	ViewRecord* parent = &record;
	for (size_t i = 0; i + 1 < path.size(); i++)
		parent = &parent->children.at(path[i]);
	if (static_cast<size_t>(path.back()) >= parent->children.size())
		return record;
	const ViewRecord moved = parent->children[path.back()];
	parent->children.erase(parent->children.begin() + path.back());
	parent->children.push_back(moved);
	return record;
}


void
CollectPaths(BView* root, BView* view, std::vector<std::vector<int32>>& paths)
{
	paths.push_back(PathTo(root, view));
	for (BView* child = view->ChildAt(0); child != nullptr; child = child->NextSibling())
		CollectPaths(root, child, paths);
}


// How many views of a design are clicked. The environment can ask for more than a usual run does:
// for that many views clicked times views of the design.
size_t
MostViews(size_t views)
{
	constexpr size_t kLeast = 4;
	if (const char* asked = std::getenv("ARCHWAY_QUICK_CLICKS"))
		return std::max<size_t>(kLeast, std::strtoul(asked, nullptr, 10) / views);
	return std::clamp<size_t>(1000 / views, kLeast, 60);
}


class QuickClicks : public testing::Test {
protected:
	// Clicks all views of the design in every manner; of a large one some, spread over it.
	void ClickViews(const BMessage& archive)
	{
		scene.Open(archive);
		ASSERT_NE(nullptr, scene.Root());
		std::vector<std::vector<int32>> paths;
		scene.Locked([&] { CollectPaths(scene.Root(), scene.Root(), paths); });
		const size_t step = std::max<size_t>(1, paths.size() / MostViews(paths.size()));
		for (size_t i = 0; i < paths.size(); i += step) {
			scene.Open(archive);
			ClickView(paths[i]);
			if (HasFailure())
				return;
		}
	}

	void ClickView(std::vector<int32> path)
	{
		const bigtime_t limit = Driver::DoubleClickTime();
		for (const bool waits : { true, false }) {
			// Of a press and the next one, two of them make the time between two presses.
			for (const bigtime_t spacing :
				{ bigtime_t(500), limit / 2 - 1, limit / 2 + 1, limit }) {
				if (!ClickTwice(path, spacing, waits))
					return;
			}
		}
	}

	bool ClickTwice(std::vector<int32>& path, bigtime_t spacing, bool waits)
	{
		BView* view = ViewAtPath(scene.Root(), path);
		BPoint where;
		if (!scene.FindPointOn(view, &where))
			return false;
		ViewRecord before, after;
		BMessage archive, archiveAfter;
		scene.Locked([&] {
			before = Record(scene.Root());
			archive = ArchiveOf(view);
		});

		const std::string label(std::string(typeid(*view).name()) + " \""
			+ (view->Name() != NULL ? view->Name() : "") + "\", " + std::to_string(spacing)
			+ (waits ? ", waiting" : ""));
		SCOPED_TRACE(label);
		Driver& input = scene.Input();
		input.MoveTo(view, where);
		input.SetSpacing(spacing);
		input.SetWaiting(waits);
		const BPoint screen = Driver::PointIn(view, where);
		input.Click(screen, 2);
		input.SetWaiting(true);
		input.SetSpacing(0);
		Driver::WaitUntilIdle();
		clicked++;

		scene.Locked([&] {
			after = Record(scene.Root());
			const ViewRecord asLast = WithLast(before, path);
			if (!(before == after) && asLast == after && !path.empty()) {
				before = asLast;
				path.back() = ParentOf(path)->CountChildren() - 1;
			}
			archiveAfter = ArchiveOf(ViewAtPath(scene.Root(), path));
		});
		EXPECT_TRUE(before == after) << Difference(before, after);
		EXPECT_TRUE(Equal(&archive, &archiveAfter))
			<< "the view differs: " << DifferingFields(archive, archiveAfter);
		const BView* selected = scene.Work()->SelectedView();
		EXPECT_EQ(ViewAtPath(scene.Root(), path), selected)
			<< (selected != nullptr ? typeid(*selected).name() : "nothing");
		return !HasFailure();
	}

	BView* ParentOf(const std::vector<int32>& path)
	{
		return ViewAtPath(scene.Root(), std::vector<int32>(path.begin(), path.end() - 1));
	}

	EditorScene scene;
	int32 clicked = 0;
};


// The samples are shared out among several tests.
constexpr size_t kParts = 8;

class QuickClicksInSamples : public QuickClicks, public testing::WithParamInterface<size_t> {};


// Calls the function with every archived view of the file.
template<class Function>
void
ForEachArchive(const std::string& path, const Function& function)
{
	BResources resources(path.c_str());
	type_code type;
	int32 id;
	const char* name;
	size_t size;
	for (int32 i = 0; resources.GetResourceInfo(i, &type, &id, &name, &size); i++) {
		const void* data = resources.LoadResource(type, id, &size);
		BMessage archive;
		if (type != 'ARCV' || data == NULL || unflatten_message(&archive, data, size) != B_OK)
			continue;
		SwapInheritedViews(&archive, 0);
		BMessage copy(archive);
		const std::unique_ptr<BArchivable> object(instantiate_object(&copy));
		if (dynamic_cast<BView*>(object.get()) == nullptr)
			continue;
		SwapInheritedViews(&archive, 0);
		SCOPED_TRACE(path + ' ' + std::to_string(id));
		function(archive);
	}
}


} // namespace


TEST_F(QuickClicks, LoseNothingInTheExamples)
{
	for (const char* file :
		{ ARCHWAY_EXAMPLES "/preferences.rsrc", ARCHWAY_EXAMPLES "/find-dialog.rsrc",
			ARCHWAY_EXAMPLES "/colours.rsrc", ARCHWAY_TEST_DATA "/resources/22-nestedboxes.rsrc",
			ARCHWAY_TEST_DATA "/resources/23-dialog.rsrc" })
		ForEachArchive(file, [&](const BMessage& archive) { ClickViews(archive); });
	EXPECT_LT(100, clicked);
}


TEST_P(QuickClicksInSamples, LoseNothing)
{
	if (test::samples_folder().empty())
		GTEST_SKIP() << "ARCHWAY_SAMPLES names no folder";
	const std::vector<std::string> files = test::sample_files();
	for (size_t i = GetParam(); i < files.size(); i += kParts)
		ForEachArchive(files[i], [&](const BMessage& archive) { ClickViews(archive); });
	EXPECT_LT(0, clicked);
}


INSTANTIATE_TEST_SUITE_P(Parts, QuickClicksInSamples, testing::Range<size_t>(0, kParts));
