/* dlog on a desktop: each line to stderr and to <data path>/dlog.log, as "<P>/<TAG>(<pid>): <message>". */
#include <dlog.h>

#include <pthread.h>
#include <stdio.h>
#include <stdlib.h>
#include <sys/time.h>
#include <time.h>
#include <unistd.h>

char *app_get_data_path(void);

static const char PRIO_LETTERS[] = "??VDIWEFS";
static pthread_mutex_t log_lock = PTHREAD_MUTEX_INITIALIZER;
static __thread int in_log; /* app_get_data_path() may itself log */

static int min_level(void)
{
	const char *lvl = getenv("DLOG_LEVEL");
	return lvl ? atoi(lvl) : 0;
}

static FILE *open_log_file(void)
{
	char *dir = app_get_data_path();
	if (!dir)
		return NULL;
	char path[4096];
	snprintf(path, sizeof(path), "%sdlog.log", dir);
	free(dir);
	return fopen(path, "a");
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
	struct tm tm;
	localtime_r(&tv.tv_sec, &tm);
	char stamp[32];
	strftime(stamp, sizeof(stamp), "%m-%d %H:%M:%S", &tm);

	char line[4352];
	int len = snprintf(line, sizeof(line), "%s.%03ld %c/%s(%5d): %s\n", stamp, (long)(tv.tv_usec / 1000),
			   PRIO_LETTERS[prio], tag ? tag : "", (int)getpid(), msg);
	if (len < 0)
		return DLOG_ERROR_NONE;
	if (len >= (int)sizeof(line))
		len = sizeof(line) - 1;

	pthread_mutex_lock(&log_lock);
	fwrite(line, 1, len, stderr);
	if (!in_log) {
		in_log = 1;
		FILE *f = open_log_file();
		if (f) {
			fwrite(line, 1, len, f);
			fclose(f);
		}
		in_log = 0;
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
