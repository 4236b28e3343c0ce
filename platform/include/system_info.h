#ifndef __TIZEN_SYSTEM_SYSTEM_INFO_H__
#define __TIZEN_SYSTEM_SYSTEM_INFO_H__

#include <stdbool.h>
#include <tizen.h>

#ifdef __cplusplus
extern "C" {
#endif

typedef enum {
	SYSTEM_INFO_ERROR_NONE = TIZEN_ERROR_NONE,
	SYSTEM_INFO_ERROR_INVALID_PARAMETER = TIZEN_ERROR_INVALID_PARAMETER,
	SYSTEM_INFO_ERROR_OUT_OF_MEMORY = TIZEN_ERROR_OUT_OF_MEMORY,
	SYSTEM_INFO_ERROR_IO_ERROR = TIZEN_ERROR_IO_ERROR,
	SYSTEM_INFO_ERROR_PERMISSION_DENIED = TIZEN_ERROR_PERMISSION_DENIED,
} system_info_error_e;

/* Platform features of the device, e.g. "http://tizen.org/feature/screen.width". The desktop reports a
   720x1280 phone at 320 dpi running "2.4.0"; TIZEN_SYSTEM_INFO_<NAME> overrides one value, the name being
   the key after its last '/', upper-cased, '.' as '_' (TIZEN_SYSTEM_INFO_SCREEN_WIDTH=1080).
   An unknown key, a key of another type or a null argument gives SYSTEM_INFO_ERROR_INVALID_PARAMETER.
   Strings are malloc'ed; the caller frees them. */
int system_info_get_platform_int(const char *key, int *value);
int system_info_get_platform_bool(const char *key, bool *value);
int system_info_get_platform_double(const char *key, double *value);
int system_info_get_platform_string(const char *key, char **value);

#ifdef __cplusplus
}
#endif

#endif
