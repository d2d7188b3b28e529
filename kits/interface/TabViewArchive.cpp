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


bool
IsPlain(const BView* view)
{
	return typeid(*view) == typeid(BView);
}


// The first child that the archive has: its place, or -1.
int32
FirstView(const BMessage& archive, BMessage* _view)
{
	int32 count = 0;
	archive.GetInfo("_views", NULL, &count);
	for (int32 i = 0; i < count; i++) {
		if (archive.FindMessage("_views", i, _view) == B_OK)
			return i;
	}
	_view->MakeEmpty();
	return -1;
}


bool
SameMessage(const BMessage& a, const BMessage& b)
{
	return a.what == b.what
		&& (MessagePrivate(&a).SharesDataWith(b) || a.HasSameData(b, false, true));
}


// Children that are the same as in the source become the source's again, together with entries
// among them that nobody can read.
void
KeepSameViews(BMessage* archive, const BMessage& source)
{
	int32 count = 0;
	source.GetInfo("_views", NULL, &count);
	BMessage given;
	BMessage read;
	int32 next = 0;
	for (int32 i = 0; i < count; i++) {
		if (source.FindMessage("_views", i, &read) != B_OK)
			continue;
		if (archive->FindMessage("_views", next++, &given) != B_OK || !SameMessage(given, read))
			return;
	}
	if (!archive->HasMessage("_views", next))
		ArchiveWriter(archive).Keep("_views", true);
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
	const bool plain = IsPlain(fContainer);
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

	if (status == B_OK && !_LeaveOutMadeContainer(archive))
		status = _ArchiveContainer(archive, source, pages);
	return status;
}


// A container that the archive had not is made again when the archive is read.
bool
BTabView::_LeaveOutMadeContainer(BMessage* archive) const
{
	return fMadeContainer && BPrivate::is_revived(this) && CountChildren() == 1
		&& ArchiveWriter(archive).Keep("_views", true);
}


status_t
BTabView::_ArchiveContainer(
	BMessage* archive, const BMessage& source, const std::vector<BMessage>& pages) const
{
	BMessage container;
	const int32 place = FirstView(*archive, &container);
	if (place < 0)
		return B_OK;
	BMessage read;
	FirstView(source, &read);
	MessagePrivate access(&container);
	if (!read.IsEmpty() && access.OwnData() != NULL) {
		auto writeBack = std::make_unique<WriteBack>(MessagePrivate(&read).Data());
		writeBack->MarkTwins(*access.OwnData(), "_views");
		access.SetWriteBack(std::move(writeBack));
	}

	status_t status = B_OK;
	if (fPagePlace == PagePlace::kInContainer)
		status = PutPages(&container, "_views", 0, pages);
	else
		status = _LeaveOutShownPage(&container);
	KeepSameViews(&container, read);
	access.SetWriteBack(NULL);
	if (status == B_OK)
		status = archive->ReplaceMessage("_views", place, &container);
	if (status == B_OK && fPagePlace == PagePlace::kBesideContainer)
		status = PutPages(archive, "_views", place + 1, pages);
	if (status == B_OK)
		KeepSameViews(archive, source);
	return status;
}


// Each page is stored once, so the container's archive has only what else is in the container. Copies
// of pages that came with a list are not revived and stay in the archive.
status_t
BTabView::_LeaveOutShownPage(BMessage* container) const
{
	const BView* page = ViewForTab(fSelection);
	std::vector<BMessage> others;
	BMessage child;
	if (page != NULL && page->Parent() == fContainer) {
		for (int32 i = 0; container->FindMessage("_views", i, &child) == B_OK; i++) {
			if (fContainer->ChildAt(i) != page)
				others.push_back(child);
		}
		container->RemoveName("_views");
	}
	status_t status = B_OK;
	for (const BMessage& other : others) {
		if (status == B_OK)
			status = container->AddMessage("_views", &other);
	}
	if (IsPlain(fContainer) && fPagePlace == PagePlace::kList && !container->HasMessage("_views"))
		ArchiveWriter(container).Keep("_views", true);
	return status;
}


// Pages come and go in a container, so a class that does things of its own with its children is no
// use; no program archives such a container. What stands for it writes back what it was.
void
BTabView::_FindContainer(const BMessage& archive)
{
	fContainer = ChildAt(0);
	if (fContainer == NULL) {
		_InitContainer();
		fMadeContainer = true;
		return;
	}
	if (IsPlain(fContainer) || typeid(*fContainer) == typeid(BPrivate::StandInView))
		return;
	BMessage read;
	if (FirstView(archive, &read) < 0)
		return;
	BView* const strange = fContainer;
	fContainer = new BPrivate::StandInView(&read);
	AddChild(fContainer, strange);
	strange->RemoveSelf();
	delete strange;
}
