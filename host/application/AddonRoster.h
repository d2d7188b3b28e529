// AddonRoster: the add-ons that are loaded, and the handlers that they make for one collection.
#pragma once

#include <memory>
#include <string>
#include <vector>

#include <image.h>

#include "host/library/ResourceAddon.h"


// Loads every add-on of a folder once, for the life of the program.
class AddonRoster {
public:
	typedef BResEditor::BResourceAddon* (*MakeHandler)(
		int32 n, image_id image, const BResEditor::BResourceAddonArgs& args, uint32 flags);

	struct Addon {
		image_id image;
		MakeHandler make;
	};

	// Add-ons that cannot be loaded are named on standard error and left out.
	static void Load(const std::string& folder);
	static const std::vector<Addon>& Addons();
};


// One handler of each kind for one collection.
class HandlerSet {
public:
	explicit HandlerSet(const BResEditor::BResourceAddonArgs& args);

	// The handler that rates the item best, or NULL when all decline. Read lock.
	BResEditor::BResourceAddon* BestFor(const BResEditor::BResourceItem* item) const;

	const std::vector<std::unique_ptr<BResEditor::BResourceAddon>>& Handlers() const;

private:
	std::vector<std::unique_ptr<BResEditor::BResourceAddon>> fHandlers;
};
