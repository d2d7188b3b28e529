// EditorFixture: an editor of an item in a window, used by mouse and keys.
#pragma once

#include <memory>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include <Message.h>
#include <TextControl.h>

#include "addon/ViewEditor.h"
#include "archive/ViewArchive.h"
#include "archive/ViewTree.h"
#include "editors/EditorInterface.h"
#include "support/ControlUser.h"
#include "support/TestWindow.h"
#include "work/WorkView.h"


class EditorFixture : public testing::Test {
protected:
	explicit EditorFixture(BRect frame = BRect(10, 10, 909, 759)) :
		window(frame), args { &collection }, owner(args)
	{
	}

	~EditorFixture() override { Close(); }

	static std::vector<char> Flatten(const BMessage& archive)
	{
		std::vector<char> bytes(static_cast<size_t>(archive.FlattenedSize()));
		archive.Flatten(bytes.data(), static_cast<ssize_t>(bytes.size()));
		return bytes;
	}

	static std::vector<char> Flatten(BView* root)
	{
		std::unique_ptr<BView> owned(root);
		BMessage archive;
		root->Archive(&archive, true);
		SwapInheritedViews(&archive, 0);
		return Flatten(archive);
	}

	BResEditor::BResourceHandle Add(int32 id, const std::vector<char>& bytes)
	{
		BResEditor::BResourceHandle handle;
		BResEditor::BResourceCollection* writable = owner.WriteLock(NULL);
		writable->AddItem(&handle, 'ARCV', id, "", bytes.data(), bytes.size());
		owner.WriteUnlock(writable);
		return handle;
	}

	BResEditor::BResourceHandle Add(int32 id, BView* root) { return Add(id, Flatten(root)); }

	std::string Bytes(const BResEditor::BResourceHandle& handle)
	{
		const BResEditor::BResourceItem* found = collection.Item(handle);
		return std::string(static_cast<const char*>(found->Data()), found->Size());
	}

	BMessage Archive(const BResEditor::BResourceHandle& handle)
	{
		BMessage archive;
		EXPECT_EQ(B_OK, archive.Unflatten(Bytes(handle).data()));
		return archive;
	}

	void Open(const BResEditor::BResourceHandle& item)
	{
		editor = new ViewEditor(args, item);
		window.Locked([&] {
			const BRect bounds = window.Window()->Bounds();
			window.Window()->AddChild(editor);
			editor->ResizeTo(bounds.Width(), bounds.Height());
		});
		workView = dynamic_cast<WorkView*>(editor->FindView("WorkView"));
	}

	// As the host does: out of the window first.
	void Close()
	{
		if (editor == nullptr)
			return;
		window.Locked([&] { editor->RemoveSelf(); });
		delete static_cast<BResEditor::BFullItemEditor*>(editor);
		editor = nullptr;
	}

	BView* Root() { return workView->EditView(); }
	BView* Find(const char* name) { return Root()->FindView(name); }
	template<class View> View* Find(const char* name) { return dynamic_cast<View*>(Find(name)); }
	BView* Column() { return editor->ChildAt(0); }

	// Clicks on a part of the view that no child covers. A selected view would be taken along.
	void Select(BView* view)
	{
		if (view == workView->SelectedView())
			return;
		const BPoint place = BarePlace(view);
		driver.Click(view, place);
		ASSERT_EQ(view, workView->SelectedView());
	}

	// From the left top, a little inside.
	BPoint BarePlace(BView* view)
	{
		const BRect bounds = view->Bounds();
		for (float y = bounds.top; y <= bounds.bottom; y += 1) {
			for (float x = bounds.left; x <= bounds.right; x += 1) {
				if (PointInView(view, BPoint(x, y), nullptr) == view)
					return BPoint(x, y);
			}
		}
		ADD_FAILURE() << view->Name() << " is covered by its children";
		return BPoint();
	}

	// A panel that is shown, or NULL.
	BView* Panel(const char* name) { return Column()->FindView(name); }

	template<class Control> Control* InPanel(const char* panel, const std::string& label, int n = 0)
	{
		return ControlUser::Find<Control>(Panel(panel), label, n);
	}

	BTextControl* Field(const char* panel, const char* label, int n = 0)
	{
		return InPanel<BTextControl>(panel, label, n);
	}

	TestWindow window;
	Driver& driver { window.driver };
	ControlUser person { window.driver };
	BResEditor::BResourceCollection collection;
	BResEditor::BResourceAddonArgs args;
	BResEditor::BResourceAddonBase owner; // of the items
	ViewEditor* editor = nullptr;
	WorkView* workView = nullptr;
};
