// Archiving and reviving of views.
#include <View.h>

#include <cmath>

#include <Message.h>

#include "app/private/MessagePrivate.h"
#include "interface/private/ArchivedState.h"
#include "interface/private/FontAccess.h"
#include "interface/private/StandInView.h"
#include "interface/private/ViewArchive.h"
#include "interface/private/ViewPrivate.h"
#include "interface/private/ViewState.h"
#include "server/ServerView.h"
#include "support/private/ManagedArchive.h"

using namespace BPrivate;

namespace {

// The view whose archive goes into its parent's. A view that is archived in any other way (a
// submenu by its item) is a root by itself, wherever that happens.
thread_local const BView* sArchivedAsChild = nullptr;

constexpr int32 kMaxEntry = (1 << 23) - 2;


bool
same_message(const BMessage& a, const BMessage& b)
{
	return a.what == b.what
		&& (MessagePrivate(&a).SharesDataWith(b) || a.HasSameData(b, false, true));
}


// Whether none of these entries of "_views" can be read.
bool
has_no_message(const BMessage& archive, int32 from, int32 to)
{
	BMessage read;
	for (int32 i = from; i < to; i++) {
		if (archive.FindMessage("_views", i, &read) == B_OK)
			return false;
	}
	return true;
}


// The last step of the outermost view. A child of a managed archive that is archived by itself is
// nested like any other.
status_t
finish_archive(BMessage* archive)
{
	if (!is_managed_root(*archive)) {
		clear_managed_note(archive);
		return B_OK;
	}
	return manage_archive(archive);
}

} // namespace


namespace BPrivate {


ArchiveScope::ArchiveScope(const BView* view, BMessage* archive) :
	fArchive(archive), fIsRoot(sArchivedAsChild != view)
{
	sArchivedAsChild = view;
}


status_t
ArchiveScope::Finish()
{
	return fIsRoot ? finish_archive(fArchive) : B_OK;
}


status_t
archive_as_child(const BView* view, BMessage* archive)
{
	sArchivedAsChild = view;
	const status_t status = view->Archive(archive, true);
	sArchivedAsChild = nullptr;
	return status;
}


void
force_flags(BView* view, uint32 add, uint32 remove)
{
	ViewPrivate(view).ForceWord((view->Flags() | add) & ~remove, view->ResizingMode());
}


void
force_resizing_mode(BView* view, uint32 mode)
{
	ViewPrivate(view).ForceWord(view->Flags(), mode);
}


void
ViewPrivate::ForceWord(uint32 flags, uint32 mode)
{
	// The bits that others have changed since stay changes.
	const uint32 word = flags | (mode & _RESIZE_MASK_);
	fView->fRevivedWord ^= fView->fNode->Word() ^ word;
	fView->fNode->SetWord(word);
}


} // namespace BPrivate


BView::BView(BMessage* archive) :
	BHandler(archive), fNode(new ServerView(this, BRect(), 0)), fOwner(nullptr), fState(nullptr),
	fExtras(nullptr), fSource(nullptr), fTouched(0), fEntry(0), fRevivedWord(0)
{
	if (archive != nullptr)
		_InitFromArchive(archive);
}


BArchivable*
BView::Instantiate(BMessage* archive)
{
	return validate_instantiation(archive, "BView") ? new BView(archive) : nullptr;
}


void
BView::_InitFromArchive(BMessage* archive)
{
	BMessage nested;
	if (is_managed_archive(*archive)) {
		nested = *archive;
		unmanage_archive(&nested);
		archive = &nested;
	}
	fSource = new ArchiveSource(archive);
	for (const char* name : { "class", "_name", "_views" })
		fSource->SetKnown(name);

	const ArchivedState state = read_archived_state(*archive);
	fNode->SetFrame(state.frame);
	fNode->SetWord(state.flags | state.mode);
	fRevivedWord = fNode->Word();
	fNode->SetColor(state.colors[2]);
	fNode->SetHideCount(state.hideCount);
	if (!is_default(state.draw))
		_State()->draw = state.draw;
	if (state.eventMask != 0 || state.eventOptions != 0) {
		_Extras()->eventMask = state.eventMask;
		_Extras()->eventOptions = state.eventOptions;
	}

	int32 count = 0;
	archive->GetInfo("_views", nullptr, &count);
	for (int32 i = 0; i < count; i++) {
		BMessage child;
		if (archive->FindMessage("_views", i, &child) != B_OK)
			continue;
		BArchivable* object = instantiate_object(&child);
		BView* view = dynamic_cast<BView*>(object);
		if (view == nullptr) {
			delete object;
			view = new StandInView(&child);
		}
		AddChild(view);
		if (i < kMaxEntry)
			view->fEntry = i + 1;
	}
}


