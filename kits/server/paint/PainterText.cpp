#include <algorithm>
#include <math.h>
#include <optional>

#include "server/paint/FontEngine.h"
#include "server/paint/PaintTask.h"
#include "server/paint/Painter.h"
#include "server/paint/PathPainter.h"

namespace BPrivate {

namespace {

// One text on its way to the surface. The baseline is the line between two rows of pixels: letters
// without descenders end in the row above the given coordinate.
class TextTask {
public:
	TextTask(PaintTask& task, const FontSpec& font, BPoint start) :
		fTask(task), fFont(font), fStart(start),
		fUpright(font.rotation == 0 && font.shear == 90 && (font.face & B_OUTLINED_FACE) == 0)
	{
	}

	void Draw(const GlyphRun& run, float nonspace, float space);
	float Advance() const { return fAdvance; }

private:
	bool _DrawImage(const PlacedGlyph& glyph, float x);
	void _AddOutline(PathPainter& path, const PlacedGlyph& glyph, float x) const;
	void _DrawLines();

	PaintTask& fTask;
	const FontSpec& fFont; // its size is in logical pixels of the surface
	BPoint fStart; // logical pixels of the surface
	bool fUpright;
	float fAdvance = 0;
};


void
TextTask::Draw(const GlyphRun& run, float nonspace, float space)
{
	std::optional<PathPainter> outlines;
	float extra = 0;
	for (const PlacedGlyph& glyph : run.glyphs) {
		const float x = glyph.x + extra;
		if (!fUpright || !_DrawImage(glyph, x)) {
			if (!outlines)
				outlines.emplace(fTask);
			_AddOutline(*outlines, glyph, x);
		}
		extra += glyph.isSpace ? space : nonspace;
	}
	fAdvance = run.width + extra;
	if (outlines) {
		if ((fFont.face & B_OUTLINED_FACE) != 0)
			outlines->Stroke();
		else
			outlines->Fill();
	}
	if ((fFont.face & (B_UNDERSCORE_FACE | B_STRIKEOUT_FACE)) != 0)
		_DrawLines();
}


bool
TextTask::_DrawImage(const PlacedGlyph& glyph, float x)
{
	const float scale = fTask.Target().Scale();
	const double pen = ((double)fStart.x + x) * scale;
	const int32 quarters = PaintTask::Round(pen * FontEngine::kPhases);
	const int32 phase = quarters & (FontEngine::kPhases - 1);
	const GlyphImage* image;
	if (!FontEngine::Get().GetImage(
			glyph, fFont.size * scale, phase, (fFont.flags & B_DISABLE_ANTIALIASING) == 0, &image))
		return false;
	if (image == nullptr)
		return true;

	const int32 left = (quarters - phase) / FontEngine::kPhases + image->left;
	const int32 top = fTask.Target().DeviceEdge(PaintTask::Round(fStart.y)) + image->top;
	const clipping_rect rect = { left, top, left + image->width - 1, top + image->height - 1 };
	fTask.Output().FillMask(rect, image->coverage, image->width);
	fTask.AddDamage(Intersect(rect, fTask.Output().Bounds()));
	return true;
}


// A path's points name centres of pixels, a glyph's the lines between them: hence the halves.
void
TextTask::_AddOutline(PathPainter& path, const PlacedGlyph& glyph, float x) const
{
	const float angle = fFont.rotation * (float)M_PI / 180;
	const float slant = 1 / tanf(std::clamp(fFont.shear, 45.0f, 135.0f) * (float)M_PI / 180);
	const float cosine = cosf(angle);
	const float sine = sinf(angle);
	PathData outline = FontEngine::Get().Outline(glyph);
	for (BPoint& point : outline.points) {
		const float along = x + (point.x - point.y * slant) * fFont.size;
		const float down = point.y * fFont.size;
		point.Set(fStart.x + along * cosine + down * sine - 0.5f,
			fStart.y - along * sine + down * cosine - 0.5f);
	}
	path.AddPath(outline);
}


void
TextTask::_DrawLines()
{
	const int32 left = PaintTask::Round(fStart.x);
	const int32 right = PaintTask::Round(fStart.x + fAdvance) - 1;
	const int32 baseline = PaintTask::Round(fStart.y);
	const int32 thickness = std::max(1, PaintTask::Round(fFont.size / 16));
	if ((fFont.face & B_UNDERSCORE_FACE) != 0)
		fTask.FillLogical({ left, baseline + 1, right, baseline + thickness });
	if ((fFont.face & B_STRIKEOUT_FACE) != 0) {
		const int32 top = baseline - PaintTask::Round(fFont.size * 0.3f);
		fTask.FillLogical({ left, top, right, top + thickness - 1 });
	}
}

} // namespace


BPoint
Painter::DrawString(std::string_view text, BPoint baseline, float nonspace, float space)
{
	PaintTask task(*this, B_SOLID_HIGH);
	FontSpec font = task.State().font;
	font.size = task.State().Transform(font.size);
	const std::shared_ptr<const GlyphRun> run = FontEngine::Get().Run(font, text);

	TextTask textTask(task, font, task.ToSurface(baseline));
	textTask.Draw(*run, task.State().Transform(nonspace), task.State().Transform(space));

	const float scale = task.State().combinedScale;
	const float width = scale != 0 ? textTask.Advance() / scale : 0;
	const float angle = font.rotation * (float)M_PI / 180;
	if (font.rotation == 0)
		return BPoint(baseline.x + width, baseline.y);
	return BPoint(baseline.x + width * cosf(angle), baseline.y - width * sinf(angle));
}


} // namespace BPrivate
