#ifndef __TIZEN_APPFW_APP_MANAGER_H__
#define __TIZEN_APPFW_APP_MANAGER_H__

#include <app_context.h>
#include <app_info.h>
#include <tizen.h>

#ifdef __cplusplus
extern "C" {
#endif

typedef enum {
	APP_MANAGER_ERROR_NONE = TIZEN_ERROR_NONE,
	APP_MANAGER_ERROR_INVALID_PARAMETER = TIZEN_ERROR_INVALID_PARAMETER,
	APP_MANAGER_ERROR_OUT_OF_MEMORY = TIZEN_ERROR_OUT_OF_MEMORY,
	APP_MANAGER_ERROR_IO_ERROR = TIZEN_ERROR_IO_ERROR,
	APP_MANAGER_ERROR_NO_SUCH_APP = TIZEN_ERROR_APPLICATION_MANAGER | 0x01,
	APP_MANAGER_ERROR_DB_FAILED = TIZEN_ERROR_APPLICATION_MANAGER | 0x03,
	APP_MANAGER_ERROR_INVALID_PACKAGE = TIZEN_ERROR_APPLICATION_MANAGER | 0x04,
	APP_MANAGER_ERROR_APP_NO_RUNNING = TIZEN_ERROR_APPLICATION_MANAGER | 0x05,
	APP_MANAGER_ERROR_REQUEST_FAILED = TIZEN_ERROR_APPLICATION_MANAGER | 0x06,
	APP_MANAGER_ERROR_PERMISSION_DENIED = TIZEN_ERROR_PERMISSION_DENIED,
} app_manager_error_e;

/* Context of a running app (NO_SUCH_APP when it is not running); destroy it with app_context_destroy. */
int app_manager_get_app_context(const char *app_id, app_context_h *app_context);
/* Whether an app with this id answers on its launch socket. */
int app_manager_is_running(const char *app_id, bool *running);
/* Brings the app's window to the front. */
int app_manager_resume_app(app_context_h app_context);
/* Registry entry of an app (NO_SUCH_APP when unknown); destroy it with app_info_destroy. */
int app_manager_get_app_info(const char *app_id, app_info_h *app_info);
/* The id of the app running in process pid (only this process is known). */
int app_manager_get_app_id(pid_t pid, char **app_id);

#ifdef __cplusplus
}
#endif

#endif /* __TIZEN_APPFW_APP_MANAGER_H__ */
