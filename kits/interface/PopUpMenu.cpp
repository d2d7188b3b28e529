#include "PopUpMenu.h"

#include <cmath>

#include <Message.h>

#include "interface/private/MenuTracker.h"
#include "interface/private/MenuWindow.h"
#include "interface/private/ViewArchive.h"

using namespace BPrivate;


BPopUpMenu::BPopUpMenu(const char* name, bool radioMode, bool labelFromMarked, menu_layout layout) :
	BMenu(name, layout), fAutoDestruct(false)
{
	if (radioMode)
		SetRadioMode(true);
	if (labelFromMarked)
		SetLabelFromMarked(true);
}


BPopUpMenu::BPopUpMenu(BMessage* archive) : BMenu(archive), fAutoDestruct(false)
{
}


BPopUpMenu::~BPopUpMenu()
{
	_EndTracking();
}


BArchivable*
BPopUpMenu::Instantiate(BMessage* archive)
{
	return validate_instantiation(archive, "BPopUpMenu") ? new BPopUpMenu(archive) : NULL;
}


status_t
BPopUpMenu::Archive(BMessage* archive, bool deep) const
{
	return BMenu::Archive(archive, deep);
}


BMenuItem*
BPopUpMenu::Go(BPoint where, bool deliversMessage, bool openAnyway, bool async)
{
	return _Go(where, deliversMessage, openAnyway, NULL, async);
}


BMenuItem*
BPopUpMenu::Go(
	BPoint where, bool deliversMessage, bool openAnyway, BRect clickToOpenRect, bool async)
{
	return _Go(where, deliversMessage, openAnyway, &clickToOpenRect, async);
}


BMenuItem*
BPopUpMenu::_Go(
	BPoint where, bool deliversMessage, bool openAnyway, BRect* clickToOpenRect, bool async)
{
	MenuTracker::Request request;
	request.menu = this;
	request.where = where;
	request.useWhere = true;
	request.sticky = openAnyway;
	request.deliver = deliversMessage;
	if (clickToOpenRect != NULL) {
		request.hasClickToOpen = true;
		request.clickToOpen = *clickToOpenRect;
	}
	if (!async)
		return MenuTracker::Track(request);
	request.autoDestruct = fAutoDestruct;
	MenuTracker::Start(request);
	return NULL;
}


void
BPopUpMenu::SetAsyncAutoDestruct(bool on)
{
	fAutoDestruct = on;
}


bool
BPopUpMenu::AsyncAutoDestruct() const
{
	return fAutoDestruct;
}


// The marked item, or the first one, comes to lie over the label that opened the menu.
BPoint
BPopUpMenu::ScreenLocation()
{
	BMenuItem* superitem = Superitem();
	BMenu* supermenu = Supermenu();
	if (superitem == NULL || supermenu == NULL)
		return BMenu::ScreenLocation();
	if (supermenu->Layout() != B_ITEMS_IN_ROW)
		return BMenu::ScreenLocation();

	// Both labels lie on each other, on one baseline.
	float left, top, superLeft;
	GetItemMargins(&left, &top, NULL, NULL);
	supermenu->GetItemMargins(&superLeft, NULL, NULL, NULL);
	font_height height;
	supermenu->GetFontHeight(&height);
	const BRect label = superitem->Frame();
	const float text = std::ceil(height.ascent) + std::ceil(height.descent);
	BPoint where = label.LeftTop() + supermenu->fScreenOrigin;
	where.x += superLeft - left - MenuWindow::kBorder;
	where.y += std::floor((label.Height() + 1 - text) / 2) - top - MenuWindow::kBorder;
	if (BMenuItem* marked = FindMarked())
		where.y -= marked->Frame().top;
	return where;
}


// #pragma mark - hooks


void
BPopUpMenu::MessageReceived(BMessage* message)
{
	BMenu::MessageReceived(message);
}


void
BPopUpMenu::MouseDown(BPoint where)
{
	BMenu::MouseDown(where);
}


void
BPopUpMenu::MouseUp(BPoint where)
{
	BMenu::MouseUp(where);
}


void
BPopUpMenu::MouseMoved(BPoint where, uint32 code, const BMessage* message)
{
	BMenu::MouseMoved(where, code, message);
}


void
BPopUpMenu::AttachedToWindow()
{
	BMenu::AttachedToWindow();
}


void
BPopUpMenu::DetachedFromWindow()
{
	BMenu::DetachedFromWindow();
}


void
BPopUpMenu::FrameMoved(BPoint newPosition)
{
	BMenu::FrameMoved(newPosition);
}


void
BPopUpMenu::FrameResized(float width, float height)
{
	BMenu::FrameResized(width, height);
}


BHandler*
BPopUpMenu::ResolveSpecifier(
	BMessage* message, int32 index, BMessage* specifier, int32 form, const char* property)
{
	return BMenu::ResolveSpecifier(message, index, specifier, form, property);
}


status_t
BPopUpMenu::GetSupportedSuites(BMessage* data)
{
	return BMenu::GetSupportedSuites(data);
}


status_t
BPopUpMenu::Perform(perform_code code, void* data)
{
	return BMenu::Perform(code, data);
}


void
BPopUpMenu::ResizeToPreferred()
{
	BMenu::ResizeToPreferred();
}


void
BPopUpMenu::GetPreferredSize(float* _width, float* _height)
{
	BMenu::GetPreferredSize(_width, _height);
}


void
BPopUpMenu::MakeFocus(bool focus)
{
	BMenu::MakeFocus(focus);
}


void
BPopUpMenu::AllAttached()
{
	BMenu::AllAttached();
}


void
BPopUpMenu::AllDetached()
{
	BMenu::AllDetached();
}
