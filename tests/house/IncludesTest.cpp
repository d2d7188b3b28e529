// The arrows of the house: what each folder includes, read from the sources.

#include <algorithm>
#include <filesystem>
#include <fstream>
#include <regex>
#include <set>
#include <string>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace {


namespace fs = std::filesystem;

const fs::path kRoot = ARCHWAY_SOURCES;

// A rule speaks for the files below a folder, the longest folder that fits winning.
struct Rule {
	std::string folder;
	std::vector<std::string> project; // allowed beginnings of project includes
	bool platform; // public platform headers
	bool system; // headers of the operating system and of libraries
	bool qt;
};

const std::vector<Rule> kRules = {
	{ "archive", { "archive/" }, true, false, false },
	{ "work", { "archive/", "work/" }, true, false, false },
	{ "palette", { "archive/", "palette/" }, true, false, false },
	{ "editors", { "archive/", "editors/" }, true, false, false },
	{ "addon", { "addon/", "archive/", "work/", "palette/", "editors/", "host/library/" }, true,
		false, false },
	{ "host/library", { "host/library/" }, true, false, false },
	{ "host/application", { "host/" }, true, true, false },
	{ "tools", { "archive/", "tools/" }, true, true, false },
	{ "kits",
		{ "kernel/", "support/", "app/", "storage/", "interface/", "translation/", "server/" },
		true, true, false },
	{ "kits/server",
		{ "kernel/private/", "support/private/", "server/", "backend/Backend", "backend/KeyTable.h",
			"backend/FolderDrop.h", "app/private/Delivery.h" },
		true, true, false },
	{ "kits/server/paint", { "kernel/private/", "support/private/", "server/paint/" }, true, true,
		true },
	{ "kits/backend",
		{ "kernel/private/", "support/private/", "backend/", "server/FrontImage.h",
			"server/CursorShape.h", "server/ScreenPicture.h", "server/paint/" },
		true, true, false },
	{ "kits/backend/qt",
		{ "kernel/private/", "support/private/", "backend/", "server/FrontImage.h",
			"server/CursorShape.h", "server/ScreenPicture.h", "server/paint/" },
		true, true, true },
};

// The value classes, which server and backend take from the other kits.
const std::set<std::string> kValueHeaders = { "BeBuild.h", "SupportDefs.h", "Errors.h",
	"TypeConstants.h", "String.h", "List.h", "OS.h", "Debug.h", "AppDefs.h", "Message.h",
	"Messenger.h", "MessageForm.h", "DataIO.h", "Entry.h", "Path.h", "Font.h", "Point.h", "Rect.h",
	"Region.h", "GraphicsDefs.h", "InterfaceDefs.h" };

// The language's own headers that end in ".h" are not used by folders that must be portable,
// but for these.
const std::set<std::string> kLanguageHeaders = { "stdio.h", "stdlib.h", "string.h", "math.h" };


struct Include {
	std::string name;
	bool quoted;
};


std::vector<Include>
IncludesOf(const std::string& text)
{
	static const std::regex kPattern(
		R"(^\s*#\s*include\s*([<"])([^>"]+)[>"])", std::regex::multiline);
	std::vector<Include> includes;
	for (std::sregex_iterator it(text.begin(), text.end(), kPattern), end; it != end; ++it)
		includes.push_back({ (*it)[2], (*it)[1] == "\"" });
	return includes;
}


// Public platform headers, by the name that programs include them by.
std::set<std::string>
PlatformHeaders()
{
	std::set<std::string> names;
	for (const char* kit : { "kernel", "support", "app", "storage", "interface", "translation" }) {
		const fs::path folder = kRoot / "kits" / kit;
		if (!fs::exists(folder))
			continue;
		for (const auto& entry : fs::directory_iterator(folder)) {
			if (entry.path().extension() == ".h")
				names.insert(entry.path().filename().string());
		}
	}
	return names;
}


const Rule*
RuleFor(const std::string& path)
{
	const Rule* best = nullptr;
	for (const Rule& rule : kRules) {
		if (path.rfind(rule.folder + "/", 0) == 0
			&& (best == nullptr || rule.folder.size() > best->folder.size()))
			best = &rule;
	}
	return best;
}


bool
StartsWithAny(const std::string& name, const std::vector<std::string>& beginnings)
{
	return std::any_of(beginnings.begin(), beginnings.end(),
		[&name](const std::string& beginning) { return name.rfind(beginning, 0) == 0; });
}


