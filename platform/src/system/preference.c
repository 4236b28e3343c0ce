/* The package's preference store: typed key files under "<data path>.pref/". */
#define _GNU_SOURCE
#include <app_preference.h>

#include <errno.h>
#include <stdlib.h>
#include <string.h>

#include <app_common.h>
#include <dlog.h>

#include "system/key_file_store.h"
#include "system/key_watch.h"

/* "<data path>.pref/", malloc'ed; NULL (logged) when the data path is unknown. */
static char *__prefDirN(void)
{
	char *data = app_get_data_path();
	if (!data) {
		LOGE("no data path");
		return NULL;
	}
	size_t len = strlen(data);
	char *dir = malloc(len + sizeof(".pref/"));
	if (dir) {
		memcpy(dir, data, len);
		strcpy(dir + len, ".pref/");
	}
	free(data);
	return dir;
}

static int __errorOf(int rc)
{
	switch (rc) {
	case 0:
		return PREFERENCE_ERROR_NONE;
	case -ENOENT:
		return PREFERENCE_ERROR_NO_KEY;
	case -EINVAL:
		return PREFERENCE_ERROR_INVALID_PARAMETER;
	case -ENOMEM:
		return PREFERENCE_ERROR_OUT_OF_MEMORY;
	default:
		return PREFERENCE_ERROR_IO_ERROR;
	}
}

static int __set(const char *key, const key_file_value_t *value)
{
	if (!key || !key[0]) {
		LOGE("invalid key");
		return PREFERENCE_ERROR_INVALID_PARAMETER;
	}
	char *dir = __prefDirN();
	if (!dir)
		return PREFERENCE_ERROR_IO_ERROR;
	int rc = key_file_write(dir, key, value);
	free(dir);
	return __errorOf(rc);
}

/* Reads key expecting the given type into *value; `out` is the caller's result, which must not be
   NULL. The caller clears *value on success. */
static int __get(const char *key, key_file_type_e type, const void *out, key_file_value_t *value)
{
	if (!out)
		return PREFERENCE_ERROR_INVALID_PARAMETER;
	if (!key || !key[0]) {
		LOGE("invalid key");
		return PREFERENCE_ERROR_INVALID_PARAMETER;
	}
	char *dir = __prefDirN();
	if (!dir)
		return PREFERENCE_ERROR_IO_ERROR;
	int rc = key_file_read(dir, key, value);
	free(dir);
	if (rc != 0)
		return __errorOf(rc);
	if (value->type != type) {
		LOGE("%s holds type %s, not %s", key, key_file_type_name(value->type), key_file_type_name(type));
		key_file_value_clear(value);
		return PREFERENCE_ERROR_INVALID_PARAMETER;
	}
	return PREFERENCE_ERROR_NONE;
}

int preference_set_int(const char *key, int value)
{
	key_file_value_t v = {.type = KEY_FILE_TYPE_INT, .i = value};
	return __set(key, &v);
}

int preference_set_double(const char *key, double value)
{
	key_file_value_t v = {.type = KEY_FILE_TYPE_DOUBLE, .d = value};
	return __set(key, &v);
}

int preference_set_string(const char *key, const char *value)
{
	if (!value) {
		LOGE("value is NULL");
		return PREFERENCE_ERROR_INVALID_PARAMETER;
	}
	key_file_value_t v = {.type = KEY_FILE_TYPE_STRING, .s = (char *)value};
	return __set(key, &v);
}

int preference_set_boolean(const char *key, bool value)
{
	key_file_value_t v = {.type = KEY_FILE_TYPE_BOOL, .i = value ? 1 : 0};
	return __set(key, &v);
}

int preference_get_int(const char *key, int *value)
{
	key_file_value_t v;
	int rc = __get(key, KEY_FILE_TYPE_INT, value, &v);
	if (rc == PREFERENCE_ERROR_NONE)
		*value = v.i;
	return rc;
}

int preference_get_double(const char *key, double *value)
{
	key_file_value_t v;
	int rc = __get(key, KEY_FILE_TYPE_DOUBLE, value, &v);
	if (rc == PREFERENCE_ERROR_NONE)
		*value = v.d;
	return rc;
}

int preference_get_string(const char *key, char **value)
{
	key_file_value_t v;
	int rc = __get(key, KEY_FILE_TYPE_STRING, value, &v);
	if (rc == PREFERENCE_ERROR_NONE)
		*value = v.s; /* ownership passes to the caller */
	return rc;
}

