// Archiving and reviving of views.
#include <View.h>

#include <cmath>

#include <Message.h>

#include "app/private/MessagePrivate.h"
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

constexpr int32 kColors = 3; // high, low, view
constexpr int32 kMaxEntry = (1 << 23) - 2;


// What the fields of a view say, by the rules for missing and strange ones.
struct ReadState {
	BRect frame { 0, 0, -1, -1 };
	uint32 mode = 0;
	uint32 flags = 0;
	uint32 eventMask = 0;
	uint32 eventOptions = 0;
	rgb_color colors[kColors] = { { 0, 0, 0, 255 }, { 255, 255, 255, 255 },
		{ 255, 255, 255, 255 } };
	int16 hideCount = 0;
	DrawState draw;
};


uint32
packed(rgb_color color)
{
	return static_cast<uint32>(color.red) << 24 | static_cast<uint32>(color.green) << 16
		| static_cast<uint32>(color.blue) << 8 | color.alpha;
}


rgb_color
unpacked(uint32 value)
{
	return { static_cast<uint8>(value >> 24), static_cast<uint8>(value >> 16),
		static_cast<uint8>(value >> 8), static_cast<uint8>(value) };
}


void
read_font(const BMessage& archive, FontSpec* _font)
{
	const char* family;
	const char* style;
	if (archive.FindString("_fname", 0, &family) == B_OK
		&& archive.FindString("_fname", 1, &style) == B_OK) {
		// A family that is not installed does not lose the style: what was bold stays bold.
		BFont font;
		if (font.SetFamilyAndStyle(family, style) == B_OK
			|| font.SetFamilyAndStyle(NULL, style) == B_OK) {
			const FontSpec spec = ToFontSpec(font);
			_font->familyAndStyle = spec.familyAndStyle;
			_font->face = spec.face;
		}
	}
	float value;
	if (archive.FindFloat("_fflt", 0, &value) == B_OK && value > 0)
		_font->size = value;
	if (archive.FindFloat("_fflt", 1, &value) == B_OK && value >= 45 && value <= 135)
		_font->shear = value;
	if (archive.FindFloat("_fflt", 2, &value) == B_OK && value >= 0 && value <= 360)
		_font->rotation = value;
}


void
read_colors(const BMessage& archive, rgb_color colors[kColors])
{
	for (int32 i = 0; i < kColors; i++) {
		int32 value;
		if (archive.FindInt32("_color", i, &value) == B_OK)
			colors[i] = unpacked(value);
		int32 which;
		if (archive.FindInt32("_uicolor", i, &which) == B_OK && which != B_NO_COLOR) {
			float tint;
			if (archive.FindFloat("_uitint", i, &tint) != B_OK)
				tint = B_NO_TINT;
			colors[i] = tint_color(ui_color(static_cast<color_which>(which)), tint);
		}
	}
}


void
read_modes(const BMessage& archive, DrawState* _draw)
{
	_draw->origin = archive.GetPoint("_origin", _draw->origin);
	_draw->scale = archive.GetFloat("_scale", _draw->scale);
	_draw->penSize = archive.GetFloat("_psize", _draw->penSize);
	_draw->penLocation = archive.GetPoint("_ploc", _draw->penLocation);

	int16 cap, join, source, function;
	float miter;
	if (archive.FindInt16("_lmcapjoin", 0, &cap) == B_OK
		&& archive.FindInt16("_lmcapjoin", 1, &join) == B_OK
		&& archive.FindFloat("_lmmiter", &miter) == B_OK) {
		_draw->lineCap = static_cast<cap_mode>(cap);
		_draw->lineJoin = static_cast<join_mode>(join);
		_draw->miterLimit = miter;
	}
	if (archive.FindInt16("_blend", 0, &source) == B_OK
		&& archive.FindInt16("_blend", 1, &function) == B_OK) {
		_draw->sourceAlpha = static_cast<source_alpha>(source);
		_draw->alphaFunction = static_cast<alpha_function>(function);
	}
	_draw->mode = static_cast<drawing_mode>(archive.GetInt32("_dmod", _draw->mode));
	_draw->combinedOrigin = _draw->origin;
	_draw->combinedScale = _draw->scale;
}


