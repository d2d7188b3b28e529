#include "archive/ViewArchive.h"

#include <algorithm>
#include <cstdio>
#include <cstring>
#include <map>
#include <memory>
#include <set>
#include <string>
#include <string_view>
#include <vector>

#include <Application.h>
#include <Archivable.h>
#include <DataIO.h>
#include <Message.h>
#include <Point.h>
#include <Resources.h>
#include <String.h>
#include <TypeConstants.h>
#include <View.h>

#include "archive/EditorCodes.h"

namespace {


constexpr const char* kClassField = "class";
constexpr const char* kPlaceholderClass = "LayoutInheritedView";


BView*
ViewFromArchive(BMessage* archive)
{
	BArchivable* object = instantiate_object(archive);
	BView* view = dynamic_cast<BView*>(object);
	if (view == nullptr)
		delete object;
	return view;
}


// Whether several fields have one name. No program writes such a message, but a file can hold one.
bool
HasTwinFields(const BMessage* message)
{
	std::vector<std::string_view> names;
	names.reserve(static_cast<size_t>(message->CountNames(B_ANY_TYPE)));
	char* name;
	type_code type;
	for (int32 i = 0; message->GetInfo(B_ANY_TYPE, i, &name, &type) == B_OK; i++)
		names.emplace_back(name);
	std::sort(names.begin(), names.end());
	return std::adjacent_find(names.begin(), names.end()) != names.end();
}


bool
SameEntries(const BMessage* a, const BMessage* b, const char* name, type_code type, int32 count)
{
	for (int32 i = 0; i < count; i++) {
		if (type == B_MESSAGE_TYPE) {
			BMessage nestedA, nestedB;
			const bool readA = a->FindMessage(name, i, &nestedA) == B_OK;
			const bool readB = b->FindMessage(name, i, &nestedB) == B_OK;
			if (readA != readB || (readA && !Equal(&nestedA, &nestedB)))
				return false;
			if (readA)
				continue;
			// What nobody can read is still the same when its bytes are.
		}

		const void* dataA;
		const void* dataB;
		ssize_t sizeA, sizeB;
		if (a->FindData(name, type, i, &dataA, &sizeA) != B_OK
			|| b->FindData(name, type, i, &dataB, &sizeB) != B_OK || sizeA != sizeB
			|| (sizeA > 0 && memcmp(dataA, dataB, static_cast<size_t>(sizeA)) != 0))
			return false;
	}
	return true;
}


void
PrintCode(uint32 code)
{
	printf("%c%c%c%c", static_cast<char>(code >> 24), static_cast<char>(code >> 16),
		static_cast<char>(code >> 8), static_cast<char>(code));
}


void
DumpValues(const BMessage* message, const char* name, type_code type, int32 count)
{
	if (type == B_STRING_TYPE && strcmp(name, kClassField) == 0) {
		for (int32 i = 0; i < count; i++) {
			const char* text;
			if (message->FindString(name, i, &text) == B_OK)
				printf(" %s ", text);
		}
	} else if (type == B_POINT_TYPE) {
		for (int32 i = 0; i < count; i++) {
			BPoint point;
			if (message->FindPoint(name, i, &point) == B_OK)
				printf(" [%g,%g]", point.x, point.y);
		}
	}
}


// Whether the class list had the placeholder at either end and was rotated.
bool
RotateClassNames(BMessage* archive)
{
	type_code type;
	int32 count;
	if (archive->GetInfo(kClassField, &type, &count) != B_OK || type != B_STRING_TYPE || count < 2)
		return false;

	std::vector<BString> names;
	for (int32 i = 0; i < count; i++) {
		const char* name = "";
		archive->FindString(kClassField, i, &name);
		names.push_back(name);
	}

	std::vector<BString> rotated;
	if (names.back() == kPlaceholderClass) {
		rotated.push_back(names.back());
		rotated.insert(rotated.end(), names.begin(), names.end() - 1);
	} else if (names.front() == kPlaceholderClass) {
		rotated.assign(names.begin() + 1, names.end());
		rotated.push_back(names.front());
	} else
		return false;

	for (int32 i = 0; i < count; i++)
		archive->ReplaceString(kClassField, i, rotated[i].String());
	return true;
}


// Replacing an entry keeps its place and the field's; untouched archives stay shared.
bool
SwapTree(BMessage* archive)
{
	bool changed = RotateClassNames(archive);

	// Of fields with one name only the first is an archive's; swapping it twice would undo it.
	std::map<std::string, int32> nested;
	char* name;
	type_code type;
	int32 count;
	for (int32 i = 0; archive->GetInfo(B_MESSAGE_TYPE, i, &name, &type, &count) == B_OK; i++)
		nested.emplace(name, count);

	for (const auto& [field, entries] : nested) {
		for (int32 i = 0; i < entries; i++) {
			BMessage entry;
			if (archive->FindMessage(field.c_str(), i, &entry) == B_OK && SwapTree(&entry)) {
				archive->ReplaceMessage(field.c_str(), i, &entry);
				changed = true;
			}
		}
	}
	return changed;
}


} // namespace


