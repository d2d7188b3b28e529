#include "tools/arcv/Json.h"

#include <math.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>

#include <algorithm>
#include <charconv>

#include "tools/arcv/TypeCode.h"

namespace Arcv {

namespace {

constexpr size_t kPieceSize = 64 * 1024;
constexpr size_t kDeepestIndent = 40;


template<typename Number>
std::string
Shortest(Number number)
{
	char buffer[64];
	const auto result = std::to_chars(buffer, buffer + sizeof(buffer), number);
	std::string text(buffer, result.ptr);
	// A zero behind the point keeps a minus in front of nothing.
	if (text.find_first_of(".en") == std::string::npos)
		text += ".0";
	return text;
}


std::string
NotFinite(double number)
{
	if (isnan(number))
		return "nan";
	return number < 0 ? "-inf" : "inf";
}

} // namespace


std::string
FloatText(float number)
{
	std::string text = Shortest(number);
	const float back = static_cast<float>(strtod(text.c_str(), NULL));
	return memcmp(&back, &number, sizeof(number)) == 0 ? text
													   : Shortest(static_cast<double>(number));
}


std::string
DoubleText(double number)
{
	return Shortest(number);
}


void
JsonWriter::Name(std::string_view name)
{
	_Separate();
	fNamed = true; // the string is a part of this member
	String(name);
	fText += ": ";
	fNamed = true;
}


void
JsonWriter::String(std::string_view text)
{
	std::string quoted = "\"";
	for (const char character : text) {
		const unsigned char byte = character;
		if (byte == '"' || byte == '\\') {
			quoted += '\\';
			quoted += character;
		} else if (byte == '\n')
			quoted += "\\n";
		else if (byte == '\t')
			quoted += "\\t";
		else if (byte < 0x20 || byte == 0x7f) {
			char escape[8];
			snprintf(escape, sizeof(escape), "\\u%04x", byte);
			quoted += escape;
		} else
			quoted += character;
	}
	_Value(quoted + "\"");
}


void
JsonWriter::Float(float number)
{
	if (isfinite(number))
		_Value(FloatText(number));
	else
		String(NotFinite(number));
}


void
JsonWriter::Double(double number)
{
	if (isfinite(number))
		_Value(DoubleText(number));
	else
		String(NotFinite(number));
}


void
JsonWriter::Hex(const void* data, size_t size)
{
	OpenObject(true);
	Name("hex");
	String(HexText(data, size));
	CloseObject();
}


void
JsonWriter::Text(std::string_view text)
{
	if (IsUtf8(text))
		String(text);
	else
		Hex(text.data(), text.size());
}


std::string
JsonWriter::Finish()
{
	fText += '\n';
	if (fSink != nullptr) {
		fSink(fText);
		fText.clear();
	}
	return std::move(fText);
}


void
JsonWriter::_Open(char bracket, bool row)
{
	_Separate();
	fText += bracket;
	const bool inRow = !fLevels.empty() && fLevels.back().row;
	fLevels.push_back({ row || inRow, true });
}


void
JsonWriter::_Close(char bracket)
{
	const Level level = fLevels.back();
	fLevels.pop_back();
	if (!level.row && !level.empty)
		_NewLine();
	fText += bracket;
}


void
JsonWriter::_Value(std::string_view text)
{
	_Separate();
	fText += text;
}


void
JsonWriter::_Separate()
{
	if (fNamed) {
		fNamed = false;
		return;
	}
	if (fLevels.empty())
		return;
	Level& level = fLevels.back();
	if (!level.empty)
		fText += level.row ? ", " : ",";
	level.empty = false;
	if (!level.row)
		_NewLine();
}


// Deep levels are indented alike: nobody could tell them apart, and the text would be mostly blanks.
void
JsonWriter::_NewLine()
{
	if (fSink != nullptr && fText.size() >= kPieceSize) {
		fSink(fText);
		fText.clear();
	}
	fText += '\n';
	fText.append(2 * std::min(fLevels.size(), kDeepestIndent), ' ');
}

} // namespace Arcv
