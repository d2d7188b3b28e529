#include "tools/arcv/MessageDiff.h"

#include <string.h>

#include <algorithm>
#include <map>

#include <MessageForm.h>
#include <TypeConstants.h>

#include "tools/arcv/MessageJson.h"
#include "tools/arcv/TypeCode.h"

namespace Arcv {

namespace {

// Above this, matching takes more memory than it is worth.
constexpr size_t kMostPairs = 4 * 1024 * 1024;

// Of several fields with one name each has a place among them: the second of one message is compared
// with the second of the other.
struct Field {
	std::string name;
	type_code type;
	int32 count;
	int32 number; // in its message
	int32 place; // among those of its name
};

using FieldKey = std::pair<std::string, int32>;


FieldKey
KeyOf(const Field& field)
{
	return { field.name, field.place };
}


std::vector<Field>
FieldsOf(const BMessage& message)
{
	std::vector<Field> fields;
	std::map<std::string, int32> places;
	char* name;
	type_code type;
	int32 count;
	for (int32 i = 0; message.GetInfo(B_ANY_TYPE, i, &name, &type, &count) == B_OK; i++)
		fields.push_back({ name, type, count, i, places[name]++ });
	return fields;
}


class Comparison {
public:
	Comparison(const BMessage& oldMessage, const BMessage& newMessage, const std::string& path,
		std::vector<FieldDifference>* differences) :
		fOld(oldMessage),
		fNew(newMessage), fPath(path), fDifferences(differences)
	{
	}

	void Run()
	{
		if (fOld.what != fNew.what)
			_Add(_Join("what"), "changed", "\"" + TypeText(fOld.what) + "\"",
				"\"" + TypeText(fNew.what) + "\"");
		const std::vector<Field> oldFields = FieldsOf(fOld);
		const std::vector<Field> newFields = FieldsOf(fNew);
		std::map<FieldKey, const Field*> newByKey;
		for (const Field& field : newFields)
			newByKey[KeyOf(field)] = &field;

		std::vector<FieldKey> common;
		for (const Field& field : oldFields) {
			const auto found = newByKey.find(KeyOf(field));
			if (found == newByKey.end()) {
				_AddAll(fOld, field, "removed");
				continue;
			}
			common.push_back(KeyOf(field));
			_CompareField(field, *found->second);
			newByKey.erase(found);
		}
		std::vector<FieldKey> newCommon;
		for (const Field& field : newFields) {
			if (newByKey.count(KeyOf(field)) != 0)
				_AddAll(fNew, field, "added");
			else
				newCommon.push_back(KeyOf(field));
		}
		if (common != newCommon)
			_Add(fPath, "moved", "", "");
	}

private:
	std::string _Join(const std::string& name) const
	{
		return fPath.empty() ? name : fPath + "." + name;
	}

	std::string _Join(const Field& field, int32 index) const
	{
		const std::string place = field.place > 0 ? "#" + std::to_string(field.place + 1) : "";
		return _Join(field.name) + place
			+ (field.count > 1 ? "[" + std::to_string(index) + "]" : "");
	}

	void _Add(const std::string& path, const char* what, const std::string& oldValue,
		const std::string& newValue)
	{
		fDifferences->push_back({ path, what, oldValue, newValue });
	}

	std::string _Value(const BMessage& message, const Field& field, int32 index) const
	{
		JsonWriter json;
		json.OpenArray(true);
		WriteFieldValue(json, message, field.number, field.type, index);
		json.CloseArray();
		const std::string text = json.Finish();
		return text.substr(1, text.size() - 3);
	}

	void _AddItem(const BMessage& message, const Field& field, int32 index, bool added)
	{
		const std::string value = _Value(message, field, index);
		_Add(_Join(field, index), added ? "added" : "removed", added ? "" : value,
			added ? value : "");
	}

	void _AddAll(const BMessage& message, const Field& field, const std::string& what)
	{
		for (int32 i = 0; i < field.count; i++)
			_AddItem(message, field, i, what == "added");
	}