status_t
BView::Archive(BMessage* archive, bool deep) const
{
	const bool isRoot = sArchivedAsChild != this;
	sArchivedAsChild = nullptr;
	begin_archive(fSource, archive);
	status_t status = BHandler::Archive(archive, deep);
	if (status != B_OK)
		return status;
	ArchiveWriter writer(archive);
	writer.KeepClass(dynamic_cast<const StandInView*>(this) != nullptr);
	// BHandler has written the name; one that was read stays as it was.
	writer.KeepName(Name());
	status = writer.Status();
	if (status == B_OK)
		status = _ArchiveOwnFields(archive);
	if (status == B_OK && deep)
		status = _ArchiveChildren(archive);
	if (status != B_OK)
		return status;

	return isRoot ? finish_archive(archive) : B_OK;
}


status_t
BView::_ArchiveOwnFields(BMessage* archive) const
{
	ArchiveWriter writer(archive);
	const ArchivedState read = read_archived_state(writer.Source());
	const BRect frame = Frame();
	if (!writer.Keep("_frame", same_value(frame, read.frame)))
		archive->AddRect("_frame", frame);
	const uint32 changed = fNode->Word() ^ fRevivedWord;
	if (!writer.Keep("_resize_mode", (changed & _RESIZE_MASK_) == 0))
		archive->AddInt32("_resize_mode", ResizingMode());
	if (!writer.Keep("_flags", (changed & ~_RESIZE_MASK_) == 0))
		archive->AddInt32("_flags", Flags());

	const uint32 mask = fExtras != nullptr ? fExtras->eventMask : 0;
	const uint32 options = fExtras != nullptr ? fExtras->eventOptions : 0;
	const bool sameMask = mask == read.eventMask && options == read.eventOptions;
	if (!writer.Keep("_evmask", sameMask) && (fTouched & kTouchedEventMask) != 0) {
		archive->AddInt32("_evmask", mask);
		archive->AddInt32("_evmask", options);
	}

	const DrawState& draw = _BottomState();
	const bool sameFont = same_font(draw.font, read.draw.font);
	const bool keptName = writer.Keep("_fname", sameFont);
	const bool keptSizes = writer.Keep("_fflt", sameFont);
	if (!keptName && !keptSizes && (fTouched & kTouchedFont) != 0) {
		BFont font;
		if (draw.font.familyAndStyle != 0)
			font.SetFamilyAndStyle(draw.font.familyAndStyle);
		font_family family;
		font_style style;
		font.GetFamilyAndStyle(&family, &style);
		archive->AddString("_fname", family);
		archive->AddString("_fname", style);
		archive->AddFloat("_fflt", draw.font.size);
		archive->AddFloat("_fflt", draw.font.shear);
		archive->AddFloat("_fflt", draw.font.rotation);
	}

	const rgb_color colors[ArchivedState::kColors] = { draw.highColor, draw.lowColor,
		fNode->Color() };
	_ArchiveColors(archive, colors, read.colors);
	_ArchiveModes(archive, draw, read.draw);
	const int16 hideCount = fNode->HideCount();
	if (!writer.Keep("_show", hideCount == read.hideCount) && hideCount != 0)
		archive->AddInt16("_show", hideCount);
	return writer.Status();
}


// A colour that follows the interface's (by "_uicolor") does so until it is set.
void
BView::_ArchiveColors(BMessage* archive, const rgb_color now[], const rgb_color read[]) const
{
	ArchiveWriter writer(archive);
	const bool unchanged = now[0] == read[0] && now[1] == read[1] && now[2] == read[2];
	if (writer.Keep("_color", unchanged)) {
		writer.Keep("_uicolor", true);
		writer.Keep("_uitint", true);
		return;
	}
	const BMessage& source = writer.Source();
	for (int32 i = 0; i < ArchivedState::kColors; i++) {
		int32 value;
		const bool keeps = now[i] == read[i] && source.FindInt32("_color", i, &value) == B_OK;
		archive->AddInt32("_color", keeps ? value : static_cast<int32>(packed(now[i])));
	}
	int32 which;
	if (source.FindInt32("_uicolor", &which) == B_OK) {
		writer.Keep("_uicolor", false);
		for (int32 i = 0; i < ArchivedState::kColors; i++) {
			if (now[i] != read[i] || source.FindInt32("_uicolor", i, &which) != B_OK)
				which = B_NO_COLOR;
			archive->AddInt32("_uicolor", which);
		}
	}
	writer.Keep("_uitint", !source.IsEmpty());
}


