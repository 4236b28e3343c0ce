#ifndef __NOTIFICATION_STATUS_H__
#define __NOTIFICATION_STATUS_H__

#include <notification_error.h>

#ifdef __cplusplus
extern "C" {
#endif

/* Shows message as a toast for about two seconds in this process's visible window and logs it.
   With no window only the log line remains. NOTIFICATION_ERROR_INVALID_PARAMETER on NULL. */
int notification_status_message_post(const char *message);

#ifdef __cplusplus
}
#endif

#endif
