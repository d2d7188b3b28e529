#include "MenuBar.h"

#include <cmath>

#include <Message.h>
#include <Window.h>

#include "interface/private/Look.h"
#include "interface/private/MenuBarKeys.h"
#include "interface/private/MenuCodes.h"
#include "interface/private/MenuTracker.h"
#include "interface/private/ViewArchive.h"

using namespace BPrivate;

namespace {

constexpr float kMarginLeft = 8;
constexpr float kMarginTop = 2;
constexpr float kMarginRight = 8;
constexpr float kMarginBottom = 2;
constexpr uint32 kForcedFlags = B_WILL_DRAW | B_FRAME_EVENTS | B_FULL_UPDATE_ON_RESIZE;

} // namespace


BMenuBar::BMenuBar(
	BRect frame, const char* name, uint32 resizingMode, menu_layout layout, bool resizeToFit) :
	BMenu(frame, name, resizingMode, kForcedFlags, layout, resizeToFit),
	fBorder(B_BORDER_FRAME)
{
	SetItemMargins(kMarginLeft, kMarginTop, kMarginRight, kMarginBottom);
}


BMenuBar::BMenuBar(BMessage* archive) : BMenu(archive)
{
	int32 border;
	fBorder =
		archive->FindInt32("_border", &border) == B_OK ? menu_bar_border(border) : B_BORDER_FRAME;
	SetItemMargins(kMarginLeft, kMarginTop, kMarginRight, kMarginBottom);
}


BMenuBar::~BMenuBar()
{
	_EndTracking();
}


BArchivable*
BMenuBar::Instantiate(BMessage* archive)
{
	return validate_instantiation(archive, "BMenuBar") ? new BMenuBar(archive) : NULL;
}


status_t
BMenuBar::Archive(BMessage* archive, bool deep) const
{
	const status_t status = BMenu::Archive(archive, deep);
	if (status != B_OK)
		return status;
	ArchiveWriter writer(archive);
	writer.Int32("_border", fBorder, B_BORDER_FRAME, fBorder != B_BORDER_FRAME);
	return writer.Status();
}


void
BMenuBar::SetBorder(menu_bar_border border)
{
	fBorder = border;
}


menu_bar_border
BMenuBar::Border() const
{
	return fBorder;
}


void
BMenuBar::Draw(BRect updateRect)
{
	BMenu::Draw(updateRect);
	PushState();
	if (fBorder == B_BORDER_FRAME) {
		Look::DrawMenuBarFrame(this, Bounds(), LowColor());
	} else if (fBorder == B_BORDER_CONTENTS) {
		float width, height;
		BMenu::GetPreferredSize(&width, &height);
		Look::DrawMenuBarFrame(this, BRect(0, 0, width, height), LowColor());
	} else {
		for (int32 i = 0; i < CountItems(); i++)
			Look::DrawMenuBarFrame(this, ItemAt(i)->Frame(), LowColor());
	}
	PopState();
}


void
BMenuBar::AttachedToWindow()
{
	BMenu::AttachedToWindow();
	Window()->SetKeyMenuBar(this);
	if (!is_revived(this))
		_FitToItems();
}


void
BMenuBar::DetachedFromWindow()
{
	BMenu::DetachedFromWindow();
}


void
BMenuBar::MessageReceived(BMessage* message)
{
	if (message->what == kMenusEnded) {
		if (Window() != NULL)
			Window()->MenusEnded();
		return;
	}
	BMenu::MessageReceived(message);
}


// A press opens the menu that it hits; what follows is the tracker's.
void
BMenuBar::MouseDown(BPoint where)
{
	BWindow* window = Window();
	if (window == NULL || fTracker != NULL || !IsEnabled())
		return;
	if (!window->IsActive()) {
		window->Activate();
		window->UpdateIfNeeded();
	}
	BMenuItem* item = _ItemAtPoint(where);
	if (item == NULL || !item->IsEnabled())
		return;
	MenuTracker::Request request;
	request.bar = this;
	request.barItem = item;
	request.staysOnClick = true;
	request.deliver = true;
	MenuTracker::Start(request);
}


void
BMenuBar::_OpenByKey()
{
	if (fTracker != NULL || !IsEnabled())
		return;
	BMenuItem* item = _NextItem(NULL, true);
	if (item == NULL)
		return;
	MenuTracker::Request request;
	request.bar = this;
	request.barItem = item;
	request.sticky = true;
	request.byKey = true;
	request.deliver = true;
	MenuTracker::Start(request);
}


namespace BPrivate {

void
MenuKeys::Open(BMenuBar* bar)
{
	bar->_OpenByKey();
}

} // namespace BPrivate


void
BMenuBar::WindowActivated(bool active)
{
	BMenu::WindowActivated(active);
}


void
BMenuBar::MouseUp(BPoint where)
{
	BMenu::MouseUp(where);
}


void
BMenuBar::FrameMoved(BPoint newPosition)
{
	BMenu::FrameMoved(newPosition);
}


void
BMenuBar::FrameResized(float width, float height)
{
	BMenu::FrameResized(width, height);
}


void
BMenuBar::Show()
{
	BView::Show();
}


void
BMenuBar::Hide()
{
	BView::Hide();
}


BHandler*
BMenuBar::ResolveSpecifier(
	BMessage* message, int32 index, BMessage* specifier, int32 form, const char* property)
{
	return BMenu::ResolveSpecifier(message, index, specifier, form, property);
}


status_t
BMenuBar::GetSupportedSuites(BMessage* data)
{
	return BMenu::GetSupportedSuites(data);
}


void
BMenuBar::ResizeToPreferred()
{
	BMenu::ResizeToPreferred();
}


// As wide as its parent if it follows both of its sides.
void
BMenuBar::GetPreferredSize(float* _width, float* _height)
{
	float width, height;
	BMenu::GetPreferredSize(&width, &height);
	if ((ResizingMode() & B_FOLLOW_LEFT_RIGHT) == B_FOLLOW_LEFT_RIGHT && Window() != NULL)
		width = Parent() != NULL ? Parent()->Bounds().Width() : Window()->Bounds().Width();
	if (_width != NULL)
		*_width = width;
	if (_height != NULL)
		*_height = height;
}


void
BMenuBar::MakeFocus(bool focus)
{
	BMenu::MakeFocus(focus);
}


void
BMenuBar::AllAttached()
{
	BMenu::AllAttached();
}


void
BMenuBar::AllDetached()
{
	BMenu::AllDetached();
}


status_t
BMenuBar::Perform(perform_code code, void* data)
{
	return BMenu::Perform(code, data);
}


void
BMenuBar::_LayoutChanged()
{
	if (!is_revived(this))
		_FitToItems();
}


void
BMenuBar::_FitToItems()
{
	if (!fResizeToFit)
		return;
	float width, height;
	GetPreferredSize(&width, &height);
	ResizeTo(width, height);
}
