#include <Resources.h>

#include <fcntl.h>
#include <stdlib.h>
#include <string.h>
#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>
#include <string>
#include <vector>

#include <Entry.h>

#include "storage/private/AtomicFile.h"
#include "storage/private/Descriptor.h"
#include "storage/private/Errno.h"
#include "storage/private/ResourcesState.h"

using namespace BPrivate;


BResources::BResources() : fState(std::make_unique<State>())
{
}


BResources::BResources(const BFile* file, bool clobber) : fState(std::make_unique<State>())
{
	SetTo(file, clobber);
}


BResources::BResources(const char* path, bool clobber) : fState(std::make_unique<State>())
{
	SetTo(path, clobber);
}


BResources::BResources(const entry_ref* ref, bool clobber) : fState(std::make_unique<State>())
{
	SetTo(ref, clobber);
}


BResources::~BResources()
{
	Unset();
}


status_t
BResources::SetTo(const BFile* file, bool clobber)
{
	// It may be our own, or see our file: then it follows what is saved now.
	const BFile given = file != NULL ? *file : BFile();
	const BFile ours(fFile);
	const bool follows = fState->changed && given.InitCheck() == B_OK
		&& given.fDescriptor != ours.fDescriptor && given == ours;
	Unset();
	if (file == NULL)
		return B_OK;
	if (follows)
		given.fDescriptor->Replace(ours._Fd());
	status_t status = given.InitCheck();
	if (status != B_OK)
		return status;
	fFile = given;
	status = _SetTo(clobber);
	if (status != B_OK)
		Unset();
	return status;
}


status_t
BResources::SetTo(const char* path, bool clobber)
{
	Unset(); // before the file is opened, because it may be the one that is saved now
	if (path == NULL)
		return B_BAD_VALUE;
	BFile file(path, B_READ_WRITE);
	if (file.InitCheck() != B_OK && file.InitCheck() != B_ENTRY_NOT_FOUND)
		file.SetTo(path, B_READ_ONLY);
	return SetTo(&file, clobber);
}


status_t
BResources::SetTo(const entry_ref* ref, bool clobber)
{
	Unset(); // before the file is opened, because it may be the one that is saved now
	if (ref == NULL)
		return B_BAD_VALUE;
	BFile file(ref, B_READ_WRITE);
	if (file.InitCheck() != B_OK && file.InitCheck() != B_ENTRY_NOT_FOUND)
		file.SetTo(ref, B_READ_ONLY);
	return SetTo(&file, clobber);
}


void
BResources::Unset()
{
	if (fState->changed && !fState->failed && fFile.InitCheck() == B_OK)
		Sync();
	fFile.Unset();
	fState = std::make_unique<State>();
}


status_t
BResources::InitCheck() const
{
	return B_OK;
}


const BFile&
BResources::File() const
{
	return fFile;
}


// #pragma mark - data


const void*
BResources::LoadResource(type_code type, int32 id, size_t* _size)
{
	const ResourceItem* item = fState->Load(fState->table.Find(type, id), fFile._Fd());
	if (item == NULL)
		return NULL;
	if (_size != NULL)
		*_size = item->size;
	return item->data;
}


const void*
BResources::LoadResource(type_code type, const char* name, size_t* _size)
{
	const ResourceItem* item = fState->Load(fState->table.Find(type, name), fFile._Fd());
	if (item == NULL)
		return NULL;
	if (_size != NULL)
		*_size = item->size;
	return item->data;
}


const void*
load_resource(BResources* resources, int32 index, size_t* _size)
{
	return resources->_LoadAt(index, _size);
}


const void*
BResources::_LoadAt(int32 index, size_t* _size)
{
	if (index < 0 || index >= fState->table.Count())
		return NULL;
	const ResourceItem* item = fState->Load(fState->table.At(index), fFile._Fd());
	if (item == NULL)
		return NULL;
	if (_size != NULL)
		*_size = item->size;
	return item->data;
}


status_t
BResources::PreloadResourceType(type_code type)
{
	if (type == 0)
		return fState->LoadAll(fFile._Fd());
	int32 failures = 0;
	for (int32 i = 0; ResourceItem* item = fState->table.At(type, i); i++) {
		if (fState->Load(item, fFile._Fd()) == NULL)
			failures++;
	}
	return -failures;
}


