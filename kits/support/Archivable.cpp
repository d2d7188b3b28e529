#include <Archivable.h>

#include <cerrno>
#include <cstdlib>
#include <cstring>
#include <map>
#include <mutex>
#include <string>
#include <string_view>
#include <typeinfo>

#include <cxxabi.h>
#include <dlfcn.h>

#include <Message.h>

#include "app/private/LookUps.h"
#include "app/private/MessagePrivate.h"
#include "kernel/private/Images.h"
#include "support/private/ClassNames.h"
#include "support/private/ManagedArchive.h"

using BPrivate::LookUps;
using BPrivate::MessageData;
using BPrivate::MessagePrivate;

namespace {

constexpr std::string_view kPrivatePrefix = "BPrivate::";

// A class that was looked for, found or not.
struct FoundClass {
	instantiation_func function = nullptr;
	image_info image {};
};

// Classes that were looked for since an image was last loaded or unloaded.
struct ClassTable {
	std::mutex lock;
	uint64 generation = 0;
	std::map<std::string, FoundClass, std::less<>> classes;
};

// An archive can name as many classes as it likes.
constexpr size_t kMostClasses = 4096;


ClassTable&
class_table()
{
	static ClassTable* sTable = new ClassTable;
	return *sTable;
}


bool
is_identifier(std::string_view name)
{
	if (name.empty() || (name[0] >= '0' && name[0] <= '9'))
		return false;
	for (char c : name) {
		if (!((c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z') || (c >= '0' && c <= '9')
				|| c == '_'))
			return false;
	}
	return true;
}


// The symbol of the class's static Instantiate(BMessage*), or nothing when the name is none of a
// class.
std::string
instantiate_symbol(std::string_view name)
{
	std::string symbol = "_ZN";
	for (std::string_view rest = name;;) {
		const size_t end = rest.find("::");
		const std::string_view part = rest.substr(0, end);
		if (!is_identifier(part))
			return std::string();
		symbol += std::to_string(part.size());
		symbol += part;
		if (end == std::string_view::npos)
			break;
		rest.remove_prefix(end + 2);
	}
	return symbol + "11InstantiateEP8BMessage";
}


FoundClass
search_images(std::string_view name)
{
	const std::string symbol = instantiate_symbol(name);
	FoundClass found;
	if (symbol.empty())
		return found;
	for (const image_info& image : BPrivate::loaded_images()) {
		if (void* address = BPrivate::symbol_of_image(image, symbol.c_str())) {
			found.function = reinterpret_cast<instantiation_func>(address);
			found.image = image;
			break;
		}
	}
	return found;
}


FoundClass
find_class(std::string_view name)
{
	ClassTable& table = class_table();
	std::unique_lock lock(table.lock);
	const uint64 generation = BPrivate::image_generation();
	if (generation != table.generation || table.classes.size() >= kMostClasses) {
		table.classes.clear();
		table.generation = generation;
	}
	const auto known = table.classes.find(name);
	if (known != table.classes.end())
		return known->second;

	FoundClass found = search_images(name);
	if (found.function == nullptr && name.starts_with('_'))
		found = search_images(std::string(kPrivatePrefix) + std::string(name));
	table.classes.emplace(std::string(name), found);
	return found;
}


bool
has_signature(const FoundClass& found, const char* signature)
{
	return signature == nullptr || BPrivate::image_signature(found.image) == signature;
}


// Records the look-ups in an archive while an object is made of it, and gives the message back as
// it was.
class ArchiveReading {
public:
	explicit ArchiveReading(BMessage* archive) :
		fMessage(archive), fData(fMessage.Data()), fLookUps(fMessage.GetLookUps())
	{
		if (fData != nullptr)
			fData->Acquire();
		if (fLookUps != nullptr)
			fLookUps->Acquire();
		fStatus = BPrivate::unmanage_archive(archive);
		fWasManaged = fMessage.Data() != fData;
		LookUps* lookUps = new LookUps(fMessage.Data());
		fMessage.SetLookUps(lookUps);
		lookUps->Release();
	}

	~ArchiveReading()
	{
		fMessage.SetLookUps(fLookUps);
		if (fWasManaged)
			fMessage.SetData(fData);
		if (fData != nullptr)
			fData->Release();
		if (fLookUps != nullptr)
			fLookUps->Release();
	}

	ArchiveReading(const ArchiveReading&) = delete;
	ArchiveReading& operator=(const ArchiveReading&) = delete;

	status_t Status() const { return fStatus; }

private:
	MessagePrivate fMessage;
	MessageData* fData; // a reference
	LookUps* fLookUps; // a reference
	status_t fStatus;
	bool fWasManaged;
};

} // namespace


// #pragma mark - BArchivable


BArchivable::BArchivable()
{
}


// The first constructor of all that run for an archive: a managed one is nested from here on.
BArchivable::BArchivable(BMessage* from)
{
	if (from != nullptr)
		BPrivate::unmanage_archive(from);
}


BArchivable::~BArchivable()
{
}


status_t
BArchivable::Archive(BMessage* into, bool) const
{
	if (into == nullptr)
		return B_BAD_VALUE;
	return into->AddString("class", BPrivate::archived_class_name(typeid(*this)));
}


BArchivable*
BArchivable::Instantiate(BMessage*)
{
	return nullptr;
}


status_t
BArchivable::Perform(perform_code, void*)
{
	return B_ERROR;
}


// #pragma mark - making objects


BArchivable*
instantiate_object(BMessage* from)
{
	return instantiate_object(from, nullptr);
}


BArchivable*
instantiate_object(BMessage* from, image_id* _id)
{
	image_id ignored;
	if (_id == nullptr)
		_id = &ignored;
	*_id = B_BAD_VALUE;
	if (from == nullptr)
		return nullptr;

	const char* addOn;
	const bool hasAddOn = from->FindString("add_on", &addOn) == B_OK;
	ArchiveReading reading(from);
	const char* name;
	if (from->FindString("class", &name) != B_OK || instantiate_symbol(name).empty())
		return nullptr;
	const FoundClass found = find_class(name);
	if (found.function == nullptr || (hasAddOn && !has_signature(found, addOn))) {
		// No archive makes the program load anything.
		*_id = hasAddOn ? B_LAUNCH_FAILED_APP_NOT_FOUND : B_NAME_NOT_FOUND;
		return nullptr;
	}
	*_id = reading.Status();
	if (reading.Status() != B_OK)
		return nullptr;
	*_id = found.image.id;
	return found.function(from);
}


bool
validate_instantiation(BMessage* from, const char* className)
{
	errno = B_BAD_VALUE;
	if (from == nullptr || className == nullptr)
		return false;

	errno = B_OK;
	std::string_view wanted = BPrivate::plain_class_name(className);
	const char* name;
	for (int32 i = 0; from->FindString("class", i, &name) == B_OK; i++) {
		if (BPrivate::plain_class_name(name) == wanted)
			return true;
	}
	errno = B_MISMATCHED_VALUES;
	return false;
}


instantiation_func
find_instantiation_func(const char* className, const char* signature)
{
	if (className == nullptr || instantiate_symbol(className).empty()) {
		errno = B_BAD_VALUE;
		return nullptr;
	}
	const FoundClass found = find_class(className);
	return found.function != nullptr && has_signature(found, signature) ? found.function : nullptr;
}


instantiation_func
find_instantiation_func(const char* className)
{
	return find_instantiation_func(className, nullptr);
}


instantiation_func
find_instantiation_func(BMessage* archive)
{
	const char* name;
	const char* signature;
	if (archive == nullptr || archive->FindString("class", &name) != B_OK
		|| archive->FindString("add_on", &signature) != B_OK) {
		errno = B_BAD_VALUE;
		return nullptr;
	}
	return find_instantiation_func(name, signature);
}


// #pragma mark - class names


namespace BPrivate {


std::string_view
plain_class_name(std::string_view name)
{
	if (name.starts_with(kPrivatePrefix) && name.substr(kPrivatePrefix.size()).starts_with('_'))
		name.remove_prefix(kPrivatePrefix.size());
	return name;
}


// The table's texts stay where they are, so they can be given out. It keeps names and no types,
// which go when their image does.
const char*
archived_class_name(const std::type_info& type)
{
	static std::mutex* sLock = new std::mutex;
	static auto* sNames = new std::map<std::string, std::string, std::less<>>;
	std::unique_lock lock(*sLock);
	const auto known = sNames->find(std::string_view(type.name()));
	if (known != sNames->end())
		return known->second.c_str();

	char* demangled = abi::__cxa_demangle(type.name(), nullptr, nullptr, nullptr);
	const std::string_view name = plain_class_name(demangled != nullptr ? demangled : type.name());
	const auto added = sNames->emplace(type.name(), name).first;
	free(demangled);
	return added->second.c_str();
}


} // namespace BPrivate
