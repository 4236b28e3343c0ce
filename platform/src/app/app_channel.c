/* Names and connections of the apps' launch sockets (Ecore_Ipc, local to the user). */
#define _GNU_SOURCE
#ifndef EFL_BETA_API_SUPPORT
#define EFL_BETA_API_SUPPORT 1 /* eina_vpath: the folder Ecore_Con puts local sockets in */
#endif
#include "app_private.h"

#include <Eina.h>
#include <dlog.h>
#include <inttypes.h>
#include <stdint.h>
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

/* Where Ecore_Con puts the user-local socket of name; the length written, or -1 when it does not fit. */
static int socket_path_get(const char *name, char *path, size_t size)
{
	int n = eina_vpath_resolve_snprintf(path, size, "(:usr.run:)/.ecore/%s/0", name);
	return n <= 0 || (size_t)n >= size ? -1 : n;
}

static uint64_t fnv1a(const char *s)
{
	uint64_t h = 1469598103934665603ULL;
	for (; *s; s++)
		h = (h ^ (unsigned char)*s) * 1099511628211ULL;
	return h;
}

/* "<prefix><key>"; socket paths are short (108 bytes): a long key is cut and made unique by its hash. */
static char *socket_name_get(const char *prefix, const char *key)
{
	char *name = NULL;
	if (asprintf(&name, "%s%s", prefix, key) < 0)
		return NULL;
	char path[sizeof(((struct sockaddr_un *)0)->sun_path)];
	if (socket_path_get(name, path, sizeof(path)) < 0) {
		free(name);
		if (asprintf(&name, "%s%.16s-%016" PRIx64, prefix, key, fnv1a(key)) < 0)
			return NULL;
		if (socket_path_get(name, path, sizeof(path)) < 0) {
			LOGE("the runtime folder is too deep for a socket of %s", key);
			free(name);
			return NULL;
		}
	}
	return name;
}

char *app_channel_name_get(const char *app_id)
{
	return app_id ? socket_name_get("tizen-app-", app_id) : NULL;
}

char *app_channel_port_name_get(const char *app_id, const char *port)
{
	char *key = NULL;
	if (!app_id || !port || asprintf(&key, "%s-%s", app_id, port) < 0)
		return NULL;
	char *name = socket_name_get("tizen-mp-", key);
	free(key);
	return name;
}

/* True when something accepts connections on the socket: Ecore_Ipc reports a stale socket (its
   owner died) only later on the main loop, so liveness is checked with a plain connect first.
   The path is the one Ecore_Con gives user-local sockets. */
bool app_channel_socket_accepts(const char *name)
{
	char path[sizeof(((struct sockaddr_un *)0)->sun_path)];
	int n = socket_path_get(name, path, sizeof(path));
	if (n < 0)
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

Ecore_Ipc_Server *app_channel_socket_connect(const char *name)
{
	channel_init();
	if (!name || !app_channel_socket_accepts(name))
		return NULL;
	return ecore_ipc_server_connect(ECORE_IPC_LOCAL_USER, (char *)name, 0, NULL); /* the name is only read */
}

Ecore_Ipc_Server *app_channel_connect(const char *app_id)
{
	char *name = app_channel_name_get(app_id);
	Ecore_Ipc_Server *server = app_channel_socket_connect(name);
	free(name);
	return server;
}

Ecore_Ipc_Server *app_channel_server_add(const char *name)
{
	channel_init();
	app_channel_stale_remove(name);
	/* Ecore_Con complains loudly that local sockets cannot reuse ports; that is expected here. */
	int level = eina_log_domain_level_get("ecore_con");
	eina_log_domain_level_set("ecore_con", EINA_LOG_LEVEL_CRITICAL);
	Ecore_Ipc_Server *s = ecore_ipc_server_add(ECORE_IPC_LOCAL_USER, name, 0, NULL);
	eina_log_domain_level_set("ecore_con", level);
	return s;
}

void app_channel_stale_remove(const char *name)
{
	char path[sizeof(((struct sockaddr_un *)0)->sun_path)];
	if (socket_path_get(name, path, sizeof(path)) < 0 || access(path, F_OK) != 0 || app_channel_socket_accepts(name))
		return;
	/* Left by an instance that died: a new server could not listen while it is there. */
	if (unlink(path) == 0)
		LOGI("removed the stale socket %s", path);
}

bool app_channel_is_running(const char *app_id)
{
	channel_init();
	char *name = app_channel_name_get(app_id);
	bool running = name && app_channel_socket_accepts(name);
	free(name);
	return running;
}
