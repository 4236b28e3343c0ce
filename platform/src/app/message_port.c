/* Message ports: each local port is a local socket named after the app and the port (app_channel.c); a
   message is one connection carrying the sender's app id and the encoded bundle, framed and bounded in
   time like launch messages (app_message.c). */
#define _GNU_SOURCE
#include <message_port.h>

#include "app_private.h"
#include "bundle_codec.h"

#include <Ecore.h>
#include <dlog.h>
#include <stdint.h>
#include <stdlib.h>
#include <string.h>
#include <sys/socket.h>
#include <unistd.h>

typedef struct {
	int id;
	char *name; /* the port's socket id */
	int listen_fd;
	Ecore_Fd_Handler *handler;
	Eina_List *clients; /* client_s, in the order they connected */
	message_port_message_cb cb;
	void *data;
} local_port_s;

typedef struct {
	local_port_s *port;
	app_message_reader_s *reader;
	Ecore_Fd_Handler *handler;
} client_s;

static Eina_List *__ports;
static int __last_id;

static local_port_s *__port_find(int id, const char *name)
{
	Eina_List *l;
	local_port_s *port;
	EINA_LIST_FOREACH(__ports, l, port)
	if (port->id == id || (name && !strcmp(port->name, name)))
		return port;
	return NULL;
}

/* The sender's app id and the bundle of a message; false when malformed. */
static bool __decode(const void *data, int size, char **sender, bundle **message)
{
	bundle_reader_s r = {data, size > 0 ? (size_t)size : 0, 0};
	const void *id, *raw;
	size_t id_len, raw_len;
	if (!bundle_reader_blob(&r, &id, &id_len) || !bundle_reader_blob(&r, &raw, &raw_len))
		return false;
	*sender = strndup(id, id_len);
	*message = bundle_decode(raw, (int)raw_len);
	if (*sender && *message)
		return true;
	free(*sender);
	if (*message)
		bundle_free(*message);
	return false;
}

static Eina_Bool __client_fd_cb(void *data, Ecore_Fd_Handler *handler);

static void __client_close(client_s *c)
{
	c->port->clients = eina_list_remove(c->port->clients, c);
	ecore_main_fd_handler_del(c->handler);
	if (c->reader)
		app_message_reader_del(c->reader);
	free(c);
}

/* One message per connection: it is handed to the port's callback, then the connection goes. */
static void __message_cb(void *data, app_message_reader_s *reader, const app_message_s *msg)
{
	client_s *c = data;
	local_port_s *port = c->port;
	if (!msg) {
		c->reader = NULL; /* the sender closed; the reader frees itself */
		__client_close(c);
		return;
	}
	char *sender = NULL;
	bundle *message = NULL;
	bool ok = msg->major == APP_CHANNEL_MSG_PORT && __decode(msg->data, msg->size, &sender, &message);
	(void)reader;
	__client_close(c);
	if (!ok) {
		LOGE("malformed message on port %s dropped", port->name);
		return;
	}
	port->cb(port->id, sender, NULL, false, message, port->data);
	bundle_free(message);
	free(sender);
}

/* Messages are handled in the order their connections were made: a sender's send returns only once the
   message is in this socket, so two sent one after the other come in that order. */
static void __port_read(local_port_s *port)
{
	int fd;
	while ((fd = accept4(port->listen_fd, NULL, NULL, SOCK_NONBLOCK | SOCK_CLOEXEC)) >= 0) {
		client_s *c = app_channel_peer_allowed(fd) ? calloc(1, sizeof(*c)) : NULL;
		if (!c) {
			close(fd);
			continue;
		}
		c->port = port;
		c->reader = app_message_reader_add(fd, false, __message_cb, c);
		if (!c->reader) {
			free(c);
			continue;
		}
		port->clients = eina_list_append(port->clients, c);
	}
	Eina_List *order = eina_list_clone(port->clients);
	client_s *c;
	EINA_LIST_FREE(order, c)
	{
		if (eina_list_data_find(port->clients, c))
			app_message_reader_read(c->reader);
	}
	/* Connections still waiting for their message are watched until it comes. */
	Eina_List *l;
	EINA_LIST_FOREACH(port->clients, l, c)
	{
		if (!c->handler)
			c->handler = ecore_main_fd_handler_add(app_message_reader_fd_get(c->reader), ECORE_FD_READ, __client_fd_cb,
			                                       port, NULL, NULL);
	}
}

static Eina_Bool __client_fd_cb(void *data, Ecore_Fd_Handler *handler)
{
	(void)handler;
	__port_read(data);
	return ECORE_CALLBACK_RENEW;
}

