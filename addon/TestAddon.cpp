#include "addon/TestAddon.h"

#include <vector>

#include <Message.h>
#include <View.h>

#include "addon/ViewEditor.h"
#include "archive/EditorCodes.h"

using namespace BResEditor;

namespace {


constexpr float kSuits = 1;
constexpr float kDeclines = -1;


// What a new item holds: an empty view.
status_t
FlattenNewView(std::vector<char>& _bytes)
{
	BView view(BRect(0, 0, 200, 100), "The View", B_FOLLOW_LEFT | B_FOLLOW_TOP,
		B_WILL_DRAW | B_NAVIGABLE_JUMP | B_FRAME_EVENTS);
	BMessage archive;
	const status_t status = view.Archive(&archive, true);
	if (status != B_OK)
		return status;

	_bytes.resize(static_cast<size_t>(archive.FlattenedSize()));
	return archive.Flatten(_bytes.data(), static_cast<ssize_t>(_bytes.size()));
}


} // namespace


TestAddon::TestAddon(const BResourceAddonArgs& args) : BResourceAddon(args)
{
}


TestAddon::~TestAddon()
{
}


status_t
TestAddon::GetNthGenerateInfo(int32 n, BMessage* info) const
{
	if (n != 0)
		return B_ERROR;

	info->AddString(B_GENERATE_NAME, "Archived Object");
	info->AddInt32(B_GENERATE_TYPE, kArchiveType);
	return B_OK;
}


status_t
TestAddon::GenerateResource(BResourceHandle* out, const BMessage* request, int32 id,
	const char* name, bool make_unique, BResourceCollection::conflict_resolution resolution)
{
	int32 type;
	status_t status = request->FindInt32(B_GENERATE_TYPE, &type);
	if (status != B_OK)
		return status;

	BResourceCollection* collection = WriteLock(NULL);
	if (collection == nullptr)
		return B_ERROR;

	status = B_ERROR;
	std::vector<char> bytes;
	if (static_cast<type_code>(type) == kArchiveType && (status = FlattenNewView(bytes)) == B_OK) {
		status = collection->AddItem(
			out, kArchiveType, id, name, bytes.data(), bytes.size(), make_unique, resolution);
	}

	WriteUnlock(collection);
	return status;
}


float
TestAddon::QuickQuality(const BResourceItem* item) const
{
	return kDeclines;
}


float
TestAddon::PreciseQuality(const BResourceItem* item) const
{
	return item->Type() == kArchiveType ? kSuits : kDeclines;
}


BMiniItemEditor*
TestAddon::MakeMiniEditor(
	const BResourceAddonArgs& args, BResourceHandle handle, const BMessage* configuration)
{
	return nullptr;
}


BFullItemEditor*
TestAddon::MakeFullEditor(
	const BResourceAddonArgs& args, BResourceHandle handle, const BMessage* configuration)
{
	return new ViewEditor(args, handle);
}


status_t
TestAddon::HandleDrop(const BMessage* drop)
{
	return B_ERROR;
}
