// Dragging a view: its translucent picture, the message that carries it, and the file it becomes.
#pragma once

#include <functional>

#include <SupportDefs.h>

class BBitmap;
class BMessage;
class BView;

// A dragged view lies in the drag message as the message field "dropped view"; as a file it is a
// resource of type 'ARCV' with this name.
constexpr const char* kDroppedViewField = "dropped view";
constexpr const char* kDraggedResourceName = "zetka";

// A picture of a view that is in no window, for the caller or for DragMessage() to own. Black and
// white pixels are opaque, all others show what is below. The function is called while the view is
// attached to the picture.
BBitmap* MakeDragImage(BView* view, const std::function<void()>& whileAttached = {});

// Makes the message that carries a deep archive of the view to work areas and file managers.
status_t MakeDragMessage(const BView* view, BMessage* drag);

// The pointer while a view is dragged tells whether what is below takes it. The drag's source shows
// and ends it, and whoever takes views shows it while the pointer is there. Any thread.
void ShowDragPointer(bool accepts);
void EndDragPointer();

// Carries out a file manager's B_COPY_TARGET reply to such a drag: writes the view into the file
// that the file manager has made.
status_t WriteDraggedView(BMessage* reply);
