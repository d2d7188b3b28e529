#include "MenuField.h"

#include <algorithm>
#include <cmath>
#include <cstdlib>
#include <cstring>

#include <MenuBar.h>
#include <MenuItem.h>
#include <Message.h>
#include <Window.h>

#include "interface/private/InnerChild.h"
#include "interface/private/Look.h"
#include "interface/private/MenuFieldBar.h"
#include "interface/private/MenuTracker.h"
#include "interface/private/ViewArchive.h"

using namespace BPrivate;

namespace {

constexpr const char* kBarName = "_mc_mb_";
constexpr float kMargin = 2; // round the bar
constexpr float kLabelGap = 2; // between label and divider

} // namespace


BMenuField::BMenuField(BRect frame, const char* name, const char* label, BMenu* menu,
	uint32 resizingMode, uint32 flags) :
	BMenuField(frame, name, label, menu, false, resizingMode, flags)
{
}


BMenuField::BMenuField(BRect frame, const char* name, const char* label, BMenu* menu,
	bool fixedSize, uint32 resizingMode, uint32 flags) :
	BView(frame, name, resizingMode, flags | B_FRAME_EVENTS)
{
	_Init();
	fLabel = label != NULL ? strdup(label) : NULL;
	fFixedSize = fixedSize;
	fDivider = label != NULL ? std::floor(Bounds().Width() / 2) : 0;
	_CreateBar(menu);
}


BMenuField::BMenuField(BMessage* archive) : BView(archive)
{
	_Init();
	const char* label;
	if (archive->FindString("_label", &label) == B_OK)
		fLabel = strdup(label);
	bool flag;
	if (archive->FindBool("_disable", &flag) == B_OK)
		fEnabled = !flag;
	int32 number;
	if (archive->FindInt32("_align", &number) == B_OK)
		fAlignment = alignment(number);
	if (archive->FindFloat("_divide", &fDivider) != B_OK)
		fDivider = 0;
	if (archive->FindBool("be:fixeds", &flag) == B_OK)
		fFixedSize = flag;
	if (archive->FindBool("be:dmark", &flag) == B_OK)
		fPopUpMarker = flag;

	if (BPrivate::inner_child(this, kBarName) == NULL)
		_CreateBar(new BMenu(""));
}


BMenuField::~BMenuField()
{
	free(fLabel);
}


void
BMenuField::_Init()
{
	fLabel = NULL;
	fAlignment = B_ALIGN_LEFT;
	fDivider = 0;
	fEnabled = true;
	fFixedSize = false;
	fPopUpMarker = true;
}


BArchivable*
BMenuField::Instantiate(BMessage* archive)
{
	return validate_instantiation(archive, "BMenuField") ? new BMenuField(archive) : NULL;
}


status_t
BMenuField::Archive(BMessage* archive, bool deep) const
{
	const status_t status = BView::Archive(archive, deep);
	if (status != B_OK)
		return status;

	ArchiveWriter writer(archive);
	writer.String("_label", fLabel, NULL);
	writer.Bool("_disable", !fEnabled, false, !fEnabled);
	writer.Int32("_align", fAlignment, B_ALIGN_LEFT);
	writer.Float("_divide", fDivider, 0);
	writer.Bool("be:fixeds", fFixedSize, false, fFixedSize);
	writer.Bool("be:dmark", fPopUpMarker, true);
	return writer.Status();
}


void
BMenuField::_CreateBar(BMenu* menu)
{
	_BMCMenuBar_* bar = new _BMCMenuBar_(_BarFrame(), fFixedSize);
	AddChild(bar);
	if (menu != NULL)
		bar->AddItem(menu);
	if (!is_revived(this))
		_FitBar();
}


BMenuBar*
BMenuField::MenuBar() const
{
	// The bar is a view like others: it may be taken out, and another one put in its place.
	for (BView* child = ChildAt(0); child != NULL; child = child->NextSibling()) {
		BMenuBar* bar = dynamic_cast<BMenuBar*>(child);
		if (bar != NULL && bar->Name() != NULL && strcmp(bar->Name(), kBarName) == 0)
			return bar;
	}
	return NULL;
}


// #pragma mark - geometry


// All the room right of the divider.
BRect
BMenuField::_BarFrame() const
{
	const float left = std::max(0.0f, fDivider) + kMargin;
	return BRect(left, kMargin, std::max(left, Bounds().Width() - kMargin),
		std::max(kMargin, Bounds().Height() - kMargin));
}


void
BMenuField::_FitBar()
{
	BMenuBar* bar = MenuBar();
	if (bar == NULL)
		return;
	const BRect room = _BarFrame();
	float width, height;
	bar->GetPreferredSize(&width, &height);
	if (fFixedSize)
		width = room.Width();
	else
		width = std::min(width, room.Width());
	bar->MoveTo(room.LeftTop());
	bar->ResizeTo(width, height);
}


void
BMenuField::AttachedToWindow()
{
	if (!is_revived(this)) {
		const rgb_color color = Look::ColorOfParent(this);
		SetViewColor(color);
		SetLowColor(color);
	}
	BView::AttachedToWindow();
}


