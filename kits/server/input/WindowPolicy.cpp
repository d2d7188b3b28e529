#include "server/input/WindowPolicy.h"

#include <algorithm>

#include <AppDefs.h>

#include "server/DesktopThread.h"

namespace BPrivate {

namespace {

constexpr uint32 kAcceptsFirstClick = 0x10, kAvoidFocus = 0x2000, kAvoidFront = 0x80;
constexpr uint32 kModalSubsetFeel = 2;
constexpr bigtime_t kPassing = 300000; // that long no window of ours may be active on the way


std::unique_ptr<BMessage>
ActivationMessage(bool active)
{
	auto message = std::make_unique<BMessage>(B_WINDOW_ACTIVATED);
	message->AddInt64("when", system_time());
	message->AddBool("active", active);
	return message;
}


bool
IsInSubset(const WindowRecord& owned, const WindowRecord& main)
{
	return std::find(owned.subset.begin(), owned.subset.end(), main.Id()) != owned.subset.end();
}

} // namespace


WindowPolicy::WindowPolicy(DesktopThread& desktop) : fDesktop(desktop)
{
}


void
WindowPolicy::Activated(const WindowReference& window)
{
	if (window != nullptr) {
		fDesktop.Settle(window->Id(), BackendEvent::Type::WindowActivated);
		fDesktop.Settle(DesktopThread::kAnyWindow, BackendEvent::Type::WindowActivated);
	}
	if (window == fActive)
		return;

	const WindowReference before = fActive;
	fActive = window;
	fActiveId = window != nullptr ? window->Id() : 0;
	if (before != nullptr) {
		before->active = false;
		before->Deliver(ActivationMessage(false));
	}
	if (window != nullptr) {
		for (const WindowReference& other : fDesktop.Windows())
			other->inFront = other == window;
		window->active = true;
		window->Deliver(ActivationMessage(true));
		if (!window->IsModal() && !window->IsFloating()) {
			fLastNormal = window;
			fDesktop.UpdateOwners();
		}
	}
	if ((before == nullptr) != (window == nullptr))
		fDesktop.PostToApplication(ActivationMessage(window != nullptr));
	// Desktops take the keyboard from one window before they give it to the next.
	if (window != nullptr || fDesktop.GetBackend().IsImmediate())
		_UpdateBackground();
	else
		fDesktop.GetBackend().PostLater(kPassing, [this] { _UpdateBackground(); });

	const WindowReference blocker = BlockerOf(window);
	if (blocker != nullptr)
		fDesktop.Activate(blocker);
}


bool
WindowPolicy::AcceptsPress(const WindowReference& window)
{
	if (window->IsMenu())
		return true;
	if (const WindowReference blocker = BlockerOf(window)) {
		fDesktop.Activate(blocker);
		return false;
	}
	if (window == fActive && !fDesktop.GetBackend().ActivatedByPress(window->native.get()))
		return true;

	const uint32 flags = window->Flags();
	const bool takesFirst = (flags & kAcceptsFirstClick) != 0;
	if ((flags & kAvoidFocus) != 0) {
		if (!takesFirst && (flags & kAvoidFront) == 0)
			window->native->Raise();
		return true;
	}
	if (takesFirst)
		return true;
	fDesktop.Activate(window);
	return false;
}


// #pragma mark - modality


WindowReference
WindowPolicy::BlockerOf(const WindowReference& window) const
{
	if (window == nullptr || window->IsMenu())
		return nullptr;

	WindowReference blocker;
	for (const WindowReference& modal : fDesktop.Windows()) {
		if (modal == window || !modal->nativeShown || !modal->IsModal()
			|| !_Concerns(*modal, *window))
			continue;
		// Of two modal windows the one that was opened last may be used.
		if (window->IsModal() && modal->shownSerial < window->shownSerial)
			continue;
		if (blocker == nullptr || modal->shownSerial > blocker->shownSerial)
			blocker = modal;
	}
	return blocker;
}


bool
WindowPolicy::_Concerns(const WindowRecord& modal, const WindowRecord& window) const
{
	return modal.Feel() != kModalSubsetFeel || IsInSubset(modal, window);
}


void
WindowPolicy::_UpdateBackground()
{
	fInBackground = fActive == nullptr;
	fDesktop.UpdateFloating();
}


bool
WindowPolicy::_ShowsNormalWindow() const
{
	for (const WindowReference& window : fDesktop.Windows()) {
		const WindowTraits::Kind kind = window->Traits().kind;
		if (window->nativeShown && kind != WindowTraits::Kind::Menu
			&& kind != WindowTraits::Kind::Floating)
			return true;
	}
	return false;
}


bool
WindowPolicy::MayBeSeen(const WindowRecord& window) const
{
	if (!window.IsFloating() || window.FloatsOverAll())
		return true;
	if (fInBackground)
		return !_ShowsNormalWindow();
	return !window.HasSubset() || fLastNormal == nullptr || IsInSubset(window, *fLastNormal);
}


BackendWindow*
WindowPolicy::OwnerOf(const WindowReference& window) const
{
	if (!window->IsModal() && !window->IsFloating())
		return nullptr;

	if (window->HasSubset()) {
		for (const uint32 id : window->subset) {
			const WindowReference main = fDesktop.Find(id);
			if (main != nullptr && main->nativeShown)
				return main->native.get();
		}
	}
	// It stays with the one that it was opened for as long as that is there.
	const WindowReference owner = fDesktop.Find(window->owner);
	if (owner != nullptr && owner->nativeShown)
		return owner->native.get();
	window->owner = 0;
	if (fLastNormal == nullptr || !fLastNormal->nativeShown || fLastNormal == window)
		return nullptr;
	window->owner = fLastNormal->Id();
	return fLastNormal->native.get();
}


WindowReference
WindowPolicy::LastMenu() const
{
	WindowReference last;
	for (const WindowReference& window : fDesktop.Windows()) {
		if (window->IsMenu() && window->nativeShown
			&& (last == nullptr || window->shownSerial > last->shownSerial))
			last = window;
	}
	return last;
}


void
WindowPolicy::WindowHidden(const WindowReference& window)
{
	window->inFront = false;
	if (fLastNormal == window) {
		fLastNormal = nullptr;
		fDesktop.UpdateOwners();
	}
	if (fActive == window)
		Activated(nullptr);
	else if (!window->IsFloating())
		fDesktop.UpdateFloating();
}


void
WindowPolicy::WindowGone(const WindowReference& window)
{
	WindowHidden(window);
}


} // namespace BPrivate
