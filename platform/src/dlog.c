/* dlog on a desktop: each line to stderr and to <data path>/dlog.log, as "<P>/<TAG>(<pid>): <message>".
   Lines below fatal logged on the main thread while the main loop runs (in an app, from its create on) are
   gathered and written together: when the loop goes idle (before the frame is drawn), when 64 KiB have
   gathered, at exit, before a fatal line or a line of another thread (so the order stays), and from the
   handler of a crash signal before the process dies. A burst of lines thus costs a few writes rather than two
   per line; only a process killed outright loses the lines of its current loop iteration. The log file stays
   open while the data path stays the same. */
#define _GNU_SOURCE
#include <dlog.h>

#include <Ecore.h>
#include <Eina.h>
#include <fcntl.h>
#include <pthread.h>
#include <signal.h>
#include <stdbool.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <sys/time.h>
#include <time.h>
#include <unistd.h>

#include "dlog_private.h"

char *app_get_data_path(void);

#define LINE_MAX_BYTES 4352
#define MESSAGE_MAX_BYTES 4096
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
static bool hooked;
static bool gather_main;
static time_t stamp_second = -1;
static pid_t pid;
static char pid_text[16];
static char stamp_text[32];
static int level; /* DLOG_LEVEL, read again with the environment once a second */

static int read_level(void)
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

void dlog_flush(void)
{
	pthread_mutex_lock(&log_lock);
	flush_locked(NULL, 0);
	pthread_mutex_unlock(&log_lock);
}

static void flush_at_exit(void)
{
	dlog_flush();
}

void dlog_gather_main_thread(bool on)
{
	pthread_mutex_lock(&log_lock);
	gather_main = on;
	if (!on) {
		flush_locked(NULL, 0);
		/* The loop may be shut down next, its idle enterers with it. */
		if (flush_idler)
			ecore_idle_enterer_del(flush_idler);
		flush_idler = NULL;
	}
	pthread_mutex_unlock(&log_lock);
}

/* A crash writes what was gathered (write() alone: no lock, no allocation), then dies as it would have. */
static const int CRASH_SIGNALS[] = {SIGSEGV, SIGBUS, SIGILL, SIGFPE, SIGABRT};

static void crash_cb(int sig)
{
	const size_t len = buffered;
	buffered = 0;
	write_all(STDERR_FILENO, buffer, len);
	write_all(log_fd, buffer, len);
	raise(sig); /* SA_RESETHAND: the default action now */
}

/* Handlers others set (a debugger's, a sanitizer's) are left as they are. */
static void hook_crash_signals(void)
{
	for (size_t i = 0; i < sizeof(CRASH_SIGNALS) / sizeof(CRASH_SIGNALS[0]); i++) {
		struct sigaction old;
		if (sigaction(CRASH_SIGNALS[i], NULL, &old) != 0 || (old.sa_flags & SA_SIGINFO) || old.sa_handler != SIG_DFL)
			continue;
		struct sigaction action;
		memset(&action, 0, sizeof(action));
		action.sa_handler = crash_cb;
		action.sa_flags = SA_RESETHAND | SA_NODEFER;
		sigemptyset(&action.sa_mask);
		sigaction(CRASH_SIGNALS[i], &action, NULL);
	}
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
	gather_main = false;
	buffered = 0;
	flush_idler = NULL;
	pthread_mutex_unlock(&log_lock);
}

/* A line may wait only on the main thread while the loop runs or is about to: nothing else would come back
   to write it. */
static bool may_wait(int prio)
{
	return prio < DLOG_FATAL && !in_log && eina_main_loop_is() && (gather_main || ecore_main_loop_nested_get() > 0);
}

static const char *stamp_of(const struct timeval *tv)
{
	if (tv->tv_sec != stamp_second) {
		struct tm tm;
		localtime_r(&tv->tv_sec, &tm);
		strftime(stamp_text, sizeof(stamp_text), "%m-%d %H:%M:%S", &tm);
		stamp_second = tv->tv_sec;
		env_recheck = true;
		level = read_level();
	}
	return stamp_text;
}

/* Appends at most the room left of out (cap bytes, at) and returns the new end. */
static size_t put(char *out, size_t at, size_t cap, const char *text, size_t len)
{
	if (at + len > cap)
		len = cap - at;
	memcpy(out + at, text, len);
	return at + len;
}

static size_t put_number(char *out, size_t at, size_t cap, long long value)
{
	char digits[24];
	size_t n = sizeof(digits);
	unsigned long long magnitude = value < 0 ? 0ULL - (unsigned long long)value : (unsigned long long)value;
	do {
		digits[--n] = (char)('0' + magnitude % 10);
		magnitude /= 10;
	} while (magnitude);
	if (value < 0)
		digits[--n] = '-';
	return put(out, at, cap, digits + n, sizeof(digits) - n);
}

