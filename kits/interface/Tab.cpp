// BTab: the tab of one page of a tab view.
#include <TabView.h>

#include <cmath>
#include <typeinfo>

#include <Message.h>
#include <String.h>
#include <Window.h>

#include "interface/private/Label.h"
#include "interface/private/Look.h"
#include "interface/private/ViewArchive.h"

namespace Look = BPrivate::Look;

using BPrivate::LabelMetrics;

namespace {

constexpr float kLabelMargin = 6; // that a label keeps from the tab's edges when it is cut

} // namespace


BTab::BTab(BView* contentsView) :
	fView(contentsView), fOwner(NULL), fEnabled(true), fSelected(false), fFocus(false)
{
}


BTab::BTab(BMessage* archive) :
	BArchivable(archive), fView(NULL), fOwner(NULL),
	fSource(std::make_unique<BPrivate::ArchiveSource>(archive)), fEnabled(true), fSelected(false),
	fFocus(false)
{
	// Some writers put false there, also for a disabled tab: the field's presence tells.
	bool disabled;
	fEnabled = archive->FindBool("_disable", &disabled) != B_OK;
}


BTab::~BTab()
{
	if (fOwner != NULL) {
		for (int32 i = 0; i < fOwner->CountTabs(); i++) {
			if (fOwner->TabAt(i) == this) {
				fOwner->RemoveTab(i);
				break;
			}
		}
	}
	if (fView != NULL) {
		fView->RemoveSelf();
		delete fView;
	}
}


BArchivable*
BTab::Instantiate(BMessage* archive)
{
	return validate_instantiation(archive, "BTab") ? new BTab(archive) : NULL;
}


status_t
BTab::Archive(BMessage* archive, bool deep) const
{
	BPrivate::begin_archive(fSource.get(), archive);
	const status_t status = BArchivable::Archive(archive, deep);
	if (status != B_OK)
		return status;

	BPrivate::ArchiveWriter writer(archive);
	// A tab of a class that is not available is a plain one but stays what it was.
	writer.KeepClass(typeid(*this) == typeid(BTab));
	if (!writer.Keep("_disable", writer.Source().HasBool("_disable") == !fEnabled) && !fEnabled)
		archive->AddBool("_disable", true);
	return writer.Status();
}


status_t
BTab::Perform(perform_code code, void* data)
{
	return BArchivable::Perform(code, data);
}


// #pragma mark - properties


const char*
BTab::Label() const
{
	return fView != NULL && fView->Name() != NULL ? fView->Name() : "";
}


void
BTab::SetLabel(const char* label)
{
	if (label == NULL || fView == NULL)
		return;
	fView->SetName(label);
	if (fOwner != NULL)
		fOwner->Invalidate();
}


bool
BTab::IsSelected() const
{
	return fSelected;
}


void
BTab::Select(BView* owner)
{
	if (owner == NULL || fView == NULL)
		return;
	fSelected = true;
	if (fView->Parent() != owner)
		owner->AddChild(fView);
}


void
BTab::Deselect()
{
	fSelected = false;
	if (fView != NULL)
		fView->RemoveSelf();
}


void
BTab::SetEnabled(bool enabled)
{
	if (enabled == fEnabled)
		return;
	fEnabled = enabled;
	if (fOwner != NULL)
		fOwner->Invalidate();
}


bool
BTab::IsEnabled() const
{
	return fEnabled;
}


void
BTab::MakeFocus(bool focused)
{
	fFocus = focused;
}


bool
BTab::IsFocus() const
{
	return fFocus;
}


void
BTab::SetView(BView* contents)
{
	if (contents == NULL || contents == fView)
		return;
	BView* container = fView != NULL && fSelected ? fView->Parent() : NULL;
	if (fView != NULL) {
		fView->RemoveSelf();
		delete fView;
	}
	fView = contents;
	if (container != NULL)
		container->AddChild(fView);
	if (fOwner != NULL)
		fOwner->Invalidate();
}


BView*
BTab::View() const
{
	return fView;
}


// #pragma mark - drawing


void
BTab::DrawTab(BView* owner, BRect frame, tab_position position, bool full)
{
	const bool front = position == B_TAB_FRONT;
	Look::DrawTab(owner, frame, Look::BaseColor(owner), front ? Look::kOn : Look::kNormal);
	DrawLabel(owner, frame);
	if (fFocus && owner->IsFocus() && owner->Window()->IsActive())
		DrawFocusMark(owner, frame);
}


namespace {

struct PlacedLabel {
	BString text;
	float left;
	float width;
	float baseline;
};

// In the middle of the tab, cut where it is too wide for it.
PlacedLabel
PlaceLabel(BView* owner, const char* label, BRect frame)
{
	PlacedLabel result { label, 0, 0, 0 };
	const float room = frame.Width() - 2 * kLabelMargin;
	owner->TruncateString(&result.text, B_TRUNCATE_END, room);
	result.width = BPrivate::label_width(owner, result.text.String());
	result.left = std::floor((frame.left + frame.right + 1 - result.width) / 2);
	result.baseline = BPrivate::centered_baseline(LabelMetrics(owner), frame.top + 1, frame.bottom);
	return result;
}

} // namespace


void
BTab::DrawLabel(BView* owner, BRect frame)
{
	if (Label()[0] == '\0')
		return;
	const PlacedLabel label = PlaceLabel(owner, Label(), frame);
	BPrivate::draw_label(owner, label.text.String(), BPoint(label.left, label.baseline), fEnabled);
}


void
BTab::DrawFocusMark(BView* owner, BRect frame)
{
	const PlacedLabel label = PlaceLabel(owner, Label(), frame);
	Look::DrawFocusLine(owner, label.left, label.left + label.width - 1, label.baseline);
}
