// BOutlineListView: a list whose items lie under each other in levels that open and close.
#pragma once

#include <ListView.h>


// The inherited functions and indices mean the items that are visible, that is under expanded
// superitems only; the FullList functions mean all. As in a list view, items stay the program's.
class BOutlineListView : public BListView {
public:
	BOutlineListView(BRect frame, const char* name, list_view_type type = B_SINGLE_SELECTION_LIST,
		uint32 resizingMode = B_FOLLOW_LEFT | B_FOLLOW_TOP,
		uint32 flags = B_WILL_DRAW | B_NAVIGABLE | B_FRAME_EVENTS);
	BOutlineListView(BMessage* archive);
	virtual ~BOutlineListView();

	static BArchivable* Instantiate(BMessage* archive);
	virtual status_t Archive(BMessage* archive, bool deep = true) const;

	virtual void MouseDown(BPoint where);
	virtual void KeyDown(const char* bytes, int32 numBytes);
	virtual void FrameMoved(BPoint newPosition);
	virtual void FrameResized(float width, float height);
	virtual void MouseUp(BPoint where);
	virtual void MouseMoved(BPoint where, uint32 code, const BMessage* message);

	// Right behind the superitem, one level below it.
	virtual bool AddUnder(BListItem* item, BListItem* superitem);

	// Indices of the full list. The item's own level decides where in the outline it lies.
	virtual bool AddItem(BListItem* item);
	virtual bool AddItem(BListItem* item, int32 fullListIndex);
	virtual bool AddList(BList* newItems);
	virtual bool AddList(BList* newItems, int32 fullListIndex);

	// A superitem takes its subitems with it; none is deleted.
	virtual bool RemoveItem(BListItem* item);
	virtual BListItem* RemoveItem(int32 fullListIndex);
	virtual bool RemoveItems(int32 fullListIndex, int32 count);

	BListItem* FullListItemAt(int32 fullListIndex) const;
	int32 FullListIndexOf(BPoint point) const;
	int32 FullListIndexOf(BListItem* item) const;
	BListItem* FullListFirstItem() const;
	BListItem* FullListLastItem() const;
	bool FullListHasItem(BListItem* item) const;
	int32 FullListCountItems() const;
	int32 FullListCurrentSelection(int32 index = 0) const;
	virtual void MakeEmpty();
	bool FullListIsEmpty() const;
	void FullListDoForEach(bool (*func)(BListItem* item));
	void FullListDoForEach(bool (*func)(BListItem* item, void* arg), void* arg);

	BListItem* Superitem(const BListItem* item);
	void Expand(BListItem* item);
	void Collapse(BListItem* item);
	bool IsExpanded(int32 fullListIndex);

	virtual BHandler* ResolveSpecifier(
		BMessage* message, int32 index, BMessage* specifier, int32 form, const char* property);
	virtual status_t GetSupportedSuites(BMessage* data);
	virtual status_t Perform(perform_code code, void* data);
	virtual void ResizeToPreferred();
	virtual void GetPreferredSize(float* _width, float* _height);
	virtual void MakeFocus(bool focus = true);
	virtual void AllAttached();
	virtual void AllDetached();
	virtual void DetachedFromWindow();

	void FullListSortItems(int (*compare)(const BListItem*, const BListItem*));
	void SortItemsUnder(BListItem* superitem, bool oneLevelOnly,
		int (*compare)(const BListItem*, const BListItem*));
	int32 CountItemsUnder(BListItem* superitem, bool oneLevelOnly) const;
	// Stops at the first item that the function returns, and returns it.
	BListItem* EachItemUnder(BListItem* superitem, bool oneLevelOnly,
		BListItem* (*eachFunc)(BListItem* item, void* arg), void* arg);
	BListItem* ItemUnderAt(BListItem* superitem, bool oneLevelOnly, int32 index) const;

protected:
	virtual bool DoMiscellaneous(MiscCode code, MiscData* data);
	virtual void ExpandOrCollapse(BListItem* superitem, bool expand);
	virtual BRect LatchRect(BRect itemRect, int32 level) const;
	virtual void DrawLatch(
		BRect itemRect, int32 level, bool collapsed, bool highlighted, bool misTracked);
	virtual void DrawItem(BListItem* item, BRect itemFrame, bool complete = false);

private:
	int32 _VisibleIndexFor(int32 fullIndex) const;
	int32 _SubtreeEnd(int32 fullIndex) const;
	int32 _SuperitemIndex(int32 fullIndex) const;
	bool _ShowsSubitems(int32 superIndex) const;
	void _CollectVisible(int32 from, int32 to, std::vector<BListItem*>& visible);
	void _RemoveFull(int32 from, int32 to);
	void _TakeHidden(int32 index, int32 count);
	bool _RangeUnder(BListItem* superitem, int32* _from, int32* _to) const;
	void _SubitemsChanged(int32 superIndex);
	void _RebuildVisible();
	void _SortBlock(int32 from, int32 to, bool oneLevelOnly,
		int (*compare)(const BListItem*, const BListItem*));
	bool _SwapBlocks(int32 a, int32 b);
	float _Indent(int32 level) const;
	bool _HitsLatch(BPoint where, int32 index) const;

	std::vector<BListItem*> fFullItems; // borrowed
	mutable bool fFullIndicesValid;
	BListItem* fLatchItem; // the item whose latch is held down, borrowed
	bool fLatchInside;
};
