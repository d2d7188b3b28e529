#include <gtest/gtest.h>

#include "server/play/PlayTokens.h"
#include "server/play/ViewFinder.h"
#include "server/play/ViewText.h"

namespace BPrivate {

namespace {

ViewPath
PathOf(const char* line)
{
	PlayTokenReader reader(play_tokens(line));
	ViewPath path = ViewPath::Read(reader);
	return path;
}

} // namespace


TEST(PlayTokens, StringsHaveEscapesAndCommentsEndTheLine)
{
	const std::vector<PlayToken> tokens = play_tokens("type \"a\\n\\\"b\\\\\" # comment \"x");
	ASSERT_EQ(2u, tokens.size());
	EXPECT_EQ("type", tokens[0].text);
	EXPECT_EQ("a\n\"b\\", tokens[1].text);
	EXPECT_EQ(PlayToken::Kind::String, tokens[1].kind);
	EXPECT_EQ(1u, play_tokens("\"#\"").size());
	EXPECT_THROW(play_tokens("echo \"open"), PlayError);
}


TEST(PlayTokens, PathOfStepsIsRead)
{
	const ViewPath path = PathOf("window \"panel.rsrc\" > BView+ > \"Name: \"[2] at 3,4");
	ASSERT_EQ(3u, path.steps.size());
	EXPECT_EQ(PathStep::Kind::Window, path.steps[0].kind);
	EXPECT_EQ("panel.rsrc", path.steps[0].text);
	EXPECT_EQ(PathStep::Kind::Class, path.steps[1].kind);
	EXPECT_TRUE(path.steps[1].orDerived);
	EXPECT_EQ("BView", path.steps[1].text);
	EXPECT_EQ("Name:", path.steps[2].text);
	EXPECT_EQ(2, path.steps[2].index);
	EXPECT_EQ("window \"panel.rsrc\" > BView+ > \"Name: \"[2]", path.source);
}


TEST(PlayTokens, ArrowsNeedNoBlanks)
{
	EXPECT_EQ(3u, PathOf("BBox>BCheckBox[1]>item \"x\"").steps.size());
}


TEST(ViewFinder, NamesComeBeforeLabels)
{
	ViewNode root, labelled, named;
	labelled.className = named.className = "BButton";
	labelled.label = " OK ";
	labelled.name = "first";
	named.name = "OK";
	root.children = { labelled, named };
	std::vector<const ViewNode*> matches;
	ViewFinder::CollectMatches(root, { PathStep::Kind::Text, "OK" }, matches);
	ASSERT_EQ(1u, matches.size());
	EXPECT_EQ("OK", matches[0]->name);

	root.children.pop_back();
	matches.clear();
	ViewFinder::CollectMatches(root, { PathStep::Kind::Text, "OK" }, matches);
	ASSERT_EQ(1u, matches.size());
	EXPECT_EQ("first", matches[0]->name);
}


TEST(ViewFinder, ClassIsExactUnlessMarked)
{
	ViewNode root, button;
	button.className = "RoundButton";
	button.baseClasses = { "BButton", "BControl", "BView" };
	root.children = { button };
	std::vector<const ViewNode*> matches;
	ViewFinder::CollectMatches(root, { PathStep::Kind::Class, "BButton" }, matches);
	EXPECT_TRUE(matches.empty());
	ViewFinder::CollectMatches(root, { PathStep::Kind::Class, "BButton", true }, matches);
	EXPECT_EQ(1u, matches.size());
}


TEST(ViewText, TreeHasALineForEachView)
{
	ViewNode root, child;
	root.className = "BView";
	root.name = "top";
	child.className = "BButton";
	child.name = "ok";
	child.label = "OK";
	child.frame = BRect(1, 2, 30, 40);
	child.screen = BRect(11, 12, 40, 50);
	child.enabled = false;
	child.focus = true;
	root.children = { child };
	const std::string tree = tree_of(root);
	const size_t line = tree.find('\n') + 1;
	EXPECT_EQ("  BButton \"ok\" frame 1,2,30,40 screen 11,12,40,50 \"OK\" focus disabled\n",
		tree.substr(line));
}


} // namespace BPrivate
