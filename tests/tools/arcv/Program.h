// Runs arcv as a person would.
#pragma once

#include <string>
#include <vector>

struct ProgramResult {
	int status; // of the exit; 128 and the signal's number when a signal ended it
	std::string output;
	std::string errors;
};

// `environment` is added as NAME=VALUE.
ProgramResult RunArcv(
	const std::vector<std::string>& arguments, const std::vector<std::string>& environment = {});
