// FilePanelWindow: what the user sees of a BFilePanel.
#pragma once

#include <memory>
#include <string>
#include <vector>

#include <FilePanel.h>
#include <Message.h>
#include <Messenger.h>
#include <Window.h>

#include "storage/private/FolderContents.h"

class BButton;
class BMenu;
class BMenuBar;
class BMenuField;
class BMenuItem;
class BTextControl;

namespace BPrivate {

class FileList;


// The public functions are for the panel, under this window's lock. A user who closes the window
// only hides it; it ends with its panel, or when the application quits.
class FilePanelWindow : public BWindow {
public:
	struct Setup {
		file_panel_mode mode;
		uint32 flavors;
		bool manyFiles;
		bool modal;
		bool hideWhenDone;
		BRefFilter* filter; // borrowed
		BMessenger target; // invalid: the application
		std::string folder;
	};

	FilePanelWindow(BFilePanel* panel, const Setup& setup);
	~FilePanelWindow() override;

	void MessageReceived(BMessage* message) override;
	void MenusBeginning() override;
	void WindowActivated(bool active) override;
	bool QuitRequested() override;

	void ShowPanel();
	void HidePanel();
	void GoTo(const std::string& folder);
	void Refresh();

	file_panel_mode Mode() const { return fMode; }
	const std::string& Folder() const { return fFolder; }
	BRefFilter* Filter() const { return fRules.filter; }
	void SetFilter(BRefFilter* filter);
	BMessenger Target() const;
	void SetTarget(const BMessenger& target) { fTarget = target; }
	void SetMessage(const BMessage* message);
	void SetName(const std::string& name);
	void SetButtonLabel(file_panel_button button, const char* label);
	bool HidesWhenDone() const { return fHideWhenDone; }
	void SetHideWhenDone(bool hide) { fHideWhenDone = hide; }

	void Rewind() { fNextSelected = 0; }
	status_t GetNextSelectedRef(entry_ref* _ref);

private:
	void _AddMenus();
	BMenu* _MakeFileMenu();
	void _AddFolderField(float top);
	void _AddButtons();
	void _AddNameField();
	void _AddList();
	void _LayOutButtons();
	bool _Read(const std::string& folder);
	void _ShowPlace();
	void _FillFavorites();
	void _FocusFirst();

	void _RowsSelected();
	void _NameChanged();
	void _TakeDrop(const BMessage* message);
	void _Invoked();
	void _Choose();
	void _OpenTyped(const std::string& text);
	void _OpenSelection();
	void _OpenPaths(const std::vector<std::string>& paths);
	void _SaveTyped(const std::string& text);
	void _AskToReplace(const std::string& path);
	void _Save(const std::string& path);
	void _Cancel();
	void _Send(BMessage* message);
	void _Done();
	void _AskForFolder();
	void _MakeFolder(const std::string& name);
	void _ChangeFavorites(status_t status);
	void _Tell(const std::string& text);

	BFilePanel* fPanel; // owns this window
	file_panel_mode fMode;
	FolderRules fRules;
	bool fManyFiles;
	bool fHideWhenDone;
	BMessenger fTarget;
	BMessage fMessage; // what is sent, without the choice
	std::string fFolder;
	std::vector<FolderItem> fItems;
	bigtime_t fChangeTime; // of the folder when it was read
	std::string fShownName; // as the panel, not the user, has put it into the field
	std::string fTypedName; // as the user has typed it, without the completion
	bool fNameTyped; // the name counts, not the selection
	int32 fNextSelected;
	BMenuBar* fMenuBar; // child
	BMenu* fFavoritesMenu; // in the menu bar
	BMenuItem* fHiddenItem; // in the menu bar
	BMenuField* fFolderField; // child
	FileList* fList; // child of a scroll view
	BTextControl* fNameField; // child
	BButton* fDefaultButton; // child
	BButton* fCancelButton; // child
};

} // namespace BPrivate