	void _CompareField(const Field& oldField, const Field& newField)
	{
		if (oldField.type != newField.type) {
			_AddAll(fOld, oldField, "removed");
			_AddAll(fNew, newField, "added");
			return;
		}
		const size_t pairs = static_cast<size_t>(oldField.count) * newField.count;
		if (oldField.type == B_MESSAGE_TYPE && oldField.count != newField.count
			&& pairs <= kMostPairs) {
			_Match(oldField, newField);
			return;
		}
		const int32 common = std::min(oldField.count, newField.count);
		for (int32 i = 0; i < common; i++)
			_CompareItem(oldField, i, newField, i);
		for (int32 i = common; i < oldField.count; i++)
			_AddItem(fOld, oldField, i, false);
		for (int32 i = common; i < newField.count; i++)
			_AddItem(fNew, newField, i, true);
	}

	void _CompareItem(const Field& oldField, int32 oldIndex, const Field& newField, int32 newIndex)
	{
		BMessage oldNested;
		BMessage newNested;
		if (find_field_message(fOld, oldField.number, oldIndex, &oldNested) == B_OK
			&& find_field_message(fNew, newField.number, newIndex, &newNested) == B_OK) {
			CompareMessages(oldNested, newNested, _Join(newField, newIndex), fDifferences);
			return;
		}
		const void* oldData = NULL;
		const void* newData = NULL;
		ssize_t oldSize = 0;
		ssize_t newSize = 0;
		find_field_data(fOld, oldField.number, oldIndex, &oldData, &oldSize);
		find_field_data(fNew, newField.number, newIndex, &newData, &newSize);
		if (oldSize != newSize || memcmp(oldData, newData, oldSize) != 0)
			_Add(_Join(newField, newIndex), "changed", _Value(fOld, oldField, oldIndex),
				_Value(fNew, newField, newIndex));
	}

	static std::vector<std::string> _Identities(const BMessage& message, const Field& field)
	{
		std::vector<std::string> identities;
		for (int32 i = 0; i < field.count; i++) {
			BMessage nested;
			find_field_message(message, field.number, i, &nested);
			const char* className = nested.FindString("class");
			const char* name = nested.FindString("_name");
			identities.push_back(std::string(className != NULL ? className : "") + "\n"
				+ (name != NULL ? name : ""));
		}
		return identities;
	}

	// The longest sequence of nested messages that both have, by their identities.
	void _Match(const Field& oldField, const Field& newField)
	{
		const std::vector<std::string> olds = _Identities(fOld, oldField);
		const std::vector<std::string> news = _Identities(fNew, newField);
		const size_t width = news.size() + 1;
		std::vector<int32> lengths((olds.size() + 1) * width);
		for (size_t i = olds.size(); i-- > 0;) {
			for (size_t j = news.size(); j-- > 0;) {
				lengths[i * width + j] = olds[i] == news[j]
					? lengths[(i + 1) * width + j + 1] + 1
					: std::max(lengths[(i + 1) * width + j], lengths[i * width + j + 1]);
			}
		}
		size_t i = 0;
		size_t j = 0;
		while (i < olds.size() || j < news.size()) {
			if (i < olds.size() && j < news.size() && olds[i] == news[j])
				_CompareItem(oldField, i++, newField, j++);
			else if (j == news.size()
				|| (i < olds.size() && lengths[(i + 1) * width + j] >= lengths[i * width + j + 1]))
				_AddItem(fOld, oldField, i++, false);
			else
				_AddItem(fNew, newField, j++, true);
		}
	}

	const BMessage& fOld;
	const BMessage& fNew;
	const std::string fPath;
	std::vector<FieldDifference>* fDifferences;
};

} // namespace


void
CompareMessages(const BMessage& oldMessage, const BMessage& newMessage, const std::string& path,
	std::vector<FieldDifference>* _differences)
{
	Comparison(oldMessage, newMessage, path, _differences).Run();
}

} // namespace Arcv
