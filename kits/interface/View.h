// BView: a rectangle of a window that draws, gets input and holds other views.
#pragma once

#include <BeBuild.h>
#include <Font.h>
#include <Handler.h>
#include <InterfaceDefs.h>
#include <Rect.h>

enum {
	B_PRIMARY_MOUSE_BUTTON = 0x01,
	B_SECONDARY_MOUSE_BUTTON = 0x02,
	B_TERTIARY_MOUSE_BUTTON = 0x04,
	B_MAX_MOUSE_BUTTONS = 16
};

enum { B_ENTERED_VIEW = 0, B_INSIDE_VIEW, B_EXITED_VIEW, B_OUTSIDE_VIEW };

enum { B_POINTER_EVENTS = 0x00000001, B_KEYBOARD_EVENTS = 0x00000002 };

enum {
	B_LOCK_WINDOW_FOCUS = 0x00000001,
	B_SUSPEND_VIEW_FOCUS = 0x00000002,
	B_NO_POINTER_HISTORY = 0x00000004,
	B_FULL_POINTER_HISTORY = 0x00000008
};

enum { B_TRACK_WHOLE_RECT, B_TRACK_RECT_CORNER };

enum {
	B_FONT_FAMILY_AND_STYLE = 0x00000001,
	B_FONT_SIZE = 0x00000002,
	B_FONT_SHEAR = 0x00000004,
	B_FONT_ROTATION = 0x00000008,
	B_FONT_SPACING = 0x00000010,
	B_FONT_ENCODING = 0x00000020,
	B_FONT_FACE = 0x00000040,
	B_FONT_FLAGS = 0x00000080,
	B_FONT_FALSE_BOLD_WIDTH = 0x00000100,
	B_FONT_ALL = 0x000001ff
};

const uint32 B_FULL_UPDATE_ON_RESIZE = 0x80000000UL;
const uint32 _B_RESERVED1_ = 0x40000000UL;
const uint32 B_WILL_DRAW = 0x20000000UL;
const uint32 B_PULSE_NEEDED = 0x10000000UL;
const uint32 B_NAVIGABLE_JUMP = 0x08000000UL;
const uint32 B_FRAME_EVENTS = 0x04000000UL;
const uint32 B_NAVIGABLE = 0x02000000UL;
const uint32 B_SUBPIXEL_PRECISE = 0x01000000UL;
const uint32 B_DRAW_ON_CHILDREN = 0x00800000UL;
const uint32 B_INPUT_METHOD_AWARE = 0x00400000UL;
const uint32 B_SCROLL_VIEW_AWARE = 0x00200000UL;
const uint32 B_SUPPORTS_LAYOUT = 0x00100000UL;
const uint32 B_INVALIDATE_AFTER_LAYOUT = 0x00080000UL;
const uint32 B_TRANSPARENT_BACKGROUND = 0x00040000UL;

#define _RESIZE_MASK_ 0x0000ffffUL

const uint32 _VIEW_TOP_ = 1UL;
const uint32 _VIEW_LEFT_ = 2UL;
const uint32 _VIEW_BOTTOM_ = 3UL;
const uint32 _VIEW_RIGHT_ = 4UL;
const uint32 _VIEW_CENTER_ = 5UL;

// What each edge follows: top, left, bottom, right, one digit each.
constexpr uint32
_rule_(uint32 top, uint32 left, uint32 bottom, uint32 right)
{
	return (top << 12) | (left << 8) | (bottom << 4) | right;
}

const uint32 B_FOLLOW_NONE = 0x0000;
const uint32 B_FOLLOW_ALL_SIDES = 0x1234;
const uint32 B_FOLLOW_ALL = 0x1234;
const uint32 B_FOLLOW_LEFT = 0x0202;
const uint32 B_FOLLOW_RIGHT = 0x0404;
const uint32 B_FOLLOW_LEFT_RIGHT = 0x0204;
const uint32 B_FOLLOW_H_CENTER = 0x0505;
const uint32 B_FOLLOW_TOP = 0x1010;
const uint32 B_FOLLOW_BOTTOM = 0x3030;
const uint32 B_FOLLOW_TOP_BOTTOM = 0x1030;
const uint32 B_FOLLOW_V_CENTER = 0x5050;
const uint32 B_FOLLOW_LEFT_TOP = 0x1212;

