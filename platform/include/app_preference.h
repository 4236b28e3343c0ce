#ifndef __TIZEN_APPFW_PREFERENCE_H__
#define __TIZEN_APPFW_PREFERENCE_H__

#include <tizen.h>

#ifdef __cplusplus
extern "C" {
#endif

typedef enum {
	PREFERENCE_ERROR_NONE = TIZEN_ERROR_NONE,
	PREFERENCE_ERROR_INVALID_PARAMETER = TIZEN_ERROR_INVALID_PARAMETER,
	PREFERENCE_ERROR_OUT_OF_MEMORY = TIZEN_ERROR_OUT_OF_MEMORY,
	PREFERENCE_ERROR_NO_KEY = TIZEN_ERROR_APPLICATION | 0x30,
	PREFERENCE_ERROR_IO_ERROR = TIZEN_ERROR_IO_ERROR,
} preference_error_e;

typedef void (*preference_changed_cb)(const char *key, void *user_data);
typedef bool (*preference_item_cb)(const char *key, void *user_data);

/* The package's preference store: one typed value per key, shared by every process of the package
   (files under "<data path>.pref/"). Every call returns PREFERENCE_ERROR_INVALID_PARAMETER on a null
   argument, and the setters replace a value of another type. */
int preference_set_int(const char *key, int value);
int preference_set_double(const char *key, double value);
int preference_set_string(const char *key, const char *value);
int preference_set_boolean(const char *key, bool value);

/* Getters: PREFERENCE_ERROR_NO_KEY when absent, PREFERENCE_ERROR_INVALID_PARAMETER when the key holds
   another type. preference_get_string's result is malloc'ed; the caller frees it. */
int preference_get_int(const char *key, int *value);
int preference_get_double(const char *key, double *value);
int preference_get_string(const char *key, char **value);
int preference_get_boolean(const char *key, bool *value);

/* Removes one key (PREFERENCE_ERROR_NO_KEY when absent) or all of them. */
int preference_remove(const char *key);
int preference_remove_all(void);

int preference_is_existing(const char *key, bool *existing);

/* Calls callback for each stored key until it returns false. */
int preference_foreach_item(preference_item_cb callback, void *user_data);

/* One callback per key (a second call replaces it), called on the Ecore main loop whenever this or any
   other process of the package sets the key, even to the same value. Removing the key calls nothing;
   the callback stays for when it is set again. PREFERENCE_ERROR_NO_KEY if the key does not exist yet. */
int preference_set_changed_cb(const char *key, preference_changed_cb callback, void *user_data);
int preference_unset_changed_cb(const char *key);

#ifdef __cplusplus
}
#endif

#endif
