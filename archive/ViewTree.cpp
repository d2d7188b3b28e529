#include "archive/ViewTree.h"

#include <algorithm>
#include <cmath>
#include <cstdio>
#include <vector>

#include <AppDefs.h>
#include <Bitmap.h>
#include <Handler.h>
#include <Invoker.h>
#include <ListView.h>
#include <Looper.h>
#include <Menu.h>
#include <MenuItem.h>
#include <ScrollBar.h>
#include <ScrollView.h>
#include <TabView.h>
#include <TextControl.h>
#include <View.h>
#include <Window.h>

#include "archive/BitmapView.h"

namespace {


constexpr rgb_color kBarFrameColor = { 152, 152, 152, 255 };
constexpr rgb_color kBarFillColor = { 240, 240, 240, 255 };
constexpr rgb_color kBarLightColor = { 255, 255, 255, 255 };


struct SavedColors {
	BView* owner; // borrowed
	rgb_color view;
	rgb_color low;
};


// The pages of a tab view are in its tree only while they are shown, and which one is shown may
// change when it is attached; so all of them are saved.
void
SaveColors(BView* view, std::vector<SavedColors>& colors)
{
	colors.push_back({ view, view->ViewColor(), view->LowColor() });

	if (BTabView* tabView = dynamic_cast<BTabView*>(view)) {
		for (int32 i = 0; i < tabView->CountTabs(); i++) {
			BView* page = tabView->ViewForTab(i);
			if (page != nullptr && page->Parent() == nullptr)
				SaveColors(page, colors);
		}
	}
	for (BView* child = view->ChildAt(0); child != nullptr; child = child->NextSibling())
		SaveColors(child, colors);
}


template<class Parent, class... Before>
BView*
AddKeepingColors(Parent* parent, BView* child, Before*... before)
{
	if (child == nullptr)
		return nullptr;

	std::vector<SavedColors> colors;
	SaveColors(child, colors);
	parent->AddChild(child, before...);
	for (const SavedColors& saved : colors) {
		saved.owner->SetViewColor(saved.view);
		saved.owner->SetLowColor(saved.low);
	}
	return child;
}


// Calls the function for every view of the tree, a parent before its children.
template<class Function>
void
ForEachView(BView* view, const Function& function)
{
	function(view);
	for (BView* child = view->ChildAt(0); child != nullptr; child = child->NextSibling())
		ForEachView(child, function);
}


// Calls the function for every item of the menu and of its submenus.
template<class Function>
void
ForEachItem(BMenu* menu, const Function& function)
{
	for (int32 i = 0; BMenuItem* item = menu->ItemAt(i); i++) {
		function(item);
		if (BMenu* submenu = item->Submenu())
			ForEachItem(submenu, function);
	}
}


// Aims a tree by a function that aims one invoker.
template<class Function>
void
AimTree(BView* view, const Function& aim)
{
	ForEachView(view, [&aim](BView* each) {
		if (BInvoker* invoker = dynamic_cast<BInvoker*>(each))
			aim(invoker);
		if (BMenu* menu = dynamic_cast<BMenu*>(each))
			ForEachItem(menu, aim);
	});
}


float
BarValue(const BView* view, orientation direction)
{
	const BScrollBar* bar = view->ScrollBar(direction);
	return bar != nullptr ? bar->Value() : 0;
}


void
SetBarRange(BScrollBar* bar, float content, float visible)
{
	if (bar == nullptr)
		return;

	bar->SetRange(0, std::max(0.0f, std::ceil(content - visible)));
	SetProportion(bar);
}


void
DrawFlatScrollBar(BView* bar)
{
	const rgb_color highColor = bar->HighColor();
	const BRect bounds = bar->Bounds();

	bar->SetHighColor(kBarFrameColor);
	bar->StrokeRect(bounds);
	bar->SetHighColor(kBarFillColor);
	bar->FillRect(bounds.InsetByCopy(1, 1));
	bar->SetHighColor(kBarLightColor);
	const BPoint corner(bounds.left + 1, bounds.top + 1);
	bar->StrokeLine(BPoint(bounds.left + 1, bounds.bottom - 1), corner);
	bar->StrokeLine(corner, BPoint(bounds.right - 1, bounds.top + 1));

	bar->SetHighColor(highColor);
}


} // namespace


