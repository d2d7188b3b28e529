#include "server/DragFile.h"

#include <atomic>
#include <cstdlib>
#include <cstring>
#include <fcntl.h>
#include <memory>
#include <thread>
#include <unistd.h>

#include <AppDefs.h>
#include <Entry.h>

#include "app/private/Delivery.h"
#include "server/DesktopThread.h"

namespace BPrivate {

namespace {

constexpr bigtime_t kPatience = 10000000;
constexpr bigtime_t kStep = 10000; // between two looks at the answer
constexpr size_t kLongestName = 200;


// A suggestion of the source, fit to be the name of a file.
std::string
FileName(const BMessage& message)
{
	const char* suggested = nullptr;
	if (message.FindString("be:clip_name", &suggested) != B_OK)
		return "Untitled clipping";

	std::string name(suggested);
	for (char& character : name) {
		if (character == '/' || static_cast<unsigned char>(character) < ' ')
			character = '-';
	}
	if (name.size() > kLongestName)
		name.resize(kLongestName);
	return name.empty() || name == "." || name == ".." ? "Untitled clipping" : name;
}


void
CopyStrings(const BMessage& from, const char* field, BMessage& to)
{
	const char* text;
	for (int32 i = 0; from.FindString(field, i, &text) == B_OK; i++)
		to.AddString(field, text);
}

} // namespace


DragFile::DragFile(DesktopThread& desktop, const BMessage& dragMessage) :
	fDesktop(desktop), fMessage(dragMessage)
{
	// Only what was delivered can be answered: here the desktop itself is where it was dropped.
	mark_as_dropped(&fMessage, dragMessage.ReturnAddress());
}


// The program that took the file may still be copying it: the desktop removes it at the end.
DragFile::~DragFile()
{
	if (!fFolder.empty())
		fDesktop.RemoveLater(fFolder);
}


bool
DragFile::Write()
{
	if (fState == State::Untouched) {
		fState = State::Asked;
		const bool written = _MakeFile() && _Ask();
		fState = written ? State::Written : State::Failed;
	}
	return fState == State::Written;
}


bool
DragFile::_MakeFile()
{
	const char* base = std::getenv("XDG_RUNTIME_DIR");
	if (base == nullptr || access(base, W_OK) != 0)
		base = "/tmp";
	std::string folder = std::string(base) + "/drag-XXXXXX";
	if (mkdtemp(folder.data()) == nullptr)
		return false;
	fFolder = folder;

	fPath = fFolder + "/" + FileName(fMessage);
	const int file = open(fPath.c_str(), O_CREAT | O_EXCL | O_WRONLY | O_CLOEXEC, 0666);
	if (file < 0)
		return false;
	close(file);
	return true;
}


bool
DragFile::_Ask()
{
	entry_ref directory;
	if (get_ref_for_path(fFolder.c_str(), &directory) != B_OK)
		return false;

	BMessage reply(B_COPY_TARGET);
	reply.AddString("be:types", "application/octet-stream");
	CopyStrings(fMessage, "be:filetypes", reply);
	reply.AddRef("directory", &directory);
	reply.AddString("name", fPath.c_str() + fFolder.size() + 1);
	const BMessenger source = fMessage.ReturnAddress();
	if (!source.IsValid() || fMessage.SendReply(&reply, (BHandler*)nullptr, 0) != B_OK)
		return false;

	// The waiting is done elsewhere, because this thread must go on with its loop.
	auto answered = std::make_shared<std::atomic<bool>>(false);
	auto finished = std::make_shared<std::atomic<bool>>(false);
	std::thread([source, answered, finished] {
		BMessage ping(_PING_), pong;
		*answered = source.SendMessage(&ping, &pong, kPatience, kPatience) == B_OK;
		*finished = true;
	}).detach();
	const bigtime_t end = system_time() + kPatience;
	while (!*finished && system_time() < end)
		fDesktop.GetBackend().RunNested(kStep);
	return *answered;
}


} // namespace BPrivate
