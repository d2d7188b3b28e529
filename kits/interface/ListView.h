// BListView: a column of items that the user selects from.
#pragma once

#include <memory>
#include <unordered_set>
#include <vector>

#include <Invoker.h>
#include <List.h>
#include <ListItem.h>
#include <View.h>

class BList;

enum list_view_type : uint32 { B_SINGLE_SELECTION_LIST, B_MULTIPLE_SELECTION_LIST };


// The items stay the program's: neither removal nor the destructor deletes them. Only those that
// the list made from its own archive, and that were not removed, go with it.
class BListView : public BView, public BInvoker {
public:
	BListView(BRect frame, const char* name, list_view_type type = B_SINGLE_SELECTION_LIST,
		uint32 resizingMode = B_FOLLOW_LEFT | B_FOLLOW_TOP,
		uint32 flags = B_WILL_DRAW | B_NAVIGABLE | B_FRAME_EVENTS);
	BListView(BMessage* archive);
	virtual ~BListView();

	static BArchivable* Instantiate(BMessage* archive);
	virtual status_t Archive(BMessage* archive, bool deep = true) const;

	virtual void Draw(BRect updateRect);
	virtual void MessageReceived(BMessage* message);
	virtual void MouseDown(BPoint where);
	virtual void KeyDown(const char* bytes, int32 numBytes);
	virtual void MakeFocus(bool focus = true);
	virtual void SetFont(const BFont* font, uint32 mask = B_FONT_ALL);
	virtual void FrameResized(float width, float height);
	virtual void TargetedByScrollView(BScrollView* scroller);
	virtual void ScrollTo(BPoint where);
	inline void ScrollTo(float x, float y) { ScrollTo(BPoint(x, y)); }

	// False for a bad index or a NULL item.
	virtual bool AddItem(BListItem* item);
	virtual bool AddItem(BListItem* item, int32 atIndex);
	virtual bool AddList(BList* newItems);
	virtual bool AddList(BList* newItems, int32 atIndex);
	virtual bool RemoveItem(BListItem* item);
	virtual BListItem* RemoveItem(int32 index);
	virtual bool RemoveItems(int32 index, int32 count);

	// Both are owned by the list.
	virtual void SetSelectionMessage(BMessage* message);
	virtual void SetInvocationMessage(BMessage* message);
	BMessage* SelectionMessage() const;
	uint32 SelectionCommand() const;
	BMessage* InvocationMessage() const;
	uint32 InvocationCommand() const;

	virtual void SetListType(list_view_type type);
	list_view_type ListType() const;

	BListItem* ItemAt(int32 index) const;
	int32 IndexOf(BListItem* item) const;
	int32 IndexOf(BPoint point) const;
	BListItem* FirstItem() const;
	BListItem* LastItem() const;
	bool HasItem(BListItem* item) const;
	int32 CountItems() const;
	virtual void MakeEmpty();
	bool IsEmpty() const;
	void DoForEach(bool (*func)(BListItem* item));
	void DoForEach(bool (*func)(BListItem* item, void* arg), void* arg);
	const BListItem** Items() const;
	void InvalidateItem(int32 index);
	void ScrollToSelection();

	void Select(int32 index, bool extend = false);
	void Select(int32 from, int32 to, bool extend = false);
	bool IsItemSelected(int32 index) const;
	// The index of the n-th selected item, ascending; -1 when there is none.
	int32 CurrentSelection(int32 index = 0) const;
	virtual status_t Invoke(BMessage* message = NULL);

	void DeselectAll();
	void DeselectExcept(int32 exceptFrom, int32 exceptTo);
	void Deselect(int32 index);
	virtual void SelectionChanged();

	void SortItems(int (*compare)(const void*, const void*));

	bool SwapItems(int32 a, int32 b);
	bool MoveItem(int32 from, int32 to);
	bool ReplaceItem(int32 index, BListItem* item);

	virtual void AttachedToWindow();
	virtual void FrameMoved(BPoint newPosition);
	BRect ItemFrame(int32 index);
	virtual BHandler* ResolveSpecifier(
		BMessage* message, int32 index, BMessage* specifier, int32 form, const char* property);
	virtual status_t GetSupportedSuites(BMessage* data);
	virtual status_t Perform(perform_code code, void* data);
	virtual void WindowActivated(bool active);
	virtual void MouseUp(BPoint where);
	virtual void MouseMoved(BPoint where, uint32 code, const BMessage* message);
	virtual void DetachedFromWindow();
	// Called while the press is held and the pointer has moved; `point` is the place of the press.
	// True means that a drag was started: the list follows the press no longer.
	virtual bool InitiateDrag(BPoint point, int32 index, bool initiallySelected);

	virtual void ResizeToPreferred();
	virtual void GetPreferredSize(float* _width, float* _height);
	virtual void AllAttached();
	virtual void AllDetached();

protected:
	enum MiscCode { B_NO_OP, B_REPLACE_OP, B_MOVE_OP, B_SWAP_OP };
	union MiscData {
		struct Spare {
			int32 data[5];
		} spare;
		struct Replace {
			int32 index;
			BListItem* item;
		} replace;
		struct Move {
			int32 from;
			int32 to;
		} move;
		struct Swap {
			int32 a;
			int32 b;
		} swap;
	};

	virtual bool DoMiscellaneous(MiscCode code, MiscData* data);
	virtual void DrawItem(BListItem* item, BRect itemFrame, bool complete = false);

private:
	friend class BListItem;
	friend class BOutlineListView;
	struct Tracking;
	struct TypeAhead;

	void _Init(list_view_type type);
	void _ReadItems(BMessage* archive, const char* field, std::vector<BListItem*>& items);
	status_t _ArchiveOwn(BMessage* archive, bool deep, const char* field,
		const std::vector<BListItem*>& items) const;
	bool _Insert(int32 index, BListItem* const* items, int32 count);
	void _Take(int32 index, int32 count);
	void _Leave(BListItem* item);
	void _UpdateItem(BListItem* item);
	void _UpdateItems();
	void _EnsurePlaces() const;
	void _PlacesChanged(int32 fromIndex, float oldBottom);
	float _Bottom() const;
	float _WidestItem() const;
	int32 _IndexAt(float y) const;
	void _UpdateScrollBars();
	void _RescanSelection();
	bool _SetSelected(int32 index, bool selected);
	bool _SelectRange(int32 from, int32 to, bool extend);
	bool _DeselectOutside(int32 from, int32 to);
	void _SelectionDone(bool changed);
	void _Press(int32 index, uint32 modifiers);
	void _TrackTo(BPoint where);
	void _AutoScroll();
	void _MoveByKey(int32 to, bool extend);
	int32 _NextEnabled(int32 from, int32 step) const;
	int32 _PageStep(int32 from, bool down) const;
	bool _HandleTypeAhead(const char* bytes, int32 numBytes);
	void _ScrollToItem(int32 index);
	void _ShowFocus();
	void _LightBorder(bool lit);

	std::vector<BListItem*> fItems; // borrowed
	std::unordered_set<BListItem*> fRevived; // made from the list's archive, and still in it
	mutable int32 fPlaced; // so many items from the start know their place and index
	list_view_type fType;
	int32 fFirstSelected; // bounds of the selection; -1 without one
	int32 fLastSelected;
	int32 fAnchor; // where Shift extends from
	int32 fFocusItem; // where the keys are
	std::unique_ptr<BMessage> fSelectionMessage;
	std::unique_ptr<Tracking> fTracking; // the press that is being followed
	std::unique_ptr<TypeAhead> fTypeAhead;
	BScrollView* fScrollView; // borrowed
};
