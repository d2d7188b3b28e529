// What drawing is described with: colours, patterns, modes, colour spaces.
#pragma once

#include <SupportDefs.h>

typedef struct pattern {
	uint8 data[8]; // a byte a row, from the top; the highest bit is the leftmost pixel
} pattern;

extern _IMPORT const pattern B_SOLID_HIGH;
extern _IMPORT const pattern B_MIXED_COLORS;
extern _IMPORT const pattern B_SOLID_LOW;

bool operator==(const pattern& a, const pattern& b);
inline bool
operator!=(const pattern& a, const pattern& b)
{
	return !(a == b);
}

typedef struct rgb_color {
	uint8 red;
	uint8 green;
	uint8 blue;
	uint8 alpha;

	rgb_color& set_to(uint8 r, uint8 g, uint8 b, uint8 a = 255)
	{
		red = r;
		green = g;
		blue = b;
		alpha = a;
		return *this;
	}

	bool operator==(const rgb_color& other) const
	{
		return red == other.red && green == other.green && blue == other.blue
			&& alpha == other.alpha;
	}
	bool operator!=(const rgb_color& other) const { return !(*this == other); }

	// 0 is black, 255 is white.
	int32 Brightness() const;
} rgb_color;

inline rgb_color
make_color(uint8 red, uint8 green, uint8 blue, uint8 alpha = 255)
{
	rgb_color color = { red, green, blue, alpha };
	return color;
}

// amount 0 gives the first colour, 255 the second.
rgb_color mix_color(rgb_color color1, rgb_color color2, uint8 amount);

extern _IMPORT const rgb_color B_TRANSPARENT_COLOR; // as view colour: paint no background

#define B_TRANSPARENT_32_BIT B_TRANSPARENT_COLOR
extern _IMPORT const uint8 B_TRANSPARENT_MAGIC_CMAP8;
extern _IMPORT const uint16 B_TRANSPARENT_MAGIC_RGBA15;
extern _IMPORT const uint16 B_TRANSPARENT_MAGIC_RGBA15_BIG;
extern _IMPORT const uint32 B_TRANSPARENT_MAGIC_RGBA32;
extern _IMPORT const uint32 B_TRANSPARENT_MAGIC_RGBA32_BIG;
extern _IMPORT const uint8 B_TRANSPARENT_8_BIT;

struct screen_id {
	int32 id;
};
extern _IMPORT const struct screen_id B_MAIN_SCREEN_ID;

// The palette of eight-bit colours and the ways into it.
typedef struct color_map {
	int32 id;
	rgb_color color_list[256];
	uint8 inversion_map[256]; // index of the inverse of each colour
	uint8 index_map[32768]; // index of the nearest colour by five bits each of red, green, blue
} color_map;

// The system's palette; never NULL, the same for the program's life. B_TRANSPARENT_8_BIT is its
// transparent entry.
const color_map* system_colors();

// Any number may come from outside, so the type has all of them.
enum color_space : uint32 {
	B_NO_COLOR_SPACE = 0x0000,

	// Linear spaces, little-endian; in memory blue comes first.
	B_RGB32 = 0x0008,
	B_RGBA32 = 0x2008,
	B_RGB24 = 0x0003,
	B_RGB16 = 0x0005,
	B_RGB15 = 0x0010,
	B_RGBA15 = 0x2010,
	B_RGB48 = 0x0011,
	B_RGBA64 = 0x2012,
	B_RGB30 = 0x0009,
	B_CMAP8 = 0x0004,
	B_GRAY8 = 0x0002,
	B_GRAY1 = 0x0001,

	B_RGB32_BIG = 0x1008,
	B_RGBA32_BIG = 0x3008,
	B_RGB24_BIG = 0x1003,
	B_RGB16_BIG = 0x1005,
	B_RGB15_BIG = 0x1010,
	B_RGBA15_BIG = 0x3010,
	B_RGB48_BIG = 0x1011,
	B_RGBA64_BIG = 0x3012,
	B_RGB30_BIG = 0x1009,

	B_RGB32_LITTLE = B_RGB32,
	B_RGBA32_LITTLE = B_RGBA32,
	B_RGB24_LITTLE = B_RGB24,
	B_RGB16_LITTLE = B_RGB16,
	B_RGB15_LITTLE = B_RGB15,
	B_RGBA15_LITTLE = B_RGBA15,
	B_RGB48_LITTLE = B_RGB48,
	B_RGBA64_LITTLE = B_RGBA64,
	B_RGB30_LITTLE = B_RGB30,

