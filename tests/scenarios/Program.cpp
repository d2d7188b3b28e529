#include "scenarios/Program.h"

#include <fcntl.h>
#include <poll.h>
#include <signal.h>
#include <stdlib.h>
#include <sys/syscall.h>
#include <sys/wait.h>
#include <unistd.h>

#include <filesystem>
#include <fstream>
#include <iterator>

namespace {


std::string
ReadAll(const std::string& path)
{
	std::ifstream stream(path, std::ios::binary);
	return std::string(std::istreambuf_iterator<char>(stream), {});
}


void
Redirect(const std::string& path, int fd)
{
	const int file = open(path.c_str(), O_WRONLY | O_CREAT | O_TRUNC, 0600);
	dup2(file, fd);
	close(file);
}


[[noreturn]] void
Execute(const std::vector<std::string>& command, const std::vector<std::string>& environment)
{
	std::vector<char*> argv;
	for (const std::string& argument : command)
		argv.push_back(const_cast<char*>(argument.c_str()));
	argv.push_back(nullptr);
	for (const std::string& variable : environment)
		putenv(const_cast<char*>(variable.c_str()));
	execvp(argv[0], argv.data());
	_exit(127);
}


} // namespace


RunningProgram::RunningProgram(const std::vector<std::string>& command,
	const std::vector<std::string>& environment, int inheritedPipe)
{
	fFolder = (std::filesystem::temp_directory_path() / "archway-run-XXXXXX").string();
	if (mkdtemp(fFolder.data()) == nullptr)
		abort();
	fProcess = fork();
	if (fProcess == 0) {
		setpgid(0, 0);
		Redirect(fFolder + "/out", STDOUT_FILENO);
		Redirect(fFolder + "/err", STDERR_FILENO);
		if (inheritedPipe >= 0)
			fcntl(inheritedPipe, F_SETFD, 0);
		setenv("XDG_CONFIG_HOME", fFolder.c_str(), 1); // the user's own settings are not ours
		// A bus that libraries start where there is none would outlive the program.
		setenv("DBUS_SESSION_BUS_ADDRESS", "disabled:", 1);
		Execute(command, environment);
	}
	fHandle = static_cast<int>(syscall(SYS_pidfd_open, fProcess, 0));
}


RunningProgram::~RunningProgram()
{
	if (!_Reap(0)) {
		kill(fProcess, SIGKILL);
		_Reap(-1);
	}
	close(fHandle);
	std::error_code error;
	std::filesystem::remove_all(fFolder, error);
}


bool
RunningProgram::IsRunning()
{
	return !_Reap(0);
}


ProgramResult
RunningProgram::Finish(int seconds)
{
	if (!_Reap(seconds * 1000)) {
		kill(fProcess, SIGKILL);
		_Reap(-1);
	}
	return { WIFEXITED(fStatus) ? WEXITSTATUS(fStatus) : 128 + WTERMSIG(fStatus),
		ReadAll(fFolder + "/out"), ReadAll(fFolder + "/err") };
}


// Whether it has ended, at the latest after the given time; without limit if that is negative.
bool
RunningProgram::_Reap(int milliseconds)
{
	if (fProcess < 0)
		return true;
	pollfd ended = { fHandle, POLLIN, 0 };
	if (poll(&ended, 1, milliseconds) != 1)
		return false;
	waitpid(fProcess, &fStatus, 0);
	fProcess = -1;
	return true;
}


ProgramResult
Run(const std::vector<std::string>& command, const std::vector<std::string>& environment)
{
	return RunningProgram(command, environment).Finish();
}
