// Stand-ins for archived items of classes that this program does not have.
#pragma once

#include <MenuItem.h>
#include <Message.h>
#include <StringItem.h>

namespace BPrivate {


// Shows the label that it finds, does nothing, and archives exactly what it was made of.
class UnknownMenuItem : public BMenuItem {
public:
	explicit UnknownMenuItem(const BMessage& archive);

	virtual status_t Archive(BMessage* archive, bool deep = true) const;

private:
	BMessage fArchive;
};


class UnknownListItem : public BStringItem {
public:
	explicit UnknownListItem(const BMessage& archive);

	virtual status_t Archive(BMessage* archive, bool deep = true) const;

private:
	BMessage fArchive;
};


} // namespace BPrivate
