// BMimeType: what the system knows about a type of file.
#pragma once

#include <StorageDefs.h>
#include <SupportDefs.h>
#include <TypeConstants.h>

class BBitmap;
class BMessage;
class BMessenger;
class BString;
struct entry_ref;

enum icon_size { B_LARGE_ICON = 32, B_MINI_ICON = 16 };

typedef enum { B_OPEN = 0 } app_verb;

#define B_APP_MIME_TYPE "application/x-vnd.Be-elfexecutable"
#define B_ELF_APP_MIME_TYPE "application/x-vnd.Be-elfexecutable"
#define B_PEF_APP_MIME_TYPE "application/x-be-executable"
#define B_PE_APP_MIME_TYPE "application/x-vnd.Be-peexecutable"
#define B_RESOURCE_MIME_TYPE "application/x-be-resource"
#define B_FILE_MIME_TYPE "application/octet-stream"

enum {
	B_META_MIME_CHANGED = 'MMCH',
	B_META_MIME_MODIFIED = B_META_MIME_CHANGED,
	B_META_MIME_DELETED = 'MMDL'
};

enum {
	B_ICON_CHANGED = 0x00000001,
	B_PREFERRED_APP_CHANGED = 0x00000002,
	B_ATTR_INFO_CHANGED = 0x00000004,
	B_FILE_EXTENSIONS_CHANGED = 0x00000008,
	B_SHORT_DESCRIPTION_CHANGED = 0x00000010,
	B_LONG_DESCRIPTION_CHANGED = 0x00000020,
	B_ICON_FOR_TYPE_CHANGED = 0x00000040,
	B_APP_HINT_CHANGED = 0x00000080,
	B_MIME_TYPE_CREATED = 0x00000100,
	B_MIME_TYPE_DELETED = 0x00000200,
	B_SNIFFER_RULE_CHANGED = 0x00000400,
	B_SUPPORTED_TYPES_CHANGED = 0x00000800,
	B_EVERYTHING_CHANGED = (int)0xFFFFFFFF
};


// Answers from the desktop's shared MIME database, and before that from what programs on this
// platform set: that is kept in the user's settings folder. Different objects may be used by
// different threads. Setters take NULL to forget a value.
class BMimeType {
public:
	BMimeType();
	BMimeType(const char* type);
	virtual ~BMimeType();

	// B_BAD_VALUE for what is no type. Case does not matter when types are compared.
	status_t SetTo(const char* type);
	status_t SetType(const char* type);
	void Unset();
	status_t InitCheck() const;

	const char* Type() const;
	bool IsValid() const;
	bool IsSupertypeOnly() const;
	bool IsInstalled() const;
	status_t GetSupertype(BMimeType* _type) const;
	// A supertype contains its types, and a type itself.
	bool Contains(const BMimeType* type) const;

	bool operator==(const BMimeType& type) const;
	bool operator==(const char* type) const;

	// Only what was installed here can be deleted.
	status_t Install();
	status_t Delete();

	// `description` has room for B_MIME_TYPE_LENGTH + 1 bytes.
	status_t GetShortDescription(char* description) const;
	status_t SetShortDescription(const char* description);
	status_t GetLongDescription(char* description) const;
	status_t SetLongDescription(const char* description);
	// Strings in the field "extensions", without the leading dot.
	status_t GetFileExtensions(BMessage* _extensions) const;
	status_t SetFileExtensions(const BMessage* extensions);
	// `signature` has room for B_MIME_TYPE_LENGTH + 1 bytes.
	status_t GetPreferredApp(char* signature, app_verb verb = B_OPEN) const;
	status_t SetPreferredApp(const char* signature, app_verb verb = B_OPEN);
	// The programs that support the type, as "applications": first those that name it, as many as
	// "be:sub" says, then the other ones that support its supertype, "be:super". The first number
	// is left out for a supertype.
	status_t GetSupportingApps(BMessage* _signatures) const;
	// Those that support any file: they name B_FILE_MIME_TYPE.
	static status_t GetWildcardApps(BMessage* _signatures);
	// Strings in the field "types"; this type is the signature of the program that supports them.
	// Types that are not installed are. Without `fullSync` the program stays listed with those
	// that it no longer supports, until a later call has it.
	status_t GetSupportedTypes(BMessage* _types) const;
	status_t SetSupportedTypes(const BMessage* types, bool fullSync = true);
	status_t GetAttrInfo(BMessage* _info) const;
	status_t SetAttrInfo(const BMessage* info);
	status_t GetAppHint(entry_ref* _ref) const;
	status_t SetAppHint(const entry_ref* ref);
	// Icons of `size` times `size` pixels; those that are set are B_CMAP8.
	status_t GetIcon(BBitmap* icon, icon_size size) const;
	status_t SetIcon(const BBitmap* icon, icon_size size);
	status_t GetIconForType(const char* type, BBitmap* icon, icon_size size) const;
	status_t SetIconForType(const char* type, const BBitmap* icon, icon_size size);

