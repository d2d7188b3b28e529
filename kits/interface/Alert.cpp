#include <Alert.h>

#include <algorithm>
#include <atomic>
#include <cmath>
#include <mutex>

#include <Button.h>
#include <Invoker.h>
#include <Message.h>
#include <Messenger.h>
#include <OS.h>
#include <Screen.h>
#include <TextView.h>

#include "app/private/LooperPrivate.h"
#include "interface/private/AlertView.h"
#include "interface/private/ControlArchive.h"
#include "interface/private/Look.h"
#include "interface/private/MenuTracker.h"
#include "interface/private/ViewArchive.h"
#include "kernel/private/Activity.h"

namespace {

constexpr uint32 kButtonPressed = 'ALTB';
constexpr int32 kMaximumButtons = 3;
constexpr const char* kMasterName = "_master_";
constexpr const char* kTextName = "_tv_";
constexpr const char* kButtonNames[] = { "_b0_", "_b1_", "_b2_" };

constexpr float kMinimumWidth = 310;
constexpr float kStripeWidth = 30;
constexpr float kTextLeft = 10;
constexpr float kTextLeftWithIcon = 55;
constexpr float kTextTop = 6;
constexpr float kTextRight = 10;
constexpr float kTextBottom = 45; // from the end of the text to the window's
constexpr float kMinimumTextHeight = 34; // room for the icon
constexpr float kButtonBottom = 9; // 6 below the ring of the default button
constexpr float kButtonRight = 6;
constexpr float kButtonGap = 6;
constexpr float kOffsetGap = 26;
constexpr float kUsualButtonWidth = 75;

constexpr bigtime_t kRedrawInterval = 50000;

} // namespace


// Outlives the alert, for the thread that waits for its end. That thread's looper, if it has one,
// counts as idle while it waits, and as busy again from the moment on that the alert is answered.
struct BAlert::Wait {
	explicit Wait(BPrivate::Worker* worker) : done(create_sem(0, "alert")), worker(worker) {}
	~Wait() { delete_sem(done); }

	// Whether the alert has ended; false when the time is over.
	bool WaitForEnd(bigtime_t timeout)
	{
		_SetWaiting(true);
		const status_t status = acquire_sem_etc(done, 1, B_RELATIVE_TIMEOUT, timeout);
		_SetWaiting(false);
		return status == B_OK || status == B_BAD_SEM_ID;
	}

	void End()
	{
		ended = true;
		_SetWaiting(false);
		release_sem(done);
	}

	std::atomic<int32> result { -1 };

private:
	void _SetWaiting(bool wait)
	{
		const std::lock_guard<std::mutex> guard(lock);
		wait = wait && !ended;
		if (worker == NULL || wait == waiting)
			return;
		waiting = wait;
		if (wait)
			worker->BeginWaiting();
		else
			worker->EndWaiting();
	}

	sem_id done;
	BPrivate::Worker* worker; // borrowed; NULL for a thread without a looper
	std::mutex lock; // for what follows
	bool waiting = false;
	std::atomic<bool> ended { false };
};


BAlert::BAlert(const char* title, const char* text, const char* button0, const char* button1,
	const char* button2, button_width width, alert_type type) :
	BAlert(title, text, button0, button1, button2, width, B_EVEN_SPACING, type)
{
}


BAlert::BAlert(const char* title, const char* text, const char* button0, const char* button1,
	const char* button2, button_width width, button_spacing spacing, alert_type type) :
	BWindow(BRect(0, 0, kMinimumWidth, 100), title, B_MODAL_WINDOW_LOOK, B_MODAL_APP_WINDOW_FEEL,
		B_NOT_CLOSABLE | B_NOT_RESIZABLE | B_ASYNCHRONOUS_CONTROLS),
	fTextView(NULL), fButtons {}, fKeys {}, fType(type), fButtonWidth(width), fSpacing(spacing)
{
	const char* const labels[kMaximumButtons] = { button0, button1, button2 };
	_Init(text, labels);
}


BAlert::BAlert(BMessage* archive) :
	BWindow(archive), fTextView(NULL), fButtons {}, fKeys {}, fType(B_INFO_ALERT),
	fButtonWidth(B_WIDTH_AS_USUAL), fSpacing(B_EVEN_SPACING)
{
	_FindViews();
	const char* text;
	if (fTextView != NULL && archive->FindString("_text", &text) == B_OK)
		fTextView->SetText(text);
	int32 number;
	if (archive->FindInt32("_atype", &number) == B_OK)
		fType = static_cast<alert_type>(number);
	if (archive->FindInt32("_but_width", &number) == B_OK)
		fButtonWidth = static_cast<button_width>(number);
	for (int32 i = 0; i < kMaximumButtons; i++) {
		int8 key;
		if (archive->FindInt8("_but_key", i, &key) == B_OK)
			fKeys[i] = key;
	}
}


BAlert::~BAlert()
{
}


BArchivable*
BAlert::Instantiate(BMessage* archive)
{
	return validate_instantiation(archive, "BAlert") ? new BAlert(archive) : NULL;
}


