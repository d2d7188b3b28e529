// What a shelf saves, and how it is filled again.
#include <Shelf.h>

#include <cerrno>

#include <DataIO.h>
#include <Dragger.h>
#include <Entry.h>
#include <File.h>
#include <Message.h>
#include <Path.h>
#include <View.h>

#include "interface/private/Replicants.h"
#include "storage/private/AtomicFile.h"

using BPrivate::Replicant;


BShelf::BShelf(const entry_ref* ref, BView* view, bool allowDrags, const char* shelfType) :
	BHandler(shelfType), fAllowsDragging(allowDrags)
{
	_Init(view);
	if (ref == NULL)
		return;
	fFile = std::make_unique<entry_ref>(*ref);
	BFile file(ref, B_READ_ONLY);
	if (file.InitCheck() == B_OK)
		_ReadStream(&file);
}


BShelf::BShelf(BDataIO* stream, BView* view, bool allowDrags, const char* shelfType) :
	BHandler(shelfType), fAllowsDragging(allowDrags)
{
	_Init(view);
	if (stream == NULL)
		return;
	SetSaveLocation(stream);
	_ReadStream(stream);
}


status_t
BShelf::SetSaveLocation(BDataIO* stream)
{
	fFile.reset();
	fStream = stream;
	const BPositionIO* positioned = dynamic_cast<BPositionIO*>(stream);
	fStreamStart = positioned != NULL ? positioned->Position() : 0;
	return B_OK;
}


status_t
BShelf::SetSaveLocation(const entry_ref* ref)
{
	fStream = NULL;
	fFile = ref != NULL ? std::make_unique<entry_ref>(*ref) : nullptr;
	return B_OK;
}


BDataIO*
BShelf::SaveLocation(entry_ref* _ref) const
{
	if (fFile != nullptr && _ref != NULL)
		*_ref = *fFile;
	return fStream;
}


// #pragma mark - writing


status_t
BShelf::Save()
{
	if (fFile == nullptr && fStream == NULL)
		return B_ERROR;
	BMessage saved;
	status_t status = _WriteTo(&saved);
	if (status != B_OK)
		return status;
	std::vector<char> bytes(static_cast<size_t>(saved.FlattenedSize()));
	status = saved.Flatten(bytes.data(), static_cast<ssize_t>(bytes.size()));
	if (status == B_OK) {
		status = fFile != nullptr ? _SaveToFile(bytes.data(), bytes.size())
								  : _SaveToStream(bytes.data(), bytes.size());
	}
	if (status == B_OK)
		SetDirty(false);
	return status;
}


status_t
BShelf::_SaveToFile(const char* bytes, size_t size) const
{
	const BPath path(fFile.get());
	status_t status = path.InitCheck();
	BPrivate::AtomicFile file;
	if (status == B_OK)
		status = file.SetTo(path.Path());
	if (status == B_OK)
		status = file.Write(bytes, size);
	return status == B_OK ? file.Commit() : status;
}


status_t
BShelf::_SaveToStream(const char* bytes, size_t size) const
{
	BPositionIO* positioned = dynamic_cast<BPositionIO*>(fStream);
	if (positioned != NULL && positioned->Seek(fStreamStart, SEEK_SET) < 0)
		return B_IO_ERROR;
	return fStream->WriteExactly(bytes, size);
}


status_t
BShelf::_WriteTo(BMessage* saved) const
{
	*saved = fSaved;
	for (const char* name : { "_zom_dsp", "_zom_alw", "_sg_cnt", "replicant" })
		saved->RemoveName(name);
	status_t status = saved->AddBool("_zom_dsp", fDisplaysZombies);
	if (status == B_OK)
		status = saved->AddBool("_zom_alw", fAllowsZombies);
	if (status == B_OK)
		status = saved->AddInt32("_sg_cnt", static_cast<int32>(fNextId));
	for (size_t i = 0; i < fReplicants.size() && status == B_OK; i++) {
		const Replicant& replicant = *fReplicants[i];
		BMessage archive;
		status = _ArchiveReplicant(replicant, &archive);
		if (status != B_OK)
			continue;
		const BView* top = _TopOf(replicant);
		BMessage entry;
		entry.AddInt32("uniqueid", static_cast<int32>(replicant.id));
		entry.AddPoint("position", top != NULL ? top->Frame().LeftTop() : replicant.location);
		entry.AddMessage("message", &archive);
		status = saved->AddMessage("replicant", &entry);
	}
	return status;
}


status_t
BShelf::_ArchiveReplicant(uint32 id, BMessage* archive) const
{
	const int32 index = IndexOf(id);
	return index >= 0 ? _ArchiveReplicant(*fReplicants[index], archive) : B_BAD_VALUE;
}


// A zombie is what it came as, and so is a replicant whose views are gone.
status_t
BShelf::_ArchiveReplicant(const Replicant& replicant, BMessage* archive) const
{
	if (replicant.isZombie || _TopOf(replicant) == NULL) {
		*archive = *replicant.archive;
		return B_OK;
	}
	archive->what = replicant.archive->what;
	return replicant.dragger->_ArchiveReplicant(archive);
}


// #pragma mark - reading


// Without a message in the stream the shelf starts empty.
void
BShelf::_ReadStream(BDataIO* stream)
{
	BMessage saved;
	if (fContainer != NULL && saved.Unflatten(stream) == B_OK)
		_ReadFrom(saved);
}


void
BShelf::_ReadFrom(const BMessage& saved)
{
	fSaved = saved;
	fSaved.RemoveName("replicant");
	fDisplaysZombies = saved.GetBool("_zom_dsp", fDisplaysZombies);
	fAllowsZombies = saved.GetBool("_zom_alw", fAllowsZombies);
	BMessage entry;
	for (int32 i = 0; saved.FindMessage("replicant", i, &entry) == B_OK; i++) {
		BMessage archive;
		if (entry.FindMessage("message", &archive) != B_OK)
			continue;
		BPoint position;
		const bool hasPosition = entry.FindPoint("position", &position) == B_OK;
		const uint32 id =
			static_cast<uint32>(entry.GetInt32("uniqueid", static_cast<int32>(fNextId)));
		_Add(archive, hasPosition ? &position : NULL, IndexOf(id) < 0 ? id : fNextId);
	}
	const uint32 next = static_cast<uint32>(saved.GetInt32("_sg_cnt", 0));
	if (next > fNextId)
		fNextId = next;
	fIsDirty = false;
}
