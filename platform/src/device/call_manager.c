/* Call manager clients over the call state key: a desktop has no modem, so the call state is
   whatever "memory/call/state" says (settable with vconftool to simulate a call). */
#include <call-manager.h>

#include <dlog.h>
#include <stdlib.h>
#include <string.h>

#include <vconf.h>

#define CALL_NUMBER_KEY "memory/desktop/call/number"

struct __cm_client {
	cm_call_status_cb cb;
	void *user_data;
	struct __cm_client *next; /* in the list of clients with a callback */
};

/* Clients with a callback; the key is watched while this is not empty. */
static struct __cm_client *__watchers;

static cm_call_status_e __status_of(int state)
{
	switch (state) {
	case VCONFKEY_CALL_VOICE_CONNECTING:
	case VCONFKEY_CALL_VIDEO_CONNECTING:
		return CM_CALL_STATUS_RINGING;
	case VCONFKEY_CALL_VOICE_ACTIVE:
	case VCONFKEY_CALL_VIDEO_ACTIVE:
		return CM_CALL_STATUS_OFFHOOK;
	default:
		return CM_CALL_STATUS_IDLE;
	}
}

static bool __is_watching(struct __cm_client *client)
{
	for (struct __cm_client *c = __watchers; c; c = c->next)
		if (c == client)
			return true;
	return false;
}

static void __call_state_changed_cb(keynode_t *node, void *user_data)
{
	(void)user_data;
	cm_call_status_e status = __status_of(vconf_keynode_get_int(node));
	char *number = vconf_get_str(CALL_NUMBER_KEY);

	/* A callback may remove clients (itself included): walk a snapshot and skip the removed. */
	size_t count = 0;
	for (struct __cm_client *c = __watchers; c; c = c->next)
		count++;
	struct __cm_client **snapshot = count ? calloc(count, sizeof(*snapshot)) : NULL;
	if (snapshot) {
		size_t i = 0;
		for (struct __cm_client *c = __watchers; c; c = c->next)
			snapshot[i++] = c;
		for (i = 0; i < count; i++)
			if (__is_watching(snapshot[i]))
				snapshot[i]->cb(status, number ? number : "", snapshot[i]->user_data);
		free(snapshot);
	}
	free(number);
}

static void __unwatch(struct __cm_client *client)
{
	for (struct __cm_client **p = &__watchers; *p; p = &(*p)->next) {
		if (*p == client) {
			*p = client->next;
			break;
		}
	}
	client->next = NULL;
	client->cb = NULL;
	client->user_data = NULL;
	if (!__watchers)
		vconf_ignore_key_changed(VCONFKEY_CALL_STATE, __call_state_changed_cb);
}

int cm_init(cm_client_h *handle)
{
	if (!handle)
		return CM_ERROR_INVALID_PARAMETER;
	*handle = calloc(1, sizeof(struct __cm_client));
	return *handle ? CM_ERROR_NONE : CM_ERROR_OUT_OF_MEMORY;
}

int cm_deinit(cm_client_h handle)
{
	if (!handle)
		return CM_ERROR_INVALID_PARAMETER;
	if (handle->cb)
		__unwatch(handle);
	free(handle);
	return CM_ERROR_NONE;
}

int cm_get_call_status(cm_client_h handle, cm_call_status_e *call_status)
{
	if (!handle || !call_status)
		return CM_ERROR_INVALID_PARAMETER;
	int state = VCONFKEY_CALL_OFF;
	if (vconf_get_int(VCONFKEY_CALL_STATE, &state) != VCONF_OK)
		state = VCONFKEY_CALL_OFF;
	*call_status = __status_of(state);
	return CM_ERROR_NONE;
}

int cm_set_call_status_cb(cm_client_h handle, cm_call_status_cb cb, void *user_data)
{
	if (!handle || !cb)
		return CM_ERROR_INVALID_PARAMETER;
	if (handle->cb)
		return CM_ERROR_ALREADY_REGISTERED;
	if (!__watchers && vconf_notify_key_changed(VCONFKEY_CALL_STATE, __call_state_changed_cb, NULL) != VCONF_OK) {
		LOGE("cannot watch %s", VCONFKEY_CALL_STATE);
		return CM_ERROR_OPERATION_FAILED;
	}
	handle->cb = cb;
	handle->user_data = user_data;
	handle->next = __watchers;
	__watchers = handle;
	return CM_ERROR_NONE;
}

int cm_unset_call_status_cb(cm_client_h handle)
{
	if (!handle)
		return CM_ERROR_INVALID_PARAMETER;
	if (!handle->cb)
		return CM_ERROR_NOT_REGISTERED;
	__unwatch(handle);
	return CM_ERROR_NONE;
}
