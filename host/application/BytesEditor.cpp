#include "host/application/BytesEditor.h"

#include <cstdio>
#include <string_view>

#include <Font.h>
#include <Message.h>
#include <ScrollView.h>
#include <StringView.h>
#include <TextView.h>

using namespace BResEditor;

namespace {


constexpr size_t kMaxShownBytes = 64 * 1024;
constexpr int kBytesPerLine = 16;
constexpr float kWidth = 560;
constexpr float kHeight = 320;
constexpr float kNoteHeight = 24;
constexpr float kScrollBarSize = 14;
constexpr rgb_color kPanelColor = { 216, 216, 216, 255 };


// The length of the UTF-8 character at the start of the text, 0 when it is none.
size_t
CharacterLength(std::string_view text)
{
	const uint8 first = static_cast<uint8>(text[0]);
	const size_t length = first < 0x80 ? 1
		: first < 0xc2                 ? 0
		: first < 0xe0                 ? 2
		: first < 0xf0                 ? 3
		: first < 0xf5                 ? 4
									   : 0;
	if (length > text.size())
		return 0;
	for (size_t i = 1; i < length; i++) {
		if ((static_cast<uint8>(text[i]) & 0xc0) != 0x80)
			return 0;
	}
	return length;
}


bool
IsText(std::string_view text)
{
	while (!text.empty()) {
		const uint8 first = static_cast<uint8>(text[0]);
		const size_t length = CharacterLength(text);
		if (length == 0 || (first < 0x20 && first != '\n' && first != '\t' && first != '\r'))
			return false;
		text.remove_prefix(length);
	}
	return true;
}


std::string
HexTable(std::string_view bytes)
{
	std::string table;
	const std::string_view shown = bytes.substr(0, kMaxShownBytes);
	for (size_t start = 0; start < shown.size(); start += kBytesPerLine) {
		char field[24];
		snprintf(field, sizeof(field), "%06zx  ", start);
		table += field;
		std::string characters;
		for (size_t i = start; i < start + kBytesPerLine; i++) {
			if (i >= shown.size()) {
				table += "   ";
				continue;
			}
			const uint8 byte = static_cast<uint8>(shown[i]);
			snprintf(field, sizeof(field), "%02x ", byte);
			table += field;
			characters += byte >= 0x20 && byte < 0x7f ? static_cast<char>(byte) : '.';
		}
		table += " " + characters + "\n";
	}
	if (bytes.size() > shown.size())
		table += "... and " + std::to_string(bytes.size() - shown.size()) + " bytes more\n";
	return table;
}


} // namespace


BytesEditor::BytesEditor(
	const BResourceAddonArgs& args, BResourceHandle handle, const std::string& note) :
	BFullItemEditor(args, handle, static_cast<BView*>(this)),
	BView(BRect(0, 0, kWidth, kHeight), "BytesEditor", B_FOLLOW_ALL_SIDES, B_WILL_DRAW),
	fIsText(false), fHadFinalZero(false)
{
	SetViewColor(kPanelColor);

	BRect frame = Bounds();
	if (!note.empty()) {
		BRect noteFrame = frame;
		noteFrame.bottom = noteFrame.top + kNoteHeight - 1;
		noteFrame.InsetBy(6, 4);
		AddChild(
			new BStringView(noteFrame, "note", note.c_str(), B_FOLLOW_LEFT_RIGHT | B_FOLLOW_TOP));
		frame.top += kNoteHeight;
	}

	frame.InsetBy(2, 2);
	frame.right -= kScrollBarSize;
	fTextView = new BTextView(frame, "bytes", frame.OffsetToCopy(0, 0).InsetByCopy(4, 4),
		B_FOLLOW_ALL_SIDES, B_WILL_DRAW | B_PULSE_NEEDED | B_NAVIGABLE);
	fTextView->SetFontAndColor(be_fixed_font);
	AddChild(new BScrollView("scroll", fTextView, B_FOLLOW_ALL_SIDES, 0, false, true));
}


BytesEditor::~BytesEditor()
{
}


BView*
BytesEditor::View()
{
	return this;
}


void
BytesEditor::UpdateValue(const char* operation)
{
	if (!fIsText || fLoadedText == fTextView->Text())
		return;

	std::string text = fTextView->Text();
	BResourceCollection* collection = WriteLock(operation != NULL ? operation : "Edit Text");
	if (collection == nullptr)
		return;
	if (BResourceItem* item = collection->WriteItem(PrimaryItem()))
		item->SetData(text.c_str(), text.size() + (fHadFinalZero ? 1 : 0));
	WriteUnlock(collection);
}


void
BytesEditor::AllAttached()
{
	_Load();
}


void
BytesEditor::DetachedFromWindow()
{
	UpdateValue(NULL);
}


void
BytesEditor::MessageReceived(BMessage* message)
{
	if (message->what != B_RESOURCE_DATA_CHANGED) {
		BView::MessageReceived(message);
		return;
	}

	bool changed = false;
	if (const BResourceCollection* collection = ReadLock()) {
		uint32 changes;
		BResourceHandle item;
		while ((item = collection->GetNextChange(this, &changes)).IsValid())
			changed |= item == PrimaryItem() && (changes & B_ITEM_DATA_CHANGED) != 0;
		ReadUnlock(collection);
	}
	if (changed)
		_Load();
}


void
BytesEditor::_Load()
{
	const BResourceCollection* collection = ReadLock();
	if (collection == nullptr)
		return;

	if (const BResourceItem* item = collection->Item(PrimaryItem())) {
		std::string_view bytes(static_cast<const char*>(item->Data()), item->Size());
		fHadFinalZero = !bytes.empty() && bytes.back() == '\0';
		const std::string_view text = bytes.substr(0, bytes.size() - (fHadFinalZero ? 1 : 0));
		fIsText = IsText(text);
		fLoadedText = fIsText ? std::string(text) : HexTable(bytes);
		if (fLoadedText != fTextView->Text())
			fTextView->SetText(fLoadedText.c_str());
		fTextView->MakeEditable(fIsText);
	}
	ReadUnlock(collection);
}
