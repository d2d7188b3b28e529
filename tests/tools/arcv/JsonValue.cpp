#include "JsonValue.h"

#include <stdlib.h>
#include <string.h>

namespace {

class Parser {
public:
	explicit Parser(const std::string& text) : fText(text) {}

	bool Parse(JsonValue* _value)
	{
		const bool fine = _Value(_value);
		_SkipWhite();
		return fine && fPlace == fText.size();
	}

private:
	void _SkipWhite()
	{
		while (fPlace < fText.size() && strchr(" \t\r\n", fText[fPlace]) != NULL)
			fPlace++;
	}

	char _Next()
	{
		_SkipWhite();
		return fPlace < fText.size() ? fText[fPlace] : '\0';
	}

	bool _Take(char character)
	{
		if (_Next() != character)
			return false;
		fPlace++;
		return true;
	}

	bool _Value(JsonValue* _value)
	{
		switch (_Next()) {
			case '{':
				return _Object(_value);
			case '[':
				return _Array(_value);
			case '"':
				_value->kind = JsonValue::Kind::kString;
				return _String(&_value->text);
			case 't':
			case 'f':
				_value->kind = JsonValue::Kind::kBoolean;
				return _Word(_value);
			case 'n':
				return _Word(_value);
			default:
				return _Number(_value);
		}
	}

	bool _Word(JsonValue* _value)
	{
		for (const char* word : { "true", "false", "null" }) {
			if (fText.compare(fPlace, strlen(word), word) == 0) {
				fPlace += strlen(word);
				_value->text = word;
				return true;
			}
		}
		return false;
	}

	bool _Number(JsonValue* _value)
	{
		const size_t start = fPlace;
		while (fPlace < fText.size() && strchr("+-.0123456789eE", fText[fPlace]) != NULL)
			fPlace++;
		_value->kind = JsonValue::Kind::kNumber;
		_value->text = fText.substr(start, fPlace - start);
		char* end = NULL;
		strtod(_value->text.c_str(), &end);
		return fPlace > start && *end == '\0';
	}

	bool _String(std::string* _text)
	{
		fPlace++;
		for (; fPlace < fText.size() && fText[fPlace] != '"'; fPlace++) {
			if (static_cast<unsigned char>(fText[fPlace]) < 0x20)
				return false;
			if (fText[fPlace] != '\\') {
				*_text += fText[fPlace];
				continue;
			}
			const char escape = fText[++fPlace];
			if (escape == 'u') {
				const unsigned long code = strtoul(fText.substr(fPlace + 1, 4).c_str(), NULL, 16);
				if (code > 0x7f)
					return false; // the writer escapes only what is below
				*_text += static_cast<char>(code);
				fPlace += 4;
			} else if (strchr("\"\\/", escape) != NULL)
				*_text += escape;
			else if (escape == 'n')
				*_text += '\n';
			else if (escape == 't')
				*_text += '\t';
			else
				return false;
		}
		return fPlace++ < fText.size();
	}

	bool _Array(JsonValue* _value)
	{
		_value->kind = JsonValue::Kind::kArray;
		fPlace++;
		if (_Take(']'))
			return true;
		do {
			if (!_Value(&_value->items.emplace_back()))
				return false;
		} while (_Take(','));
		return _Take(']');
	}

	bool _Object(JsonValue* _value)
	{
		_value->kind = JsonValue::Kind::kObject;
		fPlace++;
		if (_Take('}'))
			return true;
		do {
			if (_Next() != '"' || !_String(&_value->names.emplace_back()) || !_Take(':')
				|| !_Value(&_value->items.emplace_back()))
				return false;
		} while (_Take(','));
		return _Take('}');
	}

	const std::string& fText;
	size_t fPlace = 0;
};

} // namespace


const JsonValue*
JsonValue::Find(const std::string& name) const
{
	for (size_t i = 0; i < names.size(); i++) {
		if (names[i] == name)
			return &items[i];
	}
	return nullptr;
}


const JsonValue&
JsonValue::operator[](const std::string& name) const
{
	static const JsonValue kNothing;
	const JsonValue* found = Find(name);
	return found != nullptr ? *found : kNothing;
}


bool
ParseJson(const std::string& text, JsonValue* _value)
{
	return Parser(text).Parse(_value);
}
