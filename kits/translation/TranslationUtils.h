// BTranslationUtils: bitmaps from files, resources and streams in one call.
#pragma once

#include <SupportDefs.h>

class BBitmap;
class BPositionIO;
class BTranslatorRoster;
struct entry_ref;


// Bitmaps are the caller's; NULL when there is no such data or it is no image. Without a roster
// the default one is asked. Any thread.
class BTranslationUtils {
public:
	// A file of that name; else the application's resource of the type 'bits' with it.
	static BBitmap* GetBitmap(const char* name, BTranslatorRoster* roster = NULL);
	// Resources of the application.
	static BBitmap* GetBitmap(uint32 type, int32 id, BTranslatorRoster* roster = NULL);
	static BBitmap* GetBitmap(uint32 type, const char* name, BTranslatorRoster* roster = NULL);

	static BBitmap* GetBitmapFile(const char* path, BTranslatorRoster* roster = NULL);
	static BBitmap* GetBitmap(const entry_ref* ref, BTranslatorRoster* roster = NULL);
	static BBitmap* GetBitmap(BPositionIO* stream, BTranslatorRoster* roster = NULL);
};
