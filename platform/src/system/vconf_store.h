#ifndef PLATFORM_SRC_SYSTEM_VCONF_STORE_H
#define PLATFORM_SRC_SYSTEM_VCONF_STORE_H

#include "system/key_file_store.h"

/* The vconf folder of the user: "$TIZEN_VCONF_DIR", else "$XDG_CONFIG_HOME/tizen-platform/vconf/"
   (XDG_CONFIG_HOME defaulting to "$HOME/.config"). Malloc'ed, ends in "/"; NULL without a home. */
char *vconf_store_dir_n(void);

/* The value a key reads as while unset (device state every phone has), into *value; false for
   keys without one. */
bool vconf_store_seed(const char *key, key_file_value_t *value);

/* Whether a key has one of the prefixes vconf accepts: "db/", "file/", "memory/". */
bool vconf_store_key_valid(const char *key);

#endif
