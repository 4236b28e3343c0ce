/* app_control handles: fields, extra data and their serialised form. Launching lives in app_launch.c. */
#include <app_control.h>

#include "app_private.h"

#include <dlog.h>
#include <stdlib.h>
#include <string.h>

/* Keys of the serialised form; the prefixes are reserved, so extra data cannot collide with them. */
#define KEY_OPERATION "__APP_SVC_OPERATION__"
#define KEY_URI "__APP_SVC_URI__"
#define KEY_MIME "__APP_SVC_MIME__"
#define KEY_CATEGORY "__APP_SVC_CATEGORY__"
#define KEY_APP_ID "__APP_SVC_APP_ID__"
#define KEY_LAUNCH_MODE "__APP_SVC_LAUNCH_MODE__"
#define KEY_CALLER "__APP_SVC_CALLER__"
#define KEY_REPLY "__APP_SVC_REPLY_REQUESTED__"

static const char *const RESERVED_PREFIXES[] = {"__APP_SVC_", "__AUL_"};

static int control_error(int code, const char *func, const char *what)
{
	LOGE("[%s] %s (0x%08x)", func, what, (unsigned int)code);
	return code;
}

#define INVALID_PARAMETER() control_error(APP_CONTROL_ERROR_INVALID_PARAMETER, __func__, "invalid parameter")
#define OUT_OF_MEMORY() control_error(APP_CONTROL_ERROR_OUT_OF_MEMORY, __func__, "out of memory")

bool app_control_key_is_reserved(const char *key)
{
	for (size_t i = 0; i < sizeof(RESERVED_PREFIXES) / sizeof(RESERVED_PREFIXES[0]); i++)
		if (!strncmp(key, RESERVED_PREFIXES[i], strlen(RESERVED_PREFIXES[i])))
			return true;
	return false;
}

int app_control_create(app_control_h *app_control)
{
	if (!app_control)
		return INVALID_PARAMETER();
	struct app_control_s *h = calloc(1, sizeof(*h));
	if (h)
		h->data = bundle_create();
	if (!h || !h->data) {
		free(h);
		return OUT_OF_MEMORY();
	}
	h->launch_mode = APP_CONTROL_LAUNCH_MODE_SINGLE;
	*app_control = h;
	return APP_CONTROL_ERROR_NONE;
}

int app_control_destroy(app_control_h app_control)
{
	if (!app_control)
		return INVALID_PARAMETER();
	free(app_control->operation);
	free(app_control->uri);
	free(app_control->mime);
	free(app_control->category);
	free(app_control->app_id);
	free(app_control->caller);
	bundle_free(app_control->data);
	free(app_control);
	return APP_CONTROL_ERROR_NONE;
}

/* strdup that keeps NULL; sets *failed on allocation failure. */
static char *dup_or_null(const char *s, bool *failed)
{
	if (!s)
		return NULL;
	char *copy = strdup(s);
	if (!copy)
		*failed = true;
	return copy;
}

int app_control_clone(app_control_h *clone, app_control_h app_control)
{
	if (!clone || !app_control)
		return INVALID_PARAMETER();
	struct app_control_s *h = calloc(1, sizeof(*h));
	if (!h)
		return OUT_OF_MEMORY();
	bool failed = false;
	h->operation = dup_or_null(app_control->operation, &failed);
	h->uri = dup_or_null(app_control->uri, &failed);
	h->mime = dup_or_null(app_control->mime, &failed);
	h->category = dup_or_null(app_control->category, &failed);
	h->app_id = dup_or_null(app_control->app_id, &failed);
	h->caller = dup_or_null(app_control->caller, &failed);
	h->launch_mode = app_control->launch_mode;
	/* A clone of a received request can answer it: the token names the waiting requester. */
	h->reply_requested = app_control->reply_requested;
	h->reply_token = app_control->reply_token;
	h->data = bundle_dup(app_control->data);
	if (failed || !h->data) {
		app_control_destroy(h);
		return OUT_OF_MEMORY();
	}
	*clone = h;
	return APP_CONTROL_ERROR_NONE;
}

