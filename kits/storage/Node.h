// BNode: the data of a file system entry, with its attributes.
#pragma once

#include <memory>

#include <SupportDefs.h>

#include <Statable.h>
#include <fs_attr.h>

class BDirectory;
class BEntry;
class BString;
struct entry_ref;

namespace BPrivate {
class Descriptor;
}


// A node by its number. A small value.
struct node_ref {
	node_ref();
	node_ref(dev_t device, ino_t node);

	bool operator==(const node_ref& other) const;
	bool operator!=(const node_ref& other) const;

	dev_t device;
	ino_t node;
};

bool operator<(const node_ref& a, const node_ref& b);


// Attributes are extended attributes "user.be.NAME" whose value starts with the four bytes of the
// type. Where the file system has none, they are kept in memory until the program ends.
class BNode : public BStatable {
public:
	BNode();
	BNode(const entry_ref* ref);
	BNode(const BEntry* entry);
	BNode(const char* path);
	BNode(const BDirectory* directory, const char* path);
	BNode(const BNode& node);
	virtual ~BNode();

	status_t InitCheck() const;
	virtual status_t GetStat(struct stat* _stat) const;

	// A symbolic link is not followed: the node is the link's own.
	status_t SetTo(const entry_ref* ref);
	status_t SetTo(const BEntry* entry);
	status_t SetTo(const char* path);
	status_t SetTo(const BDirectory* directory, const char* path);
	void Unset();

	// These and the attribute functions answer B_FILE_ERROR when there is no node. A lock is
	// advisory, between those who lock too: B_BUSY when it is locked, B_BAD_VALUE for unlocking
	// what was not. It ends with the node and its copies.
	status_t Lock();
	status_t Unlock();
	status_t Sync();

	// The number of bytes, or an error. Writing replaces the attribute's type; what lies behind
	// the written bytes is kept when `offset` is not 0 and cut off when it is.
	ssize_t WriteAttr(
		const char* name, type_code type, off_t offset, const void* buffer, size_t length);
	ssize_t ReadAttr(
		const char* name, type_code type, off_t offset, void* buffer, size_t length) const;
	status_t RemoveAttr(const char* name);
	status_t RenameAttr(const char* oldName, const char* newName);
	status_t GetAttrInfo(const char* name, struct attr_info* _info) const;
	// `buffer` has room for B_ATTR_NAME_LENGTH + 1 bytes. B_ENTRY_NOT_FOUND at the end.
	status_t GetNextAttrName(char* buffer);
	status_t RewindAttrs();
	status_t WriteAttrString(const char* name, const BString* data);
	status_t ReadAttrString(const char* name, BString* _result) const;

	BNode& operator=(const BNode& node);
	bool operator==(const BNode& node) const;
	bool operator!=(const BNode& node) const;

	// Our own duplicate of the descriptor for the caller to close, or an error.
	int Dup();

private:
	friend class BDirectory;
	friend class BEntry;
	friend class BFile;
	friend class BAppFileInfo;
	friend class BNodeInfo;
	friend class BResources;
	friend class BSymLink;

	struct AttributeNames;

	virtual void close_fd();
	virtual status_t set_stat(struct stat& stat, uint32 what);
	status_t _SetTo(int directoryFd, const char* path);
	// Takes the descriptor over; a negative one means that `error` is why there is none.
	status_t _Adopt(int fd, status_t error);
	int _Fd() const;

	// Copies share it, as they share the position. NULL when unset.
	std::shared_ptr<BPrivate::Descriptor> fDescriptor;
	status_t fCStatus;
	std::unique_ptr<AttributeNames> fAttributes; // the iteration; NULL before the first step
};
