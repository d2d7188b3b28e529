// EntryRefData: references to files as the bytes of a message item.
#pragma once

#include <cstring>
#include <vector>

#include <Entry.h>
#include <Node.h>

namespace BPrivate {


// Device (four bytes) and directory or node (eight), then for a file's reference the name and its
// NUL. They mean something only on the running system that made them.
class EntryRefData {
public:
	explicit EntryRefData(const entry_ref& ref)
	{
		const char* name = ref.device != dev_t(-1) ? ref.name : nullptr;
		const size_t nameSize = name != nullptr ? strlen(name) + 1 : 0;
		fBytes.resize(12 + nameSize);
		_Put(ref.device, ref.directory);
		if (nameSize > 0)
			memcpy(fBytes.data() + 12, name, nameSize);
	}

	explicit EntryRefData(const node_ref& ref)
	{
		fBytes.resize(12);
		_Put(ref.device, ref.node);
	}

	const void* Bytes() const { return fBytes.data(); }
	size_t Size() const { return fBytes.size(); }

	// B_BAD_VALUE for bytes that are too short or whose name has no end.
	static status_t Read(const void* data, size_t size, entry_ref* ref)
	{
		int32 device;
		int64 directory;
		if (!_Get(data, size, &device, &directory))
			return B_BAD_VALUE;
		const char* name = static_cast<const char*>(data) + 12;
		if (size > 12 && memchr(name, 0, size - 12) == nullptr)
			return B_BAD_VALUE;
		*ref = entry_ref(_Device(device), ino_t(directory), size > 12 ? name : nullptr);
		return B_OK;
	}

	static status_t Read(const void* data, size_t size, node_ref* ref)
	{
		int32 device;
		int64 node;
		if (!_Get(data, size, &device, &node))
			return B_BAD_VALUE;
		ref->device = _Device(device);
		ref->node = ino_t(node);
		return B_OK;
	}

private:
	template<typename Device, typename Node> void _Put(Device device, Node node)
	{
		const int32 device32 = int32(device);
		const int64 node64 = int64(node);
		memcpy(fBytes.data(), &device32, sizeof(device32));
		memcpy(fBytes.data() + 4, &node64, sizeof(node64));
	}

	static bool _Get(const void* data, size_t size, int32* device, int64* node)
	{
		if (size < 12)
			return false;
		memcpy(device, data, sizeof(*device));
		memcpy(node, static_cast<const char*>(data) + 4, sizeof(*node));
		return true;
	}

	// -1 means none; other numbers with the top bit set are not negative.
	static dev_t _Device(int32 device) { return device == -1 ? dev_t(-1) : dev_t(uint32(device)); }

	std::vector<char> fBytes;
};


} // namespace BPrivate
