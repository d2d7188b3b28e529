#include <Node.h>

#include <errno.h>
#include <fcntl.h>
#include <stdlib.h>
#include <string.h>
#include <unistd.h>

#include <algorithm>
#include <string>
#include <tuple>
#include <vector>

#include <Directory.h>
#include <Entry.h>
#include <Errors.h>
#include <String.h>
#include <TypeConstants.h>

#include "storage/private/Descriptor.h"
#include "storage/private/Errno.h"
#include "storage/private/NodeAttributes.h"
#include "storage/private/SetStat.h"

using namespace BPrivate;

// #pragma mark - node_ref


node_ref::node_ref() : device(static_cast<dev_t>(-1)), node(static_cast<ino_t>(-1))
{
}


node_ref::node_ref(dev_t device, ino_t node) : device(device), node(node)
{
}


bool
node_ref::operator==(const node_ref& other) const
{
	return device == other.device && node == other.node;
}


bool
node_ref::operator!=(const node_ref& other) const
{
	return !(*this == other);
}


bool
operator<(const node_ref& a, const node_ref& b)
{
	return std::tie(a.device, a.node) < std::tie(b.device, b.node);
}


// #pragma mark - BNode

struct BNode::AttributeNames {
	std::vector<std::string> names;
	size_t next = 0;
};


BNode::BNode() : fCStatus(B_NO_INIT)
{
}


BNode::BNode(const entry_ref* ref) : fCStatus(B_NO_INIT)
{
	SetTo(ref);
}


BNode::BNode(const BEntry* entry) : fCStatus(B_NO_INIT)
{
	SetTo(entry);
}


BNode::BNode(const char* path) : fCStatus(B_NO_INIT)
{
	SetTo(path);
}


BNode::BNode(const BDirectory* directory, const char* path) : fCStatus(B_NO_INIT)
{
	SetTo(directory, path);
}


BNode::BNode(const BNode& node) :
	BStatable(node), fDescriptor(node.fDescriptor), fCStatus(node.fCStatus)
{
}


BNode::~BNode()
{
	// Derived classes have closed what is theirs by now.
	fDescriptor.reset();
}


status_t
BNode::InitCheck() const
{
	return fCStatus;
}


status_t
BNode::GetStat(struct stat* _stat) const
{
	if (_stat == NULL)
		return B_BAD_VALUE;
	if (fCStatus != B_OK)
		return fCStatus;
	return fstat(_Fd(), _stat) < 0 ? LastStatus() : B_OK;
}


status_t
BNode::SetTo(const entry_ref* ref)
{
	const BEntry entry(ref);
	return SetTo(&entry);
}


status_t
BNode::SetTo(const BEntry* entry)
{
	if (entry == NULL || entry->InitCheck() != B_OK) {
		Unset();
		return fCStatus = entry == NULL ? B_BAD_VALUE : entry->InitCheck();
	}
	return _SetTo(entry->_DirectoryFd(), entry->fName);
}


status_t
BNode::SetTo(const char* path)
{
	return _SetTo(AT_FDCWD, path);
}


status_t
BNode::SetTo(const BDirectory* directory, const char* path)
{
	if (directory == NULL || directory->fDescriptor == nullptr
		|| (path != NULL && path[0] == '/')) {
		Unset();
		return fCStatus = B_BAD_VALUE;
	}
	const std::shared_ptr<Descriptor> start = directory->fDescriptor;
	return _SetTo(start->Fd(), path);
}


void
BNode::Unset()
{
	close_fd();
	fAttributes.reset();
	fCStatus = B_NO_INIT;
}


status_t
BNode::Lock()
{
	if (fCStatus != B_OK)
		return B_FILE_ERROR;
	return fDescriptor->Lock();
}


status_t
BNode::Unlock()
{
	if (fCStatus != B_OK)
		return B_FILE_ERROR;
	return fDescriptor->Unlock();
}


status_t
BNode::Sync()
{
	if (fCStatus != B_OK)
		return B_FILE_ERROR;
	while (fsync(_Fd()) < 0) {
		if (errno != EINTR)
			return LastStatus();
	}
	return B_OK;
}


// #pragma mark - attributes


ssize_t
BNode::WriteAttr(const char* name, type_code type, off_t offset, const void* buffer, size_t length)
{
	if (fCStatus != B_OK)
		return B_FILE_ERROR;
	if (name == NULL || buffer == NULL || offset < 0)
		return B_BAD_VALUE;
	// More than any file system of the host keeps in an attribute.
	if (offset > 0x1000000 || length > 0x1000000)
		return B_DEVICE_FULL;

	AttributeValue value;
	if (offset > 0) {
		const status_t status = ReadAttribute(_Fd(), name, &value);
		if (status != B_OK && status != B_ENTRY_NOT_FOUND)
			return status;
		if (value.data.size() < offset + length)
			value.data.resize(offset + length);
		memcpy(value.data.data() + offset, buffer, length);
	} else
		value.data.assign(static_cast<const char*>(buffer), length);
	value.type = type;

	const status_t status = WriteAttribute(_Fd(), name, value);
	return status == B_OK ? static_cast<ssize_t>(length) : status;
}


ssize_t
BNode::ReadAttr(const char* name, type_code, off_t offset, void* buffer, size_t length) const
{
	if (fCStatus != B_OK)
		return B_FILE_ERROR;
	if (name == NULL || buffer == NULL || offset < 0)
		return B_BAD_VALUE;

	AttributeValue value;
	const status_t status = ReadAttribute(_Fd(), name, &value);
	if (status != B_OK)
		return status;
	if (static_cast<uint64>(offset) >= value.data.size())
		return 0;
	const size_t size = std::min(length, value.data.size() - static_cast<size_t>(offset));
	memcpy(buffer, value.data.data() + offset, size);
	return size;
}


