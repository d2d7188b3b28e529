// BResourceStrings: the strings of a resource file, by number.
#pragma once

#include <memory>

#include <Entry.h>
#include <Locker.h>
#include <SupportDefs.h>

class BResources;
class BString;

#define RESOURCE_TYPE 'CSTR'


// Safe to use from several threads.
class BResourceStrings {
public:
	// Of the running program.
	BResourceStrings();
	BResourceStrings(const entry_ref& ref);
	virtual ~BResourceStrings();

	status_t InitCheck();
	// A copy for the caller to delete; NULL when there is none.
	virtual BString* NewString(int32 id);
	// Valid until the next SetStringFile(); NULL when there is none.
	virtual const char* FindString(int32 id);
	// NULL means the running program.
	virtual status_t SetStringFile(const entry_ref* ref);
	status_t GetStringFile(entry_ref* _ref);

private:
	BResourceStrings(const BResourceStrings&);
	BResourceStrings& operator=(const BResourceStrings&);

	BLocker fLock;
	entry_ref fRef;
	std::unique_ptr<BResources> fResources;
	status_t fStatus;
};
