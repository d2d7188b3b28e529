// Runs the editor with a play script.
#pragma once

#include <string>
#include <vector>

#include "scenarios/Program.h"


inline const std::vector<std::string> kHeadless = { "ARCHWAY_BACKEND=headless" };


// The script of that name in plays/. Its commands for the shell find `file` as $FILE.
ProgramResult PlayScript(const std::string& name, const std::string& file,
	std::vector<std::string> environment = kHeadless);

// A script given as text.
ProgramResult PlayText(const std::string& text, const std::string& file,
	const std::vector<std::string>& environment = kHeadless);
