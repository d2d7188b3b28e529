// A folder of its own for one test, gone afterwards.
#pragma once

#include <stdlib.h>

#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>

#include <gtest/gtest.h>


class TemporaryFolder {
public:
	TemporaryFolder()
	{
		char name[] = "/tmp/archway-test-XXXXXX";
		fPath = mkdtemp(name);
	}

	~TemporaryFolder()
	{
		std::error_code ignored;
		std::filesystem::remove_all(fPath, ignored);
	}

	const std::string& Path() const { return fPath; }
	std::string operator/(const std::string& leaf) const { return fPath + "/" + leaf; }

	// The number of names in the folder, hidden ones too.
	size_t Count() const
	{
		const std::filesystem::directory_iterator names(fPath);
		return std::distance(begin(names), end(names));
	}

private:
	std::string fPath;
};


inline std::string
ReadFile(const std::string& path)
{
	std::ifstream stream(path, std::ios::binary);
	return std::string(std::istreambuf_iterator<char>(stream), {});
}


inline void
WriteFile(const std::string& path, const std::string& bytes)
{
	std::ofstream(path, std::ios::binary | std::ios::trunc) << bytes;
}


// The folder of sample files, or nothing when there is none on this machine.
inline std::string
SamplesFolder()
{
	const char* folder = getenv("ARCHWAY_SAMPLES");
	return folder != NULL ? folder : "";
}
