/* bundle: an ordered map of typed values (string, string array, bytes) with a text encoding. */
#include <bundle.h>

#include "bundle_codec.h"

#include <dlog.h>
#include <stdint.h>
#include <stdlib.h>
#include <string.h>

struct keyval_t {
	char *key;
	int type;
	unsigned int count; /* number of elements (1 for scalars) */
	void **values;      /* each element, NUL-terminated for strings */
	size_t *sizes;      /* byte size of each element (strings include the NUL) */
};

struct _bundle_t {
	struct keyval_t **items;
	int count;
	int capacity;
};

static void keyval_free(struct keyval_t *kv)
{
	if (!kv)
		return;
	for (unsigned int i = 0; i < kv->count; i++)
		free(kv->values[i]);
	free(kv->values);
	free(kv->sizes);
	free(kv->key);
	free(kv);
}

/* A new keyval holding copies of count elements; NULL on allocation failure. */
static struct keyval_t *keyval_new(const char *key, int type, unsigned int count, const void *const *values,
                                   const size_t *sizes)
{
	struct keyval_t *kv = calloc(1, sizeof(*kv));
	if (!kv)
		return NULL;
	kv->key = strdup(key);
	kv->type = type;
	kv->values = calloc(count ? count : 1, sizeof(void *));
	kv->sizes = calloc(count ? count : 1, sizeof(size_t));
	if (!kv->key || !kv->values || !kv->sizes) {
		keyval_free(kv);
		return NULL;
	}
	for (unsigned int i = 0; i < count; i++) {
		/* One spare byte keeps byte values NUL-terminated too. */
		kv->values[i] = malloc(sizes[i] + 1);
		if (!kv->values[i]) {
			kv->count = i;
			keyval_free(kv);
			return NULL;
		}
		if (sizes[i])
			memcpy(kv->values[i], values[i], sizes[i]);
		((char *)kv->values[i])[sizes[i]] = '\0';
		kv->sizes[i] = sizes[i];
	}
	kv->count = count;
	return kv;
}

static int find_index(bundle *b, const char *key)
{
	for (int i = 0; i < b->count; i++)
		if (!strcmp(b->items[i]->key, key))
			return i;
	return -1;
}

static struct keyval_t *find(bundle *b, const char *key)
{
	int i = find_index(b, key);
	return i < 0 ? NULL : b->items[i];
}

static int append(bundle *b, struct keyval_t *kv)
{
	if (!kv)
		return BUNDLE_ERROR_OUT_OF_MEMORY;
	if (b->count == b->capacity) {
		int cap = b->capacity ? b->capacity * 2 : 8;
		struct keyval_t **items = realloc(b->items, cap * sizeof(*items));
		if (!items) {
			keyval_free(kv);
			return BUNDLE_ERROR_OUT_OF_MEMORY;
		}
		b->items = items;
		b->capacity = cap;
	}
	b->items[b->count++] = kv;
	return BUNDLE_ERROR_NONE;
}

/* Common checks and insertion of every adder. */
static int add_values(bundle *b, const char *key, int type, unsigned int count, const void *const *values,
                      const size_t *sizes)
{
	if (!b || !key || !*key)
		return BUNDLE_ERROR_INVALID_PARAMETER;
	if (find(b, key))
		return BUNDLE_ERROR_KEY_EXISTS;
	return append(b, keyval_new(key, type, count, values, sizes));
}

bundle *bundle_create(void)
{
	return calloc(1, sizeof(bundle));
}

int bundle_free(bundle *b)
{
	if (!b)
		return BUNDLE_ERROR_INVALID_PARAMETER;
	for (int i = 0; i < b->count; i++)
		keyval_free(b->items[i]);
	free(b->items);
	free(b);
	return BUNDLE_ERROR_NONE;
}

bundle *bundle_dup(bundle *b_from)
{
	if (!b_from)
		return NULL;
	bundle *b = bundle_create();
	if (!b)
		return NULL;
	for (int i = 0; i < b_from->count; i++) {
		struct keyval_t *kv = b_from->items[i];
		if (append(b, keyval_new(kv->key, kv->type, kv->count, (const void *const *)kv->values, kv->sizes))) {
			bundle_free(b);
			return NULL;
		}
	}
	return b;
}

int bundle_get_count(bundle *b)
{
	return b ? b->count : 0;
}

int bundle_get_type(bundle *b, const char *key)
{
	if (!b || !key)
		return BUNDLE_TYPE_NONE;
	struct keyval_t *kv = find(b, key);
	return kv ? kv->type : BUNDLE_TYPE_NONE;
}

int bundle_del(bundle *b, const char *key)
{
	if (!b || !key)
		return BUNDLE_ERROR_INVALID_PARAMETER;
	int i = find_index(b, key);
	if (i < 0)
		return BUNDLE_ERROR_KEY_NOT_AVAILABLE;
	keyval_free(b->items[i]);
	memmove(b->items + i, b->items + i + 1, (b->count - i - 1) * sizeof(*b->items));
	b->count--;
	return BUNDLE_ERROR_NONE;
}

