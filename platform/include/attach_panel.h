#ifndef __TIZEN_ATTACH_PANEL_H__
#define __TIZEN_ATTACH_PANEL_H__

#include <Evas.h>
#include <app_control.h>
#include <bundle.h>
#include <tizen.h>

#ifdef __cplusplus
extern "C" {
#endif

/* A panel docked at the foot of a conformant that picks content for the app. On the desktop the picture,
   video, audio and file categories show a file selector filtered by type; the camera, voice, calendar and
   contact categories are not offered. The environment variable TIZEN_ATTACH_PANEL_AUTOSELECT ("/a:/b")
   makes attach_panel_show() hand those paths to the result callback instead of showing the selector. */
typedef struct _attach_panel *attach_panel_h;

typedef enum {
	ATTACH_PANEL_CONTENT_CATEGORY_IMAGE = 1,
	ATTACH_PANEL_CONTENT_CATEGORY_CAMERA,
	ATTACH_PANEL_CONTENT_CATEGORY_VOICE,
	ATTACH_PANEL_CONTENT_CATEGORY_VIDEO,
	ATTACH_PANEL_CONTENT_CATEGORY_AUDIO,
	ATTACH_PANEL_CONTENT_CATEGORY_CALENDAR,
	ATTACH_PANEL_CONTENT_CATEGORY_CONTACT,
	ATTACH_PANEL_CONTENT_CATEGORY_MYFILES,
	ATTACH_PANEL_CONTENT_CATEGORY_VIDEO_RECORDER,
} attach_panel_content_category_e;

typedef enum {
	ATTACH_PANEL_EVENT_SHOW_START = 1,
	ATTACH_PANEL_EVENT_SHOW_FINISH,
	ATTACH_PANEL_EVENT_HIDE_START,
	ATTACH_PANEL_EVENT_HIDE_FINISH,
} attach_panel_event_e;

typedef enum {
	ATTACH_PANEL_ERROR_NONE = TIZEN_ERROR_NONE,
	ATTACH_PANEL_ERROR_INVALID_PARAMETER = TIZEN_ERROR_INVALID_PARAMETER,
	ATTACH_PANEL_ERROR_OUT_OF_MEMORY = TIZEN_ERROR_OUT_OF_MEMORY,
	ATTACH_PANEL_ERROR_PERMISSION_DENIED = TIZEN_ERROR_PERMISSION_DENIED,
	ATTACH_PANEL_ERROR_ALREADY_EXISTS = TIZEN_ERROR_PANEL | 0x01,
	ATTACH_PANEL_ERROR_NOT_INITIALIZED = TIZEN_ERROR_PANEL | 0x02,
	ATTACH_PANEL_ERROR_UNSUPPORTED_CONTENT_CATEGORY = TIZEN_ERROR_PANEL | 0x03,
	ATTACH_PANEL_ERROR_ALREADY_DESTROYED = TIZEN_ERROR_PANEL | 0x05,
} attach_panel_error_e;

/* The chosen paths come in `result` as the array APP_CONTROL_DATA_SELECTED, and the same array under
   APP_CONTROL_DATA_PATH, with `result_code` APP_CONTROL_RESULT_SUCCEEDED. */
typedef void (*attach_panel_result_cb)(attach_panel_h attach_panel, attach_panel_content_category_e content_category,
                                       app_control_h result, app_control_result_e result_code, void *user_data);

/* One panel per conformant: a second gives ALREADY_EXISTS. */
int attach_panel_create(Evas_Object *conformant, attach_panel_h *attach_panel);
int attach_panel_destroy(attach_panel_h attach_panel);
/* The extra data is copied; "http://tizen.org/appcontrol/data/total_count" (or "max-count") caps how many
   items one pick returns. A category added twice gives ALREADY_EXISTS. */
int attach_panel_add_content_category(attach_panel_h attach_panel, attach_panel_content_category_e content_category,
                                      bundle *extra_data);
int attach_panel_remove_content_category(attach_panel_h attach_panel, attach_panel_content_category_e content_category);
/* Replaces the extra data of a category that was added (INVALID_PARAMETER otherwise). */
int attach_panel_set_extra_data(attach_panel_h attach_panel, attach_panel_content_category_e content_category,
                                bundle *extra_data);
int attach_panel_set_result_cb(attach_panel_h attach_panel, attach_panel_result_cb result_cb, void *user_data);
int attach_panel_unset_result_cb(attach_panel_h attach_panel);
int attach_panel_show(attach_panel_h attach_panel);
int attach_panel_hide(attach_panel_h attach_panel);
int attach_panel_get_visibility(attach_panel_h attach_panel, bool *visible);

#ifdef __cplusplus
}
#endif

#endif /* __TIZEN_ATTACH_PANEL_H__ */