/* Replaces a text field with a copy of value (NULL clears it). */
static int set_field(char **field, const char *value, const char *func)
{
	char *copy = NULL;
	if (value) {
		copy = strdup(value);
		if (!copy)
			return control_error(APP_CONTROL_ERROR_OUT_OF_MEMORY, func, "out of memory");
	}
	free(*field);
	*field = copy;
	return APP_CONTROL_ERROR_NONE;
}

/* Copies a text field out; *out is NULL when the field is unset. */
static int get_field(const char *field, char **out, const char *func)
{
	*out = NULL;
	if (field) {
		*out = strdup(field);
		if (!*out)
			return control_error(APP_CONTROL_ERROR_OUT_OF_MEMORY, func, "out of memory");
	}
	return APP_CONTROL_ERROR_NONE;
}

#define FIELD_ACCESSORS(name)                                                                                          \
	int app_control_set_##name(app_control_h app_control, const char *name)                                            \
	{                                                                                                                  \
		if (!app_control)                                                                                              \
			return INVALID_PARAMETER();                                                                                \
		return set_field(&app_control->name, name, __func__);                                                          \
	}                                                                                                                  \
	int app_control_get_##name(app_control_h app_control, char **name)                                                 \
	{                                                                                                                  \
		if (!app_control || !name)                                                                                     \
			return INVALID_PARAMETER();                                                                                \
		return get_field(app_control->name, name, __func__);                                                           \
	}

FIELD_ACCESSORS(operation)
FIELD_ACCESSORS(uri)
FIELD_ACCESSORS(mime)
FIELD_ACCESSORS(category)
FIELD_ACCESSORS(app_id)

int app_control_set_launch_mode(app_control_h app_control, app_control_launch_mode_e mode)
{
	if (!app_control || (mode != APP_CONTROL_LAUNCH_MODE_SINGLE && mode != APP_CONTROL_LAUNCH_MODE_GROUP))
		return INVALID_PARAMETER();
	app_control->launch_mode = mode;
	return APP_CONTROL_ERROR_NONE;
}

int app_control_get_launch_mode(app_control_h app_control, app_control_launch_mode_e *mode)
{
	if (!app_control || !mode)
		return INVALID_PARAMETER();
	*mode = app_control->launch_mode;
	return APP_CONTROL_ERROR_NONE;
}

/* Checks shared by the extra data functions: handle, non-empty key, reserved keys. */
static int check_key(app_control_h app_control, const char *key, const char *func)
{
	if (!app_control || !key || !*key)
		return control_error(APP_CONTROL_ERROR_INVALID_PARAMETER, func, "invalid parameter");
	if (app_control_key_is_reserved(key))
		return control_error(APP_CONTROL_ERROR_KEY_REJECTED, func, "the key is reserved");
	return APP_CONTROL_ERROR_NONE;
}

static int bundle_to_control_error(int ret, const char *func)
{
	if (ret == BUNDLE_ERROR_NONE)
		return APP_CONTROL_ERROR_NONE;
	if (ret == BUNDLE_ERROR_OUT_OF_MEMORY)
		return control_error(APP_CONTROL_ERROR_OUT_OF_MEMORY, func, "out of memory");
	return control_error(APP_CONTROL_ERROR_INVALID_PARAMETER, func, "cannot store the value");
}

int app_control_add_extra_data(app_control_h app_control, const char *key, const char *value)
{
	int ret = check_key(app_control, key, __func__);
	if (ret)
		return ret;
	if (!value || !*value)
		return INVALID_PARAMETER();
	bundle_del(app_control->data, key);
	return bundle_to_control_error(bundle_add_str(app_control->data, key, value), __func__);
}

int app_control_add_extra_data_array(app_control_h app_control, const char *key, const char *value[], int length)
{
	int ret = check_key(app_control, key, __func__);
	if (ret)
		return ret;
	if (!value || length <= 0)
		return INVALID_PARAMETER();
	for (int i = 0; i < length; i++)
		if (!value[i])
			return INVALID_PARAMETER();
	bundle_del(app_control->data, key);
	return bundle_to_control_error(bundle_add_str_array(app_control->data, key, value, length), __func__);
}

int app_control_remove_extra_data(app_control_h app_control, const char *key)
{
	int ret = check_key(app_control, key, __func__);
	if (ret)
		return ret;
	if (bundle_del(app_control->data, key) != BUNDLE_ERROR_NONE)
		return control_error(APP_CONTROL_ERROR_KEY_NOT_FOUND, __func__, "no such key");
	return APP_CONTROL_ERROR_NONE;
}

