// A user and a shared database for tests of what is known about types.
#pragma once

#include <stdlib.h>

#include <filesystem>
#include <string>

#include <Mime.h>

#include "TemporaryFolder.h"


// A user of their own, whose shared database knows a few types.
class MimeDatabaseTest : public testing::Test {
public:
	void SetUp() override
	{
		// A program that a test started is the same user's.
		if (getenv("ARCHWAY_TEST_USER") != NULL)
			return;
		setenv("XDG_CONFIG_HOME", (fFolder / "config").c_str(), 1);
		setenv("XDG_DATA_HOME", (fFolder / "data").c_str(), 1);
		setenv("XDG_DATA_DIRS", sShared.Path().c_str(), 1);
		setenv("LANG", "de_DE.UTF-8", 1);
		unsetenv("LC_ALL");
		unsetenv("LC_MESSAGES");
		std::filesystem::create_directories(sShared / "mime/image");
		WriteFile(sShared / "mime/types", "image/png\ntext/plain\ntext/x-c\nimage/x-bad\n");
		WriteFile(sShared / "mime/globs2",
			"# a comment\n50:text/plain:*.txt\n60:text/x-c:*.C:cs\n50:text/x-c++:*.c\n"
			"50:image/png:*.png\n50:image/png:*.apng\n50:application/x-tar-gz:*.tar.gz\n"
			"50:application/gzip:*.gz\n50:text/x-make:makefile\n");
		WriteFile(sShared / "mime/image/png.xml",
			"<mime-type><comment>PNG image</comment>"
			"<comment xml:lang=\"de\">PNG-Bild &amp; mehr</comment></mime-type>");
		const std::string magic = std::string("MIME-Magic\0\n", 12) + "[50:image/png]\n>0="
			+ std::string("\0\4", 2) + "\x89PNG\n[40:image/x-nested]\n>0=" + std::string("\0\1", 2)
			+ "N\n1>4=" + std::string("\0\2", 2)
			+ "ok+10\n[30:image/x-masked]\n>0=" + std::string("\0\1", 2) + "\xf0&\xf0\n";
		WriteFile(sShared / "mime/magic", magic);
	}

	static std::string Guess(const std::string& bytes)
	{
		BMimeType type;
		EXPECT_EQ(B_OK, BMimeType::GuessMimeType(bytes.data(), bytes.size(), &type));
		return type.Type();
	}

	TemporaryFolder fFolder;
	// The database is read once in a program.
	static inline TemporaryFolder sShared;
};


using BMimeTypeTest = MimeDatabaseTest;
