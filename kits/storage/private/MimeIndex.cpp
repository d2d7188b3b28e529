#include "storage/private/MimeIndex.h"

#include <sys/stat.h>
#include <time.h>

#include <algorithm>
#include <mutex>

#include <Message.h>

#include "storage/private/MimeSettings.h"

namespace BPrivate {

namespace {

std::mutex sIndexLock;
std::shared_ptr<const MimeIndex> sIndex; // NULL when it must be made
int32 sForgotten = 0; // how often


// Which folder, and when a file came or went last.
struct FolderState {
	std::string path;
	dev_t device;
	ino_t node;
	int64 changed; // nanoseconds

	bool operator==(const FolderState&) const = default;
};

FolderState sState; // the one that sIndex was made in


int64
Nanoseconds(const timespec& time)
{
	return int64(time.tv_sec) * 1000000000 + time.tv_nsec;
}


FolderState
CurrentState()
{
	FolderState state = { MimeSettingsFolder(), 0, 0, 0 };
	struct stat stat;
	if (!state.path.empty() && ::stat(state.path.c_str(), &stat) == 0) {
		state.device = stat.st_dev;
		state.node = stat.st_ino;
		state.changed = Nanoseconds(stat.st_mtim);
	}
	return state;
}


// The clock of a file system is coarse: of two changes that follow each other at once, the second
// may leave the folder's time as it is. So a folder must have rested before an index is kept.
bool
HasRested(const FolderState& state)
{
	timespec now;
	clock_gettime(CLOCK_REALTIME, &now);
	const int64 rest = Nanoseconds(now) - state.changed;
	return rest > 1000000000;
}

} // namespace


std::shared_ptr<const MimeIndex>
MimeIndex::Get()
{
	const FolderState state = CurrentState();
	int32 forgotten;
	{
		std::lock_guard<std::mutex> guard(sIndexLock);
		if (sIndex != nullptr && state == sState)
			return sIndex;
		forgotten = sForgotten;
	}
	const bool rested = HasRested(state);
	const std::shared_ptr<const MimeIndex> index(new MimeIndex);
	std::lock_guard<std::mutex> guard(sIndexLock);
	if (rested && forgotten == sForgotten) {
		sIndex = index;
		sState = state;
	}
	return index;
}


void
MimeIndex::Forget()
{
	std::lock_guard<std::mutex> guard(sIndexLock);
	sIndex.reset();
	sForgotten++;
}


std::string
MimeIndex::TypeOfBytes(std::string_view bytes, double* _priority) const
{
	for (const Rule& rule : fRules) {
		if (rule.rule.Matches(bytes)) {
			*_priority = rule.rule.Priority();
			return rule.type;
		}
	}
	return std::string();
}


std::string
MimeIndex::TypeOfName(std::string_view leaf) const
{
	for (size_t dot = leaf.find('.'); dot != leaf.npos; dot = leaf.find('.', dot + 1)) {
		const std::string extension = LowerCaseType(std::string(leaf.substr(dot + 1)).c_str());
		const auto found = fTypeOfExtension.find(extension);
		if (found != fTypeOfExtension.end())
			return found->second;
	}
	return std::string();
}


std::vector<std::string>
MimeIndex::SupportersOf(const std::string& type) const
{
	const auto found = fSupporters.find(type);
	return found != fSupporters.end() ? found->second : std::vector<std::string>();
}


// #pragma mark - private


MimeIndex::MimeIndex() : fBytesNeeded(0)
{
	for (const std::string& type : TypesWithMimeSettings())
		_Add(type, MimeSettingsOf(type.c_str()));
	std::stable_sort(fRules.begin(), fRules.end(),
		[](const Rule& a, const Rule& b) { return a.rule.Priority() > b.rule.Priority(); });
}


void
MimeIndex::_Add(const std::string& type, const BMessage& settings)
{
	const char* text;
	if (settings.FindString(kMimeSnifferRule, &text) == B_OK) {
		if (Result<SnifferRule> rule = SnifferRule::Parse(text, NULL)) {
			fBytesNeeded = std::max(fBytesNeeded, rule->BytesNeeded());
			fRules.push_back({ type, std::move(*rule) });
		}
	}
	BMessage extensions;
	settings.FindMessage(kMimeExtensions, &extensions);
	for (int32 i = 0; extensions.FindString("extensions", i, &text) == B_OK; i++)
		fTypeOfExtension.emplace(LowerCaseType(text), type);
	_AddSupporter(type, settings, kMimeSupportedTypes);
	_AddSupporter(type, settings, kMimeStrandedTypes);
}


void
MimeIndex::_AddSupporter(const std::string& signature, const BMessage& settings, const char* field)
{
	BMessage types;
	settings.FindMessage(field, &types);
	const char* type;
	for (int32 i = 0; types.FindString("types", i, &type) == B_OK; i++) {
		std::vector<std::string>& supporters = fSupporters[LowerCaseType(type)];
		if (supporters.empty() || supporters.back() != signature)
			supporters.push_back(signature);
	}
}

} // namespace BPrivate
