#include "addon/ViewEditor.h"

#include <vector>

#include <DataIO.h>
#include <OS.h>
#include <Window.h>

#include "addon/PalettePresence.h"
#include "addon/PanelTable.h"
#include "archive/EditorCodes.h"
#include "archive/ViewArchive.h"
#include "archive/ViewTree.h"
#include "editors/EditView.h"
#include "work/WorkView.h"

using namespace BResEditor;

namespace {


constexpr uint32 kAllChanges = 0xffffffff;

constexpr float kColumnRight = 408;
constexpr float kColumnGap = 4;
constexpr float kPanelMargin = 4;
constexpr float kPanelGap = 12;
constexpr float kWindowMargin = 6; // below the last panel
constexpr rgb_color kColumnColor = { 216, 216, 216, 255 };


// Where frames follow the scrolling, moves the tree to where it would be if nothing were
// scrolled, and back at the end of the scope.
class UnscrolledTree {
public:
	UnscrolledTree(BView* root, BPoint origin) :
		fRoot(kFramesFollowScrolling ? root : nullptr), fOrigin(origin)
	{
		if (fRoot != nullptr) {
			fRoot->MoveBy(fOrigin.x, fOrigin.y);
			MoveScrolledViews(fRoot, false);
		}
	}

	~UnscrolledTree()
	{
		if (fRoot != nullptr) {
			MoveScrolledViews(fRoot, true);
			fRoot->MoveBy(-fOrigin.x, -fOrigin.y);
		}
	}

private:
	BView* fRoot; // borrowed; NULL when there is nothing to do
	BPoint fOrigin;
};


} // namespace


ViewEditor::ViewEditor(const BResourceAddonArgs& args, BResourceHandle handle) :
	BFullItemEditor(args, handle, static_cast<BView*>(this)),
	BView(BRect(0, 0, 500, 450), "BView Editor", B_FOLLOW_ALL_SIDES, B_NAVIGABLE_JUMP), fPanels(),
	fPanelCount(0), fWroteItem(false)
{
	Init();
}


ViewEditor::~ViewEditor()
{
	fWorkView->SetEditView(NULL);
	for (int32 i = 0; i < fPanelCount; i++) {
		if (fPanels[i] == nullptr)
			continue;
		fPanels[i]->RemoveSelf();
		delete fPanels[i];
	}
}


status_t
ViewEditor::Retarget(BResourceHandle handle)
{
	SetPrimaryItem(handle);
	_LoadItem();
	return B_OK;
}


BView*
ViewEditor::View()
{
	return this;
}


void
ViewEditor::UpdateValue(const char* reason)
{
	BMessage archive;
	if (!_ArchiveTree(&archive) || Equal(&archive, &fLastArchive))
		return;

	BResourceCollection* collection = WriteLock(reason);
	if (collection == nullptr)
		return;

	if (BResourceItem* item = collection->WriteItem(PrimaryItem())) {
		std::vector<char> bytes(static_cast<size_t>(archive.FlattenedSize()));
		if (archive.Flatten(bytes.data(), static_cast<ssize_t>(bytes.size())) == B_OK)
			fWroteItem = item->SetData(bytes.data(), bytes.size()) == B_OK;
	}
	WriteUnlock(collection);
}


void
ViewEditor::ExecDataChanged(
	const BResourceCollection* collection, BResourceHandle& item, uint32 changes)
{
	if (item != PrimaryItem() || changes == 0)
		return;

	if (Window() != nullptr && !Window()->IsLocked()) {
		debugger("ExecDataChanged() called without window locked");
		return;
	}

	const BResourceItem* resource = collection->Item(PrimaryItem());
	if (resource == nullptr || (changes & B_ITEM_DATA_CHANGED) == 0)
		return;

	BMessage archive;
	BMemoryIO bytes(resource->Data(), resource->Size());
	archive.Unflatten(&bytes);
	fLastArchive = archive;
	SwapInheritedViews(&archive, 0);
	BArchivable* object = instantiate_object(&archive);
	if (BView* view = dynamic_cast<BView*>(object))
		_ReplaceTree(view);
	else
		delete object;
}


void
ViewEditor::ReplaceView(BView* former, BView* view)
{
	fWorkView->ReplaceView(former, view);
}


// #pragma mark - the view's side


void
ViewEditor::AllAttached()
{
	_LoadItem();
}


void
ViewEditor::AttachedToWindow()
{
	BView::AttachedToWindow();
	if (Parent() != nullptr)
		SetViewColor(Parent()->ViewColor());
	EnterPalette();
}


void
ViewEditor::DetachedFromWindow()
{
	UpdateValue(NULL);
	BView::DetachedFromWindow();
	LeavePalette();
}


void
ViewEditor::GetPreferredSize(float* width, float* height)
{
	if (width != nullptr)
		*width = 800;
	if (height != nullptr)
		*height = 430;
}


void
ViewEditor::MakeFocus(bool focus)
{
	if (IsFocus() != focus)
		BView::MakeFocus(focus);
}


