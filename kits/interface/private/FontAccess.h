// Between BFont, the value that programs see, and FontSpec, the value that painting uses.
#pragma once

#include <Font.h>

#include "server/paint/FontSpec.h"

namespace BPrivate {


FontSpec ToFontSpec(const BFont& font);


} // namespace BPrivate
