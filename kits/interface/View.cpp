#include <View.h>

#include <cmath>
#include <cstring>

#include <AppDefs.h>
#include <Debug.h>
#include <Message.h>
#include <ScrollBar.h>
#include <Shelf.h>
#include <Window.h>

#include "app/private/ArchiveSource.h"
#include "app/private/HandlerPrivate.h"
#include "interface/private/ViewArchive.h"
#include "interface/private/ViewPrivate.h"
#include "interface/private/ViewScripting.h"
#include "interface/private/ViewState.h"
#include "interface/private/ViewWalk.h"
#include "interface/private/WindowInternals.h"
#include "server/ServerView.h"

using namespace BPrivate;

namespace {

// Fractions of a frame are cut off downwards when a view is made.
BRect
whole_frame(BRect frame)
{
	return BRect(std::floor(frame.left), std::floor(frame.top), std::floor(frame.right),
		std::floor(frame.bottom));
}


ServerView*
node_of(const BView* view)
{
	return view != nullptr ? ViewPrivate(view).Node() : nullptr;
}


BView*
owner_of(const ServerView* node)
{
	return node != nullptr ? node->Owner() : nullptr;
}

} // namespace


BView::BView(BRect frame, const char* name, uint32 resizingMode, uint32 flags) :
	BHandler(name), fNode(new ServerView(this, whole_frame(frame), resizingMode | flags)),
	fOwner(nullptr), fState(nullptr), fExtras(nullptr), fSource(nullptr), fTouched(0), fEntry(0),
	fRevivedWord(0)
{
}


BView::~BView()
{
	if (fOwner != nullptr) {
		debugger("A view was deleted that still belongs to a window. Call RemoveSelf() first.");
		RemoveSelf();
	}
	if (fExtras != nullptr && fExtras->shelf != nullptr)
		fExtras->shelf->_ContainerGone();
	fNode->Unlink();
	while (ServerView* child = fNode->FirstChild())
		delete child->Owner();

	if (fExtras != nullptr) {
		for (BScrollBar* bar : fExtras->bars) {
			if (bar != nullptr)
				bar->_TargetGone();
		}
	}
	delete fExtras;
	delete fState;
	delete fSource;
	delete fNode;
}


// #pragma mark - hooks


void
BView::AttachedToWindow()
{
}


void
BView::AllAttached()
{
}


void
BView::DetachedFromWindow()
{
}


void
BView::AllDetached()
{
}


void
BView::Draw(BRect updateRect)
{
}


void
BView::DrawAfterChildren(BRect updateRect)
{
}


void
BView::WindowActivated(bool active)
{
}


void
BView::Pulse()
{
}


void
BView::FrameMoved(BPoint newPosition)
{
}


void
BView::FrameResized(float newWidth, float newHeight)
{
}


void
BView::TargetedByScrollView(BScrollView* scrollView)
{
}


void
BView::MessageReceived(BMessage* message)
{
	switch (message->what) {
		case B_MOUSE_WHEEL_CHANGED: {
			const float dx = message->FindFloat("be:wheel_delta_x");
			const float dy = message->FindFloat("be:wheel_delta_y");
			if (!ViewPrivate::ScrollByWheel(this, dx, dy))
				BHandler::MessageReceived(message);
			break;
		}

		case B_INVALIDATE: {
			BRect rect;
			if (message->FindRect("be:area", &rect) == B_OK)
				Invalidate(rect);
			else
				Invalidate();
			break;
		}

		case B_GET_PROPERTY:
		case B_SET_PROPERTY:
		case B_COUNT_PROPERTIES:
			if (!handle_view_property(this, message))
				BHandler::MessageReceived(message);
			break;

		case B_ARCHIVED_OBJECT:
			if (message->WasDropped() && fExtras != nullptr && fExtras->shelf != nullptr)
				fExtras->shelf->MessageReceived(message);
			else
				BHandler::MessageReceived(message);
			break;

		default:
			BHandler::MessageReceived(message);
			break;
	}
}


// #pragma mark - tree


void
BView::AddChild(BView* child, BView* before)
{
	const bool locked = fOwner != nullptr && fOwner->Lock();
	ViewPrivate::Insert(fNode, child, before, fOwner);
	if (locked)
		fOwner->Unlock();
}


bool
BView::RemoveChild(BView* child)
{
	if (child == nullptr || child->fNode->Parent() != fNode)
		return false;
	return child->RemoveSelf();
}


bool
BView::RemoveSelf()
{
	if (fNode->Parent() == nullptr)
		return false;
	BWindow* owner = fOwner;
	if (owner == nullptr) {
		fNode->Unlink();
		HandlerPrivate(this).SetNextHandler(nullptr);
		return true;
	}
	if (!_CheckOwnerLock())
		return false;
	ViewPrivate(this).Detach();
	return true;
}


int32
BView::CountChildren() const
{
	return fNode->CountChildren();
}


