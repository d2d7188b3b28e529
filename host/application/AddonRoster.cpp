#include "host/application/AddonRoster.h"

#include <cstdio>
#include <cstring>

#include <Directory.h>
#include <Entry.h>
#include <Path.h>

using namespace BResEditor;

namespace {


std::vector<AddonRoster::Addon> sAddons;


} // namespace


void
AddonRoster::Load(const std::string& folder)
{
	BDirectory directory(folder.c_str());
	BEntry entry;
	while (directory.GetNextEntry(&entry) == B_OK) {
		BPath path;
		if (entry.GetPath(&path) != B_OK)
			continue;

		const image_id image = load_add_on(path.Path());
		void* function;
		if (image < 0
			|| get_image_symbol(image, "make_nth_resourcer", B_SYMBOL_TYPE_TEXT, &function)
				!= B_OK) {
			fprintf(stderr, "archway: %s: this is no add-on\n", path.Path());
			continue;
		}
		sAddons.push_back({ image, reinterpret_cast<MakeHandler>(function) });
	}
}


const std::vector<AddonRoster::Addon>&
AddonRoster::Addons()
{
	return sAddons;
}


// #pragma mark - HandlerSet


HandlerSet::HandlerSet(const BResourceAddonArgs& args)
{
	for (const AddonRoster::Addon& addon : AddonRoster::Addons()) {
		for (int32 n = 0; BResourceAddon* handler = addon.make(n, addon.image, args, 0); n++)
			fHandlers.emplace_back(handler);
	}
}


BResourceAddon*
HandlerSet::BestFor(const BResourceItem* item) const
{
	BResourceAddon* best = nullptr;
	float bestQuality = 0;
	for (const auto& handler : fHandlers) {
		const float quality = handler->PreciseQuality(item);
		if (quality > bestQuality) {
			best = handler.get();
			bestQuality = quality;
		}
	}
	return best;
}


const std::vector<std::unique_ptr<BResourceAddon>>&
HandlerSet::Handlers() const
{
	return fHandlers;
}
