#include "interface/private/WindowInspector.h"

#include <algorithm>

#include <Alert.h>
#include <Application.h>
#include <ListView.h>
#include <Window.h>

#include "interface/private/WindowInternals.h"
#include "server/Desktop.h"

namespace BPrivate {

namespace {

constexpr bigtime_t kClassPatience = 50000;


// Holds the lock of the window with that number; NULL when there is none, or no lock in time.
class LockedWindow {
public:
	LockedWindow(uint32 id, bigtime_t timeout)
	{
		const bigtime_t end = system_time() + timeout;
		// A window that has gone meanwhile is not locked: the address alone is looked at.
		for (int32 i = 0; be_app != nullptr && i < be_app->CountWindows(); i++) {
			BWindow* window = be_app->WindowAt(i);
			if (window == nullptr)
				continue;
			const bigtime_t left = std::max<bigtime_t>(1, end - system_time());
			const status_t status = window->LockWithTimeout(left);
			fTimedOut = fTimedOut || status == B_TIMED_OUT;
			if (status != B_OK)
				continue;
			const auto& server = WindowInternals::Of(window).server;
			if (server != nullptr && server->Id() == id) {
				fWindow = window;
				return;
			}
			window->Unlock();
		}
	}

	~LockedWindow()
	{
		if (fWindow != nullptr)
			fWindow->Unlock();
	}

	BWindow* Get() const { return fWindow; }
	status_t Error() const { return fTimedOut ? B_TIMED_OUT : B_BAD_VALUE; }

private:
	BWindow* fWindow = nullptr; // borrowed
	bool fTimedOut = false;
};

} // namespace


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
WindowInspector::_AddClass(WindowNode& node)
{
	std::lock_guard lock(fLock);
	auto known = fClasses.find(node.id);
	if (known == fClasses.end()) {
		const LockedWindow window(node.id, kClassPatience);
		if (window.Get() == nullptr)
			return;
		const bool isAlert = dynamic_cast<BAlert*>(window.Get()) != nullptr;
		const KnownClass found { class_name_of(typeid(*window.Get())), isAlert };
		known = fClasses.emplace(node.id, found).first;
	}
	node.className = known->second.name;
	node.isAlert = known->second.isAlert;
}


status_t
WindowInspector::Describe(uint32 id, bigtime_t timeout, ViewNode* _root)
{
	const LockedWindow window(id, timeout);
	if (window.Get() == nullptr)
		return window.Error();
	*_root = describe_window(*window.Get());
	return B_OK;
}


status_t
WindowInspector::RevealItem(uint32 id, const void* view, const void* item)
{
	const LockedWindow window(id, kClassPatience);
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
