// DragFile: a file that the source of a drag writes when another program asks for it.
#pragma once

#include <string>

#include <Message.h>

namespace BPrivate {

class DesktopThread;


// Plays the file manager's part of the negotiation: makes an empty file in a private folder, asks
// the source to fill it, and knows that it did when the source's looper answers a ping that was
// sent behind. Display thread.
class DragFile {
public:
	DragFile(DesktopThread& desktop, const BMessage& dragMessage);
	~DragFile();

	// True when the file is there; runs the display thread's loop meanwhile, ten seconds at most.
	// The file is made once, further calls give the first one's result.
	bool Write();
	const std::string& Path() const { return fPath; }

private:
	enum class State { Untouched, Asked, Written, Failed };

	bool _MakeFile();
	bool _Ask();

	DesktopThread& fDesktop;
	BMessage fMessage;
	State fState = State::Untouched;
	std::string fFolder;
	std::string fPath;
};


} // namespace BPrivate
