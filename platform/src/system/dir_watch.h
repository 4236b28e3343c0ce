#ifndef PLATFORM_SRC_SYSTEM_DIR_WATCH_H
#define PLATFORM_SRC_SYSTEM_DIR_WATCH_H

#include <stdbool.h>

/* Reports changes to the key files of a folder (see key_file_store.h) made by any process, on the
   Ecore main loop. Built on inotify: a rename over a key file or a direct write reports CHANGED, a
   deletion REMOVED; temporary files are ignored. */

typedef enum {
	DIR_WATCH_CHANGED,
	DIR_WATCH_REMOVED,
} dir_watch_event_e;

typedef void (*dir_watch_cb)(const char *key, dir_watch_event_e event, void *data);

typedef struct dir_watch_s dir_watch_t;

/* Starts watching dir (created if missing); initialises Ecore for its own use.
   NULL on failure (logged). Free with dir_watch_free. */
dir_watch_t *dir_watch_new(const char *dir, dir_watch_cb cb, void *data);

/* Stops the watch; safe to call from inside its own callback. */
void dir_watch_free(dir_watch_t *watch);

/* The folder watched. */
const char *dir_watch_path(const dir_watch_t *watch);

#endif
