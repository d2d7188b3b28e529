#include "archive/ViewDrag.h"

#include <atomic>
#include <vector>

#include <AppDefs.h>
#include <Application.h>
#include <Bitmap.h>
#include <Cursor.h>
#include <Directory.h>
#include <Entry.h>
#include <File.h>
#include <Message.h>
#include <Mime.h>
#include <NodeInfo.h>
#include <Resources.h>
#include <View.h>

#include "archive/EditorCodes.h"
#include "archive/ViewTree.h"

namespace {


constexpr const char* kViewFileType = "application/x-tamvex-resource";
constexpr int32 kDraggedResourceID = 1;

constexpr uint32 kColorBits = 0x00ffffff;
constexpr uint32 kOpaque = 0xff000000;
constexpr uint32 kTranslucent = 0xc0000000;


// The program has one pointer.
std::atomic<bool> sShowsDragPointer { false };


// Pure black and pure white stay opaque; this asymmetry is wanted.
void
MakeTranslucent(BBitmap* bitmap)
{
	uint32* pixel = static_cast<uint32*>(bitmap->Bits());
	uint32* const end = pixel + bitmap->BitsLength() / static_cast<int32>(sizeof(uint32));
	for (; pixel < end; pixel++) {
		const uint32 color = *pixel & kColorBits;
		*pixel = color | (color == 0 || color == kColorBits ? kOpaque : kTranslucent);
	}
}


} // namespace


BBitmap*
MakeDragImage(BView* view, const std::function<void()>& whileAttached)
{
	BBitmap* bitmap = new BBitmap(view->Bounds(), B_RGBA32, true);
	if (!bitmap->Lock())
		return bitmap;

	ColorfulAddChild(bitmap, view);
	if (whileAttached)
		whileAttached();
	EraseBackground(view);
	DrawView(view);
	view->Sync();
	bitmap->RemoveChild(view);
	MakeTranslucent(bitmap);
	bitmap->Unlock();
	return bitmap;
}


status_t
MakeDragMessage(const BView* view, BMessage* drag)
{
	drag->what = B_SIMPLE_DATA;
	drag->AddString("be:types", B_FILE_MIME_TYPE);
	drag->AddString("be:filetypes", B_RESOURCE_MIME_TYPE);
	drag->AddInt32("be:actions", B_COPY_TARGET);
	drag->AddInt32("be:actions", B_TRASH_TARGET);
	drag->AddString("be:clip_name", "DragMe Success");

	BMessage archive(kDroppedView);
	const status_t status = view->Archive(&archive, true);
	return status == B_OK ? drag->AddMessage(kDroppedViewField, &archive) : status;
}


void
ShowDragPointer(bool accepts)
{
	sShowsDragPointer = true;
	const BCursor cursor(accepts ? B_CURSOR_ID_GRABBING : B_CURSOR_ID_NOT_ALLOWED);
	be_app->SetCursor(&cursor);
}


void
EndDragPointer()
{
	if (sShowsDragPointer.exchange(false))
		be_app->SetCursor(B_CURSOR_SYSTEM_DEFAULT);
}


status_t
WriteDraggedView(BMessage* reply)
{
	const BMessage* drag = reply->IsReply() ? reply->Previous() : NULL;
	if (drag == NULL)
		return B_BAD_VALUE;

	const char* name;
	entry_ref directory;
	BMessage archive;
	if (reply->FindString("name", &name) != B_OK || reply->FindRef("directory", &directory) != B_OK
		|| drag->FindMessage(kDroppedViewField, &archive) != B_OK)
		return B_BAD_VALUE;

	std::vector<char> bytes(static_cast<size_t>(archive.FlattenedSize()));
	status_t status = archive.Flatten(bytes.data(), static_cast<ssize_t>(bytes.size()));
	if (status != B_OK)
		return status;

	// The file manager has made the file.
	const BDirectory folder(&directory);
	BFile file(&folder, name, B_READ_WRITE | B_ERASE_FILE);
	BResources resources;
	status = resources.SetTo(&file, true);
	if (status == B_OK) {
		status = resources.AddResource(
			kArchiveType, kDraggedResourceID, bytes.data(), bytes.size(), kDraggedResourceName);
	}
	if (status == B_OK)
		status = resources.Sync();
	if (status != B_OK)
		return status;

	// Saving replaced the file, and the type belongs to the new one.
	BFile saved(&folder, name, B_READ_WRITE);
	BNodeInfo info(&saved);
	return info.SetType(kViewFileType);
}
