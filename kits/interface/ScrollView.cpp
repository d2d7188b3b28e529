#include <ScrollView.h>

#include <algorithm>

#include <Message.h>
#include <Window.h>

#include "interface/private/Look.h"
#include "interface/private/ViewArchive.h"

using namespace BPrivate;

namespace {

constexpr const char* kHorizontalName = "_HSB_";
constexpr const char* kVerticalName = "_VSB_";


float
border_size(border_style border)
{
	switch (border) {
		case B_NO_BORDER:
			return 0;
		case B_PLAIN_BORDER:
			return 1;
		default:
			return 2;
	}
}

} // namespace


BScrollView::BScrollView(const char* name, BView* target, uint32 resizingMode, uint32 flags,
	bool horizontal, bool vertical, border_style border) :
	BView(_FrameFor(target, horizontal, vertical, border), name, resizingMode,
		_FlagsFor(flags, border)),
	fTarget(nullptr), fHorizontal(nullptr), fVertical(nullptr), fBorder(border),
	fHighlighted(false), fHadTarget(target != nullptr)
{
	SetViewColor(Look::PanelColor());
	if (target != nullptr) {
		// The target keeps its size, and its place on the screen by the frame made for it.
		target->MoveTo(border_size(border), border_size(border));
		AddChild(target);
		fTarget = target;
	}
	_AddBars(horizontal, vertical);
	if (fTarget != nullptr)
		fTarget->TargetedByScrollView(this);
}


BScrollView::BScrollView(BMessage* archive) :
	BView(archive), fTarget(nullptr), fHorizontal(nullptr), fVertical(nullptr), fHighlighted(false),
	fHadTarget(false)
{
	fBorder = static_cast<border_style>(archive->GetInt32("_style", B_FANCY_BORDER));
	bool noTarget;
	_AdoptChildren(archive->FindBool("_no_target_", &noTarget) != B_OK);
}


BScrollView::~BScrollView()
{
}


BArchivable*
BScrollView::Instantiate(BMessage* archive)
{
	return validate_instantiation(archive, "BScrollView") ? new BScrollView(archive) : nullptr;
}


status_t
BScrollView::Archive(BMessage* archive, bool deep) const
{
	const status_t status = BView::Archive(archive, deep);
	if (status != B_OK)
		return status;
	ArchiveWriter writer(archive);
	writer.Int32("_style", fBorder, B_FANCY_BORDER, fBorder != B_FANCY_BORDER);
	// The presence alone counts, whatever the value. An archive may also name a target that no
	// child can be.
	bool value;
	const bool saidNone = writer.Source().FindBool("_no_target_", &value) == B_OK;
	const bool hasNone = Target() == nullptr;
	const bool unchanged = saidNone == hasNone || (hasNone && !fHadTarget);
	if (!writer.Keep("_no_target_", unchanged) && hasNone)
		archive->AddBool("_no_target_", true);
	return writer.Status();
}


// The target is the first child that is no bar; bars are told apart by their orientation.
void
BScrollView::_AdoptChildren(bool hasTarget)
{
	for (BView* child = ChildAt(0); child != nullptr; child = child->NextSibling()) {
		if (BScrollBar* bar = dynamic_cast<BScrollBar*>(child)) {
			BScrollBar*& slot = bar->Orientation() == B_VERTICAL ? fVertical : fHorizontal;
			if (slot == nullptr)
				slot = bar;
		} else if (hasTarget && fTarget == nullptr)
			fTarget = child;
	}
	for (BScrollBar* bar : { fHorizontal, fVertical }) {
		if (bar != nullptr)
			bar->SetTarget(fTarget);
	}
	fHadTarget = fTarget != nullptr;
	if (fTarget != nullptr)
		fTarget->TargetedByScrollView(this);
}


// #pragma mark - geometry


// A bar's extent is 14; without a border each bar takes one pixel more.
BRect
BScrollView::_FrameFor(BView* target, bool horizontal, bool vertical, border_style border)
{
	BRect frame = target != nullptr ? target->Frame() : BRect(0, 0, 16, 16);
	const float extra = border == B_NO_BORDER ? 1 : 0;
	if (vertical)
		frame.right += B_V_SCROLL_BAR_WIDTH + extra;
	if (horizontal)
		frame.bottom += B_H_SCROLL_BAR_HEIGHT + extra;
	return frame.InsetByCopy(-border_size(border), -border_size(border));
}


