#include "server/play/ViewText.h"

#include <cstdio>

namespace BPrivate {

namespace {

struct Property {
	const char* name;
	std::string (*get)(const ViewNode&);
};


std::string
TextOfBool(bool value)
{
	return value ? "true" : "false";
}


std::string
TextOfSelection(const ViewNode& node)
{
	std::string text;
	for (const int32 index : node.selection)
		text += (text.empty() ? "" : ",") + std::to_string(index);
	return text;
}


const Property kProperties[] = {
	{ "class", [](const ViewNode& node) { return node.className; } },
	{ "name", [](const ViewNode& node) { return node.name; } },
	{ "frame", [](const ViewNode& node) { return text_of_rect(node.frame); } },
	{ "bounds", [](const ViewNode& node) { return text_of_rect(node.bounds); } },
	{ "screen", [](const ViewNode& node) { return text_of_rect(node.screen); } },
	{ "label", [](const ViewNode& node) { return node.label; } },
	{ "text", [](const ViewNode& node) { return node.text; } },
	{ "value", [](const ViewNode& node) { return node.value; } },
	{ "enabled", [](const ViewNode& node) { return TextOfBool(node.enabled); } },
	{ "focus", [](const ViewNode& node) { return TextOfBool(node.focus); } },
	{ "hidden", [](const ViewNode& node) { return TextOfBool(node.hidden); } },
	{ "font", [](const ViewNode& node) { return node.font; } },
	{ "view-color", [](const ViewNode& node) { return text_of_color(node.viewColor); } },
	{ "low-color", [](const ViewNode& node) { return text_of_color(node.lowColor); } },
	{ "high-color", [](const ViewNode& node) { return text_of_color(node.highColor); } },
	{ "count", [](const ViewNode& node) { return std::to_string(node.count); } },
	{ "selection", TextOfSelection },
	{ "marked",
		[](const ViewNode& node) {
			return node.isItem ? TextOfBool(node.isMarked) : node.marked;
		} },
};


std::string
Quoted(const std::string& text)
{
	std::string quoted = "\"";
	for (const char character : text) {
		if (character == '\n') {
			quoted += "\\n";
			continue;
		}
		if (character == '"' || character == '\\')
			quoted += '\\';
		quoted += character;
	}
	return quoted + '"';
}

} // namespace


bool
property_of(const ViewNode& node, const std::string& property, std::string* _value)
{
	for (const Property& known : kProperties) {
		if (property == known.name) {
			*_value = known.get(node);
			return true;
		}
	}
	return false;
}


std::string
tree_of(const ViewNode& node, int32 level)
{
	std::string line(static_cast<size_t>(level) * 2, ' ');
	if (node.isItem)
		line += "item";
	else
		line += node.className + ' ' + Quoted(node.name);
	line += " frame " + text_of_rect(node.frame) + " screen " + text_of_rect(node.screen);
	const std::string& text = !node.label.empty() ? node.label : node.text;
	if (!text.empty())
		line += ' ' + Quoted(text);
	line += node.focus ? " focus" : "";
	line += node.hidden ? " hidden" : "";
	line += node.enabled ? "" : " disabled";
	line += node.isMarked ? " marked" : "";
	line += node.isSelected ? " selected" : "";
	line += '\n';
	for (const ViewNode& child : node.children)
		line += tree_of(child, level + 1);
	return line;
}


std::string
text_of_rect(BRect rect)
{
	char text[96];
	std::snprintf(text, sizeof(text), "%g,%g,%g,%g", rect.left, rect.top, rect.right, rect.bottom);
	return text;
}


std::string
text_of_color(rgb_color color)
{
	char text[32];
	std::snprintf(text, sizeof(text), "%d,%d,%d", color.red, color.green, color.blue);
	std::string result = text;
	if (color.alpha != 255)
		result += ',' + std::to_string(color.alpha);
	return result;
}


} // namespace BPrivate
