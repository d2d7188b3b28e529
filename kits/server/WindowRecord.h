// WindowRecord: what the display thread knows about a window, shared with the window's own thread.
#pragma once

#include <array>
#include <atomic>
#include <memory>
#include <mutex>
#include <string>
#include <vector>

#include <Message.h>
#include <Rect.h>

#include "backend/Backend.h"
#include "server/CursorShape.h"
#include "server/FrontImage.h"

namespace BPrivate {

class WindowClient;


// Lives until the window is gone and the display thread has let go of it.
class WindowRecord {
public:
	struct Properties {
		std::string title;
		BRect frame;
		uint32 look = 0, feel = 0, flags = 0;
		float minWidth = 0, maxWidth = 32767, minHeight = 0, maxHeight = 32767;
	};

	WindowRecord(uint32 id, WindowClient* client, const Properties& properties);
	WindowRecord(const WindowRecord&) = delete;
	WindowRecord& operator=(const WindowRecord&) = delete;

	// Any thread.
	uint32 Id() const { return fId; }
	Properties GetProperties() const;
	BRect Frame() const;
	uint32 Feel() const;
	uint32 Flags() const;
	bool IsMenu() const;
	bool IsModal() const;
	bool IsFloating() const;
	bool MayClose() const; // by the user
	bool FloatsOverAll() const; // over windows of other programs too
	bool HasSubset() const; // floats over, or blocks, the windows of its subset alone
	void Change(const std::function<void(Properties&)>& change);
	// The program wants another frame; reports of the desktop are out of date until it is applied.
	void BeginFrame(BRect frame);
	bool FrameApplied(); // whether no other change is under way
	// The desktop reports a frame; false if it is out of date.
	bool ReportFrame(BRect frame);
	WindowTraits Traits() const;

	// Gives the message to the client; it is deleted when the client is gone.
	void Deliver(std::unique_ptr<BMessage> message);
	// Returns when no delivery is under way, and lets no other begin.
	void Detach();

	FrontImage& Front() { return fFront; }

	std::atomic<bool> wantsAllPointerEvents { false };
	std::atomic<bool> shown { false }; // as the program wants it
	std::atomic<bool> active { false };
	std::atomic<bool> inFront { false };
	std::atomic<bool> flushPending { false };
	std::atomic<int32> handledPress { 0 };

	// Display thread only.
	std::unique_ptr<BackendWindow> native;
	BRect reportedFrame;
	std::vector<uint32> subset; // ids of the windows that it is modal or floating for
	uint32 owner = 0; // id of the window that it stays above; 0 for none
	int64 shownSerial = 0; // the later shown, the larger
	bool wantsShown = false; // by the program, as far as the display thread has come
	bool nativeShown = false; // a floating window is not while its program is inactive
	bool hasCursor = false;
	CursorShape cursor;
	int64 flushes = 0;
	int64 flushedPixels = 0; // device pixels

private:
	const uint32 fId;
	mutable std::mutex fLock; // of the properties
	Properties fProperties;
	int32 fFramesUnderWay = 0;
	std::mutex fClientLock; // held while a message is handed over
	WindowClient* fClient; // borrowed
	FrontImage fFront;
};


using WindowReference = std::shared_ptr<WindowRecord>;


} // namespace BPrivate
