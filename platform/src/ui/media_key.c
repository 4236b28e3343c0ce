/* Media keys: while reserved, a hidden rectangle in the canvas of each window of the app grabs them,
   so they arrive whatever widget has the focus. The grab is shared: the focused widget sees them too. */
#include <media_key.h>

#include <Elementary.h>
#include <dlog.h>
#include <string.h>

#include "app/app_private.h"

static const struct {
	const char *name;
	media_key_e key;
} __keys[] = {
    {"XF86AudioPlay", MEDIA_KEY_PLAY},     {"XF86AudioStop", MEDIA_KEY_STOP},
    {"XF86AudioPause", MEDIA_KEY_PAUSE},   {"XF86AudioPrev", MEDIA_KEY_PREVIOUS},
    {"XF86AudioNext", MEDIA_KEY_NEXT},     {"XF86AudioForward", MEDIA_KEY_FASTFORWARD},
    {"XF86AudioRewind", MEDIA_KEY_REWIND}, {"XF86AudioPlayPause", MEDIA_KEY_PLAYPAUSE},
    {"XF86AudioMedia", MEDIA_KEY_MEDIA},
};

static media_key_event_cb __cb;
static void *__cb_data;
static Eina_List *__grabbers; /* Evas_Object rectangles */

static void __deliver(const char *keyname, media_key_event_e status)
{
	for (size_t i = 0; keyname && __cb && i < sizeof(__keys) / sizeof(__keys[0]); i++)
		if (!strcmp(keyname, __keys[i].name)) {
			__cb(__keys[i].key, status, __cb_data);
			return;
		}
}

static void __key_down_cb(void *data, Evas *e, Evas_Object *obj, void *event_info)
{
	(void)data;
	(void)e;
	(void)obj;
	__deliver(((Evas_Event_Key_Down *)event_info)->keyname, MEDIA_KEY_STATUS_PRESSED);
}

static void __key_up_cb(void *data, Evas *e, Evas_Object *obj, void *event_info)
{
	(void)data;
	(void)e;
	(void)obj;
	__deliver(((Evas_Event_Key_Up *)event_info)->keyname, MEDIA_KEY_STATUS_RELEASED);
}

static void __grabber_del_cb(void *data, Evas *e, Evas_Object *obj, void *event_info)
{
	(void)data;
	(void)e;
	(void)event_info;
	__grabbers = eina_list_remove(__grabbers, obj);
}

static void __grabbers_del(void)
{
	Evas_Object *grabber;
	EINA_LIST_FREE(__grabbers, grabber)
	{
		evas_object_event_callback_del(grabber, EVAS_CALLBACK_DEL, __grabber_del_cb);
		evas_object_del(grabber);
	}
}

static bool __grabber_add(Evas_Object *win)
{
	Evas_Object *grabber = evas_object_rectangle_add(evas_object_evas_get(win));
	if (!grabber)
		return false;
	evas_object_pass_events_set(grabber, EINA_TRUE);
	for (size_t i = 0; i < sizeof(__keys) / sizeof(__keys[0]); i++)
		if (!evas_object_key_grab(grabber, __keys[i].name, 0, 0, EINA_FALSE))
			LOGE("cannot grab key %s", __keys[i].name);
	evas_object_event_callback_add(grabber, EVAS_CALLBACK_KEY_DOWN, __key_down_cb, NULL);
	evas_object_event_callback_add(grabber, EVAS_CALLBACK_KEY_UP, __key_up_cb, NULL);
	evas_object_event_callback_add(grabber, EVAS_CALLBACK_DEL, __grabber_del_cb, NULL);
	__grabbers = eina_list_append(__grabbers, grabber);
	return true;
}

int media_key_reserve(media_key_event_cb callback, void *user_data)
{
	if (!callback)
		return MEDIA_KEY_ERROR_INVALID_PARAMETER;
	__grabbers_del();
	Eina_List *windows = app_window_list_get();
	Evas_Object *win;
	EINA_LIST_FREE(windows, win)
	__grabber_add(win);
	if (!__grabbers) {
		LOGE("no window to take the media keys in");
		return MEDIA_KEY_ERROR_OPERATION_FAILED;
	}
	__cb = callback;
	__cb_data = user_data;
	return MEDIA_KEY_ERROR_NONE;
}

int media_key_release(void)
{
	__grabbers_del();
	__cb = NULL;
	__cb_data = NULL;
	return MEDIA_KEY_ERROR_NONE;
}
