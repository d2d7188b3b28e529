#include <TranslatorRoster.h>

#include <algorithm>
#include <string.h>
#include <string>
#include <vector>

#include <BitmapStream.h>
#include <TranslationErrors.h>
#include <Translator.h>

#include "interface/private/BitmapAccess.h"
#include "server/paint/ImageDecoder.h"
#include "translation/private/AddedTranslators.h"

using namespace BPrivate;

namespace {

constexpr translator_id kImageTranslator = 1;
constexpr const char* kBitmapMime = "image/x-be-bitmap";

// A source larger than this is no image that anyone means to open.
constexpr off_t kMaxSourceSize = 256 * 1024 * 1024;

// Qt's names and the type codes that programs ask for.
struct KnownFormat {
	const char* name;
	uint32 type;
	const char* mime;
	float quality;
};

constexpr KnownFormat kKnownFormats[] = {
	{ "png", 'PNG ', "image/png", 0.8f },
	{ "jpeg", 'JPEG', "image/jpeg", 0.7f },
	{ "jpg", 'JPEG', "image/jpeg", 0.7f },
	{ "gif", 'GIF ', "image/gif", 0.5f },
	{ "bmp", 'BMP ', "image/x-ms-bmp", 0.4f },
	{ "tiff", 'TIFF', "image/tiff", 0.7f },
	{ "tif", 'TIFF', "image/tiff", 0.7f },
	{ "webp", 'WebP', "image/webp", 0.7f },
	{ "ppm", 'PPM ', "image/x-portable-pixmap", 0.5f },
	{ "pgm", 'PGM ', "image/x-portable-graymap", 0.5f },
	{ "pbm", 'PBM ', "image/x-portable-bitmap", 0.3f },
	{ "tga", 'TGA ', "image/x-targa", 0.6f },
	{ "ico", 'ICO ', "image/vnd.microsoft.icon", 0.4f },
	{ "icns", 'ICNS', "image/icns", 0.4f },
	{ "svg", 'SVG ', "image/svg+xml", 0.8f },
	{ "svgz", 'SVG ', "image/svg+xml", 0.8f },
	{ "xbm", 'XBM ', "image/x-xbitmap", 0.2f },
	{ "xpm", 'XPM ', "image/x-xpixmap", 0.3f },
	{ "wbmp", 'WBMP', "image/vnd.wap.wbmp", 0.2f },
	{ "mng", 'MNG ', "video/x-mng", 0.4f },
};


const KnownFormat*
FindFormat(const std::string& name)
{
	for (const KnownFormat& format : kKnownFormats) {
		if (name == format.name)
			return &format;
	}
	return nullptr;
}


const KnownFormat*
FindFormat(uint32 type)
{
	for (const KnownFormat& format : kKnownFormats) {
		if (type == format.type)
			return &format;
	}
	return nullptr;
}


translation_format
MakeFormat(uint32 type, const char* mime, const char* name, float quality)
{
	translation_format format = {};
	format.type = type;
	format.group = B_TRANSLATOR_BITMAP;
	format.quality = quality;
	format.capability = quality;
	strncpy(format.MIME, mime, sizeof(format.MIME) - 1);
	strncpy(format.name, name, sizeof(format.name) - 1);
	return format;
}


translation_format
BitmapFormat()
{
	return MakeFormat(B_TRANSLATOR_BITMAP, kBitmapMime, "Bitmap", 1);
}


std::vector<translation_format>
MakeFormats(const std::vector<std::string>& names)
{
	std::vector<translation_format> formats = { BitmapFormat() };
	for (const std::string& name : names) {
		const KnownFormat* known = FindFormat(name);
		const bool listed = known != nullptr
			&& std::any_of(formats.begin(), formats.end(),
				[known](const auto& format) { return format.type == known->type; });
		if (known != nullptr && !listed)
			formats.push_back(MakeFormat(known->type, known->mime, known->name, known->quality));
	}
	return formats;
}


const std::vector<translation_format>&
InputFormats()
{
	static const std::vector<translation_format> sFormats = MakeFormats(ReadableImageFormats());
	return sFormats;
}


const std::vector<translation_format>&
OutputFormats()
{
	static const std::vector<translation_format> sFormats = MakeFormats(WritableImageFormats());
	return sFormats;
}


// What the image functions say, in the words of this kit.
status_t
ToTranslationError(status_t error)
{
	if (error == B_BAD_TYPE)
		return B_NO_TRANSLATOR;
	return error == B_BAD_DATA ? (status_t)B_ILLEGAL_DATA : error;
}


status_t
ReadAll(BPositionIO* source, std::string* _bytes)
{
	const off_t size = source->Seek(0, SEEK_END);
	if (size < 0)
		return (status_t)size;
	if (size > kMaxSourceSize)
		return B_ILLEGAL_DATA;
	_bytes->resize(size);
	const ssize_t count = source->ReadAt(0, _bytes->data(), size);
	source->Seek(0, SEEK_SET);
	if (count < 0)
		return (status_t)count;
	_bytes->resize(count);
	return B_OK;
}


bool
IsBitmap(const std::string& bytes)
{
	return bytes.size() >= sizeof(TranslatorBitmap) && bytes.compare(0, 4, "bits") == 0;
}


status_t
IdentifyBytes(const std::string& bytes, translator_info* _info)
{
	translation_format format = BitmapFormat();
	if (!IsBitmap(bytes)) {
		const Result<std::string> name = IdentifyImage(bytes.data(), bytes.size());
		if (!name)
			return ToTranslationError(name.Error());
		if (const KnownFormat* known = FindFormat(*name))
			format = MakeFormat(known->type, known->mime, known->name, known->quality);
		else
			format = MakeFormat('none', "image/unknown", name->c_str(), 0.1f);
	}
	memset(_info, 0, sizeof(*_info));
	_info->type = format.type;
	_info->translator = kImageTranslator;
	_info->group = format.group;
	_info->quality = format.quality;
	_info->capability = format.capability;
	memcpy(_info->name, format.name, sizeof(_info->name));
	memcpy(_info->MIME, format.MIME, sizeof(_info->MIME));
	return B_OK;
}


status_t
WriteAll(BPositionIO* destination, const void* data, size_t size)
{
	const ssize_t written = destination->Write(data, size);
	if (written < 0)
		return (status_t)written;
	return (size_t)written == size ? B_OK : B_IO_ERROR;
}


// The pixels of any readable data. Rows of the common format may be of any colour space.
status_t
ReadBitmap(const std::string& bytes, std::unique_ptr<BBitmap>* _bitmap)
{
	if (IsBitmap(bytes)) {
		BBitmapStream stream;
		const ssize_t written = stream.WriteAt(0, bytes.data(), bytes.size());
		if (written < 0)
			return ToTranslationError(written);
		BBitmap* bitmap;
		const status_t status = stream.DetachBitmap(&bitmap);
		_bitmap->reset(bitmap);
		return status == B_OK ? B_OK : (status_t)B_ILLEGAL_DATA;
	}

	const Result<DecodedImage> image = DecodeImage(bytes.data(), bytes.size());
	if (!image)
		return ToTranslationError(image.Error());
	const Surface& surface = *image->surface;
	*_bitmap = std::make_unique<BBitmap>(
		BRect(0, 0, surface.Width() - 1, surface.Height() - 1), 0, B_RGBA32);
	if (!(*_bitmap)->IsValid())
		return (*_bitmap)->InitCheck();
	return (*_bitmap)->ImportBits(surface.Row(0), surface.BytesPerRow() * surface.Height(),
		surface.BytesPerRow(), 0, B_RGBA32);
}


status_t
TranslateImage(BPositionIO* source, BPositionIO* destination, uint32 wantType)
{
	const KnownFormat* wanted = NULL;
	if (wantType != 0 && wantType != B_TRANSLATOR_BITMAP) {
		wanted = FindFormat(wantType);
		if (wanted == NULL)
			return B_NO_TRANSLATOR;
	}

	std::string bytes;
	std::unique_ptr<BBitmap> bitmap;
	status_t status = ReadAll(source, &bytes);
	if (status == B_OK)
		status = ReadBitmap(bytes, &bitmap);
	if (status != B_OK)
		return status;
	if (wanted != NULL) {
		const std::shared_ptr<const Surface> surface = BitmapAccess::Pixels(*bitmap);
		if (surface == nullptr)
			return B_ILLEGAL_DATA;
		const Result<std::string> encoded = EncodeImage(*surface, wanted->name);
		return encoded ? WriteAll(destination, encoded->data(), encoded->size())
					   : ToTranslationError(encoded.Error());
	}

	const BBitmap& pixels = *bitmap;
	BBitmapStream stream(bitmap.release());
	TranslatorBitmap header;
	stream.ReadAt(0, &header, sizeof(header));
	status = WriteAll(destination, &header, sizeof(header));
	if (status == B_OK)
		status = WriteAll(destination, pixels.Bits(), pixels.BitsLength());
	return status;
}

} // namespace


