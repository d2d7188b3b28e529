// Fields and classes that nobody knows, strewn over the trees of all archives at hand, come out as
// they went in.

#include <algorithm>
#include <cstdlib>
#include <cstring>
#include <filesystem>
#include <memory>
#include <random>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include <Control.h>
#include <Message.h>
#include <MessageForm.h>
#include <Rect.h>
#include <Resources.h>
#include <Slider.h>
#include <View.h>

#include "support/Dump.h"
#include "support/TestWindow.h"

namespace {

constexpr int kStrangers = 1000; // for each archive


// The examples and the test data are always there, the samples where the environment names them.
std::vector<std::string>
resource_files()
{
	std::vector<std::string> files = test::sample_files();
	for (const char* folder : { ARCHWAY_EXAMPLES, ARCHWAY_TEST_DATA "/resources" }) {
		for (const auto& entry : std::filesystem::directory_iterator(folder)) {
			if (entry.path().extension() == ".rsrc")
				files.push_back(entry.path());
		}
	}
	std::sort(files.begin(), files.end());
	return files;
}


std::string
flatten(const BMessage& message)
{
	std::string bytes(size_t(message.FlattenedSize()), '\0');
	EXPECT_EQ(B_OK, message.Flatten(bytes.data(), ssize_t(bytes.size())));
	return bytes;
}


// Adds fields of all kinds to a message and to those nested in it, and views of unknown classes.
class Strewer {
public:
	explicit Strewer(unsigned seed) : fRandom(seed) {}

	int Fields() const { return fFields; }
	int Views() const { return fViews; }

	// The root of an archive, nested or managed.
	void StrewTree(BMessage* root, int count)
	{
		const bool managed = root->HasBool("_managed_archive");
		fMayAddViews = !managed;
		Strew(root, count);
		for (int i = 0; managed && i < count / 50; i++)
			_AddManagedView(root);
	}

	void Strew(BMessage* message, int count)
	{
		std::vector<std::pair<std::string, int32>> nested;
		char* name;
		type_code type;
		int32 items;
		for (int32 i = 0; message->GetInfo(B_MESSAGE_TYPE, i, &name, &type, &items) == B_OK; i++) {
			for (int32 k = 0; k < items; k++)
				nested.emplace_back(name, k);
		}
		std::shuffle(nested.begin(), nested.end(), fRandom);
		int left = count;
		for (size_t i = 0; i < nested.size() && left > 0; i++) {
			const int share = i + 1 < nested.size() ? _Number(left) : _Number(left + 1);
			BMessage inner;
			if (share == 0
				|| message->FindMessage(nested[i].first.c_str(), nested[i].second, &inner) != B_OK)
				continue;
			Strew(&inner, share);
			message->ReplaceMessage(nested[i].first.c_str(), nested[i].second, &inner);
			left -= share;
		}
		for (int i = 0; i < left; i++)
			_Add(message);
	}

private:
	int _Number(int limit) { return int(fRandom() % unsigned(limit)); }

	std::string _Name()
	{
		fFields++;
		return "stranger " + std::to_string(fFields) + std::string(size_t(_Number(40)), '.');
	}

	std::string _Bytes(int least, int most)
	{
		std::string bytes(size_t(least + _Number(most - least + 1)), '\0');
		for (char& byte : bytes)
			byte = char(fRandom());
		return bytes;
	}

	void _Add(BMessage* message)
	{
		const char* className = message->FindString("class");
		const bool mayHave = message->HasMessage("_views")
			|| (className != nullptr && strcmp(className, "BView") == 0);
		if (!fMayAddViews || !mayHave || _Number(4) != 0) {
			_AddField(message);
			return;
		}
		const BMessage view = _View();
		message->AddMessage("_views", &view);
	}

	// A further child of the root: the last object, and its number among the children.
	void _AddManagedView(BMessage* root)
	{
		type_code type;
		int32 objects = 0;
		root->GetInfo("_managed_archivable", &type, &objects);
		BMessage view = _View();
		view.RemoveName("_views");
		root->AddMessage("_managed_archivable", &view);
		root->AddInt32("_views", objects + 1);
	}