status_t
BAlert::Archive(BMessage* archive, bool deep) const
{
	const status_t status = BWindow::Archive(archive, deep);
	if (status != B_OK)
		return status;
	BPrivate::ArchiveWriter writer(archive);
	writer.String("_text", fTextView != NULL ? fTextView->Text() : NULL, NULL);
	writer.Int32("_atype", fType, B_INFO_ALERT);
	writer.Int32("_but_width", fButtonWidth, B_WIDTH_AS_USUAL);

	bool hasKeys = false;
	bool sameKeys = true;
	for (int32 i = 0; i < kMaximumButtons; i++) {
		int8 key;
		if (writer.Source().FindInt8("_but_key", i, &key) != B_OK)
			key = 0;
		hasKeys = hasKeys || fKeys[i] != 0;
		sameKeys = sameKeys && key == fKeys[i];
	}
	if (!writer.Keep("_but_key", sameKeys) && hasKeys) {
		for (char key : fKeys)
			archive->AddInt8("_but_key", key);
	}
	return writer.Status();
}


// #pragma mark - building


void
BAlert::_Init(const char* text, const char* const labels[])
{
	BView* master = new BPrivate::AlertView(Bounds(), fType);
	AddChild(master);

	const BRect nowhere(0, 0, 10, 10);
	fTextView = new BTextView(nowhere, kTextName, nowhere, B_FOLLOW_NONE, B_WILL_DRAW);
	fTextView->SetText(text != NULL ? text : "");
	fTextView->MakeEditable(false);
	fTextView->MakeSelectable(false);
	fTextView->SetWordWrap(true);
	fTextView->SetViewColor(master->ViewColor());
	fTextView->SetLowColor(master->ViewColor());
	master->AddChild(fTextView);

	BButton* last = NULL;
	for (int32 i = 0; i < kMaximumButtons && labels[i] != NULL && labels[i][0] != '\0'; i++) {
		BMessage* message = new BMessage(kButtonPressed);
		message->AddInt32("which", i);
		last = new BButton(
			nowhere, kButtonNames[i], labels[i], message, B_FOLLOW_RIGHT | B_FOLLOW_BOTTOM);
		fButtons[i] = last;
		master->AddChild(last);
	}
	if (last != NULL) {
		last->MakeDefault(true);
		last->MakeFocus(true);
	}
	_LayOut();
	MoveTo(AlertPosition(Frame().Width(), Frame().Height()));
}


// Gives the buttons their sizes and answers the width that their row needs.
float
BAlert::_SizeButtons()
{
	float widest = 0;
	for (BButton* button : fButtons) {
		if (button == NULL)
			continue;
		float width;
		float height;
		button->GetPreferredSize(&width, &height);
		button->ResizeTo(width, height);
		if (button->IsDefault())
			width -= 2 * BPrivate::Look::kDefaultButtonInset;
		widest = std::max(widest, width);
	}

	float row = 0;
	for (BButton* button : fButtons) {
		if (button == NULL)
			continue;
		float width = button->Bounds().Width();
		const float ring = button->IsDefault() ? 2 * BPrivate::Look::kDefaultButtonInset : 0;
		if (fButtonWidth == B_WIDTH_FROM_WIDEST)
			width = widest + ring;
		else if (fButtonWidth == B_WIDTH_AS_USUAL)
			width = std::max(width, kUsualButtonWidth + ring);
		button->ResizeTo(width, button->Bounds().Height());
		row += width + kButtonGap;
	}
	if (fSpacing == B_OFFSET_SPACING && fButtons[1] != NULL)
		row += kOffsetGap;
	return row;
}


void
BAlert::_LayOut()
{
	const bool hasIcon = fType != B_EMPTY_ALERT;
	const float row = _SizeButtons();
	const float needed = row + kButtonRight + (hasIcon ? kStripeWidth : 0);
	const float width = std::max(kMinimumWidth, std::ceil(needed));

	const float left = hasIcon ? kTextLeftWithIcon : kTextLeft;
	BRect text(left, kTextTop, width - kTextRight, kTextTop + 10);
	fTextView->MoveTo(text.LeftTop());
	fTextView->ResizeTo(text.Width(), text.Height());
	fTextView->SetTextRect(text.OffsetToCopy(0, 0));
	float height = std::ceil(fTextView->TextHeight(0, fTextView->CountLines() - 1));
	if (hasIcon)
		height = std::max(height, kMinimumTextHeight);
	fTextView->ResizeTo(text.Width(), height);
	fTextView->SetTextRect(BRect(0, 0, text.Width(), height));
	ResizeTo(width, kTextTop + height + kTextBottom);

	// From the right to the left; the default button's ring reaches into the margins.
	float right = width - kButtonRight;
	for (int32 i = kMaximumButtons - 1; i >= 0; i--) {
		BButton* button = fButtons[i];
		if (button == NULL)
			continue;
		const float ring = button->IsDefault() ? BPrivate::Look::kDefaultButtonInset : 0;
		const BRect bounds = button->Bounds();
		if (i == 0 && fSpacing == B_OFFSET_SPACING && fButtons[1] != NULL)
			right -= kOffsetGap;
		button->MoveTo(
			right - bounds.Width(), Bounds().bottom - kButtonBottom + ring - bounds.Height());
		right -= bounds.Width() + kButtonGap;
	}
}


