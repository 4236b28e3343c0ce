/* Message ports: each local port is a user-local Ecore_Ipc socket named after the app and the port
   (app_channel.c); a message is one connection carrying the sender's app id and the encoded bundle. */
#include <message_port.h>

#include "app_private.h"
#include "bundle_codec.h"

#include <dlog.h>
#include <stdlib.h>
#include <string.h>

typedef struct {
	int id;
	char *name;
	Ecore_Ipc_Server *server;
	message_port_message_cb cb;
	void *data;
} local_port_s;

static Eina_List *__ports;
static Ecore_Event_Handler *__handlers[2];
static int __last_id;

static local_port_s *__port_of_server(const Ecore_Ipc_Server *server)
{
	Eina_List *l;
	local_port_s *port;
	EINA_LIST_FOREACH(__ports, l, port)
	if (port->server == server)
		return port;
	return NULL;
}

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

static Eina_Bool __client_data_cb(void *data, int type, void *event)
{
	(void)data;
	(void)type;
	Ecore_Ipc_Event_Client_Data *ev = event;
	local_port_s *port = __port_of_server(ecore_ipc_client_server_get(ev->client));
	if (!port)
		return ECORE_CALLBACK_PASS_ON;
	char *sender = NULL;
	bundle *message = NULL;
	bool ok = ev->major == APP_CHANNEL_MSG_PORT && __decode(ev->data, ev->size, &sender, &message);
	/* The sender holds its connection until the message is taken. */
	ecore_ipc_client_del(ev->client);
	if (!ok) {
		LOGE("malformed message on port %s dropped", port->name);
		return ECORE_CALLBACK_DONE;
	}
	port->cb(port->id, sender, NULL, false, message, port->data);
	bundle_free(message);
	free(sender);
	return ECORE_CALLBACK_DONE;
}

static Eina_Bool __client_del_cb(void *data, int type, void *event)
{
	(void)data;
	(void)type;
	Ecore_Ipc_Event_Client_Del *ev = event;
	if (!__port_of_server(ecore_ipc_client_server_get(ev->client)))
		return ECORE_CALLBACK_PASS_ON;
	ecore_ipc_client_del(ev->client);
	return ECORE_CALLBACK_DONE;
}

int message_port_register_local_port(const char *local_port, message_port_message_cb callback, void *user_data)
{
	if (!local_port || !*local_port || !callback)
		return MESSAGE_PORT_ERROR_INVALID_PARAMETER;
	char *app_id = app_paths_app_id_get();
	char *name = app_channel_port_name_get(app_id, local_port);
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
	port->server = app_channel_server_add(name);
	if (!port->server) {
		LOGE("port %s is taken by another process", local_port);
		free(port->name);
		free(port);
		return MESSAGE_PORT_ERROR_RESOURCE_UNAVAILABLE;
	}
	if (!__ports) {
		__handlers[0] = ecore_event_handler_add(ECORE_IPC_EVENT_CLIENT_DATA, __client_data_cb, NULL);
		__handlers[1] = ecore_event_handler_add(ECORE_IPC_EVENT_CLIENT_DEL, __client_del_cb, NULL);
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
	ecore_ipc_server_del(port->server);
	free(port->name);
	free(port);
	if (!__ports) {
		for (int i = 0; i < 2; i++) {
			ecore_event_handler_del(__handlers[i]);
			__handlers[i] = NULL;
		}
	}
	return MESSAGE_PORT_ERROR_NONE;
}

int message_port_check_remote_port(const char *remote_app_id, const char *remote_port, bool *exist)
{
	if (!remote_app_id || !remote_port || !exist)
		return MESSAGE_PORT_ERROR_INVALID_PARAMETER;
	char *name = app_channel_port_name_get(remote_app_id, remote_port);
	*exist = name && app_channel_socket_accepts(name);
	free(name);
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
	char *name = app_channel_port_name_get(remote_app_id, remote_port);
	Ecore_Ipc_Server *server = app_channel_socket_connect(name);
	free(name);
	int rc = MESSAGE_PORT_ERROR_NONE;
	if (!server) {
		LOGI("nobody listens on port %s of %s", remote_port, remote_app_id);
		rc = MESSAGE_PORT_ERROR_PORT_NOT_FOUND;
	} else if (!app_launch_send_and_release(server, APP_CHANNEL_MSG_PORT, 0, w.data, (int)w.size)) {
		rc = MESSAGE_PORT_ERROR_IO_ERROR;
	}
	free(w.data);
	return rc;
}
