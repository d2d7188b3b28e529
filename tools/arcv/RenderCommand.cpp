// arcv render: an archived view as a picture.

#include <math.h>
#include <stdio.h>
#include <stdlib.h>

#include <algorithm>
#include <memory>

#include <Application.h>
#include <Archivable.h>
#include <BitmapStream.h>
#include <DataIO.h>
#include <Messenger.h>
#include <Screen.h>
#include <TranslatorRoster.h>
#include <View.h>
#include <Window.h>

#include "tools/arcv/Command.h"
#include "tools/arcv/Input.h"
#include "tools/arcv/Output.h"
#include "tools/arcv/TypeCode.h"

namespace Arcv {

namespace {

constexpr float kLargestSide = 8192;
constexpr uint32 kPaint = 'pant';
constexpr uint32 kPainted = 'done';

struct RenderOptions {
	std::string file;
	std::string item;
	std::string output;
};


bool
HasFrame(const BMessage& message)
{
	BRect frame;
	return message.HasString("class") && message.FindRect("_frame", &frame) == B_OK;
}


// The item that is named, or the first archived view. False after a complaint.
bool
FindArchive(Input& input, const RenderOptions& options, BMessage* _archive)
{
	if (input.IsMessage()) {
		*_archive = input.Message();
		return true;
	}
	ItemKey key = {};
	const bool named = !options.item.empty();
	if (named && !ParseItemKey(options.item, &key)) {
		Complain(options.item, "an item is named TYPE:ID");
		return false;
	}
	for (const Item& item : input.Items()) {
		if (named ? item.type != key.type || item.id != key.id : item.type != 'ARCV')
			continue;
		const void* data = input.Load(item);
		if (data == NULL)
			return false;
		if (IsMessage(data, item.size, _archive) && (named || HasFrame(*_archive)))
			return true;
	}
	Complain(
		options.file, named ? "there is no archive " + options.item : "there is no archived view");
	return false;
}


// A class that is not available here is shown as it is inside a view: by a stand-in. NULL for what
// is no view.
BView*
MakeView(BMessage& archive)
{
	std::unique_ptr<BArchivable> object(instantiate_object(&archive));
	if (BView* view = dynamic_cast<BView*>(object.get())) {
		object.release();
		return view;
	}
	if (object != nullptr || !HasFrame(archive))
		return NULL;
	BMessage parent;
	parent.AddString("class", "BView");
	parent.AddRect("_frame", archive.FindRect("_frame").OffsetToCopy(B_ORIGIN));
	parent.AddMessage("_views", &archive);
	object.reset(instantiate_object(&parent));
	BView* view = dynamic_cast<BView*>(object.get());
	if (view == NULL || view->CountChildren() == 0)
		return NULL;
	object.release();
	view->ChildAt(0)->MoveTo(0, 0);
	return view;
}


// The size that the picture will have, limited to what a picture can be.
BRect
PictureFrame(const BMessage& archive)
{
	BRect frame;
	archive.FindRect("_frame", &frame);
	const auto side = [](float length) {
		return isfinite(length) ? std::clamp(floorf(length), 0.0f, kLargestSide - 1) : 0.0f;
	};
	return BRect(0, 0, side(frame.Width()), side(frame.Height()));
}


// Only a window's own thread updates it: it answers when it has.
class PictureWindow : public BWindow {
public:
	explicit PictureWindow(BRect frame) :
		BWindow(frame, "arcv", B_NO_BORDER_WINDOW_LOOK, B_NORMAL_WINDOW_FEEL, 0)
	{
	}

	void MessageReceived(BMessage* message) override
	{
		if (message->what != kPaint) {
			BWindow::MessageReceived(message);
			return;
		}
		UpdateIfNeeded();
		Sync();
		message->SendReply(kPainted);
	}
};


std::unique_ptr<BBitmap>
Paint(BView* view, BRect frame)
{
	BWindow* window = new PictureWindow(frame);
	view->MoveTo(0, 0);
	while (view->IsHidden())
		view->Show();
	window->AddChild(view);
	window->Show();
	BMessage reply;
	BMessenger(window).SendMessage(kPaint, &reply);
	BBitmap* bitmap = NULL;
	BScreen(window).GetBitmap(&bitmap, false, &frame);
	if (window->Lock())
		window->Quit();
	return std::unique_ptr<BBitmap>(bitmap);
}


bool
WritePng(std::unique_ptr<BBitmap> bitmap, const std::string& path)
{
	BBitmapStream stream(bitmap.release()); // owns it now
	BMallocIO bytes;
	const status_t status =
		BTranslatorRoster::Default()->Translate(&stream, NULL, NULL, &bytes, 'PNG ');
	if (status != B_OK) {
		Complain(path, StatusText(status));
		return false;
	}
	const std::string_view text(static_cast<const char*>(bytes.Buffer()), bytes.BufferLength());
	return WriteWholeFile(path, text);
}


int
RunRender(const RenderOptions& options)
{
	Input input;
	BMessage archive;
	if (!input.Open(options.file))
		return kUnreadable;
	if (!FindArchive(input, options, &archive))
		return kFindings;

	// A screen of its own in memory, as large as the view.
	const BRect frame = PictureFrame(archive);
	char size[32];
	snprintf(size, sizeof(size), "%dx%d", static_cast<int>(frame.Width()) + 1,
		static_cast<int>(frame.Height()) + 1);
	setenv("ARCHWAY_BACKEND", "headless", 1);
	setenv("ARCHWAY_SCREEN", size, 1);
	setenv("ARCHWAY_SCALE", "1", 1);
	setenv("QT_QPA_PLATFORM", "offscreen", 1);
	BApplication application("application/x-vnd.Archway-arcv");
	BView* view = MakeView(archive);
	if (view == NULL) {
		Complain(options.file, "the archive is no view");
		return kFindings;
	}
	std::unique_ptr<BBitmap> bitmap = Paint(view, frame);
	if (bitmap == nullptr) {
		Complain(options.file, "the view cannot be painted");
		return kUnreadable;
	}
	return WritePng(std::move(bitmap), options.output) ? kFine : kUnreadable;
}

} // namespace


void
AddRenderCommand(CLI::App& app, int* _status)
{
	const auto options = std::make_shared<RenderOptions>();
	CLI::App* command = app.add_subcommand("render", "Write a picture of an archived view");
	command->add_option("file", options->file, "A resource file, or one flattened archive")
		->required();
	command->add_option("item", options->item, "The item, as TYPE:ID; the first view if absent");
	command->add_option("-o,--output", options->output, "The PNG file")->required();
	command->callback([=] { *_status = RunRender(*options); });
}

} // namespace Arcv
