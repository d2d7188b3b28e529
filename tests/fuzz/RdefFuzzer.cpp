// Any bytes as resource definition text; what compiles is written as text again and compiled.

#include <stdlib.h>
#include <string.h>

#include <Resources.h>

#include "tools/arcv/Input.h"
#include "tools/arcv/rdef/Compiler.h"
#include "tools/arcv/rdef/Decompiler.h"

using namespace Arcv;

namespace {

void
Require(bool condition)
{
	if (!condition)
		abort();
}

} // namespace


extern "C" int
LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
	const CompileOptions options;
	BResources resources;
	Compiler compiler(options, resources);
	compiler.Compile("text", std::string(reinterpret_cast<const char*>(data), size));

	type_code type;
	int32 id;
	const char* name;
	size_t length;
	for (int32 i = 0; resources.GetResourceInfo(i, &type, &id, &name, &length); i++) {
		const void* bytes = resources.LoadResource(type, id, &length);
		const std::string text = ResourceText(type, id, name, bytes, length);
		BResources again;
		Compiler second(options, again);
		Require(second.Compile("again", text));
		size_t newLength = 0;
		const void* newBytes = again.LoadResource(type, id, &newLength);
		Require(newBytes != NULL);
		BMessage message;
		BMessage newMessage;
		if (IsMessage(bytes, length, &message) && IsMessage(newBytes, newLength, &newMessage))
			Require(
				message.what == newMessage.what && message.HasSameData(newMessage, false, true));
		else
			Require(length == newLength && memcmp(bytes, newBytes, length) == 0);
	}
	return 0;
}
