// The views of bitmaps that accept them.
#include <Bitmap.h>

#include <View.h>
#include <Window.h>

#include "interface/private/BitmapAccess.h"
#include "interface/private/OffscreenWindow.h"

using namespace BPrivate;


void
BBitmap::AddChild(BView* view)
{
	if (fWindow != NULL)
		fWindow->AddChild(view);
}


bool
BBitmap::RemoveChild(BView* view)
{
	return fWindow != NULL && fWindow->RemoveChild(view);
}


int32
BBitmap::CountChildren() const
{
	return fWindow != NULL ? fWindow->CountChildren() : 0;
}


BView*
BBitmap::ChildAt(int32 index) const
{
	return fWindow != NULL ? fWindow->ChildAt(index) : NULL;
}


BView*
BBitmap::FindView(const char* viewName) const
{
	return fWindow != NULL ? fWindow->FindView(viewName) : NULL;
}


BView*
BBitmap::FindView(BPoint point) const
{
	return fWindow != NULL ? fWindow->FindView(point) : NULL;
}


bool
BBitmap::Lock()
{
	return fWindow != NULL && fWindow->Lock();
}


void
BBitmap::Unlock()
{
	if (fWindow == NULL)
		return;
	_StoreSurface();
	fWindow->Unlock();
}


bool
BBitmap::IsLocked() const
{
	return fWindow != NULL && fWindow->IsLocked();
}
