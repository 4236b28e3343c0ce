/* Minicontrol windows on the desktop: the provider's window is a real Elementary window, and this file plays
   the viewers (notification panel, lock screen): where the window sits, when it may be seen, and the events
   they send back. */
#include <minicontrol-provider.h>

#include <Ecore_X.h>
#include <app_common.h>
#include <Elementary.h>
#include <dlog.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <vconf.h>

#include "app/app_private.h"
#include "desktop/minicontrol_viewer.h"

#define MINICONTROL_DATA_KEY "tizen.minicontrol"
/* Above normal windows (ecore_evas maps layers above 5 to the window manager's "above" state). */
#define MINICONTROL_LAYER 10
/* Stands in for the illume atom when no X display interned it. */
#define MINICONTROL_ROTATE_ATOM_FALLBACK 0x7fffff01

typedef struct {
	Evas_Object *win;
	char *name;
	minicontrol_target_viewer_e target;
	minicontrol_event_cb callback;
	bool wanted;  /* the provider showed it */
	bool syncing; /* the viewer itself shows or hides it */
} minicontrol_window_s;

static Eina_List *__windows; /* minicontrol_window_s*, oldest first */
static bool __watching;

static bool __is_lock_screen(const minicontrol_window_s *mc)
{
	return mc->target != MINICONTROL_TARGET_VIEWER_QUICK_PANEL;
}

static bool __locked(void)
{
	int state = VCONFKEY_IDLE_UNLOCK;
	return vconf_get_int(VCONFKEY_IDLE_LOCK_STATE, &state) == VCONF_OK && state == VCONFKEY_IDLE_LOCK;
}

static minicontrol_window_s *__get(Evas_Object *obj)
{
	minicontrol_window_s *mc = obj ? evas_object_data_get(obj, MINICONTROL_DATA_KEY) : NULL;
	return mc && mc->win == obj ? mc : NULL;
}

/* ---- placement and visibility ---- */

/* The notification panel's window hangs from the top edge, the lock screen's sits on the bottom edge, both
   centred. */
static void __dock(minicontrol_window_s *mc)
{
	int sx = 0, sy = 0, sw = 0, sh = 0, w = 0, h = 0;
	elm_win_screen_size_get(mc->win, &sx, &sy, &sw, &sh);
	evas_object_geometry_get(mc->win, NULL, NULL, &w, &h);
	int x = sw > w ? sx + (sw - w) / 2 : sx;
	int y = __is_lock_screen(mc) && sh > h ? sy + sh - h : sy;
	evas_object_move(mc->win, x, y);
}

static void __resize_cb(void *data, Evas *e, Evas_Object *obj, void *event_info)
{
	(void)e;
	(void)obj;
	(void)event_info;
	__dock(data);
}

/* What the viewer lets be seen: the provider's wish, and for the lock screen only while locked. */
static void __sync_visibility(minicontrol_window_s *mc)
{
	bool visible = mc->wanted && (!__is_lock_screen(mc) || __locked());
	if (visible == (bool)evas_object_visible_get(mc->win))
		return;
	mc->syncing = true;
	if (visible) {
		__dock(mc);
		evas_object_show(mc->win);
		elm_win_raise(mc->win);
	} else {
		evas_object_hide(mc->win);
	}
	mc->syncing = false;
}

static void __show_intercept_cb(void *data, Evas_Object *obj)
{
	minicontrol_window_s *mc = data;
	if (mc->syncing) {
		evas_object_show(obj);
		return;
	}
	mc->wanted = true;
	__sync_visibility(mc);
}

static void __hide_intercept_cb(void *data, Evas_Object *obj)
{
	minicontrol_window_s *mc = data;
	if (mc->syncing) {
		evas_object_hide(obj);
		return;
	}
	mc->wanted = false;
	__sync_visibility(mc);
}

/* The buffer engine frees its pixels on a resize even while a render thread still draws into them: the
   viewers turn these windows at any time, so a resize waits for the render in flight. */
static void __resize_intercept_cb(void *data, Evas_Object *obj, Evas_Coord w, Evas_Coord h)
{
	(void)data;
	evas_sync(evas_object_evas_get(obj));
	evas_object_resize(obj, w, h);
}

/* ---- viewer events ---- */

