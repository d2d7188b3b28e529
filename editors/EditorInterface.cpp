#include "editors/EditorInterface.h"

#include <String.h>

#include "archive/ViewTree.h"

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


EditorInterface::EditorInterface(const char* name, const char* platformClass, float height) :
	BBox(BRect(0, 0, kPanelWidth, height), name, B_FOLLOW_LEFT_RIGHT | B_FOLLOW_TOP,
		B_WILL_DRAW | B_NAVIGABLE_JUMP | B_FRAME_EVENTS, B_FANCY_BORDER),
	target(nullptr)
{
	BString label("Properties from ");
	label << platformClass;
	SetLabel(label.String());
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


BRect
EditorInterface::RowArea() const
{
	return Bounds().InsetByCopy(kRowInsetX, kRowInsetY);
}
