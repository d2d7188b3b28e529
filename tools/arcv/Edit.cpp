#include "tools/arcv/Edit.h"

#include <unistd.h>

#include <Entry.h>
#include <File.h>

#include "tools/arcv/Command.h"
#include "tools/arcv/Input.h"
#include "tools/arcv/Output.h"

namespace Arcv {

namespace {

int
Create(const std::string& file, const ResourceChange& change)
{
	BResources resources;
	const int status = change(resources);
	if (status != kFine)
		return status;
	BFile created(file.c_str(), B_READ_WRITE | B_CREATE_FILE | B_FAIL_IF_EXISTS);
	status_t error = created.InitCheck();
	if (error == B_OK)
		error = resources.WriteTo(&created);
	if (error == B_OK)
		return kFine;
	Complain(file, StatusText(error));
	return kUnreadable;
}


int
EditInPlace(const std::string& file, const ResourceChange& change)
{
	Input input; // says what is wrong, and where
	if (!input.Open(file))
		return kUnreadable;
	if (input.IsMessage()) {
		Complain(file, "this is one flattened message, not a resource file");
		return kUnreadable;
	}
	BResources resources;
	BFile opened(file.c_str(), B_READ_WRITE);
	status_t error = opened.InitCheck();
	if (error == B_OK)
		error = resources.SetTo(&opened);
	int status = kFine;
	if (error == B_OK) {
		status = change(resources);
		if (status == kFine)
			error = resources.Sync();
	}
	if (error != B_OK) {
		Complain(file, StatusText(error));
		return kUnreadable;
	}
	return status;
}


// Saves into a file of its own, so that the output is never seen half done.
int
SaveAs(const std::string& file, const std::string& output, const ResourceChange& change)
{
	const std::string temporary = output + "." + std::to_string(getpid()) + ".new";
	if (!CopyFile(file, temporary))
		return kUnreadable;
	int status = EditInPlace(temporary, change);
	if (status == kFine && rename(temporary.c_str(), output.c_str()) < 0) {
		Complain(output, "it cannot be written");
		status = kUnreadable;
	}
	if (status != kFine)
		unlink(temporary.c_str());
	return status;
}

} // namespace


int
EditFile(
	const std::string& file, const std::string& output, bool create, const ResourceChange& change)
{
	if (create && !Exists(file))
		return Create(output.empty() ? file : output, change);
	if (!output.empty() && output != file)
		return SaveAs(file, output, change);
	return EditInPlace(file, change);
}

} // namespace Arcv
