// Trees of views: the same work per view whatever their shape and number, and little memory each.
// Ends with 1 when a goal is not met.
#include <cmath>
#include <malloc.h>
#include <memory>
#include <vector>

#include <stdlib.h>

#include <Application.h>
#include <DataIO.h>
#include <Message.h>
#include <View.h>
#include <Window.h>

#include "SideBySide.h"

namespace {

constexpr int kManyViews = 10000;
constexpr int kFewViews = 1000;

typedef int (*parent_func)(int);

int
one_parent(int)
{
	return 0;
}


int
groups_of_ten(int i)
{
	return i % 11 == 1 ? 0 : i - (i - 1) % 11;
}


int
binary_tree(int i)
{
	return (i - 1) / 2;
}


int
chains(int i)
{
	constexpr int kDepth = 200; // archives nest that deep, and little deeper
	return i % kDepth == 1 ? 0 : i - 1;
}


BView*
build_tree(int count, parent_func parent)
{
	std::vector<BView*> views;
	views.push_back(new BView(BRect(0, 0, 1599, 999), "top", B_FOLLOW_ALL, B_WILL_DRAW));
	for (int i = 1; i < count; i++) {
		const BPoint at(i % 100 * 16, i / 100 % 100 * 10);
		BView* view = new BView(BRect(at.x, at.y, at.x + 13, at.y + 7), "a view of the form",
			B_FOLLOW_LEFT | B_FOLLOW_TOP, B_WILL_DRAW);
		view->SetViewColor(216, 216, 216);
		view->SetHighColor(0, 0, uint8(i));
		views[parent(i)]->AddChild(view);
		views.push_back(view);
	}
	return views[0];
}


std::vector<char>
flat_tree(int count, parent_func parent)
{
	std::unique_ptr<BView> top(build_tree(count, parent));
	BMessage archive;
	top->Archive(&archive);
	std::vector<char> bytes(archive.FlattenedSize());
	archive.Flatten(bytes.data(), bytes.size());
	return bytes;
}


std::unique_ptr<BView>
open_tree(const std::vector<char>& bytes)
{
	BMemoryIO stream(bytes.data(), bytes.size());
	BMessage archive;
	archive.Unflatten(&stream);
	return std::unique_ptr<BView>(dynamic_cast<BView*>(instantiate_object(&archive)));
}


bool
save_tree(const BView& view, const std::vector<char>& expected)
{
	BMessage archive;
	view.Archive(&archive);
	std::vector<char> bytes(archive.FlattenedSize());
	archive.Flatten(bytes.data(), bytes.size());
	return bytes == expected;
}


int32
count_views(const BView* view)
{
	int32 count = 1;
	for (const BView* child = view->ChildAt(0); child != nullptr; child = child->NextSibling())
		count += count_views(child);
	return count;
}


void
need(bool holds, const char* what)
{
	if (holds)
		return;
	fprintf(stderr, "%s\n", what);
	exit(2);
}


struct Shape {
	const char* name;
	parent_func parent;
};

constexpr Shape kShapes[] = {
	{ "one parent / groups of ten: open and save", one_parent },
	{ "binary tree / groups of ten: open and save", binary_tree },
	{ "chains / groups of ten: open and save", chains },
};


bool
compare_shapes()
{
	const std::vector<char> groups = flat_tree(kManyViews, groups_of_ten);
	bool met = true;
	for (const Shape& shape : kShapes) {
		const std::vector<char> bytes = flat_tree(kManyViews, shape.parent);
		need(count_views(open_tree(bytes).get()) == kManyViews, "views are missing");
		met = bench::compare(
				  shape.name, 1.5,
				  [&] { need(save_tree(*open_tree(bytes), bytes), "not the bytes read"); },
				  [&] { need(save_tree(*open_tree(groups), groups), "not the bytes read"); })
			&& met;
	}
	return met;
}


// Ten times as many views may take at most 10^1.1 times as long.
bool
compare_growth()
{
	const double kGoal = std::pow(10, 1.1);
	const std::vector<char> many = flat_tree(kManyViews, groups_of_ten);
	const std::vector<char> few = flat_tree(kFewViews, groups_of_ten);
	bool met = bench::compare(
		"growth: open and close", kGoal, [&] { open_tree(many); }, [&] { open_tree(few); });
	const std::unique_ptr<BView> manyViews = open_tree(many);
	const std::unique_ptr<BView> fewViews = open_tree(few);
	met = bench::compare(
			  "growth: save", kGoal, [&] { save_tree(*manyViews, many); },
			  [&] { save_tree(*fewViews, few); })
		&& met;

	BWindow* window = new BWindow(BRect(0, 0, 1599, 999), "bench", B_TITLED_WINDOW, 0);
	window->Show();
	const auto in_window = [&](BView* top) {
		window->Lock();
		window->AddChild(top);
		for (BView* view = top->ChildAt(0); view != nullptr; view = view->NextSibling())
			view->MoveBy(1, 0);
		top->RemoveSelf();
		window->Unlock();
	};
	met = bench::compare(
			  "growth: attach, move all, remove", kGoal, [&] { in_window(manyViews.get()); },
			  [&] { in_window(fewViews.get()); })
		&& met;
	window->Lock();
	window->Quit();
	return met;
}


// What a live view takes with what it keeps of its archive, against the 2553 bytes that a widget
// read from a form was measured to take.
bool
compare_memory()
{
	constexpr double kPeerBytes = 2553;
	constexpr double kGoal = 0.5;
	const std::vector<char> bytes = flat_tree(kManyViews, groups_of_ten);
	const size_t before = mallinfo2().uordblks;
	const std::unique_ptr<BView> top = open_tree(bytes);
	const double perView = double(mallinfo2().uordblks - before) / kManyViews;
	const bool met = perView / kPeerBytes <= kGoal;
	printf("%-52s %7.3f  goal %.2f  %s  (%.0f bytes)\n", "heap per view", perView / kPeerBytes,
		kGoal, met ? "met" : "NOT MET", perView);
	return met;
}

} // namespace


int
main()
{
	setenv("ARCHWAY_BACKEND", "headless", 0);
	BApplication app("application/x-vnd.Archway-bench");
	bench::clockOfWork = CLOCK_THREAD_CPUTIME_ID;
	bool met = compare_memory();
	met = compare_shapes() && met;
	met = compare_growth() && met;
	return met ? 0 : 1;
}
