#include <TabView.h>

#include <algorithm>
#include <cmath>

#include <Message.h>
#include <String.h>
#include <Window.h>

#include "interface/private/Label.h"
#include "interface/private/Look.h"
#include "interface/private/ViewArchive.h"

namespace Look = BPrivate::Look;

using BPrivate::is_revived;
using BPrivate::label_width;
using BPrivate::LabelMetrics;

namespace {

constexpr float kTabPadding = 16; // left and right of a label together
constexpr float kHeightPadding = 8; // above and below it together
constexpr float kUsualWidth = 5 * kTabPadding;
constexpr float kFirstTabLeft = 8;
constexpr float kContainerInset = 3;
constexpr const char* kContainerName = "view container";

} // namespace


BTabView::BTabView(
	BRect frame, const char* name, button_width width, uint32 resizingMode, uint32 flags) :
	BView(frame, name, resizingMode, flags),
	fContainer(NULL), fWidthSetting(width), fTabHeight(_UsualTabHeight()), fSelection(-1),
	fFocus(-1)
{
	_InitContainer();
}


BTabView::BTabView(BMessage* archive) :
	BView(archive), fContainer(NULL), fWidthSetting(B_WIDTH_AS_USUAL),
	fTabHeight(_UsualTabHeight()), fSelection(-1), fFocus(-1)
{
	int16 width;
	if (archive->FindInt16("_but_width", &width) == B_OK)
		fWidthSetting = static_cast<button_width>(width);
	float height;
	if (archive->FindFloat("_high", &height) == B_OK)
		fTabHeight = height;

	_FindContainer(*archive);
	_ReadTabs(archive);

	int32 selection;
	if (archive->FindInt32("_sel", &selection) == B_OK && selection >= 0
		&& selection < CountTabs()) {
		_Show(selection);
	}
}


BTabView::~BTabView()
{
	// A shown page is the container's child, which would delete it a second time.
	_Show(-1);
	for (BTab* tab : fTabs) {
		tab->fOwner = NULL;
		delete tab;
	}
}


void
BTabView::_InitContainer()
{
	BRect frame = Bounds();
	frame.top += fTabHeight;
	frame.InsetBy(kContainerInset, kContainerInset);
	fContainer = new BView(frame, kContainerName, B_FOLLOW_ALL, B_WILL_DRAW);
	fContainer->SetViewColor(Look::PanelColor());
	fContainer->SetLowColor(Look::PanelColor());
	AddChild(fContainer);
}


// #pragma mark - hooks


void
BTabView::AttachedToWindow()
{
	if (!is_revived(this)) {
		const rgb_color color = Look::PanelColor();
		for (BView* view : { static_cast<BView*>(this), fContainer }) {
			view->SetViewColor(color);
			view->SetLowColor(color);
		}
		if (fSelection < 0 && CountTabs() > 0)
			Select(0);
	}
	BView::AttachedToWindow();
}


void
BTabView::AllAttached()
{
	BView::AllAttached();
}


void
BTabView::DetachedFromWindow()
{
	fFocus = -1;
	BView::DetachedFromWindow();
}


void
BTabView::AllDetached()
{
	BView::AllDetached();
}


void
BTabView::WindowActivated(bool active)
{
	BView::WindowActivated(active);
	if (IsFocus())
		_InvalidateTabs();
}


void
BTabView::MessageReceived(BMessage* message)
{
	BView::MessageReceived(message);
}


void
BTabView::FrameMoved(BPoint newPosition)
{
	BView::FrameMoved(newPosition);
}


void
BTabView::FrameResized(float width, float height)
{
	BView::FrameResized(width, height);
}


void
BTabView::Pulse()
{
	BView::Pulse();
}


void
BTabView::SetFlags(uint32 flags)
{
	BView::SetFlags(flags);
}


void
BTabView::SetResizingMode(uint32 mode)
{
	BView::SetResizingMode(mode);
}


void
BTabView::GetPreferredSize(float* _width, float* _height)
{
	BView::GetPreferredSize(_width, _height);
}


void
BTabView::ResizeToPreferred()
{
	BView::ResizeToPreferred();
}


BHandler*
BTabView::ResolveSpecifier(
	BMessage* message, int32 index, BMessage* specifier, int32 what, const char* property)
{
	return BView::ResolveSpecifier(message, index, specifier, what, property);
}


status_t
BTabView::GetSupportedSuites(BMessage* message)
{
	return BView::GetSupportedSuites(message);
}


status_t
BTabView::Perform(perform_code code, void* data)
{
	return BView::Perform(code, data);
}


// #pragma mark - tabs


void
BTabView::AddTab(BView* tabContents, BTab* tab)
{
	if (tab == NULL)
		tab = new BTab;
	tab->SetView(tabContents);
	tab->fOwner = this;
	fTabs.push_back(tab);

	if (CountTabs() == 1 && Window() != NULL)
		Select(0);
	_InvalidateTabs();
}


