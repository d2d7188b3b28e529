// Any message as the archive of a view: revived, shown in a window, and archived again. Whatever it
// is, looking at it changes nothing, unknown fields stay, and what was written is read and written
// the same. (That a sound archive is written as it was read, the tests of the samples show.)

#include <stdio.h>
#include <stdlib.h>
#include <string.h>

#include <memory>

#include <Application.h>
#include <Autolock.h>
#include <Message.h>
#include <MessageForm.h>
#include <OS.h>
#include <Slider.h>
#include <View.h>
#include <Window.h>

#include "archive/ViewArchive.h"
#include "tests/support/Dump.h"

namespace {

void
Require(bool holds, const char* what)
{
	if (holds)
		return;
	fprintf(stderr, "not so: %s\n", what);
	abort();
}


constexpr uint32 kLook = 'look';


// Shows a view for the length of an update, which only its own thread can make.
class StageWindow : public BWindow {
public:
	StageWindow() : BWindow(BRect(0, 0, 119, 89), "stage", B_TITLED_WINDOW, 0) {}

	void MessageReceived(BMessage* message) override
	{
		if (message->what == kLook) {
			Show(fView, true);
			release_sem(fDone);
		} else
			BWindow::MessageReceived(message);
	}

	void Show(BView* view, bool update)
	{
		AddChild(view);
		if (update)
			UpdateIfNeeded();
		Require(view->RemoveSelf(), "a view leaves its window");
	}

	void ShowAndWait(BView* view)
	{
		fView = view;
		PostMessage(kLook);
		Require(acquire_sem(fDone) == B_OK, "the window answers");
	}

	using BWindow::Show;

private:
	BView* fView = NULL; // borrowed, while it is shown
	const sem_id fDone = create_sem(0, "shown");
};


// One window for all runs, never deleted: an application ends with the process.
StageWindow*
Stage()
{
	static StageWindow* sWindow = NULL;
	if (sWindow == NULL) {
		setenv("ARCHWAY_BACKEND", "headless", 0);
		setenv("QT_QPA_PLATFORM", "offscreen", 0);
		new BApplication("application/x-vnd.Archway-fuzzer");
		sWindow = new StageWindow;
		sWindow->Show();
	}
	return sWindow;
}


void
RequireEqual(const BMessage& expected, const BMessage& given, const char* what)
{
	if (Equal(&expected, &given))
		return;
	fprintf(stderr, "archive%s\n", test::first_difference(expected, given).c_str());
	Require(false, what);
}


// The fields that no class knows.
void
RequireStrangers(const BMessage& read, const BMessage& written)
{
	BMessage before;
	BMessage after;
	for (const BMessage* message : { &read, &written }) {
		char* name;
		type_code type;
		for (int32 i = 0; message->GetInfo(B_ANY_TYPE, i, &name, &type) == B_OK; i++) {
			if (strncmp(name, "stranger", 8) != 0)
				continue;
			const void* data;
			ssize_t size;
			for (int32 k = 0; find_field_data(*message, i, k, &data, &size) == B_OK; k++)
				(message == &read ? before : after).AddData(name, type, data, size, false);
		}
	}
	RequireEqual(before, after, "unknown fields are written back");
}


std::unique_ptr<BView>
Revive(BMessage* archive)
{
	BArchivable* object = InstantiateAsChild(archive);
	BView* view = dynamic_cast<BView*>(object);
	if (view == NULL)
		delete object;
	return std::unique_ptr<BView>(view);
}


BMessage
ArchiveOf(const BView& view, uint32 what)
{
	BMessage archive(what);
	Require(view.Archive(&archive) == B_OK, "a view can be archived");
	archive.what = what;
	return archive;
}


// Painting takes longer than all the rest, so not everything is painted.
void
Show(BView* view, bool update)
{
	if (update) {
		Stage()->ShowAndWait(view);
		return;
	}
	const BAutolock lock(Stage());
	Stage()->Show(view, false);
}


// What an editor may do to any view.
void
Change(BView* view)
{
	view->SetName("changed");
	view->MoveBy(1, 2);
	view->SetFlags(view->Flags() ^ B_NAVIGABLE);
	view->SetResizingMode(B_FOLLOW_ALL);
	view->SetEventMask(B_POINTER_EVENTS, B_NO_POINTER_HISTORY);
	view->SetViewColor(1, 2, 3);
	view->SetHighColor(4, 5, 6);
	view->SetFontSize(view->Bounds().Width() > 20 ? 13 : 14);
	view->SetOrigin(3, 4);
	view->SetScale(1.5f);
	view->SetPenSize(7);
	view->MovePenTo(5, 6);
	view->SetLineMode(B_ROUND_CAP, B_BEVEL_JOIN, 5);
	view->SetBlendingMode(B_CONSTANT_ALPHA, B_ALPHA_COMPOSITE);
	view->SetDrawingMode(B_OP_BLEND);
	view->Hide();
	if (BSlider* slider = dynamic_cast<BSlider*>(view)) {
		const rgb_color color = { 7, 8, 9, 255 };
		slider->UseFillColor(true, &color);
		slider->SetStyle(slider->Style() == B_BLOCK_THUMB ? B_TRIANGLE_THUMB : B_BLOCK_THUMB);
	}
}


// What was changed is read as it was written, too, and what was unknown is still there.
void
RequireChanges(BView* view, const BMessage& read, uint32 what)
{
	Change(view);
	BMessage changed = ArchiveOf(*view, what);
	RequireStrangers(read, changed);
	const BMessage expected(changed);
	const std::unique_ptr<BView> third = Revive(&changed);
	Require(third != NULL, "what was changed can be revived");
	Show(third.get(), false);
	RequireEqual(expected, ArchiveOf(*third, what), "what was changed is read and written");
}

} // namespace


extern "C" int
LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
	BMessage archive;
	if (unflatten_message(&archive, data, size) != B_OK)
		return 0;
	const uint32 what = archive.what;
	SwapInheritedViews(&archive, 0);
	find_instantiation_func(&archive);
	Stage();

	BMessage read(archive);
	const std::unique_ptr<BView> view = Revive(&archive);
	RequireEqual(read, archive, "reviving leaves the archive as it is");
	if (view == NULL)
		return 0;
	BMessage written = ArchiveOf(*view, what);
	RequireStrangers(read, written);

	Show(view.get(), size % 4 == 0);
	BMessage shown = ArchiveOf(*view, what);
	// What a class makes that its archive lacks looks for its colours when it is shown.
	if (Equal(&read, &written))
		RequireEqual(written, shown, "showing changes nothing");

	const BMessage expected(shown);
	const std::unique_ptr<BView> second = Revive(&shown);
	Require(second != NULL, "what was written can be revived");
	Show(second.get(), size % 8 == 0);
	const BMessage again = ArchiveOf(*second, what);
	RequireEqual(expected, again, "what was written is read and written");
	// Fields of types that nobody writes there may come and go with what they should have told.
	if (size % 4 == 1 && Equal(&read, &expected))
		RequireChanges(second.get(), read, what);
	return 0;
}
