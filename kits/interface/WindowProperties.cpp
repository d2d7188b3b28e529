// Frame, title and archive of windows.
#include <Window.h>

#include <algorithm>
#include <cmath>
#include <cstring>

#include <AppDefs.h>
#include <Message.h>
#include <Screen.h>

#include "interface/private/ViewArchive.h"
#include "interface/private/ViewInspector.h"
#include "interface/private/ViewPrivate.h"
#include "interface/private/WindowInternals.h"

using namespace BPrivate;


BRect
BWindow::Bounds() const
{
	return fInternals->tree.Root().Bounds();
}


BRect
BWindow::Frame() const
{
	if (fInternals->server == nullptr)
		return Bounds();
	// The size is the one that the views have; the desktop's may be a message ahead.
	return Bounds().OffsetToCopy(fInternals->server->Frame().LeftTop());
}


// #pragma mark - conversions


BPoint
BWindow::ConvertToScreen(BPoint point) const
{
	return point + Frame().LeftTop();
}


BPoint
BWindow::ConvertFromScreen(BPoint point) const
{
	return point - Frame().LeftTop();
}


BRect
BWindow::ConvertToScreen(BRect rect) const
{
	return rect.OffsetByCopy(Frame().LeftTop());
}


BRect
BWindow::ConvertFromScreen(BRect rect) const
{
	return rect.OffsetByCopy(-Frame().LeftTop());
}


void
BWindow::ConvertToScreen(BPoint* point) const
{
	*point = ConvertToScreen(*point);
}


void
BWindow::ConvertFromScreen(BPoint* point) const
{
	*point = ConvertFromScreen(*point);
}


void
BWindow::ConvertToScreen(BRect* rect) const
{
	*rect = ConvertToScreen(*rect);
}


void
BWindow::ConvertFromScreen(BRect* rect) const
{
	*rect = ConvertFromScreen(*rect);
}


// #pragma mark - moving and sizing


void
BWindow::MoveBy(float dx, float dy)
{
	MoveTo(Frame().LeftTop() + BPoint(std::round(dx), std::round(dy)));
}


void
BWindow::MoveTo(float x, float y)
{
	MoveTo(BPoint(x, y));
}


void
BWindow::MoveTo(BPoint where)
{
	if (fInternals->server == nullptr)
		return;
	where.Set(std::round(where.x), std::round(where.y));
	fInternals->server->SetFrame(Bounds().OffsetToCopy(where));
}


void
BWindow::ResizeBy(float dx, float dy)
{
	const BRect bounds = Bounds();
	ResizeTo(bounds.Width() + std::round(dx), bounds.Height() + std::round(dy));
}


void
BWindow::ResizeTo(float width, float height)
{
	if (fInternals->server == nullptr)
		return;
	const bool locked = Lock();
	width = std::max(0.0f, std::round(width));
	height = std::max(0.0f, std::round(height));
	const BPoint leftTop = Frame().LeftTop();
	fInternals->server->SetFrame(
		BRect(leftTop.x, leftTop.y, leftTop.x + width, leftTop.y + height));
	fInternals->ResizeViews(width, height);
	if (locked)
		Unlock();
}


void
BWindow::CenterIn(const BRect& rect)
{
	const BRect bounds = Bounds();
	MoveTo(rect.left + std::floor((rect.Width() - bounds.Width()) / 2),
		rect.top + std::floor((rect.Height() - bounds.Height()) / 2));
}


void
BWindow::CenterOnScreen()
{
	CenterIn(BScreen(this).Frame());
}


void
BWindow::SetSizeLimits(float minWidth, float maxWidth, float minHeight, float maxHeight)
{
	if (minWidth > maxWidth || minHeight > maxHeight)
		return;
	fInternals->minWidth = minWidth;
	fInternals->maxWidth = maxWidth;
	fInternals->minHeight = minHeight;
	fInternals->maxHeight = maxHeight;
	if (fInternals->server != nullptr)
		fInternals->server->SetSizeLimits(minWidth, maxWidth, minHeight, maxHeight);
}


void
BWindow::GetSizeLimits(float* minWidth, float* maxWidth, float* minHeight, float* maxHeight)
{
	if (minWidth != nullptr)
		*minWidth = fInternals->minWidth;
	if (maxWidth != nullptr)
		*maxWidth = fInternals->maxWidth;
	if (minHeight != nullptr)
		*minHeight = fInternals->minHeight;
	if (maxHeight != nullptr)
		*maxHeight = fInternals->maxHeight;
}


// #pragma mark - title and kind


const char*
BWindow::Title() const
{
	return fInternals->title.c_str();
}


void
BWindow::SetTitle(const char* title)
{
	fInternals->title = title != nullptr ? title : "";
	SetName(fInternals->title.c_str());
	if (fInternals->server != nullptr)
		fInternals->server->SetTitle(fInternals->title.c_str());
	WindowList::SetTitle(this, fInternals->title.c_str());
}


status_t
BWindow::SetFlags(uint32 flags)
{
	fInternals->flags = flags;
	return fInternals->ApplyKind();
}


uint32
BWindow::Flags() const
{
	return fInternals->flags;
}


status_t
WindowInternals::ApplyKind()
{
	if (server == nullptr)
		return B_ERROR;
	server->SetKind(look, feel, flags);
	return B_OK;
}


bool
BWindow::IsModal() const
{
	return Feel() == B_MODAL_SUBSET_WINDOW_FEEL || Feel() == B_MODAL_APP_WINDOW_FEEL
		|| Feel() == B_MODAL_ALL_WINDOW_FEEL;
}