uint32
BScrollView::_FlagsFor(uint32 flags, border_style border)
{
	return border == B_NO_BORDER ? flags : flags | B_WILL_DRAW | B_FRAME_EVENTS;
}


// What the border and the bars leave, in the geometry of _FrameFor().
BRect
BScrollView::_TargetFrame() const
{
	BRect frame = Bounds().InsetByCopy(border_size(fBorder), border_size(fBorder));
	const float extra = fBorder == B_NO_BORDER ? 1 : 0;
	if (fVertical != nullptr)
		frame.right -= B_V_SCROLL_BAR_WIDTH + extra;
	if (fHorizontal != nullptr)
		frame.bottom -= B_H_SCROLL_BAR_HEIGHT + extra;
	return frame;
}


void
BScrollView::_AddBars(bool horizontal, bool vertical)
{
	if (horizontal)
		fHorizontal = new BScrollBar(BRect(0, 0, 14, B_H_SCROLL_BAR_HEIGHT), kHorizontalName,
			fTarget, 0, 1000, B_HORIZONTAL);
	if (vertical)
		fVertical = new BScrollBar(
			BRect(0, 0, B_V_SCROLL_BAR_WIDTH, 14), kVerticalName, fTarget, 0, 1000, B_VERTICAL);
	_PlaceParts();
	if (fHorizontal != nullptr)
		AddChild(fHorizontal);
	if (fVertical != nullptr)
		AddChild(fVertical);
}


// Bars start one pixel after the target. With a border they overlap it by a pixel at both ends, and
// they reach one pixel past the target where the border or the other bar follows.
void
BScrollView::_PlaceParts()
{
	const BRect target = _TargetFrame();
	const bool bordered = fBorder != B_NO_BORDER;
	const float before = bordered ? 1 : 0;
	if (fHorizontal != nullptr) {
		const float past = bordered || fVertical != nullptr ? 1 : 0;
		fHorizontal->MoveTo(target.left - before, target.bottom + 1);
		fHorizontal->ResizeTo(target.Width() + before + past, B_H_SCROLL_BAR_HEIGHT);
	}
	if (fVertical != nullptr) {
		const float past = bordered || fHorizontal != nullptr ? 1 : 0;
		fVertical->MoveTo(target.right + 1, target.top - before);
		fVertical->ResizeTo(B_V_SCROLL_BAR_WIDTH, target.Height() + before + past);
	}
}


// #pragma mark - hooks


void
BScrollView::AttachedToWindow()
{
	BView::AttachedToWindow();
	if (is_revived(this) || Window() == nullptr || Window()->Look() != B_DOCUMENT_WINDOW_LOOK)
		return;
	// One bar alone leaves room for the resize corner of a document window.
	if ((fHorizontal == nullptr) == (fVertical == nullptr))
		return;
	const BRect corner = ConvertToScreen(Bounds());
	const BRect frame = Window()->Frame();
	const float border = border_size(fBorder);
	if (corner.right - border < frame.right || corner.bottom - border < frame.bottom)
		return;
	if (fHorizontal != nullptr)
		fHorizontal->ResizeBy(-B_V_SCROLL_BAR_WIDTH, 0);
	else
		fVertical->ResizeBy(0, -B_H_SCROLL_BAR_HEIGHT);
}


void
BScrollView::DetachedFromWindow()
{
	BView::DetachedFromWindow();
}


void
BScrollView::AllAttached()
{
	BView::AllAttached();
}


void
BScrollView::AllDetached()
{
	BView::AllDetached();
}


void
BScrollView::Draw(BRect updateRect)
{
	if (fBorder == B_NO_BORDER)
		return;
	const rgb_color base = Look::BaseColor(this);
	if (fBorder == B_PLAIN_BORDER) {
		Look::DrawPlainFrame(this, Bounds(), base);
		return;
	}
	const bool lit = fHighlighted && Window() != nullptr && Window()->IsActive();
	Look::DrawFieldFrame(this, Bounds(), base, lit ? Look::kFocused : Look::kNormal);
}


void
BScrollView::WindowActivated(bool active)
{
	if (fHighlighted)
		Invalidate();
	BView::WindowActivated(active);
}


void
BScrollView::MessageReceived(BMessage* message)
{
	BView::MessageReceived(message);
}


