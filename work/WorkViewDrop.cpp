// WorkView: what is dropped on it, and what becomes of its own drags.

#include <cmath>
#include <memory>

#include <Alert.h>
#include <AppDefs.h>
#include <Beep.h>
#include <Bitmap.h>
#include <DataIO.h>
#include <Entry.h>
#include <File.h>
#include <MenuBar.h>
#include <Message.h>
#include <Resources.h>
#include <TranslationUtils.h>
#include <Window.h>

#include "archive/BitmapView.h"
#include "archive/EditorCodes.h"
#include "archive/ViewArchive.h"
#include "archive/ViewDrag.h"
#include "archive/ViewTree.h"
#include "work/WorkBackgroundView.h"
#include "work/WorkView.h"

namespace {


constexpr const char* kReplaceQuestion =
	"Whoa!  You have dropped a view onto the main work area.  Normally you want to drop a view "
	"inside an existing view.\n\nDo you wish to remove the exiting view(s) and replace with the "
	"dropped view?";
constexpr int32 kYes = 0;
constexpr int32 kNo = 1;


// The view lives as long as the design, and the bitmap with it.
BArchivable*
MakeBitmapView(BBitmap* bitmap, const char* name)
{
	BitmapView* view = new BitmapView(bitmap->Bounds(), name, B_FOLLOW_LEFT | B_FOLLOW_TOP, 0);
	view->AdoptBitmap(std::unique_ptr<BBitmap>(bitmap));
	return view;
}


// What tells how the view has come is not to be archived with the view from now on.
void
ForgetDrop(BMessage* archive)
{
	if (archive->what == kDroppedView || archive->what == kDroppedProperty)
		archive->what = 0;
	for (const char* field : { "_drop_point_", "_drop_offset_", "buttons" })
		archive->RemoveName(field);
}


// A picture, or a file that a view was dragged into. NULL when it is neither.
BArchivable*
ObjectFromFile(const entry_ref& ref)
{
	BFile file(&ref, B_READ_ONLY);
	if (BBitmap* bitmap = BTranslationUtils::GetBitmap(&file))
		return MakeBitmapView(bitmap, ref.name);

	BResources resources;
	if (resources.SetTo(&file, false) != B_OK)
		return NULL;
	size_t size;
	const void* data = resources.LoadResource(kArchiveType, kDraggedResourceName, &size);
	if (data == NULL)
		return NULL;

	BMemoryIO bytes(data, size);
	BMessage archive;
	if (archive.Unflatten(&bytes) != B_OK)
		return NULL;
	ForgetDrop(&archive);
	return instantiate_object(&archive);
}


BArchivable*
ObjectFromDrop(BMessage* message)
{
	if (message->what != B_SIMPLE_DATA) {
		BMessage archive(*message);
		ForgetDrop(&archive);
		return instantiate_object(&archive);
	}

	BMessage archive;
	if (message->FindMessage(kDroppedViewField, &archive) == B_OK) {
		ForgetDrop(&archive);
		return InstantiateAsChild(&archive); // a view that was dragged out of a design is not lost
	}

	entry_ref ref;
	return message->FindRef("refs", &ref) == B_OK ? ObjectFromFile(ref) : NULL;
}


// Points are converted back and forth, so the last bits may differ.
bool
IsSamePixel(BPoint a, BPoint b)
{
	return std::fabs(a.x - b.x) < 0.5f && std::fabs(a.y - b.y) < 0.5f;
}


bool
AskToReplace()
{
	BAlert* alert = new BAlert("Warning!", kReplaceQuestion, "Yes", "No", NULL, B_WIDTH_AS_USUAL,
		B_OFFSET_SPACING, B_WARNING_ALERT);
	alert->SetShortcut(kNo, B_ESCAPE);
	return alert->Go() == kYes;
}


} // namespace


void
WorkView::MessageReceived(BMessage* message)
{
	switch (message->what) {
		case B_COPY_TARGET:
			WriteDraggedView(message);
			break;
		case B_TRASH_TARGET:
			// The view was taken away when its drag began.
			break;
		case kFieldLeft:
			fFieldsLeft--;
			break;
		default:
			BView::MessageReceived(message);
	}
}


void
WorkView::HandleFilteredDrop(BMessage* message, BView* target)
{
	DumpMessage(message, 0);
	EndDragPointer();
	if (_PutBack(message))
		return;

	BArchivable* object = ObjectFromDrop(message);
	BView* view = dynamic_cast<BView*>(object);
	if (view == nullptr) {
		delete object;
		beep();
		return;
	}

	if (target == fContainer)
		_ReplaceTree(view);
	else
		_AddDropped(message, target, view);
}


// A view that is dropped where its drag began goes back to its place, whatever else lies there.
// Returns whether it is such a drop.
bool
WorkView::_PutBack(BMessage* drop)
{
	BPoint where;
	if (fTaken == nullptr || drop->ReturnAddress() != BMessenger(this)
		|| drop->FindPoint("_drop_point_", &where) != B_OK)
		return false;

	std::unique_ptr<BView> taken = std::move(fTaken);
	BView* parent = fTakenFrom.View();
	if (!IsSamePixel(where, fTakenAt) || LiveViewAttached(fEditView, parent) == nullptr)
		return false;

	BView* before = fTakenBefore.View();
	if (before != nullptr && before->Parent() != parent)
		before = nullptr;
	taken->MoveTo(fTakenLeftTop);
	SetSelectedView(ColorfulAddChild(parent, taken.release(), before));
	Window()->Activate();
	return true;
}


// Puts the view where the drag image's left top was.
void
WorkView::_AddDropped(BMessage* message, BView* target, BView* view)
{
	BPoint where, offset;
	message->FindPoint("_drop_point_", &where);
	message->FindPoint("_drop_offset_", &offset);
	view->MoveTo(target->ConvertFromScreen(where) - offset);

	if (message->what == kDroppedView)
		ColorfulAddChild(target, view);
	else {
		target->AddChild(view);
		if (dynamic_cast<BMenuBar*>(view) != nullptr)
			view->MoveTo(0, 0);
	}
	SetSelectedView(view);
	Window()->Activate();
}


void
WorkView::_ReplaceTree(BView* view)
{
	if (!AskToReplace()) {
		delete view;
		return;
	}
	view->MoveTo(0, 0);
	SetEditView(view);
}
