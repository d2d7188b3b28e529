#include "host/library/ItemEditor.h"

namespace BResEditor {


BFullItemEditor::BFullItemEditor(
	const BResourceAddonArgs& args, const BResourceHandle& handle, BHandler* handler) :
	BResourceAddonBase(args, handler)
{
	SetPrimaryItem(handle);
}


BFullItemEditor::~BFullItemEditor()
{
}


bool
BFullItemEditor::HasOpenChanges()
{
	return false;
}


void
BFullItemEditor::ApplyChanges()
{
	UpdateValue(NULL);
}


status_t
BFullItemEditor::Retarget(BResourceHandle handle)
{
	SetPrimaryItem(handle);
	return B_OK;
}


BMenuItem*
BFullItemEditor::EditMenuItem()
{
	return nullptr;
}


BMenu*
BFullItemEditor::CustomMenu()
{
	return nullptr;
}


status_t
BFullItemEditor::GetConfiguration(BMessage* configuration) const
{
	return B_OK;
}


status_t
BFullItemEditor::SetConfiguration(const BMessage* configuration)
{
	return B_OK;
}


void
BFullItemEditor::UpdateValue(const char* operation)
{
}


// #pragma mark - BMiniItemEditor


BMiniItemEditor::BMiniItemEditor(
	const BResourceAddonArgs& args, const BResourceHandle& handle, BHandler* handler) :
	BResourceAddonBase(args, handler)
{
	SetPrimaryItem(handle);
}


BMiniItemEditor::~BMiniItemEditor()
{
}


} // namespace BResEditor
