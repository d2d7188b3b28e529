// CatalogueFixture: a view of the palette in an empty design, which is saved to a file and opened again.
#pragma once

#include <File.h>
#include <OutlineListView.h>
#include <Resources.h>
#include <ScrollView.h>

#include "EditorFixture.h"
#include "palette/WidgetWindow.h"
#include "scenarios/ScratchFolder.h"


class CatalogueFixture : public EditorFixture {
protected:
	CatalogueFixture() : EditorFixture(BRect(10, 10, 1509, 909))
	{
		item = Add(
			1, new BView(BRect(0, 0, 699, 699), "root", B_FOLLOW_LEFT | B_FOLLOW_TOP, B_WILL_DRAW));
		Open(item);
	}

	// By the mouse; the view under the place of the design takes it.
	void DragTo(const char* entry, BPoint place)
	{
		BOutlineListView* list = dynamic_cast<BOutlineListView*>(
			dynamic_cast<BScrollView*>(widgetWindow->ChildAt(0))->Target());
		driver.Drag(person.PlaceOfEntry(list, entry), Driver::PointIn(Root(), place));
	}

	void DragIn(const char* entry)
	{
		DragTo(entry, BPoint(150, 150));
		ASSERT_EQ(1, Root()->CountChildren());
	}

	BView* Sample() { return Root()->ChildAt(0); }

	// Closes the editor, which saves, and opens what a file has of it.
	void SaveAndReopen()
	{
		Close();
		item = Saved();
		Open(item);
	}

	// Through a file.
	BResEditor::BResourceHandle Saved()
	{
		const ScratchFolder folder;
		const std::string path = folder.Path("design.rsrc");
		const std::string bytes = Bytes(item);
		{
			BFile file(path.c_str(), B_READ_WRITE | B_CREATE_FILE);
			BResources resources(&file, true);
			EXPECT_EQ(B_OK, resources.AddResource('ARCV', 1, bytes.data(), bytes.size(), "design"));
		}
		BFile file(path.c_str(), B_READ_ONLY);
		BResources resources(&file);
		size_t size = 0;
		const char* data =
			static_cast<const char*>(resources.LoadResource('ARCV', int32(1), &size));
		return Add(++fLastId, std::vector<char>(data, data + size));
	}

	BResEditor::BResourceHandle item; // what is open

private:
	int32 fLastId = 1;
};
