// ArabicForms: the shapes that Arabic letters take beside each other.
#pragma once

#include <functional>
#include <vector>

#include <SupportDefs.h>

namespace BPrivate {


// In the text's order; characters of other scripts stay, and those whose form the font lacks. Of a
// lam with an alef behind it the alef becomes U+200B.
std::vector<uint32> JoinedForms(
	std::vector<uint32> characters, const std::function<bool(uint32)>& hasForm);


} // namespace BPrivate
