// BTranslator: somebody who reads and writes formats for the roster.
#pragma once

#include <atomic>

#include <Archivable.h>
#include <TranslationDefs.h>

class BMessage;
class BPositionIO;
class BRect;
class BView;

// Counts its references and is deleted with the last, never directly. The creator has the first.
// A roster may call it from any thread.
class BTranslator : public BArchivable {
public:
	BTranslator();

	BTranslator* Acquire(); // itself
	BTranslator* Release(); // itself, or NULL when that was the last reference
	int32 ReferenceCount();

	virtual const char* TranslatorName() const = 0;
	virtual const char* TranslatorInfo() const = 0;
	virtual int32 TranslatorVersion() const = 0; // hundreds for the major number
	// The formats stay the translator's.
	virtual const translation_format* InputFormats(int32* _count) const = 0;
	virtual const translation_format* OutputFormats(int32* _count) const = 0;

	// From the source's position. An outType of 0 means any. B_NO_TRANSLATOR for foreign data.
	virtual status_t Identify(BPositionIO* source, const translation_format* format,
		BMessage* ioExtension, translator_info* _info, uint32 outType) = 0;
	virtual status_t Translate(BPositionIO* source, const translator_info* info,
		BMessage* ioExtension, uint32 outType, BPositionIO* destination) = 0;

	// By default there are no settings: B_ERROR.
	virtual status_t MakeConfigurationView(BMessage* ioExtension, BView** _view, BRect* _extent);
	virtual status_t GetConfigurationMessage(BMessage* ioExtension);

protected:
	virtual ~BTranslator();

private:
	std::atomic<int32> fReferences { 1 };
};
