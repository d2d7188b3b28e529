// EditInherited: the panel for the class name of a placeholder.
#pragma once

#include "editors/EditorInterface.h"

class BTextControl;
class LayoutInherited;


class EditInherited : public EditorInterface {
public:
	EditInherited();
	~EditInherited() override;

	// The name that is typed shows when the placeholder is drawn again; nothing is locked or
	// invalidated for it.
	void MessageReceived(BMessage* message) override;
	bool UseView(BView* view) override;

private:
	BTextControl* fClassNameControl;
};