class BBitmap;
class BCursor;
class BMessage;
class BPolygon;
class BRegion;
class BScrollBar;
class BScrollView;
class BShape;
class BString;
class BWindow;

namespace BPrivate {
class ArchiveSource;
struct DrawState;
class Painter;
class ServerView;
class ViewPrivate;
struct ViewExtras;
struct ViewState;
} // namespace BPrivate


// Coordinates are pixels of the view's own system: Bounds() starts at the scroll position, a
// rectangle includes its right and bottom edge. An attached view is used only while its window is
// locked, as it is inside of every hook. A view owns its children; deleting one needs it detached.
class _EXPORT BView : public BHandler {
public:
	// The mode and the flags share one word, so their order does not matter.
	BView(BRect frame, const char* name, uint32 resizingMode, uint32 flags);
	explicit BView(BMessage* archive);
	virtual ~BView();
	BView(const BView&) = delete;
	BView& operator=(const BView&) = delete;

	static BArchivable* Instantiate(BMessage* archive);
	virtual status_t Archive(BMessage* archive, bool deep = true) const;

	// Parents are told first of AttachedToWindow() and DetachedFromWindow(), children first of the
	// other two. Window() answers in all four.
	virtual void AttachedToWindow();
	virtual void AllAttached();
	virtual void DetachedFromWindow();
	virtual void AllDetached();
	virtual void MessageReceived(BMessage* message);

	// The child goes before that sibling, or to the end. AddChild() locks the window by itself.
	// A removed view belongs to the caller.
	void AddChild(BView* child, BView* before = NULL);
	bool RemoveChild(BView* child);
	int32 CountChildren() const;
	BView* ChildAt(int32 index) const;
	BView* NextSibling() const;
	BView* PreviousSibling() const;
	bool RemoveSelf();

	BWindow* Window() const;

	// The rectangle covers what has to be drawn, in own coordinates. State set in here is undone.
	virtual void Draw(BRect updateRect);
	virtual void DrawAfterChildren(BRect updateRect);
	virtual void MouseDown(BPoint where);
	virtual void MouseUp(BPoint where);
	virtual void MouseMoved(BPoint where, uint32 transit, const BMessage* dragMessage);
	virtual void WindowActivated(bool active);
	virtual void KeyDown(const char* bytes, int32 numBytes);
	virtual void KeyUp(const char* bytes, int32 numBytes);
	virtual void Pulse();
	virtual void FrameMoved(BPoint newPosition);
	virtual void FrameResized(float newWidth, float newHeight);
	virtual void TargetedByScrollView(BScrollView* scrollView);

	// An outline that follows the pointer as a whole or by its right bottom corner, over what the
	// view draws. The rectangle is the program's to work out from the pointer's place.
	void BeginRectTracking(BRect startRect, uint32 style = B_TRACK_WHOLE_RECT);
	void EndRectTracking();

	// Own coordinates. checkMessageQueue consumes the window's waiting moves and releases.
	void GetMouse(BPoint* location, uint32* buttons, bool checkMessageQueue = true);

	// The message is copied, the bitmap taken over. Without a held button nothing happens.
	void DragMessage(BMessage* message, BRect dragRect, BHandler* replyTo = NULL);
	void DragMessage(BMessage* message, BBitmap* bitmap, BPoint offset, BHandler* replyTo = NULL);
	void DragMessage(BMessage* message, BBitmap* bitmap, drawing_mode dragMode, BPoint offset,
		BHandler* replyTo = NULL);

	// This view included, parents before children; the first match.
	BView* FindView(const char* name) const;
	// NULL also for a view directly in a window.
	BView* Parent() const;
	BRect Bounds() const;
	// In the parent's coordinates; scrolling the parent does not change it.
	BRect Frame() const;

	// Screen conversions leave the values alone while the view is not attached.
	void ConvertToScreen(BPoint* point) const;
	BPoint ConvertToScreen(BPoint point) const;
	void ConvertFromScreen(BPoint* point) const;
	BPoint ConvertFromScreen(BPoint point) const;
	void ConvertToScreen(BRect* rect) const;
	BRect ConvertToScreen(BRect rect) const;
	void ConvertFromScreen(BRect* rect) const;
	BRect ConvertFromScreen(BRect rect) const;
	void ConvertToParent(BPoint* point) const;
	BPoint ConvertToParent(BPoint point) const;
	void ConvertFromParent(BPoint* point) const;
	BPoint ConvertFromParent(BPoint point) const;
	void ConvertToParent(BRect* rect) const;
	BRect ConvertToParent(BRect rect) const;
	void ConvertFromParent(BRect* rect) const;
	BRect ConvertFromParent(BRect rect) const;

