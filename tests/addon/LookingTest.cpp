// Looking at a design, view by view, changes nothing in its file.

#include "EditorFixture.h"

#include <cmath>
#include <filesystem>

#include <MessageForm.h>
#include <Resources.h>

#include "palette/WidgetWindow.h"
#include "support/Dump.h"

namespace {


class LookingTest : public EditorFixture {
protected:
	LookingTest() : EditorFixture(BRect(10, 10, 1509, 909)) {}

	// The examples, the tests' own files, and the samples where the environment names them.
	static std::vector<std::string> Files()
	{
		std::vector<std::string> files = test::sample_files();
		for (const char* folder : { ARCHWAY_EXAMPLES, ARCHWAY_TEST_DATA "/resources" }) {
			for (const auto& entry : std::filesystem::directory_iterator(folder)) {
				if (entry.path().extension() == ".rsrc")
					files.push_back(entry.path());
			}
		}
		return files;
	}

	// What a click at a place of the view's tree hits: of siblings the one that was added first.
	static BView* Hit(BView* view, BPoint where)
	{
		for (BView* child = view->ChildAt(0); child != nullptr; child = child->NextSibling()) {
			const BPoint inside = child->ConvertFromParent(where);
			if (!child->IsHidden() && child->Bounds().Contains(inside))
				return Hit(child, inside);
		}
		return view;
	}

	// A place on the screen where the user gets at the view. False when it is covered, hidden, or
	// scrolled away.
	bool PlaceOf(BView* view, BPoint* _place)
	{
		constexpr int kSteps = 24;
		const BRect frame = view->ConvertToScreen(view->Bounds());
		BRect seen = workView->Target()->ConvertToScreen(workView->Target()->Bounds());
		seen = seen & Root()->ConvertToScreen(Root()->Bounds());
		seen = seen & window.Window()->Frame() & frame;
		if (view->IsHidden() || !seen.IsValid())
			return false;
		for (int i = 0; i < kSteps * kSteps; i++) {
			const BPoint place(std::floor(seen.left + seen.Width() * float(i % kSteps) / kSteps),
				std::floor(seen.top + seen.Height() * float(i / kSteps) / kSteps));
			const bool isFree = !widgetWindow->Frame().InsetByCopy(-20, -30).Contains(place);
			if (isFree && Hit(Root(), Root()->ConvertFromScreen(place)) == view) {
				*_place = place;
				return true;
			}
		}
		return false;
	}

	// By the mouse, where it gets there.
	void SelectEvery(const std::vector<BView*>& views)
	{
		for (BView* view : views) {
			BPoint place;
			bool isThere = false;
			window.Locked([&] { isThere = PlaceOf(view, &place); });
			if (view == workView->SelectedView())
				continue;
			if (isThere)
				driver.Click(place);
			else
				window.Locked([&] { workView->SetSelectedView(view); });
			EXPECT_EQ(view, workView->SelectedView());
			clicks += isThere;
		}
	}

	// With something from the palette, which is let go where nobody takes it.
	void HoverOverEvery(const std::vector<BView*>& views)
	{
		BView* list = widgetWindow->ChildAt(0);
		driver.MoveTo(list, BPoint(60, 20));
		driver.Press();
		driver.MoveTo(list, BPoint(70, 30));
		for (BView* view : views) {
			BPoint place;
			bool isThere = false;
			window.Locked([&] { isThere = PlaceOf(view, &place); });
			if (!isThere)
				continue;
			driver.MoveTo(place);
			EXPECT_EQ(view, workView->SelectedView());
		}
		driver.MoveTo(BPoint(3, 3));
		driver.Release();
	}

	// The one thing that is not written as it was read: a placeholder has two class names.
	static bool IsOtherPlaceholder(const BMessage& archive)
	{
		type_code type;
		int32 count = 0;
		const char* name;
		archive.GetInfo("class", &type, &count);
		for (int32 i = 0; archive.FindString("class", i, &name) == B_OK; i++) {
			if (std::string(name) == "LayoutInheritedView")
				return count != 2;
		}
		return false;
	}

	static bool HoldsOtherPlaceholder(const BMessage& archive)
	{
		BMessage child;
		for (const char* field : { "_views", "_managed_archivable" }) {
			for (int32 i = 0; archive.FindMessage(field, i, &child) == B_OK; i++) {
				if (HoldsOtherPlaceholder(child))
					return true;
			}
		}
		return IsOtherPlaceholder(archive);
	}

	void LookAt(const BResEditor::BResourceHandle& item)
	{
		uint32 changes;
		while (collection.GetNextChange(&owner, &changes).IsValid())
			;
		const std::string before = Bytes(item);
		Open(item);
		ASSERT_NE(nullptr, Root());
		std::vector<BView*> views = ControlUser::All<BView>(Root());
		views.push_back(Root());
		SelectEvery(views);
		HoverOverEvery(views);
		Close();
		BMessage archive;
		archive.Unflatten(before.data());
		viewCount += views.size();
		if (HoldsOtherPlaceholder(archive))
			return;
		EXPECT_FALSE(collection.GetNextChange(&owner, &changes).IsValid()) << "was written";
		if (Bytes(item) != before) {
			ADD_FAILURE() << test::first_difference(archive, Archive(item));
		}
	}

	size_t viewCount = 0;
	size_t clicks = 0;
};


bool
IsView(const void* data, size_t size)
{
	BMessage archive;
	if (data == nullptr || unflatten_message(&archive, data, size) != B_OK)
		return false;
	const std::unique_ptr<BArchivable> object(instantiate_object(&archive));
	return dynamic_cast<BView*>(object.get()) != nullptr;
}


} // namespace


TEST_F(LookingTest, SelectingAndHoveringWritesNothing)
{
	int32 count = 0;
	for (const std::string& path : Files()) {
		BResources resources(path.c_str());
		type_code type;
		int32 id;
		const char* name;
		size_t size;
		for (int32 i = 0; resources.GetResourceInfo(i, &type, &id, &name, &size); i++) {
			SCOPED_TRACE(path + " " + std::to_string(id));
			const char* data = static_cast<const char*>(resources.LoadResource(type, id, &size));
			if (type == 'ARCV' && IsView(data, size))
				LookAt(Add(++count, std::vector<char>(data, data + size)));
		}
	}
	EXPECT_LE(8, count);
	EXPECT_LE(40u, viewCount);
	EXPECT_LE(viewCount / 2, clicks); // the mouse does get at most of them
}