static Eina_Bool __accept_cb(void *data, Ecore_Fd_Handler *handler)
{
	(void)handler;
	__port_read(data);
	return ECORE_CALLBACK_RENEW;
}

int message_port_register_local_port(const char *local_port, message_port_message_cb callback, void *user_data)
{
	if (!local_port || !*local_port || !callback)
		return MESSAGE_PORT_ERROR_INVALID_PARAMETER;
	char *app_id = app_paths_app_id_get();
	char *name = app_channel_port_id_get(app_id, local_port);
	free(app_id);
	if (!name) {
		LOGE("this process has no app id for port %s", local_port);
		return MESSAGE_PORT_ERROR_IO_ERROR;
	}
	local_port_s *port = __port_find(-1, name);
	if (port) {
		free(name);
		port->cb = callback;
		port->data = user_data;
		return port->id;
	}
	port = calloc(1, sizeof(*port));
	if (!port) {
		free(name);
		return MESSAGE_PORT_ERROR_OUT_OF_MEMORY;
	}
	port->name = name;
	port->listen_fd = app_channel_port_listen(name);
	if (port->listen_fd >= 0)
		port->handler = ecore_main_fd_handler_add(port->listen_fd, ECORE_FD_READ, __accept_cb, port, NULL, NULL);
	if (!port->handler) {
		LOGE("port %s is taken by another process", local_port);
		app_channel_port_unlisten(name, port->listen_fd);
		free(port->name);
		free(port);
		return MESSAGE_PORT_ERROR_RESOURCE_UNAVAILABLE;
	}
	port->id = ++__last_id;
	port->cb = callback;
	port->data = user_data;
	__ports = eina_list_append(__ports, port);
	return port->id;
}

int message_port_unregister_local_port(int local_port_id)
{
	local_port_s *port = local_port_id > 0 ? __port_find(local_port_id, NULL) : NULL;
	if (!port)
		return MESSAGE_PORT_ERROR_PORT_NOT_FOUND;
	__ports = eina_list_remove(__ports, port);
	while (port->clients)
		__client_close(eina_list_data_get(port->clients));
	ecore_main_fd_handler_del(port->handler);
	app_channel_port_unlisten(port->name, port->listen_fd);
	free(port->name);
	free(port);
	return MESSAGE_PORT_ERROR_NONE;
}

int message_port_check_remote_port(const char *remote_app_id, const char *remote_port, bool *exist)
{
	if (!remote_app_id || !remote_port || !exist)
		return MESSAGE_PORT_ERROR_INVALID_PARAMETER;
	char *port_id = app_channel_port_id_get(remote_app_id, remote_port);
	*exist = port_id && app_channel_is_running(port_id);
	free(port_id);
	return MESSAGE_PORT_ERROR_NONE;
}

int message_port_send_message(const char *remote_app_id, const char *remote_port, bundle *message)
{
	if (!remote_app_id || !remote_port || !message)
		return MESSAGE_PORT_ERROR_INVALID_PARAMETER;
	bundle_raw *raw = NULL;
	int raw_len = 0;
	if (bundle_encode(message, &raw, &raw_len) != BUNDLE_ERROR_NONE)
		return MESSAGE_PORT_ERROR_OUT_OF_MEMORY;
	char *sender = app_paths_app_id_get();
	bundle_writer_s w;
	bundle_writer_init(&w);
	bundle_writer_blob(&w, sender ? sender : "", sender ? strlen(sender) : 0);
	bundle_writer_blob(&w, raw, (size_t)raw_len);
	free(sender);
	bundle_free_encoded_rawdata(&raw);
	if (w.failed) {
		free(w.data);
		return MESSAGE_PORT_ERROR_OUT_OF_MEMORY;
	}
	char *port_id = app_channel_port_id_get(remote_app_id, remote_port);
	int fd = -1;
	int rc = MESSAGE_PORT_ERROR_NONE;
	if (!port_id || app_channel_connect(port_id, &fd) != APP_CONTROL_ERROR_NONE) {
		LOGI("nobody listens on port %s of %s", remote_port, remote_app_id);
		rc = MESSAGE_PORT_ERROR_PORT_NOT_FOUND;
	} else {
		/* Bounded like every other send: a stopped listener costs the sender at most the deadline. */
		app_message_s msg = {APP_CHANNEL_MSG_PORT, 0, 0, (int)w.size, w.data};
		if (app_message_send(fd, &msg, APP_MESSAGE_SEND_TIMEOUT_SEC) != APP_CONTROL_ERROR_NONE)
			rc = MESSAGE_PORT_ERROR_IO_ERROR;
	}
	if (fd >= 0)
		close(fd);
	free(port_id);
	free(w.data);
	return rc;
}
