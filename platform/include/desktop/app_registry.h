#ifndef __DESKTOP_APP_REGISTRY_H__
#define __DESKTOP_APP_REGISTRY_H__

/* Desktop-only view on the launch registry ("<id>.ini" files in TIZEN_APPS_DIR and the built-in folder),
   for tools and tests. */
#include <stdbool.h>

#ifdef __cplusplus
extern "C" {
#endif

/* Called once per registered app (the first folder wins for a duplicate id); return false to stop.
   The strings live for the call only. */
typedef bool (*desktop_app_registry_cb)(const char *app_id, const char *exec, void *user_data);

/* Walks the registry; 0, or TIZEN_ERROR_INVALID_PARAMETER for a NULL callback. */
int desktop_app_registry_foreach(desktop_app_registry_cb callback, void *user_data);

#ifdef __cplusplus
}
#endif

#endif
