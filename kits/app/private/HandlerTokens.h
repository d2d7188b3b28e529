// HandlerTokens: finds handlers by the numbers that messages name them with.
#pragma once

#include <atomic>

#include <SupportDefs.h>

class BHandler;
class BLooper;

namespace BPrivate {


// Any thread. A handler that is found in a looper stays alive as long as that looper is locked.
class HandlerTokens {
public:
	static int32 Add(BHandler* handler, const std::atomic<BLooper*>& looper);
	// Takes over what the handler's link now says.
	static void Update(int32 token, const std::atomic<BLooper*>& looper);
	static void Remove(int32 token);

	// The handler of this number if it belongs to the looper, else NULL.
	static BHandler* FindIn(int32 token, const BLooper* looper);
	// The handler and its looper at this moment; NULL when it is gone.
	static BHandler* Find(int32 token, BLooper** _looper);
};


} // namespace BPrivate
