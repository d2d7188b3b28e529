// Port: the place where messages for one receiver arrive, and the table that finds it by number.
#pragma once

#include <memory>

#include <SupportDefs.h>

class BMessage;

namespace BPrivate {


// Kept alive by the table and by those who are just sending.
class Port {
public:
	virtual ~Port() = default;

	// Waits for room at most so many microseconds. B_WOULD_BLOCK or B_TIMED_OUT when there was
	// none, B_BAD_PORT_ID when the receiver is gone; the message is deleted then.
	virtual status_t Receive(std::unique_ptr<BMessage> message, bigtime_t timeout) = 0;
};


// Any thread.
class PortTable {
public:
	static int32 Add(std::shared_ptr<Port> port);
	static void Remove(int32 id);
	static std::shared_ptr<Port> Find(int32 id); // NULL when it is gone
};


} // namespace BPrivate
