// The classic look: the one place that knows its colours, bevels and marks.
#pragma once

#include <GraphicsDefs.h>
#include <InterfaceDefs.h>
#include <Rect.h>

class BView;


// Drawing is done with the calling view's own drawing calls, in its coordinates. Every function
// leaves the view's pen size, drawing mode and colours as it found them. `base` is the colour
// that the part stands on, usually the view's view colour.
namespace BPrivate::Look {

enum State : uint32 {
	kNormal = 0,
	kDisabled = 1 << 0,
	kPressed = 1 << 1,
	kFocused = 1 << 2,
	kDefault = 1 << 3,
	kOn = 1 << 4, // checked, selected
	kPartlyOn = 1 << 5,
};

enum class Direction { kLeft, kRight, kUp, kDown };

// The corners of the stroked frame of a push button, a text line, ...
constexpr float kDefaultButtonInset = 3; // what MakeDefault() adds on every side
constexpr float kCheckBoxSize = 13; // pixels
constexpr float kPopUpMarkWidth = 13;

rgb_color PanelColor(); // 216 grey
rgb_color TextColor(uint32 state = kNormal);
rgb_color NavigationColor();
rgb_color MarkColor();
rgb_color DocumentColor();
rgb_color MenuColor();
rgb_color MenuSelectionColor();
rgb_color ListSelectionColor(rgb_color listColor);
rgb_color StatusBarColor();

// The colour that a view takes when it is attached: its parent's view colour, or the panel colour
// where there is none or where it is transparent.
rgb_color ColorOfParent(const BView* view);

// What the part stands on: the view's colour, or what shows through a transparent one.
rgb_color BaseColor(const BView* view);

bool IsTransparent(rgb_color color);

// One ring of lines along the edges of the rectangle. The right and bottom lines own the corners
// where they meet the left and top ones.
void DrawRing(BView* view, BRect frame, rgb_color leftTop, rgb_color rightBottom);

// Dark line outside left and top, light line inside: the frame of a group. The top line is broken
// where the gap is; an invalid gap breaks nothing.
void DrawGroove(BView* view, BRect frame, rgb_color base, BRect gap = BRect());
// A single raised frame line.
void DrawPlainFrame(BView* view, BRect frame, rgb_color base, BRect gap = BRect());
// A line pair, horizontal or vertical along the longer side of the rectangle.
void DrawSeparator(BView* view, BRect frame, rgb_color base);
// One button-like raised surface with its fill; pressed it is sunken.
void DrawRaised(BView* view, BRect frame, rgb_color base, uint32 state = kNormal);

// The whole push button without its label.
void DrawButton(BView* view, BRect frame, rgb_color base, uint32 state);
// Box and mark of a check box, kCheckBoxSize pixels in both directions from the place.
void DrawCheckBox(BView* view, BPoint leftTop, rgb_color base, uint32 state);
void DrawRadioButton(BView* view, BPoint leftTop, rgb_color base, uint32 state);

// The underline of a focused label; y is the text's baseline.
void DrawFocusLine(BView* view, float left, float right, float baseline);

// The two-pixel frame round a text field, a list or another document; `frame` is its outside.
void DrawFieldFrame(BView* view, BRect frame, rgb_color base, uint32 state = kNormal);

// A sunken bar with its border of two pixels, filled up to the column `filled`, that included; a
// column left of the bar's inside fills nothing.
void DrawProgressBar(BView* view, BRect frame, rgb_color base, rgb_color barColor, float filled);

// The channel of a slider, one part of it, in the given colour.
void DrawSliderBar(BView* view, BRect frame, rgb_color base, rgb_color barColor, uint32 state);
// The inside of a part of the bar in another colour; `part` is cut out of the bar's frame.
void DrawSliderFill(BView* view, BRect part, rgb_color base, rgb_color fillColor, uint32 state);
void DrawSliderBlockThumb(
	BView* view, BRect frame, orientation direction, rgb_color base, uint32 state);
// Points up or left.
void DrawSliderTriangleThumb(
	BView* view, BRect frame, orientation direction, rgb_color base, uint32 state);
// One mark of a scale: a dark and a light line side by side.
void DrawHashMark(BView* view, BPoint from, BPoint to, rgb_color base, uint32 state);

// Where a ramp of colours stands: a ring across the ramp at the column x, to be seen on any colour.
void DrawColorMarker(BView* view, BRect ramp, float x, uint32 state);

// The tab of a page: a raised tongue that is open at the bottom when it is in front.
void DrawTab(BView* view, BRect frame, rgb_color base, uint32 state);
// The raised body of a tab view, open below the selected tab.
void DrawTabBody(BView* view, BRect frame, BRect selectedTab, rgb_color base);

// A filled triangle centred in the rectangle.
void DrawArrow(BView* view, BRect frame, Direction direction, rgb_color color);
// The triangle before an item of an outline.
void DrawLatch(BView* view, BRect frame, bool expanded, bool pressed = false);

// Scroll bars. The frame of the whole bar is one pixel wide; parts lie inside it.
void DrawScrollBarFrame(BView* view, BRect frame, rgb_color base, uint32 state);
void DrawScrollBarButton(
	BView* view, BRect frame, Direction direction, rgb_color base, uint32 state);
void DrawScrollBarArea(
	BView* view, BRect frame, orientation direction, rgb_color base, uint32 state);
void DrawScrollBarThumb(
	BView* view, BRect frame, orientation direction, rgb_color base, uint32 state);

// The handle of a dragger, kDragHandleSize pixels in both directions up to the corner, that included.
constexpr float kDragHandleSize = 8;
void DrawDragHandle(BView* view, BPoint rightBottom, rgb_color base);

// Menus.
void DrawMenuFrame(BView* view, BRect frame, rgb_color base); // a menu's own window
void DrawMenuBarFrame(BView* view, BRect frame, rgb_color base);
void DrawMenuItemBackground(BView* view, BRect frame, rgb_color base, uint32 state);
void DrawMenuCheckMark(BView* view, BRect frame, uint32 state);
void DrawSubmenuMark(BView* view, BRect frame, uint32 state);
// The raised field of a menu field, with the pop-up mark at its right when there is one.
void DrawMenuField(BView* view, BRect frame, rgb_color base, bool popUpMark, uint32 state);

} // namespace BPrivate::Look
