#include "interface/private/ControlArchive.h"

#include <DataIO.h>
#include <Message.h>

#include "interface/private/ViewArchive.h"

namespace BPrivate {


std::string
read_text(const BMessage* archive, const char* name)
{
	const char* text = nullptr;
	return archive->FindString(name, &text) == B_OK ? text : "";
}


void
write_text(ArchiveWriter& writer, BMessage* archive, const char* name, const std::string& text)
{
	if (writer.Keep(name, read_text(&writer.Source(), name) == text))
		return;
	if (!text.empty())
		archive->AddString(name, text.c_str());
}


rgb_color
color_from_bytes(int32 bytes)
{
	const uint32 word = static_cast<uint32>(bytes);
	return { static_cast<uint8>(word), static_cast<uint8>(word >> 8),
		static_cast<uint8>(word >> 16), static_cast<uint8>(word >> 24) };
}


int32
color_to_bytes(rgb_color color)
{
	return static_cast<int32>(static_cast<uint32>(color.alpha) << 24
		| static_cast<uint32>(color.blue) << 16 | static_cast<uint32>(color.green) << 8
		| color.red);
}


std::unique_ptr<BMessage>
read_message(const BMessage* archive, const char* name)
{
	auto message = std::make_unique<BMessage>();
	if (archive->FindMessage(name, message.get()) == B_OK)
		return message;

	const void* bytes;
	ssize_t size;
	if (archive->FindData(name, B_RAW_TYPE, &bytes, &size) != B_OK)
		return nullptr;
	BMemoryIO stream(bytes, static_cast<size_t>(size));
	return message->Unflatten(&stream) == B_OK ? std::move(message) : nullptr;
}


void
write_message(ArchiveWriter& writer, BMessage* archive, const char* name, const BMessage* message)
{
	const std::unique_ptr<BMessage> read = read_message(&writer.Source(), name);
	const bool unchanged = read == nullptr || message == nullptr
		? read.get() == message
		: read->what == message->what && read->HasSameData(*message, false, true);
	if (writer.Keep(name, unchanged))
		return;
	if (message != nullptr)
		archive->AddMessage(name, message);
}

} // namespace BPrivate
