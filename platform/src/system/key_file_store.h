#ifndef PLATFORM_SRC_SYSTEM_KEY_FILE_STORE_H
#define PLATFORM_SRC_SYSTEM_KEY_FILE_STORE_H

#include <stdbool.h>

/* A folder of typed values, one file per key, shared by every process that opens the same folder.
   Preferences and vconf both sit on it. A file holds a type line and the value ("int\n42"); it is
   named after the escaped key and replaced atomically (temporary file + rename), so a reader in
   another process sees the old or the new value, never a mix, and watchers see one rename. */

typedef enum {
	KEY_FILE_TYPE_NONE = 0,
	KEY_FILE_TYPE_INT,
	KEY_FILE_TYPE_BOOL,
	KEY_FILE_TYPE_DOUBLE,
	KEY_FILE_TYPE_STRING,
} key_file_type_e;

typedef struct {
	key_file_type_e type;
	int i;    /* INT and BOOL (0 or 1) */
	double d; /* DOUBLE */
	char *s;  /* STRING, owned by the value */
} key_file_value_t;

/* The file name of a key: bytes outside [A-Za-z0-9_.-] and a leading '.' become "%XX", so names never
   start with '.' (kept for temporary files) nor hold '/'. Malloc'ed; NULL for an empty or too long key. */
char *key_file_escape(const char *key);

/* The key of a file name, malloc'ed; NULL for names that are not key files (temporary files, bad escapes). */
char *key_file_unescape(const char *name);

/* Creates the folder and its parents (mode 0700). 0 or -errno. */
int key_file_make_dirs(const char *dir);

/* Stores a value, replacing the file atomically. 0 or -errno (-EINVAL for a bad key); logs failures. */
int key_file_write(const char *dir, const char *key, const key_file_value_t *value);

/* Reads a value into *value (clear it with key_file_value_clear). 0, -ENOENT when absent, -EINVAL for a
   bad key, -EIO for an unreadable or malformed file (logged). */
int key_file_read(const char *dir, const char *key, key_file_value_t *value);

/* Deletes a key's file. 0, -ENOENT when absent, or -errno. */
int key_file_remove(const char *dir, const char *key);

/* Calls fn for each key in the folder until it returns false. 0 or -errno. */
int key_file_foreach(const char *dir, bool (*fn)(const char *key, void *data), void *data);

/* Frees the string of a value and resets it to KEY_FILE_TYPE_NONE. */
void key_file_value_clear(key_file_value_t *value);

/* The name written in files and shown by tools: "int", "bool", "double", "string". */
const char *key_file_type_name(key_file_type_e type);

#endif
