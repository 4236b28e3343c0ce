#ifndef __VCONF_H__
#define __VCONF_H__

#include "vconf-keys.h"

#ifdef __cplusplus
extern "C" {
#endif

/* Results of every vconf call. */
#define VCONF_OK 0
#define VCONF_ERROR -1

enum vconf_t {
	VCONF_TYPE_NONE = 0,
	VCONF_TYPE_STRING = 40,
	VCONF_TYPE_INT = 41,
	VCONF_TYPE_DOUBLE = 42,
	VCONF_TYPE_BOOL = 43,
	VCONF_TYPE_DIR
};

/* One key and its value, handed to change callbacks; valid only during the callback. */
typedef struct _keynode_t {
	char *keyname;
	int type;
	union {
		int i;
		int b;
		double d;
		char *s;
	} value;
	struct _keynode_t *next;
} keynode_t;

typedef void (*vconf_callback_fn)(keynode_t *node, void *user_data);

/* Keynode accessors: the name, the type (enum vconf_t), and the value; -1 (NULL for strings)
   on a null node or a different type. The string belongs to the node. */
char *vconf_keynode_get_name(keynode_t *keynode);
int vconf_keynode_get_type(keynode_t *keynode);
int vconf_keynode_get_int(keynode_t *keynode);
int vconf_keynode_get_bool(keynode_t *keynode);
double vconf_keynode_get_dbl(keynode_t *keynode);
char *vconf_keynode_get_str(keynode_t *keynode);

/* Setters: store the value (any earlier type is replaced) atomically, visible to every process of the
   user at once; watchers are notified even when the value is unchanged. Keys start with "db/",
   "file/" or "memory/". VCONF_OK or VCONF_ERROR (logged). */
int vconf_set_int(const char *in_key, const int intval);
int vconf_set_bool(const char *in_key, const int boolval);
int vconf_set_dbl(const char *in_key, const double dblval);
int vconf_set_str(const char *in_key, const char *strval);

/* Getters: VCONF_ERROR on a null argument, a missing key or a key of another type. A few keys the
   device always has read as their default while unset (language, region format, call state ...). */
int vconf_get_int(const char *in_key, int *intval);
int vconf_get_bool(const char *in_key, int *boolval);
int vconf_get_dbl(const char *in_key, double *dblval);
/* The string value, malloc'ed (caller frees), or NULL. */
char *vconf_get_str(const char *in_key);

/* The type of a stored key (enum vconf_t) in *type; VCONF_ERROR when absent. */
int vconf_get_type(const char *in_key, int *type);

/* Removes a key; watchers are not called. VCONF_ERROR if it did not exist. */
int vconf_unset(const char *in_key);

/* Calls cb on the Ecore main loop whenever any process sets the key (the key need not exist yet).
   The node passed is fresh for each call. Needs the Ecore main loop. */
int vconf_notify_key_changed(const char *in_key, vconf_callback_fn cb, void *user_data);
/* Removes every registration of cb on the key; VCONF_ERROR if there was none. */
int vconf_ignore_key_changed(const char *in_key, vconf_callback_fn cb);

#ifdef __cplusplus
}
#endif

#endif