static void __deliver(minicontrol_window_s *mc, int event, bundle *arg)
{
	if (mc->callback)
		mc->callback((minicontrol_viewer_event_e)event, arg);
}

static void __delete_request_cb(void *data, Evas_Object *obj, void *event_info)
{
	(void)obj;
	(void)event_info;
	minicontrol_window_s *mc = data;
	LOGI("%s: the viewer asks to hide it", mc->name);
	__deliver(mc, MINICONTROL_PROVIDER_EVENT_REQUEST_HIDE, NULL);
}

/* Without an X display ecore_x has neither made its event types nor interned its atoms; the rotation
   message of the viewers needs both, so that providers can listen for it as on the device. */
static void __x_types_ensure(void)
{
	if (!ECORE_X_EVENT_CLIENT_MESSAGE)
		ECORE_X_EVENT_CLIENT_MESSAGE = ecore_event_type_new();
	if (!ECORE_X_ATOM_E_ILLUME_ROTATE_ROOT_ANGLE)
		ECORE_X_ATOM_E_ILLUME_ROTATE_ROOT_ANGLE = MINICONTROL_ROTATE_ATOM_FALLBACK;
}

void minicontrol_viewer_angle_report(int angle)
{
	__x_types_ensure();
	Ecore_X_Event_Client_Message *ev = calloc(1, sizeof(*ev));
	if (!ev)
		return;
	ev->message_type = ECORE_X_ATOM_E_ILLUME_ROTATE_ROOT_ANGLE;
	ev->format = 32;
	ev->data.l[0] = angle;
	ev->time = (Ecore_X_Time)(ecore_time_get() * 1000);
	ecore_event_add(ECORE_X_EVENT_CLIENT_MESSAGE, ev, NULL, NULL);

	char text[16];
	snprintf(text, sizeof(text), "%d", angle);
	bundle *arg = bundle_create();
	if (arg)
		bundle_add_str(arg, "angle", text);
	Eina_List *copy = eina_list_clone(__windows);
	minicontrol_window_s *mc;
	EINA_LIST_FREE(copy, mc)
	{
		if (eina_list_data_find(__windows, mc))
			__deliver(mc, MINICONTROL_VIEWER_EVENT_REPORT_ANGLE, arg);
	}
	if (arg)
		bundle_free(arg);
}

static void __lock_changed_cb(keynode_t *node, void *data)
{
	(void)node;
	(void)data;
	Eina_List *l;
	minicontrol_window_s *mc;
	EINA_LIST_FOREACH(__windows, l, mc)
	if (__is_lock_screen(mc))
		__sync_visibility(mc);
}

static void __rotation_changed_cb(keynode_t *node, void *data)
{
	(void)data;
	minicontrol_viewer_angle_report(vconf_keynode_get_int(node));
}

/* One watch on each key for all windows: ignoring a key drops every registration of the callback. */
static void __watch(bool on)
{
	if (on == __watching)
		return;
	__watching = on;
	if (on) {
		vconf_notify_key_changed(VCONFKEY_IDLE_LOCK_STATE, __lock_changed_cb, NULL);
		vconf_notify_key_changed(APP_ROTATION_VCONF_KEY, __rotation_changed_cb, NULL);
	} else {
		vconf_ignore_key_changed(VCONFKEY_IDLE_LOCK_STATE, __lock_changed_cb);
		vconf_ignore_key_changed(APP_ROTATION_VCONF_KEY, __rotation_changed_cb);
	}
}

static void __win_del_cb(void *data, Evas *e, Evas_Object *obj, void *event_info)
{
	(void)e;
	(void)obj;
	(void)event_info;
	minicontrol_window_s *mc = data;
	__windows = eina_list_remove(__windows, mc);
	free(mc->name);
	free(mc);
	if (!__windows)
		__watch(false);
}

/* ---- provider API ---- */

