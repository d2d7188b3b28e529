// Helpers that walk a tree of views: depth first, a view before its children, children in order.
#pragma once

#include <vector>

#include <Message.h>
#include <MessageFilter.h>
#include <Messenger.h>
#include <Point.h>

class BBitmap;
class BHandler;
class BLooper;
class BMenu;
class BScrollBar;
class BScrollView;
class BView;
class BWindow;

// Whether a view's frame moves when its parent scrolls. Where it does, views are moved back by
// their parents' scroll positions before they are archived.
constexpr bool kFramesFollowScrolling = false;

// Adds the child and keeps the view and low colours of its whole tree, which attaching would
// change to the parent's. Returns the child; does nothing for NULL. It goes before that sibling, or
// to the end.
BView* ColorfulAddChild(BView* parent, BView* child, BView* before = nullptr);
BView* ColorfulAddChild(BWindow* window, BView* child);
BView* ColorfulAddChild(BBitmap* bitmap, BView* child);

// Whether the view's frame is its parent's business: a scroll view's target, a tab's page, the
// field of a text control.
bool FrameControled(const BView* view);

// Filter hooks: the first prints the code of every message but the frequent ones, the second
// activates a window that is clicked.
filter_result WatchMessages(BMessage* message, BHandler** target, BMessageFilter* filter);
filter_result ActivateOnClick(BMessage* message, BHandler** target, BMessageFilter* filter);

// The deepest view under a point given in the view's own coordinates, or NULL. Neither the
// excluded view nor anything in it is found.
BView* PointInView(BView* view, BPoint point, BView* exclude);

// The view if it is the root or in the root's tree, else NULL. Compares addresses only, so the
// view need not exist any more.
BView* ViewAttached(BView* root, BView* view);

// The same for a view that is known to exist, in time that grows with its depth only.
BView* LiveViewAttached(const BView* root, BView* view);

// The indices of the children on the way from the root to a view in its tree, and the way back. A
// path that the tree does not have ends where it leaves it.
std::vector<int32> PathTo(const BView* root, const BView* view);
BView* ViewAtPath(BView* root, const std::vector<int32>& path);

// Aims every control and every menu item of a tree.
void SetTarget(BView* view, BMessenger target);
void SetTarget(BView* view, const BHandler* handler, const BLooper* looper);
void SetTarget(BMenu* menu, BMessenger target);
void SetTarget(BMenu* menu, const BHandler* handler, const BLooper* looper);

// How far the view's parent is scrolled, by its scroll bars.
BPoint ScrolledBy(const BView* view);

// Moves every view of the tree by its parent's scroll position, or back.
void MoveScrolledViews(BView* view, bool undo);

void InvalidateViewTree(BView* view);

// Sizes the thumbs by how much of the range the target shows.
void SetProportion(BScrollBar* bar);
void SetProportions(BScrollView* view);

// Lets a content of that size (right - left, bottom - top) be scrolled through.
void SetRange(BScrollView* view, float width, float height);

// Paint a tree that lies in a bitmap, for a picture of it: first the backgrounds, then the views.
void EraseBackground(BView* view);
void DrawView(BView* view);
