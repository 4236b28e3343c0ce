/* The app's top-level windows: listing, raising, rotating. */
#include <Elementary.h>

#include "app_private.h"

#include <dlog.h>

Eina_List *app_window_list_get(void)
{
	Eina_List *windows = NULL;
	Eina_List *canvases = ecore_evas_ecore_evas_list_get();
	Ecore_Evas *ee;
	EINA_LIST_FREE(canvases, ee)
	{
		/* Elementary marks the canvas of each window with the window object. A deleted window keeps
		   its canvas until the next loop iteration: it must not be hooked, raised or rotated. */
		Evas_Object *win = ecore_evas_data_get(ee, "elm_win");
		if (win && !efl_invalidating_get(win) && !efl_invalidated_get(win) && !app_window_is_minicontrol(win))
			windows = eina_list_append(windows, win);
	}
	return windows;
}

Evas_Object *app_window_main_get(void)
{
	Eina_List *windows = app_window_list_get();
	Evas_Object *found = NULL;
	Eina_List *l;
	Evas_Object *win;
	EINA_LIST_FOREACH(windows, l, win)
	{
		if (evas_object_visible_get(win)) {
			found = win;
			break;
		}
	}
	if (!found && windows)
		found = eina_list_data_get(windows);
	eina_list_free(windows);
	return found;
}

void app_window_raise_all(void)
{
	Eina_List *windows = app_window_list_get();
	Evas_Object *win;
	EINA_LIST_FREE(windows, win)
	{
		if (elm_win_iconified_get(win))
			elm_win_iconified_set(win, EINA_FALSE);
		elm_win_raise(win);
		elm_win_activate(win);
	}
}

/* True when the window takes this rotation (a window that declared none takes every one). */
static bool rotation_allowed(Evas_Object *win, int degree)
{
	int *rotations = NULL;
	unsigned int count = 0;
	if (!elm_win_wm_rotation_available_rotations_get(win, &rotations, &count) || !count) {
		free(rotations);
		return true;
	}
	bool allowed = false;
	for (unsigned int i = 0; i < count; i++)
		allowed = allowed || rotations[i] == degree;
	free(rotations);
	return allowed;
}

static void rotation_seen_cb(void *data, Evas_Object *obj, void *event_info)
{
	(void)obj;
	(void)event_info;
	*(bool *)data = true;
}

void app_window_rotate_all(int degree)
{
	Eina_List *windows = app_window_list_get();
	Evas_Object *win;
	EINA_LIST_FREE(windows, win)
	{
		if (elm_win_rotation_get(win) == degree || !rotation_allowed(win, degree))
			continue;
		/* Without a window manager EFL does not announce the rotation itself: do it for it. */
		bool seen = false;
		evas_object_smart_callback_add(win, "wm,rotation,changed", rotation_seen_cb, &seen);
		elm_win_rotation_with_resize_set(win, degree);
		evas_object_smart_callback_del_full(win, "wm,rotation,changed", rotation_seen_cb, &seen);
		if (!seen)
			evas_object_smart_callback_call(win, "wm,rotation,changed", NULL);
		LOGI("window %p rotated to %d", (void *)win, degree);
	}
}
