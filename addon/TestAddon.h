// TestAddon: the add-on's one resource handler, for archived views.
#pragma once

#include "host/library/ResourceAddon.h"


class TestAddon : public BResEditor::BResourceAddon {
public:
	explicit TestAddon(const BResEditor::BResourceAddonArgs& args);
	~TestAddon() override;

	status_t GetNthGenerateInfo(int32 n, BMessage* info) const override;
	status_t GenerateResource(BResEditor::BResourceHandle* out, const BMessage* request, int32 id,
		const char* name, bool make_unique,
		BResEditor::BResourceCollection::conflict_resolution resolution) override;

	float QuickQuality(const BResEditor::BResourceItem* item) const override;
	float PreciseQuality(const BResEditor::BResourceItem* item) const override;

	BResEditor::BMiniItemEditor* MakeMiniEditor(const BResEditor::BResourceAddonArgs& args,
		BResEditor::BResourceHandle handle, const BMessage* configuration) override;
	BResEditor::BFullItemEditor* MakeFullEditor(const BResEditor::BResourceAddonArgs& args,
		BResEditor::BResourceHandle handle, const BMessage* configuration) override;

	status_t HandleDrop(const BMessage* drop) override;
};
