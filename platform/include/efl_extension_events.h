#ifndef __EFL_EXTENSION_EVENTS_H__
#define __EFL_EXTENSION_EVENTS_H__

#include <Elementary.h>

#ifdef __cplusplus
extern "C" {
#endif

/* Hardware keys routed to objects. On the desktop BACK is Escape, XF86Back or XF86Stop and MORE is
   Menu, XF86Menu, XF86Send or F2; both fire on key release. */
typedef enum _Eext_Callback_Type {
	EEXT_CALLBACK_BACK,
	EEXT_CALLBACK_MORE,
	EEXT_CALLBACK_LAST,
} Eext_Callback_Type;

/* event_info is the Eext_Callback_Type that fired, cast to a pointer. */
typedef void (*Eext_Event_Cb)(void *data, Evas_Object *obj, void *event_info);

/* Registers func for the key type on obj; callbacks of one object run in registration order. Of all objects
   with a callback for the key, only one gets it: a shown one, on the highest layer, under the top-level
   object highest in the stacking order, and there the topmost and deepest. The callbacks go away with obj.
   A window close request is not a back key. Logs and does nothing on a null obj/func or a bad type. */
void eext_object_event_callback_add(Evas_Object *obj, Eext_Callback_Type type, Eext_Event_Cb func, void *data);

/* Removes the newest registration of func for the type on obj; returns its data, or NULL if none. */
void *eext_object_event_callback_del(Evas_Object *obj, Eext_Callback_Type type, Eext_Event_Cb func);

/* Ready-made handlers: delete the popup, dismiss the ctxpopup, pop the naviframe's top item. */
void eext_popup_back_cb(void *data, Evas_Object *obj, void *event_info);
void eext_ctxpopup_back_cb(void *data, Evas_Object *obj, void *event_info);
void eext_naviframe_back_cb(void *data, Evas_Object *obj, void *event_info);

/* Clicks the top item's "toolbar_more_btn" if it has one, else emits "elm,action,more_event" on the naviframe. */
void eext_naviframe_more_cb(void *data, Evas_Object *obj, void *event_info);

#ifdef __cplusplus
}
#endif

#endif
