#include "interface/private/TextInput.h"

#include <algorithm>
#include <cmath>
#include <string>

#include <Message.h>
#include <TextControl.h>
#include <Window.h>

#include "interface/private/ViewArchive.h"

namespace {

constexpr float kTextInset = 2;

} // namespace


_BTextInput_::_BTextInput_(BRect frame, BRect textRect, uint32 resizingMode, uint32 flags) :
	BTextView(frame, "_input_", textRect, resizingMode, flags)
{
	SetWordWrap(false);
}


_BTextInput_::_BTextInput_(BMessage* archive) : BTextView(archive)
{
}


_BTextInput_::~_BTextInput_() = default;


BArchivable*
_BTextInput_::Instantiate(BMessage* archive)
{
	return validate_instantiation(archive, "_BTextInput_") ? new _BTextInput_(archive) : NULL;
}


void
_BTextInput_::AttachedToWindow()
{
	BTextView::AttachedToWindow();
	if (BTextControl* control = Control())
		SetFaded(!control->IsEnabled());
}


// The window takes the focus away without asking, so the text is committed here.
void
_BTextInput_::DetachedFromWindow()
{
	if (IsFocus()) {
		if (BTextControl* control = Control())
			control->_CommitText();
	}
	BTextView::DetachedFromWindow();
}


// By the keyboard the whole text is selected; a press only places the caret.
void
_BTextInput_::MakeFocus(bool focus)
{
	const bool had = IsFocus();
	BTextView::MakeFocus(focus);
	if (IsFocus() == had)
		return;
	BTextControl* control = Control();
	if (control == NULL)
		return;
	if (IsFocus()) {
		control->fCommittedText = Text();
		if (!fPressed)
			SelectAll();
	} else {
		control->_CommitText();
	}
	control->_InputFocusChanged();
}


void
_BTextInput_::MouseDown(BPoint where)
{
	fPressed = true;
	BTextView::MouseDown(where);
	fPressed = false;
}


void
_BTextInput_::KeyDown(const char* bytes, int32 numBytes)
{
	const char key = numBytes > 0 ? bytes[0] : '\0';
	if (key == B_TAB) {
		BView::KeyDown(bytes, numBytes);
		return;
	}
	if (key == B_ENTER) {
		if (BTextControl* control = Control())
			control->_CommitText();
		SelectAll();
		return;
	}
	// One line has nowhere to go.
	if (key == B_UP_ARROW || key == B_DOWN_ARROW || key == B_PAGE_UP || key == B_PAGE_DOWN) {
		BView::KeyDown(bytes, numBytes);
		return;
	}
	BTextView::KeyDown(bytes, numBytes);
}


void
_BTextInput_::FrameResized(float width, float height)
{
	BTextView::FrameResized(width, height);
	AlignTextRect();
}


void
_BTextInput_::WindowActivated(bool active)
{
	BTextView::WindowActivated(active);
	if (BTextControl* control = Control(); control != NULL && IsFocus())
		control->_InputFocusChanged();
}


BTextControl*
_BTextInput_::Control() const
{
	return dynamic_cast<BTextControl*>(Parent());
}


void
_BTextInput_::SetFaded(bool faded)
{
	if (fFaded == faded)
		return;
	fFaded = faded;
	Invalidate();
}


void
_BTextInput_::AlignTextRect()
{
	const BRect bounds = Bounds();
	const float room = bounds.Height() + 1 - LineHeight(0);
	BRect rect(kTextInset, std::max(0.0f, std::floor(room / 2)), bounds.Width() - kTextInset, 0);
	const BRect now = TextRect();
	if (now.left == rect.left && now.top == rect.top && now.right == rect.right)
		return;
	SetTextRect(rect);
}


// Line breaks of pasted text become blanks.
void
_BTextInput_::InsertText(const char* text, int32 length, int32 offset, const text_run_array* runs)
{
	std::string line(text, std::max<int32>(0, length));
	std::replace(line.begin(), line.end(), '\n', ' ');
	BTextView::InsertText(line.data(), length, offset, runs);
	if (BTextControl* control = Control())
		control->_SendModification();
}


void
_BTextInput_::DeleteText(int32 fromOffset, int32 toOffset)
{
	BTextView::DeleteText(fromOffset, toOffset);
	if (BTextControl* control = Control())
		control->_SendModification();
}


namespace BPrivate {

// The name that newer systems write for the same class.
class _BTextInput_ {
public:
	static BArchivable* Instantiate(BMessage* archive);
};


BArchivable*
_BTextInput_::Instantiate(BMessage* archive)
{
	return validate_instantiation(archive, "_BTextInput_") ? new ::_BTextInput_(archive) : NULL;
}

} // namespace BPrivate
