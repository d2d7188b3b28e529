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
#include "storage/private/ResourceFormat.h"
#include "storage/private/ResourceReader.h"
#include "storage/private/ResourceTable.h"
#include "storage/private/ResourceWriter.h"

using namespace BPrivate;

namespace {

constexpr size_t kLargestName = 65534; // its size, with the terminator, is written as 16 bits
constexpr size_t kLargestResource = 0xffff0000;


// The file's size and the time of its last writing: while they stay, the places that were read
// from its table are good.
struct Stamp {
	off_t size = 0;
	timespec time = {};

	bool operator==(const Stamp& other) const
	{
		return size == other.size && time.tv_sec == other.time.tv_sec
			&& time.tv_nsec == other.time.tv_nsec;
	}
};


Stamp
StampOf(int fd)
{
	struct stat stat;
	if (fstat(fd, &stat) < 0)
		return Stamp();
	return { stat.st_size, stat.st_mtim };
}


std::unique_ptr<ResourceItem>
NewItem(type_code type, int32 id, const char* name, const void* data, size_t size)
{
	auto item = std::make_unique<ResourceItem>();
	item->type = type;
	item->id = id;
	item->named = name != NULL;
	item->name = name != NULL ? name : "";
	item->size = size;
	item->data = malloc(std::max<size_t>(size, 1));
	if (item->data == NULL)
		return nullptr;
	memcpy(item->data, data, size);
	return item;
}

} // namespace


struct BResources::State {
	ResourceTable table;
	ResourceFrame frame;
	Stamp stamp;
	std::string path; // as far as it is known, to find a file that was replaced
	bool readOnly = false;
	bool changed = false;
	bool failed = false; // at the last Sync(), and somebody was told

	ResourceItem* Load(ResourceItem* item, int fd)
	{
		if (item == NULL || item->data != NULL)
			return item;
		if (!(StampOf(fd) == stamp))
			return NULL; // somebody wrote over the file: the places mean nothing now
		item->data = ReadResourceData(*item, Source(fd));
		table.DataChanged(item, NULL);
		return item->data != NULL ? item : NULL;
	}

	ResourceSource Source(int fd) const { return { fd, frame.info.big_endian }; }

	status_t LoadAll(int fd)
	{
		int32 failures = 0;
		for (int32 i = 0; i < table.Count(); i++) {
			if (Load(table.At(i), fd) == NULL)
				failures++;
		}
		return -failures;
	}

	// Whether all that a save needs can be had.
	bool IsIntact(int fd)
	{
		if (StampOf(fd) == stamp)
			return true;
		for (int32 i = 0; i < table.Count(); i++) {
			if (table.At(i)->data == NULL)
				return false;
		}
		return frame.info.base <= static_cast<off_t>(kX86HeaderSize);
	}

	// What the file has besides its resources. What a damaged or foreign file holds is given up; an
	// executable's own part never is.
	void AdoptFrame(const ResourceReader& reader, status_t status)
	{
		frame = ResourceFrame();
		if (reader.Info().kind == B_NO_RESOURCE_FILE)
			return;
		frame.info = reader.Info();
		frame.size = reader.FileSize();
		if (status == B_OK)
			frame.extras = reader.Extras();
	}

