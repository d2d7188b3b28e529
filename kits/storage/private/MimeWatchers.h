// MimeWatchers: tells those who asked for it what is set about types.
#pragma once

#include <map>
#include <memory>
#include <mutex>
#include <string>
#include <vector>

#include <Messenger.h>

namespace BPrivate {

class FolderEvents;

// Compares a type's settings with those it saw last, so that each change is told once, whoever
// made it: this program says so itself, of other programs the settings folder tells. Any thread.
class MimeWatchers {
public:
	static MimeWatchers& Get();
	~MimeWatchers();

	// Twice is once.
	status_t Start(const BMessenger& target);
	// B_ENTRY_NOT_FOUND for one who does not watch. Nothing is sent to the target afterwards.
	status_t Stop(const BMessenger& target);
	void End(); // for everybody

	// The type's settings may have changed; an empty one stands for any type.
	void Check(const std::string& type);

private:
	using Fields = std::map<std::string, std::string>; // their bytes

	MimeWatchers() = default;
	status_t _Begin();
	void _CheckAll();
	void _CheckOne(const std::string& type);
	void _Compare(const std::string& type, const Fields* before, const Fields* after);
	void _TellField(const std::string& type, const std::string& field);
	void _Send(BMessage* change);

	std::mutex fLock; // of everything below
	std::vector<BMessenger> fTargets;
	std::map<std::string, Fields> fKnown; // of each type that has settings, while somebody watches
	std::unique_ptr<FolderEvents> fEvents; // NULL while nobody watches
};

} // namespace BPrivate
