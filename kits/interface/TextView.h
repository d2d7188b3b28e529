// BTextView: an editor for UTF-8 text in one or many fonts and colours.
#pragma once

#include <memory>
#include <string>
#include <vector>

#include <Font.h>
#include <View.h>

class BBitmap;
class BClipboard;
class BFile;
class BRegion;
class _BTextInput_;

namespace BPrivate {
class ArchiveWriter;
class TextHistory;
class TextLayout;
class TextModel;
struct TextPlace;
struct TextRun;
} // namespace BPrivate


// The look of the text from its offset (bytes) to the next run's.
struct text_run {
	int32 offset;
	BFont font;
	rgb_color color;
};

// `count` runs follow each other in memory. Arrays are made by BTextView::AllocRunArray() and
// given back with BTextView::FreeRunArray().
struct text_run_array {
	int32 count;
	text_run runs[1];
};

// What the next Undo() takes back.
enum undo_state {
	B_UNDO_UNAVAILABLE,
	B_UNDO_TYPING,
	B_UNDO_CUT,
	B_UNDO_PASTE,
	B_UNDO_CLEAR,
	B_UNDO_DROP
};


// Offsets are bytes from the start of the text and are moved to the start of the character that
// they lie in; lines are counted from 0. Coordinates are the view's. As with every view, an
// attached one is used under its window's lock only.
class BTextView : public BView {
public:
	BTextView(BRect frame, const char* name, BRect textRect, uint32 resizingMode,
		uint32 flags = B_WILL_DRAW | B_PULSE_NEEDED);
	BTextView(BRect frame, const char* name, BRect textRect, const BFont* initialFont,
		const rgb_color* initialColor, uint32 resizingMode,
		uint32 flags = B_WILL_DRAW | B_PULSE_NEEDED);
	BTextView(BMessage* archive);
	virtual ~BTextView();

	static BArchivable* Instantiate(BMessage* archive);
	virtual status_t Archive(BMessage* archive, bool deep = true) const;

	virtual void AttachedToWindow();
	virtual void DetachedFromWindow();
	virtual void AllAttached();
	virtual void AllDetached();
	virtual void Draw(BRect updateRect);
	virtual void MouseDown(BPoint where);
	virtual void MouseUp(BPoint where);
	virtual void MouseMoved(BPoint where, uint32 code, const BMessage* message);
	virtual void WindowActivated(bool active);
	virtual void KeyDown(const char* bytes, int32 numBytes);
	virtual void Pulse();
	virtual void FrameResized(float width, float height);
	virtual void MakeFocus(bool focus = true);
	virtual void MessageReceived(BMessage* message);
	virtual BHandler* ResolveSpecifier(
		BMessage* message, int32 index, BMessage* specifier, int32 form, const char* property);
	virtual status_t GetSupportedSuites(BMessage* data);
	virtual status_t Perform(perform_code code, void* data);

	// Replaces everything; the caret goes to the start. With NULL runs the text takes the look
	// that the first character had.
	void SetText(const char* text, const text_run_array* runs = NULL);
	void SetText(const char* text, int32 length, const text_run_array* runs = NULL);
	void SetText(BFile* file, int32 offset, int32 length, const text_run_array* runs = NULL);

	// Text goes in at the caret, or at the offset; the selection moves with the text around it.
	void Insert(const char* text, const text_run_array* runs = NULL);
	void Insert(const char* text, int32 length, const text_run_array* runs = NULL);
	void Insert(int32 offset, const char* text, int32 length, const text_run_array* runs = NULL);

	// The selection, or the given part.
	void Delete();
	void Delete(int32 startOffset, int32 endOffset);

	// The view's own bytes, with a final zero; valid until the text changes.
	const char* Text() const;
	int32 TextLength() const;
	// The buffer takes length + 1 bytes: a final zero is added.
	void GetText(int32 offset, int32 length, char* buffer) const;
	uchar ByteAt(int32 offset) const;

	int32 CountLines() const;
	int32 CurrentLine() const;
	void GoToLine(int32 line);

	virtual void Cut(BClipboard* clipboard);
	virtual void Copy(BClipboard* clipboard);
	virtual void Paste(BClipboard* clipboard);
	void Clear();
	virtual bool AcceptsPaste(BClipboard* clipboard);
	virtual bool AcceptsDrop(const BMessage* message);

	virtual void Select(int32 startOffset, int32 endOffset);
	void SelectAll();
	void GetSelection(int32* _start, int32* _end) const;

