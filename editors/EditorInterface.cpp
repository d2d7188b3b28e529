#include "editors/EditorInterface.h"

#include "archive/ViewTree.h"
#include "editors/TargetLock.h"

namespace {


constexpr float kPanelWidth = 400;
constexpr float kRowInsetX = 6;
constexpr float kRowInsetY = 16;


} // namespace


void
EditorInterface::FrameChanged()
{
}


void
EditorInterface::AllAttached()
{
	BBox::AllAttached();
	// Without this the controls would send to the window.
	::SetTarget(this, this, nullptr);
}


void
EditorInterface::MessageReceived(BMessage* message)
{
	bool applied = false;
	if (TargetLives()) {
		TargetLock lock(target);
		applied = ApplyEdit(message);
	}
	if (!applied)
		BBox::MessageReceived(message);
}


EditorInterface::EditorInterface(const char* name, const char* label, float height) :
	BBox(BRect(0, 0, kPanelWidth, height), name, B_FOLLOW_LEFT_RIGHT | B_FOLLOW_TOP,
		B_WILL_DRAW | B_NAVIGABLE_JUMP | B_FRAME_EVENTS, B_FANCY_BORDER),
	target(nullptr)
{
	SetLabel(label);
}


bool
EditorInterface::TakeTarget(BView* view)
{
	target = view;
	fTargetWatch.Set(view);
	return target != nullptr;
}


bool
EditorInterface::TargetLives() const
{
	return target != nullptr && fTargetWatch.View() == target;
}


bool
EditorInterface::ApplyEdit(BMessage* message)
{
	return false;
}


BRect
EditorInterface::RowArea() const
{
	return Bounds().InsetByCopy(kRowInsetX, kRowInsetY);
}


BRect
EditorInterface::TextBesideMenuFrame() const
{
	const BRect area = RowArea();
	return BRect(area.left, area.top, area.right - 120, area.top + 20);
}


BRect
EditorInterface::MenuBesideTextFrame() const
{
	const BRect area = RowArea();
	return BRect(area.right - 110, area.top - 2, area.right, area.top + 18);
}