BView*
ColorfulAddChild(BView* parent, BView* child, BView* before)
{
	return AddKeepingColors(parent, child, before);
}


BView*
ColorfulAddChild(BWindow* window, BView* child)
{
	return AddKeepingColors(window, child);
}


BView*
ColorfulAddChild(BBitmap* bitmap, BView* child)
{
	return AddKeepingColors(bitmap, child);
}


bool
FrameControled(const BView* view)
{
	const BView* parent = view != nullptr ? view->Parent() : nullptr;
	if (parent == nullptr)
		return false;

	return dynamic_cast<const BScrollView*>(parent) != nullptr
		|| dynamic_cast<const BTextControl*>(parent) != nullptr
		|| dynamic_cast<const BTabView*>(parent) != nullptr
		|| dynamic_cast<const BTabView*>(parent->Parent()) != nullptr
		|| dynamic_cast<const BListView*>(parent) != nullptr;
}


filter_result
WatchMessages(BMessage* message, BHandler** target, BMessageFilter* filter)
{
	constexpr uint32 kPendingEvents = '_EVP'; // the platform's own notice, without a public name
	const uint32 what = message->what;
	if (what != B_PULSE && what != kPendingEvents && what != B_MOUSE_MOVED) {
		printf("%c%c%c%c\n", static_cast<char>(what >> 24), static_cast<char>(what >> 16),
			static_cast<char>(what >> 8), static_cast<char>(what));
	}
	return B_DISPATCH_MESSAGE;
}


filter_result
ActivateOnClick(BMessage* message, BHandler** target, BMessageFilter* filter)
{
	if (message->what == B_MOUSE_DOWN) {
		if (BWindow* window = dynamic_cast<BWindow*>(filter->Looper()))
			window->Activate(true);
	}
	return B_DISPATCH_MESSAGE;
}


BView*
PointInView(BView* view, BPoint point, BView* exclude)
{
	if (view == exclude || !view->Bounds().Contains(point))
		return nullptr;

	if (BScrollView* scrollView = dynamic_cast<BScrollView*>(view)) {
		BView* target = scrollView->Target();
		BView* found = target != nullptr
			? PointInView(target, target->ConvertFromParent(point), exclude)
			: nullptr;
		return found != nullptr ? found : view;
	}

	for (BView* child = view->ChildAt(0); child != nullptr; child = child->NextSibling()) {
		if (BView* found = PointInView(child, child->ConvertFromParent(point), exclude))
			return found;
	}
	return view;
}


BView*
ViewAttached(BView* root, BView* view)
{
	if (root == nullptr || view == nullptr)
		return nullptr;
	if (root == view)
		return view;

	for (BView* child = root->ChildAt(0); child != nullptr; child = child->NextSibling()) {
		if (ViewAttached(child, view) != nullptr)
			return view;
	}
	return nullptr;
}


BView*
LiveViewAttached(const BView* root, BView* view)
{
	if (root == nullptr)
		return nullptr;

	for (const BView* each = view; each != nullptr; each = each->Parent()) {
		if (each == root)
			return view;
	}
	return nullptr;
}


std::vector<int32>
PathTo(const BView* root, const BView* view)
{
	std::vector<int32> path;
	for (; view != nullptr && view != root; view = view->Parent()) {
		int32 index = 0;
		for (BView* before = view->PreviousSibling(); before != nullptr;
			 before = before->PreviousSibling())
			index++;
		path.push_back(index);
	}
	std::reverse(path.begin(), path.end());
	return path;
}