void
BAlert::_FindViews()
{
	fTextView = dynamic_cast<BTextView*>(FindView(kTextName));
	for (int32 i = 0; i < kMaximumButtons; i++)
		fButtons[i] = dynamic_cast<BButton*>(FindView(kButtonNames[i]));
}


BPoint
BAlert::AlertPosition(float width, float height)
{
	const BRect screen = BScreen().Frame();
	BPoint place(std::floor(screen.left + screen.Width() / 2 - width / 2),
		std::floor(screen.top + screen.Height() / 4 - std::ceil(height / 3)));
	place.x = std::max(place.x, screen.left);
	place.y = std::max(place.y, screen.top);
	return place;
}


// #pragma mark - running


int32
BAlert::Go()
{
	// The alert may end by itself, as when the application quits, so that only what is held here
	// is touched after it was shown.
	BLooper* looper = BLooper::LooperForThread(find_thread(NULL));
	BWindow* caller = dynamic_cast<BWindow*>(looper);
	const std::shared_ptr<Wait> wait =
		std::make_shared<Wait>(looper != NULL ? &BPrivate::LooperPrivate(looper).Activity() : NULL);
	const BMessenger self(this);
	fWait = wait;

	// An open menu of the caller would wait for its lock, and the user for the menu.
	if (caller != NULL && caller->LockingThread() == find_thread(NULL))
		BPrivate::MenuTracker::EndMenusOf(caller);
	Show();
	while (!wait->WaitForEnd(caller != NULL ? kRedrawInterval : B_INFINITE_TIMEOUT)) {
		if (caller != NULL)
			caller->UpdateIfNeeded();
	}

	if (self.LockTarget())
		Quit();
	return wait->result;
}


status_t
BAlert::Go(BInvoker* invoker)
{
	fInvoker.reset(invoker);
	Show();
	return B_OK;
}


void
BAlert::MessageReceived(BMessage* message)
{
	int32 which;
	if (message->what == kButtonPressed && message->FindInt32("which", &which) == B_OK)
		_Answer(which);
	else
		BWindow::MessageReceived(message);
}


void
BAlert::_Answer(int32 which)
{
	if (fWait != NULL) {
		fWait->result = which;
		fWait->End();
		return;
	}
	if (fInvoker != NULL && fInvoker->Message() != NULL) {
		BMessage message(*fInvoker->Message());
		message.AddInt32("which", which);
		fInvoker->Invoke(&message);
	}
	PostMessage(B_QUIT_REQUESTED);
}


bool
BAlert::QuitRequested()
{
	if (fWait == NULL)
		return true;
	// The waiting thread ends the alert.
	fWait->End();
	return false;
}


void
BAlert::Quit()
{
	if (fWait != NULL)
		fWait->End();
	BWindow::Quit();
}


void
BAlert::DispatchMessage(BMessage* message, BHandler* handler)
{
	if (message->what == B_KEY_DOWN && _HandleShortcut(message))
		return;
	BWindow::DispatchMessage(message, handler);
}


bool
BAlert::_HandleShortcut(BMessage* message)
{
	int8 byte;
	int32 modifiers;
	if (message->FindInt8("byte", &byte) != B_OK || byte == 0)
		return false;
	if (message->FindInt32("modifiers", &modifiers) == B_OK
		&& (modifiers & (B_COMMAND_KEY | B_CONTROL_KEY | B_OPTION_KEY | B_MENU_KEY)) != 0) {
		return false;
	}
	for (int32 i = 0; i < kMaximumButtons; i++) {
		if (fButtons[i] == NULL || fKeys[i] != byte)
			continue;
		const char space = B_SPACE;
		fButtons[i]->KeyDown(&space, 1);
		return true;
	}
	return false;
}


// #pragma mark - properties


void
BAlert::SetShortcut(int32 index, char key)
{
	if (index >= 0 && index < kMaximumButtons)
		fKeys[index] = key;
}


char
BAlert::Shortcut(int32 index) const
{
	return index >= 0 && index < kMaximumButtons ? fKeys[index] : 0;
}


BButton*
BAlert::ButtonAt(int32 index) const
{
	return index >= 0 && index < kMaximumButtons ? fButtons[index] : NULL;
}


BTextView*
BAlert::TextView() const
{
	return fTextView;
}


alert_type
BAlert::Type() const
{
	return fType;
}


void
BAlert::FrameResized(float newWidth, float newHeight)
{
	BWindow::FrameResized(newWidth, newHeight);
}


BHandler*
BAlert::ResolveSpecifier(
	BMessage* message, int32 index, BMessage* specifier, int32 what, const char* property)
{
	return BWindow::ResolveSpecifier(message, index, specifier, what, property);
}


status_t
BAlert::GetSupportedSuites(BMessage* message)
{
	return BWindow::GetSupportedSuites(message);
}


status_t
BAlert::Perform(perform_code code, void* data)
{
	return BWindow::Perform(code, data);
}
