/* Change callbacks on the keys of a key file folder, shared by the vconf and preference stores. */
#define _GNU_SOURCE
#include "system/key_watch.h"

#include <stdlib.h>
#include <string.h>

/* Unlinks watchers removed during dispatch, and stops the folder watch once none is left. */
static void __sweep(key_watch_list_t *list)
{
	if (list->dispatch_depth > 0)
		return;
	key_watcher_t **link = &list->watchers;
	while (*link) {
		key_watcher_t *w = *link;
		if (w->removed) {
			*link = w->next;
			free(w->key);
			free(w);
		} else {
			link = &w->next;
		}
	}
	if (!list->watchers && list->watch) {
		dir_watch_free(list->watch);
		list->watch = NULL;
	}
}

static void __keyChangedCb(const char *key, dir_watch_event_e event, void *data)
{
	key_watch_list_t *list = data;
	/* A removal is no value to report; the registration stays for when the key comes back. */
	if (event != DIR_WATCH_CHANGED)
		return;
	list->dispatch_depth++;
	for (key_watcher_t *w = list->watchers; w; w = w->next)
		if (!w->removed && !strcmp(w->key, key) && !list->deliver(w, key))
			break;
	list->dispatch_depth--;
	__sweep(list);
}

bool key_watch_start(key_watch_list_t *list, char *(*dir_n)(void))
{
	if (list->watch)
		return true;
	char *dir = dir_n();
	list->watch = dir ? dir_watch_new(dir, __keyChangedCb, list) : NULL;
	free(dir);
	return list->watch != NULL;
}

key_watcher_t *key_watch_find(const key_watch_list_t *list, const char *key)
{
	for (key_watcher_t *w = list->watchers; w; w = w->next)
		if (!w->removed && !strcmp(w->key, key))
			return w;
	return NULL;
}

key_watcher_t *key_watch_add(key_watch_list_t *list, const char *key, key_watch_fn cb, void *user_data)
{
	key_watcher_t *w = calloc(1, sizeof(*w));
	if (!w || !(w->key = strdup(key))) {
		free(w);
		__sweep(list);
		return NULL;
	}
	w->cb = cb;
	w->user_data = user_data;
	key_watcher_t **link = &list->watchers;
	while (*link)
		link = &(*link)->next;
	*link = w;
	return w;
}

bool key_watch_remove(key_watch_list_t *list, const char *key, key_watch_fn cb)
{
	bool found = false;
	for (key_watcher_t *w = list->watchers; w; w = w->next) {
		if (!w->removed && (!cb || w->cb == cb) && !strcmp(w->key, key)) {
			w->removed = true;
			found = true;
		}
	}
	if (found)
		__sweep(list);
	return found;
}
