// ToolTips: the short texts that a window shows where the pointer rests.
#pragma once

#include <memory>

#include <MessageRunner.h>
#include <Messenger.h>
#include <Point.h>

class BView;
class BWindow;

namespace BPrivate {

class Worker;


// One per window, for who holds its lock. A view without a text shows that of the nearest view
// above it. Waiting for the pointer to rest counts as work of the window, so that who waits for a
// quiet program waits for the tip as well.
class ToolTips {
public:
	static constexpr uint32 kRested = '_TIP';
	static constexpr bigtime_t kStillTime = 700000; // microseconds

	explicit ToolTips(BWindow& window);
	~ToolTips();
	ToolTips(const ToolTips&) = delete;
	ToolTips& operator=(const ToolTips&) = delete;

	// The pointer has moved to this place in this view, or out of all views (NULL). Without
	// `mayShow` (a button is held, something is dragged) nothing will be shown there.
	void PointerMoved(const BView* view, BPoint screen, bool mayShow);
	// Presses, keys and the wheel take the tip away; it comes again when the pointer moves.
	void Dismiss();
	// Whose text is shown or waited for; it must be forgotten before it is hidden or taken out.
	const BView* View() const { return fView; }
	void Forget();
	void Rested(); // kRested has come

private:
	void _Wait(bigtime_t time);
	void _StopWaiting();
	void _Open(const char* text);
	void _Close();

	BWindow& fWindow;
	const BView* fView = nullptr; // borrowed
	BPoint fWhere; // screen
	bigtime_t fLastMove = 0;
	std::unique_ptr<BMessageRunner> fTimer; // while something is waited for
	BMessenger fTip; // the window that shows it
};


} // namespace BPrivate
