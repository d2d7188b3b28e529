#include "interface/private/StandInView.h"

#include <cmath>

#include <Message.h>

#include "interface/private/Look.h"
#include "interface/private/ViewArchive.h"

namespace BPrivate {


StandInView::StandInView(BMessage* archive) : BView(archive)
{
	fClass = archive->GetString("class", "");
	force_flags(this, B_WILL_DRAW | B_FULL_UPDATE_ON_RESIZE);
}


void
StandInView::Draw(BRect updateRect)
{
	const BRect bounds = Bounds();
	const rgb_color base = Look::BaseColor(this);
	SetHighColor(tint_color(base, B_DARKEN_3_TINT));
	SetLowColor(base);
	StrokeRect(bounds, B_MIXED_COLORS);

	BFont font(be_plain_font);
	SetFont(&font);
	font_height height;
	font.GetHeight(&height);
	const float width = StringWidth(fClass.c_str());
	const float left = std::floor((bounds.left + bounds.right - width) / 2);
	const float baseline =
		std::floor((bounds.top + bounds.bottom + height.ascent - height.descent) / 2);
	SetHighColor(Look::TextColor());
	DrawString(fClass.c_str(), BPoint(std::max(left, bounds.left + 3), baseline));
}


} // namespace BPrivate
