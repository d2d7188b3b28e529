#include "host/library/ResourceAddon.h"

namespace BResEditor {

namespace {


constexpr float kDeclines = -1;


} // namespace


BResourceAddon::BResourceAddon(const BResourceAddonArgs& args) : BResourceAddonBase(args)
{
}


BResourceAddon::~BResourceAddon()
{
}


status_t
BResourceAddon::GetNthGenerateInfo(int32 n, BMessage* info) const
{
	return B_BAD_INDEX;
}


status_t
BResourceAddon::GenerateResource(BResourceHandle* _handle, const BMessage* request, int32 id,
	const char* name, bool makeUnique, BResourceCollection::conflict_resolution resolution)
{
	return B_ERROR;
}


float
BResourceAddon::QuickQuality(const BResourceItem* item) const
{
	return kDeclines;
}


float
BResourceAddon::PreciseQuality(const BResourceItem* item) const
{
	return QuickQuality(item);
}


BMiniItemEditor*
BResourceAddon::MakeMiniEditor(
	const BResourceAddonArgs& args, BResourceHandle handle, const BMessage* configuration)
{
	return nullptr;
}


BFullItemEditor*
BResourceAddon::MakeFullEditor(
	const BResourceAddonArgs& args, BResourceHandle handle, const BMessage* configuration)
{
	return nullptr;
}


float
BResourceAddon::PasteQuality(const BMessage* clip) const
{
	return kDeclines;
}


status_t
BResourceAddon::HandlePaste(const BMessage* clip)
{
	return B_ERROR;
}


float
BResourceAddon::DropQuality(const BMessage* drop) const
{
	return kDeclines;
}


status_t
BResourceAddon::HandleDrop(const BMessage* drop)
{
	return B_ERROR;
}


float
BResourceAddon::BufferQuality(const void* data, size_t size) const
{
	return kDeclines;
}


status_t
BResourceAddon::HandleBuffer(const void* data, size_t size)
{
	return B_ERROR;
}


} // namespace BResEditor
