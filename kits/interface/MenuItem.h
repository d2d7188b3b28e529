// BMenuItem: one choice of a menu, or the way into a submenu.
#pragma once

#include <memory>
#include <string>

#include <Archivable.h>
#include <Invoker.h>
#include <Menu.h>

class BWindow;

namespace BPrivate {
class ArchiveSource;
class ArchiveWriter;
class MenuAccess;
class MenuTracker;
} // namespace BPrivate


// Belongs to the menu that it was added to, and owns its submenu. While its menu is attached,
// or part of an attached menu bar, use it under that window's lock.
class BMenuItem : public BArchivable, public BInvoker {
public:
	BMenuItem(const char* label, BMessage* message, char shortcut = 0, uint32 modifiers = 0);
	BMenuItem(BMenu* menu, BMessage* message = NULL);
	BMenuItem(BMessage* archive);
	virtual ~BMenuItem();
	BMenuItem(const BMenuItem&) = delete;
	BMenuItem& operator=(const BMenuItem&) = delete;

	static BArchivable* Instantiate(BMessage* archive);
	virtual status_t Archive(BMessage* archive, bool deep = true) const;

	virtual void SetLabel(const char* label);
	// Passed on to the submenu, if there is one.
	virtual void SetEnabled(bool enabled);
	// In a radio menu the others are unmarked; where the menu gives its superitem the label of
	// its marked item, that label follows at once.
	virtual void SetMarked(bool marked);
	virtual void SetTrigger(char trigger);
	// B_COMMAND_KEY is implied.
	virtual void SetShortcut(char shortcut, uint32 modifiers);

	const char* Label() const;
	// False too while any menu above is disabled.
	bool IsEnabled() const;
	bool IsMarked() const;
	char Trigger() const;
	char Shortcut(uint32* _modifiers = NULL) const;

	BMenu* Submenu() const;
	BMenu* Menu() const;
	BRect Frame() const;

protected:
	virtual void GetContentSize(float* _width, float* _height);
	// `newLabel` has room for the label's bytes and three more.
	virtual void TruncateLabel(float maxWidth, char* newLabel);
	virtual void DrawContent();
	virtual void Draw();
	virtual void Highlight(bool on);
	bool IsSelected() const;
	BPoint ContentLocation() const;

	// Nothing while the item or a menu above is disabled; marks itself first in a radio menu.
	virtual status_t Invoke(BMessage* message = NULL);

private:
	friend class BMenu;
	friend class BMenuBar;
	friend class BMenuField;
	friend class BPopUpMenu;
	friend class BSeparatorItem;
	friend class _BMCMenuBar_;
	friend class BPrivate::MenuAccess;
	friend class BPrivate::MenuTracker;

	void _Init();
	void _ArchiveSubmenu(BPrivate::ArchiveWriter& writer) const;
	void _SetSubmenu(BMenu* submenu);
	void _TakeLabelFromSubmenu();
	void _SetLabelText(const char* label);
	void _Install(BWindow* window);
	void _Uninstall();
	void _Select(bool selected);
	float _LabelWidth();
	float _ShortcutWidth() const;
	std::string _ShortcutText() const;
	int32 _TriggerOffset() const;
	uint32 _LookState() const;
	void _DrawTrigger(BPoint baseline) const;

	char* fLabel; // owned
	BMenu* fSubmenu; // owned
	BMenu* fSuper; // the menu that holds it, borrowed
	BWindow* fWindow; // the window that it was installed in, borrowed
	BRect fBounds; // in its menu's coordinates
	float fLabelWidth; // negative: measure anew
	float fContentWidth;
	float fContentHeight;
	uint32 fModifiers;
	int32 fIndex; // where the menu saw it last: a first guess
	char fShortcut;
	char fTrigger; // the one in use; chosen by the menu where the program set none
	char fUserTrigger;
	bool fEnabled;
	bool fMarked;
	bool fSelected;
	bool fLabelTouched; // since it was revived
	std::unique_ptr<BPrivate::ArchiveSource> fSource; // what it was revived from
};

#include <SeparatorItem.h>
