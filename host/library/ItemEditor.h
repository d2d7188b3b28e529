// BFullItemEditor and BMiniItemEditor: editors of one item, embedded in the host's windows.
#pragma once

#include <BeBuild.h>
#include <SupportDefs.h>

#include "host/library/ResourceAddonBase.h"

class BMenu;
class BMenuItem;
class BMessage;
class BView;

namespace BResEditor {


// An editor that fills a window. The host puts View() into a window, takes it out again before the
// window goes, and then deletes the editor as a BFullItemEditor; the window never deletes it.
// All calls come in that window's thread with the window locked.
class _EXPORT BFullItemEditor : public BResourceAddonBase {
public:
	BFullItemEditor(
		const BResourceAddonArgs& args, const BResourceHandle& handle, BHandler* handler = NULL);
	~BFullItemEditor() override;

	// Whether ApplyChanges() would write something; false when the editor does not know.
	virtual bool HasOpenChanges();

	// Writes what is being edited into the item; calls UpdateValue(NULL).
	virtual void ApplyChanges();

	// Points the editor at another item.
	virtual status_t Retarget(BResourceHandle handle);

	virtual BView* View() = 0;

	// Entries for the window's menus, given to the caller; NULL for none.
	virtual BMenuItem* EditMenuItem();
	virtual BMenu* CustomMenu();

	// How the editor is set up for its user (scroll places, open sections), not the item's data.
	virtual status_t GetConfiguration(BMessage* configuration) const;
	virtual status_t SetConfiguration(const BMessage* configuration);

	// Writes the edited value into the item when it differs; the text names the undo step.
	virtual void UpdateValue(const char* operation);
};


// An editor small enough for a row of the host's list. Ownership as above.
class _EXPORT BMiniItemEditor : public BResourceAddonBase {
public:
	BMiniItemEditor(
		const BResourceAddonArgs& args, const BResourceHandle& handle, BHandler* handler = NULL);
	~BMiniItemEditor() override;

	virtual BView* View() = 0;
};


} // namespace BResEditor