BView*
ViewFromResource(int32 id)
{
	static BResources* const sResources = BApplication::AppResources();
	if (sResources == nullptr)
		return nullptr;

	size_t size;
	const void* data = sResources->LoadResource(kArchiveType, id, &size);
	if (data == nullptr)
		return nullptr;

	BMemoryIO bytes(data, size);
	BMessage archive;
	if (archive.Unflatten(&bytes) != B_OK)
		return nullptr;
	return ViewFromArchive(&archive);
}


BView*
ViewFromResource(const char* name)
{
	static BResources* const sResources = BApplication::AppResources();
	if (sResources == nullptr)
		return nullptr;

	int32 id;
	size_t size;
	if (!sResources->GetResourceInfo(kArchiveType, name, &id, &size))
		return nullptr;
	return ViewFromResource(id);
}


BArchivable*
InstantiateAsChild(BMessage* archive)
{
	if (BArchivable* object = instantiate_object(archive))
		return object;

	BMessage parentArchive;
	parentArchive.AddString(kClassField, "BView");
	parentArchive.AddMessage("_views", archive);
	const std::unique_ptr<BView> parent(ViewFromArchive(&parentArchive));
	BView* child = parent != nullptr ? parent->ChildAt(0) : nullptr;
	if (child != nullptr)
		child->RemoveSelf();
	return child;
}


bool
Equal(const BMessage* a, const BMessage* b)
{
	if (a == nullptr || b == nullptr || a->what != b->what
		|| a->CountNames(B_ANY_TYPE) != b->CountNames(B_ANY_TYPE))
		return false;
	// Of fields with one name only the first can be asked for; the messages know them all.
	if (HasTwinFields(a))
		return a->HasSameData(*b, true, true);

	char* name;
	type_code type, typeB;
	int32 count, countB;
	for (int32 i = 0; a->GetInfo(B_ANY_TYPE, i, &name, &type, &count) == B_OK; i++) {
		if (b->GetInfo(name, &typeB, &countB) != B_OK || type != typeB || count != countB
			|| !SameEntries(a, b, name, type, count))
			return false;
	}
	return true;
}


void
DumpMessage(const BMessage* message, int depth)
{
	const std::string indent(static_cast<size_t>(depth), '\t');
	if (message == nullptr) {
		printf("%sMESSAGE POINTER IS NULL\n", indent.c_str());
		return;
	}

	printf("%s What = ", indent.c_str());
	PrintCode(message->what);
	printf("\n");

	std::set<std::string> names;
	char* name;
	type_code type;
	int32 count;
	for (int32 i = 0; message->GetInfo(B_ANY_TYPE, i, &name, &type, &count) == B_OK; i++) {
		printf("%s% 5ld ", indent.c_str(), static_cast<long>(count));
		PrintCode(type);
		printf(" \"%s\"", name);
		// Values are asked for by name, which finds the first field of that name.
		if (!names.insert(name).second) {
			printf(" (again)\n");
			continue;
		}
		DumpValues(message, name, type, count);
		printf("\n");

		for (int32 j = 0; type == B_MESSAGE_TYPE && j < count; j++) {
			BMessage nested;
			if (message->FindMessage(name, j, &nested) == B_OK)
				DumpMessage(&nested, depth + 1);
		}
	}
}


void
SwapInheritedViews(BMessage* archive, int depth)
{
	SwapTree(archive);
}
