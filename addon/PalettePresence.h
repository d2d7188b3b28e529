// Opens and closes the palette that all editors share, as they come and go.
#pragma once

// Counts an editor that is attached; the first one opens the palette. Any window's thread.
void EnterPalette();

// Counts an editor that is detached; the last one closes the palette.
void LeavePalette();
