#ifndef __MINICONTROL_PROVIDER_H__
#define __MINICONTROL_PROVIDER_H__

/* Small windows of an app that other parts of the system show: the notification panel and the lock screen.
   On the desktop each is a real undecorated Elementary window kept above the others: the notification
   panel's docked at the top edge of the screen, the lock screen's at the bottom edge and shown only while
   vconf "memory/idle_lock/state" says locked. Viewer events reach the callback on the main loop: 100 when
   the user closes the window, and for a screen rotation (vconf "memory/desktop/rotation") an illume
   root-angle client message (ECORE_X_EVENT_CLIENT_MESSAGE) and REPORT_ANGLE. */
#include <Evas.h>
#include <bundle.h>
#include <minicontrol-error.h>
#include <minicontrol-type.h>

#ifdef __cplusplus
extern "C" {
#endif

typedef void (*minicontrol_event_cb)(minicontrol_viewer_event_e event_type, bundle *event_arg);

/* A new hidden window named name for the viewer, or NULL (get_last_result() tells why). The callback may be
   NULL. The caller sizes, shows and deletes it. */
Evas_Object *minicontrol_create_window(const char *name, minicontrol_target_viewer_e target_viewer,
                                       minicontrol_event_cb callback);

/* Asks the viewer: REQUEST_HIDE hides the window, REQUEST_ANGLE has the viewer report its angle. A lock-screen
   window kept out of sight while unlocked takes a hide only this way (or by being deleted): Evas passes no
   evas_object_hide of an object that is hidden.
   MINICONTROL_ERROR_INVALID_PARAMETER for another window or event. */
int minicontrol_send_event(Evas_Object *mincontrol, minicontrol_provider_event_e event, bundle *event_arg);

#ifdef __cplusplus
}
#endif

#endif
