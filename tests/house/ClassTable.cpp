#include "ClassTable.h"

#include <algorithm>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <regex>
#include <set>

namespace {


namespace fs = std::filesystem;

const fs::path kRoot = ARCHWAY_SOURCES;


std::string
ReadFile(const fs::path& path)
{
	std::ifstream file(path, std::ios::binary);
	return std::string(std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>());
}


std::string
WithoutComments(const std::string& text)
{
	return std::regex_replace(text, std::regex("//[^\n]*"), "");
}


// The place behind the bracket that closes the one at `at`.
size_t
EndOfGroup(const std::string& text, size_t at)
{
	int depth = 0;
	for (; at < text.size(); at++) {
		if (text[at] == '{' || text[at] == '(')
			depth++;
		else if ((text[at] == '}' || text[at] == ')') && --depth == 0)
			return at + 1;
	}
	return text.size();
}


std::string
ClassBody(const std::string& header, const std::string& name)
{
	std::smatch match;
	const std::regex pattern("class (_EXPORT )?" + name + "\\b[^;{]*\\{");
	if (!std::regex_search(header, match, pattern))
		return "";
	const size_t start = static_cast<size_t>(match.position(0) + match.length(0));
	return header.substr(start, EndOfGroup(header, start - 1) - start - 1);
}


// Declarations at the outermost level, with what follows each; access labels become ones of
// their own.
std::vector<std::string>
Declarations(const std::string& body)
{
	std::vector<std::string> result;
	std::string current;
	for (size_t i = 0; i < body.size(); i++) {
		if (body[i] == '{') {
			result.push_back(current);
			current.clear();
			i = EndOfGroup(body, i) - 1;
		} else if (body[i] == '(') {
			const size_t end = EndOfGroup(body, i);
			current += "(" + std::string(end < body.size() ? ")" : "");
			i = end - 1;
		} else if (body[i] == ';') {
			result.push_back(current);
			current.clear();
		} else {
			current += body[i];
			if (current.ends_with("public:") || current.ends_with("protected:")
				|| current.ends_with("private:")) {
				result.push_back(current);
				current.clear();
			}
		}
	}
	return result;
}


std::vector<std::string>
CallsOf(const std::string& header, const std::string& name)
{
	std::vector<std::string> calls;
	bool visible = false;
	const std::regex function("([A-Za-z_0-9]+)\\s*\\(\\)");
	for (const std::string& declaration : Declarations(ClassBody(header, name))) {
		if (declaration.ends_with(":")) {
			visible = !declaration.ends_with("private:");
			continue;
		}
		std::smatch match;
		if (!visible || !std::regex_search(declaration, match, function)
			|| declaration.find("operator") != std::string::npos
			|| declaration.find("typedef") != std::string::npos)
			continue;
		const std::string call = match[1];
		const bool special = call == name || call[0] == '_' || call == "throw"
			|| declaration.find('~') != std::string::npos;
		if (!special && std::find(calls.begin(), calls.end(), call) == calls.end())
			calls.push_back(call);
	}
	return calls;
}


void
AddField(std::map<std::string, ArchiveField>& fields, const std::string& name,
	const std::string& type, bool read)
{
	ArchiveField& field = fields[name];
	(read ? field.read : field.written) = true;
	if (field.type.empty() && type != "Data")
		field.type = type;
}


void
FindFields(const std::string& source, std::map<std::string, ArchiveField>& fields)
{
	const std::string name = "\"((?:_|be:|BView:)[A-Za-z_0-9:]+)\"";
	// The writer's own source is what was read; asking it is part of writing.
	const std::regex reads("(?:archive|data|from)(?:->|\\.)(?:Find|Get|Has)([A-Z][A-Za-z0-9]*)"
						   "\\(\\s*"
		+ name);
	const std::regex helperReads(
		"\\b(read|read_bool|read_text|read_message|_ReadItems|RevivePage)\\("
		"(?:archive,\\s*)?"
		+ name);
	const std::regex writes("writer\\.(?!Keep|Source)([A-Z][A-Za-z0-9]*)\\(\\s*" + name);
	const std::regex adds("(?:archive|data|into)(?:->|\\.)Add([A-Z][A-Za-z0-9]*)\\(\\s*" + name);
	const std::regex helperWrites("\\b(write_text|write_message|_ArchiveOwn)\\(([^;\"]*)" + name);

	for (std::sregex_iterator it(source.begin(), source.end(), reads), end; it != end; ++it)
		AddField(fields, (*it)[2], (*it)[1], true);
	for (std::sregex_iterator it(source.begin(), source.end(), helperReads), end; it != end; ++it) {
		const std::string helper = (*it)[1];
		const char* type = helper == "read" || helper == "read_bool" ? "Bool"
			: helper == "read_text"                                  ? "String"
																	 : "Message";
		AddField(fields, (*it)[2], type, true);
	}
	for (std::sregex_iterator it(source.begin(), source.end(), writes), end; it != end; ++it)
		AddField(fields, (*it)[2], (*it)[1], false);
	// What is always written as it was read.
	const std::regex kept("writer\\.Keep\\(" + name + ",\\s*true\\)");
	for (std::sregex_iterator it(source.begin(), source.end(), kept), end; it != end; ++it)
		AddField(fields, (*it)[1], "", false);
	for (std::sregex_iterator it(source.begin(), source.end(), adds), end; it != end; ++it)
		AddField(fields, (*it)[2], (*it)[1], false);
	for (std::sregex_iterator it(source.begin(), source.end(), helperWrites), end; it != end; ++it)
		AddField(fields, (*it)[3], (*it)[1] == "write_text" ? "String" : "Message", false);
}


// Hooks are called by the kit; these are the marks of a test that makes it call them.
std::string
EvidenceFor(const std::string& call)
{
	static const std::map<std::string, std::string> kEvidence = {
		{ "MouseDown", "Click\\(|Press\\(|Drag\\(" },
		{ "MouseUp", "Click\\(|Release\\(|Drag\\(" },
		{ "MouseMoved", "MoveTo\\(|Drag\\(" },
		{ "KeyDown", "[dD]river\\.(Key|Type)" },
		{ "KeyUp", "[dD]river\\.(Key|Type)" },
		{ "Draw", "PixelAt|Picture|Screenshot" },
		{ "DrawAfterChildren", "DRAW_ON_CHILDREN" },
		{ "AttachedToWindow", "\\bAdd(Child)?\\(" },
		{ "AllAttached", "\\bAdd(Child)?\\(" },
		{ "DetachedFromWindow", "Remove(Self|Child)" },
		{ "AllDetached", "Remove(Self|Child)" },
		{ "Archive", "ArchiveOf|RoundTrip|Archive\\(" },
		{ "Instantiate", "Revive|RoundTrip|instantiate" },
		{ "FrameResized", "Resize(To|By|Window)" },
		{ "FrameMoved", "\\bMove(To|By|Window)\\(" },
		{ "MakeFocus", "Focus\\(|\"Tab\"" },
		{ "WindowActivated", "Activate(Window)?\\(" },
		{ "MessageReceived", "Received|PostMessage|SendMessage" },
		{ "DispatchMessage", "Received|PostMessage|SendMessage" },
		{ "Pulse", "Pulse" },
		{ "ValueChanged", "ValueChanged" },
	};
	const auto found = kEvidence.find(call);
	return found != kEvidence.end() ? found->second : "";
}


// BView's are ViewTest, ViewTreeTest and so on, but not those of a class whose name goes on.
bool
IsOwnFile(const std::string& file, const KitClass& theClass)
{
	static const std::set<std::string> kLongerNames = { "MenuFieldTest", "MenuBarTest",
		"MenuItemTest", "BitmapViewTest", "TabViewTest" };
	const std::string base = theClass.name.substr(1);
	return file == base + "Test" || (file.starts_with(base) && kLongerNames.count(file) == 0);
}


std::vector<std::string>
TestsThatMatch(const std::vector<TestText>& tests, const KitClass& theClass,
	const std::string& word, const std::regex& pattern)
{
	std::vector<std::string> own, others;
	for (const TestText& test : tests) {
		const bool isOwn = IsOwnFile(test.file, theClass);
		// Looking for words first saves most of the slow searches.
		if ((!isOwn && test.text.find(theClass.name) == std::string::npos)
			|| test.text.find(word) == std::string::npos || !std::regex_search(test.text, pattern))
			continue;
		(isOwn ? own : others).push_back(test.name);
	}
	own.insert(own.end(), others.begin(), others.end());
	return own;
}


} // namespace


