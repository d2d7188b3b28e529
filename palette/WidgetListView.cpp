#include "palette/WidgetListView.h"

#include <Bitmap.h>
#include <Message.h>
#include <Window.h>

#include "archive/ViewDrag.h"
#include "palette/WidgetCatalogue.h"

namespace {


// The nesting mirrors the platform's class tree.
struct Entry {
	const char* text;
	uint32 level;
	bool enabled; // headings are not
};

constexpr Entry kEntries[] = { { "BView", 0, true }, { "BView (custom)", 1, true },
	{ "BBox", 1, true }, { "BStringView", 1, true }, { "BControl", 1, false },
	{ "BButton", 2, true }, { "BCheckBox", 2, true }, { "BRadioButton", 2, true },
	{ "BTextControl", 2, true }, { "BSlider", 2, true }, { "BColorControl", 2, true },
	{ "BMenuField", 1, true }, { "BStatusBar", 1, true }, { "BTextView", 1, true },
	{ "BScrollView containing...", 1, false }, { "BScrollView with BView", 2, true },
	{ "BScrollView with BTextView", 2, true }, { "BTabView", 1, true }, { "BListView", 1, true },
	{ "BOutlineListView", 1, true }, { "BMenuBar", 1, true } };


} // namespace


WidgetListView::WidgetListView(BRect frame, const char* name) :
	BOutlineListView(frame, name, B_SINGLE_SELECTION_LIST, B_FOLLOW_ALL_SIDES,
		B_WILL_DRAW | B_FRAME_EVENTS | B_NAVIGABLE)
{
	for (const Entry& entry : kEntries) {
		fItems.push_back(std::make_unique<BStringItem>(entry.text, entry.level, true));
		AddItem(fItems.back().get());
	}
	for (size_t i = 0; i < fItems.size(); i++) {
		if (!kEntries[i].enabled)
			fItems[i]->SetEnabled(false);
	}
}


WidgetListView::~WidgetListView()
{
	MakeEmpty();
}


bool
WidgetListView::InitiateDrag(BPoint where, int32 index, bool wasSelected)
{
	const BStringItem* item = dynamic_cast<BStringItem*>(ItemAt(index));
	const std::unique_ptr<BView> sample(item != nullptr ? MakeSample(item->Text()) : nullptr);
	if (sample == nullptr)
		return true;

	const BRect bounds = sample->Bounds();
	BBitmap* image = MakeDragImage(sample.get(), [&sample] { FinishAttachedSample(sample.get()); });
	BMessage drag;
	MakeDragMessage(sample.get(), &drag);
	SetEventMask(B_POINTER_EVENTS); // the button is released elsewhere
	ShowDragPointer(false);
	DragMessage(
		&drag, image, B_OP_ALPHA, BPoint(bounds.Width() / 2, bounds.Height() / 2), Window());
	return true;
}


void
WidgetListView::MouseUp(BPoint where)
{
	BOutlineListView::MouseUp(where);
	SetEventMask(0);
	EndDragPointer();
}


void
WidgetListView::DetachedFromWindow()
{
	EndDragPointer();
	BOutlineListView::DetachedFromWindow();
}
