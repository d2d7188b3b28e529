// The graphics state of views: colours, font, pen, modes, and the stack of saved states.
#include <View.h>

#include <cmath>

#include <Bitmap.h>
#include <Window.h>

#include "interface/private/BitmapAccess.h"
#include "interface/private/FontAccess.h"
#include "interface/private/ViewPrivate.h"
#include "interface/private/ViewState.h"
#include "interface/private/WindowInternals.h"
#include "server/ViewTree.h"

using namespace BPrivate;

namespace BPrivate {


void
ViewState::Combine()
{
	const BPoint baseOrigin = below ? below->draw.combinedOrigin : BPoint(0, 0);
	const float baseScale = below ? below->draw.combinedScale : 1;
	draw.combinedOrigin =
		BPoint(baseOrigin.x + draw.origin.x * baseScale, baseOrigin.y + draw.origin.y * baseScale);
	draw.combinedScale = baseScale * draw.scale;
}


std::optional<BRegion>
ViewState::Constraint() const
{
	std::optional<BRegion> constraint;
	for (const ViewState* level = this; level != nullptr; level = level->below.get()) {
		if (!level->draw.hasClipping)
			continue;
		if (constraint)
			constraint->IntersectWith(&level->draw.clipping);
		else
			constraint = level->draw.clipping;
	}
	return constraint;
}


void
ViewPrivate::CallDraw(BRect updateRect, bool afterChildren)
{
	// The hook works on a copy of the present level, which is thrown away with everything that
	// it has pushed.
	BView* view = fView;
	ViewState* saved = view->fState;
	const uint32 touched = view->fTouched;
	if (saved != nullptr) {
		auto level = new ViewState;
		level->draw = saved->draw;
		level->below.reset(saved->below.get());
		level->isFloor = true;
		view->fState = level;
	}
	if (afterChildren)
		view->DrawAfterChildren(updateRect);
	else
		view->Draw(updateRect);

	ViewState* level = view->fState;
	if (saved != nullptr) {
		while (!level->isFloor) {
			ViewState* next = level->below.release();
			delete level;
			level = next;
		}
		level->below.release(); // belongs to the saved level
	}
	delete level;
	view->fState = saved;
	if (!afterChildren)
		DrawTracking();
	view->fTouched = touched;
}


} // namespace BPrivate


// The state for setters; made when it is first needed.
ViewState*
BView::_State()
{
	if (fState == nullptr)
		fState = new ViewState;
	return fState;
}


const ViewState&
BView::_StateToRead() const
{
	static const ViewState kDefault;
	return fState != nullptr ? *fState : kDefault;
}


// The lowest level: what the view has when no state is pushed.
const DrawState&
BView::_BottomState() const
{
	const ViewState* level = &_StateToRead();
	while (level->below != nullptr)
		level = level->below.get();
	return level->draw;
}


// #pragma mark - stack


void
BView::PushState()
{
	_CheckLock();
	auto level = new ViewState;
	level->below.reset(_State());
	level->draw = level->below->draw;
	level->draw.origin = BPoint(0, 0);
	level->draw.scale = 1;
	level->draw.hasClipping = false;
	level->draw.clipping.MakeEmpty();
	// The pen's place is a drawing coordinate, and those start anew at this level.
	level->Combine();
	fState = level;
}


void
BView::PopState()
{
	_CheckLock();
	if (fState == nullptr || fState->isFloor || fState->below == nullptr)
		return;
	ViewState* level = fState;
	fState = level->below.release();
	const bool clipped = level->draw.hasClipping;
	delete level;
	if (clipped && fOwner != nullptr)
		fNode->Tree()->ConstraintChanged(*fNode);
}


// #pragma mark - colours


void
BView::SetHighColor(rgb_color color)
{
	if (HighColor() == color)
		return;
	_CheckLock();
	_State()->draw.highColor = color;
}


rgb_color
BView::HighColor() const
{
	return _StateToRead().draw.highColor;
}


void
BView::SetLowColor(rgb_color color)
{
	if (LowColor() == color)
		return;
	_CheckLock();
	_State()->draw.lowColor = color;
}


rgb_color
BView::LowColor() const
{
	return _StateToRead().draw.lowColor;
}


void
BView::SetViewColor(rgb_color color)
{
	_CheckLock();
	fNode->SetColor(color);
}


rgb_color
BView::ViewColor() const
{
	return fNode->Color();
}


// #pragma mark - view bitmap


void
BView::SetViewBitmap(
	const BBitmap* bitmap, BRect srcRect, BRect dstRect, uint32 followFlags, uint32 options)
{
	if (fOwner == nullptr || !_CheckOwnerLock())
		return;
	std::unique_ptr<ViewBackground> background;
	if (bitmap != nullptr && srcRect.IsValid() && dstRect.IsValid()) {
		if (std::shared_ptr<Surface> image = BitmapAccess::CopyOf(*bitmap)) {
			background = std::make_unique<ViewBackground>();
			background->image = std::move(image);
			background->source = srcRect;
			background->destination = dstRect;
			background->follow = followFlags;
			background->options = options;
		}
	}
	if (background == nullptr && fNode->Background() == nullptr)
		return;
	fNode->SetBackground(std::move(background));
	Invalidate();
}


