#include "editors/TargetLock.h"

#include <View.h>
#include <Window.h>


TargetLock::TargetLock(BView* view) : fWindow(view != nullptr ? view->Window() : nullptr)
{
	if (fWindow != nullptr && !fWindow->Lock())
		fWindow = nullptr;
}


TargetLock::~TargetLock()
{
	if (fWindow != nullptr)
		fWindow->Unlock();
}