	// Video and print spaces: names for data from elsewhere; bitmaps cannot be made of them.
	B_YCbCr422 = 0x4000,
	B_YCbCr411 = 0x4001,
	B_YCbCr444 = 0x4003,
	B_YCbCr420 = 0x4004,
	B_YUV422 = 0x4020,
	B_YUV411 = 0x4021,
	B_YUV444 = 0x4023,
	B_YUV420 = 0x4024,
	B_YUV9 = 0x402c,
	B_YUV12 = 0x402d,
	B_UVL24 = 0x4030,
	B_UVL32 = 0x4031,
	B_UVLA32 = 0x6031,
	B_LAB24 = 0x4032,
	B_LAB32 = 0x4033,
	B_LABA32 = 0x6033,
	B_HSI24 = 0x4040,
	B_HSI32 = 0x4041,
	B_HSIA32 = 0x6041,
	B_HSV24 = 0x4042,
	B_HSV32 = 0x4043,
	B_HSVA32 = 0x6043,
	B_HLS24 = 0x4044,
	B_HLS32 = 0x4045,
	B_HLSA32 = 0x6045,
	B_CMY24 = 0xc001,
	B_CMY32 = 0xc002,
	B_CMYA32 = 0xe002,
	B_CMYK32 = 0xc003,

	B_MONOCHROME_1_BIT = B_GRAY1,
	B_GRAYSCALE_8_BIT = B_GRAY8,
	B_COLOR_8_BIT = B_CMAP8,
	B_RGB_32_BIT = B_RGB32,
	B_RGB_16_BIT = B_RGB15,
	B_BIG_RGB_32_BIT = B_RGB32_BIG,
	B_BIG_RGB_16_BIT = B_RGB15_BIG
};

// What bitmaps_support_space() answers through its second argument.
enum { B_VIEWS_SUPPORT_DRAW_BITMAP = 0x1, B_BITMAPS_SUPPORT_ATTACHED_VIEWS = 0x2 };

// Whether bitmaps of the space can be made; *supportFlags, when given, is set either way.
bool bitmaps_support_space(color_space space, uint32* supportFlags);
// Bytes of a chunk, bytes a row must be a multiple of, and pixels in a chunk; any may be NULL.
status_t get_pixel_size_for(
	color_space space, size_t* pixelChunk, size_t* rowAlignment, size_t* pixelsPerChunk);

enum buffer_orientation { B_BUFFER_TOP_TO_BOTTOM, B_BUFFER_BOTTOM_TO_TOP };
enum buffer_layout { B_BUFFER_NONINTERLEAVED = 1 };

enum drawing_mode : uint32 {
	B_OP_COPY,
	B_OP_OVER,
	B_OP_ERASE,
	B_OP_INVERT,
	B_OP_ADD,
	B_OP_SUBTRACT,
	B_OP_BLEND,
	B_OP_MIN,
	B_OP_MAX,
	B_OP_SELECT,
	B_OP_ALPHA
};

enum source_alpha : uint32 { B_PIXEL_ALPHA = 0, B_CONSTANT_ALPHA };

enum alpha_function : uint32 {
	B_ALPHA_OVERLAY = 0,
	B_ALPHA_COMPOSITE,
	B_ALPHA_COMPOSITE_SOURCE_OVER = B_ALPHA_COMPOSITE,
	B_ALPHA_COMPOSITE_SOURCE_IN,
	B_ALPHA_COMPOSITE_SOURCE_OUT,
	B_ALPHA_COMPOSITE_SOURCE_ATOP,
	B_ALPHA_COMPOSITE_DESTINATION_OVER,
	B_ALPHA_COMPOSITE_DESTINATION_IN,
	B_ALPHA_COMPOSITE_DESTINATION_OUT,
	B_ALPHA_COMPOSITE_DESTINATION_ATOP,
	B_ALPHA_COMPOSITE_XOR,
	B_ALPHA_COMPOSITE_CLEAR,
	B_ALPHA_COMPOSITE_DIFFERENCE,
	B_ALPHA_COMPOSITE_LIGHTEN,
	B_ALPHA_COMPOSITE_DARKEN
};

enum { B_FILTER_BITMAP_BILINEAR = 0x00000100, B_WAIT_FOR_RETRACE = 0x00000800 };

enum { B_TILE_BITMAP_X = 0x00000001, B_TILE_BITMAP_Y = 0x00000002, B_TILE_BITMAP = 0x00000003 };

enum {
	B_OVERLAY_FILTER_HORIZONTAL = 0x00010000,
	B_OVERLAY_FILTER_VERTICAL = 0x00020000,
	B_OVERLAY_MIRROR = 0x00040000,
	B_OVERLAY_TRANSFER_CHANNEL = 0x00080000
};

enum join_mode : uint32 {
	B_ROUND_JOIN = 0,
	B_MITER_JOIN,
	B_BEVEL_JOIN,
	B_BUTT_JOIN,
	B_SQUARE_JOIN
};

enum cap_mode : uint32 {
	B_ROUND_CAP = B_ROUND_JOIN,
	B_BUTT_CAP = B_BUTT_JOIN,
	B_SQUARE_CAP = B_SQUARE_JOIN
};

const float B_DEFAULT_MITER_LIMIT = 10.0f;

enum { B_EVEN_ODD = 0, B_NONZERO };
