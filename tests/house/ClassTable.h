// The table of the Interface Kit in docs/CLASSES.md: what each class archives and can do, and which
// test covers it, taken from headers, sources and tests, and from trying.
#pragma once

#include <map>
#include <string>
#include <vector>


struct ArchiveField {
	std::string type; // as in BMessage's Find functions: "Int32", "String", ...; "" when unknown
	bool read = false;
	bool written = false;
};

struct KitClass {
	std::string name;
	std::string header; // from the root of the sources
	std::vector<std::string> sources;
	std::map<std::string, ArchiveField> fields; // its own, not those of its bases
	std::vector<std::string> calls; // public and protected functions, in order
};

// One TEST, by what it is called and what stands in it.
struct TestText {
	std::string name; // "Button.KeysInvoke"
	std::string file; // without folder and suffix: "ButtonTest"
	std::string text;
};


// `name` is with its B; the files are those that begin with the name without it.
KitClass ReadClass(const std::string& name, const std::string& headerFolder = "kits/interface");
std::vector<TestText> ReadTests();

// The names of the tests that mention the field or make the call; those of the class's own test
// file first. A hook counts as called by a test that does what the hook is for.
std::vector<std::string> TestsOfField(
	const std::vector<TestText>& tests, const KitClass& theClass, const std::string& field);
std::vector<std::string> TestsOfCall(
	const std::vector<TestText>& tests, const KitClass& theClass, const std::string& call);

// Whether a picture of an object of the class changes with the field: "yes", "no", or "" where
// there is nothing to try. Needs an application.
std::string IsShown(
	const std::string& className, const std::string& field, const std::string& type);
