#include "MenuItem.h"

#include <cstdlib>
#include <cstring>

#include <Message.h>
#include <Messenger.h>
#include <Window.h>

#include "app/private/ArchiveSource.h"
#include "interface/private/MenuShortcuts.h"
#include "interface/private/ViewArchive.h"

using namespace BPrivate;

BMenuItem::BMenuItem(const char* label, BMessage* message, char shortcut, uint32 modifiers)
{
	_Init();
	_SetLabelText(label);
	SetMessage(message);
	fShortcut = shortcut;
	fModifiers = shortcut != 0 ? modifiers | B_COMMAND_KEY : 0;
}


BMenuItem::BMenuItem(BMenu* menu, BMessage* message)
{
	_Init();
	SetMessage(message);
	_SetSubmenu(menu);
	_TakeLabelFromSubmenu();
}


BMenuItem::BMenuItem(BMessage* archive) : BArchivable(archive)
{
	_Init();
	fSource = std::make_unique<ArchiveSource>(archive);

	const char* label;
	if (archive->FindString("_label", &label) == B_OK)
		_SetLabelText(label);
	bool flag;
	if (archive->FindBool("_disable", &flag) == B_OK)
		fEnabled = !flag;
	if (archive->FindBool("_marked", &flag) == B_OK)
		fMarked = flag;
	int32 number;
	if (archive->FindInt32("_user_trig", &number) == B_OK)
		fTrigger = fUserTrigger = static_cast<char>(number);
	if (archive->FindInt32("_shortcut", &number) == B_OK)
		fShortcut = static_cast<char>(number);
	if (archive->FindInt32("_mods", &number) == B_OK)
		fModifiers = static_cast<uint32>(number);
	BMessage message;
	if (archive->FindMessage("_msg", &message) == B_OK)
		SetMessage(new BMessage(message));

	if (archive->FindMessage("_submenu", &message) != B_OK)
		return;
	BArchivable* object = instantiate_object(&message);
	if (BMenu* submenu = dynamic_cast<BMenu*>(object)) {
		_SetSubmenu(submenu);
		_TakeLabelFromSubmenu();
	} else {
		delete object;
	}
}


BMenuItem::~BMenuItem()
{
	if (fSuper != NULL)
		fSuper->RemoveItem(this);
	SetMessage(NULL);
	if (fSubmenu != NULL) {
		fSubmenu->fSuperitem = NULL;
		delete fSubmenu;
	}
	free(fLabel);
}


void
BMenuItem::_Init()
{
	fLabel = NULL;
	fSubmenu = NULL;
	fSuper = NULL;
	fWindow = NULL;
	fLabelWidth = -1;
	fContentWidth = fContentHeight = 0;
	fModifiers = 0;
	fIndex = 0;
	fShortcut = fTrigger = fUserTrigger = 0;
	fEnabled = true;
	fMarked = false;
	fSelected = false;
	fLabelTouched = false;
}


BArchivable*
BMenuItem::Instantiate(BMessage* archive)
{
	return validate_instantiation(archive, "BMenuItem") ? new BMenuItem(archive) : NULL;
}


status_t
BMenuItem::Archive(BMessage* archive, bool deep) const
{
	begin_archive(fSource.get(), archive);
	const status_t status = BArchivable::Archive(archive, deep);
	if (status != B_OK)
		return status;

	ArchiveWriter writer(archive);
	// An item with a submenu shows another label than its archive has.
	if (!writer.Keep("_label", !fLabelTouched))
		writer.String("_label", fLabel, NULL);
	writer.Bool("_disable", !fEnabled, false, !fEnabled);
	writer.Bool("_marked", fMarked, false, fMarked);
	writer.Int32("_user_trig", fUserTrigger, 0, fUserTrigger != 0);
	writer.Int32("_shortcut", static_cast<uchar>(fShortcut), 0, fShortcut != 0);
	writer.Int32("_mods", static_cast<int32>(fModifiers), 0, fShortcut != 0);
	writer.Message("_msg", Message());
	if (!deep)
		return writer.Status();
	// A submenu that could not be revived is carried along.
	if (fSubmenu == NULL)
		writer.Keep("_submenu", true);
	else
		_ArchiveSubmenu(writer);
	return writer.Status();
}


void
BMenuItem::_ArchiveSubmenu(ArchiveWriter& writer) const
{
	BMessage submenu;
	if (fSubmenu->Archive(&submenu, true) == B_OK)
		writer.Message("_submenu", &submenu);
}


// #pragma mark - properties


