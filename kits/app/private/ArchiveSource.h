// ArchiveSource: what a revived object keeps of the archive that it was made from.
#pragma once

#include <Message.h>

namespace BPrivate {


// Shares the archive's bytes, so it costs little more than a pointer, and knows which fields any
// constructor of the object looked up. instantiate_object() starts the recording on the message
// that it hands to Instantiate(); look-ups through other messages, also those that share the same
// fields, are not recorded, so a later reader of the archive disturbs nothing.
class ArchiveSource {
public:
	ArchiveSource();
	// Starts the recording on the message if instantiate_object() has not done so.
	explicit ArchiveSource(BMessage* archive);
	ArchiveSource(const ArchiveSource& other);
	ArchiveSource(ArchiveSource&& other);
	~ArchiveSource();
	ArchiveSource& operator=(ArchiveSource other);

	bool IsSet() const;

	// The archive as it was read. Look-ups through the result are not recorded.
	BMessage Archive() const;

	// A field counts as known when it was looked up. A name that the archive has not is not known.
	bool IsKnown(const char* name) const;
	void SetKnown(const char* name);

	// The shared fields, NULL if there are none, and whether one of them is known.
	MessageData* Data() const { return fData; }
	bool IsKnownField(uint32 number) const;

	// Whether the archive was part of a managed one; see ManagedArchive.h.
	bool WasManaged() const;

private:
	MessageData* fData = nullptr; // shared
	LookUps* fLookUps = nullptr; // shared
	uint32 fWhat = 0;
};


} // namespace BPrivate
