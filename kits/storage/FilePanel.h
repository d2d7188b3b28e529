// BFilePanel: the window in which the user chooses files to open, or where to save one.
#pragma once

#include <sys/stat.h>

#include <BeBuild.h>
#include <Directory.h>
#include <Entry.h>
#include <Messenger.h>
#include <StorageDefs.h>

class BDirectory;
class BEntry;
class BMessage;
class BNode;
class BWindow;

namespace BPrivate {
class FilePanelWindow;
}

enum file_panel_mode { B_OPEN_PANEL, B_SAVE_PANEL };
enum file_panel_button { B_CANCEL_BUTTON, B_DEFAULT_BUTTON };


// Decides what a panel lists.
class _EXPORT BRefFilter {
public:
	virtual ~BRefFilter();

	// Called in the panel's thread for everything in a folder, folders included; false hides it.
	// The type is "" where it is not known.
	virtual bool Filter(
		const entry_ref* ref, BNode* node, struct stat* stat, const char* mimeType) = 0;
};


// The panel's window has a thread of its own and is hidden at first. What the user chose is sent
// to the target: B_REFS_RECEIVED with "refs", or B_SAVE_REQUESTED with "directory" (a ref) and
// "name", or the given message with those fields added. A user who gives up makes it send B_CANCEL
// with int32 "old_what", the code of that message, and the pointer "source", the panel.
//
// Any thread may call the functions; they lock the window. A panel is not deleted from its own
// hooks. When the application has ended the window, every call does nothing.
class _EXPORT BFilePanel {
public:
	// Without a target the application gets the messages; without a folder it is the current one.
	// `nodeFlavors` says what an open panel chooses, 0 meaning files; folders can be entered in
	// any case. Target, ref and message are copied, the filter stays the caller's.
	BFilePanel(file_panel_mode mode = B_OPEN_PANEL, BMessenger* target = NULL,
		const entry_ref* directory = NULL, uint32 nodeFlavors = 0,
		bool allowMultipleSelection = true, BMessage* message = NULL, BRefFilter* filter = NULL,
		bool modal = false, bool hideWhenDone = true);
	virtual ~BFilePanel();

	// Showing a panel that is shown brings it to the front. Hide() tells nobody.
	void Show();
	void Hide();
	bool IsShowing() const;

	// The user's choice or cancelling has hidden the panel.
	virtual void WasHidden();
	// The user has selected something else: see GetNextSelectedRef().
	virtual void SelectionChanged();
	// Passes on every message that the panel sends.
	virtual void SendMessage(const BMessenger* target, BMessage* message);

	BWindow* Window() const;
	BMessenger Messenger() const;
	BRefFilter* RefFilter() const;
	file_panel_mode PanelMode() const;

	void SetTarget(BMessenger target);
	void SetMessage(BMessage* message); // copied; NULL is the mode's own message
	// Reads the folder again. Done by the panel itself when its window becomes active.
	void Refresh();
	void SetRefFilter(BRefFilter* filter);
	void SetSaveText(const char* text);
	void SetButtonLabel(file_panel_button button, const char* label);

	void SetPanelDirectory(const BEntry* directory);
	void SetPanelDirectory(const BDirectory* directory);
	void SetPanelDirectory(const entry_ref* directory);
	void SetPanelDirectory(const char* directory);
	void GetPanelDirectory(entry_ref* _ref) const;

	void SetHideWhenDone(bool hide);
	bool HidesWhenDone() const;

	void Rewind();
	// B_ENTRY_NOT_FOUND after the last one.
	status_t GetNextSelectedRef(entry_ref* _ref);

private:
	friend class BPrivate::FilePanelWindow;

	BFilePanel(const BFilePanel&) = delete;
	BFilePanel& operator=(const BFilePanel&) = delete;

	BPrivate::FilePanelWindow* fWindow; // ended by the destructor, or by the application
	BMessenger fWindowMessenger; // knows whether the window is still there
};
