// PathWindow: asks for the path of a file.
#pragma once

#include <Messenger.h>
#include <Window.h>

class BTextControl;


// Sends kPathChosen with the string "path" to the target and goes; closing it sends nothing.
class PathWindow : public BWindow {
public:
	PathWindow(const char* title, const char* action, const char* path, const BMessenger& target);

	void MessageReceived(BMessage* message) override;

private:
	BTextControl* fPathControl; // grandchild
	BMessenger fTarget;
};