KitClass
ReadClass(const std::string& name, const std::string& headerFolder)
{
	const std::string base = name.substr(1);
	// Some classes share a header with their family.
	static const std::map<std::string, std::string> kHeaders = { { "BTab", "TabView" } };
	const auto shared = kHeaders.find(name);

	KitClass result;
	result.name = name;
	result.header = headerFolder + "/" + (shared != kHeaders.end() ? shared->second : base) + ".h";
	result.calls = CallsOf(WithoutComments(ReadFile(kRoot / result.header)), name);

	for (const auto& entry : fs::directory_iterator(kRoot / headerFolder)) {
		const std::string file = entry.path().filename().string();
		const std::regex own(base + "(Archive|Items|Draw|Settings|Looks|Text|Levels)?\\.cpp");
		if (std::regex_match(file, own))
			result.sources.push_back(entry.path().string());
	}
	std::sort(result.sources.begin(), result.sources.end());
	for (const std::string& source : result.sources)
		FindFields(WithoutComments(ReadFile(source)), result.fields);
	return result;
}


std::vector<TestText>
ReadTests()
{
	std::vector<fs::path> files;
	for (const auto& entry : fs::recursive_directory_iterator(kRoot / "tests")) {
		if (entry.path().filename().string().ends_with("Test.cpp"))
			files.push_back(entry.path());
	}
	std::sort(files.begin(), files.end());

	std::vector<TestText> tests;
	const std::regex start("\nTEST(_[FP])?\\((\\w+),\\s*(\\w+)\\)");
	for (const fs::path& path : files) {
		const std::string text = ReadFile(path);
		// What stands before the tests is for all of them.
		tests.push_back({ path.stem().string() + " (what its tests share)", path.stem().string(),
			text.substr(0, text.find("\nTEST")) });
		for (std::sregex_iterator it(text.begin(), text.end(), start), end; it != end; ++it) {
			const size_t at = static_cast<size_t>(it->position(0));
			const size_t next = text.find("\nTEST", at + 1);
			tests.push_back({ (*it)[2].str() + "." + (*it)[3].str(), path.stem().string(),
				text.substr(at, next - at) });
		}
	}
	return tests;
}


std::vector<std::string>
TestsOfField(const std::vector<TestText>& tests, const KitClass& theClass, const std::string& field)
{
	return TestsThatMatch(
		tests, theClass, field, std::regex("(^|[^A-Za-z0-9_:])" + field + "($|[^A-Za-z0-9_:])"));
}


std::vector<std::string>
TestsOfCall(const std::vector<TestText>& tests, const KitClass& theClass, const std::string& call)
{
	std::vector<std::string> result =
		TestsThatMatch(tests, theClass, call, std::regex("[^A-Za-z0-9_]" + call + "\\("));
	const std::string evidence = EvidenceFor(call);
	if (result.empty() && !evidence.empty())
		result = TestsThatMatch(tests, theClass, "", std::regex(evidence));
	return result;
}
