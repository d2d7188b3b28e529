// MenuShortcuts: the items of a window's menus that a key chooses.
#pragma once

#include <SupportDefs.h>

class BMenuItem;
class BWindow;

namespace BPrivate {


// Called under the window's lock. Of several items with one key the newest answers.
class MenuShortcuts {
public:
	static void Add(BWindow* window, BMenuItem* item);
	static void Remove(BWindow* window, BMenuItem* item);

	// Invokes the item that the key belongs to, if it is enabled. Command is implied, and Control is
	// the same key here. Returns whether there is an item: the key is eaten also by a disabled one.
	static bool Send(BWindow* window, uint32 key, uint32 modifiers);
	static bool Has(BWindow* window, uint32 key, uint32 modifiers);
};


} // namespace BPrivate
