// The window inside a bitmap that accepts views.
#pragma once

#include <Rect.h>

class BBitmap;
class BWindow;

namespace BPrivate {

class Surface;


// A window that is never shown: its views draw straight into the surface, whenever they are told
// to. Its looper does not run; the bitmap locks it from the drawing thread and ends it with
// Lock() and Quit(). Both arguments outlive the window.
BWindow* NewOffscreenWindow(BBitmap* bitmap, Surface* surface);


} // namespace BPrivate