int bundle_add_str(bundle *b, const char *key, const char *str)
{
	if (!str)
		return BUNDLE_ERROR_INVALID_PARAMETER;
	const void *values[1] = {str};
	size_t sizes[1] = {strlen(str) + 1};
	return add_values(b, key, BUNDLE_TYPE_STR, 1, values, sizes);
}

int bundle_add(bundle *b, const char *key, const char *val)
{
	return bundle_add_str(b, key, val);
}

int bundle_add_str_array(bundle *b, const char *key, const char **str_array, const int len)
{
	if (len < 0 || (len > 0 && !str_array))
		return BUNDLE_ERROR_INVALID_PARAMETER;
	size_t *sizes = calloc(len ? len : 1, sizeof(size_t));
	if (!sizes)
		return BUNDLE_ERROR_OUT_OF_MEMORY;
	/* A NULL element is kept as an empty string. */
	const void **values = calloc(len ? len : 1, sizeof(void *));
	if (!values) {
		free(sizes);
		return BUNDLE_ERROR_OUT_OF_MEMORY;
	}
	for (int i = 0; i < len; i++) {
		values[i] = str_array[i] ? str_array[i] : "";
		sizes[i] = strlen(values[i]) + 1;
	}
	int ret = add_values(b, key, BUNDLE_TYPE_STR_ARRAY, len, values, sizes);
	free(values);
	free(sizes);
	return ret;
}

int bundle_add_byte(bundle *b, const char *key, const void *byte, const size_t size)
{
	if (!byte && size)
		return BUNDLE_ERROR_INVALID_PARAMETER;
	const void *values[1] = {byte ? byte : ""};
	size_t sizes[1] = {size};
	return add_values(b, key, BUNDLE_TYPE_BYTE, 1, values, sizes);
}

/* The keyval of key if it has the given type; the error otherwise. */
static int lookup(bundle *b, const char *key, int type, struct keyval_t **out)
{
	if (!b || !key)
		return BUNDLE_ERROR_INVALID_PARAMETER;
	struct keyval_t *kv = find(b, key);
	if (!kv)
		return BUNDLE_ERROR_KEY_NOT_AVAILABLE;
	if (kv->type != type)
		return BUNDLE_ERROR_INVALID_PARAMETER;
	*out = kv;
	return BUNDLE_ERROR_NONE;
}

int bundle_get_str(bundle *b, const char *key, char **str)
{
	if (!str)
		return BUNDLE_ERROR_INVALID_PARAMETER;
	struct keyval_t *kv = NULL;
	int ret = lookup(b, key, BUNDLE_TYPE_STR, &kv);
	*str = ret ? NULL : (char *)kv->values[0];
	return ret;
}

const char *bundle_get_val(bundle *b, const char *key)
{
	char *s = NULL;
	bundle_get_str(b, key, &s);
	return s;
}

const char **bundle_get_str_array(bundle *b, const char *key, int *len)
{
	struct keyval_t *kv = NULL;
	if (len)
		*len = 0;
	if (lookup(b, key, BUNDLE_TYPE_STR_ARRAY, &kv))
		return NULL;
	if (len)
		*len = (int)kv->count;
	return (const char **)kv->values;
}

int bundle_get_byte(bundle *b, const char *key, void **byte, size_t *size)
{
	if (!byte)
		return BUNDLE_ERROR_INVALID_PARAMETER;
	struct keyval_t *kv = NULL;
	int ret = lookup(b, key, BUNDLE_TYPE_BYTE, &kv);
	*byte = ret ? NULL : kv->values[0];
	if (size)
		*size = ret ? 0 : kv->sizes[0];
	return ret;
}

void bundle_foreach(bundle *b, bundle_iterator_t iter, void *user_data)
{
	if (!b || !iter)
		return;
	/* Iterate over a snapshot of the count: callbacks must not change the bundle. */
	for (int i = 0; i < b->count; i++)
		iter(b->items[i]->key, b->items[i]->type, b->items[i], user_data);
}

int bundle_keyval_get_type(bundle_keyval_t *kv)
{
	return kv ? kv->type : BUNDLE_TYPE_NONE;
}

int bundle_keyval_type_is_array(bundle_keyval_t *kv)
{
	if (!kv)
		return -1;
	return (kv->type & BUNDLE_TYPE_ARRAY) ? 1 : 0;
}

int bundle_keyval_get_basic_val(bundle_keyval_t *kv, void **val, size_t *size)
{
	if (!kv || !val || (kv->type & BUNDLE_TYPE_ARRAY))
		return BUNDLE_ERROR_INVALID_PARAMETER;
	*val = kv->values[0];
	if (size)
		*size = kv->sizes[0];
	return BUNDLE_ERROR_NONE;
}

