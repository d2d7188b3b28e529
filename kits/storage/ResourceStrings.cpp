#include <ResourceStrings.h>

#include <Autolock.h>
#include <Resources.h>
#include <String.h>

namespace {

// The running program's file.
status_t
GetProgram(entry_ref* _ref)
{
	const BEntry entry("/proc/self/exe", true);
	return entry.GetRef(_ref);
}

} // namespace


BResourceStrings::BResourceStrings() : fLock("resource strings"), fStatus(B_NO_INIT)
{
	SetStringFile(NULL);
}


BResourceStrings::BResourceStrings(const entry_ref& ref) :
	fLock("resource strings"), fStatus(B_NO_INIT)
{
	SetStringFile(&ref);
}


BResourceStrings::~BResourceStrings()
{
}


status_t
BResourceStrings::InitCheck()
{
	BAutolock lock(fLock);
	return fStatus;
}


BString*
BResourceStrings::NewString(int32 id)
{
	BAutolock lock(fLock);
	const char* string = FindString(id);
	return string != NULL ? new BString(string) : NULL;
}


const char*
BResourceStrings::FindString(int32 id)
{
	BAutolock lock(fLock);
	if (fStatus != B_OK)
		return NULL;
	size_t size = 0;
	const void* data = fResources->LoadResource(RESOURCE_TYPE, id, &size);
	// One that does not end would be read beyond its end.
	const char* string = static_cast<const char*>(data);
	return data != NULL && size > 0 && string[size - 1] == '\0' ? string : NULL;
}


status_t
BResourceStrings::SetStringFile(const entry_ref* ref)
{
	BAutolock lock(fLock);
	fResources.reset();
	entry_ref file;
	fStatus = B_OK;
	if (ref != NULL)
		file = *ref;
	else
		fStatus = GetProgram(&file);
	auto resources = std::make_unique<BResources>();
	if (fStatus == B_OK) {
		BFile opened(&file, B_READ_ONLY);
		fStatus = resources->SetTo(&opened);
	}
	if (fStatus != B_OK)
		return fStatus;
	fRef = file;
	fResources = std::move(resources);
	return B_OK;
}


status_t
BResourceStrings::GetStringFile(entry_ref* _ref)
{
	if (_ref == NULL)
		return B_BAD_VALUE;
	BAutolock lock(fLock);
	if (fStatus != B_OK)
		return fStatus;
	*_ref = fRef;
	return B_OK;
}
