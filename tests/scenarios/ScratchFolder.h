// ScratchFolder: a folder that ends with the test, for copies of files that a test edits.
#pragma once

#include <stdlib.h>

#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>


class ScratchFolder {
public:
	ScratchFolder() :
		fPath((std::filesystem::temp_directory_path() / "archway-scenario-XXXXXX").string())
	{
		if (mkdtemp(fPath.data()) == nullptr)
			abort();
	}

	~ScratchFolder()
	{
		std::error_code error;
		std::filesystem::remove_all(fPath, error);
	}

	ScratchFolder(const ScratchFolder&) = delete;
	ScratchFolder& operator=(const ScratchFolder&) = delete;

	std::string Path(const std::string& name) const { return fPath + '/' + name; }

	// The copy's path.
	std::string Copy(const std::string& file, const std::string& name) const
	{
		std::filesystem::copy_file(file, Path(name));
		return Path(name);
	}

	std::string Write(const std::string& name, const std::string& bytes) const
	{
		std::ofstream(Path(name), std::ios::binary) << bytes;
		return Path(name);
	}

private:
	std::string fPath;
};


inline std::string
BytesOf(const std::string& path)
{
	std::ifstream stream(path, std::ios::binary);
	return std::string(std::istreambuf_iterator<char>(stream), {});
}
