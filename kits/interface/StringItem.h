// BStringItem: a list item that shows one line of text.
#pragma once

#include <ListItem.h>


class BStringItem : public BListItem {
public:
	BStringItem(const char* text, uint32 outlineLevel = 0, bool expanded = true);
	BStringItem(BMessage* archive);
	virtual ~BStringItem();

	static BArchivable* Instantiate(BMessage* archive);
	virtual status_t Archive(BMessage* archive, bool deep = true) const;

	virtual void DrawItem(BView* owner, BRect frame, bool complete = false);
	// Copied; NULL stays NULL. The list shows it after InvalidateItem().
	virtual void SetText(const char* text);
	const char* Text() const;
	virtual void Update(BView* owner, const BFont* font);
	virtual status_t Perform(perform_code code, void* data);

protected:
	// Pixels from the top of the item to the text's baseline.
	float BaselineOffset() const;

private:
	char* fText; // owned
	float fBaselineOffset;
};