BTranslatorRoster::BTranslatorRoster() : fAdded(std::make_unique<AddedTranslators>())
{
}


BTranslatorRoster::~BTranslatorRoster()
{
}


BTranslatorRoster*
BTranslatorRoster::Default()
{
	static BTranslatorRoster sRoster;
	return &sRoster;
}


status_t
BTranslatorRoster::AddTranslator(BTranslator* translator)
{
	if (translator == NULL)
		return B_BAD_VALUE;
	fAdded->Add(translator);
	return B_OK;
}


status_t
BTranslatorRoster::Identify(BPositionIO* source, BMessage* ioExtension, translator_info* _info,
	uint32 hintType, const char* hintMIME, uint32 wantType)
{
	if (source == NULL || _info == NULL)
		return B_BAD_VALUE;
	std::vector<translator_info> infos;
	const status_t status = _Identify(source, ioExtension, wantType, &infos);
	if (status == B_OK)
		*_info = infos[0];
	return status;
}


status_t
BTranslatorRoster::GetTranslators(BPositionIO* source, BMessage* ioExtension,
	translator_info** _info, int32* _count, uint32 hintType, const char* hintMIME, uint32 wantType)
{
	if (source == NULL || _info == NULL || _count == NULL)
		return B_BAD_VALUE;
	std::vector<translator_info> infos;
	const status_t status = _Identify(source, ioExtension, wantType, &infos);
	if (status != B_OK)
		return status;
	*_info = new translator_info[infos.size()];
	std::copy(infos.begin(), infos.end(), *_info);
	*_count = static_cast<int32>(infos.size());
	return B_OK;
}


