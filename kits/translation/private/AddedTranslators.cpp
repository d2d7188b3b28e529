#include "translation/private/AddedTranslators.h"

#include <stdio.h>

#include <DataIO.h>

namespace BPrivate {


void
AddedTranslators::Add(BTranslator* translator)
{
	Reference reference(translator->Acquire(), [](BTranslator* last) { last->Release(); });
	std::lock_guard lock(fLock);
	fTranslators.push_back(std::move(reference));
}


std::vector<translator_id>
AddedTranslators::IDs() const
{
	std::lock_guard lock(fLock);
	std::vector<translator_id> ids;
	for (size_t i = 0; i < fTranslators.size(); i++)
		ids.push_back(kFirst + i);
	return ids;
}


AddedTranslators::Reference
AddedTranslators::Get(translator_id id) const
{
	std::lock_guard lock(fLock);
	const bool known = id >= kFirst && id - kFirst < fTranslators.size();
	return known ? fTranslators[id - kFirst] : nullptr;
}


void
AddedTranslators::Identify(BPositionIO* source, BMessage* ioExtension, uint32 wantType,
	std::vector<translator_info>* _infos) const
{
	for (translator_id id : IDs()) {
		translator_info info;
		if (IdentifyBy(*Get(id), id, source, ioExtension, wantType, &info) == B_OK)
			_infos->push_back(info);
	}
}


status_t
IdentifyBy(BTranslator& translator, translator_id id, BPositionIO* source, BMessage* ioExtension,
	uint32 wantType, translator_info* _info)
{
	source->Seek(0, SEEK_SET);
	*_info = {};
	const status_t status = translator.Identify(source, NULL, ioExtension, _info, wantType);
	_info->translator = id;
	source->Seek(0, SEEK_SET);
	return status;
}

} // namespace BPrivate
