// Messages side by side with their peers: copying bytes, QVariantMap, and themselves at other sizes.
// Ends with 1 when a goal is not met.
#include <cstdlib>
#include <cstring>
#include <memory>
#include <string>
#include <vector>

#include <QDataStream>
#include <QIODevice>
#include <QVariantMap>
#include <benchmark/benchmark.h>

#include <Message.h>
#include <MessageForm.h>

#include "SideBySide.h"

namespace {

// What a button's archive has, in twelve fields.
BMessage
build_view(int number)
{
	BMessage view;
	view.AddString("class", "BButton");
	view.AddString("_name", "a view of the form");
	view.AddRect("_frame", BRect(10, 20, 100 + float(number % 50), 44));
	view.AddInt32("_resize_mode", 0x1202);
	view.AddInt32("_flags", 0x22000000);
	for (int i = 0; i < 3; i++)
		view.AddInt32("_color", i * 0x01020304);
	view.AddString("_fname", "Swis721 BT");
	view.AddString("_fname", "Roman");
	for (int i = 0; i < 3; i++)
		view.AddFloat("_fflt", 10.0f);
	view.AddInt16("_show", 0);
	view.AddString("_label", "Press the button");
	view.AddInt32("_val", number);
	view.AddBool("_disable", number % 2 == 0);
	return view;
}


QVariantMap
build_map(int number)
{
	QVariantMap view;
	view.insert("class", QByteArray("BButton"));
	view.insert("_name", QByteArray("a view of the form"));
	view.insert("_frame", QVariantList { 10.0f, 20.0f, 100.0f + float(number % 50), 44.0f });
	view.insert("_resize_mode", 0x1202);
	view.insert("_flags", 0x22000000);
	view.insert("_color", QVariantList { 0, 0x01020304, 0x02040608 });
	view.insert("_fname", QVariantList { QByteArray("Swis721 BT"), QByteArray("Roman") });
	view.insert("_fflt", QVariantList { 10.0f, 10.0f, 10.0f });
	view.insert("_show", 0);
	view.insert("_label", QByteArray("Press the button"));
	view.insert("_val", number);
	view.insert("_disable", number % 2 == 0);
	return view;
}


// How the views of a tree hang together: children of view i are those whose parent is i.
typedef int (*parent_func)(int);

int
one_parent(int)
{
	return 0;
}


int
groups_of_ten(int i)
{
	return i / 10 * 10 == i ? 0 : i / 10 * 10;
}


int
binary_tree(int i)
{
	return (i - 1) / 2;
}


int
chain(int i)
{
	return i % 200 == 1 ? 0 : i - 1;
}


template<typename View, typename Build, typename Add>
View
build_tree(int count, parent_func parent, Build build, Add add)
{
	std::vector<View> views;
	views.reserve(size_t(count));
	for (int i = 0; i < count; i++)
		views.push_back(build(i));
	for (int i = count - 1; i > 0; i--) {
		add(views[size_t(parent(i))], views[size_t(i)]);
		views[size_t(i)] = View();
	}
	return views[0];
}


BMessage
message_tree(int count, parent_func parent)
{
	return build_tree<BMessage>(count, parent, build_view,
		[](BMessage& to, BMessage& child) { to.AddMessage("_views", &child); });
}


QVariantMap
map_tree(int count, parent_func parent)
{
	return build_tree<QVariantMap>(
		count, parent, build_map, [](QVariantMap& to, QVariantMap& child) {
			QVariantList views = to.take("_views").toList();
			views.append(child);
			to.insert("_views", views);
		});
}


// A bare live object: what a reader cannot do without.
struct Node {
	float frame[4];
	int flags;
	int value;
	size_t nameLength;
	Node* firstChild = nullptr; // owned
	Node* nextSibling = nullptr; // owned by the parent

