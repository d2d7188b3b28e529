#include "server/play/ViewFinder.h"

#include <algorithm>

#include "server/DesktopThread.h"

namespace BPrivate {

namespace {

constexpr bigtime_t kLockPatience = 5000000;


bool
IsNamed(const ViewNode& node, const std::string& text)
{
	return !node.isItem && plain_label(node.name) == text;
}


bool
IsLabelled(const ViewNode& node, const std::string& text)
{
	return !node.isItem && (plain_label(node.label) == text || plain_label(node.text) == text);
}


bool
IsItem(const ViewNode& node, const std::string& text)
{
	return node.isItem && (plain_label(node.label) == text || plain_label(node.text) == text);
}


// Name spaces may be left out.
bool
IsClassName(const std::string& name, const std::string& wanted)
{
	if (name == wanted)
		return true;
	const size_t length = wanted.size() + 2;
	return name.size() > length && name.compare(name.size() - length, 2, "::") == 0
		&& name.compare(name.size() - wanted.size(), wanted.size(), wanted) == 0;
}


bool
IsOfClass(const ViewNode& node, const PathStep& step)
{
	if (node.isItem)
		return false;
	if (IsClassName(node.className, step.text))
		return true;
	const auto isWanted = [&](const std::string& base) { return IsClassName(base, step.text); };
	const std::vector<std::string>& bases = node.baseClasses;
	return step.orDerived && std::any_of(bases.begin(), bases.end(), isWanted);
}


template<typename Predicate>
void
Collect(const ViewNode& parent, const Predicate& wanted, std::vector<const ViewNode*>& matches,
	std::vector<const void*>* owners)
{
	for (const ViewNode& child : parent.children) {
		if (wanted(child)) {
			matches.push_back(&child);
			if (owners != nullptr)
				owners->push_back(parent.address);
		}
		Collect(child, wanted, matches, owners);
	}
}

} // namespace


std::string
plain_label(const std::string& text)
{
	const size_t first = text.find_first_not_of(" \t\n");
	if (first == std::string::npos)
		return "";
	std::string plain = text.substr(first, text.find_last_not_of(" \t\n") - first + 1);
	static const std::string kEllipsis = "\xe2\x80\xa6";
	for (size_t at = plain.find(kEllipsis); at != std::string::npos; at = plain.find(kEllipsis))
		plain.replace(at, kEllipsis.size(), "...");
	return plain;
}


// #pragma mark - paths


ViewPath
ViewPath::Read(PlayTokenReader& reader)
{
	ViewPath path;
	PlayToken token;
	do {
		token = reader.Take("a view");
		PathStep step { PathStep::Kind::Text, token.text };
		std::string shown = '"' + token.text + '"';
		if (token.kind == PlayToken::Kind::Word) {
			const bool isWindow = token.text == "window" && path.steps.empty();
			const bool isItem = token.text == "item";
			if (isWindow || isItem) {
				step.kind = isWindow ? PathStep::Kind::Window : PathStep::Kind::Item;
				step.text = reader.TakeText(isWindow ? "a window's title" : "an item's text");
				shown = token.text + " \"" + step.text + '"';
			} else {
				step.kind = PathStep::Kind::Class;
				shown = token.text;
				step.orDerived = step.text.size() > 1 && step.text.back() == '+';
				if (step.orDerived)
					step.text.pop_back();
			}
		} else if (token.kind != PlayToken::Kind::String) {
			throw PlayError { "a view", token.kind == PlayToken::Kind::Arrow ? ">" : "[n]" };
		}
		if (step.kind != PathStep::Kind::Window && step.kind != PathStep::Kind::Class)
			step.text = plain_label(step.text);
		if (reader.TakeKind(PlayToken::Kind::Index, &token)) {
			step.index = token.index;
			shown += '[' + std::to_string(token.index) + ']';
		}
		path.source += (path.steps.empty() ? "" : " > ") + shown;
		path.steps.push_back(std::move(step));
	} while (reader.TakeKind(PlayToken::Kind::Arrow, &token));
	return path;
}


void
ViewFinder::CollectMatches(const ViewNode& parent, const PathStep& step,
	std::vector<const ViewNode*>& matches, std::vector<const void*>* owners)
{
	switch (step.kind) {
		case PathStep::Kind::Class:
			Collect(
				parent, [&](const ViewNode& node) { return IsOfClass(node, step); }, matches,
				owners);
			break;

		case PathStep::Kind::Item:
			Collect(
				parent, [&](const ViewNode& node) { return IsItem(node, step.text); }, matches,
				owners);
			break;

		default:
			// Names come first, whatever the labels of other views say.
			Collect(
				parent, [&](const ViewNode& node) { return IsNamed(node, step.text); }, matches,
				owners);
			if (matches.empty()) {
				Collect(
					parent, [&](const ViewNode& node) { return IsLabelled(node, step.text); },
					matches, owners);
			}
			break;
	}
}


// #pragma mark - finding


std::vector<WindowNode>
ViewFinder::Windows()
{
	std::vector<WindowNode> windows;
	if (!fDesktop.Inspect([&](Inspector& inspector) { windows = inspector.Windows(); }))
		throw PlayError { "a program with windows", "none" };
	return windows;
}


WindowNode
ViewFinder::DefaultWindow()
{
	const std::vector<WindowNode> windows = Windows();
	for (const WindowNode& window : windows) {
		if (window.active && window.shown && !window.isMenu)
			return window;
	}
	for (auto it = windows.rbegin(); it != windows.rend(); ++it) {
		if (it->shown && !it->isMenu)
			return *it;
	}
	throw PlayError { "a window", "none" };
}


// Of several windows whose title contains the text one that is shown is meant.
WindowNode
ViewFinder::WindowNamed(const std::string& title)
{
	const std::vector<WindowNode> windows = Windows();
	const WindowNode* hidden = nullptr;
	for (const WindowNode& window : windows) {
		if (window.isMenu || window.title.find(title) == std::string::npos)
			continue;
		if (window.shown)
			return window;
		hidden = &window;
	}
	if (hidden != nullptr)
		return *hidden;

	std::string titles;
	for (const WindowNode& window : windows) {
		if (!window.isMenu)
			titles += (titles.empty() ? "\"" : ", \"") + window.title + '"';
	}
	throw PlayError { "window \"" + title + '"', titles.empty() ? "no window" : titles };
}


ViewNode
ViewFinder::Describe(uint32 window)
{
	ViewNode root;
	status_t status = B_ERROR;
	fDesktop.Inspect(
		[&](Inspector& inspector) { status = inspector.Describe(window, kLockPatience, &root); });
	if (status == B_TIMED_OUT)
		throw PlayError { "a window that answers", "a busy one" };
	if (status != B_OK)
		throw PlayError { "a window", "it has just gone" };
	return root;
}


FoundView
ViewFinder::DescribeWindow(const WindowNode& window)
{
	FoundView found { window, Describe(window.id), nullptr, true };
	found.node.className = window.className;
	found.node.label = window.title;
	found.node.frame = window.frame;
	found.node.focus = window.active;
	found.node.hidden = !window.shown;
	return found;
}


std::optional<FoundView>
ViewFinder::Look(const ViewPath& path)
{
	FoundView found;
	size_t next = 0;
	if (path.steps.front().kind == PathStep::Kind::Window) {
		try {
			found.window = WindowNamed(path.steps.front().text);
		} catch (const PlayError&) {
			return std::nullopt;
		}
		next = 1;
	} else {
		found.window = DefaultWindow();
	}

	found = DescribeWindow(found.window);
	found.isWindow = next == path.steps.size();
	for (; next < path.steps.size(); next++) {
		std::vector<const ViewNode*> matches;
		std::vector<const void*> owners;
		CollectMatches(found.node, path.steps[next], matches, &owners);
		const auto index = static_cast<size_t>(path.steps[next].index);
		if (index >= matches.size())
			return std::nullopt;
		found.owner = owners[index];
		ViewNode node = *matches[index];
		found.node = std::move(node);
	}
	return found;
}


FoundView
ViewFinder::Find(const ViewPath& path)
{
	if (path.steps.front().kind == PathStep::Kind::Window)
		WindowNamed(path.steps.front().text);
	std::optional<FoundView> found = Look(path);
	if (!found)
		throw PlayError { path.source, "no such view" };
	return *found;
}


FoundView
ViewFinder::FindVisible(const ViewPath& path)
{
	FoundView found = Find(path);
	if (found.node.isItem && !found.node.visible.IsValid()) {
		fDesktop.Inspect([&](Inspector& inspector) {
			inspector.RevealItem(found.window.id, found.owner, found.node.address);
		});
		wait_until_idle(kLockPatience);
		found = Find(path);
	}
	if (!found.window.shown || found.node.hidden)
		throw PlayError { path.source, "it is hidden" };
	if (!found.node.visible.IsValid())
		throw PlayError { path.source, "it is scrolled away or covered by its parents' edges" };
	return found;
}


std::optional<FoundView>
ViewFinder::LookMenuItem(const std::string& label)
{
	std::vector<WindowNode> windows = Windows();
	const PathStep step { PathStep::Kind::Item, plain_label(label) };
	for (auto it = windows.rbegin(); it != windows.rend(); ++it) {
		if (!it->isMenu || !it->shown)
			continue;
		const ViewNode root = Describe(it->id);
		std::vector<const ViewNode*> matches;
		CollectMatches(root, step, matches);
		if (!matches.empty())
			return FoundView { *it, *matches.front(), nullptr, false };
	}
	return std::nullopt;
}


} // namespace BPrivate