Evas_Object *minicontrol_create_window(const char *name, minicontrol_target_viewer_e target_viewer,
                                       minicontrol_event_cb callback)
{
	if (!name || !*name ||
	    (target_viewer != MINICONTROL_TARGET_VIEWER_QUICK_PANEL &&
	     target_viewer != MINICONTROL_TARGET_VIEWER_STOCK_LOCK_SCREEN &&
	     target_viewer != MINICONTROL_TARGET_VIEWER_CUSTOM_LOCK_SCREEN)) {
		LOGE("invalid name or target");
		set_last_result(MINICONTROL_ERROR_INVALID_PARAMETER);
		return NULL;
	}
	minicontrol_window_s *mc = calloc(1, sizeof(*mc));
	if (!mc || !(mc->name = strdup(name))) {
		free(mc);
		set_last_result(MINICONTROL_ERROR_OUT_OF_MEMORY);
		return NULL;
	}
	mc->win = elm_win_add(NULL, name, ELM_WIN_UTILITY);
	if (!mc->win) {
		LOGE("%s: no window", name);
		free(mc->name);
		free(mc);
		set_last_result(MINICONTROL_ERROR_ELM_FAILURE);
		return NULL;
	}
	mc->target = target_viewer;
	mc->callback = callback;
	__x_types_ensure();
	/* Marked before anything else sees it: the app's own window handling leaves these windows alone. */
	evas_object_data_set(mc->win, MINICONTROL_DATA_KEY, mc);
	elm_win_title_set(mc->win, name);
	elm_win_borderless_set(mc->win, EINA_TRUE);
	elm_win_layer_set(mc->win, MINICONTROL_LAYER);
	elm_win_prop_focus_skip_set(mc->win, EINA_TRUE);
	evas_object_intercept_show_callback_add(mc->win, __show_intercept_cb, mc);
	evas_object_intercept_hide_callback_add(mc->win, __hide_intercept_cb, mc);
	evas_object_intercept_resize_callback_add(mc->win, __resize_intercept_cb, mc);
	evas_object_event_callback_add(mc->win, EVAS_CALLBACK_RESIZE, __resize_cb, mc);
	evas_object_event_callback_add(mc->win, EVAS_CALLBACK_DEL, __win_del_cb, mc);
	evas_object_smart_callback_add(mc->win, "delete,request", __delete_request_cb, mc);
	__windows = eina_list_append(__windows, mc);
	__watch(true);
	set_last_result(MINICONTROL_ERROR_NONE);
	LOGI("%s: window for viewer %d", name, (int)target_viewer);
	return mc->win;
}

int minicontrol_send_event(Evas_Object *mincontrol, minicontrol_provider_event_e event, bundle *event_arg)
{
	(void)event_arg;
	minicontrol_window_s *mc = __get(mincontrol);
	if (!mc) {
		LOGE("not a minicontrol window");
		return MINICONTROL_ERROR_INVALID_PARAMETER;
	}
	switch (event) {
	case MINICONTROL_PROVIDER_EVENT_REQUEST_HIDE:
		/* Also when the viewer keeps it out of sight already: Evas passes no hide of a hidden object. */
		mc->wanted = false;
		__sync_visibility(mc);
		return MINICONTROL_ERROR_NONE;
	case MINICONTROL_PROVIDER_EVENT_REQUEST_ANGLE: {
		int angle = (int)app_get_device_orientation();
		minicontrol_viewer_angle_report(angle);
		return MINICONTROL_ERROR_NONE;
	}
	default:
		LOGE("%s: unknown event %d", mc->name, (int)event);
		return MINICONTROL_ERROR_INVALID_PARAMETER;
	}
}

/* ---- viewer side ---- */

bool app_window_is_minicontrol(Evas_Object *win)
{
	return __get(win) != NULL;
}

Evas_Object *minicontrol_viewer_window_find(const char *name)
{
	Evas_Object *found = NULL;
	Eina_List *l;
	minicontrol_window_s *mc;
	EINA_LIST_FOREACH(__windows, l, mc)
	if (name && !strcmp(mc->name, name))
		found = mc->win;
	return found;
}

int minicontrol_viewer_target_get(Evas_Object *win)
{
	minicontrol_window_s *mc = __get(win);
	return mc ? (int)mc->target : 0;
}

bool minicontrol_viewer_shown_by_provider(Evas_Object *win)
{
	minicontrol_window_s *mc = __get(win);
	return mc && mc->wanted;
}

int minicontrol_viewer_event_send(Evas_Object *win, int event, bundle *event_arg)
{
	minicontrol_window_s *mc = __get(win);
	if (!mc)
		return MINICONTROL_ERROR_INVALID_PARAMETER;
	__deliver(mc, event, event_arg);
	return MINICONTROL_ERROR_NONE;
}
