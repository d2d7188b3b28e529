#include "archive/ViewWatch.h"

#include <Looper.h>
#include <View.h>


void
ViewWatch::Set(BView* view)
{
	fView = view;
	fMessenger = view != nullptr ? BMessenger(view) : BMessenger();
}


BView*
ViewWatch::View() const
{
	if (fView == nullptr)
		return nullptr;

	BLooper* looper;
	return fMessenger.Target(&looper) == fView ? fView : nullptr;
}
