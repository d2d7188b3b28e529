// Loaded images: the program, its libraries and its add-ons.
#pragma once

#include <OS.h>

typedef int32 image_id;

typedef enum { B_APP_IMAGE = 1, B_LIBRARY_IMAGE, B_ADD_ON_IMAGE, B_SYSTEM_IMAGE } image_type;

enum {
	B_SYMBOL_TYPE_DATA = 0x1,
	B_SYMBOL_TYPE_TEXT = 0x2,
	B_SYMBOL_TYPE_ANY = 0x5,
};

typedef struct {
	image_id id;
	image_type type;
	int32 sequence;
	char name[1024]; // the path
	void* text;
} image_info;

#ifdef __cplusplus
extern "C" {
#endif

// Each successful load must be undone by an unload; the image leaves the program with the last.
// The add-on's symbols are its own: they serve no other image.
image_id load_add_on(const char* path);
status_t unload_add_on(image_id image);
status_t get_image_symbol(image_id image, const char* name, int32 symbolType, void** _location);

// Walks all loaded images in load order. The cookie starts at 0.
status_t _get_next_image_info(team_id team, int32* cookie, image_info* info, size_t size);
status_t _get_image_info(image_id image, image_info* info, size_t size);
#define get_next_image_info(team, cookie, info)                                                    \
	_get_next_image_info((team), (cookie), (info), sizeof(*(info)))
#define get_image_info(image, info) _get_image_info((image), (info), sizeof(*(info)))

#ifdef __cplusplus
}
#endif
