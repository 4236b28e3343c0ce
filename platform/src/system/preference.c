/* The package's preference store: typed key files under "<data path>.pref/". */
#define _GNU_SOURCE
#include <app_preference.h>

#include <errno.h>
#include <stdlib.h>
#include <string.h>

#include <app_common.h>
#include <dlog.h>

#include "system/dir_watch.h"
#include "system/key_file_store.h"

typedef struct pref_watcher_s {
	char *key;
	preference_changed_cb cb;
	void *user_data;
	bool removed; /* unset while callbacks were running; unlinked afterwards */
	struct pref_watcher_s *next;
} pref_watcher_t;

static pref_watcher_t *__watchers;
static dir_watch_t *__watch;
static int __dispatchDepth;

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

/* Reads key expecting the given type; the caller clears *value on success. */
static int __get(const char *key, key_file_type_e type, key_file_value_t *value)
{
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
	if (!value)
		return PREFERENCE_ERROR_INVALID_PARAMETER;
	key_file_value_t v;
	int rc = __get(key, KEY_FILE_TYPE_INT, &v);
	if (rc == PREFERENCE_ERROR_NONE)
		*value = v.i;
	return rc;
}

int preference_get_double(const char *key, double *value)
{
	if (!value)
		return PREFERENCE_ERROR_INVALID_PARAMETER;
	key_file_value_t v;
	int rc = __get(key, KEY_FILE_TYPE_DOUBLE, &v);
	if (rc == PREFERENCE_ERROR_NONE)
		*value = v.d;
	return rc;
}

int preference_get_string(const char *key, char **value)
{
	if (!value)
		return PREFERENCE_ERROR_INVALID_PARAMETER;
	key_file_value_t v;
	int rc = __get(key, KEY_FILE_TYPE_STRING, &v);
	if (rc == PREFERENCE_ERROR_NONE)
		*value = v.s; /* ownership passes to the caller */
	return rc;
}

int preference_get_boolean(const char *key, bool *value)
{
	if (!value)
		return PREFERENCE_ERROR_INVALID_PARAMETER;
	key_file_value_t v;
	int rc = __get(key, KEY_FILE_TYPE_BOOL, &v);
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

static pref_watcher_t *__findWatcher(const char *key)
{
	for (pref_watcher_t *w = __watchers; w; w = w->next)
		if (!w->removed && !strcmp(w->key, key))
			return w;
	return NULL;
}

/* Unlinks watchers unset during dispatch, and stops the folder watch once none is left. */
static void __sweepWatchers(void)
{
	if (__dispatchDepth > 0)
		return;
	pref_watcher_t **link = &__watchers;
	while (*link) {
		pref_watcher_t *w = *link;
		if (w->removed) {
			*link = w->next;
			free(w->key);
			free(w);
		} else {
			link = &w->next;
		}
	}
	if (!__watchers && __watch) {
		dir_watch_free(__watch);
		__watch = NULL;
	}
}

static void __keyChangedCb(const char *key, dir_watch_event_e event, void *data)
{
	(void)data;
	/* A removal is no value to report; the registration stays for when the key comes back. */
	if (event != DIR_WATCH_CHANGED)
		return;
	__dispatchDepth++;
	for (pref_watcher_t *w = __watchers; w; w = w->next)
		if (!w->removed && !strcmp(w->key, key))
			w->cb(key, w->user_data);
	__dispatchDepth--;
	__sweepWatchers();
}

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
	if (!__watch) {
		char *dir = __prefDirN();
		__watch = dir ? dir_watch_new(dir, __keyChangedCb, NULL) : NULL;
		free(dir);
		if (!__watch)
			return PREFERENCE_ERROR_IO_ERROR;
	}
	pref_watcher_t *w = __findWatcher(key);
	if (!w) {
		w = calloc(1, sizeof(*w));
		if (!w || !(w->key = strdup(key))) {
			free(w);
			__sweepWatchers();
			return PREFERENCE_ERROR_OUT_OF_MEMORY;
		}
		w->next = __watchers;
		__watchers = w;
	}
	w->cb = callback;
	w->user_data = user_data;
	return PREFERENCE_ERROR_NONE;
}

int preference_unset_changed_cb(const char *key)
{
	if (!key || !key[0])
		return PREFERENCE_ERROR_INVALID_PARAMETER;
	pref_watcher_t *w = __findWatcher(key);
	if (!w) {
		bool existing = false;
		int rc = preference_is_existing(key, &existing);
		if (rc != PREFERENCE_ERROR_NONE)
			return rc;
		LOGE("no callback on %s", key);
		return existing ? PREFERENCE_ERROR_IO_ERROR : PREFERENCE_ERROR_NO_KEY;
	}
	w->removed = true;
	__sweepWatchers();
	return PREFERENCE_ERROR_NONE;
}
