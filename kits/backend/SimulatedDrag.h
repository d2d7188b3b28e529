// SimulatedDrag: a desktop's drag for scripted input, which no real desktop can follow.
#pragma once

#include "backend/Backend.h"

namespace BPrivate {


// Tells the sink what it would hear of a drag that comes home. Display thread.
class SimulatedDrag {
public:
	void Start(const DataOffer& offer, int32 session);
	bool IsActive() const { return fSession != 0; }

	// A pointer event while it is active, and our window there, or NULL.
	void Follow(const BackendEvent& event, BackendWindow* under, BackendSink& sink);
	// Ends on a folder of the file manager.
	void DropOnFolder(const BackendEvent& event, BackendSink& sink);
	void WindowGone(const BackendWindow* window);

private:
	DataOffer fOffer;
	int32 fSession = 0; // 0 for none
	BackendWindow* fOver = nullptr; // borrowed
};


} // namespace BPrivate