status_t
BTranslatorRoster::GetAllTranslators(translator_id** _list, int32* _count)
{
	if (_list == NULL || _count == NULL)
		return B_BAD_VALUE;
	std::vector<translator_id> ids = fAdded->IDs();
	ids.insert(ids.begin(), kImageTranslator);
	*_list = new translator_id[ids.size()];
	std::copy(ids.begin(), ids.end(), *_list);
	*_count = static_cast<int32>(ids.size());
	return B_OK;
}


status_t
BTranslatorRoster::GetTranslatorInfo(
	translator_id id, const char** _name, const char** _info, int32* _version)
{
	const AddedTranslators::Reference added = fAdded->Get(id);
	if (id != kImageTranslator && added == nullptr)
		return B_NO_TRANSLATOR;
	if (_name != NULL)
		*_name = added != nullptr ? added->TranslatorName() : "Images";
	if (_info != NULL)
		*_info = added != nullptr ? added->TranslatorInfo() : "The image formats of this system";
	if (_version != NULL)
		*_version = added != nullptr ? added->TranslatorVersion() : 100;
	return B_OK;
}


status_t
BTranslatorRoster::GetInputFormats(
	translator_id id, const translation_format** _formats, int32* _count)
{
	if (_formats == NULL || _count == NULL)
		return B_BAD_VALUE;
	if (const AddedTranslators::Reference added = fAdded->Get(id)) {
		*_formats = added->InputFormats(_count);
		return B_OK;
	}
	if (id != kImageTranslator)
		return B_NO_TRANSLATOR;
	*_formats = InputFormats().data();
	*_count = InputFormats().size();
	return B_OK;
}


