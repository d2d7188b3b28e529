#include "server/paint/FontList.h"

#include <algorithm>
#include <fontconfig/fontconfig.h>
#include <set>
#include <string.h>

namespace BPrivate {

namespace {

// The default fonts have the widths that the platform's panels were laid out for; the others
// stand in where those are not installed.
const char* const kPlainFamilies[] = { "Liberation Sans", "Arimo", "DejaVu Sans", nullptr };
const char* const kFixedFamilies[] = { "Liberation Mono", "Cousine", "DejaVu Sans Mono", nullptr };
const char* const kFallbackFamilies[] = { "Liberation Sans", "DejaVu Sans", "Noto Sans",
	"Noto Sans CJK SC", "WenQuanYi Micro Hei", "Droid Sans Fallback", "FreeSans", nullptr };


std::string
TextOf(FcPattern* pattern, const char* object)
{
	FcChar8* text = nullptr;
	if (FcPatternGetString(pattern, object, 0, &text) != FcResultMatch)
		return std::string();
	return reinterpret_cast<const char*>(text);
}


int
NumberOf(FcPattern* pattern, const char* object, int missing)
{
	int number = missing;
	return FcPatternGetInteger(pattern, object, 0, &number) == FcResultMatch ? number : missing;
}


uint16
FaceBits(FcPattern* pattern)
{
	uint16 face = 0;
	const int weight = NumberOf(pattern, FC_WEIGHT, FC_WEIGHT_REGULAR);
	if (weight >= FC_WEIGHT_DEMIBOLD)
		face |= B_BOLD_FACE;
	if (weight >= FC_WEIGHT_EXTRABOLD)
		face |= B_HEAVY_FACE;
	if (weight < FC_WEIGHT_BOOK)
		face |= B_LIGHT_FACE;
	if (NumberOf(pattern, FC_SLANT, FC_SLANT_ROMAN) != FC_SLANT_ROMAN)
		face |= B_ITALIC_FACE;
	if (NumberOf(pattern, FC_WIDTH, FC_WIDTH_NORMAL) < FC_WIDTH_NORMAL)
		face |= B_CONDENSED_FACE;
	return face == 0 ? (uint16)B_REGULAR_FACE : face;
}


std::unique_ptr<GlyphFace>
MakeFace(FcPattern* pattern)
{
	auto face = std::make_unique<GlyphFace>();
	face->family = TextOf(pattern, FC_FAMILY).substr(0, B_FONT_FAMILY_LENGTH);
	face->style = TextOf(pattern, FC_STYLE).substr(0, B_FONT_STYLE_LENGTH);
	face->file = TextOf(pattern, FC_FILE);
	face->index = NumberOf(pattern, FC_INDEX, 0);
	face->face = FaceBits(pattern);
	face->isFixed = NumberOf(pattern, FC_SPACING, FC_PROPORTIONAL) >= FC_MONO;
	FcCharSet* characters = nullptr;
	if (FcPatternGetCharSet(pattern, FC_CHARSET, 0, &characters) == FcResultMatch)
		face->characters = FcCharSetCopy(characters);
	const std::string format = TextOf(pattern, FC_FONTFORMAT);
	const bool usable = format == "TrueType" || format == "CFF";
	if (!usable || face->family.empty() || face->style.empty() || face->file.empty())
		return nullptr;
	return face;
}

} // namespace


FontList::FontList()
{
	_ReadInstalled();
	if (fOwned.empty()) {
		fOwned.push_back(std::make_unique<GlyphFace>());
		fOwned.back()->family = kPlainFamilies[0];
		fOwned.back()->style = "Regular";
		fOwned.back()->face = B_REGULAR_FACE;
	}
	_SortFamilies();
	_ChooseDefaults();
}


const FontFamily*
FontList::Find(const char* family) const
{
	const auto found = std::lower_bound(fFamilies.begin(), fFamilies.end(), family,
		[](const FontFamily& candidate, const char* name) { return candidate.name < name; });
	return found != fFamilies.end() && found->name == family ? &*found : nullptr;
}


GlyphFace&
FontList::FaceAt(uint32 code) const
{
	return *fFaces[code < fFaces.size() ? code : 0];
}


const GlyphFace*
FontList::FallbackFor(uint32 character) const
{
	for (const GlyphFace* face : fFallbacks) {
		if (face->Includes(character))
			return face;
	}
	return nullptr;
}


// #pragma mark - private


void
FontList::_ReadInstalled()
{
	FcConfig* config = FcInitLoadConfigAndFonts();
	if (config == nullptr)
		return;
	FcPattern* all = FcPatternBuild(
		nullptr, FC_SCALABLE, FcTypeBool, FcTrue, FC_VARIABLE, FcTypeBool, FcFalse, nullptr);
	FcObjectSet* objects = FcObjectSetBuild(FC_FAMILY, FC_STYLE, FC_FILE, FC_INDEX, FC_WEIGHT,
		FC_SLANT, FC_WIDTH, FC_SPACING, FC_CHARSET, FC_FONTFORMAT, nullptr);
	FcFontSet* fonts = FcFontList(config, all, objects);
	std::set<std::pair<std::string, std::string>> seen;
	for (int i = 0; fonts != nullptr && i < fonts->nfont; i++) {
		std::unique_ptr<GlyphFace> face = MakeFace(fonts->fonts[i]);
		if (face != nullptr && seen.insert({ face->family, face->style }).second)
			fOwned.push_back(std::move(face));
	}
	if (fonts != nullptr)
		FcFontSetDestroy(fonts);
	FcObjectSetDestroy(objects);
	FcPatternDestroy(all);
	FcConfigDestroy(config);
}


void
FontList::_SortFamilies()
{
	std::sort(fOwned.begin(), fOwned.end(), [](const auto& a, const auto& b) {
		return std::tie(a->family, a->style) < std::tie(b->family, b->style);
	});
	for (const std::unique_ptr<GlyphFace>& face : fOwned) {
		if (fFamilies.empty() || fFamilies.back().name != face->family) {
			fFamilies.emplace_back();
			fFamilies.back().name = face->family;
			fFamilies.back().isFixed = true;
		}
		fFamilies.back().styles.push_back(face.get());
		fFamilies.back().isFixed &= face->isFixed;
	}
}


void
FontList::_ChooseDefaults()
{
	GlyphFace* defaults[] = { _Choose(kPlainFamilies, B_REGULAR_FACE),
		_Choose(kPlainFamilies, B_BOLD_FACE), _Choose(kFixedFamilies, B_REGULAR_FACE) };
	fFaces.assign(std::begin(defaults), std::end(defaults));
	for (const std::unique_ptr<GlyphFace>& face : fOwned)
		face->code = UINT32_MAX;
	for (uint32 code = fFaces.size(); code > 0; code--)
		fFaces[code - 1]->code = code - 1;
	for (const std::unique_ptr<GlyphFace>& face : fOwned) {
		if (face->code != UINT32_MAX)
			continue;
		face->code = fFaces.size();
		fFaces.push_back(face.get());
	}

	for (const char* const* name = kFallbackFamilies; *name != nullptr; name++) {
		const FontFamily* family = Find(*name);
		for (size_t i = 0; family != nullptr && i < family->styles.size(); i++) {
			if (family->styles[i]->face == B_REGULAR_FACE)
				fFallbacks.push_back(family->styles[i]);
		}
	}
	for (const std::unique_ptr<GlyphFace>& face : fOwned) {
		if (face->face == B_REGULAR_FACE)
			fFallbacks.push_back(face.get());
	}
}


// The first family that has such a face; else any family's, else any face.
GlyphFace*
FontList::_Choose(const char* const* families, uint16 face) const
{
	for (; *families != nullptr; families++) {
		const FontFamily* family = Find(*families);
		for (size_t i = 0; family != nullptr && i < family->styles.size(); i++) {
			if (family->styles[i]->face == face)
				return family->styles[i];
		}
	}
	for (const std::unique_ptr<GlyphFace>& candidate : fOwned) {
		if (candidate->face == face)
			return candidate.get();
	}
	return fOwned.front().get();
}


} // namespace BPrivate
