// Replicants: what draggers and shelves say to each other.
#pragma once

#include <memory>

#include <Message.h>
#include <Point.h>

class BDragger;

namespace BPrivate {


// To a shelf: take out the replicant with the number in kReplicantId, an int32.
constexpr uint32 kRemoveReplicant = '_RMR';
constexpr const char* kReplicantId = "_replicant_id";

// In the archive of a target: that of a dragger which is its sibling.
constexpr const char* kSiblingDragger = "__widget";


// One replicant of a shelf.
struct Replicant {
	uint32 id = 0;
	std::unique_ptr<BMessage> archive; // as it came, without what the drag added
	BDragger* dragger = nullptr; // borrowed: of the view tree; NULL when nothing is shown
	BPoint location; // of what is not shown
	bool isZombie = false;
	status_t error = B_OK; // why it is a zombie
};


} // namespace BPrivate
