#include <SymLink.h>

#include <limits.h>
#include <string.h>
#include <unistd.h>

#include <algorithm>

#include <Directory.h>
#include <Entry.h>
#include <Errors.h>
#include <Path.h>

#include "storage/private/Descriptor.h"
#include "storage/private/Errno.h"

using namespace BPrivate;


BSymLink::BSymLink()
{
}


BSymLink::BSymLink(const BSymLink& link) : BNode(link)
{
}


BSymLink::BSymLink(const entry_ref* ref) : BNode(ref)
{
}


BSymLink::BSymLink(const BEntry* entry) : BNode(entry)
{
}


BSymLink::BSymLink(const char* path) : BNode(path)
{
}


BSymLink::BSymLink(const BDirectory* directory, const char* path) : BNode(directory, path)
{
}


BSymLink::~BSymLink()
{
}


ssize_t
BSymLink::ReadLink(char* buffer, size_t length)
{
	if (buffer == NULL || length == 0)
		return B_BAD_VALUE;
	if (InitCheck() != B_OK)
		return B_FILE_ERROR;
	if (!IsSymLink())
		return B_BAD_VALUE;
	char text[PATH_MAX];
	const ssize_t size = readlinkat(_Fd(), "", text, sizeof(text));
	if (size < 0)
		return LastStatus();
	const size_t copied = std::min(static_cast<size_t>(size), length - 1);
	memcpy(buffer, text, copied);
	buffer[copied] = '\0';
	return size;
}


ssize_t
BSymLink::MakeLinkedPath(const char* directoryPath, BPath* _path)
{
	if (directoryPath == NULL || _path == NULL)
		return B_BAD_VALUE;
	char text[PATH_MAX];
	const ssize_t size = ReadLink(text, sizeof(text));
	if (size < 0)
		return size;
	const status_t status = text[0] == '/' ? _path->SetTo(text) : _path->SetTo(directoryPath, text);
	return status == B_OK ? static_cast<ssize_t>(strlen(_path->Path())) : status;
}


ssize_t
BSymLink::MakeLinkedPath(const BDirectory* directory, BPath* _path)
{
	if (directory == NULL || _path == NULL)
		return B_BAD_VALUE;
	BPath path;
	const status_t status = path.SetTo(directory, NULL);
	return status == B_OK ? MakeLinkedPath(path.Path(), _path) : status;
}


bool
BSymLink::IsAbsolute()
{
	char first[2];
	return ReadLink(first, sizeof(first)) > 0 && first[0] == '/';
}


BSymLink&
BSymLink::operator=(const BSymLink& link)
{
	BNode::operator=(link);
	return *this;
}