void
BView::SetViewBitmap(const BBitmap* bitmap, uint32 followFlags, uint32 options)
{
	const BRect bounds = bitmap != nullptr ? bitmap->Bounds() : BRect();
	SetViewBitmap(bitmap, bounds, bounds.OffsetToCopy(0, 0), followFlags, options);
}


void
BView::ClearViewBitmap()
{
	SetViewBitmap(nullptr, BRect(), BRect());
}


status_t
BView::SetViewOverlay(
	const BBitmap* overlay, BRect srcRect, BRect dstRect, rgb_color* colorKey, uint32, uint32)
{
	return B_UNSUPPORTED;
}


status_t
BView::SetViewOverlay(const BBitmap* overlay, rgb_color* colorKey, uint32, uint32)
{
	return B_UNSUPPORTED;
}


void
BView::ClearViewOverlay()
{
}


// #pragma mark - modes


void
BView::SetDrawingMode(drawing_mode mode)
{
	if (DrawingMode() == mode)
		return;
	_CheckLock();
	_State()->draw.mode = mode;
	fTouched |= kTouchedDrawingMode;
}


drawing_mode
BView::DrawingMode() const
{
	return _StateToRead().draw.mode;
}


void
BView::SetBlendingMode(source_alpha sourceAlpha, alpha_function alphaFunction)
{
	const DrawState& now = _StateToRead().draw;
	if (now.sourceAlpha == sourceAlpha && now.alphaFunction == alphaFunction)
		return;
	_CheckLock();
	_State()->draw.sourceAlpha = sourceAlpha;
	_State()->draw.alphaFunction = alphaFunction;
	fTouched |= kTouchedBlending;
}


void
BView::GetBlendingMode(source_alpha* sourceAlpha, alpha_function* alphaFunction) const
{
	if (sourceAlpha != nullptr)
		*sourceAlpha = _StateToRead().draw.sourceAlpha;
	if (alphaFunction != nullptr)
		*alphaFunction = _StateToRead().draw.alphaFunction;
}


void
BView::SetPenSize(float size)
{
	if (PenSize() == size)
		return;
	_CheckLock();
	_State()->draw.penSize = size;
	fTouched |= kTouchedPenSize;
}


float
BView::PenSize() const
{
	return _StateToRead().draw.penSize;
}


void
BView::SetLineMode(cap_mode lineCap, join_mode lineJoin, float miterLimit)
{
	const DrawState& now = _StateToRead().draw;
	if (now.lineCap == lineCap && now.lineJoin == lineJoin && now.miterLimit == miterLimit)
		return;
	_CheckLock();
	DrawState& draw = _State()->draw;
	draw.lineCap = lineCap;
	draw.lineJoin = lineJoin;
	draw.miterLimit = miterLimit;
	fTouched |= kTouchedLineMode;
}


join_mode
BView::LineJoinMode() const
{
	return _StateToRead().draw.lineJoin;
}


cap_mode
BView::LineCapMode() const
{
	return _StateToRead().draw.lineCap;
}


float
BView::LineMiterLimit() const
{
	return _StateToRead().draw.miterLimit;
}


void
BView::SetOrigin(float x, float y)
{
	SetOrigin(BPoint(x, y));
}


void
BView::SetOrigin(BPoint point)
{
	if (Origin() == point)
		return;
	_CheckLock();
	_State()->draw.origin = point;
	_State()->Combine();
	fTouched |= kTouchedOrigin;
}


BPoint
BView::Origin() const
{
	return _StateToRead().draw.origin;
}


void
BView::SetScale(float scale) const
{
	if (Scale() == scale)
		return;
	_CheckLock();
	BView* self = const_cast<BView*>(this); // const in the platform's signature
	self->_State()->draw.scale = scale;
	self->_State()->Combine();
	self->fTouched |= kTouchedScale;
}


float
BView::Scale() const
{
	return _StateToRead().draw.scale;
}


// #pragma mark - pen


void
BView::MovePenTo(float x, float y)
{
	MovePenTo(BPoint(x, y));
}


void
BView::MovePenTo(BPoint point)
{
	if (PenLocation() == point)
		return;
	_CheckLock();
	_State()->draw.penLocation = point;
	fTouched |= kTouchedPenLocation;
}


void
BView::MovePenBy(float x, float y)
{
	MovePenTo(PenLocation() + BPoint(x, y));
}


BPoint
BView::PenLocation() const
{
	return _StateToRead().draw.penLocation;
}
