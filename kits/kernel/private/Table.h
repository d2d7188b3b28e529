// Table: objects of the kernel by their ids.
#pragma once

#include <memory>
#include <mutex>
#include <shared_mutex>
#include <unordered_map>
#include <vector>

#include <unistd.h>

#include <OS.h>

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

	// The smallest id above the given one, or -1.
	int32 Next(int32 id) const
	{
		std::shared_lock lock(fLock);
		int32 next = -1;
		for (const auto& entry : fObjects) {
			if (entry.first > id && (next < 0 || entry.first < next))
				next = entry.first;
		}
		return next;
	}

	int32 Count() const
	{
		std::shared_lock lock(fLock);
		return static_cast<int32>(fObjects.size());
	}

private:
	mutable std::shared_mutex fLock;
	std::unordered_map<int32, std::shared_ptr<T>> fObjects;
	int32 fNextID = 0;
};

// Whether the id names this team, the only one that is known.
inline bool
IsOwnTeam(team_id team)
{
	return team == B_CURRENT_TEAM || team == getpid();
}

// Gives the next object of a team to a function that fills its information. The cookie is the last
// id that was given.
template<typename T, typename Info>
status_t
NextInfo(const Table<T>& table, team_id team, int32* cookie, Info* info, size_t size,
	status_t (*fill)(int32, Info*, size_t))
{
	if (cookie == nullptr || info == nullptr || size != sizeof(Info) || *cookie < 0)
		return B_BAD_VALUE;
	if (!IsOwnTeam(team))
		return B_BAD_TEAM_ID;
	// What goes away meanwhile is passed over.
	for (int32 id; (id = table.Next(*cookie)) >= 0;) {
		*cookie = id;
		if (fill(id, info, size) == B_OK)
			return B_OK;
	}
	return B_BAD_VALUE;
}


} // namespace BPrivate
