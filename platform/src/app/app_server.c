/* The running app's launch socket: takes requests, terminate and resume messages, sends replies. */
#define _GNU_SOURCE
#include <app.h>

#include "app_private.h"

#include <dlog.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <sys/socket.h>
#include <unistd.h>

/* A connection from another app; token is set while a request received on it waits for its reply. */
typedef struct {
	app_message_reader_s *reader;
	Ecore_Fd_Handler *handler;
	unsigned int token;
	int ref;
} client_s;

static int listen_fd = -1;
static char *listen_id;
static Ecore_Fd_Handler *accept_handler;
static Eina_List *clients;
static unsigned int last_token;

static client_s *waiting_find(unsigned int token)
{
	Eina_List *l;
	client_s *c;
	EINA_LIST_FOREACH(clients, l, c)
	if (c->token == token)
		return c;
	return NULL;
}

static void client_forget(client_s *c)
{
	clients = eina_list_remove(clients, c);
	if (c->handler)
		ecore_main_fd_handler_del(c->handler);
	free(c);
}

static void client_close(client_s *c)
{
	app_message_reader_s *reader = c->reader;
	/* The watch goes before the socket it watches is closed. */
	client_forget(c);
	app_message_reader_del(reader);
}

static void on_launch(client_s *c, const app_message_s *msg)
{
	app_control_h request = msg->size > 0 ? app_control_decode_internal(msg->data, msg->size) : NULL;
	if (!request) {
		LOGE("malformed launch request dropped");
		client_close(c);
		return;
	}
	request->reply_token = ++last_token;
	request->reply_requested = msg->response == 1;
	if (request->reply_requested) {
		c->token = request->reply_token;
		c->ref = msg->ref;
	} else {
		client_close(c);
	}
	LOGI("launch request from %s (%s)", request->caller ? request->caller : "?",
	     request->operation ? request->operation : "no operation");
	app_main_deliver_request(request);
	app_control_destroy(request);
}

static void client_message_cb(void *data, app_message_reader_s *reader, const app_message_s *msg)
{
	(void)reader;
	client_s *c = data;
	if (!msg) {
		/* The sender is gone, or needs nothing more from this connection. */
		client_forget(c);
		return;
	}
	switch (msg->major) {
	case APP_CHANNEL_MSG_LAUNCH:
		on_launch(c, msg);
		break;
	case APP_CHANNEL_MSG_TERMINATE:
		client_close(c);
		LOGI("asked to end");
		ui_app_exit();
		break;
	case APP_CHANNEL_MSG_RESUME:
		client_close(c);
		app_main_raise();
		break;
	default:
		LOGE("unknown message %d on the launch socket", msg->major);
		break;
	}
}

static Eina_Bool client_fd_cb(void *data, Ecore_Fd_Handler *handler);

static void clients_accept(void)
{
	int fd;
	while ((fd = accept4(listen_fd, NULL, NULL, SOCK_NONBLOCK | SOCK_CLOEXEC)) >= 0) {
		client_s *c = app_channel_peer_allowed(fd) ? calloc(1, sizeof(*c)) : NULL;
		if (!c) {
			close(fd);
			continue;
		}
		c->reader = app_message_reader_add(fd, false, client_message_cb, c);
		if (c->reader)
			c->handler = ecore_main_fd_handler_add(fd, ECORE_FD_READ, client_fd_cb, NULL, NULL, NULL);
		if (!c->handler) {
			app_message_reader_del(c->reader);
			free(c);
			continue;
		}
		clients = eina_list_append(clients, c);
	}
}

/* Takes the messages of all connections in the order they were made: the main loop reports ready
   sockets in no set order, and an app that sends two messages one after the other expects them handled
   in that order (a request, then a terminate). */
static void clients_read(void)
{
	clients_accept();
	Eina_List *order = eina_list_clone(clients);
	client_s *c;
	EINA_LIST_FREE(order, c)
	{
		if (listen_fd >= 0 && eina_list_data_find(clients, c))
			app_message_reader_read(c->reader);
	}
}

static Eina_Bool client_fd_cb(void *data, Ecore_Fd_Handler *handler)
{
	(void)data;
	(void)handler;
	clients_read();
	return ECORE_CALLBACK_RENEW;
}

bool app_server_start(const char *app_id)
{
	if (listen_fd >= 0)
		return true;
	listen_fd = app_channel_listen(app_id);
	if (listen_fd < 0)
		return false;
	accept_handler = ecore_main_fd_handler_add(listen_fd, ECORE_FD_READ, client_fd_cb, NULL, NULL, NULL);
	listen_id = strdup(app_id);
	LOGI("taking launch requests for %s", app_id);
	return true;
}

void app_server_stop(void)
{
	if (listen_fd < 0)
		return;
	if (accept_handler)
		ecore_main_fd_handler_del(accept_handler);
	accept_handler = NULL;
	/* Senders still waiting for a reply see their request canceled. */
	while (clients)
		client_close(eina_list_data_get(clients));
	app_channel_unlisten(listen_id, listen_fd);
	listen_fd = -1;
	free(listen_id);
	listen_id = NULL;
}

int app_server_reply(unsigned int reply_token, app_control_h reply, app_control_result_e result)
{
	client_s *c = waiting_find(reply_token);
	if (!c) {
		LOGE("the request was answered already or its sender is gone");
		return APP_CONTROL_ERROR_INVALID_PARAMETER;
	}
	bundle_raw *raw = NULL;
	int len = 0;
	if (!app_control_encode_internal(reply, NULL, false, &raw, &len)) {
		LOGE("cannot encode the reply");
		return APP_CONTROL_ERROR_OUT_OF_MEMORY;
	}
	app_message_s msg = {APP_CHANNEL_MSG_REPLY, c->ref, (int)result, len, raw};
	int ret = app_message_send(app_message_reader_fd_get(c->reader), &msg, APP_MESSAGE_SEND_TIMEOUT_SEC);
	free(raw);
	/* One answer per request: the sender reads it after the close as well. */
	client_close(c);
	if (ret != APP_CONTROL_ERROR_NONE)
		LOGE("cannot send the reply");
	return ret;
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
