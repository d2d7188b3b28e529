#include "app/private/HandlerTokens.h"

#include <mutex>
#include <unordered_map>

namespace BPrivate {
namespace {

struct Entry {
	BHandler* handler;
	BLooper* looper;
};

struct Table {
	std::mutex lock;
	std::unordered_map<int32, Entry> entries;
	int32 nextToken = 1;
};

// Never destroyed: handlers may outlive the static objects of this file.
Table&
TheTokens()
{
	static Table* table = new Table;
	return *table;
}

} // namespace


int32
HandlerTokens::Add(BHandler* handler, const std::atomic<BLooper*>& looper)
{
	Table& table = TheTokens();
	std::lock_guard lock(table.lock);
	while (!table.entries.try_emplace(table.nextToken, Entry { handler, looper.load() }).second)
		table.nextToken = table.nextToken == INT32_MAX ? 1 : table.nextToken + 1;

	const int32 token = table.nextToken;
	table.nextToken = token == INT32_MAX ? 1 : token + 1;
	return token;
}


void
HandlerTokens::Update(int32 token, const std::atomic<BLooper*>& looper)
{
	Table& table = TheTokens();
	std::lock_guard lock(table.lock);
	if (const auto found = table.entries.find(token); found != table.entries.end())
		found->second.looper = looper.load();
}


void
HandlerTokens::Remove(int32 token)
{
	Table& table = TheTokens();
	std::lock_guard lock(table.lock);
	table.entries.erase(token);
}


BHandler*
HandlerTokens::FindIn(int32 token, const BLooper* looper)
{
	BLooper* found = nullptr;
	BHandler* handler = Find(token, &found);
	return found == looper ? handler : nullptr;
}


BHandler*
HandlerTokens::Find(int32 token, BLooper** _looper)
{
	Table& table = TheTokens();
	std::lock_guard lock(table.lock);
	const auto found = table.entries.find(token);
	if (found == table.entries.end()) {
		*_looper = nullptr;
		return nullptr;
	}
	*_looper = found->second.looper;
	return found->second.handler;
}


} // namespace BPrivate
