// What translations are described with.
#pragma once

#include <SupportDefs.h>

typedef unsigned long translator_id;

// A kind of data that a translator reads or writes.
struct translation_format {
	uint32 type; // 'PNG ' and so on; B_TRANSLATOR_BITMAP is the common one
	uint32 group; // B_TRANSLATOR_BITMAP for images
	float quality; // 0 to 1: how well the format keeps what matters
	float capability; // 0 to 1: how much of the format the translator knows
	char MIME[251];
	char name[251];
};

// What a translator found out about some data.
struct translator_info {
	uint32 type;
	translator_id translator;
	uint32 group;
	float quality;
	float capability;
	char name[251];
	char MIME[251];
};
