// DragOffer: drags in the form of other programs, both ways.
#pragma once

#include <memory>

#include "backend/Backend.h"
#include "server/DragSession.h"

namespace BPrivate {

class DesktopThread;


// What other programs may take of a drag of ours: files for "refs", a file written on request for
// the file type among "be:types", and every field that is named by a MIME type.
DataOffer make_drag_offer(DesktopThread& desktop, const DragReference& session);

// The message of a drag that comes in, whose fields are named by MIME types: files become "refs"
// of a B_SIMPLE_DATA message, anything else stays in a B_MIME_DATA message.
std::unique_ptr<BMessage> make_foreign_drag(const BMessage& data);


} // namespace BPrivate
