// The common formats between translators and programs.
#pragma once

#include <GraphicsDefs.h>
#include <Rect.h>
#include <SupportDefs.h>

enum TranslatorGroups {
	B_TRANSLATOR_BITMAP = 'bits',
	B_TRANSLATOR_PICTURE = 'pict',
	B_TRANSLATOR_TEXT = 'TEXT',
	B_TRANSLATOR_SOUND = 'nois',
	B_TRANSLATOR_MIDI = 'midi',
	B_TRANSLATOR_MEDIA = 'mhi!',
	B_TRANSLATOR_NONE = 'none',
	B_TRANSLATOR_ANY_TYPE = 0
};

// The beginning of the common format of images; all of it is big-endian, the rows follow.
struct TranslatorBitmap {
	uint32 magic; // B_TRANSLATOR_BITMAP
	BRect bounds;
	uint32 rowBytes;
	color_space colors;
	uint32 dataSize;
};

// Types of the formats that are exchanged most.
enum {
	B_BMP_FORMAT = 'BMP ',
	B_GIF_FORMAT = 'GIF ',
	B_JPEG_FORMAT = 'JPEG',
	B_PNG_FORMAT = 'PNG ',
	B_PPM_FORMAT = 'PPM ',
	B_TGA_FORMAT = 'TGA ',
	B_TIFF_FORMAT = 'TIFF',
	B_STYLED_TEXT_FORMAT = 'STXT',
};

// Names of fields in the message that goes along with a translation.
inline constexpr char B_TRANSLATOR_EXT_HEADER_ONLY[] = "/headerOnly"; // bool
inline constexpr char B_TRANSLATOR_EXT_DATA_ONLY[] = "/dataOnly"; // bool
inline constexpr char B_TRANSLATOR_EXT_COMMENT[] = "/comment"; // string
inline constexpr char B_TRANSLATOR_EXT_TIME[] = "/time"; // int64
inline constexpr char B_TRANSLATOR_EXT_FRAME[] = "/frame"; // int32
inline constexpr char B_TRANSLATOR_EXT_BITMAP_RECT[] = "bits/Rect"; // rect
inline constexpr char B_TRANSLATOR_EXT_BITMAP_COLOR_SPACE[] = "bits/space"; // int32
inline constexpr char B_TRANSLATOR_EXT_BITMAP_PALETTE[] = "bits/palette"; // raw
