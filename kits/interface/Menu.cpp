#include "Menu.h"

#include <algorithm>
#include <mutex>

#include <Message.h>
#include <Window.h>

#include "interface/private/Look.h"
#include "interface/private/MenuTracker.h"
#include "interface/private/UnknownItem.h"
#include "interface/private/ViewArchive.h"

using namespace BPrivate;

namespace {

constexpr float kMarginLeft = 14;
constexpr float kMarginTop = 2;
constexpr float kMarginRight = 20;
constexpr float kMarginBottom = 0;

std::mutex sInfoLock;
menu_info* sInfo; // NULL until it is asked for

} // namespace


status_t
get_menu_info(menu_info* info)
{
	if (info == NULL)
		return B_BAD_VALUE;
	const std::lock_guard lock(sInfoLock);
	if (sInfo == NULL) {
		sInfo = new menu_info();
		sInfo->font_size = be_plain_font->Size();
		be_plain_font->GetFamilyAndStyle(&sInfo->f_family, &sInfo->f_style);
		sInfo->background_color = Look::MenuColor();
		sInfo->click_to_open = true;
	}
	*info = *sInfo;
	return B_OK;
}


// For the menus of this program that are made from now on.
status_t
set_menu_info(menu_info* info)
{
	menu_info present;
	if (info == NULL || get_menu_info(&present) != B_OK)
		return B_BAD_VALUE;
	const std::lock_guard lock(sInfoLock);
	*sInfo = *info;
	return B_OK;
}


BMenu::BMenu(const char* name, menu_layout layout) :
	BView(BRect(0, 0, 0, 0), name, B_FOLLOW_NONE, B_WILL_DRAW)
{
	_Init();
	fLayout = layout;
	fResizeToFit = true;
}


BMenu::BMenu(const char* name, float width, float height) :
	BView(BRect(0, 0, width, height), name, B_FOLLOW_NONE, B_WILL_DRAW)
{
	_Init();
	fLayout = B_ITEMS_IN_MATRIX;
	fResizeToFit = false;
	fMatrixSize = BPoint(width, height);
}


BMenu::BMenu(BRect frame, const char* name, uint32 resizingMode, uint32 flags, menu_layout layout,
	bool resizeToFit) :
	BView(frame, name, resizingMode, flags)
{
	_Init();
	fLayout = layout;
	fResizeToFit = resizeToFit;
	fMatrixSize = BPoint(frame.Width(), frame.Height());
}


BMenu::BMenu(BMessage* archive) : BView(archive)
{
	_Init();
	const auto read = [archive](const char* name) {
		bool value;
		return archive->FindBool(name, &value) == B_OK && value;
	};
	int32 number;
	fLayout = archive->FindInt32("_layout", &number) == B_OK ? menu_layout(number) : B_ITEMS_IN_ROW;
	fResizeToFit = read("_rsize_to_fit");
	fEnabled = !read("_disable");
	fRadioMode = read("_radio");
	fTriggersEnabled = !read("_trig_disabled");
	fLabelFromMarked = read("_dyn_label");
	if (archive->FindFloat("_maxwidth", &fMaxContentWidth) != B_OK)
		fMaxContentWidth = 0;
	fMatrixSize = BPoint(Bounds().Width(), Bounds().Height());
	_ReadItems(archive);
}


BMenu::~BMenu()
{
	_EndTracking();
	// An item that was taken out of its menu does not keep its submenu alive.
	if (fSuperitem != NULL)
		fSuperitem->fSubmenu = NULL;
	for (BMenuItem* item : fItems) {
		item->fSuper = NULL;
		delete item;
	}
}


BArchivable*
BMenu::Instantiate(BMessage* archive)
{
	return validate_instantiation(archive, "BMenu") ? new BMenu(archive) : NULL;
}


void
BMenu::_Init()
{
	fSuperitem = NULL;
	fSelected = NULL;
	fTracker = NULL;
	fInstalledWindow = NULL;
	fMarginLeft = kMarginLeft;
	fMarginTop = kMarginTop;
	fMarginRight = kMarginRight;
	fMarginBottom = kMarginBottom;
	fMaxContentWidth = 0;
	fTrackingHook = NULL;
	fTrackingState = NULL;
	fLayout = B_ITEMS_IN_ROW;
	fResizeToFit = true;
	fEnabled = true;
	fRadioMode = false;
	fLabelFromMarked = false;
	fTriggersEnabled = true;
	fShowTriggers = false;
	fLayoutValid = false;
	if (is_revived(this))
		return;
	BView::SetViewColor(B_TRANSPARENT_COLOR);
	BView::SetLowColor(Look::MenuColor());
}


// Items of classes that this program does not have are kept as they are.
void
BMenu::_ReadItems(BMessage* archive)
{
	BMessage itemArchive;
	for (int32 i = 0; archive->FindMessage("_items", i, &itemArchive) == B_OK; i++) {
		BArchivable* object = instantiate_object(&itemArchive);
		BMenuItem* item = dynamic_cast<BMenuItem*>(object);
		if (item == NULL) {
			delete object;
			item = new UnknownMenuItem(itemArchive);
		}
		BRect frame;
		if (archive->FindRect("_i_frames", i, &frame) == B_OK)
			item->fBounds = frame;
		item->fSuper = this;
		item->fIndex = i;
		fItems.push_back(item);
	}
}


