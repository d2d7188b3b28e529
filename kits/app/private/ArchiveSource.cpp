#include "app/private/ArchiveSource.h"

#include <utility>

#include "app/private/LookUps.h"
#include "app/private/MessageData.h"
#include "app/private/MessagePrivate.h"

namespace BPrivate {


ArchiveSource::ArchiveSource()
{
}


ArchiveSource::ArchiveSource(BMessage* archive) : fWhat(archive->what)
{
	MessagePrivate message(archive);
	if (message.GetLookUps() == nullptr) {
		LookUps* lookUps = new LookUps(message.Data());
		message.SetLookUps(lookUps);
		lookUps->Release();
	}
	fLookUps = message.GetLookUps();
	fLookUps->Acquire();
	fData = fLookUps->Data();
	if (fData != nullptr)
		fData->Acquire();
}


ArchiveSource::ArchiveSource(const ArchiveSource& other) :
	fData(other.fData), fLookUps(other.fLookUps), fWhat(other.fWhat)
{
	if (fData != nullptr)
		fData->Acquire();
	if (fLookUps != nullptr)
		fLookUps->Acquire();
}


ArchiveSource::ArchiveSource(ArchiveSource&& other) :
	fData(std::exchange(other.fData, nullptr)), fLookUps(std::exchange(other.fLookUps, nullptr)),
	fWhat(other.fWhat)
{
}


ArchiveSource::~ArchiveSource()
{
	if (fData != nullptr)
		fData->Release();
	if (fLookUps != nullptr)
		fLookUps->Release();
}


ArchiveSource&
ArchiveSource::operator=(ArchiveSource other)
{
	std::swap(fData, other.fData);
	std::swap(fLookUps, other.fLookUps);
	std::swap(fWhat, other.fWhat);
	return *this;
}


bool
ArchiveSource::IsSet() const
{
	return fLookUps != nullptr;
}


BMessage
ArchiveSource::Archive() const
{
	BMessage archive(fWhat);
	MessagePrivate(&archive).SetData(fData);
	return archive;
}


bool
ArchiveSource::IsKnown(const char* name) const
{
	const int32 field = fData != nullptr ? fData->Find(name) : -1;
	return field >= 0 && fLookUps->IsMarked(uint32(field));
}


bool
ArchiveSource::IsKnownField(uint32 number) const
{
	return fLookUps->IsMarked(number);
}


void
ArchiveSource::SetKnown(const char* name)
{
	const int32 field = fData != nullptr ? fData->Find(name) : -1;
	if (field >= 0)
		fLookUps->Mark(fData, field, name);
}


bool
ArchiveSource::WasManaged() const
{
	return fData != nullptr && fData->Note() != nullptr;
}


} // namespace BPrivate
