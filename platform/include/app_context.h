#ifndef __TIZEN_APPFW_APP_CONTEXT_H__
#define __TIZEN_APPFW_APP_CONTEXT_H__

#include <sys/types.h>
#include <tizen.h>

#ifdef __cplusplus
extern "C" {
#endif

/* A running application (id and pid), from app_manager_get_app_context. */
typedef struct app_context_s *app_context_h;

typedef enum {
	APP_CONTEXT_EVENT_LAUNCHED,
	APP_CONTEXT_EVENT_TERMINATED,
} app_context_event_e;

int app_context_destroy(app_context_h app_context);
/* The id (malloc'ed) and process id of the context's app. */
int app_context_get_app_id(app_context_h app_context, char **app_id);
int app_context_get_pid(app_context_h app_context, pid_t *pid);
int app_context_clone(app_context_h *clone, app_context_h app_context);

#ifdef __cplusplus
}
#endif

#endif /* __TIZEN_APPFW_APP_CONTEXT_H__ */