/* The type of key in the extra data, or the error for a missing key. */
static int extra_type(app_control_h app_control, const char *key, int *type, const char *func)
{
	*type = bundle_get_type(app_control->data, key);
	if (*type == BUNDLE_TYPE_NONE)
		return control_error(APP_CONTROL_ERROR_KEY_NOT_FOUND, func, "no such key");
	return APP_CONTROL_ERROR_NONE;
}

int app_control_get_extra_data(app_control_h app_control, const char *key, char **value)
{
	int ret = check_key(app_control, key, __func__);
	if (ret)
		return ret;
	if (!value)
		return INVALID_PARAMETER();
	*value = NULL;
	int type;
	if ((ret = extra_type(app_control, key, &type, __func__)))
		return ret;
	if (type != BUNDLE_TYPE_STR)
		return control_error(APP_CONTROL_ERROR_INVALID_DATA_TYPE, __func__, "the value is an array");
	char *s = NULL;
	bundle_get_str(app_control->data, key, &s);
	*value = strdup(s ? s : "");
	return *value ? APP_CONTROL_ERROR_NONE : OUT_OF_MEMORY();
}

int app_control_get_extra_data_array(app_control_h app_control, const char *key, char ***value, int *length)
{
	int ret = check_key(app_control, key, __func__);
	if (ret)
		return ret;
	if (!value || !length)
		return INVALID_PARAMETER();
	*value = NULL;
	*length = 0;
	int type;
	if ((ret = extra_type(app_control, key, &type, __func__)))
		return ret;
	if (type != BUNDLE_TYPE_STR_ARRAY)
		return control_error(APP_CONTROL_ERROR_INVALID_DATA_TYPE, __func__, "the value is not an array");
	int n = 0;
	const char **src = bundle_get_str_array(app_control->data, key, &n);
	char **out = calloc(n ? n : 1, sizeof(char *));
	if (!out)
		return OUT_OF_MEMORY();
	for (int i = 0; i < n; i++) {
		out[i] = strdup(src[i]);
		if (!out[i]) {
			while (i--)
				free(out[i]);
			free(out);
			return OUT_OF_MEMORY();
		}
	}
	*value = out;
	*length = n;
	return APP_CONTROL_ERROR_NONE;
}

int app_control_is_extra_data_array(app_control_h app_control, const char *key, bool *array)
{
	int ret = check_key(app_control, key, __func__);
	if (ret)
		return ret;
	if (!array)
		return INVALID_PARAMETER();
	*array = bundle_get_type(app_control->data, key) == BUNDLE_TYPE_STR_ARRAY;
	return APP_CONTROL_ERROR_NONE;
}

typedef struct {
	char **keys;
	int count;
	int capacity;
} key_snapshot_s;

static void collect_key_cb(const char *key, const int type, const bundle_keyval_t *kv, void *user_data)
{
	(void)type;
	(void)kv;
	key_snapshot_s *snap = user_data;
	if (app_control_key_is_reserved(key))
		return;
	if (snap->count == snap->capacity) {
		int cap = snap->capacity ? snap->capacity * 2 : 8;
		char **keys = realloc(snap->keys, cap * sizeof(char *));
		if (!keys)
			return;
		snap->keys = keys;
		snap->capacity = cap;
	}
	snap->keys[snap->count] = strdup(key);
	if (snap->keys[snap->count])
		snap->count++;
}

int app_control_foreach_extra_data(app_control_h app_control, app_control_extra_data_cb callback, void *user_data)
{
	if (!app_control || !callback)
		return INVALID_PARAMETER();
	/* Keys are copied first so that the callback may change the extra data. */
	key_snapshot_s snap = {NULL, 0, 0};
	bundle_foreach(app_control->data, collect_key_cb, &snap);
	bool go_on = true;
	for (int i = 0; i < snap.count; i++) {
		if (go_on)
			go_on = callback(app_control, snap.keys[i], user_data);
		free(snap.keys[i]);
	}
	free(snap.keys);
	return APP_CONTROL_ERROR_NONE;
}

