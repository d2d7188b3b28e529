#include "work/WorkView.h"

#include <cmath>
#include <cstdio>

#include <Beep.h>
#include <Message.h>
#include <MessageFilter.h>
#include <TextControl.h>
#include <Window.h>

#include "archive/EditorCodes.h"
#include "archive/TypedText.h"
#include "archive/ViewDrag.h"
#include "archive/ViewTree.h"
#include "work/HiliteView.h"
#include "work/WorkBackgroundView.h"
#include "work/WorkViewFilter.h"

namespace {


constexpr float kScrollBarSize = 14;
constexpr float kMargin = 8; // round the edited tree
constexpr int32 kInitialRange = 500;
constexpr float kGroundSize = 10000;
constexpr uint32 kTargetFlags = B_FULL_UPDATE_ON_RESIZE | B_WILL_DRAW | B_FRAME_EVENTS;

// A press whose distances to the right and to the bottom edge add up to less starts a resize.
constexpr float kResizeZone = 12;

// The third bit has no use here; masks are kept as they are given.
constexpr uint32 kResizeEventMask = B_POINTER_EVENTS | 0x4;


// A scroll view is made round its target, so the target is made first.
BView*
MakeScrollTarget(BRect frame)
{
	frame.right -= kScrollBarSize;
	frame.bottom -= kScrollBarSize;
	BView* target = new BView(frame, "scroll target", B_FOLLOW_ALL_SIDES, kTargetFlags);
	target->SetViewColor(B_TRANSPARENT_COLOR);
	return target;
}


} // namespace


WorkView::WorkView(BRect frame, uint32 resizingMode, BHandler* editor) :
	BScrollView("WorkView", MakeScrollTarget(frame), resizingMode, B_FRAME_EVENTS, true, true,
		B_FANCY_BORDER),
	fScrollOrigin(0, 0), fResizing(false), fLastResizePoint(0, 0), fRangeWidth(kInitialRange),
	fRangeHeight(kInitialRange), fEditor(editor), fEditView(nullptr), fFieldsLeft(0)
{
	fContainer = new WorkBackgroundView(BRect(0, 0, kGroundSize, kGroundSize), "container",
		B_FOLLOW_LEFT | B_FOLLOW_TOP, kTargetFlags);
	fHiliteView = new HiliteView(
		fContainer->Bounds(), "hilite view", B_FOLLOW_LEFT | B_FOLLOW_TOP, B_WILL_DRAW, this);
	Target()->AddChild(fContainer);
	Target()->AddChild(fHiliteView);

	SetRange(this, fRangeWidth, fRangeHeight);
}


void
WorkView::AttachedToWindow()
{
	Window()->AddCommonFilter(new BMessageFilter(B_ANY_DELIVERY, B_ANY_SOURCE, WorkViewFilter));
}


void
WorkView::DetachedFromWindow()
{
	EndDragPointer();
	BScrollView::DetachedFromWindow();
}


void
WorkView::FrameResized(float width, float height)
{
	BScrollView::FrameResized(width, height);
	SetRange(this, fRangeWidth, fRangeHeight);
	fContainer->Invalidate();
}


void
WorkView::KeyDown(const char* bytes, int32 numBytes)
{
	if (SelectedView() == nullptr) {
		beep();
		return;
	}

	for (int32 i = 0; i < numBytes; i++) {
		printf("%x\n", static_cast<unsigned char>(bytes[i])); // a trace kept on purpose
		_HandleKey(bytes[i]);
	}
}


void
WorkView::MouseMoved(BPoint where, uint32 transit, const BMessage* drag)
{
	BView* selection = SelectedView();
	if (!fResizing || selection == nullptr)
		return;

	// Sizes are whole; what is left of a step between pixels counts for the next one.
	const BPoint point = selection->ConvertFromScreen(ConvertToScreen(where));
	const BPoint step(
		std::round(point.x - fLastResizePoint.x), std::round(point.y - fLastResizePoint.y));
	selection->ResizeBy(step.x, step.y);
	fLastResizePoint += step;
	selection->Invalidate();

	BMessage moved(kSelectionMoved);
	_NotifyEditor(&moved);
}


void
WorkView::MouseUp(BPoint where)
{
	SetEventMask(0, 0);
	EndDragPointer();
	fResizing = false;
}


void
WorkView::SetEditView(BView* view)
{
	fTaken.reset();
	if (fEditView != nullptr) {
		fSelectedView.Set(nullptr);
		fContainer->RemoveChild(fEditView);
		delete fEditView;
	}

	fContainer->ScrollTo(BPoint(0, 0));
	fEditView = view;
	if (view == nullptr)
		return;

	const BRect bounds = view->Bounds();
	fRangeWidth = static_cast<int32>(std::lround(bounds.Width() + 2 * kMargin));
	fRangeHeight = static_cast<int32>(std::lround(bounds.Height() + 2 * kMargin));
	SetRange(this, fRangeWidth, fRangeHeight);

	ColorfulAddChild(fContainer, view);
	fContainer->Invalidate();
	SetSelectedView(view);

	fScrollOrigin = view->Frame().LeftTop() - BPoint(kMargin, kMargin);
	fContainer->ScrollTo(fScrollOrigin);
}


BView*
WorkView::EditView() const
{
	return fEditView;
}


BPoint
WorkView::ScrollOrigin() const
{
	return fScrollOrigin;
}


