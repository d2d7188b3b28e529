// WindowInspector: describes the windows and views of this program.
#pragma once

#include <map>
#include <mutex>
#include <typeinfo>

#include "server/Inspector.h"

class BView;
class BWindow;

namespace BPrivate {


// One per program, from the first window on to the end.
class WindowInspector final : public Inspector {
public:
	static WindowInspector& Get();

	// Of a window that has just been made. Nobody says when it goes: its number is never given
	// again, and its address is locked only if it is a window's.
	void Add(uint32 id, BWindow* window);

	std::vector<WindowNode> Windows() override;
	status_t Describe(uint32 window, bigtime_t timeout, ViewNode* _root) override;
	status_t RevealItem(uint32 window, const void* view, const void* item) override;

private:
	class LockedWindow;

	struct KnownWindow {
		BWindow* window; // borrowed; may be gone
		std::string className; // empty until it was looked at, which is done once
		bool isAlert = false;
	};

	void _AddClass(WindowNode& node);
	BWindow* _Find(uint32 id);

	std::mutex fLock; // never held while a window's is waited for
	std::map<uint32, KnownWindow> fWindows; // by id
};


// In ViewDescription.cpp. The window is locked.
ViewNode describe_window(BWindow& window);
BView* find_view(BWindow& window, const void* address);
std::string class_name_of(const std::type_info& type);


} // namespace BPrivate
