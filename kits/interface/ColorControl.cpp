#include <ColorControl.h>

#include <algorithm>
#include <cmath>
#include <cstdlib>
#include <cstring>
#include <string>

#include <Message.h>
#include <TextControl.h>
#include <TextView.h>
#include <Window.h>

#include "interface/private/ColorControlParts.h"
#include "interface/private/Label.h"
#include "interface/private/Look.h"
#include "interface/private/ViewArchive.h"

using namespace BPrivate;

namespace {

constexpr uint32 kFieldInvoked = 'ccol';
constexpr const char* kFieldNames[] = { "_red", "_green", "_blue" };
constexpr const char* kFieldLabels[] = { "Red:", "Green:", "Blue:" };

color_control_layout
ReadLayout(const BMessage* archive)
{
	int32 layout = 0;
	return archive->FindInt32("_layout", &layout) == B_OK ? CheckedLayout(layout) : B_CELLS_4x64;
}


float
ReadCellSize(const BMessage* archive)
{
	float size = 0;
	if (archive->FindFloat("_csize", &size) != B_OK || !(size >= kMinimumCellSize))
		return kMinimumCellSize;
	return size;
}


int32
ValueOf(rgb_color color)
{
	return static_cast<int32>(static_cast<uint32>(color.red) << 24
		| static_cast<uint32>(color.green) << 16 | static_cast<uint32>(color.blue) << 8);
}

} // namespace


BColorControl::BColorControl(BPoint leftTop, color_control_layout layout, float cellSize,
	const char* name, BMessage* message, bool useOffscreen) :
	BControl(BRect(leftTop, leftTop), name, NULL, message, B_FOLLOW_LEFT | B_FOLLOW_TOP,
		B_WILL_DRAW | B_NAVIGABLE),
	fLayout(CheckedLayout(layout)), fCellSize(std::max(cellSize, kMinimumCellSize)),
	fUseOffscreen(useOffscreen), fTrackedRamp(-1), fFocusedRamp(kGreyRamp)
{
	_CreateFields();
	ResizeToPreferred();
}


BColorControl::BColorControl(BMessage* archive) :
	BControl(archive), fLayout(ReadLayout(archive)), fCellSize(ReadCellSize(archive)),
	fUseOffscreen(false), fTrackedRamp(-1), fFocusedRamp(kGreyRamp)
{
	bool useOffscreen;
	if (archive->FindBool("_use_off", &useOffscreen) == B_OK)
		fUseOffscreen = useOffscreen;
	_CreateFields();
}


BColorControl::~BColorControl()
{
}


BArchivable*
BColorControl::Instantiate(BMessage* archive)
{
	return validate_instantiation(archive, "BColorControl") ? new BColorControl(archive) : NULL;
}


status_t
BColorControl::Archive(BMessage* archive, bool deep) const
{
	const status_t status = BControl::Archive(archive, deep);
	if (status != B_OK)
		return status;

	BPrivate::ArchiveWriter writer(archive);
	if (!writer.Keep("_layout", ReadLayout(&writer.Source()) == fLayout))
		archive->AddInt32("_layout", fLayout);
	if (!writer.Keep("_csize", ReadCellSize(&writer.Source()) == fCellSize))
		archive->AddFloat("_csize", fCellSize);
	writer.Bool("_use_off", fUseOffscreen, false);
	return writer.Status();
}


// #pragma mark - text fields


// Those that an archive does not have.
void
BColorControl::_CreateFields()
{
	bool created = false;
	for (int32 i = 0; i < 3; i++) {
		if (_Field(i) != NULL)
			continue;
		AddChild(_CreateField(i));
		created = true;
	}
	if (created) {
		_PlaceFields();
		_WriteFields();
	}
}


// A field is a view like others: it may be taken out, and another one put in its place.
BTextControl*
BColorControl::_Field(int32 component) const
{
	for (BView* child = ChildAt(0); child != NULL; child = child->NextSibling()) {
		BTextControl* field = dynamic_cast<BTextControl*>(child);
		if (field != NULL && field->Name() != NULL
			&& strcmp(field->Name(), kFieldNames[component]) == 0)
			return field;
	}
	return NULL;
}


BTextControl*
BColorControl::_CreateField(int32 component)
{
	float labelWidth = 0;
	for (const char* label : kFieldLabels)
		labelWidth = std::max(labelWidth, label_width(this, label));
	const float divider = labelWidth + kFieldGap;
	const BRect frame(0, 0, divider + label_width(this, "999999"), kFieldHeight);

	BTextControl* field = new BTextControl(
		frame, kFieldNames[component], kFieldLabels[component], "0", new BMessage(kFieldInvoked));
	field->SetDivider(divider);
	field->SetAlignment(B_ALIGN_LEFT, B_ALIGN_RIGHT);
	field->SetEnabled(IsEnabled());
	for (uint32 character = 0; character < 256; character++) {
		if (character < '0' || character > '9')
			field->TextView()->DisallowChar(character);
	}
	field->TextView()->SetMaxBytes(3);
	return field;
}


// In a column at the right of the palette; beside the colour ramps where those are higher.
void
BColorControl::_PlaceFields()
{
	BRect palette = _PaletteFrame();
	palette.InsetBy(-kBevel, -kBevel);
	const float left = palette.right + kFieldGap;
	const float ramp = _RampFrame(1).Height() + 1;

	float top = 0;
	float step = std::max(kFieldHeight + 1, std::ceil(palette.Height() / 3));
	if (ramp > kFieldHeight + 1) {
		step = ramp;
		top = std::floor(_RampFrame(1).top + (ramp - kFieldHeight) / 2);
	}
	for (int32 i = 0; i < 3; i++) {
		if (BTextControl* field = _Field(i)) {
			field->MoveTo(left, top);
			field->ResizeTo(field->Bounds().Width(), kFieldHeight);
		}
		top += step;
	}
}


