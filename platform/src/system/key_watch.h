#ifndef PLATFORM_SRC_SYSTEM_KEY_WATCH_H
#define PLATFORM_SRC_SYSTEM_KEY_WATCH_H

#include <stdbool.h>

#include "system/dir_watch.h"

/* The change callbacks registered on the keys of one key file folder (see key_file_store.h). The
   folder is watched while at least one callback is registered. Callbacks may be removed from inside
   a callback: they are skipped at once and unlinked when the dispatch is over. */

/* Any callback type, cast back by the store that registered it. */
typedef void (*key_watch_fn)(void);

typedef struct key_watcher_s {
	char *key;
	key_watch_fn cb;
	void *user_data;
	bool removed;
	struct key_watcher_s *next;
} key_watcher_t;

/* Hands a change of `key` to one watcher; false stops the dispatch of this change. */
typedef bool (*key_watch_deliver_cb)(key_watcher_t *watcher, const char *key);

typedef struct {
	key_watch_deliver_cb deliver; /* set by the store */
	key_watcher_t *watchers;
	dir_watch_t *watch;
	int dispatch_depth;
} key_watch_list_t;

/* Starts watching the folder that dir_n() names (malloc'ed, may be NULL) unless already watching.
   False when the watch cannot start. */
bool key_watch_start(key_watch_list_t *list, char *(*dir_n)(void));

/* The first live watcher of key, or NULL. */
key_watcher_t *key_watch_find(const key_watch_list_t *list, const char *key);

/* Appends a watcher, so that callbacks run in the order they were added. NULL when out of memory
   (the folder watch stops again if nothing else is registered). */
key_watcher_t *key_watch_add(key_watch_list_t *list, const char *key, key_watch_fn cb, void *user_data);

/* Removes the live watchers of key, only those with callback cb unless cb is NULL. False when
   there was none. */
bool key_watch_remove(key_watch_list_t *list, const char *key, key_watch_fn cb);

#endif
