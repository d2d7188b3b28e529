// Runs a fuzzer's function over files: those given, and those in the folders given.

#include <stddef.h>
#include <stdint.h>
#include <stdio.h>

#include <filesystem>
#include <fstream>
#include <iterator>
#include <vector>

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size);

namespace {

void
Replay(const std::filesystem::path& path)
{
	std::ifstream stream(path, std::ios::binary);
	const std::vector<char> bytes(std::istreambuf_iterator<char>(stream), {});
	// A buffer of exactly that size, so that a sanitizer sees every step beyond it.
	const std::vector<uint8_t> data(bytes.begin(), bytes.end());
	LLVMFuzzerTestOneInput(data.data(), data.size());
}

} // namespace


int
main(int argc, char** argv)
{
	int count = 0;
	for (int i = 1; i < argc; i++) {
		if (!std::filesystem::is_directory(argv[i])) {
			Replay(argv[i]);
			count++;
			continue;
		}
		for (const auto& entry : std::filesystem::recursive_directory_iterator(argv[i])) {
			if (entry.is_regular_file()) {
				Replay(entry.path());
				count++;
			}
		}
	}
	printf("%d inputs\n", count);
	return count > 0 ? 0 : 1;
}
