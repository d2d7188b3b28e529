// strerror(), which takes status codes beside the host's error numbers.

#include <Errors.h>

#include <algorithm>
#include <cstring>
#include <iterator>

#include <BeBuild.h>
#include <SupportDefs.h>

namespace {

struct ErrorText {
	status_t error;
	const char* text;
};

constexpr ErrorText kTexts[] = {
	{ B_OK, "No error" },
	{ B_ERROR, "General error" },
	{ B_NO_MEMORY, "Out of memory" },
	{ B_IO_ERROR, "Input or output error" },
	{ B_PERMISSION_DENIED, "Permission denied" },
	{ B_BAD_INDEX, "Index out of range" },
	{ B_BAD_TYPE, "Wrong type" },
	{ B_BAD_VALUE, "Invalid argument" },
	{ B_MISMATCHED_VALUES, "Arguments do not fit together" },
	{ B_NAME_NOT_FOUND, "Name not found" },
	{ B_NAME_IN_USE, "Name in use" },
	{ B_TIMED_OUT, "Operation timed out" },
	{ B_INTERRUPTED, "Operation interrupted" },
	{ B_WOULD_BLOCK, "Operation would block" },
	{ B_CANCELED, "Operation canceled" },
	{ B_NO_INIT, "Not initialized" },
	{ B_BUSY, "Resource busy" },
	{ B_NOT_ALLOWED, "Operation not allowed" },
	{ B_BAD_DATA, "Damaged data" },
	{ B_DONT_DO_THAT, "Do not do that" },
	{ B_BAD_SEM_ID, "No such semaphore" },
	{ B_NO_MORE_SEMS, "No more semaphores" },
	{ B_BAD_THREAD_ID, "No such thread" },
	{ B_NO_MORE_THREADS, "No more threads" },
	{ B_BAD_THREAD_STATE, "Thread in a state that does not allow this" },
	{ B_BAD_TEAM_ID, "No such team" },
	{ B_NO_MORE_TEAMS, "No more teams" },
	{ B_BAD_PORT_ID, "No such port" },
	{ B_NO_MORE_PORTS, "No more ports" },
	{ B_BAD_IMAGE_ID, "No such image" },
	{ B_BAD_ADDRESS, "Bad address" },
	{ B_NOT_AN_EXECUTABLE, "Not an executable" },
	{ B_MISSING_LIBRARY, "Missing library" },
	{ B_MISSING_SYMBOL, "Missing symbol" },
	{ B_UNKNOWN_EXECUTABLE, "Executable of an unknown kind" },
	{ B_LEGACY_EXECUTABLE, "Executable of an old kind" },
	{ B_DEBUGGER_ALREADY_INSTALLED, "A debugger is already installed" },
	{ B_BAD_REPLY, "Reply to nobody" },
	{ B_DUPLICATE_REPLY, "Replied already" },
	{ B_MESSAGE_TO_SELF, "Message to oneself" },
	{ B_BAD_HANDLER, "No such handler" },
	{ B_ALREADY_RUNNING, "Already running" },
	{ B_LAUNCH_FAILED, "Program could not be started" },
	{ B_AMBIGUOUS_APP_LAUNCH, "More than one program could be started" },
	{ B_UNKNOWN_MIME_TYPE, "Unknown file type" },
	{ B_BAD_SCRIPT_SYNTAX, "Bad scripting syntax" },
	{ B_LAUNCH_FAILED_NO_RESOLVE_LINK, "Program not started: a link leads nowhere" },
	{ B_LAUNCH_FAILED_EXECUTABLE, "Program not started: the file is a program that cannot be run" },
	{ B_LAUNCH_FAILED_APP_NOT_FOUND, "Program not started: it was not found" },
	{ B_LAUNCH_FAILED_APP_IN_TRASH, "Program not started: it is in the trash" },
	{ B_LAUNCH_FAILED_NO_PREFERRED_APP, "Program not started: none is preferred for this type" },
	{ B_LAUNCH_FAILED_FILES_APP_NOT_FOUND, "Program not started: the file's own was not found" },
	{ B_BAD_MIME_SNIFFER_RULE, "Bad rule for telling file types" },
	{ B_NOT_A_MESSAGE, "Not a message" },
	{ B_SHUTDOWN_CANCELLED, "Shutdown canceled" },
	{ B_SHUTTING_DOWN, "Shutting down" },
	{ B_FILE_ERROR, "No file open" },
	{ B_FILE_EXISTS, "File exists already" },
	{ B_ENTRY_NOT_FOUND, "No such file or directory" },
	{ B_NAME_TOO_LONG, "Name too long" },
	{ B_NOT_A_DIRECTORY, "Not a directory" },
	{ B_DIRECTORY_NOT_EMPTY, "Directory not empty" },
	{ B_DEVICE_FULL, "No space left" },
	{ B_READ_ONLY_DEVICE, "File system is read only" },
	{ B_IS_A_DIRECTORY, "Is a directory" },
	{ B_NO_MORE_FDS, "Too many open files" },
	{ B_CROSS_DEVICE_LINK, "Not on the same file system" },
	{ B_LINK_LIMIT, "Too many links" },
	{ B_BUSTED_PIPE, "Broken pipe" },
	{ B_UNSUPPORTED, "Not supported here" },
	{ B_PARTITION_TOO_SMALL, "Partition too small" },
	{ B_PARTIAL_READ, "Not all could be read" },
	{ B_PARTIAL_WRITE, "Not all could be written" },
	{ B_BUFFER_OVERFLOW, "Buffer too small" },
	{ B_TOO_MANY_ARGS, "Too many arguments" },
	{ B_FILE_TOO_LARGE, "File too large" },
	{ B_RESULT_NOT_REPRESENTABLE, "Result cannot be expressed" },
	{ B_DEVICE_NOT_FOUND, "Device not found" },
	{ B_NOT_SUPPORTED, "Operation not supported" },
	{ B_TRANSLATION_ERROR_BASE, "Nobody can translate this" },
	{ B_TRANSLATION_ERROR_BASE + 1, "Damaged data for a translator" },
};


const char*
FindText(status_t error)
{
	const auto found = std::find_if(std::begin(kTexts), std::end(kTexts),
		[error](const ErrorText& known) { return known.error == error; });
	return found != std::end(kTexts) ? found->text : nullptr;
}

} // namespace


// Takes the place of the host's for the whole program. The text of an unknown number is the
// thread's own until its next call. Only the host's numbers are above zero.
extern "C" _EXPORT char*
strerror(int error) noexcept
{
	if (const char* text = error <= 0 ? FindText(error) : nullptr)
		return const_cast<char*>(text);
	static thread_local char sBuffer[128];
	return strerror_r(error, sBuffer, sizeof(sBuffer));
}
