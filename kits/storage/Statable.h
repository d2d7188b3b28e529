// BStatable: what is known about a file system node without reading it.
#pragma once

#include <sys/stat.h>
#include <sys/types.h>

#include <SupportDefs.h>

struct node_ref;
class BVolume;


// The base of BEntry and BNode. All times are seconds since 1970, UTC.
class BStatable {
public:
	virtual ~BStatable();

	virtual status_t GetStat(struct stat* _stat) const = 0;

	bool IsFile() const;
	bool IsDirectory() const;
	bool IsSymLink() const;

	status_t GetNodeRef(node_ref* _ref) const;

	status_t GetOwner(uid_t* _owner) const;
	status_t SetOwner(uid_t owner);
	status_t GetGroup(gid_t* _group) const;
	status_t SetGroup(gid_t group);
	status_t GetPermissions(mode_t* _permissions) const;
	status_t SetPermissions(mode_t permissions);
	status_t GetSize(off_t* _size) const;

	status_t GetModificationTime(time_t* _time) const;
	status_t SetModificationTime(time_t time);
	// The host cannot set a creation time: setting it answers B_UNSUPPORTED.
	status_t GetCreationTime(time_t* _time) const;
	status_t SetCreationTime(time_t time);
	status_t GetAccessTime(time_t* _time) const;
	status_t SetAccessTime(time_t time);

	status_t GetVolume(BVolume* _volume) const;

protected:
	enum stat_field {
		kStatOwner = 0x01,
		kStatGroup = 0x02,
		kStatMode = 0x04,
		kStatModificationTime = 0x08,
		kStatAccessTime = 0x10,
		kStatCreationTime = 0x20
	};

	// Writes the fields of `what`, a mask of stat_field.
	virtual status_t set_stat(struct stat& stat, uint32 what) = 0;
};
