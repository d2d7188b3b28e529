#include "editors/EditScrollView.h"

#include <cfloat>
#include <climits>
#include <cmath>

#include <Beep.h>
#include <CheckBox.h>
#include <Font.h>
#include <Menu.h>
#include <MenuField.h>
#include <Message.h>
#include <ScrollBar.h>
#include <ScrollView.h>

#include "archive/ViewTree.h"
#include "editors/EditorHost.h"
#include "editors/FloatControl.h"
#include "editors/IntControl.h"
#include "editors/PanelRows.h"
#include "editors/TargetLock.h"


// What the four controls of a bar send.
struct EditScrollView::Codes {
	uint32 use;
	uint32 total;
	uint32 smallStep;
	uint32 bigStep;
};


// What a bar is set to, to be carried over to another one.
struct EditScrollView::BarState {
	explicit BarState(const BScrollBar* bar)
	{
		if (bar == nullptr)
			return;
		exists = true;
		bar->GetRange(&minimum, &maximum);
		bar->GetSteps(&smallStep, &bigStep);
		value = bar->Value();
	}

	void ApplyTo(BScrollBar* bar) const
	{
		if (!exists || bar == nullptr)
			return;
		bar->SetRange(minimum, maximum);
		bar->SetValue(value);
		bar->SetSteps(smallStep, bigStep);
	}

	bool exists = false;
	float minimum = 0, maximum = 0, value = 0, smallStep = 1, bigStep = 10;
};

namespace {


constexpr uint32 kBorderChosen = 'brdr';
constexpr uint32 kHorizontalUse = 'huse';
constexpr uint32 kHorizontalTotal = 'htot';
constexpr uint32 kHorizontalSmall = 'hsml';
constexpr uint32 kHorizontalBig = 'hbig';
constexpr uint32 kVerticalUse = 'vuse';
constexpr uint32 kVerticalTotal = 'vtot';
constexpr uint32 kVerticalSmall = 'vsml';
constexpr uint32 kVerticalBig = 'vbig';

constexpr float kPanelHeight = 98;
constexpr float kFieldHeight = 20;
constexpr float kFieldGap = 20;
constexpr int kDefaultSmallStep = 1;
constexpr int kDefaultBigStep = 10;


void
CopyLook(const BView* from, BView* to)
{
	to->SetViewColor(from->ViewColor());
	to->SetHighColor(from->HighColor());
	to->SetLowColor(from->LowColor());
	BFont font;
	from->GetFont(&font);
	to->SetFont(&font, B_FONT_ALL);
	to->SetDrawingMode(from->DrawingMode());
	to->MovePenTo(from->PenLocation());
}


} // namespace


EditScrollView::EditScrollView() :
	PanelOf("EditScrollView", "Properties from BScrollView", kPanelHeight)
{
	BRect row = RowArea();
	row.bottom = row.top + kFieldHeight;
	fBorderMenu = MakeBorderMenu(kBorderChosen);
	AddMenuField(this, row, "Border style:", fBorderMenu, 80, B_FOLLOW_LEFT_RIGHT);

	fHorizontal.direction = B_HORIZONTAL;
	fVertical.direction = B_VERTICAL;
	row.OffsetBy(0, kRowStep);
	_AddBarRow(row, fHorizontal, "Horizontal",
		"Total width:", { kHorizontalUse, kHorizontalTotal, kHorizontalSmall, kHorizontalBig });
	row.OffsetBy(0, kRowStep);
	_AddBarRow(row, fVertical, "Vertical",
		"Total height:", { kVerticalUse, kVerticalTotal, kVerticalSmall, kVerticalBig });
}


EditScrollView::~EditScrollView()
{
}


void
EditScrollView::FrameChanged()
{
	if (!TargetLives())
		return;

	TargetLock lock(target);
	_LoadExtent(fHorizontal);
	_LoadExtent(fVertical);
}


bool
EditScrollView::UseView(BView* view)
{
	if (!TakeTarget(view))
		return false;

	MarkChoice(fBorderMenu, _Target()->Border());
	_LoadBar(fHorizontal);
	_LoadBar(fVertical);
	FrameChanged();
	return true;
}


bool
EditScrollView::ApplyEdit(BMessage* message)
{
	switch (message->what) {
		case kBorderChosen:
			_Target()->SetBorder(static_cast<border_style>(Choice(fBorderMenu)));
			target->Invalidate();
			break;
		case kHorizontalTotal:
			_ApplyTotal(fHorizontal);
			break;
		case kVerticalTotal:
			_ApplyTotal(fVertical);
			break;
		case kHorizontalSmall:
		case kHorizontalBig:
			_ApplySteps(fHorizontal);
			break;
		case kVerticalSmall:
		case kVerticalBig:
			_ApplySteps(fVertical);
			break;
		case kHorizontalUse:
			_ToggleBar(fHorizontal, fVertical);
			break;
		case kVerticalUse:
			_ToggleBar(fVertical, fHorizontal);
			break;
		default:
			return false;
	}
	return true;
}


