#include "TextView.h"

#include <algorithm>
#include <cstring>

#include <AppDefs.h>
#include <Clipboard.h>
#include <Cursor.h>
#include <Message.h>
#include <Window.h>

#include "interface/private/TextHistory.h"
#include "interface/private/TextLayout.h"
#include "interface/private/TextViewPrivate.h"
#include "interface/private/ViewArchive.h"

using namespace BPrivate;

namespace {

constexpr rgb_color kTextColor = { 0, 0, 0, 255 };
constexpr float kDefaultTabWidth = 28;
constexpr uint32 kForcedFlags = B_FRAME_EVENTS | B_PULSE_NEEDED | B_INPUT_METHOD_AWARE;


bool
read_bool(BMessage* archive, const char* name, bool absent)
{
	bool value;
	return archive->FindBool(name, &value) == B_OK ? value : absent;
}


// What the archive's "_runs" mean for a text of that length.
TextRuns
runs_of(const BMessage& archive, int32 length, const TextStyle& fallback)
{
	const void* data;
	ssize_t size;
	if (archive.FindData("_runs", B_RAW_TYPE, &data, &size) != B_OK)
		return { { 0, fallback } };
	text_run_array* array = unflatten_runs(data, size);
	TextRuns runs = runs_from_array(array, length, fallback);
	BTextView::FreeRunArray(array);
	return runs;
}


std::vector<uint32>
disallowed_of(const BMessage& archive)
{
	std::vector<uint32> characters;
	const void* data;
	ssize_t size;
	if (archive.FindData("_dis_ch", B_RAW_TYPE, &data, &size) == B_OK) {
		characters.resize(size / sizeof(uint32));
		memcpy(characters.data(), data, characters.size() * sizeof(uint32));
	}
	return characters;
}


// Both entries, or (0, 0).
void
get_selection_of(const BMessage& archive, int32 length, int32* _start, int32* _end)
{
	if (archive.FindInt32("_sel", 0, _start) != B_OK || archive.FindInt32("_sel", 1, _end) != B_OK)
		*_start = *_end = 0;
	*_start = std::clamp<int32>(*_start, 0, length);
	*_end = std::clamp<int32>(*_end, *_start, length);
}

} // namespace


BTextView::BTextView(
	BRect frame, const char* name, BRect textRect, uint32 resizingMode, uint32 flags) :
	BView(frame, name, resizingMode, flags | kForcedFlags)
{
	_Init(textRect, nullptr, nullptr);
}


BTextView::BTextView(BRect frame, const char* name, BRect textRect, const BFont* initialFont,
	const rgb_color* initialColor, uint32 resizingMode, uint32 flags) :
	BView(frame, name, resizingMode, flags | kForcedFlags)
{
	_Init(textRect, initialFont, initialColor);
}


BTextView::BTextView(BMessage* archive) : BView(archive)
{
	_Init(BRect(0, 0, 0, 0), nullptr, nullptr);
	_ReadArchive(archive);
}


BTextView::~BTextView() = default;


BArchivable*
BTextView::Instantiate(BMessage* archive)
{
	return validate_instantiation(archive, "BTextView") ? new BTextView(archive) : NULL;
}


void
BTextView::_Init(BRect textRect, const BFont* font, const rgb_color* color)
{
	TextStyle style { font != NULL ? *font : *be_plain_font, color != NULL ? *color : kTextColor };
	if (font == NULL && is_revived(this))
		GetFont(&style.font);
	fModel = std::make_unique<TextModel>(style);
	fLayout = std::make_unique<TextLayout>(*this, *fModel);

	fTextRect = textRect;
	fContainer = NULL;
	fCaretTime = 0;
	fAnchor = fCaret = 0;
	fCaretX = -1;
	fDropPlace = -1;
	fHighlightStart = fHighlightEnd = 0;
	fMaxBytes = INT32_MAX;
	fTabWidth = kDefaultTabWidth;
	fAlignment = B_ALIGN_LEFT;
	fColorSpace = B_CMAP8;
	fCaretBehind = false;
	fCaretVisible = false;
	fActive = false;
	fStylable = false;
	fSelectable = true;
	fEditable = true;
	fWrap = true;
	fAutoindent = false;
	fResizable = false;
	fDoesUndo = true;
	fHidesTyping = false;
	fFaded = false;

	fLayout->SetTabWidth(fTabWidth);
	fLayout->SetWrapWidth(_WrapWidth());
	if (!is_revived(this))
		_TextHeightChanged();
}


