// MimeIndex: what programs set about all types, for questions that concern more than one.
#pragma once

#include <map>
#include <memory>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

#include "storage/private/SnifferRule.h"

class BMessage;

namespace BPrivate {

// Made from all settings at once and never changed then, so safe to use from any thread. Types
// are in small letters.
class MimeIndex {
public:
	// The newest one: made again only when something was set by this or by another program.
	static std::shared_ptr<const MimeIndex> Get();
	// This program is about to set something, or just did.
	static void Forget();

	// The type whose rule of the highest priority matches, or nothing.
	std::string TypeOfBytes(std::string_view bytes, double* _priority) const;
	// So many bytes are enough for every rule.
	size_t BytesNeeded() const { return fBytesNeeded; }
	// The type that has the longest extension of the file's name, or nothing.
	std::string TypeOfName(std::string_view leaf) const;
	// The signatures of the programs that support exactly this type, in order.
	std::vector<std::string> SupportersOf(const std::string& type) const;

private:
	struct Rule {
		std::string type;
		SnifferRule rule;
	};

	MimeIndex();
	void _Add(const std::string& type, const BMessage& settings);
	void _AddSupporter(const std::string& signature, const BMessage& settings, const char* field);

	std::vector<Rule> fRules; // by falling priority
	std::unordered_map<std::string, std::string> fTypeOfExtension;
	std::map<std::string, std::vector<std::string>> fSupporters;
	size_t fBytesNeeded;
};

} // namespace BPrivate
