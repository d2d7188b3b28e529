#include "editors/EditorInterface.h"

#include <Looper.h>
#include <Message.h>
#include <TextControl.h>

#include "archive/TypedText.h"
#include "archive/ViewTree.h"
#include "editors/LiveColorControl.h"
#include "editors/PanelRows.h"
#include "editors/TargetLock.h"

namespace {


constexpr float kPanelWidth = 400;
constexpr float kRowInsetX = 6;
constexpr float kRowInsetY = 16;

constexpr const char* kTypedTextSent = "typed text sent";


// Whether the message comes from another control than the one in which something is being typed. A
// colour control sends while it is dragged, and what it sends replaces no typed text.
bool
PassesBy(const BTextControl* field, const BMessage* message)
{
	const void* source;
	return message->FindPointer("source", const_cast<void**>(&source)) == B_OK && source != field
		&& message->what != kLiveColorChanged && message->what != kColorComponentTyped;
}


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
	if (_WaitsForTypedText(message))
		return;

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


void
EditorInterface::AddOnlySentence(const char* text)
{
	const BRect area = RowArea();
	AddSentence(this, FrameAt(area.left, area.top, area.Width(), kRowHeight), text);
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


// An edit may load the fields anew, or replace the view. So what is being typed in one of them is
// sent first, and the message comes again behind that.
bool
EditorInterface::_WaitsForTypedText(const BMessage* message)
{
	BTextControl* field = FieldInUse(Window());
	if (field == nullptr || dynamic_cast<EditorInterface*>(field->Target()) == nullptr
		|| !PassesBy(field, message) || message->HasBool(kTypedTextSent))
		return false;

	SendTypedText(field);
	BMessage again(*message);
	again.AddBool(kTypedTextSent, true);
	return Looper()->PostMessage(&again, this) == B_OK;
}
