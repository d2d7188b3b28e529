// WidgetListView: the palette's outline of widget kinds, from which samples are dragged.
#pragma once

#include <memory>
#include <vector>

#include <OutlineListView.h>
#include <StringItem.h>


class WidgetListView : public BOutlineListView {
public:
	WidgetListView(BRect frame, const char* name);
	~WidgetListView() override;

	// Drags a new sample of the item's kind; the replies go to the window.
	bool InitiateDrag(BPoint where, int32 index, bool wasSelected) override;
	void MouseUp(BPoint where) override;
	void DetachedFromWindow() override;

private:
	std::vector<std::unique_ptr<BStringItem>> fItems; // a list does not own its items
};