BTab*
BTabView::RemoveTab(int32 index)
{
	if (index < 0 || index >= CountTabs())
		return NULL;

	BTab* tab = fTabs[index];
	const int32 selection = fSelection;
	if (index == selection)
		_Show(-1);
	fTabs.erase(fTabs.begin() + index);
	tab->fOwner = NULL;
	tab->MakeFocus(false);
	if (fFocus >= CountTabs())
		fFocus = CountTabs() - 1;

	if (index < selection) {
		// The same page stays shown under its new number.
		fSelection = selection - 1;
	} else if (index == selection && CountTabs() > 0)
		Select(std::max<int32>(selection - 1, 0));
	_InvalidateTabs();
	return tab;
}


BTab*
BTabView::TabAt(int32 index) const
{
	return index >= 0 && index < CountTabs() ? fTabs[index] : NULL;
}


BView*
BTabView::ViewForTab(int32 index) const
{
	const BTab* tab = TabAt(index);
	return tab != NULL ? tab->View() : NULL;
}


int32
BTabView::CountTabs() const
{
	return static_cast<int32>(fTabs.size());
}


void
BTabView::Select(int32 index)
{
	if (index < 0 || index >= CountTabs())
		index = fSelection;
	if (index < 0 || index == fSelection)
		return;
	_Show(index);
	if (fFocus >= 0)
		SetFocusTab(index, true);
	_InvalidateTabs();
}


// Takes the shown page out and puts the one of the index in; -1 shows none.
void
BTabView::_Show(int32 index)
{
	if (BTab* tab = TabAt(fSelection))
		tab->Deselect();
	fSelection = index;
	if (BTab* tab = TabAt(index))
		tab->Select(fContainer);
}


int32
BTabView::Selection() const
{
	return fSelection;
}


BView*
BTabView::ContainerView() const
{
	return fContainer;
}


// #pragma mark - geometry


void
BTabView::SetTabWidth(button_width width)
{
	if (width == fWidthSetting)
		return;
	fWidthSetting = width;
	_InvalidateTabs();
}


button_width
BTabView::TabWidth() const
{
	return fWidthSetting;
}


void
BTabView::SetTabHeight(float height)
{
	if (height == fTabHeight)
		return;
	const float growth = height - fTabHeight;
	fTabHeight = height;
	fContainer->MoveBy(0, growth);
	fContainer->ResizeBy(0, -growth);
	Invalidate();
}


float
BTabView::TabHeight() const
{
	return fTabHeight;
}


float
BTabView::_UsualTabHeight() const
{
	return LabelMetrics(this).lineHeight + kHeightPadding;
}


float
BTabView::_LabelWidth(int32 index) const
{
	return label_width(this, fTabs[index]->Label());
}


BRect
BTabView::TabFrame(int32 index) const
{
	if (index < 0 || index >= CountTabs())
		return BRect();

	float width = kUsualWidth;
	float left = kFirstTabLeft;
	if (fWidthSetting == B_WIDTH_FROM_LABEL) {
		for (int32 i = 0; i < index; i++)
			left += _LabelWidth(i) + kTabPadding;
		width = _LabelWidth(index) + kTabPadding;
	} else {
		if (fWidthSetting == B_WIDTH_FROM_WIDEST) {
			width = 0;
			for (int32 i = 0; i < CountTabs(); i++)
				width = std::max(width, _LabelWidth(i) + kTabPadding);
		}
		left += index * width;
	}
	return BRect(left, 0, left + width, fTabHeight);
}


void
BTabView::_InvalidateTabs()
{
	const BRect bounds = Bounds();
	Invalidate(
		BRect(bounds.left, bounds.top, bounds.right, bounds.top + fTabHeight + kContainerInset));
}


// #pragma mark - drawing


void
BTabView::Draw(BRect updateRect)
{
	DrawBox(DrawTabs());
}


BRect
BTabView::DrawTabs()
{
	for (int32 i = 0; i < CountTabs(); i++) {
		if (i != fSelection)
			fTabs[i]->DrawTab(this, TabFrame(i), i == 0 ? B_TAB_FIRST : B_TAB_ANY, true);
	}
	if (fSelection < 0 || fSelection >= CountTabs())
		return BRect();

	// The one in front covers the edges of its neighbours.
	const BRect frame = TabFrame(fSelection);
	fTabs[fSelection]->DrawTab(this, frame, B_TAB_FRONT, true);
	return frame;
}


void
BTabView::DrawBox(BRect selectedTabRect)
{
	BRect frame = Bounds();
	frame.top += fTabHeight;
	Look::DrawTabBody(this, frame, selectedTabRect, Look::BaseColor(this));
}
