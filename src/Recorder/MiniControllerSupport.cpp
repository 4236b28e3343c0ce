#include "MiniControllerSupport.h"

#include <app.h>
#include <app_manager.h>
#include <system_info.h>
#include <vconf.h>

#include <cstdlib>

#include "MemoLog.h"

namespace mini_controller
{
int scaled(int size)
{
	return static_cast<int>(elm_config_scale_get() * size / elm_app_base_scale_get());
}

bool isLandscape(int rotation)
{
	return rotation == 90 || rotation == 270;
}

int panelWidth(int rotation)
{
	int width = 0;
	system_info_get_platform_int(isLandscape(rotation) ? "http://tizen.org/feature/screen.height"
	                                                   : "http://tizen.org/feature/screen.width",
	                             &width);
	return width;
}

int lockWidth(Evas_Object *win)
{
	int width = 0;
	if (win)
		elm_win_screen_size_get(win, nullptr, nullptr, &width, nullptr);
	return width ? width : scaled(LOCK_DEFAULT_WIDTH);
}

Evas_Object *partObject(Evas_Object *layout, const char *part)
{
	Evas_Object *edje = layout ? elm_layout_edje_get(layout) : nullptr;
	return edje ? const_cast<Evas_Object *>(edje_object_part_object_get(edje, part)) : nullptr;
}

bool addPartMouseUp(Evas_Object *layout, const char *part, Evas_Object_Event_Cb cb, void *data)
{
	Evas_Object *obj = partObject(layout, part);
	if (!obj) {
		MEMO_LOGE("no part %s", part);
		return false;
	}
	evas_object_event_callback_add(obj, EVAS_CALLBACK_MOUSE_UP, cb, data);
	return true;
}

void emit(Evas_Object *layout, const char *signal)
{
	elm_object_signal_emit(layout, signal, "elm");
}

void resumeApp()
{
	char *appId = nullptr;
	if (app_get_id(&appId) != APP_ERROR_NONE || !appId)
		return;
	app_context_h context = nullptr;
	int ret = app_manager_get_app_context(appId, &context);
	if (ret != APP_MANAGER_ERROR_NONE) {
		MEMO_LOGE("app_manager_get_app_context().. [0x%x]", ret);
		free(appId);
		return;
	}
	ret = app_manager_resume_app(context);
	if (ret != APP_MANAGER_ERROR_NONE) {
		MEMO_LOGE("app_manager_resume_app().. [0x%x]", ret);
		free(appId);
		app_context_destroy(context);
		return;
	}
	free(appId);
	app_context_destroy(context);
	if (vconf_set_int(VCONFKEY_IDLE_LOCK_STATE, VCONFKEY_IDLE_UNLOCK) != VCONF_OK)
		MEMO_LOGE("vconf_set_int(VCONFKEY_IDLE_LOCK_STATE, VCONFKEY_IDLE_UNLOCK)");
}

void setTimeParts(Evas_Object *layout, const char *part, const char *text, const char *otherPart)
{
	if (!layout)
		return;
	elm_object_part_text_set(layout, part, text);
	if (otherPart)
		elm_object_part_text_set(layout, otherPart, "");
}
} // namespace mini_controller
