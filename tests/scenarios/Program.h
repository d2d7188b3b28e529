// Runs programs as a desktop or a shell would, with a time limit.
#pragma once

#include <sys/types.h>

#include <string>
#include <vector>


struct ProgramResult {
	int status; // of the exit; 128 and the signal's number when a signal ended it
	std::string output;
	std::string errors;
};


// One running program. It is killed when it outlives the object, or its time limit.
class RunningProgram {
public:
	// The program is looked for in PATH unless it has a slash. `environment` is added as NAME=VALUE.
	RunningProgram(const std::vector<std::string>& command,
		const std::vector<std::string>& environment = {}, int inheritedPipe = -1);
	~RunningProgram();
	RunningProgram(const RunningProgram&) = delete;
	RunningProgram& operator=(const RunningProgram&) = delete;

	bool IsRunning();
	// Waits for its end; a program that takes longer is killed (status 128 + SIGKILL).
	ProgramResult Finish(int seconds = 60);

private:
	bool _Reap(int milliseconds);

	std::string fFolder; // of its output files
	pid_t fProcess;
	int fHandle; // of the process, readable when it has ended
	int fStatus = -1;
};


ProgramResult Run(
	const std::vector<std::string>& command, const std::vector<std::string>& environment = {});
