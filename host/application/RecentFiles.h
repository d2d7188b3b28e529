// RecentFiles: the files that were opened or saved last.
#pragma once

#include <string>
#include <vector>


// Kept in the user's settings, shared by all running editors. Any thread.
class RecentFiles {
public:
	// Puts that absolute path first. Settings that cannot be written are not worth a message.
	static void Add(const std::string& path);

	// Those that still exist, the newest first, at most ten.
	static std::vector<std::string> Paths();
};
