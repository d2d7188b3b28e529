// A shelf in the second of two windows, and what can be put into it.
#pragma once

#include <memory>
#include <vector>

#include <PopUpMenu.h>
#include <Shelf.h>

#include "ReplicantWindows.h"


// A shelf of the other window, which notes what it is asked.
class NotingShelf : public BShelf {
public:
	using BShelf::BShelf;

	std::vector<int32> deleted;
	BRect asked;
	BPoint adjustment;
	bool takesMessages = true;
	bool takesViews = true;

	bool CanAcceptReplicantMessage(BMessage* archive) const override
	{
		return takesMessages && BShelf::CanAcceptReplicantMessage(archive);
	}

	bool CanAcceptReplicantView(BRect destination, BView* view, BMessage* archive) const override
	{
		const_cast<NotingShelf*>(this)->asked = destination;
		EXPECT_NE(nullptr, view);
		return takesViews && BShelf::CanAcceptReplicantView(destination, view, archive);
	}

	BPoint AdjustReplicantBy(BRect destination, BMessage* archive) const override
	{
		return adjustment + BShelf::AdjustReplicantBy(destination, archive);
	}

	void ReplicantDeleted(int32 index, const BMessage* archive, const BView* replicant) override
	{
		EXPECT_NE(nullptr, archive);
		EXPECT_EQ(nullptr, replicant != NULL ? replicant->Window() : NULL);
		deleted.push_back(index);
		BShelf::ReplicantDeleted(index, archive, replicant);
	}
};


struct ShelfWindows : ReplicantWindows {
	ShelfWindows()
	{
		drops->notes = false;
		LockedOther([&] { shelf = std::make_unique<NotingShelf>(drops, true, "shelf of a kind"); });
	}

	~ShelfWindows()
	{
		other->Lock();
		shelf.reset();
		other->Unlock();
	}

	int32 Count()
	{
		return LockedOther([&] { return shelf->CountReplicants(); });
	}

	BView* ViewAt(int32 index)
	{
		return LockedOther([&] {
			BView* view = NULL;
			shelf->ReplicantAt(index, &view);
			return view;
		});
	}

	BDragger* DraggerAt(int32 index)
	{
		BView* view = ViewAt(index);
		return LockedOther([&] {
			for (BView* child = view->ChildAt(0); child != NULL; child = child->NextSibling()) {
				if (BDragger* dragger = dynamic_cast<BDragger*>(child))
					return dragger;
			}
			return static_cast<BDragger*>(NULL);
		});
	}

	BRect FrameAt(int32 index)
	{
		BView* view = ViewAt(index);
		return LockedOther([&] { return view->Frame(); });
	}

	// The middle of an item of a menu that is open.
	void ChooseItem(BMenu* menu, int32 index)
	{
		ASSERT_TRUE(menu->LockLooper()) << "not open";
		const BRect frame = menu->ItemAt(index)->Frame();
		const BPoint where = menu->ConvertToScreen(frame.LeftTop() + BPoint(10, 8));
		menu->UnlockLooper();
		driver.Click(where);
	}

	void OpenMenu(BDragger* dragger)
	{
		driver.Click(dragger, BPoint(4, 4), 1, B_SECONDARY_MOUSE_BUTTON);
	}

	std::unique_ptr<NotingShelf> shelf;
};


inline BMessage
TextArchive(const char* text = "text", bool hasDragger = true)
{
	BStringView view(BRect(10, 10, 109, 39), text, text);
	if (hasDragger)
		view.AddChild(new BDragger(BRect(92, 22, 99, 29), &view));
	BMessage archive = ArchiveOf(view);
	archive.what = B_ARCHIVED_OBJECT;
	return archive;
}


inline BMessage
StrangeArchive()
{
	BMessage archive = TextArchive();
	archive.ReplaceString("class", "ClassOfAnotherProgram");
	archive.AddInt32("its field", 5);
	return archive;
}