void
WorkView::SetSelectedView(BView* view)
{
	if (view == SelectedView())
		return;

	_SendTypedText();
	Window()->BeginViewTransaction();
	fHiliteView->InvalidateSelection();
	fSelectedView.Set(view);
	PostHiliteRedraw();
	BMessage changed(kSelectionChanged);
	changed.AddPointer(kSelectedViewField, view);
	_NotifyEditor(&changed);
	Window()->EndViewTransaction();
	Window()->Flush();
}


BView*
WorkView::SelectedView() const
{
	return fSelectedView.View();
}


void
WorkView::ReplaceView(BView* former, BView* view)
{
	if (former == fEditView)
		fEditView = view;
	SetSelectedView(view);
}


WorkBackgroundView*
WorkView::Container() const
{
	return fContainer;
}


WorkView::Place
WorkView::PresentPlace() const
{
	return { PathTo(fEditView, SelectedView()), Target()->Bounds().LeftTop() };
}


void
WorkView::ReturnTo(const Place& place)
{
	if (fEditView == nullptr)
		return;

	SetSelectedView(ViewAtPath(fEditView, place.selection));
	Target()->ScrollTo(place.scrolled);
}


void
WorkView::PostHiliteRedraw()
{
	Window()->PostMessage(kDrawHilite, fHiliteView);
}


void
WorkView::HandleFilteredMouse(BMessage* message, BView* view, int32 modifiers)
{
	BPoint where;
	if (message->FindPoint("where", &where) != B_OK)
		return;

	_TakeKeyboard();
	if (view != SelectedView()) {
		SetSelectedView(view);
		return;
	}

	const BRect bounds = view->Bounds();
	const bool inResizeZone = (bounds.right - where.x) + (bounds.bottom - where.y) < kResizeZone;
	if (FrameControled(view))
		beep();
	else if (inResizeZone)
		_BeginResize(where);
	else if (view == fEditView)
		beep();
	else if (fFieldsLeft > 0)
		Window()->PostMessage(message, view);
	else
		_BeginMove(view, where, (modifiers & B_CONTROL_KEY) != 0);
}


// A field that loses the keyboard sends what was typed in it, by a message of its own. A view is
// taken away only when that has arrived, and until then a press that would do so is put off.
void
WorkView::_TakeKeyboard()
{
	if (IsFocus())
		return;

	MakeFocus(true);
	if (Window()->PostMessage(kFieldLeft, this) == B_OK)
		fFieldsLeft++;
}


// What is being typed belongs to the view that was selected while it was typed, also when the
// selection changes without a press, as under a drag.
void
WorkView::_SendTypedText()
{
	BTextControl* field = FieldInUse(Window());
	if (field != nullptr && LiveViewAttached(fContainer, field) == nullptr)
		SendTypedText(field);
}


// The root and views whose parents place them stay where they are.
bool
WorkView::_MayMove(const BView* view) const
{
	return view != fEditView && !FrameControled(view);
}


void
WorkView::_BeginResize(BPoint where)
{
	SetEventMask(kResizeEventMask, 0);
	fResizing = true;
	fLastResizePoint = where;
}


// A view that is moved is taken away at once: it will exist again where it is dropped.
void
WorkView::_BeginMove(BView* view, BPoint where, bool copy)
{
	BView* parent = view->Parent();
	SetSelectedView(parent);
	fTakenFrom.Set(parent);
	fTakenBefore.Set(view->NextSibling());
	fTakenAt = view->ConvertToScreen(where);
	parent->RemoveChild(view);
	const BPoint leftTop = view->Frame().LeftTop();
	view->MoveTo(0, 0);

	BBitmap* image = MakeDragImage(view);
	BMessage drag;
	if (kFramesFollowScrolling)
		MoveScrolledViews(view, false);
	MakeDragMessage(view, &drag);
	SetEventMask(B_POINTER_EVENTS, 0); // the button is released elsewhere
	ShowDragPointer(true);
	DragMessage(&drag, image, B_OP_ALPHA, where - view->Bounds().LeftTop(), this);

	fTaken.reset();
	fTakenLeftTop = leftTop;
	if (copy) {
		if (kFramesFollowScrolling)
			MoveScrolledViews(view, true);
		view->MoveTo(leftTop);
		ColorfulAddChild(parent, view);
	} else
		fTaken.reset(view);
}


void
WorkView::_DeleteSelection()
{
	BView* view = SelectedView();
	if (!_MayMove(view)) {
		beep();
		return;
	}

	BView* parent = view->Parent();
	SetSelectedView(parent);
	parent->RemoveChild(view);
	delete view;
}


void
WorkView::_HandleKey(char key)
{
	switch (key) {
		case B_BACKSPACE:
		case B_DELETE:
			_DeleteSelection();
			break;
		case B_LEFT_ARROW:
			_MoveSelection(-1, 0);
			break;
		case B_RIGHT_ARROW:
			_MoveSelection(1, 0);
			break;
		case B_UP_ARROW:
			_MoveSelection(0, -1);
			break;
		case B_DOWN_ARROW:
			_MoveSelection(0, 1);
			break;
	}
}


void
WorkView::_MoveSelection(float x, float y)
{
	BView* view = SelectedView();
	if (!_MayMove(view)) {
		beep();
		return;
	}

	view->MoveBy(x, y);
	BMessage moved(kSelectionMoved);
	_NotifyEditor(&moved);
}


void
WorkView::_NotifyEditor(BMessage* message)
{
	Window()->PostMessage(message, fEditor);
}
