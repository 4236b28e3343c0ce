#ifndef __DESKTOP_TOAST_LOG_H__
#define __DESKTOP_TOAST_LOG_H__

/* Desktop-only view on the toasts of notification_status_message_post, for tests and tools. */
#include <Evas.h>

#ifdef __cplusplus
extern "C" {
#endif

/* Number of messages posted in this process since start or the last clear (the newest 256 are kept). */
int desktop_toast_log_count(void);

/* The index-th posted message, oldest first; NULL out of range. The log owns it. */
const char *desktop_toast_log_get(int index);

/* Forgets the posted messages (the toast on screen stays). */
void desktop_toast_log_clear(void);

/* The toast popup now on screen, or NULL when none is shown. */
Evas_Object *desktop_toast_current_get(void);

#ifdef __cplusplus
}
#endif

#endif
