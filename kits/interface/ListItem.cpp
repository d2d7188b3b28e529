#include "ListItem.h"

#include <ListView.h>
#include <Message.h>
#include <View.h>

#include "app/private/ArchiveSource.h"
#include "interface/private/ViewArchive.h"

using namespace BPrivate;


BListItem::BListItem(uint32 outlineLevel, bool expanded) :
	fWidth(0), fHeight(0), fTop(0), fIndex(0), fFullIndex(0), fLevel(outlineLevel),
	fSelected(false), fEnabled(true), fExpanded(expanded), fHasSubitems(false), fVisible(true),
	fReviver(NULL)
{
}


BListItem::BListItem(BMessage* archive) : BListItem(0, false)
{
	fSource = std::make_unique<ArchiveSource>(archive);
	bool flag;
	if (archive->FindBool("_sel", &flag) == B_OK)
		fSelected = flag;
	// The field's being there disables, whatever it says.
	if (archive->FindBool("_disable", &flag) == B_OK)
		fEnabled = false;
	if (archive->FindBool("_li_expanded", &flag) == B_OK)
		fExpanded = flag;
	int32 level;
	if (archive->FindInt32("_li_outline_level", &level) == B_OK && level > 0)
		fLevel = static_cast<uint32>(level);
}


BListItem::~BListItem()
{
	if (fReviver != NULL)
		fReviver->_Leave(this);
}


status_t
BListItem::Archive(BMessage* archive, bool deep) const
{
	begin_archive(fSource.get(), archive);
	const status_t status = BArchivable::Archive(archive, deep);
	if (status != B_OK)
		return status;
	ArchiveWriter writer(archive);
	writer.Bool("_sel", fSelected, false, fSelected);
	bool flag;
	const bool wasDisabled = writer.Source().FindBool("_disable", &flag) == B_OK;
	if (!writer.Keep("_disable", wasDisabled == !fEnabled) && !fEnabled)
		archive->AddBool("_disable", true);
	writer.Bool("_li_expanded", fExpanded, false, fExpanded);
	writer.Int32("_li_outline_level", static_cast<int32>(fLevel), 0, fLevel != 0);
	return writer.Status();
}


float
BListItem::Height() const
{
	return fHeight;
}


float
BListItem::Width() const
{
	return fWidth;
}


void
BListItem::SetHeight(float height)
{
	fHeight = height;
}


void
BListItem::SetWidth(float width)
{
	fWidth = width;
}


void
BListItem::Select()
{
	fSelected = true;
}


void
BListItem::Deselect()
{
	fSelected = false;
}


bool
BListItem::IsSelected() const
{
	return fSelected;
}


void
BListItem::SetEnabled(bool enabled)
{
	fEnabled = enabled;
}


bool
BListItem::IsEnabled() const
{
	return fEnabled;
}


bool
BListItem::IsExpanded() const
{
	return fExpanded;
}


void
BListItem::SetExpanded(bool expanded)
{
	fExpanded = expanded;
}


uint32
BListItem::OutlineLevel() const
{
	return fLevel;
}


void
BListItem::SetOutlineLevel(uint32 level)
{
	fLevel = level;
}


bool
BListItem::HasSubitems() const
{
	return fHasSubitems;
}


bool
BListItem::IsItemVisible() const
{
	return fVisible;
}


void
BListItem::Update(BView* owner, const BFont* font)
{
	font_height height;
	font->GetHeight(&height);
	SetWidth(owner->Bounds().Width());
	SetHeight(height.ascent + height.descent + height.leading);
}


status_t
BListItem::Perform(perform_code code, void* data)
{
	return BArchivable::Perform(code, data);
}
