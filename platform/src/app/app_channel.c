/* Names and connections of the apps' launch sockets (Ecore_Ipc, local to the user). */
#ifndef EFL_BETA_API_SUPPORT
#define EFL_BETA_API_SUPPORT 1 /* eina_vpath: the folder Ecore_Con puts local sockets in */
#endif
#include "app_private.h"

#include <Eina.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <sys/socket.h>
#include <sys/un.h>
#include <unistd.h>

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

/* True when something accepts connections on the socket: Ecore_Ipc reports a stale socket (its
   owner died) only later on the main loop, so liveness is checked with a plain connect first.
   The path is the one Ecore_Con gives user-local sockets. */
static bool socket_accepts(const char *name)
{
	char path[sizeof(((struct sockaddr_un *)0)->sun_path)];
	int n = eina_vpath_resolve_snprintf(path, sizeof(path), "(:usr.run:)/.ecore/%s/0", name);
	if (n <= 0 || (size_t)n >= sizeof(path))
		return false;
	int fd = socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0);
	if (fd < 0)
		return false;
	struct sockaddr_un addr;
	memset(&addr, 0, sizeof(addr));
	addr.sun_family = AF_UNIX;
	memcpy(addr.sun_path, path, (size_t)n + 1);
	bool ok = connect(fd, (struct sockaddr *)&addr, sizeof(addr)) == 0;
	close(fd);
	return ok;
}

Ecore_Ipc_Server *app_channel_connect(const char *app_id)
{
	channel_init();
	char *name = app_channel_name_get(app_id);
	if (!name)
		return NULL;
	Ecore_Ipc_Server *server = NULL;
	if (socket_accepts(name))
		server = ecore_ipc_server_connect(ECORE_IPC_LOCAL_USER, name, 0, NULL);
	free(name);
	return server;
}

bool app_channel_is_running(const char *app_id)
{
	channel_init();
	char *name = app_channel_name_get(app_id);
	bool running = name && socket_accepts(name);
	free(name);
	return running;
}
