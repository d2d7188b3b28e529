#include "interface/private/MenuShortcuts.h"

#include <algorithm>
#include <cctype>
#include <mutex>
#include <unordered_map>
#include <vector>

#include <MenuItem.h>
#include <Window.h>

namespace BPrivate {

namespace {

constexpr uint32 kRelevant = B_SHIFT_KEY | B_OPTION_KEY;

// The lock guards the table only; a window's entry belongs to who holds the window.
std::mutex sLock;

typedef std::unordered_map<uint64, std::vector<BMenuItem*>> ItemsByKey;
auto& sWindows = *new std::unordered_map<const BWindow*, ItemsByKey>();


bool
is_letter(uint32 key)
{
	return key < 0x80 && isalpha(static_cast<int>(key));
}


uint64
key_of(uint32 key, uint32 modifiers)
{
	if (key < 0x80)
		key = static_cast<uint32>(tolower(static_cast<int>(key)));
	return static_cast<uint64>(modifiers & kRelevant) << 32 | key;
}


uint64
key_of(const BMenuItem* item)
{
	uint32 modifiers;
	const uchar key = static_cast<uchar>(item->Shortcut(&modifiers));
	return key_of(key, modifiers);
}


BMenuItem*
find(BWindow* window, uint32 key, uint32 modifiers)
{
	const std::lock_guard lock(sLock);
	const auto items = sWindows.find(window);
	if (items == sWindows.end())
		return nullptr;
	auto found = items->second.find(key_of(key, modifiers));
	// Shift may only have been needed to type the character.
	if (found == items->second.end() && (modifiers & B_SHIFT_KEY) != 0 && !is_letter(key))
		found = items->second.find(key_of(key, modifiers & ~B_SHIFT_KEY));
	return found != items->second.end() ? found->second.back() : nullptr;
}

} // namespace


void
MenuShortcuts::Add(BWindow* window, BMenuItem* item)
{
	const std::lock_guard lock(sLock);
	sWindows[window][key_of(item)].push_back(item);
}


void
MenuShortcuts::Remove(BWindow* window, BMenuItem* item)
{
	const std::lock_guard lock(sLock);
	const auto items = sWindows.find(window);
	if (items == sWindows.end())
		return;
	const auto found = items->second.find(key_of(item));
	if (found == items->second.end())
		return;
	std::erase(found->second, item);
	if (found->second.empty())
		items->second.erase(found);
	if (items->second.empty())
		sWindows.erase(items);
}


bool
MenuShortcuts::Send(BWindow* window, uint32 key, uint32 modifiers)
{
	BMenuItem* item = find(window, key, modifiers);
	if (item == nullptr)
		return false;
	BInvoker* invoker = item;
	invoker->Invoke();
	return true;
}


bool
MenuShortcuts::Has(BWindow* window, uint32 key, uint32 modifiers)
{
	return find(window, key, modifiers) != nullptr;
}


} // namespace BPrivate
