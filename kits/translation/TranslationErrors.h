// Errors of translations.
#pragma once

#include <Errors.h>

enum {
	B_TRANSLATION_BASE_ERROR = B_TRANSLATION_ERROR_BASE,
	B_NO_TRANSLATOR = B_TRANSLATION_BASE_ERROR, // nobody knows the data, or the wanted format
	B_ILLEGAL_DATA // it looked like known data, but is damaged
};