	status_t Adopt(ResourceReader& reader)
	{
		frame.info = reader.Info();
		frame.extras = reader.Extras();
		frame.size = reader.FileSize();
		for (auto& item : reader.Items())
			table.Add(std::move(item));
		return B_OK;
	}
};


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
		auto copy = NewItem(
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


// #pragma mark - changes


status_t
BResources::AddResource(type_code type, int32 id, const void* data, size_t length, const char* name)
{
	if (data == NULL || length > kLargestResource)
		return B_BAD_VALUE;
	if (name != NULL && strlen(name) > kLargestName)
		return B_NAME_TOO_LONG;
	const status_t status = _CheckChange();
	if (status != B_OK)
		return status;
	ResourceItem* old = fState->table.Find(type, id);
	if (old == NULL && fState->table.Count() >= static_cast<int32>(kMostResources))
		return B_NOT_ALLOWED; // the file could not be read any more

	// The bytes may be the old resource's own.
	auto item = NewItem(type, id, name, data, length);
	if (item == nullptr)
		return B_NO_MEMORY;
	if (old != NULL)
		fState->table.Remove(old);
	fState->table.Add(std::move(item));
	fState->changed = true;
	return B_OK;
}


bool
BResources::HasResource(type_code type, int32 id)
{
	return fState->table.Find(type, id) != NULL;
}


bool
BResources::HasResource(type_code type, const char* name)
{
	return fState->table.Find(type, name) != NULL;
}


namespace {

template<typename Type, typename Value>
void
Answer(Type* _answer, Value value)
{
	if (_answer != NULL)
		*_answer = value;
}

} // namespace


bool
BResources::GetResourceInfo(
	int32 index, type_code* _type, int32* _id, const char** _name, size_t* _length)
{
	const ResourceItem* item = fState->table.At(index);
	if (item == NULL)
		return false;
	Answer(_type, item->type);
	Answer(_id, item->id);
	Answer(_name, item->name.c_str());
	Answer(_length, item->size);
	return true;
}


bool
BResources::GetResourceInfo(
	type_code byType, int32 index, int32* _id, const char** _name, size_t* _length)
{
	const ResourceItem* item = fState->table.At(byType, index);
	if (item == NULL)
		return false;
	Answer(_id, item->id);
	Answer(_name, item->name.c_str());
	Answer(_length, item->size);
	return true;
}


bool
BResources::GetResourceInfo(type_code byType, int32 id, const char** _name, size_t* _length)
{
	const ResourceItem* item = fState->table.Find(byType, id);
	if (item == NULL)
		return false;
	Answer(_name, item->name.c_str());
	Answer(_length, item->size);
	return true;
}


bool
BResources::GetResourceInfo(type_code byType, const char* name, int32* _id, size_t* _length)
{
	const ResourceItem* item = fState->table.Find(byType, name);
	if (item == NULL)
		return false;
	Answer(_id, item->id);
	Answer(_length, item->size);
	return true;
}


bool
BResources::GetResourceInfo(
	const void* pointer, type_code* _type, int32* _id, size_t* _length, const char** _name)
{
	const ResourceItem* item = fState->table.Find(pointer);
	if (item == NULL)
		return false;
	Answer(_type, item->type);
	Answer(_id, item->id);
	Answer(_length, item->size);
	Answer(_name, item->name.c_str());
	return true;
}


status_t
BResources::RemoveResource(const void* resource)
{
	const status_t status = _CheckChange();
	if (resource != NULL && status != B_OK)
		return status;
	ResourceItem* item = fState->table.Find(resource);
	if (item == NULL)
		return B_BAD_VALUE;
	fState->table.Remove(item);
	fState->changed = true;
	return B_OK;
}


status_t
BResources::RemoveResource(type_code type, int32 id)
{
	const status_t status = _CheckChange();
	if (status != B_OK)
		return status;
	ResourceItem* item = fState->table.Find(type, id);
	if (item == NULL)
		return B_BAD_VALUE;
	fState->table.Remove(item);
	fState->changed = true;
	return B_OK;
}


status_t
BResources::WriteResource(type_code type, int32 id, const void* data, off_t offset, size_t length)
{
	if (data == NULL || offset < 0 || static_cast<uint64>(offset) > kLargestResource
		|| length > kLargestResource - static_cast<size_t>(offset))
		return B_BAD_VALUE;
	const status_t status = _CheckChange();
	if (status != B_OK)
		return status;
	ResourceItem* item = fState->table.Find(type, id);
	if (item == NULL)
		return B_BAD_VALUE;
	if (fState->Load(item, fFile._Fd()) == NULL)
		return B_IO_ERROR;

	// A new block, because the bytes may come from the old one.
	const void* oldData = item->data;
	const size_t size = std::max(item->size, static_cast<size_t>(offset) + length);
	char* bytes = static_cast<char*>(malloc(std::max<size_t>(size, 1)));
	if (bytes == NULL)
		return B_NO_MEMORY;
	memcpy(bytes, oldData, item->size);
	memset(bytes + item->size, 0, size - item->size);
	memcpy(bytes + offset, data, length);
	void* old = item->data;
	item->data = bytes;
	item->size = size;
	item->offset = -1;
	fState->table.DataChanged(item, old);
	free(old);
	fState->changed = true;
	return B_OK;
}


status_t
BResources::ReadResource(type_code type, int32 id, void* data, off_t offset, size_t length)
{
	if (data == NULL || offset < 0)
		return B_BAD_VALUE;
	ResourceItem* item = fState->table.Find(type, id);
	if (item == NULL)
		return B_BAD_VALUE;
	if (fState->Load(item, fFile._Fd()) == NULL)
		return B_IO_ERROR;
	if (static_cast<uint64>(offset) < item->size)
		memcpy(data, static_cast<const char*>(item->data) + offset,
			std::min(length, item->size - static_cast<size_t>(offset)));
	return B_OK;
}


namespace {

void*
CopyOf(const void* data, size_t size, size_t* _length)
{
	void* copy = data != NULL ? malloc(std::max<size_t>(size, 1)) : NULL;
	if (copy != NULL)
		memcpy(copy, data, size);
	Answer(_length, copy != NULL ? size : 0);
	return copy;
}

} // namespace


void*
BResources::FindResource(type_code type, int32 id, size_t* _length)
{
	size_t size = 0;
	const void* data = LoadResource(type, id, &size);
	return CopyOf(data, size, _length);
}


void*
BResources::FindResource(type_code type, const char* name, size_t* _length)
{
	size_t size = 0;
	const void* data = LoadResource(type, name, &size);
	return CopyOf(data, size, _length);
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


status_t
BResources::_CheckChange() const
{
	if (fFile.InitCheck() == B_OK && fState->readOnly)
		return B_NOT_ALLOWED;
	return B_OK;
}