int preference_get_boolean(const char *key, bool *value)
{
	key_file_value_t v;
	int rc = __get(key, KEY_FILE_TYPE_BOOL, value, &v);
	if (rc == PREFERENCE_ERROR_NONE)
		*value = v.i != 0;
	return rc;
}

int preference_remove(const char *key)
{
	if (!key || !key[0])
		return PREFERENCE_ERROR_INVALID_PARAMETER;
	char *dir = __prefDirN();
	if (!dir)
		return PREFERENCE_ERROR_IO_ERROR;
	int rc = key_file_remove(dir, key);
	free(dir);
	return __errorOf(rc);
}

typedef struct {
	const char *dir;
	int rc;
} remove_all_ctx_t;

static bool __removeOneCb(const char *key, void *data)
{
	remove_all_ctx_t *ctx = data;
	int rc = key_file_remove(ctx->dir, key);
	if (rc != 0 && rc != -ENOENT) {
		LOGE("cannot remove %s: %s", key, strerror(-rc));
		ctx->rc = rc;
	}
	return true;
}

int preference_remove_all(void)
{
	char *dir = __prefDirN();
	if (!dir)
		return PREFERENCE_ERROR_IO_ERROR;
	remove_all_ctx_t ctx = {dir, 0};
	int rc = key_file_foreach(dir, __removeOneCb, &ctx);
	free(dir);
	return __errorOf(rc != 0 ? rc : ctx.rc);
}

int preference_is_existing(const char *key, bool *existing)
{
	if (!existing || !key || !key[0])
		return PREFERENCE_ERROR_INVALID_PARAMETER;
	char *dir = __prefDirN();
	if (!dir)
		return PREFERENCE_ERROR_IO_ERROR;
	key_file_value_t v;
	int rc = key_file_read(dir, key, &v);
	free(dir);
	key_file_value_clear(&v);
	if (rc != 0 && rc != -ENOENT)
		return __errorOf(rc);
	*existing = rc == 0;
	return PREFERENCE_ERROR_NONE;
}

typedef struct {
	preference_item_cb cb;
	void *user_data;
} foreach_ctx_t;

static bool __foreachCb(const char *key, void *data)
{
	foreach_ctx_t *ctx = data;
	return ctx->cb(key, ctx->user_data);
}

int preference_foreach_item(preference_item_cb callback, void *user_data)
{
	if (!callback)
		return PREFERENCE_ERROR_INVALID_PARAMETER;
	char *dir = __prefDirN();
	if (!dir)
		return PREFERENCE_ERROR_IO_ERROR;
	foreach_ctx_t ctx = {callback, user_data};
	int rc = key_file_foreach(dir, __foreachCb, &ctx);
	free(dir);
	return __errorOf(rc);
}

static bool __deliverCb(key_watcher_t *watcher, const char *key)
{
	((preference_changed_cb)watcher->cb)(key, watcher->user_data);
	return true;
}

static key_watch_list_t __watches = {.deliver = __deliverCb};

int preference_set_changed_cb(const char *key, preference_changed_cb callback, void *user_data)
{
	if (!key || !key[0] || !callback)
		return PREFERENCE_ERROR_INVALID_PARAMETER;
	bool existing = false;
	int rc = preference_is_existing(key, &existing);
	if (rc != PREFERENCE_ERROR_NONE)
		return rc;
	if (!existing) {
		LOGE("%s does not exist", key);
		return PREFERENCE_ERROR_NO_KEY;
	}
	if (!key_watch_start(&__watches, __prefDirN))
		return PREFERENCE_ERROR_IO_ERROR;
	/* One callback per key: a second registration replaces the first. */
	key_watcher_t *w = key_watch_find(&__watches, key);
	if (!w)
		w = key_watch_add(&__watches, key, NULL, NULL);
	if (!w)
		return PREFERENCE_ERROR_OUT_OF_MEMORY;
	w->cb = (key_watch_fn)callback;
	w->user_data = user_data;
	return PREFERENCE_ERROR_NONE;
}

int preference_unset_changed_cb(const char *key)
{
	if (!key || !key[0])
		return PREFERENCE_ERROR_INVALID_PARAMETER;
	if (!key_watch_remove(&__watches, key, NULL)) {
		bool existing = false;
		int rc = preference_is_existing(key, &existing);
		if (rc != PREFERENCE_ERROR_NONE)
			return rc;
		LOGE("no callback on %s", key);
		return existing ? PREFERENCE_ERROR_IO_ERROR : PREFERENCE_ERROR_NO_KEY;
	}
	return PREFERENCE_ERROR_NONE;
}
