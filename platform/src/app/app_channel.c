/* The apps' launch sockets: where each lives, listening on one's own, connecting to another's. */
#define _GNU_SOURCE
#ifndef EFL_BETA_API_SUPPORT
#define EFL_BETA_API_SUPPORT 1 /* eina_vpath: the per-user run-time folder */
#endif
#include "app_private.h"

#include <Eina.h>
#include <dlog.h>
#include <errno.h>
#include <fcntl.h>
#include <inttypes.h>
#include <stdint.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <sys/file.h>
#include <sys/socket.h>
#include <sys/un.h>
#include <time.h>
#include <unistd.h>

#define SOCKET_PATH_MAX sizeof(((struct sockaddr_un *)0)->sun_path)
/* Between tries at a socket whose queue of connections is full. */
#define CONNECT_RETRY_USEC 10000

static void channel_init(void)
{
	static bool done = false;
	if (!done)
		done = eina_init() > 0;
}

static uint64_t fnv1a(const char *s)
{
	uint64_t h = 1469598103934665603ULL;
	for (; *s; s++)
		h = (h ^ (unsigned char)*s) * 1099511628211ULL;
	return h;
}

/* <run-time folder>/tizen-app/<id>; a long id is cut and made unique by its hash, since socket paths
   are short. The length written, or -1. */
static int socket_path_get(const char *app_id, char *path, size_t size)
{
	channel_init();
	int n = eina_vpath_resolve_snprintf(path, size, "(:usr.run:)/tizen-app/%s", app_id);
	if (n > 0 && (size_t)n < size)
		return n;
	n = eina_vpath_resolve_snprintf(path, size, "(:usr.run:)/tizen-app/%.16s-%016" PRIx64, app_id, fnv1a(app_id));
	if (n > 0 && (size_t)n < size)
		return n;
	LOGE("the run-time folder is too deep for the launch socket of %s", app_id);
	return -1;
}

static bool address_get(const char *app_id, struct sockaddr_un *addr)
{
	memset(addr, 0, sizeof(*addr));
	addr->sun_family = AF_UNIX;
	return app_id && socket_path_get(app_id, addr->sun_path, SOCKET_PATH_MAX) > 0;
}

static int socket_new(void)
{
	return socket(AF_UNIX, SOCK_STREAM | SOCK_NONBLOCK | SOCK_CLOEXEC, 0);
}

/* One try: 0 when connected, else the errno (EAGAIN: the app is there but its queue is full). */
static int connect_once(const struct sockaddr_un *addr, int *fd)
{
	*fd = socket_new();
	if (*fd < 0)
		return errno;
	if (connect(*fd, (const struct sockaddr *)addr, sizeof(*addr)) == 0)
		return 0;
	int err = errno;
	close(*fd);
	*fd = -1;
	return err;
}

int app_channel_connect(const char *app_id, int *fd)
{
	struct sockaddr_un addr;
	*fd = -1;
	if (!address_get(app_id, &addr))
		return APP_CONTROL_ERROR_APP_NOT_FOUND;
	struct timespec start, now;
	clock_gettime(CLOCK_MONOTONIC, &start);
	for (;;) {
		int err = connect_once(&addr, fd);
		if (err == 0)
			return APP_CONTROL_ERROR_NONE;
		if (err != EAGAIN && err != EINTR)
			return APP_CONTROL_ERROR_APP_NOT_FOUND;
		clock_gettime(CLOCK_MONOTONIC, &now);
		if (now.tv_sec - start.tv_sec + (now.tv_nsec - start.tv_nsec) / 1e9 > APP_MESSAGE_SEND_TIMEOUT_SEC) {
			LOGE("%s takes no connection: stopped or hung", app_id);
			return APP_CONTROL_ERROR_TIMED_OUT;
		}
		usleep(CONNECT_RETRY_USEC);
	}
}

bool app_channel_is_running(const char *app_id)
{
	struct sockaddr_un addr;
	int fd = -1;
	if (!address_get(app_id, &addr))
		return false;
	int err = connect_once(&addr, &fd);
	if (fd >= 0)
		close(fd);
	return err == 0 || err == EAGAIN;
}

/* Held while this process owns its launch socket: a second instance finds it locked, and the lock
   goes with the process however it ends. It holds the owner's pid, written before anyone can connect. */
static int owner_lock_fd = -1;

static void lock_path_get(const struct sockaddr_un *addr, char *path, size_t size)
{
	snprintf(path, size, "%s.lock", addr->sun_path);
}