bool
IsAllowed(const std::string& path, const Rule& rule, const Include& include,
	const std::set<std::string>& platform)
{
	const bool isOwnHeader =
		include.name.find('/') == std::string::npos && platform.count(include.name) != 0;
	if (include.quoted && !(rule.folder == "kits" && isOwnHeader))
		return StartsWithAny(include.name, rule.project);

	const bool isQt =
		std::regex_match(include.name, std::regex("(Qt.*/)?Q[A-Za-z]+|qpa/.*|q[a-z]+\\.h"));
	if (isQt)
		return rule.qt;

	if (platform.count(include.name) != 0) {
		const bool valuesOnly =
			rule.folder.rfind("kits/server", 0) == 0 || rule.folder.rfind("kits/backend", 0) == 0;
		return rule.platform && (!valuesOnly || kValueHeaders.count(include.name) != 0);
	}

	const bool isLanguage =
		include.name.find('.') == std::string::npos || kLanguageHeaders.count(include.name) != 0;
	if (isLanguage)
		return true;

	// Our own documented extension.
	if (include.name == "MessageForm.h")
		return rule.folder == "host/application" || rule.folder == "tools";
	return rule.system;
}


std::vector<std::string>
WrongArrows(const std::string& path, const std::string& text, const std::set<std::string>& platform)
{
	std::vector<std::string> wrong;
	const Rule* rule = RuleFor(path);
	if (rule == nullptr)
		return wrong;

	for (const Include& include : IncludesOf(text)) {
		if (!IsAllowed(path, *rule, include, platform))
			wrong.push_back(path + " includes " + include.name);
	}
	return wrong;
}


std::string
ReadFile(const fs::path& path)
{
	std::ifstream file(path, std::ios::binary);
	return std::string(std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>());
}


} // namespace


TEST(Includes, RunOneWayOnly)
{
	const std::set<std::string> platform = PlatformHeaders();
	std::vector<std::string> wrong;
	int files = 0;
	for (const Rule& rule : kRules) {
		if (rule.folder.find('/') != std::string::npos && rule.folder.rfind("kits/", 0) == 0)
			continue;
		if (!fs::exists(kRoot / rule.folder))
			continue;
		for (const auto& entry : fs::recursive_directory_iterator(kRoot / rule.folder)) {
			const std::string extension = entry.path().extension().string();
			if (extension != ".h" && extension != ".cpp")
				continue;
			files++;
			const std::string path = fs::relative(entry.path(), kRoot).generic_string();
			const auto found = WrongArrows(path, ReadFile(entry.path()), platform);
			wrong.insert(wrong.end(), found.begin(), found.end());
		}
	}
	EXPECT_GT(files, 50);
	EXPECT_THAT(wrong, testing::IsEmpty());
}


TEST(Includes, WrongArrowsAreFound)
{
	const std::set<std::string> platform = { "View.h", "Message.h", "Rect.h", "MessageForm.h" };
	auto wrong = [&platform](const char* path, const char* include) {
		return WrongArrows(path, std::string("#include ") + include + "\n", platform).size();
	};

	EXPECT_EQ(0u, wrong("archive/ViewTree.cpp", "<View.h>"));
	EXPECT_EQ(0u, wrong("archive/ViewTree.cpp", "<vector>"));
	EXPECT_EQ(1u, wrong("archive/ViewTree.cpp", "\"work/WorkView.h\""));
	EXPECT_EQ(1u, wrong("archive/ViewTree.cpp", "<unistd.h>"));
	EXPECT_EQ(1u, wrong("work/WorkView.cpp", "\"interface/private/Look.h\""));
	EXPECT_EQ(1u, wrong("editors/EditView.cpp", "\"addon/ViewEditor.h\""));
	EXPECT_EQ(1u, wrong("host/library/ResourceItem.cpp", "\"host/application/App.h\""));
	EXPECT_EQ(1u, wrong("host/application/App.cpp", "<QWindow>"));
	EXPECT_EQ(1u, wrong("kits/interface/View.cpp", "<QtGui/QImage>"));
	EXPECT_EQ(0u, wrong("kits/server/paint/Painter.cpp", "<QImage>"));
	EXPECT_EQ(1u, wrong("kits/server/Desktop.cpp", "<View.h>"));
	EXPECT_EQ(0u, wrong("kits/server/Desktop.cpp", "<Message.h>"));
	EXPECT_EQ(1u, wrong("kits/backend/headless/HeadlessBackend.cpp", "\"server/Desktop.h\""));
	EXPECT_EQ(1u, wrong("kits/app/Message.cpp", "\"host/library/ResourceItem.h\""));
}
