#include "interface/private/ToolTips.h"

#include <algorithm>
#include <cmath>
#include <string>
#include <string_view>
#include <vector>

#include <AppDefs.h>
#include <Font.h>
#include <Message.h>
#include <Screen.h>
#include <View.h>
#include <Window.h>

#include "app/private/LooperPrivate.h"
#include "kernel/private/Activity.h"
#include "server/ServerWindow.h"

namespace BPrivate {

namespace {

constexpr float kMargin = 4; // pixels round the text
constexpr float kBelowPointer = 20; // far enough for the pointer's own picture
constexpr float kAbovePointer = 4;


std::vector<std::string_view>
LinesOf(std::string_view text)
{
	std::vector<std::string_view> lines;
	for (;;) {
		const size_t end = text.find('\n');
		lines.push_back(text.substr(0, end));
		if (end == std::string_view::npos)
			return lines;
		text.remove_prefix(end + 1);
	}
}


float
WidthOf(std::string_view line)
{
	return be_plain_font->StringWidth(line.data(), static_cast<int32>(line.size()));
}


class TipView : public BView {
public:
	explicit TipView(const char* text) :
		BView(BRect(), "tip", B_FOLLOW_ALL, B_WILL_DRAW), fText(text), fLines(LinesOf(fText))
	{
		font_height height;
		be_plain_font->GetHeight(&height);
		fAscent = std::ceil(height.ascent);
		fLineHeight = fAscent + std::ceil(height.descent) + std::ceil(height.leading);
		SetViewColor(ui_color(B_TOOL_TIP_BACKGROUND_COLOR));
		SetLowColor(ViewColor());
		SetHighColor(ui_color(B_TOOL_TIP_TEXT_COLOR));
		TipView::ResizeToPreferred();
	}

	void GetPreferredSize(float* _width, float* _height) override
	{
		float width = 0;
		for (const std::string_view line : fLines)
			width = std::max(width, std::ceil(WidthOf(line)));
		*_width = width + 2 * kMargin - 1;
		*_height = fLineHeight * fLines.size() + 2 * kMargin - 1;
	}

	void Draw(BRect) override
	{
		StrokeRect(Bounds());
		float baseline = kMargin + fAscent;
		for (const std::string_view line : fLines) {
			DrawString(line.data(), static_cast<int32>(line.size()), BPoint(kMargin, baseline));
			baseline += fLineHeight;
		}
	}

private:
	const std::string fText;
	const std::vector<std::string_view> fLines;
	float fAscent, fLineHeight;
};


// Below the pointer, or above where there is no room, and whole on the screen.
BPoint
PlaceFor(BPoint pointer, BRect size)
{
	const BRect screen = BScreen().Frame();
	BPoint place(pointer.x, pointer.y + kBelowPointer);
	if (place.y + size.Height() > screen.bottom)
		place.y = pointer.y - kAbovePointer - size.Height();
	place.x = std::max(screen.left, std::min(place.x, screen.right - size.Width()));
	place.y = std::max(screen.top, place.y);
	return place;
}


BWindow*
MakeTipWindow(const char* text, BPoint pointer)
{
	auto view = new TipView(text);
	const BRect size = view->Bounds();
	auto window = new BWindow(size.OffsetToCopy(PlaceFor(pointer, size)), "tool tip",
		B_NO_BORDER_WINDOW_LOOK, static_cast<window_feel>(kTipWindowFeel),
		B_NOT_MOVABLE | B_NOT_RESIZABLE | B_NOT_CLOSABLE | B_AVOID_FOCUS
			| B_WILL_ACCEPT_FIRST_CLICK);
	window->AddChild(view);
	return window;
}

} // namespace


ToolTips::ToolTips(BWindow& window) : fWindow(window)
{
}


ToolTips::~ToolTips()
{
	Dismiss();
}


void
ToolTips::PointerMoved(const BView* view, BPoint screen, bool mayShow)
{
	while (view != nullptr && view->ToolTip() == nullptr)
		view = view->Parent();
	if (view == nullptr && fView == nullptr)
		return;
	if (view == fView && screen == fWhere)
		return;

	_Close();
	fView = view;
	fWhere = screen;
	fLastMove = system_time();
	if (view == nullptr || !mayShow)
		_StopWaiting();
	else if (fTimer == nullptr)
		_Wait(kStillTime);
}


void
ToolTips::Dismiss()
{
	_StopWaiting();
	_Close();
}


void
ToolTips::Forget()
{
	Dismiss();
	fView = nullptr;
}


// The timer runs on while the pointer moves; what is left of the time is waited for again.
void
ToolTips::Rested()
{
	if (fTimer == nullptr)
		return;
	_StopWaiting();
	const bigtime_t left = fLastMove + kStillTime - system_time();
	if (left > 0)
		_Wait(left);
	else if (fView != nullptr && fView->ToolTip() != nullptr)
		_Open(fView->ToolTip());
}


void
ToolTips::_Wait(bigtime_t time)
{
	const BMessage rested(kRested);
	fTimer = std::make_unique<BMessageRunner>(BMessenger(&fWindow), &rested, time, 1);
	LooperPrivate(&fWindow).Activity().AddWork();
}


void
ToolTips::_StopWaiting()
{
	if (fTimer == nullptr)
		return;
	fTimer.reset();
	LooperPrivate(&fWindow).Activity().WorkDone();
}


void
ToolTips::_Open(const char* text)
{
	BWindow* tip = MakeTipWindow(text, fWhere);
	fTip = BMessenger(tip);
	tip->Show();
}


void
ToolTips::_Close()
{
	fTip.SendMessage(B_QUIT_REQUESTED);
	fTip = BMessenger();
}


} // namespace BPrivate
