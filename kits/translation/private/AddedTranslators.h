// The translators that a program added to a roster.
#pragma once

#include <memory>
#include <mutex>
#include <vector>

#include <TranslationDefs.h>
#include <Translator.h>

class BMessage;
class BPositionIO;

namespace BPrivate {

// Any thread. A translator that is being used lives on when the list goes.
class AddedTranslators {
public:
	using Reference = std::shared_ptr<BTranslator>;

	void Add(BTranslator* translator); // gets a reference of its own
	std::vector<translator_id> IDs() const;
	Reference Get(translator_id id) const; // NULL when there is none

	// Appends what each of them says about the source, which is asked from its beginning.
	void Identify(BPositionIO* source, BMessage* ioExtension, uint32 wantType,
		std::vector<translator_info>* _infos) const;

private:
	// The roster's own translator has the number before these.
	static constexpr translator_id kFirst = 2;

	mutable std::mutex fLock;
	std::vector<Reference> fTranslators; // never shrinks, so that ids stay
};

// What one translator says, with its id in it.
status_t IdentifyBy(BTranslator& translator, translator_id id, BPositionIO* source,
	BMessage* ioExtension, uint32 wantType, translator_info* _info);

} // namespace BPrivate