	~Node()
	{
		while (Node* child = firstChild) {
			firstChild = child->nextSibling;
			delete child;
		}
	}
};


std::unique_ptr<Node>
make_node(const BMessage& view)
{
	auto node = std::make_unique<Node>();
	node->nameLength = strlen(view.FindString("_name"));
	const BRect frame = view.FindRect("_frame");
	memcpy(node->frame, &frame, sizeof(frame));
	node->flags = view.FindInt32("_flags");
	node->value = view.FindInt32("_val");
	Node** end = &node->firstChild;
	BMessage child;
	for (int32 i = 0; view.FindMessage("_views", i, &child) == B_OK; i++) {
		*end = make_node(child).release();
		end = &(*end)->nextSibling;
	}
	return node;
}


std::unique_ptr<Node>
make_node(const QVariantMap& view)
{
	auto node = std::make_unique<Node>();
	node->nameLength = size_t(view.value("_name").toByteArray().size());
	const QVariantList frame = view.value("_frame").toList();
	for (int i = 0; i < 4; i++)
		node->frame[i] = frame[i].toFloat();
	node->flags = view.value("_flags").toInt();
	node->value = view.value("_val").toInt();
	Node** end = &node->firstChild;
	const QVariantList children = view.value("_views").toList();
	for (const QVariant& child : children) {
		*end = make_node(child.toMap()).release();
		end = &(*end)->nextSibling;
	}
	return node;
}


int
count_nodes(const Node& node)
{
	int count = 1;
	for (const Node* child = node.firstChild; child != nullptr; child = child->nextSibling)
		count += count_nodes(*child);
	return count;
}


void
verify(bool condition, const char* what)
{
	if (condition)
		return;
	fprintf(stderr, "wrong result: %s\n", what);
	exit(2);
}


bool
bench_bytes(const char* shape, int count, parent_func parent)
{
	const std::string name = std::string(shape) + " of " + std::to_string(count);
	if (!bench::is_chosen(("unflatten / memcpy, " + name).c_str()))
		return true; // has the other one's name in it
	const BMessage tree = message_tree(count, parent);
	const size_t size = size_t(tree.FlattenedSize());
	std::string bytes(size, '\0');
	std::string copy(size, '\0');
	tree.Flatten(bytes.data(), ssize_t(size));

	bool met = bench::compare(("flatten / memcpy, " + name).c_str(), 1.5,
		[&] { benchmark::DoNotOptimize(tree.Flatten(copy.data(), ssize_t(size))); },
		[&] {
			memcpy(copy.data(), bytes.data(), size);
			benchmark::ClobberMemory();
		});
	tree.Flatten(copy.data(), ssize_t(size));
	verify(copy == bytes, "flatten");

	BMessage read;
	met &= bench::compare(("unflatten / memcpy, " + name).c_str(), 2.0,
		[&] { benchmark::DoNotOptimize(unflatten_message(&read, bytes.data(), size)); },
		[&] {
			void* block = malloc(size);
			memcpy(block, bytes.data(), size);
			benchmark::DoNotOptimize(block);
			benchmark::ClobberMemory();
			free(block);
		});
	verify(read.HasSameData(tree, false, true), "unflatten");
	verify(count_nodes(*make_node(read)) == count, "tree");
	return met;
}


bool
bench_build()
{
	int number = 0;
	return bench::compare(
		"build a view by Add / QVariantMap", 0.25,
		[&] { benchmark::DoNotOptimize(build_view(number++)); },
		[&] { benchmark::DoNotOptimize(build_map(number++)); });
}


bool
bench_read(int count)
{
	const BMessage tree = message_tree(count, groups_of_ten);
	std::string bytes(size_t(tree.FlattenedSize()), '\0');
	tree.Flatten(bytes.data(), ssize_t(bytes.size()));
	QByteArray mapBytes;
	{
		QDataStream stream(&mapBytes, QIODevice::WriteOnly);
		stream << map_tree(count, groups_of_ten);
	}

	const auto ours = [&] {
		BMessage read;
		unflatten_message(&read, bytes.data(), bytes.size());
		return make_node(read);
	};
	const auto theirs = [&] {
		QVariantMap read;
		QDataStream stream(mapBytes);
		stream >> read;
		return make_node(read);
	};
	verify(count_nodes(*ours()) == count && count_nodes(*theirs()) == count, "nodes");
	return bench::compare(
		"read and make nodes / QDataStream, 10,000 views", 0.08,
		[&] { benchmark::DoNotOptimize(ours()); }, [&] { benchmark::DoNotOptimize(theirs()); });
}


BMessage
with_fields(int count)
{
	BMessage message;
	for (int32 i = 0; i < count; i++)
		message.AddInt32(("field number " + std::to_string(i)).c_str(), i);
	return message;
}


bool
bench_find()
{
	const BMessage few = with_fields(10);
	const BMessage many = with_fields(1000);
	std::vector<std::string> names;
	for (int i = 0; i < 1000; i++)
		names.push_back("field number " + std::to_string(i));
	const auto find_all = [&](const BMessage& message, int fields) {
		int32 sum = 0;
		for (int i = 0; i < 1000; i++)
			sum += message.FindInt32(names[size_t(i % fields)].c_str());
		benchmark::DoNotOptimize(sum);
	};
	return bench::compare(
		"one Find among 1,000 fields / among 10", 2.0, [&] { find_all(many, 1000); },
		[&] { find_all(few, 10); });
}


bool
bench_items()
{
	const auto with_items = [](int32 count) {
		BMessage message;
		for (int32 i = 0; i < count; i++)
			message.AddString("s", std::to_string(i).c_str());
		return message;
	};
	const BMessage few = with_items(1000);
	const BMessage many = with_items(10000);
	const auto all = [](const BMessage& message) {
		int sum = 0;
		const char* text;
		for (int32 i = 0; message.FindString("s", i, &text) == B_OK; i++)
			sum += text[0];
		benchmark::DoNotOptimize(sum);
	};
	return bench::compare(
		"all of 10,000 items / ten times all of 1,000", 1.3, [&] { all(many); },
		[&] {
			for (int i = 0; i < 10; i++)
				all(few);
		});
}

} // namespace


int
main()
{
	bench::clockOfWork = CLOCK_THREAD_CPUTIME_ID;
	bool met = true;
	for (int count : { 10, 1000, 10000 }) {
		met &= bench_bytes("one parent", count, one_parent);
		met &= bench_bytes("groups of ten", count, groups_of_ten);
		met &= bench_bytes("binary tree", count, binary_tree);
		met &= bench_bytes("chains", count, chain);
	}
	met &= bench_build();
	met &= bench_read(10000);
	met &= bench_find();
	met &= bench_items();
	return met ? 0 : 1;
}
