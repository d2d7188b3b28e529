// Whole windows: the first paint of a full window against QWidget::render() of the same form, two
// windows that repaint at once against one, and what an idle window of many views costs. Ends with
// 1 when a goal is not met.
#include <stdlib.h>
#include <sys/resource.h>
#include <unistd.h>

#include <atomic>
#include <vector>

#include <QApplication>
#include <QCheckBox>
#include <QImage>
#include <QLineEdit>
#include <QPushButton>
#include <QWidget>

#include <Application.h>
#include <Button.h>
#include <CheckBox.h>
#include <Message.h>
#include <StringView.h>
#include <TextControl.h>
#include <Window.h>

#include "SideBySide.h"
#include "kernel/private/Activity.h"

namespace {


constexpr int kWidth = 1600, kHeight = 1000;
constexpr int kColumns = 10, kRows = 36;
constexpr int kIdleViews = 10000;


BRect
Cell(int column, int row)
{
	const BPoint at(static_cast<float>(column) * 158 + 8, static_cast<float>(row) * 27 + 6);
	return BRect(at, at + BPoint(145, 22));
}


// A panel of buttons, check boxes, labels and fields that fills the window.
BView*
MakePanel()
{
	BView* panel =
		new BView(BRect(0, 0, kWidth - 1, kHeight - 1), "panel", B_FOLLOW_NONE, B_WILL_DRAW);
	panel->SetViewColor(216, 216, 216);
	for (int i = 0; i < kColumns * kRows; i++) {
		const BRect frame = Cell(i % kColumns, i / kColumns);
		switch (i % 4) {
			case 0:
				panel->AddChild(new BButton(frame, "button", "Push me", NULL));
				break;
			case 1:
				panel->AddChild(new BCheckBox(frame, "box", "Choose me", NULL));
				break;
			case 2:
				panel->AddChild(new BStringView(frame, "label", "A label to read"));
				break;
			case 3:
				panel->AddChild(new BTextControl(frame, "field", "Name:", "text", NULL));
				break;
		}
	}
	return panel;
}


// Repaints all of itself whenever it is told, so many times.
class BusyWindow : public BWindow {
public:
	explicit BusyWindow(BRect frame) : BWindow(frame, "busy", B_TITLED_WINDOW, 0)
	{
		panel = MakePanel();
		AddChild(panel);
	}

	void MessageReceived(BMessage* message) override
	{
		if (message->what != 'work') {
			BWindow::MessageReceived(message);
			return;
		}
		for (int32 left = message->GetInt32("times", 1); left > 0; left--) {
			panel->Invalidate();
			UpdateIfNeeded();
		}
		done++;
		done.notify_all();
	}

	void Work(int32 times)
	{
		BMessage work('work');
		work.AddInt32("times", times);
		PostMessage(&work);
	}

	BView* panel; // child
	std::atomic<int> done { 0 };
};


void
WaitFor(BusyWindow* window, int done)
{
	for (int now = window->done; now < done; now = window->done)
		window->done.wait(now);
}


std::unique_ptr<QWidget>
MakeForm()
{
	auto form = std::make_unique<QWidget>();
	form->setFixedSize(kWidth, kHeight);
	for (int i = 0; i < kColumns * kRows; i++) {
		QWidget* widget = nullptr;
		switch (i % 4) {
			case 0:
				widget = new QPushButton("Push me", form.get());
				break;
			case 1:
				widget = new QCheckBox("Choose me", form.get());
				break;
			case 2:
				widget = new QPushButton("A label to read", form.get());
				static_cast<QPushButton*>(widget)->setFlat(true);
				break;
			case 3:
				widget = new QLineEdit("text", form.get());
				break;
		}
		const BRect frame = Cell(i % kColumns, i / kColumns);
		widget->setGeometry(int(frame.left), int(frame.top), 146, 23);
	}
	return form;
}


bool
FirstPaint(BusyWindow* window)
{
	const std::unique_ptr<QWidget> form = MakeForm();
	QImage image(kWidth, kHeight, QImage::Format_RGB32);
	int done = window->done;
	return bench::compare(
		"full paint of 1600 x 1000 / QWidget::render", 0.33,
		[&] {
			window->Work(1);
			WaitFor(window, ++done);
		},
		[&] { form->render(&image); });
}


// So many repaints of one window, against the same number in each of two.
bool
TwoAtOnce(BusyWindow* first, BusyWindow* second)
{
	constexpr int32 kTimes = 20;
	std::vector<double> gains;
	for (int turn = 0; turn < 9; turn++) {
		const int one = first->done;
		const double alone = bench::seconds(
			[&] {
				first->Work(kTimes);
				WaitFor(first, one + 1);
			},
			1);
		const int two = second->done;
		const double both = bench::seconds(
			[&] {
				first->Work(kTimes);
				second->Work(kTimes);
				WaitFor(first, one + 2);
				WaitFor(second, two + 1);
			},
			1);
		gains.push_back(2 * alone / both);
	}
	std::sort(gains.begin(), gains.end());
	const double median = gains[gains.size() / 2];
	printf("%-52s %7.3f  [%.3f .. %.3f]  goal %.2f  %s\n", "two windows' throughput / one's",
		median, gains.front(), gains.back(), 1.7, median >= 1.7 ? "met" : "NOT MET");
	return median >= 1.7;
}


long
Wakeups()
{
	rusage usage;
	getrusage(RUSAGE_SELF, &usage);
	return usage.ru_nvcsw + usage.ru_nivcsw;
}


bool
Idle()
{
	BWindow* window = new BWindow(BRect(0, 0, 999, 999), "idle", B_TITLED_WINDOW, 0);
	for (int i = 0; i < kIdleViews; i++) {
		const BPoint at(static_cast<float>(i % 100) * 10, static_cast<float>(i / 100) * 10);
		window->AddChild(
			new BView(BRect(at, at + BPoint(7, 7)), "view", B_FOLLOW_NONE, B_WILL_DRAW));
	}
	window->Show();
	BPrivate::wait_until_idle(20000000);
	constexpr unsigned kSeconds = 3;
	const long before = Wakeups();
	sleep(kSeconds);
	const double perSecond = double(Wakeups() - before - 1) / kSeconds;
	printf("%-52s %7.2f  goal 5.00  %s\n", "wake-ups a second, idle with 10,000 views", perSecond,
		perSecond <= 5 ? "met" : "NOT MET");
	window->Lock();
	window->Quit();
	return perSecond <= 5;
}


} // namespace


int
main(int argc, char** argv)
{
	setenv("ARCHWAY_BACKEND", "headless", 1);
	setenv("QT_QPA_PLATFORM", "offscreen", 1);
	QApplication peer(argc, argv);
	BApplication application("application/x-vnd.Archway-bench");
	BusyWindow* first = new BusyWindow(BRect(0, 0, kWidth - 1, kHeight - 1));
	BusyWindow* second = new BusyWindow(BRect(0, 0, kWidth - 1, kHeight - 1));
	first->Show();
	second->Show();
	BPrivate::wait_until_idle(20000000);

	bool met = FirstPaint(first);
	met = TwoAtOnce(first, second) && met;
	for (BusyWindow* window : { first, second }) {
		window->Lock();
		window->Quit();
	}
	met = Idle() && met;
	return met ? 0 : 1;
}
