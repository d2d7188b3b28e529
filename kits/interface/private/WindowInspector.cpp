#include "interface/private/WindowInspector.h"

#include <Alert.h>
#include <ListView.h>
#include <Window.h>

#include "interface/private/WindowInternals.h"
#include "server/Desktop.h"

namespace BPrivate {

namespace {

constexpr bigtime_t kClassPatience = 50000;

} // namespace


// Holds the lock of a window; NULL when it is gone, or when there was no lock in time.
class WindowInspector::LockedWindow {
public:
	LockedWindow(BWindow* window, uint32 id, bigtime_t timeout)
	{
		// A looper that is gone is not locked: the address alone is looked at.
		fStatus = window != nullptr ? window->LockWithTimeout(timeout) : B_BAD_VALUE;
		if (fStatus != B_OK)
			return;
		const auto& server = WindowInternals::Of(window).server;
		if (server != nullptr && server->Id() == id)
			fWindow = window;
		else
			window->Unlock();
	}

	~LockedWindow()
	{
		if (fWindow != nullptr)
			fWindow->Unlock();
	}

	BWindow* Get() const { return fWindow; }
	status_t Error() const { return fStatus == B_TIMED_OUT ? B_TIMED_OUT : B_BAD_VALUE; }

private:
	BWindow* fWindow = nullptr; // borrowed
	status_t fStatus;
};


WindowInspector&
WindowInspector::Get()
{
	static auto& inspector = *new WindowInspector;
	return inspector;
}


std::vector<WindowNode>
WindowInspector::Windows()
{
	Desktop* desktop = Desktop::Get();
	if (desktop == nullptr)
		return {};
	std::vector<WindowNode> windows = desktop->ListWindows();
	for (WindowNode& window : windows)
		_AddClass(window);
	return windows;
}


void
WindowInspector::Add(uint32 id, BWindow* window)
{
	std::lock_guard lock(fLock);
	// Whatever was at that address before is gone.
	std::erase_if(fWindows, [window](const auto& known) { return known.second.window == window; });
	fWindows[id].window = window;
}


BWindow*
WindowInspector::_Find(uint32 id)
{
	std::lock_guard lock(fLock);
	const auto known = fWindows.find(id);
	return known != fWindows.end() ? known->second.window : nullptr;
}


void
WindowInspector::_AddClass(WindowNode& node)
{
	BWindow* address = nullptr;
	{
		std::lock_guard lock(fLock);
		const auto known = fWindows.find(node.id);
		if (known == fWindows.end())
			return;
		address = known->second.window;
		node.className = known->second.className;
		node.isAlert = known->second.isAlert;
	}
	if (!node.className.empty())
		return;

	const LockedWindow window(address, node.id, kClassPatience);
	if (window.Get() == nullptr)
		return;
	node.className = class_name_of(typeid(*window.Get()));
	node.isAlert = dynamic_cast<BAlert*>(window.Get()) != nullptr;
	std::lock_guard lock(fLock);
	const auto known = fWindows.find(node.id);
	if (known != fWindows.end())
		known->second = { address, node.className, node.isAlert };
}


status_t
WindowInspector::Describe(uint32 id, bigtime_t timeout, ViewNode* _root)
{
	const LockedWindow window(_Find(id), id, timeout);
	if (window.Get() == nullptr)
		return window.Error();
	*_root = describe_window(*window.Get());
	return B_OK;
}


status_t
WindowInspector::RevealItem(uint32 id, const void* view, const void* item)
{
	const LockedWindow window(_Find(id), id, kClassPatience);
	if (window.Get() == nullptr)
		return window.Error();
	auto* list = dynamic_cast<BListView*>(find_view(*window.Get(), view));
	if (list == nullptr)
		return B_BAD_VALUE;

	for (int32 i = 0; i < list->CountItems(); i++) {
		if (list->ItemAt(i) != item)
			continue;
		const BRect bounds = list->Bounds();
		const BRect frame = list->ItemFrame(i);
		if (frame.top < bounds.top)
			list->ScrollTo(BPoint(bounds.left, frame.top));
		else if (frame.bottom > bounds.bottom)
			list->ScrollTo(BPoint(bounds.left, frame.bottom - bounds.Height()));
		return B_OK;
	}
	return B_BAD_VALUE;
}


} // namespace BPrivate
