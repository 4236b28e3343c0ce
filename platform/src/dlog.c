/* dlog on a desktop: each line to stderr and to <data path>/dlog.log, as "<P>/<TAG>(<pid>): <message>".
   Error and fatal lines are written at once (with every line before them). Other lines logged on the main
   loop's thread while the loop runs are gathered and written together when the loop goes idle, when the
   buffer fills and at exit, so that a burst of lines costs two writes rather than two per line. The log file
   stays open while the data path stays the same. */
#define _GNU_SOURCE
#include <dlog.h>

#include <Ecore.h>
#include <Eina.h>
#include <fcntl.h>
#include <pthread.h>
#include <stdbool.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <sys/time.h>
#include <time.h>
#include <unistd.h>

char *app_get_data_path(void);

#define LINE_MAX_BYTES 4352
#define BUFFER_BYTES (64 * 1024)

static const char PRIO_LETTERS[] = "??VDIWEFS";
/* Environment that decides the data path: the file is opened again when any of it changes. */
static const char *const PATH_ENV[] = {"TIZEN_APP_ROOT", "XDG_DATA_HOME", "HOME", "TIZEN_APP_ID"};
#define PATH_ENV_COUNT (sizeof(PATH_ENV) / sizeof(PATH_ENV[0]))

/* Recursive: the data path lookup may log while the lock is held. */
static pthread_mutex_t log_lock = PTHREAD_RECURSIVE_MUTEX_INITIALIZER_NP;
static __thread int in_log; /* app_get_data_path() may itself log */
static int log_fd = -1;
static char *log_env[PATH_ENV_COUNT];
static char buffer[BUFFER_BYTES];
static size_t buffered;
static Ecore_Idle_Enterer *flush_idler;
static bool exit_hooked;
static time_t stamp_second = -1;
static pid_t pid;
static char stamp_text[32];

static int min_level(void)
{
	const char *lvl = getenv("DLOG_LEVEL");
	return lvl ? atoi(lvl) : 0;
}

static bool env_same(const char *a, const char *b)
{
	return (!a && !b) || (a && b && !strcmp(a, b));
}

/* The open log file for the current data path, opened (again) when the path's environment changed; the
   environment is looked at once a second. */
static int log_file(bool recheck)
{
	bool same = log_fd >= 0;
	if (same && !recheck)
		return log_fd;
	for (size_t i = 0; i < PATH_ENV_COUNT && same; i++)
		same = env_same(getenv(PATH_ENV[i]), log_env[i]);
	if (same)
		return log_fd;
	if (log_fd >= 0)
		close(log_fd);
	log_fd = -1;
	for (size_t i = 0; i < PATH_ENV_COUNT; i++) {
		free(log_env[i]);
		const char *value = getenv(PATH_ENV[i]);
		log_env[i] = value ? strdup(value) : NULL;
	}
	in_log = 1;
	char *dir = app_get_data_path();
	in_log = 0;
	if (!dir)
		return -1;
	char path[4096];
	snprintf(path, sizeof(path), "%sdlog.log", dir);
	free(dir);
	log_fd = open(path, O_WRONLY | O_CREAT | O_APPEND | O_CLOEXEC, 0644);
	return log_fd;
}

static void write_all(int fd, const char *data, size_t len)
{
	while (fd >= 0 && len > 0) {
		ssize_t n = write(fd, data, len);
		if (n <= 0)
			return;
		data += n;
		len -= (size_t)n;
	}
}

static bool env_recheck;

/* Writes the gathered lines and then `line` (may be NULL) to both places. Called with the lock held. */
static void flush_locked(const char *line, size_t len)
{
	if (in_log) { /* a line of the data path lookup itself: stderr only */
		write_all(STDERR_FILENO, line, line ? len : 0);
		return;
	}
	int fd = log_file(env_recheck);
	env_recheck = false;
	if (buffered) {
		write_all(STDERR_FILENO, buffer, buffered);
		write_all(fd, buffer, buffered);
		buffered = 0;
	}
	if (line) {
		write_all(STDERR_FILENO, line, len);
		write_all(fd, line, len);
	}
}

