// EditorScene: a design in a view editor, in a window, for tests that use mouse and keys.
#pragma once

#include <algorithm>
#include <cmath>
#include <memory>
#include <string>
#include <vector>

#include <Message.h>
#include <OutlineListView.h>
#include <ScrollView.h>

#include "addon/ViewEditor.h"
#include "palette/WidgetWindow.h"
#include "support/TestWindow.h"
#include "work/WorkView.h"


class EditorScene {
public:
	explicit EditorScene(BRect frame = BRect(30, 30, 1229, 929)) :
		fWindow(frame), fArgs { &fCollection }, fUser(fArgs)
	{
	}

	~EditorScene() { Close(); }

	// The design that was open before is closed.
	void Open(const BMessage& archive)
	{
		std::string bytes(static_cast<size_t>(archive.FlattenedSize()), '\0');
		archive.Flatten(bytes.data(), static_cast<ssize_t>(bytes.size()));
		Open(bytes);
	}

	void Open(const std::string& bytes)
	{
		Close();
		BResourceHandle item;
		BResEditor::BResourceCollection* writable = fUser.WriteLock(NULL);
		writable->AddItem(&item, 'ARCV', ++fLastId, "", bytes.data(), bytes.size());
		fUser.WriteUnlock(writable);
		fEditor = new ViewEditor(fArgs, item);
		fWindow.Locked([&] {
			// Only what is attached has its children follow.
			const BRect bounds = fWindow.Window()->Bounds();
			fWindow.Window()->AddChild(fEditor);
			fEditor->ResizeTo(bounds.Width(), bounds.Height());
		});
		// Out of the way.
		widgetWindow->Lock();
		widgetWindow->MoveTo(fWindow.Window()->Frame().RightTop() + BPoint(40, 0));
		widgetWindow->Unlock();
		Driver::WaitUntilIdle();
	}

	// As the host does: out of the window first.
	void Close()
	{
		if (fEditor == nullptr)
			return;
		fWindow.Locked([&] { fEditor->RemoveSelf(); });
		delete static_cast<BResEditor::BFullItemEditor*>(fEditor);
		fEditor = nullptr;
	}

	void Locked(const std::function<void()>& function) { fWindow.Locked(function); }

	Driver& Input() { return fWindow.driver; }
	BWindow* Window() { return fWindow.Window(); }
	ViewEditor* Editor() { return fEditor; }
	WorkView* Work() { return static_cast<WorkView*>(fEditor->FindView("WorkView")); }
	BView* Root() { return Work()->EditView(); }

	// Where an entry of the palette is on the screen, scrolled into sight; the last one when there
	// is none of that text.
	static BPoint PaletteEntry(const std::string& text)
	{
		widgetWindow->Lock();
		BOutlineListView* list = dynamic_cast<BOutlineListView*>(
			dynamic_cast<BScrollView*>(widgetWindow->ChildAt(0))->Target());
		int32 index = 0;
		while (index < list->CountItems() - 1
			&& dynamic_cast<BStringItem*>(list->ItemAt(index))->Text() != text)
			index++;
		list->ScrollTo(BPoint(0, std::max(0.0f, list->ItemFrame(index).top - 60)));
		const BPoint place = list->ConvertToScreen(BPoint(60, list->ItemFrame(index).top + 5));
		widgetWindow->Unlock();
		Driver::WaitUntilIdle();
		return place;
	}

	// A point of the view where the mouse reaches the view itself, in its coordinates; the work
	// area is scrolled so that it is in sight. False when there is none.
	bool FindPointOn(BView* view, BPoint* _where)
	{
		bool found = false;
		Locked([&] {
			BView* target = Work()->Target();
			const BPoint leftTop = Root()->ConvertFromScreen(view->ConvertToScreen(BPoint(0, 0)));
			const BPoint origin = Root()->Frame().LeftTop();
			target->ScrollTo(std::max(0.0f, origin.x + leftTop.x - 40),
				std::max(0.0f, origin.y + leftTop.y - 40));
			found = _FindPointOn(view, _where);
		});
		return found;
	}

private:
	using BResourceHandle = BResEditor::BResourceHandle;

	bool _FindPointOn(BView* view, BPoint* _where)
	{
		const BRect sight = Work()->Target()->ConvertToScreen(Work()->Target()->Bounds());
		const BRect bounds = view->Bounds();
		constexpr int32 kSteps = 12;
		for (int32 y = 0; y <= kSteps; y++) {
			for (int32 x = 0; x <= kSteps; x++) {
				// From the middle outwards, as a user would point.
				const float dx = static_cast<float>((x + kSteps / 2) % (kSteps + 1)) / kSteps;
				const float dy = static_cast<float>((y + kSteps / 2) % (kSteps + 1)) / kSteps;
				BPoint screen = view->ConvertToScreen(
					BPoint(bounds.left + dx * bounds.Width(), bounds.top + dy * bounds.Height()));
				screen.Set(std::floor(screen.x), std::floor(screen.y));
				const BWindow* window = view->Window();
				if (!sight.Contains(screen)
					|| window->FindView(window->ConvertFromScreen(screen)) != view)
					continue;
				*_where = view->ConvertFromScreen(screen);
				return true;
			}
		}
		return false;
	}

	TestWindow fWindow;
	BResEditor::BResourceCollection fCollection;
	BResEditor::BResourceAddonArgs fArgs;
	BResEditor::BResourceAddonBase fUser;
	ViewEditor* fEditor = nullptr; // owned
	int32 fLastId = 0;
};
