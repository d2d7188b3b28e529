// NewFolderWindow: asks for the name of a new folder.
#pragma once

#include <Messenger.h>
#include <Window.h>

class BTextControl;

namespace BPrivate {

// Sends kPanelMakeFolder to the window that it stands before, and goes; closing it sends nothing.
class NewFolderWindow : public BWindow {
public:
	explicit NewFolderWindow(BWindow* panel);

	void MessageReceived(BMessage* message) override;

private:
	BMessenger fPanel;
	BTextControl* fName; // grandchild
};

} // namespace BPrivate
