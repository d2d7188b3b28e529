// BSymLink: a symbolic link itself, not what it leads to.
#pragma once

#include <Node.h>
#include <StorageDefs.h>

class BPath;


class BSymLink : public BNode {
public:
	BSymLink();
	BSymLink(const BSymLink& link);
	BSymLink(const entry_ref* ref);
	BSymLink(const BEntry* entry);
	BSymLink(const char* path);
	BSymLink(const BDirectory* directory, const char* path);
	virtual ~BSymLink();

	// The length of the whole text, or an error; the text is cut to `length` and terminated.
	ssize_t ReadLink(char* buffer, size_t length);
	ssize_t MakeLinkedPath(const char* directoryPath, BPath* _path);
	ssize_t MakeLinkedPath(const BDirectory* directory, BPath* _path);
	bool IsAbsolute();

	BSymLink& operator=(const BSymLink& link);
};
