// PaintCounter: how much a window's painting took, for tests of growth.
#pragma once

#include <SupportDefs.h>

class BWindow;


// Counts from its making or the last Reset(). Call it while the program is idle.
class PaintCounter {
public:
	explicit PaintCounter(BWindow* window); // shown, and borrowed

	void Reset();
	int64 Flushes() const; // to the screen
	int64 FlushedPixels() const;
	int64 Drawn() const; // Draw() calls and painted backgrounds of views
	int64 Clippings() const; // made for views that draw
	int64 HitTested() const; // views asked whether a point lies in them
	int64 Visited() const; // children looked at because something was painted or clipped

	// Lines of text laid out by any text view since the start of the program.
	static int64 LinesLaidOut();

private:
	struct Counts {
		int64 flushes, flushedPixels, drawn, clippings, hitTested, visited;
	};

	Counts _Read() const;

	BWindow* fWindow; // borrowed
	Counts fStart;
};
