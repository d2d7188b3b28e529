#include "interface/private/DraggerList.h"

#include <atomic>
#include <map>
#include <mutex>
#include <vector>

#include <AppDefs.h>
#include <Dragger.h>
#include <Messenger.h>

namespace BPrivate {

namespace {

struct AttachedDraggers {
	std::mutex lock;
	std::map<const BDragger*, BMessenger> messengers;
	std::atomic<bool> drawn { true };
};


AttachedDraggers&
attached_draggers()
{
	static AttachedDraggers* sDraggers = new AttachedDraggers;
	return *sDraggers;
}

} // namespace


void
DraggerList::Add(const BDragger* dragger)
{
	const BMessenger messenger(dragger);
	AttachedDraggers& all = attached_draggers();
	const std::lock_guard guard(all.lock);
	all.messengers[dragger] = messenger;
}


void
DraggerList::Remove(const BDragger* dragger)
{
	AttachedDraggers& all = attached_draggers();
	const std::lock_guard guard(all.lock);
	all.messengers.erase(dragger);
}


void
DraggerList::SetDrawn(bool drawn)
{
	AttachedDraggers& all = attached_draggers();
	if (all.drawn.exchange(drawn) == drawn)
		return;
	std::vector<BMessenger> targets;
	{
		const std::lock_guard guard(all.lock);
		for (const auto& [dragger, messenger] : all.messengers)
			targets.push_back(messenger);
	}
	for (const BMessenger& target : targets)
		target.SendMessage(_SHOW_DRAG_HANDLES_);
}


bool
DraggerList::IsDrawn()
{
	return attached_draggers().drawn;
}


} // namespace BPrivate