status_t
BTranslatorRoster::GetOutputFormats(
	translator_id id, const translation_format** _formats, int32* _count)
{
	if (_formats == NULL || _count == NULL)
		return B_BAD_VALUE;
	if (const AddedTranslators::Reference added = fAdded->Get(id)) {
		*_formats = added->OutputFormats(_count);
		return B_OK;
	}
	if (id != kImageTranslator)
		return B_NO_TRANSLATOR;
	*_formats = OutputFormats().data();
	*_count = OutputFormats().size();
	return B_OK;
}


status_t
BTranslatorRoster::Translate(BPositionIO* source, const translator_info* info,
	BMessage* ioExtension, BPositionIO* destination, uint32 wantType, uint32 hintType,
	const char* hintMIME)
{
	if (source == NULL || destination == NULL)
		return B_BAD_VALUE;
	// Nobody else to ask, so the image translator finds out by itself.
	if (info == NULL && fAdded->IDs().empty())
		return Translate(kImageTranslator, source, ioExtension, destination, wantType);
	translator_info found;
	if (info == NULL) {
		const status_t status = Identify(source, ioExtension, &found, hintType, hintMIME, wantType);
		if (status != B_OK)
			return status;
		info = &found;
	}
	if (const AddedTranslators::Reference added = fAdded->Get(info->translator)) {
		source->Seek(0, SEEK_SET);
		return added->Translate(source, info, ioExtension, wantType, destination);
	}
	return Translate(info->translator, source, ioExtension, destination, wantType);
}


status_t
BTranslatorRoster::Translate(translator_id translator, BPositionIO* source, BMessage* ioExtension,
	BPositionIO* destination, uint32 wantType)
{
	if (source == NULL || destination == NULL)
		return B_BAD_VALUE;
	if (const AddedTranslators::Reference added = fAdded->Get(translator)) {
		translator_info info;
		const status_t status =
			IdentifyBy(*added, translator, source, ioExtension, wantType, &info);
		return status == B_OK ? Translate(source, &info, ioExtension, destination, wantType)
							  : status;
	}
	return translator == kImageTranslator ? TranslateImage(source, destination, wantType)
										  : (status_t)B_NO_TRANSLATOR;
}


status_t
BTranslatorRoster::MakeConfigurationView(
	translator_id id, BMessage* ioExtension, BView** _view, BRect* _extent)
{
	if (_view == NULL || _extent == NULL)
		return B_BAD_VALUE;
	if (const AddedTranslators::Reference added = fAdded->Get(id))
		return added->MakeConfigurationView(ioExtension, _view, _extent);
	return id == kImageTranslator ? B_ERROR : (status_t)B_NO_TRANSLATOR;
}


status_t
BTranslatorRoster::GetConfigurationMessage(translator_id id, BMessage* ioExtension)
{
	if (ioExtension == NULL)
		return B_BAD_VALUE;
	if (const AddedTranslators::Reference added = fAdded->Get(id))
		return added->GetConfigurationMessage(ioExtension);
	return id == kImageTranslator ? B_ERROR : (status_t)B_NO_TRANSLATOR;
}


// #pragma mark - private


// What is known about the data, best first; at least one when the result is B_OK.
status_t
BTranslatorRoster::_Identify(BPositionIO* source, BMessage* ioExtension, uint32 wantType,
	std::vector<translator_info>* _infos)
{
	std::string bytes;
	status_t status = ReadAll(source, &bytes);
	if (status != B_OK)
		return status;

	translator_info image;
	status = B_NO_TRANSLATOR;
	if (wantType == 0 || wantType == B_TRANSLATOR_BITMAP || FindFormat(wantType) != nullptr)
		status = IdentifyBytes(bytes, &image);
	if (status == B_OK)
		_infos->push_back(image);
	fAdded->Identify(source, ioExtension, wantType, _infos);
	std::stable_sort(_infos->begin(), _infos->end(), [](const auto& a, const auto& b) {
		return a.quality * a.capability > b.quality * b.capability;
	});
	return _infos->empty() ? status : B_OK;
}
