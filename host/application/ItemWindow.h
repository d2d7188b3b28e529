// ItemWindow: shows one item of a document in its editor.
#pragma once

#include <memory>
#include <string>

#include <Messenger.h>
#include <Window.h>

#include "host/library/ResourceHandle.h"

class BMenu;
class HandlerSet;
class ResourceDocument;

namespace BResEditor {
class BFullItemEditor;
}


// Belongs to a file window, to which it posts its menu commands and kItemClosed. The document and
// the handlers outlive it. What is edited never acts on this window: see DispatchMessage().
class ItemWindow : public BWindow {
public:
	ItemWindow(BRect frame, const BMessenger& fileWindow, ResourceDocument* document,
		HandlerSet* handlers, const BResEditor::BResourceHandle& handle);
	~ItemWindow() override;

	const BResEditor::BResourceHandle& Handle() const;

	void DispatchMessage(BMessage* message, BHandler* handler) override;
	void MenusBeginning() override;
	void MessageReceived(BMessage* message) override;
	bool QuitRequested() override;
	void Quit() override;

private:
	void _AddMenuBar();
	void _AddEditor();
	void _RemoveEditor(bool writeBack);
	void _UpdateTitle();
	void _ReleaseFocus();
	void _ApplyNow(BMessage* request);
	bool _ItemIsGone() const;
	std::string _WhyUnfit() const;
	bool _IsFromDesign(const BMessage* message) const;
	bool _TakeShortcut(const BMessage* message);

	BMessenger fFileWindow;
	ResourceDocument* fDocument; // borrowed
	HandlerSet* fHandlers; // borrowed
	BResEditor::BResourceHandle fHandle;
	BMenuBar* fMenuBar; // child
	BMenu* fEditMenu; // in the menu bar
	std::unique_ptr<BResEditor::BFullItemEditor> fEditor;
	bool fEditsObject; // the editor is an add-on's
	BMessenger fFormerFocus; // the view to give the focus back to after a save
};
