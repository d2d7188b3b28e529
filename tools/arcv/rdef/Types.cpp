#include "tools/arcv/rdef/Types.h"

#include <string.h>

#include <bit>
#include <map>

#include <TypeConstants.h>

namespace Arcv {

namespace {

using Kind = Value::Kind;
using TypeTable = std::map<std::string, RdefType, std::less<>>;

constexpr int32 kIconId = 101;


void
AddType(TypeTable& table, const char* name, type_code code, Kind kind, size_t size)
{
	RdefType& type = table[name];
	type.name = name;
	type.code = code;
	type.kind = kind;
	type.size = size;
}


void
AddResourceType(
	TypeTable& table, const char* name, type_code code, Kind kind, int32 id, const char* title)
{
	AddType(table, name, code, kind, kind == Kind::kInteger ? 4 : 0);
	table[name].id = id;
	table[name].resourceName = title;
}


void
AddField(TypeTable& table, const char* owner, const char* name, const char* type, uint64 value = 0,
	size_t size = 0)
{
	RdefField field;
	field.name = name;
	field.type = &table[type];
	field.size = size;
	if (field.type->kind != Kind::kBytes) {
		Value standard;
		standard.kind = field.type->kind;
		standard.type = field.type->code;
		standard.integer = value;
		field.defaultValue = standard;
	}
	table[owner].fields.push_back(field);
}


void
AddNumbers(TypeTable& table)
{
	AddType(table, "int8", B_INT8_TYPE, Kind::kInteger, 1);
	AddType(table, "uint8", B_UINT8_TYPE, Kind::kInteger, 1);
	AddType(table, "int16", B_INT16_TYPE, Kind::kInteger, 2);
	AddType(table, "uint16", B_UINT16_TYPE, Kind::kInteger, 2);
	AddType(table, "int32", B_INT32_TYPE, Kind::kInteger, 4);
	AddType(table, "uint32", B_UINT32_TYPE, Kind::kInteger, 4);
	AddType(table, "size_t", B_SIZE_T_TYPE, Kind::kInteger, 4);
	AddType(table, "ssize_t", B_SSIZE_T_TYPE, Kind::kInteger, 4);
	AddType(table, "time_t", B_TIME_TYPE, Kind::kInteger, 4);
	AddType(table, "int64", B_INT64_TYPE, Kind::kInteger, 8);
	AddType(table, "uint64", B_UINT64_TYPE, Kind::kInteger, 8);
	AddType(table, "off_t", B_OFF_T_TYPE, Kind::kInteger, 8);
	AddType(table, "float", B_FLOAT_TYPE, Kind::kReal, 4);
	AddType(table, "double", B_DOUBLE_TYPE, Kind::kReal, 8);
}


void
AddCompounds(TypeTable& table)
{
	AddType(table, "point", B_POINT_TYPE, Kind::kBytes, 0);
	for (const char* name : { "x", "y" })
		AddField(table, "point", name, "float");
	AddType(table, "rect", B_RECT_TYPE, Kind::kBytes, 0);
	for (const char* name : { "left", "top", "right", "bottom" })
		AddField(table, "rect", name, "float");
	AddType(table, "rgb_color", B_RGB_COLOR_TYPE, Kind::kBytes, 0);
	for (const char* name : { "red", "green", "blue" })
		AddField(table, "rgb_color", name, "uint8");
	AddField(table, "rgb_color", "alpha", "uint8", 255);

	AddResourceType(table, "app_version", 'APPV', Kind::kBytes, 1, "BEOS:APP_VERSION");
	for (const char* name : { "major", "middle", "minor", "variety", "internal" })
		AddField(table, "app_version", name, "uint32");
	AddField(table, "app_version", "short_info", "string", 0, 64);
	AddField(table, "app_version", "long_info", "string", 0, 256);
}


TypeTable
MakeTable()
{
	TypeTable table;
	AddNumbers(table);
	AddType(table, "bool", B_BOOL_TYPE, Kind::kBytes, 1);
	AddType(table, "string", B_STRING_TYPE, Kind::kBytes, 0);
	for (const char* name : { "raw", "buffer", "array" })
		AddType(table, name, B_RAW_TYPE, Kind::kBytes, 0);
	for (const char* name : { "message", "archive" })
		AddType(table, name, B_MESSAGE_TYPE, Kind::kMessage, 0);
	AddResourceType(table, "app_signature", 'MIMS', Kind::kBytes, 1, "BEOS:APP_SIG");
	AddResourceType(table, "app_name_catalog_entry", 'CSTR', Kind::kBytes, 1, "SYS:NAME");
	AddResourceType(table, "app_flags", 'APPF', Kind::kInteger, 1, "BEOS:APP_FLAGS");
	AddResourceType(table, "file_types", 'MSGG', Kind::kMessage, 1, "BEOS:FILE_TYPES");
	AddResourceType(table, "large_icon", 'ICON', Kind::kBytes, kIconId, "BEOS:L:STD_ICON");
	AddResourceType(table, "mini_icon", 'MICN', Kind::kBytes, kIconId, "BEOS:M:STD_ICON");
	AddResourceType(table, "vector_icon", 'VICN', Kind::kBytes, kIconId, "BEOS:ICON");
	AddResourceType(table, "png_icon", 'PNG ', Kind::kBytes, kIconId, "BEOS:ICON");
	AddCompounds(table);
	return table;
}


const TypeTable&
Table()
{
	static const TypeTable& table = *new TypeTable(MakeTable());
	return table;
}

} // namespace


const RdefType*
FindBuiltInType(std::string_view name)
{
	const auto found = Table().find(name);
	return found != Table().end() ? &found->second : nullptr;
}


const RdefType*
FindNumberType(type_code code)
{
	for (const auto& [name, type] : Table()) {
		if (type.code == code && (type.kind == Kind::kInteger || type.kind == Kind::kReal))
			return &type;
	}
	return nullptr;
}


bool
FindConstant(std::string_view name, uint64* _value)
{
	static const std::map<std::string_view, uint64> kConstants = { { "B_SINGLE_LAUNCH", 0 },
		{ "B_MULTIPLE_LAUNCH", 1 }, { "B_EXCLUSIVE_LAUNCH", 2 }, { "B_BACKGROUND_APP", 4 },
		{ "B_ARGV_ONLY", 8 }, { "B_APPV_DEVELOPMENT", 0 }, { "B_APPV_ALPHA", 1 },
		{ "B_APPV_BETA", 2 }, { "B_APPV_GAMMA", 3 }, { "B_APPV_GOLDEN_MASTER", 4 },
		{ "B_APPV_FINAL", 5 } };
	const auto found = kConstants.find(name);
	if (found == kConstants.end())
		return false;
	*_value = found->second;
	return true;
}


std::string
NumberBytes(uint64 number, size_t size)
{
	const char* bytes = reinterpret_cast<const char*>(&number);
	if (std::endian::native == std::endian::big)
		bytes += sizeof(number) - size;
	return std::string(bytes, size);
}

} // namespace Arcv
