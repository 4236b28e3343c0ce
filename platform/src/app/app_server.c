/* The running app's launch socket: takes requests, terminate and resume messages, sends replies. */
#define _GNU_SOURCE
#include <app.h>

#include "app_private.h"

#include <dlog.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <unistd.h>

/* A received request whose sender waits for the reply on its connection. */
typedef struct {
	unsigned int token;
	Ecore_Ipc_Client *client;
	int ref;
} waiting_sender_s;

static Ecore_Ipc_Server *server;
static Eina_List *waiting_senders;
static Ecore_Event_Handler *handlers[2];
static unsigned int last_token;

static waiting_sender_s *waiting_find(unsigned int token)
{
	Eina_List *l;
	waiting_sender_s *w;
	EINA_LIST_FOREACH(waiting_senders, l, w)
	if (w->token == token)
		return w;
	return NULL;
}

static void on_launch(Ecore_Ipc_Event_Client_Data *ev)
{
	app_control_h request = ev->size > 0 ? app_control_decode_internal(ev->data, ev->size) : NULL;
	if (!request) {
		LOGE("malformed launch request dropped");
		return;
	}
	request->reply_token = ++last_token;
	request->reply_requested = ev->response == 1;
	/* The sender waits for us to close a connection that needs no answer. */
	if (!request->reply_requested)
		ecore_ipc_client_del(ev->client);
	if (request->reply_requested) {
		waiting_sender_s *w = calloc(1, sizeof(*w));
		if (w) {
			w->token = request->reply_token;
			w->client = ev->client;
			w->ref = ev->ref;
			waiting_senders = eina_list_append(waiting_senders, w);
		}
	}
	LOGI("launch request from %s (%s)", request->caller ? request->caller : "?",
	     request->operation ? request->operation : "no operation");
	app_main_deliver_request(request);
	app_control_destroy(request);
}

static Eina_Bool client_data_cb(void *data, int type, void *event)
{
	(void)data;
	(void)type;
	Ecore_Ipc_Event_Client_Data *ev = event;
	if (!server || ecore_ipc_client_server_get(ev->client) != server)
		return ECORE_CALLBACK_PASS_ON;
	switch (ev->major) {
	case APP_CHANNEL_MSG_LAUNCH:
		on_launch(ev);
		break;
	case APP_CHANNEL_MSG_TERMINATE:
		ecore_ipc_client_del(ev->client);
		LOGI("asked to end");
		ui_app_exit();
		break;
	case APP_CHANNEL_MSG_RESUME:
		ecore_ipc_client_del(ev->client);
		app_main_raise();
		break;
	default:
		LOGE("unknown message %d on the launch socket", ev->major);
		break;
	}
	return ECORE_CALLBACK_DONE;
}

static Eina_Bool client_del_cb(void *data, int type, void *event)
{
	(void)data;
	(void)type;
	Ecore_Ipc_Event_Client_Del *ev = event;
	if (!server || ecore_ipc_client_server_get(ev->client) != server)
		return ECORE_CALLBACK_PASS_ON;
	Eina_List *l, *next;
	waiting_sender_s *w;
	EINA_LIST_FOREACH_SAFE(waiting_senders, l, next, w)
	{
		if (w->client != ev->client)
			continue;
		free(w);
		waiting_senders = eina_list_remove_list(waiting_senders, l);
	}
	ecore_ipc_client_del(ev->client);
	return ECORE_CALLBACK_DONE;
}

/* <runtime dir>/<id>.pid (malloc'ed) */
static char *pid_file_path(const char *app_id)
{
	char *dir = app_paths_runtime_dir_get();
	char *path = NULL;
	if (dir && asprintf(&path, "%s/%s.pid", dir, app_id) < 0)
		path = NULL;
	free(dir);
	return path;
}

static char *pid_file;

static void pid_file_write(const char *app_id)
{
	pid_file = pid_file_path(app_id);
	FILE *f = pid_file ? fopen(pid_file, "w") : NULL;
	if (!f)
		return;
	fprintf(f, "%d\n", (int)getpid());
	fclose(f);
}

