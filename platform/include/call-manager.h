#ifndef __CALL_MANAGER_H__
#define __CALL_MANAGER_H__

#include <tizen.h>

#ifdef __cplusplus
extern "C" {
#endif

#ifndef TIZEN_ERROR_CALL_MANAGER
#define TIZEN_ERROR_CALL_MANAGER -0x00000000
#endif

typedef struct __cm_client *cm_client_h;

typedef enum {
	CM_ERROR_NONE = TIZEN_ERROR_NONE,
	CM_ERROR_OUT_OF_MEMORY = TIZEN_ERROR_OUT_OF_MEMORY,
	CM_ERROR_INVALID_PARAMETER = TIZEN_ERROR_INVALID_PARAMETER,
	CM_ERROR_PERMISSION_DENIED = TIZEN_ERROR_PERMISSION_DENIED,
	CM_ERROR_NOT_SUPPORTED = TIZEN_ERROR_NOT_SUPPORTED,
	CM_ERROR_NOT_REGISTERED = TIZEN_ERROR_CALL_MANAGER | 0x01,
	CM_ERROR_ALREADY_REGISTERED = TIZEN_ERROR_CALL_MANAGER | 0x02,
	CM_ERROR_OPERATION_FAILED = TIZEN_ERROR_CALL_MANAGER | 0x03,
} cm_error_e;

typedef enum {
	CM_CALL_STATUS_IDLE,
	CM_CALL_STATUS_RINGING,
	CM_CALL_STATUS_OFFHOOK,
	CM_CALL_STATUS_MAX
} cm_call_status_e;

/* call_num is the number of the call, "" when unknown; valid during the call only. */
typedef void (*cm_call_status_cb)(cm_call_status_e call_status, const char *call_num, void *user_data);

/* A client of the call manager. On the desktop the call state is the vconf key "memory/call/state"
   (0 off, 1/3 connecting -> RINGING, 2/4 active -> OFFHOOK) and the number "memory/desktop/call/number". */
int cm_init(cm_client_h *handle);
/* Removes the client's status callback and frees it. */
int cm_deinit(cm_client_h handle);
int cm_get_call_status(cm_client_h handle, cm_call_status_e *call_status);
/* Calls cb on the Ecore main loop whenever the call state is set; one callback per client
   (CM_ERROR_ALREADY_REGISTERED for a second one). */
int cm_set_call_status_cb(cm_client_h handle, cm_call_status_cb cb, void *user_data);
/* CM_ERROR_NOT_REGISTERED when none was set. */
int cm_unset_call_status_cb(cm_client_h handle);

#ifdef __cplusplus
}
#endif

#endif /* __CALL_MANAGER_H__ */
