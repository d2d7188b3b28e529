#include <image.h>

#include <cstring>
#include <map>
#include <memory>
#include <mutex>

#include <dlfcn.h>
#include <limits.h>
#include <link.h>
#include <sys/xattr.h>
#include <unistd.h>

#include "kernel/private/Images.h"
#include "kernel/private/Table.h"

using BPrivate::Table;

namespace {

// One load of an add-on. Loading a file twice gives two ids, which are unloaded one by one.
struct AddOn {
	void* handle;
	std::string path;
};


Table<AddOn>&
add_ons()
{
	static Table<AddOn>* sAddOns = new Table<AddOn>;
	return *sAddOns;
}


// The ids of images that were not loaded as add-ons, by where they lie. They count downwards from
// far above, so that they never meet an add-on's id.
struct OtherImages {
	std::mutex lock;
	std::map<const void*, image_id> ids;
	image_id next = INT32_MAX;
};


OtherImages&
other_images()
{
	static OtherImages* sOthers = new OtherImages;
	return *sOthers;
}


std::string
program_path()
{
	char path[PATH_MAX];
	const ssize_t length = readlink("/proc/self/exe", path, sizeof(path) - 1);
	return length > 0 ? std::string(path, size_t(length)) : std::string();
}


void
collect(dl_phdr_info* host, std::vector<image_info>& images)
{
	if (host->dlpi_phnum == 0 || host->dlpi_phdr == nullptr)
		return;
	image_info info;
	memset(&info, 0, sizeof(info));
	const bool isProgram = images.empty();
	const std::string path = isProgram ? program_path() : host->dlpi_name;
	strncpy(info.name, path.c_str(), sizeof(info.name) - 1);
	info.type = isProgram ? B_APP_IMAGE : B_LIBRARY_IMAGE;
	info.sequence = static_cast<int32>(images.size());
	for (int i = 0; i < host->dlpi_phnum; i++) {
		const auto& header = host->dlpi_phdr[i];
		if (header.p_type == PT_LOAD && (header.p_flags & PF_X) != 0) {
			info.text = reinterpret_cast<void*>(host->dlpi_addr + header.p_vaddr);
			break;
		}
	}
	images.push_back(info);
}


image_id
id_of(const image_info& info)
{
	const image_id addOn =
		add_ons().Find([&](const AddOn& candidate) { return candidate.path == info.name; });
	if (addOn >= 0)
		return addOn;

	OtherImages& others = other_images();
	std::unique_lock lock(others.lock);
	const auto [entry, isNew] = others.ids.emplace(info.text, others.next);
	if (isNew)
		others.next--;
	return entry->second;
}


// A handle for looking up symbols, without loading anything.
void*
borrow_handle(const image_info& image)
{
	const char* path = image.type == B_APP_IMAGE ? nullptr : image.name;
	return dlopen(path, RTLD_LAZY | RTLD_NOLOAD);
}


bool
lies_in(const void* address, const image_info& image)
{
	Dl_info found;
	Dl_info wanted;
	return dladdr(address, &found) != 0 && dladdr(image.text, &wanted) != 0
		&& found.dli_fbase == wanted.dli_fbase;
}

} // namespace


image_id
load_add_on(const char* path)
{
	if (path == nullptr)
		return B_BAD_VALUE;
	char resolved[PATH_MAX];
	if (realpath(path, resolved) == nullptr)
		return B_ENTRY_NOT_FOUND;

	void* handle = dlopen(resolved, RTLD_NOW | RTLD_LOCAL);
	if (handle == nullptr)
		return B_NOT_AN_EXECUTABLE;
	auto addOn = std::make_shared<AddOn>();
	addOn->handle = handle;
	addOn->path = resolved;
	return add_ons().Add(std::move(addOn));
}


status_t
unload_add_on(image_id image)
{
	std::shared_ptr<AddOn> addOn = add_ons().Remove(image);
	if (addOn == nullptr)
		return B_BAD_IMAGE_ID;
	dlclose(addOn->handle);
	return B_OK;
}


status_t
get_image_symbol(image_id image, const char* name, int32 symbolType, void** _location)
{
	if (name == nullptr || _location == nullptr)
		return B_BAD_VALUE;

	if (std::shared_ptr<AddOn> addOn = add_ons().Get(image)) {
		*_location = dlsym(addOn->handle, name);
		return *_location != nullptr ? B_OK : B_MISSING_SYMBOL;
	}

	image_info info;
	if (get_image_info(image, &info) != B_OK)
		return B_BAD_IMAGE_ID;
	*_location = BPrivate::symbol_of_image(info, name);
	return *_location != nullptr ? B_OK : B_MISSING_SYMBOL;
}


status_t
_get_next_image_info(team_id team, int32* cookie, image_info* info, size_t size)
{
	if (cookie == nullptr || info == nullptr || size != sizeof(image_info) || *cookie < 0)
		return B_BAD_VALUE;
	const std::vector<image_info> images = BPrivate::loaded_images();
	if (size_t(*cookie) >= images.size())
		return B_BAD_INDEX;
	*info = images[size_t((*cookie)++)];
	return B_OK;
}


status_t
_get_image_info(image_id image, image_info* info, size_t size)
{
	if (info == nullptr || size != sizeof(image_info))
		return B_BAD_VALUE;
	for (const image_info& candidate : BPrivate::loaded_images()) {
		if (candidate.id == image) {
			*info = candidate;
			return B_OK;
		}
	}
	return B_BAD_IMAGE_ID;
}


namespace BPrivate {


uint64
image_generation()
{
	uint64 generation = 0;
	dl_iterate_phdr(
		[](dl_phdr_info* info, size_t, void* result) {
			*static_cast<uint64*>(result) = info->dlpi_adds + info->dlpi_subs;
			return 1;
		},
		&generation);
	return generation;
}


std::vector<image_info>
loaded_images()
{
	std::vector<image_info> images;
	dl_iterate_phdr(
		[](dl_phdr_info* info, size_t, void* result) {
			collect(info, *static_cast<std::vector<image_info>*>(result));
			return 0;
		},
		&images);
	for (image_info& image : images) {
		image.id = id_of(image);
		if (add_ons().Get(image.id) != nullptr)
			image.type = B_ADD_ON_IMAGE;
	}
	return images;
}


void*
symbol_of_image(const image_info& image, const char* name)
{
	void* handle = borrow_handle(image);
	if (handle == nullptr)
		return nullptr;
	// The look-up also goes through the image's libraries; only its own symbols count.
	void* address = dlsym(handle, name);
	dlclose(handle);
	return address != nullptr && lies_in(address, image) ? address : nullptr;
}


std::string
image_signature(const image_info& image)
{
	// An attribute's value begins with the four bytes of its type.
	constexpr ssize_t kTypeSize = 4;
	char signature[256];
	const ssize_t length =
		getxattr(image.name, "user.be.BEOS:APP_SIG", signature, sizeof(signature));
	if (length <= kTypeSize)
		return std::string();
	return std::string(
		signature + kTypeSize, strnlen(signature + kTypeSize, size_t(length - kTypeSize)));
}


} // namespace BPrivate
