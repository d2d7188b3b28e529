// BFont: which typeface, how large and how placed; it measures text.
#pragma once

#include <InterfaceDefs.h>
#include <Rect.h>

class BShape;
class BString;

const size_t B_FONT_FAMILY_LENGTH = 63;
const size_t B_FONT_STYLE_LENGTH = 63;

typedef char font_family[B_FONT_FAMILY_LENGTH + 1];
typedef char font_style[B_FONT_STYLE_LENGTH + 1];

enum { B_CHAR_SPACING = 0, B_STRING_SPACING, B_BITMAP_SPACING, B_FIXED_SPACING };

enum font_direction { B_FONT_LEFT_TO_RIGHT = 0, B_FONT_RIGHT_TO_LEFT };

enum { B_DISABLE_ANTIALIASING = 0x00000001, B_FORCE_ANTIALIASING = 0x00000002 };

enum : uint32 {
	B_TRUNCATE_END = 0,
	B_TRUNCATE_BEGINNING,
	B_TRUNCATE_MIDDLE,
	B_TRUNCATE_SMART,
	B_NO_TRUNCATION = 0xffffffff
};

enum {
	B_UNICODE_UTF8 = 0,
	B_ISO_8859_1,
	B_ISO_8859_2,
	B_ISO_8859_3,
	B_ISO_8859_4,
	B_ISO_8859_5,
	B_ISO_8859_6,
	B_ISO_8859_7,
	B_ISO_8859_8,
	B_ISO_8859_9,
	B_ISO_8859_10,
	B_MACINTOSH_ROMAN
};

// What get_font_family() and get_font_style() say of one.
enum { B_HAS_TUNED_FONT = 0x0001, B_IS_FIXED = 0x0002 };

enum {
	B_ITALIC_FACE = 0x0001,
	B_UNDERSCORE_FACE = 0x0002,
	B_NEGATIVE_FACE = 0x0004,
	B_OUTLINED_FACE = 0x0008,
	B_STRIKEOUT_FACE = 0x0010,
	B_BOLD_FACE = 0x0020,
	B_REGULAR_FACE = 0x0040,
	B_CONDENSED_FACE = 0x0080,
	B_LIGHT_FACE = 0x0100,
	B_HEAVY_FACE = 0x0200
};

enum font_metric_mode { B_SCREEN_METRIC = 0, B_PRINTING_METRIC = 1 };

enum font_file_format { B_TRUETYPE_WINDOWS = 0, B_POSTSCRIPT_TYPE1_WINDOWS = 1 };

struct edge_info {
	float left; // from the pen to the glyph's left edge, in ems
	float right; // from the glyph's right edge to the next pen place, in ems
};

struct font_height {
	float ascent; // all three are positive, in pixels
	float descent;
	float leading;
};

struct escapement_delta {
	float nonspace; // pixels added to each glyph that can be seen
	float space; // pixels added to each that cannot
};

struct tuned_font_info {
	float size;
	float shear;
	float rotation;
	uint32 flags;
	uint16 face;
};

// The 128 blocks of Unicode 3 that a font may cover.
class unicode_block {
public:
	unicode_block() : fData { 0, 0 } {}
	unicode_block(uint64 block2, uint64 block1) : fData { block1, block2 } {}

	bool Includes(const unicode_block& block) const;
	unicode_block operator&(const unicode_block& block) const;
	unicode_block operator|(const unicode_block& block) const;
	bool operator==(const unicode_block& block) const;
	bool operator!=(const unicode_block& block) const { return !(*this == block); }

private:
	uint64 fData[2];
};


// A small value; an ordinary copy is cheap. Sizes are in pixels per em. All measures are in
// pixels at scale 1, and do not depend on the screen. Text is UTF-8; bytes that are not are
// measured as replacement characters. Constant functions may be called from any thread.
class BFont {
public:
	BFont(); // as be_plain_font
	BFont(const BFont& font) = default;
	BFont(const BFont* font); // NULL gives the plain font

	// NULL or an empty style takes the family's first (its regular one, if it has that); a NULL
	// family stays as it is. B_NAME_NOT_FOUND leaves everything as it was.
	status_t SetFamilyAndStyle(const font_family family, const font_style style);
	void SetFamilyAndStyle(uint32 code);
	status_t SetFamilyAndFace(const font_family family, uint16 face);

	void SetSize(float size);
	void SetShear(float shear); // 45 to 135 degrees, 90 is upright
	void SetRotation(float rotation); // degrees against the clock
	// B_CHAR_SPACING gives each character its own width, whatever stands beside it: pairs are not
	// kerned. B_STRING_SPACING keeps the text as wide, but puts each character on the whole pixel
	// next to its place. B_BITMAP_SPACING gives each the width of its image on the screen; images
	// are made for places between pixels and for every scale, so it is that of the outline, too.
	// B_FIXED_SPACING gives all characters the width of a "W".
	void SetSpacing(uint8 spacing);
	void SetEncoding(uint8 encoding);
	void SetFace(uint16 face); // chooses the family's style that fits best
	void SetFlags(uint32 flags);
	void SetFalseBoldWidth(float width);