	// The look of the selection, or of the given part; of everything if the view is not stylable.
	void SetFontAndColor(
		const BFont* font, uint32 mode = B_FONT_ALL, const rgb_color* color = NULL);
	void SetFontAndColor(int32 startOffset, int32 endOffset, const BFont* font,
		uint32 mode = B_FONT_ALL, const rgb_color* color = NULL);
	void GetFontAndColor(int32 offset, BFont* _font, rgb_color* _color = NULL) const;
	// *_mode gets the font bits that are the same all over the selection.
	void GetFontAndColor(
		BFont* _font, uint32* _mode, rgb_color* _color = NULL, bool* _sameColor = NULL) const;
	void SetRunArray(int32 startOffset, int32 endOffset, const text_run_array* runs);
	// The caller frees it with FreeRunArray().
	text_run_array* RunArray(int32 startOffset, int32 endOffset, int32* _size = NULL) const;

	int32 LineAt(int32 offset) const;
	int32 LineAt(BPoint point) const;
	// The left top of the character's place; *_height gets the height of its line.
	BPoint PointAt(int32 offset, float* _height = NULL) const;
	int32 OffsetAt(BPoint point) const;
	int32 OffsetAt(int32 line) const;

	virtual void FindWord(int32 offset, int32* _fromOffset, int32* _toOffset);
	// Whether a line may be broken after the character at the offset.
	virtual bool CanEndLine(int32 offset);

	float LineWidth(int32 line = 0) const;
	float LineHeight(int32 line = 0) const;
	float TextHeight(int32 startLine, int32 endLine) const;
	void GetTextRegion(int32 startOffset, int32 endOffset, BRegion* _region) const;

	virtual void ScrollToOffset(int32 offset);
	void ScrollToSelection();

	void Highlight(int32 startOffset, int32 endOffset);

	void SetTextRect(BRect rect);
	BRect TextRect() const;

	void SetStylable(bool stylable);
	bool IsStylable() const;
	void SetTabWidth(float width);
	float TabWidth() const;
	void MakeSelectable(bool selectable = true);
	bool IsSelectable() const;
	void MakeEditable(bool editable = true);
	bool IsEditable() const;
	void SetWordWrap(bool wrap);
	bool DoesWordWrap() const;
	// Insertions stop at that many bytes.
	void SetMaxBytes(int32 max);
	int32 MaxBytes() const;
	void DisallowChar(uint32 character);
	void AllowChar(uint32 character);
	void SetAlignment(alignment flag);
	alignment Alignment() const;
	void SetAutoindent(bool autoindent);
	bool DoesAutoindent() const;
	void SetColorSpace(color_space colors);
	color_space ColorSpace() const;
	// The view, or the container that it lies in, grows and shrinks with the text from now on.
	void MakeResizable(bool resize, BView* resizeView = NULL);
	bool IsResizable() const;
	void SetDoesUndo(bool undo);
	bool DoesUndo() const;
	void HideTyping(bool enabled);
	bool IsTypingHidden() const;

	virtual void ResizeToPreferred();
	virtual void GetPreferredSize(float* _width, float* _height);

	// Takes back the last step; where there is none, does again what was taken back last.
	virtual void Undo(BClipboard* clipboard);
	virtual void Redo(BClipboard* clipboard);
	undo_state UndoState(bool* _isRedo) const;

	static text_run_array* AllocRunArray(int32 entryCount, int32* _size = NULL);
	static text_run_array* CopyRunArray(const text_run_array* other, int32 countDelta = 0);
	static void FreeRunArray(text_run_array* array);
	// The result of both is the caller's: free() the first, FreeRunArray() the second.
	static void* FlattenRunArray(const text_run_array* runs, int32* _size = NULL);
	static text_run_array* UnflattenRunArray(const void* data, int32* _size = NULL);

protected:
	// Every change of the text, whoever asked for it, comes through these two.
	virtual void InsertText(
		const char* text, int32 length, int32 offset, const text_run_array* runs);
	virtual void DeleteText(int32 fromOffset, int32 toOffset);

	// The bitmap and the handler may stay NULL: an outline, and this view, are taken then.
	virtual void GetDragParameters(
		BMessage* drag, BBitmap** _bitmap, BPoint* _point, BHandler** _handler);

private:
	friend class _BTextInput_;
	struct Composition;
	struct Tracking;

	void _Init(BRect textRect, const BFont* font, const rgb_color* color);
	void _ReadArchive(BMessage* archive);
	std::vector<BPrivate::TextRun> _RunsOf(const BMessage& archive) const;
	bool _HasRunsOf(const BMessage& archive) const;
	void _ArchiveSelection(BPrivate::ArchiveWriter& writer, BMessage* archive) const;

