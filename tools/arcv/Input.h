// Files that arcv reads: resource files, and files that are one flattened message.
#pragma once

#include <string>
#include <vector>

#include <Message.h>
#include <MessageForm.h>
#include <ResourceForm.h>
#include <Resources.h>

namespace Arcv {

// False after a complaint.
bool ReadWholeFile(const std::string& path, std::string* _bytes);

struct Item {
	type_code type;
	int32 id;
	std::string name;
	size_t size;
	int32 index; // in the file: two items may have one type and id
};

// A file opened for reading. Only what is asked for is read.
class Input {
public:
	// False after a complaint that says what is wrong, and where.
	bool Open(const std::string& path);

	const std::string& Path() const { return fPath; }
	// The file is one flattened message; then it has no items.
	bool IsMessage() const { return fIsMessage; }
	const BMessage& Message() const { return fMessage; }
	message_form Form() const { return fForm; }

	BResources& Resources() { return fResources; }
	const std::vector<Item>& Items() const { return fItems; }
	// NULL after a complaint when the bytes cannot be read.
	const void* Load(const Item& item);

private:
	bool _OpenMessage();
	bool _ComplainOfDamage(status_t status);

	std::string fPath;
	bool fIsMessage = false;
	message_form fForm = B_NO_MESSAGE_FORM;
	BMessage fMessage;
	BResources fResources;
	std::vector<Item> fItems;
};

// Whether these bytes are a whole flattened message; it is read then.
bool IsMessage(const void* data, size_t size, BMessage* _message, message_form* _form = NULL);

} // namespace Arcv
