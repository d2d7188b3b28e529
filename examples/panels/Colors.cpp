// Swatches, a colour control and a text in several looks.

#include "Panels.h"

#include <Box.h>
#include <Button.h>
#include <ColorControl.h>
#include <Font.h>
#include <Message.h>
#include <StringView.h>

namespace {


constexpr rgb_color kSwatches[] = { { 198, 62, 48, 255 }, { 226, 140, 40, 255 },
	{ 236, 200, 70, 255 }, { 96, 160, 72, 255 }, { 52, 120, 176, 255 }, { 112, 80, 160, 255 },
	{ 90, 70, 54, 255 }, { 40, 44, 52, 255 } };


BView*
MakeSwatches()
{
	BBox* box = new BBox(BRect(12, 12, 327, 76), "palette");
	box->SetLabel("Palette");
	float left = 12;
	for (const rgb_color& color : kSwatches) {
		BView* swatch = new BView(
			BRect(left, 20, left + 31, 51), "swatch", B_FOLLOW_LEFT | B_FOLLOW_TOP, B_WILL_DRAW);
		swatch->SetViewColor(color);
		box->AddChild(swatch);
		left += 37;
	}
	return box;
}


BStringView*
MakeLine(float top, const char* name, const char* text, float size, rgb_color color)
{
	BStringView* line = new BStringView(BRect(12, top, 327, top + size + 8), name, text);
	BFont font(be_plain_font);
	font.SetSize(size);
	line->SetFont(&font);
	line->SetHighColor(color);
	return line;
}


} // namespace


BView*
MakeColorPanel()
{
	BView* panel = MakePanel(BRect(0, 0, 339, 269), "colours");
	panel->AddChild(MakeSwatches());
	BColorControl* control =
		new BColorControl(BPoint(12, 88), B_CELLS_32x8, 6, "colour", new BMessage('colr'));
	control->SetValue(kSwatches[4]);
	panel->AddChild(control);
	panel->AddChild(MakeLine(158, "large", "The quick brown fox", 24, kSwatches[4]));
	panel->AddChild(MakeLine(194, "small", "jumps over the lazy dog", 12, kSwatches[0]));
	panel->AddChild(new BButton(BRect(248, 234, 327, 257), "apply", "Apply", new BMessage('aply'),
		B_FOLLOW_RIGHT | B_FOLLOW_BOTTOM));
	return panel;
}
