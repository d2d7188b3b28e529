// The add-on's entry point.

#include <BeBuild.h>
#include <image.h>

#include "addon/TestAddon.h"


extern "C" _EXPORT BResEditor::BResourceAddon*
make_nth_resourcer(
	int32 n, image_id image, const BResEditor::BResourceAddonArgs& args, uint32 flags)
{
	return n == 0 ? new TestAddon(args) : nullptr;
}
