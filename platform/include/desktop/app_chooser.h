#ifndef __DESKTOP_APP_CHOOSER_H__
#define __DESKTOP_APP_CHOOSER_H__

/* Desktop-only view on the chooser window that a launch request without an app id opens when several
   registered apps take its operation, for tests and tools. */
#include <Evas.h>

#ifdef __cplusplus
extern "C" {
#endif

/* Name of the chooser's app list (an elm_list) on the window's canvas, for evas_object_name_find.
   Each item's data is the app id (const char *); selecting an item sends the request to that app. */
#define DESKTOP_APP_CHOOSER_LIST_NAME "app_chooser_list"

/* The newest chooser window open in this process, or NULL. Deleting it cancels its request. */
Evas_Object *desktop_app_chooser_current_get(void);

#ifdef __cplusplus
}
#endif

#endif
