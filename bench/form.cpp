// Opening and saving a design of 10,000 views side by side with a form of as many widgets, and the
// memory that each takes. Ends with 1 when a goal is not met.
#include <malloc.h>
#include <stdlib.h>

#include <memory>
#include <string>
#include <vector>

#include <QApplication>
#include <QBuffer>
#include <QFormBuilder>
#include <QUiLoader>
#include <QWidget>

#include <Application.h>
#include <Button.h>
#include <CheckBox.h>
#include <Message.h>
#include <MessageForm.h>
#include <StringView.h>
#include <TextControl.h>
#include <View.h>

#include "SideBySide.h"

namespace {

constexpr int kGroups = 1000;
constexpr int kInGroup = 9;
constexpr int kViews = kGroups * (kInGroup + 1); // besides the top

// What lies in the groups: plain views, or buttons, check boxes, labels and text fields in turn.
enum class Kind { kViews, kControls };


BRect
GroupFrame(int group)
{
	const BPoint at(static_cast<float>(group % 10) * 160, static_cast<float>(group / 10) * 10);
	return BRect(at, at + BPoint(155, 8));
}


BRect
ChildFrame(int child)
{
	const BPoint at(static_cast<float>(child) * 17, 0);
	return BRect(at, at + BPoint(15, 8));
}


BView*
MakeChild(Kind kind, int number, BRect frame)
{
	if (kind == Kind::kViews)
		return new BView(frame, "a view", B_FOLLOW_NONE, B_WILL_DRAW);
	switch (number % 4) {
		case 0:
			return new BButton(frame, "a button", "Press me", NULL);
		case 1:
			return new BCheckBox(frame, "a box", "Choose me", NULL);
		case 2:
			return new BStringView(frame, "a label", "A label to read");
		default:
			return new BTextControl(frame, "a field", NULL, "text", NULL);
	}
}


BView*
MakeViews(Kind kind)
{
	BView* top = new BView(BRect(0, 0, 1599, 999), "top", B_FOLLOW_ALL, B_WILL_DRAW);
	for (int group = 0; group < kGroups; group++) {
		BView* box = new BView(GroupFrame(group), "a group", B_FOLLOW_NONE, B_WILL_DRAW);
		for (int child = 0; child < kInGroup; child++) {
			box->AddChild(MakeChild(kind, child, ChildFrame(child)));
		}
		top->AddChild(box);
	}
	return top;
}


std::string
WidgetText(const char* className, const std::string& name, BRect frame, const char* label)
{
	const auto number = [](const char* tag, int value) {
		return std::string("<") + tag + ">" + std::to_string(value) + "</" + tag + ">";
	};
	std::string text = std::string("<widget class=\"") + className + "\" name=\"" + name
		+ "\"><property name=\"geometry\"><rect>" + number("x", static_cast<int>(frame.left))
		+ number("y", static_cast<int>(frame.top))
		+ number("width", static_cast<int>(frame.Width()) + 1)
		+ number("height", static_cast<int>(frame.Height()) + 1) + "</rect></property>";
	if (label != nullptr)
		text += std::string("<property name=\"text\"><string>") + label + "</string></property>";
	return text;
}


QByteArray
FormText(Kind kind)
{
	struct Peer {
		const char* className;
		const char* text;
	};
	constexpr Peer kControls[] = { { "QPushButton", "Press me" }, { "QCheckBox", "Choose me" },
		{ "QLabel", "A label to read" }, { "QLineEdit", "text" } };
	constexpr Peer kPlain = { "QWidget", nullptr };
	std::string text = "<ui version=\"4.0\"><class>Form</class>"
		+ WidgetText("QWidget", "Form", BRect(0, 0, 1599, 999), nullptr);
	for (int group = 0; group < kGroups; group++) {
		const std::string number = std::to_string(group);
		text += WidgetText("QWidget", "group" + number, GroupFrame(group), nullptr);
		for (int child = 0; child < kInGroup; child++) {
			const Peer& peer = kind == Kind::kControls ? kControls[child % 4] : kPlain;
			const std::string name = "child" + number + "_" + std::to_string(child);
			text += WidgetText(peer.className, name, ChildFrame(child), peer.text) + "</widget>";
		}
		text += "</widget>";
	}
	return QByteArray::fromStdString(text + "</widget></ui>");
}


void
Need(bool holds, const char* what)
{
	if (holds)
		return;
	fprintf(stderr, "wrong result: %s\n", what);
	exit(2);
}


int
CountViews(const BView* view)
{
	int count = 1;
	for (const BView* child = view->ChildAt(0); child != NULL; child = child->NextSibling())
		count += CountViews(child);
	return count;
}


std::string
Save(const BView& view)
{
	BMessage archive;
	Need(view.Archive(&archive) == B_OK, "the archive");
	std::string bytes(static_cast<size_t>(archive.FlattenedSize()), '\0');
	archive.Flatten(bytes.data(), static_cast<ssize_t>(bytes.size()));
	return bytes;
}


std::unique_ptr<BView>
Open(const std::string& bytes)
{
	BMessage archive;
	unflatten_message(&archive, bytes.data(), bytes.size());
	return std::unique_ptr<BView>(dynamic_cast<BView*>(instantiate_object(&archive)));
}


std::unique_ptr<QWidget>
OpenForm(const QByteArray& text)
{
	QByteArray copy(text);
	QBuffer buffer(&copy);
	buffer.open(QIODevice::ReadOnly);
	return std::unique_ptr<QWidget>(QUiLoader().load(&buffer));
}


QByteArray
SaveForm(QWidget* form)
{
	QByteArray text;
	QBuffer buffer(&text);
	buffer.open(QIODevice::WriteOnly);
	QFormBuilder().save(&buffer, form);
	return text;
}


size_t
HeapOf(const auto& make)
{
	malloc_trim(0);
	const size_t before = mallinfo2().uordblks;
	const auto made = make();
	return mallinfo2().uordblks - before;
}


bool
Compare(const char* what, Kind kind)
{
	const std::string name = std::string(what) + ": ";
	const std::string bytes = Save(*std::unique_ptr<BView>(MakeViews(kind)));
	const QByteArray text = FormText(kind);
	const std::unique_ptr<BView> views = Open(bytes);
	const std::unique_ptr<QWidget> form = OpenForm(text);
	// A text field has a part of its own.
	Need(CountViews(views.get()) >= kViews + 1, "the views");
	Need(form->findChildren<QWidget*>().size() == kViews, "the widgets");
	Need(Save(*views) == bytes, "the bytes that were read");
	Need(SaveForm(form.get()).count("<widget") == kViews + 1, "the form's text");

	bool met = bench::compare((name + "open / QUiLoader").c_str(), 0.10,
		[&] { Need(Open(bytes) != nullptr, "a tree"); },
		[&] { Need(OpenForm(text) != nullptr, "a form"); });
	met = bench::compare((name + "save / QFormBuilder").c_str(), 0.02,
			  [&] { Need(Save(*views).size() == bytes.size(), "a file"); },
			  [&] { Need(!SaveForm(form.get()).isEmpty(), "a text"); })
		&& met;
	const double ours = static_cast<double>(HeapOf([&] { return Open(bytes); })) / kViews;
	const double theirs = static_cast<double>(HeapOf([&] { return OpenForm(text); })) / kViews;
	printf("%-52s %7.3f  goal 0.50  %s  (%.0f / %.0f bytes)\n", (name + "heap / QUiLoader").c_str(),
		ours / theirs, ours / theirs <= 0.5 ? "met" : "NOT MET", ours, theirs);
	return met && ours / theirs <= 0.5;
}

} // namespace


int
main(int argc, char** argv)
{
	setenv("ARCHWAY_BACKEND", "headless", 1);
	setenv("QT_QPA_PLATFORM", "offscreen", 1);
	// The form's writer complains about properties, hundreds of thousands of times.
	qInstallMessageHandler([](QtMsgType, const QMessageLogContext&, const QString&) {});
	QApplication peer(argc, argv);
	BApplication application("application/x-vnd.Archway-bench");
	bench::clockOfWork = CLOCK_THREAD_CPUTIME_ID;
	bool met = Compare("10,000 plain views", Kind::kViews);
	met = Compare("10,000 controls in groups", Kind::kControls) && met;
	return met ? 0 : 1;
}
