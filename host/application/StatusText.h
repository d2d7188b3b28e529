// What a status code means, in words for the user.
#pragma once

#include <SupportDefs.h>


// Never NULL; the text stays. It goes behind a colon and has no full stop.
const char* StatusText(status_t status);
