#include "interface/private/ViewWalk.h"

#include <View.h>

#include "server/ServerView.h"

namespace BPrivate {

namespace {

ServerView*
first_in_post_order(ServerView* view)
{
	while (view->FirstChild() != nullptr)
		view = view->FirstChild();
	return view;
}


ServerView*
next_in_post_order(ServerView* view, const ServerView* top)
{
	if (view == top)
		return nullptr;
	return view->Next() != nullptr ? first_in_post_order(view->Next()) : view->Parent();
}


bool
is_in(const ServerView* view, const ServerView& top)
{
	while (view != nullptr && view != &top)
		view = view->Parent();
	return view != nullptr;
}

} // namespace


ViewWalk::ViewWalk(ServerView& top, ViewWalk*& list, Purpose purpose) :
	fList(list), fNext(list), fTop(&top), fFirstMark(purpose == kAttachment ? 1 : 4),
	fSecondMark(purpose == kAttachment ? 2 : 8)
{
	fList = this;
	for (ServerView* view = &top; view != nullptr; view = view->NextInTree(&top))
		view->SetMarks(view->Marks() | fFirstMark | fSecondMark);
}


ViewWalk::~ViewWalk()
{
	fList = fNext;
}


bool
ViewWalk::ParentsFirst(const Hook& hook)
{
	for (ServerView* view = fTop; view != nullptr;) {
		if (!_Visit(*view, fFirstMark, hook))
			return false;
		view = fDisturbed ? fTop : view->NextInTree(fTop);
	}
	return fTop != nullptr;
}


bool
ViewWalk::ChildrenFirst(const Hook& hook)
{
	if (fTop == nullptr)
		return false;
	for (ServerView* view = first_in_post_order(fTop); view != nullptr;) {
		if (!_Visit(*view, fSecondMark, hook))
			return false;
		view = fDisturbed ? first_in_post_order(fTop) : next_in_post_order(view, fTop);
	}
	return true;
}


// Returns whether the walk goes on. The view may be gone afterwards if the walk was disturbed.
bool
ViewWalk::_Visit(ServerView& view, uint16_t mark, const Hook& hook)
{
	fDisturbed = false;
	if ((view.Marks() & mark) == 0)
		return true;
	view.SetMarks(view.Marks() & ~mark);
	if (view.Owner() != nullptr)
		hook(*view.Owner());
	return fTop != nullptr;
}


void
ViewWalk::Leave(ViewWalk* list, const ServerView& top)
{
	for (ViewWalk* walk = list; walk != nullptr; walk = walk->fNext) {
		if (walk->fTop == nullptr)
			continue;
		if (is_in(walk->fTop, top))
			walk->fTop = nullptr;
		else if (is_in(&top, *walk->fTop))
			walk->fDisturbed = true;
	}
}


} // namespace BPrivate