/* Formats with no other conversions than %s, %d, %i, %u, %c and %%: the app's lines. */
static bool is_simple(const char *fmt)
{
	for (const char *p = strchr(fmt, '%'); p; p = strchr(p + 2, '%'))
		if (!p[1] || !strchr("sdiuc%", p[1]))
			return false;
	return true;
}

/* The message as vsnprintf would give it, cut to cap - 1 bytes; returns its length. The app's simple formats
   are done here, at a fraction of the cost. */
static size_t format_message(char *out, size_t cap, const char *fmt, va_list ap)
{
	if (!is_simple(fmt)) {
		int n = vsnprintf(out, cap, fmt, ap);
		return n < 0 ? 0 : ((size_t)n >= cap ? cap - 1 : (size_t)n);
	}
	const size_t room = cap - 1;
	size_t at = 0;
	for (const char *p = fmt; *p;) {
		const char *mark = strchrnul(p, '%');
		at = put(out, at, room, p, (size_t)(mark - p));
		if (!*mark)
			break;
		switch (mark[1]) {
		case 's': {
			const char *text = va_arg(ap, const char *);
			if (!text)
				text = "(null)";
			at = put(out, at, room, text, strlen(text));
			break;
		}
		case 'd':
		case 'i':
			at = put_number(out, at, room, va_arg(ap, int));
			break;
		case 'u':
			at = put_number(out, at, room, va_arg(ap, unsigned int));
			break;
		case 'c': {
			const char c = (char)va_arg(ap, int);
			at = put(out, at, room, &c, 1);
			break;
		}
		default:
			at = put(out, at, room, "%", 1);
			break;
		}
		p = mark + 2;
	}
	out[at] = '\0';
	return at;
}

/* "MM-DD hh:mm:ss.mmm P/TAG(  pid): message\n" into out (LINE_MAX_BYTES); returns its length. Called with
   the lock held. */
static size_t format_line(char *out, const struct timeval *tv, int prio, const char *tag, const char *fmt, va_list ap)
{
	const size_t room = LINE_MAX_BYTES - 1; /* the line end always fits */
	const char *stamp = stamp_of(tv);
	size_t at = put(out, 0, room, stamp, strlen(stamp));
	const long ms = (long)(tv->tv_usec / 1000);
	const char head[] = {
	    '.', (char)('0' + ms / 100), (char)('0' + ms / 10 % 10), (char)('0' + ms % 10), ' ', PRIO_LETTERS[prio], '/'};
	at = put(out, at, room, head, sizeof(head));
	if (tag)
		at = put(out, at, room, tag, strnlen(tag, 64));
	at = put(out, at, room, pid_text, strlen(pid_text));
	size_t cap = room - at + 1;
	if (cap > MESSAGE_MAX_BYTES)
		cap = MESSAGE_MAX_BYTES;
	at += format_message(out + at, cap, fmt, ap);
	out[at++] = '\n';
	return at;
}

int __dlog_vprint(log_id_t log_id, int prio, const char *tag, const char *fmt, va_list ap)
{
	if (!fmt || log_id < LOG_ID_MAIN || log_id >= LOG_ID_MAX || prio < DLOG_UNKNOWN || prio >= DLOG_PRIO_MAX)
		return DLOG_ERROR_INVALID_PARAMETER;
	if (prio == DLOG_SILENT)
		return DLOG_ERROR_NONE;

	struct timeval tv;
	gettimeofday(&tv, NULL);

	pthread_mutex_lock(&log_lock);
	if (!hooked) {
		hooked = true;
		level = read_level();
		atexit(flush_at_exit);
		pthread_atfork(lock_for_fork, unlock_after_fork, forget_after_fork);
		hook_crash_signals();
	}
	if (!pid) {
		pid = getpid();
		snprintf(pid_text, sizeof(pid_text), "(%5d): ", (int)pid);
	}
	stamp_of(&tv);
	if (prio < level) {
		pthread_mutex_unlock(&log_lock);
		return DLOG_ERROR_NONE;
	}
	if (!may_wait(prio)) {
		char line[LINE_MAX_BYTES];
		flush_locked(line, format_line(line, &tv, prio, tag, fmt, ap));
	} else {
		if (sizeof(buffer) - buffered < LINE_MAX_BYTES)
			flush_locked(NULL, 0);
		if (log_fd < 0) /* open for a crash to write to */
			log_file(false);
		buffered += format_line(buffer + buffered, &tv, prio, tag, fmt, ap);
		/* Before the canvas's own: the lines of a step are written before its frame is drawn. */
		if (!flush_idler)
			flush_idler = ecore_idle_enterer_before_add(flush_idle_cb, NULL);
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
