#include <FilePanel.h>

#include <Directory.h>
#include <Looper.h>
#include <Path.h>

#include "storage/private/FilePanelWindow.h"

using namespace BPrivate;

namespace {


// Holds the panel's window, if it has not been ended yet.
class WindowLock {
public:
	explicit WindowLock(const BMessenger& window) : fLooper(nullptr)
	{
		if (window.LockTarget())
			window.Target(&fLooper);
	}

	~WindowLock()
	{
		if (fLooper != nullptr)
			fLooper->Unlock();
	}

	explicit operator bool() const { return fLooper != nullptr; }

private:
	WindowLock(const WindowLock&) = delete;
	WindowLock& operator=(const WindowLock&) = delete;

	BLooper* fLooper; // borrowed
};


} // namespace


BRefFilter::~BRefFilter()
{
}


BFilePanel::BFilePanel(file_panel_mode mode, BMessenger* target, const entry_ref* directory,
	uint32 nodeFlavors, bool allowMultipleSelection, BMessage* message, BRefFilter* filter,
	bool modal, bool hideWhenDone)
{
	FilePanelWindow::Setup setup;
	setup.mode = mode;
	setup.flavors = nodeFlavors != 0 ? nodeFlavors : static_cast<uint32>(B_FILE_NODE);
	setup.manyFiles = allowMultipleSelection;
	setup.modal = modal;
	setup.hideWhenDone = hideWhenDone;
	setup.filter = filter;
	if (target != NULL)
		setup.target = *target;
	const BPath path = directory != NULL ? BPath(directory) : BPath(".");
	setup.folder = path.InitCheck() == B_OK ? path.Path() : "/";

	fWindow = new FilePanelWindow(this, setup);
	fWindow->SetMessage(message);
	fWindowMessenger = BMessenger(fWindow);
	// One Show() too few to be seen: it starts the window's thread and lets go of its lock.
	fWindow->Hide();
	fWindow->Show();
}


BFilePanel::~BFilePanel()
{
	if (fWindowMessenger.LockTarget())
		fWindow->Quit();
}


void
BFilePanel::Show()
{
	if (WindowLock lock { fWindowMessenger })
		fWindow->ShowPanel();
}


void
BFilePanel::Hide()
{
	if (WindowLock lock { fWindowMessenger })
		fWindow->HidePanel();
}


bool
BFilePanel::IsShowing() const
{
	WindowLock lock { fWindowMessenger };
	return lock && !fWindow->IsHidden();
}


void
BFilePanel::WasHidden()
{
}


void
BFilePanel::SelectionChanged()
{
}


void
BFilePanel::SendMessage(const BMessenger* target, BMessage* message)
{
	target->SendMessage(message);
}


BWindow*
BFilePanel::Window() const
{
	return fWindowMessenger.IsValid() ? fWindow : NULL;
}


BMessenger
BFilePanel::Messenger() const
{
	WindowLock lock { fWindowMessenger };
	return lock ? fWindow->Target() : BMessenger();
}


BRefFilter*
BFilePanel::RefFilter() const
{
	WindowLock lock { fWindowMessenger };
	return lock ? fWindow->Filter() : NULL;
}


file_panel_mode
BFilePanel::PanelMode() const
{
	WindowLock lock { fWindowMessenger };
	return lock ? fWindow->Mode() : B_OPEN_PANEL;
}


void
BFilePanel::SetTarget(BMessenger target)
{
	if (WindowLock lock { fWindowMessenger })
		fWindow->SetTarget(target);
}


void
BFilePanel::SetMessage(BMessage* message)
{
	if (WindowLock lock { fWindowMessenger })
		fWindow->SetMessage(message);
}


void
BFilePanel::Refresh()
{
	if (WindowLock lock { fWindowMessenger })
		fWindow->Refresh();
}


void
BFilePanel::SetRefFilter(BRefFilter* filter)
{
	if (WindowLock lock { fWindowMessenger })
		fWindow->SetFilter(filter);
}


void
BFilePanel::SetSaveText(const char* text)
{
	if (WindowLock lock { fWindowMessenger })
		fWindow->SetName(text != NULL ? text : "");
}


void
BFilePanel::SetButtonLabel(file_panel_button button, const char* label)
{
	if (WindowLock lock { fWindowMessenger })
		fWindow->SetButtonLabel(button, label);
}


void
BFilePanel::SetPanelDirectory(const BEntry* directory)
{
	const BPath path(directory);
	SetPanelDirectory(path.Path());
}


void
BFilePanel::SetPanelDirectory(const BDirectory* directory)
{
	const BPath path(directory, NULL);
	SetPanelDirectory(path.Path());
}


void
BFilePanel::SetPanelDirectory(const entry_ref* directory)
{
	const BPath path(directory);
	SetPanelDirectory(path.Path());
}


void
BFilePanel::SetPanelDirectory(const char* directory)
{
	const BPath path(directory);
	if (WindowLock lock { fWindowMessenger }; lock && path.InitCheck() == B_OK)
		fWindow->GoTo(path.Path());
}


void
BFilePanel::GetPanelDirectory(entry_ref* _ref) const
{
	if (WindowLock lock { fWindowMessenger })
		get_ref_for_path(fWindow->Folder().c_str(), _ref);
}


void
BFilePanel::SetHideWhenDone(bool hide)
{
	if (WindowLock lock { fWindowMessenger })
		fWindow->SetHideWhenDone(hide);
}


bool
BFilePanel::HidesWhenDone() const
{
	WindowLock lock { fWindowMessenger };
	return lock && fWindow->HidesWhenDone();
}


void
BFilePanel::Rewind()
{
	if (WindowLock lock { fWindowMessenger })
		fWindow->Rewind();
}


status_t
BFilePanel::GetNextSelectedRef(entry_ref* _ref)
{
	WindowLock lock { fWindowMessenger };
	return lock ? fWindow->GetNextSelectedRef(_ref) : B_ERROR;
}
