// ClipboardBridge: the system clipboard between our messages and other programs' types.
#pragma once

#include <atomic>

#include <Message.h>

namespace BPrivate {

class DesktopThread;


// Display thread, but for Announce() and Serial().
class ClipboardBridge {
public:
	explicit ClipboardBridge(DesktopThread& desktop);

	void Announce() { fSerial++; } // data of ours are on their way
	uint32 Serial() const { return fSerial; }

	void Set(const BMessage& data);
	// What was set, fields and all, while it is still there; else what another program offers.
	status_t Get(BMessage* _data);
	void Changed(); // by another program

private:
	void _Notify();

	DesktopThread& fDesktop;
	BMessage fData;
	std::atomic<uint32> fSerial { 0 };
};


} // namespace BPrivate
