// BTextView: an editor for UTF-8 text in one or many fonts and colours.
#pragma once

#include <memory>

#include <Font.h>
#include <View.h>

class BBitmap;
class BClipboard;
class BFile;
class BRegion;

namespace BPrivate {
class TextHistory;
class TextLayout;
class TextModel;
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
	friend class BPrivate::TextLayout;
	struct Input;
	struct Tracking;

	void _Init(BRect textRect, const BFont* font, const rgb_color* color);
	void _InitFromArchive(BMessage* archive);

	bool _CanEdit() const;
	bool _Replace(int32 from, int32 to, const char* text, int32 length, const text_run_array* runs,
		undo_state kind);
	void _TextChanged(int32 offset, int32 removed, int32 inserted);
	void _UpdateLayout();
	void _InvalidateLines(int32 from, int32 to, float oldHeight);
	void _InvalidateText(int32 from, int32 to);
	void _RecalculateAll();
	void _AdjustSize();
	void _UpdateScrollBars();
	BRect _LayoutRect() const;
	float _LineLeft(int32 line) const;
	BPoint _PlaceOf(int32 offset, float* _height) const;

	void _SetSelection(int32 anchor, int32 caret, bool scroll);
	void _ShowCaret();
	void _HideCaret();
	BRect _CaretRect() const;
	bool _HasActiveFocus() const;
	void _ExtendSelection(int32 to);
	void _MoveCaret(int32 to, bool extend);
	void _MoveVertically(int32 lines, bool extend);
	int32 _WordEdge(int32 from, bool forward) const;

	void _HandleArrow(char key, uint32 modifiers);
	void _HandleHomeEndPage(char key, uint32 modifiers);
	void _HandleBackspace(bool word);
	void _HandleDelete(bool word);
	void _HandleText(const char* bytes, int32 numBytes);
	bool _IsAllowed(uint32 character) const;
	bool _FilterInsertion(const char*& text, int32& length, std::unique_ptr<char[]>& storage) const;

	void _TrackPress(BPoint where);
	void _BeginDrag(BPoint where);
	void _HandleDrop(BMessage* message);
	void _ShowDropCaret(BPoint where);
	void _HideDropCaret();
	void _SelectAround(int32 offset, int32 clicks, int32* _from, int32* _to);
	void _HandleInputMethod(BMessage* message);
	void _ConfirmInput();
	void _UpdateCursor(BPoint where);
	void _AddShortcuts();
	void _RemoveShortcuts();
	void _ApplyStep(bool undo);
	void _DrawLine(int32 line, BRect updateRect);
	void _DrawSelection(BRect updateRect);
	void _AddToClipboard(BMessage* data, int32 from, int32 to) const;

	std::unique_ptr<BPrivate::TextModel> fModel;
	std::unique_ptr<BPrivate::TextLayout> fLayout;
	std::unique_ptr<BPrivate::TextHistory> fHistory;
	std::unique_ptr<Input> fInput; // what an input method composes; NULL at rest
	std::unique_ptr<Tracking> fTracking; // the press that is being followed; NULL without one

	BRect fTextRect; // its bottom follows the text
	int32 fAnchor; // where the selection was begun
	int32 fCaret; // where it ends now
	float fCaretX; // the column that vertical moves keep; negative when unset
	int32 fDropOffset;
	bigtime_t fCaretTime;
	float fTabWidth;
	alignment fAlignment;
	color_space fColorSpace;
	int32 fMaxBytes;
	std::unique_ptr<BList> fDisallowed; // characters, in the order they were disallowed
	BView* fContainer; // borrowed; grows instead of this view
	bool fCaretShown;
	bool fActive; // focus in an active window
	bool fStylable;
	bool fSelectable;
	bool fEditable;
	bool fWrap;
	bool fAutoindent;
	bool fResizable;
	bool fPassword;
	bool fShortcutsAdded;
	bool fRevived; // sizes stay as archived until a setter or the user changes something
};
