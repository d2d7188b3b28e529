#include "storage/private/NodeAttributes.h"

#include <errno.h>
#include <fcntl.h>
#include <string.h>
#include <sys/stat.h>
#include <sys/xattr.h>

#include <map>
#include <mutex>
#include <tuple>

#include <Errors.h>

#include "storage/private/Descriptor.h"
#include "storage/private/Errno.h"

namespace BPrivate {

namespace {

constexpr char kPrefix[] = "user.be.";
constexpr size_t kPrefixLength = sizeof(kPrefix) - 1;
constexpr size_t kTypeSize = 4;
constexpr size_t kLargestName = 255;

// Nodes whose file system has no extended attributes. A number can be used again for another
// node, so the time of birth belongs to the key.
struct Remembered {
	using Key = std::tuple<dev_t, ino_t, int64, uint32>;

	std::mutex lock;
	std::map<Key, std::map<std::string, AttributeValue>> nodes;
};


Remembered&
TheRemembered()
{
	static Remembered* remembered = new Remembered; // outlives all threads
	return *remembered;
}


bool
KeyOf(int fd, Remembered::Key* _key)
{
	struct statx stat;
	if (statx(fd, "", AT_EMPTY_PATH, STATX_INO | STATX_BTIME, &stat) < 0)
		return false;
	const dev_t device = (static_cast<dev_t>(stat.stx_dev_major) << 32) | stat.stx_dev_minor;
	const bool born = (stat.stx_mask & STATX_BTIME) != 0;
	*_key = Remembered::Key(
		device, stat.stx_ino, born ? stat.stx_btime.tv_sec : 0, born ? stat.stx_btime.tv_nsec : 0);
	return true;
}


// Links and devices refuse attributes with EPERM, which a regular file does only when it is
// immutable; then the memory is a fine place too.
bool
HasNone(int error)
{
	return error == ENOTSUP || error == EPERM || error == ENOSYS;
}


status_t
FullName(const char* name, std::string* _full)
{
	if (name == NULL || name[0] == '\0')
		return B_BAD_VALUE;
	if (strlen(name) + kPrefixLength > kLargestName)
		return B_NAME_TOO_LONG;
	*_full = std::string(kPrefix) + name;
	return B_OK;
}


template<typename Function>
status_t
WithRemembered(int fd, Function function)
{
	Remembered::Key key;
	if (!KeyOf(fd, &key))
		return LastStatus();
	Remembered& remembered = TheRemembered();
	std::lock_guard<std::mutex> guard(remembered.lock);
	return function(remembered.nodes, key);
}


status_t
ReadRemembered(int fd, const char* name, AttributeValue* _value)
{
	return WithRemembered(fd, [&](auto& nodes, const auto& key) -> status_t {
		const auto node = nodes.find(key);
		if (node == nodes.end())
			return B_ENTRY_NOT_FOUND;
		const auto found = node->second.find(name);
		if (found == node->second.end())
			return B_ENTRY_NOT_FOUND;
		*_value = found->second;
		return B_OK;
	});
}

} // namespace


status_t
ReadAttribute(int fd, const char* name, AttributeValue* _value)
{
	std::string full;
	const status_t status = FullName(name, &full);
	if (status != B_OK)
		return status;

	const std::string path = ProcPathOf(fd);
	std::string raw;
	for (;;) {
		const ssize_t size = getxattr(path.c_str(), full.c_str(), NULL, 0);
		if (size < 0)
			break;
		raw.resize(size);
		const ssize_t read = getxattr(path.c_str(), full.c_str(), raw.data(), raw.size());
		if (read < 0 && errno == ERANGE)
			continue; // it grew in between
		if (read < 0)
			break;
		raw.resize(read);
		if (raw.size() < kTypeSize)
			return B_ENTRY_NOT_FOUND; // nobody of ours wrote it
		const uint8* type = reinterpret_cast<const uint8*>(raw.data());
		_value->type =
			static_cast<type_code>(type[0]) << 24 | type[1] << 16 | type[2] << 8 | type[3];
		_value->data = raw.substr(kTypeSize);
		return B_OK;
	}

	if (errno == ENODATA || HasNone(errno))
		return ReadRemembered(fd, name, _value);
	return LastStatus();
}


status_t
WriteAttribute(int fd, const char* name, const AttributeValue& value)
{
	std::string full;
	const status_t status = FullName(name, &full);
	if (status != B_OK)
		return status;

	std::string raw(kTypeSize, '\0');
	for (size_t i = 0; i < kTypeSize; i++)
		raw[i] = static_cast<char>(value.type >> (24 - 8 * i));
	raw += value.data;
	if (setxattr(ProcPathOf(fd).c_str(), full.c_str(), raw.data(), raw.size(), 0) == 0)
		return B_OK;
	if (errno == E2BIG || errno == ERANGE)
		return B_DEVICE_FULL;
	if (!HasNone(errno))
		return LastStatus();

	return WithRemembered(fd, [&](auto& nodes, const auto& key) -> status_t {
		nodes[key][name] = value;
		return B_OK;
	});
}


status_t
RemoveAttribute(int fd, const char* name)
{
	std::string full;
	const status_t status = FullName(name, &full);
	if (status != B_OK)
		return status;
	if (removexattr(ProcPathOf(fd).c_str(), full.c_str()) == 0)
		return B_OK;
	if (errno != ENODATA && !HasNone(errno))
		return LastStatus();

	return WithRemembered(fd, [&](auto& nodes, const auto& key) -> status_t {
		const auto node = nodes.find(key);
		if (node == nodes.end() || node->second.erase(name) == 0)
			return B_ENTRY_NOT_FOUND;
		if (node->second.empty())
			nodes.erase(node);
		return B_OK;
	});
}


status_t
ListAttributes(int fd, std::vector<std::string>* _names)
{
	_names->clear();
	const std::string path = ProcPathOf(fd);
	std::string list;
	ssize_t length;
	do {
		length = listxattr(path.c_str(), NULL, 0);
		if (length >= 0) {
			list.resize(length);
			length = listxattr(path.c_str(), list.data(), list.size());
		}
	} while (length < 0 && errno == ERANGE);
	if (length < 0 && !HasNone(errno))
		return LastStatus();

	list.resize(length < 0 ? 0 : length);
	for (size_t start = 0; start < list.size();) {
		const char* name = list.c_str() + start;
		if (strncmp(name, kPrefix, kPrefixLength) == 0)
			_names->push_back(name + kPrefixLength);
		start += strlen(name) + 1;
	}

	return WithRemembered(fd, [&](auto& nodes, const auto& key) -> status_t {
		const auto node = nodes.find(key);
		if (node == nodes.end())
			return B_OK;
		for (const auto& attribute : node->second)
			_names->push_back(attribute.first);
		return B_OK;
	});
}


bool
KeepsAttributes(int fd)
{
	char probe;
	return getxattr(ProcPathOf(fd).c_str(), "user.be.probe", &probe, 0) >= 0 || errno == ENODATA;
}


void
MoveRememberedAttributes(int fromFd, int toFd)
{
	Remembered::Key to;
	if (!KeyOf(toFd, &to))
		return;
	WithRemembered(fromFd, [&](auto& nodes, const auto& from) -> status_t {
		auto node = nodes.extract(from);
		if (!node.empty()) {
			nodes.erase(to);
			node.key() = to;
			nodes.insert(std::move(node));
		}
		return B_OK;
	});
}

} // namespace BPrivate