static Eina_Bool flush_idle_cb(void *data)
{
	(void)data;
	pthread_mutex_lock(&log_lock);
	flush_idler = NULL;
	flush_locked(NULL, 0);
	pthread_mutex_unlock(&log_lock);
	return ECORE_CALLBACK_CANCEL;
}

static void flush_at_exit(void)
{
	pthread_mutex_lock(&log_lock);
	flush_locked(NULL, 0);
	pthread_mutex_unlock(&log_lock);
}

/* A fork waits for a line in progress, so that the child's lock is free. The child keeps nothing of its
   parent's log but the file: lines gathered there are the parent's to write. */
static void lock_for_fork(void)
{
	pthread_mutex_lock(&log_lock);
}

static void unlock_after_fork(void)
{
	pthread_mutex_unlock(&log_lock);
}

static void forget_after_fork(void)
{
	pid = 0;
	buffered = 0;
	flush_idler = NULL;
	pthread_mutex_unlock(&log_lock);
}

/* A line may wait for the loop to go idle only on the loop's own thread while the loop runs: nothing else
   would come back to write it. */
static bool may_wait(int prio)
{
	return prio < DLOG_ERROR && !in_log && eina_main_loop_is() && ecore_main_loop_nested_get() > 0;
}

static const char *stamp_of(const struct timeval *tv)
{
	if (tv->tv_sec != stamp_second) {
		struct tm tm;
		localtime_r(&tv->tv_sec, &tm);
		strftime(stamp_text, sizeof(stamp_text), "%m-%d %H:%M:%S", &tm);
		stamp_second = tv->tv_sec;
		env_recheck = true;
	}
	return stamp_text;
}

int __dlog_vprint(log_id_t log_id, int prio, const char *tag, const char *fmt, va_list ap)
{
	if (!fmt || log_id < LOG_ID_MAIN || log_id >= LOG_ID_MAX || prio < DLOG_UNKNOWN || prio >= DLOG_PRIO_MAX)
		return DLOG_ERROR_INVALID_PARAMETER;
	if (prio < min_level() || prio == DLOG_SILENT)
		return DLOG_ERROR_NONE;

	char msg[4096];
	vsnprintf(msg, sizeof(msg), fmt, ap);

	struct timeval tv;
	gettimeofday(&tv, NULL);

	pthread_mutex_lock(&log_lock);
	if (!pid)
		pid = getpid();
	char line[LINE_MAX_BYTES];
	int len = snprintf(line, sizeof(line), "%s.%03ld %c/%s(%5d): %s\n", stamp_of(&tv), (long)(tv.tv_usec / 1000),
	                   PRIO_LETTERS[prio], tag ? tag : "", (int)pid, msg);
	if (len < 0) {
		pthread_mutex_unlock(&log_lock);
		return DLOG_ERROR_NONE;
	}
	if (len >= (int)sizeof(line))
		len = sizeof(line) - 1;
	if (!exit_hooked) {
		exit_hooked = true;
		atexit(flush_at_exit);
		pthread_atfork(lock_for_fork, unlock_after_fork, forget_after_fork);
	}
	if (!may_wait(prio)) {
		flush_locked(line, (size_t)len);
	} else {
		if (buffered + (size_t)len > sizeof(buffer))
			flush_locked(NULL, 0);
		memcpy(buffer + buffered, line, (size_t)len);
		buffered += (size_t)len;
		if (!flush_idler)
			flush_idler = ecore_idle_enterer_add(flush_idle_cb, NULL);
	}
	pthread_mutex_unlock(&log_lock);
	return DLOG_ERROR_NONE;
}

int __dlog_print(log_id_t log_id, int prio, const char *tag, const char *fmt, ...)
{
	va_list ap;
	va_start(ap, fmt);
	int ret = __dlog_vprint(log_id, prio, tag, fmt, ap);
	va_end(ap);
	return ret;
}

int dlog_vprint(log_priority prio, const char *tag, const char *fmt, va_list ap)
{
	return __dlog_vprint(LOG_ID_APPS, prio, tag, fmt, ap);
}

int dlog_print(log_priority prio, const char *tag, const char *fmt, ...)
{
	va_list ap;
	va_start(ap, fmt);
	int ret = __dlog_vprint(LOG_ID_APPS, prio, tag, fmt, ap);
	va_end(ap);
	return ret;
}
