// The views that an editor shows of a sample are those of the tree that was archived, as the
// sample's .tree file lists them.

#include "EditorFixture.h"

#include <algorithm>
#include <cxxabi.h>
#include <filesystem>
#include <fstream>
#include <sstream>

#include <gmock/gmock.h>

#include <Resources.h>

#include "support/Dump.h"

namespace {


// "Class name" of a view: one line for each, sorted.
using Views = std::vector<std::string>;


std::string
WithoutNamespace(std::string name)
{
	const size_t colon = name.rfind("::");
	return colon == std::string::npos ? name : name.substr(colon + 2);
}


std::string
ClassOf(const BView* view)
{
	const std::unique_ptr<char, decltype(&std::free)> name(
		abi::__cxa_demangle(typeid(*view).name(), nullptr, nullptr, nullptr), &std::free);
	return WithoutNamespace(name.get());
}


// As the .tree files write it: quotes and backslashes behind a backslash, what is no ASCII by number.
std::string
Escaped(const char* text)
{
	std::ostringstream escaped;
	for (const char* at = text == nullptr ? "" : text; *at != '\0'; at++) {
		const unsigned char byte = static_cast<unsigned char>(*at);
		if (byte == '"' || byte == '\\')
			escaped << '\\' << *at;
		else if (byte >= ' ' && byte < 0x7f)
			escaped << *at;
		else
			escaped << "\\x" << std::hex << (byte >> 4) << (byte & 15);
	}
	return escaped.str();
}


Views
ViewsOf(BView* root)
{
	std::vector<BView*> all = ControlUser::All<BView>(root);
	all.push_back(root);
	Views views;
	for (const BView* view : all)
		views.push_back(ClassOf(view) + " " + Escaped(view->Name()));
	std::sort(views.begin(), views.end());
	return views;
}


// Those in the tree: the pages of a tab view that it does not show stand beneath "(unattached)".
Views
ViewsOfTreeFile(const std::filesystem::path& path)
{
	std::ifstream file(path);
	Views views;
	size_t unattached = std::string::npos;
	for (std::string line; std::getline(file, line);) {
		const size_t indent = line.find_first_not_of(' ');
		if (indent == std::string::npos || indent > unattached)
			continue;
		const bool isUnattached = line.compare(indent, 12, "(unattached)") == 0;
		unattached = isUnattached ? indent : std::string::npos;
		if (line.compare(indent, 5, "view ") != 0)
			continue;
		const size_t name = line.find(" name=") + 6;
		const std::string title = line.substr(name, line.find(" frame=") - name);
		const std::string text =
			title == "(null)" ? std::string() : title.substr(1, title.size() - 2);
		views.push_back(WithoutNamespace(line.substr(indent + 5, name - indent - 11)) + " " + text);
	}
	std::sort(views.begin(), views.end());
	return views;
}


// The item that the tree belongs to: "NAME.7.tree" is that of item 7, "NAME.tree" that of every one.
bool
Describes(const std::filesystem::path& tree, int32 id)
{
	const std::string number = tree.stem().extension();
	return number.empty() || number == "." + std::to_string(id);
}


std::filesystem::path
ResourceFileOf(const std::filesystem::path& tree)
{
	std::filesystem::path file = tree.parent_path() / tree.stem();
	file += ".rsrc";
	return std::filesystem::exists(file) ? file
										 : file.replace_extension().replace_extension(".rsrc");
}


class SampleTrees : public EditorFixture {
protected:
	void ExpectShown(BResources& resources, type_code type, int32 id, const Views& expected)
	{
		SCOPED_TRACE(id);
		size_t size;
		const char* data = static_cast<const char*>(resources.LoadResource(type, id, &size));
		ASSERT_NE(nullptr, data);
		Open(Add(++itemCount, std::vector<char>(data, data + size)));
		ASSERT_NE(nullptr, Root());
		Views shown;
		window.Locked([&] { shown = ViewsOf(Root()); });
		EXPECT_THAT(shown, testing::ElementsAreArray(expected));
		Close();
	}

	void ExpectShown(const std::filesystem::path& tree)
	{
		SCOPED_TRACE(tree);
		const Views expected = ViewsOfTreeFile(tree);
		EXPECT_LE(1u, expected.size());
		BResources resources(ResourceFileOf(tree).c_str());
		type_code type;
		int32 id;
		const char* name;
		size_t size;
		for (int32 i = 0; resources.GetResourceInfo(i, &type, &id, &name, &size); i++) {
			if (type == 'ARCV' && Describes(tree, id))
				ExpectShown(resources, type, id, expected);
		}
	}

	int32 itemCount = 0;
};


} // namespace


TEST_F(SampleTrees, AreShownWhole)
{
	if (test::samples_folder().empty())
		GTEST_SKIP() << "ARCHWAY_SAMPLES names no folder";
	for (const auto& entry :
		std::filesystem::recursive_directory_iterator(test::samples_folder())) {
		if (entry.path().extension() == ".tree")
			ExpectShown(entry.path());
	}
	EXPECT_LE(60, itemCount);
}