pid_t app_server_pid_get(const char *app_id)
{
	char *path = pid_file_path(app_id);
	FILE *f = path ? fopen(path, "r") : NULL;
	free(path);
	int pid = -1;
	if (f) {
		if (fscanf(f, "%d", &pid) != 1)
			pid = -1;
		fclose(f);
	}
	return (pid_t)pid;
}

bool app_server_start(const char *app_id)
{
	if (server)
		return true;
	ecore_ipc_init();
	char *name = app_channel_name_get(app_id);
	server = name ? app_channel_server_add(name) : NULL;
	free(name);
	if (!server) {
		ecore_ipc_shutdown();
		return false;
	}
	handlers[0] = ecore_event_handler_add(ECORE_IPC_EVENT_CLIENT_DATA, client_data_cb, NULL);
	handlers[1] = ecore_event_handler_add(ECORE_IPC_EVENT_CLIENT_DEL, client_del_cb, NULL);
	pid_file_write(app_id);
	LOGI("taking launch requests for %s", app_id);
	return true;
}

void app_server_stop(void)
{
	if (!server)
		return;
	for (int i = 0; i < 2; i++) {
		ecore_event_handler_del(handlers[i]);
		handlers[i] = NULL;
	}
	waiting_sender_s *w;
	EINA_LIST_FREE(waiting_senders, w)
	free(w);
	/* Closing drops the open connections: senders still waiting see their request canceled. */
	ecore_ipc_server_del(server);
	server = NULL;
	if (pid_file) {
		unlink(pid_file);
		free(pid_file);
		pid_file = NULL;
	}
	ecore_ipc_shutdown();
}

int app_server_reply(unsigned int reply_token, app_control_h reply, app_control_result_e result)
{
	waiting_sender_s *w = waiting_find(reply_token);
	if (!w) {
		LOGE("the request was answered already or its sender is gone");
		return APP_CONTROL_ERROR_INVALID_PARAMETER;
	}
	bundle_raw *raw = NULL;
	int len = 0;
	if (!app_control_encode_internal(reply, NULL, false, &raw, &len)) {
		LOGE("cannot encode the reply");
		return APP_CONTROL_ERROR_OUT_OF_MEMORY;
	}
	int sent = ecore_ipc_client_send(w->client, APP_CHANNEL_MSG_REPLY, 0, 0, w->ref, (int)result, raw, len);
	ecore_ipc_client_flush(w->client);
	free(raw);
	waiting_senders = eina_list_remove(waiting_senders, w);
	free(w);
	if (sent <= 0) {
		LOGE("cannot send the reply");
		return APP_CONTROL_ERROR_IO_ERROR;
	}
	return APP_CONTROL_ERROR_NONE;
}

int app_control_reply_to_launch_request(app_control_h reply, app_control_h request, app_control_result_e result)
{
	if (!reply || !request) {
		LOGE("invalid parameter");
		return APP_CONTROL_ERROR_INVALID_PARAMETER;
	}
	if (result == APP_CONTROL_RESULT_APP_STARTED) {
		LOGE("APP_CONTROL_RESULT_APP_STARTED is not allowed as a reply");
		return APP_CONTROL_ERROR_INVALID_PARAMETER;
	}
	if (result < APP_CONTROL_RESULT_CANCELED || result > APP_CONTROL_RESULT_APP_STARTED) {
		LOGE("unknown result %d", (int)result);
		return APP_CONTROL_ERROR_INVALID_PARAMETER;
	}
	if (!request->reply_token) {
		LOGE("the request was not received from another app");
		return APP_CONTROL_ERROR_INVALID_PARAMETER;
	}
	/* A sender that asked for no reply gets none; answering it is not an error. */
	if (!request->reply_requested)
		return APP_CONTROL_ERROR_NONE;
	return app_server_reply(request->reply_token, reply, result);
}
