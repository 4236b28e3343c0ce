#ifndef __TIZEN_APPFW_APP_RESOURCE_MANAGER_H__
#define __TIZEN_APPFW_APP_RESOURCE_MANAGER_H__

#include <tizen.h>

#ifdef __cplusplus
extern "C" {
#endif

typedef enum {
	APP_RESOURCE_TYPE_IMAGE = 0,
	APP_RESOURCE_TYPE_LAYOUT,
	APP_RESOURCE_TYPE_SOUND,
	APP_RESOURCE_TYPE_BIN,
	APP_RESOURCE_TYPE_MIN = APP_RESOURCE_TYPE_IMAGE,
	APP_RESOURCE_TYPE_MAX = APP_RESOURCE_TYPE_BIN,
} app_resource_e;

typedef enum {
	APP_RESOURCE_ERROR_NONE = TIZEN_ERROR_NONE,
	APP_RESOURCE_ERROR_INVALID_PARAMETER = TIZEN_ERROR_INVALID_PARAMETER,
	APP_RESOURCE_ERROR_OUT_OF_MEMORY = TIZEN_ERROR_OUT_OF_MEMORY,
	APP_RESOURCE_ERROR_IO_ERROR = TIZEN_ERROR_IO_ERROR,
} app_resource_error_e;

/* Opens the resource manager (counted: each init needs one release). */
int app_resource_manager_init(void);
/* Resolves a resource id such as "edje/memo.edj" to "<resource path><id>" in *path (malloc'ed, caller frees).
   A missing file gives APP_RESOURCE_ERROR_IO_ERROR and a log line. */
int app_resource_manager_get(app_resource_e type, const char *id, char **path);
int app_resource_manager_release(void);

#ifdef __cplusplus
}
#endif

#endif /* __TIZEN_APPFW_APP_RESOURCE_MANAGER_H__ */
