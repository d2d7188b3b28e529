#include <Statable.h>

#include <Errors.h>
#include <Node.h>
#include <Volume.h>

BStatable::~BStatable()
{
}


bool
BStatable::IsFile() const
{
	struct stat stat;
	return GetStat(&stat) == B_OK && S_ISREG(stat.st_mode);
}


bool
BStatable::IsDirectory() const
{
	struct stat stat;
	return GetStat(&stat) == B_OK && S_ISDIR(stat.st_mode);
}


bool
BStatable::IsSymLink() const
{
	struct stat stat;
	return GetStat(&stat) == B_OK && S_ISLNK(stat.st_mode);
}


status_t
BStatable::GetNodeRef(node_ref* _ref) const
{
	if (_ref == NULL)
		return B_BAD_VALUE;
	struct stat stat;
	const status_t status = GetStat(&stat);
	if (status == B_OK)
		*_ref = node_ref(stat.st_dev, stat.st_ino);
	return status;
}


// #pragma mark - fields

namespace {

template<typename Value, typename Member>
status_t
GetField(const BStatable* statable, Member member, Value* _value)
{
	if (_value == NULL)
		return B_BAD_VALUE;
	struct stat stat;
	const status_t status = statable->GetStat(&stat);
	if (status == B_OK)
		*_value = member(stat);
	return status;
}

} // namespace


status_t
BStatable::GetOwner(uid_t* _owner) const
{
	return GetField(
		this, [](const struct stat& stat) { return stat.st_uid; }, _owner);
}


status_t
BStatable::SetOwner(uid_t owner)
{
	struct stat stat = {};
	stat.st_uid = owner;
	return set_stat(stat, kStatOwner);
}


status_t
BStatable::GetGroup(gid_t* _group) const
{
	return GetField(
		this, [](const struct stat& stat) { return stat.st_gid; }, _group);
}


status_t
BStatable::SetGroup(gid_t group)
{
	struct stat stat = {};
	stat.st_gid = group;
	return set_stat(stat, kStatGroup);
}


status_t
BStatable::GetPermissions(mode_t* _permissions) const
{
	return GetField(
		this, [](const struct stat& stat) { return stat.st_mode & 07777; }, _permissions);
}


status_t
BStatable::SetPermissions(mode_t permissions)
{
	struct stat stat = {};
	stat.st_mode = permissions & 07777;
	return set_stat(stat, kStatMode);
}


status_t
BStatable::GetSize(off_t* _size) const
{
	return GetField(
		this, [](const struct stat& stat) { return stat.st_size; }, _size);
}


status_t
BStatable::GetModificationTime(time_t* _time) const
{
	return GetField(
		this, [](const struct stat& stat) { return stat.st_mtime; }, _time);
}


status_t
BStatable::SetModificationTime(time_t time)
{
	struct stat stat = {};
	stat.st_mtime = time;
	return set_stat(stat, kStatModificationTime);
}


// The host keeps no creation time that every file system has: the time of the last change of the
// node comes closest from above, that of its data from below.
status_t
BStatable::GetCreationTime(time_t* _time) const
{
	const auto earliest = [](const struct stat& stat) {
		return stat.st_mtime < stat.st_ctime ? stat.st_mtime : stat.st_ctime;
	};
	return GetField(this, earliest, _time);
}


status_t
BStatable::SetCreationTime(time_t time)
{
	struct stat stat = {};
	return set_stat(stat, kStatCreationTime);
}


status_t
BStatable::GetAccessTime(time_t* _time) const
{
	return GetField(
		this, [](const struct stat& stat) { return stat.st_atime; }, _time);
}


status_t
BStatable::SetAccessTime(time_t time)
{
	struct stat stat = {};
	stat.st_atime = time;
	return set_stat(stat, kStatAccessTime);
}


status_t
BStatable::GetVolume(BVolume* _volume) const
{
	if (_volume == NULL)
		return B_BAD_VALUE;
	struct stat stat;
	const status_t status = GetStat(&stat);
	return status == B_OK ? _volume->SetTo(stat.st_dev) : status;
}
