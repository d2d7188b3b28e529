// What windows, bars and controls do to views.
#include "interface/private/ViewPrivate.h"

#include <Debug.h>
#include <ScrollBar.h>
#include <Shelf.h>
#include <Window.h>

#include "app/private/HandlerPrivate.h"
#include "interface/private/ViewArchive.h"
#include "interface/private/ViewState.h"
#include "interface/private/ViewWalk.h"
#include "interface/private/WindowInternals.h"

namespace BPrivate {


bool
is_revived(const BView* view)
{
	return view != nullptr && ViewPrivate(view).Source() != nullptr;
}


bool
ViewPrivate::Insert(ServerView* parent, BView* child, BView* before, BWindow* window)
{
	if (child == nullptr)
		return false;
	ServerView* node = child->fNode;
	if (node->Parent() != nullptr) {
		debugger("AddChild(): the view already has a parent.");
		return false;
	}
	if (before != nullptr && before->fNode->Parent() != parent) {
		debugger("AddChild(): the view to insert before is no child of this parent.");
		return false;
	}
	// Only a view with children can contain its own new parent.
	if (node->FirstChild() != nullptr || node == parent) {
		for (const ServerView* above = parent; above != nullptr; above = above->Parent()) {
			if (above == node) {
				debugger("AddChild(): a view cannot be inside of itself.");
				return false;
			}
		}
	}

	child->fEntry = 0;
	parent->InsertChild(node, before != nullptr ? before->fNode : nullptr);
	if (window != nullptr)
		ViewPrivate(child).Attach(window);
	else
		HandlerPrivate(child).SetNextHandler(parent->Owner());
	return true;
}


void
ViewPrivate::Attach(BWindow* window)
{
	WindowInternals& internals = WindowInternals::Of(window);
	ServerView& top = *fView->fNode;
	for (ServerView* node = &top; node != nullptr; node = node->NextInTree(&top)) {
		BView* view = node->Owner();
		view->fOwner = window;
		HandlerPrivate handler(view);
		handler.SetLooper(window);
		BView* parent = node->Parent()->Owner();
		handler.SetNextHandler(parent != nullptr ? static_cast<BHandler*>(parent) : window);
		if (view->fExtras != nullptr && view->fExtras->shelf != nullptr)
			window->AddHandler(view->fExtras->shelf);
	}
	internals.ViewsEntered(top);
	ViewWalk walk(top, internals.walks, ViewWalk::kAttachment);
	if (walk.ParentsFirst([](BView& view) { view.AttachedToWindow(); }))
		walk.ChildrenFirst([](BView& view) { view.AllAttached(); });
}


void
ViewPrivate::Detach()
{
	BWindow* window = fView->fOwner;
	WindowInternals& internals = WindowInternals::Of(window);
	ServerView& top = *fView->fNode;
	{
		ViewWalk walk(top, internals.walks, ViewWalk::kAttachment);
		const bool complete = walk.ParentsFirst([](BView& view) { view.DetachedFromWindow(); })
			&& walk.ChildrenFirst([](BView& view) { view.AllDetached(); });
		if (!complete)
			return; // a hook has taken the view out itself
	}
	ViewWalk::Leave(internals.walks, top);
	internals.ViewsLeave(top);
	top.Unlink();
	for (ServerView* node = &top; node != nullptr; node = node->NextInTree(&top)) {
		BView* view = node->Owner();
		view->fOwner = nullptr;
		HandlerPrivate handler(view);
		handler.SetLooper(nullptr);
		const ServerView* parent = node->Parent();
		handler.SetNextHandler(parent != nullptr ? parent->Owner() : nullptr);
		if (view->fExtras != nullptr && view->fExtras->shelf != nullptr)
			window->RemoveHandler(view->fExtras->shelf);
	}
}


void
ViewPrivate::SetShelf(BShelf* shelf)
{
	BShelf*& current = fView->_Extras()->shelf;
	if (current != nullptr && shelf != nullptr)
		current->_ContainerGone();
	else if (current != nullptr && current->Looper() != nullptr)
		current->Looper()->RemoveHandler(current);
	current = shelf;
	if (shelf != nullptr && fView->fOwner != nullptr)
		fView->fOwner->AddHandler(shelf);
}


void
ViewPrivate::SetScrollBar(orientation direction, BScrollBar* bar)
{
	if (bar != nullptr || fView->fExtras != nullptr)
		fView->_Extras()->bars[direction == B_VERTICAL ? 1 : 0] = bar;
}


bool
ViewPrivate::ScrollByWheel(BView* view, float dx, float dy)
{
	constexpr float kLinesPerNotch = 3;
	for (; view != nullptr; view = view->Parent()) {
		bool scrolled = false;
		for (const orientation direction : { B_HORIZONTAL, B_VERTICAL }) {
			const float delta = direction == B_VERTICAL ? dy : dx;
			BScrollBar* bar = view->ScrollBar(direction);
			if (bar == nullptr || delta == 0)
				continue;
			float smallStep, largeStep;
			bar->GetSteps(&smallStep, &largeStep);
			bar->SetValue(bar->Value() + delta * smallStep * kLinesPerNotch);
			scrolled = true;
		}
		if (scrolled)
			return true;
	}
	return false;
}


} // namespace BPrivate
