#ifndef __TIZEN_APPFW_APP_H__
#define __TIZEN_APPFW_APP_H__

#include <app_common.h>
#include <app_control.h>
#include <app_i18n.h>
#include <app_preference.h>
#include <tizen.h>

#ifdef __cplusplus
extern "C" {
#endif

typedef bool (*app_create_cb)(void *user_data);
typedef void (*app_pause_cb)(void *user_data);
typedef void (*app_resume_cb)(void *user_data);
typedef void (*app_terminate_cb)(void *user_data);
typedef void (*app_control_cb)(app_control_h app_control, void *user_data);

typedef struct {
	app_create_cb create;
	app_terminate_cb terminate;
	app_pause_cb pause;
	app_resume_cb resume;
	app_control_cb app_control;
} ui_app_lifecycle_callback_s;

/* Runs the application: Elementary init, create (false ends the app), the first app_control built from argv
   (--operation/--uri/--mime/--extra k=v/--extra-array k=a,b), the main loop, then terminate.
   When another instance with the same app id is running, forwards the argv request to it and returns
   APP_ERROR_NONE at once. Returns APP_ERROR_ALREADY_RUNNING when called while running, INVALID_PARAMETER on
   bad arguments, INVALID_CONTEXT when create() refused. */
int ui_app_main(int argc, char **argv, ui_app_lifecycle_callback_s *callback, void *user_data);
/* Ends the main loop; terminate runs on the way out of ui_app_main. */
void ui_app_exit(void);

/* Registers a system event callback; *event_handler is freed by ui_app_remove_event_handler. */
int ui_app_add_event_handler(app_event_handler_h *event_handler, app_event_type_e event_type, app_event_cb callback,
                             void *user_data);
int ui_app_remove_event_handler(app_event_handler_h event_handler);

#ifdef __cplusplus
}
#endif

#endif /* __TIZEN_APPFW_APP_H__ */
