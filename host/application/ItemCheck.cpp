#include "host/application/ItemCheck.h"

#include <Archivable.h>
#include <Message.h>
#include <MessageForm.h>

#include "host/library/ResourceItem.h"


std::string
WhyNoArchivedObject(const BResEditor::BResourceItem* item)
{
	BMessage archive;
	message_damage damage;
	if (unflatten_message(&archive, item->Data(), item->Size(), &damage) != B_OK) {
		return "This is no archive: at byte " + std::to_string(damage.offset) + " " + damage.reason
			+ ".";
	}

	const char* name;
	if (archive.FindString("class", &name) != B_OK)
		return "This archive names no class.";

	for (int32 i = 0; archive.FindString("class", i, &name) == B_OK; i++) {
		if (find_instantiation_func(name, NULL) != NULL)
			return "";
	}
	archive.FindString("class", &name);
	return std::string("The class \"") + name + "\" is not available here.";
}
