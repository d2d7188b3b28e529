#include <Query.h>

#include <stdio.h>
#include <string.h>

#include <Entry.h>
#include <String.h>
#include <Volume.h>

namespace {

// Characters that would be a pattern's own are marked as plain.
std::string
Escape(const char* text, bool caseInsensitive)
{
	std::string escaped;
	for (; *text != '\0'; text++) {
		const char character = *text;
		const char lower = character >= 'A' && character <= 'Z' ? character + 32 : character;
		if (caseInsensitive && lower >= 'a' && lower <= 'z') {
			escaped += { '[', lower, static_cast<char>(lower - 32), ']' };
			continue;
		}
		if (strchr("\"\\'*?[]", character) != NULL)
			escaped += '\\';
		escaped += character;
	}
	return escaped;
}


const char*
OperatorText(query_op operation)
{
	switch (operation) {
		case B_EQ:
		case B_CONTAINS:
		case B_BEGINS_WITH:
		case B_ENDS_WITH:
			return "==";
		case B_GT:
			return ">";
		case B_GE:
			return ">=";
		case B_LT:
			return "<";
		case B_LE:
			return "<=";
		case B_NE:
			return "!=";
		case B_AND:
			return "&&";
		case B_OR:
			return "||";
		default:
			return NULL;
	}
}

} // namespace


BQuery::BQuery() : fDevice(static_cast<dev_t>(B_ERROR))
{
}


BQuery::~BQuery() = default;


status_t
BQuery::Clear()
{
	fStack.clear();
	fBroken = false;
	fFetched = false;
	fDevice = static_cast<dev_t>(B_ERROR);
	fTarget = BMessenger();
	return B_OK;
}


// #pragma mark - pushing


void
BQuery::PushAttr(const char* attribute)
{
	if (attribute == NULL || attribute[0] == '\0')
		fBroken = true;
	else
		fStack.push_back({ Piece::kAttribute, attribute });
}


void
BQuery::PushOp(query_op operation)
{
	const size_t operands = operation == B_NOT ? 1 : 2;
	if (fStack.size() < operands || (operation != B_NOT && OperatorText(operation) == NULL)) {
		fBroken = true;
		return;
	}
	if (operation < B_AND) {
		_PushComparison(operation);
		return;
	}

	const Piece last = fStack.back();
	fStack.pop_back();
	if (operation == B_NOT) {
		fBroken |= last.kind != Piece::kTerm;
		fStack.push_back({ Piece::kTerm, "(!" + last.text + ")" });
		return;
	}
	Piece& first = fStack.back();
	fBroken |= first.kind != Piece::kTerm || last.kind != Piece::kTerm;
	first = { Piece::kTerm, "(" + first.text + OperatorText(operation) + last.text + ")" };
}


void
BQuery::PushUInt32(uint32 value)
{
	_PushNumber(std::to_string(value));
}


void
BQuery::PushInt32(int32 value)
{
	_PushNumber(std::to_string(value));
}


void
BQuery::PushUInt64(uint64 value)
{
	_PushNumber(std::to_string(value));
}


void
BQuery::PushInt64(int64 value)
{
	_PushNumber(std::to_string(value));
}


void
BQuery::PushFloat(float value)
{
	PushDouble(value);
}


void
BQuery::PushDouble(double value)
{
	char text[400];
	snprintf(text, sizeof(text), "%g", value);
	_PushNumber(text);
}


void
BQuery::PushString(const char* value, bool caseInsensitive)
{
	if (value == NULL)
		fBroken = true;
	else
		fStack.push_back({ Piece::kString, Escape(value, caseInsensitive) });
}


// #pragma mark - setting and asking


status_t
BQuery::SetVolume(const BVolume* volume)
{
	if (volume == NULL)
		return B_BAD_VALUE;
	if (fFetched)
		return B_NOT_ALLOWED;
	if (volume->InitCheck() != B_OK)
		return B_BAD_VALUE;
	fDevice = volume->Device();
	return B_OK;
}