	void _AddField(BMessage* message)
	{
		const std::string name = _Name();
		const int items = 1 + _Number(3);
		const int kind = _Number(6);
		const ssize_t size = 1 + _Number(20);
		for (int i = 0; i < items; i++) {
			if (kind == 0)
				message->AddString(name.c_str(), _Name().c_str());
			else if (kind == 1)
				message->AddInt32(name.c_str(), int32(fRandom()));
			else if (kind == 2)
				message->AddRect(name.c_str(), BRect(1, 2, 3, float(_Number(100))));
			else if (kind == 3) {
				BMessage inner(fRandom());
				inner.AddString("class", "Never::Revived");
				inner.AddInt64(_Name().c_str(), int64(fRandom()));
				message->AddMessage(name.c_str(), &inner);
			} else if (kind == 4)
				message->AddData(name.c_str(), 'STRA', _Bytes(int(size), int(size)).data(), size);
			else {
				const std::string bytes = _Bytes(1, 300);
				message->AddData(name.c_str(), 'strv', bytes.data(), ssize_t(bytes.size()), false);
			}
		}
	}

	BMessage _View()
	{
		fViews++;
		BMessage view(fRandom());
		view.AddString("class", ("Unknown::View" + std::to_string(fViews)).c_str());
		if (_Number(2) == 0)
			view.AddString("class", "BView");
		if (_Number(4) != 0)
			view.AddRect("_frame", BRect(_Number(50), _Number(50), 60 + _Number(50), 99));
		if (_Number(2) == 0)
			view.AddString("_name", _Name().c_str());
		const int fields = _Number(4);
		for (int i = 0; i < fields; i++)
			_AddField(&view);
		if (_Number(3) == 0) {
			BMessage child;
			child.AddString("class", "BStringView");
			child.AddRect("_frame", BRect(0, 0, 20, 10));
			_AddField(&child);
			view.AddMessage("_views", &child);
		}
		return view;
	}

	std::mt19937 fRandom;
	bool fMayAddViews = true;
	int fFields = 0;
	int fViews = 0;
};


// ARCHWAY_SEED repeats a run.
unsigned
seed_of_run()
{
	const char* given = getenv("ARCHWAY_SEED");
	return given != nullptr ? unsigned(strtoul(given, nullptr, 10)) : std::random_device()();
}

} // namespace


TEST(UnknownFields, StrewnOverAllArchivesTheySurviveAShowing)
{
	const unsigned seed = seed_of_run();
	SCOPED_TRACE("ARCHWAY_SEED=" + std::to_string(seed));
	printf("ARCHWAY_SEED=%u\n", seed);
	TestWindow window(BRect(20, 20, 619, 419));
	int archives = 0;
	int strangeViews = 0;
	for (const std::string& path : resource_files()) {
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
			Strewer strewer(seed + unsigned(archives));
			strewer.StrewTree(&archive, kStrangers);
			const std::string before = flatten(archive);
			BArchivable* object = instantiate_object(&archive);
			const std::unique_ptr<BView> view(dynamic_cast<BView*>(object));
			if (view == nullptr) {
				delete object;
				continue;
			}
			archives++;
			strangeViews += strewer.Views();
			window.Add(view.get());
			BMessage after(archive.what);
			window.Locked([&] {
				EXPECT_TRUE(view->RemoveSelf());
				EXPECT_EQ(B_OK, view->Archive(&after));
			});
			after.what = archive.what;
			ASSERT_EQ("", test::first_difference(archive, after));
			ASSERT_TRUE(flatten(after) == before);
			EXPECT_GE(strewer.Fields() + strewer.Views(), kStrangers);
		}
	}
	EXPECT_GE(archives, 4);
	EXPECT_GT(strangeViews, 100);
}


// #pragma mark - one edit among strangers


namespace {

BMessage
archive_of(const char* className, const char* name, BRect frame)
{
	BMessage archive;
	archive.AddString("class", className);
	archive.AddString("_name", name);
	archive.AddRect("_frame", frame);
	archive.AddInt32("_resize_mode", B_FOLLOW_LEFT | B_FOLLOW_TOP);
	archive.AddInt32("_flags", B_WILL_DRAW | B_NAVIGABLE);
	archive.AddInt64((std::string("stranger of ") + name).c_str(), 5);
	return archive;
}


// A stand-in, a disabled button and a slider with labels at its limits, side by side.
struct Tree {
	BMessage standIn = archive_of("Some::Dial", "dial", BRect(5, 5, 54, 44));
	BMessage button = archive_of("BButton", "button", BRect(5, 50, 84, 73));
	BMessage slider = archive_of("BSlider", "slider", BRect(5, 80, 184, 129));