	// How the first bytes of a file tell that it is of this type, as a priority and expressions:
	//
	//	0.8 [0:16] ("%PDF" | "%!PS") (-i "title" | [4] 0xff00 & 0xfff0)
	//
	// All expressions must match, and one pattern of each. The range says at which places of the
	// file a pattern may begin, at most 64 KB are looked at; "-i" stands before patterns in which
	// the case of letters does not matter; a mask says which bits count. Texts and words know the
	// escapes of C. B_BAD_MIME_SNIFFER_RULE for anything else, and for more than 4096 bytes.
	status_t GetSnifferRule(BString* _rule) const;
	status_t SetSnifferRule(const char* rule);
	// Says in `_error`, which may be NULL, what is wrong and at which character, counted from 1.
	static status_t CheckSnifferRule(const char* rule, BString* _error);

	// Strings in the field "super_types", or in "types".
	static status_t GetInstalledSupertypes(BMessage* _supertypes);
	static status_t GetInstalledTypes(BMessage* _types);
	static status_t GetInstalledTypes(const char* supertype, BMessage* _types);

	// By the file's name and first bytes; by bytes alone; by name alone. What cannot be told is
	// B_FILE_MIME_TYPE. A rule that a program set is compared with what the shared database says:
	// the rule's priority is on a scale up to 1.0 what a name's weight or the priority of the
	// database's own rules, both usually 50, is on a scale up to 100. The rule wins when it is
	// not lower. Otherwise a name comes before bytes, since it knows the member where bytes often
	// know the family only; and an extension that a program set before all others.
	static status_t GuessMimeType(const entry_ref* file, BMimeType* _type);
	static status_t GuessMimeType(const void* buffer, int32 length, BMimeType* _type);
	static status_t GuessMimeType(const char* filename, BMimeType* _type);

	// The target gets a B_META_MIME_CHANGED for every change, whichever program made it: "be:type"
	// and, as int32 "be:which", one of the bits above. B_ICON_FOR_TYPE_CHANGED has the other type
	// as "be:extra_type", and both changes of icons say as bool "be:large_icon" which one it was.
	// Setting what is set already is no change. A target that is gone is forgotten.
	static status_t StartWatching(BMessenger target);
	// B_ENTRY_NOT_FOUND for one who does not watch; the last message was sent before it returns.
	static status_t StopWatching(BMessenger target);

	static bool IsValid(const char* type);

private:
	BMimeType(const BMimeType&);
	BMimeType& operator=(const BMimeType&);

	char* fType; // owned; NULL when unset
	status_t fCStatus;
};


// Writes the type that is guessed to the file's attributes: where it has none, or always if
// `force` is set. A folder's files too if `recursive` is set.
status_t update_mime_info(const char* path, int recursive, int synchronous, int force);

// Makes the signature of a program's file known as a type: with the file as its hint and the name
// as its description, with the file's icons and the types that it supports. What is set already
// stays unless `force` is set. B_ENTRY_NOT_FOUND for a file without a signature; of a folder all
// programs are taken if `recursive` is set, and other files are passed over.
status_t create_app_meta_mime(const char* path, int recursive, int synchronous, int force);