// The text rectangle stays as archived until something changes.
void
BTextView::_ReadArchive(BMessage* archive)
{
	if (archive->FindRect("_trect", &fTextRect) != B_OK)
		fTextRect = BRect(0, 0, 0, 0);
	fHidesTyping = read_bool(archive, "_password", false);

	const char* text;
	if (archive->FindString("_text", &text) == B_OK)
		fModel->Insert(0, text, static_cast<int32>(strlen(text)), NULL);

	int32 number;
	fAlignment = archive->FindInt32("_align", &number) == B_OK ? alignment(number) : B_ALIGN_LEFT;
	if (archive->FindFloat("_tab", &fTabWidth) != B_OK)
		fTabWidth = kDefaultTabWidth;
	fColorSpace = archive->FindInt32("_col_sp", &number) == B_OK ? color_space(number) : B_CMAP8;
	if (archive->FindInt32("_max", &fMaxBytes) != B_OK)
		fMaxBytes = INT32_MAX;
	get_selection_of(*archive, fModel->Length(), &fAnchor, &fCaret);
	fStylable = read_bool(archive, "_stylable", false);
	fAutoindent = read_bool(archive, "_auto_in", false);
	fWrap = read_bool(archive, "_wrap", true);
	fSelectable = !read_bool(archive, "_nsel", false);
	fEditable = !read_bool(archive, "_nedit", false);
	fDisallowed = disallowed_of(*archive);
	fModel->SetRuns(0, fModel->Length(), _RunsOf(*archive));

	fLayout->SetHidden(fHidesTyping);
	fLayout->SetTabWidth(fTabWidth);
	fLayout->SetWrapWidth(_WrapWidth());
	fLayout->LayOut();
}


// A view that is not stylable gives all of its text the look of the first run.
TextRuns
BTextView::_RunsOf(const BMessage& archive) const
{
	TextStyle fallback { BFont(), kTextColor };
	GetFont(&fallback.font);
	TextRuns runs = runs_of(archive, fModel->Length(), fallback);
	if (!fStylable)
		runs.resize(1, runs.front());
	return runs;
}


status_t
BTextView::Archive(BMessage* archive, bool deep) const
{
	const status_t status = BView::Archive(archive, deep);
	if (status != B_OK)
		return status;

	ArchiveWriter writer(archive);
	writer.String("_text", Text(), "");
	writer.Int32("_align", fAlignment, B_ALIGN_LEFT);
	writer.Float("_tab", fTabWidth, kDefaultTabWidth);
	writer.Int32("_col_sp", fColorSpace, B_CMAP8);
	writer.Rect("_trect", fTextRect, BRect(0, 0, 0, 0));
	writer.Int32("_max", fMaxBytes, INT32_MAX);
	_ArchiveSelection(writer, archive);
	writer.Bool("_stylable", fStylable, false);
	writer.Bool("_auto_in", fAutoindent, false);
	writer.Bool("_wrap", fWrap, true);
	writer.Bool("_nsel", !fSelectable, false);
	writer.Bool("_nedit", !fEditable, false);
	writer.Bool("_password", fHidesTyping, false);

	if (!writer.Keep("_dis_ch", disallowed_of(writer.Source()) == fDisallowed)
		&& !fDisallowed.empty()) {
		archive->AddData(
			"_dis_ch", B_RAW_TYPE, fDisallowed.data(), fDisallowed.size() * sizeof(uint32));
	}
	if (!writer.Keep("_runs", _HasRunsOf(writer.Source()))) {
		text_run_array* runs = RunArray(0, TextLength());
		int32 size;
		void* data = FlattenRunArray(runs, &size);
		archive->AddData("_runs", B_RAW_TYPE, data, size);
		free(data);
		FreeRunArray(runs);
	}
	return writer.Status();
}