BView*
ViewAtPath(BView* root, const std::vector<int32>& path)
{
	BView* view = root;
	for (int32 index : path) {
		BView* child = view->ChildAt(index);
		if (child == nullptr)
			break;
		view = child;
	}
	return view;
}


void
SetTarget(BView* view, BMessenger target)
{
	AimTree(view, [&target](BInvoker* invoker) { invoker->SetTarget(target); });
}


void
SetTarget(BView* view, const BHandler* handler, const BLooper* looper)
{
	AimTree(view, [=](BInvoker* invoker) { invoker->SetTarget(handler, looper); });
}


void
SetTarget(BMenu* menu, BMessenger target)
{
	ForEachItem(menu, [&target](BMenuItem* item) { item->SetTarget(target); });
}


void
SetTarget(BMenu* menu, const BHandler* handler, const BLooper* looper)
{
	ForEachItem(menu, [=](BMenuItem* item) { item->SetTarget(handler, looper); });
}


BPoint
ScrolledBy(const BView* view)
{
	const BView* parent = view->Parent();
	if (parent == nullptr)
		return BPoint(0, 0);
	return BPoint(BarValue(parent, B_HORIZONTAL), BarValue(parent, B_VERTICAL));
}


void
MoveScrolledViews(BView* view, bool undo)
{
	ForEachView(view, [undo](BView* each) {
		const BPoint offset = ScrolledBy(each);
		if (undo)
			each->MoveBy(-offset.x, -offset.y);
		else
			each->MoveBy(offset.x, offset.y);
	});
}


void
InvalidateViewTree(BView* view)
{
	ForEachView(view, [](BView* each) { each->Invalidate(); });
}


void
SetProportion(BScrollBar* bar)
{
	if (bar == nullptr || bar->Target() == nullptr)
		return;

	const BRect bounds = bar->Target()->Bounds();
	const float visible = bar->Orientation() == B_HORIZONTAL ? bounds.Width() : bounds.Height();
	float minimum, maximum;
	bar->GetRange(&minimum, &maximum);
	const float whole = maximum - minimum + visible;
	bar->SetProportion(whole > 0 ? visible / whole : 1); // all of a target without extent
}


void
SetProportions(BScrollView* view)
{
	if (view == nullptr)
		return;

	SetProportion(view->ScrollBar(B_HORIZONTAL));
	SetProportion(view->ScrollBar(B_VERTICAL));
}


void
SetRange(BScrollView* view, float width, float height)
{
	if (view == nullptr || view->Target() == nullptr)
		return;

	const BRect bounds = view->Target()->Bounds();
	SetBarRange(view->ScrollBar(B_HORIZONTAL), width, bounds.Width());
	SetBarRange(view->ScrollBar(B_VERTICAL), height, bounds.Height());
}


void
EraseBackground(BView* view)
{
	if (view == nullptr)
		return;

	view->WindowActivated(true);
	if (dynamic_cast<BScrollBar*>(view) != nullptr)
		return;

	const BitmapView* bitmapView = dynamic_cast<const BitmapView*>(view);
	if (bitmapView != nullptr && bitmapView->Bitmap() != nullptr)
		view->DrawBitmap(bitmapView->Bitmap());
	else {
		const rgb_color highColor = view->HighColor();
		view->SetHighColor(view->ViewColor());
		view->FillRect(view->Bounds(), B_SOLID_HIGH);
		view->SetHighColor(highColor);
	}

	for (BView* child = view->ChildAt(0); child != nullptr; child = child->NextSibling())
		EraseBackground(child);
}


void
DrawView(BView* view)
{
	if (view == nullptr)
		return;

	if (dynamic_cast<BScrollBar*>(view) != nullptr) {
		DrawFlatScrollBar(view);
		return;
	}

	// As in an update, what a view sets for its drawing does not stay: it would be archived.
	view->PushState();
	view->Draw(view->Bounds());
	view->PopState();
	for (BView* child = view->ChildAt(0); child != nullptr; child = child->NextSibling()) {
		DrawView(child);
		child->Sync();
	}
}
