#include "support/PaintCounter.h"

#include <Window.h>

#include "interface/private/TextLayout.h"
#include "interface/private/WindowInternals.h"
#include "server/Desktop.h"
#include "server/ServerWindow.h"
#include "server/WindowRecord.h"


PaintCounter::PaintCounter(BWindow* window) : fWindow(window)
{
	Reset();
}


void
PaintCounter::Reset()
{
	fStart = _Read();
}


int64
PaintCounter::Flushes() const
{
	return _Read().flushes - fStart.flushes;
}


int64
PaintCounter::FlushedPixels() const
{
	return _Read().flushedPixels - fStart.flushedPixels;
}


int64
PaintCounter::Drawn() const
{
	return _Read().drawn - fStart.drawn;
}


int64
PaintCounter::Clippings() const
{
	return _Read().clippings - fStart.clippings;
}


int64
PaintCounter::HitTested() const
{
	return _Read().hitTested - fStart.hitTested;
}


int64
PaintCounter::LinesLaidOut()
{
	return BPrivate::TextLayout::CountLaidOut();
}


int64
PaintCounter::Visited() const
{
	return _Read().visited - fStart.visited;
}


PaintCounter::Counts
PaintCounter::_Read() const
{
	using namespace BPrivate;
	Counts counts {};
	fWindow->Lock();
	const WindowInternals& internals = WindowInternals::Of(fWindow);
	counts.drawn = internals.tree.CountDrawn();
	counts.clippings = internals.tree.CountClippings();
	counts.hitTested = internals.tree.CountHitTested();
	counts.visited = internals.tree.CountVisited();
	const WindowRecord& record = internals.server->Record();
	fWindow->Unlock();
	// Those two belong to the display's thread.
	Desktop::Get()->RunOnDisplay([&] {
		counts.flushes = record.flushes;
		counts.flushedPixels = record.flushedPixels;
	});
	return counts;
}
