// BTranslatorRoster: who can translate which data, and have it done.
#pragma once

#include <memory>
#include <vector>

#include <SupportDefs.h>
#include <TranslationDefs.h>
#include <TranslatorFormats.h>

class BMessage;
class BPositionIO;
class BRect;
class BTranslator;
class BView;

namespace BPrivate {
class AddedTranslators;
}


// Knows one translator of its own, which reads and writes the image formats of this system, and
// those that were added. Any thread.
class BTranslatorRoster {
public:
	BTranslatorRoster();
	virtual ~BTranslatorRoster();

	static BTranslatorRoster* Default(); // never NULL, not the caller's

	// Shares the translator with the caller.
	virtual status_t AddTranslator(BTranslator* translator);

	// The best by quality and capability.
	virtual status_t Identify(BPositionIO* source, BMessage* ioExtension, translator_info* _info,
		uint32 hintType = 0, const char* hintMIME = NULL, uint32 wantType = 0);
	// Every translator that takes the data, best first; the array is the caller's (delete[]).
	virtual status_t GetTranslators(BPositionIO* source, BMessage* ioExtension,
		translator_info** _info, int32* _count, uint32 hintType = 0, const char* hintMIME = NULL,
		uint32 wantType = 0);
	virtual status_t GetAllTranslators(translator_id** _list, int32* _count); // delete[]
	virtual status_t GetTranslatorInfo(
		translator_id id, const char** _name, const char** _info, int32* _version);
	// The formats stay the roster's.
	virtual status_t GetInputFormats(
		translator_id id, const translation_format** _formats, int32* _count);
	virtual status_t GetOutputFormats(
		translator_id id, const translation_format** _formats, int32* _count);

	// From the source's beginning; what is written begins at the destination's position. With
	// no info the data is identified first. B_NO_TRANSLATOR, B_ILLEGAL_DATA, or what reading and
	// writing say.
	virtual status_t Translate(BPositionIO* source, const translator_info* info,
		BMessage* ioExtension, BPositionIO* destination, uint32 wantType, uint32 hintType = 0,
		const char* hintMIME = NULL);
	virtual status_t Translate(translator_id translator, BPositionIO* source, BMessage* ioExtension,
		BPositionIO* destination, uint32 wantType);

	// The settings of one translator: B_ERROR when it has none.
	virtual status_t MakeConfigurationView(
		translator_id id, BMessage* ioExtension, BView** _view, BRect* _extent);
	virtual status_t GetConfigurationMessage(translator_id id, BMessage* ioExtension);

private:
	BTranslatorRoster(const BTranslatorRoster&);
	BTranslatorRoster& operator=(const BTranslatorRoster&);

	status_t _Identify(BPositionIO* source, BMessage* ioExtension, uint32 wantType,
		std::vector<translator_info>* _infos);

	const std::unique_ptr<BPrivate::AddedTranslators> fAdded; // never NULL
};
