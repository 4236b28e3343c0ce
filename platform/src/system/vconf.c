/* vconf: typed keys of the device state, one file per key in the user's vconf folder. */
#define _GNU_SOURCE
#include <vconf.h>

#include <errno.h>
#include <stdlib.h>
#include <string.h>

#include <dlog.h>

#include "system/key_file_store.h"
#include "system/key_watch.h"
#include "system/vconf_store.h"

static int __set(const char *key, const key_file_value_t *value)
{
	if (!vconf_store_key_valid(key)) {
		LOGE("invalid key %s", key ? key : "(null)");
		return VCONF_ERROR;
	}
	char *dir = vconf_store_dir_n();
	if (!dir) {
		LOGE("no vconf folder (set TIZEN_VCONF_DIR or HOME)");
		return VCONF_ERROR;
	}
	int rc = key_file_write(dir, key, value);
	free(dir);
	return rc == 0 ? VCONF_OK : VCONF_ERROR;
}

/* Reads a key, falling back to its seeded default; the caller clears *value on VCONF_OK. */
static int __read(const char *key, key_file_value_t *value)
{
	memset(value, 0, sizeof(*value));
	if (!vconf_store_key_valid(key)) {
		LOGE("invalid key %s", key ? key : "(null)");
		return VCONF_ERROR;
	}
	char *dir = vconf_store_dir_n();
	if (!dir)
		return VCONF_ERROR;
	int rc = key_file_read(dir, key, value);
	free(dir);
	if (rc == -ENOENT && vconf_store_seed(key, value))
		rc = 0;
	return rc == 0 ? VCONF_OK : VCONF_ERROR;
}

static int __get(const char *key, key_file_type_e type, key_file_value_t *value)
{
	if (__read(key, value) != VCONF_OK)
		return VCONF_ERROR;
	if (value->type != type) {
		LOGE("%s holds type %s, not %s", key, key_file_type_name(value->type), key_file_type_name(type));
		key_file_value_clear(value);
		return VCONF_ERROR;
	}
	return VCONF_OK;
}

int vconf_set_int(const char *in_key, const int intval)
{
	key_file_value_t v = {.type = KEY_FILE_TYPE_INT, .i = intval};
	return __set(in_key, &v);
}

int vconf_set_bool(const char *in_key, const int boolval)
{
	key_file_value_t v = {.type = KEY_FILE_TYPE_BOOL, .i = boolval ? 1 : 0};
	return __set(in_key, &v);
}

int vconf_set_dbl(const char *in_key, const double dblval)
{
	key_file_value_t v = {.type = KEY_FILE_TYPE_DOUBLE, .d = dblval};
	return __set(in_key, &v);
}

int vconf_set_str(const char *in_key, const char *strval)
{
	if (!strval) {
		LOGE("value is NULL");
		return VCONF_ERROR;
	}
	key_file_value_t v = {.type = KEY_FILE_TYPE_STRING, .s = (char *)strval};
	return __set(in_key, &v);
}

int vconf_get_int(const char *in_key, int *intval)
{
	key_file_value_t v;
	if (!intval || __get(in_key, KEY_FILE_TYPE_INT, &v) != VCONF_OK)
		return VCONF_ERROR;
	*intval = v.i;
	return VCONF_OK;
}

int vconf_get_bool(const char *in_key, int *boolval)
{
	key_file_value_t v;
	if (!boolval || __get(in_key, KEY_FILE_TYPE_BOOL, &v) != VCONF_OK)
		return VCONF_ERROR;
	*boolval = v.i;
	return VCONF_OK;
}

int vconf_get_dbl(const char *in_key, double *dblval)
{
	key_file_value_t v;
	if (!dblval || __get(in_key, KEY_FILE_TYPE_DOUBLE, &v) != VCONF_OK)
		return VCONF_ERROR;
	*dblval = v.d;
	return VCONF_OK;
}

char *vconf_get_str(const char *in_key)
{
	key_file_value_t v;
	if (__get(in_key, KEY_FILE_TYPE_STRING, &v) != VCONF_OK)
		return NULL;
	return v.s; /* ownership passes to the caller */
}

