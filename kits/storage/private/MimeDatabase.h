// The desktop's shared MIME database, read once.
#pragma once

#include <set>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

#include <SupportDefs.h>

namespace BPrivate {

// What the database's files say; types are in lower case. Read-only after its making, so safe to
// use from any thread.
class MimeDatabase {
public:
	// The one of this system, read when first asked for.
	static const MimeDatabase& Get();

	// From the folders given, the most important first.
	explicit MimeDatabase(const std::vector<std::string>& folders);

	// A supertype is known if one of its types is.
	bool IsKnown(const std::string& type) const;
	const std::set<std::string>& Types() const { return fTypes; }
	std::vector<std::string> ExtensionsOf(const std::string& type) const;
	// The comment in the language that fits best; empty without one.
	std::string DescriptionOf(const std::string& type) const;

	// Empty when nothing fits. The weight, from 0 to 100, says how sure a name or a rule is.
	std::string TypeOfName(std::string_view leaf, int32* _weight = NULL) const;
	std::string TypeOfBytes(const void* data, size_t size, int32* _weight = NULL) const;
	// So many bytes are enough for every rule.
	size_t BytesNeeded() const { return fBytesNeeded; }

private:
	struct Glob {
		std::string pattern;
		std::string type;
		int32 weight;
		bool caseSensitive;
	};
	struct MagicLine {
		int32 indent;
		uint32 offset;
		std::string value;
		std::string mask; // empty, or as long as the value
		uint32 range; // places that are tried
	};
	struct Magic {
		std::string type;
		int32 priority;
		std::vector<MagicLine> lines;
	};

	const Glob* _GlobOf(std::string_view leaf) const;
	void _ReadTypes(const std::string& folder);
	void _ReadGlobs(const std::string& folder);
	void _AddGlob(Glob glob);
	void _ReadMagic(const std::string& folder);
	bool _ReadMagicLine(std::string_view bytes, size_t* _place, Magic* magic);
	static bool _Matches(const Magic& magic, std::string_view bytes);
	static bool _Matches(const MagicLine& line, std::string_view bytes);

	std::vector<std::string> fFolders;
	std::set<std::string> fTypes;
	std::unordered_map<std::string, Glob> fLiterals; // whole names
	std::unordered_map<std::string, std::vector<Glob>> fSuffixes; // "*" and what follows it
	std::vector<Glob> fGlobs; // all others
	std::unordered_map<std::string, std::vector<std::string>> fExtensions;
	std::vector<Magic> fMagic; // by falling priority
	size_t fBytesNeeded;
};

} // namespace BPrivate