void
BColorControl::_WriteFields()
{
	for (int32 i = 0; i < 3; i++) {
		const std::string amount = std::to_string(ComponentOf(Value(), i));
		BTextControl* field = _Field(i);
		if (field != NULL && field->Text() != amount)
			field->SetText(amount.c_str());
	}
}


// What the user typed becomes the colour, with one invocation.
void
BColorControl::_TakeFields()
{
	int32 value = Value();
	for (int32 i = 0; i < 3; i++) {
		if (const BTextControl* field = _Field(i))
			value = WithComponent(value, i, std::clamp(atoi(field->Text()), 0, 255));
	}
	SetValue(value);
	// A number above 255 leaves the colour at 255 but must not stay to be seen.
	_WriteFields();
	Invoke();
}


// #pragma mark - value


void
BColorControl::SetValue(int32 colorValue)
{
	// The lowest byte means nothing.
	colorValue &= ~0xff;
	if (colorValue == Value()) {
		_WriteFields(); // where the same was typed in another way
		return;
	}
	SetValueNoUpdate(colorValue);
	_WriteFields();
	Invalidate(_PaletteFrame());
}


void
BColorControl::SetValue(rgb_color color)
{
	SetValue(ValueOf(color));
}


rgb_color
BColorControl::ValueAsColor()
{
	const int32 value = Value();
	return { static_cast<uint8>(ComponentOf(value, 0)), static_cast<uint8>(ComponentOf(value, 1)),
		static_cast<uint8>(ComponentOf(value, 2)), 255 };
}


void
BColorControl::SetEnabled(bool enabled)
{
	BControl::SetEnabled(enabled);
	for (int32 i = 0; i < 3; i++) {
		if (BTextControl* field = _Field(i))
			field->SetEnabled(enabled);
	}
}


// What the ramp's marker shows; -1 for the grey ramp when the colour is no grey.
int32
BColorControl::_RampValue(int32 ramp) const
{
	if (ramp != kGreyRamp)
		return ComponentOf(Value(), ramp - 1);
	const int32 red = ComponentOf(Value(), 0);
	const bool isGrey = red == ComponentOf(Value(), 1) && red == ComponentOf(Value(), 2);
	return isGrey ? red : -1;
}


// A change by the user; the grey ramp sets all three components.
void
BColorControl::_ChangeRamp(int32 ramp, int32 amount)
{
	amount = std::clamp<int32>(amount, 0, 255);
	int32 value = Value();
	for (int32 i = 0; i < 3; i++) {
		if (ramp == kGreyRamp || ramp == i + 1)
			value = WithComponent(value, i, amount);
	}
	SetValue(value);
	Invoke();
}


// #pragma mark - hooks


void
BColorControl::MessageReceived(BMessage* message)
{
	if (message->what == kFieldInvoked)
		_TakeFields();
	else if (!message->WasDropped() || !_TakeDroppedColor(message))
		BControl::MessageReceived(message);
}


// Any field of a dropped message that holds a colour will do.
bool
BColorControl::_TakeDroppedColor(BMessage* message)
{
	char* name;
	type_code type;
	int32 count;
	const void* data;
	ssize_t size;
	if (!IsEnabled() || message->GetInfo(B_RGB_COLOR_TYPE, 0, &name, &type, &count) != B_OK
		|| message->FindData(name, B_RGB_COLOR_TYPE, &data, &size) != B_OK
		|| size != static_cast<ssize_t>(sizeof(rgb_color))) {
		return false;
	}
	SetValue(*static_cast<const rgb_color*>(data));
	Invoke(message);
	return true;
}


void
BColorControl::AttachedToWindow()
{
	BControl::AttachedToWindow();
	for (int32 i = 0; i < 3; i++) {
		if (BTextControl* field = _Field(i))
			field->SetTarget(this);
	}
}


void
BColorControl::DetachedFromWindow()
{
	fTrackedRamp = -1;
	BControl::DetachedFromWindow();
}


void
BColorControl::AllAttached()
{
	// The fields have taken the height that a text control has by itself.
	if (!BPrivate::is_revived(this)) {
		_PlaceFields();
		ResizeToPreferred();
	}
	BControl::AllAttached();
}


void
BColorControl::AllDetached()
{
	BControl::AllDetached();
}


void
BColorControl::FrameMoved(BPoint newPosition)
{
	BControl::FrameMoved(newPosition);
}


void
BColorControl::FrameResized(float newWidth, float newHeight)
{
	BControl::FrameResized(newWidth, newHeight);
}


void
BColorControl::WindowActivated(bool active)
{
	BControl::WindowActivated(active);
}


void
BColorControl::MakeFocus(bool focused)
{
	BControl::MakeFocus(focused);
}


status_t
BColorControl::Invoke(BMessage* message)
{
	return BControl::Invoke(message);
}


BHandler*
BColorControl::ResolveSpecifier(
	BMessage* message, int32 index, BMessage* specifier, int32 what, const char* property)
{
	return BControl::ResolveSpecifier(message, index, specifier, what, property);
}


status_t
BColorControl::GetSupportedSuites(BMessage* message)
{
	return BControl::GetSupportedSuites(message);
}


status_t
BColorControl::Perform(perform_code code, void* data)
{
	return BControl::Perform(code, data);
}
