#include "interface/private/UnknownItem.h"

namespace BPrivate {

namespace {

const char*
label_of(const BMessage& archive)
{
	const char* text;
	if (archive.FindString("_label", &text) == B_OK || archive.FindString("class", &text) == B_OK)
		return text;
	return "";
}


uint32
level_of(const BMessage& archive)
{
	int32 level;
	return archive.FindInt32("_li_outline_level", &level) == B_OK && level > 0 ? level : 0;
}


bool
is_expanded(const BMessage& archive)
{
	bool expanded;
	return archive.FindBool("_li_expanded", &expanded) == B_OK && expanded;
}

} // namespace


UnknownMenuItem::UnknownMenuItem(const BMessage& archive) :
	BMenuItem(label_of(archive), NULL), fArchive(archive)
{
	SetEnabled(false);
}


status_t
UnknownMenuItem::Archive(BMessage* archive, bool) const
{
	*archive = fArchive;
	return B_OK;
}


UnknownListItem::UnknownListItem(const BMessage& archive) :
	BStringItem(label_of(archive), level_of(archive), is_expanded(archive)), fArchive(archive)
{
}


status_t
UnknownListItem::Archive(BMessage* archive, bool) const
{
	*archive = fArchive;
	return B_OK;
}


} // namespace BPrivate