	Tree()
	{
		standIn.AddFloat("angle", 1.5f);
		BMessage child = archive_of("BView", "inside", BRect(1, 1, 20, 20));
		standIn.AddMessage("_views", &child);
		BMessage message('push');
		message.AddString("note", "of the button");
		button.AddString("_label", "Push");
		button.AddMessage("_msg", &message);
		button.AddInt32("_val", 0);
		button.AddBool("_disable", true);
		button.AddString("last", "stays last");
		// Its preferred size without the labels, which it takes when they go.
		BSlider preferred(BRect(5, 80, 184, 129), "slider", NULL, NULL, 0, 100);
		preferred.ResizeToPreferred();
		slider.ReplaceRect("_frame", preferred.Frame());
		slider.AddInt32("_val", 20);
		slider.AddString("_minlbl", "low");
		slider.AddString("_maxlbl", "high");
		slider.AddInt32("_max", 100);
		slider.AddInt32("_hashcount", 11);
		slider.AddInt32("_hashloc", 3);
	}

	BMessage Archive() const
	{
		BMessage tree = archive_of("BView", "tree", BRect(0, 0, 199, 149));
		for (const BMessage* child : { &standIn, &button, &slider })
			tree.AddMessage("_views", child);
		tree.AddString("after the children", "kept in its place");
		return tree;
	}
};


// Revives the tree in a shown window, edits it there and compares its archive with the tree that
// is expected: byte for byte, so the order counts.
template<typename Edit>
void
expect_after_edit(TestWindow& window, const Tree& expected, Edit edit)
{
	BMessage archive = Tree().Archive();
	BView* view = window.Add(dynamic_cast<BView*>(instantiate_object(&archive)));
	ASSERT_NE(nullptr, view);
	BMessage untouched;
	window.Locked([&] { EXPECT_EQ(B_OK, view->Archive(&untouched)); });
	EXPECT_TRUE(flatten(untouched) == flatten(archive));

	window.Locked([&] { edit(view); });
	BMessage edited;
	window.Locked([&] { EXPECT_EQ(B_OK, view->Archive(&edited)); });
	EXPECT_NE("", test::first_difference(archive, edited));
	EXPECT_EQ("", test::first_difference(expected.Archive(), edited));
	EXPECT_TRUE(flatten(edited) == flatten(expected.Archive()));
}

} // namespace


TEST(UnknownFields, AMovedSiblingOfAStandInIsAllThatChanges)
{
	TestWindow window;
	Tree expected;
	expected.button.ReplaceRect("_frame", BRect(9, 52, 88, 75));
	expect_after_edit(
		window, expected, [](BView* tree) { tree->FindView("button")->MoveBy(4, 2); });
}


TEST(UnknownFields, AMovedStandInChangesItsFrameAlone)
{
	TestWindow window;
	Tree expected;
	expected.standIn.ReplaceRect("_frame", BRect(95, 5, 154, 54));
	expect_after_edit(window, expected, [](BView* tree) {
		BView* standIn = tree->ChildAt(0);
		standIn->MoveTo(95, 5);
		standIn->ResizeBy(10, 10);
	});
}


TEST(UnknownFields, AControlThatIsEnabledLosesThatFieldAlone)
{
	TestWindow window;
	Tree expected;
	expected.button.RemoveName("_disable");
	expect_after_edit(window, expected,
		[](BView* tree) { dynamic_cast<BControl*>(tree->FindView("button"))->SetEnabled(true); });
}


TEST(UnknownFields, ASliderWithoutLimitLabelsLosesThoseFieldsAlone)
{
	TestWindow window;
	Tree expected;
	expected.slider.RemoveName("_minlbl");
	expected.slider.RemoveName("_maxlbl");
	expect_after_edit(window, expected, [](BView* tree) {
		dynamic_cast<BSlider*>(tree->FindView("slider"))->SetLimitLabels(NULL, NULL);
	});
}
