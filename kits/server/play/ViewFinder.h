// ViewFinder: names views as play scripts do, and finds what they name.
#pragma once

#include <optional>
#include <string>
#include <vector>

#include <Point.h>

#include "server/Inspector.h"
#include "server/play/PlayTokens.h"

namespace BPrivate {

class DesktopThread;


struct PathStep {
	enum class Kind { Window, Text, Class, Item };

	Kind kind;
	std::string text;
	bool orDerived = false;
	int32 index = 0;
};


// `window "Title" > Class > "name"[1]`
struct ViewPath {
	std::vector<PathStep> steps;
	std::string source; // as it was written, for messages

	static ViewPath Read(PlayTokenReader& reader);
};


struct FoundView {
	WindowNode window;
	ViewNode node; // with its children; of a window the top view
	const void* owner = nullptr; // of an item: the list's or menu's view
	bool isWindow = false;
};


// The player's thread. Throws PlayError where it says so.
class ViewFinder {
public:
	explicit ViewFinder(DesktopThread& desktop) : fDesktop(desktop) {}

	std::optional<FoundView> Look(const ViewPath& path); // empty when there is none
	FoundView Find(const ViewPath& path); // throws
	// The same, with an item scrolled into view.
	FoundView FindVisible(const ViewPath& path);

	std::vector<WindowNode> Windows();
	WindowNode DefaultWindow(); // the active one, or else the newest that is shown; throws
	WindowNode WindowNamed(const std::string& title); // throws
	ViewNode Describe(uint32 window); // throws
	// The same, with what the window is.
	FoundView DescribeWindow(const WindowNode& window); // throws

	// The item of that label in the menu that was opened last of those that have it.
	std::optional<FoundView> LookMenuItem(const std::string& label);

	static void CollectMatches(const ViewNode& parent, const PathStep& step,
		std::vector<const ViewNode*>& matches, std::vector<const void*>* owners = nullptr);

private:
	DesktopThread& fDesktop;
};


// Without blanks at both ends, and with three dots for an ellipsis.
std::string plain_label(const std::string& text);


} // namespace BPrivate