int vconf_get_type(const char *in_key, int *type)
{
	key_file_value_t v;
	if (!type || __read(in_key, &v) != VCONF_OK)
		return VCONF_ERROR;
	switch (v.type) {
	case KEY_FILE_TYPE_INT:
		*type = VCONF_TYPE_INT;
		break;
	case KEY_FILE_TYPE_BOOL:
		*type = VCONF_TYPE_BOOL;
		break;
	case KEY_FILE_TYPE_DOUBLE:
		*type = VCONF_TYPE_DOUBLE;
		break;
	default:
		*type = VCONF_TYPE_STRING;
		break;
	}
	key_file_value_clear(&v);
	return VCONF_OK;
}

int vconf_unset(const char *in_key)
{
	if (!vconf_store_key_valid(in_key))
		return VCONF_ERROR;
	char *dir = vconf_store_dir_n();
	if (!dir)
		return VCONF_ERROR;
	int rc = key_file_remove(dir, in_key);
	free(dir);
	return rc == 0 ? VCONF_OK : VCONF_ERROR;
}

char *vconf_keynode_get_name(keynode_t *keynode)
{
	return keynode ? keynode->keyname : NULL;
}

int vconf_keynode_get_type(keynode_t *keynode)
{
	return keynode ? keynode->type : VCONF_ERROR;
}

int vconf_keynode_get_int(keynode_t *keynode)
{
	return keynode && keynode->type == VCONF_TYPE_INT ? keynode->value.i : VCONF_ERROR;
}

int vconf_keynode_get_bool(keynode_t *keynode)
{
	return keynode && keynode->type == VCONF_TYPE_BOOL ? keynode->value.b : VCONF_ERROR;
}

double vconf_keynode_get_dbl(keynode_t *keynode)
{
	return keynode && keynode->type == VCONF_TYPE_DOUBLE ? keynode->value.d : VCONF_ERROR;
}

char *vconf_keynode_get_str(keynode_t *keynode)
{
	return keynode && keynode->type == VCONF_TYPE_STRING ? keynode->value.s : NULL;
}

/* Fills a node from the stored value; false when the key cannot be read (removed again meanwhile). */
static bool __fillNode(const char *key, keynode_t *node, key_file_value_t *value)
{
	if (__read(key, value) != VCONF_OK)
		return false;
	memset(node, 0, sizeof(*node));
	node->keyname = (char *)key;
	switch (value->type) {
	case KEY_FILE_TYPE_INT:
		node->type = VCONF_TYPE_INT;
		node->value.i = value->i;
		break;
	case KEY_FILE_TYPE_BOOL:
		node->type = VCONF_TYPE_BOOL;
		node->value.b = value->i;
		break;
	case KEY_FILE_TYPE_DOUBLE:
		node->type = VCONF_TYPE_DOUBLE;
		node->value.d = value->d;
		break;
	default:
		node->type = VCONF_TYPE_STRING;
		node->value.s = value->s;
		break;
	}
	return true;
}

/* A fresh node per callback: a callback may keep nothing, nor spoil the next one's copy. Stops the
   dispatch when the key cannot be read (removed again meanwhile). */
static bool __deliverCb(key_watcher_t *watcher, const char *key)
{
	keynode_t node;
	key_file_value_t value;
	if (!__fillNode(key, &node, &value))
		return false;
	((vconf_callback_fn)watcher->cb)(&node, watcher->user_data);
	key_file_value_clear(&value);
	return true;
}

static key_watch_list_t __watches = {.deliver = __deliverCb};

int vconf_notify_key_changed(const char *in_key, vconf_callback_fn cb, void *user_data)
{
	if (!vconf_store_key_valid(in_key) || !cb) {
		LOGE("invalid key or callback");
		return VCONF_ERROR;
	}
	if (!key_watch_start(&__watches, vconf_store_dir_n))
		return VCONF_ERROR;
	return key_watch_add(&__watches, in_key, (key_watch_fn)cb, user_data) ? VCONF_OK : VCONF_ERROR;
}

int vconf_ignore_key_changed(const char *in_key, vconf_callback_fn cb)
{
	if (!in_key || !cb)
		return VCONF_ERROR;
	if (!key_watch_remove(&__watches, in_key, (key_watch_fn)cb)) {
		LOGE("no callback on %s", in_key);
		return VCONF_ERROR;
	}
	return VCONF_OK;
}
