// The measures of a one-line label, as all controls take them.
#pragma once

#include <Font.h>
#include <Rect.h>

class BView;

namespace BPrivate {


// The font of a view in whole pixels.
struct LabelMetrics {
	explicit LabelMetrics(const BView* view);

	float ascent; // rounded up
	float descent; // rounded up
	float textHeight; // ascent + descent, rounded up together
	float lineHeight; // with the leading
	float size; // of the font
};

// The width of the label in the view's font, rounded up; 0 for NULL.
float label_width(const BView* view, const char* label);

// The baseline that centres capital letters between two lines.
float centered_baseline(const LabelMetrics& metrics, float top, float bottom);

// In the view's high colour, or grey.
void draw_label(BView* view, const char* label, BPoint baseline, bool enabled);

} // namespace BPrivate
