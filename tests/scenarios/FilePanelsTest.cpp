// The resource editor's file panels, as a person uses them.

#include <fstream>

#include <gtest/gtest.h>

#include "scenarios/Archway.h"
#include "scenarios/Differences.h"
#include "scenarios/ScratchFolder.h"

namespace {


constexpr const char* kDesign = ARCHWAY_TEST_DATA "/resources/22-nestedboxes.rsrc";
constexpr const char* kOther = ARCHWAY_TEST_DATA "/resources/23-dialog.rsrc";


struct Scene {
	void Play(const std::string& script)
	{
		const ProgramResult result = PlayText(script, file);
		EXPECT_EQ(0, result.status) << result.errors << result.output;
	}

	ScratchFolder folder;
	std::string file = folder.Copy(kDesign, "design.rsrc");
};


} // namespace


TEST(FilePanels, OpenAnotherFileFromTheSameFolder)
{
	Scene scene;
	scene.folder.Copy(kOther, "other.rsrc");
	scene.Play("key o with Command\n"
			   "wait window \"Open\"\n"
			   "click window \"Open\" > item \"other.rsrc\" times 2\n"
			   "wait window \"other.rsrc\"\n"
			   "windows 2\n");
}


TEST(FilePanels, OpenAFileByItsPath)
{
	Scene scene;
	const std::string other = scene.folder.Copy(kOther, "other.rsrc");
	scene.Play("menu \"File\" \"Open...\"\n"
			   "key Tab\n"
			   "type \""
		+ other
		+ "\\n\"\n"
		  "wait window \"other.rsrc\"\n");
}


TEST(FilePanels, SaveUnderAnotherName)
{
	Scene scene;
	scene.Play("key s with Command Shift\n"
			   "wait window \"Save\"\n"
			   "expect window \"Save\" > \"text view\" text design.rsrc\n"
			   "type \"copy\\n\"\n"
			   "wait window \"copy.rsrc\"\n"
			   "windows 1\n");
	EXPECT_TRUE(BytesOf(kDesign) == BytesOf(scene.folder.Path("copy.rsrc")));
}


TEST(FilePanels, AskBeforeAnotherFileIsReplaced)
{
	Scene scene;
	const std::string other = scene.folder.Copy(kOther, "other.rsrc");
	const std::string ask =
		"key s with Command Shift\nkey a with Command\ntype \"other.rsrc\\n\"\n";
	scene.Play(ask + "answer \"Cancel\"\nkey Escape\nwindows 1\n");
	EXPECT_TRUE(BytesOf(kOther) == BytesOf(other));
	scene.Play(ask + "answer \"Replace\"\nwait window \"other.rsrc\"\n");
	EXPECT_TRUE(BytesOf(kDesign) == BytesOf(other));
}


TEST(FilePanels, AnyFileIsReplacedWhenThePersonAgrees)
{
	Scene scene;
	const std::string notes = scene.folder.Path("notes.txt");
	std::ofstream(notes) << "no resources, but somebody's notes";
	scene.Play("key s with Command Shift\nkey a with Command\ntype \"notes.txt\\n\"\n"
			   "answer \"Replace\"\nwait window \"notes.txt\"\n");
	EXPECT_TRUE(BytesOf(kDesign) == BytesOf(notes));
}


TEST(FilePanels, ACancelledPanelKeepsTheUnsavedWindowOpen)
{
	Scene scene;
	scene.Play("click item \"ARCV:1\"\n"
			   "menu \"Resource\" \"Delete\"\n"
			   "key s with Command Shift\n"
			   "key Escape\n"
			   "wait window \"design.rsrc *\"\n"
			   "key z with Command\n");
	EXPECT_TRUE(BytesOf(kDesign) == BytesOf(scene.file));
}


TEST(FilePanels, AnExportedItemComesBackByImport)
{
	Scene scene;
	scene.Play("click item \"ARCV:1\"\n"
			   "key e with Command\n"
			   "wait window \"Export\"\n"
			   "key a with Command\n"
			   "type \"item.msg\\n\"\n"
			   "key i with Command\n"
			   "wait window \"Import\"\n"
			   "click window \"Import\" > item \"item.msg\" times 2\n"
			   "wait window \"design.rsrc *\"\n"
			   "key s with Command\n");
	const std::string bytes = BytesOf(scene.folder.Path("item.msg"));
	EXPECT_LT(100u, bytes.size());
	const std::string saved = BytesOf(scene.file);
	const size_t first = saved.find(bytes);
	ASSERT_NE(std::string::npos, first);
	EXPECT_NE(std::string::npos, saved.find(bytes, first + 1));
}
