#ifndef PLATFORM_SRC_UI_EEXT_EVENTS_KEYS_H
#define PLATFORM_SRC_UI_EEXT_EVENTS_KEYS_H

#include <efl_extension_events.h>

/* The desktop keys that act as the hardware keys: NULL-terminated list of every key name to grab. */
const char *const *eext_key_names(void);

/* The key type of a key name; EINA_FALSE for a key that is neither back nor more. */
Eina_Bool eext_key_type_get(const char *keyname, Eext_Callback_Type *type);

#endif
