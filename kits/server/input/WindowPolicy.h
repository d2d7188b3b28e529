// WindowPolicy: which window is active, which presses it takes, what stays above what.
#pragma once

#include <atomic>

#include "server/WindowRecord.h"

namespace BPrivate {

class DesktopThread;


// Display thread only, but for ActiveId().
class WindowPolicy {
public:
	explicit WindowPolicy(DesktopThread& desktop);

	uint32 ActiveId() const { return fActiveId; } // any thread
	const WindowReference& Active() const { return fActive; }
	// The desktop has given the keyboard to this window; NULL: to none of ours.
	void Activated(const WindowReference& window);

	// Applies the first-click rules and modality: may activate or raise the window, or the modal
	// one that blocks it. False: the press is thrown away.
	bool AcceptsPress(const WindowReference& window);

	// The modal window that keeps input from this one, or NULL.
	WindowReference BlockerOf(const WindowReference& window) const;
	// Floating windows go with the others of their program: they are off the screen while another
	// program is active, one with a subset also while none of that was active last. Where there are
	// no others they stay, as nothing else could bring them back.
	bool MayBeSeen(const WindowRecord& window) const;
	BackendWindow* OwnerOf(const WindowReference& window) const;
	WindowReference LastMenu() const; // the shown menu window that was opened last

	void WindowHidden(const WindowReference& window);
	void WindowGone(const WindowReference& window);

private:
	bool _Concerns(const WindowRecord& modal, const WindowRecord& window) const;
	void _UpdateBackground();
	bool _ShowsNormalWindow() const;

	DesktopThread& fDesktop;
	WindowReference fActive;
	WindowReference fLastNormal; // the normal window that was active last
	std::atomic<uint32> fActiveId { 0 };
	bool fInBackground = false; // another program has been active for a while
};


} // namespace BPrivate
