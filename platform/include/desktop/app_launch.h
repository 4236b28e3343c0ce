#ifndef __DESKTOP_APP_LAUNCH_H__
#define __DESKTOP_APP_LAUNCH_H__

/* Desktop-only companion of app_control_send_launch_request, for short-lived tools. */

#ifdef __cplusplus
extern "C" {
#endif

/* Messages that need no answer (requests sent without a reply callback, terminate, message port
   messages) are handed over on the main loop. Runs the loop until every such message of this process
   has been taken by its receiver, or the time is up: APP_CONTROL_ERROR_NONE or
   APP_CONTROL_ERROR_TIMED_OUT. Call it before a process that sent requests ends. */
int desktop_app_launch_drain(double timeout_sec);

#ifdef __cplusplus
}
#endif

#endif