status_t
BMenu::Archive(BMessage* archive, bool deep) const
{
	const status_t status = BView::Archive(archive, deep);
	if (status != B_OK)
		return status;

	ArchiveWriter writer(archive);
	writer.Int32("_layout", fLayout, B_ITEMS_IN_ROW, fLayout != B_ITEMS_IN_ROW);
	writer.Bool("_rsize_to_fit", fResizeToFit, false);
	writer.Bool("_disable", !fEnabled, false);
	writer.Bool("_radio", fRadioMode, false);
	writer.Bool("_trig_disabled", !fTriggersEnabled, false);
	writer.Bool("_dyn_label", fLabelFromMarked, false);
	writer.Float("_maxwidth", fMaxContentWidth, 0);
	for (BMenuItem* item : fItems) {
		if (!deep || writer.Status() != B_OK)
			break;
		BMessage itemArchive;
		const status_t itemStatus = item->Archive(&itemArchive, true);
		if (itemStatus != B_OK)
			return itemStatus;
		archive->AddMessage("_items", &itemArchive);
		if (fLayout == B_ITEMS_IN_MATRIX)
			archive->AddRect("_i_frames", item->fBounds);
	}
	return writer.Status();
}


// #pragma mark - hooks


void
BMenu::AttachedToWindow()
{
	BView::AttachedToWindow();
	if (fTracker != NULL)
		return;
	if (fSuperitem == NULL)
		_Install(Window());
	_ValidateLayout();
}


void
BMenu::DetachedFromWindow()
{
	// The tracker takes its menus out by itself; anybody else ends the tracking first.
	if (fTracker == NULL || Window() == fInstalledWindow) {
		_EndTracking();
		_Uninstall();
	}
	BView::DetachedFromWindow();
}


void
BMenu::AllAttached()
{
	BView::AllAttached();
}


void
BMenu::AllDetached()
{
	BView::AllDetached();
}


void
BMenu::MessageReceived(BMessage* message)
{
	BView::MessageReceived(message);
}


void
BMenu::KeyDown(const char* bytes, int32 numBytes)
{
	BView::KeyDown(bytes, numBytes);
}


void
BMenu::MouseDown(BPoint where)
{
	BView::MouseDown(where);
}


void
BMenu::MouseUp(BPoint where)
{
	BView::MouseUp(where);
}


void
BMenu::MouseMoved(BPoint where, uint32 code, const BMessage* message)
{
	BView::MouseMoved(where, code, message);
}


void
BMenu::MakeFocus(bool focus)
{
	BView::MakeFocus(focus);
}


void
BMenu::FrameMoved(BPoint newPosition)
{
	BView::FrameMoved(newPosition);
}


void
BMenu::FrameResized(float width, float height)
{
	BView::FrameResized(width, height);
}


status_t
BMenu::Perform(perform_code code, void* data)
{
	return BView::Perform(code, data);
}


// #pragma mark - tracking


// Beside the superitem, or below it when that lies in a bar.
BPoint
BMenu::ScreenLocation()
{
	BMenu* super = Supermenu();
	if (super == NULL) {
		debugger("BMenu can't determine where to draw."
				 "Override BMenu::ScreenLocation() to determine location.");
		return BPoint(0, 0);
	}
	const BRect frame = fSuperitem->fBounds;
	const BPoint corner = super->fLayout == B_ITEMS_IN_ROW ? BPoint(frame.left, frame.bottom + 1)
														   : BPoint(frame.right + 1, frame.top);
	return corner + super->fScreenOrigin;
}


void
BMenu::SetItemMargins(float left, float top, float right, float bottom)
{
	fMarginLeft = left;
	fMarginTop = top;
	fMarginRight = right;
	fMarginBottom = bottom;
	InvalidateLayout();
}


void
BMenu::GetItemMargins(float* _left, float* _top, float* _right, float* _bottom) const
{
	if (_left != NULL)
		*_left = fMarginLeft;
	if (_top != NULL)
		*_top = fMarginTop;
	if (_right != NULL)
		*_right = fMarginRight;
	if (_bottom != NULL)
		*_bottom = fMarginBottom;
}


menu_layout
BMenu::Layout() const
{
	return fLayout;
}


void
BMenu::Show()
{
	BView::Show();
}


void
BMenu::Show(bool)
{
	Show();
}


void
BMenu::Hide()
{
	BView::Hide();
}


BMenuItem*
BMenu::Track(bool startOpened, BRect* clickToOpenRect)
{
	MenuTracker::Request request;
	request.menu = this;
	request.where = ScreenLocation();
	request.useWhere = true;
	request.sticky = startOpened;
	if (clickToOpenRect != NULL) {
		request.clickToOpen = *clickToOpenRect;
		request.hasClickToOpen = true;
	}
	return MenuTracker::Track(request);
}


bool
BMenu::AddDynamicItem(add_state)
{
	return false;
}


void
BMenu::SetTrackingHook(menu_tracking_hook hook, void* state)
{
	fTrackingHook = hook;
	fTrackingState = state;
}


void
BMenu::_EndTracking()
{
	if (fTracker != NULL)
		fTracker->Abort();
}
