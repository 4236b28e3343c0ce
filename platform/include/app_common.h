#ifndef __TIZEN_APPFW_APP_COMMON_H__
#define __TIZEN_APPFW_APP_COMMON_H__

#include <app_types.h>

#ifdef __cplusplus
extern "C" {
#endif

/* Event payload readers: valid inside an app_event_cb only. The strings are malloc'ed; the caller frees them.
   A reader of the wrong event kind returns APP_ERROR_INVALID_CONTEXT. */
int app_event_get_low_memory_status(app_event_info_h event_info, app_event_low_memory_status_e *status);
int app_event_get_low_battery_status(app_event_info_h event_info, app_event_low_battery_status_e *status);
int app_event_get_language(app_event_info_h event_info, char **lang);
int app_event_get_region_format(app_event_info_h event_info, char **region);
int app_event_get_device_orientation(app_event_info_h event_info, app_device_orientation_e *orientation);
int app_event_get_suspended_state(app_event_info_h event_info, app_suspended_state_e *state);

/* Application identity: app id (TIZEN_APP_ID, else the manifest beside the executable, else the executable's
   name), the manifest's label and version. Results are malloc'ed; the caller frees them. */
int app_get_id(char **id);
int app_get_name(char **name);
int app_get_version(char **version);

/* Folders of the application, malloc'ed, ending in "/", created on demand; NULL on failure. */
char *app_get_data_path(void);
char *app_get_cache_path(void);
char *app_get_resource_path(void);
char *app_get_shared_data_path(void);
char *app_get_shared_resource_path(void);
char *app_get_shared_trusted_path(void);
char *app_get_external_data_path(void);
char *app_get_external_cache_path(void);
char *app_get_external_shared_data_path(void);

/* The current device orientation (vconf "memory/desktop/rotation"). */
app_device_orientation_e app_get_device_orientation(void);

#ifdef __cplusplus
}
#endif

#endif /* __TIZEN_APPFW_APP_COMMON_H__ */
