// Files that were cut short or changed by accident: nothing crashes, hangs or grows without limit.

#include <algorithm>
#include <memory>
#include <vector>

#include <gtest/gtest.h>

#include <Application.h>
#include <Archivable.h>
#include <Message.h>
#include <View.h>
#include <Window.h>

#include "host/application/ItemCheck.h"
#include "host/application/ResourceDocument.h"
#include "host/library/ResourceAddonBase.h"
#include "host/library/ResourceItem.h"
#include "scenarios/Archway.h"
#include "scenarios/ScratchFolder.h"

using namespace BResEditor;

namespace {


constexpr const char* kSmallFile = ARCHWAY_TEST_DATA "/resources/01-view.rsrc";
constexpr const char* kLargerFile = ARCHWAY_TEST_DATA "/resources/23-dialog.rsrc";


// The host's way from a file to a view in a window and back to an archive.
class OpenPath {
public:
	OpenPath() : fApplication("application/x-vnd.Archway-test")
	{
		fWindow = new BWindow(
			BRect(50, 50, 449, 349), "damaged", B_TITLED_WINDOW, B_ASYNCHRONOUS_CONTROLS);
	}

	~OpenPath()
	{
		fWindow->Lock();
		fWindow->Quit();
	}

	// How many items could be shown.
	int32 Open(const std::string& bytes)
	{
		ResourceDocument document;
		document.Load(fFolder.Write("damaged.rsrc", bytes).c_str());
		BResourceAddonBase reader(BResourceAddonArgs { &document });
		const BResourceCollection* collection = reader.ReadLock();
		int32 shown = 0;
		for (int32 i = 0; i < collection->CountItems(); i++)
			shown += _Show(collection->Item(collection->HandleAt(i))) ? 1 : 0;
		reader.ReadUnlock(collection);
		return shown;
	}

private:
	bool _Show(const BResourceItem* item)
	{
		if (!WhyNoArchivedObject(item).empty())
			return false;
		BMessage archive;
		archive.Unflatten(static_cast<const char*>(item->Data()));
		const std::unique_ptr<BArchivable> object(instantiate_object(&archive));
		BView* view = dynamic_cast<BView*>(object.get());
		if (view == nullptr)
			return false;
		fWindow->Lock();
		fWindow->AddChild(view);
		BMessage again;
		view->Archive(&again, true);
		view->RemoveSelf();
		fWindow->Unlock();
		return true;
	}

	const ScratchFolder fFolder;
	BApplication fApplication;
	BWindow* fWindow; // ends with Quit()
};


// Every 1/100 of the file in turn is cut away, or one byte of it is inverted.
std::vector<std::string>
ChosenCases()
{
	const std::string bytes = BytesOf(kLargerFile);
	std::vector<std::string> cases;
	for (size_t i = 0; i < 100; i++) {
		const size_t place = bytes.size() * i / 100;
		cases.push_back(bytes.substr(0, place));
		cases.push_back(bytes);
		cases.back()[place] = static_cast<char>(~cases.back()[place]);
	}
	return cases;
}


class DamagedFile : public testing::TestWithParam<size_t> {};


} // namespace


TEST(DamagedFiles, OpenPathTakesEveryTruncation)
{
	OpenPath path;
	const std::string bytes = BytesOf(kSmallFile);
	EXPECT_GT(path.Open(bytes), 0);
	int32 shown = 0;
	for (size_t length = 0; length < bytes.size(); length++)
		shown = std::max(shown, path.Open(bytes.substr(0, length)));
	EXPECT_LE(shown, path.Open(bytes));
}


TEST(DamagedFiles, OpenPathTakesEveryChangedByte)
{
	OpenPath path;
	std::string bytes = BytesOf(kSmallFile);
	const int32 whole = path.Open(bytes);
	int32 most = 0;
	for (char& byte : bytes) {
		const char kept = byte;
		byte = static_cast<char>(~byte);
		most = std::max(most, path.Open(bytes));
		byte = kept;
	}
	EXPECT_EQ(whole, most);
}


// The programs end by themselves and say what is wrong; none is ended by a signal.
TEST_P(DamagedFile, EndsNoProgram)
{
	const std::vector<std::string> cases = ChosenCases();
	const ScratchFolder folder;
	for (size_t i = GetParam(); i < cases.size(); i += 4) {
		const std::string file = folder.Write("damaged.rsrc", cases[i]);
		const ProgramResult dump = ::Run({ ARCHWAY_BINARIES "/arcv", "dump", "--json", file });
		EXPECT_TRUE(dump.status == 0 || dump.status == 3) << "case " << i << dump.errors;
		EXPECT_EQ(dump.status == 0, dump.errors.empty()) << "case " << i << dump.errors;

		const ProgramResult shown = PlayText("key Return\nquit!\n", file);
		EXPECT_EQ(0, shown.status) << "case " << i << shown.errors;
	}
}


INSTANTIATE_TEST_SUITE_P(Cases, DamagedFile, testing::Range<size_t>(0, 4));