	// Where drawing is allowed now, in own coordinates: neither children nor covering siblings.
	void GetClippingRegion(BRegion* region) const;
	// Replaces the constraint of this state level; NULL removes it.
	virtual void ConstrainClippingRegion(BRegion* region);

	virtual void SetDrawingMode(drawing_mode mode);
	drawing_mode DrawingMode() const;
	void SetBlendingMode(source_alpha sourceAlpha, alpha_function alphaFunction);
	void GetBlendingMode(source_alpha* sourceAlpha, alpha_function* alphaFunction) const;
	virtual void SetPenSize(float size);
	float PenSize() const;

	void SetViewCursor(const BCursor* cursor, bool sync = true);

	// Painted by the system before Draw(), unless it is B_TRANSPARENT_COLOR. Invalidates nothing.
	virtual void SetViewColor(rgb_color color);
	void SetViewColor(uchar red, uchar green, uchar blue, uchar alpha = 255);
	rgb_color ViewColor() const;

	// The pixels are copied, and lie over the view colour. They need an attached view.
	void SetViewBitmap(const BBitmap* bitmap, BRect srcRect, BRect dstRect,
		uint32 followFlags = B_FOLLOW_TOP | B_FOLLOW_LEFT, uint32 options = B_TILE_BITMAP);
	void SetViewBitmap(const BBitmap* bitmap, uint32 followFlags = B_FOLLOW_TOP | B_FOLLOW_LEFT,
		uint32 options = B_TILE_BITMAP);
	void ClearViewBitmap();
	status_t SetViewOverlay(const BBitmap* overlay, BRect srcRect, BRect dstRect,
		rgb_color* colorKey, uint32 followFlags = B_FOLLOW_TOP | B_FOLLOW_LEFT, uint32 options = 0);
	status_t SetViewOverlay(const BBitmap* overlay, rgb_color* colorKey,
		uint32 followFlags = B_FOLLOW_TOP | B_FOLLOW_LEFT, uint32 options = 0);
	void ClearViewOverlay();

	virtual void SetHighColor(rgb_color color);
	void SetHighColor(uchar red, uchar green, uchar blue, uchar alpha = 255);
	rgb_color HighColor() const;
	virtual void SetLowColor(rgb_color color);
	void SetLowColor(uchar red, uchar green, uchar blue, uchar alpha = 255);
	rgb_color LowColor() const;

	void SetLineMode(
		cap_mode lineCap, join_mode lineJoin, float miterLimit = B_DEFAULT_MITER_LIMIT);
	join_mode LineJoinMode() const;
	cap_mode LineCapMode() const;
	float LineMiterLimit() const;

	// Drawing coordinates are scaled, then shifted; saved states' values add to the present ones.
	void SetOrigin(BPoint point);
	void SetOrigin(float x, float y);
	BPoint Origin() const;
	void SetScale(float scale) const;
	float Scale() const;
	void PushState();
	void PopState();

	void MovePenTo(BPoint point);
	void MovePenTo(float x, float y);
	void MovePenBy(float x, float y);
	BPoint PenLocation() const;

	void StrokeLine(BPoint toPoint, pattern p = B_SOLID_HIGH);
	void StrokeLine(BPoint start, BPoint end, pattern p = B_SOLID_HIGH);
	void BeginLineArray(int32 count);
	void AddLine(BPoint start, BPoint end, rgb_color color);
	void EndLineArray();

