// BListItem: what a list view holds, abstract.
#pragma once

#include <memory>

#include <Archivable.h>
#include <Font.h>
#include <Rect.h>

class BListView;
class BView;

namespace BPrivate {
class ArchiveSource;
}


// An item belongs to the program; a list only refers to it. While it is in an attached list, use
// it under the window's lock.
class BListItem : public BArchivable {
public:
	BListItem(uint32 outlineLevel = 0, bool expanded = true);
	BListItem(BMessage* archive);
	virtual ~BListItem();
	BListItem(const BListItem&) = delete;
	BListItem& operator=(const BListItem&) = delete;

	virtual status_t Archive(BMessage* archive, bool deep = true) const;

	float Height() const;
	float Width() const;
	void SetHeight(float height);
	void SetWidth(float width);

	// These only change the item; a list's own Select() keeps its books as well.
	void Select();
	void Deselect();
	bool IsSelected() const;
	virtual void SetEnabled(bool enabled);
	bool IsEnabled() const;

	bool IsExpanded() const;
	void SetExpanded(bool expanded);
	uint32 OutlineLevel() const;
	void SetOutlineLevel(uint32 level);
	bool HasSubitems() const;
	bool IsItemVisible() const;

	// `frame` is in the owner's coordinates; `complete` asks for the background as well.
	virtual void DrawItem(BView* owner, BRect frame, bool complete = false) = 0;
	// Takes width and height anew; called on attach and when the owner's font changes.
	virtual void Update(BView* owner, const BFont* font);
	virtual status_t Perform(perform_code code, void* data);

private:
	friend class BListView;
	friend class BOutlineListView;

	float fWidth;
	float fHeight;
	float fTop; // place in the list, kept by it
	int32 fIndex; // where the list saw it last: a first guess, checked before use
	int32 fFullIndex; // the same in an outline's full list
	uint32 fLevel;
	bool fSelected;
	bool fEnabled;
	bool fExpanded;
	bool fHasSubitems;
	bool fVisible;
	BListView* fReviver; // the list that made it from its own archive and still has it, or NULL
	std::unique_ptr<BPrivate::ArchiveSource> fSource; // what it was revived from
};

#include <StringItem.h>
