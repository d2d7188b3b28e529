// The picture of a channel slider's thumb.
#pragma once

#include <memory>

#include <GraphicsDefs.h>
#include <InterfaceDefs.h>

class BBitmap;

namespace BPrivate {


constexpr float kThumbAlong = 17; // pixels, along the bar
constexpr float kThumbAcross = 13;

// One for each look, made when it is first asked for and shared as long as somebody holds it. NULL
// without an application. Safe on any thread.
std::shared_ptr<BBitmap> channel_thumb(orientation posture, uint32 lookState, rgb_color base);


} // namespace BPrivate
