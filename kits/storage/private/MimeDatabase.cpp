#include "storage/private/MimeDatabase.h"

#include <fnmatch.h>
#include <locale.h>
#include <stdlib.h>
#include <string.h>

#include <algorithm>
#include <fstream>
#include <iterator>
#include <sstream>

namespace BPrivate {

namespace {

constexpr size_t kLargestFile = 16 * 1024 * 1024;
constexpr size_t kMostBytesNeeded = 64 * 1024;
constexpr int32 kUsualWeight = 50;


std::string
ReadFile(const std::string& path)
{
	std::ifstream stream(path, std::ios::binary);
	std::string bytes(std::istreambuf_iterator<char>(stream), {});
	if (bytes.size() > kLargestFile)
		bytes.clear();
	return bytes;
}


std::string
LowerCase(std::string_view text)
{
	std::string lower(text);
	for (char& character : lower) {
		if (character >= 'A' && character <= 'Z')
			character += 'a' - 'A';
	}
	return lower;
}


std::vector<std::string>
SystemFolders()
{
	std::vector<std::string> folders;
	const char* home = getenv("XDG_DATA_HOME");
	if (home != NULL && home[0] == '/')
		folders.push_back(std::string(home) + "/mime");
	else if (const char* user = getenv("HOME"))
		folders.push_back(std::string(user) + "/.local/share/mime");
	const char* shared = getenv("XDG_DATA_DIRS");
	std::istringstream list(
		shared != NULL && shared[0] != '\0' ? shared : "/usr/local/share:/usr/share");
	std::string folder;
	while (std::getline(list, folder, ':')) {
		if (!folder.empty() && folder[0] == '/')
			folders.push_back(folder + "/mime");
	}
	return folders;
}


// The language of messages, as "de_DE" and "de".
std::vector<std::string>
Languages()
{
	const char* locale = getenv("LC_ALL");
	if (locale == NULL || locale[0] == '\0')
		locale = getenv("LC_MESSAGES");
	if (locale == NULL || locale[0] == '\0')
		locale = getenv("LANG");
	std::string name = locale != NULL ? locale : "";
	name.resize(std::min(name.find_first_of(".@"), name.size()));
	if (name.empty())
		return {};
	return { name, name.substr(0, name.find('_')) };
}


std::string
PlainText(std::string text)
{
	static const std::pair<const char*, const char*> kEntities[] = { { "&lt;", "<" },
		{ "&gt;", ">" }, { "&quot;", "\"" }, { "&apos;", "'" }, { "&amp;", "&" } };
	for (const auto& [entity, character] : kEntities) {
		for (size_t at = text.find(entity); at != std::string::npos; at = text.find(entity, at + 1))
			text.replace(at, strlen(entity), character);
	}
	return text;
}


// The text of the first such element.
bool
FindElement(const std::string& xml, const std::string& start, std::string* _text)
{
	const size_t place = xml.find(start);
	if (place == std::string::npos)
		return false;
	const size_t text = place + start.size();
	const size_t end = xml.find('<', text);
	if (end == std::string::npos)
		return false;
	*_text = PlainText(xml.substr(text, end - text));
	return true;
}

} // namespace


const MimeDatabase&
MimeDatabase::Get()
{
	static const MimeDatabase& database = *new MimeDatabase(SystemFolders());
	return database;
}


MimeDatabase::MimeDatabase(const std::vector<std::string>& folders) :
	fFolders(folders), fBytesNeeded(0)
{
	for (const std::string& folder : fFolders) {
		_ReadTypes(folder);
		_ReadGlobs(folder);
		_ReadMagic(folder);
	}
	std::stable_sort(fMagic.begin(), fMagic.end(),
		[](const Magic& a, const Magic& b) { return a.priority > b.priority; });
}


bool
MimeDatabase::IsKnown(const std::string& type) const
{
	if (fTypes.count(type) != 0)
		return true;
	const auto first = fTypes.lower_bound(type + "/");
	return first != fTypes.end() && first->compare(0, type.size() + 1, type + "/") == 0;
}


std::vector<std::string>
MimeDatabase::ExtensionsOf(const std::string& type) const
{
	const auto found = fExtensions.find(type);
	return found != fExtensions.end() ? found->second : std::vector<std::string>();
}


std::string
MimeDatabase::DescriptionOf(const std::string& type) const
{
	if (!IsKnown(type))
		return std::string(); // then nobody's path is made of it
	for (const std::string& folder : fFolders) {
		const std::string xml = ReadFile(folder + "/" + type + ".xml");
		std::string text;
		for (const std::string& language : Languages()) {
			if (FindElement(xml, "<comment xml:lang=\"" + language + "\">", &text))
				return text;
		}
		if (FindElement(xml, "<comment>", &text))
			return text;
	}
	return std::string();
}


std::string
MimeDatabase::TypeOfName(std::string_view leaf, int32* _weight) const
{
	const Glob* best = _GlobOf(leaf);
	if (best == NULL)
		return std::string();
	if (_weight != NULL)
		*_weight = best->weight;
	return best->type;
}


// A whole name comes first.
const MimeDatabase::Glob*
MimeDatabase::_GlobOf(std::string_view leaf) const
{
	const std::string exact(leaf);
	const std::string lower = LowerCase(leaf);
	const auto literal = fLiterals.find(exact);
	if (literal != fLiterals.end())
		return &literal->second;

	// The longest suffix wins among those of the greatest weight.
	const Glob* best = NULL;
	const auto consider = [&](const Glob& glob) {
		if (best == NULL || glob.weight > best->weight
			|| (glob.weight == best->weight && glob.pattern.size() > best->pattern.size()))
			best = &glob;
	};
	for (size_t dot = 0; dot < lower.size(); dot++) {
		const auto found = fSuffixes.find(lower.substr(dot));
		if (found == fSuffixes.end())
			continue;
		for (const Glob& glob : found->second) {
			if (!glob.caseSensitive || exact.substr(dot) == glob.pattern.substr(1))
				consider(glob);
		}
	}
	for (const Glob& glob : fGlobs) {
		if (fnmatch(glob.pattern.c_str(), (glob.caseSensitive ? exact : lower).c_str(), 0) == 0)
			consider(glob);
	}
	return best;
}


std::string
MimeDatabase::TypeOfBytes(const void* data, size_t size, int32* _weight) const
{
	const std::string_view bytes(static_cast<const char*>(data), size);
	for (const Magic& magic : fMagic) {
		if (!_Matches(magic, bytes))
			continue;
		if (_weight != NULL)
			*_weight = magic.priority;
		return magic.type;
	}
	return std::string();
}


// #pragma mark - private


void
MimeDatabase::_ReadTypes(const std::string& folder)
{
	std::istringstream lines(ReadFile(folder + "/types"));
	std::string line;
	while (std::getline(lines, line)) {
		if (!line.empty() && line[0] != '#')
			fTypes.insert(LowerCase(line));
	}
}


void
MimeDatabase::_ReadGlobs(const std::string& folder)
{
	std::istringstream lines(ReadFile(folder + "/globs2"));
	std::string line;
	while (std::getline(lines, line)) {
		if (line.empty() || line[0] == '#')
			continue;
		std::vector<std::string> parts;
		std::istringstream fields(line);
		for (std::string part; std::getline(fields, part, ':');)
			parts.push_back(part);
		if (parts.size() < 3 || parts[2].empty() || parts[2] == "__NOGLOBS__")
			continue;
		const int32 weight = static_cast<int32>(strtol(parts[0].c_str(), NULL, 10));
		const bool caseSensitive = parts.size() > 3 && parts[3].find("cs") != std::string::npos;
		_AddGlob({ caseSensitive ? parts[2] : LowerCase(parts[2]), LowerCase(parts[1]), weight,
			caseSensitive });
	}
}


void
MimeDatabase::_AddGlob(Glob glob)
{
	fTypes.insert(glob.type);
	const size_t special = glob.pattern.find_first_of("*?[");
	if (special == std::string::npos) {
		fLiterals.emplace(glob.pattern, glob);
		return;
	}
	const bool suffix = special == 0 && glob.pattern[0] == '*'
		&& glob.pattern.find_first_of("*?[", 1) == std::string::npos;
	if (!suffix) {
		fGlobs.push_back(std::move(glob));
		return;
	}
	if (glob.pattern.size() > 2 && glob.pattern[1] == '.') {
		std::vector<std::string>& extensions = fExtensions[glob.type];
		const std::string extension = glob.pattern.substr(2);
		if (std::find(extensions.begin(), extensions.end(), extension) == extensions.end()) {
			// The usual one comes first.
			const bool usual = glob.weight > kUsualWeight;
			extensions.insert(usual ? extensions.begin() : extensions.end(), extension);
		}
	}
	fSuffixes[LowerCase(glob.pattern.substr(1))].push_back(std::move(glob));
}


void
MimeDatabase::_ReadMagic(const std::string& folder)
{
	static const std::string kStart("MIME-Magic\0\n", 12);
	const std::string file = ReadFile(folder + "/magic");
	const std::string_view bytes(file);
	if (bytes.substr(0, kStart.size()) != kStart)
		return;

	size_t place = kStart.size();
	while (place < bytes.size() && bytes[place] == '[') {
		const size_t colon = bytes.find(':', place);
		const size_t end = bytes.find("]\n", place);
		if (colon == std::string_view::npos || end == std::string_view::npos || colon > end)
			return;
		Magic magic;
		magic.priority = static_cast<int32>(
			strtol(std::string(bytes.substr(place + 1, colon - place - 1)).c_str(), NULL, 10));
		magic.type = LowerCase(bytes.substr(colon + 1, end - colon - 1));
		place = end + 2;
		while (place < bytes.size() && bytes[place] != '[') {
			if (!_ReadMagicLine(bytes, &place, &magic))
				return;
		}
		fTypes.insert(magic.type);
		fMagic.push_back(std::move(magic));
	}
}


// [indent] ">" offset "=" two bytes of length, the value, ["&" mask] ["~" word size] ["+" range]
bool
MimeDatabase::_ReadMagicLine(std::string_view bytes, size_t* _place, Magic* magic)
{
	size_t place = *_place;
	const auto number = [&](uint32* _number) {
		uint64 value = 0;
		const size_t start = place;
		while (place < bytes.size() && bytes[place] >= '0' && bytes[place] <= '9'
			&& value < UINT32_MAX)
			value = value * 10 + (bytes[place++] - '0');
		*_number = static_cast<uint32>(std::min<uint64>(value, UINT32_MAX));
		return place > start;
	};
	const auto take = [&](char character) {
		const bool there = place < bytes.size() && bytes[place] == character;
		place += there;
		return there;
	};

	MagicLine line = { 0, 0, {}, {}, 1 };
	uint32 indent = 0;
	number(&indent);
	line.indent = static_cast<int32>(indent);
	if (!take('>') || !number(&line.offset) || !take('=') || bytes.size() - place < 2)
		return false;
	const size_t length =
		static_cast<uint8>(bytes[place]) << 8 | static_cast<uint8>(bytes[place + 1]);
	place += 2;
	if (bytes.size() - place < length)
		return false;
	line.value = bytes.substr(place, length);
	place += length;
	if (take('&')) {
		if (bytes.size() - place < length)
			return false;
		line.mask = bytes.substr(place, length);
		place += length;
	}
	uint32 wordSize = 1;
	if (take('~') && !number(&wordSize))
		return false;
	if (take('+') && !number(&line.range))
		return false;
	// Later versions of the format may say more here.
	const size_t end = bytes.find('\n', place);
	if (end == std::string_view::npos)
		return false;
	*_place = end + 1;

	// Values of the host's byte order are stored in the network's.
	if (wordSize > 1 && wordSize <= length && length % wordSize == 0) {
		for (size_t start = 0; start < length; start += wordSize) {
			std::reverse(line.value.begin() + start, line.value.begin() + start + wordSize);
			if (!line.mask.empty())
				std::reverse(line.mask.begin() + start, line.mask.begin() + start + wordSize);
		}
	}
	const uint64 needed = uint64(line.offset) + line.range + length;
	fBytesNeeded = std::max<size_t>(fBytesNeeded, std::min<uint64>(needed, kMostBytesNeeded));
	magic->lines.push_back(std::move(line));
	return true;
}


// A line counts when it and one of its children, if it has any, match.
bool
MimeDatabase::_Matches(const Magic& magic, std::string_view bytes)
{
	int32 wanted = 0; // the level whose lines are tried
	for (size_t i = 0; i < magic.lines.size(); i++) {
		const MagicLine& line = magic.lines[i];
		if (line.indent > wanted)
			continue; // a child of a line that did not match
		wanted = line.indent;
		if (!_Matches(line, bytes))
			continue;
		if (i + 1 == magic.lines.size() || magic.lines[i + 1].indent <= line.indent)
			return true;
		wanted = line.indent + 1;
	}
	return false;
}


bool
MimeDatabase::_Matches(const MagicLine& line, std::string_view bytes)
{
	const size_t length = line.value.size();
	for (size_t at = line.offset; at < size_t(line.offset) + line.range; at++) {
		if (at + length > bytes.size())
			return false;
		bool same = true;
		for (size_t i = 0; same && i < length; i++) {
			const char mask = line.mask.empty() ? '\xff' : line.mask[i];
			same = (bytes[at + i] & mask) == (line.value[i] & mask);
		}
		if (same)
			return true;
	}
	return false;
}

} // namespace BPrivate