void
BMenuItem::SetLabel(const char* label)
{
	fLabelTouched = true;
	_SetLabelText(label);
	if (fSuper != NULL) {
		fSuper->_ItemChanged(this, true);
		if (fMarked)
			fSuper->_UpdateSuperitemLabel();
	}
}


void
BMenuItem::SetEnabled(bool enabled)
{
	if (fEnabled == enabled)
		return;
	fEnabled = enabled;
	if (fSubmenu != NULL)
		fSubmenu->SetEnabled(enabled);
	if (fSuper != NULL)
		fSuper->_ItemChanged(this, false);
}


void
BMenuItem::SetMarked(bool marked)
{
	const bool changed = fMarked != marked;
	fMarked = marked;
	if (fSuper == NULL)
		return;
	if (marked)
		fSuper->_ItemMarked(this);
	if (changed)
		fSuper->_ItemChanged(this, false);
}


void
BMenuItem::SetTrigger(char trigger)
{
	fUserTrigger = fTrigger = trigger;
	if (fSuper != NULL)
		fSuper->_ItemChanged(this, false);
}


void
BMenuItem::SetShortcut(char shortcut, uint32 modifiers)
{
	BWindow* window = fWindow;
	if (window != NULL && fShortcut != 0)
		MenuShortcuts::Remove(window, this);
	fShortcut = shortcut;
	fModifiers = shortcut != 0 ? modifiers | B_COMMAND_KEY : 0;
	if (window != NULL && fShortcut != 0)
		MenuShortcuts::Add(window, this);
	if (fSuper != NULL)
		fSuper->_ItemChanged(this, true);
}


const char*
BMenuItem::Label() const
{
	return fLabel;
}


bool
BMenuItem::IsEnabled() const
{
	if (fSubmenu != NULL && !fSubmenu->fEnabled)
		return false;
	return fEnabled && (fSuper == NULL || fSuper->IsEnabled());
}


bool
BMenuItem::IsMarked() const
{
	return fMarked;
}


char
BMenuItem::Trigger() const
{
	return fUserTrigger;
}


char
BMenuItem::Shortcut(uint32* _modifiers) const
{
	if (_modifiers != NULL)
		*_modifiers = fModifiers;
	return fShortcut;
}


BMenu*
BMenuItem::Submenu() const
{
	return fSubmenu;
}


BMenu*
BMenuItem::Menu() const
{
	return fSuper;
}


BRect
BMenuItem::Frame() const
{
	if (fSuper != NULL && fSuper->fTracker == NULL)
		fSuper->_ValidateLayout();
	return fBounds;
}


void
BMenuItem::_SetSubmenu(BMenu* submenu)
{
	fSubmenu = submenu;
	if (submenu == NULL)
		return;
	submenu->fSuperitem = this;
}


void
BMenuItem::_TakeLabelFromSubmenu()
{
	if (fSubmenu == NULL)
		return;
	BMenuItem* marked =
		fSubmenu->fLabelFromMarked && fSubmenu->fRadioMode ? fSubmenu->FindMarked() : NULL;
	_SetLabelText(marked != NULL ? marked->Label() : fSubmenu->Name());
}


void
BMenuItem::_SetLabelText(const char* label)
{
	char* copy = label != NULL ? strdup(label) : NULL;
	free(fLabel);
	fLabel = copy;
	fLabelWidth = -1;
}


// #pragma mark - windows


// Takes part in the window: its shortcut works there, and the window is its target if it has none.
void
BMenuItem::_Install(BWindow* window)
{
	fWindow = window;
	if (fShortcut != 0)
		MenuShortcuts::Add(window, this);
	if (Message() != NULL && !Messenger().IsValid())
		SetTarget(window);
	if (fSubmenu != NULL)
		fSubmenu->_Install(window);
}


void
BMenuItem::_Uninstall()
{
	if (fWindow == NULL)
		return;
	if (fShortcut != 0)
		MenuShortcuts::Remove(fWindow, this);
	if (Target() == fWindow)
		SetTarget(BMessenger());
	fWindow = NULL;
	if (fSubmenu != NULL)
		fSubmenu->_Uninstall();
}


status_t
BMenuItem::Invoke(BMessage* message)
{
	if (!IsEnabled())
		return B_ERROR;
	if (fSuper != NULL && fSuper->IsRadioMode())
		SetMarked(true);
	if (message == NULL)
		message = Message();
	if (message == NULL)
		return B_BAD_VALUE;

	BMessage copy(*message);
	copy.AddInt64("when", system_time());
	copy.AddPointer("source", this);
	copy.AddInt32("index", fSuper != NULL ? fSuper->IndexOf(this) : -1);
	return BInvoker::Invoke(&copy);
}
