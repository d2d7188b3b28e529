// BResourceAddon: handles resource types for the host: rates items, makes them, makes editors.
#pragma once

#include <BeBuild.h>
#include <SupportDefs.h>
#include <image.h>

#include "host/library/ItemEditor.h"
#include "host/library/ResourceAddonBase.h"

class BMessage;

namespace BResEditor {

// Fields of a generate-info and of the request made from it.
#define B_GENERATE_NAME "be:generate_name" // string: what the user chooses in the New menu
#define B_GENERATE_TYPE "be:generate_type" // int32: the resource type that is made


// One handler of an add-on, owned by the host and deleted before the add-on's image is closed.
// Qualities are from -1.0 (cannot) to 1.0 (made for it). Calls may come in any of the host's
// threads, one at a time.
class _EXPORT BResourceAddon : public BResourceAddonBase {
public:
	explicit BResourceAddon(const BResourceAddonArgs& args);
	~BResourceAddon() override;

	// Describes the n-th kind of item that this handler can make; an error ends the enumeration.
	virtual status_t GetNthGenerateInfo(int32 n, BMessage* info) const;

	// Makes an item as a generate-info asked and returns its handle.
	virtual status_t GenerateResource(BResourceHandle* _handle, const BMessage* request, int32 id,
		const char* name, bool makeUnique, BResourceCollection::conflict_resolution resolution);

	// The first looks at type, id and name only, the second may read the data. Read lock is held.
	virtual float QuickQuality(const BResourceItem* item) const;
	virtual float PreciseQuality(const BResourceItem* item) const;

	// The caller owns the editor. NULL when there is none. The configuration may be NULL.
	virtual BMiniItemEditor* MakeMiniEditor(
		const BResourceAddonArgs& args, BResourceHandle handle, const BMessage* configuration);
	virtual BFullItemEditor* MakeFullEditor(
		const BResourceAddonArgs& args, BResourceHandle handle, const BMessage* configuration);

	// Data from the clipboard, from a drop, and from an imported file.
	virtual float PasteQuality(const BMessage* clip) const;
	virtual status_t HandlePaste(const BMessage* clip);
	virtual float DropQuality(const BMessage* drop) const;
	virtual status_t HandleDrop(const BMessage* drop);
	virtual float BufferQuality(const void* data, size_t size) const;
	virtual status_t HandleBuffer(const void* data, size_t size);
};


} // namespace BResEditor


// What an add-on exports: its n-th handler, or NULL after the last. The image is the add-on's own.
extern "C" _EXPORT BResEditor::BResourceAddon* make_nth_resourcer(
	int32 n, image_id image, const BResEditor::BResourceAddonArgs& args, uint32 flags);
