#include "Program.h"

#include <fcntl.h>
#include <stdlib.h>
#include <sys/wait.h>
#include <unistd.h>

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

} // namespace


ProgramResult
RunArcv(const std::vector<std::string>& arguments, const std::vector<std::string>& environment)
{
	char folder[] = "/tmp/arcv-run-XXXXXX";
	const std::string place = mkdtemp(folder);
	const std::string program = ARCHWAY_BINARIES "/arcv";
	const pid_t child = fork();
	if (child == 0) {
		std::vector<char*> argv = { const_cast<char*>(program.c_str()) };
		for (const std::string& argument : arguments)
			argv.push_back(const_cast<char*>(argument.c_str()));
		argv.push_back(nullptr);
		for (const std::string& variable : environment)
			putenv(const_cast<char*>(variable.c_str()));
		Redirect(place + "/out", STDOUT_FILENO);
		Redirect(place + "/err", STDERR_FILENO);
		execv(program.c_str(), argv.data());
		_exit(127);
	}
	int status = 0;
	waitpid(child, &status, 0);
	const ProgramResult result = { WIFEXITED(status) ? WEXITSTATUS(status) : 128 + WTERMSIG(status),
		ReadAll(place + "/out"), ReadAll(place + "/err") };
	for (const char* name : { "/out", "/err", "" }) {
		const std::string path = place + name;
		name[0] == '\0' ? rmdir(path.c_str()) : unlink(path.c_str());
	}
	return result;
}
