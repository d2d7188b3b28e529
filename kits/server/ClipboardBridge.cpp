#include "server/ClipboardBridge.h"

#include <algorithm>
#include <cstring>

#include <MessageForm.h>
#include <TypeConstants.h>

#include "server/Desktop.h"
#include "server/DesktopThread.h"

namespace BPrivate {

namespace {

constexpr const char* kPlainText = "text/plain";
// A whole message, flattened, for programs on these kits.
constexpr const char* kMessageType = "application/x-vnd.archway-message";


DataOffer
OfferOf(const BMessage& data)
{
	DataOffer offer;
	offer.types.push_back(kMessageType);
	char* name;
	type_code type;
	for (int32 i = 0; data.GetInfo(B_MIME_TYPE, i, &name, &type) == B_OK; i++) {
		if (std::strchr(name, '/') != nullptr)
			offer.types.push_back(name);
	}

	offer.get = [data](const std::string& wanted, std::string* _data) {
		if (wanted == kMessageType) {
			_data->resize(static_cast<size_t>(data.FlattenedSize()));
			return data.Flatten(_data->data(), static_cast<ssize_t>(_data->size())) == B_OK;
		}
		const void* bytes;
		ssize_t size;
		if (data.FindData(wanted.c_str(), B_MIME_TYPE, &bytes, &size) != B_OK)
			return false;
		_data->assign(static_cast<const char*>(bytes), static_cast<size_t>(size));
		return true;
	};
	return offer;
}


// Bytes of another program: a message that does not unflatten is as good as none.
bool
ReadMessage(const DataOffer& offer, BMessage* _data)
{
	std::string bytes;
	if (!offer.get(kMessageType, &bytes) || bytes.empty())
		return false;
	return unflatten_message(_data, bytes.data(), bytes.size()) == B_OK;
}

} // namespace


ClipboardBridge::ClipboardBridge(DesktopThread& desktop) : fDesktop(desktop)
{
}


void
ClipboardBridge::Set(const BMessage& data)
{
	fData = data;
	fDesktop.GetBackend().SetClipboard(OfferOf(data));
	_Notify();
}


status_t
ClipboardBridge::Get(BMessage* _data)
{
	Backend& backend = fDesktop.GetBackend();
	if (backend.OwnsClipboard()) {
		*_data = fData;
		return B_OK;
	}

	_data->MakeEmpty();
	const DataOffer offer = backend.Clipboard();
	const auto has = [&offer](const char* type) {
		return std::find(offer.types.begin(), offer.types.end(), type) != offer.types.end();
	};
	if (!offer.get || (has(kMessageType) && ReadMessage(offer, _data)))
		return B_OK;
	std::string text;
	if (offer.get(kPlainText, &text))
		_data->AddData(kPlainText, B_MIME_TYPE, text.data(), static_cast<ssize_t>(text.size()));
	return B_OK;
}


void
ClipboardBridge::Changed()
{
	if (fDesktop.GetBackend().OwnsClipboard())
		return;
	fData.MakeEmpty();
	fSerial++;
	_Notify();
}


void
ClipboardBridge::_Notify()
{
	fDesktop.PostToApplication(std::make_unique<BMessage>(kClipboardChanged));
}


} // namespace BPrivate
