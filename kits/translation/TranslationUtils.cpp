#include <TranslationUtils.h>

#include <Application.h>
#include <BitmapStream.h>
#include <Entry.h>
#include <Errors.h>
#include <File.h>
#include <Resources.h>
#include <TranslatorRoster.h>

namespace {

BBitmap*
BitmapOf(const void* data, size_t size, BTranslatorRoster* roster)
{
	if (data == NULL)
		return NULL;
	BMemoryIO stream(data, size);
	return BTranslationUtils::GetBitmap(&stream, roster);
}


BResources*
ApplicationResources()
{
	return be_app != NULL ? BApplication::AppResources() : NULL;
}

} // namespace


BBitmap*
BTranslationUtils::GetBitmap(const char* name, BTranslatorRoster* roster)
{
	BBitmap* bitmap = GetBitmapFile(name, roster);
	return bitmap != NULL ? bitmap : GetBitmap(B_TRANSLATOR_BITMAP, name, roster);
}


BBitmap*
BTranslationUtils::GetBitmap(uint32 type, int32 id, BTranslatorRoster* roster)
{
	BResources* resources = ApplicationResources();
	if (resources == NULL)
		return NULL;
	size_t size = 0;
	const void* data = resources->LoadResource(type, id, &size);
	return BitmapOf(data, size, roster);
}


BBitmap*
BTranslationUtils::GetBitmap(uint32 type, const char* name, BTranslatorRoster* roster)
{
	BResources* resources = ApplicationResources();
	if (resources == NULL || name == NULL)
		return NULL;
	size_t size = 0;
	const void* data = resources->LoadResource(type, name, &size);
	return BitmapOf(data, size, roster);
}


BBitmap*
BTranslationUtils::GetBitmapFile(const char* path, BTranslatorRoster* roster)
{
	if (path == NULL || path[0] == '\0')
		return NULL;
	BFile file(path, B_READ_ONLY);
	return file.InitCheck() == B_OK ? GetBitmap(&file, roster) : NULL;
}


BBitmap*
BTranslationUtils::GetBitmap(const entry_ref* ref, BTranslatorRoster* roster)
{
	if (ref == NULL)
		return NULL;
	BFile file(ref, B_READ_ONLY);
	return file.InitCheck() == B_OK ? GetBitmap(&file, roster) : NULL;
}


BBitmap*
BTranslationUtils::GetBitmap(BPositionIO* stream, BTranslatorRoster* roster)
{
	if (stream == NULL)
		return NULL;
	if (roster == NULL)
		roster = BTranslatorRoster::Default();
	BBitmapStream result;
	if (roster->Translate(stream, NULL, NULL, &result, B_TRANSLATOR_BITMAP) != B_OK)
		return NULL;
	BBitmap* bitmap = NULL;
	result.DetachBitmap(&bitmap);
	return bitmap;
}
