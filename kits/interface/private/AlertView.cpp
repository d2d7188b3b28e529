#include "interface/private/AlertView.h"

#include <cmath>

#include <Font.h>
#include <Message.h>

#include "interface/private/Look.h"
#include "interface/private/ViewArchive.h"

namespace BPrivate {

namespace {

constexpr float kStripeWidth = 30;
const BPoint kIconPlace(18, 6);
constexpr float kIconSize = 32; // pixels

constexpr rgb_color kBlack = { 0, 0, 0, 255 };
constexpr rgb_color kWhite = { 255, 255, 255, 255 };
constexpr rgb_color kBlue = { 51, 102, 204, 255 };
constexpr rgb_color kYellow = { 255, 203, 0, 255 };
constexpr rgb_color kRed = { 204, 34, 34, 255 };


void
DrawSign(BView* view, BRect icon, const char* sign, rgb_color color, float below)
{
	BFont font(be_bold_font);
	font.SetSize(22);
	view->PushState();
	view->SetFont(&font);
	view->SetHighColor(color);
	const float left = (icon.left + icon.right + 1 - font.StringWidth(sign)) / 2;
	view->DrawString(sign, BPoint(std::floor(left + 0.5f), icon.bottom - below));
	view->PopState();
}


void
DrawDisc(BView* view, BRect icon, rgb_color color)
{
	view->SetHighColor(color);
	view->FillEllipse(icon);
	view->SetHighColor(tint_color(color, B_DARKEN_4_TINT));
	view->StrokeEllipse(icon);
}


void
DrawWarning(BView* view, BRect icon)
{
	const BPoint top(std::floor((icon.left + icon.right) / 2), icon.top);
	view->SetHighColor(kYellow);
	view->FillTriangle(top, icon.LeftBottom(), icon.RightBottom());
	view->SetHighColor(kBlack);
	view->StrokeTriangle(top, icon.LeftBottom(), icon.RightBottom());
	DrawSign(view, icon, "!", kBlack, 4);
}


void
DrawBulb(BView* view, BRect icon)
{
	BRect glass = icon;
	glass.InsetBy(5, 0);
	glass.bottom = glass.top + glass.Width();
	BRect socket(glass.left + 6, glass.bottom - 1, glass.right - 6, icon.bottom);
	view->SetHighColor(tint_color(Look::PanelColor(), B_DARKEN_2_TINT));
	view->FillRect(socket);
	view->SetHighColor(tint_color(Look::PanelColor(), B_DARKEN_4_TINT));
	for (float y = socket.top + 3; y <= socket.bottom; y += 3)
		view->StrokeLine(BPoint(socket.left, y), BPoint(socket.right, y));
	view->StrokeRect(socket);
	DrawDisc(view, glass, kYellow);
}

} // namespace


AlertView::AlertView(BRect frame, alert_type type) :
	BView(frame, "_master_", B_FOLLOW_ALL, B_WILL_DRAW), fType(type)
{
	SetViewColor(Look::PanelColor());
	SetLowColor(Look::PanelColor());
}


AlertView::AlertView(BMessage* archive) : BView(archive), fType(B_EMPTY_ALERT)
{
	int32 type;
	if (archive->FindInt32("_atype", &type) == B_OK)
		fType = static_cast<alert_type>(type);
}


BArchivable*
AlertView::Instantiate(BMessage* archive)
{
	return validate_instantiation(archive, "BPrivate::AlertView") ? new AlertView(archive)
																  : nullptr;
}


status_t
AlertView::Archive(BMessage* archive, bool deep) const
{
	const status_t status = BView::Archive(archive, deep);
	if (status != B_OK)
		return status;
	ArchiveWriter writer(archive);
	writer.Int32("_atype", fType, B_EMPTY_ALERT);
	return writer.Status();
}


void
AlertView::Draw(BRect updateRect)
{
	if (fType == B_EMPTY_ALERT)
		return;

	BRect stripe = Bounds();
	stripe.right = stripe.left + kStripeWidth - 1;
	SetHighColor(tint_color(ViewColor(), B_DARKEN_1_TINT));
	FillRect(stripe);

	const BRect icon(kIconPlace, kIconPlace + BPoint(kIconSize - 1, kIconSize - 1));
	switch (fType) {
		case B_INFO_ALERT:
			DrawDisc(this, icon, kBlue);
			DrawSign(this, icon, "i", kWhite, 8);
			break;
		case B_IDEA_ALERT:
			DrawBulb(this, icon);
			break;
		case B_WARNING_ALERT:
			DrawWarning(this, icon);
			break;
		case B_STOP_ALERT:
			DrawDisc(this, icon, kRed);
			DrawSign(this, icon, "!", kWhite, 8);
			break;
		default:
			break;
	}
}

} // namespace BPrivate
