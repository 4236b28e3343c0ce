#ifndef __TIZEN_APPFW_APP_TYPES_H__
#define __TIZEN_APPFW_APP_TYPES_H__

#include <tizen.h>

#ifdef __cplusplus
extern "C" {
#endif

/* Error codes of the application API. */
typedef enum {
	APP_ERROR_NONE = TIZEN_ERROR_NONE,
	APP_ERROR_INVALID_PARAMETER = TIZEN_ERROR_INVALID_PARAMETER,
	APP_ERROR_OUT_OF_MEMORY = TIZEN_ERROR_OUT_OF_MEMORY,
	APP_ERROR_INVALID_CONTEXT = TIZEN_ERROR_APPLICATION | 0x01,
	APP_ERROR_NO_SUCH_FILE = TIZEN_ERROR_NO_SUCH_FILE,
	APP_ERROR_ALREADY_RUNNING = TIZEN_ERROR_ALREADY_IN_PROGRESS,
	APP_ERROR_PERMISSION_DENIED = TIZEN_ERROR_PERMISSION_DENIED,
} app_error_e;

/* System events an application can listen to. */
typedef enum {
	APP_EVENT_LOW_MEMORY,
	APP_EVENT_LOW_BATTERY,
	APP_EVENT_LANGUAGE_CHANGED,
	APP_EVENT_DEVICE_ORIENTATION_CHANGED,
	APP_EVENT_REGION_FORMAT_CHANGED,
	APP_EVENT_SUSPENDED_STATE_CHANGED,
} app_event_type_e;

/* Orientation of the device, in degrees. */
typedef enum {
	APP_DEVICE_ORIENTATION_0 = 0,
	APP_DEVICE_ORIENTATION_90 = 90,
	APP_DEVICE_ORIENTATION_180 = 180,
	APP_DEVICE_ORIENTATION_270 = 270,
} app_device_orientation_e;

typedef enum {
	APP_EVENT_LOW_MEMORY_NORMAL = 0x01,
	APP_EVENT_LOW_MEMORY_SOFT_WARNING = 0x02,
	APP_EVENT_LOW_MEMORY_HARD_WARNING = 0x04,
} app_event_low_memory_status_e;

typedef enum {
	APP_EVENT_LOW_BATTERY_POWER_OFF = 1,
	APP_EVENT_LOW_BATTERY_CRITICAL_LOW,
} app_event_low_battery_status_e;

typedef enum {
	APP_SUSPENDED_STATE_WILL_ENTER = 0,
	APP_SUSPENDED_STATE_DID_EXIT,
} app_suspended_state_e;

typedef struct app_event_handler *app_event_handler_h;
typedef struct app_event_info *app_event_info_h;

/* Called on the main loop when a registered system event happens; event_info lives for the call only. */
typedef void (*app_event_cb)(app_event_info_h event_info, void *user_data);

#ifdef __cplusplus
}
#endif

#endif /* __TIZEN_APPFW_APP_TYPES_H__ */
