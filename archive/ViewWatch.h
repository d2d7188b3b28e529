// ViewWatch: remembers a view and knows, without touching it, whether it still exists.
#pragma once

#include <Messenger.h>

class BView;


// Meant for pointers that outlive a dispatch, such as a selection: an address alone may meanwhile
// belong to another object. The view must be attached when it is set. Use it in its window's
// thread.
class ViewWatch {
public:
	void Set(BView* view); // NULL for none

	// NULL when the view is gone or none was set.
	BView* View() const;

private:
	BView* fView = nullptr; // borrowed, perhaps gone
	BMessenger fMessenger; // names the view by a token that is not used again
};
