// MenuKeys: how a window opens its menu bar for the keyboard.
#pragma once

class BMenuBar;

namespace BPrivate {


class MenuKeys {
public:
	// Selects the first menu and opens it. The bar's window is locked.
	static void Open(BMenuBar* bar);
};


} // namespace BPrivate
