/* System events of the app (language, rotation, region, memory, battery), driven by vconf keys. */
#include <app.h>
#include <vconf.h>

#include "app_private.h"

#include <dlog.h>
#include <libintl.h>
#include <locale.h>
#include <stdlib.h>
#include <string.h>

/* Battery level key and its two alarming values. */
#define BATTERY_LOW_VCONF_KEY "memory/sysman/battery_status_low"

struct app_event_handler {
	app_event_type_e type;
	app_event_cb callback;
	void *user_data;
};

struct app_event_info {
	app_event_type_e type;
	const char *text;
	int number;
};

static Eina_List *handlers;
static bool watching;
static int applied_rotation;

int ui_app_add_event_handler(app_event_handler_h *event_handler, app_event_type_e event_type, app_event_cb callback,
                             void *user_data)
{
	if (!event_handler || !callback || event_type < APP_EVENT_LOW_MEMORY ||
	    event_type > APP_EVENT_SUSPENDED_STATE_CHANGED) {
		LOGE("invalid parameter");
		return APP_ERROR_INVALID_PARAMETER;
	}
	struct app_event_handler *h = calloc(1, sizeof(*h));
	if (!h)
		return APP_ERROR_OUT_OF_MEMORY;
	/* Handlers may come before the main loop exists; the list needs Eina. */
	static bool eina_ready = false;
	if (!eina_ready)
		eina_ready = eina_init() > 0;
	h->type = event_type;
	h->callback = callback;
	h->user_data = user_data;
	handlers = eina_list_append(handlers, h);
	*event_handler = h;
	return APP_ERROR_NONE;
}

int ui_app_remove_event_handler(app_event_handler_h event_handler)
{
	if (!event_handler || !eina_list_data_find(handlers, event_handler)) {
		LOGE("invalid or unknown handler");
		return APP_ERROR_INVALID_PARAMETER;
	}
	handlers = eina_list_remove(handlers, event_handler);
	free(event_handler);
	return APP_ERROR_NONE;
}

static void dispatch(app_event_type_e type, const char *text, int number)
{
	struct app_event_info info = {type, text, number};
	/* A callback may remove handlers: walk a copy and skip the ones gone meanwhile. */
	Eina_List *copy = eina_list_clone(handlers);
	struct app_event_handler *h;
	EINA_LIST_FREE(copy, h)
	{
		if (h->type == type && eina_list_data_find(handlers, h))
			h->callback(&info, h->user_data);
	}
}

/* ---- payload readers ---- */

static int check_info(app_event_info_h info, const void *out, app_event_type_e type)
{
	if (!info || !out)
		return APP_ERROR_INVALID_PARAMETER;
	if (info->type != type) {
		LOGE("event %d has no such payload", (int)info->type);
		return APP_ERROR_INVALID_CONTEXT;
	}
	return APP_ERROR_NONE;
}

static int text_payload(app_event_info_h info, char **out, app_event_type_e type)
{
	int ret = check_info(info, out, type);
	if (ret)
		return ret;
	*out = strdup(info->text ? info->text : "");
	return *out ? APP_ERROR_NONE : APP_ERROR_OUT_OF_MEMORY;
}

int app_event_get_language(app_event_info_h event_info, char **lang)
{
	return text_payload(event_info, lang, APP_EVENT_LANGUAGE_CHANGED);
}

int app_event_get_region_format(app_event_info_h event_info, char **region)
{
	return text_payload(event_info, region, APP_EVENT_REGION_FORMAT_CHANGED);
}

int app_event_get_low_memory_status(app_event_info_h event_info, app_event_low_memory_status_e *status)
{
	int ret = check_info(event_info, status, APP_EVENT_LOW_MEMORY);
	if (!ret)
		*status = (app_event_low_memory_status_e)event_info->number;
	return ret;
}

int app_event_get_low_battery_status(app_event_info_h event_info, app_event_low_battery_status_e *status)
{
	int ret = check_info(event_info, status, APP_EVENT_LOW_BATTERY);
	if (!ret)
		*status = (app_event_low_battery_status_e)event_info->number;
	return ret;
}

int app_event_get_device_orientation(app_event_info_h event_info, app_device_orientation_e *orientation)
{
	int ret = check_info(event_info, orientation, APP_EVENT_DEVICE_ORIENTATION_CHANGED);
	if (!ret)
		*orientation = (app_device_orientation_e)event_info->number;
	return ret;
}

int app_event_get_suspended_state(app_event_info_h event_info, app_suspended_state_e *state)
{
	int ret = check_info(event_info, state, APP_EVENT_SUSPENDED_STATE_CHANGED);
	if (!ret)
		*state = (app_suspended_state_e)event_info->number;
	return ret;
}

