#include <TabView.h>

#include <algorithm>
#include <cmath>

#include <Message.h>
#include <String.h>
#include <Window.h>

#include "interface/private/Label.h"
#include "interface/private/Look.h"
#include "interface/private/StandInView.h"
#include "interface/private/ViewArchive.h"

namespace Look = BPrivate::Look;

using BPrivate::ArchiveWriter;
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
	fContainer(NULL), fWidthSetting(width),
	fTabHeight(LabelMetrics(this).lineHeight + kHeightPadding), fSelection(-1), fFocus(-1)
{
	_InitContainer();
}


BTabView::BTabView(BMessage* archive) :
	BView(archive), fContainer(NULL), fWidthSetting(B_WIDTH_AS_USUAL),
	fTabHeight(LabelMetrics(this).lineHeight + kHeightPadding), fSelection(-1), fFocus(-1)
{
	int16 width;
	if (archive->FindInt16("_but_width", &width) == B_OK)
		fWidthSetting = static_cast<button_width>(width);
	float height;
	if (archive->FindFloat("_high", &height) == B_OK)
		fTabHeight = height;

	fContainer = ChildAt(0);
	if (fContainer == NULL)
		_InitContainer();
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


// #pragma mark - archive


BArchivable*
BTabView::Instantiate(BMessage* archive)
{
	return validate_instantiation(archive, "BTabView") ? new BTabView(archive) : NULL;
}


namespace {

// What stands for a page whose class is not available keeps its archive.
BView*
RevivePage(const BMessage* archive, const char* field, int32 index)
{
	BMessage item;
	if (archive->FindMessage(field, index, &item) != B_OK)
		return NULL;
	BArchivable* object = instantiate_object(&item);
	if (BView* page = dynamic_cast<BView*>(object))
		return page;
	delete object;
	return new BPrivate::StandInView(&item);
}


BTab*
ReviveTab(const BMessage* archive, int32 index)
{
	BMessage item;
	if (archive->FindMessage("_l_items", index, &item) != B_OK)
		return new BTab;
	BArchivable* object = instantiate_object(&item);
	if (BTab* tab = dynamic_cast<BTab*>(object))
		return tab;
	delete object;
	return new BTab(&item);
}


// The archives of the pages go into the field, in the places of those that it has already.
status_t
PutPages(BMessage* archive, const char* field, int32 first, const std::vector<BMessage>& pages)
{
	status_t status = B_OK;
	for (size_t i = 0; status == B_OK && i < pages.size(); i++) {
		const int32 index = first + static_cast<int32>(i);
		status = archive->HasMessage(field, index)
			? archive->ReplaceMessage(field, index, &pages[i])
			: archive->AddMessage(field, &pages[i]);
	}
	return status;
}

} // namespace


void
BTabView::_ReadTabs(BMessage* archive)
{
	int32 count = 0;
	archive->GetInfo("_l_items", NULL, &count);
	int32 listed = 0;
	archive->GetInfo("_view_list", NULL, &listed);

	// Old archives have no list but the pages beside, or inside of, the container, in tab order.
	if (listed == 0 && CountChildren() > 1)
		fPagePlace = PagePlace::kBesideContainer;
	else if (listed == 0 && fContainer->CountChildren() > 0)
		fPagePlace = PagePlace::kInContainer;

	std::vector<BView*> pages;
	if (fPagePlace == PagePlace::kList) {
		for (int32 i = 0; i < listed; i++)
			pages.push_back(RevivePage(archive, "_view_list", i));
		// An archive may have the selected page in the container as well: the list's copy counts.
		while (BView* copy = fContainer->ChildAt(0)) {
			copy->RemoveSelf();
			delete copy;
		}
	} else {
		const bool beside = fPagePlace == PagePlace::kBesideContainer;
		while (BView* page = beside ? ChildAt(1) : fContainer->ChildAt(0)) {
			page->RemoveSelf();
			pages.push_back(page);
		}
	}

	// A tab without a page gets an empty one, so that the others keep their numbers.
	const int32 tabs = std::max(count, static_cast<int32>(pages.size()));
	for (int32 i = 0; i < tabs; i++) {
		BView* page = i < static_cast<int32>(pages.size()) ? pages[i] : NULL;
		if (page == NULL)
			page = new BView(fContainer->Bounds(), NULL, B_FOLLOW_ALL, B_WILL_DRAW);
		BTab* tab = ReviveTab(archive, i);
		tab->SetView(page);
		tab->fOwner = this;
		fTabs.push_back(tab);
	}
}


status_t
BTabView::Archive(BMessage* archive, bool deep) const
{
	BPrivate::ArchiveScope scope(this, archive);
	status_t status = BView::Archive(archive, deep);
	if (status != B_OK)
		return status;

	ArchiveWriter writer(archive);
	writer.Int16("_but_width", static_cast<int16>(fWidthSetting), B_WIDTH_AS_USUAL);
	writer.Float("_high", fTabHeight, LabelMetrics(this).lineHeight + kHeightPadding);
	writer.Int32("_sel", fSelection, -1);
	status = writer.Status();
	if (status == B_OK && deep)
		status = _ArchiveTabs(archive, writer.Source());
	return status == B_OK ? scope.Finish() : status;
}


// Each page is stored once: the container's archive leaves the shown one out, as long as the pages
// are not stored right there.
status_t
BTabView::_ArchiveTabs(BMessage* archive, const BMessage& source) const
{
	std::vector<BMessage> pages(fTabs.size());
	status_t status = B_OK;
	for (size_t i = 0; status == B_OK && i < fTabs.size(); i++) {
		BMessage tab;
		status = fTabs[i]->Archive(&tab, true);
		if (status == B_OK)
			status = archive->AddMessage("_l_items", &tab);
		if (status == B_OK && fTabs[i]->View() != NULL)
			status = BPrivate::archive_as_child(fTabs[i]->View(), &pages[i]);
		if (status == B_OK && fPagePlace == PagePlace::kList)
			status = archive->AddMessage("_view_list", &pages[i]);
	}

	BMessage container;
	if (status != B_OK || archive->FindMessage("_views", 0, &container) != B_OK)
		return status;
	if (fPagePlace == PagePlace::kInContainer)
		status = PutPages(&container, "_views", 0, pages);
	else {
		container.RemoveName("_views");
		_RestoreContainer(&container, source);
	}
	if (status == B_OK)
		status = archive->ReplaceMessage("_views", 0, &container);
	if (status == B_OK && fPagePlace == PagePlace::kBesideContainer)
		status = PutPages(archive, "_views", 1, pages);
	return status;
}


// What an archive had in the container besides its list stays there.
void
BTabView::_RestoreContainer(BMessage* container, const BMessage& source) const
{
	BMessage read;
	if (source.FindMessage("_views", 0, &read) != B_OK)
		return;
	BMessage copy;
	for (int32 i = 0; read.FindMessage("_views", i, &copy) == B_OK; i++)
		container->AddMessage("_views", &copy);
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


// #pragma mark - mouse and keys


int32
BTabView::_TabAt(BPoint where) const
{
	for (int32 i = 0; i < CountTabs(); i++) {
		if (TabFrame(i).Contains(where))
			return i;
	}
	return -1;
}


void
BTabView::MouseDown(BPoint where)
{
	const int32 index = where.y <= fTabHeight ? _TabAt(where) : -1;
	if (index < 0) {
		BView::MouseDown(where);
		return;
	}
	if (fTabs[index]->IsEnabled())
		Select(index);
}


void
BTabView::MouseUp(BPoint where)
{
	BView::MouseUp(where);
}


void
BTabView::MouseMoved(BPoint where, uint32 transit, const BMessage* dragMessage)
{
	BView::MouseMoved(where, transit, dragMessage);
}


void
BTabView::KeyDown(const char* bytes, int32 numBytes)
{
	if (numBytes != 1 || IsHidden() || CountTabs() == 0) {
		BView::KeyDown(bytes, numBytes);
		return;
	}

	switch (bytes[0]) {
		case B_LEFT_ARROW:
		case B_DOWN_ARROW:
			SetFocusTab(fFocus <= 0 ? CountTabs() - 1 : fFocus - 1, true);
			break;
		case B_RIGHT_ARROW:
		case B_UP_ARROW:
			SetFocusTab(fFocus >= CountTabs() - 1 ? 0 : fFocus + 1, true);
			break;
		case B_SPACE:
		case B_ENTER:
			if (fFocus >= 0 && fTabs[fFocus]->IsEnabled())
				Select(fFocus);
			break;
		default:
			BView::KeyDown(bytes, numBytes);
			break;
	}
}


void
BTabView::MakeFocus(bool focused)
{
	BView::MakeFocus(focused);
	SetFocusTab(std::max<int32>(fSelection, 0), focused);
}


void
BTabView::SetFocusTab(int32 tab, bool focused)
{
	const int32 before = fFocus;
	if (before >= 0 && before < CountTabs())
		fTabs[before]->MakeFocus(false);
	fFocus = focused && tab >= 0 && tab < CountTabs() ? tab : -1;
	if (fFocus >= 0)
		fTabs[fFocus]->MakeFocus(true);
	if (fFocus != before)
		_InvalidateTabs();
}


int32
BTabView::FocusTab() const
{
	return fFocus;
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
