#include "tools/arcv/rdef/Compiler.h"

#include <TypeConstants.h>

#include "tools/arcv/Input.h"
#include "tools/arcv/Output.h"
#include "tools/arcv/TypeCode.h"

namespace Arcv {

Compiler::Compiler(const CompileOptions& options, BResources& resources) :
	fOptions(options), fResources(resources)
{
}


bool
Compiler::Compile(const std::string& name, const std::string& text)
{
	Lexer lexer(
		name, text, [this](const std::string& file, std::string* _path, std::string* _bytes) {
			return _FindFile(file, _path, _bytes);
		});
	fLexer = &lexer;
	fDepth = 0;
	if (!_Advance())
		return false;
	while (fToken.kind != TokenKind::kEnd) {
		bool fine = false;
		if (fToken.Is("resource"))
			fine = _Resource();
		else if (fToken.Is("enum"))
			fine = _Enum();
		else if (fToken.Is("type"))
			fine = _TypeDefinition();
		else
			return _Fail("a resource, an enum or a type is expected here");
		if (!fine)
			return false;
	}
	return true;
}


// #pragma mark - tokens


bool
Compiler::_Fail(const std::string& reason)
{
	if (fError.reason.empty())
		fError = { fLexer->FileName(fToken.file), fToken.line, reason };
	return false;
}


void
Compiler::_Warn(const std::string& reason)
{
	fWarnings.push_back({ fLexer->FileName(fToken.file), fToken.line, reason });
}


bool
Compiler::_Advance()
{
	if (fLexer->Next(&fToken))
		return true;
	if (fError.reason.empty())
		fError = fLexer->Error();
	return false;
}


// Whether the sign was there; an error in what follows shows at the next step.
bool
Compiler::_Take(char sign)
{
	return fToken.Is(sign) && _Advance();
}


bool
Compiler::_Expect(char sign)
{
	if (!fToken.Is(sign))
		return _Fail(std::string("'") + sign + "' is expected here");
	return _Advance();
}


bool
Compiler::_FindFile(const std::string& name, std::string* _path, std::string* _bytes)
{
	for (const std::string& folder : fOptions.includeFolders) {
		const std::string path = folder + "/" + name;
		if (Exists(path)) {
			*_path = path;
			return ReadWholeFile(path, _bytes);
		}
	}
	return false;
}


// #pragma mark - declarations


bool
Compiler::_Resource()
{
	Head head;
	Value value;
	return _Advance() && _Head(&head) && _Data(&value) && _Expect(';') && _AddResource(head, value);
}


bool
Compiler::_Head(Head* _head)
{
	if (fToken.Is('(') && !fLexer->SeesTypeCode()) {
		if (!_Advance())
			return false;
		if (!fToken.Is(')') && fToken.kind != TokenKind::kString) {
			const std::string symbol =
				fToken.kind == TokenKind::kIdentifier ? fToken.text : std::string();
			int32 id = 0;
			if (!_Id(&id))
				return false;
			_head->id = id;
			if (fOptions.autoNames && !symbol.empty())
				_head->name = symbol;
			if (fToken.Is(',') && !_Advance())
				return false;
		}
		if (fToken.kind == TokenKind::kString) {
			_head->name = fToken.text;
			if (!_Advance())
				return false;
		}
		if (!_Expect(')'))
			return false;
	}
	return _TypeCode(&_head->type);
}


bool
Compiler::_Id(int32* _id)
{
	const bool minus = fToken.Is('-');
	if (minus && !_Advance())
		return false;
	if (fToken.kind == TokenKind::kInteger)
		*_id = static_cast<int32>(minus ? -fToken.integer : fToken.integer);
	else if (fToken.kind == TokenKind::kIdentifier && fSymbols.count(fToken.text) != 0)
		*_id = fSymbols[fToken.text];
	else
		return _Fail("a number or a known symbol is expected here");
	return _Advance();
}


// A type code, with or without parentheses, or none.
bool
Compiler::_TypeCode(std::optional<type_code>* _type)
{
	const bool enclosed = fToken.Is('(') && fLexer->SeesTypeCode();
	if (enclosed && !_Advance())
		return false;
	if (fToken.kind != TokenKind::kTypeCode)
		return true;
	*_type = fToken.integer;
	return _Advance() && (!enclosed || _Expect(')'));
}


bool
Compiler::_AddResource(const Head& head, const Value& value)
{
	const type_code type = head.type.value_or(_TypeOf(value));
	const bool given = value.origin != nullptr && value.origin->id.has_value();
	const int32 id = head.id.value_or(given ? *value.origin->id : 1);
	const char* name = NULL;
	if (head.name.has_value())
		name = head.name->c_str();
	else if (value.origin != nullptr && !value.origin->resourceName.empty())
		name = value.origin->resourceName.c_str();

	if (!fOptions.merge && fResources.HasResource(type, id))
		return _Fail("duplicate resource " + ItemText(type, id));
	std::string bytes;
	if (!_Bytes(value, &bytes))
		return false;
	const status_t status = fResources.AddResource(type, id, bytes.data(), bytes.size(), name);
	return status == B_OK || _Fail("the resource cannot be added: " + StatusText(status));
}


bool
Compiler::_Enum()
{
	if (!_Advance() || !_Expect('{'))
		return false;
	uint32 next = 0;
	while (!fToken.Is('}')) {
		if (fToken.kind != TokenKind::kIdentifier)
			return _Fail("the name of a symbol is expected here");
		const std::string name = fToken.text;
		if (!_Advance())
			return false;
		if (_Take('=')) {
			int32 value = 0;
			if (!_Id(&value))
				return false;
			next = value;
		}
		if (!fSymbols.emplace(name, static_cast<int32>(next++)).second)
			return _Fail("the symbol \"" + name + "\" is there already");
		if (!_Take(',') && !fToken.Is('}'))
			return _Fail("',' or '}' is expected here");
	}
	return _Expect('}') && _Expect(';');
}


bool
Compiler::_TypeDefinition()
{
	Head head;
	if (!_Advance() || !_Head(&head))
		return false;
	if (fToken.kind != TokenKind::kIdentifier)
		return _Fail("the name of a type is expected here");
	RdefType& type = fDefinedTypes.emplace_back();
	type.name = fToken.text;
	type.code = head.type.value_or(B_RAW_TYPE);
	type.id = head.id.value_or(1);
	type.resourceName = head.name.value_or("");
	if (_FindType(type.name) != nullptr)
		return _Fail("the type \"" + type.name + "\" is there already");
	if (!_Advance() || !_Expect('{'))
		return false;
	do {
		if (!_DefinedField(&type))
			return false;
	} while (_Take(','));
	if (!_Expect('}') || !_Expect(';'))
		return false;
	fTypes[type.name] = &type;
	return true;
}


bool
Compiler::_DefinedField(RdefType* type)
{
	constexpr uint64 kLargestField = 1024 * 1024;
	RdefField field;
	if (fToken.kind != TokenKind::kIdentifier || (field.type = _FindType(fToken.text)) == nullptr)
		return _Fail("the name of a type is expected here");
	if (!_Advance())
		return false;
	if (fToken.kind != TokenKind::kIdentifier)
		return _Fail("the name of a field is expected here");
	field.name = fToken.text;
	if (!_Advance())
		return false;
	if (_Take('[')) {
		if (fToken.kind != TokenKind::kInteger || fToken.integer > kLargestField)
			return _Fail("the field's size is expected here");
		field.size = fToken.integer;
		if (!_Advance() || !_Expect(']'))
			return false;
	}
	if (_Take('=')) {
		Value value;
		if (!_Data(&value) || !_Cast(field.type, &value))
			return false;
		field.defaultValue = value;
	}
	type->fields.push_back(field);
	return true;
}


const RdefType*
Compiler::_FindType(const std::string& name) const
{
	const auto found = fTypes.find(name);
	return found != fTypes.end() ? found->second : FindBuiltInType(name);
}

} // namespace Arcv
