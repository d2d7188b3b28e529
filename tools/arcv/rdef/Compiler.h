// Turns resource definition text into resources.
#pragma once

#include <deque>
#include <map>
#include <string>
#include <utility>
#include <vector>

#include <MessageForm.h>
#include <Resources.h>

#include "tools/arcv/rdef/Lexer.h"
#include "tools/arcv/rdef/Types.h"

namespace Arcv {

struct CompileOptions {
	std::vector<std::string> includeFolders;
	message_form form = B_R5_FORM;
	bool merge = false; // a resource that is there already is replaced
	bool autoNames = false; // a resource whose id is a symbol is named by it
};

// Reads the language whole. Two things go beyond it: the mark /*class*/ inside an archive says
// where among the fields its class belongs, which is the end without it; and integers that become
// floats keep their sign. Memory stays in proportion to the text.
class Compiler {
public:
	Compiler(const CompileOptions& options, BResources& resources);

	// False when the text is wrong; Error() says why. What was compiled before is then added.
	bool Compile(const std::string& name, const std::string& text);
	const RdefError& Error() const { return fError; }
	const std::vector<RdefError>& Warnings() const { return fWarnings; }

private:
	struct Field {
		std::string name;
		type_code type;
		std::vector<Value> values;
	};
	struct Fields {
		std::vector<Field> list;
		std::map<std::string, size_t> byName;
	};
	struct Head {
		std::optional<int32> id;
		std::optional<std::string> name;
		std::optional<type_code> type;
	};

	// Tokens
	bool _Fail(const std::string& reason);
	void _Warn(const std::string& reason);
	bool _Advance();
	bool _Take(char sign);
	bool _Expect(char sign);
	bool _FindFile(const std::string& name, std::string* _path, std::string* _bytes);

	// Declarations
	bool _Resource();
	bool _Head(Head* _head);
	bool _Id(int32* _id);
	bool _TypeCode(std::optional<type_code>* _type);
	bool _AddResource(const Head& head, const Value& value);
	bool _Enum();
	bool _TypeDefinition();
	bool _DefinedField(RdefType* type);

	// Values
	bool _Data(Value* _value, int32 precedence = 0);
	bool _Operand(Value* _value);
	bool _PlainOperand(Value* _value);
	bool _Parenthesis(Value* _value);
	bool _Minus(Value* _value);
	bool _Word(Value* _value);
	bool _Array(Value* _value);
	bool _Import(Value* _value);
	bool _Message(Value* _value);
	bool _Archive(Value* _value);
	bool _MessageHead(bool archive, Value* _value, std::string* _signature);
	bool _Fields(Fields* fields, const std::string* className);
	bool _Field(Fields* fields);
	void _AddField(Fields* fields, const std::string& name, type_code type, Value value);
	bool _Build(const Fields& fields, BMessage* message);
	bool _TypedValue(const RdefType* type, Value* _value);
	bool _FillCompound(const RdefType* type, std::vector<std::optional<Value>>* values);
	bool _Join(
		const RdefType* type, const std::vector<std::optional<Value>>& values, Value* _value);
	const RdefType* _FindType(const std::string& name) const;
	bool _TakeType(const RdefType** _type);
	bool _Cast(const RdefType* type, Value* value);
	bool _Calculate(char sign, const Value& right, Value* left);
	bool _Bytes(const Value& value, std::string* _bytes);
	type_code _TypeOf(const Value& value) const;

	const CompileOptions& fOptions;
	BResources& fResources;
	Lexer* fLexer = nullptr; // during Compile()
	Token fToken; // the next one
	int32 fDepth = 0;
	RdefError fError;
	std::vector<RdefError> fWarnings;
	std::map<std::string, int32> fSymbols;
	std::map<std::string, const RdefType*> fTypes;
	std::deque<RdefType> fDefinedTypes; // never moved: values point to them
};

} // namespace Arcv
