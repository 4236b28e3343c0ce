/* The viewer side of the minicontrol windows of this process, for tools and tests. */
#ifndef PLATFORM_INCLUDE_DESKTOP_MINICONTROL_VIEWER_H
#define PLATFORM_INCLUDE_DESKTOP_MINICONTROL_VIEWER_H

#include <minicontrol-provider.h>
#include <stdbool.h>

#ifdef __cplusplus
extern "C" {
#endif

/* The live window made with that name (the latest one), or NULL. */
Evas_Object *minicontrol_viewer_window_find(const char *name);

/* The target the window was made for, or 0 for any other object. */
int minicontrol_viewer_target_get(Evas_Object *win);

/* True when the provider has shown the window, whether or not the viewer lets it be seen now. */
bool minicontrol_viewer_shown_by_provider(Evas_Object *win);

/* Calls the window's provider callback as its viewer would; MINICONTROL_ERROR_INVALID_PARAMETER for an
   object that is no minicontrol window. */
int minicontrol_viewer_event_send(Evas_Object *win, int event, bundle *event_arg);

/* The viewers turn to angle (0, 90, 180 or 270): posts the illume root-angle client message and sends
   REPORT_ANGLE to every window. */
void minicontrol_viewer_angle_report(int angle);

#ifdef __cplusplus
}
#endif

#endif
