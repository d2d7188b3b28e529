// The compiler's messages and archives.

#include <TypeConstants.h>

#include "tools/arcv/rdef/Compiler.h"

namespace Arcv {

namespace {

using Kind = Value::Kind;


Value
StringValue(const std::string& text)
{
	Value value;
	value.type = B_STRING_TYPE;
	value.bytes = text + '\0';
	return value;
}

} // namespace


bool
Compiler::_Message(Value* _value)
{
	_value->kind = Kind::kMessage;
	_value->type = B_MESSAGE_TYPE;
	_value->message = std::make_shared<BMessage>();
	std::string none;
	if (!_Advance() || !_MessageHead(false, _value, &none))
		return false;
	if (!fToken.Is('{'))
		return true;
	Fields fields;
	return _Fields(&fields, nullptr) && _Build(fields, _value->message.get());
}


bool
Compiler::_Archive(Value* _value)
{
	_value->kind = Kind::kMessage;
	_value->type = B_MESSAGE_TYPE;
	_value->message = std::make_shared<BMessage>();
	std::string signature;
	if (!_Advance() || !_MessageHead(true, _value, &signature))
		return false;
	if (fToken.kind != TokenKind::kIdentifier)
		return _Fail("the name of a class is expected here");
	const std::string className = fToken.text;
	if (!_Advance())
		return false;
	if (!fToken.Is('{'))
		return _Fail("an archive needs braces with at least one field");
	Fields fields;
	if (!_Fields(&fields, &className))
		return false;
	if (!signature.empty())
		_AddField(&fields, "add_on", B_STRING_TYPE, StringValue(signature));
	return _Build(fields, _value->message.get());
}


// ('what') of a message; ("sig"), (, 'what') or ("sig", 'what') of an archive.
bool
Compiler::_MessageHead(bool archive, Value* _value, std::string* _signature)
{
	if (!_Take('('))
		return true;
	if (archive && fToken.kind == TokenKind::kString) {
		*_signature = fToken.text;
		if (!_Advance())
			return false;
	}
	if (archive && !_Take(','))
		return _Expect(')');
	if (archive || !fToken.Is(')')) {
		int32 what = 0;
		if (!_Id(&what))
			return false;
		_value->message->what = static_cast<uint32>(what);
	}
	return _Expect(')');
}


bool
Compiler::_Fields(Fields* fields, const std::string* className)
{
	if (!_Expect('{'))
		return false;
	bool hasClass = className == nullptr;
	const auto takeMark = [&] {
		if (fToken.kind != TokenKind::kMark)
			return true;
		if (!hasClass)
			_AddField(fields, "class", B_STRING_TYPE, StringValue(*className));
		hasClass = true;
		return _Advance();
	};

	if (!takeMark())
		return false;
	if (className != nullptr && fToken.Is('}'))
		return _Fail("an archive needs at least one field");
	while (!fToken.Is('}')) {
		if (!_Field(fields) || !takeMark())
			return false;
		if (fToken.Is('}'))
			break;
		if (!_Expect(',') || !takeMark())
			return false;
		if (fToken.Is('}'))
			return _Fail("no comma belongs in front of the closing brace");
	}
	if (!hasClass)
		_AddField(fields, "class", B_STRING_TYPE, StringValue(*className));
	return _Expect('}');
}


bool
Compiler::_Field(Fields* fields)
{
	std::optional<type_code> code;
	const RdefType* type = nullptr;
	if (!_TypeCode(&code) || !_TakeType(&type))
		return false;
	if (fToken.kind != TokenKind::kString)
		return _Fail("the name of a field is expected here");
	const std::string name = fToken.text;
	Value value;
	if (!_Advance() || !_Expect('=') || !_Data(&value))
		return false;
	if (type != nullptr && !_Cast(type, &value))
		return false;
	_AddField(fields, name, code.value_or(_TypeOf(value)), std::move(value));
	return true;
}


// An item without bytes is left out, as is one of another type than the first.
void
Compiler::_AddField(Fields* fields, const std::string& name, type_code type, Value value)
{
	if (value.kind == Kind::kBytes && value.bytes.empty()) {
		if (!name.empty())
			_Warn("the empty item of \"" + name + "\" is left out");
		return;
	}
	const auto [place, added] = fields->byName.emplace(name, fields->list.size());
	if (added)
		fields->list.push_back({ name, type, {} });
	Field& field = fields->list[place->second];
	if (field.type != type) {
		_Warn("an item of \"" + name + "\" is left out: its type is not that of the first one");
		return;
	}
	field.values.push_back(std::move(value));
}


bool
Compiler::_Build(const Fields& fields, BMessage* message)
{
	std::vector<std::string> items;
	for (const Field& field : fields.list) {
		const char* name = field.name.c_str();
		if (field.type == B_MESSAGE_TYPE && field.values.front().kind == Kind::kMessage) {
			for (const Value& value : field.values) {
				if (value.kind == Kind::kMessage
					&& message->AddMessage(name, value.message.get()) != B_OK)
					return _Fail("the message \"" + field.name + "\" cannot be added");
			}
			continue;
		}

		items.resize(field.values.size());
		bool sameSize = field.type != B_STRING_TYPE && field.type != B_MESSAGE_TYPE;
		for (size_t i = 0; i < items.size(); i++) {
			if (!_Bytes(field.values[i], &items[i]))
				return false;
			sameSize = sameSize && items[i].size() == items[0].size();
		}
		for (const std::string& item : items) {
			if (message->AddData(name, field.type, item.data(), item.size(), sameSize) != B_OK)
				return _Fail("the field \"" + field.name + "\" cannot be added");
		}
	}
	return true;
}

} // namespace Arcv