	void StrokePolygon(const BPolygon* polygon, bool closed = true, pattern p = B_SOLID_HIGH);
	void StrokePolygon(
		const BPoint* points, int32 count, bool closed = true, pattern p = B_SOLID_HIGH);
	void StrokePolygon(const BPoint* points, int32 count, BRect bounds, bool closed = true,
		pattern p = B_SOLID_HIGH);
	void FillPolygon(const BPolygon* polygon, pattern p = B_SOLID_HIGH);
	void FillPolygon(const BPoint* points, int32 count, pattern p = B_SOLID_HIGH);
	void FillPolygon(const BPoint* points, int32 count, BRect bounds, pattern p = B_SOLID_HIGH);
	void StrokeTriangle(BPoint a, BPoint b, BPoint c, BRect bounds, pattern p = B_SOLID_HIGH);
	void StrokeTriangle(BPoint a, BPoint b, BPoint c, pattern p = B_SOLID_HIGH);
	void FillTriangle(BPoint a, BPoint b, BPoint c, pattern p = B_SOLID_HIGH);
	void FillTriangle(BPoint a, BPoint b, BPoint c, BRect bounds, pattern p = B_SOLID_HIGH);

	void StrokeRect(BRect rect, pattern p = B_SOLID_HIGH);
	void FillRect(BRect rect, pattern p = B_SOLID_HIGH);
	void FillRegion(BRegion* region, pattern p = B_SOLID_HIGH);
	void InvertRect(BRect rect);
	void StrokeRoundRect(BRect rect, float xRadius, float yRadius, pattern p = B_SOLID_HIGH);
	void FillRoundRect(BRect rect, float xRadius, float yRadius, pattern p = B_SOLID_HIGH);

	// Angles are degrees, counter-clockwise from the right.
	void StrokeEllipse(BPoint center, float xRadius, float yRadius, pattern p = B_SOLID_HIGH);
	void StrokeEllipse(BRect rect, pattern p = B_SOLID_HIGH);
	void FillEllipse(BPoint center, float xRadius, float yRadius, pattern p = B_SOLID_HIGH);
	void FillEllipse(BRect rect, pattern p = B_SOLID_HIGH);
	void StrokeArc(BPoint center, float xRadius, float yRadius, float startAngle, float arcAngle,
		pattern p = B_SOLID_HIGH);
	void StrokeArc(BRect rect, float startAngle, float arcAngle, pattern p = B_SOLID_HIGH);
	void FillArc(BPoint center, float xRadius, float yRadius, float startAngle, float arcAngle,
		pattern p = B_SOLID_HIGH);
	void FillArc(BRect rect, float startAngle, float arcAngle, pattern p = B_SOLID_HIGH);
	void StrokeBezier(BPoint* controlPoints, pattern p = B_SOLID_HIGH);
	void FillBezier(BPoint* controlPoints, pattern p = B_SOLID_HIGH);
	// Shapes start at the pen position.
	void StrokeShape(BShape* shape, pattern p = B_SOLID_HIGH);
	void FillShape(BShape* shape, pattern p = B_SOLID_HIGH);

	// What is hidden in the source is invalidated in the destination.
	void CopyBits(BRect src, BRect dst);
	void DrawBitmapAsync(const BBitmap* bitmap, BRect srcRect, BRect dstRect);
	void DrawBitmapAsync(const BBitmap* bitmap, BRect dstRect);
	void DrawBitmapAsync(const BBitmap* bitmap, BPoint where);
	void DrawBitmapAsync(const BBitmap* bitmap);
	void DrawBitmap(const BBitmap* bitmap, BRect srcRect, BRect dstRect);
	void DrawBitmap(const BBitmap* bitmap, BRect dstRect);
	void DrawBitmap(const BBitmap* bitmap, BPoint where);
	void DrawBitmap(const BBitmap* bitmap);

	// The point is the left end of the baseline; the pen is left behind the text.
	void DrawChar(char character);
	void DrawChar(char character, BPoint location);
	void DrawString(const char* string, escapement_delta* delta = NULL);
	void DrawString(const char* string, BPoint location, escapement_delta* delta = NULL);
	void DrawString(const char* string, int32 length, escapement_delta* delta = NULL);
	void DrawString(
		const char* string, int32 length, BPoint location, escapement_delta* delta = NULL);

	virtual void SetFont(const BFont* font, uint32 mask = B_FONT_ALL);
	void GetFont(BFont* font) const;
	void TruncateString(BString* string, uint32 mode, float width) const;
	float StringWidth(const char* string) const;
	float StringWidth(const char* string, int32 length) const;
	void GetStringWidths(char* strings[], int32 lengths[], int32 count, float widths[]) const;
	void SetFontSize(float size);
	void ForceFontAliasing(bool enable);
	void GetFontHeight(font_height* height) const;