status_t
BNode::RemoveAttr(const char* name)
{
	if (fCStatus != B_OK)
		return B_FILE_ERROR;
	return RemoveAttribute(_Fd(), name);
}


status_t
BNode::RenameAttr(const char* oldName, const char* newName)
{
	if (fCStatus != B_OK)
		return B_FILE_ERROR;
	if (oldName == NULL || newName == NULL)
		return B_BAD_VALUE;
	AttributeValue value;
	status_t status = ReadAttribute(_Fd(), oldName, &value);
	if (status != B_OK || strcmp(oldName, newName) == 0)
		return status;
	status = WriteAttribute(_Fd(), newName, value);
	return status == B_OK ? RemoveAttribute(_Fd(), oldName) : status;
}


status_t
BNode::GetAttrInfo(const char* name, struct attr_info* _info) const
{
	if (fCStatus != B_OK)
		return B_FILE_ERROR;
	if (name == NULL || _info == NULL)
		return B_BAD_VALUE;
	AttributeValue value;
	const status_t status = ReadAttribute(_Fd(), name, &value);
	if (status == B_OK) {
		_info->type = value.type;
		_info->size = value.data.size();
	}
	return status;
}


status_t
BNode::GetNextAttrName(char* buffer)
{
	if (buffer == NULL)
		return B_BAD_VALUE;
	if (fCStatus != B_OK)
		return B_FILE_ERROR;
	if (fAttributes == nullptr) {
		auto attributes = std::make_unique<AttributeNames>();
		const status_t status = ListAttributes(_Fd(), &attributes->names);
		if (status != B_OK)
			return status;
		fAttributes = std::move(attributes);
	}
	if (fAttributes->next == fAttributes->names.size())
		return B_ENTRY_NOT_FOUND;
	strcpy(buffer, fAttributes->names[fAttributes->next++].c_str());
	return B_OK;
}


status_t
BNode::RewindAttrs()
{
	if (fCStatus != B_OK)
		return B_FILE_ERROR;
	fAttributes.reset();
	return B_OK;
}


status_t
BNode::WriteAttrString(const char* name, const BString* data)
{
	if (name == NULL || data == NULL)
		return B_BAD_VALUE;
	const ssize_t length = data->Length() + 1;
	const ssize_t written = WriteAttr(name, B_STRING_TYPE, 0, data->String(), length);
	return written < 0 ? static_cast<status_t>(written) : B_OK;
}


status_t
BNode::ReadAttrString(const char* name, BString* _result) const
{
	if (fCStatus != B_OK)
		return B_FILE_ERROR;
	if (name == NULL || _result == NULL)
		return B_BAD_VALUE;
	AttributeValue value;
	const status_t status = ReadAttribute(_Fd(), name, &value);
	_result->SetTo(status == B_OK ? value.data.c_str() : "");
	return status;
}


// #pragma mark - operators


BNode&
BNode::operator=(const BNode& node)
{
	if (this != &node) {
		Unset();
		fDescriptor = node.fDescriptor;
		fCStatus = node.fCStatus;
	}
	return *this;
}


bool
BNode::operator==(const BNode& node) const
{
	if (fCStatus != B_OK || node.fCStatus != B_OK)
		return fCStatus != B_OK && node.fCStatus != B_OK;
	node_ref mine;
	node_ref theirs;
	return GetNodeRef(&mine) == B_OK && node.GetNodeRef(&theirs) == B_OK && mine == theirs;
}


bool
BNode::operator!=(const BNode& node) const
{
	return !(*this == node);
}


int
BNode::Dup()
{
	if (fCStatus != B_OK)
		return fCStatus;
	const int fd = fcntl(_Fd(), F_DUPFD_CLOEXEC, 0);
	return fd < 0 ? LastStatus() : fd;
}


// #pragma mark - private


void
BNode::close_fd()
{
	fDescriptor.reset();
}


status_t
BNode::set_stat(struct stat& stat, uint32 what)
{
	if (fCStatus != B_OK)
		return fCStatus;
	return SetStatAt(AT_FDCWD, ProcPathOf(_Fd()).c_str(), 0, stat, what);
}


status_t
BNode::_SetTo(int directoryFd, const char* path)
{
	if (path == NULL && directoryFd == AT_FDCWD) {
		Unset();
		return fCStatus = B_BAD_VALUE;
	}
	if (path == NULL)
		path = ".";
	if (path[0] == '\0') {
		Unset();
		return fCStatus = B_ENTRY_NOT_FOUND;
	}

	// Opening a device or a pipe can do things, and locks and fsync() need more than a path: only
	// files and directories are opened for reading, if we may.
	int fd = OpenAt(directoryFd, path, O_PATH | O_NOFOLLOW);
	status_t error = fd < 0 ? LastStatus() : B_OK;
	struct stat stat;
	if (fd >= 0 && fstat(fd, &stat) == 0 && (S_ISREG(stat.st_mode) || S_ISDIR(stat.st_mode))) {
		const int readable = OpenAt(AT_FDCWD, ProcPathOf(fd).c_str(), O_RDONLY | O_NONBLOCK);
		if (readable >= 0) {
			close(fd);
			fd = readable;
		}
	}
	return _Adopt(fd, error);
}


status_t
BNode::_Adopt(int fd, status_t error)
{
	Unset();
	if (fd < 0)
		return fCStatus = error;
	fDescriptor = std::make_shared<Descriptor>(fd);
	return fCStatus = B_OK;
}


int
BNode::_Fd() const
{
	return fDescriptor != nullptr ? fDescriptor->Fd() : -1;
}