pid_t app_channel_owner_pid(const char *app_id)
{
	struct sockaddr_un addr;
	char path[SOCKET_PATH_MAX + 8];
	if (!address_get(app_id, &addr))
		return -1;
	lock_path_get(&addr, path, sizeof(path));
	int fd = open(path, O_RDONLY | O_CLOEXEC);
	if (fd < 0)
		return -1;
	char text[32] = "";
	ssize_t n = read(fd, text, sizeof(text) - 1);
	/* A lock that can be taken has no owner: the pid in it is old. */
	bool owned = flock(fd, LOCK_SH | LOCK_NB) != 0;
	close(fd);
	if (!owned || n <= 0)
		return -1;
	text[n] = '\0';
	return (pid_t)atoi(text);
}

/* Binds and listens on the socket at addr, replacing one that a dead owner left; -1 on failure. */
static int listen_at(const struct sockaddr_un *addr)
{
	unlink(addr->sun_path);
	int fd = socket_new();
	if (fd < 0 || bind(fd, (const struct sockaddr *)addr, sizeof(*addr)) != 0 || listen(fd, SOMAXCONN) != 0) {
		LOGE("cannot listen on %s: %s", addr->sun_path, strerror(errno));
		if (fd >= 0)
			close(fd);
		return -1;
	}
	return fd;
}

static bool socket_dir_make(const struct sockaddr_un *addr)
{
	char *dir = strdup(addr->sun_path);
	char *slash = dir ? strrchr(dir, '/') : NULL;
	if (slash)
		*slash = '\0';
	bool have_dir = slash && app_paths_mkdir_p(dir) && app_paths_dir_is_private(dir);
	free(dir);
	return have_dir;
}

bool app_channel_peer_allowed(int fd)
{
	struct ucred cred;
	socklen_t len = sizeof(cred);
	if (getsockopt(fd, SOL_SOCKET, SO_PEERCRED, &cred, &len) != 0) {
		LOGE("a connection without credentials refused (%s)", strerror(errno));
		return false;
	}
	if (cred.uid != geteuid()) {
		LOGE("a connection from user %u (pid %d) refused", (unsigned int)cred.uid, (int)cred.pid);
		return false;
	}
	return true;
}

int app_channel_listen(const char *app_id)
{
	struct sockaddr_un addr;
	if (!address_get(app_id, &addr))
		return -1;
	bool have_dir = socket_dir_make(&addr);
	char lock_path[SOCKET_PATH_MAX + 8];
	lock_path_get(&addr, lock_path, sizeof(lock_path));
	int lock_fd = have_dir ? open(lock_path, O_RDWR | O_CREAT | O_CLOEXEC, 0600) : -1;
	if (lock_fd < 0 || flock(lock_fd, LOCK_EX | LOCK_NB) != 0) {
		if (lock_fd >= 0)
			close(lock_fd);
		return -1;
	}
	char pid[32];
	int len = snprintf(pid, sizeof(pid), "%d\n", (int)getpid());
	if (ftruncate(lock_fd, 0) != 0 || pwrite(lock_fd, pid, (size_t)len, 0) != len)
		LOGE("cannot note the pid in %s", lock_path);
	/* A socket left by an instance that died would keep the new one from listening. */
	int fd = listen_at(&addr);
	if (fd < 0) {
		close(lock_fd);
		return -1;
	}
	owner_lock_fd = lock_fd;
	return fd;
}

char *app_channel_port_id_get(const char *app_id, const char *port)
{
	char *id = NULL;
	if (!app_id || !port || asprintf(&id, "%s@%s", app_id, port) < 0)
		return NULL;
	return id;
}

int app_channel_port_listen(const char *port_id)
{
	struct sockaddr_un addr;
	if (!address_get(port_id, &addr) || !socket_dir_make(&addr))
		return -1;
	/* A port another live process listens on stays its own. */
	if (app_channel_is_running(port_id)) {
		LOGE("%s is taken by another process", port_id);
		return -1;
	}
	return listen_at(&addr);
}

void app_channel_port_unlisten(const char *port_id, int fd)
{
	struct sockaddr_un addr;
	if (fd < 0)
		return;
	close(fd);
	if (address_get(port_id, &addr))
		unlink(addr.sun_path);
}

void app_channel_unlisten(const char *app_id, int fd)
{
	struct sockaddr_un addr;
	if (fd < 0)
		return;
	close(fd);
	if (address_get(app_id, &addr))
		unlink(addr.sun_path);
	if (owner_lock_fd >= 0)
		close(owner_lock_fd);
	owner_lock_fd = -1;
}
