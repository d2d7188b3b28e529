// Keys of a window: where they go, shortcuts, and moving the focus by Tab.
#include <Window.h>

#include <algorithm>
#include <cctype>
#include <cstring>
#include <span>

#include <AppDefs.h>
#include <Application.h>
#include <Control.h>
#include <MenuField.h>
#include <Message.h>

#include "interface/private/MenuBarKeys.h"
#include "interface/private/MenuShortcuts.h"
#include "interface/private/ViewPrivate.h"
#include "interface/private/ViewState.h"
#include "interface/private/WindowInternals.h"

using namespace BPrivate;

namespace {

constexpr uint32 kModifiers = B_SHIFT_KEY | B_COMMAND_KEY | B_CONTROL_KEY | B_OPTION_KEY;

struct EditKey {
	uint32 key;
	uint32 modifiers;
	uint32 what;
};

// What the focus view is sent before any menu or shortcut is asked.
constexpr EditKey kEditKeys[] = {
	{ 'x', 0, B_CUT },
	{ 'c', 0, B_COPY },
	{ 'v', 0, B_PASTE },
	{ 'a', 0, B_SELECT_ALL },
};

// What it is sent when neither a menu nor the program wants the key.
constexpr EditKey kUndoKeys[] = {
	{ 'z', 0, B_UNDO },
	{ 'z', B_SHIFT_KEY, B_REDO },
	{ 'y', 0, B_REDO },
};


// Returns whether the key is one of these and there is a view to send it to.
bool
send_edit_key(std::span<const EditKey> keys, BWindow& window, BView* focus, uint32 raw, uint32 held)
{
	const auto found = std::find_if(keys.begin(), keys.end(), [raw, held](const EditKey& edit) {
		return edit.key == raw && (edit.modifiers | B_COMMAND_KEY) == held;
	});
	if (focus == nullptr || found == keys.end())
		return false;
	window.PostMessage(found->what, focus);
	return true;
}


uint32
lower(uint32 key)
{
	return key < 128 ? static_cast<uint32>(std::tolower(static_cast<int>(key))) : key;
}


// The modifiers that tell shortcuts apart. The desktop's control key is the command key as well,
// so with Command held Control says nothing.
uint32
significant(uint32 modifiers)
{
	modifiers &= kModifiers;
	return (modifiers & B_COMMAND_KEY) != 0 ? modifiers & ~B_CONTROL_KEY : modifiers;
}


bool
is_motion_key(uint32 key)
{
	return (key >= B_LEFT_ARROW && key <= B_DOWN_ARROW) || key == B_HOME || key == B_END
		|| key == B_PAGE_UP || key == B_PAGE_DOWN || key == B_BACKSPACE || key == B_DELETE;
}


bool
is_navigable(const BView* view)
{
	if ((view->Flags() & B_NAVIGABLE) == 0)
		return false;
	if (const BControl* control = dynamic_cast<const BControl*>(view))
		return control->IsEnabled();
	const BMenuField* field = dynamic_cast<const BMenuField*>(view);
	return field == nullptr || field->IsEnabled();
}

} // namespace


void
WindowInternals::_RouteKey(BMessage* message)
{
	const std::unique_ptr<BMessage> event(message);
	if (event->what == B_KEY_DOWN)
		tips.Dismiss();
	const std::vector<BView*> views = eventMaskViews;
	bool suspended = false;
	for (BView* view : views) {
		const bool still =
			std::find(eventMaskViews.begin(), eventMaskViews.end(), view) != eventMaskViews.end();
		if (!still)
			continue;
		const ViewExtras* extras = ViewPrivate(view).Extras();
		suspended = suspended || (extras->mouseEventOptions & B_SUSPEND_VIEW_FOCUS) != 0;
		if (((extras->eventMask | extras->mouseEventMask) & B_KEYBOARD_EVENTS) != 0
			&& view != focus)
			_Deliver(new BMessage(*event), view);
	}

	BHandler* target = focus != nullptr && !suspended ? static_cast<BHandler*>(focus) : &window;
	if (event->what == B_KEY_DOWN && defaultButtonView != nullptr) {
		const char* bytes = event->GetString("bytes", "");
		const uint32 held = event->GetInt32("modifiers", 0);
		if (bytes[0] == B_ENTER && bytes[1] == '\0' && (held & (kModifiers | B_MENU_KEY)) == 0)
			target = defaultButtonView;
	}
	_Deliver(new BMessage(*event), target);
}


void
WindowInternals::SetFocus(BView* view)
{
	focus = view;
	window.SetPreferredHandler(view);
}


// #pragma mark - shortcuts


void
WindowInternals::AddShortcut(
	uint32 key, uint32 modifiers, BMessage* message, BHandler* target, bool hasTarget)
{
	const uint32 combined = (modifiers & B_NO_COMMAND_KEY) != 0 ? modifiers & ~B_NO_COMMAND_KEY
																: modifiers | B_COMMAND_KEY;
	RemoveShortcut(key, modifiers);
	shortcuts.push_back({ lower(key), significant(combined), std::unique_ptr<BMessage>(message),
		target, dynamic_cast<BView*>(target), hasTarget });
}