BView*
BView::ChildAt(int32 index) const
{
	return owner_of(fNode->ChildAt(index));
}


BView*
BView::NextSibling() const
{
	return owner_of(fNode->Next());
}


BView*
BView::PreviousSibling() const
{
	return owner_of(fNode->Previous());
}


BView*
BView::Parent() const
{
	return owner_of(fNode->Parent());
}


BWindow*
BView::Window() const
{
	return fOwner;
}


BView*
BView::FindView(const char* name) const
{
	if (name == nullptr)
		return nullptr;
	for (ServerView* node = fNode; node != nullptr; node = node->NextInTree(fNode)) {
		const char* other = node->Owner()->Name();
		if (other != nullptr && std::strcmp(other, name) == 0)
			return node->Owner();
	}
	return nullptr;
}


// #pragma mark - flags, showing


void
BView::SetFlags(uint32 flags)
{
	_CheckLock();
	const uint32 old = Flags();
	const uint32 now = flags & ~_RESIZE_MASK_;
	fNode->SetWord(ResizingMode() | now);
	if (fOwner == nullptr || old == now)
		return;

	fNode->Tree()->ClippingChanged();
	if ((now & ~old & (B_WILL_DRAW | B_DRAW_ON_CHILDREN)) != 0)
		Invalidate();
	if ((now & ~old & B_PULSE_NEEDED) != 0)
		WindowInternals::Of(fOwner).NeedPulse();
}


uint32
BView::Flags() const
{
	return fNode->Word() & ~_RESIZE_MASK_;
}


void
BView::SetResizingMode(uint32 mode)
{
	fNode->SetWord(Flags() | (mode & _RESIZE_MASK_));
}


uint32
BView::ResizingMode() const
{
	return fNode->Word() & _RESIZE_MASK_;
}


void
BView::Show()
{
	_CheckLock();
	const int16 count = fNode->HideCount() - 1;
	if (fOwner != nullptr && count == 0)
		fNode->Tree()->SetHideCount(*fNode, count);
	else
		fNode->SetHideCount(count);
}


void
BView::Hide()
{
	_CheckLock();
	const int16 count = fNode->HideCount() + 1;
	if (fOwner != nullptr && count == 1) {
		fNode->Tree()->SetHideCount(*fNode, count);
		WindowInternals::Of(fOwner).ViewHidden(this);
	} else
		fNode->SetHideCount(count);
}


bool
BView::IsHidden() const
{
	return fNode->IsHidden() || (fOwner != nullptr && fOwner->IsHidden());
}


bool
BView::IsHidden(const BView* lookingFrom) const
{
	if (lookingFrom == nullptr)
		return IsHidden();
	return fNode->HideCount() > 0 || (lookingFrom != this && fNode->IsHidden(node_of(lookingFrom)));
}


bool
BView::IsPrinting() const
{
	return false;
}


// #pragma mark - focus, bars, tips


void
BView::MakeFocus(bool focusState)
{
	if (fOwner == nullptr || !_CheckOwnerLock())
		return;
	WindowInternals& internals = WindowInternals::Of(fOwner);
	if (!focusState) {
		if (internals.focus == this)
			internals.SetFocus(nullptr);
		return;
	}
	BView* previous = internals.focus;
	if (previous == this)
		return;
	if (previous != nullptr)
		previous->MakeFocus(false);
	// The hook of the one before may have taken this view out.
	if (fOwner != nullptr)
		internals.SetFocus(this);
}


bool
BView::IsFocus() const
{
	return fOwner != nullptr && WindowInternals::Of(fOwner).focus == this;
}


BScrollBar*
BView::ScrollBar(orientation posture) const
{
	return fExtras != nullptr ? fExtras->bars[posture == B_VERTICAL ? 1 : 0] : nullptr;
}


void
BView::SetToolTip(const char* text)
{
	if (fExtras != nullptr || (text != nullptr && text[0] != '\0'))
		_Extras()->toolTip = text != nullptr ? text : "";
	if (fOwner != nullptr && WindowInternals::Of(fOwner).tips.View() == this)
		WindowInternals::Of(fOwner).tips.Dismiss();
}


const char*
BView::ToolTip() const
{
	return fExtras != nullptr && !fExtras->toolTip.empty() ? fExtras->toolTip.c_str() : nullptr;
}


// #pragma mark - scripting


status_t
BView::Perform(perform_code code, void* argument)
{
	return BHandler::Perform(code, argument);
}


// #pragma mark - private


void
BView::_CheckLock() const
{
	if (fOwner != nullptr)
		_CheckOwnerLock();
}


bool
BView::_CheckOwnerLock() const
{
	if (fOwner->IsLocked())
		return true;
	debugger("The window of a view must be locked by who uses the view.");
	return false;
}


ViewExtras*
BView::_Extras()
{
	if (fExtras == nullptr)
		fExtras = new ViewExtras;
	return fExtras;
}
