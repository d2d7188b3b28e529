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

	std::vector<WindowNode> Windows() override;
	status_t Describe(uint32 window, bigtime_t timeout, ViewNode* _root) override;
	status_t RevealItem(uint32 window, const void* view, const void* item) override;

private:
	struct KnownClass {
		std::string name;
		bool isAlert;
	};

	// What stays the same for a window's life, so that a busy window is waited for once at most.
	void _AddClass(WindowNode& node);

	std::mutex fLock;
	std::map<uint32, KnownClass> fClasses; // by window
};


// In ViewDescription.cpp. The window is locked.
ViewNode describe_window(BWindow& window);
BView* find_view(BWindow& window, const void* address);
std::string class_name_of(const std::type_info& type);


} // namespace BPrivate
