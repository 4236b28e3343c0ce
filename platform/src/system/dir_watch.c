/* inotify on a key folder, dispatched through an Ecore fd handler. */
#define _GNU_SOURCE
#include "system/dir_watch.h"

#include <errno.h>
#include <stdlib.h>
#include <string.h>
#include <sys/inotify.h>
#include <unistd.h>

#include <Ecore.h>
#include <dlog.h>

#include "system/key_file_store.h"

struct dir_watch_s {
	char *path;
	int fd;
	Ecore_Fd_Handler *handler;
	dir_watch_cb cb;
	void *data;
	bool dispatching;
	bool freed; /* freed from inside its callback: released once dispatch unwinds */
};

static void __release(dir_watch_t *watch)
{
	if (watch->handler)
		ecore_main_fd_handler_del(watch->handler);
	if (watch->fd >= 0)
		close(watch->fd);
	free(watch->path);
	free(watch);
	ecore_shutdown();
}

static void __dispatch(dir_watch_t *watch, const struct inotify_event *ev)
{
	if (ev->mask & IN_Q_OVERFLOW) {
		LOGE("change queue of %s overflowed; some notices were lost", watch->path);
		return;
	}
	if (ev->mask & IN_IGNORED) {
		LOGE("%s is no longer watched (removed?)", watch->path);
		return;
	}
	if (!ev->len || (ev->mask & IN_ISDIR))
		return;
	char *key = key_file_unescape(ev->name);
	if (!key)
		return;
	if (ev->mask & (IN_CLOSE_WRITE | IN_MOVED_TO))
		watch->cb(key, DIR_WATCH_CHANGED, watch->data);
	else if (ev->mask & (IN_DELETE | IN_MOVED_FROM))
		watch->cb(key, DIR_WATCH_REMOVED, watch->data);
	free(key);
}

static Eina_Bool __readableCb(void *data, Ecore_Fd_Handler *handler)
{
	(void)handler;
	dir_watch_t *watch = data;
	char buf[8192] __attribute__((aligned(__alignof__(struct inotify_event))));
	watch->dispatching = true;
	while (!watch->freed) {
		ssize_t n = read(watch->fd, buf, sizeof(buf));
		if (n < 0 && errno == EINTR)
			continue;
		if (n <= 0)
			break;
		for (char *p = buf; p < buf + n && !watch->freed;) {
			const struct inotify_event *ev = (const struct inotify_event *)p;
			__dispatch(watch, ev);
			p += sizeof(struct inotify_event) + ev->len;
		}
	}
	watch->dispatching = false;
	if (watch->freed) {
		/* The handler is deleted by __release; tell Ecore to drop it too. */
		watch->handler = NULL;
		__release(watch);
		return ECORE_CALLBACK_CANCEL;
	}
	return ECORE_CALLBACK_RENEW;
}

dir_watch_t *dir_watch_new(const char *dir, dir_watch_cb cb, void *data)
{
	if (!dir || !cb)
		return NULL;
	int rc = key_file_make_dirs(dir);
	if (rc != 0) {
		LOGE("cannot create %s: %s", dir, strerror(-rc));
		return NULL;
	}
	dir_watch_t *watch = calloc(1, sizeof(*watch));
	if (!watch)
		return NULL;
	ecore_init();
	watch->fd = -1;
	watch->cb = cb;
	watch->data = data;
	watch->path = strdup(dir);
	watch->fd = inotify_init1(IN_NONBLOCK | IN_CLOEXEC);
	if (!watch->path || watch->fd < 0) {
		LOGE("inotify_init1 failed: %s", strerror(errno));
		__release(watch);
		return NULL;
	}
	uint32_t mask = IN_CLOSE_WRITE | IN_MOVED_TO | IN_DELETE | IN_MOVED_FROM | IN_ONLYDIR;
	if (inotify_add_watch(watch->fd, dir, mask) < 0) {
		LOGE("cannot watch %s: %s", dir, strerror(errno));
		__release(watch);
		return NULL;
	}
	watch->handler = ecore_main_fd_handler_add(watch->fd, ECORE_FD_READ, __readableCb, watch, NULL, NULL);
	if (!watch->handler) {
		LOGE("cannot add an fd handler for %s", dir);
		__release(watch);
		return NULL;
	}
	return watch;
}

void dir_watch_free(dir_watch_t *watch)
{
	if (!watch)
		return;
	if (watch->dispatching) {
		watch->freed = true;
		return;
	}
	__release(watch);
}

const char *dir_watch_path(const dir_watch_t *watch)
{
	return watch ? watch->path : NULL;
}
