/* Ready-made back/more handlers for popups, context popups and naviframes. */
#include <efl_extension.h>

#include <dlog.h>

void eext_popup_back_cb(void *data, Evas_Object *obj, void *event_info)
{
	(void)data;
	(void)event_info;
	if (!obj) {
		LOGE("obj is NULL");
		return;
	}
	evas_object_del(obj);
}

void eext_ctxpopup_back_cb(void *data, Evas_Object *obj, void *event_info)
{
	(void)data;
	(void)event_info;
	if (!obj) {
		LOGE("obj is NULL");
		return;
	}
	elm_ctxpopup_dismiss(obj);
}

void eext_naviframe_back_cb(void *data, Evas_Object *obj, void *event_info)
{
	(void)data;
	(void)event_info;
	if (!obj) {
		LOGE("obj is NULL");
		return;
	}
	elm_naviframe_item_pop(obj);
}

void eext_naviframe_more_cb(void *data, Evas_Object *obj, void *event_info)
{
	(void)data;
	(void)event_info;
	if (!obj) {
		LOGE("obj is NULL");
		return;
	}
	Elm_Object_Item *top = elm_naviframe_top_item_get(obj);
	Evas_Object *more = top ? elm_object_item_part_content_get(top, "toolbar_more_btn") : NULL;
	if (more && !elm_object_disabled_get(more))
		evas_object_smart_callback_call(more, "clicked", NULL);
	else
		elm_layout_signal_emit(obj, "elm,action,more_event", "");
}