/* ---- device state ---- */

static bool valid_rotation(int degree)
{
	return degree == 0 || degree == 90 || degree == 180 || degree == 270;
}

app_device_orientation_e app_get_device_orientation(void)
{
	int degree = 0;
	if (vconf_get_int(APP_ROTATION_VCONF_KEY, &degree) != VCONF_OK || !valid_rotation(degree))
		degree = 0;
	return (app_device_orientation_e)degree;
}

void app_event_language_apply(void)
{
	char *lang = vconf_get_str(VCONFKEY_LANGSET);
	if (!lang || !*lang) {
		free(lang);
		return;
	}
	/* gettext reads LANGUAGE first. */
	setenv("LANGUAGE", lang, 1);
	setenv("LANG", lang, 1);
	if (getenv("LC_ALL"))
		setenv("LC_ALL", lang, 1);
	if (!setlocale(LC_ALL, "")) {
		/* The language has no system locale here: C.UTF-8 still honours LANGUAGE, plain C would not. */
		setlocale(LC_ALL, "C.UTF-8");
	}
	/* gettext caches translations under the locale name, which often stays C.UTF-8 from one language
	   to the next; re-announcing the text domain drops that cache for every bound domain. */
	textdomain(textdomain(NULL));
	LOGI("language %s", lang);
	free(lang);
}

static void language_changed_cb(keynode_t *node, void *user_data)
{
	(void)user_data;
	app_event_language_apply();
	dispatch(APP_EVENT_LANGUAGE_CHANGED, vconf_keynode_get_str(node), 0);
}

static void region_changed_cb(keynode_t *node, void *user_data)
{
	(void)node;
	(void)user_data;
	char *region = vconf_get_str(VCONFKEY_REGIONFORMAT);
	dispatch(APP_EVENT_REGION_FORMAT_CHANGED, region ? region : "", 0);
	free(region);
}

static void rotation_changed_cb(keynode_t *node, void *user_data)
{
	(void)user_data;
	int degree = vconf_keynode_get_int(node);
	if (!valid_rotation(degree)) {
		LOGE("rotation %d ignored: 0, 90, 180 or 270 only", degree);
		return;
	}
	if (degree == applied_rotation)
		return;
	applied_rotation = degree;
	dispatch(APP_EVENT_DEVICE_ORIENTATION_CHANGED, NULL, degree);
	app_window_rotate_all(degree);
}

void app_event_rotation_apply(void)
{
	applied_rotation = (int)app_get_device_orientation();
	if (applied_rotation)
		app_window_rotate_all(applied_rotation);
}

static void low_memory_cb(keynode_t *node, void *user_data)
{
	(void)user_data;
	int status = vconf_keynode_get_int(node);
	if (status >= APP_EVENT_LOW_MEMORY_SOFT_WARNING)
		dispatch(APP_EVENT_LOW_MEMORY, NULL, status);
}

static void low_battery_cb(keynode_t *node, void *user_data)
{
	(void)user_data;
	int status = vconf_keynode_get_int(node);
	if (status == APP_EVENT_LOW_BATTERY_POWER_OFF || status == APP_EVENT_LOW_BATTERY_CRITICAL_LOW)
		dispatch(APP_EVENT_LOW_BATTERY, NULL, status);
}

static const struct {
	const char *key;
	vconf_callback_fn callback;
} WATCHES[] = {
    {VCONFKEY_LANGSET, language_changed_cb},
    {VCONFKEY_REGIONFORMAT, region_changed_cb},
    {VCONFKEY_REGIONFORMAT_TIME1224, region_changed_cb},
    {APP_ROTATION_VCONF_KEY, rotation_changed_cb},
    {VCONFKEY_SYSMAN_LOW_MEMORY, low_memory_cb},
    {BATTERY_LOW_VCONF_KEY, low_battery_cb},
};

void app_event_watch_start(void)
{
	if (watching)
		return;
	watching = true;
	applied_rotation = (int)app_get_device_orientation();
	for (size_t i = 0; i < sizeof(WATCHES) / sizeof(WATCHES[0]); i++)
		if (vconf_notify_key_changed(WATCHES[i].key, WATCHES[i].callback, NULL) != VCONF_OK)
			LOGE("cannot watch %s", WATCHES[i].key);
}

void app_event_watch_stop(void)
{
	if (!watching)
		return;
	watching = false;
	for (size_t i = 0; i < sizeof(WATCHES) / sizeof(WATCHES[0]); i++)
		vconf_ignore_key_changed(WATCHES[i].key, WATCHES[i].callback);
}