void
ViewEditor::MessageReceived(BMessage* message)
{
	switch (message->what) {
		case kSelectionChanged:
			_SelectionChanged(message);
			break;
		case kSelectionMoved:
			_SelectionMoved();
			break;
		case B_RESOURCE_DATA_CHANGED:
			_ReadChanges();
			break;
		default:
			BView::MessageReceived(message);
	}
}


// #pragma mark - private


void
ViewEditor::Init()
{
	BRect bounds = Bounds();
	BRect column = bounds;
	column.right = kColumnRight;
	fPanelColumn = new BView(column, NULL, B_FOLLOW_LEFT | B_FOLLOW_TOP_BOTTOM,
		B_WILL_DRAW | B_NAVIGABLE_JUMP | B_FRAME_EVENTS);
	fPanelColumn->SetViewColor(kColumnColor);
	AddChild(fPanelColumn);

	fViewPanel = new EditView;
	fViewPanel->MoveTo(kPanelMargin, kPanelMargin);
	fViewPanel->ResizeTo(
		fPanelColumn->Bounds().Width() - 2 * kPanelMargin, fViewPanel->Bounds().Height());
	fPanelColumn->AddChild(fViewPanel);

	// The count includes the view panel, which is not in the array, and so the NULL that ends it.
	fPanelCount = MakePanels(fPanels, kMaxPanels) + 1;

	bounds.left = kColumnRight + kColumnGap;
	bounds.top += 1;
	fWorkView = new WorkView(bounds, B_FOLLOW_ALL_SIDES, static_cast<BView*>(this));
	AddChild(fWorkView);
}


// Shows the panels that accept the view, stacked below the view panel.
void
ViewEditor::FocusOnView(BView* view)
{
	Window()->BeginViewTransaction();

	fViewPanel->UseView(view);
	BRect last = fViewPanel->Frame();
	for (int32 i = 0; fPanels[i] != nullptr; i++) {
		EditorInterface* panel = fPanels[i];
		if (panel->UseView(view))
			_ShowPanel(panel, last);
		else if (panel->Window() != nullptr)
			panel->RemoveSelf();
	}
	_GrowWindowTo(fPanelColumn->ConvertToScreen(last.RightBottom()));

	Window()->EndViewTransaction();
	Window()->Flush();
}


// A panel that is already shown keeps its place.
void
ViewEditor::_ShowPanel(EditorInterface* panel, BRect& last)
{
	if (panel->Window() == nullptr) {
		panel->MoveTo(last.left, last.bottom + kPanelGap);
		fPanelColumn->AddChild(panel);
		panel->ResizeTo(last.Width(), panel->Bounds().Height());
	}
	last = panel->Frame();
}


// The window grows to show a point given on the screen; it is never made smaller.
void
ViewEditor::_GrowWindowTo(BPoint corner)
{
	BWindow* window = Window();
	const float height = window->ConvertFromScreen(corner).y + kWindowMargin;
	if (window->Bounds().Height() < height)
		window->ResizeTo(window->Bounds().Width(), height);
}


void
ViewEditor::_LoadItem()
{
	if (const BResourceCollection* collection = ReadLock()) {
		ExecDataChanged(collection, PrimaryItem(), kAllChanges);
		ReadUnlock(collection);
	}
}


// When the new tree is what this editor wrote itself, the user notices nothing.
void
ViewEditor::_ReplaceTree(BView* view)
{
	const WorkView::Place place = fWorkView->PresentPlace();
	fWorkView->SetEditView(view);
	if (fWroteItem)
		fWorkView->ReturnTo(place);
	fWroteItem = false;
	FocusOnView(fWorkView->SelectedView());
}


void
ViewEditor::_ReadChanges()
{
	const BResourceCollection* collection = ReadLock();
	if (collection == nullptr)
		return;

	uint32 changes;
	for (;;) {
		BResourceHandle item = collection->GetNextChange(this, &changes);
		if (!item.IsValid())
			break;
		ExecDataChanged(collection, item, changes);
	}
	ReadUnlock(collection);
}


// The message may be older than the view's deletion, so the tree decides whether it is there.
void
ViewEditor::_SelectionChanged(const BMessage* message)
{
	void* pointer;
	if (message->FindPointer(kSelectedViewField, &pointer) != B_OK || pointer == nullptr)
		return;

	BView* view = static_cast<BView*>(pointer);
	if (view == fWorkView->SelectedView() || ViewAttached(fWorkView->EditView(), view) != nullptr)
		FocusOnView(view);
}


void
ViewEditor::_SelectionMoved()
{
	fViewPanel->FrameChanged();
	for (int32 i = 0; fPanels[i] != nullptr; i++) {
		if (fPanels[i]->Window() != nullptr)
			fPanels[i]->FrameChanged();
	}
}


// Archives the live tree in resource form. False when there is no tree.
bool
ViewEditor::_ArchiveTree(BMessage* _archive)
{
	BView* root = fWorkView->EditView();
	if (root == nullptr)
		return false;

	UnscrolledTree unscrolled(root, fWorkView->ScrollOrigin());
	if (root->Archive(_archive, true) != B_OK)
		return false;
	SwapInheritedViews(_archive, 0);
	return true;
}
