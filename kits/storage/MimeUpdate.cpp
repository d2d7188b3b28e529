// What files say about types, taken over for the whole system.

#include <Mime.h>

#include <functional>

#include <AppFileInfo.h>
#include <Bitmap.h>
#include <Directory.h>
#include <Entry.h>
#include <File.h>
#include <Message.h>
#include <NodeInfo.h>
#include <Path.h>

namespace {

// Ends with the first error.
status_t
ForEachPath(const BEntry& folder, const std::function<status_t(const char* path)>& work)
{
	status_t status = B_OK;
	BDirectory directory(&folder);
	BEntry child;
	while (status == B_OK && directory.GetNextEntry(&child) == B_OK) {
		BPath path;
		if (child.GetPath(&path) == B_OK)
			status = work(path.Path());
	}
	return status;
}


status_t
TakeIcon(const BAppFileInfo& info, BMimeType* type, const char* forType, icon_size size, bool force)
{
	BBitmap icon(BRect(0, 0, size - 1, size - 1), B_CMAP8);
	if (!force && type->GetIconForType(forType, &icon, size) == B_OK)
		return B_OK;
	if (info.GetIconForType(forType, &icon, size) != B_OK)
		return B_OK; // the program has none
	return type->SetIconForType(forType, &icon, size);
}


status_t
TakeIcons(const BAppFileInfo& info, BMimeType* type, const char* forType, bool force)
{
	const status_t status = TakeIcon(info, type, forType, B_LARGE_ICON, force);
	return status == B_OK ? TakeIcon(info, type, forType, B_MINI_ICON, force) : status;
}


// The types that the program supports, and the icons that it has for their files.
status_t
TakeTypes(const BAppFileInfo& info, BMimeType* app, bool force)
{
	BMessage types;
	BMessage known;
	if (info.GetSupportedTypes(&types) != B_OK)
		return B_OK;
	status_t status = B_OK;
	if (force || app->GetSupportedTypes(&known) != B_OK)
		status = app->SetSupportedTypes(&types);
	const char* type;
	for (int32 i = 0; status == B_OK && types.FindString("types", i, &type) == B_OK; i++) {
		if (BMimeType::IsValid(type))
			status = TakeIcons(info, app, type, force);
	}
	return status;
}


status_t
TakeApp(const entry_ref& ref, bool force)
{
	BFile file(&ref, B_READ_ONLY);
	const BAppFileInfo info(&file);
	char signature[B_MIME_TYPE_LENGTH + 1];
	status_t status = info.GetSignature(signature);
	BMimeType app;
	if (status == B_OK)
		status = app.SetTo(signature);
	entry_ref hint;
	char text[B_MIME_TYPE_LENGTH + 1];
	if (status == B_OK && (force || app.GetAppHint(&hint) != B_OK))
		status = app.SetAppHint(&ref);
	if (status == B_OK && (force || app.GetPreferredApp(text) != B_OK))
		status = app.SetPreferredApp(signature);
	if (status == B_OK && (force || app.GetShortDescription(text) != B_OK))
		status = app.SetShortDescription(ref.name);
	if (status == B_OK)
		status = TakeIcons(info, &app, NULL, force);
	return status == B_OK ? TakeTypes(info, &app, force) : status;
}

} // namespace


status_t
update_mime_info(const char* path, int recursive, int, int force)
{
	if (path == NULL)
		return B_BAD_VALUE;
	const BEntry entry(path);
	entry_ref ref;
	status_t status = entry.GetRef(&ref);
	if (status == B_OK && !entry.Exists())
		status = B_ENTRY_NOT_FOUND;
	if (status != B_OK)
		return status;

	BNode node(&entry);
	attr_info info;
	if (force != 0 || node.GetAttrInfo("BEOS:TYPE", &info) != B_OK) {
		BMimeType type;
		status = BMimeType::GuessMimeType(&ref, &type);
		if (status == B_OK)
			status = BNodeInfo(&node).SetType(type.Type());
	}
	if (status != B_OK || recursive == 0 || !entry.IsDirectory())
		return status;
	return ForEachPath(entry,
		[force](const char* child) -> status_t { return update_mime_info(child, 1, 1, force); });
}


status_t
create_app_meta_mime(const char* path, int recursive, int, int force)
{
	if (path == NULL)
		return B_BAD_VALUE;
	const BEntry entry(path);
	entry_ref ref;
	const status_t status = entry.GetRef(&ref);
	if (status != B_OK)
		return status;
	if (!entry.Exists())
		return B_ENTRY_NOT_FOUND;
	if (!entry.IsDirectory())
		return TakeApp(ref, force != 0);
	if (recursive == 0)
		return B_ENTRY_NOT_FOUND;
	return ForEachPath(entry, [force](const char* child) -> status_t {
		const BEntry file(child);
		if (file.IsFile() || file.IsDirectory())
			create_app_meta_mime(child, 1, 1, force);
		return B_OK;
	});
}