	void GetFamilyAndStyle(font_family* family, font_style* style) const;
	uint32 FamilyAndStyle() const;
	float Size() const { return fSize; }
	float Shear() const { return fShear; }
	float Rotation() const { return fRotation; }
	uint8 Spacing() const { return fSpacing; }
	uint8 Encoding() const { return fEncoding; }
	uint16 Face() const { return fFace; }
	uint32 Flags() const { return fFlags; }
	float FalseBoldWidth() const { return fFalseBoldWidth; }

	font_direction Direction() const;
	bool IsFixed() const;
	bool IsFullAndHalfFixed() const;
	BRect BoundingBox() const; // of all glyphs, for a size of 1
	unicode_block Blocks() const;
	font_file_format FileFormat() const;
	int32 CountTuned() const;
	void GetTunedInfo(int32 index, tuned_font_info* info) const;

	// Cuts the text to the width and marks the cut with an ellipsis; a text that fits stays.
	void TruncateString(BString* inOut, uint32 mode, float width) const;
	void GetTruncatedStrings(const char* stringArray[], int32 numStrings, uint32 mode, float width,
		BString resultArray[]) const;
	// Each result must have room for the text's bytes and 3 more, and the final zero.
	void GetTruncatedStrings(const char* stringArray[], int32 numStrings, uint32 mode, float width,
		char* resultArray[]) const;

	float StringWidth(const char* string) const;
	float StringWidth(const char* string, int32 length) const; // length in bytes
	void GetStringWidths(const char* stringArray[], const int32 lengthArray[], int32 numStrings,
		float widthArray[]) const;

	// Escapements are in ems: multiply them by Size(). numChars counts characters, not bytes, and
	// the arrays are in the text's order, also where letters run from the right. They are those of
	// the characters beside each other as given: together they are the width of that text as it is
	// measured and drawn, with the delta as it is drawn with that. Arabic letters that join differ
	// from lone ones; accents of such scripts take no room.
	void GetEscapements(const char charArray[], int32 numChars, float escapementArray[]) const;
	void GetEscapements(const char charArray[], int32 numChars, escapement_delta* delta,
		float escapementArray[]) const;
	void GetEscapements(const char charArray[], int32 numChars, escapement_delta* delta,
		BPoint escapementArray[]) const;
	void GetEscapements(const char charArray[], int32 numChars, escapement_delta* delta,
		BPoint escapementArray[], BPoint offsetArray[]) const;
	void GetEdges(const char charArray[], int32 numChars, edge_info edgeArray[]) const;
	void GetHeight(font_height* height) const;

	void GetBoundingBoxesAsGlyphs(const char charArray[], int32 numChars, font_metric_mode mode,
		BRect boundingBoxArray[]) const;
	void GetBoundingBoxesAsString(const char charArray[], int32 numChars, font_metric_mode mode,
		escapement_delta* delta, BRect boundingBoxArray[]) const;
	void GetBoundingBoxesForStrings(const char* stringArray[], int32 numStrings,
		font_metric_mode mode, escapement_delta deltas[], BRect boundingBoxArray[]) const;

	// The shapes stay the caller's; the pen is at (0, 0) and y grows downwards.
	void GetGlyphShapes(const char charArray[], int32 numChars, BShape* glyphShapeArray[]) const;
	void GetHasGlyphs(const char charArray[], int32 numChars, bool hasArray[]) const;

	BFont& operator=(const BFont& font) = default;
	bool operator==(const BFont& font) const;
	bool operator!=(const BFont& font) const { return !(*this == font); }
	void PrintToStream() const;

private:
	void _GetBoxes(const char charArray[], int32 numChars, font_metric_mode mode,
		escapement_delta* delta, bool asString, BRect boxes[]) const;

	uint32 fFamilyAndStyle; // the font engine's code; 0 is its plain font
	float fSize;
	float fShear;
	float fRotation;
	float fFalseBoldWidth;
	uint32 fFlags;
	uint16 fFace;
	uint8 fSpacing;
	uint8 fEncoding;
};

// They exist from the program's start on and never change.
extern _IMPORT const BFont* be_plain_font;
extern _IMPORT const BFont* be_bold_font;
extern _IMPORT const BFont* be_fixed_font;

// Families and styles are sorted by name. Index out of range: B_BAD_VALUE.
int32 count_font_families();
status_t get_font_family(int32 index, font_family* name, uint32* flags = NULL);
int32 count_font_styles(font_family name);
status_t get_font_style(font_family family, int32 index, font_style* name, uint32* flags = NULL);
status_t get_font_style(
	font_family family, int32 index, font_style* name, uint16* face, uint32* flags = NULL);
// Whether families have come or gone since the last call with checkOnly false.
bool update_font_families(bool checkOnly);