void
EditScrollView::_AddBarRow(
	BRect row, Bar& bar, const char* label, const char* total, const Codes& codes)
{
	BRect frame = FrameAt(row.left, row.top, 60, kFieldHeight);
	bar.use = AddCheckBox(this, frame, label, codes.use);
	frame = FrameAt(frame.right + kFieldGap, row.top, 100, kFieldHeight);
	bar.total = AddFloatControl(this, frame, total, codes.total, 0, 0, FLT_MAX, 60);
	frame = FrameAt(frame.right + kFieldGap, row.top, 85, kFieldHeight);
	bar.smallStep = AddIntControl(this, frame, "Small step:", codes.smallStep, kDefaultSmallStep, 1,
		INT_MAX, 55, B_FOLLOW_RIGHT);
	frame = FrameAt(frame.right + kFieldGap, row.top, 83, kFieldHeight);
	bar.bigStep = AddIntControl(
		this, frame, "Big step:", codes.bigStep, kDefaultBigStep, 0, INT_MAX, 53, B_FOLLOW_RIGHT);
}


void
EditScrollView::_LoadBar(Bar& bar)
{
	const bool exists = _Target()->ScrollBar(bar.direction) != nullptr;
	SetOn(bar.use, exists);
	bar.total->SetEnabled(exists);
	bar.smallStep->SetEnabled(exists);
	bar.bigStep->SetEnabled(exists);
	if (exists)
		return;

	bar.total->SetMin(0);
	bar.total->SetMax(0);
	bar.total->SetFloatValue(0);
	bar.smallStep->SetValue(kDefaultSmallStep);
	bar.bigStep->SetValue(kDefaultBigStep);
}


void
EditScrollView::_LoadExtent(Bar& bar)
{
	const BScrollBar* scrollBar = _Target()->ScrollBar(bar.direction);
	if (scrollBar == nullptr)
		return;

	const float extent = _TargetExtent(bar);
	float minimum, maximum, smallStep, bigStep;
	scrollBar->GetRange(&minimum, &maximum);
	scrollBar->GetSteps(&smallStep, &bigStep);
	bar.total->SetMax(FLT_MAX);
	bar.total->SetMin(extent);
	bar.total->SetFloatValue(extent + maximum);
	bar.smallStep->SetValue(WholeNumber(std::round(smallStep)));
	bar.bigStep->SetValue(WholeNumber(std::round(bigStep)));
}


float
EditScrollView::_TargetExtent(const Bar& bar) const
{
	const BView* view = _Target()->Target();
	if (view == nullptr)
		return 0;
	return bar.direction == B_HORIZONTAL ? view->Bounds().Width() : view->Bounds().Height();
}


void
EditScrollView::_ApplyTotal(const Bar& bar)
{
	BScrollBar* scrollBar = _Target()->ScrollBar(bar.direction);
	const float total = bar.total->FloatValue();
	if (scrollBar == nullptr || total <= 0)
		return;

	const float extent = _TargetExtent(bar);
	scrollBar->SetRange(0, total - extent);
	scrollBar->SetProportion(extent / total);
}


void
EditScrollView::_ApplySteps(const Bar& bar)
{
	if (BScrollBar* scrollBar = _Target()->ScrollBar(bar.direction)) {
		scrollBar->SetSteps(
			static_cast<float>(bar.smallStep->Value()), static_cast<float>(bar.bigStep->Value()));
	}
}


// A scroll view has its bars from the start, so a new one takes its place. It is selected, and so
// becomes the target, before the old one goes.
void
EditScrollView::_ToggleBar(const Bar& toggled, const Bar& kept)
{
	BScrollView* old = _Target();
	BView* parent = old->Parent();
	BView* child = old->ChildAt(0);
	if (parent == nullptr || child == nullptr || child != old->Target()) {
		beep();
		return;
	}

	const BarState state(old->ScrollBar(kept.direction));
	child->ScrollTo(BPoint(0, 0));
	const BPoint place = parent->ConvertFromScreen(child->ConvertToScreen(BPoint(0, 0)));
	parent->RemoveChild(old);
	old->SetTarget(NULL);
	if (child->Parent() != nullptr)
		child->RemoveSelf();
	child->MoveTo(place);

	BScrollView* scrollView = _RebuildAround(child);
	state.ApplyTo(scrollView->ScrollBar(kept.direction));
	if (BScrollBar* bar = scrollView->ScrollBar(toggled.direction))
		bar->SetRange(0, 0);
	SetProportions(scrollView);
	CopyLook(old, scrollView);
	ColorfulAddChild(parent, scrollView);
	beep(); // also when all went well

	ReplaceInEditor(this, old, scrollView);
	TakeTarget(scrollView);
	delete old;
}


// The event mask is given as the resizing mode, as it is meant to be.
BScrollView*
EditScrollView::_RebuildAround(BView* child) const
{
	BScrollView* old = _Target();
	return new BScrollView(old->Name(), child, old->EventMask(), old->Flags(),
		IsOn(fHorizontal.use), IsOn(fVertical.use), old->Border());
}