void
BTextView::_ArchiveSelection(ArchiveWriter& writer, BMessage* archive) const
{
	int32 start, end;
	get_selection_of(writer.Source(), TextLength(), &start, &end);
	if (writer.Keep("_sel", start == _Start() && end == _End()))
		return;
	archive->AddInt32("_sel", _Start());
	archive->AddInt32("_sel", _End());
}


bool
BTextView::_HasRunsOf(const BMessage& archive) const
{
	const TextRuns runs = _RunsOf(archive);
	const TextRuns& own = fModel->Runs();
	return std::equal(
		runs.begin(), runs.end(), own.begin(), own.end(), [](const TextRun& a, const TextRun& b) {
			return a.offset == b.offset && a.style == b.style;
		});
}


// #pragma mark - hooks


void
BTextView::AttachedToWindow()
{
	BView::AttachedToWindow();
	SetViewCursor(fSelectable || fEditable ? B_CURSOR_I_BEAM : B_CURSOR_SYSTEM_DEFAULT);
	if (!is_revived(this))
		_UpdateScrollBars();
}


void
BTextView::DetachedFromWindow()
{
	_SetActive(false);
	_StopTracking();
	fDropPlace = -1;
	BView::DetachedFromWindow();
}


void
BTextView::AllAttached()
{
	BView::AllAttached();
}


void
BTextView::AllDetached()
{
	BView::AllDetached();
}


void
BTextView::WindowActivated(bool active)
{
	BView::WindowActivated(active);
	_SetActive(active && IsFocus());
}


void
BTextView::MakeFocus(bool focus)
{
	BView::MakeFocus(focus);
	_SetActive(IsFocus() && Window() != NULL && Window()->IsActive());
}


// The caret shows for half of the time.
void
BTextView::Pulse()
{
	if (!_ShowsCaret() && fCaretVisible)
		return;
	if (!fActive || !fEditable || _Start() != _End())
		return;
	if (system_time() - fCaretTime < kBlinkTime)
		return;
	fCaretTime = system_time();
	fCaretVisible = !fCaretVisible;
	Invalidate(_CaretRect(fCaret));
}


void
BTextView::FrameResized(float width, float height)
{
	BView::FrameResized(width, height);
	if (!fWrap) {
		const BRect bounds = Bounds();
		const float right = bounds.Width() - fTextRect.left;
		if (fTextRect.right != right && !fResizable) {
			fTextRect.right = std::max(fTextRect.left, right);
			if (fAlignment != B_ALIGN_LEFT)
				Invalidate();
		}
	}
	_UpdateScrollBars();
	_KeepInView();
}


void
BTextView::MessageReceived(BMessage* message)
{
	if (message->WasDropped()) {
		if (AcceptsDrop(message))
			_HandleDrop(message);
		else
			BView::MessageReceived(message);
		return;
	}

	switch (message->what) {
		case B_CUT:
			Cut(be_clipboard);
			break;

		case B_COPY:
			Copy(be_clipboard);
			break;

		case B_PASTE:
			Paste(be_clipboard);
			break;

		case B_SELECT_ALL:
			SelectAll();
			break;

		case B_UNDO: {
			bool isRedo;
			if (UndoState(&isRedo) != B_UNDO_UNAVAILABLE && !isRedo)
				Undo(be_clipboard);
			break;
		}

		case B_REDO:
			Redo(be_clipboard);
			break;

		case B_INPUT_METHOD_EVENT:
			_HandleInputMethod(message);
			break;

		case kAutoScroll:
			_AutoScroll();
			break;

		case B_GET_PROPERTY:
		case B_SET_PROPERTY:
		case B_COUNT_PROPERTIES:
			if (!_HandleProperty(message))
				BView::MessageReceived(message);
			break;

		default:
			BView::MessageReceived(message);
			break;
	}
}


status_t
BTextView::Perform(perform_code code, void* data)
{
	return BView::Perform(code, data);
}
