/* One watch on the call and earjack keys for every recorder, player and route listener: vconf removes
   callbacks by function, so each user cannot register its own. */
#include "media/media_policy.h"

#include <dlog.h>
#include <stdlib.h>
#include <vconf.h>

typedef struct listener_s {
	media_policy_cb cb;
	void *data;
	bool removed;
	struct listener_s *next;
} listener_t;

static listener_t *__listeners;
static int __dispatching;
static bool __watching;

static int __key_int(const char *key)
{
	int value = 0;
	return vconf_get_int(key, &value) == VCONF_OK ? value : 0;
}

bool media_policy_in_call(void)
{
	return __key_int(VCONFKEY_CALL_STATE) != VCONFKEY_CALL_OFF;
}

int media_policy_earjack(void)
{
	return __key_int(VCONFKEY_SYSMAN_EARJACK);
}

static void __sweep(void)
{
	if (__dispatching)
		return;
	for (listener_t **link = &__listeners; *link;) {
		listener_t *l = *link;
		if (l->removed) {
			*link = l->next;
			free(l);
		} else {
			link = &l->next;
		}
	}
}

static void __dispatch(media_policy_event_e event, int value)
{
	__dispatching++;
	for (listener_t *l = __listeners; l; l = l->next)
		if (!l->removed)
			l->cb(event, value, l->data);
	__dispatching--;
	__sweep();
}

static void __call_changed_cb(keynode_t *node, void *data)
{
	(void)data;
	__dispatch(MEDIA_POLICY_CALL, vconf_keynode_get_int(node) != VCONFKEY_CALL_OFF);
}

static void __earjack_changed_cb(keynode_t *node, void *data)
{
	(void)data;
	__dispatch(MEDIA_POLICY_EARJACK, vconf_keynode_get_int(node));
}

bool media_policy_listen(media_policy_cb cb, void *data)
{
	if (!__watching) {
		if (vconf_notify_key_changed(VCONFKEY_CALL_STATE, __call_changed_cb, NULL) != VCONF_OK) {
			LOGE("cannot watch %s", VCONFKEY_CALL_STATE);
			return false;
		}
		if (vconf_notify_key_changed(VCONFKEY_SYSMAN_EARJACK, __earjack_changed_cb, NULL) != VCONF_OK) {
			LOGE("cannot watch %s", VCONFKEY_SYSMAN_EARJACK);
			vconf_ignore_key_changed(VCONFKEY_CALL_STATE, __call_changed_cb);
			return false;
		}
		__watching = true;
	}
	listener_t *l = calloc(1, sizeof(*l));
	if (!l)
		return false;
	l->cb = cb;
	l->data = data;
	listener_t **link = &__listeners;
	while (*link)
		link = &(*link)->next;
	*link = l;
	return true;
}

void media_policy_unlisten(media_policy_cb cb, void *data)
{
	bool live = false;
	for (listener_t *l = __listeners; l; l = l->next) {
		if (l->cb == cb && l->data == data)
			l->removed = true;
		live = live || !l->removed;
	}
	__sweep();
	if (!live && __watching) {
		vconf_ignore_key_changed(VCONFKEY_CALL_STATE, __call_changed_cb);
		vconf_ignore_key_changed(VCONFKEY_SYSMAN_EARJACK, __earjack_changed_cb);
		__watching = false;
	}
}
