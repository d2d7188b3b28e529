// The compiler's values: numbers, strings, casts, compounds.

#include <string.h>

#include <limits>

#include <TypeConstants.h>

#include "tools/arcv/Input.h"
#include "tools/arcv/rdef/Compiler.h"

namespace Arcv {

namespace {

using Kind = Value::Kind;

// Deeper texts would need more stack than there is.
constexpr int32 kDeepest = 256;
constexpr int32 kUnaryPrecedence = 5;


// 0 for what joins nothing.
int32
PrecedenceOf(const Token& token)
{
	if (token.kind != TokenKind::kSign)
		return -1;
	switch (token.sign) {
		case '|':
			return 0;
		case '^':
			return 1;
		case '&':
			return 2;
		case '+':
		case '-':
			return 3;
		case '*':
		case '/':
		case '%':
			return 4;
		default:
			return -1;
	}
}


struct Depth {
	explicit Depth(int32& depth) : depth(depth) { depth++; }
	~Depth() { depth--; }
	int32& depth;
};

} // namespace


bool
Compiler::_Data(Value* _value, int32 precedence)
{
	const Depth depth(fDepth);
	if (fDepth > kDeepest)
		return _Fail("the values are nested too deeply");
	if (!_Operand(_value))
		return false;
	while (PrecedenceOf(fToken) >= precedence) {
		const char sign = fToken.sign;
		const int32 next = PrecedenceOf(fToken) + 1;
		Value right;
		if (!_Advance() || !_Data(&right, next) || !_Calculate(sign, right, _value))
			return false;
	}
	return true;
}


bool
Compiler::_Operand(Value* _value)
{
	const Depth depth(fDepth);
	if (fDepth > kDeepest)
		return _Fail("the values are nested too deeply");
	if (fToken.Is('~')) {
		Value zero;
		zero.kind = Kind::kInteger;
		return _Advance() && _Data(_value, kUnaryPrecedence) && _Calculate('~', zero, _value);
	}
	if (fToken.Is('('))
		return _Parenthesis(_value);
	return _PlainOperand(_value);
}


bool
Compiler::_PlainOperand(Value* _value)
{
	switch (fToken.kind) {
		case TokenKind::kInteger:
			_value->kind = Kind::kInteger;
			_value->integer = fToken.integer;
			return _Advance();
		case TokenKind::kFloat:
			_value->kind = Kind::kReal;
			_value->real = fToken.real;
			return _Advance();
		case TokenKind::kString:
			_value->type = B_STRING_TYPE;
			_value->bytes = fToken.text + '\0';
			return _Advance();
		case TokenKind::kRaw:
			_value->type = B_RAW_TYPE;
			_value->bytes = fToken.text;
			return _Advance();
		case TokenKind::kIdentifier:
			return _Word(_value);
		default:
			return fToken.Is('-') ? _Minus(_value) : _Fail("a value is expected here");
	}
}


// A cast, or data in parentheses.
bool
Compiler::_Parenthesis(Value* _value)
{
	if (!_Advance())
		return false;
	if (fToken.kind == TokenKind::kIdentifier && _FindType(fToken.text) != nullptr) {
		const RdefType* type = _FindType(fToken.text);
		const Token name = fToken;
		if (!_Advance())
			return false;
		if (name.text == "archive" && fToken.kind == TokenKind::kIdentifier && !_Advance())
			return false;
		if (_Take(')'))
			return _Operand(_value) && _Cast(type, _value);
		if (!_TypedValue(type, _value))
			return false;
		while (PrecedenceOf(fToken) >= 0) {
			const char sign = fToken.sign;
			const int32 next = PrecedenceOf(fToken) + 1;
			Value right;
			if (!_Advance() || !_Data(&right, next) || !_Calculate(sign, right, _value))
				return false;
		}
		return _Expect(')');
	}
	return _Data(_value) && _Expect(')');
}


bool
Compiler::_Minus(Value* _value)
{
	if (!_Advance())
		return false;
	if (fToken.kind == TokenKind::kInteger) {
		_value->kind = Kind::kInteger;
		_value->integer = -fToken.integer;
		_value->negative = true;
	} else if (fToken.kind == TokenKind::kFloat) {
		_value->kind = Kind::kReal;
		_value->real = -fToken.real;
	} else
		return _Fail("a number is expected behind the minus sign");
	return _Advance();
}


bool
Compiler::_Word(Value* _value)
{
	const std::string word = fToken.text;
	if (word == "array")
		return _Array(_value);
	if (word == "import")
		return _Import(_value);
	if (word == "message")
		return _Message(_value);
	if (word == "archive")
		return _Archive(_value);
	if (word == "true" || word == "false") {
		_value->type = B_BOOL_TYPE;
		_value->bytes = std::string(1, word == "true");
		return _Advance();
	}
	if (const RdefType* type = _FindType(word))
		return _Advance() && _TypedValue(type, _value);

	_value->kind = Kind::kInteger;
	_value->type = B_INT32_TYPE;
	const auto symbol = fSymbols.find(word);
	if (symbol != fSymbols.end()) {
		_value->integer = static_cast<int64>(symbol->second);
		_value->negative = symbol->second < 0;
	} else if (!FindConstant(word, &_value->integer))
		return _Fail("\"" + word + "\" is neither a type nor a symbol");
	return _Advance();
}


bool
Compiler::_Array(Value* _value)
{
	_value->type = B_RAW_TYPE;
	if (!_Advance())
		return false;
	if (fToken.Is("import"))
		return _Import(_value);
	if (!_Take('{'))
		return fToken.kind != TokenKind::kEnd || _Fail("the array is not finished");
	while (!fToken.Is('}')) {
		Value part;
		std::string bytes;
		if (!_Data(&part) || !_Bytes(part, &bytes))
			return false;
		_value->bytes += bytes;
		if (!fToken.Is('}') && !_Expect(','))
			return false;
	}
	return _Expect('}');
}


bool
Compiler::_Import(Value* _value)
{
	_value->type = B_RAW_TYPE;
	if (!_Advance())
		return false;
	if (fToken.kind != TokenKind::kString)
		return _Fail("the name of a file is expected here");
	std::string path;
	if (!_FindFile(fToken.text, &path, &_value->bytes))
		return _Fail("the imported file \"" + fToken.text + "\" is not found");
	return _Advance();
}


// #pragma mark - types


// What may follow a type's name in front of a value: its fields, one value, or nothing.
bool
Compiler::_TypedValue(const RdefType* type, Value* _value)
{
	if (type->kind == Kind::kMessage || type->fields.empty()) {
		const bool alone = fToken.Is(';') || fToken.Is(',') || fToken.Is('}') || fToken.Is(')')
			|| fToken.kind == TokenKind::kEnd;
		if (fToken.Is('{')) {
			if (!_Advance() || (!fToken.Is('}') && !_Data(_value)) || !_Expect('}'))
				return false;
		} else if (!alone && !_Operand(_value))
			return false;
		else if (alone) {
			_value->kind = type->kind;
			_value->type = type->code;
			_value->bytes.assign(type->kind == Kind::kBytes ? type->size : 0, '\0');
			if (type->kind == Kind::kMessage)
				_value->message = std::make_shared<BMessage>();
		}
		if (!_Cast(type, _value))
			return false;
		_value->origin = type;
		return true;
	}

	std::vector<std::optional<Value>> values(type->fields.size());
	return _FillCompound(type, &values) && _Join(type, values, _value);
}


bool
Compiler::_FillCompound(const RdefType* type, std::vector<std::optional<Value>>* values)
{
	const auto add = [&](size_t index) {
		Value value;
		if (!_Data(&value) || !_Cast(type->fields[index].type, &value))
			return false;
		(*values)[index] = std::move(value);
		return true;
	};
	if (!fToken.Is('{')) {
		const bool alone = fToken.Is(';') || fToken.Is(',') || fToken.Is('}') || fToken.Is(')');
		return alone || add(0);
	}

	if (!_Advance())
		return false;
	while (!fToken.Is('}')) {
		size_t index = 0;
		while (index < values->size() && (*values)[index].has_value())
			index++;
		// A field's name may be that of a symbol too: only "=" tells.
		for (size_t i = 0; fToken.kind == TokenKind::kIdentifier && i < values->size(); i++) {
			if (type->fields[i].name == fToken.text && _FindType(fToken.text) == nullptr) {
				if (!_Advance() || !_Expect('='))
					return false;
				index = i;
				break;
			}
		}
		if (index >= values->size())
			return _Fail("too many fields");
		if (!add(index) || (!fToken.Is('}') && !_Expect(',')))
			return false;
	}
	return _Expect('}');
}


bool
Compiler::_Join(
	const RdefType* type, const std::vector<std::optional<Value>>& values, Value* _value)
{
	_value->kind = Kind::kBytes;
	_value->type = type->code;
	_value->origin = type;
	_value->bytes.clear();
	for (size_t i = 0; i < values.size(); i++) {
		const RdefField& field = type->fields[i];
		std::string bytes(field.type->size, '\0');
		const Value* value = values[i].has_value() ? &*values[i] : nullptr;
		if (value == nullptr && field.defaultValue.has_value())
			value = &*field.defaultValue;
		if (value != nullptr && !_Bytes(*value, &bytes))
			return false;
		// A text that is cut still ends with a zero.
		if (field.size > 0 && bytes.size() > field.size && field.type->code == B_STRING_TYPE)
			bytes[field.size - 1] = '\0';
		if (field.size > 0)
			bytes.resize(field.size, '\0');
		_value->bytes += bytes;
	}
	return true;
}


bool
Compiler::_TakeType(const RdefType** _type)
{
	*_type = nullptr;
	if (fToken.kind != TokenKind::kIdentifier)
		return true;
	*_type = _FindType(fToken.text);
	if (*_type == nullptr)
		return _Fail("\"" + fToken.text + "\" is no type");
	const bool archive = fToken.Is("archive");
	if (!_Advance())
		return false;
	return !archive || fToken.kind != TokenKind::kIdentifier || _Advance();
}


bool
Compiler::_Cast(const RdefType* type, Value* value)
{
	if (type->code == B_RAW_TYPE && type->fields.empty()) {
		std::string bytes;
		if (value->kind == Kind::kInteger && value->type == 0)
			bytes = NumberBytes(value->integer, sizeof(uint64));
		else if (!_Bytes(*value, &bytes))
			return false;
		*value = Value();
		value->type = B_RAW_TYPE;
		value->bytes = std::move(bytes);
		return true;
	}

	bool fits = false;
	if (type->kind == Kind::kInteger)
		fits = value->kind == Kind::kInteger;
	else if (type->kind == Kind::kReal) {
		fits = value->kind == Kind::kReal || value->kind == Kind::kInteger;
		if (value->kind == Kind::kInteger)
			value->real = value->negative ? static_cast<double>(static_cast<int64>(value->integer))
										  : static_cast<double>(value->integer);
	} else if (type->kind == Kind::kMessage)
		fits = value->kind == Kind::kMessage;
	else if (value->kind == Kind::kBytes) {
		// The types of resources that are bytes take any; a compound takes only its own.
		const bool plain = type->fields.empty() && type->id.has_value();
		fits = value->type == type->code || plain;
	}
	if (!fits)
		return _Fail("cannot cast to this type");
	value->kind = type->kind;
	value->type = type->code;
	return true;
}


bool
Compiler::_Calculate(char sign, const Value& right, Value* left)
{
	const auto isWord = [](const Value& value) {
		const RdefType* type = value.type != 0 ? FindNumberType(value.type) : nullptr;
		return value.kind == Kind::kInteger && (value.type == 0 || (type && type->size == 4));
	};
	if (!isWord(*left) || !isWord(right))
		return _Fail("only integers of 32 bits can be calculated with");
	const int32 a = static_cast<int32>(left->integer);
	const int32 b = static_cast<int32>(right.integer);
	const bool divides = sign == '/' || sign == '%';
	if (divides && (b == 0 || (b == -1 && a == std::numeric_limits<int32>::min())))
		return _Fail("this division has no result");

	const uint32 ua = a;
	const uint32 ub = b;
	uint32 result = 0;
	switch (sign) {
		case '|':
			result = ua | ub;
			break;
		case '^':
			result = ua ^ ub;
			break;
		case '&':
			result = ua & ub;
			break;
		case '+':
			result = ua + ub;
			break;
		case '-':
			result = ua - ub;
			break;
		case '*':
			result = ua * ub;
			break;
		case '/':
			result = a / b;
			break;
		case '%':
			result = a % b;
			break;
		default:
			result = ~ua;
			break;
	}
	left->integer = static_cast<int64>(static_cast<int32>(result));
	left->negative = static_cast<int32>(result) < 0;
	return true;
}


bool
Compiler::_Bytes(const Value& value, std::string* _bytes)
{
	switch (value.kind) {
		case Kind::kInteger: {
			const RdefType* type = value.type != 0 ? FindNumberType(value.type) : nullptr;
			*_bytes = NumberBytes(value.integer, type != nullptr ? type->size : sizeof(int32));
			return true;
		}
		case Kind::kReal: {
			const float single = static_cast<float>(value.real);
			if (value.type == B_DOUBLE_TYPE)
				_bytes->assign(reinterpret_cast<const char*>(&value.real), sizeof(value.real));
			else
				_bytes->assign(reinterpret_cast<const char*>(&single), sizeof(single));
			return true;
		}
		case Kind::kMessage: {
			const ssize_t size = flattened_message_size(*value.message, fOptions.form);
			if (size < 0)
				return _Fail("the message cannot be flattened");
			_bytes->resize(size);
			return flatten_message(*value.message, fOptions.form, _bytes->data(), size) == B_OK
				|| _Fail("the message cannot be flattened");
		}
		default:
			*_bytes = value.bytes;
			return true;
	}
}


type_code
Compiler::_TypeOf(const Value& value) const
{
	if (value.type != 0)
		return value.type;
	return value.kind == Kind::kReal ? B_FLOAT_TYPE : B_INT32_TYPE;
}

} // namespace Arcv
