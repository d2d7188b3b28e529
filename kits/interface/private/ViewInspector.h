// ViewInspector: describes windows and views for scripts.
#pragma once

#include <string>

#include "server/Inspector.h"

class BView;
class BWindow;

namespace BPrivate {


class ViewInspector final : public Inspector {
public:
	// Makes it known to the desktop that runs now.
	static void Install();

	std::vector<WindowNode> Windows() override;
	status_t Describe(uint32 window, bigtime_t timeout, ViewNode* _root) override;
	status_t RevealItem(uint32 window, const void* view, const void* item) override;
};


// The windows that have a place on the desktop, in the order of their making. Any thread.
class WindowList {
public:
	static void Add(BWindow* window, uint32 id);
	static void Remove(BWindow* window);
	// Of any thread, as long as it holds no window's lock for long.
	static void SetTitle(BWindow* window, const char* title);
	static void SetShown(BWindow* window, bool shown);
	static void SetActive(BWindow* window, bool active);
	static void SetFrame(BWindow* window, BRect frame);
};


} // namespace BPrivate
