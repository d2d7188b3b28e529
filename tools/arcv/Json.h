// Writes JSON.
#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace Arcv {

// Objects and arrays are indented, one member a line; what is opened as a row stays on its line.
class JsonWriter {
public:
	// What is written goes to the sink in large pieces, so that memory does not hold all of it;
	// without one, Finish() returns the whole.
	using Sink = void (*)(std::string_view text);
	explicit JsonWriter(Sink sink = nullptr) : fSink(sink) {}

	void OpenObject(bool row = false) { _Open('{', row); }
	void CloseObject() { _Close('}'); }
	void OpenArray(bool row = false) { _Open('[', row); }
	void CloseArray() { _Close(']'); }

	// The name of the next value.
	void Name(std::string_view name);

	void String(std::string_view text); // UTF-8
	void Integer(long long number) { _Value(std::to_string(number)); }
	void Unsigned(unsigned long long number) { _Value(std::to_string(number)); }
	void Boolean(bool value) { _Value(value ? "true" : "false"); }
	// The shortest number that reads back to the same bits; "nan", "inf" and "-inf" as strings.
	void Float(float number);
	void Double(double number);
	void Hex(const void* data, size_t size); // as {"hex": "..."}
	// A string, or its bytes when it is not UTF-8.
	void Text(std::string_view text);

	// A value that is JSON already.
	void Verbatim(std::string_view json) { _Value(json); }

	// Ends the line, and returns what no sink got. The writer is empty afterwards.
	std::string Finish();

private:
	struct Level {
		bool row;
		bool empty;
	};

	void _Open(char bracket, bool row);
	void _Close(char bracket);
	void _Value(std::string_view text);
	void _Separate();

	void _NewLine();

	const Sink fSink;
	std::string fText;
	std::vector<Level> fLevels;
	bool fNamed = false; // a name waits for its value
};

// The digits of a number that reads back to the same bits, also when it is first read as a double.
std::string FloatText(float number);
std::string DoubleText(double number);

} // namespace Arcv
