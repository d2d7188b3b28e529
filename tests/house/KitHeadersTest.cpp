// Each kit's one include has all of its public headers.

#include <filesystem>
#include <fstream>
#include <iterator>
#include <set>
#include <string>

#include <AppKit.h>
#include <InterfaceKit.h>
#include <KernelKit.h>
#include <StorageKit.h>
#include <SupportKit.h>
#include <TranslationKit.h>

#include <gtest/gtest.h>

namespace {


namespace fs = std::filesystem;

// Not of the platform's own interface, or the base of something.
const std::set<std::string> kApart = { "MessageForm.h", "ResourceForm.h", "MarkedControl.h",
	"PressControl.h", "fs_attr.h" };


std::string
ReadFile(const fs::path& path)
{
	std::ifstream file(path);
	return std::string(std::istreambuf_iterator<char>(file), {});
}


} // namespace


TEST(KitHeaders, EachKitsOneIncludeHasAllPublicHeaders)
{
	int kits = 0;
	for (const char* kit : { "app", "interface", "kernel", "storage", "support", "translation" }) {
		const fs::path folder = fs::path(ARCHWAY_SOURCES) / "kits" / kit;
		std::string umbrella = kit;
		umbrella[0] = static_cast<char>(toupper(umbrella[0]));
		umbrella += "Kit.h";
		const std::string text = ReadFile(folder / umbrella);
		EXPECT_FALSE(text.empty()) << umbrella;
		for (const auto& entry : fs::directory_iterator(folder)) {
			const std::string name = entry.path().filename();
			if (entry.path().extension() != ".h" || name == umbrella || kApart.count(name) > 0)
				continue;
			EXPECT_NE(std::string::npos, text.find("#include <" + name + ">"))
				<< umbrella << " lacks " << name;
		}
		kits++;
	}
	EXPECT_EQ(6, kits);
}