	// Text and runs
	int32 _Clamp(int32 offset) const;
	int32 _InsertLimited(int32 offset, const char* text, int32 length, const text_run_array* runs);
	void _Edit(undo_state kind, int32 from, int32 to, const char* text, int32 length,
		const text_run_array* runs);
	void _TextChanged(int32 offset, int32 removed, int32 inserted);
	void _StyleChanged(int32 from, int32 to);
	void _ApplyStep(bool undo);

	// Layout
	void _LayOutAgain();
	void _TextHeightChanged();
	void _FitToText();
	float _ContentWidth() const;
	float _ContentHeight() const;
	void _UpdateScrollBars();
	void _KeepInView();
	float _WrapWidth() const;
	float _LineLeft(int32 line) const;
	BRect _ExtentOf(int32 offset) const;
	void _AddSpans(int32 line, int32 from, int32 to, BRegion* region) const;
	void _InvalidateLines(int32 from, int32 to);
	void _InvalidateRange(int32 from, int32 to);

	// Selection and caret
	int32 _Start() const { return fAnchor < fCaret ? fAnchor : fCaret; }
	int32 _End() const { return fAnchor < fCaret ? fCaret : fAnchor; }
	void _SetSelection(int32 anchor, int32 caret, bool isBehind = false);
	void _SetCaretBehind(bool isBehind);
	BPrivate::TextPlace _CaretPlace() const;
	BPrivate::TextPlace _PlaceAt(BPoint point) const;
	BPrivate::TextPlace _PlaceBesideCaret(bool toRight, bool extend, bool byWord) const;
	void _MoveCaret(BPrivate::TextPlace to, bool extend);
	void _MoveByLines(int32 lines, bool extend);
	int32 _WordEdge(int32 from, bool forward) const;
	void _SetActive(bool active);
	void _RestartBlinking();
	BRect _CaretRect(int32 offset) const;
	bool _ShowsCaret() const;
	bool _ShowsSelection() const;

	// Keys
	bool _HandleNavigation(char key, uint32 modifiers);
	void _HandleErasing(bool forward, bool word);
	void _HandleEnter();
	void _HandleTyping(const char* bytes, int32 numBytes);
	bool _ScrollByKey(char key);
	bool _IsAllowed(uint32 character) const;
	std::string _Allowed(const char* text, int32 length) const;

	// Mouse and drags
	void _SelectAround(int32 offset, int32 clicks, int32* _from, int32* _to);
	void _TrackTo(BPoint where);
	void _AutoScroll();
	void _StopTracking();
	void _BeginDrag();
	void _ShowDropPlace(int32 offset);
	void _HandleDrop(BMessage* message);
	void _UpdateCursor(BPoint where);
	void _HandleInputMethod(BMessage* message);
	void _Compose(BMessage* message);
	void _RemoveComposed();
	void _EndComposition(bool keepText);
	void _SendCompositionPlaces();
	void _AddToMessage(BMessage* data, int32 from, int32 to) const;
	bool _InsertFrom(const BMessage* data, undo_state kind, int32 offset);

	// Drawing
	void _DrawLine(int32 line, BRect updateRect);
	void _InvertRange(int32 from, int32 to, BRect updateRect);
	void _DrawComposition(BRect updateRect);
	bool _HandleProperty(BMessage* message);
	status_t _HandleSelectionProperty(BMessage* message, BMessage* reply);
	status_t _HandleTextProperty(
		BMessage* message, const BMessage& specifier, int32 form, BMessage* reply);

	std::unique_ptr<BPrivate::TextModel> fModel;
	std::unique_ptr<BPrivate::TextLayout> fLayout;
	std::unique_ptr<BPrivate::TextHistory> fHistory; // NULL until there is something to remember
	std::unique_ptr<Composition> fComposition; // of an input method; NULL at rest
	std::unique_ptr<Tracking> fTracking; // the press that is being followed
	std::vector<uint32> fDisallowed; // in the order they were disallowed

	BRect fTextRect;
	BView* fContainer; // borrowed; grows with the text instead of this view
	bigtime_t fCaretTime;
	int32 fAnchor; // where the selection was begun
	int32 fCaret; // where it ends now
	float fCaretX; // what moves up and down keep to; negative when unset
	int32 fDropPlace; // -1 without a drag over the view
	int32 fHighlightStart;
	int32 fHighlightEnd;
	int32 fMaxBytes;
	float fTabWidth;
	alignment fAlignment;
	color_space fColorSpace;
	bool fCaretBehind; // at the character before it, where letters run both ways
	bool fCaretVisible; // the phase of its blinking
	bool fActive; // has the focus, in an active window
	bool fStylable;
	bool fSelectable;
	bool fEditable;
	bool fWrap;
	bool fAutoindent;
	bool fResizable;
	bool fDoesUndo;
	bool fHidesTyping;
	bool fFaded; // as the text of a disabled control
};
