// BMenuField: what it shows and what programs ask of it.
#include "MenuField.h"

#include <algorithm>
#include <cmath>
#include <cstdlib>
#include <cstring>

#include <MenuBar.h>
#include <MenuItem.h>
#include <Message.h>
#include <Window.h>

#include "interface/private/Look.h"
#include "interface/private/MenuFieldBar.h"
#include "interface/private/MenuTracker.h"
#include "interface/private/ViewArchive.h"

using namespace BPrivate;


BMenu*
BMenuField::Menu() const
{
	const BMenuBar* bar = MenuBar();
	return bar != NULL ? bar->SubmenuAt(0) : NULL;
}


BMenuItem*
BMenuField::MenuItem() const
{
	const BMenuBar* bar = MenuBar();
	return bar != NULL ? bar->ItemAt(0) : NULL;
}


void
BMenuField::SetLabel(const char* label)
{
	if (fLabel != NULL && label != NULL && strcmp(fLabel, label) == 0)
		return;
	char* copy = label != NULL ? strdup(label) : NULL;
	free(fLabel);
	fLabel = copy;
	Invalidate();
}


const char*
BMenuField::Label() const
{
	return fLabel;
}


void
BMenuField::SetEnabled(bool enabled)
{
	if (fEnabled == enabled)
		return;
	fEnabled = enabled;
	if (BMenuBar* bar = MenuBar()) {
		bar->SetEnabled(enabled);
		bar->Invalidate();
	}
	Invalidate();
}


bool
BMenuField::IsEnabled() const
{
	return fEnabled;
}


void
BMenuField::SetAlignment(alignment label)
{
	fAlignment = label;
}


alignment
BMenuField::Alignment() const
{
	return fAlignment;
}


void
BMenuField::ShowPopUpMarker()
{
	fPopUpMarker = true;
	if (BMenuBar* bar = MenuBar())
		bar->Invalidate();
}


void
BMenuField::HidePopUpMarker()
{
	fPopUpMarker = false;
	if (BMenuBar* bar = MenuBar())
		bar->Invalidate();
}


BHandler*
BMenuField::ResolveSpecifier(
	BMessage* message, int32 index, BMessage* specifier, int32 form, const char* property)
{
	return BView::ResolveSpecifier(message, index, specifier, form, property);
}


status_t
BMenuField::GetSupportedSuites(BMessage* data)
{
	return BView::GetSupportedSuites(data);
}


status_t
BMenuField::Perform(perform_code code, void* data)
{
	return BView::Perform(code, data);
}
