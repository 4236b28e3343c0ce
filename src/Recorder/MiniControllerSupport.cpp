#include "MiniControllerSupport.h"

#include <Ecore_X.h>

#include <app.h>
#include <app_manager.h>
#include <system_info.h>
#include <vconf.h>

#include <cstdlib>

#include "MemoLog.h"
#include "Util/MemoUtil.h"

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

bool addButton(Evas_Object *layout, const char *part, Evas_Object_Event_Cb cb, void *data)
{
	if (!layout) {
		MEMO_LOGE("getEvasObj() is nullptr");
		return false;
	}
	return addPartMouseUp(layout, part, cb, data);
}

Evas_Object *createNotiWindow(const char *name, minicontrol_event_cb cb, int *rotation)
{
	Evas_Object *win = minicontrol_create_window(name, MINICONTROL_TARGET_VIEWER_QUICK_PANEL, cb);
	*rotation = elm_win_rotation_get(win);
	elm_win_alpha_set(win, EINA_TRUE);
	evas_object_resize(win, panelWidth(*rotation), scaled(NOTI_HEIGHT));
	evas_object_show(win);
	return win;
}

namespace
{
// The lock screen sends nothing that its controllers act on.
void lockWindowEventCb(minicontrol_viewer_event_e, bundle *) {}
} // namespace

Evas_Object *createLockWindow(const char *name)
{
	Evas_Object *win = minicontrol_create_window(name, MINICONTROL_TARGET_VIEWER_STOCK_LOCK_SCREEN, lockWindowEventCb);
	elm_win_alpha_set(win, EINA_TRUE);
	evas_object_resize(win, lockWidth(win), scaled(LOCK_HEIGHT));
	evas_object_show(win);
	return win;
}

Evas_Object *addLayout(Evas_Object *win, const char *group)
{
	Evas_Object *layout = elm_layout_add(win);
	elm_layout_file_set(layout, MemoUtil::getEdjePath(), group);
	evas_object_size_hint_weight_set(layout, EVAS_HINT_EXPAND, EVAS_HINT_EXPAND);
	evas_object_show(layout);
	elm_win_resize_object_add(win, layout);
	return layout;
}

void deleteWindow(Evas_Object **win, Evas_Object **layout)
{
	if (*win) {
		evas_object_hide(*win);
		evas_object_del(*win);
	}
	*win = nullptr;
	*layout = nullptr;
}

void deleteHandler(Ecore_Event_Handler **handler)
{
	if (*handler)
		ecore_event_handler_del(*handler);
	*handler = nullptr;
}

bool rotateNotiWindow(Evas_Object *win, int *rotation, void *event)
{
	Ecore_X_Event_Client_Message *ev = static_cast<Ecore_X_Event_Client_Message *>(event);
	if (ev->message_type != ECORE_X_ATOM_E_ILLUME_ROTATE_ROOT_ANGLE || ev->data.l[0] == *rotation)
		return false;
	int angle = static_cast<int>(ev->data.l[0]);
	evas_object_resize(win, panelWidth(angle), scaled(NOTI_HEIGHT));
	*rotation = angle;
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
