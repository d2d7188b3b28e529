// The catalogue of widgets: what the palette's entries stand for.
#pragma once

class BView;

// A new sample of the kind that the palette's entry names, in its sample colours and preferred
// size, for the caller. NULL for a text that names no kind.
BView* MakeSample(const char* entry);

// What a sample needs once it is attached somewhere.
void FinishAttachedSample(BView* sample);