status_t
BQuery::SetPredicate(const char* expression)
{
	if (expression == NULL || expression[0] == '\0')
		return B_BAD_VALUE;
	if (fFetched)
		return B_NOT_ALLOWED;
	fBroken = false;
	fStack = { { Piece::kTerm, expression } };
	return B_OK;
}


status_t
BQuery::SetTarget(BMessenger target)
{
	if (!target.IsValid())
		return B_BAD_VALUE;
	if (fFetched)
		return B_NOT_ALLOWED;
	fTarget = target;
	return B_OK;
}


bool
BQuery::IsLive() const
{
	return fTarget.IsValid();
}


status_t
BQuery::GetPredicate(char* buffer, size_t length)
{
	const std::string* predicate = _Predicate();
	if (predicate == NULL)
		return B_NO_INIT;
	if (buffer == NULL || length <= predicate->size())
		return B_BAD_VALUE;
	strcpy(buffer, predicate->c_str());
	return B_OK;
}


status_t
BQuery::GetPredicate(BString* _predicate)
{
	const std::string* predicate = _Predicate();
	if (predicate == NULL)
		return B_NO_INIT;
	if (_predicate == NULL)
		return B_BAD_VALUE;
	_predicate->SetTo(predicate->c_str());
	return B_OK;
}


size_t
BQuery::PredicateLength()
{
	const std::string* predicate = _Predicate();
	return predicate != NULL ? predicate->size() + 1 : 0;
}


dev_t
BQuery::TargetDevice() const
{
	return fDevice;
}


status_t
BQuery::Fetch()
{
	if (fFetched)
		return B_NOT_ALLOWED;
	if (_Predicate() == NULL || fDevice == static_cast<dev_t>(B_ERROR))
		return B_NO_INIT;
	fFetched = true;
	return B_UNSUPPORTED;
}


// #pragma mark - entries


status_t
BQuery::GetNextEntry(BEntry* entry, bool traverse)
{
	if (entry == NULL)
		return B_BAD_VALUE;
	return fFetched ? B_ENTRY_NOT_FOUND : B_FILE_ERROR;
}


status_t
BQuery::GetNextRef(entry_ref* ref)
{
	if (ref == NULL)
		return B_BAD_VALUE;
	return fFetched ? B_ENTRY_NOT_FOUND : B_FILE_ERROR;
}


int32
BQuery::GetNextDirents(struct dirent* buffer, size_t length, int32 count)
{
	if (buffer == NULL)
		return B_BAD_VALUE;
	return fFetched ? 0 : B_FILE_ERROR;
}


// A query cannot be walked twice, nor counted without walking it.
status_t
BQuery::Rewind()
{
	return B_ERROR;
}


int32
BQuery::CountEntries()
{
	return B_ERROR;
}


// #pragma mark - private


void
BQuery::_PushNumber(const std::string& text)
{
	fStack.push_back({ Piece::kNumber, text });
}


void
BQuery::_PushComparison(query_op operation)
{
	Piece value = fStack.back();
	fStack.pop_back();
	Piece& attribute = fStack.back();
	const bool isString = value.kind == Piece::kString;
	const bool isPattern = operation >= B_CONTAINS;
	fBroken |= attribute.kind != Piece::kAttribute || value.kind == Piece::kTerm
		|| value.kind == Piece::kAttribute || (isPattern && !isString);

	if (operation == B_CONTAINS || operation == B_ENDS_WITH)
		value.text.insert(0, "*");
	if (operation == B_CONTAINS || operation == B_BEGINS_WITH)
		value.text += "*";
	if (isString)
		value.text = "\"" + value.text + "\"";
	attribute = { Piece::kTerm, "(" + attribute.text + OperatorText(operation) + value.text + ")" };
}


const std::string*
BQuery::_Predicate() const
{
	const bool whole = !fBroken && fStack.size() == 1 && fStack[0].kind == Piece::kTerm;
	return whole ? &fStack[0].text : NULL;
}
