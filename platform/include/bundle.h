#ifndef __BUNDLE_H__
#define __BUNDLE_H__

#include <stddef.h>
#include <tizen.h>

#ifdef __cplusplus
extern "C" {
#endif

typedef enum {
	BUNDLE_ERROR_NONE = TIZEN_ERROR_NONE,
	BUNDLE_ERROR_OUT_OF_MEMORY = TIZEN_ERROR_OUT_OF_MEMORY,
	BUNDLE_ERROR_INVALID_PARAMETER = TIZEN_ERROR_INVALID_PARAMETER,
	BUNDLE_ERROR_KEY_NOT_AVAILABLE = TIZEN_ERROR_KEY_NOT_AVAILABLE,
	BUNDLE_ERROR_KEY_EXISTS = TIZEN_ERROR_BUNDLE | 0x01,
} bundle_error_e;

typedef struct _bundle_t bundle;
typedef unsigned char bundle_raw;

#define BUNDLE_TYPE_NONE -1
#define BUNDLE_TYPE_ANY 0
#define BUNDLE_TYPE_ARRAY 0x0100
#define BUNDLE_TYPE_PRIMITIVE 0x0200
#define BUNDLE_TYPE_MEASURABLE 0x0400
#define BUNDLE_TYPE_STR (1 | BUNDLE_TYPE_MEASURABLE)
#define BUNDLE_TYPE_STR_ARRAY (BUNDLE_TYPE_STR | BUNDLE_TYPE_ARRAY | BUNDLE_TYPE_MEASURABLE)
#define BUNDLE_TYPE_BYTE 2
#define BUNDLE_TYPE_BYTE_ARRAY (BUNDLE_TYPE_BYTE | BUNDLE_TYPE_ARRAY)

typedef struct keyval_t bundle_keyval_t;

/* Called once per key in insertion order; kv lives for the call only. */
typedef void (*bundle_iterator_t)(const char *key, const int type, const bundle_keyval_t *kv, void *user_data);

/* A new empty bundle (caller frees with bundle_free), or NULL with get_last_result() set. */
bundle *bundle_create(void);
int bundle_free(bundle *b);
/* A deep copy, or NULL. */
bundle *bundle_dup(bundle *b_from);
/* Number of keys, 0 for NULL. */
int bundle_get_count(bundle *b);
/* BUNDLE_TYPE_* of the key, or BUNDLE_TYPE_NONE with get_last_result() set. */
int bundle_get_type(bundle *b, const char *key);
int bundle_del(bundle *b, const char *key);

/* Adders copy their arguments and refuse a present key with BUNDLE_ERROR_KEY_EXISTS. */
int bundle_add_str(bundle *b, const char *key, const char *str);
int bundle_add_str_array(bundle *b, const char *key, const char **str_array, const int len);
int bundle_add_byte(bundle *b, const char *key, const void *byte, const size_t size);
/* Legacy adder (same as bundle_add_str). */
int bundle_add(bundle *b, const char *key, const char *val);

/* Getters point INTO the bundle: valid until the key is deleted or the bundle freed. */
int bundle_get_str(bundle *b, const char *key, char **str);
const char **bundle_get_str_array(bundle *b, const char *key, int *len);
int bundle_get_byte(bundle *b, const char *key, void **byte, size_t *size);
/* Legacy getter: the string or NULL. */
const char *bundle_get_val(bundle *b, const char *key);

void bundle_foreach(bundle *b, bundle_iterator_t iter, void *user_data);
int bundle_keyval_get_type(bundle_keyval_t *kv);
int bundle_keyval_type_is_array(bundle_keyval_t *kv);
int bundle_keyval_get_basic_val(bundle_keyval_t *kv, void **val, size_t *size);
int bundle_keyval_get_array_val(bundle_keyval_t *kv, void ***array_val, unsigned int *array_len,
                                size_t **array_element_size);

/* Text form (base64 of a length-prefixed record list): *r is malloc'ed, free it with
   bundle_free_encoded_rawdata. bundle_decode returns a new bundle or NULL on malformed input. */
int bundle_encode(bundle *b, bundle_raw **r, int *len);
int bundle_free_encoded_rawdata(bundle_raw **r);
bundle *bundle_decode(const bundle_raw *r, const int len);

#ifdef __cplusplus
}
#endif

#endif /* __BUNDLE_H__ */