void
BScrollView::MouseDown(BPoint where)
{
	BView::MouseDown(where);
}


void
BScrollView::MouseUp(BPoint where)
{
	BView::MouseUp(where);
}


void
BScrollView::MouseMoved(BPoint where, uint32 transit, const BMessage* dragMessage)
{
	BView::MouseMoved(where, transit, dragMessage);
}


void
BScrollView::FrameMoved(BPoint newPosition)
{
	BView::FrameMoved(newPosition);
}


void
BScrollView::FrameResized(float newWidth, float newHeight)
{
	// The border has moved with the edges.
	if (fBorder != B_NO_BORDER)
		Invalidate();
	BView::FrameResized(newWidth, newHeight);
}


// #pragma mark - parts


BScrollBar*
BScrollView::ScrollBar(orientation direction) const
{
	return direction == B_HORIZONTAL ? fHorizontal : fVertical;
}


void
BScrollView::SetBorder(border_style border)
{
	if (border == fBorder)
		return;
	fBorder = border;
	SetFlags(_FlagsFor(Flags(), border));
	_PlaceParts();
	if (BView* target = Target()) {
		const BRect frame = _TargetFrame();
		target->MoveTo(frame.LeftTop());
		target->ResizeTo(frame.Width(), frame.Height());
	}
	Invalidate();
}


border_style
BScrollView::Border() const
{
	return fBorder;
}


status_t
BScrollView::SetBorderHighlighted(bool state)
{
	if (fBorder != B_FANCY_BORDER)
		return B_ERROR;
	if (state == fHighlighted)
		return B_OK;
	fHighlighted = state;
	const BRect bounds = Bounds();
	const float border = border_size(fBorder);
	Invalidate(BRect(bounds.left, bounds.top, bounds.right, bounds.top + border));
	Invalidate(BRect(bounds.left, bounds.bottom - border, bounds.right, bounds.bottom));
	Invalidate(BRect(bounds.left, bounds.top, bounds.left + border, bounds.bottom));
	Invalidate(BRect(bounds.right - border, bounds.top, bounds.right, bounds.bottom));
	return B_OK;
}


bool
BScrollView::IsBorderHighlighted() const
{
	return fHighlighted;
}


void
BScrollView::SetTarget(BView* target)
{
	BView* old = Target();
	if (target == old)
		return;
	fTarget = nullptr;
	if (old != nullptr) {
		old->TargetedByScrollView(nullptr);
		for (BScrollBar* bar : { fHorizontal, fVertical }) {
			if (bar != nullptr)
				bar->SetTarget(static_cast<BView*>(nullptr));
		}
		RemoveChild(old);
	}
	fTarget = target;
	if (target == nullptr)
		return;

	const BRect frame = _TargetFrame();
	target->MoveTo(frame.LeftTop());
	target->ResizeTo(frame.Width(), frame.Height());
	for (BScrollBar* bar : { fHorizontal, fVertical }) {
		if (bar != nullptr)
			bar->SetTarget(target);
	}
	if (target->Parent() != this)
		AddChild(target, ChildAt(0));
	target->TargetedByScrollView(this);
}


// A target may have been taken out like any other child, and even be gone.
BView*
BScrollView::Target() const
{
	for (BView* child = ChildAt(0); fTarget != nullptr && child != nullptr;
		 child = child->NextSibling()) {
		if (child == fTarget)
			return fTarget;
	}
	return nullptr;
}


// #pragma mark - the rest


void
BScrollView::GetPreferredSize(float* width, float* height)
{
	BView::GetPreferredSize(width, height);
}


// It has no size of its own; one that is not attached is left alone altogether.
void
BScrollView::ResizeToPreferred()
{
	if (Window() != nullptr)
		BView::ResizeToPreferred();
}


void
BScrollView::MakeFocus(bool state)
{
	BView::MakeFocus(state);
}


BHandler*
BScrollView::ResolveSpecifier(
	BMessage* message, int32 index, BMessage* specifier, int32 form, const char* property)
{
	return BView::ResolveSpecifier(message, index, specifier, form, property);
}


status_t
BScrollView::GetSupportedSuites(BMessage* data)
{
	return BView::GetSupportedSuites(data);
}


status_t
BScrollView::Perform(perform_code code, void* argument)
{
	return BView::Perform(code, argument);
}
