// Which hook a message of a window or of a view reaches.
#include <Window.h>

#include <cstring>

#include <AppDefs.h>
#include <Message.h>
#include <ScrollBar.h>

#include "interface/private/WindowInternals.h"

using namespace BPrivate;


void
BWindow::DispatchMessage(BMessage* message, BHandler* handler)
{
	if (BView* view = dynamic_cast<BView*>(handler)) {
		_DispatchToView(message, view);
		return;
	}
	if (handler != this) {
		BLooper::DispatchMessage(message, handler);
		return;
	}

	WindowInternals& internals = *fInternals;
	switch (message->what) {
		case _UPDATE_:
			internals.Update();
			break;

		case B_WINDOW_RESIZED: {
			internals.FollowServerSize();
			const BRect bounds = Bounds();
			FrameResized(message->GetInt32("width", bounds.IntegerWidth()),
				message->GetInt32("height", bounds.IntegerHeight()));
			break;
		}

		case B_WINDOW_MOVED:
			FrameMoved(message->GetPoint("where", Frame().LeftTop()));
			break;

		case B_WINDOW_ACTIVATED:
			internals.CallWindowActivated(message->FindBool("active"));
			break;

		case B_KEY_DOWN:
			if (!internals.HandleKeyDown(message)) {
				const char* bytes = message->GetString("bytes", "");
				if (bytes[0] == B_TAB)
					internals.Navigate(
						nullptr, (message->FindInt32("modifiers") & B_SHIFT_KEY) != 0, false);
				else
					MessageReceived(message);
			}
			break;

		case B_PULSE:
			internals.Pulse();
			break;

		case B_MINIMIZE:
			Minimize(message->GetBool("minimize", true));
			break;

		case B_ZOOM:
			Zoom();
			break;

		case B_SCREEN_CHANGED:
			internals.UpdateNeeded();
			ScreenChanged(message->FindRect("frame"),
				static_cast<color_space>(message->GetInt32("mode", B_RGBA32)));
			break;

		case B_WORKSPACE_ACTIVATED:
			WorkspaceActivated(message->FindInt32("workspace"), message->FindBool("active"));
			break;

		case B_WORKSPACES_CHANGED:
			WorkspacesChanged(message->FindInt32("old"), message->FindInt32("new"));
			break;

		case _QUIT_:
			_DeleteViews();
			BLooper::DispatchMessage(message, handler);
			break;

		default:
			BLooper::DispatchMessage(message, handler);
			break;
	}
}


void
BWindow::_DispatchToView(BMessage* message, BView* view)
{
	// A drop may carry any code, also one of these.
	if (message->WasDropped()) {
		view->MessageReceived(message);
		return;
	}
	switch (message->what) {
		case B_MOUSE_DOWN:
			view->MouseDown(message->FindPoint("where"));
			break;

		case B_MOUSE_UP:
			view->MouseUp(message->FindPoint("where"));
			break;

		case B_MOUSE_MOVED: {
			BMessage dragged;
			const bool drags = message->FindMessage("be:drag_message", &dragged) == B_OK;
			view->MouseMoved(message->FindPoint(kViewWhere),
				static_cast<uint32>(message->GetInt32(kTransit, B_INSIDE_VIEW)),
				drags ? &dragged : nullptr);
			break;
		}

		case B_KEY_DOWN:
			if (!fInternals->HandleKeyDown(message)) {
				const char* bytes = message->GetString("bytes", "");
				view->KeyDown(bytes, static_cast<int32>(strlen(bytes)));
			}
			break;

		case B_KEY_UP: {
			const char* bytes = message->GetString("bytes", "");
			view->KeyUp(bytes, static_cast<int32>(strlen(bytes)));
			break;
		}

		case B_VIEW_MOVED:
			view->FrameMoved(message->FindPoint("where"));
			break;

		case B_VIEW_RESIZED:
			view->FrameResized(message->FindInt32("width"), message->FindInt32("height"));
			break;

		case B_VALUE_CHANGED:
			if (BScrollBar* bar = dynamic_cast<BScrollBar*>(view))
				bar->ValueChanged(message->FindInt32("value"));
			else
				BLooper::DispatchMessage(message, view);
			break;

		default:
			BLooper::DispatchMessage(message, view);
			break;
	}
}
