#include "ListView.h"

#include <algorithm>

#include <AppDefs.h>
#include <Message.h>
#include <Messenger.h>
#include <ScrollView.h>
#include <Window.h>

#include "interface/private/ListViewPrivate.h"
#include "interface/private/Look.h"
#include "interface/private/UnknownItem.h"
#include "interface/private/ViewArchive.h"

using namespace BPrivate;


BListView::BListView(
	BRect frame, const char* name, list_view_type type, uint32 resizingMode, uint32 flags) :
	BView(frame, name, resizingMode, flags | B_SCROLL_VIEW_AWARE)
{
	_Init(type);
	BView::SetViewColor(Look::DocumentColor());
	BView::SetLowColor(Look::DocumentColor());
}


BListView::BListView(BMessage* archive) : BView(archive)
{
	int32 type;
	_Init(archive->FindInt32("_lv_type", &type) == B_OK ? list_view_type(type)
														: B_SINGLE_SELECTION_LIST);
	BMessage message;
	if (archive->FindMessage("_msg", &message) == B_OK)
		SetInvocationMessage(new BMessage(message));
	if (archive->FindMessage("_2nd_msg", &message) == B_OK)
		SetSelectionMessage(new BMessage(message));
	_ReadItems(archive, "_l_items", fItems);
	_RescanSelection();
}


BListView::~BListView()
{
	// The other items may be gone by now.
	const std::unordered_set<BListItem*> revived = std::move(fRevived);
	for (BListItem* item : revived) {
		item->fReviver = NULL;
		delete item;
	}
	SetMessage(NULL);
}


BArchivable*
BListView::Instantiate(BMessage* archive)
{
	return validate_instantiation(archive, "BListView") ? new BListView(archive) : NULL;
}


void
BListView::_Init(list_view_type type)
{
	fPlaced = 0;
	fType = type;
	fFirstSelected = fLastSelected = -1;
	fAnchor = -1;
	fFocusItem = -1;
	fScrollView = NULL;
}


// They belong to the list while they are in it. Items of classes that this program does not have
// are carried along.
void
BListView::_ReadItems(BMessage* archive, const char* field, std::vector<BListItem*>& items)
{
	BMessage itemArchive;
	for (int32 i = 0; archive->FindMessage(field, i, &itemArchive) == B_OK; i++) {
		BArchivable* object = instantiate_object(&itemArchive);
		BListItem* item = dynamic_cast<BListItem*>(object);
		if (item == NULL) {
			delete object;
			item = new UnknownListItem(itemArchive);
		}
		item->fReviver = this;
		fRevived.insert(item);
		items.push_back(item);
	}
}


status_t
BListView::Archive(BMessage* archive, bool deep) const
{
	const status_t status = BView::Archive(archive, deep);
	if (status != B_OK)
		return status;
	return _ArchiveOwn(archive, deep, "_l_items", fItems);
}


status_t
BListView::_ArchiveOwn(
	BMessage* archive, bool deep, const char* field, const std::vector<BListItem*>& items) const
{
	ArchiveWriter writer(archive);
	writer.Int32("_lv_type", fType, B_SINGLE_SELECTION_LIST);
	for (const BListItem* item : items) {
		if (!deep)
			break;
		BMessage itemArchive;
		const status_t status = item->Archive(&itemArchive, true);
		if (status != B_OK)
			return status;
		archive->AddMessage(field, &itemArchive);
	}
	writer.Message("_msg", Message());
	writer.Message("_2nd_msg", fSelectionMessage.get());
	return writer.Status();
}


// #pragma mark - hooks


void
BListView::AttachedToWindow()
{
	BView::AttachedToWindow();
	if (!Messenger().IsValid())
		SetTarget(Window());
	_UpdateItems();
	if (!is_revived(this))
		_UpdateScrollBars();
}


void
BListView::DetachedFromWindow()
{
	fTracking.reset();
	_LightBorder(false);
	BView::DetachedFromWindow();
}


void
BListView::AllAttached()
{
	BView::AllAttached();
}


void
BListView::AllDetached()
{
	BView::AllDetached();
}


void
BListView::FrameMoved(BPoint newPosition)
{
	BView::FrameMoved(newPosition);
}


void
BListView::FrameResized(float width, float height)
{
	BView::FrameResized(width, height);
	_UpdateScrollBars();
	// Selected items reach to the right edge.
	if (fFirstSelected >= 0)
		Invalidate();
}


void
BListView::TargetedByScrollView(BScrollView* scroller)
{
	_LightBorder(false);
	fScrollView = scroller;
	if (scroller != NULL && !is_revived(this))
		_UpdateScrollBars();
	_ShowFocus();
}


void
BListView::ScrollTo(BPoint where)
{
	BView::ScrollTo(where);
}


void
BListView::SetFont(const BFont* font, uint32 mask)
{
	BView::SetFont(font, mask);
	if (Window() == NULL)
		return;
	_UpdateItems();
	_UpdateScrollBars();
	Invalidate();
}


void
BListView::MakeFocus(bool focus)
{
	if (focus == IsFocus())
		return;
	BView::MakeFocus(focus);
	_ShowFocus();
}


void
BListView::WindowActivated(bool active)
{
	BView::WindowActivated(active);
	if (IsFocus())
		_ShowFocus();
}


void
BListView::_ShowFocus()
{
	_LightBorder(IsFocus() && Window() != NULL && Window()->IsActive());
}


// A scroll view that the list has left may be gone.
void
BListView::_LightBorder(bool lit)
{
	if (fScrollView != NULL && Parent() == fScrollView)
		fScrollView->SetBorderHighlighted(lit);
}


void
BListView::MessageReceived(BMessage* message)
{
	switch (message->what) {
		case B_SELECT_ALL:
			if (fType == B_MULTIPLE_SELECTION_LIST && CountItems() > 0)
				Select(0, CountItems() - 1, false);
			break;

		case kListScroll:
			_AutoScroll();
			break;

		default:
			BView::MessageReceived(message);
			break;
	}
}


void
BListView::Draw(BRect updateRect)
{
	_EnsurePlaces();
	for (int32 i = std::max<int32>(0, _IndexAt(updateRect.top)); i < CountItems(); i++) {
		const BRect frame = ItemFrame(i);
		if (frame.top > updateRect.bottom)
			break;
		if (frame.bottom >= updateRect.top)
			DrawItem(fItems[i], frame);
	}
}


void
BListView::DrawItem(BListItem* item, BRect itemFrame, bool complete)
{
	item->DrawItem(this, itemFrame, complete);
}


void
BListView::ResizeToPreferred()
{
	BView::ResizeToPreferred();
}


void
BListView::GetPreferredSize(float* _width, float* _height)
{
	if (IsEmpty()) {
		BView::GetPreferredSize(_width, _height);
		return;
	}
	if (_width != NULL)
		*_width = _WidestItem();
	if (_height != NULL)
		*_height = _Bottom();
}


status_t
BListView::Perform(perform_code code, void* data)
{
	return BView::Perform(code, data);
}


BHandler*
BListView::ResolveSpecifier(
	BMessage* message, int32 index, BMessage* specifier, int32 form, const char* property)
{
	return BView::ResolveSpecifier(message, index, specifier, form, property);
}


status_t
BListView::GetSupportedSuites(BMessage* data)
{
	if (data == NULL)
		return B_BAD_VALUE;
	data->AddString("suites", "suite/vnd.Be-list-view");
	return BView::GetSupportedSuites(data);
}
