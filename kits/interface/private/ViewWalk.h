// ViewWalk: calls a hook of every view of a subtree, whatever the hooks do to the tree.
#pragma once

#include <cstdint>
#include <functional>

class BView;

namespace BPrivate {

class ServerView;


// A view that a hook adds is not visited, one that a hook takes out is not visited either. Walks of
// one window may be nested. The window is locked.
class ViewWalk {
public:
	enum Purpose : uint8_t { kAttachment, kNotice };
	using Hook = std::function<void(BView&)>;

	// Notices (activation, pulse) may reach views whose attachment is still under way.
	ViewWalk(ServerView& top, ViewWalk*& list, Purpose purpose);
	~ViewWalk();
	ViewWalk(const ViewWalk&) = delete;
	ViewWalk& operator=(const ViewWalk&) = delete;

	// Each may be called once. They return whether the subtree is still where it was.
	bool ParentsFirst(const Hook& hook);
	bool ChildrenFirst(const Hook& hook);

	// The subtree is taken out: walks inside of it stop, others look for their place anew.
	static void Leave(ViewWalk* list, const ServerView& top);

private:
	bool _Visit(ServerView& view, uint16_t mark, const Hook& hook);

	ViewWalk*& fList;
	ViewWalk* fNext; // the walk that this one runs inside
	ServerView* fTop; // borrowed; NULL once it was taken out
	const uint16_t fFirstMark;
	const uint16_t fSecondMark;
	bool fDisturbed = false; // a view below was taken out during the last hook
};


} // namespace BPrivate