void
WindowInternals::RemoveShortcut(uint32 key, uint32 modifiers)
{
	const uint32 combined = (modifiers & B_NO_COMMAND_KEY) != 0 ? modifiers & ~B_NO_COMMAND_KEY
																: modifiers | B_COMMAND_KEY;
	std::erase_if(shortcuts, [&](const Shortcut& shortcut) {
		return shortcut.key == lower(key) && shortcut.modifiers == significant(combined);
	});
}


// Returns whether there is such a shortcut, even if its target has gone.
bool
WindowInternals::SendShortcut(uint32 key, uint32 modifiers)
{
	for (const Shortcut& shortcut : shortcuts) {
		if (shortcut.key != key || shortcut.modifiers != modifiers)
			continue;
		BHandler* target = &window;
		if (shortcut.hasTarget && shortcut.target != nullptr)
			target = shortcut.target;
		else if (shortcut.hasTarget && focus != nullptr)
			target = focus;
		if (shortcut.message != nullptr) {
			BMessage copy(*shortcut.message);
			copy.AddInt64("when", system_time());
			window.PostMessage(&copy, target);
		}
		return true;
	}
	return false;
}


bool
WindowInternals::HandleKeyDown(BMessage* message)
{
	const uint32 held = message->GetInt32("modifiers", 0);
	const char* bytes = message->GetString("bytes", "");
	const uint32 raw = lower(message->GetInt32("raw_char", static_cast<uint8>(bytes[0])));

	if (raw == B_TAB && (held & (B_OPTION_KEY | B_CONTROL_KEY)) != 0) {
		Navigate(focus, (held & B_SHIFT_KEY) != 0, (held & B_CONTROL_KEY) != 0);
		return true;
	}
	if ((held & B_COMMAND_KEY) == 0) {
		if (raw == B_ESCAPE && (flags & B_CLOSE_ON_ESCAPE) != 0) {
			window.PostMessage(B_QUIT_REQUESTED);
			return true;
		}
		return SendShortcut(raw, significant(held));
	}
	if (raw == B_ESCAPE) {
		if (keyMenuBar != nullptr)
			MenuKeys::Open(keyMenuBar);
		return true;
	}
	return _HandleCommandKey(raw, static_cast<uint8>(bytes[0]), significant(held));
}


// What is typed with Command held belongs to the window, whether it means something or not; only
// keys that move or erase go on to the focus view, which does it by words then.
bool
WindowInternals::_HandleCommandKey(uint32 raw, uint32 typed, uint32 held)
{
	if (raw == 'q' && held == B_COMMAND_KEY) {
		BMessage quit(B_QUIT_REQUESTED);
		quit.AddBool("shortcut", true);
		be_app->PostMessage(&quit);
		return true;
	}
	if (raw == 'w' && held == B_COMMAND_KEY) {
		if ((flags & B_NOT_CLOSABLE) == 0 && !window.IsModal()) {
			BMessage quit(B_QUIT_REQUESTED);
			quit.AddBool("shortcut", true);
			window.PostMessage(&quit);
		}
		return true;
	}

	if (send_edit_key(kEditKeys, window, focus, raw, held))
		return true;

	window.MenusBeginning();
	bool found = MenuShortcuts::Send(&window, raw, held) || SendShortcut(raw, held);
	// A sign that is typed with Shift is found by the sign as well.
	const uint32 plain = held & ~B_SHIFT_KEY;
	if (!found && typed > ' ' && typed != raw && !std::isalpha(typed) && typed < 127)
		found = MenuShortcuts::Send(&window, typed, plain) || SendShortcut(typed, plain);
	window.MenusEnded();
	if (found || focus == nullptr || send_edit_key(kUndoKeys, window, focus, raw, held))
		return true;
	return !is_motion_key(typed);
}


// #pragma mark - navigation


// Depth first, children before siblings, round in a circle. By groups: to the first view of the
// next group.
void
WindowInternals::Navigate(const BView* from, bool backwards, bool byGroups)
{
	std::vector<BView*> order;
	std::vector<size_t> starts; // of groups
	size_t at = SIZE_MAX; // where `from` is, or would be
	const ServerView& root = tree.Root();
	for (ServerView* node = root.FirstChild(); node != nullptr;) {
		if (node->HideCount() > 0) {
			node = node->NextSkippingChildren(&root);
			continue;
		}
		BView* view = node->Owner();
		if (view == from)
			at = order.size();
		if (node->Has(B_NAVIGABLE_JUMP))
			starts.push_back(order.size());
		if (is_navigable(view))
			order.push_back(view);
		node = node->NextInTree(&root);
	}
	if (order.empty())
		return;

	const size_t count = order.size();
	size_t next = 0;
	if (byGroups && !starts.empty()) {
		const size_t here = at != SIZE_MAX ? at : 0;
		const auto after = std::upper_bound(starts.begin(), starts.end(), here);
		if (!backwards)
			next = after != starts.end() ? *after : starts.front();
		else {
			const auto own = std::lower_bound(starts.begin(), starts.end(), here);
			next = own != starts.begin() ? *(own - 1) : starts.back();
		}
		next %= count;
	} else if (at == SIZE_MAX)
		next = backwards ? count - 1 : 0;
	else {
		const bool fromCounts = at < count && order[at] == from;
		if (backwards)
			next = (at + count - 1) % count;
		else
			next = (at + (fromCounts ? 1 : 0)) % count;
	}
	if (order[next] != from)
		order[next]->MakeFocus(true);
}
