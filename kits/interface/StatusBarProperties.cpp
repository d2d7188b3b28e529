// BStatusBar: its values and texts.
#include <StatusBar.h>

#include <algorithm>
#include <cmath>

#include <AppDefs.h>
#include <Message.h>

#include "interface/private/ControlArchive.h"
#include "interface/private/Label.h"
#include "interface/private/Look.h"
#include "interface/private/ViewArchive.h"


void
BStatusBar::SetBarColor(rgb_color color)
{
	fBarColor = color;
	fCustomBarColor = true;
	Invalidate(_BarFrame());
}


void
BStatusBar::SetBarHeight(float height)
{
	const float growth = height - fBarHeight;
	fBarHeight = height;
	fCustomBarHeight = true;
	if (growth != 0) {
		ResizeTo(Bounds().Width(), _TextHeight() + fBarHeight);
		Invalidate();
	}
}


void
BStatusBar::SetText(const char* text)
{
	_SetText(fText, text);
}


void
BStatusBar::SetTrailingText(const char* text)
{
	_SetText(fTrailingText, text);
}


void
BStatusBar::SetMaxValue(float max)
{
	_SetValue(fCurrent, max);
}


void
BStatusBar::Update(float delta, const char* text, const char* trailingText)
{
	SetTo(fCurrent + delta, text, trailingText);
}


void
BStatusBar::SetTo(float value, const char* text, const char* trailingText)
{
	if (text != NULL)
		_SetText(fText, text);
	if (trailingText != NULL)
		_SetText(fTrailingText, trailingText);
	_SetValue(std::clamp(value, 0.0f, std::max(fMax, 0.0f)), fMax);
}


void
BStatusBar::_SetText(std::string& text, const char* newText)
{
	if (newText == NULL)
		newText = "";
	if (text == newText)
		return;
	text = newText;
	const BRect bounds = Bounds();
	Invalidate(BRect(bounds.left, bounds.top, bounds.right, _TextHeight() - 1));
}


// Only the columns between the old and the new end of the filled part are drawn anew.
void
BStatusBar::_SetValue(float value, float max)
{
	const float before = _FillRight(fCurrent);
	fCurrent = value;
	fMax = max;
	const float after = _FillRight(fCurrent);
	if (before == after)
		return;
	BRect changed = _BarFrame();
	changed.left = std::min(before, after) - 1;
	changed.right = std::max(before, after);
	Invalidate(changed);
}


float
BStatusBar::CurrentValue() const
{
	return fCurrent;
}


float
BStatusBar::MaxValue() const
{
	return fMax;
}


rgb_color
BStatusBar::BarColor() const
{
	return fBarColor;
}


float
BStatusBar::BarHeight() const
{
	return fBarHeight;
}


const char*
BStatusBar::Text() const
{
	return fText.c_str();
}


const char*
BStatusBar::TrailingText() const
{
	return fTrailingText.c_str();
}


const char*
BStatusBar::Label() const
{
	return fLabel.c_str();
}


const char*
BStatusBar::TrailingLabel() const
{
	return fTrailingLabel.c_str();
}


// #pragma mark - scripting


BHandler*
BStatusBar::ResolveSpecifier(
	BMessage* message, int32 index, BMessage* specifier, int32 what, const char* property)
{
	return BView::ResolveSpecifier(message, index, specifier, what, property);
}


status_t
BStatusBar::GetSupportedSuites(BMessage* message)
{
	return BView::GetSupportedSuites(message);
}


status_t
BStatusBar::Perform(perform_code code, void* data)
{
	return BView::Perform(code, data);
}
