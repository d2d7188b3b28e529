#include <GraphicsDefs.h>

#include <string.h>

#include <Errors.h>

const pattern B_SOLID_HIGH = { { 0xff, 0xff, 0xff, 0xff, 0xff, 0xff, 0xff, 0xff } };
const pattern B_MIXED_COLORS = { { 0xaa, 0x55, 0xaa, 0x55, 0xaa, 0x55, 0xaa, 0x55 } };
const pattern B_SOLID_LOW = { { 0, 0, 0, 0, 0, 0, 0, 0 } };

const rgb_color B_TRANSPARENT_COLOR = { 0x77, 0x74, 0x77, 0x00 };
const uint8 B_TRANSPARENT_MAGIC_CMAP8 = 0xff;
const uint16 B_TRANSPARENT_MAGIC_RGBA15 = 0x39ce;
const uint16 B_TRANSPARENT_MAGIC_RGBA15_BIG = 0xce39;
const uint32 B_TRANSPARENT_MAGIC_RGBA32 = 0x00777477;
const uint32 B_TRANSPARENT_MAGIC_RGBA32_BIG = 0x77747700;
const uint8 B_TRANSPARENT_8_BIT = 0xff;
const struct screen_id B_MAIN_SCREEN_ID = { 0 };


bool
operator==(const pattern& a, const pattern& b)
{
	return memcmp(a.data, b.data, sizeof(a.data)) == 0;
}


int32
rgb_color::Brightness() const
{
	// The usual weights of luminance, in 256ths.
	return (77 * red + 150 * green + 29 * blue) >> 8;
}


rgb_color
mix_color(rgb_color color1, rgb_color color2, uint8 amount)
{
	auto mix = [amount](uint8 from, uint8 to) {
		return (uint8)((from * (255 - amount) + to * amount + 127) / 255);
	};
	return make_color(mix(color1.red, color2.red), mix(color1.green, color2.green),
		mix(color1.blue, color2.blue), mix(color1.alpha, color2.alpha));
}


// #pragma mark - palette


namespace {

constexpr int kGrays = 32;
constexpr int kWhite = 63;


// Programs may count on these entries: 0 to 31 are the grays from 0 to 248 in steps of 8, 63 is
// white, 255 is transparent. The others spread over all colours in an order of this system's own:
// ten shades each of blue, red and green, then mixed colours in even steps.
class Palette : public color_map {
public:
	Palette();

private:
	void _Add(int red, int green, int blue);
	void _AddMixedColors();
	uint8 _Nearest(int red, int green, int blue) const;

	int fCount = 0;
};


Palette::Palette()
{
	id = 0;
	for (int i = 0; i < kGrays; i++)
		_Add(i * 8, i * 8, i * 8);
	for (int axis = 0; axis < 3; axis++) {
		for (int i = 0; i < 10; i++) {
			const int shade = 255 - i * 25;
			_Add(axis == 1 ? shade : 0, axis == 2 ? shade : 0, axis == 0 ? shade : 0);
		}
	}
	_AddMixedColors();
	color_list[B_TRANSPARENT_8_BIT] = B_TRANSPARENT_COLOR;

	for (int i = 0; i < 32768; i++) {
		auto component = [i](int shift) { return ((i >> shift) & 31) * 255 / 31; };
		index_map[i] = _Nearest(component(10), component(5), component(0));
	}
	for (int i = 0; i < 256; i++) {
		const rgb_color& color = color_list[i];
		inversion_map[i] = _Nearest(255 - color.red, 255 - color.green, 255 - color.blue);
	}
	inversion_map[B_TRANSPARENT_8_BIT] = B_TRANSPARENT_8_BIT;
}


void
Palette::_Add(int red, int green, int blue)
{
	if (fCount == kWhite)
		color_list[fCount++] = make_color(255, 255, 255);
	if (fCount < B_TRANSPARENT_8_BIT)
		color_list[fCount++] = make_color(red, green, blue);
}


void
Palette::_AddMixedColors()
{
	static constexpr int kLevels[] = { 255, 203, 152, 102, 51, 0 };

	for (int red : kLevels) {
		for (int green : kLevels) {
			for (int blue : kLevels) {
				const int zeros = (red == 0) + (green == 0) + (blue == 0);
				const bool gray = red == green && green == blue;
				if (!gray && zeros < 2)
					_Add(red, green, blue);
			}
		}
	}
	while (fCount < B_TRANSPARENT_8_BIT)
		_Add(0, 0, 0);
}


uint8
Palette::_Nearest(int red, int green, int blue) const
{
	int best = 0;
	int bestDistance = 1 << 30;
	for (int i = 0; i < B_TRANSPARENT_8_BIT; i++) {
		const int dr = color_list[i].red - red;
		const int dg = color_list[i].green - green;
		const int db = color_list[i].blue - blue;
		const int distance = dr * dr * 3 + dg * dg * 6 + db * db;
		if (distance < bestDistance) {
			best = i;
			bestDistance = distance;
		}
	}
	return best;
}

} // namespace


const color_map*
system_colors()
{
	static const Palette sPalette;
	return &sPalette;
}


// #pragma mark - colour spaces


namespace {

// Bytes of one pixel; 0 for B_GRAY1, whose bytes hold eight; -1 for a space without bitmaps.
int
BytesPerPixel(color_space space)
{
	switch (space) {
		case B_RGBA64:
		case B_RGBA64_BIG:
			return 8;
		case B_RGB48:
		case B_RGB48_BIG:
			return 6;
		case B_RGB32:
		case B_RGBA32:
		case B_RGB32_BIG:
		case B_RGBA32_BIG:
			return 4;
		case B_RGB24:
		case B_RGB24_BIG:
			return 3;
		case B_RGB16:
		case B_RGB15:
		case B_RGBA15:
		case B_RGB16_BIG:
		case B_RGB15_BIG:
		case B_RGBA15_BIG:
			return 2;
		case B_CMAP8:
		case B_GRAY8:
			return 1;
		case B_GRAY1:
			return 0;
		default:
			return -1;
	}
}

} // namespace


bool
bitmaps_support_space(color_space space, uint32* supportFlags)
{
	const bool supported = BytesPerPixel(space) >= 0;
	if (supportFlags != NULL) {
		*supportFlags =
			supported ? B_VIEWS_SUPPORT_DRAW_BITMAP | B_BITMAPS_SUPPORT_ATTACHED_VIEWS : 0;
	}
	return supported;
}


status_t
get_pixel_size_for(
	color_space space, size_t* pixelChunk, size_t* rowAlignment, size_t* pixelsPerChunk)
{
	const int bytes = BytesPerPixel(space);
	if (bytes < 0)
		return B_BAD_VALUE;

	if (pixelChunk != NULL)
		*pixelChunk = bytes == 0 ? 1 : bytes;
	if (rowAlignment != NULL)
		*rowAlignment = 4;
	if (pixelsPerChunk != NULL)
		*pixelsPerChunk = bytes == 0 ? 8 : 1;
	return B_OK;
}