status_t
BResources::Sync()
{
	if (fFile.InitCheck() != B_OK)
		return B_NO_INIT;
	if (fState->readOnly)
		return B_NOT_ALLOWED;
	const status_t status = _Save();
	fState->failed = status != B_OK;
	return status;
}


status_t
BResources::MergeFrom(BFile* from)
{
	if (from == NULL)
		return B_BAD_VALUE;
	BFile read(*from);
	State other;
	ResourceReader reader(read, false);
	const Stamp stamp = StampOf(read._Fd());
	status_t status = read.InitCheck();
	if (status == B_OK)
		status = reader.Read();
	if (status != B_OK)
		return status;
	other.Adopt(reader);
	other.stamp = stamp;
	if (other.LoadAll(read._Fd()) != B_OK)
		return B_IO_ERROR;

	for (int32 i = 0; i < other.table.Count(); i++) {
		const ResourceItem* item = other.table.At(i);
		auto copy = NewResourceItem(
			item->type, item->id, item->named ? item->name.c_str() : NULL, item->data, item->size);
		if (copy == nullptr)
			return B_NO_MEMORY;
		if (ResourceItem* old = fState->table.Find(item->type, item->id))
			fState->table.Remove(old);
		fState->table.Add(std::move(copy));
		fState->changed = true;
	}
	return B_OK;
}


status_t
BResources::WriteTo(BFile* file)
{
	return _WriteTo(file, false);
}


status_t
write_resources_over(BResources* resources, BFile* file)
{
	return resources->_WriteTo(file, true);
}


// #pragma mark - private


status_t
BResources::_SetTo(bool clobber)
{
	fState->readOnly = !fFile.IsWritable();
	fState->path = PathOf(fFile._Fd());
	fState->stamp = StampOf(fFile._Fd());
	ResourceReader reader(fFile, false);
	const status_t status = reader.Read();
	if (!clobber || fState->readOnly) {
		if (status == B_OK)
			fState->Adopt(reader);
		return status;
	}

	if (reader.Info().base == 0)
		return status;
	fState->AdoptFrame(reader, B_ERROR);
	return _Save();
}


// Only the frame of the other file stays; its resources are replaced by ours.
status_t
BResources::_WriteTo(BFile* file, bool clobber)
{
	if (file == NULL)
		return B_BAD_VALUE;
	if (file->InitCheck() != B_OK)
		return file->InitCheck();
	if (!file->IsWritable())
		return B_NOT_ALLOWED;

	BFile target(*file);
	ResourceReader reader(target, false);
	const Stamp stamp = StampOf(target._Fd());
	const status_t status = reader.Read();
	if (status != B_OK && (!clobber || reader.Info().base == 0))
		return status;
	if (fState->LoadAll(fFile._Fd()) != B_OK)
		return B_IO_ERROR;

	fState->AdoptFrame(reader, status);
	fState->stamp = stamp;
	fState->path = PathOf(target._Fd());
	fState->readOnly = false;
	fState->changed = true;
	fFile = target;
	const status_t saved = _Save();
	// Who was told that it failed does not expect it to be tried again at our end.
	if (saved != B_OK)
		fFile.Unset();
	return saved;
}


status_t
BResources::_Save()
{
	const int fd = fFile._Fd();
	if (!fState->IsIntact(fd))
		return B_IO_ERROR;

	AtomicFile file;
	status_t status = file.SetTo(fd, fState->path.c_str());
	std::vector<off_t> offsets;
	if (status == B_OK)
		status =
			WriteResourceFile(file, fState->frame, fd, fState->table, fState->Source(fd), &offsets);
	if (status == B_OK) {
		const off_t position = lseek(fd, 0, SEEK_CUR);
		status = file.Commit();
		if (!file.IsReplaced())
			return status;
		lseek(file.Fd(), position, SEEK_SET);
		fcntl(file.Fd(), F_SETFL, fcntl(fd, F_GETFL) & O_APPEND);
	}
	if (!file.IsReplaced())
		return status;

	const status_t followed = fFile.fDescriptor->Replace(file.Fd());
	if (followed != B_OK)
		return followed;
	for (size_t i = 0; i < offsets.size(); i++)
		fState->table.At(i)->offset = offsets[i];
	if (fState->frame.info.kind == B_EMPTY_FILE)
		fState->frame.info.kind = B_X86_RESOURCE_FILE;
	fState->frame.info.has_section = true;
	fState->frame.size = file.Written();
	fState->stamp = StampOf(fd);
	fState->path = file.Path();
	fState->changed = status != B_OK;
	return status;
}