	// Marks for redrawing this view and all its descendants there.
	void Invalidate(BRect rect);
	void Invalidate(const BRegion* region);
	void Invalidate();

	void SetEventMask(uint32 mask, uint32 options = 0);
	uint32 EventMask();
	// From MouseDown() only; ends with the next mouse-up.
	void SetMouseEventMask(uint32 mask, uint32 options = 0);

	virtual void SetFlags(uint32 flags);
	uint32 Flags() const;
	virtual void SetResizingMode(uint32 mode);
	uint32 ResizingMode() const;

	void MoveBy(float dx, float dy);
	void MoveTo(BPoint where);
	void MoveTo(float x, float y);
	// Width and height are right - left and bottom - top.
	void ResizeBy(float dx, float dy);
	void ResizeTo(float width, float height);
	void ScrollBy(float dx, float dy);
	void ScrollTo(float x, float y);
	virtual void ScrollTo(BPoint where);

	virtual void MakeFocus(bool focusState = true);
	bool IsFocus() const;
	// Calls nest: as many Show() as Hide().
	virtual void Show();
	virtual void Hide();
	// Own or inherited; the other looks no higher than that ancestor.
	bool IsHidden() const;
	bool IsHidden(const BView* lookingFrom) const;
	bool IsPrinting() const;

	void Flush() const;
	void Sync() const;

	virtual void GetPreferredSize(float* width, float* height);
	virtual void ResizeToPreferred();
	BScrollBar* ScrollBar(orientation posture) const;

	// NULL or an empty text removes it.
	void SetToolTip(const char* text);
	const char* ToolTip() const;

	virtual BHandler* ResolveSpecifier(
		BMessage* message, int32 index, BMessage* specifier, int32 form, const char* property);
	virtual status_t GetSupportedSuites(BMessage* data);
	virtual status_t Perform(perform_code code, void* argument);

private:
	friend class BPrivate::ViewPrivate;
	friend class BWindow;

	void _InitFromArchive(BMessage* archive);
	status_t _ArchiveOwnFields(BMessage* archive) const;
	void _ArchiveColors(BMessage* archive, const rgb_color now[], const rgb_color read[]) const;
	void _ArchiveModes(
		BMessage* archive, const BPrivate::DrawState& now, const BPrivate::DrawState& read) const;
	status_t _ArchiveChildren(BMessage* archive) const;
	static bool _TakeEntry(const BMessage& source, int32 count, int32* _entry, BMessage* _child);
	const BPrivate::DrawState& _BottomState() const;
	BPrivate::ViewState* _State();
	const BPrivate::ViewState& _StateToRead() const;
	BPrivate::ViewExtras* _Extras();
	BPrivate::Painter* _BeginDrawing();
	void _SetPen(BPoint location);
	void _InvalidateTracking();
	void _CheckLock() const;
	bool _CheckOwnerLock() const;
	bool _StartDrag(BMessage* message, BBitmap* bitmap, drawing_mode mode, BRect rect,
		BPoint offset, BHandler* replyTo);

	BPrivate::ServerView* fNode; // owned; the links, frame, scroll position, flags and colour
	BWindow* fOwner; // borrowed; NULL while not attached
	mutable BPrivate::ViewState* fState; // owned; NULL while every value is the default
	BPrivate::ViewExtras* fExtras; // owned; scroll bars, event mask and other rare things
	BPrivate::ArchiveSource* fSource; // owned; what an archived view was read from
	uint32 fTouched : 9; // which settings were ever changed, for the archive
	uint32 fEntry : 23; // 1 + its number in the parent's archive; 0 once it was added anew
	uint32 fRevivedWord; // flags and mode that an unchanged archived view has
};


// #pragma mark - inline functions


inline void
BView::ScrollTo(float x, float y)
{
	ScrollTo(BPoint(x, y));
}


inline void
BView::SetViewColor(uchar red, uchar green, uchar blue, uchar alpha)
{
	SetViewColor(rgb_color { red, green, blue, alpha });
}


inline void
BView::SetHighColor(uchar red, uchar green, uchar blue, uchar alpha)
{
	SetHighColor(rgb_color { red, green, blue, alpha });
}


inline void
BView::SetLowColor(uchar red, uchar green, uchar blue, uchar alpha)
{
	SetLowColor(rgb_color { red, green, blue, alpha });
}