bool
BWindow::IsFloating() const
{
	return Feel() == B_FLOATING_SUBSET_WINDOW_FEEL || Feel() == B_FLOATING_APP_WINDOW_FEEL
		|| Feel() == B_FLOATING_ALL_WINDOW_FEEL;
}


status_t
BWindow::AddToSubset(BWindow* window)
{
	if (window == nullptr || window->fInternals->server == nullptr || fInternals->server == nullptr)
		return B_BAD_VALUE;
	window->fInternals->server->AddToSubset(*fInternals->server);
	return B_OK;
}


status_t
BWindow::RemoveFromSubset(BWindow* window)
{
	if (window == nullptr || window->fInternals->server == nullptr || fInternals->server == nullptr)
		return B_BAD_VALUE;
	window->fInternals->server->RemoveFromSubset(*fInternals->server);
	return B_OK;
}


uint32
BWindow::Workspaces() const
{
	return fInternals->workspaces == B_CURRENT_WORKSPACE ? 1 : fInternals->workspaces;
}


void
BWindow::SetWorkspaces(uint32 workspaces)
{
	fInternals->workspaces = workspaces;
}


status_t
BWindow::SetWindowAlignment(
	window_alignment, int32, int32, int32, int32, int32, int32, int32, int32)
{
	return B_UNSUPPORTED;
}


// Windows lie on whole pixels.
status_t
BWindow::GetWindowAlignment(window_alignment* mode, int32* h, int32* hOffset, int32* width,
	int32* widthOffset, int32* v, int32* vOffset, int32* height, int32* heightOffset) const
{
	if (mode != nullptr)
		*mode = B_PIXEL_ALIGNMENT;
	for (int32* value : { h, width, v, height }) {
		if (value != nullptr)
			*value = 1;
	}
	for (int32* value : { hOffset, widthOffset, vOffset, heightOffset }) {
		if (value != nullptr)
			*value = 0;
	}
	return B_OK;
}


// #pragma mark - archive


BWindow::BWindow(BMessage* archive) : BLooper(archive)
{
	auto source = std::make_unique<ArchiveSource>(archive);
	// Looked up by others, maybe before anybody took notes.
	for (const char* name : { "class", "_name", "_views" })
		source->SetKnown(name);
	BRect frame;
	if (archive->FindRect("_frame", &frame) != B_OK)
		frame.Set(100, 100, 300, 300);
	const char* title = archive->GetString("_title", "");
	const auto look = static_cast<window_look>(archive->GetInt32("_wlook", B_TITLED_WINDOW_LOOK));
	const auto feel = static_cast<window_feel>(archive->GetInt32("_wfeel", B_NORMAL_WINDOW_FEEL));
	const auto type = static_cast<window_type>(archive->GetInt32("_type", B_UNTYPED_WINDOW));
	_Init(frame, title, look, feel, archive->GetInt32("_flags", 0),
		archive->GetInt32("_wspace", B_CURRENT_WORKSPACE), type);

	fInternals->source = std::move(source);

	float limits[4];
	bool limited = true;
	for (int32 i = 0; i < 4; i++)
		limited = limited && archive->FindFloat("_sizel", i, &limits[i]) == B_OK;
	if (limited)
		SetSizeLimits(limits[0], limits[1], limits[2], limits[3]);
	fInternals->pulseRate = archive->GetInt64("_pulse", 500000);

	BMessage child;
	for (int32 i = 0; archive->FindMessage("_views", i, &child) == B_OK; i++) {
		BArchivable* object = instantiate_object(&child);
		if (BView* view = dynamic_cast<BView*>(object))
			AddChild(view);
		else
			delete object;
	}
}


BArchivable*
BWindow::Instantiate(BMessage* archive)
{
	return validate_instantiation(archive, "BWindow") ? new BWindow(archive) : nullptr;
}


status_t
BWindow::Archive(BMessage* archive, bool deep) const
{
	begin_archive(fInternals->source.get(), archive);
	const status_t status = BLooper::Archive(archive, deep);
	if (status != B_OK)
		return status;
	ArchiveWriter writer(archive);
	writer.Rect("_frame", Frame(), BRect());
	writer.String("_title", Title(), nullptr);
	writer.Int32("_wlook", Look(), 0);
	writer.Int32("_wfeel", Feel(), 0);
	writer.Int32("_type", Type(), 0);
	writer.Int32("_flags", Flags(), 0, Flags() != 0);
	writer.Int32("_wspace", Workspaces(), 0);
	const float limits[] = { fInternals->minWidth, fInternals->maxWidth, fInternals->minHeight,
		fInternals->maxHeight };
	const float none[] = { 0, 0, 0, 0 };
	writer.Floats("_sizel", limits, none);
	writer.Int64("_pulse", fInternals->pulseRate, 0, fInternals->pulseRate != 500000);
	if (!deep || writer.Status() != B_OK)
		return writer.Status();

	const ServerView& root = fInternals->tree.Root();
	for (const ServerView* node = root.FirstChild(); node != nullptr; node = node->Next()) {
		BMessage child;
		status_t childStatus = node->Owner()->Archive(&child, true);
		if (childStatus == B_OK)
			childStatus = archive->AddMessage("_views", &child);
		if (childStatus != B_OK)
			return childStatus;
	}
	return B_OK;
}


status_t
BWindow::Perform(perform_code code, void* argument)
{
	return BLooper::Perform(code, argument);
}
