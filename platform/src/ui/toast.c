/* Status messages shown as a toast in this process's window.
 *
 * The window is found without any registration: among the canvases of this process, the one holding an
 * Elementary window that is focused and shown wins, then any shown one, then any. Only one toast shows at a
 * time; a new one replaces it. */
#include <notification_status.h>

#include <Elementary.h>
#include <dlog.h>

#include "desktop/toast_log.h"

#define TOAST_TIMEOUT 2.0
#define TOAST_LOG_MAX 256

static Eina_List *__posted; /* char*, oldest first, at most TOAST_LOG_MAX */
static Evas_Object *__current;

static void __logMessage(const char *message)
{
	char *copy = strdup(message);
	if (!copy)
		return;
	if (eina_list_count(__posted) >= TOAST_LOG_MAX) {
		free(eina_list_data_get(__posted));
		__posted = eina_list_remove_list(__posted, __posted);
	}
	__posted = eina_list_append(__posted, copy);
}

static int __windowRank(Ecore_Evas *ee, Evas_Object *win)
{
	if (!evas_object_visible_get(win))
		return 1;
	return ecore_evas_focus_get(ee) ? 3 : 2;
}

static Evas_Object *__findWindow(void)
{
	Eina_List *list = ecore_evas_ecore_evas_list_get();
	Evas_Object *best = NULL;
	int bestRank = 0;
	Eina_List *l;
	Ecore_Evas *ee;
	EINA_LIST_FOREACH(list, l, ee)
	{
		Evas_Object *win = ecore_evas_data_get(ee, "elm_win");
		if (!win)
			continue;
		int rank = __windowRank(ee, win);
		if (rank > bestRank) {
			best = win;
			bestRank = rank;
		}
	}
	eina_list_free(list);
	return best;
}

static void __toastDelCb(void *data, Evas *e, Evas_Object *obj, void *event_info)
{
	(void)data;
	(void)e;
	(void)event_info;
	if (__current == obj)
		__current = NULL;
}

static void __toastTimeoutCb(void *data, Evas_Object *obj, void *event_info)
{
	(void)data;
	(void)event_info;
	evas_object_del(obj);
}

static void __showToast(Evas_Object *win, const char *message)
{
	if (__current)
		evas_object_del(__current);

	Evas_Object *popup = elm_popup_add(win);
	if (!popup) {
		LOGE("cannot create the toast popup");
		return;
	}
	/* The stock theme has no toast style; a theme extension may bring one. */
	if (elm_theme_group_path_find(NULL, "elm/popup/base/toast"))
		elm_object_style_set(popup, "toast");
	elm_popup_orient_set(popup, ELM_POPUP_ORIENT_BOTTOM);
	elm_popup_allow_events_set(popup, EINA_TRUE);
	char *markup = elm_entry_utf8_to_markup(message);
	elm_object_text_set(popup, markup ? markup : message);
	free(markup);
	elm_popup_timeout_set(popup, TOAST_TIMEOUT);
	evas_object_smart_callback_add(popup, "timeout", __toastTimeoutCb, NULL);
	evas_object_event_callback_add(popup, EVAS_CALLBACK_DEL, __toastDelCb, NULL);
	evas_object_show(popup);
	__current = popup;
}

static void __postOnMainLoop(const char *message);

static void __postAsyncCb(void *data)
{
	__postOnMainLoop(data);
	free(data);
}

int notification_status_message_post(const char *message)
{
	if (!message) {
		LOGE("message is NULL");
		return NOTIFICATION_ERROR_INVALID_PARAMETER;
	}
	if (eina_main_loop_is()) {
		__postOnMainLoop(message);
		return NOTIFICATION_ERROR_NONE;
	}
	/* Posted from a worker: the toast is made on the main loop, as the device's service would show it. */
	char *copy = strdup(message);
	if (!copy)
		return NOTIFICATION_ERROR_OUT_OF_MEMORY;
	ecore_main_loop_thread_safe_call_async(__postAsyncCb, copy);
	return NOTIFICATION_ERROR_NONE;
}

static void __postOnMainLoop(const char *message)
{
	LOGI("toast: %s", message);
	__logMessage(message);

	Evas_Object *win = __findWindow();
	if (!win) {
		LOGI("no window to show the toast in");
		return;
	}
	__showToast(win, message);
}

int desktop_toast_log_count(void)
{
	return (int)eina_list_count(__posted);
}

const char *desktop_toast_log_get(int index)
{
	if (index < 0)
		return NULL;
	return eina_list_nth(__posted, (unsigned int)index);
}

void desktop_toast_log_clear(void)
{
	char *message;
	EINA_LIST_FREE(__posted, message)
	free(message);
}

Evas_Object *desktop_toast_current_get(void)
{
	return __current;
}
