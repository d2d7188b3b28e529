// DragSession: one dragged message, from the press that began it to its drop.
#pragma once

#include <memory>
#include <vector>

#include <Message.h>
#include <Point.h>

#include "backend/Backend.h"

namespace BPrivate {

struct DragImage;


// Made by any thread, then used by the display thread alone.
class DragSession {
public:
	// Of one of our own views.
	DragSession(std::unique_ptr<BMessage> message, const DragImage& image);
	// Of another program.
	explicit DragSession(std::unique_ptr<BMessage> message);

	const BMessage& Message() const { return *fMessage; }
	bool IsForeign() const { return fForeign; }
	int32 Serial() const { return fSerial; } // unique in the program
	BPoint Offset() const { return fOffset; }
	// At the given scale, of device pixels per logical unit; empty when there is nothing to show.
	ScreenPicture Picture(float scale) const;

	// "be:drag_message" and "_msg_what_".
	void AddTo(BMessage& moved) const;
	// The internal drop message, for the window's thread to make the dragged one of it again.
	std::unique_ptr<BMessage> MakeDrop(BPoint screen, uint32 buttons) const;

private:
	std::unique_ptr<BMessage> fMessage;
	bool fForeign;
	int32 fSerial;
	BPoint fOffset;
	ScreenPicture fImage; // at scale 1
};


using DragReference = std::shared_ptr<DragSession>;


} // namespace BPrivate
