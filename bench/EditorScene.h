// EditorScene: a design of many small buttons in the view editor, for measuring what a click costs.
#pragma once

#include <string>
#include <vector>

#include <Button.h>
#include <Message.h>
#include <Window.h>

#include "addon/ViewEditor.h"
#include "support/Driver.h"
#include "work/WorkView.h"

namespace bench {


// The first rows are in sight. There is a BApplication, and no window is locked.
class EditorScene {
public:
	static constexpr int32 kColumns = 40;
	static constexpr float kWidth = 18; // of a button, pixels
	static constexpr float kHeight = 14;

	EditorScene(BRect frame, int32 views) :
		fWindow(new BWindow(frame, "scene", B_TITLED_WINDOW, B_ASYNCHRONOUS_CONTROLS)),
		fArgs { &fCollection }, fUser(fArgs)
	{
		const std::vector<char> bytes = _Design(views);
		BResEditor::BResourceCollection* writable = fUser.WriteLock(NULL);
		writable->AddItem(&fItem, 'ARCV', 1, "", bytes.data(), bytes.size());
		fUser.WriteUnlock(writable);
		fWindow->Show();
		Driver::WaitUntilIdle();
	}

	~EditorScene()
	{
		Close();
		if (fWindow->Lock())
			fWindow->Quit();
	}

	EditorScene(const EditorScene&) = delete;
	EditorScene& operator=(const EditorScene&) = delete;

	void Open()
	{
		fEditor = new ViewEditor(fArgs, fItem);
		fWindow->Lock();
		// Only what is attached has its children follow.
		const BRect bounds = fWindow->Bounds();
		fWindow->AddChild(fEditor);
		fEditor->ResizeTo(bounds.Width(), bounds.Height());
		fWindow->Unlock();
		Driver::WaitUntilIdle();
		fChild = static_cast<WorkView*>(fEditor->FindView("WorkView"))->EditView()->ChildAt(0);
		fIndex = 0;
	}

	// As the host does: out of the window first.
	void Close()
	{
		if (fEditor == nullptr)
			return;
		fWindow->Lock();
		fEditor->RemoveSelf();
		fWindow->Unlock();
		delete static_cast<BResEditor::BFullItemEditor*>(fEditor);
		fEditor = nullptr;
	}

	// Another of the first children each time, without a walk from the first one.
	BView* Next(int32 children)
	{
		fIndex = (fIndex + 1) % children;
		fChild = fIndex == 0 ? fChild->Parent()->ChildAt(0) : fChild->NextSibling();
		return fChild;
	}

	BWindow* Window() { return fWindow; }
	ViewEditor* Editor() { return fEditor; }

private:
	static std::vector<char> _Design(int32 views)
	{
		const float height = static_cast<float>((views + kColumns - 1) / kColumns) * 16 - 1;
		BView root(BRect(0, 0, kColumns * 20 - 1, height), "root", B_FOLLOW_NONE, B_WILL_DRAW);
		for (int32 i = 0; i < views; i++) {
			const BPoint at(
				static_cast<float>(i % kColumns) * 20, static_cast<float>(i / kColumns) * 16);
			root.AddChild(new BButton(BRect(at, at + BPoint(kWidth, kHeight)),
				("child " + std::to_string(i)).c_str(), "", new BMessage('pres')));
		}
		BMessage archive;
		root.Archive(&archive, true);
		std::vector<char> bytes(static_cast<size_t>(archive.FlattenedSize()));
		archive.Flatten(bytes.data(), static_cast<ssize_t>(bytes.size()));
		return bytes;
	}

	BWindow* fWindow; // ends with Quit()
	BResEditor::BResourceCollection fCollection;
	BResEditor::BResourceAddonArgs fArgs;
	BResEditor::BResourceAddonBase fUser;
	BResEditor::BResourceHandle fItem;
	ViewEditor* fEditor = nullptr; // owned
	BView* fChild = nullptr; // of the design
	int32 fIndex = 0;
};


} // namespace bench
