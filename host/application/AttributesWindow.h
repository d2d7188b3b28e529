// AttributesWindow: asks for an item's type, number and name.
#pragma once

#include <Messenger.h>
#include <Window.h>

namespace BResEditor {
class BResourceItem;
}
class BTextControl;


// Sends kAttributesChosen to the target, which closes the window when it could do what it says.
class AttributesWindow : public BWindow {
public:
	// In the middle of `over`, in screen coordinates. The item is read here only.
	AttributesWindow(BRect over, const BMessenger& target, const BResEditor::BResourceItem* item);

	void MessageReceived(BMessage* message) override;

private:
	BTextControl* _AddField(const char* label, const char* text, int32 row);
	void _AddButtons();
	void _Send();

	BMessenger fTarget;
	BTextControl* fType; // children
	BTextControl* fID;
	BTextControl* fName;
};
