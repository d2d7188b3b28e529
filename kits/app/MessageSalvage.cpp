#include <MessageForm.h>

#include <cstring>
#include <string>

#include "app/private/MessageData.h"
#include "app/private/MessagePrivate.h"
#include "app/private/MessageReader.h"

using BPrivate::MessageData;
using BPrivate::MessagePrivate;
using BPrivate::MessageReader;
using BPrivate::SharedBytes;

namespace {

// Bytes inside a source that lives as long as this.
struct Piece {
	SharedBytes* source; // borrowed
	const uint8* bytes;
	size_t size;
	size_t offset; // in the whole that is salvaged

	bool Contains(const uint8* place) const { return place >= bytes && place < bytes + size; }
	Piece Part(const uint8* from, size_t length) const
	{
		return { source, from, length, offset + size_t(from - bytes) };
	}
};


// Puts together again what is left of one message, and of those inside it.
class Salvage {
public:
	explicit Salvage(std::vector<message_damage>& damages) : fDamages(damages) {}

	status_t Run(BMessage* message, const Piece& piece, int32 level);

private:
	void _MendNested(BMessage* message, const Piece& piece, int32 level);
	bool _MendItem(BMessage* item, const Piece& piece, int32 level);
	bool _MendCopy(BMessage* item, const void* data, size_t size, size_t offset, int32 level);

	std::vector<message_damage>& fDamages;
};


status_t
Salvage::Run(BMessage* message, const Piece& piece, int32 level)
{
	message->MakeEmpty();
	message->what = 0;
	if (level > B_MAX_MESSAGE_NESTING)
		return B_BAD_DATA;
	piece.source->Acquire(); // for the reader
	MessageReader reader(piece.source, piece.bytes, piece.size, level);
	std::vector<message_damage> damages;
	reader.Tolerate(&damages);
	MessageData* data = reader.Read();
	if (data == nullptr)
		damages.push_back(reader.Damage());
	for (const message_damage& damage : damages)
		fDamages.push_back({ piece.offset + damage.offset, damage.reason });
	if (data == nullptr)
		return reader.Status();

	message->what = data->What();
	MessagePrivate(message).SetData(data);
	data->Release();
	_MendNested(message, piece, level);
	for (const MessageReader::CutItem& item : reader.CutItems()) {
		BMessage inner;
		if (item.type == B_MESSAGE_TYPE
			&& Run(&inner, piece.Part(item.data, item.size), level + 1) == B_OK)
			message->AddMessage(std::string(item.name, item.nameLength).c_str(), &inner);
	}
	return B_OK;
}


void
Salvage::_MendNested(BMessage* message, const Piece& piece, int32 level)
{
	std::vector<std::pair<std::string, int32>> fields;
	char* name;
	type_code type;
	int32 count;
	for (int32 i = 0; message->GetInfo(B_MESSAGE_TYPE, i, &name, &type, &count) == B_OK; i++)
		fields.emplace_back(name, count);
	for (const auto& [field, items] : fields) {
		for (int32 i = 0; i < items; i++) {
			const void* data;
			ssize_t size;
			if (message->FindData(field.c_str(), B_MESSAGE_TYPE, i, &data, &size) != B_OK)
				continue;
			const uint8* bytes = static_cast<const uint8*>(data);
			BMessage mended;
			// Items that had to be swapped lie elsewhere; the message's own place must do.
			const bool isMended = piece.Contains(bytes)
				? _MendItem(&mended, piece.Part(bytes, size_t(size)), level + 1)
				: _MendCopy(&mended, data, size_t(size), piece.offset, level + 1);
			if (isMended)
				message->ReplaceMessage(field.c_str(), i, &mended);
		}
	}
}


// Whether the item was damaged, and something of it is left.
bool
Salvage::_MendItem(BMessage* item, const Piece& piece, int32 level)
{
	const size_t before = fDamages.size();
	return Run(item, piece, level) == B_OK && fDamages.size() > before;
}


bool
Salvage::_MendCopy(BMessage* item, const void* data, size_t size, size_t offset, int32 level)
{
	SharedBytes* source = SharedBytes::Create(size);
	if (source == nullptr)
		return false;
	memcpy(source->Bytes(), data, size);
	const bool mended = _MendItem(item, { source, source->Bytes(), size, offset }, level);
	source->Release();
	return mended;
}

} // namespace


status_t
salvage_message(
	BMessage* message, const void* data, size_t size, std::vector<message_damage>* _damages)
{
	if (message == nullptr || data == nullptr)
		return B_BAD_VALUE;
	SharedBytes* source = SharedBytes::Create(size);
	if (source == nullptr)
		return B_NO_MEMORY;
	memcpy(source->Bytes(), data, size);
	std::vector<message_damage> damages;
	const status_t status = Salvage(damages).Run(message, { source, source->Bytes(), size, 0 }, 0);
	source->Release();
	if (_damages != nullptr)
		*_damages = std::move(damages);
	return status;
}