void
BMenuField::AllAttached()
{
	BView::AllAttached();
	BMenuBar* bar = MenuBar();
	if (is_revived(this) || bar == NULL)
		return;
	_FitBar();
	ResizeTo(Bounds().Width(), bar->Bounds().Height() + 2 * kMargin);
	if (fFixedSize)
		bar->SetResizingMode(B_FOLLOW_LEFT_RIGHT | B_FOLLOW_TOP);
}


void
BMenuField::FrameMoved(BPoint newPosition)
{
	BView::FrameMoved(newPosition);
}


void
BMenuField::FrameResized(float width, float height)
{
	BView::FrameResized(width, height);
	_FitBar();
	Invalidate();
}


void
BMenuField::SetDivider(float position)
{
	position = std::floor(position + 0.5f);
	if (fDivider == position)
		return;
	fDivider = position;
	_FitBar();
	Invalidate();
}


float
BMenuField::Divider() const
{
	return fDivider;
}


float
BMenuField::_LabelWidth() const
{
	return fLabel != NULL ? std::ceil(StringWidth(fLabel)) : 0;
}


void
BMenuField::ResizeToPreferred()
{
	BView::ResizeToPreferred();
}


void
BMenuField::GetPreferredSize(float* _width, float* _height)
{
	float width = 0;
	float height = 0;
	if (BMenuBar* bar = MenuBar())
		bar->GetPreferredSize(&width, &height);
	font_height label;
	GetFontHeight(&label);
	if (_width != NULL) {
		const float divider = fLabel != NULL ? std::max(fDivider, _LabelWidth() + kLabelGap) : 0;
		*_width = divider + width + 2 * kMargin;
	}
	if (_height != NULL) {
		const float line = std::ceil(label.ascent + label.descent + label.leading);
		*_height = std::max(height, line) + 2 * kMargin;
	}
}


// #pragma mark - drawing and input


void
BMenuField::Draw(BRect)
{
	const BMenuBar* menuBar = MenuBar();
	if (fLabel == NULL) {
		if (menuBar != NULL && IsFocus() && Window()->IsActive()) {
			SetHighColor(Look::NavigationColor());
			StrokeRect(menuBar->Frame().InsetByCopy(-1, -1));
		}
		return;
	}
	font_height height;
	GetFontHeight(&height);
	// On the baseline of what the bar shows.
	const BRect bar = menuBar != NULL ? menuBar->Frame() : Bounds();
	const float text = std::ceil(height.ascent) + std::ceil(height.descent);
	const float baseline =
		bar.top + std::floor((bar.Height() + 1 - text) / 2) + std::ceil(height.ascent);
	const float width = StringWidth(fLabel);
	float x = 0;
	if (fAlignment == B_ALIGN_RIGHT)
		x = fDivider - width - kLabelGap;
	else if (fAlignment == B_ALIGN_CENTER)
		x = (fDivider - width) / 2;
	x = std::max(0.0f, std::floor(x));
	const uint32 state = IsEnabled() ? Look::kNormal : Look::kDisabled;
	PushState();
	SetDrawingMode(B_OP_OVER);
	SetHighColor(Look::TextColor(state));
	DrawString(fLabel, BPoint(x, baseline));
	PopState();
	if (IsFocus() && Window()->IsActive())
		Look::DrawFocusLine(this, x, x + std::ceil(width), baseline);
}


void
BMenuField::MouseDown(BPoint)
{
	_OpenMenu(false);
}


void
BMenuField::KeyDown(const char* bytes, int32 numBytes)
{
	if (numBytes == 1 && (bytes[0] == B_SPACE || bytes[0] == B_DOWN_ARROW || bytes[0] == B_UP_ARROW)
		&& IsEnabled()) {
		_OpenMenu(true);
		return;
	}
	BView::KeyDown(bytes, numBytes);
}


void
BMenuField::_OpenMenu(bool byKey)
{
	BMenuBar* bar = MenuBar();
	if (bar == NULL || !IsEnabled())
		return;
	BMenuItem* item = bar->ItemAt(0);
	if (item == NULL)
		return;
	MenuTracker::Request request;
	request.bar = bar;
	request.barItem = item;
	request.sticky = byKey;
	request.staysOnClick = true;
	request.byKey = byKey;
	request.deliver = true;
	MenuTracker::Start(request);
}


void
BMenuField::MakeFocus(bool focus)
{
	if (focus == IsFocus())
		return;
	BView::MakeFocus(focus);
	Invalidate();
}


void
BMenuField::WindowActivated(bool active)
{
	BView::WindowActivated(active);
	if (IsFocus())
		Invalidate();
}


void
BMenuField::MessageReceived(BMessage* message)
{
	BView::MessageReceived(message);
}


void
BMenuField::MouseUp(BPoint where)
{
	BView::MouseUp(where);
}


void
BMenuField::MouseMoved(BPoint where, uint32 code, const BMessage* message)
{
	BView::MouseMoved(where, code, message);
}


void
BMenuField::DetachedFromWindow()
{
	BView::DetachedFromWindow();
}


void
BMenuField::AllDetached()
{
	BView::AllDetached();
}