int app_control_get_caller(app_control_h app_control, char **id)
{
	if (!app_control || !id)
		return INVALID_PARAMETER();
	*id = NULL;
	if (!app_control->caller)
		return control_error(APP_CONTROL_ERROR_INVALID_PARAMETER, __func__, "not a received request");
	*id = strdup(app_control->caller);
	return *id ? APP_CONTROL_ERROR_NONE : OUT_OF_MEMORY();
}

int app_control_is_reply_requested(app_control_h app_control, bool *requested)
{
	if (!app_control || !requested)
		return INVALID_PARAMETER();
	*requested = app_control->reply_token != 0 && app_control->reply_requested;
	return APP_CONTROL_ERROR_NONE;
}

/* ---- serialised form ---- */

static void add_if_set(bundle *b, const char *key, const char *value)
{
	if (value)
		bundle_add_str(b, key, value);
}

bool app_control_encode_internal(app_control_h app_control, const char *caller, bool reply_requested, bundle_raw **raw,
                                 int *len)
{
	bundle *b = bundle_dup(app_control->data);
	if (!b)
		return false;
	add_if_set(b, KEY_OPERATION, app_control->operation);
	add_if_set(b, KEY_URI, app_control->uri);
	add_if_set(b, KEY_MIME, app_control->mime);
	add_if_set(b, KEY_CATEGORY, app_control->category);
	add_if_set(b, KEY_APP_ID, app_control->app_id);
	add_if_set(b, KEY_CALLER, caller);
	bundle_add_str(b, KEY_LAUNCH_MODE, app_control->launch_mode == APP_CONTROL_LAUNCH_MODE_GROUP ? "group" : "single");
	bundle_add_str(b, KEY_REPLY, reply_requested ? "1" : "0");
	bool ok = bundle_encode(b, raw, len) == BUNDLE_ERROR_NONE;
	bundle_free(b);
	return ok;
}

/* An operation, URI (a file URI of the longest path fits), mime type, category or app id longer than this
   is not a request of ours. */
#define FIELD_MAX_LEN 8192

/* Moves a reserved string key of b into *field; false (logged) when another process sent it as
   something other than a text, or longer than any real one. */
static bool take_field(bundle *b, const char *key, char **field)
{
	int type = bundle_get_type(b, key);
	if (type == BUNDLE_TYPE_NONE)
		return true;
	char *s = NULL;
	if (type != BUNDLE_TYPE_STR || bundle_get_str(b, key, &s) != BUNDLE_ERROR_NONE || !s) {
		LOGE("launch request refused: %s is not a text", key);
		return false;
	}
	if (strlen(s) > FIELD_MAX_LEN) {
		LOGE("launch request refused: %s of %zu bytes", key, strlen(s));
		return false;
	}
	free(*field);
	*field = strdup(s);
	bundle_del(b, key);
	return true;
}

app_control_h app_control_decode_internal(const bundle_raw *raw, int len)
{
	bundle *b = bundle_decode(raw, len);
	if (!b)
		return NULL;
	app_control_h h = NULL;
	if (app_control_create(&h) != APP_CONTROL_ERROR_NONE) {
		bundle_free(b);
		return NULL;
	}
	char *mode = NULL, *reply = NULL;
	bool ok = take_field(b, KEY_OPERATION, &h->operation) && take_field(b, KEY_URI, &h->uri) &&
	          take_field(b, KEY_MIME, &h->mime) && take_field(b, KEY_CATEGORY, &h->category) &&
	          take_field(b, KEY_APP_ID, &h->app_id) && take_field(b, KEY_CALLER, &h->caller) &&
	          take_field(b, KEY_LAUNCH_MODE, &mode) && take_field(b, KEY_REPLY, &reply);
	if (!ok) {
		free(mode);
		free(reply);
		bundle_free(b);
		app_control_destroy(h);
		return NULL;
	}
	h->launch_mode = mode && !strcmp(mode, "group") ? APP_CONTROL_LAUNCH_MODE_GROUP : APP_CONTROL_LAUNCH_MODE_SINGLE;
	h->reply_requested = reply && !strcmp(reply, "1");
	free(mode);
	free(reply);
	bundle_free(h->data);
	h->data = b;
	return h;
}
