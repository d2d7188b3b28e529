// The sound that says no.
#pragma once

#include <SupportDefs.h>

#ifdef __cplusplus
extern "C" {
#endif

status_t beep(void);
status_t system_beep(const char* eventName);
status_t add_system_beep_event(const char* eventName, uint32 flags);

#ifdef __cplusplus
}
#endif
