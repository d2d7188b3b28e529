// What the sources of BTextControl share.
#pragma once

namespace BPrivate {


constexpr float kTextControlFrame = 2; // pixels round the field
constexpr float kTextControlLabelGap = 2; // between label and divider


} // namespace BPrivate
