/* Names and connections of the apps' launch sockets (Ecore_Ipc, local to the user). */
#include "app_private.h"

#include <stdio.h>
#include <stdlib.h>
#include <string.h>

static void channel_init(void)
{
	static bool done = false;
	if (done)
		return;
	ecore_ipc_init();
	done = true;
}

char *app_channel_name_get(const char *app_id)
{
	if (!app_id)
		return NULL;
	size_t n = strlen("tizen-app-") + strlen(app_id) + 1;
	char *name = malloc(n);
	if (name)
		snprintf(name, n, "tizen-app-%s", app_id);
	return name;
}

Ecore_Ipc_Server *app_channel_connect(const char *app_id)
{
	channel_init();
	char *name = app_channel_name_get(app_id);
	if (!name)
		return NULL;
	/* A local connect fails at once when nobody listens (or the socket is stale). */
	Ecore_Ipc_Server *server = ecore_ipc_server_connect(ECORE_IPC_LOCAL_USER, name, 0, NULL);
	free(name);
	return server;
}

bool app_channel_is_running(const char *app_id)
{
	Ecore_Ipc_Server *server = app_channel_connect(app_id);
	if (!server)
		return false;
	ecore_ipc_server_del(server);
	return true;
}