void
BView::_ArchiveModes(BMessage* archive, const DrawState& now, const DrawState& read) const
{
	ArchiveWriter writer(archive);
	const auto touched = [this](uint32 bit) { return (fTouched & bit) != 0; };
	if (!writer.Keep("_origin", same_value(now.origin, read.origin)) && touched(kTouchedOrigin))
		archive->AddPoint("_origin", now.origin);
	if (!writer.Keep("_scale", same_value(now.scale, read.scale)) && touched(kTouchedScale))
		archive->AddFloat("_scale", now.scale);
	if (!writer.Keep("_psize", same_value(now.penSize, read.penSize)) && touched(kTouchedPenSize))
		archive->AddFloat("_psize", now.penSize);
	// Drawing moves the pen too, but that is nothing to remember.
	const bool samePen =
		same_value(now.penLocation, read.penLocation) || !touched(kTouchedPenLocation);
	if (!writer.Keep("_ploc", samePen) && touched(kTouchedPenLocation))
		archive->AddPoint("_ploc", now.penLocation);

	const bool sameLine = now.lineCap == read.lineCap && now.lineJoin == read.lineJoin
		&& same_value(now.miterLimit, read.miterLimit);
	const bool keptMode = writer.Keep("_lmcapjoin", sameLine);
	const bool keptMiter = writer.Keep("_lmmiter", sameLine);
	if (!keptMode && !keptMiter && touched(kTouchedLineMode)) {
		archive->AddInt16("_lmcapjoin", now.lineCap);
		archive->AddInt16("_lmcapjoin", now.lineJoin);
		archive->AddFloat("_lmmiter", now.miterLimit);
	}
	const bool sameBlend =
		now.sourceAlpha == read.sourceAlpha && now.alphaFunction == read.alphaFunction;
	if (!writer.Keep("_blend", sameBlend) && touched(kTouchedBlending)) {
		archive->AddInt16("_blend", now.sourceAlpha);
		archive->AddInt16("_blend", now.alphaFunction);
	}
	if (!writer.Keep("_dmod", now.mode == read.mode) && touched(kTouchedDrawingMode))
		archive->AddInt32("_dmod", now.mode);
}


// Replaces the child's archive by the next entry that is a message, if it says the same.
bool
BView::_TakeEntry(const BMessage& source, int32 count, int32* _entry, BMessage* _child)
{
	BMessage read;
	while (*_entry < count && source.FindMessage("_views", *_entry, &read) != B_OK)
		(*_entry)++;
	if (*_entry >= count || !same_message(*_child, read))
		return false;
	*_child = read;
	return true;
}


// A child that archives to what it was read from is the same message again, so that nothing is
// copied, and the comparison one level up is short.
status_t
BView::_ArchiveChildren(BMessage* archive) const
{
	ArchiveWriter writer(archive);
	const BMessage& source = writer.Source();
	int32 count = 0;
	source.GetInfo("_views", nullptr, &count);
	int32 entry = 0;
	bool unchanged = true;
	status_t status = B_OK;
	std::vector<BMessage> children;
	children.reserve(CountChildren());
	for (const ServerView* node = fNode->FirstChild(); node != nullptr && status == B_OK;
		 node = node->Next()) {
		const BView* view = node->Owner();
		BMessage child;
		sArchivedAsChild = view;
		status = view->Archive(&child, true);
		// Where it was read from this view's archive, it need not be compared with all of that.
		const int32 readFrom = static_cast<int32>(view->fEntry) - 1;
		BMessage read;
		if (readFrom >= entry && readFrom < count && is_as_read(child))
			read = view->fSource->Archive();
		if (!read.IsEmpty() && read.what == child.what) {
			unchanged = unchanged && has_no_message(source, entry, readFrom);
			entry = readFrom;
			child = std::move(read);
		} else if (!_TakeEntry(source, count, &entry, &child))
			unchanged = false;
		entry++;
		children.push_back(std::move(child));
	}
	if (status != B_OK)
		return status;
	// Entries that are no messages count for nothing, but stay while the rest does.
	unchanged = unchanged && has_no_message(source, entry, count);
	if (writer.Keep("_views", unchanged))
		return writer.Status();
	for (const BMessage& child : children) {
		status = archive->AddMessage("_views", &child);
		if (status != B_OK)
			return status;
	}
	return B_OK;
}
