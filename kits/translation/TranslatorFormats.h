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
