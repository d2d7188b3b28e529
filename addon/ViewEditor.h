// ViewEditor: the full editor of one archived view: panels at the left, the work area at the right.
#pragma once

#include <Message.h>
#include <View.h>

#include "host/library/ItemEditor.h"

class EditView;
class EditorInterface;
class WorkView;


// A host's item editor and a view at once; the host owns it. Everything runs in the thread of the
// window that it is in. The item is read when the editor is attached and written back, if the
// tree differs from what was read, when it is detached.
class ViewEditor : public BResEditor::BFullItemEditor, public BView {
public:
	ViewEditor(const BResEditor::BResourceAddonArgs& args, BResEditor::BResourceHandle handle);
	~ViewEditor() override;

	// The host's side.
	status_t Retarget(BResEditor::BResourceHandle handle) override;
	BView* View() override;
	void UpdateValue(const char* reason) override;

	// Takes a change of the collection: the item's new data replaces the tree. Other items, and
	// changes that leave the data alone, are ignored. Window and read lock are held.
	virtual void ExecDataChanged(const BResEditor::BResourceCollection* collection,
		BResEditor::BResourceHandle& item, uint32 changes);

	// A view has taken the place of another one in the edited tree: it is selected, and the former
	// one may be deleted.
	void ReplaceView(BView* former, BView* view);

	// The view's side.
	void AllAttached() override;
	void AttachedToWindow() override;
	void DetachedFromWindow() override;
	void GetPreferredSize(float* width, float* height) override;
	void MakeFocus(bool focus = true) override;
	void MessageReceived(BMessage* message) override;

private:
	static constexpr int32 kMaxPanels = 25;

	void Init();
	void FocusOnView(BView* view);
	void _ShowPanel(EditorInterface* panel, BRect& last);
	void _GrowWindowTo(BPoint corner);
	void _LoadItem();
	void _ReadChanges();
	void _ReplaceTree(BView* view);
	void _SelectionChanged(const BMessage* message);
	void _SelectionMoved();
	bool _ArchiveTree(BMessage* _archive);

	WorkView* fWorkView; // child
	BView* fPanelColumn; // child
	BMessage fLastArchive; // in resource form, as last read
	EditorInterface* fPanels[kMaxPanels]; // ours while not children; NULL after the last
	int32 fPanelCount; // with the view panel and without the NULL, which makes it both
	EditView* fViewPanel; // child of the column
	bool fWroteItem; // what is read next is what was written last
};