int bundle_keyval_get_array_val(bundle_keyval_t *kv, void ***array_val, unsigned int *array_len,
                                size_t **array_element_size)
{
	if (!kv || !array_val || !(kv->type & BUNDLE_TYPE_ARRAY))
		return BUNDLE_ERROR_INVALID_PARAMETER;
	*array_val = kv->values;
	if (array_len)
		*array_len = kv->count;
	if (array_element_size)
		*array_element_size = kv->sizes;
	return BUNDLE_ERROR_NONE;
}

/* ---- encoding: records "type, key, element count, elements", each length-prefixed, then base64 ---- */

int bundle_encode(bundle *b, bundle_raw **r, int *len)
{
	if (!b || !r || !len)
		return BUNDLE_ERROR_INVALID_PARAMETER;
	bundle_writer_s w;
	bundle_writer_init(&w);
	bundle_writer_u32(&w, BUNDLE_CODEC_MAGIC);
	bundle_writer_u32(&w, (uint32_t)b->count);
	for (int i = 0; i < b->count; i++) {
		struct keyval_t *kv = b->items[i];
		bundle_writer_u32(&w, (uint32_t)kv->type);
		bundle_writer_blob(&w, kv->key, strlen(kv->key));
		bundle_writer_u32(&w, kv->count);
		for (unsigned int j = 0; j < kv->count; j++)
			bundle_writer_blob(&w, kv->values[j], kv->sizes[j]);
	}
	char *text = w.failed ? NULL : bundle_base64_encode(w.data, w.size);
	free(w.data);
	if (!text) {
		LOGE("out of memory encoding a bundle");
		return BUNDLE_ERROR_OUT_OF_MEMORY;
	}
	*r = (bundle_raw *)text;
	*len = (int)strlen(text);
	return BUNDLE_ERROR_NONE;
}

int bundle_free_encoded_rawdata(bundle_raw **r)
{
	if (!r || !*r)
		return BUNDLE_ERROR_INVALID_PARAMETER;
	free(*r);
	*r = NULL;
	return BUNDLE_ERROR_NONE;
}

/* Bounds of a decoded bundle: text from another process never makes us allocate or search without end
   (keys are looked up one by one, so their number is what a hostile sender would inflate). */
#define DECODE_MAX_KEYS 1024
#define DECODE_MAX_KEY_LEN 1024
#define DECODE_MAX_ELEMENTS 65536

/* Reads one keyval record; false on malformed input. */
static bool decode_record(bundle_reader_s *rd, bundle *b)
{
	uint32_t type = 0, count = 0;
	const void *key = NULL;
	size_t key_len = 0;
	if (!bundle_reader_u32(rd, &type) || !bundle_reader_blob(rd, &key, &key_len) || !bundle_reader_u32(rd, &count))
		return false;
	if (key_len == 0 || memchr(key, '\0', key_len) || count > rd->size)
		return false;
	if (key_len > DECODE_MAX_KEY_LEN || count > DECODE_MAX_ELEMENTS) {
		LOGE("bundle record refused: key of %zu bytes, %u elements", key_len, count);
		return false;
	}
	bool scalar = type == BUNDLE_TYPE_STR || type == BUNDLE_TYPE_BYTE;
	bool array = type == BUNDLE_TYPE_STR_ARRAY || type == (uint32_t)BUNDLE_TYPE_BYTE_ARRAY;
	if (!(scalar && count == 1) && !array)
		return false;
	char *key_str = strndup(key, key_len);
	const void **values = calloc(count ? count : 1, sizeof(void *));
	size_t *sizes = calloc(count ? count : 1, sizeof(size_t));
	bool ok = key_str && values && sizes;
	for (uint32_t i = 0; ok && i < count; i++)
		ok = bundle_reader_blob(rd, &values[i], &sizes[i]);
	if (ok)
		ok = add_values(b, key_str, (int)type, count, values, sizes) == BUNDLE_ERROR_NONE;
	free(key_str);
	free(values);
	free(sizes);
	return ok;
}

bundle *bundle_decode(const bundle_raw *r, const int len)
{
	if (!r || len <= 0)
		return NULL;
	size_t size = 0;
	unsigned char *data = bundle_base64_decode((const char *)r, (size_t)len, &size);
	if (!data) {
		LOGE("bundle text is not valid base64");
		return NULL;
	}
	bundle_reader_s rd = {data, size, 0};
	uint32_t magic = 0, count = 0;
	bundle *b = bundle_create();
	bool ok = b && bundle_reader_u32(&rd, &magic) && magic == BUNDLE_CODEC_MAGIC && bundle_reader_u32(&rd, &count);
	if (ok && count > DECODE_MAX_KEYS) {
		LOGE("bundle of %u keys refused (at most %d)", count, DECODE_MAX_KEYS);
		ok = false;
	}
	for (uint32_t i = 0; ok && i < count; i++)
		ok = decode_record(&rd, b);
	if (ok && rd.pos != rd.size)
		ok = false; /* bytes behind the last record: not one of our bundles */
	free(data);
	if (!ok) {
		LOGE("malformed bundle text (%d bytes)", len);
		bundle_free(b);
		return NULL;
	}
	return b;
}
