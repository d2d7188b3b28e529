#include <gtest/gtest.h>

#include "backend/FolderDrop.h"

namespace BPrivate {


TEST(FolderDrop, PathSurvivesItsAddress)
{
	const std::string path = "/tmp/a b%c#\xc3\xa9";
	const std::string uri = uri_of_path(path);
	EXPECT_EQ("file:///tmp/a%20b%25c%23%C3%A9", uri);
	EXPECT_EQ(std::vector<std::string> { path }, paths_of_uri_list(uri + "\r\n"));
}


TEST(FolderDrop, OnlyFilesAreTaken)
{
	const std::vector<std::string> expected { "/one", "/two", "/th%zree" };
	EXPECT_EQ(expected,
		paths_of_uri_list("# a list\r\nfile:///one\r\nhttp://host/page\nfile://host/two\r\n"
						  "file:///th%zree\r\nfile:nothing\r\n"));
	EXPECT_TRUE(paths_of_uri_list("").empty());
	EXPECT_TRUE(paths_of_uri_list("file://").empty());
}


} // namespace BPrivate
