// Table: objects of the kernel by their ids.
#pragma once

#include <memory>
#include <mutex>
#include <shared_mutex>
#include <unordered_map>
#include <vector>

#include <SupportDefs.h>

namespace BPrivate {


// Ids start at 1, grow, and are not used again until they have gone round. A caller that holds the
// object may still use it after it has left the table. Any thread.
template<typename T> class Table {
public:
	int32 Add(std::shared_ptr<T> object)
	{
		std::unique_lock lock(fLock);
		do {
			fNextID = fNextID == INT32_MAX ? 1 : fNextID + 1;
		} while (fObjects.count(fNextID) != 0);
		fObjects.emplace(fNextID, std::move(object));
		return fNextID;
	}

	std::shared_ptr<T> Get(int32 id) const
	{
		std::shared_lock lock(fLock);
		const auto found = fObjects.find(id);
		return found != fObjects.end() ? found->second : nullptr;
	}

	std::shared_ptr<T> Remove(int32 id)
	{
		std::unique_lock lock(fLock);
		const auto found = fObjects.find(id);
		if (found == fObjects.end())
			return nullptr;
		std::shared_ptr<T> object = std::move(found->second);
		fObjects.erase(found);
		return object;
	}

	// The id of an object for which the function is true, or -1. The table is not locked meanwhile,
	// so the function may take the objects' own locks.
	template<typename Predicate> int32 Find(Predicate predicate) const
	{
		std::vector<std::pair<int32, std::shared_ptr<T>>> objects;
		{
			std::shared_lock lock(fLock);
			objects.assign(fObjects.begin(), fObjects.end());
		}
		for (const auto& [id, object] : objects) {
			if (predicate(*object))
				return id;
		}
		return -1;
	}

private:
	mutable std::shared_mutex fLock;
	std::unordered_map<int32, std::shared_ptr<T>> fObjects;
	int32 fNextID = 0;
};


} // namespace BPrivate
