#ifndef __TIZEN_APPFW_MESSAGE_PORT_H__
#define __TIZEN_APPFW_MESSAGE_PORT_H__

/* Named ports on which an app receives bundles from other apps. A local port is open while the
   process lives or until it is unregistered; messages arrive on the main loop. */
#include <bundle.h>
#include <tizen.h>

#ifdef __cplusplus
extern "C" {
#endif

typedef enum {
	MESSAGE_PORT_ERROR_NONE = TIZEN_ERROR_NONE,
	MESSAGE_PORT_ERROR_IO_ERROR = TIZEN_ERROR_IO_ERROR,
	MESSAGE_PORT_ERROR_OUT_OF_MEMORY = TIZEN_ERROR_OUT_OF_MEMORY,
	MESSAGE_PORT_ERROR_INVALID_PARAMETER = TIZEN_ERROR_INVALID_PARAMETER,
	MESSAGE_PORT_ERROR_PORT_NOT_FOUND = TIZEN_ERROR_MESSAGE_PORT | 0x01,
	MESSAGE_PORT_ERROR_CERTIFICATE_NOT_MATCH = TIZEN_ERROR_MESSAGE_PORT | 0x02,
	MESSAGE_PORT_ERROR_MAX_EXCEEDED = TIZEN_ERROR_MESSAGE_PORT | 0x03,
	MESSAGE_PORT_ERROR_RESOURCE_UNAVAILABLE = TIZEN_ERROR_MESSAGE_PORT | 0x04,
} message_port_error_e;

/* remote_port is NULL: senders here have no port of their own. The bundle is freed after the call. */
typedef void (*message_port_message_cb)(int local_port_id, const char *remote_app_id, const char *remote_port,
                                        bool trusted_remote_port, bundle *message, void *user_data);

/* The port's id (> 0), or a negative error. Registering a name again replaces its callback. */
int message_port_register_local_port(const char *local_port, message_port_message_cb callback, void *user_data);
int message_port_unregister_local_port(int local_port_id);
/* *exist tells whether the app listens on the port now. */
int message_port_check_remote_port(const char *remote_app_id, const char *remote_port, bool *exist);
/* Delivered on the main loop; MESSAGE_PORT_ERROR_PORT_NOT_FOUND when nobody listens. */
int message_port_send_message(const char *remote_app_id, const char *remote_port, bundle *message);

#ifdef __cplusplus
}
#endif

#endif /* __TIZEN_APPFW_MESSAGE_PORT_H__ */
