#include "host/application/ReplaceFile.h"

#include <Entry.h>
#include <File.h>


status_t
ReplaceFile(const std::string& path, const void* data, size_t size)
{
	std::string temporary;
	BFile file;
	status_t status = B_FILE_EXISTS;
	for (int i = 0; status == B_FILE_EXISTS; i++) {
		temporary = path + ".new" + std::to_string(i);
		status = file.SetTo(temporary.c_str(), B_READ_WRITE | B_CREATE_FILE | B_FAIL_IF_EXISTS);
	}
	if (status != B_OK)
		return status;

	const ssize_t written = file.Write(data, size);
	if (written != static_cast<ssize_t>(size))
		status = written < 0 ? static_cast<status_t>(written) : B_IO_ERROR;
	if (status == B_OK)
		status = file.Sync();
	BEntry entry(temporary.c_str());
	if (status == B_OK)
		status = entry.Rename(path.c_str(), true);
	if (status != B_OK)
		entry.Remove();
	return status;
}
