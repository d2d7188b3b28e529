// BMimeType: which type bytes, names and files are of.

#include <Mime.h>

#include <string.h>

#include <algorithm>
#include <string>
#include <string_view>
#include <vector>

#include <Entry.h>
#include <File.h>
#include <Message.h>
#include <String.h>

#include "storage/private/MimeDatabase.h"
#include "storage/private/MimeIndex.h"
#include "storage/private/MimeSettings.h"

using namespace BPrivate;

namespace {

constexpr int32 kUsualWeight = 50; // of a name in the shared database


status_t
SetGuess(const std::string& type, BMimeType* _type)
{
	return _type->SetTo(type.empty() ? B_FILE_MIME_TYPE : type.c_str());
}


std::string
TypeOfName(const MimeIndex& index, std::string_view leaf, int32* _weight)
{
	std::string type = index.TypeOfName(leaf);
	if (type.empty())
		return MimeDatabase::Get().TypeOfName(leaf, _weight);
	*_weight = kUsualWeight;
	return type;
}


// An empty name is none.
std::string
TypeOf(const MimeIndex& index, std::string_view leaf, std::string_view bytes)
{
	int32 weight = -1;
	std::string type;
	if (!leaf.empty())
		type = TypeOfName(index, leaf, &weight);
	if (type.empty())
		type = MimeDatabase::Get().TypeOfBytes(bytes.data(), bytes.size(), &weight);
	double priority = 0;
	std::string ruled = index.TypeOfBytes(bytes, &priority);
	// 0.29 times 100 is a little less than 29.
	const bool wins = !ruled.empty() && priority * 100 + 1e-9 >= weight;
	return wins ? ruled : type;
}

} // namespace


status_t
BMimeType::GuessMimeType(const entry_ref* file, BMimeType* _type)
{
	if (file == NULL || file->name == NULL || _type == NULL)
		return B_BAD_VALUE;
	const BEntry entry(file);
	struct stat stat;
	const status_t status = entry.GetStat(&stat);
	if (status != B_OK)
		return status;
	if (S_ISDIR(stat.st_mode))
		return _type->SetTo("application/x-vnd.Be-directory");
	if (S_ISLNK(stat.st_mode))
		return _type->SetTo("application/x-vnd.Be-symlink");

	const auto index = MimeIndex::Get();
	const size_t needed = std::max(MimeDatabase::Get().BytesNeeded(), index->BytesNeeded());
	std::vector<char> start(S_ISREG(stat.st_mode) ? needed : 0);
	BFile opened;
	ssize_t read = 0;
	if (!start.empty() && opened.SetTo(&entry, B_READ_ONLY) == B_OK)
		read = opened.ReadAt(0, start.data(), start.size());
	const std::string_view bytes(start.data(), read > 0 ? read : 0);
	return SetGuess(TypeOf(*index, file->name, bytes), _type);
}


status_t
BMimeType::GuessMimeType(const void* buffer, int32 length, BMimeType* _type)
{
	if (buffer == NULL || length < 0 || _type == NULL)
		return B_BAD_VALUE;
	const std::string_view bytes(static_cast<const char*>(buffer), length);
	return SetGuess(TypeOf(*MimeIndex::Get(), "", bytes), _type);
}


status_t
BMimeType::GuessMimeType(const char* filename, BMimeType* _type)
{
	if (filename == NULL || _type == NULL)
		return B_BAD_VALUE;
	const char* slash = strrchr(filename, '/');
	int32 weight;
	return SetGuess(
		TypeOfName(*MimeIndex::Get(), slash != NULL ? slash + 1 : filename, &weight), _type);
}


// #pragma mark - rules


status_t
BMimeType::GetSnifferRule(BString* _rule) const
{
	if (_rule == NULL)
		return B_BAD_VALUE;
	if (fCStatus != B_OK)
		return fCStatus;
	if (MimeSettingsOf(fType).FindString(kMimeSnifferRule, _rule) == B_OK)
		return B_OK;
	return B_ENTRY_NOT_FOUND;
}


status_t
BMimeType::SetSnifferRule(const char* rule)
{
	if (fCStatus != B_OK)
		return fCStatus;
	const status_t status = rule != NULL ? CheckSnifferRule(rule, NULL) : B_OK;
	if (status != B_OK)
		return status;
	return ChangeMimeSettings(fType, [&](BMessage& settings) -> status_t {
		settings.RemoveName(kMimeSnifferRule);
		return rule != NULL ? settings.AddString(kMimeSnifferRule, rule) : B_OK;
	});
}


status_t
BMimeType::CheckSnifferRule(const char* rule, BString* _error)
{
	if (rule == NULL)
		return B_BAD_VALUE;
	std::string error;
	const Result<SnifferRule> parsed = SnifferRule::Parse(rule, &error);
	if (parsed)
		return B_OK;
	if (_error != NULL)
		_error->SetTo(error.c_str());
	return parsed.Error();
}
