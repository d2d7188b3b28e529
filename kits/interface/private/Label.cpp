#include "interface/private/Label.h"

#include <cmath>

#include <View.h>

#include "interface/private/Look.h"

namespace BPrivate {


LabelMetrics::LabelMetrics(const BView* view)
{
	BFont font;
	view->GetFont(&font);
	font_height height;
	font.GetHeight(&height);
	ascent = std::ceil(height.ascent);
	descent = std::ceil(height.descent);
	textHeight = std::ceil(height.ascent + height.descent);
	lineHeight = std::ceil(height.ascent + height.descent + height.leading);
	size = font.Size();
}


float
label_width(const BView* view, const char* label)
{
	return label != nullptr ? std::ceil(view->StringWidth(label)) : 0;
}


float
centered_baseline(const LabelMetrics& metrics, float top, float bottom)
{
	// Capitals are about seven tenths of the font's size high.
	const float capHeight = std::round(metrics.size * 0.7f);
	return std::ceil((top + bottom + capHeight) / 2);
}


void
draw_label(BView* view, const char* label, BPoint baseline, bool enabled)
{
	if (label == nullptr)
		return;
	const rgb_color color = view->HighColor();
	if (!enabled)
		view->SetHighColor(tint_color(Look::BaseColor(view), B_DISABLED_LABEL_TINT));
	view->DrawString(label, baseline);
	if (!enabled)
		view->SetHighColor(color);
}

} // namespace BPrivate
