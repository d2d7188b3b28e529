// BTabView: how its pages are read from archives and written to them.
#include <TabView.h>

#include <algorithm>
#include <memory>
#include <typeinfo>

#include <Message.h>

#include "app/private/MessagePrivate.h"
#include "app/private/WriteBack.h"
#include "interface/private/StandInView.h"
#include "interface/private/ViewArchive.h"

using BPrivate::ArchiveWriter;
using BPrivate::MessagePrivate;
using BPrivate::WriteBack;


BArchivable*
BTabView::Instantiate(BMessage* archive)
{
	return validate_instantiation(archive, "BTabView") ? new BTabView(archive) : NULL;
}


namespace {

// What stands for a page whose class is not available keeps its archive.
BView*
RevivePage(const BMessage* archive, const char* field, int32 index)
{
	BMessage item;
	if (archive->FindMessage(field, index, &item) != B_OK)
		return NULL;
	BArchivable* object = instantiate_object(&item);
	if (BView* page = dynamic_cast<BView*>(object))
		return page;
	delete object;
	return new BPrivate::StandInView(&item);
}


BTab*
ReviveTab(const BMessage* archive, int32 index)
{
	BMessage item;
	if (archive->FindMessage("_l_items", index, &item) != B_OK)
		return new BTab;
	BArchivable* object = instantiate_object(&item);
	if (BTab* tab = dynamic_cast<BTab*>(object))
		return tab;
	delete object;
	return new BTab(&item);
}


// The archives of the pages go into the field, in the places of those that it has already.
status_t
PutPages(BMessage* archive, const char* field, int32 first, const std::vector<BMessage>& pages)
{
	status_t status = B_OK;
	for (size_t i = 0; status == B_OK && i < pages.size(); i++) {
		const int32 index = first + static_cast<int32>(i);
		status = archive->HasMessage(field, index)
			? archive->ReplaceMessage(field, index, &pages[i])
			: archive->AddMessage(field, &pages[i]);
	}
	return status;
}

} // namespace


void
BTabView::_ReadTabs(BMessage* archive)
{
	int32 count = 0;
	archive->GetInfo("_l_items", NULL, &count);
	int32 listed = 0;
	archive->GetInfo("_view_list", NULL, &listed);

	// Old archives have no list but the pages beside, or inside of, the container, in tab order. The
	// children of a container that is more than a view are its own parts.
	const bool plain = typeid(*fContainer) == typeid(BView);
	if (listed == 0 && CountChildren() > 1)
		fPagePlace = PagePlace::kBesideContainer;
	else if (listed == 0 && plain && fContainer->CountChildren() > 0)
		fPagePlace = PagePlace::kInContainer;

	std::vector<BView*> pages;
	if (fPagePlace == PagePlace::kList) {
		for (int32 i = 0; i < listed; i++)
			pages.push_back(RevivePage(archive, "_view_list", i));
		// An archive may have the selected page in the container as well: the list's copy counts.
		while (BView* copy = plain ? fContainer->ChildAt(0) : NULL) {
			copy->RemoveSelf();
			delete copy;
		}
	} else {
		const bool beside = fPagePlace == PagePlace::kBesideContainer;
		while (BView* page = beside ? ChildAt(1) : fContainer->ChildAt(0)) {
			page->RemoveSelf();
			pages.push_back(page);
		}
	}

	// A tab without a page gets an empty one, so that the others keep their numbers.
	const int32 tabs = std::max(count, static_cast<int32>(pages.size()));
	for (int32 i = 0; i < tabs; i++) {
		BView* page = i < static_cast<int32>(pages.size()) ? pages[i] : NULL;
		if (page == NULL)
			page = new BView(fContainer->Bounds(), NULL, B_FOLLOW_ALL, B_WILL_DRAW);
		BTab* tab = ReviveTab(archive, i);
		tab->SetView(page);
		tab->fOwner = this;
		fTabs.push_back(tab);
	}
}


status_t
BTabView::Archive(BMessage* archive, bool deep) const
{
	BPrivate::ArchiveScope scope(this, archive);
	status_t status = BView::Archive(archive, deep);
	if (status != B_OK)
		return status;

	ArchiveWriter writer(archive);
	writer.Int16("_but_width", static_cast<int16>(fWidthSetting), B_WIDTH_AS_USUAL);
	writer.Float("_high", fTabHeight, _UsualTabHeight());
	writer.Int32("_sel", fSelection, -1);
	status = writer.Status();
	if (status == B_OK && deep)
		status = _ArchiveTabs(archive, writer.Source());
	return status == B_OK ? scope.Finish() : status;
}


// Each page is stored once: the container's archive leaves the shown one out, as long as the pages
// are not stored right there.
status_t
BTabView::_ArchiveTabs(BMessage* archive, const BMessage& source) const
{
	std::vector<BMessage> pages(fTabs.size());
	status_t status = B_OK;
	for (size_t i = 0; status == B_OK && i < fTabs.size(); i++) {
		BMessage tab;
		status = fTabs[i]->Archive(&tab, true);
		if (status == B_OK)
			status = archive->AddMessage("_l_items", &tab);
		if (status == B_OK && fTabs[i]->View() != NULL)
			status = BPrivate::archive_as_child(fTabs[i]->View(), &pages[i]);
		if (status == B_OK && fPagePlace == PagePlace::kList)
			status = archive->AddMessage("_view_list", &pages[i]);
	}

	BMessage container;
	if (status != B_OK || archive->FindMessage("_views", 0, &container) != B_OK)
		return status;
	if (fPagePlace == PagePlace::kInContainer)
		status = PutPages(&container, "_views", 0, pages);
	else
		_RestoreContainer(&container, source);
	if (status == B_OK)
		status = archive->ReplaceMessage("_views", 0, &container);
	if (status == B_OK && fPagePlace == PagePlace::kBesideContainer)
		status = PutPages(archive, "_views", 1, pages);
	return status;
}


// What an archive had in the container besides its list stays there, and in its place.
void
BTabView::_RestoreContainer(BMessage* container, const BMessage& source) const
{
	container->RemoveName("_views");
	BMessage read;
	if (source.FindMessage("_views", 0, &read) != B_OK || read.IsEmpty())
		return;
	MessagePrivate(container).SetWriteBack(
		std::make_unique<WriteBack>(MessagePrivate(&read).Data()));
	BMessage copy;
	for (int32 i = 0; read.FindMessage("_views", i, &copy) == B_OK; i++)
		container->AddMessage("_views", &copy);
	MessagePrivate(container).SetWriteBack(nullptr);
}