ReadState
read_state(const BMessage& archive)
{
	ReadState state;
	const BRect frame = archive.GetRect("_frame", state.frame);
	state.frame.Set(std::round(frame.left), std::round(frame.top), std::round(frame.right),
		std::round(frame.bottom));
	state.mode = static_cast<uint32>(archive.GetInt32("_resize_mode", 0)) & _RESIZE_MASK_;
	state.flags = static_cast<uint32>(archive.GetInt32("_flags", 0)) & ~_RESIZE_MASK_;
	int32 mask, options;
	if (archive.FindInt32("_evmask", 0, &mask) == B_OK
		&& archive.FindInt32("_evmask", 1, &options) == B_OK) {
		state.eventMask = mask;
		state.eventOptions = options;
	}
	read_font(archive, &state.draw.font);
	read_colors(archive, state.colors);
	state.draw.highColor = state.colors[0];
	state.draw.lowColor = state.colors[1];
	read_modes(archive, &state.draw);
	state.hideCount = archive.GetInt16("_show", 0);
	return state;
}


bool
same_font(const FontSpec& a, const FontSpec& b)
{
	return a.familyAndStyle == b.familyAndStyle && a.size == b.size && a.shear == b.shear
		&& a.rotation == b.rotation;
}


bool
is_default(const DrawState& draw)
{
	const DrawState usual;
	return draw.highColor == usual.highColor && draw.lowColor == usual.lowColor
		&& draw.mode == usual.mode && draw.sourceAlpha == usual.sourceAlpha
		&& draw.alphaFunction == usual.alphaFunction && draw.penSize == usual.penSize
		&& draw.lineCap == usual.lineCap && draw.lineJoin == usual.lineJoin
		&& draw.miterLimit == usual.miterLimit && draw.penLocation == usual.penLocation
		&& draw.origin == usual.origin && draw.scale == usual.scale && draw.font == usual.font;
}


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

	const ReadState state = read_state(*archive);
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
	const ReadState read = read_state(writer.Source());
	const BRect frame = Frame();
	if (!writer.Keep("_frame", frame == read.frame))
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

	const rgb_color colors[kColors] = { draw.highColor, draw.lowColor, fNode->Color() };
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
	for (int32 i = 0; i < kColors; i++) {
		int32 value;
		const bool keeps = now[i] == read[i] && source.FindInt32("_color", i, &value) == B_OK;
		archive->AddInt32("_color", keeps ? value : static_cast<int32>(packed(now[i])));
	}
	int32 which;
	if (source.FindInt32("_uicolor", &which) == B_OK) {
		writer.Keep("_uicolor", false);
		for (int32 i = 0; i < kColors; i++) {
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
	if (!writer.Keep("_origin", now.origin == read.origin) && touched(kTouchedOrigin))
		archive->AddPoint("_origin", now.origin);
	if (!writer.Keep("_scale", now.scale == read.scale) && touched(kTouchedScale))
		archive->AddFloat("_scale", now.scale);
	if (!writer.Keep("_psize", now.penSize == read.penSize) && touched(kTouchedPenSize))
		archive->AddFloat("_psize", now.penSize);
	// Drawing moves the pen too, but that is nothing to remember.
	const bool samePen = now.penLocation == read.penLocation || !touched(kTouchedPenLocation);
	if (!writer.Keep("_ploc", samePen) && touched(kTouchedPenLocation))
		archive->AddPoint("_ploc", now.penLocation);

	const bool sameLine = now.lineCap == read.lineCap && now.lineJoin == read.lineJoin
		&& now.miterLimit == read.miterLimit;
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
